#include "MotionIO/GltfMotion.h"

#include "DebugServices/GlobalLog.h"
#include "FBXIO/FBXReader.h"
#include "MotionIO/GlbFile.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstring>
#include <map>
#include <set>

using namespace Rotation;

namespace
{

using namespace MotionIO;
using TakeIO::VJointPose;
using VJson = nlohmann::ordered_json;

/// Bones of a skin are counted in a byte.
constexpr std::size_t c_MostBones = 256;

/// A picture with the bytes of its file.
struct VWholePicture : FBXIO::VPicture
{
	std::string m_Bytes;
};

class VWholePictureFile : public FBXIO::IPictureFile
{
public:
	VWholePictureFile(std::string_view i_Bytes, const std::string& i_rFormat)
	    : m_Bytes(i_Bytes), m_pHead(FBXIO::OpenPictureHead(i_Bytes, i_rFormat))
	{
	}
	bool ReadHead(int& o_rWidth, int& o_rHeight) override { return m_pHead->ReadHead(o_rWidth, o_rHeight); }
	int PointBytes() override { return m_pHead->PointBytes(); }
	std::shared_ptr<FBXIO::VPicture> Read() override
	{
		if (!m_pHead->Read())
			return {};
		const auto pPicture = std::make_shared<VWholePicture>();
		pPicture->m_Bytes = m_Bytes;
		return pPicture;
	}

private:
	const std::string_view m_Bytes;
	const std::unique_ptr<IPictureFile> m_pHead;
};

std::unique_ptr<FBXIO::IPictureFile> OpenWholePicture(std::string_view i_Bytes, const std::string& i_rFormat)
{
	return std::make_unique<VWholePictureFile>(i_Bytes, i_rFormat);
}

/// x, y, z, w; of the two that give the rotation the one next to another.
std::array<double, 4> Quaternion(const VMatrix3& i_rRotation, const std::array<double, 4>& i_rNear)
{
	const auto [x, y, z] = AngleAxisFromRotationMatrix(i_rRotation);
	const double angle = std::sqrt(x * x + y * y + z * z);
	const double factor = angle > 0.0 ? std::sin(0.5 * angle) / angle : 0.0;
	std::array<double, 4> quaternion{factor * x, factor * y, factor * z, std::cos(0.5 * angle)};
	double dot = 0.0;
	for (std::size_t i = 0; i < 4; ++i)
		dot += quaternion[i] * i_rNear[i];
	for (double& rNumber : quaternion)
		rNumber *= dot < 0.0 ? -1.0 : 1.0;
	return quaternion;
}

/// What of a vertex every mesh has.
struct VVertices
{
	std::vector<float> m_Positions, m_Normals, m_TexCoords;

	void Add(const FBXIO::VBasicVertex& i_rVertex)
	{
		for (const float coordinate : i_rVertex.m_Position)
			m_Positions.push_back(coordinate / 1000.0f);
		// Without a length there is no direction: any will do.
		const auto [x, y, z] = i_rVertex.m_Normal;
		const float length = std::hypot(x, y, z);
		const bool bNone = !(length > 1e-20f && std::isfinite(length));
		m_Normals.insert(
		    m_Normals.end(), {bNone ? 0.0f : x / length, bNone ? 0.0f : y / length, bNone ? 1.0f : z / length});
		// From the upper edge of the picture down.
		m_TexCoords.insert(m_TexCoords.end(), {i_rVertex.m_TexCoord[0], 1.0f - i_rVertex.m_TexCoord[1]});
	}
};

class VGltfMotion
{
public:
	VGltfMotion(const VBones& i_rBones, const TakeIO::VTake& i_rMotion, const VMotionSettings& i_rSettings)
	    : m_rBones(i_rBones), m_rTake(i_rMotion), m_rSettings(i_rSettings),
	      m_Motion(i_rBones, i_rMotion, i_rSettings.m_Scale),
	      m_Axes(Product(Transposed(ToZUp(TakeIO::EUp::Y)), ToZUp(i_rBones.m_Up)))
	{
	}

