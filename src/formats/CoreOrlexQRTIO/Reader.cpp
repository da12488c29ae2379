#include "CoreOrlexQRTIO/Reader.h"

#include "CoreOrlexQRTIO/Limits.h"
#include "CoreOrlexQRTIO/read/ReadChecks.h"
#include "CoreOrlexTypes/NameHash.h"
#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"
#include "DebugServices/GlobalLog.h"
#include "NVX/Status.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsRapidXml/ReaderNode.h"

#include <boost/format.hpp>

#include <new>

namespace CoreOrlexQRTIO
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;

namespace
{

using VTexts = std::vector<std::string>;

/// Walks the document's elements.
void ReadTree(UtilsRapidXml::VDocument& i_rDocument, bool i_bOwnFormsAreDetails, VReading& io_rReading,
    VTexts& o_rErrors, VTexts& o_rWarnings)
{
	std::shared_ptr<UtilsRapidXml::VReaderNode::VGlobalInfo> pGlobal;
	{
		UtilsRapidXml::VReaderNode root(i_rDocument, false);
		pGlobal = root.GetGlobalInfo();
		pGlobal->m_bOwnFormsAreDetails = i_bOwnFormsAreDetails;
		FormatDocument(root, io_rReading);
	}
	if (pGlobal->m_bOutOfMemory)
		throw std::bad_alloc();
	o_rErrors = pGlobal->m_Errors.GetTexts();
	o_rWarnings = pGlobal->m_Warnings.GetTexts();
	for (const std::string& rDetail : pGlobal->m_Details.GetTexts())
		NVX_LOG("QRTIO", NVX::ELogDetail, "%1%", rDetail);
}

} // namespace

bool VReader::ReadText(std::string i_Text, const std::string& i_rSubjectName, std::uint32_t i_SubjectId,
    VSubjectParametrised& o_rSubject, VSubjectApplicationData& o_rApplicationData, VSubjectQRTExtras& o_rExtras,
    VTexts& o_rErrors, VTexts& o_rWarnings)
{
	o_rSubject = {};
	o_rApplicationData = {};
	o_rExtras = {};
	o_rErrors.clear();
	o_rWarnings.clear();

	VReading reading{o_rSubject, o_rApplicationData, o_rExtras};
	reading.m_bHashedIds = i_SubjectId == c_HashedIds;
	o_rSubject.m_Name = i_rSubjectName;
	o_rSubject.m_SubjectId = reading.m_bHashedIds ? CoreOrlexTypes::HashName(i_rSubjectName) : i_SubjectId;
	o_rApplicationData.m_SubjectId = o_rSubject.m_SubjectId;

	UtilsRapidXml::VDocument document;
	std::string reason;
	if (!document.Parse(std::move(i_Text), reason))
	{
		o_rSubject = {};
		o_rApplicationData = {};
		o_rErrors.push_back("Failed to read file");
		o_rWarnings.push_back(reason);
		return false;
	}
	ReadTree(document, m_bOwnFormsAreDetails, reading, o_rErrors, o_rWarnings);

	CoreOrlexTypesUtils::VDynamicExpressionParserSimple parser;
	if (!CheckExpressions(parser, reading, o_rErrors, o_rWarnings))
	{
		o_rErrors.push_back("Failed validating one or more Expressions");
		return false;
	}
	IdentifySubspaces(reading);
	FinishJointsAndTargets(parser, reading, o_rErrors, o_rWarnings);
	return o_rErrors.empty();
}

bool VReader::Read(const boost::filesystem::path& i_rPath, const std::string& i_rSubjectName, std::uint32_t i_SubjectId,
    VSubjectParametrised& o_rSubject, VSubjectApplicationData& o_rApplicationData, VSubjectQRTExtras& o_rExtras,
    VTexts& o_rErrors, VTexts& o_rWarnings)
{
	std::string text;
	std::string reason;
	const std::uint32_t status = UtilsFileSystem::ReadWholeFile(i_rPath, c_MaximumFileSize, text, reason);
	if (status == NVX::Status::c_Success)
		return ReadText(std::move(text), i_rSubjectName, i_SubjectId, o_rSubject, o_rApplicationData, o_rExtras,
		    o_rErrors, o_rWarnings);
	o_rSubject = {};
	o_rApplicationData = {};
	o_rExtras = {};
	o_rWarnings.assign(1, reason);
	o_rErrors.assign(1,
	    status == NVX::Status::c_FileNotOpened
	        ? (boost::format("Error opening file '%1%' for reading") % i_rPath.string()).str()
	        : "Failed to read file");
	return false;
}

bool VReader::Read(const boost::filesystem::path& i_rPath, const std::string& i_rSubjectName, std::uint32_t i_SubjectId,
    VSubjectParametrised& o_rSubject, VSubjectApplicationData& o_rApplicationData, VSubjectQRTExtras& o_rExtras)
{
	VTexts errors;
	VTexts warnings;
	const bool bRead =
	    Read(i_rPath, i_rSubjectName, i_SubjectId, o_rSubject, o_rApplicationData, o_rExtras, errors, warnings);
	for (const std::string& rWarning : warnings)
		NVX_LOG("QRTIO", NVX::ELogWarning, "%1%", rWarning);
	for (const std::string& rError : errors)
		NVX_LOG("QRTIO", NVX::ELogError, "%1%", rError);
	return bRead;
}

} // namespace CoreOrlexQRTIO
