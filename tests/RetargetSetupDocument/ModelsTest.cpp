#include "NVX/SelectionItemVariant.h"
#include "RetargetSetupDocument/RetargetSetupSegmentModel.h"
#include "RetargetSetupDocument/RetargetSetupTargetModel.h"
#include "RetargetSetupDocument/RoleNames.h"
#include "TestDocument.h"

#include <QAbstractItemModelTester>
#include <QCoreApplication>
#include <QMetaType>
#include <QQmlComponent>
#include <QQmlEngine>
#include <gtest/gtest.h>

namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;
using VSegmentModel = VRetargetSetupSegmentModel;
using VTargetModel = VRetargetSetupTargetModel;

/// What a model emits, in order.
template <typename TModel>
class VWatched
{
public:
	template <typename... VArguments>
	explicit VWatched(VArguments... i_Arguments)
	    : m_Model(i_Arguments...), m_Tester(&m_Model, QAbstractItemModelTester::FailureReportingMode::Fatal)
	{
		const auto note = [this](const char* i_pWhat)
		{
			return [this, i_pWhat](const QModelIndex&, int i_First, int i_Last)
			{ m_Told += i_pWhat + std::to_string(i_First) + "-" + std::to_string(i_Last) + ";"; };
		};
		QObject::connect(&m_Model, &TModel::rowsRemoved, note("removed "));
		QObject::connect(&m_Model, &TModel::rowsInserted, note("inserted "));
		QObject::connect(&m_Model, &TModel::modelReset, [this] { m_Told += "reset;"; });
		QObject::connect(&m_Model, &TModel::dataChanged,
		    [this](const QModelIndex& i_rFirst, const QModelIndex& i_rLast, const QVector<int>& i_rRoles)
		    {
			    m_Told += "changed " + std::to_string(i_rFirst.row()) + "-" + std::to_string(i_rLast.row())
			        + (i_rRoles.isEmpty() ? ";" : " some roles;");
		    });
	}

	std::string Take() { return std::exchange(m_Told, {}); }

	TModel m_Model;

private:
	QAbstractItemModelTester m_Tester;
	std::string m_Told;
};

std::shared_ptr<const VSubjectParametrised> Shared(VSubjectParametrised i_Subject)
{
	return std::make_shared<const VSubjectParametrised>(std::move(i_Subject));
}

VSubjectParametrised WithTargets(std::size_t i_Count)
{
	VSubjectParametrised subject = MakeSubject({{"pelvis", -1}, {"arm", 0}});
	subject.m_Markers.resize(1);
	subject.m_Markers[0].m_Name = "Hips";
	subject.m_Rotations = {{"Wrist", 1}};
	for (std::size_t i = 0; i < i_Count; ++i)
	{
		VTarget& rTarget = subject.m_Targets.emplace_back();
		rTarget.m_Type = i % 2 ? VTarget::ELocalRotationToWorldRotation : VTarget::ELocalPointToWorldPoint;
		rTarget.m_MarkerIndices = {0};
		rTarget.m_RotationObservationIndices = {0};
		rTarget.m_SegmentIndices = {1};
		rTarget.m_Weight = double(i) + 0.5;
	}
	return subject;
}

TEST(RoleName, Rows)
{
	const std::pair<const char*, const char*> rows[] = {{"Name", "name"}, {"SelectionItem", "selectionItem"},
	    {"NameRole", "name"}, {"ENameRole", "name"}, {"EName", "name"}, {"Event", "event"}, {"EN", "eN"}, {"ENa", "na"},
	    {"Role", ""}, {"E", "e"}};
	for (const auto& [key, expected] : rows)
		EXPECT_EQ(RetargetSetup::RoleName(key).toStdString(), expected) << key;
}

TEST(SegmentModel, RowsAndRoles)
{
	for (const auto flavour : {VSegmentModel::EFlavour::ESource, VSegmentModel::EFlavour::ETarget})
	{
		VWatched<VSegmentModel> watched(flavour);
		VSegmentModel& rModel = watched.m_Model;
		EXPECT_EQ(rModel.rowCount(), 0);
		EXPECT_FALSE(rModel.data(rModel.index(0, 0), VSegmentModel::Name).isValid());
		const auto pSubject = Shared(MakeSubject({{"Hips", -1},
		    {"Stra\xC3\x9F"
		     "e",
		        0}}));
		rModel.SetSubject(pSubject);
		rModel.SetSubject(pSubject);
		EXPECT_EQ(watched.Take(), "reset;reset;") << "an equal subject resets too";
		EXPECT_EQ(rModel.rowCount(), 2);
		EXPECT_EQ(rModel.columnCount(), 1);
		EXPECT_EQ(rModel.data(rModel.index(1, 0), VSegmentModel::Name).toString(), QString::fromUtf8("Straße"));
		const QVariant item = rModel.data(rModel.index(1, 0), VSegmentModel::SelectionItem);
		EXPECT_EQ(item.userType(), QMetaType::type("NVX::ISelectionItem"));
		EXPECT_EQ(item.value<NVX::ISelectionItem>(),
		    (NVX::ISelectionItem{flavour == VSegmentModel::EFlavour::ESource ? 11u : 14u, 0x0FFFFFFFu, 1u, {}}));
		EXPECT_FALSE(rModel.data(rModel.index(1, 0), Qt::DisplayRole).isValid());
	}
	EXPECT_EQ(VSegmentModel(VSegmentModel::EFlavour::ESource).roleNames(),
	    (QHash<int, QByteArray>{{257, "name"}, {258, "selectionItem"}}));
}

