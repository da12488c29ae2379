#include "Character.h"

#include "../../tests/FBXIO/MeshFile.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <random>

using namespace FbxTest;

namespace
{

using VPoint = std::array<double, 3>;
/// Bones one below the other.
using VChain = std::vector<int>;

struct VBones
{
	VTestScene m_Scene{{}, {{"UpAxis", {1}}, {"UnitScaleFactor", {1}}}, {{"Lcl Scaling", {1, 1, 1}}}, {}};
	std::vector<VPoint> m_Places;

	/// That many bones below a bone, each this far from the one above it.
	VChain Add(const std::string& i_rName, int i_Parent, int i_Count, const VPoint& i_rFirst, const VPoint& i_rStep)
	{
		VChain chain;
		for (int i = 0; i < i_Count; ++i)
		{
			const auto& [x, y, z] = i == 0 ? i_rFirst : i_rStep;
			const VPoint above = i_Parent < 0 ? VPoint{} : m_Places[i_Parent];
			m_Scene.m_Nodes.push_back(
			    {i_rName + std::to_string(i), "LimbNode", i_Parent, {{"Lcl Translation", {x, y, z}}}});
			m_Places.push_back({above[0] + x, above[1] + y, above[2] + z});
			chain.push_back(i_Parent = int(m_Places.size()) - 1);
		}
		return chain;
	}
};

VTestMaterial Material(const std::string& i_rTexture)
{
	return {"phong",
	    {{"DiffuseColor", {0.8, 0.7, 0.6}}, {"SpecularColor", {0.2, 0.2, 0.2}}, {"ShininessExponent", {20}}},
	    "C:\\art\\hero\\textures\\" + i_rTexture, "textures\\" + i_rTexture};
}

class VMeshBuilder
{
public:
	explicit VMeshBuilder(const VBones& i_rBones) : m_rBones(i_rBones), m_Clusters(i_rBones.m_Places.size()) {}

	/// A skin around a chain. Numbers have the digits of floats.
	void AddTube(const VChain& i_rChain, int i_Rings, int i_Around, double i_Radius)
	{
		const int first = int(m_Mesh.m_Points.size()) / 3;
		const int firstUV = int(m_Mesh.m_UV.m_Direct.size()) / 2;
		std::vector<VPoint> normals;
		for (int ring = 0; ring < i_Rings; ++ring)
		{
			const double along = double(ring) / (i_Rings - 1) * double(i_rChain.size() - 1);
			for (int i = 0; i <= i_Around; ++i)
			{
				AddNumbers(m_Mesh.m_UV.m_Direct, {double(i) / i_Around, double(ring) / i_Rings});
				if (i < i_Around)
					AddPoint(i_rChain, along, i * 2.0 * 3.141592653589793 / i_Around, i_Radius, normals);
			}
		}
		for (int ring = 0; ring + 1 < i_Rings; ++ring)
			for (int i = 0; i < i_Around; ++i)
			{
				const int next = (i + 1) % i_Around;
				const int corners[]{ring * i_Around + i, ring * i_Around + next, (ring + 1) * i_Around + next,
				    (ring + 1) * i_Around + i};
				const int edge = int(m_Mesh.m_Polygons.size());
				for (int k = 0; k < 4; ++k)
				{
					m_Mesh.m_Polygons.push_back(k < 3 ? first + corners[k] : -1 - (first + corners[k]));
					m_Mesh.m_UV.m_Index.push_back(
					    firstUV + (ring + k / 2) * (i_Around + 1) + i + (k == 1 || k == 2 ? 1 : 0));
					AddNumbers(m_Mesh.m_Normals.m_Direct, normals[corners[k]]);
				}
				m_Edges.insert(m_Edges.end(), {edge, edge + 3});
				m_Smoothing.insert(m_Smoothing.end(), {1, 1});
			}
	}

	VTestMesh Finish(int i_Node, const std::string& i_rTexture)
	{
		m_Mesh.m_Node = i_Node;
		m_Mesh.m_Materials = {Material(i_rTexture)};
		for (int bone = 0; bone < int(m_Clusters.size()); ++bone)
		{
			VTestCluster& rCluster = m_Clusters[bone];
			const auto& [x, y, z] = m_rBones.m_Places[bone];
			rCluster.m_Node = bone;
			rCluster.m_Transform = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, -x, -y, -z, 1};
			rCluster.m_Link = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, x, y, z, 1};
			if (!rCluster.m_Points.empty())
				m_Mesh.m_Clusters.push_back(std::move(rCluster));
		}
		return std::move(m_Mesh);
	}

	VIntegers m_Edges;
	VIntegers m_Smoothing;

