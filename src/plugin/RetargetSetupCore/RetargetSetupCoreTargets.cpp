// The commands of VRetargetSetupCore that edit targets and joints.

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/Joints.h"
#include "RetargetSetupCore/Partner.h"
#include "RetargetSetupCore/RestSkeletons.h"
#include "RetargetSetupCore/RetargetSetupCore.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupCore/SessionSteps.h"
#include "RetargetSetupCore/StepNames.h"

#include <cmath>
#include <numbers>

using ComputeSubject::VComputeSubjectFK;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using RetargetSetup::c_LogCategory;
namespace Ignored = RetargetSetup::Ignored;
namespace Steps = RetargetSetup::Steps;

namespace
{

bool IsWhole(const VRetargetSetupCore::VSubjectValues& i_rValues)
{
	return i_rValues.m_pParametrised && i_rValues.m_pApplicationData && i_rValues.m_pSubject;
}

/// The subject must be whole.
std::unique_ptr<VComputeSubjectFK> TargetKinematics(const VRetargetSetupCore::VSubjectValues& i_rTarget)
{
	return RetargetSetup::KinematicsInBindPose(*i_rTarget.m_pParametrised, *i_rTarget.m_pSubject, "target");
}

void TellNoPartner(const VSubjectParametrised& i_rSubject, std::size_t i_SegmentIndex, const char* i_pWhich)
{
	NVX_LOG(c_LogCategory, NVX::ELogWarning,
	    "Segment '%1%' of the %2% subject has no partner on the other side: no mirrored target is added",
	    i_rSubject.m_Segments[i_SegmentIndex].m_Name, i_pWhich);
}

void TellChangedPose(const VComputeSubjectFK& i_rBefore, const VSubjectParametrised& i_rAfter)
{
	VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rAfter, subject);
	const auto pAfter = RetargetSetup::KinematicsInBindPose(i_rAfter, subject, "target");
	if (!pAfter)
		return;
	const auto worst = RetargetSetup::WorstPoseDifference(
	    RetargetSetup::SegmentPoses(i_rBefore), RetargetSetup::SegmentPoses(*pAfter));
	if (worst)
		NVX_LOG(c_LogCategory, NVX::ELogWarning,
		    "Removing joints changed the bind pose: segment '%1%' most, by %2$.1f mm and %3$.2f degrees",
		    i_rAfter.m_Segments[worst->m_SegmentIndex].m_Name, worst->m_Distance,
		    worst->m_Angle * 180.0 / std::numbers::pi);
}

} // namespace

const VComputeSubjectFK* VRetargetSetupCore::SourceKinematics()
{
	const VSubjectValues source = SourceValues();
	if (source.m_pSubject != m_pSubjectOfSourceFK)
	{
		m_pSourceFK.reset();
		m_pSubjectOfSourceFK.reset();
	}
	if (!m_pSourceFK && source.m_pParametrised && source.m_pSubject)
	{
		m_pSourceFK = RetargetSetup::KinematicsInBindPose(*source.m_pParametrised, *source.m_pSubject, "source");
		m_pSubjectOfSourceFK = source.m_pSubject;
	}
	return m_pSourceFK.get();
}

std::int32_t VRetargetSetupCore::PartnerOf(const VSubjectValues& i_rValues, std::size_t i_SegmentIndex) const
{
	if (!i_rValues.m_pParametrised || !i_rValues.m_pSubject
	    || i_SegmentIndex >= i_rValues.m_pSubject->m_Segments.size())
		return -1;
	return HostRules().m_bPartnersBySides
	    ? RetargetSetup::FindPartner(*i_rValues.m_pParametrised, *i_rValues.m_pSubject, i_SegmentIndex)
	    : RetargetSetup::FindMirrorSegment(*i_rValues.m_pParametrised, i_SegmentIndex);
}

std::optional<VRetargetSetupCore::VBothPosed> VRetargetSetupCore::BothPosed(const char* i_pCommand)
{
	VBothPosed both{SourceValues(), TargetValues(), nullptr, nullptr};
	const auto ignore = [&](const char* i_pReason)
	{
		CommandIgnored(i_pCommand, i_pReason);
		return std::nullopt;
	};
	if (!both.m_Source.m_pParametrised)
		return ignore(Ignored::c_NoSource);
	if (!IsWhole(both.m_Target))
		return ignore(Ignored::c_NoTarget);
	both.m_pSourceFK = SourceKinematics();
	if (!both.m_pSourceFK)
		return ignore(Ignored::c_SourceNoTree);
	both.m_pTargetFK = TargetKinematics(both.m_Target);
	if (!both.m_pTargetFK)
		return ignore(Ignored::c_TargetNoTree);
	return both;
}

