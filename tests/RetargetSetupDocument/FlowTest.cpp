// The document from end to end on files: an FBX file and a performer in, a retarget subject out and in again.

#include "CoreOrlexQRTIO/FileDifference.h"
#include "TestDocument.h"

#include "CoreOrlexTypes/SubjectRecord.h"
#include "CoreOrlexTypes/TextForm.h"
#include "InMemoryHost/Application.h"
#include "RetargetSetupCore/FilePath.h"
#include "RetargetSetupCore/RootHeight.h"
#include "SetupIO/ReadSetup.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <limits>
#include <numbers>

namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

const boost::filesystem::path c_Demo = RETARGET_SOURCE "/demo";
const boost::filesystem::path c_Cases = RETARGET_TEST_DATA "/fbx/cases";

int IndexOf(const VSubjectParametrised& i_rSubject, const std::string& i_rName)
{
	const auto found = std::find_if(i_rSubject.m_Segments.begin(), i_rSubject.m_Segments.end(),
	    [&i_rName](const auto& i_rSegment) { return i_rSegment.m_Name == i_rName; });
	return found == i_rSubject.m_Segments.end() ? -1 : int(found - i_rSubject.m_Segments.begin());
}

class Flow : public VDocumentTest
{
protected:
	/// The pairs of the demo's mapping file, through the commands that QML calls.
	void AddDemoTargets()
	{
		SetupIO::VSetup mapping;
		SetupIO::VFault fault;
		ASSERT_TRUE(SetupIO::ReadSetup(Get(c_Demo / "mapping.json"), mapping, fault)) << fault.m_Reason;
		VSubjectParametrised source;
		ASSERT_TRUE(m_Document.GetSourceSubject(source));
		for (const SetupIO::VPair& rPair : mapping.m_Pairs)
		{
			const int sourceIndex = IndexOf(source, rPair.m_Source);
			const int targetIndex = IndexOf(Target(), rPair.m_Target);
			ASSERT_TRUE(sourceIndex >= 0 && targetIndex >= 0) << rPair.m_Source;
			for (const bool bPosition : {true, false})
				if (bPosition ? rPair.m_Position : rPair.m_Rotation)
					QMetaObject::invokeMethod(&m_Document, "AddTarget", Q_ARG(int, sourceIndex),
					    Q_ARG(int, targetIndex), Q_ARG(bool, bPosition), Q_ARG(bool, false));
		}
	}
};

TEST_F(Flow, FromFBXToASavedSubjectAndBack)
{
	ASSERT_TRUE(m_Document.LoadSourceSubject(c_Demo / "performer.qrs", "Actor"));
	EXPECT_EQ(m_Document.GetSourceName(), "performer");
	EXPECT_EQ(m_Document.SourceValues().m_pApplicationData->m_Skin, "Actor");
	ASSERT_TRUE(m_Document.LoadTargetFBX(c_Demo / "character.fbx"));
	EXPECT_TRUE(m_Document.IsTargetFBXComplete());
	EXPECT_FALSE(m_Document.TargetValues().m_pParametrised) << "nothing is made before it is asked for";
	m_Document.CreateTargetSubject();
	EXPECT_EQ(Target().m_Segments.size(), 39u);
	EXPECT_EQ(Target().m_SubjectId, 0x0FFFFFFFu);

	AddDemoTargets();
	EXPECT_EQ(Target().m_Targets.size(), 34u);
	m_Document.RemoveUnnecessaryJoints();
	m_Document.UpdateTargets();
	const VSubjectParametrised pruned = Target();
	const auto jointCount = std::count_if(pruned.m_Segments.begin(), pruned.m_Segments.end(),
	    [](const auto& i_rSegment) { return i_rSegment.m_Joint.m_JointType != VJoint::EDummy; });
	EXPECT_GT(jointCount, 10);
	EXPECT_LT(jointCount, 39);

	const boost::filesystem::path file = m_Folder / "Kästrel.v1.qrr";
	const QUrl url = QUrl::fromLocalFile(QString::fromStdString(file.string()));
	m_Document.SaveTargetSubjectURL(url);
	const std::string bytes = Get(file);
	ASSERT_FALSE(bytes.empty());

	VRetargetSetup other(m_Host.GetDispatcher(), m_Host.GetFrameFactory(), m_Host.GetItemFactory());
	other.LoadTargetSubjectURL(url);
	EXPECT_EQ(other.GetSourceName(), "performer");
	VSubjectParametrised subject;
	VSubjectApplicationData data;
	ASSERT_TRUE(other.GetTargetSubjectAndData(subject, data));
	EXPECT_EQ(data.m_Skin, "character");
	const VSubjectApplicationData& rSavedData = *m_Document.TargetValues().m_pApplicationData;
	EXPECT_EQ(CoreOrlexQRTIO::FileDifference({Target(), rSavedData}, {subject, data}), "");

	ASSERT_EQ(other.SaveTargetSubject(m_Folder / "again.qrr"), 0u);
	EXPECT_EQ(Get(m_Folder / "again.qrr"), bytes);
	// Edits go on where the file left off.
	ASSERT_TRUE(other.LoadSourceSubject(c_Demo / "performer.qrs", ""));
	other.UpdateTargets();
	ASSERT_TRUE(other.GetTargetSubject(subject));
	EXPECT_EQ(CoreOrlexQRTIO::FileDifference({Target(), data}, {subject, data}), "");
}

