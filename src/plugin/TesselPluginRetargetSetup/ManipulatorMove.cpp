#include "TesselPluginRetargetSetup/ManipulatorMove.h"

#include "CoreOrlexTypes/JointType.h"
#include "RetargetSetupDocument/AngleAxis.h"
#include "RetargetSetupDocument/RetargetTargets.h"

#include <QVector3D>

#include <algorithm>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

namespace RetargetSetup
{

namespace
{

constexpr std::size_t c_RotationLength = 3;
constexpr std::size_t c_RootLength = 6;
/// Joints nearer than this, in mm, coincide.
constexpr float c_SamePlace = 1e-3f;

QVector3D Origin(const QMatrix4x4& i_rMatrix)
{
	return i_rMatrix.column(3).toVector3D();
}

/// The joint's bind pose, with a value for each of its degrees of freedom.
std::vector<double>& WholePose(VSubjectParametrised::VJoint& io_rJoint)
{
	io_rJoint.m_BindPose.resize(
	    std::max(io_rJoint.m_BindPose.size(), CoreOrlexTypes::StateSize(io_rJoint.m_JointType)));
	return io_rJoint.m_BindPose;
}

void SetRotation(std::vector<double>& io_rPose, const QMatrix4x4& i_rRotation)
{
	const Rotation::VVector3 angleAxis = MatrixToAngleAxis(i_rRotation);
	std::copy_n(angleAxis.begin(), std::min(c_RotationLength, io_rPose.size()), io_rPose.begin());
}

} // namespace

QMatrix4x4 JointFrame(const QMatrix4x4& i_rParentWorld, const VSubject::VSegment& i_rSegment)
{
	QMatrix4x4 joint = AngleAxisToMatrix(i_rSegment.m_PreRotation);
	for (int row = 0; row < 3; ++row)
		joint(row, 3) = float(i_rSegment.m_PreTranslation[std::size_t(row)]);
	return i_rParentWorld * joint;
}

void PoseSegment(VSubjectParametrised::VSegment& io_rSegment, const QMatrix4x4& i_rJointFrame,
    const QMatrix4x4& i_rWorld, bool i_bRoot)
{
	std::vector<double>& rPose = WholePose(io_rSegment.m_Joint);
	const QMatrix4x4 local = i_rJointFrame.inverted() * i_rWorld;
	SetRotation(rPose, local);
	if (i_bRoot)
		for (std::size_t i = c_RotationLength; i < std::min(c_RootLength, rPose.size()); ++i)
			rPose[i] = double(local(int(i - c_RotationLength), 3));
	io_rSegment.m_Joint.m_Mean = rPose;
}

void PoseMirrorSegment(VSubjectParametrised::VSegment& io_rMirrorSegment, const QMatrix4x4& i_rJointFrame,
    const QMatrix4x4& i_rWorld, const QMatrix4x4& i_rOrigin, const QMatrix4x4& i_rMirrorJointFrame)
{
	const Rotation::VVector3 turn = MatrixToAngleAxis(i_rWorld * i_rJointFrame.inverted());
	const QVector3D w{float(turn[0]), float(turn[1]), float(turn[2])};
	const QVector3D between = Origin(i_rOrigin) - Origin(i_rMirrorJointFrame);
	const QVector3D normal = between.length() < c_SamePlace ? QVector3D() : between.normalized();
	// A mirror makes of a rotation about an axis one the other way about the mirrored axis.
	const QVector3D mirrored = -(w - 2.0f * QVector3D::dotProduct(w, normal) * normal);
	const QMatrix4x4 rotation = AngleAxisToMatrix({double(mirrored.x()), double(mirrored.y()), double(mirrored.z())});
	std::vector<double>& rPose = WholePose(io_rMirrorSegment.m_Joint);
	SetRotation(rPose, i_rMirrorJointFrame.inverted() * rotation * i_rMirrorJointFrame);
	io_rMirrorSegment.m_Joint.m_Mean = rPose;
}

bool MoveSegment(VSubjectParametrised& io_rSubject, std::size_t i_SegmentIndex, const QMatrix4x4& i_rWorld,
    const QMatrix4x4& i_rOrigin, bool i_bSymmetry, const std::function<QMatrix4x4(std::size_t)>& i_rJointFrame)
{
	if (i_SegmentIndex >= io_rSubject.m_Segments.size())
		return false;
	const QMatrix4x4 frame = i_rJointFrame(i_SegmentIndex);
	PoseSegment(io_rSubject.m_Segments[i_SegmentIndex], frame, i_rWorld, i_SegmentIndex == 0);
	const std::int32_t mirror = i_bSymmetry ? FindMirrorSegment(io_rSubject, i_SegmentIndex) : -1;
	if (mirror != -1)
		PoseMirrorSegment(io_rSubject.m_Segments[std::size_t(mirror)], frame, i_rWorld, i_rOrigin,
		    i_rJointFrame(std::size_t(mirror)));
	return true;
}

} // namespace RetargetSetup
