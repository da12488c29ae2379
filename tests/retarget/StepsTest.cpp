// What is done to a target subject in a window, done again by a recipe and by the commands.

#include "../LogRecorder.h"
#include "Rows.h"

#include "InMemoryHost/Application.h"
#include "InMemoryHost/PluginContext.h"
#include "RetargetSetupCore/RetargetSetupCore.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupCore/StepNames.h"
#include "SetupReview/rebind/RebindDocument.h"

#include <boost/filesystem/operations.hpp>

#include <cstdlib>
#include <random>
#include <set>

namespace
{

using CoreOrlexTypes::VSubjectParametrised;

class Steps : public testing::Test
{
protected:
	Steps()
	{
		m_pRules->m_Rules.m_bEachPairOnce = m_pRules->m_Rules.m_bPartnersBySides = true;
		m_Document.SetHostRules(m_pRules);
		m_Document.KeepHistory(nullptr);
	}

	/// An edit of the subject's value, as the panel's fields and the preview make them.
	template <typename TEdit>
	void Edit(TEdit i_Edit, const RetargetSetup::VEdit& i_rEdit)
	{
		VSubjectParametrised subject = *m_Document.TargetValues().m_pParametrised;
		i_Edit(subject);
		m_Document.SetTargetSubjectParametrised(std::move(subject), i_rEdit);
	}

	void Pose(std::size_t i_Segment, std::size_t i_Component, double i_Value, std::uint64_t i_Drag)
	{
		Edit(
		    [&](VSubjectParametrised& io_rSubject)
		    {
			    auto& rJoint = io_rSubject.m_Segments[i_Segment % io_rSubject.m_Segments.size()].m_Joint;
			    if (!rJoint.m_BindPose.empty())
				    rJoint.m_BindPose[i_Component % rJoint.m_BindPose.size()] = i_Value;
			    rJoint.m_Mean = rJoint.m_BindPose;
		    },
		    {RetargetSetup::Steps::c_Pose, i_Drag});
	}

	/// What a save gives, what the recipe gives and what the commands give.
	void ExpectTheSame()
	{
		ASSERT_EQ(m_Document.SaveTargetSubject(m_Folder / "saved.qrr"), 0u);
		const std::string saved = m_Folder.Read("saved.qrr");
		ASSERT_TRUE(m_Document.SaveSessionRecipe(m_Folder / "recipe.json"));
		const VRun run = m_Folder.Run({"-q", "build", "recipe.json", "-o", "built.qrr", "--force"});
		ASSERT_EQ(run.m_Status, 0) << run.m_Err << m_Folder.Read("recipe.json");
		EXPECT_TRUE(m_Folder.Read("built.qrr") == saved) << m_Folder.Read("recipe.json");
		const VJson recipe = VJson::parse(m_Folder.Read("recipe.json"));
		for (const VJson& rEdit : recipe.value("edits", VJson::array()))
			m_Kinds.insert(rEdit.begin().key());
		std::string commands = m_Document.SessionCommands();
		// Of what is in no file, no command can begin.
		if (m_Folder.Read("recipe.json").find("recipe-begin") != std::string::npos && commands.empty())
			return;
		ASSERT_TRUE(commands.starts_with("retarget "));
		++m_Commands;
		commands.replace(0, 8, RETARGET_PROGRAM " -q");
		commands.replace(commands.rfind("-o "), std::string::npos, "-o done.qrr --force > out.txt");
		const std::string inFolder = "cd '" + m_Folder.Path().string() + "' && " + commands;
		ASSERT_EQ(std::system(inFolder.c_str()), 0) << commands;
		EXPECT_TRUE(m_Folder.Read("done.qrr") == saved) << commands;
	}