void VRetargetSetupCore::AddTarget(
    int i_SourceSegmentIndex, int i_TargetSegmentIndex, bool i_bPosition, bool i_bSymmetry)
{
	constexpr const char* c_Command = "AddTarget";
	const std::optional<VBothPosed> both = BothPosed(c_Command);
	if (!both)
		return;
	const VSubjectValues& source = both->m_Source;
	const VSubjectValues& target = both->m_Target;
	const auto sourceIndex = std::uint32_t(i_SourceSegmentIndex);
	const auto targetIndex = std::uint32_t(i_TargetSegmentIndex);
	if (sourceIndex >= source.m_pParametrised->m_Segments.size())
		return CommandIgnored(c_Command, Ignored::c_NoSourceSegment);
	if (targetIndex >= target.m_pParametrised->m_Segments.size())
		return CommandIgnored(c_Command, Ignored::c_NoTargetSegment);

	VSubjectParametrised subject = *target.m_pParametrised;
	VSubjectApplicationData applicationData = *target.m_pApplicationData;
	const bool bOnce = HostRules().m_bEachPairOnce;
	std::vector<std::int32_t> found;
	const auto addPair = [&](std::size_t i_Source, std::size_t i_Target)
	{
		const std::int32_t there = bOnce ? RetargetSetup::FindTargetPair(*target.m_pParametrised,
		                               source.m_pParametrised->m_Segments[i_Source].m_Name, i_Target, i_bPosition)
		                                 : -1;
		if (there != -1)
			return found.push_back(there);
		RetargetSetup::AddTargetPair(*both->m_pSourceFK, *both->m_pTargetFK, i_Source, i_Target, i_bPosition,
		    *source.m_pParametrised, subject, applicationData);
	};
	addPair(sourceIndex, targetIndex);
	if (i_bSymmetry)
	{
		const std::int32_t sourceMirror = PartnerOf(source, sourceIndex);
		const std::int32_t targetMirror = PartnerOf(target, targetIndex);
		if (sourceMirror == -1)
			TellNoPartner(*source.m_pParametrised, sourceIndex, "source");
		if (targetMirror == -1)
			TellNoPartner(subject, targetIndex, "target");
		if (sourceMirror != -1 && targetMirror != -1)
			addPair(std::size_t(sourceMirror), std::size_t(targetMirror));
	}
	const auto nameOf = [&applicationData](std::int32_t i_Index) -> std::string
	{
		const auto& rTargets = applicationData.m_Targets;
		return std::size_t(i_Index) < rTargets.size() ? rTargets[std::size_t(i_Index)].m_Name : "";
	};
	if (subject.m_Targets.size() == target.m_pParametrised->m_Targets.size())
	{
		CommandIgnored(c_Command, Ignored::Text(Ignored::c_PairIsThere, nameOf(found.front())));
		TargetFound(found.front());
		return;
	}
	for (const std::int32_t index : found)
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "There is a target '%1%' already: only the other side is added",
		    nameOf(index));
	const VStep step(*this, {Steps::c_AddTarget});
	ReplaceTarget(c_Command, std::move(subject),
	    std::make_shared<const VSubjectApplicationData>(std::move(applicationData)), m_Target.m_Identities);
}

void VRetargetSetupCore::AddTargets(const std::vector<RetargetSetup::VNewTarget>& i_rTargets)
{
	constexpr const char* c_Command = "AddTargets";
	const std::optional<VBothPosed> both = BothPosed(c_Command);
	if (!both)
		return;
	const VSubjectValues& source = both->m_Source;
	const VSubjectValues& target = both->m_Target;
	VSubjectParametrised subject = *target.m_pParametrised;
	VSubjectApplicationData applicationData = *target.m_pApplicationData;
	for (const RetargetSetup::VNewTarget& rNew : i_rTargets)
	{
		if (rNew.m_Source >= source.m_pParametrised->m_Segments.size())
			return CommandIgnored(c_Command, Ignored::c_NoSourceSegment);
		if (rNew.m_Target >= subject.m_Segments.size())
			return CommandIgnored(c_Command, Ignored::c_NoTargetSegment);
		if (RetargetSetup::FindTargetPair(
		        subject, source.m_pParametrised->m_Segments[rNew.m_Source].m_Name, rNew.m_Target, rNew.m_bPosition)
		    != -1)
			continue;
		RetargetSetup::AddTargetPair(*both->m_pSourceFK, *both->m_pTargetFK, rNew.m_Source, rNew.m_Target,
		    rNew.m_bPosition, *source.m_pParametrised, subject, applicationData);
		subject.m_Targets.back().m_Weight = rNew.m_Weight;
	}
	if (subject.m_Targets.size() == target.m_pParametrised->m_Targets.size())
		return CommandIgnored(c_Command, Ignored::c_PairsAreThere);
	const VStep step(*this, {Steps::c_ProposeTargets});
	ReplaceTarget(c_Command, std::move(subject),
	    std::make_shared<const VSubjectApplicationData>(std::move(applicationData)), m_Target.m_Identities);
}

std::optional<SetupProposal::VProposal> VRetargetSetupCore::ProposeTargets(double i_LeastScore)
{
	const std::optional<VBothPosed> both = BothPosed("ProposeTargets");
	if (!both)
		return std::nullopt;
	return SetupProposal::Propose(RetargetSetup::RestOf(*both->m_Source.m_pParametrised, *both->m_Source.m_pSubject),
	    TargetSkeleton(), i_LeastScore);
}