TEST_F(Flow, TheRootTakesItsPlaceInAWorldWithZUp)
{
	const struct
	{
		const char* m_pFile;
		/// In the file's space.
		std::array<float, 3> m_Up;
	} rows[] = {{"inch_x_up.fbx", {1, 0, 0}}, {"millimetre_y_up.fbx", {0, 1, 0}}, {"metre_z_up.fbx", {0, 0, 1}}};
	for (const auto& rRow : rows)
	{
		ASSERT_TRUE(m_Document.LoadTargetFBX(c_Cases / rRow.m_pFile));
		const std::array<float, 3> up = m_Document.GetTargetAxisMatrix().MapVector(rRow.m_Up);
		EXPECT_EQ(up, (std::array<float, 3>{0, 0, 1})) << rRow.m_pFile;
		m_Document.CreateTargetSubject();
		const std::vector<double> pose = Target().m_Segments[0].m_Joint.m_BindPose;
		ASSERT_EQ(pose.size(), 6u);
		const Rotation::VMatrix4 world = m_Document.GetTargetAxisMatrix() * (*m_Document.GetFBXSkeleton())[0].m_Global;
		for (int row = 0; row < 3; ++row)
			EXPECT_EQ(pose[std::size_t(3 + row)], double(world(row, 3)));
		EXPECT_EQ(Target().m_Segments[0].m_Joint.m_Mean, pose);
	}
}

TEST_F(Flow, ALaterRootDropsWhatStandsBefore)
{
	ASSERT_TRUE(m_Document.LoadTargetFBX(c_Cases / "metre_z_up.fbx"));
	m_Document.SetTargetScale(2.0);
	m_Document.SetTargetRootIndex(1);
	m_Document.CreateTargetSubject();
	ASSERT_EQ(Target().m_Segments.size(), 2u);
	EXPECT_EQ(Target().m_Segments[0].m_Name, "middle");
	EXPECT_EQ(m_Document.GetTargetScale(), 2.0);
	const Rotation::VMatrix4& rGlobal = (*m_Document.GetFBXSkeleton())[1].m_Global;
	EXPECT_EQ(Target().m_Segments[0].m_Joint.m_BindPose[3], double(rGlobal(0, 3))) << "the place carries no scale";

	VLogRecorder log;
	m_Document.SetTargetRootIndex(3);
	m_Document.CreateTargetSubject();
	EXPECT_EQ(Target().m_Segments.size(), 2u) << "the old subject stays";
	EXPECT_EQ(log.Take(), "3 RetargetSetup: The FBX skeleton has no bone 3 to begin with: nothing is made");
}

