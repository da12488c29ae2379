// The operations of VRetargetSetupCore that read and write files.

#include "CoreOrlexQRTIO/FileDifference.h"
#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexQRTIO/Writer.h"
#include "DebugServices/GlobalLog.h"
#include "FBXIO/FBXReader.h"
#include "NVX/Status.h"
#include "RetargetSetupCore/AngleAxis.h"
#include "RetargetSetupCore/DefaultPose.h"
#include "RetargetSetupCore/FilePath.h"
#include "RetargetSetupCore/FilePose.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/LegacyText.h"
#include "RetargetSetupCore/Presets.h"
#include "RetargetSetupCore/RetargetSetupCore.h"
#include "RetargetSetupCore/RootHeight.h"
#include "RetargetSetupCore/StepNames.h"
#include "RetargetSetupCore/TargetConstruction.h"
#include "SetupIO/WriteSetup.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/SaveFile.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <cmath>
#include <map>
#include <utility>

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using CoreOrlexTypes::VSubjectRecord;
using RetargetSetup::c_LogCategory;
using RetargetSetup::DigestOf;
using RetargetSetup::VTargetFile;
using RetargetSetup::VTargetState;
namespace Ignored = RetargetSetup::Ignored;
namespace Steps = RetargetSetup::Steps;

namespace
{

constexpr const char* c_LegacyExtension = ".qrx";

/// The operator did not choose among several trees of bones, so the first is taken.
void TellOtherRoots(const FBXIO::VSkinSkeleton& i_rSkeleton)
{
	const std::vector<std::size_t> roots = RetargetSetup::RootBones(i_rSkeleton);
	if (roots.size() < 2)
		return;
	std::string names;
	for (const std::size_t root : roots)
		names += (names.empty() ? "" : "', '") + i_rSkeleton[root].m_Name;
	NVX_LOG(c_LogCategory, NVX::ELogWarning,
	    "The file has %1% root bones, and no root was chosen: only the first is taken, of '%2%'", roots.size(), names);
}

/// The place of the root is its bone's global matrix, which has the pre-rotation in it already.
void TellTwiceTurnedRoot(const FBXIO::VSkinBone& i_rRoot)
{
	const Rotation::VVector3 preRotation = RetargetSetup::MatrixToAngleAxis(i_rRoot.m_PreRotation);
	const auto isTurn = [](double i_Value) { return std::abs(i_Value) > 1e-6; };
	if (std::any_of(preRotation.begin(), preRotation.end(), isTurn))
		NVX_LOG(c_LogCategory, NVX::ELogWarning,
		    "Root bone '%1%' has a pre-rotation, which counts twice: the bind pose differs from the pose in the file",
		    i_rRoot.m_Name);
}

void TellNamesUsedTwice(const VSubjectParametrised& i_rSubject)
{
	std::map<std::string_view, std::size_t> uses;
	for (const VSubjectParametrised::VSegment& rSegment : i_rSubject.m_Segments)
		++uses[rSegment.m_Name];
	for (const auto& [name, count] : uses)
		if (count > 1)
			NVX_LOG(c_LogCategory, NVX::ELogWarning,
			    "%1% segments are named '%2%': when the file is read, all their targets come back on the first", count,
			    name);
}

/// Whoever loads the file is shown the source that it names.
void TellSourceOfSaved(const std::string& i_rNamed, const std::string& i_rShown)
{
	if (i_rNamed.empty())
		NVX_LOG(c_LogCategory, NVX::ELogWarning,
		    "The saved subject names no source skeleton: it was made before one was chosen");
	else if (i_rNamed != i_rShown)
		NVX_LOG(c_LogCategory, NVX::ELogWarning,
		    "The saved subject names source skeleton '%1%', and the one that is shown is '%2%'", i_rNamed, i_rShown);
}

/// Reads the file that is about to be written, in memory, and tells what would not come back.
/// @return false if it could not be read at all, so that it must not replace a file that can.
bool ReadsBack(const VSubjectRecord& i_rRecord, std::string i_Text, std::string& o_rReason)
{
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	VSubjectRecord read;
	CoreOrlexQRTIO::VSubjectQRTExtras extras;
	if (!CoreOrlexQRTIO::VReader().ReadText(std::move(i_Text), i_rRecord.m_SubjectParametrised.m_Name,
	        i_rRecord.m_SubjectParametrised.m_SubjectId, read.m_SubjectParametrised, read.m_SubjectApplicationData,
	        extras, errors, warnings))
	{
		o_rReason = "the file could not be read again" + (errors.empty() ? "" : ": " + errors.front());
		NVX_LOG(c_LogCategory, NVX::ELogError, "Nothing was saved, since %1%", o_rReason);
		return false;
	}
	const std::string difference = CoreOrlexQRTIO::FileDifference(i_rRecord, std::move(read));
	if (difference.empty())
		NVX_LOG(c_LogCategory, NVX::ELogInformation, "The file reads back equal to what is saved");
	else
		NVX_LOG(c_LogCategory, NVX::ELogWarning,
		    "The file does not hold all of the subject: it reads back different, first in %1%", difference);
	return true;
}

/// A quarter turn about Y or X; the identity for a file with Z up.
Rotation::VMatrix4 ToZUp(int i_UpAxis)
{
	Rotation::VMatrix4 matrix;
	if (i_UpAxis > 1)
		return matrix;
	const int from = i_UpAxis == 0 ? 0 : 1;
	matrix(from, from) = matrix(2, 2) = 0.0f;
	matrix(from, 2) = -1.0f;
	matrix(2, from) = 1.0f;
	return matrix;
}

} // namespace

