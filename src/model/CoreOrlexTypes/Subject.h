#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

namespace CoreOrlexTypes
{

/// A subject evaluated to numbers: what forward kinematics and the scene consume.
/// Lists run parallel to those of the VSubjectParametrised that it was converted from.
/// Positions are in millimetres, rotations are angle-axis vectors in radians, matrices are row by row.
struct VSubject
{
	struct VJoint
	{
		std::string m_Name;
		VSubjectParametrised::VJoint::EJointType m_JointType = VSubjectParametrised::VJoint::EDummy;
		std::array<double, 3> m_JointOrientation{};
		std::vector<double> m_Covariance;
		std::vector<double> m_Mean;
		std::vector<double> m_RangeCentringState;
		std::vector<double> m_RangeMatrix;
	};

	struct VSegment
	{
		std::string m_Name;
		std::uint32_t m_SegmentIndex = 0;
		std::uint32_t m_ParentSegmentIndex = c_NoParent;
		std::uint32_t m_TreeDepth = 0;
		std::array<double, 3> m_PreRotation{};
		std::array<double, 3> m_PreTranslation{};
		std::array<double, 3> m_InversePostRotation{};
		std::array<double, 3> m_InversePostTranslation{};
		std::array<double, 6> m_Bounds{};
		VJoint m_Joint;
	};

	struct VMarker
	{
		std::string m_Name;
		std::uint32_t m_MarkerId = 0;
		double m_Radius = 10.0;
		bool m_Missing = false;
		double m_ViewAngle = 0.0;
	};

	struct VRotation
	{
		std::string m_Name;
		std::uint32_t m_RotationId = 0;
	};

	struct VTarget
	{
		enum ETargetType : std::int32_t
		{
			EBadTargetType,
			ELocalPointToWorldPoint,
			ELocalPointToWorldPointGaussian,
			ELocalPlaneToWorldPoint,
			ELocalPlaneToWorldPointGaussian,
			ELocalLineToWorldPoint,
			ELocalLineToWorldPointGaussian,
			ERigidBody,
			ELocalRotationToWorldRotation,
			ELocalDirectionToWorldDirection
		};

		enum ERotationCalibrationBehaviourType : std::int32_t
		{
			EBadBehaviourType,
			EOther,
			EHingeLike,
			EHardySpicerLike
		};

		ETargetType m_Type = EBadTargetType;
		double m_Weight = 1.0;
		ERotationCalibrationBehaviourType m_RotationCalibrationBehaviour = EOther;
		std::vector<double> m_RotationTargetOrientation;
		std::uint32_t m_NumberOfDegreesOfFreedom = 0;
		std::vector<std::uint32_t> m_MarkerIndices;
		std::vector<std::uint32_t> m_RotationObservationIndices;
		std::vector<std::uint32_t> m_SegmentIndices;
		std::vector<double> m_State;
		std::vector<double> m_Covariance;
		std::vector<std::array<double, 3>> m_ViewNormals;
	};

	std::string m_Name;
	std::uint32_t m_SubjectId = 0;
	std::vector<VSegment> m_Segments;
	std::vector<VMarker> m_Markers;
	std::vector<VRotation> m_Rotations;
	std::vector<VTarget> m_Targets;
};

/// Exact, field by field; two NaNs are equal to each other.
bool operator==(const VSubject& i_rLeft, const VSubject& i_rRight);

} // namespace CoreOrlexTypes
