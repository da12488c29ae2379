#include "RetargetSetupCore/FilePose.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/AngleAxis.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/ParseNumber.h"
#include "RetargetSetupCore/TargetConstruction.h"
#include "math/NumberText.h"

#include <boost/format.hpp>

#include <algorithm>
#include <cmath>
#include <locale>
#include <numbers>

namespace RetargetSetup
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using Rotation::VMatrix3;
using Rotation::VMatrix4;
using Rotation::VPose;
using Rotation::VVector3;

/// Offsets that differ by less than this share of their length are the file's own.
constexpr double c_SameLength = 0.001;

double Dot(const VVector3& i_rA, const VVector3& i_rB)
{
	return i_rA[0] * i_rB[0] + i_rA[1] * i_rB[1] + i_rA[2] * i_rB[2];
}

double Length(const VVector3& i_rVector)
{
	return std::sqrt(Dot(i_rVector, i_rVector));
}

VVector3 Minus(const VVector3& i_rA, const VVector3& i_rB)
{
	return {i_rA[0] - i_rB[0], i_rA[1] - i_rB[1], i_rA[2] - i_rB[2]};
}

VVector3 Times(double i_Factor, const VVector3& i_rVector)
{
	return {i_Factor * i_rVector[0], i_Factor * i_rVector[1], i_Factor * i_rVector[2]};
}

VVector3 Cross(const VVector3& i_rA, const VVector3& i_rB)
{
	return {i_rA[1] * i_rB[2] - i_rA[2] * i_rB[1], i_rA[2] * i_rB[0] - i_rA[0] * i_rB[2],
	    i_rA[0] * i_rB[1] - i_rA[1] * i_rB[0]};
}

VVector3 Column(const VMatrix4& i_rMatrix, int i_Column)
{
	return {i_rMatrix(0, i_Column), i_rMatrix(1, i_Column), i_rMatrix(2, i_Column)};
}

/// Gram-Schmidt on the first two columns; the third follows from them, so that the result is always a rotation.
VMatrix3 RotationWithoutScale(const VMatrix4& i_rMatrix)
{
	VVector3 x = Column(i_rMatrix, 0);
	VVector3 y = Column(i_rMatrix, 1);
	if (!(Length(x) > 0.0) || !(Length(y) > 0.0))
		return Rotation::c_Identity3;
	x = Times(1.0 / Length(x), x);
	y = Times(1.0 / Length(y), y);
	y = Minus(y, Times(Dot(x, y), x));
	if (!(Length(y) > 1e-6))
		return Rotation::c_Identity3;
	y = Times(1.0 / Length(y), y);
	const VVector3 z = Cross(x, y);
	return {x[0], y[0], z[0], x[1], y[1], z[1], x[2], y[2], z[2]};
}

/// The same rotation as a vector with an angle of at most pi.
VVector3 AngleAxis(const VMatrix3& i_rRotation)
{
	return Rotation::CanonicalAngleAxis(Rotation::AngleAxisFromRotationMatrix(i_rRotation));
}

bool AreTheSegments(const VSubjectParametrised& i_rSubject, const FBXIO::VSkinSkeleton& i_rBones)
{
	return std::ranges::equal(i_rSubject.m_Segments, i_rBones,
	    [](const VSubjectParametrised::VSegment& i_rSegment, const FBXIO::VSkinBone& i_rBone)
	    {
		    return i_rSegment.m_Name == StripNamespace(i_rBone.m_Name)
		        && i_rSegment.m_ParentSegmentIndex == std::uint32_t(i_rBone.m_ParentIndex);
	    });
}

} // namespace

FBXIO::VSkinSkeleton BonesOfSegments(
    const VSubjectParametrised& i_rSubject, const FBXIO::VSkinSkeleton& i_rSkeleton, std::size_t i_Root)
{
	if (i_rSubject.m_Segments.empty())
		return {};
	// The one that is asked for, then all.
	for (std::size_t i = 0; i <= i_rSkeleton.size(); ++i)
	{
		const std::size_t root = i == 0 ? i_Root : i - 1;
		if (root >= i_rSkeleton.size()
		    || i_rSubject.m_Segments.front().m_Name != StripNamespace(i_rSkeleton[root].m_Name))
			continue;
		FBXIO::VSkinSkeleton bones = ExtractSubtree(i_rSkeleton, root);
		if (AreTheSegments(i_rSubject, bones))
			return bones;
	}
	return {};
}

