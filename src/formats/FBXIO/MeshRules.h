#pragma once

namespace FBXIO
{

/// What tells vertices apart where texture coordinates are given by polygon vertex.
enum class EVertexKey
{
	/// The index of the coordinate alone: as many vertices as there are coordinates in use. Control points that share
	/// one become one vertex, in the place of the first.
	UVIndex,
	/// The control point and the index of its coordinate: nothing moves.
	ControlPointAndUVIndex
};

/// How meshes are read where a rule has a plain form and one that fits more files. The defaults are the plain forms.
struct VMeshRules
{
	EVertexKey m_VertexKey = EVertexKey::UVIndex;
	/// A material that is neither Phong nor Lambert shows its base colour and the texture of that, under the names that
	/// exporters give them; else it is drawn in the default.
	bool m_bBaseColours = false;
};

/// For programs that show a mesh as its file means it.
inline constexpr VMeshRules c_FaithfulMeshes{EVertexKey::ControlPointAndUVIndex, true};

} // namespace FBXIO
