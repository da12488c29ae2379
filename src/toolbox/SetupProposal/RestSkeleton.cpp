#include "SetupProposal/RestSkeleton.h"

#include <cmath>

namespace SetupProposal
{

VRestSkeleton Sound(VRestSkeleton i_Skeleton)
{
	// Far beyond every stage, and its square is still a number.
	constexpr double c_Farthest = 1e9;
	for (std::size_t i = 0; i < i_Skeleton.size(); ++i)
	{
		VRestJoint& rJoint = i_Skeleton[i];
		if (rJoint.m_Parent < 0 || rJoint.m_Parent >= std::int64_t(i))
			rJoint.m_Parent = -1;
		for (double& rValue : rJoint.m_Place)
			if (!(std::abs(rValue) < c_Farthest))
				rValue = 0.0;
	}
	return i_Skeleton;
}

} // namespace SetupProposal
