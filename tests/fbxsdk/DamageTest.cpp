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
};

/// Imports and evaluates everything.
VResult Load(const std::string& i_rBytes)
{
	const VTestLog quiet("FBXIO");
	VImported file(i_rBytes);
	VResult result{file.m_bInitialized, file.m_bImported, 0};
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
	const std::string binary = Write(c_Forms[1], std::vector<VTestRecord>{}).substr(0, 27);
	EXPECT_FALSE(Load(binary + repeat("\xff")).m_bComplete);
	EXPECT_FALSE(Load(binary + repeat("\1"s + std::string(12, '\0'))).m_bComplete);
}

/// More than is kept is left out and told; what was kept is whole.
TEST(Damage, ListsAreBounded)
{
	std::string nodes, connections;
	for (std::size_t i = 1; i <= FbxFormat::Limits::c_Nodes + 1; ++i)
	{
		const std::string number = std::to_string(i);
		nodes.append("Model: ").append(number).append(",\"Model::a\",\"Null\"\n");
		connections.append("C: \"OO\",").append(number).append(",0\n");
	}
	const VResult result = Load(c_Head + "Objects: {\n" + nodes + "}\nConnections: {\n" + connections + "}\n");
	EXPECT_FALSE(result.m_bComplete);
	EXPECT_EQ(result.m_Nodes, int(FbxFormat::Limits::c_Nodes) + 1);
	const auto objects = [&](std::size_t i_Count) {
		return Load(c_Head + "Objects: {\n" + Repeated(i_Count, "Pose: 7,\"\"\n") + "}\nConnections: {\n}\n")
		    .m_bComplete;
	};
	EXPECT_TRUE(objects(FbxFormat::Limits::c_Objects));
	EXPECT_FALSE(objects(FbxFormat::Limits::c_Objects + 1));
	const auto records = [&](std::size_t i_Count)
	{ return Load(c_Head + "Objects: {\n}\nConnections: {\n}\n" + Repeated(i_Count, "A:1\n")).m_bComplete; };
	// The root and the two sections are records too.
	EXPECT_TRUE(records(FbxFormat::Limits::c_Records - 3));
	EXPECT_FALSE(records(FbxFormat::Limits::c_Records - 2));
}

} // namespace
