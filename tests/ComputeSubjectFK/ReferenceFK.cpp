#include "ReferenceFK.h"

#include "CoreOrlexTypes/JointType.h"

namespace Reference
{
namespace
{

using Eigen::AngleAxisd;
using Eigen::Isometry3d;
using Eigen::Vector3d;

Isometry3d Motion(EJointType i_Type, const double* i_pState)
{
	switch (i_Type)
	{
	case VJointTypes::EFree:
		return Pose({i_pState[0], i_pState[1], i_pState[2]}, {i_pState[3], i_pState[4], i_pState[5]});
	case VJointTypes::EBall: return Pose({i_pState[0], i_pState[1], i_pState[2]}, {});
	case VJointTypes::EHardySpicer:
		return Isometry3d(AngleAxisd(i_pState[0], Vector3d::UnitZ()) * AngleAxisd(i_pState[1], Vector3d::UnitY()));
	case VJointTypes::EHinge: return Isometry3d(AngleAxisd(i_pState[0], Vector3d::UnitZ()));
	case VJointTypes::ESlider: return Pose({}, {0.0, 0.0, i_pState[0]});
	default: return Isometry3d::Identity();
	}
}

} // namespace

VSubject::VSegment Segment(std::uint32_t i_Parent, EJointType i_Type, std::array<double, 3> i_PreTranslation)
{
	VSubject::VSegment segment;
	segment.m_ParentSegmentIndex = i_Parent;
	segment.m_Joint.m_JointType = i_Type;
	segment.m_PreTranslation = i_PreTranslation;
	return segment;
}

VSubject::VTarget Target(
    VSubject::VTarget::ETargetType i_Type, std::uint32_t i_Segment, std::vector<double> i_State, std::uint32_t i_Index)
{
	VSubject::VTarget target;
	target.m_Type = i_Type;
	target.m_SegmentIndices = {i_Segment};
	target.m_State = std::move(i_State);
	const bool bRotation = i_Type >= VSubject::VTarget::ELocalRotationToWorldRotation;
	(bRotation ? target.m_RotationObservationIndices : target.m_MarkerIndices) = {i_Index};
	return target;
}

VSubject RandomSubject(std::mt19937& io_rRandom, std::size_t i_Segments)
{
	std::uniform_real_distribution<double> angle(-2.0, 2.0);
	std::uniform_real_distribution<double> length(-300.0, 300.0);
	const auto vector = [&](auto& io_rDistribution) -> std::array<double, 3> {
		return {io_rDistribution(io_rRandom), io_rDistribution(io_rRandom), io_rDistribution(io_rRandom)};
	};
	VSubject subject;
	for (std::uint32_t i = 0; i < i_Segments; ++i)
	{
		const std::uint32_t parent =
		    i == 0 ? CoreOrlexTypes::c_NoParent : std::uniform_int_distribution<std::uint32_t>(0, i - 1)(io_rRandom);
		const int type = std::uniform_int_distribution<int>(VJointTypes::EFree, VJointTypes::EDummy)(io_rRandom);
		VSubject::VSegment segment = Segment(parent, static_cast<EJointType>(type), vector(length));
		segment.m_PreRotation = vector(angle);
		segment.m_InversePostRotation = vector(angle);
		segment.m_InversePostTranslation = vector(length);
		segment.m_Joint.m_JointOrientation = vector(angle);
		subject.m_Segments.push_back(segment);
	}
	return subject;
}

std::vector<double> RandomState(std::mt19937& io_rRandom, const VSubject& i_rSubject, double i_Size)
{
	std::uniform_real_distribution<double> value(-i_Size, i_Size);
	std::vector<double> state;
	for (const VSubject::VSegment& rSegment : i_rSubject.m_Segments)
		for (std::size_t i = 0; i < CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType); ++i)
			state.push_back(value(io_rRandom));
	return state;
}

Isometry3d Pose(const std::array<double, 3>& i_rRotation, const std::array<double, 3>& i_rTranslation)
{
	const Vector3d rotation(i_rRotation.data());
	Isometry3d pose = Isometry3d::Identity();
	if (rotation.norm() > 0.0)
		pose.linear() = AngleAxisd(rotation.norm(), rotation.normalized()).toRotationMatrix();
	pose.translation() = Vector3d(i_rTranslation.data());
	return pose;
}

Isometry3d SegmentPose(const VSubject& i_rSubject, const std::vector<double>& i_rState, std::size_t i_Segment)
{
	const VSubject::VSegment& rSegment = i_rSubject.m_Segments[i_Segment];
	std::size_t firstState = 0;
	for (std::size_t i = 0; i < i_Segment; ++i)
		firstState += CoreOrlexTypes::StateSize(i_rSubject.m_Segments[i].m_Joint.m_JointType);
	const Isometry3d parent =
	    i_Segment == 0 ? Isometry3d::Identity() : SegmentPose(i_rSubject, i_rState, rSegment.m_ParentSegmentIndex);
	const Isometry3d axes = Pose(rSegment.m_Joint.m_JointOrientation, {});
	return parent * Pose(rSegment.m_PreRotation, rSegment.m_PreTranslation) * axes
	    * Motion(rSegment.m_Joint.m_JointType, i_rState.data() + firstState) * axes.inverse()
	    * Pose(rSegment.m_InversePostRotation, rSegment.m_InversePostTranslation).inverse();
}

Isometry3d WorldPose(const VSubject& i_rSubject, const std::vector<double>& i_rState, std::size_t i_Segment)
{
	const VSubject::VSegment& rSegment = i_rSubject.m_Segments[i_Segment];
	return SegmentPose(i_rSubject, i_rState, i_Segment)
	    * Pose(rSegment.m_InversePostRotation, rSegment.m_InversePostTranslation)
	    * Pose(rSegment.m_Joint.m_JointOrientation, {});
}

double Difference(const Rotation::VPose<double>& i_rPose, const Isometry3d& i_rExpected)
{
	return std::max(Difference(i_rPose.R, i_rExpected.linear()), Difference(i_rPose.t, i_rExpected.translation()));
}

double Difference(const Rotation::VMatrix3& i_rMatrix, const Eigen::Matrix3d& i_rExpected)
{
	using VRowMajor = Eigen::Matrix<double, 3, 3, Eigen::RowMajor>;
	return (VRowMajor(i_rMatrix.data()) - i_rExpected).cwiseAbs().maxCoeff();
}

double Difference(const Rotation::VVector3& i_rPoint, const Vector3d& i_rExpected)
{
	return (Vector3d(i_rPoint.data()) - i_rExpected).cwiseAbs().maxCoeff();
}

} // namespace Reference
