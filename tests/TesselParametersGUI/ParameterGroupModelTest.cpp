#include "TesselParametersGUI/ParameterGroupModel.h"

#include "TesselParameters/ParameterGroup.h"

#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/ParameterRegistry.h"
#include "TesselDataStore/DataStore.h"

#include <QAbstractItemModelTester>
#include <QSignalSpy>

#include <gtest/gtest.h>

namespace
{

using namespace TesselPluginInterface;
using TesselDataStore::ToVariant;
using TesselParameters::VParameterGroup;
using TesselParametersGUI::VParameterGroupModel;

class GroupModel : public testing::Test
{
protected:
	GroupModel()
	{
		m_pWeight = m_pGroup->Add<double>("TargetWeight", "Weight", "How much it counts.");
		m_pWeight->SetDefault(1.0);
		m_pWeight->SetLimits(1.0, 100.0);
		m_pWeight->SetPresentationHint(EPresentationHint::ESlider);
		m_pRoot = m_pGroup->Add<std::uint32_t>("TargetRoot", "Target Root");
		m_pRoot->SetEnumeration({{"Hips", ToVariant(0u)}, {" Spine", ToVariant(1u)}});
	}

	QVariant Get(int i_Row, const char* i_pRole) const
	{
		return m_Model.data(m_Model.index(i_Row), m_Model.roleNames().key(i_pRole, -1));
	}

