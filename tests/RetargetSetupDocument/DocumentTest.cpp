#include "TestDocument.h"

#include "RetargetSetupCore/AngleAxis.h"
#include "UtilsFileSystem/Paths.h"

#include <QMetaMethod>
#include <QMetaProperty>

#include <fstream>
#include <functional>
#include <iterator>
#include <limits>
#include <numbers>

namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

using Document = VDocumentTest;

TEST(DocumentInterface, IsWhatQmlCalls)
{
	const QMetaObject& rMeta = VRetargetSetup::staticMetaObject;
	EXPECT_STREQ(rMeta.className(), "VRetargetSetup");
	for (const char* const pSignature : {"CreateTargetSubject()", "LoadTargetSubjectURL(QUrl)",
	         "SaveTargetSubjectURL(QUrl)", "AddTarget(int,int,bool,bool)", "RemoveTarget(int)", "CreateAllJoints()",
	         "RemoveUnnecessaryJoints()", "UpdateTargets()"})
	{
		const int index = rMeta.indexOfMethod(pSignature);
		ASSERT_NE(index, -1) << pSignature;
		EXPECT_STREQ(rMeta.method(index).typeName(), "void");
	}
	const QMetaProperty property = rMeta.property(rMeta.indexOfProperty("jointSymmetry"));
	EXPECT_TRUE(property.isWritable());
	EXPECT_EQ(property.notifySignal().name(), "jointSymmetryChanged");
}

TEST_F(Document, JointSymmetryTellsOfChangesOnly)
{
	int told = 0;
	QObject::connect(&m_Document, &VRetargetSetup::jointSymmetryChanged, [&told] { ++told; });
	EXPECT_TRUE(m_Document.property("jointSymmetry").toBool());
	m_Document.setProperty("jointSymmetry", true);
	EXPECT_EQ(told, 0);
	m_Document.setProperty("jointSymmetry", false);
	EXPECT_EQ(told, 1);
	EXPECT_FALSE(m_Document.JointSymmetry());
	EXPECT_EQ(m_Changes, 0);
}

TEST_F(Document, CommandsOnNothingDoNothing)
{
	VLogRecorder log;
	m_Document.CreateTargetSubject();
	m_Document.AddTarget(0, 0, true, true);
	m_Document.RemoveTarget(0);
	m_Document.UpdateTargets();
	m_Document.CreateAllJoints();
	m_Document.RemoveUnnecessaryJoints();
	m_Document.SetTargetScale(2.0);
	m_Document.SetTargetRootIndex(5);
	m_Document.SaveTargetSubjectURL(QUrl::fromLocalFile(QString::fromStdString((m_Folder / "a.qrr").string())));
	EXPECT_EQ(m_Folder.Count(), 0);
	EXPECT_EQ(m_Document.SaveTargetSubject(m_Folder / "a.qrr"), 0x8000000Au);
	EXPECT_EQ(m_Changes, 0);
	EXPECT_EQ(log.Take(), "");
	EXPECT_FALSE(m_Document.GetCurrentFrame());
	EXPECT_FALSE(m_Document.GetFBXSkeleton());
	EXPECT_EQ(m_Document.GetTargetScale(), 1.0);
	CoreOrlexTypes::VSubject subject;
	VSubjectParametrised parametrised;
	VSubjectApplicationData data;
	EXPECT_FALSE(m_Document.GetSourceTemplate(subject) || m_Document.GetTargetTemplate(subject)
	    || m_Document.GetSourceSubject(parametrised) || m_Document.GetTargetSubject(parametrised)
	    || m_Document.GetTargetSubjectAndData(parametrised, data));
}

TEST_F(Document, TheFrameHoldsTheSixItems)
{
	SetSmallSubjects();
	const auto pFrame = m_Document.GetCurrentFrame();
	ASSERT_TRUE(pFrame);
	const auto& rItems = dynamic_cast<InMemoryHost::VFlowFrame&>(*pFrame).Items();
	std::string types;
	for (const auto& pItem : rItems)
		types += pItem->FlowType() + " ";
	EXPECT_EQ(types,
	    "FlowSubject FlowSubjectApplicationData FlowSubjectParametrised FlowSubjectForSolving "
	    "FlowSubjectApplicationDataForSolving FlowSubjectParametrisedForSolving ");
	EXPECT_EQ(TesselPluginInterface::ItemValue<VSubjectParametrised>(rItems[2])->m_Segments[1].m_Name, "LeftArm");
	EXPECT_EQ(m_Document.GetSourceSegmentModel()->rowCount(), 5);
	EXPECT_EQ(m_Document.GetTargetSegmentModel()->rowCount(), 5);
}

