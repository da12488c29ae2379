#include "RetargetSetupCore/RootHeight.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Identity.h"

#include <algorithm>
#include <cmath>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

namespace RetargetSetup
{

namespace
{

constexpr std::size_t c_RootLength = 6;
/// Heights that differ by less, in mm, are the same.
constexpr double c_SameHeight = 1.0;

VSubject Converted(const VSubjectParametrised& i_rSubject)
{
	VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rSubject, subject);
	return subject;
}

const char* Side(double i_Height)
{
	return i_Height < 0.0 ? "below" : "above";
}

} // namespace

bool MoveRoot(VSubjectParametrised& io_rSubject, const std::function<void(Rotation::VPose<double>&)>& i_rMove)
{
	if (io_rSubject.m_Segments.empty())
		return false;
	VSubjectParametrised::VJoint& rJoint = io_rSubject.m_Segments.front().m_Joint;
	std::vector<double>& rBindPose = rJoint.m_BindPose;
	if (rBindPose.size() < c_RootLength || rJoint.m_JointOrientation != std::array<double, 3>{})
		return false;
	// The joint moves in the frame of its segment.
	const VSubject subject = Converted(io_rSubject);
	const VSubject::VSegment& rRoot = subject.m_Segments.front();
	const Rotation::VPose<double> pre = Rotation::PoseFromAngleAxis(rRoot.m_PreRotation, rRoot.m_PreTranslation);
	const Rotation::VPose<double> before = Rotation::Compose(pre,
	    Rotation::PoseFromAngleAxis(
	        {rBindPose[0], rBindPose[1], rBindPose[2]}, {rBindPose[3], rBindPose[4], rBindPose[5]}));
	Rotation::VPose<double> world = before;
	i_rMove(world);
	const Rotation::VPose<double> joint = Rotation::Relative(pre, world);
	// What does not turn keeps its angles to the bit.
	if (world.R != before.R)
		std::ranges::copy(Rotation::AngleAxisFromRotationMatrix(joint.R), rBindPose.begin());
	std::ranges::copy(joint.t, rBindPose.begin() + 3);
	rJoint.m_Mean = rBindPose;
	return true;
}

void ScaleRootHeight(VSubjectParametrised& io_rSubject, double i_Factor)
{
	MoveRoot(io_rSubject, [&](Rotation::VPose<double>& io_rWorld) { io_rWorld.t[2] *= i_Factor; });
}

std::optional<VLowestSegment> FindLowestSegment(const VSubjectParametrised& i_rSubject)
{
	const auto pFK = KinematicsInBindPose(i_rSubject, Converted(i_rSubject), "target");
	if (!pFK)
		return std::nullopt;
	const std::vector<Rotation::VPose<double>> poses = SegmentPoses(*pFK);
	const auto lowest =
	    std::ranges::min_element(poses, {}, [](const Rotation::VPose<double>& i_rPose) { return i_rPose.t[2]; });
	return VLowestSegment{std::size_t(lowest - poses.begin()), lowest->t[2]};
}

void TellLowestSegment(const VSubjectParametrised& i_rSubject)
{
	const double scale = GetGlobalScale(i_rSubject);
	if (scale == 1.0)
		return;
	VSubjectParametrised atFileSize = i_rSubject;
	SetGlobalScale(atFileSize, 1.0);
	const auto before = FindLowestSegment(atFileSize);
	const auto now = before ? FindLowestSegment(i_rSubject) : std::nullopt;
	if (!now || std::abs(now->m_Height - scale * before->m_Height) < c_SameHeight)
		return;
	NVX_LOG(c_LogCategory, NVX::ELogWarning,
	    "At scale %1% the lowest segment, '%2%', is %3$.1f mm %4% the floor, and at scale 1 it is %5$.1f mm %6% it: "
	    "the "
	    "root keeps its height unless that is scaled, too",
	    scale, i_rSubject.m_Segments[now->m_SegmentIndex].m_Name, std::abs(now->m_Height), Side(now->m_Height),
	    std::abs(before->m_Height), Side(before->m_Height));
}

} // namespace RetargetSetup
