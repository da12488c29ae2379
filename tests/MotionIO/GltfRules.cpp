#include "GltfRules.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <set>
#include <stdexcept>

namespace
{

using VGltf = nlohmann::json;

void Require(bool i_bHolds, const std::string& i_rRule)
{
	if (!i_bHolds)
		throw std::runtime_error(i_rRule);
}

template <typename TNumber>
TNumber Load(const std::string& i_rBytes, std::size_t i_Offset)
{
	Require(i_Offset + sizeof(TNumber) <= i_rBytes.size(), "what is read lies in the file");
	TNumber number;
	std::memcpy(&number, i_rBytes.data() + i_Offset, sizeof(TNumber));
	return number;
}

std::size_t ComponentSize(int i_Type)
{
	Require(i_Type >= 5120 && i_Type <= 5126 && i_Type != 5124, "a type of component");
	return i_Type == 5126 || i_Type == 5125 ? 4 : i_Type >= 5122 ? 2 : 1;
}

std::size_t Components(const std::string& i_rType)
{
	constexpr std::pair<const char*, std::size_t> c_Types[]{
	    {"SCALAR", 1}, {"VEC2", 2}, {"VEC3", 3}, {"VEC4", 4}, {"MAT4", 16}};
	for (const auto& [pType, count] : c_Types)
		if (i_rType == pType)
			return count;
	throw std::runtime_error("a type of accessor");
}

class VChecker
{
public:
	explicit VChecker(const std::string& i_rBytes)
	{
		Require(i_rBytes.substr(0, 4) == "glTF" && Load<std::uint32_t>(i_rBytes, 4) == 2, "head");
		Require(Load<std::uint32_t>(i_rBytes, 8) == i_rBytes.size(), "length of the file");
		const auto text = Load<std::uint32_t>(i_rBytes, 12);
		Require(text % 4 == 0 && i_rBytes.substr(16, 4) == "JSON", "chunk of text");
		m_Gltf = VGltf::parse(i_rBytes.substr(20, text));
		const auto binary = Load<std::uint32_t>(i_rBytes, 20 + text);
		Require(binary % 4 == 0 && i_rBytes.substr(24 + text, 4) == std::string("BIN\0", 4), "chunk of numbers");
		Require(28 + text + binary == i_rBytes.size(), "two chunks");
		m_Binary = i_rBytes.substr(28 + text);
		Require(m_Gltf.at("asset").at("version") == "2.0" && m_Gltf.at("buffers").size() == 1, "asset, one buffer");
		const std::size_t length = m_Gltf["buffers"][0].at("byteLength");
		Require(length <= binary && binary < length + 4, "length of the buffer");
		m_Binary.resize(length);
	}

	void Check()
	{
		for (const VGltf& rView : List("bufferViews"))
			Require(rView.value("byteOffset", 0u) + rView.at("byteLength").get<std::size_t>() <= m_Binary.size()
			        && rView.at("byteLength") > 0,
			    "a view lies in its buffer");
		for (std::size_t i = 0; i < List("accessors").size(); ++i)
			Values(i);
		CheckNodes();
		for (const VGltf& rMesh : List("meshes"))
			for (const VGltf& rPrimitive : rMesh.at("primitives"))
				CheckPrimitive(rPrimitive);
		for (const VGltf& rSkin : List("skins"))
			CheckSkin(rSkin);
		for (const VGltf& rAnimation : List("animations"))
			CheckAnimation(rAnimation);
		for (const VGltf& rTexture : List("textures"))
			Require(rTexture.at("source") < List("images").size(), "the picture of a texture");
		for (const VGltf& rImage : List("images"))
		{
			const VGltf& rView = List("bufferViews").at(rImage.at("bufferView").get<std::size_t>());
			const bool bPng = m_Binary.substr(rView.value("byteOffset", 0u), 4) == "\x89PNG";
			Require(rImage.at("mimeType") == (bPng ? "image/png" : "image/jpeg"), "the kind of a picture");
		}
	}

private:
	const VGltf& List(const char* i_pName) const
	{
		static const VGltf s_None = VGltf::array();
		return m_Gltf.contains(i_pName) ? m_Gltf.at(i_pName) : s_None;
	}