TEST_F(Document, AnEditMakesNewItemsAndLeavesTheOldOnes)
{
	SetSmallSubjects();
	const auto before = m_Document.TargetValues();
	const auto pFrame = m_Document.GetCurrentFrame();
	const auto pModel = m_Document.GetTargetModel();
	m_Document.AddTarget(1, 1, true, true);
	EXPECT_EQ(m_Changes, 1);
	EXPECT_EQ(before.m_pParametrised->m_Targets.size(), 0u);
	EXPECT_NE(m_Document.GetCurrentFrame(), pFrame);
	EXPECT_EQ(pModel->rowCount(), 2);
	CoreOrlexTypes::VSubject subject;
	ASSERT_TRUE(m_Document.GetTargetTemplate(subject));
	EXPECT_EQ(subject.m_Targets.size(), 2u);
}

TEST_F(Document, AddTargetRows)
{
	const struct
	{
		const char* m_pName;
		int m_Source;
		int m_Target;
		bool m_bSymmetry;
		std::string m_Targets;
		const char* m_pTold;
	} rows[] = {
	    {"one side", 1, 1, false, "LeftArm>arm_l ", ""},
	    {"both sides", 4, 4, true, "RightHand>hand_r LeftHand>hand_l ", ""},
	    {"no partner on either side", 0, 0, true, "Hips>pelvis ",
	        "3 RetargetSetup: Segment 'Hips' of the source subject has no partner on the other side: no mirrored "
	        "target is "
	        "added\n3 RetargetSetup: Segment 'pelvis' of the target subject has no partner on the other side: no "
	        "mirrored "
	        "target is added"},
	    {"no partner on one side", 1, 0, true, "LeftArm>pelvis ",
	        "3 RetargetSetup: Segment 'pelvis' of the target subject has no partner on the other side: no mirrored "
	        "target "
	        "is added"},
	    {"minus one", -1, 1, false, "", ""},
	    {"beyond the source", 5, 1, false, "", ""},
	    {"minus one for the target", 1, -1, true, "", ""},
	    {"beyond the target", 1, 5, true, "", ""},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		SetSmallSubjects();
		VLogRecorder log;
		m_Document.AddTarget(rRow.m_Source, rRow.m_Target, true, rRow.m_bSymmetry);
		std::string names;
		for (const auto& rTarget : m_Document.TargetValues().m_pApplicationData->m_Targets)
			names += rTarget.m_Name + " ";
		EXPECT_EQ(names, rRow.m_Targets);
		EXPECT_EQ(m_Changes, rRow.m_Targets.empty() ? 0 : 1);
		EXPECT_EQ(log.Take(), rRow.m_pTold);
	}
}

TEST_F(Document, RemoveTargetOutOfRangeChangesNothing)
{
	SetSmallSubjects();
	m_Document.AddTarget(1, 1, true, false);
	m_Document.RemoveTarget(-1);
	m_Document.RemoveTarget(1);
	EXPECT_EQ(m_Changes, 1);
	m_Document.RemoveTarget(0);
	EXPECT_TRUE(Target().m_Targets.empty() && Target().m_Markers.empty());
}

TEST_F(Document, ATargetThatFitsNoClassDoesNotStopTheOthers)
{
	SetSmallSubjects();
	VSubjectParametrised subject = Target();
	subject.m_Targets.resize(1);
	subject.m_Targets[0].m_Type = VSubjectParametrised::VTarget::ERigidBody;
	VSubjectApplicationData data = *m_Document.TargetValues().m_pApplicationData;
	data.m_Targets.resize(1);
	m_Document.SetTargetSubject(subject, data);
	m_Document.AddTarget(1, 1, true, false);
	EXPECT_EQ(Target().m_Targets.size(), 2u);
}

