#include "Rows.h"

#include <boost/algorithm/string/replace.hpp>

namespace
{

using boost::algorithm::replace_all_copy;

/// A character with its set-up in "own.qrr", and files of the character that were changed.
class Rebind : public testing::Test
{
protected:
	Rebind()
	{
		const std::string fbx = Get(Data("fbx/own_ns_yup_cm_a7400.fbx"));
		m_Folder.Write("own.fbx", fbx);
		m_Folder.Write("prefix.fbx", replace_all_copy(fbx, "Character1:", "Rig_"));
		std::string changed = replace_all_copy(fbx, "Character1:LeftForeArm", "Character1:L_Elbow");
		// Both shins 70 mm longer.
		changed = replace_all_copy(changed, "43.011627197265625", "50.011627197265625");
		m_Folder.Write("changed.fbx", changed);
		const VRun run = m_Folder.Run({"-q", "create", "--fbx", "own.fbx", "--source", c_Performer, "--auto",
		    "--prune-joints", "--match-file-pose", "--update-targets", "-o", "own.qrr"});
		EXPECT_EQ(run.m_Status, 0) << run.m_Err;
	}

	VJson Changed(const std::string& i_rFbx)
	{
		return RunJson({"-q", "rebind", "own.qrr", "--fbx", i_rFbx, "-o", "new.qrr", "--json"}, m_Folder);
	}

