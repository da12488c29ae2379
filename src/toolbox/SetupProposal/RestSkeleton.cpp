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

VRestSkeleton Posed(VRestSkeleton i_Skeleton, const std::vector<Rotation::VMatrix3>& i_rTurns,
    const std::vector<Rotation::VVector3>& i_rPlaces)
{
	for (std::size_t i = 0; i < i_Skeleton.size(); ++i)
	{
		VRestJoint& rJoint = i_Skeleton[i];
		if (rJoint.m_Skin)
		{
			VRestSkin& rSkin = *rJoint.m_Skin;
			for (std::size_t axis = 0; axis < 3; ++axis)
				rSkin.m_Centre[axis] -= rJoint.m_Place[axis];
			rSkin.m_Centre = Rotation::Product(i_rTurns[i], rSkin.m_Centre);
			for (std::size_t axis = 0; axis < 3; ++axis)
				rSkin.m_Centre[axis] += i_rPlaces[i][axis];
			rSkin.m_Axes = Rotation::Product(i_rTurns[i], rSkin.m_Axes);
			rSkin.m_BoundUp = Rotation::Product(i_rTurns[i], rSkin.m_BoundUp);
		}
		rJoint.m_Place = i_rPlaces[i];
	}
	return i_Skeleton;
}

} // namespace SetupProposal