	const std::shared_ptr<InMemoryHost::VParameterRegistry> m_pRegistry =
	    std::make_shared<InMemoryHost::VParameterRegistry>();
	const std::shared_ptr<InMemoryHost::VDispatcher> m_pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	std::shared_ptr<VParameterGroup> m_pGroup =
	    std::make_shared<VParameterGroup>(std::make_shared<TesselDataStore::VDataStore>(), "RetargetSetup", "Target");
	std::shared_ptr<TesselParameters::VParameter> m_pWeight;
	std::shared_ptr<TesselParameters::VParameter> m_pRoot;
	VParameterGroupModel m_Model{m_pRegistry, m_pDispatcher, "RetargetSetup", "Target"};
	QAbstractItemModelTester m_Tester{&m_Model, QAbstractItemModelTester::FailureReportingMode::Fatal};
};

TEST_F(GroupModel, WorksBeforeAndAfterTheGroupIsThere)
{
	EXPECT_EQ(m_Model.rowCount(), 0);
	EXPECT_NE(m_Model.setValueText(0, "1"), "");
	m_pRegistry->Register("RetargetSetup", std::make_shared<VParameterGroup>(nullptr, "RetargetSetup", "Subject"));
	EXPECT_EQ(m_Model.rowCount(), 0);
	m_pRegistry->Register("RetargetSetup", m_pGroup);
	ASSERT_EQ(m_Model.rowCount(), 2);
	EXPECT_EQ(m_Model.rowCount(m_Model.index(0)), 0);
	const auto pChild = std::make_shared<VParameterGroup>(nullptr, "RetargetSetup", "Child");
	pChild->Add<bool>("Flag");
	m_pGroup->AddChild(pChild);
	ASSERT_EQ(m_Model.rowCount(), 3);
	EXPECT_EQ(Get(2, "type"), "bool");

	// It ends: nothing of it is shown, kept or called any more.
	const std::weak_ptr<IParameterGroup> pGroup = m_pGroup;
	m_pWeight->Set(7.0);
	m_pGroup.reset();
	EXPECT_TRUE(pGroup.expired());
	EXPECT_EQ(m_Model.rowCount(), 0);
	m_pDispatcher->RunPending();
	EXPECT_EQ(m_pWeight.use_count(), 1);
	pChild->Find("Flag")->SetValue(ToVariant(true));
	EXPECT_EQ(m_pDispatcher->PendingCount(), 0u);
}

TEST_F(GroupModel, GivesEachRole)
{
	m_pRegistry->Register("RetargetSetup", m_pGroup);
	m_pRoot->Set(1u);
	m_pDispatcher->RunPending();
	const QVariant none;
	const struct
	{
		const char* m_pRole;
		QVariant m_Weight;
		QVariant m_Root;
	} rows[] = {
	    {"name", "TargetWeight", "TargetRoot"},
	    {"display", "Weight", "Target Root"},
	    {"description", "How much it counts.", ""},
	    {"category", "", ""},
	    {"value", 1.0, 1u},
	    {"valueText", "1", "1"},
	    {"hasValue", true, true},
	    {"defaultText", "1", ""},
	    {"presentationHint", 1, 0},
	    {"dataConversionHint", 0, 0},
	    {"fileAccess", 0, 0},
	    {"fileFilter", "", ""},
	    {"validatorRegEx", "", ""},
	    {"hidden", false, false},
	    {"advanced", false, false},
	    {"dynamic", false, false},
	    {"minimum", 1.0, none},
	    {"maximum", 100.0, none},
	    {"enumerated", false, true},
	    {"enumNames", QStringList(), QStringList({"Hips", " Spine"})},
	    {"enumTexts", QStringList(), QStringList({"0", "1"})},
	    {"currentEnumIndex", -1, 1},
	    {"type", "double", "int"},
	};
	EXPECT_EQ(m_Model.roleNames().size(), int(std::size(rows)));
	for (const auto& rRow : rows)
	{
		EXPECT_EQ(Get(0, rRow.m_pRole), rRow.m_Weight) << rRow.m_pRole;
		EXPECT_EQ(Get(1, rRow.m_pRole), rRow.m_Root) << rRow.m_pRole;
	}
	EXPECT_EQ(m_Model.data(m_Model.index(0), Qt::DisplayRole), "Weight");
}

TEST_F(GroupModel, TellsWhatChanged)
{
	m_pRegistry->Register("RetargetSetup", m_pGroup);
	QSignalSpy spy(&m_Model, &QAbstractItemModel::dataChanged);
	const auto changed = [&]
	{
		m_pDispatcher->RunPending();
		QStringList told;
		for (const QList<QVariant>& rArguments : std::exchange(static_cast<QList<QList<QVariant>>&>(spy), {}))
		{
			QStringList roles;
			for (const int role : rArguments[2].value<QVector<int>>())
				roles.push_back(m_Model.roleNames().value(role));
			roles.sort();
			told.push_back(QString::number(rArguments[0].toModelIndex().row()) + ' ' + roles.join(' '));
		}
		return told;
	};
	m_pWeight->Set(2.0);
	EXPECT_EQ(changed(), QStringList{"0 value valueText"});
	m_pRoot->Set(1u);
	EXPECT_EQ(changed(), QStringList{"1 currentEnumIndex hasValue value valueText"});
	m_pRoot->SetFlag(IParameter::EHidden, true);
	EXPECT_EQ(changed(), QStringList{"1 hidden"});
	m_pRoot->SetEnumeration({{"Spine", ToVariant(1u)}});
	EXPECT_EQ(changed(), QStringList{"1 currentEnumIndex enumNames enumTexts"});
	m_pRoot->SetDisplay("Root");
	EXPECT_EQ(changed(), QStringList{"1  display"});
	m_pRoot->ClearValue();
	EXPECT_EQ(changed(), QStringList{"1 currentEnumIndex hasValue value valueText"});
	m_pRoot->SetDisplay("Root");
	EXPECT_EQ(changed(), QStringList());
}

TEST_F(GroupModel, TakesWhatTheUserEnters)
{
	m_pRegistry->Register("RetargetSetup", m_pGroup);
	EXPECT_EQ(m_Model.setValueText(0, "5"), "");
	EXPECT_EQ(m_pWeight->GetValueText(), "5");
	EXPECT_EQ(m_Model.setValueText(0, "0.5"), "Value is less than permitted minimum");
	EXPECT_EQ(m_Model.setValueText(0, "five"), "Value is not a number");
	EXPECT_EQ(m_pWeight->GetValueText(), "5");
	m_Model.resetToDefault(0);
	EXPECT_EQ(m_pWeight->GetValueText(), "1");
	EXPECT_TRUE(m_Model.setEnumIndex(1, 1));
	EXPECT_EQ(m_pRoot->GetValueText(), "1");
	for (const int index : {-1, 2})
		EXPECT_FALSE(m_Model.setEnumIndex(1, index));
	EXPECT_FALSE(m_Model.setEnumIndex(2, 0));
	EXPECT_FALSE(m_Model.setEnumIndex(-1, 0));
	EXPECT_EQ(m_pRoot->GetValueText(), "1");

	// The list has changed, and the user has not been shown the new one.
	m_pRoot->SetEnumeration({{"Spine", ToVariant(1u)}, {"Hips", ToVariant(0u)}});
	EXPECT_TRUE(m_Model.setEnumIndex(1, 0));
	EXPECT_EQ(m_pRoot->GetValueText(), "0");
}

TEST_F(GroupModel, MayEndBeforeItsCallbacks)
{
	m_pRegistry->Register("RetargetSetup", m_pGroup);
	{
		const VParameterGroupModel other(m_pRegistry, m_pDispatcher, "RetargetSetup", "Target");
		m_pWeight->Set(3.0);
	}
	m_pDispatcher->RunPending();
	m_pGroup->Add<bool>("Flag");
	m_pRegistry->Register("RetargetSetup", m_pGroup);
	EXPECT_EQ(m_Model.rowCount(), 3);
}

} // namespace