std::vector<VPose<double>> PosesInFile(
    const FBXIO::VSkinSkeleton& i_rBones, const VMatrix4& i_rAxis, double i_Scale, double i_RootFactor)
{
	std::vector<VPose<double>> poses;
	VVector3 root{};
	for (const FBXIO::VSkinBone& rBone : i_rBones)
	{
		const VMatrix4 world = i_rAxis * rBone.m_Global;
		VPose<double> pose{RotationWithoutScale(world), Column(world, 3)};
		if (poses.empty())
		{
			root = pose.t;
			pose.t[2] *= i_RootFactor;
		}
		else
		{
			const VVector3 fromRoot = Times(i_Scale, Minus(pose.t, root));
			for (std::size_t i = 0; i < 3; ++i)
				pose.t[i] = poses.front().t[i] + fromRoot[i];
		}
		poses.push_back(pose);
	}
	return poses;
}

VFileMatch MatchFilePose(VSubjectParametrised& io_rSubject, const FBXIO::VSkinSkeleton& i_rBones,
    const VMatrix4& i_rAxis, double i_RootFactor)
{
	VFileMatch match;
	if (io_rSubject.m_DynamicParameters.empty() || io_rSubject.m_Segments.size() != i_rBones.size())
		return match;
	// At scale 1 the offsets are the numbers of the file.
	VSubjectParametrised atFileSize = io_rSubject;
	SetGlobalScale(atFileSize, 1.0);
	CoreOrlexTypes::VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(atFileSize, subject);
	const std::vector<VPose<double>> poses = PosesInFile(i_rBones, i_rAxis, 1.0, i_RootFactor);
	const std::string& rScaleName = io_rSubject.m_DynamicParameters.back().m_Name;

	for (std::size_t i = 0; i < poses.size(); ++i)
	{
		auto& rSegment = io_rSubject.m_Segments[i];
		const auto& rEvaluated = subject.m_Segments[i];
		const VPose<double> pre = Rotation::PoseFromAngleAxis(rEvaluated.m_PreRotation, rEvaluated.m_PreTranslation);
		// The root has no parent: its own pose is then what it stands in, in the world.
		const VPose<double> inParent =
		    i == 0 ? poses[0] : Rotation::Relative(poses[rSegment.m_ParentSegmentIndex], poses[i]);
		if (i > 0 && Length(Minus(inParent.t, pre.t)) > c_SameLength * Length(inParent.t))
		{
			for (std::size_t axis = 0; axis < 3; ++axis)
				rSegment.m_PreTranslation[axis] = NumberText::PrintF(inParent.t[axis]) + "*" + rScaleName;
			match.m_Lengths.push_back(i);
		}
		const std::size_t size = CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType);
		if (size < 3)
		{
			const VVector3 rotation = AngleAxis(inParent.R);
			for (std::size_t axis = 0; axis < 3; ++axis)
				rSegment.m_PreRotation[axis] = NumberText::PrintG17(rotation[axis]);
			match.m_PreRotations.push_back(i);
			continue;
		}
		const VPose<double> motion = Rotation::Relative(pre, inParent);
		std::vector<double>& rBindPose = rSegment.m_Joint.m_BindPose;
		rBindPose.assign(size, 0.0);
		std::ranges::copy(AngleAxis(motion.R), rBindPose.begin());
		if (i == 0 && size == 6)
			std::ranges::copy(motion.t, rBindPose.begin() + 3);
		rSegment.m_Joint.m_Mean = rBindPose;
	}
	return match;
}