	/// Keeps what the readers tell out of the tests' output.
	VLogRecorder m_Quiet;
	int m_Commands = 0;
	std::set<std::string> m_Kinds;
	const VScratchFolder m_Folder;
	InMemoryHost::VPluginContext m_Host;
	const std::shared_ptr<InMemoryHost::VApplication> m_pRules = std::make_shared<InMemoryHost::VApplication>();
	VRetargetSetupCore m_Document{m_Host.GetDispatcher(), m_Host.GetFrameFactory(), m_Host.GetItemFactory()};
};

TEST_F(Steps, OfEveryKindInAnyOrderGiveTheBytesOfASave)
{
	const std::string fbx[] = {RETARGET_SOURCE "/demo/character.fbx", Data("fbx/kenney_medium_b7400.fbx")};
	const std::string sources[] = {RETARGET_SOURCE "/demo/performer.qrs", (m_Folder / "second.qrs").string()};
	Put(sources[1], Get(Data("qrt/performer.qrs")));
	const boost::filesystem::path other = m_Folder / "it's another.qrr";
	for (unsigned seed = 1; seed <= 8; ++seed)
	{
		SCOPED_TRACE(seed);
		std::mt19937 random(seed);
		const auto upTo = [&random](int i_Most) { return int(random() % unsigned(i_Most + 1)); };
		m_Document.NewTargetSubject();
		m_pRules->m_Rules.m_bPoseFromFile = seed % 2 == 0;
		m_Document.LoadTargetFBX(fbx[0]);
		m_Document.LoadSourceSubject(sources[0], "");
		m_Document.CreateTargetSubject();
		for (int step = 0; step < 60; ++step)
		{
			if (!m_Document.TargetValues().m_pParametrised)
				m_Document.CreateTargetSubject();
			const int a = upTo(60), b = upTo(40);
			const std::size_t targets = m_Document.TargetValues().m_pParametrised->m_Targets.size();
			switch (upTo(23))
			{
			case 0: m_Document.UpdateTargets(); break;
			case 1: a % 2 == 0 ? m_Document.RemoveUnnecessaryJoints() : m_Document.RemoveJoint(b); break;
			case 2: m_Document.CreateAllJoints(); break;
			case 3: m_Document.SetTargetScale(0.3 + 0.07 * a); break;
			case 4: m_Document.SetScaleRootHeight(!m_Document.ScaleRootHeight()); break;
			case 5: m_Document.RemoveTarget(a % 4); break;
			case 6:
				if (const auto proposal = m_Document.ProposeTargets(0.5))
					for (const auto& rPair : proposal->m_Pairs)
						m_Document.AddTargets({{rPair.m_Source, rPair.m_Target, a % 2 == 0, 0.1 * b}});
				break;
			case 7:
				if (targets > 0)
					Edit([&](VSubjectParametrised& io_rSubject)
					    { io_rSubject.m_Targets[std::size_t(a) % targets].m_Weight = 0.1 * b; },
					    {RetargetSetup::Steps::c_Weight, std::uint64_t(a) + 1});
				break;
			case 8:
				if (targets > 0)
					Edit(
					    [&](VSubjectParametrised& io_rSubject)
					    {
						    for (const char* const pText : {"0.50 * 2", "-12.345"})
							    RetargetSetup::SetStateExpression(
							        io_rSubject, pText, std::size_t(a) % targets, std::size_t(b) % 3);
					    },
					    {RetargetSetup::Steps::c_State});
				break;
			case 9: m_Document.MatchFilePose(); break;
			case 10:
			{
				RetargetSetup::VAlignmentChoice choice;
				choice.m_bArms = a % 3 != 0;
				choice.m_bOthers = a % 5 != 0;
				choice.m_bFeetWithShins = a % 2 == 0;
				choice.m_bFitScale = a % 3 == 1;
				if (b % 2 == 0)
					choice.m_Locked = {std::size_t(b) / 4, std::size_t(b) / 3};
				m_Document.AlignToSource(choice, std::uint64_t(a));
				break;
			}
			case 11: m_Document.LoadSourceSubject(sources[a % 2], ""); break;
			case 12: m_Document.LoadTargetFBX(fbx[a % 2]); break;
			case 13:
				if (a % 4 == 0)
					m_Document.CreateTargetSubject();
				break;
			case 14:
				// Saved, gone on with, saved again, and loaded.
				m_Document.SaveTargetSubject(other);
				if (a % 2 == 0)
					m_Document.LoadTargetSubject(other);
				if (a % 4 == 0)
				{
					m_Document.MatchFilePose();
					Pose(std::size_t(a), 0, 0.1, 0);
					m_Document.MatchFilePose();
				}
				else if (b % 4 == 0)
					m_Document.CreateTargetSubject();
				break;
			case 15:
			case 16: m_Document.Undo(); break;
			case 17: m_Document.Redo(); break;
			case 18:
			case 19:
				for (int i = 0; i < 3; ++i)
					Pose(std::size_t(a), std::size_t(b), 0.013 * (b + i), std::uint64_t(step) + 1);
				break;
			case 20:
				if (const auto rebound = SetupReview::ReboundOf(m_Document, b % 2 == 0);
				    rebound && rebound->m_Refusal.empty())
					SetupReview::TakeOver(m_Document, *rebound, b % 2 == 0, a % 3 == 0);
				break;
			default: m_Document.AddTarget(a % 24, b, a % 2 == 0, b % 2 == 0); break;
			}
			m_Host.Dispatcher().RunPending();
			if (step % 10 == 9 && m_Document.TargetValues().m_pParametrised)
				ExpectTheSame();
			if (HasFailure())
				return;
		}
	}
	// A saved subject is tied to no file until one is read.
	m_Document.CreateTargetSubject();
	m_Document.AddTargets({{0, 0, true, 1.0}});
	m_Document.SaveTargetSubject(other);
	m_Document.LoadTargetSubject(other);
	Pose(1, 0, 0.1, 0);
	m_Document.AlignToSource({}, 1);
	m_Host.Dispatcher().RunPending();
	ExpectTheSame();
	EXPECT_GT(m_Commands, 10);
	EXPECT_EQ(m_Kinds,
	    (std::set<std::string>{"align", "allow-partial", "as-it-stands", "chain", "create-joints", "expressions",
	        "fbx-pose", "feet", "lock", "match-file-pose", "on-joints", "pose", "position", "prune-joint",
	        "prune-joints", "rebind-fbx", "rebind-source", "remove-target", "rotation", "scale", "skin", "source-name",
	        "switch-root-height", "switch-source", "unlock", "update-targets", "weight"}));
}

} // namespace
