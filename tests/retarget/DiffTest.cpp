#include "Rows.h"

namespace
{

TEST(Diff, TellsEditsInWords)
{
	const VScratchFolder folder;
	ASSERT_EQ(folder
	              .Run({"-q", "create", "--fbx", c_Fbx, "--source", c_Performer, "--position", "Hips:Hips",
	                  "--rotation", "LeftArm:LeftArm", "-o", "a.qrr"})
	              .m_Status,
	    0);
	const auto edited = [&](std::vector<std::string> i_Edits)
	{
		i_Edits.insert(i_Edits.begin(), {"-q", "edit", "a.qrr", "-o", "b.qrr"});
		const VRun run = folder.Run(i_Edits);
		EXPECT_EQ(run.m_Status, 0) << run.m_Err;
	};
	struct VEdited
	{
		std::vector<std::string> m_Edits;
		std::string m_Out;
	};
	for (const auto& [rEdits, rOut] : std::vector<VEdited>{
	         {{}, "no differences\n"},
	         {{"--weight", "1=0.25"}, "target \"Rotation LeftArm > LeftArm\": weight 1 -> 0.25\n"},
	         {{"--scale", "1.5"}, "subject: scale 1 -> 1.5\n"},
	         {{"--pose", "LeftArm=0,0,0", "--pose", "LeftArm=0.5,0,0"}, "segment \"LeftArm\": bind pose"},
	         {{"--remove-target", "0"}, "target \"Position Hips > Hips\": removed\n"},
	         {{"--prune-joints"}, "segment \"Head\": joint pruned, which was of type Ball\n"},
	     })
	{
		edited(rEdits);
		const VRun run = folder.Run({"diff", "a.qrr", "b.qrr"});
		EXPECT_EQ(run.m_Status, rEdits.empty() ? 0 : 1);
		EXPECT_NE(run.m_Out.find(rOut), std::string::npos) << run.m_Out;
	}
	// An offset of 3 mm and 4 mm more, at any scale.
	edited({"--state", "0=0,0,0"});
	ASSERT_EQ(folder.Run({"-q", "edit", "b.qrr", "--scale", "2", "--state", "0=6,8,0", "-o", "c.qrr"}).m_Status, 0);
	const VJson json = VJson::parse(folder.Run({"diff", "b.qrr", "c.qrr", "--json"}).m_Out);
	for (const VJson& rChange : json["changes"])
		EXPECT_NEAR(rChange["id"] == "offset" ? 5.0 : 0.0, rChange.value("millimetres", 0.0), 1e-6);
	EXPECT_EQ(json["changes"].size(), 2u);
	EXPECT_NE(folder.Run({"diff", "--describe", "b.qrr"}).m_Out.find("segment \"LeftArm\" Joint.JointType: Ball\n"),
	    std::string::npos);
}

} // namespace