	/// All numbers of an accessor, with the rules for it.
	std::vector<double> Values(std::size_t i_Accessor) const
	{
		const VGltf& rAccessor = List("accessors").at(i_Accessor);
		const VGltf& rView = List("bufferViews").at(rAccessor.at("bufferView").get<std::size_t>());
		const int type = rAccessor.at("componentType");
		const std::size_t size = ComponentSize(type), components = Components(rAccessor.at("type"));
		const std::size_t count = rAccessor.at("count"), offset = rAccessor.value("byteOffset", 0u);
		const std::size_t begin = rView.value("byteOffset", 0u) + offset;
		const std::size_t stride = rView.value("byteStride", size * components);
		Require(count > 0 && begin % size == 0 && offset % size == 0 && stride % size == 0, "alignment");
		Require(!rView.contains("target") || rView["target"] != 34962 || (stride % 4 == 0 && offset % 4 == 0),
		    "alignment of vertices");
		Require(offset + stride * (count - 1) + size * components <= rView.at("byteLength"), "it lies in its view");
		std::vector<double> values, least(components, INFINITY), greatest(components, -INFINITY);
		for (std::size_t i = 0; i < count; ++i)
			for (std::size_t k = 0; k < components; ++k)
			{
				const std::size_t at = begin + i * stride + k * size;
				const double value = type == 5126 ? double(Load<float>(m_Binary, at))
				    : size == 4                   ? double(Load<std::uint32_t>(m_Binary, at))
				    : size == 2                   ? double(Load<std::uint16_t>(m_Binary, at))
				                                  : double(Load<std::uint8_t>(m_Binary, at));
				Require(std::isfinite(value), "finite numbers");
				values.push_back(value);
				least[k] = std::min(least[k], value);
				greatest[k] = std::max(greatest[k], value);
			}
		for (const auto& [pName, pExpected] : {std::pair("min", &least), {"max", &greatest}})
			if (rAccessor.contains(pName))
				for (std::size_t k = 0; k < components; ++k)
					Require(float(rAccessor[pName].at(k).get<double>()) == float((*pExpected)[k]), pName);
		return values;
	}

	void RequireBounds(std::size_t i_Accessor) const
	{
		const VGltf& rAccessor = List("accessors").at(i_Accessor);
		Require(rAccessor.contains("min") && rAccessor.contains("max"), "least and greatest are told");
	}

	static void RequireUnit(const std::vector<double>& i_rValues, std::size_t i_Size, const char* i_pRule)
	{
		for (std::size_t i = 0; i < i_rValues.size(); i += i_Size)
		{
			double squares = 0.0;
			for (std::size_t k = 0; k < i_Size; ++k)
				squares += i_rValues[i + k] * i_rValues[i + k];
			Require(std::abs(std::sqrt(squares) - 1.0) < 5e-5, i_pRule);
		}
	}

	void CheckNodes() const
	{
		const VGltf& rNodes = List("nodes");
		std::vector<std::size_t> parents(rNodes.size(), rNodes.size());
		for (std::size_t i = 0; i < rNodes.size(); ++i)
		{
			for (const std::size_t child : rNodes[i].value("children", std::vector<std::size_t>()))
			{
				Require(child < rNodes.size() && parents[child] == rNodes.size(), "one parent each");
				parents[child] = i;
			}
			if (rNodes[i].contains("rotation"))
				RequireUnit(rNodes[i]["rotation"], 4, "unit quaternions of nodes");
			Require(!rNodes[i].contains("matrix") || !rNodes[i].contains("rotation"), "matrix or parts");
			Require(
			    !rNodes[i].contains("skin") || (rNodes[i].contains("mesh") && rNodes[i]["skin"] < List("skins").size()),
			    "a skin has its mesh");
			if (rNodes[i].contains("mesh"))
				Require(rNodes[i]["mesh"] < List("meshes").size(), "the mesh of a node");
			if (rNodes[i].contains("skin"))
				for (const VGltf& rPrimitive : List("meshes")[rNodes[i]["mesh"].get<std::size_t>()].at("primitives"))
					CheckWeights(rPrimitive.at("attributes"),
					    List("skins")[rNodes[i]["skin"].get<std::size_t>()].at("joints").size());
		}
		for (std::size_t i = 0; i < parents.size(); ++i)
		{
			std::size_t steps = 0;
			for (std::size_t above = parents[i]; above < parents.size(); above = parents[above])
				Require(++steps <= parents.size(), "no ring of nodes");
		}
		for (const VGltf& rScene : List("scenes"))
			for (const std::size_t root : rScene.at("nodes").get<std::vector<std::size_t>>())
				Require(root < parents.size() && parents[root] == parents.size(), "a scene has roots");
	}

