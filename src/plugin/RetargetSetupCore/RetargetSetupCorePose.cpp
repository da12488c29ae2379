// The operations of VRetargetSetupCore that hold the target subject against the pose in its FBX file.

#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/FilePose.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/RetargetSetupCore.h"
#include "RetargetSetupCore/RootHeight.h"
#include "RetargetSetupCore/StepNames.h"

#include <boost/format.hpp>

#include <cmath>
#include <locale>
#include <numbers>

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

void VRetargetSetupCore::MatchFilePose()
{
	constexpr const char* c_Command = "MatchFilePose";
	const VSubjectValues target = TargetValues();
	if (!target.m_pParametrised || !target.m_pApplicationData)
		return CommandIgnored(c_Command, Ignored::c_NoTarget);
	if (!m_pFBXSkeleton)
		return CommandIgnored(c_Command, Ignored::c_NoFBX);
	const FBXIO::VSkinSkeleton bones = BonesOfTarget();
	if (bones.empty())
		return CommandIgnored(c_Command, Ignored::c_NotItsFBX);
	if (!RetargetSetup::HoldsFilePose(*target.m_pParametrised))
		return CommandIgnored(c_Command, Ignored::c_OwnJoints);
	VSubjectParametrised subject = *target.m_pParametrised;
	RetargetSetup::MatchFilePoseAndTell(subject, bones, m_TargetAxisMatrix, RootFactor(GetTargetScale()));
	const VStep step(*this, {RetargetSetup::Steps::c_MatchFilePose});
	if (ReplaceTarget(c_Command, std::move(subject), target.m_pApplicationData, m_Target.m_Identities))
		m_Target.m_AtRest = TargetValues();
}

void VRetargetSetupCore::SetScaleRootHeight(bool i_bScale)
{
	if (i_bScale == ScaleRootHeight())
		return;
	std::optional<VStep> step;
	if (TargetValues().m_pParametrised)
		step.emplace(*this, RetargetSetup::VEdit{RetargetSetup::Steps::c_ScaleRootHeight});
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
