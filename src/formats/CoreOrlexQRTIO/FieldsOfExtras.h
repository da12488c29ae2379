#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/Fields.h"

/// The one description of the extras, as CoreOrlexTypes/Fields.h is of the subject types. Costly to compile: for source
/// files only.
namespace CoreOrlexTypes
{

using CoreOrlexQRTIO::VSubjectQRTExtras;

template <>
inline constexpr auto c_Fields<VSubjectQRTExtras::VJoint> = Fields(VField("Signs", &VSubjectQRTExtras::VJoint::m_Signs),
    VField("Labels", &VSubjectQRTExtras::VJoint::m_Labels),
    VField("EditPoseMean", &VSubjectQRTExtras::VJoint::m_EditPoseMean),
    VField("TPose", &VSubjectQRTExtras::VJoint::m_TPose), VField("Bounds", &VSubjectQRTExtras::VJoint::m_Bounds),
    VField("HasT", &VSubjectQRTExtras::VJoint::m_bHasT), VField("Axis", &VSubjectQRTExtras::VJoint::m_Axis),
    VField("PostOrientation", &VSubjectQRTExtras::VJoint::m_PostOrientation),
    VField("PostPosition", &VSubjectQRTExtras::VJoint::m_PostPosition),
    VField("TemplateInversePostOrientation", &VSubjectQRTExtras::VJoint::m_TemplateInversePostOrientation),
    VField("TemplateInversePostPosition", &VSubjectQRTExtras::VJoint::m_TemplateInversePostPosition),
    VField("TemplatePostOrientation", &VSubjectQRTExtras::VJoint::m_TemplatePostOrientation),
    VField("TemplatePostPosition", &VSubjectQRTExtras::VJoint::m_TemplatePostPosition));

template <>
inline constexpr auto c_Fields<VSubjectQRTExtras::VSegment> = Fields(
    VField("Name", &VSubjectQRTExtras::VSegment::m_Name),
    VField("Covariance", &VSubjectQRTExtras::VSegment::m_Covariance),
    VField("Size", &VSubjectQRTExtras::VSegment::m_Size), VField("Joint", &VSubjectQRTExtras::VSegment::m_Joint));

template <>
inline constexpr auto c_Fields<VSubjectQRTExtras::VMarker> = Fields(VField("Name", &VSubjectQRTExtras::VMarker::m_Name),
    VField("Descriptor", &VSubjectQRTExtras::VMarker::m_Descriptor),
    VField("Position", &VSubjectQRTExtras::VMarker::m_Position),
    VField("TemplatePosition", &VSubjectQRTExtras::VMarker::m_TemplatePosition),
    VField("TemplatePlacementCovariance", &VSubjectQRTExtras::VMarker::m_TemplatePlacementCovariance));

template <>
inline constexpr auto c_Fields<VSubjectQRTExtras::VTarget> = Fields(
    VField("Name", &VSubjectQRTExtras::VTarget::m_Name), VField("Axis", &VSubjectQRTExtras::VTarget::m_Axis));

template <>
inline constexpr auto c_Fields<VSubjectQRTExtras::VPrincipalComponent> = Fields(
    VField("Name", &VSubjectQRTExtras::VPrincipalComponent::m_Name),
    VField("JointParams", &VSubjectQRTExtras::VPrincipalComponent::m_JointParams),
    VField("SqrtEigenvalue", &VSubjectQRTExtras::VPrincipalComponent::m_SqrtEigenvalue),
    VField("LowerBound", &VSubjectQRTExtras::VPrincipalComponent::m_LowerBound),
    VField("UpperBound", &VSubjectQRTExtras::VPrincipalComponent::m_UpperBound),
    VField("TemporalDerivativeSd", &VSubjectQRTExtras::VPrincipalComponent::m_TemporalDerivativeSd));

template <>
inline constexpr auto c_Fields<VSubjectQRTExtras::VDynamicSubspace> = Fields(
    VField("Name", &VSubjectQRTExtras::VDynamicSubspace::m_Name),
    VField("Version", &VSubjectQRTExtras::VDynamicSubspace::m_Version),
    VField("JointNames", &VSubjectQRTExtras::VDynamicSubspace::m_JointNames),
    VField("JointParamsMean", &VSubjectQRTExtras::VDynamicSubspace::m_JointParamsMean),
    VField("Components", &VSubjectQRTExtras::VDynamicSubspace::m_Components));

template <>
inline constexpr auto c_Fields<VSubjectQRTExtras> = Fields(VField("Segments", &VSubjectQRTExtras::m_Segments),
    VField("Markers", &VSubjectQRTExtras::m_Markers), VField("Targets", &VSubjectQRTExtras::m_Targets),
    VField("DynamicSubspaces", &VSubjectQRTExtras::m_DynamicSubspaces),
    VField("SubspaceId", &VSubjectQRTExtras::m_SubspaceId), VField("SubspaceHash", &VSubjectQRTExtras::m_SubspaceHash));

} // namespace CoreOrlexTypes