	void CheckPrimitive(const VGltf& i_rPrimitive) const
	{
		const VGltf& rAttributes = i_rPrimitive.at("attributes");
		const std::size_t positions = rAttributes.at("POSITION");
		RequireBounds(positions);
		const std::size_t count = List("accessors")[positions].at("count");
		for (const auto& [name, accessor] : rAttributes.items())
		{
			Require(List("accessors").at(accessor.get<std::size_t>()).at("count") == count, "as many " + name);
			if (name == "NORMAL")
				RequireUnit(Values(accessor), 3, "unit normals");
		}
		if (i_rPrimitive.contains("material"))
			Require(i_rPrimitive["material"] < List("materials").size(), "the material of a mesh");
		const std::vector<double> indices = Values(i_rPrimitive.at("indices"));
		Require(indices.size() % 3 == 0 && *std::ranges::max_element(indices) < double(count), "indices of triangles");
	}

	void CheckWeights(const VGltf& i_rAttributes, std::size_t i_Joints) const
	{
		const std::vector<double> joints = Values(i_rAttributes.at("JOINTS_0"));
		const std::vector<double> weights = Values(i_rAttributes.at("WEIGHTS_0"));
		for (std::size_t i = 0; i < weights.size(); i += 4)
		{
			double sum = 0.0;
			std::set<double> used;
			for (std::size_t k = i; k < i + 4; ++k)
			{
				Require(joints[k] < double(i_Joints), "joints of a vertex");
				Require(weights[k] >= 0.0 && (weights[k] > 0.0 || joints[k] == 0.0), "a joint without weight is 0");
				Require(weights[k] == 0.0 || used.insert(joints[k]).second, "a joint once in a vertex");
				sum += weights[k];
			}
			Require(std::abs(sum - 1.0) < 8e-7, "weights have the sum 1");
		}
	}

	void CheckSkin(const VGltf& i_rSkin) const
	{
		const auto joints = i_rSkin.at("joints").get<std::vector<std::size_t>>();
		Require(std::set(joints.begin(), joints.end()).size() == joints.size(), "a joint once in a skin");
		Require(std::ranges::all_of(joints, [&](std::size_t i_Joint) { return i_Joint < List("nodes").size(); }),
		    "joints are nodes");
		const std::vector<double> matrices = Values(i_rSkin.at("inverseBindMatrices"));
		Require(matrices.size() == 16 * joints.size(), "an inverse bind matrix each");
		for (std::size_t i = 0; i < matrices.size(); i += 16)
			Require(
			    matrices[i + 3] == 0.0 && matrices[i + 7] == 0.0 && matrices[i + 11] == 0.0 && matrices[i + 15] == 1.0,
			    "the last row of a bind matrix");
	}

	void CheckAnimation(const VGltf& i_rAnimation) const
	{
		std::set<std::pair<std::size_t, std::string>> targets;
		for (const VGltf& rChannel : i_rAnimation.at("channels"))
		{
			const VGltf& rSampler = i_rAnimation.at("samplers").at(rChannel.at("sampler").get<std::size_t>());
			const std::string path = rChannel.at("target").at("path");
			const std::size_t node = rChannel["target"].at("node");
			Require(node < List("nodes").size() && targets.emplace(node, path).second, "a target once");
			Require(!List("nodes")[node].contains("matrix"), "what moves has no matrix");
			RequireBounds(rSampler.at("input"));
			const std::vector<double> times = Values(rSampler["input"]), values = Values(rSampler.at("output"));
			Require(times.front() >= 0.0 && std::ranges::adjacent_find(times, std::greater_equal()) == times.end(),
			    "times rise");
			const std::size_t size = path == "rotation" ? 4 : 3;
			Require(values.size() == size * times.size(), "a value for each time");
			if (size == 4)
				RequireUnit(values, 4, "unit quaternions of a motion");
		}
	}

	VGltf m_Gltf;
	std::string m_Binary;
};

} // namespace

std::string BrokenGltfRule(const std::string& i_rBytes)
{
	try
	{
		VChecker(i_rBytes).Check();
	}
	catch (const std::exception& rBroken)
	{
		return rBroken.what();
	}
	return {};
}

std::set<std::string> AnimatedNodes(const std::string& i_rBytes)
{
	const VGltf gltf = VGltf::parse(i_rBytes.substr(20, Load<std::uint32_t>(i_rBytes, 12)));
	std::set<std::string> names;
	for (const VGltf& rAnimation : gltf.at("animations"))
		for (const VGltf& rChannel : rAnimation.at("channels"))
			names.insert(gltf["nodes"][rChannel["target"]["node"].get<std::size_t>()].at("name"));
	return names;
}
