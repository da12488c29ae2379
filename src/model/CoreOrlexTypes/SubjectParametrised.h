#pragma once

#include <array>
#include <cstdint>
#include <limits>
#include <string>
#include <vector>

namespace CoreOrlexTypes
{

/// Parent index of a segment that has no parent.
inline constexpr std::uint32_t c_NoParent = 0xFFFFFFFFu;

/// Marks a static parameter's value, or one degree of freedom of a T-pose, as not set.
inline constexpr double c_NotSet = std::numeric_limits<double>::max();

/// The editable subject: geometry is expression text over named parameters, joint statistics come in
/// four variants (calibrated, T-pose, template, bind pose).
/// Positions are in millimetres, rotations are angle-axis vectors in radians, matrices are row by row.
/// Parents stand before their children in m_Segments; all cross references are list indices, not ids.
struct VSubjectParametrised
{
	struct VStaticParameter
	{
		enum EQuantity : std::int32_t
		{
			EQuantityScalar,
			EQuantityLength,
			EQuantityAngle,
			EQuantityMass,
			EQuantityTime
		};

		bool m_Advanced = false;
		bool m_Visible = false;
		bool m_ReadOnly = false;
		bool m_Required = false;
		std::string m_Name;
		std::string m_DefaultExpression;
		double m_UserValue = c_NotSet;
		double m_Prior = c_NotSet;
		EQuantity m_Quantity = EQuantityScalar;
	};

	struct VDynamicParameter
	{
		std::string m_Name;
		double m_Prior = 0.0;
		double m_StandardDeviation = 0.0;
		double m_Value = 0.0;
		bool m_Visible = false;
	};

	/// A statistic is either empty or has the size that the joint type prescribes (see JointType.h). The rotation's
	/// part of a ball or free joint's covariance is that of the angle-axis vector from the mean to the state, about the
	/// joint's axes at the mean.
	struct VJoint
	{
		enum EJointType : std::int32_t
		{
			EFree,
			EBall,
			EHardySpicer,
			EHinge,
			ESlider,
			EDummy,
			EBadJointType
		};

		std::string m_Name;
		EJointType m_JointType = EDummy;
		std::array<double, 3> m_JointOrientation{};
		std::vector<double> m_Covariance;
		std::vector<double> m_Mean;
		std::vector<double> m_TPoseCovariance;
		std::vector<double> m_TPoseMean;
		std::vector<double> m_RangeCentringState;
		std::vector<double> m_RangeMatrix;
		std::vector<double> m_TemplateCovariance;
		std::vector<double> m_TemplateMean;
		std::vector<double> m_TemplateRangeCentringState;
		std::vector<double> m_TemplateRangeMatrix;
		std::vector<double> m_BindPose;
	};

	struct VSegment
	{
		std::string m_Name;
		std::uint32_t m_SegmentIndex = 0;
		std::uint32_t m_ParentSegmentIndex = c_NoParent;
		std::uint32_t m_TreeDepth = 0;
		VJoint m_Joint;
		std::array<std::string, 3> m_PreRotation{"0", "0", "0"};
		std::array<std::string, 3> m_PreTranslation{"0", "0", "0"};
		std::array<double, 3> m_InversePostRotation{};
		std::array<double, 3> m_InversePostTranslation{};
		std::string m_MassExpression;
		std::array<std::string, 3> m_MassCentreExpressions;
		std::array<std::string, 3> m_RadiusOfGyrationExpressions;
		std::array<std::string, 6> m_Bounds{"0", "0", "0", "0", "0", "0"};
	};

	struct VMarker
	{
		enum EMarkerStatus : std::int32_t
		{
			ERequired,
			EOptional,
			ECalibrationOnly,
			EVirtualCalibrationOnly
		};

		std::string m_Name;
		std::uint32_t m_MarkerId = 0;
		bool m_Missing = false;
		double m_Radius = 10.0;
		EMarkerStatus m_Status = ERequired;
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

		std::vector<double> m_Covariance;
		std::vector<double> m_PlacementCovariance;
		std::vector<std::uint32_t> m_MarkerIndices;
		std::vector<std::uint32_t> m_RotationObservationIndices;
		std::vector<std::uint32_t> m_SegmentIndices;
		std::vector<std::string> m_StateExpressions;
		std::vector<double> m_TemplateCovariance;
		std::vector<std::array<double, 3>> m_ViewNormals;
		ETargetType m_Type = EBadTargetType;
		double m_Weight = 1.0;
		double m_CalibrationWeight = 1.0;
		ERotationCalibrationBehaviourType m_RotationCalibrationBehaviour = EOther;
		std::vector<double> m_RotationTargetOrientation;
		std::uint32_t m_NumberOfDegreesOfFreedom = 0;
	};

	std::string m_Name;
	std::string m_Model;
	std::string m_ModelVersion;
	std::string m_MarkerSetName;
	std::uint32_t m_SubjectId = 0;
	std::vector<VStaticParameter> m_StaticParameters;
	std::vector<VDynamicParameter> m_DynamicParameters;
	std::vector<VSegment> m_Segments;
	std::vector<VMarker> m_Markers;
	std::vector<VRotation> m_Rotations;
	std::vector<VTarget> m_Targets;
	std::vector<double> m_TPoseConstraints;
};

/// Exact, field by field; two NaNs are equal to each other, so that a value always equals its copy.
bool operator==(const VSubjectParametrised& i_rLeft, const VSubjectParametrised& i_rRight);

} // namespace CoreOrlexTypes
