// The steps of a session as a command line and as a recipe: what each edit is told as, and where they begin when what
// was done has no words.

#include "TestDocument.h"

#include <boost/filesystem/operations.hpp>

#include <functional>

namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using VJoint = VSubjectParametrised::VJoint;

class Session : public VDocumentTest
{
protected:
	Session() { m_Document.KeepHistory(m_Host.GetSelectionManager()); }

	void Make()
	{
		ASSERT_TRUE(m_Document.LoadTargetFBX(RETARGET_SOURCE "/demo/character.fbx"));
		ASSERT_TRUE(m_Document.LoadSourceSubject(RETARGET_SOURCE "/demo/performer.qrs", ""));
		m_Document.CreateTargetSubject();
		m_Document.AddTarget(0, 0, true, false);
		m_Document.AddTarget(0, 0, false, false);
	}
};

constexpr const char* c_Gone =
    "CopyCommands: What the steps began with is in no file any more. \"Save as Recipe\" keeps "
    "it in a file beside the recipe.";

/// An edit that comes with no words of its own is told by what it has changed.
TEST_F(Session, TellsWhatHasChanged)
{
	const struct
	{
		const char* m_pName;
		std::function<void(VSubjectParametrised&)> m_Edit;
		/// What stands behind the target that was added before; null where no option could do it.
		const char* m_pOptions;
	} rows[] = {
	    {"a pose",
	        [](auto& io_rSubject) {
		        io_rSubject.m_Segments[1].m_Joint.m_Mean =
		            io_rSubject.m_Segments[1].m_Joint.m_BindPose = {0.5, 0, 0.25};
	        },
	        " --pose loin=0.5,0,0.25"},
	    {"a weight", [](auto& io_rSubject) { io_rSubject.m_Targets[0].m_Weight = 0.5; }, " --weight 0=0.5"},
	    {"one text of an offset",
	        [](auto& io_rSubject) { io_rSubject.m_Targets[0].m_StateExpressions[1] = "12.5*GlobalScale"; },
	        " --expressions 0=,12.5,"},
	    {"a text of a rotation", [](auto& io_rSubject) { io_rSubject.m_Targets[1].m_StateExpressions[2] = "pi/2"; },
	        " --expressions 1=,,pi/2"},
	    {"another target of the same source",
	        [](auto& io_rSubject)
	        {
		        io_rSubject.m_Targets.push_back(io_rSubject.m_Targets[0]);
		        io_rSubject.m_Targets[2].m_SegmentIndices[0] = 3;
		        io_rSubject.m_Targets[2].m_Weight = 0.25;
	        },
	        " --position Pelvis:breast --weight 2=0.25"},
	    {"nothing", [](auto&) {}, ""},
	    {"a joint of another type",
	        [](auto& io_rSubject) { io_rSubject.m_Segments[1].m_Joint.m_JointType = VJoint::EDummy; }, nullptr},
	    {"a pose that is not at its mean",
	        [](auto& io_rSubject) {
		        io_rSubject.m_Segments[1].m_Joint.m_Mean = {0.5, 0, 0};
	        },
	        nullptr},
	    {"no pose",
	        [](auto& io_rSubject)
	        { io_rSubject.m_Segments[1].m_Joint.m_Mean = io_rSubject.m_Segments[1].m_Joint.m_BindPose = {}; },
	        nullptr},
	    {"a pose of too many numbers",
	        [](auto& io_rSubject) {
		        io_rSubject.m_Segments[1].m_Joint.m_Mean = io_rSubject.m_Segments[1].m_Joint.m_BindPose = {1, 2, 3, 4};
	        },
	        nullptr},
	    {"a target less", [](auto& io_rSubject) { io_rSubject.m_Targets.clear(); }, nullptr},
	    {"a segment less", [](auto& io_rSubject) { io_rSubject.m_Segments.pop_back(); }, nullptr},
	    {"a target of no source", [](auto& io_rSubject) { io_rSubject.m_Targets.emplace_back(); }, nullptr},
	    {"a target of no segment",
	        [](auto& io_rSubject)
	        {
		        io_rSubject.m_Targets.push_back(io_rSubject.m_Targets[0]);
		        io_rSubject.m_Targets[2].m_SegmentIndices.clear();
	        },
	        nullptr},
	    {"a target of another performer",
	        [](auto& io_rSubject)
	        {
		        io_rSubject.m_Targets.push_back(io_rSubject.m_Targets[0]);
		        io_rSubject.m_Markers[io_rSubject.m_Targets[0].m_MarkerIndices[0]].m_Name = "nobody";
	        },
	        nullptr},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		Make();
		VSubjectParametrised subject = Target();
		rRow.m_Edit(subject);
		m_Document.SetTargetSubjectParametrised(subject);
		std::string options = m_Document.SessionCommands().toStdString();
		if (!rRow.m_pOptions)
		{
			EXPECT_EQ(options + TakeTold(), c_Gone);
			continue;
		}
		for (std::size_t at = 0; (at = options.find(" \\\n  ", at)) != std::string::npos;)
			options.erase(at, 4);
		const std::string c_Before = "--rotation Pelvis:haunch";
		const std::size_t begin = options.find(c_Before) + c_Before.size();
		EXPECT_EQ(options.substr(begin, options.find(" -o ") - begin), rRow.m_pOptions) << options;
	}
}

