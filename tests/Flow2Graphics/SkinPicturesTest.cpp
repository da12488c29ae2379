#include "PicturesFixture.h"

#include "../FBXIO/MeshFile.h"
#include "../OrlexGraphics/HeldJobs.h"
#include "CoreGraphics/RenderContext.h"
#include "DebugServices/GlobalLog.h"
#include "Flow2Graphics/SubjectTypes.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "OrlexGraphics/skins/SkinRenderer.h"
#include "TestSubject.h"

#include <QTemporaryDir>

#include <fstream>

namespace
{

using namespace FbxTest;

/// A box about a place, in one material, that goes with one bone; each face shows the whole texture.
VTestMesh Box(int i_Node, int i_Bone, const QVector3D& i_rMiddle, VTestMaterial i_Material)
{
	constexpr double c_Edge = 30.0;
	VTestMesh mesh;
	mesh.m_Node = i_Node;
	mesh.m_UV = {"ByPolygonVertex", "IndexToDirect", {}, {}};
	mesh.m_MaterialLayer = {"AllSame", "IndexToDirect", {}, {0}};
	mesh.m_Materials = {std::move(i_Material)};
	VTestCluster cluster{i_Bone, {}, {}, {}, {}};
	for (int axis = 0; axis < 3; ++axis)
		for (const double side : {1.0, -1.0})
			for (int corner = 0; corner < 4; ++corner)
			{
				// Counted so that the face looks outwards.
				const double u = corner == 1 || corner == 2 ? 1.0 : -1.0;
				const double v = corner >= 2 ? 1.0 : -1.0;
				double place[3];
				place[axis] = side * c_Edge;
				place[(axis + 1) % 3] = u * side * c_Edge;
				place[(axis + 2) % 3] = v * c_Edge;
				const int point = int(mesh.m_Points.size() / 3);
				for (int k = 0; k < 3; ++k)
					mesh.m_Points.push_back(place[k] + double(i_rMiddle[k]));
				mesh.m_Polygons.push_back(corner == 3 ? -point - 1 : point);
				mesh.m_UV.m_Direct.insert(mesh.m_UV.m_Direct.end(), {u * 0.5 + 0.5, v * 0.5 + 0.5});
				mesh.m_UV.m_Index.push_back(point);
				cluster.m_Points.push_back(point);
				cluster.m_Weights.push_back(1.0);
			}
	const double x = double(i_rMiddle.x()), y = double(i_rMiddle.y()), z = double(i_rMiddle.z());
	cluster.m_Link = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, x, y, z, 1};
	cluster.m_Transform = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, -x, -y, -z, 1};
	mesh.m_Clusters = {std::move(cluster)};
	return mesh;
}

class SkinPictures : public VPicturesTest
{
protected:
	void SetUp() override
	{
		m_pSkinCache = NVX::MakeShared<OrlexGraphics::VSkinCache>(m_pDispatcher, m_pJobs);
		ASSERT_NO_FATAL_FAILURE(VPicturesTest::SetUp());
		ShowOnly("LabellingSubject", {});
		ShowOnly("SolvingSubject", {"Enabled", "Skin", "Clusters"});
		WriteBoxes({1, 0, 0});
	}
	void TearDown() override { m_pSkinCache->Dispose(); }

	static void AddNode(
	    VTestScene& io_rScene, const char* i_pName, const char* i_pKind, int i_Parent, const VNumbers& i_rPlace)
	{
		io_rScene.m_Nodes.push_back({i_pName, i_pKind, i_Parent, {{"Lcl Translation", i_rPlace}}});
	}
	void WriteFile(const char* i_pName, VTestScene& io_rScene, const std::vector<VTestMesh>& i_rMeshes)
	{
		io_rScene.m_Settings = {{"UnitScaleFactor", {0.1}}};
		std::ofstream(m_Folder.filePath(QString(i_pName) + ".fbx").toStdString(), std::ios::binary)
		    << Write(c_Forms[1], io_rScene, i_rMeshes);
	}