	EPrinted Print(const VCharacterFile& i_rCharacter, std::string& o_rBytes, std::string& o_rError)
	{
		if (m_Motion.Driven() == 0)
		{
			o_rError = "No bone has the name of a joint of the motion";
			return EPrinted::Refused;
		}
		m_Motion.Compute({});
		m_Rest = WorldPlaces();
		AddBones();
		AddMeshes(i_rCharacter);
		if (!AddAnimation())
			return EPrinted::Cancelled;
		m_File.m_Json["scene"] = 0;
		m_File.m_Json["scenes"] = VJson::array({{{"nodes", m_Roots}}});
		m_File.m_Json["nodes"] = std::move(m_Nodes);
		if (m_File.Finish(o_rBytes))
			return EPrinted::Done;
		o_rError = "The file were larger than 4 GB, which is the most that a glTF binary file holds";
		return EPrinted::Refused;
	}

private:
	/// Metres, Y up, without scaling.
	std::vector<VJointPose> WorldPlaces() const
	{
		std::vector<VJointPose> places(m_rBones.m_Joints.size());
		for (std::size_t i = 0; i < places.size(); ++i)
		{
			const FbxFormat::VGlobalTransform& rGlobal = m_Motion.Global(i);
			places[i] = {Product(m_Axes, rGlobal.m_Rotation), Product(m_Axes, rGlobal.m_Map.t)};
			for (double& rCoordinate : places[i].t)
				rCoordinate *= 0.001 * m_rBones.m_Unit;
		}
		return places;
	}

	VJointPose Local(const std::vector<VJointPose>& i_rPlaces, std::size_t i_Bone) const
	{
		const std::int32_t parent = m_rBones.m_Joints[i_Bone].m_Parent;
		return parent < 0 ? i_rPlaces[i_Bone] : Relative(i_rPlaces[std::size_t(parent)], i_rPlaces[i_Bone]);
	}

	/// Nodes have the numbers of the bones.
	void AddBones()
	{
		for (std::size_t i = 0; i < m_rBones.m_Joints.size(); ++i)
		{
			const VJointPose pose = Local(m_Rest, i);
			m_Nodes.push_back({{"name", m_rBones.m_Names[i]}, {"translation", InFloats(pose.t)},
			    {"rotation", InFloats(Quaternion(pose.R, {}))}});
			Hang(i, m_rBones.m_Joints[i].m_Parent);
		}
	}

	void Hang(std::size_t i_Node, std::int32_t i_Parent)
	{
		if (i_Parent < 0)
			m_Roots.push_back(i_Node);
		else
			m_Nodes[std::size_t(i_Parent)]["children"].push_back(i_Node);
	}

	template <std::size_t Size>
	static std::array<float, Size> InFloats(const std::array<double, Size>& i_rNumbers)
	{
		std::array<float, Size> floats;
		std::ranges::transform(i_rNumbers, floats.begin(), [](double i_Number) { return float(i_Number); });
		return floats;
	}

	/// The last bone of a name is the one that meshes are bound to; -1 without one.
	std::int32_t BoneOf(const std::string& i_rName) const
	{
		for (std::size_t i = m_rBones.m_Names.size(); i-- > 0;)
			if (m_rBones.m_Joints[i].m_bBone && m_rBones.m_Names[i] == i_rName)
				return std::int32_t(i);
		return -1;
	}

	void AddMeshes(const VCharacterFile& i_rCharacter)
	{
		FBXIO::FBXReader reader;
		reader.SetMeshRules(FBXIO::c_FaithfulMeshes);
		reader.SetPictures(&OpenWholePicture);
		if (!reader.LoadMemory(i_rCharacter.m_Bytes, i_rCharacter.m_Path))
			return;
		std::vector<FBXIO::VPlacedMesh> placed;
		reader.ReadPlacedMeshes(placed);
		for (const FBXIO::VPlacedMesh& rPlaced : placed)
			if (!rPlaced.m_bSkinned)
				AddPlaced(rPlaced);
		placed.clear();
		FBXIO::VSkin skin;
		reader.ReadSkin(skin);
		if (!skin.m_Meshes.empty())
			AddSkin(skin);
		for (const std::string& rPath : m_LeftOut)
			NVX_LOG("MotionIO", NVX::ELogWarning, "The picture %1% is left out: it is neither PNG nor JPEG", rPath);
	}