void VRetargetSetupCore::RemoveTarget(int i_TargetIndex)
{
	constexpr const char* c_Command = "RemoveTarget";
	VSubjectParametrised subject;
	VSubjectApplicationData applicationData;
	if (!GetTargetSubjectAndData(subject, applicationData))
		return CommandIgnored(c_Command, Ignored::c_NoTarget);
	if (std::uint32_t(i_TargetIndex) >= subject.m_Targets.size())
		return CommandIgnored(c_Command, Ignored::c_NoSelectedTarget);
	RetargetSetup::RemoveTarget(subject, applicationData, std::uint32_t(i_TargetIndex));
	VIdentities identities = m_Target.m_Identities;
	const VStep step(
	    *this, RetargetSetup::EditAs(Steps::c_RemoveTarget, "remove-target", std::to_string(i_TargetIndex)));
	identities.m_Targets.erase(identities.m_Targets.begin() + i_TargetIndex);
	ReplaceTarget(c_Command, std::move(subject),
	    std::make_shared<const VSubjectApplicationData>(std::move(applicationData)), std::move(identities));
}

void VRetargetSetupCore::UpdateTargets()
{
	constexpr const char* c_Command = "UpdateTargets";
	const std::optional<VBothPosed> both = BothPosed(c_Command);
	if (!both)
		return;
	const VSubjectValues& source = both->m_Source;
	const VSubjectValues& target = both->m_Target;
	VSubjectParametrised subject = *target.m_pParametrised;
	RetargetSetup::UpdateTargetStates(*both->m_pSourceFK, *both->m_pTargetFK, *source.m_pParametrised, subject);
	const VStep step(*this, RetargetSetup::EditAs(Steps::c_UpdateTargets, "update-targets"));
	ReplaceTarget(c_Command, std::move(subject), target.m_pApplicationData, m_Target.m_Identities);
}

void VRetargetSetupCore::CreateAllJoints()
{
	constexpr const char* c_Command = "CreateAllJoints";
	const VSubjectValues target = TargetValues();
	if (!IsWhole(target))
		return CommandIgnored(c_Command, Ignored::c_NoTarget);
	VSubjectParametrised subject = *target.m_pParametrised;
	CoreOrlexQRTIO::VSubjectQRTExtras extras = GetTargetExtras();
	RetargetSetup::EnableAllJoints(subject, extras);
	const VStep step(*this, RetargetSetup::EditAs(Steps::c_CreateAllJoints, "create-joints"));
	if (ReplaceTarget(c_Command, std::move(subject), target.m_pApplicationData, m_Target.m_Identities))
		TakeExtras(std::move(extras));
}

void VRetargetSetupCore::RemoveUnnecessaryJoints()
{
	constexpr const char* c_Command = "RemoveUnnecessaryJoints";
	const VSubjectValues target = TargetValues();
	if (!IsWhole(target))
		return CommandIgnored(c_Command, Ignored::c_NoTarget);
	RemoveJoints(c_Command, target, RetargetSetup::JointsWithoutTargets(*target.m_pParametrised),
	    RetargetSetup::EditAs(Steps::c_RemoveJoints, "prune-joints"));
}

void VRetargetSetupCore::RemoveJoint(std::int32_t i_SegmentIndex)
{
	constexpr const char* c_Command = "RemoveJoint";
	const VSubjectValues target = TargetValues();
	if (!IsWhole(target))
		return CommandIgnored(c_Command, Ignored::c_NoTarget);
	const auto segment = std::size_t(i_SegmentIndex);
	if (i_SegmentIndex < 1 || segment >= target.m_pParametrised->m_Segments.size()
	    || target.m_pParametrised->m_Segments[segment].m_Joint.m_JointType == VSubjectParametrised::VJoint::EDummy)
		return CommandIgnored(c_Command, Ignored::c_NoJointToRemove);
	RemoveJoints(c_Command, target, {segment},
	    RetargetSetup::EditAs(
	        Steps::c_RemoveJoint, "prune-joint", RetargetSetup::WordOf(segment, *target.m_pParametrised)));
}

void VRetargetSetupCore::RemoveJoints(const char* i_pCommand, const VSubjectValues& i_rTarget,
    const std::vector<std::size_t>& i_rSegments, const RetargetSetup::VEdit& i_rEdit)
{
	VSubjectParametrised subject = *i_rTarget.m_pParametrised;
	CoreOrlexQRTIO::VSubjectQRTExtras extras = GetTargetExtras();
	RetargetSetup::RemoveJoints(subject, extras, i_rSegments);
	if (const auto pBefore =
	        RetargetSetup::KinematicsInBindPose(*i_rTarget.m_pParametrised, *i_rTarget.m_pSubject, "target"))
		TellChangedPose(*pBefore, subject);
	const VStep step(*this, i_rEdit);
	if (ReplaceTarget(i_pCommand, std::move(subject), i_rTarget.m_pApplicationData, m_Target.m_Identities))
		TakeExtras(std::move(extras));
}
