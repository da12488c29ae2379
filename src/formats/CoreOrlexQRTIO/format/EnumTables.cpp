#include "CoreOrlexQRTIO/format/EnumTables.h"

namespace CoreOrlexQRTIO::EnumTables
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using UtilsRapidXml::VEnum;

const VEnum<VSubjectApplicationData::VSegment::EDrawShading>& DrawShading()
{
	using VSegment = VSubjectApplicationData::VSegment;
	static const auto s_Table = VEnum<VSegment::EDrawShading>("TYPE_DRAW-SHADING")
	                                .Add(VSegment::EDrawShadingWireFrameUnlit, "wireframe-unlit")
	                                .Add(VSegment::EDrawShadingWireFrameLit, "wireframe-lit")
	                                .Add(VSegment::EDrawShadingShadedFlat, "shaded-flat")
	                                .Add(VSegment::EDrawShadingShadedSmooth, "shaded-smooth");
	return s_Table;
}

const VEnum<VSubjectApplicationData::VSegment::EDrawStyle>& DrawStyle()
{
	using VSegment = VSubjectApplicationData::VSegment;
	static const auto s_Table = VEnum<VSegment::EDrawStyle>("TYPE_DRAW-STYLE")
	                                .Add(VSegment::EDrawStyleTetrahedron, "tetrahedron")
	                                .Add(VSegment::EDrawStyleTetraStripe, "tetra-stripe")
	                                .Add(VSegment::EDrawStyleBox, "box")
	                                .Add(VSegment::EDrawStyleCarton, "carton")
	                                .Add(VSegment::EDrawStyleHead, "head")
	                                .Add(VSegment::EDrawStyleSpine, "spine")
	                                .Add(VSegment::EDrawStyleCylinder, "cylinder")
	                                .Add(VSegment::EDrawStyleBodyPart, "bodypart");
	return s_Table;
}

const VEnum<VSubjectApplicationData::VJoint::EEulerOrder>& EulerOrder()
{
	using VJoint = VSubjectApplicationData::VJoint;
	static const auto s_Table = VEnum<VJoint::EEulerOrder>("TYPE_EULER-ORDER")
	                                .Add(VJoint::EXYZ, "XYZ")
	                                .Add(VJoint::EXZY, "XZY")
	                                .Add(VJoint::EYXZ, "YXZ")
	                                .Add(VJoint::EYZX, "YZX")
	                                .Add(VJoint::EZXY, "ZXY")
	                                .Add(VJoint::EZYX, "ZYX");
	return s_Table;
}

const VEnum<VSubjectParametrised::VStaticParameter::EQuantity>& Quantity()
{
	using VStaticParameter = VSubjectParametrised::VStaticParameter;
	static const auto s_Table = VEnum<VStaticParameter::EQuantity>("TYPE_QUANTITY")
	                                .Add(VStaticParameter::EQuantityScalar, "scalar")
	                                .Add(VStaticParameter::EQuantityLength, "length")
	                                .Add(VStaticParameter::EQuantityAngle, "angle")
	                                .Add(VStaticParameter::EQuantityMass, "mass")
	                                .Add(VStaticParameter::EQuantityTime, "time");
	return s_Table;
}

const VEnum<std::uint32_t>& Status()
{
	using VMarker = VSubjectParametrised::VMarker;
	static const auto s_Table = VEnum<std::uint32_t>("TYPE_STATUS")
	                                .Add(VMarker::ERequired, "required")
	                                .Add(VMarker::EOptional, "optional")
	                                .Add(VMarker::ECalibrationOnly, "constraint")
	                                .Add(VMarker::EVirtualCalibrationOnly, "virtual-constraint")
	                                .Add(c_StatusMissing | VMarker::EOptional, "missing")
	                                .Add(c_StatusMissing | VMarker::ECalibrationOnly, "missing-constraint");
	return s_Table;
}

const VEnum<VSubjectApplicationData::VTarget::EDrawStyle>& TargetDrawStyle()
{
	using VTarget = VSubjectApplicationData::VTarget;
	static const auto s_Table = VEnum<VTarget::EDrawStyle>("TYPE_TARGET-DRAW-STYLE")
	                                .Add(VTarget::EDrawStyleNone, "None")
	                                .Add(VTarget::EDrawStyleError, "Error")
	                                .Add(VTarget::EDrawStyleBoneLines, "BoneLines");
	return s_Table;
}

} // namespace CoreOrlexQRTIO::EnumTables
