#include "FbxFileBuilder.h"
#include "TestFile.h"
#include "TestLog.h"

#include <fbxsdk.h>

#include <gtest/gtest.h>

using namespace FbxTest;
using namespace std::string_literals;

namespace
{

/// A file imported into a scene.
struct VImported
{
	explicit VImported(const std::string& i_rBytes) : m_File(i_rBytes)
	{
		m_pManager = FbxManager::Create();
		m_pScene = FbxScene::Create(m_pManager, "scene");
		m_pImporter = FbxImporter::Create(m_pManager, "importer");
		m_bInitialized = m_pImporter->Initialize(m_File.Path().c_str(), -1, nullptr);
		m_bImported = m_pImporter->Import(m_pScene, false);
	}
	~VImported() { m_pManager->Destroy(); }
	FbxNode* Root() { return m_pScene->GetRootNode(); }

	VTestFile m_File;
	FbxManager* m_pManager;
	FbxScene* m_pScene;
	FbxImporter* m_pImporter;
	bool m_bInitialized;
	bool m_bImported;
};

/// "a(b(c) d)", bones with a star.
std::string Outline(FbxNode* i_pNode)
{
	std::string outline = i_pNode->GetName();
	outline += i_pNode->GetSkeleton() ? "*" : "";
	for (int i = 0; i < i_pNode->GetChildCount(); ++i)
	{
		EXPECT_EQ(i_pNode->GetChild(i)->GetParent(), i_pNode);
		outline += i == 0 ? "(" : " ";
		outline += Outline(i_pNode->GetChild(i));
	}
	outline += i_pNode->GetChildCount() > 0 ? ")" : "";
	return outline;
}

TEST(Scene, IsTheSameInEveryForm)
{
	const VTestScene scene{
	    {{"top", "Null", -1, {{"Lcl Translation", {1, 2, 3}}, {"Lcl Scaling", {2, 2, 2}}}},
	        {"hips", "LimbNode", 0,
	            {{"Lcl Translation", {4, 5, 6}}, {"Lcl Rotation", {10, 20, 30}}, {"RotationOrder", {3}},
	                {"RotationActive", {1}}, {"PreRotation", {5, 6, 7}}, {"InheritType", {2}}}},
	        {"knee", "Limb", 1, {{"PostRotation", {7, 8, 9}}, {"RotationActive", {1}}}}, {"root", "Root", -1, {}},
	        {"tip", "Effector", 2, {}}},
	    {{"UpAxis", {2}}, {"UpAxisSign", {-1}}, {"UnitScaleFactor", {2.54}}}, {}, {}};
	VImported first(Write(c_Forms[0], scene));
	for (const VTestForm& rForm : c_Forms)
	{
		VImported file(Write(rForm, scene));
		ASSERT_TRUE(file.m_bImported) << file.m_pImporter->GetStatus().GetErrorString();
		EXPECT_EQ(Outline(file.Root()), "RootNode(top(hips*(knee*(tip*))) root*)") << rForm.m_pName;
		EXPECT_EQ(file.m_pScene->GetGlobalSettings().GetSystemUnit().GetScaleFactor(), 2.54);
		int sign = 0;
		EXPECT_EQ(file.m_pScene->GetGlobalSettings().GetAxisSystem().GetUpVector(sign), FbxAxisSystem::eZAxis);
		EXPECT_EQ(sign, -1);
		EXPECT_TRUE(file.Root()->GetChild(1)->GetSkeleton()->IsSkeletonRoot());
		FbxNode* pNode = file.Root();
		FbxNode* pOther = first.Root();
		for (; pNode->GetChildCount() > 0; pNode = pNode->GetChild(0), pOther = pOther->GetChild(0))
			for (int i = 0; i < 16; ++i)
			{
				EXPECT_EQ(pNode->EvaluateGlobalTransform().Get(i / 4, i % 4),
				    pOther->EvaluateGlobalTransform().Get(i / 4, i % 4));
				EXPECT_EQ(pNode->EvaluateLocalTransform().Get(i / 4, i % 4),
				    pOther->EvaluateLocalTransform().Get(i / 4, i % 4));
			}
		int major = 0, minor = 0, revision = 0;
		file.m_pImporter->GetFileVersion(major, minor, revision);
		EXPECT_EQ(major * 1000 + minor * 100 + revision * 10, int(rForm.m_Version));
	}
}

TEST(Scene, NodesTakeWhatTheyDoNotTellFromTheTemplate)
{
	const VTestScene scene{
	    {{"a", "Null", -1, {}}, {"b", "Null", -1, {{"Lcl Translation", {1, 1, 1}}, {"RotationActive", {0}}}}}, {},
	    {{"Lcl Translation", {7, 8, 9}}, {"Lcl Scaling", {3, 4, 5}}, {"PreRotation", {1, 2, 3}},
	        {"RotationActive", {1}}},
	    {}};
	VImported file(Write(c_Forms[1], scene));
	FbxNode* const pA = file.Root()->GetChild(0);
	FbxNode* const pB = file.Root()->GetChild(1);
	EXPECT_EQ(pA->EvaluateLocalTransform().Get(3, 2), 9.0);
	EXPECT_EQ(pB->EvaluateLocalTransform().Get(3, 2), 1.0);
	EXPECT_EQ(pB->EvaluateLocalScaling()[2], 5.0);
	EXPECT_EQ(pA->GetPreRotation(FbxNode::eSourcePivot)[1], 2.0);
	EXPECT_EQ(pB->GetPreRotation(FbxNode::eSourcePivot)[1], 0.0);
	EXPECT_EQ(pA->GetPreRotation(FbxNode::eDestinationPivot)[1], 0.0);
}

TEST(Scene, BrokenConnectionsAreLeftOutAndTold)
{
	for (const VTestForm& rForm : c_Forms)
	{
		VTestLog log;
		const VTestScene scene{{{"a", "LimbNode", -1, {}}, {"b", "LimbNode", 0, {}}, {"ring1", "Null", 3, {}},
		                           {"ring2", "Null", 2, {}}, {"below", "Null", 2, {}}, {"self", "Null", 5, {}}},
		    {}, {}, {{1, -1}, {1, 0}}};
		std::vector<VTestRecord> records = Records(rForm, scene);
		const bool bNew = rForm.m_Version >= 7000;
		const auto key = [bNew](std::int64_t i_Number, const char* i_pName)
		{ return bNew ? VTestValue(i_Number) : VTestValue("Model::"s + i_pName); };
		const VTestRecord unknown[]{{"C", {"OO"s, key(99, "nobody"), key(1, "a")}, {}},
		    {"C", {"OO"s, key(1, "a"), key(99, "nobody")}, {}}, {"C", {"OO"s}, {}}, {"C", {}, {}}};
		auto& rConnections = records.back().m_Children;
		rConnections.insert(rConnections.begin(), std::begin(unknown), std::end(unknown));
		// An object that no connection names.
		records[records.size() - 2].m_Children.push_back({"Model",
		    bNew ? std::vector<VTestValue>{std::int64_t(500), "Model::loose"s, "Null"s}
		         : std::vector<VTestValue>{"Model::loose"s, "Null"s},
		    {}});
		VImported file(Write(rForm, records));
		EXPECT_TRUE(file.m_bImported);
		EXPECT_EQ(Outline(file.Root()), "RootNode(a*(b*))") << rForm.m_pName;
		EXPECT_EQ(file.Root()->GetChildCount(true), 2);
		const VMessages expected{
		    {3, "Connections left out because their node has another parent: 1, such as that of b"},
		    {4, "Nodes left out because no connection leads to them: 1"},
		    {3, "Nodes left out because their connections lead round in a ring: 4"}};
		EXPECT_EQ(log.m_Messages, expected) << rForm.m_pName;
	}
}

TEST(Scene, ChainOfFiftyThousandNodes)
{
	constexpr int c_Count = 50'000;
	std::string nodes, connections;
	for (int i = 1; i <= c_Count; ++i)
	{
		const std::string number = std::to_string(i);
		nodes.append("Model: ").append(number).append(",\"\",\"\" {\nProperties70: {\n");
		nodes.append("P: \"Lcl Translation\",\"\",\"\",\"\",1,0,0\n}\n}\n");
		connections.append("C: \"OO\",").append(number).append(",").append(std::to_string(i - 1)).append("\n");
	}
	VImported file("; FBX 7.4.0\nObjects: {\n" + nodes + "}\nConnections: {\n" + connections + "}\n");
	ASSERT_TRUE(file.m_bImported);
	EXPECT_EQ(file.Root()->GetChildCount(true), c_Count);
	FbxNode* pLast = file.Root();
	while (pLast->GetChildCount() > 0)
		pLast = pLast->GetChild(0);
	// From the far end, so that all of them are open at once.
	EXPECT_EQ(pLast->EvaluateGlobalTransform().Get(3, 0), c_Count);
}

TEST(Scene, ImporterRefusesWhatItCannotDo)
{
	VImported file(Write(c_Forms[1], VTestScene()));
	EXPECT_TRUE(file.m_bImported);
	EXPECT_FALSE(file.m_pImporter->Import(file.m_pScene, true));
	EXPECT_FALSE(file.m_pImporter->Import(nullptr, false));
	EXPECT_FALSE(file.m_pImporter->Initialize(file.m_File.Path().c_str(), 2, nullptr));
	EXPECT_EQ(file.m_pImporter->GetStatus().GetCode(), FbxStatus::eInvalidParameter);
	EXPECT_FALSE(file.m_pImporter->Import(file.m_pScene, false));
	EXPECT_EQ(file.Root()->GetChild(0), nullptr);
	EXPECT_EQ(file.Root()->GetParent(), nullptr);
}

} // namespace
