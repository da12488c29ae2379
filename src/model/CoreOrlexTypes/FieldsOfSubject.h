#pragma once

// A part of it, and compiled only with it.
#include "CoreOrlexTypes/Fields.h"

namespace CoreOrlexTypes
{

template <>
inline constexpr auto c_Fields<VSubject::VJoint> = Fields(VField("Name", &VSubject::VJoint::m_Name, "Joint name."),
    VField("JointType", &VSubject::VJoint::m_JointType),
    VField("JointOrientation", &VSubject::VJoint::m_JointOrientation, "Orientation of the joint axes, angle-axis."),
    VField("Covariance", &VSubject::VJoint::m_Covariance), VField("Mean", &VSubject::VJoint::m_Mean),
    VField("RangeCentringState", &VSubject::VJoint::m_RangeCentringState,
        "Centres joint states in the middle of the range space."),
    VField("RangeMatrix", &VSubject::VJoint::m_RangeMatrix, "Covariance-like matrix that defines the joint ranges."));

template <>
inline constexpr auto c_Fields<VSubject::VSegment> = Fields(
    VField("Name", &VSubject::VSegment::m_Name, "Segment name."),
    VField("SegmentIndex", &VSubject::VSegment::m_SegmentIndex, "Index (not id) of this segment within VSubject."),
    VField(
        "ParentSegmentIndex", &VSubject::VSegment::m_ParentSegmentIndex, "Index of the parent; 4294967295 means none."),
    VField(
        "TreeDepth", &VSubject::VSegment::m_TreeDepth, "Depth of this segment in the segment tree ( Root is zero )."),
    VField("PreRotation", &VSubject::VSegment::m_PreRotation,
        "Orientation of the joint in the parent segment's frame, angle-axis."),
    VField("PreTranslation", &VSubject::VSegment::m_PreTranslation,
        "Position of the joint in the parent segment's frame."),
    VField("InversePostRotation", &VSubject::VSegment::m_InversePostRotation,
        "Inverse orientation of the child segment in the joint's frame, angle-axis."),
    VField("InversePostTranslation", &VSubject::VSegment::m_InversePostTranslation,
        "Inverse position of the child segment in the joint's frame."),
    VField("Bounds", &VSubject::VSegment::m_Bounds, "Two corners of the box used to show the segment."),
    VField("Joint", &VSubject::VSegment::m_Joint, "The joint that connects this segment to its parent."));

template <>
inline constexpr auto c_Fields<VSubject::VMarker> = Fields(VField("Name", &VSubject::VMarker::m_Name, "Marker name."),
    VField("MarkerId", &VSubject::VMarker::m_MarkerId, "Numeric id, unique in the subject."),
    VField("Radius", &VSubject::VMarker::m_Radius, "Marker radius."), VField("Missing", &VSubject::VMarker::m_Missing),
    VField("ViewAngle", &VSubject::VMarker::m_ViewAngle));

template <>
inline constexpr auto c_Fields<VSubject::VRotation> = Fields(
    VField("Name", &VSubject::VRotation::m_Name), VField("RotationId", &VSubject::VRotation::m_RotationId));

template <>
inline constexpr auto c_Fields<VSubject::VTarget> = Fields(VField("Type", &VSubject::VTarget::m_Type),
    VField("Weight", &VSubject::VTarget::m_Weight, "The amount of influence the target has in the solution."),
    VField("RotationCalibrationBehaviour", &VSubject::VTarget::m_RotationCalibrationBehaviour),
    VField("RotationTargetOrientation", &VSubject::VTarget::m_RotationTargetOrientation,
        "Empty, or an angle-axis vector."),
    VField("NumberOfDegreesOfFreedom", &VSubject::VTarget::m_NumberOfDegreesOfFreedom),
    VField("MarkerIndices", &VSubject::VTarget::m_MarkerIndices, "Indices into Markers."),
    VField("RotationObservationIndices", &VSubject::VTarget::m_RotationObservationIndices, "Indices into Rotations."),
    VField("SegmentIndices", &VSubject::VTarget::m_SegmentIndices, "Indices into Segments."),
    VField("State", &VSubject::VTarget::m_State, "The evaluated state expressions."),
    VField("Covariance", &VSubject::VTarget::m_Covariance, "Uncertainty of the state."),
    VField("ViewNormals", &VSubject::VTarget::m_ViewNormals, "Direction the target faces, in the segment's frame."));

template <>
inline constexpr auto c_Fields<VSubject> = Fields(VField("Name", &VSubject::m_Name, "Subject name."),
    VField("SubjectId", &VSubject::m_SubjectId, "Numeric subject id."),
    VField("Segments", &VSubject::m_Segments, "The segment tree, parents first."),
    VField("Markers", &VSubject::m_Markers), VField("Rotations", &VSubject::m_Rotations, "Rotation observations."),
    VField("Targets", &VSubject::m_Targets));

} // namespace CoreOrlexTypes
