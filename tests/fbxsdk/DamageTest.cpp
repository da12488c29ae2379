#include "../UtilsFileSystem/Log.h"

#include "fbxsdk/Limits.h"

#include "FbxFileBuilder.h"
#include "Imported.h"

using namespace FbxTest;
using namespace std::string_literals;

namespace
{

const std::string c_Head = "; FBX 7.4.0\n";

std::string Repeated(std::size_t i_Count, const std::string& i_rText)
{
	std::string text;
	while (i_Count-- > 0)
		text += i_rText;
	return text;
}

struct VResult
{
	bool m_bInitialized;
	bool m_bComplete;
	int m_Nodes;
	std::string m_Reason;
};

/// Imports and evaluates everything.
VResult Load(const std::string& i_rBytes)
{
	const VTestLog quiet("FBXIO");
	VImported file(i_rBytes);
	VResult result{file.m_bInitialized, file.m_bImported, 0, file.m_pImporter->GetStatus().GetErrorString()};
	std::vector<FbxNode*> open{file.Root()};
	while (!open.empty())
	{
		FbxNode* const pNode = open.back();
		open.pop_back();
		++result.m_Nodes;
		pNode->EvaluateGlobalTransform();
		for (int i = 0; i < pNode->GetChildCount(); ++i)
			open.push_back(pNode->GetChild(i));
	}
	return result;
}

/// What a hostile MiB can hold most of: all of it must stay linear.
TEST(Damage, AMillionBytesOfAnythingAreReadInOneGo)
{
	const auto repeat = [](const std::string& i_rText) { return Repeated((1 << 20) / i_rText.size(), i_rText); };
	for (const std::string& rUnit :
	    {"}"s, "{"s, "A:\n"s, "A: ,\n"s, "\"x\""s, ";\n"s, "A: *9 {\n"s, "A: 1,;\n"s, "A:{}\n"s})
		EXPECT_TRUE(Load(c_Head + repeat(rUnit)).m_bInitialized) << rUnit;
	// Objects with one and the same number, and connections among them.
	EXPECT_EQ(Load(c_Head + "Objects: {\n" + repeat("Model: 5,\"Model::a\",\"Null\"\n") + "}\nConnections: {\n"
	              + repeat("C: \"OO\",5,0\n") + "}\n")
	              .m_Nodes,
	    2);
	// What is passed over has no end.
	for (const char* pUnit : {"Pose: 5,\"\" {\n", "Pose: 5,\"\" {}\n", "Pose: 5,\"\" { \"\n"})
		EXPECT_FALSE(Load(c_Head + "Objects: {\n" + repeat(pUnit)).m_bComplete) << pUnit;
	const std::string binary = Write(c_Forms[1], std::vector<VTestRecord>{}).substr(0, 27);
	EXPECT_FALSE(Load(binary + repeat("\xff")).m_bComplete);
	EXPECT_FALSE(Load(binary + repeat("\1"s + std::string(12, '\0'))).m_bComplete);
}

/// More than is kept is left out, and the limit is named; what was kept is whole.
TEST(Damage, ListsAreBounded)
{
	namespace Limits = FbxFormat::Limits;
	const auto objects = [](std::size_t i_Count, const char* i_pObject)
	{ return c_Head + "Objects: {\n" + Repeated(i_Count, i_pObject) + "}\nConnections: {\n}\n"; };
	const auto isBeyond = [](const std::string& i_rBytes, const std::string& i_rWhat)
	{
		const VResult result = Load(i_rBytes);
		EXPECT_EQ(result.m_Reason.substr(0, result.m_Reason.find(" (byte ")),
		    result.m_bComplete ? "" : "File holds more than is read: it has more than " + i_rWhat);
		return !result.m_bComplete;
	};
	const std::tuple<std::size_t, const char*, const char*> rows[]{
	    {Limits::c_Nodes, "Model: 7,\"Model::a\",\"Null\"\n", " nodes"},
	    {Limits::c_Parts, "Video: 7,\"\"\n", " materials, textures, pictures, meshes and skins"},
	    {Limits::c_Clusters, "Deformer: 7,\"\",\"Cluster\"\n", " clusters of skins"},
	    {Limits::c_Objects, "Display: 7,\"\"\n", " objects"}};
	for (const auto& [limit, pObject, pWhat] : rows)
	{
		EXPECT_FALSE(isBeyond(objects(limit, pObject), std::to_string(limit) + pWhat));
		EXPECT_TRUE(isBeyond(objects(limit + 1, pObject), std::to_string(limit) + pWhat));
	}
	// The root and the two sections are records too.
	const auto records = [&](std::size_t i_Count) { return objects(0, "") + Repeated(i_Count, "A:1\n"); };
	const std::string many = std::to_string(Limits::c_Records) + " records";
	EXPECT_FALSE(isBeyond(records(Limits::c_Records - 3), many));
	EXPECT_TRUE(isBeyond(records(Limits::c_Records - 2), many));
	// What came before the limit is there.
	std::string nodes, connections;
	for (std::size_t i = 1; i <= Limits::c_Nodes + 1; ++i)
	{
		const std::string number = std::to_string(i);
		nodes.append("Model: ").append(number).append(",\"Model::a\",\"Null\"\n");
		connections.append("C: \"OO\",").append(number).append(",0\n");
	}
	const VResult result = Load(c_Head + "Objects: {\n" + nodes + "}\nConnections: {\n" + connections + "}\n");
	EXPECT_EQ(result.m_Nodes, int(Limits::c_Nodes) + 1);
}

} // namespace
