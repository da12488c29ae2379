#include "CoreOrlexTypes/JointType.h"

std::vector<double> CoreOrlexTypes::DefaultCovariance(VSubjectParametrised::VJoint::EJointType i_Type)
{
	using VJoint = VSubjectParametrised::VJoint;
	const std::size_t size = StateSize(i_Type);
	std::vector<double> covariance(size * size, 0.0);
	for (std::size_t i = 0; i < size; ++i)
	{
		const bool bTranslation = i_Type == VJoint::ESlider || i >= 3;
		covariance[i * size + i] = bTranslation ? 1e8 : 10.0;
	}
	return covariance;
}