TEST(TargetModel, RolesOfEachType)
{
	VSubjectParametrised subject = WithTargets(4);
	subject.m_Targets[2].m_Type = VTarget::ERigidBody;
	subject.m_Targets[3].m_SegmentIndices = {9};
	subject.m_Targets[3].m_RotationObservationIndices = {1};
	VTargetModel model;
	model.SetSubject(Shared(subject));
	const auto text = [&model](int i_Row, int i_Role)
	{
		const QVariant value = model.data(model.index(i_Row, 0), i_Role);
		return value.isValid() ? value.toString().toStdString() : "nothing";
	};
	const char* const expected[4][4] = {{"Hips", "arm", "Position", "0.5"}, {"Wrist", "arm", "Rotation", "1.5"},
	    {"nothing", "arm", "nothing", "2.5"}, {"nothing", "nothing", "Rotation", "3.5"}};
	for (int row = 0; row < 4; ++row)
		for (int role = 0; role < 4; ++role)
			EXPECT_EQ(text(row, VTargetModel::SourceSegment + role), expected[row][role]) << row << " " << role;
	EXPECT_EQ(model.data(model.index(3, 0), VTargetModel::SelectionItem).value<NVX::ISelectionItem>(),
	    (NVX::ISelectionItem{16u, 0x0FFFFFFFu, 3u, {}}));
	EXPECT_EQ(text(0, Qt::DisplayRole), "nothing");
	EXPECT_EQ(text(4, VTargetModel::Weight), "nothing");
	EXPECT_EQ(model.roleNames(),
	    (QHash<int, QByteArray>{{257, "sourceSegment"}, {258, "targetSegment"}, {259, "targetType"}, {260, "weight"},
	        {261, "selectionItem"}}));
}

TEST(TargetModel, KeepsRowsThatStay)
{
	const struct
	{
		std::size_t m_Before;
		std::size_t m_After;
		const char* m_pTold;
	} rows[] = {
	    {0, 3, "inserted 0-2;"},
	    {3, 5, "inserted 3-4;changed 0-2;"},
	    {5, 4, "removed 4-4;changed 0-3;"},
	    {2, 0, "removed 0-1;"},
	    {3, 3, ""},
	};
	for (const auto& rRow : rows)
	{
		VWatched<VTargetModel> watched;
		watched.m_Model.SetSubject(Shared(WithTargets(rRow.m_Before)));
		watched.Take();
		watched.m_Model.SetSubject(Shared(WithTargets(rRow.m_After)));
		EXPECT_EQ(watched.Take(), rRow.m_pTold) << rRow.m_Before << " to " << rRow.m_After;
		EXPECT_EQ(watched.m_Model.rowCount(), int(rRow.m_After));
	}
}

TEST(TargetModel, IsEmptyWithoutASubject)
{
	VWatched<VTargetModel> watched;
	EXPECT_EQ(watched.m_Model.rowCount(), 0);
	for (int role = VTargetModel::SourceSegment; role <= VTargetModel::SelectionItem; ++role)
		EXPECT_FALSE(watched.m_Model.data(watched.m_Model.index(0, 0), role).isValid()) << role;
}

TEST(ListModels, NothingStandsBelowARow)
{
	VSegmentModel segments(VSegmentModel::EFlavour::ESource);
	VTargetModel targets;
	for (const auto pSubject = Shared(WithTargets(3));
	     auto* const pModel : {static_cast<QAbstractItemModel*>(&segments), static_cast<QAbstractItemModel*>(&targets)})
	{
		pModel == &targets ? targets.SetSubject(pSubject) : segments.SetSubject(pSubject);
		ASSERT_GT(pModel->rowCount(), 0);
		EXPECT_EQ(pModel->rowCount(pModel->index(0, 0)), 0);
		EXPECT_EQ(pModel->columnCount(pModel->index(0, 0)), 0);
	}
}