bool VRetargetSetupCore::LoadTargetFBX(const boost::filesystem::path& i_rPath)
{
	FBXIO::FBXReader reader;
	const bool bLoaded = reader.LoadFile(UtilsFileSystem::ToUtf8(i_rPath));
	m_TargetFBXError = reader.GetError();
	if (!bLoaded)
		return false;
	m_bTargetFBXComplete = reader.IsComplete();
	reader.ReadBoneSkins();
	m_pFBXSkeleton = reader.GetSkeleton();
	if (!m_pFBXSkeleton || m_pFBXSkeleton->empty())
	{
		m_pFBXSkeleton = nullptr;
		if (m_TargetFBXError.empty())
			m_TargetFBXError = "It holds no skeleton";
		return false;
	}
	m_TargetName = RetargetSetup::FileStem(i_rPath);
	m_TargetFBXFile = RetargetSetup::ReadNow(i_rPath);
	m_bTargetRootChosen = false;
	m_TargetAxisMatrix = ToZUp(reader.GetUpAxis());
	return true;
}

void VRetargetSetupCore::CreateTargetSubject()
{
	constexpr const char* c_Command = "CreateTargetSubject";
	// The host's question may run events, in which another file is read.
	const std::shared_ptr<const FBXIO::VSkinSkeleton> pSkeleton = m_pFBXSkeleton;
	if (!pSkeleton)
		return CommandIgnored(c_Command, Ignored::c_NoFBX);
	VSubjectParametrised subject;
	VSubjectApplicationData applicationData;
	subject.m_Name = RetargetSetup::c_SubjectName;
	subject.m_SubjectId = RetargetSetup::c_SubjectId;
	applicationData.m_SubjectId = RetargetSetup::c_SubjectId;
	applicationData.m_Skin = m_TargetName;
	applicationData.m_RetargetSourceTemplate = m_SourceName;
	RetargetSetup::BuildTargetSubject(*pSkeleton, subject, applicationData, m_TargetRootIndex);
	RetargetSetup::SetGlobalScale(subject, m_Target.m_NextScale);
	if (subject.m_Segments.empty())
	{
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "The FBX skeleton has no bone %1% to begin with: nothing is made",
		    m_TargetRootIndex);
		return CommandIgnored(c_Command, Ignored::c_NoRootBone);
	}
	const FBXIO::VSkinBone& rRootBone = (*pSkeleton)[m_TargetRootIndex];
	const Rotation::VMatrix4 axis = m_TargetAxisMatrix;
	const Rotation::VMatrix4 world = axis * rRootBone.m_Global;
	const FBXIO::VSkinSkeleton bones = RetargetSetup::ExtractSubtree(*pSkeleton, m_TargetRootIndex);
	const bool bRootChosen = m_bTargetRootChosen;
	const bool bPoseFromFile = HostRules().m_bPoseFromFile;
	const double rootFactor = RootFactor(RetargetSetup::GetGlobalScale(subject));
	RetargetSetup::VBeginning beginning = RetargetSetup::MadeOf(
	    m_TargetFBXFile, *pSkeleton, m_TargetRootIndex, m_SourceName, m_Target.m_NextScale, bPoseFromFile);
	if (!MayReplaceTarget(c_Command, Steps::c_Create))
		return;
	if (!bRootChosen)
		TellOtherRoots(*pSkeleton);
	if (!bPoseFromFile)
		TellTwiceTurnedRoot(rRootBone);
	if (const auto pBefore = TargetValues().m_pApplicationData;
	    pBefore && pBefore->m_Skin != m_TargetName && m_Target.m_NextScale != 1.0)
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "'%1%' is made with the scale %2%, which was that of '%3%'",
		    m_TargetName, m_Target.m_NextScale, pBefore->m_Skin);

	const std::optional<Rotation::VVector3> rotation = RetargetSetup::RotationOf(world);
	if (!rotation && !bPoseFromFile)
		NVX_LOG(c_LogCategory, NVX::ELogWarning,
		    "The place of root bone '%1%' is no rotation (negative or sheared scale): it is lost and counts as none",
		    rRootBone.m_Name);
	VSubjectParametrised::VJoint& rJoint = subject.m_Segments.front().m_Joint;
	rJoint.m_BindPose.assign(6, 0.0);
	if (rotation)
		std::copy(rotation->begin(), rotation->end(), rJoint.m_BindPose.begin());
	for (int row = 0; row < 3; ++row)
		rJoint.m_BindPose[3 + std::size_t(row)] = double(world(row, 3));
	rJoint.m_Mean = rJoint.m_BindPose;
	if (bPoseFromFile)
		RetargetSetup::MatchFilePoseAndTell(subject, bones, axis, rootFactor);
	else if (rootFactor != 1.0)
		RetargetSetup::ScaleRootHeight(subject, rootFactor);
	if (!ScaleRootHeight())
		RetargetSetup::TellLowestSegment(subject);
	const VStep step(*this, {Steps::c_Create});
	if (!SetTargetSubject(std::move(subject), std::move(applicationData)))
		return CommandIgnored(c_Command, Ignored::c_HostRefused);
	m_Target.m_pFile = NewFile();
	m_Target.m_pFile->m_Made = TargetValues();
	BeginSession(std::move(beginning));
	UnsavedChangesChanged();
	TargetSubjectCreated();
}