TEST_F(Session, TellsSegmentsOfOneNameApart)
{
	Make();
	const auto source = m_Document.SourceValues();
	VSubjectParametrised subject = *source.m_pParametrised;
	subject.m_Segments[1].m_Name = subject.m_Segments[0].m_Name;
	m_Document.SetSourceSubject(subject, *source.m_pApplicationData);
	m_Document.AddTarget(1, 1, false, false);
	const std::string options = m_Document.SessionCommands().toStdString();
	EXPECT_NE(options.find("--rotation '#0:loin'"), std::string::npos) << options;
	EXPECT_NE(options.find("--expressions 2="), std::string::npos) << "since it was measured to the other one";
}

TEST_F(Session, BeginsWithAFile)
{
	const auto save = [this](const char* i_pName) { return m_Document.SaveRecipeURL(Url(i_pName)); };
	EXPECT_FALSE(save("a.json"));
	EXPECT_EQ(TakeTold(), "SaveRecipe: There is no target subject. Create one, or open a retarget subject file.");
	SetSmallSubjects();
	EXPECT_EQ(m_Document.SessionCommands(), "");
	EXPECT_EQ(TakeTold(), c_Gone);
	EXPECT_FALSE(save("no/such/a.json"));
	EXPECT_EQ(TakeTold(),
	    "SaveRecipe: Nothing was saved, and '" + File("no/such/a.json") + "' is as it was. Could not save '"
	        + File("no/such/a-begin.qrr") + "': there is no folder '" + File("no/such") + "'");
	EXPECT_TRUE(save("a.json"));
	const std::string recipe = Get(m_Folder / "a.json");
	EXPECT_NE(recipe.find("\"subject\": \"a-begin.qrr\""), std::string::npos) << recipe;
	EXPECT_NE(recipe.find("\"output\": \"a.qrr\""), std::string::npos) << recipe;
	EXPECT_TRUE(save("a.json")) << "the same again";
	EXPECT_TRUE(Get(m_Folder / "a.json") == recipe);
	Put(m_Folder / "a-begin.qrr", "somebody else's");
	EXPECT_TRUE(save("a.json"));
	EXPECT_EQ(Get(m_Folder / "a-begin.qrr"), "somebody else's");
	EXPECT_NE(Get(m_Folder / "a.json").find("\"subject\": \"a-begin-2.qrr\""), std::string::npos);

	// What the recipe writes is not what it reads.
	m_Document.SaveTargetSubject(m_Folder / "b.qrr");
	m_Document.LoadTargetSubject(m_Folder / "b.qrr");
	EXPECT_EQ(m_Document.SessionCommands().toStdString(),
	    "retarget edit " + File("b.qrr") + " \\\n  -o " + File("b.qrr") + "\n");
	EXPECT_TRUE(save("b.json"));
	EXPECT_NE(Get(m_Folder / "b.json").find("\"subject\": \"b-begin.qrr\""), std::string::npos);
	Put(m_Folder / "b.qrr", Get(RETARGET_SOURCE "/demo/performer.qrs"));
	EXPECT_EQ(m_Document.SessionCommands(), "") << "what it began with is no longer there";
	EXPECT_EQ(TakeTold(), c_Gone);
}

TEST_F(Session, TellsOfFilesThatHaveChanged)
{
	boost::filesystem::copy_file(RETARGET_SOURCE "/demo/character.fbx", m_Folder / "character.fbx");
	ASSERT_TRUE(m_Document.LoadTargetFBX(m_Folder / "character.fbx"));
	ASSERT_TRUE(m_Document.LoadSourceSubject(RETARGET_SOURCE "/demo/performer.qrs", ""));
	m_Document.CreateTargetSubject();
	boost::filesystem::last_write_time(m_Folder / "character.fbx", 1);
	m_Quiet.Take();
	EXPECT_NE(m_Document.SessionCommands(), "");
	EXPECT_NE(m_Quiet.Take().find("'" + File("character.fbx")
	              + "' has changed since it was read here: the steps may give "
	                "something else with it."),
	    std::string::npos);
}

} // namespace
