#include "CoreOrlexQRTIO/FormatVersions.h"
#include "CoreOrlexQRTIO/format/FormatFunctions.h"
#include "CoreOrlexQRTIO/format/FormatTable.h"
#include "CoreOrlexQRTIO/read/AttributeReading.h"

#include <boost/format.hpp>

namespace CoreOrlexQRTIO
{

using UtilsRapidXml::INode;
using UtilsRapidXml::ReadAttribute;

void FormatDocument(INode& io_rNode, VReading& io_rReading)
{
	Process(io_rNode, Format::KinematicModel::c_Element,
	    [&](INode& io_rModel)
	    {
		    if (++io_rReading.m_ModelCount > 1)
			    io_rModel.AddError("File has more than one KinematicModel element");
		    else
			    FormatKinematicModel(io_rModel, io_rReading);
	    });
	if (io_rReading.m_ModelCount == 0)
		io_rNode.AddError("File has no KinematicModel element");
}

void FormatKinematicModel(INode& io_rNode, VReading& io_rReading)
{
	namespace Table = Format::KinematicModel;
	ReadAttribute(io_rNode, Table::c_Model, io_rReading.m_rSubject.m_Model);
	if (ReadAttribute(io_rNode, Table::c_Version, io_rReading.m_Version))
		io_rNode.SetVersion(io_rReading.m_Version);
	ReadAttribute(io_rNode, Table::c_ModelVersion, io_rReading.m_rSubject.m_ModelVersion);
	ReadAttribute(io_rNode, Table::c_RetargetSourceTemplate, io_rReading.m_rApplicationData.m_RetargetSourceTemplate);
	ReadAttribute(io_rNode, Table::c_RetargetSourceSubject, io_rReading.m_rApplicationData.m_RetargetSourceSubject);
	bool bDevelopment = false;
	ReadAttribute(io_rNode, Table::c_Development, bDevelopment);
	if (bDevelopment)
	{
		io_rNode.AddError("Attempting to load a QRT version which was saved while in development.");
		return;
	}
	const auto refuse = [&](const char* i_pFormat, Format::VVersion i_Bound)
	{ io_rNode.AddError((boost::format(i_pFormat) % ToText(io_rReading.m_Version) % ToText(i_Bound)).str()); };
	if (io_rReading.m_Version < c_MinimumVersion)
		return refuse("Cannot load QRT file with version %1%, minimum supported version is %2%", c_MinimumVersion);
	if (io_rReading.m_Version > c_MaximumVersion)
		return refuse("Cannot load QRT file with version %1%, maximum supported version is %2%", c_MaximumVersion);

	// In this order whatever the order in the file: markers refer to segments, targets to both.
	const auto section = [&](const Format::VElement& i_rElement, void (*i_pFunction)(INode&, VReading&))
	{ Process(io_rNode, i_rElement, [&](INode& io_rSection) { i_pFunction(io_rSection, io_rReading); }); };
	section(Table::c_Parameters, FormatParameters);
	section(Table::c_Skeleton, FormatSkeleton);
	section(Table::c_MarkerSet, FormatMarkerSet);
	section(Table::c_TargetSet, FormatTargetSet);
	section(Table::c_Skin, FormatSkin);
	section(Table::c_SubjectDynamicSubspace, FormatSubjectDynamicSubspace);
}

void FormatSkin(INode& io_rNode, VReading& io_rReading)
{
	CoreOrlexTypes::VSubjectApplicationData& rApplicationData = io_rReading.m_rApplicationData;
	ReadAttribute(io_rNode, Format::Skin::c_Name, rApplicationData.m_Skin);
	ReadColour(io_rNode, Format::Skin::c_ColourA, rApplicationData.m_SkinColourA);
	ReadColour(io_rNode, Format::Skin::c_ColourB, rApplicationData.m_SkinColourB);
}

} // namespace CoreOrlexQRTIO
