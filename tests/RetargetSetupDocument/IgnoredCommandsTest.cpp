// What the document tells of its commands: each that ends with no change says why, and a loaded file is told as loaded.

#include "TestDocument.h"

namespace
{

using CoreOrlexTypes::VSubjectParametrised;

class CommandIgnored : public VDocumentTest
{
protected:
	CommandIgnored()
	{
		QObject::connect(&m_Document, &VRetargetSetup::targetSubjectLoaded,
		    [this](const QUrl& i_rUrl) { m_Told += "loaded " + i_rUrl.toString().toStdString(); });
	}

	void BreakTree(VSubjectParametrised i_Subject, bool i_bSource)
	{
		i_Subject.m_Segments[1].m_ParentSegmentIndex = 3;
		const auto data = *m_Document.TargetValues().m_pApplicationData;
		i_bSource ? m_Document.SetSourceSubject(i_Subject, data) : void(m_Document.SetTargetSubject(i_Subject, data));
	}
};

constexpr const char* c_NoSource = "There is no source subject. Choose a source skeleton first.";
constexpr const char* c_NotItsFBX =
    "The segments of the target subject are not the bones of the FBX file. Choose the FBX file that it was made from.";
constexpr const char* c_NoFile = "'' is no file on this computer.";
constexpr const char* c_NoFBX = "No skeleton has been read from an FBX file. Choose a target FBX first.";
constexpr const char* c_NoTarget = "There is no target subject. Create one, or open a retarget subject file.";

TEST_F(CommandIgnored, EachEndWithoutAChangeSaysWhy)
{
	const struct
	{
		const char* m_pSetUp;
		std::function<void()> m_SetUp;
		const char* m_pCommand;
		std::function<void()> m_Command;
		std::string m_Reason;
	} rows[] = {
	    {"nothing", [] {}, "CreateTargetSubject", [this] { m_Document.CreateTargetSubject(); }, c_NoFBX},
	    {"nothing", [] {}, "Advise", [this] { m_Document.Advise(); }, c_NoTarget},
	    {"nothing", [] {}, "CheckPose", [this] { m_Document.CheckPose(); }, c_NoSource},
	    {"nothing", [] {}, "ProposeTargets", [this] { m_Document.ProposeTargets(0.5); }, c_NoSource},
	    {"nothing", [] {}, "Rebind", [this] { m_Document.Rebind(false, false); }, c_NoTarget},
	    {"nothing", [] {}, "CompareWith", [this] { m_Document.CompareWith({}); }, c_NoFile},
	    {"nothing", [] {}, "CompareWith", [this] { m_Document.CompareWith(Url("none.qrr")); }, c_NoTarget},
	    {"nothing", [] {}, "FitPreset", [this] { m_Document.FitPreset({}, 0.5); }, c_NoFile},
	    {"nothing", [] {}, "SavePreset", [this] { m_Document.SavePresetURL({}); }, c_NoFile},
	    {"nothing", [] {}, "SavePreset", [this] { m_Document.SavePresetURL(Url("a.json")); }, c_NoTarget},
	    {"nothing", [] {}, "SaveRecipe", [this] { m_Document.SaveRecipeURL({}); }, c_NoFile},
	    {"nothing", [] {}, "RestoreTargetSubjectURL", [this] { m_Document.RestoreTargetSubjectURL({}, {}); }, c_NoFile},
	    {"nothing", [] {}, "RestoreTargetSubjectURL",
	        [this] { m_Document.RestoreTargetSubjectURL(Url("none.qrr"), {}); },
	        "'" + File("none.qrr") + "' could not be loaded. The target subject is still the one before."},
	    {"nothing", [] {}, "AddTarget", [this] { m_Document.AddTarget(0, 0, true, true); }, c_NoSource},
	    {"nothing", [] {}, "AddTargets", [this] { m_Document.AddTargets({}); }, c_NoSource},
	    {"nothing", [] {}, "RemoveTarget", [this] { m_Document.RemoveTarget(0); }, c_NoTarget},
	    {"nothing", [] {}, "UpdateTargets", [this] { m_Document.UpdateTargets(); }, c_NoSource},
	    {"nothing", [] {}, "CreateAllJoints", [this] { m_Document.CreateAllJoints(); }, c_NoTarget},
	    {"nothing", [] {}, "RemoveUnnecessaryJoints", [this] { m_Document.RemoveUnnecessaryJoints(); }, c_NoTarget},
	    {"nothing", [] {}, "RemoveJoint", [this] { m_Document.RemoveJoint(1); }, c_NoTarget},
	    {"nothing", [] {}, "SaveTargetSubjectURL", [this] { m_Document.SaveTargetSubjectURL(Url("a.qrr")); },
	        c_NoTarget},
	    {"nothing", [] {}, "MatchFilePose", [this] { m_Document.MatchFilePose(); }, c_NoTarget},
	    {"an FBX, a root beyond it",
	        [this]
	        {
		        ASSERT_TRUE(m_Document.LoadTargetFBX(RETARGET_SOURCE "/demo/character.fbx"));
		        m_Document.SetTargetRootIndex(1000);
	        },
	        "CreateTargetSubject", [this] { m_Document.CreateTargetSubject(); },
	        "The FBX skeleton has no such root bone. Choose a target root."},
	    {"a source",
	        [this] {
		        m_Document.SetSourceSubject(MakeSubject({{"a", -1}}), {});
	        },
	        "AddTarget", [this] { m_Document.AddTarget(0, 0, true, true); }, c_NoTarget},
	    {"a source", [] {}, "UpdateTargets", [this] { m_Document.UpdateTargets(); }, c_NoTarget},
	    {"a source", [] {}, "CheckPose", [this] { m_Document.CheckPose(); }, c_NoTarget},
	    {"a source", [] {}, "ProposeTargets", [this] { m_Document.ProposeTargets(0.5); }, c_NoTarget},
	    {"both", [this] { SetSmallSubjects(); }, "AddTarget", [this] { m_Document.AddTarget(-1, 0, true, true); },
	        "No single segment of the source subject is selected."},
	    {"both", [] {}, "AddTargets",
	        [this] {
		        m_Document.AddTargets({QVariantMap{{"source", -1}}});
	        },
	        "No single segment of the source subject is selected."},
	    {"both", [] {}, "AddTargets",
	        [this] {
		        m_Document.AddTargets({QVariantMap{{"target", 5}}});
	        },
	        "No single segment of the target subject is selected."},
	    {"both", [] {}, "FitPreset", [this] { m_Document.FitPreset(Url("none.json"), 0.5); },
	        "'" + File("none.json") + "' could not be read as a preset: Could not read '" + File("none.json")
	            + "': No such file or directory"},
	    {"both", [] {}, "SavePreset", [this] { m_Document.SavePresetURL(Url("no/such/a.json")); },
	        "The target subject has no position or rotation target that a preset could hold. Add targets first."},
	    {"both", [] {}, "CompareWith", [this] { m_Document.CompareWith(Url("none.qrr")); },
	        "'" + File("none.qrr") + "' could not be read as a retarget subject."},
	    {"both", [] {}, "MatchFilePose", [this] { m_Document.MatchFilePose(); }, c_NotItsFBX},
	    {"both", [] {}, "RemoveJoint", [this] { m_Document.RemoveJoint(0); },
	        "The target subject has no such segment with a joint that can go; the root's stays."},
	    {"its FBX, a hinge",
	        [this]
	        {
		        m_Document.SetTargetRootIndex(0);
		        m_Document.CreateTargetSubject();
		        VSubjectParametrised subject = Target();
		        subject.m_Segments[4].m_Joint.m_JointType = VSubjectParametrised::VJoint::EHinge;
		        m_Document.SetTargetSubjectParametrised(subject);
	        },
	        "MatchFilePose", [this] { m_Document.MatchFilePose(); },
	        "The target subject has joints, post poses or parameters of its own, which the pose of an FBX file does "
	        "not "
	        "fit."},
	    {"another FBX of the same bones",
	        [this]
	        {
		        m_Document.CreateTargetSubject();
		        boost::filesystem::copy_file(RETARGET_SOURCE "/demo/character.fbx", m_Folder / "other.fbx");
		        ASSERT_TRUE(m_Document.LoadTargetFBX(m_Folder / "other.fbx"));
	        },
	        "MatchFilePose", [this] { m_Document.MatchFilePose(); }, c_NotItsFBX},
	    {"both", [this] { SetSmallSubjects(); }, "AddTarget", [this] { m_Document.AddTarget(0, 5, false, false); },
	        "No single segment of the target subject is selected."},
	    {"both", [] {}, "RemoveTarget", [this] { m_Document.RemoveTarget(-1); }, "No single target is selected."},
	    {"both", [] {}, "LoadTargetSubjectURL", [this] { m_Document.LoadTargetSubjectURL(QUrl("http://a/b.qrr")); },
	        "'http://a/b.qrr' is no file on this computer."},
	    {"both", [] {}, "LoadTargetSubjectURL", [this] { m_Document.LoadTargetSubjectURL({}); },
	        "'' is no file on this computer."},
	    {"both", [] {}, "LoadTargetSubjectURL", [this] { m_Document.LoadTargetSubjectURL(Url("100%1.qrr")); },
	        "'" + File("100%1.qrr") + "' could not be loaded. The target subject is still the one before."},
	    {"both", [] {}, "LoadTargetSubjectURL", [this] { m_Document.LoadTargetSubjectURL(Url("none.qrx")); },
	        "'" + File("none.qrx") + "' cannot be opened. The target subject is still the one before."},
	    {"a later file", [this] { Put(m_Folder / "newer.qrx", "[[1,0,2],\"\"]{}"); }, "LoadTargetSubjectURL",
	        [this] { m_Document.LoadTargetSubjectURL(Url("newer.qrx")); },
	        "'" + File("newer.qrx")
	            + "' was written by a later version, which this one cannot read. The target subject is still the one "
	              "before."},
	    {"a damaged file", [this] { Put(m_Folder / "bad.qrr", "<not a skeleton"); }, "LoadTargetSubjectURL",
	        [this] { m_Document.LoadTargetSubjectURL(Url("bad.qrr")); },
	        "'" + File("bad.qrr") + "' could not be loaded. The target subject is still the one before."},
	    {"both", [] {}, "SaveTargetSubjectURL", [this] { m_Document.SaveTargetSubjectURL(QUrl("ftp://a/b.qrr")); },
	        "'ftp://a/b.qrr' is no file on this computer."},
	    {"both", [] {}, "SaveTargetSubjectURL", [this] { m_Document.SaveTargetSubjectURL(Url("no/such/a.qrr")); },
	        "Nothing was saved, and '" + File("no/such/a.qrr") + "' is as it was. Could not save '"
	            + File("no/such/a.qrr") + "': there is no folder '" + File("no/such") + "'"},
	    {"both", [] {}, "SaveTargetSubjectURL", [this] { m_Document.SaveTargetSubjectURL(Url("a.qrx")); },
	        "Nothing was saved: '" + File("a.qrx")
	            + "' is a legacy file, and those are only read. Choose a name that ends in .qrr."},
	    {"a broken target", [this] { BreakTree(*m_Document.TargetValues().m_pParametrised, false); }, "AddTarget",
	        [this] { m_Document.AddTarget(1, 1, true, false); },
	        "The segments of the target subject make no tree with joints."},
	    {"a broken target", [] {}, "UpdateTargets", [this] { m_Document.UpdateTargets(); },
	        "The segments of the target subject make no tree with joints."},
	    {"a broken source", [this] { BreakTree(*m_Document.SourceValues().m_pParametrised, true); }, "AddTarget",
	        [this] { m_Document.AddTarget(1, 1, true, false); },
	        "The segments of the source subject make no tree with joints."},
	    {"a broken source", [] {}, "UpdateTargets", [this] { m_Document.UpdateTargets(); },
	        "The segments of the source subject make no tree with joints."},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(std::string(rRow.m_pSetUp) + ", " + rRow.m_pCommand);
		rRow.m_SetUp();
		const auto pBefore = m_Document.TargetValues().m_pParametrised;
		m_Changes = 0;
		TakeTold();
		rRow.m_Command();
		EXPECT_EQ(TakeTold(), rRow.m_pCommand + (": " + rRow.m_Reason));
		EXPECT_EQ(m_Document.TargetValues().m_pParametrised, pBefore);
		EXPECT_EQ(m_Changes, 0);
	}
}

/// Of a preset that is damaged the line and what is wrong is told.
TEST_F(CommandIgnored, ByPresetsThatCannotBeRead)
{
	SetSmallSubjects();
	const std::pair<std::string, std::string> rows[] = {{"{\n\"pairs\": 1}", "2: \"pairs\" is to be "},
	    {"{\"pairs\": [\n1]}", "2: this is to be a pair: "},
	    {"{\"pairs\": [{\"source\": -1}]}", "1: \"source\" is to be a text in quotes"},
	    {"{\"pairs\": [{\"source\": \"a\"}]}", "1: a pair has no \"target\", which names one of the two"},
	    {"{\"pairs\": [{\"target\": \"a\"}]}", "1: a pair has no \"source\", which names one of the two"},
	    {"{\"pairs\": [{\"position\": -1}]}", "1: \"position\" cannot be -1: it is 0 or more"},
	    {"{\"pairs\": [{\"position\": -0.5}]}", "1: \"position\" cannot be -0.5: it is 0 or more"},
	    {"{\"pairs\": [{\"position\": null}]}", "1: \"position\" is to be a number"},
	    {"{\"pairs\": [{\"position\": 1e999}]}", "1: a number is larger than any that can be held"},
	    {"{\"pairs\": [], \"pairs\": []}", "1: \"pairs\" stands there twice, first in line 1"},
	    {"{\"pairs\": [", "1: this is no JSON: "}};
	for (const auto& [text, reason] : rows)
	{
		Put(m_Folder / "a.json", text);
		EXPECT_TRUE(m_Document.FitPreset(Url("a.json"), 0.5).isEmpty());
		const std::string told = "FitPreset: '" + File("a.json") + "', line " + reason;
		EXPECT_EQ(TakeTold().substr(0, told.size()), told) << text;
	}
	Put(m_Folder / "a.json",
	    R"({"pairs": [{"source": "Hips", "target": "pelvis", "comment": "the root"}, {"source": "x", "target": "y"}]})");
	const QVariantMap fit = m_Document.FitPreset(Url("a.json"), 0.5);
	ASSERT_EQ(fit["pairs"].toList().size(), 1);
	EXPECT_EQ(fit["pairs"].toList()[0].toMap()["reasons"].toString(), "by names in the preset; the root");
	EXPECT_EQ(fit["misfits"].toStringList(),
	    QStringList{"\"x\" and \"y\": the source has no segment \"x\", and the target has no segment \"y\""});
	EXPECT_EQ(fit["unmapped"].toList().size(), 4);
}

TEST_F(CommandIgnored, NotByCommandsThatDoTheirWork)
{
	SetSmallSubjects();
	m_Document.AddTarget(1, 1, true, true);
	m_Document.AddTarget(0, 0, false, true); // No partner for the mirrored target: the log's matter.
	m_Document.UpdateTargets();
	m_Document.RemoveTarget(0);
	m_Document.RemoveUnnecessaryJoints();
	m_Document.CreateAllJoints();
	m_Document.SaveTargetSubjectURL(Url("a.qrr"));
	ASSERT_TRUE(m_Document.LoadTargetFBX(RETARGET_SOURCE "/demo/character.fbx"));
	m_Document.CreateTargetSubject();
	EXPECT_EQ(TakeTold(), "");
	m_Document.LoadTargetSubject(m_Folder / "a.qrr");
	EXPECT_EQ(TakeTold(), "") << "not the operator's command";
	m_Document.LoadTargetSubjectURL(Url("a.qrr"));
	EXPECT_EQ(TakeTold(), "loaded " + Url("a.qrr").toString().toStdString());
}

TEST_F(CommandIgnored, AFileIsToldAsLoadedAfterTheDocumentHasIt)
{
	SetSmallSubjects();
	m_Document.SaveTargetSubject(m_Folder / "a.qrr");
	m_Document.RemoveUnnecessaryJoints();
	std::size_t dummies = 0;
	QObject::connect(&m_Document, &VRetargetSetup::targetSubjectLoaded,
	    [&]
	    {
		    for (const auto& rSegment : Target().m_Segments)
			    dummies += rSegment.m_Joint.m_JointType == VSubjectParametrised::VJoint::EDummy;
	    });
	m_Document.LoadTargetSubjectURL(Url("a.qrr"));
	EXPECT_EQ(dummies, 0u);
	EXPECT_EQ(TakeTold(), "loaded " + Url("a.qrr").toString().toStdString());
}

} // namespace
