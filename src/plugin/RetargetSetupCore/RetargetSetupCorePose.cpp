// The operations of VRetargetSetupCore that hold the target subject against the pose in its FBX file.

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/FilePose.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/RetargetSetupCore.h"
#include "RetargetSetupCore/RootHeight.h"
#include "RetargetSetupCore/SessionSteps.h"
#include "RetargetSetupCore/StepNames.h"
#include "UtilsFileSystem/Paths.h"

#include <boost/format.hpp>

#include <algorithm>
#include <cmath>
#include <locale>
#include <numbers>
#include <span>
#include <utility>

using CoreOrlexTypes::VSubjectParametrised;
using RetargetSetup::c_LogCategory;
namespace Ignored = RetargetSetup::Ignored;

FBXIO::VSkinSkeleton VRetargetSetupCore::BonesOfTarget() const
{
	const VSubjectValues target = TargetValues();
	if (!m_pFBXSkeleton || !target.m_pParametrised || !target.m_pApplicationData
	    || target.m_pApplicationData->m_Skin != m_TargetName)
		return {};
	return RetargetSetup::BonesOfSegments(*target.m_pParametrised, *m_pFBXSkeleton, m_TargetRootIndex);
}

SetupProposal::VRestSkeleton VRetargetSetupCore::TargetSkeleton() const
{
	const VSubjectValues target = TargetValues();
	if (!target.m_pParametrised)
		return {};
	return RetargetSetup::RestOf(*target.m_pParametrised, *target.m_pSubject, BonesOfTarget());
}

std::optional<RetargetSetup::VPoseDifference> VRetargetSetupCore::DifferenceFromFile() const
{
	const FBXIO::VSkinSkeleton bones = BonesOfTarget();
	if (bones.empty())
		return std::nullopt;
	return RetargetSetup::DifferenceFromFile(
	    *TargetValues().m_pParametrised, bones, m_TargetAxisMatrix, RootFactor(GetTargetScale()));
}

std::optional<VSubjectParametrised> VRetargetSetupCore::InFilePose(const char*& o_rpReason) const
{
	const VSubjectValues target = TargetValues();
	const FBXIO::VSkinSkeleton bones = BonesOfTarget();
	o_rpReason = !target.m_pParametrised || !target.m_pApplicationData ? Ignored::c_NoTarget
	    : !m_pFBXSkeleton                                              ? Ignored::c_NoFBX
	    : bones.empty()                                                ? Ignored::c_NotItsFBX
	    : !RetargetSetup::HoldsFilePose(*target.m_pParametrised)       ? Ignored::c_OwnJoints
	                                                                   : nullptr;
	if (o_rpReason)
		return std::nullopt;
	VSubjectParametrised subject = *target.m_pParametrised;
	RetargetSetup::MatchFilePoseAndTell(subject, bones, m_TargetAxisMatrix, RootFactor(GetTargetScale()));
	return subject;
}

void VRetargetSetupCore::MatchFilePose()
{
	constexpr const char* c_Command = "MatchFilePose";
	const char* pReason = nullptr;
	std::optional<VSubjectParametrised> subject = InFilePose(pReason);
	if (!subject)
		return CommandIgnored(c_Command, pReason);
	const VStep step(*this,
	    RetargetSetup::EditAs(RetargetSetup::Steps::c_MatchFilePose, RetargetSetup::c_FbxPoseCommand,
	        UtilsFileSystem::ToUtf8(m_TargetFBXFile.m_Path)));
	if (ReplaceTarget(c_Command, std::move(*subject), TargetValues().m_pApplicationData, m_Target.m_Identities))
		m_Target.m_AtRest = TargetValues();
}