	/// Three boxes in the proportions of the subject: one colour, half transparent, and with a texture.
	void WriteBoxes(const VNumbers& i_rColour)
	{
		VTestScene scene;
		AddNode(scene, "Ns:Root", "LimbNode", -1, {0, 0, 0});
		AddNode(scene, "Ns:Spine", "LimbNode", 0, {0, 0, 100});
		AddNode(scene, "Ns:Limb", "LimbNode", 1, {300, 0, 0});
		for (const char* const pMesh : {"plain", "glass", "texture"})
			AddNode(scene, pMesh, "Mesh", -1, {0, 0, 0});
		QImage image(2, 2, QImage::Format_RGB32);
		image.setPixel(0, 0, 0xff0000ff);
		image.setPixel(1, 0, 0xffffffff);
		image.setPixel(0, 1, 0xff00ff00);
		image.setPixel(1, 1, 0xffff0000);
		image = image.scaled(64, 64);
		ASSERT_TRUE(image.save(m_Folder.filePath("texture.png")));
		const VTestMaterial plain{"phong", {{"DiffuseColor", i_rColour}}, "", ""};
		const VTestMaterial glass{"phong",
		    {{"DiffuseColor", {0, 0.5, 1}}, {"TransparentColor", {1, 1, 1}}, {"TransparencyFactor", {0.5}}}, "", ""};
		const VTestMaterial texture{
		    "phong", {{"TransparentColor", {1, 1, 1}}, {"TransparencyFactor", {0}}}, "texture.png", "texture.png"};
		WriteFile("Boxes", scene,
		    {Box(3, 0, {0, 0, 0}, plain), Box(4, 1, {0, 0, 100}, glass), Box(5, 2, {300, 0, 100}, texture)});
	}

	void Show(const CoreOrlexTypes::VReconstructionLabelSet* i_pLabels = nullptr,
	    const CoreOrlexTypes::VColour& i_rTint = {0, 0, 0, 0})
	{
		CoreOrlexTypes::VSubjectApplicationData data = TestSubject::MakeData();
		data.m_Skin = "Boxes";
		data.m_Targets[TestSubject::EBody].m_Colour = {0, 255, 0, 255};
		data.m_SkinColourA = data.m_SkinColourB = i_rTint;
		ShowSmall(Flow2Graphics::VFlowSubjectForSolvingTypes::c_Types, i_pLabels, TestSubject::MakePose(), data);
	}
	/// Until the skin is on.
	void Wear()
	{
		m_pSkinCache->SetFolders(OrlexGraphics::c_pSubjectSkins, {m_Folder.path().toStdString()});
		m_pDispatcher->RunPending();
		Draw(c_Small);
		m_pJobs->RunAll();
		m_pDispatcher->RunPending();
	}

	const QTemporaryDir m_Folder;
	const std::shared_ptr<VHeldJobs> m_pJobs = std::make_shared<VHeldJobs>();
};
INSTANTIATE_IN_BOTH_DIALECTS(SkinPictures);

TEST_P(SkinPictures, OfMaterialsOpaqueAndAsXRay)
{
	Show();
	const QImage bare = Draw(c_Small);
	Wear();
	Compare(Draw(c_Small), "skin");
	ShowOnly("SolvingSubject", {"Enabled", "Skin", "SkinXRay", "Clusters"});
	Compare(Draw(c_Small), "skin-xray");
	ShowOnly("SolvingSubject", {"Enabled", "SkinXRay", "Clusters"});
	EXPECT_EQ(Draw(c_Small), bare);
	ShowOnly("SolvingSubject", {"Enabled", "Skin", "Clusters"});
	Show(nullptr, {0, 255, 255, 128});
	Compare(Draw(c_Small), "skin-tinted");
	// The limb's marker is missing.
	const CoreOrlexTypes::VReconstructionLabelSet labels{
	    {{TestSubject::c_Id, 1, {0, 320, 130}}, {TestSubject::c_Id, 2, {10, 360, 190}}}};
	Show(&labels);
	Options().m_SolvingSubject.m_bMissingMarkers = true;
	Compare(Draw(c_Small), "skin-health");
}

