#include "TesselPluginRetargetSetup/ManipulatorMove.h"

#include "CoreGraphics/QtForm.h"
#include "CoreOrlexTypes/JointType.h"
#include "RetargetSetupCore/AngleAxis.h"
#include "RetargetSetupCore/Mirror.h"
#include "RetargetSetupCore/RetargetTargets.h"

#include <algorithm>

using CoreGraphics::FromQt;
using CoreGraphics::ToQt;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

namespace RetargetSetup
{

namespace
{

constexpr std::size_t c_RotationLength = 3;
constexpr std::size_t c_RootLength = 6;

/// The joint's bind pose, with a value for each of its degrees of freedom.
std::vector<double>& WholePose(VSubjectParametrised::VJoint& io_rJoint)
{
	io_rJoint.m_BindPose.resize(
	    std::max(io_rJoint.m_BindPose.size(), CoreOrlexTypes::StateSize(io_rJoint.m_JointType)));
	return io_rJoint.m_BindPose;
}

/// The rotation of a joint in its frame, as far as its bind pose tells it.
QMatrix4x4 JointRotation(const VSubjectParametrised::VJoint& i_rJoint)
{
	Rotation::VVector3 rotation{};
	std::copy_n(i_rJoint.m_BindPose.begin(), std::min(c_RotationLength, i_rJoint.m_BindPose.size()), rotation.begin());
	return ToQt(AngleAxisToMatrix(rotation));
}

Rotation::VVector3 Origin(const QMatrix4x4& i_rMatrix)
{
	return {i_rMatrix(0, 3), i_rMatrix(1, 3), i_rMatrix(2, 3)};
}

void SetRotation(std::vector<double>& io_rPose, const QMatrix4x4& i_rRotation)
{
	const Rotation::VVector3 angleAxis = MatrixToAngleAxis(FromQt(i_rRotation));
	std::copy_n(angleAxis.begin(), std::min(c_RotationLength, io_rPose.size()), io_rPose.begin());
}

} // namespace

QMatrix4x4 JointFrame(const QMatrix4x4& i_rParentWorld, const VSubject::VSegment& i_rSegment)
{
	QMatrix4x4 joint = ToQt(AngleAxisToMatrix(i_rSegment.m_PreRotation));
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

void PoseMirrorSegment(VSubjectParametrised::VSegment& io_rMirrorSegment, const QMatrix4x4& i_rFrom,
    const QMatrix4x4& i_rWorld, const QMatrix4x4& i_rOrigin, const QMatrix4x4& i_rMirrorJointFrame,
    const QMatrix4x4& i_rMirrorFrom)
{
	const Rotation::VVector3 turn = MatrixToAngleAxis(FromQt(i_rWorld * i_rFrom.inverted()));
	const QMatrix4x4 mirrored =
	    ToQt(AngleAxisToMatrix(Mirrored(turn, MirrorNormal(Origin(i_rOrigin), Origin(i_rMirrorJointFrame)))));
	std::vector<double>& rPose = WholePose(io_rMirrorSegment.m_Joint);
	SetRotation(rPose, i_rMirrorJointFrame.inverted() * mirrored * i_rMirrorFrom);
	io_rMirrorSegment.m_Joint.m_Mean = rPose;
}

bool MoveSegment(VSubjectParametrised& io_rSubject, std::size_t i_SegmentIndex, const QMatrix4x4& i_rWorld,
    const QMatrix4x4& i_rOrigin, const VMirror& i_rMirror, const std::function<QMatrix4x4(std::size_t)>& i_rJointFrame)
{
	if (i_SegmentIndex >= io_rSubject.m_Segments.size())
		return false;
	VSubjectParametrised::VSegment& rSegment = io_rSubject.m_Segments[i_SegmentIndex];
	const QMatrix4x4 frame = i_rJointFrame(i_SegmentIndex);
	const QMatrix4x4 before = frame * JointRotation(rSegment.m_Joint);
	PoseSegment(rSegment, frame, i_rWorld, i_SegmentIndex == 0);
	const auto mirror = std::size_t(i_rMirror.m_SegmentIndex);
	if (mirror >= io_rSubject.m_Segments.size())
		return true;
	VSubjectParametrised::VSegment& rMirror = io_rSubject.m_Segments[mirror];
	const QMatrix4x4 mirrorFrame = i_rJointFrame(mirror);
	if (i_rMirror.m_bMirrorsChange)
		PoseMirrorSegment(
		    rMirror, before, i_rWorld, i_rOrigin, mirrorFrame, mirrorFrame * JointRotation(rMirror.m_Joint));
	else
		PoseMirrorSegment(rMirror, frame, i_rWorld, i_rOrigin, mirrorFrame, mirrorFrame);
	return true;
}

} // namespace RetargetSetup
