#include "OrlexGraphics/manipulator/MeshFile.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "DebugServices/GlobalLog.h"
#include "FBXIO/FBXReader.h"

namespace OrlexGraphics
{

std::optional<CoreGraphics::VShape> ReadMeshFile(
    const CoreGraphics::VShaderLibrary& i_rLibrary, const std::string& i_rName)
{
	const std::string path = i_rLibrary.GetResourceRoot() + "/Geometry/" + i_rName;
	FBXIO::FBXReader reader;
	FBXIO::VBasicMesh mesh;
	if (reader.LoadFile(path))
		reader.ReadTopMesh(mesh);
	if (mesh.m_Parts.empty() || mesh.m_Parts.front().m_Indices.empty())
	{
		NVX_LOG("CoreGraphics", NVX::ELogError, "Failed to open %1%", path);
		return {};
	}
	FBXIO::VMeshPart& rPart = mesh.m_Parts.front();
	return CoreGraphics::VShape{
	    CoreGraphics::VVertexBuffer(CoreGraphics::VVertexFormat::Mesh(), CoreGraphics::BytesOf(mesh.m_Vertices)),
	    CoreGraphics::VIndexBuffer(std::move(rPart.m_Indices), rPart.m_IndexSize)};
}

} // namespace OrlexGraphics
