#include "ComputeSubjectFK/TargetFK.h"

namespace ComputeSubject
{

const ITargetFKFactory<CoreOrlexTypes::VSubject::VTarget>* TargetFKFactory(
    CoreOrlexTypes::VSubject::VTarget::ETargetType i_Type)
{
	static const VTargetFKFactory<VTargetFKLocalPointToWorldPoint> s_Point;
	static const VTargetFKFactory<VTargetFKLocalPlaneToWorldPoint> s_Plane;
	static const VTargetFKFactory<VTargetFKLocalLineToWorldPoint> s_Line;
	static const VTargetFKFactory<VTargetFKRigidBody> s_RigidBody;
	static const VTargetFKFactory<VTargetFKLocalRotationToWorldRotation> s_Rotation;
	// By the value of the target type; there is no class for bad targets and for directions.
	static constexpr const ITargetFKFactory<CoreOrlexTypes::VSubject::VTarget>* c_Table[] = {
	    nullptr, &s_Point, &s_Point, &s_Plane, &s_Plane, &s_Line, &s_Line, &s_RigidBody, &s_Rotation, nullptr};
	const auto index = static_cast<std::size_t>(i_Type);
	return index < std::size(c_Table) ? c_Table[index] : nullptr;
}

} // namespace ComputeSubject
