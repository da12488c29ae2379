#include "TestSubject.h"

namespace TestSubject
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

VSubject Make()
{
	VSubject subject;
	subject.m_Name = "Ann";
	subject.m_SubjectId = c_Id;
	const struct
	{
		const char* m_pName;
		std::uint32_t m_Parent;
		std::array<double, 3> m_Offset;
		VJoint::EJointType m_Joint;
	} c_Segments[] = {{"Root", CoreOrlexTypes::c_NoParent, {0, 0, 0}, VJoint::EFree},
	    {"Spine", ERoot, {0, 0, 100}, VJoint::EBall}, {"Limb", ESpine, {300, 0, 0}, VJoint::EHinge},
	    {"Tip", ELimb, {0, 50, 0}, VJoint::EDummy}, {"Short", ESpine, {0, 0, 0}, VJoint::EDummy}};
	for (const auto& rRow : c_Segments)
	{
		VSubject::VSegment segment;
		segment.m_Name = rRow.m_pName;
		segment.m_SegmentIndex = std::uint32_t(subject.m_Segments.size());
		segment.m_ParentSegmentIndex = rRow.m_Parent;
		segment.m_PreTranslation = rRow.m_Offset;
		segment.m_Joint.m_JointType = rRow.m_Joint;
		subject.m_Segments.push_back(segment);
	}
	for (const char* const pName : {"M0", "M1", "M2"})
	{
		VSubject::VMarker marker;
		marker.m_Name = pName;
		marker.m_Radius = 7.0;
		subject.m_Markers.push_back(marker);
	}
	subject.m_Rotations.resize(1);

	VSubject::VTarget point;
	point.m_Type = VSubject::VTarget::ELocalPointToWorldPoint;
	point.m_MarkerIndices = {0};
	point.m_SegmentIndices = {ELimb};
	point.m_State = {0, 10, 0};
	point.m_Covariance = {400, 0, 0, 0, 900, 0, 0, 0, 1600};
	VSubject::VTarget rotation;
	rotation.m_Type = VSubject::VTarget::ELocalRotationToWorldRotation;
	rotation.m_RotationObservationIndices = {0};
	rotation.m_SegmentIndices = {ESpine};
	rotation.m_State = {1.5707963267948966, 0, 0};
	VSubject::VTarget body;
	body.m_Type = VSubject::VTarget::ERigidBody;
	body.m_MarkerIndices = {1, 2};
	body.m_SegmentIndices = {ELimb};
	body.m_State = {0, 0, 60, 0, 0, 0, 40, 0, 0, -40, 0, 0};
	subject.m_Targets = {point, rotation, body};
	return subject;
}

VSubjectApplicationData MakeData()
{
	VSubjectApplicationData data;
	data.m_SubjectId = c_Id;
	data.m_Segments.resize(ETip + 1);
	data.m_Segments[ERoot].m_Colour = {255, 0, 0, 255};
	data.m_Segments[ESpine].m_Colour = {0, 204, 51, 102};
	data.m_Segments[ELimb].m_Colour = {0, 0, 255, 255};
	data.m_Segments[ETip].m_Visible = false;
	data.m_Targets.resize(ETargetCount);
	data.m_Targets[EPoint].m_Name = "Ann Limb point";
	data.m_Targets[EPoint].m_Colour = {255, 255, 0, 255};
	data.m_Markers.resize(3, {{0, 255, 255, 255}});
	data.m_Sticks = {{0, {255, 255, 255, 255}, 1, {0, 0, 255, 255}}, {1, {255, 0, 0, 255}, 2, {0, 255, 0, 255}}};
	return data;
}

CoreOrlexTypes::VSubjectDynamicParameters MakePose()
{
	return {c_Id, {0, 0, 1.5707963267948966, 10, 20, 30, 0, 0, 0, 0}};
}

NVX::CountedPointer<TesselPluginInterface::IFlowFrame> MakeFrame(
    const std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>>& i_rItems)
{
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> pFrame(new InMemoryHost::VFlowFrame);
	for (const auto& rpItem : i_rItems)
		pFrame->AddItem(rpItem);
	return pFrame;
}

NVX::CountedPointer<TesselPluginInterface::IFlowFrame> MakeSubjectFrame(const Flow2Graphics::VSubjectTypes& i_rTypes,
    const CoreOrlexTypes::VReconstructionLabelSet* i_pLabels, const CoreOrlexTypes::VSubjectDynamicParameters& i_rPose,
    const VSubjectApplicationData& i_rData)
{
	std::vector items{
	    Item(i_rTypes.m_Subject, Make()), Item(i_rTypes.m_ApplicationData, i_rData), Item(i_rTypes.m_Pose, i_rPose)};
	if (i_pLabels)
		items.push_back(Item(i_rTypes.m_Labels, *i_pLabels));
	if (i_rTypes.m_Settings)
		items.push_back(Item(i_rTypes.m_Settings,
		    CoreOrlexTypes::VSubjectSettings{c_Id, i_rTypes.m_Class == Flow2Graphics::ESubjectClassProp}));
	return MakeFrame(items);
}

} // namespace TestSubject
