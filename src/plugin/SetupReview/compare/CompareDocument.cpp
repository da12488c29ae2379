#include "SetupReview/compare/CompareDocument.h"

#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexQRTIO/Writer.h"
#include "RetargetSetupCore/DefaultPose.h"
#include "RetargetSetupCore/FilePath.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/LegacyText.h"
#include "UtilsFileSystem/Paths.h"

namespace SetupReview
{
namespace
{

bool ReadSetupFile(const boost::filesystem::path& i_rPath, bool i_bOwnFormsAreDetails, VSetup& o_rSetup)
{
	CoreOrlexTypes::VSubjectParametrised& rSubject = o_rSetup.m_Record.m_SubjectParametrised;
	if (RetargetSetup::FileExtension(i_rPath) != ".qrx")
		return CoreOrlexQRTIO::VReader(i_bOwnFormsAreDetails)
		    .Read(i_rPath, RetargetSetup::c_SubjectName, RetargetSetup::c_SubjectId, rSubject,
		        o_rSetup.m_Record.m_SubjectApplicationData, o_rSetup.m_Extras);
	if (RetargetSetup::ReadLegacyFile(i_rPath, o_rSetup.m_Record) != 0)
		return false;
	if (RetargetSetup::LacksBindPose(rSubject))
		RetargetSetup::AdoptTPoseAsBindPose(rSubject);
	return true;
}

/// The numbers of a file have fewer digits than those that are at work.
bool AsSaved(const VRetargetSetupCore& i_rDocument, VSetup& o_rSetup, std::string& o_rReason)
{
	const auto target = i_rDocument.TargetValues();
	std::string text;
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	if (CoreOrlexQRTIO::VWriter().WriteText(*target.m_pParametrised, *target.m_pApplicationData,
	        i_rDocument.GetTargetExtras(), CoreOrlexQRTIO::c_AutomaticVersion, text, errors, warnings)
	    && CoreOrlexQRTIO::VReader().ReadText(std::move(text), RetargetSetup::c_SubjectName, RetargetSetup::c_SubjectId,
	        o_rSetup.m_Record.m_SubjectParametrised, o_rSetup.m_Record.m_SubjectApplicationData, o_rSetup.m_Extras,
	        errors, warnings))
		return true;
	o_rReason = errors.empty() ? std::string() : errors.front();
	return false;
}

} // namespace

std::optional<std::vector<VSetupChange>> ChangesSince(
    const VRetargetSetupCore& i_rDocument, const boost::filesystem::path& i_rPath, std::string& o_rReason)
{
	const auto target = i_rDocument.TargetValues();
	VSetup before;
	VSetup now;
	if (!target.m_pParametrised || !target.m_pApplicationData)
		o_rReason = RetargetSetup::Ignored::c_NoTarget;
	else if (!ReadSetupFile(i_rPath, i_rDocument.HostRules().m_bOwnFormsAreDetails, before))
		o_rReason = "'" + UtilsFileSystem::ToUtf8(i_rPath) + "' could not be read as a retarget subject.";
	else if (AsSaved(i_rDocument, now, o_rReason))
		return CompareSetups(before, now);
	return std::nullopt;
}

} // namespace SetupReview
