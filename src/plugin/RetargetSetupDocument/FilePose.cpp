#include "RetargetSetupDocument/FilePose.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypesUtils/SubjectParametrisedConverter.h"
#include "RetargetSetupDocument/GlobalScale.h"
#include "math/NumberText.h"

#include <algorithm>
#include <cmath>

namespace RetargetSetup
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using Rotation::VMatrix3;
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

VVector3 Column(const QMatrix4x4& i_rMatrix, int i_Column)
{
	return {i_rMatrix(0, i_Column), i_rMatrix(1, i_Column), i_rMatrix(2, i_Column)};
}

/// Gram-Schmidt on the first two columns; the third follows from them, so that the result is always a rotation.
VMatrix3 RotationWithoutScale(const QMatrix4x4& i_rMatrix)
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

} // namespace

std::vector<VPose<double>> PosesInFile(const FBXIO::VSkinSkeleton& i_rBones, const QMatrix4x4& i_rAxis, double i_Scale)
{
	std::vector<VPose<double>> poses;
	for (const FBXIO::VSkinBone& rBone : i_rBones)
	{
		const QMatrix4x4 world = i_rAxis * rBone.m_Global;
		VPose<double> pose{RotationWithoutScale(world), Column(world, 3)};
		if (!poses.empty())
		{
			const VVector3 fromRoot = Times(i_Scale, Minus(pose.t, poses.front().t));
			for (std::size_t i = 0; i < 3; ++i)
				pose.t[i] = poses.front().t[i] + fromRoot[i];
		}
		poses.push_back(pose);
	}
	return poses;
}

VFileMatch MatchFilePose(
    VSubjectParametrised& io_rSubject, const FBXIO::VSkinSkeleton& i_rBones, const QMatrix4x4& i_rAxis)
{
	VFileMatch match;
	if (io_rSubject.m_DynamicParameters.empty() || io_rSubject.m_Segments.size() != i_rBones.size())
		return match;
	// At scale 1 the offsets are the numbers of the file.
	VSubjectParametrised atFileSize = io_rSubject;
	SetGlobalScale(atFileSize, 1.0);
	CoreOrlexTypes::VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(atFileSize, subject);
	const std::vector<VPose<double>> poses = PosesInFile(i_rBones, i_rAxis, 1.0);
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

} // namespace RetargetSetup