void VRetargetSetupCore::NewTargetSubject()
{
	constexpr const char* c_Command = "NewTargetSubject";
	if (!TargetValues().m_pParametrised)
		return CommandIgnored(c_Command, Ignored::c_NoTarget);
	if (!MayReplaceTarget(c_Command, Steps::c_New))
		return;
	const VStep step(*this, {Steps::c_New});
	VTargetState none;
	none.m_pFile = NewFile();
	none.m_NextScale = m_Target.m_NextScale;
	none.m_bScaleRootHeight = m_Target.m_bScaleRootHeight;
	m_Target = std::move(none);
	Publish();
	UnsavedChangesChanged();
}

bool VRetargetSetupCore::LoadSourceSubject(const boost::filesystem::path& i_rPath, const std::string& i_rSkinName)
{
	VSubjectParametrised subject;
	VSubjectApplicationData applicationData;
	CoreOrlexQRTIO::VSubjectQRTExtras extras;
	if (!CoreOrlexQRTIO::VReader(HostRules().m_bOwnFormsAreDetails)
	         .Read(i_rPath, RetargetSetup::c_SubjectName, RetargetSetup::c_SubjectId, subject, applicationData, extras))
		return false;
	applicationData.m_Skin = i_rSkinName;
	if (RetargetSetup::LacksBindPose(subject))
	{
		RetargetSetup::ApplyDefaultPose(subject);
		RetargetSetup::AdoptTPoseAsBindPose(subject);
	}
	std::string sourceName = std::exchange(m_SourceName, RetargetSetup::FileStem(i_rPath));
	if (Replace(m_SourceItems, std::make_shared<const VSubjectParametrised>(std::move(subject)),
	        std::make_shared<const VSubjectApplicationData>(std::move(applicationData))))
	{
		m_ShownSourceName = m_SourceName;
		m_SourceFile = RetargetSetup::ReadNow(i_rPath);
		return true;
	}
	m_SourceName = std::move(sourceName);
	return false;
}