bool VRetargetSetupCore::StandsAsMade() const
{
	const auto pNow = TargetValues().m_pParametrised;
	const auto pAtRest = TargetAtRest().m_pParametrised;
	// A scale moves what is free along, and turns nothing.
	const auto turn = [](const VSubjectParametrised::VSegment& i_rSegment)
	{
		constexpr std::size_t c_Turn = 3;
		const std::vector<double>& rPose = i_rSegment.m_Joint.m_BindPose;
		return std::span(rPose).first(std::min(rPose.size(), c_Turn));
	};
	return pNow && pAtRest
	    && std::ranges::equal(pNow->m_Segments, pAtRest->m_Segments,
	        [&](const VSubjectParametrised::VSegment& i_rNow, const VSubjectParametrised::VSegment& i_rThen)
	        {
		        return i_rNow.m_Joint.m_JointType == VSubjectParametrised::VJoint::EDummy
		            || std::ranges::equal(turn(i_rNow), turn(i_rThen));
	        });
}

bool VRetargetSetupCore::AlignsFromFilePose() const
{
	return StandsAsMade() && DifferenceFromFile() && RetargetSetup::HoldsFilePose(*TargetValues().m_pParametrised);
}

std::optional<VRetargetSetupCore::VAlignedEdit> VRetargetSetupCore::Aligned(
    const RetargetSetup::VAlignmentChoice& i_rChoice)
{
	constexpr const char* c_Command = "AlignToSource";
	const std::optional<VBothPosed> both = BothPosed(c_Command);
	if (!both)
		return std::nullopt;
	const VSubjectValues& source = both->m_Source;
	VSubjectValues target = both->m_Target;
	const FBXIO::VSkinSkeleton bones = i_rChoice.m_bOnJoints ? FBXIO::VSkinSkeleton() : BonesOfTarget();
	RetargetSetup::VEdit edit = RetargetSetup::AlignmentEdit(i_rChoice, *target.m_pParametrised);
	if (!i_rChoice.m_bAsItStands && AlignsFromFilePose())
	{
		NVX_LOG(c_LogCategory, NVX::ELogInformation, "Aligning begins with the pose of the FBX file");
		const char* pReason = nullptr;
		auto pPosed = std::make_shared<const VSubjectParametrised>(InFilePose(pReason).value());
		auto pConverted = std::make_shared<CoreOrlexTypes::VSubject>();
		CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(*pPosed, *pConverted);
		target.m_pParametrised = std::move(pPosed);
		target.m_pSubject = std::move(pConverted);
		edit.m_Commands.insert(edit.m_Commands.begin(),
		    {RetargetSetup::c_FbxPoseCommand, UtilsFileSystem::ToUtf8(m_TargetFBXFile.m_Path), {}, {}});
	}
	else
	{
		if (StandsAsMade())
			edit.m_Commands.insert(edit.m_Commands.begin(), {RetargetSetup::c_AsItStandsCommand, {}, {}, {}});
		edit.m_Commands.insert(edit.m_Commands.begin(),
		    bones.empty() ? SetupIO::VEdit{RetargetSetup::c_OnJointsCommand, {}, {}, {}}
		                  : SetupIO::VEdit{
		                      RetargetSetup::c_SkinCommand, UtilsFileSystem::ToUtf8(m_TargetFBXFile.m_Path), {}, {}});
	}
	std::string reason;
	auto aligned = RetargetSetup::AlignToSource(*source.m_pParametrised, *source.m_pSubject, *target.m_pParametrised,
	    *target.m_pSubject, bones, i_rChoice, reason);
	if (!aligned)
	{
		CommandIgnored(c_Command, reason);
		return std::nullopt;
	}
	return VAlignedEdit{std::move(*aligned), std::move(edit)};
}