TEST_F(Flow, SeveralRootsAreTold)
{
	ASSERT_TRUE(m_Document.LoadTargetFBX(c_Cases / "skeleton_kinds.fbx"));
	VLogRecorder log;
	m_Document.CreateTargetSubject();
	EXPECT_EQ(Target().m_Segments.size(), 4u);
	EXPECT_NE(
	    log.Take().find("3 RetargetSetup: The file has 2 root bones, and no root was chosen: only the first is taken, "
	                    "of 'master', 'secondRoot'"),
	    std::string::npos);
	m_Document.SetTargetRootIndex(4);
	m_Document.CreateTargetSubject();
	EXPECT_EQ(log.Take().find("root bones"), std::string::npos);
	EXPECT_EQ(Target().m_Segments.size(), 2u);
}

TEST_F(Flow, ARootWithAPreRotationAndALostRotationAreTold)
{
	VLogRecorder log;
	ASSERT_TRUE(m_Document.LoadTargetFBX(c_Cases / "metre_z_up.fbx"));
	m_Document.SetTargetRootIndex(1);
	m_Document.CreateTargetSubject();
	EXPECT_EQ(log.Take(),
	    "3 RetargetSetup: Root bone 'middle' has a pre-rotation, which counts twice: the bind pose differs "
	    "from the pose in the file");
	ASSERT_TRUE(m_Document.LoadTargetFBX(c_Cases / "negative_scale.fbx"));
	m_Document.SetTargetRootIndex(0);
	m_Document.CreateTargetSubject();
	EXPECT_NE(
	    log.Take().find("3 RetargetSetup: The local transform of bone 'mirror' is no rotation"), std::string::npos);
	m_Document.SetTargetRootIndex(1);
	m_Document.CreateTargetSubject();
	EXPECT_NE(log.Take().find("3 RetargetSetup: The place of root bone 'mirror' is no rotation"), std::string::npos);
}

TEST_F(Flow, ThePoseOfTheFileAtOnceOrByItsCommand)
{
	const std::string arnaud = RETARGET_TEST_DATA "/fbx/pab_arnaud_b7500.fbx";
	const QString c_Note =
	    "The character stands turned by 90 degrees against its FBX file: the pre-rotation of its root "
	    "bone 'Hips' counts twice.";
	const auto pApplication = std::make_shared<InMemoryHost::VApplication>();
	ASSERT_TRUE(m_Document.LoadTargetFBX(arnaud));
	m_Document.CreateTargetSubject();
	EXPECT_NEAR(m_Document.DifferenceFromFile().value().m_Angle, std::numbers::pi / 2, 1e-4);
	EXPECT_EQ(m_Document.PoseNote(), c_Note);
	m_Document.SaveTargetSubject(m_Folder / "lying.qrr");
	m_Document.MatchFilePose();
	EXPECT_FALSE(m_Document.DifferenceFromFile());
	EXPECT_EQ(m_Document.PoseNote(), "");
	const VSubjectParametrised byCommand = Target();

	ASSERT_EQ(m_Document.LoadTargetSubject(m_Folder / "lying.qrr"), 0u);
	EXPECT_EQ(m_Document.PoseNote(), c_Note) << "the file is the chosen one";
	m_Document.MatchFilePose();
	EXPECT_FALSE(m_Document.DifferenceFromFile());

	m_Document.SetHostRules(pApplication);
	m_Document.CreateTargetSubject();
	EXPECT_NE(m_Document.PoseNote(), "") << "a host that wants it";
	pApplication->m_Rules.m_bPoseFromFile = true;
	VLogRecorder log;
	m_Document.CreateTargetSubject();
	EXPECT_TRUE(Target() == byCommand);
	EXPECT_EQ(log.Take(), "") << "nothing to warn of";
	EXPECT_EQ(m_Document.PoseNote(), "");

	// Another file with the same bones is another character.
	boost::filesystem::copy_file(arnaud, m_Folder / "other.fbx");
	ASSERT_TRUE(m_Document.LoadTargetFBX(m_Folder / "other.fbx"));
	m_Document.MatchFilePose();
	EXPECT_FALSE(m_Document.DifferenceFromFile());
	EXPECT_TRUE(Target() == byCommand);
}