TEST_F(Document, ABrokenTreeIsToldAndLeftAlone)
{
	SetSmallSubjects();
	VSubjectParametrised subject = Target();
	subject.m_Segments[1].m_ParentSegmentIndex = 3;
	m_Document.SetTargetSubjectParametrised(subject);
	VLogRecorder log;
	m_Document.AddTarget(1, 1, true, false);
	m_Document.UpdateTargets();
	EXPECT_EQ(Target(), subject);
	EXPECT_EQ(log.Take(),
	    "3 RetargetSetup: The segments of the target subject make no tree with joints, so their poses are "
	    "not known\n3 RetargetSetup: The segments of the target subject make no tree with joints, so "
	    "their poses are not known");
}

TEST_F(Document, OffsetsFollowThePoseOnlyWhenUpdated)
{
	SetSmallSubjects();
	m_Document.AddTarget(1, 1, true, false);
	const auto offset = [this] { return Target().m_Targets.at(0).m_StateExpressions; };
	const std::vector<std::string> first = {"150.000000*GlobalScale", "0.000000*GlobalScale", "200.000000*GlobalScale"};
	EXPECT_EQ(offset(), first);
	VSubjectParametrised subject = Target();
	subject.m_Segments[0].m_Joint.m_BindPose = {0, 0, std::numbers::pi / 2, 0, 0, 100};
	m_Document.SetTargetSubjectParametrised(subject);
	EXPECT_EQ(offset(), first);
	m_Document.UpdateTargets();
	// The arm stands at (0, 150, 300) with X along world Y; the source's at (300, 0, 400).
	EXPECT_EQ(offset(),
	    (std::vector<std::string>{"-150.000000*GlobalScale", "-300.000000*GlobalScale", "100.000000*GlobalScale"}));
}

TEST_F(Document, TheNextScaleLeavesThePresentSubject)
{
	ASSERT_TRUE(m_Document.LoadTargetFBX(RETARGET_SOURCE "/demo/character.fbx"));
	m_Document.CreateTargetSubject();
	m_Changes = 0;
	m_Document.SetNextTargetScale(3.0);
	m_Document.SetNextTargetScale(0.0);
	EXPECT_EQ(m_Changes, 0);
	EXPECT_EQ(m_Document.GetTargetScale(), 1.0);
	m_Document.CreateTargetSubject();
	EXPECT_EQ(m_Document.GetTargetScale(), 3.0);
}

TEST_F(Document, TheOperatorIsToldWhichSourceASavedFileNames)
{
	const auto save = [this]
	{
		VLogRecorder log;
		m_Document.SaveTargetSubjectURL(QUrl::fromLocalFile(QString::fromStdString((m_Folder / "a.qrr").string())));
		std::string first = log.Take();
		return first.substr(0, first.find('\n'));
	};
	ASSERT_TRUE(m_Document.LoadTargetFBX(RETARGET_SOURCE "/demo/character.fbx"));
	m_Document.CreateTargetSubject();
	EXPECT_EQ(save(), "3 RetargetSetup: The saved subject names no source skeleton: it was made before one was chosen");
	ASSERT_TRUE(m_Document.LoadSourceSubject(RETARGET_SOURCE "/demo/performer.qrs", ""));
	m_Document.CreateTargetSubject();
	EXPECT_EQ(save().find("names"), std::string::npos);
	ASSERT_TRUE(m_Document.LoadSourceSubject(RETARGET_TEST_DATA "/qrt/version-3.5.qrs", ""));
	EXPECT_EQ(m_Document.GetShownSourceName(), "version-3.5");
	EXPECT_EQ(save(),
	    "3 RetargetSetup: The saved subject names source skeleton 'performer', and the one that is shown "
	    "is 'version-3.5'");
	ASSERT_EQ(m_Document.LoadTargetSubject(m_Folder / "a.qrr"), 0u);
	EXPECT_EQ(m_Document.GetSourceName(), "performer");
	EXPECT_EQ(m_Document.GetShownSourceName(), "version-3.5") << "no source was loaded";
}

