#include "QmlPage.h"

#include <gtest/gtest.h>

TEST(Controls, Load)
{
	VQmlPage page;
	ASSERT_TRUE(page.Show("OrlexButton { objectName: \"b\"; text: \"x\" }"));
}