TEST_F(Flow, TheScaleLeavesTheRootWhereItIsOrTakesItAlong)
{
	// Of a root with a pre-rotation, whose joint has other axes than the world.
	ASSERT_TRUE(m_Document.LoadTargetFBX(RETARGET_TEST_DATA "/fbx/pab_arnaud_b7500.fbx"));
	m_Document.CreateTargetSubject();
	m_Document.MatchFilePose();
	const auto lowest = [&] { return RetargetSetup::FindLowestSegment(Target()).value().m_Height; };
	const double height = lowest();
	const double root =
	    double((m_Document.GetTargetAxisMatrix() * m_Document.GetFBXSkeleton()->front().m_Global)(2, 3));
	ASSERT_GT(root, 800.0);
	VLogRecorder log;
	m_Document.SetTargetScale(0.5);
	EXPECT_NEAR(lowest(), root + 0.5 * (height - root), 0.01);
	EXPECT_NE(log.Take().find("mm above the floor, and at scale 1 it is"), std::string::npos);
	m_Document.SetScaleRootHeight(true);
	EXPECT_NEAR(lowest(), 0.5 * height, 0.01) << "at once";
	EXPECT_EQ(Target().m_Segments[0].m_Joint.m_Mean, Target().m_Segments[0].m_Joint.m_BindPose);
	m_Document.SetTargetScale(2.0);
	EXPECT_NEAR(lowest(), 2.0 * height, 0.01);
	EXPECT_FALSE(m_Document.DifferenceFromFile());
	m_Document.MatchFilePose();
	EXPECT_NEAR(lowest(), 2.0 * height, 0.01);
	EXPECT_EQ(log.Take(), "");
	m_Document.SetScaleRootHeight(false);
	EXPECT_NEAR(lowest(), root + 2.0 * (height - root), 0.01);
	EXPECT_NE(log.Take().find("mm below the floor, and at scale 1 it is"), std::string::npos);
	ASSERT_TRUE(m_Document.LoadTargetFBX(c_Demo / "character.fbx"));
	for (const bool bScale : {false, true})
	{
		m_Document.SetScaleRootHeight(bScale);
		log.Take();
		m_Document.CreateTargetSubject();
		EXPECT_EQ(log.Take().find("the lowest segment") != std::string::npos, !bScale);
		const float hips = (m_Document.GetTargetAxisMatrix() * m_Document.GetFBXSkeleton()->front().m_Global)(2, 3);
		EXPECT_NEAR(Target().m_Segments[0].m_Joint.m_BindPose.at(5), bScale ? 2.0 * hips : hips, 0.01);
		m_Document.SaveTargetSubject(m_Folder / "made.qrr");
		m_Document.CreateTargetSubject();
		EXPECT_TRUE(m_Document.HasUnsavedChanges()) << "made anew it is in no file";
	}
}

TEST_F(Flow, AnFBXFileThatGivesNoSkeleton)
{
	ASSERT_TRUE(m_Document.LoadTargetFBX(c_Demo / "character.fbx"));
	m_Document.CreateTargetSubject();
	const auto pSkeleton = m_Document.GetFBXSkeleton();
	const VLogRecorder quiet;
	EXPECT_FALSE(m_Document.LoadTargetFBX(m_Folder / "missing.fbx"));
	EXPECT_EQ(m_Document.GetFBXSkeleton(), pSkeleton);
	EXPECT_EQ(m_Document.GetTargetFBXError(), "There is no such file");
	EXPECT_FALSE(m_Document.LoadTargetFBX(c_Cases / "no_skeleton.fbx"));
	EXPECT_EQ(m_Document.GetTargetFBXError(), "It holds no skeleton");
	EXPECT_FALSE(m_Document.GetFBXSkeleton());
	EXPECT_EQ(Target().m_Segments.size(), 39u);
	m_Document.CreateTargetSubject();
	EXPECT_EQ(Target().m_Segments.size(), 39u);
}