std::optional<RetargetSetup::VAlignedToSource> VRetargetSetupCore::AlignToSource(
    const RetargetSetup::VAlignmentChoice& i_rChoice, std::uint64_t i_Way)
{
	auto made = Aligned(i_rChoice);
	if (!made)
		return std::nullopt;
	RetargetSetup::VAlignedToSource told;
	const VSubjectValues source = SourceValues();
	const VSubjectParametrised& rAligned = made->m_Aligned.m_Subject;
	CoreOrlexTypes::VSubject converted;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(rAligned, converted);
	told.m_Scale = RetargetSetup::ScaleFinding(*source.m_pParametrised, *source.m_pSubject, rAligned, converted);
	const double scale = told.m_Scale ? GetTargetScale() * SetupProposal::SuggestedScale(*told.m_Scale) : 0.0;
	told.m_bScaled = i_rChoice.m_bFitScale && told.m_Scale && !told.m_Scale->m_bFine
	    && RetargetSetup::IsUsableScale(scale) && RetargetSetup::LostParameters(rAligned).empty();
	RunStep({RetargetSetup::Steps::c_Align, i_Way},
	    [&]
	    {
		    if (told.m_bScaled)
		    {
			    SetScaleRootHeight(true);
			    SetTargetScale(scale);
			    made = Aligned(i_rChoice);
		    }
		    if (made)
			    SetTargetSubjectParametrised(std::move(made->m_Aligned.m_Subject), made->m_Edit);
	    });
	if (!made)
		return std::nullopt;
	told.m_Alignment = std::move(made->m_Aligned.m_Alignment);
	return told;
}

VRetargetSetupCore::VPosedTarget VRetargetSetupCore::PosedTarget() const
{
	return {TargetValues().m_pParametrised, m_Target.m_NextScale, m_Target.m_bScaleRootHeight};
}

void VRetargetSetupCore::Restore(const VPosedTarget& i_rBefore, const RetargetSetup::VEdit& i_rEdit)
{
	const VStep step(*this, i_rEdit);
	const bool bScaleRootHeight = std::exchange(m_Target.m_bScaleRootHeight, i_rBefore.m_bScaleRootHeight);
	m_Target.m_NextScale = i_rBefore.m_NextScale;
	SetTargetSubjectParametrised(*i_rBefore.m_pSubject);
	if (bScaleRootHeight != i_rBefore.m_bScaleRootHeight)
		ScaleRootHeightChanged();
}

void VRetargetSetupCore::SetScaleRootHeight(bool i_bScale)
{
	if (i_bScale == ScaleRootHeight())
		return;
	std::optional<VStep> step;
	if (TargetValues().m_pParametrised)
		step.emplace(*this,
		    RetargetSetup::EditAs(
		        RetargetSetup::Steps::c_ScaleRootHeight, "switch-root-height", i_bScale ? "scale" : "keep"));
	const double scale = GetTargetScale();
	const double before = RootFactor(scale);
	m_Target.m_bScaleRootHeight = i_bScale;
	ScaleRootHeightChanged();
	const auto pTarget = TargetValues().m_pParametrised;
	if (!pTarget || scale == 1.0)
		return;
	VSubjectParametrised subject = *pTarget;
	RetargetSetup::ScaleRootHeight(subject, RootFactor(scale) / before);
	if (!i_bScale)
		RetargetSetup::TellLowestSegment(subject);
	SetTargetSubjectParametrised(std::move(subject));
}

void VRetargetSetupCore::UpdatePoseNote()
{
	const VSubjectValues target = TargetValues();
	std::string note;
	if (m_pFBXSkeleton && target.m_pParametrised && target.m_pApplicationData
	    && target.m_pApplicationData->m_Skin == m_TargetName)
		if (const auto turned =
		        RetargetSetup::FindTurnedRoot(*target.m_pParametrised, *m_pFBXSkeleton, m_TargetAxisMatrix))
			note = (boost::format("The character stands turned by %1% degrees against its FBX file: the pre-rotation "
			                      "of its root bone '%2%' counts twice.",
			            std::locale::classic())
			    % std::lround(turned->m_Angle * 180.0 / std::numbers::pi) % turned->m_BoneName)
			           .str();
	if (note == m_PoseNote)
		return;
	m_PoseNote = note;
	PoseNoteChanged();
}