TEST_P(SkinPictures, OfTheClustersOfASubject)
{
	Show();
	Wear();
	const QImage without = Draw(c_Small);
	VTestScene scene;
	AddNode(scene, "beacon", "LimbNode", -1, {0, 0, 0});
	AddNode(scene, "mesh", "Mesh", -1, {0, 0, 0});
	WriteFile("OrlexBeacon", scene, {Box(1, 0, {0, 0, 0}, {"phong", {}, "", ""})});
	m_pSkinCache->SetFolders(OrlexGraphics::c_pSubjectSkins, {});
	Wear();
	Compare(Draw(c_Small), "skin-cluster");
	ShowOnly("SolvingSubject", {"Enabled", "Skin"});
	EXPECT_EQ(Draw(c_Small), without);
}

TEST_P(SkinPictures, OfAFileAsItStands)
{
	m_pScene->LoadFBXScene(m_Folder.filePath("Boxes.fbx"));
	const VView view{{150, 0, 60}, 460.0f, -65.0f, -30.0f};
	const QImage drawn = Draw(view);
	Compare(drawn, "fbx-scene");
	Options().m_bFBXScene = false;
	const QImage nothing = Draw(view);
	EXPECT_NE(nothing, drawn);
	Options().m_bFBXScene = true;
	m_pScene->LoadFBXScene({});
	EXPECT_EQ(Draw(view), nothing);
}

TEST_P(SkinPictures, ChangeWithTheFileAndNotBeforeItIsRead)
{
	Show();
	Wear();
	const QImage red = Draw(c_Small);
	WriteBoxes({0, 1, 0});
	m_pSkinCache->SetFolders(OrlexGraphics::c_pSubjectSkins, {"/", m_Folder.path().toStdString()});
	m_pDispatcher->RunPending();
	EXPECT_EQ(Draw(c_Small), red) << "worn until the new one is there";
	m_pJobs->RunAll();
	EXPECT_NE(Draw(c_Small), red);
}

TEST_P(SkinPictures, ArePickedAsTheSubjectUnlessTheyAreSeenThrough)
{
	Show();
	Wear();
	Options().m_SolvingSubject.m_bBones = true;
	const Flow2Graphics::VSubjectSelectionMaker<Flow2Graphics::VFlowSubjectForSolvingTypes> items;
	const QVector3D skinOverBone(10, 22, 100);
	Draw(c_Small);
	EXPECT_EQ(PickAt(skinOverBone), std::vector{items.Subject(TestSubject::c_Id)});
	Options().m_SolvingSubject.m_bSkinXRay = true;
	Draw(c_Small);
	EXPECT_EQ(PickAt(skinOverBone), std::vector{items.Segment(TestSubject::c_Id, TestSubject::ERoot)});
}

TEST_P(SkinPictures, WalkOverWhatDoesNotChange)
{
	Show();
	Wear();
	for (const bool bXRay : {false, true})
	{
		Options().m_SolvingSubject.m_bSkinXRay = bXRay;
		SCOPED_TRACE(bXRay);
		Draw(c_Small);
		ExpectThatAFrameIsAWalk();
	}
}

TEST_P(SkinPictures, AreLeftOutWhereTheDriverHasNoRoom)
{
	EXPECT_TRUE(OrlexGraphics::HasRoomForSkins(1024));
	std::string log;
	const auto pSink = NVX::GlobalLog::AddSink(
	    [&log](const NVX::VLogCategory&, int, const std::string& i_rMessage) { log += i_rMessage + "\n"; });
	m_pShaders->InitialiseGL();
	OrlexGraphics::VSkinRenderer renderer(*m_pShaders, 256);
	EXPECT_EQ(log,
	    "Skins are not shown: they take 1016 uniform vectors of a vertex shader, and the graphics driver has "
	    "256\n");
	CoreGraphics::VRenderContext context;
	context.Initialise();
	for (int i = 0; i < 2; ++i)
		EXPECT_FALSE(renderer.BeginRender(context, {}, OrlexGraphics::EPassOpaque));
	OrlexGraphics::VSkinRenderer here(*m_pShaders);
	EXPECT_TRUE(here.BeginRender(context, {}, OrlexGraphics::EPassOpaque));
	EXPECT_FALSE(here.BeginRender(context, {}, OrlexGraphics::EPassTransparent));
	EXPECT_EQ(log.find("Skins", 10), std::string::npos);
}

} // namespace