bool HoldsFilePose(const VSubjectParametrised& i_rSubject)
{
	using VJoint = VSubjectParametrised::VJoint;
	constexpr VVector3 c_None{};
	for (std::size_t i = 0; i < i_rSubject.m_Segments.size(); ++i)
	{
		const VSubjectParametrised::VSegment& rSegment = i_rSubject.m_Segments[i];
		const VJoint::EJointType type = rSegment.m_Joint.m_JointType;
		if (type != (i == 0 ? VJoint::EFree : VJoint::EBall) && (i == 0 || type != VJoint::EDummy))
			return false;
		if (rSegment.m_Joint.m_JointOrientation != c_None || rSegment.m_InversePostRotation != c_None
		    || rSegment.m_InversePostTranslation != c_None)
			return false;
	}
	return i_rSubject.m_DynamicParameters.size() == 1
	    && i_rSubject.m_DynamicParameters.front().m_Name == c_GlobalScaleName;
}

std::optional<VPoseDifference> DifferenceFromFile(const VSubjectParametrised& i_rSubject,
    const FBXIO::VSkinSkeleton& i_rBones, const VMatrix4& i_rAxis, double i_RootFactor)
{
	CoreOrlexTypes::VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rSubject, subject);
	const auto pFK = KinematicsInBindPose(i_rSubject, subject, "target");
	return pFK ? WorstPoseDifference(
	           PosesInFile(i_rBones, i_rAxis, GetGlobalScale(i_rSubject), i_RootFactor), SegmentPoses(*pFK))
	           : std::nullopt;
}

std::string WorstText(const VSubjectParametrised& i_rSubject, const VPoseDifference& i_rWorst)
{
	return (boost::format("at worst \"%1%\" by %2$.1f mm and %3$.1f degrees", std::locale::classic())
	    % i_rSubject.m_Segments[i_rWorst.m_SegmentIndex].m_Name % i_rWorst.m_Distance
	    % (i_rWorst.m_Angle * 180.0 / std::numbers::pi))
	    .str();
}

void MatchFilePoseAndTell(VSubjectParametrised& io_rSubject, const FBXIO::VSkinSkeleton& i_rBones,
    const VMatrix4& i_rAxis, double i_RootFactor)
{
	const VFileMatch match = MatchFilePose(io_rSubject, i_rBones, i_rAxis, i_RootFactor);
	if (!match.m_Lengths.empty())
		NVX_LOG(c_LogCategory, NVX::ELogInformation, "Pose from the FBX file: %1% segments got the file's lengths",
		    match.m_Lengths.size());
	if (!match.m_PreRotations.empty())
		NVX_LOG(c_LogCategory, NVX::ELogInformation, "Pose from the FBX file: %1% segments without a joint were turned",
		    match.m_PreRotations.size());
	// What lengths within a thousandth of the file's add up to is no concern.
	if (const auto worst = DifferenceFromFile(io_rSubject, i_rBones, i_rAxis, i_RootFactor))
		NVX_LOG(c_LogCategory,
		    worst->m_Distance > 1.0 || worst->m_Angle > 1e-3 ? NVX::ELogWarning : NVX::ELogInformation,
		    "The bind pose still differs from the pose in the FBX file, %1%", WorstText(io_rSubject, *worst));
}

std::optional<VTurnedRoot> FindTurnedRoot(
    const VSubjectParametrised& i_rSubject, const FBXIO::VSkinSkeleton& i_rSkeleton, const VMatrix4& i_rAxis)
{
	if (i_rSubject.m_Segments.empty())
		return std::nullopt;
	const VSubjectParametrised::VSegment& rRoot = i_rSubject.m_Segments.front();
	VVector3 preRotation{};
	for (std::size_t i = 0; i < 3; ++i)
		ParseNumber(rRoot.m_PreRotation[i], preRotation[i]);
	const double angle = Length(Rotation::CanonicalAngleAxis(preRotation));
	const std::vector<double>& rBindPose = rRoot.m_Joint.m_BindPose;
	if (angle < c_SamePoseAngle || rBindPose.size() < preRotation.size())
		return std::nullopt;
	const VVector3 rotation{rBindPose[0], rBindPose[1], rBindPose[2]};
	for (const FBXIO::VSkinBone& rBone : i_rSkeleton)
		if (rRoot.m_Name == StripNamespace(rBone.m_Name)
		    && Length(Minus(rotation, MatrixToAngleAxis(i_rAxis * rBone.m_Global))) < c_SamePoseAngle)
			return VTurnedRoot{rBone.m_Name, angle};
	return std::nullopt;
}

} // namespace RetargetSetup
