#include "retarget/subject/Session.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "retarget/subject/Mapping.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/Output.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexQRTIO/Limits.h"
#include "DebugServices/GlobalLog.h"
#include "FBXIO/FBXReader.h"
#include "InMemoryHost/Flow.h"
#include "NVX/Status.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/TargetConstruction.h"
#include "UtilsFileSystem/Files.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>

namespace CommandLine
{
namespace
{

/// What was told of a pose that is now the file's.
void ForgetPoseWarnings()
{
	ForgetMessages(
	    [](const std::string& i_rCategory, const std::string& i_rText)
	    {
		    for (const auto& [pCategory, pBegin] :
		        {std::pair{"RetargetSetup", "Root bone '"}, {"RetargetSetup", "Removing joints changed the bind pose"},
		            {c_pCategory, "The bind pose as built differs"}, {c_pCategory, "--prune-joints after"},
		            {c_pCategory, "--prune-joint after"}})
			    if (i_rCategory == pCategory && i_rText.starts_with(pBegin))
				    return true;
		    return false;
	    });
}

/// Keeps why a command was ignored.
class VTellingDocument final : public VRetargetSetupCore
{
public:
	VTellingDocument(std::string& o_rWhyIgnored, const std::shared_ptr<InMemoryHost::VDispatcher>& i_rpDispatcher)
	    : VRetargetSetupCore(i_rpDispatcher,
	        NVX::CountedPointer<TesselPluginInterface::IFrameFactory>(new InMemoryHost::VFrameFactory),
	        NVX::CountedPointer<TesselPluginInterface::IItemFactory>(new InMemoryHost::VItemFactory)),
	      m_rWhyIgnored(o_rWhyIgnored)
	{
	}

private:
	void CommandIgnored(const char* /*i_pCommand*/, const std::string& i_rReason) override
	{
		m_rWhyIgnored = i_rReason;
	}

