#include "ComputeSubjectFK/JointFK.h"

namespace ComputeSubject
{

const IJointFKFactory* JointFKFactory(VJointFKBase::EJointType i_Type)
{
	static const VJointFKFactory<VJointFKFree> s_Free;
	static const VJointFKFactory<VJointFKBall> s_Ball;
	static const VJointFKFactory<VJointFKHardySpicer> s_HardySpicer;
	static const VJointFKFactory<VJointFKHinge> s_Hinge;
	static const VJointFKFactory<VJointFKSlider> s_Slider;
	static const VJointFKFactory<VJointFKDummy> s_Dummy;
	// By the value of the joint type.
	static constexpr const IJointFKFactory* c_Table[] = {
	    &s_Free, &s_Ball, &s_HardySpicer, &s_Hinge, &s_Slider, &s_Dummy};
	const auto index = static_cast<std::size_t>(i_Type);
	return index < std::size(c_Table) ? c_Table[index] : nullptr;
}

} // namespace ComputeSubject