std::uint32_t VRetargetSetupCore::LoadTargetSubject(const boost::filesystem::path& i_rPath)
{
	CoreOrlexTypes::VSubjectRecord record;
	VSubjectParametrised& rSubject = record.m_SubjectParametrised;
	VSubjectApplicationData& rApplicationData = record.m_SubjectApplicationData;
	CoreOrlexQRTIO::VSubjectQRTExtras extras;
	if (RetargetSetup::FileExtension(i_rPath) == c_LegacyExtension)
	{
		if (const std::uint32_t status = RetargetSetup::ReadLegacyFile(i_rPath, record))
			return status;
	}
	else if (!CoreOrlexQRTIO::VReader(HostRules().m_bOwnFormsAreDetails)
	              .Read(i_rPath, RetargetSetup::c_SubjectName, RetargetSetup::c_SubjectId, rSubject, rApplicationData,
	                  extras))
		return NVX::Status::c_Failure;
	if (RetargetSetup::LacksBindPose(rSubject))
		RetargetSetup::AdoptTPoseAsBindPose(rSubject);
	std::string sourceName = rApplicationData.m_RetargetSourceTemplate;
	const VStep step(*this, {.m_pName = Steps::c_Load, .m_bNamesSource = true});
	if (!ReplaceTargetItems(std::move(rSubject),
	        std::make_shared<const VSubjectApplicationData>(std::move(rApplicationData)), NewIdentities()))
		return NVX::Status::c_Failure;
	TakeExtras(std::move(extras));
	m_SourceName = std::move(sourceName);
	m_Target.m_AtRest = TargetValues();
	m_Target.m_pFile = NewFile();
	RememberTargetFile(i_rPath, TargetValues());
	BeginSession({.m_Subject = i_rPath, .m_Digest = m_Target.m_pFile->m_Digest});
	UnsavedChangesChanged();
	return NVX::Status::c_Success;
}

std::uint32_t VRetargetSetupCore::SaveTargetSubject(const boost::filesystem::path& i_rPath)
{
	std::string reason;
	return Save(i_rPath, reason);
}

std::uint32_t VRetargetSetupCore::Save(const boost::filesystem::path& i_rPath, std::string& o_rReason)
{
	const VSubjectValues target = TargetValues();
	if (!target.m_pParametrised || !target.m_pApplicationData)
		return NVX::Status::c_NothingToActOn;
	TellNamesUsedTwice(*target.m_pParametrised);
	std::vector<std::string> errors;
	const std::uint32_t status = CoreOrlexQRTIO::VWriter().Write(i_rPath, *target.m_pParametrised,
	    *target.m_pApplicationData, GetTargetExtras(), CoreOrlexQRTIO::c_AutomaticVersion, &errors,
	    [&](const std::string& i_rText) {
		    return ReadsBack({*target.m_pParametrised, *target.m_pApplicationData}, i_rText, o_rReason);
	    });
	for (const std::string& rError : errors)
	{
		NVX_LOG("QRTIO", NVX::ELogError, "%1%", rError);
		o_rReason = rError;
	}
	if (status == NVX::Status::c_Success)
	{
		RememberTargetFile(i_rPath, target);
		UnsavedChangesChanged();
	}
	return status;
}

bool VRetargetSetupCore::WriteCopy(const boost::filesystem::path& i_rPath, std::string& o_rReason) const
{
	const VSubjectValues target = TargetValues();
	std::string text;
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	if (!target.m_pParametrised || !target.m_pApplicationData)
		o_rReason = Ignored::c_NoTarget;
	else if (!CoreOrlexQRTIO::VWriter().WriteText(*target.m_pParametrised, *target.m_pApplicationData,
	             GetTargetExtras(), CoreOrlexQRTIO::c_AutomaticVersion, text, errors, warnings))
		o_rReason = errors.empty() ? std::string() : errors.front();
	else
		return UtilsFileSystem::SaveFile(i_rPath, text, o_rReason) == NVX::Status::c_Success;
	return false;
}

bool VRetargetSetupCore::SavePreset(const boost::filesystem::path& i_rPath, std::string& o_rReason) const
{
	const VSubjectValues target = TargetValues();
	std::vector<std::string> leftOut;
	SetupIO::VSetup preset;
	if (target.m_pParametrised && target.m_pApplicationData)
		preset = RetargetSetup::PresetOf(*target.m_pParametrised, *target.m_pApplicationData, leftOut);
	for (const std::string& rSentence : leftOut)
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "%1%", rSentence);
	if (preset.m_Pairs.empty())
		o_rReason = target.m_pParametrised ? Ignored::c_NoPairs : Ignored::c_NoTarget;
	else
		return UtilsFileSystem::SaveFile(i_rPath, SetupIO::WriteSetup(preset), o_rReason) == NVX::Status::c_Success;
	return false;
}