	const VScratchFolder m_Folder;
};

TEST_F(Rebind, TheSameFileChangesNothing)
{
	EXPECT_EQ(Changed("own.fbx")["changes"].size(), 0u);
	EXPECT_EQ(m_Folder.Read("new.qrr"), m_Folder.Read("own.qrr"));
	// Of two bones of one name each stays beneath its own hand.
	m_Folder.Write("twins.fbx",
	    replace_all_copy(
	        replace_all_copy(m_Folder.Read("own.fbx"), "LeftHandIndex1", "HandIndex"), "RightHandIndex1", "HandIndex"));
	ASSERT_EQ(m_Folder.Run({"-q", "create", "--fbx", "twins.fbx", "--source", c_Performer, "--auto", "-o", "twins.qrr"})
	              .m_Status,
	    0);
	const VJson twins = RunJson({"-q", "rebind", "twins.qrr", "--fbx", "twins.fbx", "--json"}, m_Folder);
	EXPECT_EQ(twins["changes"].size(), 0u) << twins["changes"];
}

TEST_F(Rebind, AnotherPrefixKeepsAll)
{
	const VJson json = Changed("prefix.fbx");
	EXPECT_EQ(json["changes"].size(), 1u) << json["changes"];
	EXPECT_EQ(json["lost"].size(), 0u);
	for (const VJson& rMatch : json["segments"])
		EXPECT_EQ(rMatch["new"], "Rig_" + rMatch["old"].get<std::string>());
	for (const VJson& rTarget : RunJson({"-q", "targets", "new.qrr", "--json"}, m_Folder))
		EXPECT_TRUE(rTarget["name"].get<std::string>().ends_with(rTarget["target"].get<std::string>())) << rTarget;
	EXPECT_EQ(replace_all_copy(replace_all_copy(m_Folder.Read("new.qrr"), "Rig_", ""), "\"prefix\"", "\"own\""),
	    m_Folder.Read("own.qrr"));
}

/// The feet stay on the floor, so that the body rises by what the shins got longer, and each target keeps what it
/// follows: measured anew, no offset moves.
TEST_F(Rebind, LongerLegsAndAnotherName)
{
	const VJson json = Changed("changed.fbx");
	EXPECT_EQ(json["lost"].size(), 0u);
	const VJson poses = RunJson({"-q", "fk", "new.qrr"}, m_Folder)["segments"];
	const VJson before = RunJson({"-q", "fk", "own.qrr"}, m_Folder)["segments"];
	for (std::size_t i = 0; i < poses.size(); ++i)
	{
		const std::string name = poses[i]["name"];
		const bool bFoot = name.ends_with("Foot") || name.ends_with("ToeBase");
		const double rise = poses[i]["translation"][2].get<double>() - before[i]["translation"][2].get<double>();
		EXPECT_NEAR(rise, bFoot ? 0.0 : name.ends_with("Leg") ? rise : 70.0, 0.1) << name;
		for (std::size_t k = 0; k < 9; ++k)
			EXPECT_NEAR(poses[i]["rotation"][k].get<double>(), before[i]["rotation"][k].get<double>(), 1e-5) << name;
	}
	ASSERT_EQ(
	    m_Folder.Run({"-q", "edit", "new.qrr", "--source", c_Performer, "--update-targets", "-o", "m.qrr"}).m_Status,
	    0);
	const VJson measured = VJson::parse(m_Folder.Run({"-q", "diff", "new.qrr", "m.qrr", "--json"}).m_Out);
	for (const VJson& rChange : measured["changes"])
		EXPECT_LT(rChange.value("millimetres", 0.0) + rChange.value("degrees", 0.0), 1e-3) << rChange;
}

TEST_F(Rebind, NothingIsLostSilently)
{
	RunRows(
	    {
	        {"half the body", {"-q", "rebind", "own.qrr", "--fbx", "own.fbx", "--root", "LeftUpLeg", "-o", "x.qrr"}, 1,
	            "What could not be kept", "\"x.qrr\" is not written, since not all could be kept (Target"},
	        {"told only", {"-q", "rebind", "own.qrr", "--fbx", "own.fbx", "--root", "LeftUpLeg"}, 1, "Target 0", ""},
	        {"performer without fingers",
	            {"-q", "rebind", "own.qrr", "--source", RETARGET_SOURCE "/demo/performer.qrs", "-o", "x.qrr"}, 1,
	            "Hips             Pelvis", "The new performer has no segment \"LeftHandIndex1\""},
	        {"as an edit",
	            {"edit", "own.qrr", "--source", RETARGET_SOURCE "/demo/performer.qrs", "--rebind-source", "-o",
	                "x.qrr"},
	            1, "", "error retarget: Not kept: "},
	        {"nothing new", {"rebind", "own.qrr"}, 2, "", "Give what is new: the character's file with --fbx"},
	        {"nothing to measure", {"rebind", "own.qrr", "--fbx", "own.fbx", "--measure"}, 2, "", "--measure needs"},
	        {"no root", {"-q", "rebind", "own.qrr", "--fbx", "own.fbx", "--root", "Hip"}, 2, "", "there is no bone"},
	        {"no FBX", {"-q", "rebind", "own.qrr", "--fbx", "own.qrr"}, 3, "", "could not be read as FBX"},
	        {"own joints", {"-q", "rebind", c_Performer, "--fbx", "own.fbx"}, 3, "",
	            "joints, post poses or parameters"},
	        {"over its input", {"rebind", "own.qrr", "--fbx", "own.fbx", "-o", "own.fbx"}, 2, "", "is an input"},
	    },
	    m_Folder);
	const VRun partial = m_Folder.Run({"rebind", "own.qrr", "--source", RETARGET_SOURCE "/demo/performer.qrs",
	    "--measure", "--allow-partial", "-o", "other.qrr"});
	ASSERT_EQ(partial.m_Status, 0);
	EXPECT_NE(partial.m_Err.find("warning retarget: Not kept: The new performer has no segment \"LeftHandIndex1\""),
	    std::string::npos)
	    << partial.m_Err;
	for (const VJson& rTarget :
	    RunJson({"-q", "targets", "other.qrr", "--source", RETARGET_SOURCE "/demo/performer.qrs", "--json"}, m_Folder))
	{
		// Nothing of the performer is there for the two fingers.
		const VJson& rResidual = rTarget[rTarget["distance"].is_null() ? "angle" : "distance"];
		EXPECT_LT(rResidual.is_null() ? 0.0 : rResidual.get<double>(), 1e-3) << rTarget;
		EXPECT_EQ(rResidual.is_null(), rTarget["source"].get<std::string>().ends_with("HandIndex1")) << rTarget;
	}
}

} // namespace