	/// A mesh that stands still on its bone; in the bone's frame.
	void AddPlaced(const FBXIO::VPlacedMesh& i_rPlaced)
	{
		const std::int32_t bone = BoneOf(i_rPlaced.m_Bone);
		const VJointPose frame = bone < 0 ? VJointPose() : m_Rest[std::size_t(bone)];
		VMatrix3 linear{};
		VVector3 place{};
		for (int row = 0; row < 3; ++row)
		{
			for (int column = 0; column < 3; ++column)
				linear[3 * std::size_t(row) + std::size_t(column)] = i_rPlaced.m_Transform(row, column);
			place[std::size_t(row)] = 0.001 * i_rPlaced.m_Transform(row, 3);
		}
		const VMatrix3 turn = Product(Transposed(frame.R), m_Axes);
		linear = Product(turn, linear);
		place = Product(turn, place);
		const VVector3 origin = Product(Transposed(frame.R), frame.t);
		const VMatrix3 normals = Transposed(FbxFormat::Inverse({linear, {}}).L);
		VVertices vertices;
		for (FBXIO::VBasicVertex vertex : i_rPlaced.m_Mesh.m_Vertices)
		{
			const auto map = [](const VMatrix3& i_rMatrix, std::array<float, 3>& io_rVector)
			{
				const VVector3 mapped = Product(i_rMatrix, VVector3{io_rVector[0], io_rVector[1], io_rVector[2]});
				io_rVector = InFloats(mapped);
			};
			map(linear, vertex.m_Position);
			map(normals, vertex.m_Normal);
			for (std::size_t axis = 0; axis < 3; ++axis)
				vertex.m_Position[axis] += float(1000.0 * (place[axis] - origin[axis]));
			vertices.Add(vertex);
		}
		if (const std::optional<std::size_t> mesh = AddMesh(vertices, i_rPlaced.m_Mesh.m_Parts, {}))
		{
			m_Nodes.push_back({{"name", i_rPlaced.m_Name}, {"mesh", *mesh}});
			Hang(m_Nodes.size() - 1, bone);
		}
	}

	void AddSkin(const FBXIO::VSkin& i_rSkin)
	{
		const FBXIO::VSkinSkeleton& rSkeleton = *i_rSkin.m_pSkeleton;
		std::vector<std::int32_t> joints;
		for (const FBXIO::VSkinBone& rBone : rSkeleton)
			joints.push_back(BoneOf(rBone.m_Name));
		if (rSkeleton.empty() || rSkeleton.size() > c_MostBones || std::ranges::find(joints, -1) != joints.end())
		{
			// The form has no skin without a joint.
			NVX_LOG("MotionIO", NVX::ELogWarning, "The character's skin is left out: %1%",
			    rSkeleton.empty()                    ? "no bone moves it"
			        : rSkeleton.size() > c_MostBones ? "more than 256 bones move it"
			                                         : "some of its bones are unknown");
			return;
		}
		std::vector<float> inverseBinds;
		for (std::size_t i = 0; i < rSkeleton.size(); ++i)
			AppendInverseBind(rSkeleton[i].m_InverseBind, std::size_t(joints[i]), inverseBinds);
		m_File.m_Json["skins"] =
		    VJson::array({{{"inverseBindMatrices", m_File.AddFloats(inverseBinds, "MAT4")}, {"joints", joints}}});
		for (const FBXIO::VSkinMesh& rMesh : i_rSkin.m_Meshes)
		{
			VVertices vertices;
			std::vector<std::uint8_t> bones;
			std::vector<float> weights;
			for (const FBXIO::VSkinVertex& rVertex : rMesh.m_Vertices)
			{
				vertices.Add(rVertex);
				AppendWeights(rVertex, bones, weights);
			}
			if (rMesh.m_Vertices.empty())
				continue;
			const VJson attributes{{"JOINTS_0", m_File.AddBytes(bones, "VEC4", VGlbFile::EVertices)},
			    {"WEIGHTS_0", m_File.AddFloats(weights, "VEC4", VGlbFile::EVertices)}};
			if (const std::optional<std::size_t> mesh = AddMesh(vertices, rMesh.m_Parts, attributes))
			{
				m_Nodes.push_back({{"name", "skin"}, {"mesh", *mesh}, {"skin", 0}});
				m_Roots.push_back(m_Nodes.size() - 1);
			}
		}
	}

	/// Column by column. What scales the bone in the file stands here, as its node has none.
	void AppendInverseBind(const Rotation::VMatrix4& i_rBind, std::size_t i_Bone, std::vector<float>& io_rNumbers) const
	{
		const FbxFormat::VGlobalTransform& rGlobal = m_Motion.Global(i_Bone);
		const VMatrix3 scale = Product(Transposed(rGlobal.m_Rotation), rGlobal.m_Map.L);
		for (int column = 0; column < 4; ++column)
		{
			const VVector3 mapped =
			    Product(scale, VVector3{i_rBind(0, column), i_rBind(1, column), i_rBind(2, column)});
			for (const double number : mapped)
				io_rNumbers.push_back(float(column < 3 ? number : 0.001 * number));
			io_rNumbers.push_back(column < 3 ? 0.0f : 1.0f);
		}
	}

