#include "fbxsdk/scene/LegacyTextures.h"

#include "DebugServices/GlobalLog.h"
#include "fbxsdk/container/Values.h"
#include "fbxsdk/scene/MaterialReader.h"

#include <algorithm>
#include <vector>

namespace
{

using namespace FbxFormat;

constexpr std::string_view c_Diffuse = "DiffuseColor";

/// For each polygon a place in a list; a single one is that of all.
VArrayNumbers<std::int32_t> PlacesOf(
    const VArraySource& i_rMesh, const char* i_pLayer, const char* i_pPlaces, const char* i_pNode)
{
	const VArraySource layer = i_rMesh.m_Element == c_NoElement ? i_rMesh : i_rMesh.Child(i_pLayer);
	if (layer.m_Element == c_NoElement)
		return {};
	VArrayNumbers<std::int32_t> places;
	(void)FbxFormat::Decode({layer.Child(i_pPlaces), i_pNode, &places});
	const VElementIndex mapping = layer.Child("MappingInformationType").m_Element;
	const std::string_view mode =
	    mapping == c_NoElement ? std::string_view() : ValueAt(*i_rMesh.m_pTree, mapping, 0).m_Text;
	if (mode == "AllSame")
		places.resize(std::min<std::size_t>(places.size(), 1));
	else if (mode != "ByPolygon")
		places.clear();
	return places;
}

/// The first texture that no layer for something else than the diffuse colour names, such as
/// "LayerElementEmissiveTextures"; their count if there is none.
std::size_t FirstWithoutLayer(const VArraySource& i_rMesh, std::size_t i_Textures, const char* i_pNode)
{
	std::vector<bool> named(i_Textures);
	if (i_rMesh.m_Element != c_NoElement)
		for (const VElementIndex layer : i_rMesh.m_pTree->Children(i_rMesh.m_Element))
		{
			const std::string_view name = i_rMesh.m_pTree->Name(layer);
			if (!name.starts_with("LayerElement") || !name.ends_with("Textures"))
				continue;
			VArrayNumbers<std::int32_t> places;
			const VArraySource source{i_rMesh.m_pTree, i_rMesh.m_pBudget, layer};
			(void)FbxFormat::Decode({source.Child("TextureId"), i_pNode, &places});
			for (const std::int32_t place : places)
				if (place >= 0 && std::size_t(place) < i_Textures)
					named[place] = true;
		}
	return std::size_t(std::find(named.begin(), named.end(), false) - named.begin());
}

} // namespace

void FbxFormat::ConnectLegacyTextures(const VArraySource& i_rMesh, const char* i_pNode,
    std::span<fbxsdk::FbxFileTexture* const> i_Textures, std::span<fbxsdk::FbxSurfaceMaterial* const> i_Materials)
{
	const VArrayNumbers<std::int32_t> textures = PlacesOf(i_rMesh, "LayerElementTexture", "TextureId", i_pNode);
	if (textures.empty())
	{
		const std::size_t place = FirstWithoutLayer(i_rMesh, i_Textures.size(), i_pNode);
		if (place < i_Textures.size())
			for (fbxsdk::FbxSurfaceMaterial* const pMaterial : i_Materials)
				VMaterialReader::Connect(*i_Textures[place], *pMaterial, c_Diffuse);
		return;
	}
	const VArrayNumbers<std::int32_t> materials = PlacesOf(i_rMesh, "LayerElementMaterial", "Materials", i_pNode);
	constexpr std::int32_t c_Unknown = -2;
	std::vector<std::int32_t> textureOf(i_Materials.size(), c_Unknown);
	bool bSeveral = false;
	for (std::size_t polygon = 0; polygon < std::max(textures.size(), materials.size()); ++polygon)
	{
		// Materials below zero are the first, as everywhere.
		const std::int32_t material = materials.empty() ? 0 : materials[std::min(polygon, materials.size() - 1)];
		const auto place = std::size_t(std::max(material, 0));
		const std::int32_t texture = textures[std::min(polygon, textures.size() - 1)];
		if (place >= textureOf.size() || texture >= std::int32_t(i_Textures.size()))
			continue;
		bSeveral = bSeveral || (textureOf[place] != c_Unknown && textureOf[place] != texture);
		if (textureOf[place] == c_Unknown)
			textureOf[place] = texture;
	}
	for (std::size_t i = 0; i < textureOf.size(); ++i)
		if (textureOf[i] >= 0)
			VMaterialReader::Connect(*i_Textures[textureOf[i]], *i_Materials[i], c_Diffuse);
	if (bSeveral)
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "Polygons of one material of %1% have several textures; each material gets the first of its own", i_pNode);
}