private:
	template <typename TNumbers>
	static void AddNumbers(VNumbers& io_rNumbers, const TNumbers& i_rNumbers)
	{
		for (const double number : i_rNumbers)
			io_rNumbers.push_back(float(number));
	}
	static void AddNumbers(VNumbers& io_rNumbers, std::initializer_list<double> i_Numbers)
	{
		AddNumbers<std::initializer_list<double>>(io_rNumbers, i_Numbers);
	}

	void AddPoint(
	    const VChain& i_rChain, double i_Along, double i_Angle, double i_Radius, std::vector<VPoint>& o_rNormals)
	{
		const int point = int(m_Mesh.m_Points.size()) / 3;
		const auto below = std::min(std::size_t(i_Along), i_rChain.size() - 2);
		const VPoint& a = m_rBones.m_Places[i_rChain[below]];
		const VPoint& b = m_rBones.m_Places[i_rChain[below + 1]];
		const double part = i_Along - double(below);
		// Muscles, and what a sculptor leaves.
		const double noise = double(m_Random()) / double(m_Random.max());
		const double radius =
		    i_Radius * (1.0 + 0.15 * std::sin(4.0 * i_Along) + 0.1 * std::cos(3.0 * i_Angle) + 0.004 * noise);
		const double c = std::cos(i_Angle);
		const double s = std::sin(i_Angle);
		// Across the chain: it runs mostly up and down, or sideways.
		const bool bUpright = std::abs(b[1] - a[1]) > std::abs(b[0] - a[0]);
		const VPoint across = bUpright ? VPoint{c, 0.0, s} : VPoint{0.0, c, s};
		VPoint place;
		for (int i = 0; i < 3; ++i)
			place[i] = a[i] + part * (b[i] - a[i]) + radius * across[i];
		AddNumbers(m_Mesh.m_Points, place);
		o_rNormals.push_back({across[0] + 0.02 * noise, across[1] - 0.01 * noise, across[2] + 0.03 * noise});
		double weights[4];
		double sum = 0.0;
		const int nearest = std::clamp(int(std::lround(i_Along)) - 1, 0, std::max(int(i_rChain.size()) - 4, 0));
		const int count = std::min<int>(4, int(i_rChain.size()));
		for (int k = 0; k < count; ++k)
			sum += weights[k] =
			    std::exp(-0.7 * std::pow(i_Along - (nearest + k), 2)) * (1.0 + 0.1 * std::cos(i_Angle + k));
		for (int k = 0; k < count; ++k)
		{
			VTestCluster& rCluster = m_Clusters[i_rChain[nearest + k]];
			rCluster.m_Points.push_back(point);
			rCluster.m_Weights.push_back(float(weights[k] / sum));
		}
	}

	const VBones& m_rBones;
	std::mt19937 m_Random{7};
	VTestMesh m_Mesh{0, {}, {}, {"ByPolygonVertex", "Direct", {}, {}}, {"ByPolygonVertex", "IndexToDirect", {}, {}},
	    {"AllSame", "IndexToDirect", {}, {0}}, {}, {}};
	std::vector<VTestCluster> m_Clusters;
};

/// What exporters write beside what we read.
void AddEdges(std::vector<VTestRecord>& io_rRecords, const std::vector<VMeshBuilder>& i_rMeshes)
{
	std::size_t mesh = 0;
	for (VTestRecord& rSection : io_rRecords)
		for (VTestRecord& rObject : rSection.m_Children)
			if (rObject.m_Name == "Geometry")
			{
				rObject.m_Children.push_back({"Edges", {i_rMeshes[mesh].m_Edges}, {}});
				rObject.m_Children.push_back({"LayerElementSmoothing", {std::int32_t(0)},
				    {{"MappingInformationType", {std::string("ByEdge")}, {}},
				        {"ReferenceInformationType", {std::string("Direct")}, {}},
				        {"Smoothing", {i_rMeshes[mesh].m_Smoothing}, {}}}});
				++mesh;
			}
}

} // namespace

std::string GeneratedCharacter()
{
	VBones bones;
	const VChain spine = bones.Add("Hero:Spine", -1, 7, {0, 95, 0}, {0, 11, 0});
	const VChain head = bones.Add("Hero:Head", spine.back(), 3, {0, 9, 1}, {0, 10, 0});
	std::vector<VChain> limbs;
	std::vector<VChain> fingers;
	for (const double side : {1.0, -1.0})
	{
		const std::string name = side > 0 ? "Hero:Left" : "Hero:Right";
		limbs.push_back(bones.Add(name + "Leg", spine.front(), 5, {side * 10, -4, 0}, {0, -21, 0}));
		limbs.push_back(bones.Add(name + "Arm", spine[5], 5, {side * 16, 8, 0}, {side * 17, 0, 0}));
		for (int i = 0; i < 5; ++i)
			fingers.push_back(bones.Add(name + "Finger" + std::to_string(i) + '_', limbs.back().back(), 4,
			    {side * 8, 0, 2.0 * i - 4}, {side * 3, 0, 0}));
	}
	std::vector<VMeshBuilder> meshes(3, VMeshBuilder(bones));
	meshes[0].AddTube(spine, 120, 96, 18);
	meshes[0].AddTube(head, 80, 80, 9);
	meshes[1].AddTube(spine, 90, 96, 20);
	for (const VChain& rLimb : limbs)
	{
		meshes[0].AddTube(rLimb, 130, 48, 6);
		meshes[1].AddTube(rLimb, 90, 48, 7);
	}
	for (const VChain& rFinger : fingers)
		meshes[0].AddTube(rFinger, 24, 16, 1);
	for (int lock = 0; lock < 24; ++lock)
		meshes[2].AddTube(head, 40, 12, 8.0 + 0.2 * lock);
	std::vector<VTestMesh> finished;
	for (VMeshBuilder& rMesh : meshes)
	{
		const std::string name = "mesh" + std::to_string(finished.size());
		bones.m_Scene.m_Nodes.push_back({"Hero:" + name, "Mesh", -1, {{"Lcl Scaling", {1, 1, 1}}}});
		finished.push_back(rMesh.Finish(int(bones.m_Scene.m_Nodes.size()) - 1, name + ".png"));
	}
	std::vector<VTestRecord> records = Records(c_Forms[1], bones.m_Scene, finished);
	AddEdges(records, meshes);
	return Write(c_Forms[1], records);
}