TEST_F(Flow, FilesThatCannotBeReadChangeNothing)
{
	SetSmallSubjects();
	const auto before = m_Document.TargetValues();
	Put(m_Folder / "text.qrr", "no subject");
	Put(m_Folder / "legacy.QRX", "[[1,0,1],\"\"]{}");
	Put(m_Folder / "newer.qrx", "[[1,0,2],\"\"]{}");
	const std::pair<boost::filesystem::path, std::uint32_t> rows[] = {{m_Folder / "missing.qrr", 0x80000000u},
	    {m_Folder / "text.qrr", 0x80000000u}, {m_Folder.Path(), 0x80000000u}, {m_Folder / "legacy.QRX", 0x80000000u},
	    {m_Folder / "missing.qrx", 0x8000002Au}, {m_Folder / "newer.qrx", 0x80000018u}};
	const VLogRecorder quiet;
	for (const auto& [path, status] : rows)
		EXPECT_EQ(m_Document.LoadTargetSubject(path), status) << path;
	EXPECT_FALSE(m_Document.LoadSourceSubject(m_Folder / "text.qrr", ""));
	m_Document.LoadTargetSubjectURL(QUrl("http://example.com/a.qrr"));
	m_Document.LoadTargetSubjectURL(QUrl());
	EXPECT_EQ(m_Document.TargetValues().m_pParametrised, before.m_pParametrised);
	EXPECT_EQ(m_Document.GetSourceName(), "");
	EXPECT_EQ(m_Changes, 0);
}

TEST_F(Flow, ALegacyFileBecomesASubjectOfToday)
{
	CoreOrlexTypes::VSubjectRecord record;
	record.m_SubjectParametrised = MakeSubject({{"pelvis", -1}, {"arm", 0}, {"hand", 1}});
	for (auto& rSegment : record.m_SubjectParametrised.m_Segments)
	{
		rSegment.m_Joint.m_TPoseMean = rSegment.m_Joint.m_BindPose;
		rSegment.m_Joint.m_TPoseMean[0] = 0.25;
		rSegment.m_Joint.m_TPoseCovariance = {7};
		rSegment.m_Joint.m_BindPose.clear();
	}
	auto& rHand = record.m_SubjectParametrised.m_Segments[2].m_Joint;
	rHand.m_BindPose.swap(rHand.m_TPoseMean);
	record.m_SubjectApplicationData.m_RetargetSourceTemplate = "Anna";
	std::string text = "{\"Version\":[1,0,1],\"Schema\":\"any\"}\n";
	ASSERT_TRUE(CoreOrlexTypes::WriteText(record, text, CoreOrlexTypes::ETextSpelling::EPositional));
	Put(m_Folder / "old.qrx", text);

	std::string names;
	const auto note = [&] { names += "'" + m_Document.GetSourceName() + "'"; };
	m_Document.GetChangedSignal().Connect(note);
	m_Document.GetChangedSignal().Connect(note, m_Host.GetDispatcher());
	VLogRecorder log;
	EXPECT_EQ(m_Document.LoadTargetSubject(m_Folder / "old.qrx"), 0u);
	EXPECT_EQ(log.Take(),
	    "3 RetargetSetup: Legacy file: the id 0 of the application data becomes 268435455\n"
	    "3 RetargetSetup: Legacy file: the application data of 0 segments is brought to the subject's 3");
	m_Host.Dispatcher().RunPending();
	EXPECT_EQ(names, "'''Anna'") << "published first; a queued callback sees the new name";
	EXPECT_EQ(Target().m_Segments[1].m_Joint.m_BindPose, (std::vector<double>{0.25, 0, 0}));
	EXPECT_TRUE(Target().m_Segments[1].m_Joint.m_TPoseMean.empty());
	EXPECT_TRUE(Target().m_Segments[1].m_Joint.m_TPoseCovariance.empty());
	EXPECT_TRUE(Target().m_Segments[2].m_Joint.m_BindPose.empty()) << "replaced by a T-pose that there is not";
	EXPECT_EQ(m_Document.SaveTargetSubject(m_Folder / "new.qrr"), 0u);
	EXPECT_EQ(m_Document.LoadTargetSubject(m_Folder / "new.qrr"), 0u);
	EXPECT_EQ(m_Document.GetSourceName(), "Anna");
}

