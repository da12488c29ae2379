#pragma once

#include "CoreGraphics/MaterialMesh.h"

#include <cstddef>
#include <memory>
#include <set>
#include <string>
#include <vector>

namespace CoreGraphics
{

/// As many bones as the shader of skins has room for. What others move goes with the last of them.
inline constexpr std::size_t c_MaxSkinBones = 250;

/// The skin of an FBX file, shared by all that wear it. Any thread makes it, the render thread uses it.
class VSkin
{
public:
	/// @param i_Name as messages call it
	VSkin(const FBXIO::VSkin& i_rData, std::string i_Name);

	const std::string& Name() const { return m_Name; }
	/// Null for a file without bones.
	const std::shared_ptr<const FBXIO::VSkinSkeleton>& Skeleton() const { return m_pSkeleton; }
	std::vector<VMaterialMesh>& Meshes() { return m_Meshes; }
	/// Whether any vertex goes with the bone.
	bool MovesVertices(std::size_t i_Bone) const { return i_Bone < m_MovesVertices.size() && m_MovesVertices[i_Bone]; }

	/// Warns in the log, once for each text.
	void WarnOnce(const std::string& i_rText);

private:
	const std::string m_Name;
	const std::shared_ptr<const FBXIO::VSkinSkeleton> m_pSkeleton;
	std::vector<VMaterialMesh> m_Meshes;
	std::vector<bool> m_MovesVertices;
	std::set<std::string> m_Warned;
};

} // namespace CoreGraphics