TEST(ListModels, TheirRolesAreKnownToQml)
{
	int count = 1;
	char name[] = "test";
	char* arguments[] = {name, nullptr};
	QCoreApplication application(count, arguments);
	const VSegmentModel segments(VSegmentModel::EFlavour::ESource);
	const VTargetModel targets;
	QQmlEngine engine;
	const struct
	{
		const char* m_pRole;
		int m_Value;
	} rows[] = {
	    {"RetargetSetupSegmentModel.Name", 257},
	    {"RetargetSetupSegmentModel.SelectionItem", 258},
	    {"RetargetSetupTargetModel.SourceSegment", 257},
	    {"RetargetSetupTargetModel.TargetSegment", 258},
	    {"RetargetSetupTargetModel.TargetType", 259},
	    {"RetargetSetupTargetModel.Weight", 260},
	    {"RetargetSetupTargetModel.SelectionItem", 261},
	};
	const auto make = [&engine](const std::string& i_rBody, QString& o_rError)
	{
		QQmlComponent component(&engine);
		component.setData(
		    QByteArray::fromStdString("import QtQml 2.0\nimport TesselPluginRetargetSetup 1.0\n" + i_rBody),
		    QUrl("qrc:/roles.qml"));
		std::unique_ptr<QObject> pObject(component.create());
		o_rError = component.errorString();
		return pObject;
	};
	QString error;
	for (const auto& rRow : rows)
	{
		const auto pObject = make(std::string("QtObject { property int role: ") + rRow.m_pRole + " }", error);
		ASSERT_TRUE(pObject) << error.toStdString();
		EXPECT_EQ(pObject->property("role").toInt(), rRow.m_Value) << rRow.m_pRole;
	}
	for (const char* const pType : {"RetargetSetupSegmentModel", "RetargetSetupTargetModel"})
	{
		EXPECT_FALSE(make(std::string(pType) + " {}", error));
		EXPECT_TRUE(
		    error.contains("This type is only used to allow custom model role enums to be accessible from QML."))
		    << error.toStdString();
	}
}

/// What the three models of a document emit when it publishes.
class PublishedModels : public VDocumentTest
{
protected:
	PublishedModels()
	{
		SetSmallSubjects();
		for (int i = 0; i < 5; ++i)
			m_Document.AddTarget(i, i, true, false);
		QObject::connect(m_Document.GetSourceSegmentModel().get(), &QAbstractItemModel::modelReset,
		    [this] { m_Told += "source reset;"; });
		QObject::connect(m_Document.GetTargetSegmentModel().get(), &QAbstractItemModel::modelReset,
		    [this] { m_Told += "target reset;"; });
		const QAbstractItemModel* const pTargets = m_Document.GetTargetModel().get();
		QObject::connect(pTargets, &QAbstractItemModel::modelReset, [this] { m_Told += "reset;"; });
		QObject::connect(pTargets, &QAbstractItemModel::rowsRemoved,
		    [this](const QModelIndex&, int i_First, int i_Last)
		    { m_Told += "removed " + std::to_string(i_First) + "-" + std::to_string(i_Last) + ";"; });
		QObject::connect(pTargets, &QAbstractItemModel::dataChanged,
		    [this](const QModelIndex& i_rFirst, const QModelIndex& i_rLast)
		    { m_Told += "changed " + std::to_string(i_rFirst.row()) + "-" + std::to_string(i_rLast.row()) + ";"; });
	}

	std::string m_Told;
};

TEST_F(PublishedModels, AnEqualSubjectLeavesTheTableAlone)
{
	m_Document.SetTargetSubjectParametrised(Target());
	EXPECT_EQ(m_Told, "source reset;target reset;");
}

TEST_F(PublishedModels, RemovingATargetTakesTheLastRow)
{
	m_Document.RemoveTarget(2);
	EXPECT_EQ(m_Told, "source reset;target reset;removed 4-4;changed 0-3;");
	const auto pModel = m_Document.GetTargetModel();
	EXPECT_EQ(pModel->data(pModel->index(2, 0), VTargetModel::SourceSegment).toString(), "LeftHand");
}

TEST(TargetModel, AnyDifferenceOfTheSubjectChangesTheData)
{
	VWatched<VTargetModel> watched;
	VSubjectParametrised subject = WithTargets(2);
	watched.m_Model.SetSubject(Shared(subject));
	watched.Take();
	subject.m_Segments[0].m_Joint.m_BindPose[4] = 1e-300;
	watched.m_Model.SetSubject(Shared(subject));
	EXPECT_EQ(watched.Take(), "changed 0-1;");
}

} // namespace
