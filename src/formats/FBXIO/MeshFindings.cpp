#include "FBXIO/MeshFindings.h"

#include "DebugServices/GlobalLog.h"

void FBXIO::Tell(const VMeshFindings& i_rFindings, const std::string& i_rPath)
{
	if (i_rFindings.m_Moved > 0)
		NVX_LOG("FBXIO", NVX::ELogInformation,
		    "%1% polygon vertices of %2% are moved in all: its meshes are not drawn as the file means them. Told apart "
		    "by control point, too, the vertices stay",
		    i_rFindings.m_Moved, i_rPath);
	if (i_rFindings.m_WithoutPart > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "%1% polygons of %2% are left out because their material is beyond the list of their node",
		    i_rFindings.m_WithoutPart, i_rPath);
	if (i_rFindings.m_Geometric > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "%1% meshes of %2% are drawn without their geometric transform, which would move them by up to %3$.1f mm. "
		    "Apply it in the program that wrote the file",
		    i_rFindings.m_Geometric, i_rPath, i_rFindings.m_GeometricDistance);
	if (const std::size_t others = i_rFindings.m_OtherMaterials - i_rFindings.m_BaseColours; others > 0)
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "%1% materials of %2% are neither Phong nor Lambert and are drawn in the default colour", others, i_rPath);
	if (i_rFindings.m_BaseColours > 0)
		NVX_LOG("FBXIO", NVX::ELogInformation,
		    "%1% materials of %2% are neither Phong nor Lambert; their base colour and its texture are shown",
		    i_rFindings.m_BaseColours, i_rPath);
	if (!i_rFindings.m_BoundDifferently.empty())
		NVX_LOG("FBXIO", NVX::ELogWarning,
		    "%1% bones of %2% are bound differently by several meshes; each moves all of them as the last one binds it",
		    i_rFindings.m_BoundDifferently.size(), i_rPath);
}
