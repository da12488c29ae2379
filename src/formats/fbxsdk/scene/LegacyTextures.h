#pragma once

#include "fbxsdk/scene/ArraySource.h"
#include "fbxsdk/sdk/Material.h"

namespace FbxFormat
{

/// Before version 7 textures are connected to nodes, and a layer of the mesh tells which of them each polygon has. They
/// become the textures of the diffuse colours of the materials that these polygons have; without such a layer all
/// materials get the first that no layer for something else names. A material whose polygons have several textures gets
/// the first of these, and that is told.
/// @param i_rMesh the mesh's record, or none.
void ConnectLegacyTextures(const VArraySource& i_rMesh, const char* i_pNode,
    std::span<fbxsdk::FbxFileTexture* const> i_Textures, std::span<fbxsdk::FbxSurfaceMaterial* const> i_Materials);

} // namespace FbxFormat