TEST_F(Document, TheScale)
{
	m_Document.SetTargetScale(0.5);
	EXPECT_EQ(m_Document.GetTargetScale(), 1.0) << "there is no target subject yet";
	SetSmallSubjects();
	VSubjectParametrised subject = Target();
	subject.m_DynamicParameters.push_back({"Age", 0, 0, 40, false});
	subject.m_DynamicParameters.push_back({"GlobalScale", 0, 0, 9, false});
	m_Document.SetTargetSubjectParametrised(subject);
	EXPECT_EQ(m_Document.GetTargetScale(), 1.0) << "the first of that name";
	const auto pData = m_Document.TargetValues().m_pApplicationData;
	VLogRecorder log;
	m_Document.SetTargetScale(2.0);
	EXPECT_EQ(log.Take(), "3 RetargetSetup: The new scale drops the dynamic parameters 'Age', 'GlobalScale'");
	ASSERT_EQ(Target().m_DynamicParameters.size(), 1u);
	EXPECT_EQ(Target().m_DynamicParameters[0].m_Prior, 2.0);
	EXPECT_EQ(m_Document.GetTargetScale(), 2.0);
	EXPECT_EQ(m_Document.TargetValues().m_pSubject->m_Segments[1].m_PreTranslation[0], 300.0);
	EXPECT_EQ(m_Document.TargetValues().m_pApplicationData, pData);

	const VSubjectParametrised scaled = Target();
	subject.m_Segments[1].m_PreTranslation[0] = "3*Age";
	m_Document.SetTargetSubjectParametrised(subject);
	m_Document.SetTargetScale(3.0);
	EXPECT_EQ(log.Take(),
	    "3 RetargetSetup: The scale stays: another one takes the place of the dynamic parameters 'Age', which the "
	    "target subject needs");
	EXPECT_EQ(Target(), subject);
	EXPECT_EQ(m_Document.SaveTargetSubject(m_Folder / "a.qrr"), 0u);
	m_Document.SetTargetSubjectParametrised(scaled);
	log.Take();

	m_Changes = 0;
	for (const double scale :
	    {0.0, -1.0, std::numeric_limits<double>::infinity(), std::numeric_limits<double>::quiet_NaN()})
	{
		m_Document.SetTargetScale(scale);
		EXPECT_EQ(m_Document.GetTargetScale(), 2.0);
		EXPECT_EQ(log.Take().find("3 RetargetSetup: A scale must be a finite number above 0, not "), 0u);
	}
	EXPECT_EQ(m_Changes, 0);
}

TEST_F(Document, PruningTellsHowFarThePoseWent)
{
	SetSmallSubjects();
	m_Document.AddTarget(3, 3, true, false);
	VSubjectParametrised subject = Target();
	subject.m_Segments[1].m_PreRotation[0] = "1.5707963267948966";
	m_Document.SetTargetSubjectParametrised(subject);
	VLogRecorder log;
	m_Document.RemoveUnnecessaryJoints();
	EXPECT_EQ(log.Take(), "") << "at rest nothing moves";

	SetSmallSubjects();
	subject.m_Segments[1].m_Joint.m_BindPose = {0, 0, 0.5};
	m_Document.SetTargetSubjectParametrised(subject);
	m_Document.RemoveUnnecessaryJoints();
	EXPECT_EQ(Target().m_Segments[1].m_Joint.m_JointType, VJoint::EDummy);
	EXPECT_EQ(Target().m_Segments[3].m_Joint.m_JointType, VJoint::EBall);
	// The hand hangs 125 mm along X: once in the XZ plane, once in the XY plane, half a radian away from X.
	const std::string told = log.Take();
	EXPECT_EQ(
	    told.find("3 RetargetSetup: Removing joints changed the bind pose: segment 'hand_l' most, by 84.8 mm and "), 0u)
	    << told;
	m_Document.CreateAllJoints();
	EXPECT_EQ(Target().m_Segments[1].m_Joint.m_JointType, VJoint::EBall);
}

TEST_F(Document, CallbacksThroughADispatcherReadWhatStandsWhenTheyRun)
{
	SetSmallSubjects();
	std::string names;
	m_Document.GetChangedSignal().Connect([&]
	    { names += m_Document.GetSourceName() + std::to_string(Target().m_Targets.size()) + ";"; },
	    m_Host.GetDispatcher());
	m_Document.AddTarget(1, 1, true, false);
	m_Document.AddTarget(1, 1, true, false);
	EXPECT_EQ(names, "");
	m_Host.Dispatcher().RunPending();
	EXPECT_EQ(names, "2;2;");
}