TEST_F(Flow, ABindPoseOfTheFirstSegmentCountsForAll)
{
	for (const bool bFirst : {true, false})
	{
		VSubjectParametrised subject = MakeSubject({{"pelvis", -1}, {"arm", 0}});
		subject.m_Segments[0].m_Joint.m_TPoseMean = {1, 0, 0, 0, 0, 0};
		subject.m_Segments[1].m_Joint.m_TPoseMean = {1, 0, 0};
		subject.m_Segments[bFirst ? 1 : 0].m_Joint.m_BindPose.clear();
		VSubjectApplicationData data;
		data.m_Segments.resize(2);
		m_Document.SetTargetSubject(subject, data);
		ASSERT_EQ(m_Document.SaveTargetSubject(m_Folder / "a.qrr"), 0u);
		ASSERT_EQ(m_Document.LoadTargetSubject(m_Folder / "a.qrr"), 0u);
		EXPECT_EQ(Target().m_Segments[0].m_Joint.m_BindPose[0], bFirst ? 0.0 : 1.0);
		EXPECT_EQ(Target().m_Segments[1].m_Joint.m_BindPose.size(), bFirst ? 0u : 3u);
		EXPECT_EQ(Target().m_Segments[1].m_Joint.m_TPoseMean.size(), bFirst ? 3u : 0u);
	}
}

TEST_F(Flow, ASourceWithoutABindPoseStandsOnTheFloor)
{
	VSubjectParametrised subject = MakeSubject({{"Hips", -1}, {"Head", 0, {"0", "500", "0"}}});
	for (auto& rSegment : subject.m_Segments)
		rSegment.m_Joint.m_BindPose.clear();
	VSubjectApplicationData data;
	data.m_Segments.resize(2);
	m_Document.SetTargetSubject(subject, data);
	ASSERT_EQ(m_Document.SaveTargetSubject(m_Folder / "Anna.take2.qrs"), 0u);
	ASSERT_TRUE(m_Document.LoadSourceSubject(m_Folder / "Anna.take2.qrs", ""));
	EXPECT_EQ(m_Document.GetSourceName(), "Anna.take2");
	EXPECT_EQ(m_Document.SourceValues().m_pParametrised->m_Segments[0].m_Joint.m_BindPose,
	    (std::vector<double>{1.5707963267948966, 0, 0, 0, 0, 1000}));
	EXPECT_EQ(m_Document.SourceValues().m_pParametrised->m_Segments[1].m_Joint.m_BindPose, std::vector<double>(3));
}

TEST_F(Flow, AFailedSaveLeavesTheFile)
{
	SetSmallSubjects();
	ASSERT_EQ(m_Document.SaveTargetSubject(m_Folder / "a.qrr"), 0u);
	const std::string bytes = Get(m_Folder / "a.qrr");
	VSubjectParametrised subject = Target();
	subject.m_Segments[0].m_Joint.m_Mean[0] = std::numeric_limits<double>::infinity();
	m_Document.SetTargetSubjectParametrised(subject);
	VLogRecorder log;
	EXPECT_EQ(m_Document.SaveTargetSubject(m_Folder / "a.qrr"), 0x80000020u);
	EXPECT_NE(log.Take().find("Could not stringify"), std::string::npos);
	EXPECT_EQ(Get(m_Folder / "a.qrr"), bytes);
	EXPECT_EQ(m_Document.SaveTargetSubject(m_Folder / "missing" / "a.qrr"), 0x80000020u);
	EXPECT_EQ(m_Folder.Count(), 1) << "nothing is left behind";
}

TEST_F(Flow, NamesUsedTwiceAreToldAtSave)
{
	m_Document.SetTargetSubject(MakeSubject({{"a", -1}, {"b", 0}, {"b", 0}, {"b", 1}}), {});
	VLogRecorder log;
	m_Document.SaveTargetSubject(m_Folder / "a.qrr");
	EXPECT_NE(
	    log.Take().find("3 RetargetSetup: 3 segments are named 'b': when the file is read, all their targets come "
	                    "back on the first"),
	    std::string::npos);
}

TEST(FilePath, Rows)
{
	const struct
	{
		const char* m_pPath;
		const char* m_pStem;
		const char* m_pExtension;
	} rows[] = {{"/a.b/c.d.fbx", "c.d", ".fbx"}, {"/a.b/c", "c", ""}, {".qrx", "", ".qrx"}, {"x.", "x", "."}};
	for (const auto& rRow : rows)
	{
		EXPECT_EQ(RetargetSetup::FileStem(rRow.m_pPath), rRow.m_pStem);
		EXPECT_EQ(RetargetSetup::FileExtension(rRow.m_pPath), rRow.m_pExtension);
	}
}

} // namespace
