#pragma once

// A part of it, and compiled only with it.
#include "CoreOrlexTypes/Fields.h"

namespace CoreOrlexTypes
{

template <>
inline constexpr auto c_Enumeration<VSubjectApplicationData::VJoint::EEulerOrder> =
    VEnumeration<VSubjectApplicationData::VJoint::EEulerOrder, 7>("SubjectApplicationData.Joint.EEulerOrder",
        "Different kinds of Euler angle orders.",
        {{VSubjectApplicationData::VJoint::EXYZ, "XYZ"}, {VSubjectApplicationData::VJoint::EXZY, "XZY"},
            {VSubjectApplicationData::VJoint::EYXZ, "YXZ"}, {VSubjectApplicationData::VJoint::EYZX, "YZX"},
            {VSubjectApplicationData::VJoint::EZXY, "ZXY"}, {VSubjectApplicationData::VJoint::EZYX, "ZYX"},
            {VSubjectApplicationData::VJoint::ENone, "None"}});

template <>
inline constexpr auto c_Enumeration<VSubjectApplicationData::VSegment::EDrawShading> =
    VEnumeration<VSubjectApplicationData::VSegment::EDrawShading, 4>("SubjectApplicationData.Segment.EDrawShading",
        "Different kinds of draw shading.",
        {{VSubjectApplicationData::VSegment::EDrawShadingWireFrameUnlit, "DrawShadingWireFrameUnlit"},
            {VSubjectApplicationData::VSegment::EDrawShadingWireFrameLit, "DrawShadingWireFrameLit"},
            {VSubjectApplicationData::VSegment::EDrawShadingShadedFlat, "DrawShadingShadedFlat"},
            {VSubjectApplicationData::VSegment::EDrawShadingShadedSmooth, "DrawShadingShadedSmooth"}});

template <>
inline constexpr auto c_Enumeration<VSubjectApplicationData::VSegment::EDrawStyle> =
    VEnumeration<VSubjectApplicationData::VSegment::EDrawStyle, 8>("SubjectApplicationData.Segment.EDrawStyle",
        "Different kinds of draw style.",
        {{VSubjectApplicationData::VSegment::EDrawStyleTetrahedron, "DrawStyleTetrahedron"},
            {VSubjectApplicationData::VSegment::EDrawStyleTetraStripe, "DrawStyleTetraStripe"},
            {VSubjectApplicationData::VSegment::EDrawStyleBox, "DrawStyleBox"},
            {VSubjectApplicationData::VSegment::EDrawStyleCarton, "DrawStyleCarton"},
            {VSubjectApplicationData::VSegment::EDrawStyleHead, "DrawStyleHead"},
            {VSubjectApplicationData::VSegment::EDrawStyleSpine, "DrawStyleSpine"},
            {VSubjectApplicationData::VSegment::EDrawStyleCylinder, "DrawStyleCylinder"},
            {VSubjectApplicationData::VSegment::EDrawStyleBodyPart, "DrawStyleBodyPart"}});

template <>
inline constexpr auto c_Enumeration<VSubjectApplicationData::VTarget::EDrawStyle> =
    VEnumeration<VSubjectApplicationData::VTarget::EDrawStyle, 3>("SubjectApplicationData.Target.EDrawStyle",
        "Different kinds of draw style.",
        {{VSubjectApplicationData::VTarget::EDrawStyleNone, "DrawStyleNone"},
            {VSubjectApplicationData::VTarget::EDrawStyleError, "DrawStyleError"},
            {VSubjectApplicationData::VTarget::EDrawStyleBoneLines, "DrawStyleBoneLines"}});

template <>
inline constexpr auto c_Fields<VSubjectApplicationData::VMarker> = Fields(
    VField("Colour", &VSubjectApplicationData::VMarker::m_Colour));

template <>
inline constexpr auto c_Fields<VSubjectApplicationData::VJoint> = Fields(
    VField("EulerOrder", &VSubjectApplicationData::VJoint::m_EulerOrder, "The order used to display the state."),
    VField("Labels", &VSubjectApplicationData::VJoint::m_Labels, "A list of labels of the state components."),
    VField("Signs", &VSubjectApplicationData::VJoint::m_Signs, "A list of + or - for the state components."));

template <>
inline constexpr auto c_Fields<VSubjectApplicationData::VSegment> = Fields(
    VField("Colour", &VSubjectApplicationData::VSegment::m_Colour),
    VField("Context", &VSubjectApplicationData::VSegment::m_Context,
        "Context of the segment, for instance left or right."),
    VField("DrawEndRatio", &VSubjectApplicationData::VSegment::m_DrawEndRatio,
        "Ratio between the size of the start and end of the geometry."),
    VField("DrawHeight", &VSubjectApplicationData::VSegment::m_DrawHeight, "Multiplier on the height of the geometry."),
    VField("DrawShading", &VSubjectApplicationData::VSegment::m_DrawShading),
    VField("DrawStyle", &VSubjectApplicationData::VSegment::m_DrawStyle),
    VField("DrawTwist", &VSubjectApplicationData::VSegment::m_DrawTwist, "Rotation applied to the geometry."),
    VField("DrawWidth", &VSubjectApplicationData::VSegment::m_DrawWidth, "Multiplier on the width of the geometry."),
    VField("Part", &VSubjectApplicationData::VSegment::m_Part, "The part of the body that the segment represents."),
    VField("Visible", &VSubjectApplicationData::VSegment::m_Visible),
    VField("Joint", &VSubjectApplicationData::VSegment::m_Joint));

template <>
inline constexpr auto c_Fields<VSubjectApplicationData::VStick> = Fields(
    VField("MarkerIndexA", &VSubjectApplicationData::VStick::m_MarkerIndexA,
        "Index (not id) of first marker within the associated VSubject."),
    VField("ColourA", &VSubjectApplicationData::VStick::m_ColourA),
    VField("MarkerIndexB", &VSubjectApplicationData::VStick::m_MarkerIndexB,
        "Index (not id) of second marker within the associated VSubject."),
    VField("ColourB", &VSubjectApplicationData::VStick::m_ColourB));

template <>
inline constexpr auto c_Fields<VSubjectApplicationData::VTarget> = Fields(
    VField("Colour", &VSubjectApplicationData::VTarget::m_Colour),
    VField("DrawStyle", &VSubjectApplicationData::VTarget::m_DrawStyle),
    VField("FillGaps", &VSubjectApplicationData::VTarget::m_FillGaps),
    VField("Name", &VSubjectApplicationData::VTarget::m_Name),
    VField("Visible", &VSubjectApplicationData::VTarget::m_Visible));

template <>
inline constexpr auto c_Fields<VSubjectApplicationData> = Fields(
    VField("SubjectId", &VSubjectApplicationData::m_SubjectId, "The subject it belongs to."),
    VField("Colour", &VSubjectApplicationData::m_Colour, "Colour of the subject."),
    VField("Markers", &VSubjectApplicationData::m_Markers, "One per subject marker."),
    VField("Segments", &VSubjectApplicationData::m_Segments, "One per subject segment."),
    VField("Sticks", &VSubjectApplicationData::m_Sticks, "Lines drawn between markers."),
    VField("Targets", &VSubjectApplicationData::m_Targets, "One per subject target."),
    VField("Skin", &VSubjectApplicationData::m_Skin, "Skin name."),
    VField("SkinColourA", &VSubjectApplicationData::m_SkinColourA, "Primary skin colour."),
    VField("SkinColourB", &VSubjectApplicationData::m_SkinColourB, "Secondary skin colour."),
    VField("RetargetSourceTemplate", &VSubjectApplicationData::m_RetargetSourceTemplate,
        "File of the source template of a retarget subject."),
    VField("RetargetSourceSubject", &VSubjectApplicationData::m_RetargetSourceSubject,
        "Name of the source subject of a retarget subject."));

} // namespace CoreOrlexTypes