TEST_F(Document, AManyStepDragKeepsOneFrameAlive)
{
	SetSmallSubjects();
	m_Document.AddTarget(1, 1, true, true);
	std::weak_ptr<const VSubjectParametrised> pFirst = m_Document.TargetValues().m_pParametrised;
	for (int step = 0; step < 200; ++step)
	{
		VSubjectParametrised subject = Target();
		subject.m_Segments[1].m_Joint.m_BindPose = {0.01 * step, 0, 0};
		m_Document.SetTargetSubjectParametrised(std::move(subject));
	}
	EXPECT_TRUE(pFirst.expired()) << "nothing may keep the subjects of earlier steps";
	EXPECT_EQ(m_Document.TargetValues().m_pParametrised.use_count(), 4)
	    << "one item, the two models, and the value in hand";
	EXPECT_EQ(Target().m_Segments[1].m_Joint.m_BindPose[0], 1.99);
}

/// A host that is asked before work is lost.
struct VAskedHost : TesselPluginInterface::IHostRules
{
	TesselPluginInterface::VHostRules Rules() const override { return m_Rules; }
	bool MayReplaceTargetSubject(const std::string& i_rAction) override
	{
		m_Asked += i_rAction + ";";
		m_Meanwhile();
		return m_bAnswer;
	}
	bool MayOverwriteChangedFile(const std::string& i_rPath) override { return MayReplaceTargetSubject(i_rPath); }

	TesselPluginInterface::VHostRules m_Rules;
	std::string m_Asked;
	bool m_bAnswer = false;
	std::function<void()> m_Meanwhile = [] {};
};

TEST_F(Document, AsksItsHostBeforeUnsavedChangesAreReplaced)
{
	const auto pHost = std::make_shared<VAskedHost>();
	m_Document.SetHostRules(pHost);
	const QUrl file = QUrl::fromLocalFile(QString::fromStdString((m_Folder / "a.qrr").string()));
	ASSERT_TRUE(m_Document.LoadTargetFBX(RETARGET_SOURCE "/demo/character.fbx"));
	SetSmallSubjects();
	m_Document.SaveTargetSubjectURL(file);

	const auto edit = [this] { m_Document.AddTarget(0, 0, true, false); };
	const auto create = [this] { m_Document.CreateTargetSubject(); };
	const auto load = [&] { m_Document.LoadTargetSubjectURL(file); };
	const auto begin = [this] { m_Document.NewTargetSubject(); };
	const auto nothing = [] {};
	const struct
	{
		const char* m_pName;
		std::function<void()> m_Before;
		std::function<void()> m_Command;
		bool m_bAnswer;
		const char* m_pAsked;
		bool m_bReplaced;
	} rows[] = {{"loading what was saved", nothing, load, false, "", true},
	    {"an edit, kept", edit, load, false, "Load;", false},
	    {"still there, kept", nothing, create, false, "Create Target Subject;", false},
	    {"still there, given up", nothing, create, true, "Create Target Subject;", true},
	    {"just made", nothing, create, false, "", true}, {"just made, loading", nothing, load, false, "", true},
	    {"an edit of a loaded one, given up", edit, load, true, "Load;", true},
	    {"an edit, kept again", edit, create, false, "Create Target Subject;", false},
	    {"saved", [&] { m_Document.SaveTargetSubjectURL(file); }, create, false, "", true},
	    {"an edit of a new one", edit, load, false, "Load;", false},
	    {"another file read during the question",
	        [&]
	        {
		        pHost->m_Meanwhile = [this]
		        { EXPECT_FALSE(m_Document.LoadTargetFBX(RETARGET_TEST_DATA "/fbx/cases/no_skeleton.fbx")); };
	        },
	        create, true, "Create Target Subject;", true},
	    {"an edit, kept from New", edit, begin, false, "New Retarget Subject;", false},
	    {"still there, given up for New", nothing, begin, true, "New Retarget Subject;", true}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		rRow.m_Before();
		pHost->m_bAnswer = rRow.m_bAnswer;
		pHost->m_Asked.clear();
		const auto pBefore = m_Document.TargetValues().m_pParametrised;
		rRow.m_Command();
		EXPECT_EQ(pHost->m_Asked, rRow.m_pAsked);
		EXPECT_EQ(m_Document.TargetValues().m_pParametrised != pBefore, rRow.m_bReplaced);
	}
}