	/// Parts whose sum is 1, whatever was lost by rounding; each bone once; a vertex without any hangs on the first
	/// bone.
	static void AppendWeights(
	    const FBXIO::VSkinVertex& i_rVertex, std::vector<std::uint8_t>& io_rBones, std::vector<float>& io_rWeights)
	{
		std::array<std::uint8_t, 4> bones{};
		std::array<int, 4> weights{};
		std::size_t count = 0;
		int left = 255;
		for (std::size_t i = 0; i < 4; ++i)
		{
			if (i_rVertex.m_BoneWeights[i] == 0)
				continue;
			const auto end = bones.begin() + std::ptrdiff_t(count);
			const auto place = std::size_t(std::find(bones.begin(), end, i_rVertex.m_BoneIndices[i]) - bones.begin());
			count += place == count ? 1 : 0;
			bones[place] = i_rVertex.m_BoneIndices[i];
			weights[place] += i_rVertex.m_BoneWeights[i];
			left -= i_rVertex.m_BoneWeights[i];
		}
		weights[0] += left;
		io_rBones.insert(io_rBones.end(), bones.begin(), bones.end());
		for (const int weight : weights)
			io_rWeights.push_back(float(weight) / 255.0f);
	}

	/// A primitive for each part. Nothing if there are none.
	std::optional<std::size_t> AddMesh(
	    const VVertices& i_rVertices, const std::vector<FBXIO::VMeshPart>& i_rParts, VJson i_Attributes)
	{
		if (i_rVertices.m_Positions.empty()
		    || std::ranges::all_of(i_rParts, [](const FBXIO::VMeshPart& i_rPart) { return i_rPart.m_Indices.empty(); }))
			return std::nullopt;
		i_Attributes["POSITION"] = m_File.AddFloats(i_rVertices.m_Positions, "VEC3", VGlbFile::EVertices, true);
		i_Attributes["NORMAL"] = m_File.AddFloats(i_rVertices.m_Normals, "VEC3", VGlbFile::EVertices);
		i_Attributes["TEXCOORD_0"] = m_File.AddFloats(i_rVertices.m_TexCoords, "VEC2", VGlbFile::EVertices);
		VJson primitives = VJson::array();
		for (const FBXIO::VMeshPart& rPart : i_rParts)
			if (!rPart.m_Indices.empty())
				primitives.push_back(
				    {{"attributes", i_Attributes}, {"indices", m_File.AddIndices(rPart.m_Indices, rPart.m_IndexSize)},
				        {"material", AddMaterial(rPart)}});
		VJson& rMeshes = m_File.m_Json["meshes"];
		rMeshes.push_back({{"primitives", std::move(primitives)}});
		return rMeshes.size() - 1;
	}

	std::size_t AddMaterial(const FBXIO::VMeshPart& i_rPart)
	{
		const std::optional<std::size_t> texture = AddTexture(i_rPart);
		const auto colour = [](const FBXIO::VColourAndFactor& i_rColour, std::size_t i_Channel)
		{ return std::clamp(i_rColour[i_Channel] * i_rColour[3], 0.0f, 1.0f); };
		// A material that nothing is to be seen of is one whose exporter meant the opposite.
		const float clear =
		    (colour(i_rPart.m_Transparent, 0) + colour(i_rPart.m_Transparent, 1) + colour(i_rPart.m_Transparent, 2))
		    / 3.0f;
		const float alpha = clear < 0.99f ? 1.0f - clear : 1.0f;
		VJson base = VJson::array(), emissive = VJson::array();
		for (std::size_t i = 0; i < 3; ++i)
		{
			base.push_back(texture ? 1.0f : colour(i_rPart.m_Diffuse, i));
			emissive.push_back(colour(i_rPart.m_Emissive, i));
		}
		base.push_back(alpha);
		// The width of a highlight of Phong's exponent.
		const float shininess = std::max(i_rPart.m_Shininess, 0.0f);
		VJson surface{{"baseColorFactor", std::move(base)}, {"metallicFactor", 0.0f},
		    {"roughnessFactor", std::sqrt(2.0f / (2.0f + shininess))}};
		if (texture)
			surface["baseColorTexture"] = {{"index", *texture}};
		VJson material{{"pbrMetallicRoughness", std::move(surface)}, {"emissiveFactor", std::move(emissive)},
		    {"doubleSided", true}};
		if (alpha < 1.0f)
			material["alphaMode"] = "BLEND";
		VJson& rMaterials = m_File.m_Json["materials"];
		const auto [found, bNew] = m_Materials.try_emplace(material.dump(), rMaterials.size());
		if (bNew)
			rMaterials.push_back(std::move(material));
		return found->second;
	}

