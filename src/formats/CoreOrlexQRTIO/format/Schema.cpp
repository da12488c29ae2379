#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexQRTIO/format/FormatFunctions.h"
#include "DebugServices/GlobalLog.h"
#include "NVX/Status.h"
#include "UtilsFileSystem/SaveFile.h"
#include "UtilsRapidXml/SchemaNode.h"

namespace CoreOrlexQRTIO
{
namespace
{

/// Of the version annotations.
constexpr const char* c_SchemaNamespace = "urn:orlex:qrt-schema";
constexpr const char* c_Stylesheet = "Orlex_QRT_Schema-HTML.xsl";

} // namespace

std::string VReader::SchemaText()
{
	CoreOrlexTypes::VSubjectParametrised subject;
	CoreOrlexTypes::VSubjectApplicationData applicationData;
	VSubjectQRTExtras extras;
	VReading reading{subject, applicationData, extras};
	UtilsRapidXml::VDocument document;
	{
		UtilsRapidXml::VSchemaNode root(document, true, c_SchemaNamespace, c_Stylesheet);
		FormatDocument(root, reading);
	}
	return document.Print();
}

bool VReader::WriteSchema(const boost::filesystem::path& i_rPath)
{
	std::string reason;
	if (UtilsFileSystem::SaveFile(i_rPath, SchemaText(), reason) == NVX::Status::c_Success)
		return true;
	NVX_LOG("QRTIO", NVX::ELogError, "%1%", reason);
	return false;
}

} // namespace CoreOrlexQRTIO