TEST_F(Document, AHostMayWantEachPairOnce)
{
	SetSmallSubjects();
	std::string told;
	QObject::connect(&m_Document, &VRetargetSetup::targetFound,
	    [&](int i_Index) { told += "found " + std::to_string(i_Index) + ";"; });
	QObject::connect(&m_Document, &VRetargetSetup::commandIgnored,
	    [&](const QString&, const QString& i_rReason) { told += i_rReason.toStdString(); });
	const auto add = [&](int i_Source, int i_Target, bool i_bPosition, bool i_bSymmetry)
	{
		told.clear();
		m_Document.AddTarget(i_Source, i_Target, i_bPosition, i_bSymmetry);
		return Target().m_Targets.size();
	};
	EXPECT_EQ(add(0, 0, true, false), 1u);
	EXPECT_EQ(add(0, 0, true, false), 2u) << "the plain form";
	const auto pHost = std::make_shared<VAskedHost>();
	pHost->m_Rules.m_bEachPairOnce = true;
	m_Document.SetHostRules(pHost);
	EXPECT_EQ(add(0, 0, true, false), 2u);
	EXPECT_EQ(told, "There is a target 'Hips>pelvis' already.found 0;");
	EXPECT_EQ(add(0, 0, false, false), 3u) << "of another kind";
	EXPECT_EQ(add(1, 1, true, false), 4u);
	VLogRecorder log;
	EXPECT_EQ(add(1, 1, true, true), 5u);
	EXPECT_EQ(told, "");
	EXPECT_EQ(log.Take(), "3 RetargetSetup: There is a target 'LeftArm>arm_l' already: only the other side is added");
	EXPECT_EQ(add(2, 2, true, true), 5u) << "both sides are there";
	EXPECT_EQ(told, "There is a target 'RightArm>arm_r' already.found 4;");
	EXPECT_EQ(add(3, 0, true, false), 6u) << "of another source segment";
	EXPECT_EQ(add(0, 3, true, false), 7u) << "on another target segment";
}

TEST_F(Document, AsksItsHostBeforeAChangedFileIsOverwritten)
{
	const auto pHost = std::make_shared<VAskedHost>();
	const boost::filesystem::path file = m_Folder / "a.qrr";
	const QUrl url = QUrl::fromLocalFile(QString::fromStdString(file.string()));
	const auto write = [&file](const char* i_pText) { std::ofstream(file.string()) << i_pText; };
	const auto holds = [&file](const std::string& i_rText)
	{ return std::string(std::istreambuf_iterator<char>(std::ifstream(file.string()).rdbuf()), {}) == i_rText; };
	SetSmallSubjects();
	write("another asset");
	m_Document.SaveTargetSubjectURL(url);
	m_Document.SetHostRules(pHost);
	m_Document.SaveTargetSubjectURL(url);
	EXPECT_EQ(pHost->m_Asked, "") << "it holds what was saved";
	write("of another program");
	pHost->m_bAnswer = false;
	m_Document.SaveTargetSubjectURL(url);
	EXPECT_EQ(pHost->m_Asked, file.string() + ";");
	EXPECT_TRUE(holds("of another program"));
	pHost->m_bAnswer = true;
	m_Document.SaveTargetSubjectURL(url);
	EXPECT_FALSE(holds("of another program"));
	boost::filesystem::remove(file);
	pHost->m_Asked.clear();
	m_Document.SaveTargetSubjectURL(url);
	EXPECT_EQ(pHost->m_Asked, "") << "nothing is lost where there is nothing";
	EXPECT_TRUE(boost::filesystem::exists(file));
	write("of another program");
	m_Document.SaveTargetSubjectURL(QUrl::fromLocalFile(QString::fromStdString((m_Folder / "b.qrr").string())));
	m_Document.SaveTargetSubjectURL(url);
	EXPECT_EQ(pHost->m_Asked, "") << "Save As has asked already";
}

} // namespace