	std::optional<std::size_t> AddTexture(const FBXIO::VMeshPart& i_rPart)
	{
		const auto* const pPicture = dynamic_cast<const VWholePicture*>(i_rPart.m_pTexture.get());
		if (!pPicture)
			return std::nullopt;
		const bool bPng = pPicture->m_Bytes.starts_with("\x89PNG");
		if (!bPng && !pPicture->m_Bytes.starts_with("\xff\xd8\xff"))
		{
			m_LeftOut.insert(i_rPart.m_TexturePath);
			return std::nullopt;
		}
		// Each texture has the image of its number.
		const auto [found, bNew] = m_Textures.try_emplace(pPicture, m_Textures.size());
		if (bNew)
		{
			m_File.m_Json["textures"].push_back({{"source", found->second}});
			const std::size_t view = m_File.AddView(pPicture->m_Bytes);
			m_File.m_Json["images"].push_back({{"bufferView", view}, {"mimeType", bPng ? "image/png" : "image/jpeg"}});
		}
		return found->second;
	}

	/// False if it was cancelled.
	bool AddAnimation()
	{
		struct VSampled
		{
			std::vector<float> m_Places, m_Turns;
			std::array<double, 4> m_Last{};
			bool m_bGoes = false;
		};
		std::vector<float> times;
		std::vector<VSampled> tracks(m_rBones.m_Joints.size());
		for (std::size_t frame = 0; frame < m_rTake.m_Frames; ++frame)
		{
			if (m_rSettings.m_Progress && !m_rSettings.m_Progress(double(frame) / double(m_rTake.m_Frames)))
				return false;
			times.push_back(float(double(frame) / m_rTake.m_Rate));
			m_Motion.Compute(frame);
			const std::vector<VJointPose> places = WorldPlaces();
			for (std::size_t i = 0; i < tracks.size(); ++i)
			{
				if (!m_Motion.IsDriven(i))
					continue;
				VSampled& rTrack = tracks[i];
				const VJointPose pose = Local(places, i), rest = Local(m_Rest, i);
				rTrack.m_Last = Quaternion(pose.R, rTrack.m_Last);
				for (const double number : rTrack.m_Last)
					rTrack.m_Turns.push_back(float(number));
				for (std::size_t axis = 0; axis < 3; ++axis)
				{
					rTrack.m_Places.push_back(float(pose.t[axis]));
					rTrack.m_bGoes = rTrack.m_bGoes || std::abs(pose.t[axis] - rest.t[axis]) > 0.001 * c_SamePlace;
				}
			}
		}
		VJson samplers = VJson::array(), channels = VJson::array();
		const std::size_t input = m_File.AddFloats(times, "SCALAR", VGlbFile::ENone, true);
		const auto add = [&](std::size_t i_Bone, const char* i_pPath, std::size_t i_Output)
		{
			channels.push_back({{"sampler", samplers.size()}, {"target", {{"node", i_Bone}, {"path", i_pPath}}}});
			samplers.push_back({{"input", input}, {"output", i_Output}});
		};
		for (std::size_t i = 0; i < tracks.size(); ++i)
		{
			if (!m_Motion.IsDriven(i))
				continue;
			add(i, "rotation", m_File.AddFloats(tracks[i].m_Turns, "VEC4"));
			if (tracks[i].m_bGoes)
				add(i, "translation", m_File.AddFloats(tracks[i].m_Places, "VEC3"));
		}
		m_File.m_Json["animations"] = VJson::array(
		    {{{"name", m_rSettings.m_Name}, {"samplers", std::move(samplers)}, {"channels", std::move(channels)}}});
		return true;
	}

	const VBones& m_rBones;
	const TakeIO::VTake& m_rTake;
	const VMotionSettings& m_rSettings;
	VBoneMotion m_Motion;
	/// From the axes of the file.
	const VMatrix3 m_Axes;
	std::vector<VJointPose> m_Rest;
	VGlbFile m_File;
	VJson m_Nodes = VJson::array();
	std::vector<std::size_t> m_Roots;
	/// By what they are.
	std::map<std::string, std::size_t> m_Materials;
	std::map<const VWholePicture*, std::size_t> m_Textures;
	std::set<std::string> m_LeftOut;
};

} // namespace

MotionIO::EPrinted MotionIO::PrintGltfMotion(const VBones& i_rBones, const VCharacterFile& i_rCharacter,
    const TakeIO::VTake& i_rMotion, const VMotionSettings& i_rSettings, std::string& o_rBytes, std::string& o_rError)
{
	return VGltfMotion(i_rBones, i_rMotion, i_rSettings).Print(i_rCharacter, o_rBytes, o_rError);
}