	std::string& m_rWhyIgnored;
};

} // namespace

std::size_t FindRootBone(const std::string& i_rWord, const FBXIO::VSkinSkeleton& i_rSkeleton)
{
	VElements bones{"bone", {}};
	for (const FBXIO::VSkinBone& rBone : i_rSkeleton)
		bones.m_Names.push_back(rBone.m_Name);
	// The name comes first: a bone may be called by a number.
	if (std::find(bones.m_Names.begin(), bones.m_Names.end(), i_rWord) != bones.m_Names.end()
	    || i_rWord.starts_with('#'))
		return FindElement(i_rWord, bones);
	if (!i_rWord.empty() && i_rWord.find_first_not_of("0123456789") == std::string::npos)
		return FindElement("#" + i_rWord, bones);
	// Or as the segment will be called, without the namespace.
	for (std::string& rName : bones.m_Names)
		rName = RetargetSetup::StripNamespace(rName);
	return FindElement(i_rWord, bones);
}

VSession::VSession()
    : m_pApplication(std::make_shared<InMemoryHost::VApplication>()),
      m_pDispatcher(std::make_shared<InMemoryHost::VDispatcher>()),
      m_pDocument(std::make_shared<VTellingDocument>(m_WhyIgnored, m_pDispatcher))
{
	m_pApplication->m_Rules.m_bOwnFormsAreDetails = true;
	m_pDocument->SetHostRules(m_pApplication);
}

void VSession::LoadSource(const std::string& i_rPath)
{
	if (!m_pDocument->LoadSourceSubject(InputPath(i_rPath, CoreOrlexQRTIO::c_MaximumFileSize), ""))
		throw VCommandError(EBadInput, "\"" + i_rPath + "\" could not be read as a source skeleton");
	Settle();
	m_bSourceNamed = i_rPath != c_pStandardStream;
	const auto pData = m_pDocument->TargetValues().m_pApplicationData;
	if (m_bSourceNamed && pData && !pData->m_RetargetSourceTemplate.empty()
	    && pData->m_RetargetSourceTemplate != m_pDocument->GetSourceName())
		NVX_LOG(c_pCategory, NVX::ELogWarning, "The retarget subject was made for the source \"%1%\", not for \"%2%\"",
		    pData->m_RetargetSourceTemplate, m_pDocument->GetSourceName());
}

void VSession::LoadTarget(const std::string& i_rPath)
{
	const std::uint32_t status = m_pDocument->LoadTargetSubject(InputPath(i_rPath, CoreOrlexQRTIO::c_MaximumFileSize));
	if (status == NVX::Status::c_NewerFileVersion)
		throw VCommandError(EBadInput, "\"" + i_rPath + "\" is of a later version than this program reads");
	if (status == NVX::Status::c_FileNotOpened)
		throw VCommandError(EBadInput, "\"" + i_rPath + "\" could not be opened");
	if (status != NVX::Status::c_Success)
		throw VCommandError(EBadInput, "\"" + i_rPath + "\" could not be read as a retarget subject");
	Settle();
}

void VSession::LoadFbx(const std::string& i_rPath)
{
	if (!m_pDocument->LoadTargetFBX(InputPath(i_rPath)))
		throw VCommandError(EBadInput,
		    m_pDocument->IsTargetFBXComplete() ? "\"" + i_rPath + "\" could not be read as FBX, or holds no skeleton"
		                                       : "\"" + i_rPath + "\" could be read only in part");
	const auto pSkeleton = m_pDocument->GetFBXSkeleton();
	if (!m_pDocument->IsTargetFBXComplete())
		throw VCommandError(EBadInput,
		    "\"" + i_rPath + "\" could be read only in part: " + std::to_string(pSkeleton->size())
		        + " bones up to where it broke off");
	m_Alignment.m_bOnJoints = false;
}

void VSession::CreateTarget(const std::string& i_rPath, const std::optional<std::string>& i_rRoot, bool i_bBodyRoot,
    const std::string& i_rRootWhere)
{
	LoadFbx(i_rPath);
	const auto pSkeleton = m_pDocument->GetFBXSkeleton();
	m_Root = 0;
	if (i_rRoot)
		try
		{
			m_Root = FindRootBone(*i_rRoot, *pSkeleton);
		}
		catch (const VCommandError& rError)
		{
			throw VCommandError(rError.Status(), i_rRootWhere + rError.what());
		}
	else if (const std::int64_t root = i_bBodyRoot ? ProposeForFile(*this).m_Root : -1; root >= 0)
		m_Root = std::size_t(root);
	if (i_rRoot || *m_Root != 0)
		m_pDocument->SetTargetRootIndex(std::uint32_t(*m_Root));
	m_bTargetNamed = i_rPath != c_pStandardStream;
	m_pDocument->CreateTargetSubject();
	Settle();
}

std::size_t VSession::CountJoints() const
{
	return std::size_t(std::ranges::count_if(Target().m_Segments,
	    [](const auto& i_rSegment)
	    { return i_rSegment.m_Joint.m_JointType != CoreOrlexTypes::VSubjectParametrised::VJoint::EDummy; }));
}

void VSession::Report(const std::string& i_rPath) const
{
	const CoreOrlexTypes::VSubjectParametrised& rSubject = Target();
	VJson json{{"output", i_rPath}, {"segments", rSubject.m_Segments.size()}, {"joints", CountJoints()},
	    {"targets", rSubject.m_Targets.size()}};
	json.update(m_ReportJson);
	PrintResult(json, i_rPath == c_pStandardStream ? "" : m_ReportText);
}

void VSession::MatchFilePose()
{
	m_WhyIgnored.clear();
	m_pDocument->MatchFilePose();
	if (!m_WhyIgnored.empty())
		throw VCommandError(EBadInput, "The pose of the FBX file cannot be taken. " + m_WhyIgnored);
	TookFilePose();
}

void VSession::TookFilePose()
{
	m_bMatched = true;
	ForgetPoseWarnings();
}

void VSession::ForgetNamelessFiles()
{
	const auto values = m_pDocument->TargetValues();
	CoreOrlexTypes::VSubjectApplicationData data = *values.m_pApplicationData;
	if (!m_bTargetNamed)
		data.m_Skin.clear();
	if (!m_bSourceNamed)
		data.m_RetargetSourceTemplate.clear();
	if (data != *values.m_pApplicationData)
		m_pDocument->SetTargetSubject(*values.m_pParametrised, data, m_pDocument->GetTargetExtras());
}

void VSession::NameSource(const std::string& i_rName)
{
	const auto values = m_pDocument->TargetValues();
	CoreOrlexTypes::VSubjectApplicationData data = *values.m_pApplicationData;
	data.m_RetargetSourceTemplate = i_rName;
	m_pDocument->SetTargetSubject(*values.m_pParametrised, data, m_pDocument->GetTargetExtras());
}

void VSession::Save(const std::string& i_rPath)
{
	const bool bStandardOutput = i_rPath == c_pStandardStream;
	std::uint32_t status = NVX::Status::c_Success;
	std::string text;
	if (StrictAsked() || bStandardOutput)
	{
		// What saving would warn of is known only from a save.
		boost::system::error_code error;
		const boost::filesystem::path trial = boost::filesystem::temp_directory_path(error)
		    / boost::filesystem::unique_path("retarget-%%%%%%%%%%%%.qrr", error);
		status = m_pDocument->SaveTargetSubject(trial);
		std::string reason;
		if (status == NVX::Status::c_Success && bStandardOutput)
			status = UtilsFileSystem::ReadWholeFile(trial, text.max_size() / 2, text, reason);
		boost::filesystem::remove(trial, error);
	}
	RequireNoErrors();
	if (!bStandardOutput)
		status = m_pDocument->SaveTargetSubject(i_rPath);
	if (status != NVX::Status::c_Success)
		throw VCommandError(EBadOutput, "\"" + i_rPath + "\" could not be written");
	if (bStandardOutput)
		Print(text);
	NVX_LOG(c_pCategory, NVX::ELogInformation, "Saved \"%1%\": %2% segments, %3% targets", i_rPath,
	    Target().m_Segments.size(), Target().m_Targets.size());
}

const CoreOrlexTypes::VSubjectParametrised& VSession::Source(const std::string& i_rWhatFor) const
{
	const auto pSource = m_pDocument->SourceValues().m_pParametrised;
	if (!pSource)
		throw VCommandError(
		    EWrongUsage, i_rWhatFor + " needs the performer's skeleton: give it with --source FILE.qrs");
	return *pSource;
}

const CoreOrlexTypes::VSubjectParametrised& VSession::Target() const
{
	return *m_pDocument->TargetValues().m_pParametrised;
}

std::vector<Rotation::VPose<double>> BindPosesOf(
    const VRetargetSetupCore::VSubjectValues& i_rValues, const char* i_pWhich)
{
	const auto pFK = RetargetSetup::KinematicsInBindPose(*i_rValues.m_pParametrised, *i_rValues.m_pSubject, i_pWhich);
	return pFK ? RetargetSetup::SegmentPoses(*pFK) : std::vector<Rotation::VPose<double>>();
}

} // namespace CommandLine