std::uint32_t VRetargetSetupCore::RestoreTargetSubject(
    const boost::filesystem::path& i_rCopy, const boost::filesystem::path& i_rFile)
{
	if (const std::uint32_t status = LoadTargetSubject(i_rCopy))
		return status;
	// Nothing to go back to: what is there now is what was left.
	if (m_History)
		m_History->Clear();
	RememberTargetFile(i_rFile, {});
	std::optional<std::string>& rDigest = m_Target.m_pFile->m_Digest;
	boost::system::error_code error;
	const std::time_t written = boost::filesystem::last_write_time(i_rFile, error);
	if (!error && rDigest && written > boost::filesystem::last_write_time(i_rCopy, error))
		rDigest->clear(); // of no file
	UnsavedChangesChanged();
	return NVX::Status::c_Success;
}

bool VRetargetSetupCore::TargetDiffersFrom(const VSubjectValues& i_rKept) const
{
	const VSubjectValues target = TargetValues();
	return target.m_pParametrised && RetargetSetup::Differ(target, i_rKept);
}

void VRetargetSetupCore::RememberTargetFile(const boost::filesystem::path& i_rPath, VSubjectValues i_Saved)
{
	VTargetFile& rFile = *m_Target.m_pFile;
	rFile.m_Path = i_rPath;
	rFile.m_Digest = DigestOf(i_rPath);
	rFile.m_Saved = std::move(i_Saved);
	// Another subject may be of it, too.
	for (const auto& rpOther : m_Files)
		if (const auto pOther = rpOther.lock(); pOther && pOther != m_Target.m_pFile && pOther->m_Path == i_rPath)
		{
			pOther->m_Digest = rFile.m_Digest;
			pOther->m_Saved = rFile.m_Saved;
		}
}

bool VRetargetSetupCore::MayOverwrite(const boost::filesystem::path& i_rPath) const
{
	const VTargetFile& rFile = *m_Target.m_pFile;
	if (!m_pHostRules || i_rPath != rFile.m_Path || !rFile.m_Digest)
		return true;
	const std::optional<std::string> now = DigestOf(i_rPath);
	return !now || now == rFile.m_Digest || m_pHostRules->MayOverwriteChangedFile(UtilsFileSystem::ToUtf8(i_rPath));
}

bool VRetargetSetupCore::HasUnsavedChanges() const
{
	return TargetDiffersFrom(m_Target.m_pFile->m_Saved);
}

bool VRetargetSetupCore::LoadTargetSubjectBy(const char* i_pCommand, const boost::filesystem::path& i_rPath)
{
	if (!MayReplaceTarget(i_pCommand, Steps::c_Load))
		return false;
	const char* pReason = Ignored::c_NotRead;
	switch (LoadTargetSubject(i_rPath))
	{
	case NVX::Status::c_Success: return true;
	case NVX::Status::c_FileNotOpened: pReason = Ignored::c_NotOpened; break;
	case NVX::Status::c_NewerFileVersion: pReason = Ignored::c_LaterVersion; break;
	default: break;
	}
	CommandIgnored(i_pCommand, Ignored::Text(pReason, UtilsFileSystem::ToUtf8(i_rPath)));
	return false;
}

bool VRetargetSetupCore::SaveTargetSubjectBy(const char* i_pCommand, const boost::filesystem::path& i_rPath)
{
	const std::string path = UtilsFileSystem::ToUtf8(i_rPath);
	const auto ignore = [&](const std::string& i_rReason)
	{
		CommandIgnored(i_pCommand, i_rReason);
		return false;
	};
	if (RetargetSetup::FileExtension(i_rPath) == c_LegacyExtension)
		return ignore(Ignored::Text(Ignored::c_LegacyOnlyRead, path));
	if (!MayOverwrite(i_rPath))
		return ignore(Ignored::Text(Ignored::c_FileKept, path));
	if (const auto pApplicationData = TargetValues().m_pApplicationData)
		TellSourceOfSaved(pApplicationData->m_RetargetSourceTemplate, m_ShownSourceName);
	std::string reason;
	switch (Save(i_rPath, reason))
	{
	case NVX::Status::c_Success: return true;
	case NVX::Status::c_NothingToActOn: return ignore(Ignored::c_NoTarget);
	default: return ignore(Ignored::Text(Ignored::c_NotSaved, path, reason));
	}
}
