#pragma once

// A part of it, and compiled only with it.
#include "CoreOrlexTypes/Fields.h"

namespace CoreOrlexTypes
{

template <>
inline constexpr auto
    c_Enumeration<VSubjectParametrised::VJoint::EJointType> = VEnumeration<VSubjectParametrised::VJoint::EJointType, 7>(
        "SubjectParametrised.Joint.EJointType", "Possible joint types.",
        {{VSubjectParametrised::VJoint::EFree, "Free"}, {VSubjectParametrised::VJoint::EBall, "Ball"},
            {VSubjectParametrised::VJoint::EHardySpicer, "HardySpicer"},
            {VSubjectParametrised::VJoint::EHinge, "Hinge"}, {VSubjectParametrised::VJoint::ESlider, "Slider"},
            {VSubjectParametrised::VJoint::EDummy, "Dummy"},
            {VSubjectParametrised::VJoint::EBadJointType, "BadJointType"}});

/// The evaluated and the editable target each declare this enumeration.
template <typename TTarget>
constexpr auto TargetTypeEnumeration(std::string_view i_Name)
{
	constexpr std::string_view c_Point = "the state is a 3-vector defining the local offset";
	constexpr std::string_view c_Plane =
	    "the state is a 6-vector defining the origin of the plane and it normal in the local coordinate system of the "
	    "parent segment";
	constexpr std::string_view c_Line =
	    "the state is a 6-vector defining two points on a line in the local coordinate system of the parent segment";
	return VEnumeration<typename TTarget::ETargetType, 10>(i_Name, "Possible target types.",
	    {{TTarget::EBadTargetType, "BadTargetType"},
	        {TTarget::ELocalPointToWorldPoint, "LocalPointToWorldPoint", c_Point},
	        {TTarget::ELocalPointToWorldPointGaussian, "LocalPointToWorldPointGaussian", c_Point},
	        {TTarget::ELocalPlaneToWorldPoint, "LocalPlaneToWorldPoint", c_Plane},
	        {TTarget::ELocalPlaneToWorldPointGaussian, "LocalPlaneToWorldPointGaussian", c_Plane},
	        {TTarget::ELocalLineToWorldPoint, "LocalLineToWorldPoint", c_Line},
	        {TTarget::ELocalLineToWorldPointGaussian, "LocalLineToWorldPointGaussian", c_Line},
	        {TTarget::ERigidBody, "RigidBody"},
	        {TTarget::ELocalRotationToWorldRotation, "LocalRotationToWorldRotation",
	            "the state is a 3-vector defining the local angle-axis offset"},
	        {TTarget::ELocalDirectionToWorldDirection, "LocalDirectionToWorldDirection"}});
}

template <typename TTarget>
constexpr auto RotationCalibrationBehaviourEnumeration(std::string_view i_Name)
{
	return VEnumeration<typename TTarget::ERotationCalibrationBehaviourType, 4>(i_Name,
	    "Other for Ball-like or dummy-like targets EHingeLike is initialised from an 'AXIS' attribute and calibratable "
	    "on a single DOF EHardySpicerLike is initialised from an 'AXIS-PAIR' attribute and calibratable on two DoF",
	    {{TTarget::EBadBehaviourType, "BadBehaviourType"}, {TTarget::EOther, "Other"},
	        {TTarget::EHingeLike, "HingeLike"}, {TTarget::EHardySpicerLike, "HardySpicerLike"}});
}

template <>
inline constexpr auto c_Enumeration<VSubjectParametrised::VTarget::ETargetType> =
    TargetTypeEnumeration<VSubjectParametrised::VTarget>("SubjectParametrised.Target.ETargetType");

template <>
inline constexpr auto c_Enumeration<VSubjectParametrised::VTarget::ERotationCalibrationBehaviourType> =
    RotationCalibrationBehaviourEnumeration<VSubjectParametrised::VTarget>(
        "SubjectParametrised.Target.ERotationCalibrationBehaviourType");

template <>
inline constexpr auto c_Enumeration<VSubject::VTarget::ETargetType> = TargetTypeEnumeration<VSubject::VTarget>(
    "Subject.Target.ETargetType");

template <>
inline constexpr auto c_Enumeration<VSubject::VTarget::ERotationCalibrationBehaviourType> =
    RotationCalibrationBehaviourEnumeration<VSubject::VTarget>("Subject.Target.ERotationCalibrationBehaviourType");

template <>
inline constexpr auto c_Enumeration<VSubjectParametrised::VMarker::EMarkerStatus> =
    VEnumeration<VSubjectParametrised::VMarker::EMarkerStatus, 4>("SubjectParametrised.Marker.EMarkerStatus", "",
        {{VSubjectParametrised::VMarker::ERequired, "Required", "Marker is always present."},
            {VSubjectParametrised::VMarker::EOptional, "Optional", "Marker may or may not be physically present."},
            {VSubjectParametrised::VMarker::ECalibrationOnly, "CalibrationOnly",
                "Marker is physically present, but physically removed after calibration."},
            {VSubjectParametrised::VMarker::EVirtualCalibrationOnly, "VirtualCalibrationOnly"}});

template <>
inline constexpr auto c_Enumeration<VSubjectParametrised::VStaticParameter::EQuantity> =
    VEnumeration<VSubjectParametrised::VStaticParameter::EQuantity, 5>("SubjectParametrised.StaticParameter.EQuantity",
        "The different possible quantities.",
        {{VSubjectParametrised::VStaticParameter::EQuantityScalar, "QuantityScalar"},
            {VSubjectParametrised::VStaticParameter::EQuantityLength, "QuantityLength"},
            {VSubjectParametrised::VStaticParameter::EQuantityAngle, "QuantityAngle"},
            {VSubjectParametrised::VStaticParameter::EQuantityMass, "QuantityMass"},
            {VSubjectParametrised::VStaticParameter::EQuantityTime, "QuantityTime"}});

template <>
inline constexpr auto c_Fields<VSubjectParametrised::VStaticParameter> = Fields(
    VField("Advanced", &VSubjectParametrised::VStaticParameter::m_Advanced, "Shown only among advanced parameters."),
    VField("Visible", &VSubjectParametrised::VStaticParameter::m_Visible, "Shown to the user."),
    VField("ReadOnly", &VSubjectParametrised::VStaticParameter::m_ReadOnly, "Not editable."),
    VField("Required", &VSubjectParametrised::VStaticParameter::m_Required, "Must be given."),
    VField("Name", &VSubjectParametrised::VStaticParameter::m_Name, "The name by which expressions use it."),
    VField("DefaultExpression", &VSubjectParametrised::VStaticParameter::m_DefaultExpression,
        "Expression giving the default value."),
    VField("UserValue", &VSubjectParametrised::VStaticParameter::m_UserValue,
        "Value entered by the user; the largest finite number if not set."),
    VField("Prior", &VSubjectParametrised::VStaticParameter::m_Prior,
        "Prior value; the largest finite number if not set."),
    VField("Quantity", &VSubjectParametrised::VStaticParameter::m_Quantity, "Unit class."));

template <>
inline constexpr auto c_Fields<VSubjectParametrised::VDynamicParameter> = Fields(
    VField("Name", &VSubjectParametrised::VDynamicParameter::m_Name),
    VField("Prior", &VSubjectParametrised::VDynamicParameter::m_Prior),
    VField("StandardDeviation", &VSubjectParametrised::VDynamicParameter::m_StandardDeviation),
    VField("Value", &VSubjectParametrised::VDynamicParameter::m_Value),
    VField("Visible", &VSubjectParametrised::VDynamicParameter::m_Visible));

template <>
inline constexpr auto c_Fields<VSubjectParametrised::VJoint> = Fields(
    VField("Name", &VSubjectParametrised::VJoint::m_Name, "Joint name."),
    VField("JointType", &VSubjectParametrised::VJoint::m_JointType),
    VField("JointOrientation", &VSubjectParametrised::VJoint::m_JointOrientation,
        "Orientation of the joint axes, angle-axis."),
    VField("Covariance", &VSubjectParametrised::VJoint::m_Covariance, "Of the calibrated subject."),
    VField("Mean", &VSubjectParametrised::VJoint::m_Mean, "Of the calibrated subject."),
    VField("TPoseCovariance", &VSubjectParametrised::VJoint::m_TPoseCovariance, "Of the T-pose."),
    VField("TPoseMean", &VSubjectParametrised::VJoint::m_TPoseMean, "Of the T-pose."),
    VField("RangeCentringState", &VSubjectParametrised::VJoint::m_RangeCentringState,
        "Centres joint states in the middle of the range space."),
    VField("RangeMatrix", &VSubjectParametrised::VJoint::m_RangeMatrix,
        "Covariance-like matrix that defines the joint ranges."),
    VField("TemplateCovariance", &VSubjectParametrised::VJoint::m_TemplateCovariance, "Of the uncalibrated subject."),
    VField("TemplateMean", &VSubjectParametrised::VJoint::m_TemplateMean, "Of the uncalibrated subject."),
    VField("TemplateRangeCentringState", &VSubjectParametrised::VJoint::m_TemplateRangeCentringState,
        "Of the uncalibrated subject."),
    VField("TemplateRangeMatrix", &VSubjectParametrised::VJoint::m_TemplateRangeMatrix, "Of the uncalibrated subject."),
    VField("BindPose", &VSubjectParametrised::VJoint::m_BindPose, "Bind pose for retargeting"));

template <>
inline constexpr auto c_Fields<VSubjectParametrised::VSegment> = Fields(
    VField("Name", &VSubjectParametrised::VSegment::m_Name, "Segment name."),
    VField("SegmentIndex", &VSubjectParametrised::VSegment::m_SegmentIndex,
        "Index (not id) of this segment within VSubject."),
    VField("ParentSegmentIndex", &VSubjectParametrised::VSegment::m_ParentSegmentIndex,
        "Index of the parent; 4294967295 means none."),
    VField("TreeDepth", &VSubjectParametrised::VSegment::m_TreeDepth,
        "Depth of this segment in the segment tree ( Root is zero )."),
    VField("Joint", &VSubjectParametrised::VSegment::m_Joint, "The joint that connects this segment to its parent."),
    VField("PreRotation", &VSubjectParametrised::VSegment::m_PreRotation,
        "Orientation of the joint in the parent segment's frame, angle-axis."),
    VField("PreTranslation", &VSubjectParametrised::VSegment::m_PreTranslation,
        "Position of the joint in the parent segment's frame."),
    VField("InversePostRotation", &VSubjectParametrised::VSegment::m_InversePostRotation,
        "Inverse orientation of the child segment in the joint's frame, angle-axis."),
    VField("InversePostTranslation", &VSubjectParametrised::VSegment::m_InversePostTranslation,
        "Inverse position of the child segment in the joint's frame."),
    VField("MassExpression", &VSubjectParametrised::VSegment::m_MassExpression,
        "Mass of the segment as a proportion of the total subject mass."),
    VField("MassCentreExpressions", &VSubjectParametrised::VSegment::m_MassCentreExpressions,
        "Centre of mass in the local frame."),
    VField("RadiusOfGyrationExpressions", &VSubjectParametrised::VSegment::m_RadiusOfGyrationExpressions,
        "Radii of gyration about the local axes."),
    VField("Bounds", &VSubjectParametrised::VSegment::m_Bounds, "Two corners of the box used to show the segment."));

template <>
inline constexpr auto c_Fields<VSubjectParametrised::VMarker> = Fields(
    VField("Name", &VSubjectParametrised::VMarker::m_Name, "Marker name."),
    VField("MarkerId", &VSubjectParametrised::VMarker::m_MarkerId, "Numeric id, unique in the subject."),
    VField("Missing", &VSubjectParametrised::VMarker::m_Missing),
    VField("Radius", &VSubjectParametrised::VMarker::m_Radius, "Marker radius."),
    VField("Status", &VSubjectParametrised::VMarker::m_Status),
    VField("ViewAngle", &VSubjectParametrised::VMarker::m_ViewAngle));

template <>
inline constexpr auto c_Fields<VSubjectParametrised::VRotation> = Fields(
    VField("Name", &VSubjectParametrised::VRotation::m_Name),
    VField("RotationId", &VSubjectParametrised::VRotation::m_RotationId));

template <>
inline constexpr auto c_Fields<VSubjectParametrised::VTarget> = Fields(
    VField("Covariance", &VSubjectParametrised::VTarget::m_Covariance, "Uncertainty of the state."),
    VField("PlacementCovariance", &VSubjectParametrised::VTarget::m_PlacementCovariance),
    VField("MarkerIndices", &VSubjectParametrised::VTarget::m_MarkerIndices, "Indices into Markers."),
    VField("RotationObservationIndices", &VSubjectParametrised::VTarget::m_RotationObservationIndices,
        "Indices into Rotations."),
    VField("SegmentIndices", &VSubjectParametrised::VTarget::m_SegmentIndices, "Indices into Segments."),
    VField("StateExpressions", &VSubjectParametrised::VTarget::m_StateExpressions, "One per state component."),
    VField("TemplateCovariance", &VSubjectParametrised::VTarget::m_TemplateCovariance, "Of the uncalibrated subject."),
    VField("ViewNormals", &VSubjectParametrised::VTarget::m_ViewNormals,
        "Direction the target faces, in the segment's frame."),
    VField("Type", &VSubjectParametrised::VTarget::m_Type),
    VField(
        "Weight", &VSubjectParametrised::VTarget::m_Weight, "The amount of influence the target has in the solution."),
    VField("CalibrationWeight", &VSubjectParametrised::VTarget::m_CalibrationWeight,
        "Non-negative weight for subject scale estimation."),
    VField("RotationCalibrationBehaviour", &VSubjectParametrised::VTarget::m_RotationCalibrationBehaviour),
    VField("RotationTargetOrientation", &VSubjectParametrised::VTarget::m_RotationTargetOrientation,
        "Empty, or an angle-axis vector."),
    VField("NumberOfDegreesOfFreedom", &VSubjectParametrised::VTarget::m_NumberOfDegreesOfFreedom));

template <>
inline constexpr auto c_Fields<VSubjectParametrised> = Fields(
    VField("Name", &VSubjectParametrised::m_Name, "Subject name."),
    VField("Model", &VSubjectParametrised::m_Model, "Model name."),
    VField("ModelVersion", &VSubjectParametrised::m_ModelVersion, "Model version."),
    VField("MarkerSetName", &VSubjectParametrised::m_MarkerSetName, "Name of the marker set."),
    VField("SubjectId", &VSubjectParametrised::m_SubjectId, "Numeric subject id."),
    VField("StaticParameters", &VSubjectParametrised::m_StaticParameters, "Named scalars that expressions refer to."),
    VField("DynamicParameters", &VSubjectParametrised::m_DynamicParameters),
    VField("Segments", &VSubjectParametrised::m_Segments, "The segment tree, parents first."),
    VField("Markers", &VSubjectParametrised::m_Markers),
    VField("Rotations", &VSubjectParametrised::m_Rotations, "Rotation observations."),
    VField("Targets", &VSubjectParametrised::m_Targets),
    VField("TPoseConstraints", &VSubjectParametrised::m_TPoseConstraints));

} // namespace CoreOrlexTypes
