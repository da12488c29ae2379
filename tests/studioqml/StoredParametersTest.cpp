#include "QmlPage.h"

#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/ParameterRegistry.h"
#include "TesselDataStore/DataStore.h"
#include "TesselParameters/ParameterGroup.h"
#include "TesselParametersGUI/ParameterGroupModel.h"

#include <gtest/gtest.h>

namespace
{

using TesselDataStore::ToVariant;
using TesselParameters::VParameter;
using TesselParameters::VParameterGroup;
using TesselPluginInterface::EPresentationHint;
using TesselPluginInterface::IParameter;

/// A view of a group as modules make them, over a store and the host's registry.
class StoredParameters : public testing::Test
{
protected:
	StoredParameters()
	{
		m_pWeight = m_pGroup->Add<double>("TargetWeight", "Weight", "How much it counts.");
		m_pWeight->SetDefault(1.0);
		m_pWeight->SetLimits(1.0, 100.0);
		m_pWeight->SetPresentationHint(EPresentationHint::ESlider);
		m_pRoot = m_pGroup->Add<std::uint32_t>("TargetRoot", "Target Root");
		m_pRoot->SetEnumeration({});
		m_pState = m_pGroup->Add<std::string>("TargetStateExpressionX", "State X");
		m_pFlag = m_pGroup->Add<bool>("Flag", "Flag");
	}

	bool Show()
	{
		m_Page.m_Services.m_MakeParameterGroupModel = [this](const QString& i_rPath, const QString& i_rGroup) {
			return std::make_unique<TesselParametersGUI::VParameterGroupModel>(
			    m_pRegistry, m_pDispatcher, i_rPath, i_rGroup);
		};
		return m_Page.Show("ParameterView { objectName: \"view\"; width: 400\n"
		                   "model: TesselParameters.ParameterGroupModel(\"RetargetSetup\", \"Target\") }");
	}
	void TypeInto(const QString& i_rName, const QString& i_rText)
	{
		m_Page.Click(i_rName);
		m_Page.Key(Qt::Key_A, Qt::ControlModifier);
		m_Page.Type(i_rText);
		m_Page.Key(Qt::Key_Return);
		m_pDispatcher->RunPending();
	}

	const std::shared_ptr<InMemoryHost::VParameterRegistry> m_pRegistry =
	    std::make_shared<InMemoryHost::VParameterRegistry>();
	const std::shared_ptr<InMemoryHost::VDispatcher> m_pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	std::shared_ptr<VParameterGroup> m_pGroup =
	    std::make_shared<VParameterGroup>(std::make_shared<TesselDataStore::VDataStore>(), "RetargetSetup", "Target");
	std::shared_ptr<VParameter> m_pWeight;
	std::shared_ptr<VParameter> m_pRoot;
	std::shared_ptr<VParameter> m_pState;
	std::shared_ptr<VParameter> m_pFlag;
	VQmlPage m_Page;
};

} // namespace

TEST_F(StoredParameters, ViewBeforeAndAfterItsGroup)
{
	ASSERT_TRUE(Show());
	EXPECT_FALSE(m_Page.Has("TargetWeight"));
	m_pRegistry->Register("RetargetSetup", m_pGroup);
	EXPECT_TRUE(m_Page.Has("TargetWeight"));
	EXPECT_EQ(m_Page.Property("TargetWeight", "text"), "1");

	// A module that goes while somebody types takes its parameters along.
	m_Page.Click("TargetWeight");
	m_Page.Type("7");
	m_pWeight.reset();
	m_pRoot.reset();
	m_pState.reset();
	m_pFlag.reset();
	m_pGroup.reset();
	m_pDispatcher->RunPending();
	EXPECT_FALSE(m_Page.Has("TargetWeight"));
	m_Page.Key(Qt::Key_Return);
}

TEST_F(StoredParameters, WhatIsTypedReachesTheStore)
{
	m_pRegistry->Register("RetargetSetup", m_pGroup);
	ASSERT_TRUE(Show());
	TypeInto("TargetWeight", "12.5");
	double weight = 0;
	ASSERT_TRUE(m_pWeight->Get(weight));
	EXPECT_EQ(weight, 12.5);
	EXPECT_EQ(m_Page.Property("TargetWeight", "text"), "12.5");

	TypeInto("TargetWeight", "500");
	EXPECT_EQ(m_Page.Property("TargetWeightReason", "text"), "Value is greater than permitted maximum");
	ASSERT_TRUE(m_pWeight->Get(weight));
	EXPECT_EQ(weight, 12.5);
	m_Page.Key(Qt::Key_Escape);

	// Limits do not bind a file.
	m_pWeight->Set(0.5);
	m_pDispatcher->RunPending();
	EXPECT_EQ(m_Page.Property("TargetWeight", "text"), "0.5");

	TypeInto("TargetStateExpressionX", "1*GlobalScale");
	std::string text;
	ASSERT_TRUE(m_pState->Get(text));
	EXPECT_EQ(text, "1*GlobalScale");

	for (const bool bExpected : {true, false})
	{
		m_Page.Click("Flag");
		m_pDispatcher->RunPending();
		bool bFlag = !bExpected;
		ASSERT_TRUE(m_pFlag->Get(bFlag));
		EXPECT_EQ(bFlag, bExpected);
		EXPECT_EQ(m_Page.Property("Flag", "checked"), bExpected);
	}
}

TEST_F(StoredParameters, EnumerationThatIsFilledLater)
{
	m_pRegistry->Register("RetargetSetup", m_pGroup);
	ASSERT_TRUE(Show());
	EXPECT_EQ(m_Page.Property("TargetRoot", "count"), 0);
	m_Page.Click("TargetRoot");
	m_Page.Key(Qt::Key_Return);
	EXPECT_FALSE(m_pRoot->HasValue());

	std::vector<TesselPluginInterface::VEnumEntry> bones;
	for (std::uint32_t bone = 0; bone < 200; ++bone)
		bones.push_back({std::string(bone % 7, ' ') + "Bone" + std::to_string(bone), ToVariant(bone)});
	m_pRoot->SetEnumeration(bones);
	m_pRoot->Set(0u);
	m_pDispatcher->RunPending();
	EXPECT_EQ(m_Page.Property("TargetRoot", "displayText"), "Bone0");
	m_Page.Click("TargetRoot");
	m_Page.Type("bone13");
	m_Page.Key(Qt::Key_Down);
	m_Page.Key(Qt::Key_Return);
	m_pDispatcher->RunPending();
	std::uint32_t root = 0;
	ASSERT_TRUE(m_pRoot->Get(root));
	EXPECT_EQ(root, 130u);
	EXPECT_EQ(m_Page.Property("TargetRoot", "displayText"), "Bone130");
}

TEST_F(StoredParameters, FlagsOfAParameterHideItsRow)
{
	m_pRegistry->Register("RetargetSetup", m_pGroup);
	ASSERT_TRUE(Show());
	EXPECT_TRUE(m_Page.Has("TargetStateExpressionX"));
	m_pState->SetFlag(IParameter::EHidden, true);
	m_pDispatcher->RunPending();
	EXPECT_FALSE(m_Page.Has("TargetStateExpressionX"));
	m_pState->SetFlag(IParameter::EHidden, false);
	m_pDispatcher->RunPending();
	EXPECT_TRUE(m_Page.Has("TargetStateExpressionX"));
}
