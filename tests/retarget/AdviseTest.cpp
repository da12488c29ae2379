#include "Rows.h"

#include <set>
#include <utility>

namespace
{

class Advise : public testing::Test
{
protected:
	void Create(std::vector<std::string> i_Edits)
	{
		i_Edits.insert(i_Edits.begin(), {"-q", "create", "--fbx", c_Fbx, "--source", c_Performer, "-o", "x.qrr"});
		const VRun run = m_Folder.Run(i_Edits);
		ASSERT_EQ(run.m_Status, 0) << run.m_Err;
	}

	VJson Advice(std::vector<std::string> i_Options)
	{
		i_Options.insert(i_Options.begin(), {"-q", "advise", "x.qrr", "--json"});
		return RunJson(i_Options, m_Folder);
	}

	VJson Joint(const std::vector<std::string>& i_rOptions, const std::string& i_rName)
	{
		const VJson advice = Advice(i_rOptions);
		for (const VJson& rJoint : advice["prune"])
			if (rJoint["segment"] == i_rName)
				return rJoint;
		return {{"verdict", "not there"}};
	}

	const VScratchFolder m_Folder{};
};

TEST_F(Advise, JointsThatCouldGo)
{
	Create({"--rotation", "Hips:Hips", "--position", "LeftHand:LeftHand", "--pose", "LeftForeArm=0,0,0.5"});
	EXPECT_EQ(Joint({}, "LeftForeArm")["verdict"], "may go");
	const VJson stay = Joint({"--fbx", c_Fbx}, "LeftForeArm");
	EXPECT_EQ(stay["verdict"], "stay");
	EXPECT_GT(stay["vertices"].get<int>(), 100);
	EXPECT_EQ(stay["targetsBelow"], VJson({1}));
	EXPECT_EQ(Joint({}, "RightLeg")["verdict"], "go");
	for (const char* const pKept : {"Hips", "LeftHand"})
		EXPECT_EQ(Joint({}, pKept)["verdict"], "not there") << pKept;
	// One by one as advised, the rest by the edit for all.
	EXPECT_EQ(Joint({}, "RightLeg")["options"], "--prune-joint RightLeg");
	EXPECT_EQ(stay["options"], "");
	const VRun told = m_Folder.Run({"-q", "advise", "x.qrr"});
	EXPECT_NE(told.m_Out.find(" --prune-joint RightLeg "), std::string::npos) << told.m_Out;
	ASSERT_EQ(m_Folder.Run({"-q", "edit", "x.qrr", "--prune-joint", "RightLeg", "-o", "x.qrr"}).m_Status, 0);
	EXPECT_EQ(Joint({}, "RightLeg")["verdict"], "not there");
	EXPECT_EQ(Joint({}, "LeftLeg")["verdict"], "go");
	for (const auto& [pJoint, pWhy] : {std::pair("RightLeg", "has no joint that could go"), {"Hips", "is the root"}})
	{
		const VRun run = m_Folder.Run({"-q", "edit", "x.qrr", "--prune-joint", pJoint, "-o", "x.qrr"});
		EXPECT_EQ(run.m_Status, 2);
		EXPECT_NE(run.m_Err.find(pWhy), std::string::npos) << run.m_Err;
	}
	// As pruning all joints but those does: the hand stays where it is told to go.
	ASSERT_EQ(m_Folder.Run({"-q", "edit", "x.qrr", "--prune-joints", "-o", "x.qrr"}).m_Status, 0);
	EXPECT_EQ(Advice({})["prune"].size(), 0u);
}

TEST_F(Advise, TargetsThatPullAgainstEachOther)
{
	Create({"--rotation", "Hips:Hips", "--rotation", "LeftArm:LeftArm", "--rotation", "LeftForeArm:LeftForeArm"});
	const VJson alone = Advice({"--source", c_Performer})["range"];
	EXPECT_EQ(alone["conflicts"].size(), 0u) << alone;
	EXPECT_GT(alone["poses"].get<int>(), 20);
	// The character's arm has another length: where the performer's turns, position and rotation want two things.
	Create({"--position", "Hips:Hips", "--rotation", "Hips:Hips", "--rotation", "LeftArm:LeftArm", "--rotation",
	    "LeftForeArm:LeftForeArm", "--position", "LeftHand:LeftHand", "--weight", "4=100", "--scale", "0.7"});
	bool bAgainst = false;
	const VJson range = Advice({"--source", c_Performer})["range"];
	for (const VJson& rConflict : range["conflicts"])
		bAgainst = bAgainst || (rConflict["target"].get<int>() < 4 && rConflict["against"] == 4);
	EXPECT_TRUE(bAgainst);
	// The demo's set-up: what pulls against others, not everything that is missed where limbs go far.
	const std::string demo = RETARGET_SOURCE "/demo/";
	const std::string performer = demo + "performer.qrs";
	const VRun create = m_Folder.Run({"-q", "create", "--fbx", demo + "character.fbx", "--source", performer, "--auto",
	    "--align", "-o", "x.qrr", "--force"});
	ASSERT_EQ(create.m_Status, 0) << create.m_Err;
	const VJson ranged = Advice({"--source", performer})["range"];
	std::set<std::pair<int, int>> pairs;
	std::set<int> pulling;
	for (const VJson& rConflict : ranged["conflicts"])
	{
		const int target = rConflict["target"];
		const int against = rConflict["against"];
		EXPECT_LT(rConflict["without"].get<double>(), 0.25 * rConflict["atWorst"].get<double>());
		EXPECT_FALSE(pairs.contains({against, target})) << "told once";
		pairs.emplace(target, against);
		pulling.insert(against);
	}
	EXPECT_GT(ranged["unopposed"].get<int>(), 0);
	EXPECT_GT(pulling.size(), 2u);
	EXPECT_LT(pulling.size(), 10u);
}

TEST_F(Advise, WrongInput)
{
	Create({});
	RunRows(
	    {
	        {"no subject", {"-q", "advise", "none.qrr"}, 3, "", "\"none.qrr\" could not be read"},
	        {"no skin", {"-q", "advise", "x.qrr", "--fbx", "x.qrr"}, 3, "", "could not be read whole as FBX"},
	        {"nothing to solve", {"-q", "advise", "x.qrr", "--source", c_Performer}, 0, "there is no target", ""},
	    },
	    m_Folder);
}

} // namespace
