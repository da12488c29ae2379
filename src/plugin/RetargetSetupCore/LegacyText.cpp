#include "RetargetSetupCore/LegacyText.h"

#include "CoreOrlexTypes/TextForm.h"
#include "DebugServices/GlobalLog.h"
#include "NVX/Status.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/Limits.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"

#include <string>

using CoreOrlexTypes::VSubjectParametrised;
using CoreOrlexTypes::VSubjectRecord;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

namespace RetargetSetup
{

namespace
{

template <typename TElement>
void FitList(std::vector<TElement>& io_rList, std::size_t i_Count, const char* i_pWhat)
{
	if (io_rList.size() == i_Count)
		return;
	NVX_LOG(c_LogCategory, NVX::ELogWarning,
	    "Legacy file: the application data of %1% %2% is brought to the subject's %3%", io_rList.size(), i_pWhat,
	    i_Count);
	io_rList.resize(i_Count);
}

void FitId(std::uint32_t& io_rId, const char* i_pWhere)
{
	if (io_rId == c_SubjectId)
		return;
	NVX_LOG(c_LogCategory, NVX::ELogWarning, "Legacy file: the id %1% of the %2% becomes %3%", io_rId, i_pWhere,
	    c_SubjectId);
	io_rId = c_SubjectId;
}

} // namespace

std::uint32_t ParseLegacyText(std::string_view i_Text, VSubjectRecord& io_rRecord)
{
	CoreOrlexTypes::VTextHeader header;
	std::size_t headerLength = 0;
	if (!CoreOrlexTypes::ReadText(i_Text, header, &headerLength))
		return NVX::Status::c_Failure;
	if (header.m_Version > c_LegacyVersion)
		return NVX::Status::c_NewerFileVersion;
	return CoreOrlexTypes::ReadText(i_Text.substr(headerLength), io_rRecord) ? NVX::Status::c_Success
	                                                                         : NVX::Status::c_Failure;
}

void RepairLegacyRecord(VSubjectRecord& io_rRecord)
{
	VSubjectParametrised& rSubject = io_rRecord.m_SubjectParametrised;
	CoreOrlexTypes::VSubjectApplicationData& rData = io_rRecord.m_SubjectApplicationData;
	if (rSubject.m_Name != c_SubjectName)
	{
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "Legacy file: the subject's name '%1%' becomes '%2%'", rSubject.m_Name,
		    c_SubjectName);
		rSubject.m_Name = c_SubjectName;
	}
	FitId(rSubject.m_SubjectId, "subject");
	FitId(rData.m_SubjectId, "application data");
	FitList(rData.m_Markers, rSubject.m_Markers.size(), "markers");
	FitList(rData.m_Segments, rSubject.m_Segments.size(), "segments");
	FitList(rData.m_Targets, rSubject.m_Targets.size(), "targets");
	for (VTarget& rTarget : rSubject.m_Targets)
		if (rTarget.m_Type == VTarget::ELocalRotationToWorldRotation)
			rTarget.m_RotationCalibrationBehaviour = VTarget::EOther;
}

std::uint32_t ReadLegacyFile(const boost::filesystem::path& i_rPath, VSubjectRecord& io_rRecord)
{
	const std::string name = UtilsFileSystem::ToUtf8(i_rPath);
	std::string text;
	std::string error;
	std::uint32_t status = UtilsFileSystem::ReadWholeFile(i_rPath, c_MaxLegacyFileBytes, text, error);
	if (status != NVX::Status::c_Success)
	{
		NVX_LOG(c_LogCategory, NVX::ELogError, "Cannot read the legacy file '%1%': %2%", name, error);
		return status;
	}
	status = ParseLegacyText(text, io_rRecord);
	if (status == NVX::Status::c_NewerFileVersion)
		NVX_LOG(c_LogCategory, NVX::ELogError, "The legacy file '%1%' is of a later version than 1.0.1", name);
	else if (status != NVX::Status::c_Success)
		NVX_LOG(c_LogCategory, NVX::ELogError, "'%1%' is not a legacy subject file, or is damaged", name);
	else
		RepairLegacyRecord(io_rRecord);
	return status;
}

} // namespace RetargetSetup
