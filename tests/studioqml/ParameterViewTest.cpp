#include "FakeParameterModel.h"
#include "QmlPage.h"

#include <gtest/gtest.h>

TEST(ParameterView, Load)
{
	VFakeParameterModel model({{.m_Name = "A"}});
	VQmlPage page;
	page.SetContext("group", &model);
	ASSERT_TRUE(page.Show("ParameterView { objectName: \"v\"; width: 300; model: group }"));
	page.Click("A");
	EXPECT_EQ(page.FocusName(), "A");
}
