#pragma once

#include "SetupProposal/NameWords.h"
#include "SetupProposal/RestSkeleton.h"

#include <optional>

namespace SetupProposal
{

inline constexpr double c_UsualLegsUp = 0.53;
inline constexpr double c_UsualArmsUp = 0.83;

/// Where a body at rest has its left and its front, by its shape. Directions are unit vectors in the horizontal plane.
struct VBodyFrame
{
	Rotation::VVector3 m_Left{1.0, 0.0, 0.0};
	Rotation::VVector3 m_Forward{0.0, -1.0, 0.0};
	/// A point of the plane that mirrors one side on the other, in mm.
	Rotation::VVector3 m_Centre{};
	/// Of the lowest joint, and from there to the highest, in mm. At least 1e-6.
	double m_Floor = 0.0;
	double m_Height = 1.0;
	/// What told left from right: the names, or the feet, which point to the front. If both did, whether they agree: if
	/// not, feet that clearly point somewhere win.
	bool m_bSidesByName = false;
	bool m_bFrontByFeet = false;
	bool m_bContradiction = false;
	/// How high legs and arms begin, as parts of the height: as in most bodies, until the limbs are known.
	double m_LegsUp = c_UsualLegsUp;
	double m_ArmsUp = c_UsualArmsUp;
};

/// @param i_rNames of the joints.
/// @param i_rTwins of the joints, as FindTwins gives them.
VBodyFrame BodyFrameOf(const VRestSkeleton& i_rSkeleton, const std::vector<VNameWords>& i_rNames,
    const std::vector<std::int64_t>& i_rTwins);

/// A place as the body has it, as parts of its height: to the left of the mirror plane, to the front of its centre,
/// above the lowest joint.
struct VBodyPlace
{
	double m_Left = 0.0;
	double m_Forward = 0.0;
	double m_Up = 0.0;
};

VBodyPlace PlaceIn(const VBodyFrame& i_rFrame, const Rotation::VVector3& i_rPlace);

/// Where a height would be in a body of usual proportions: heads may be as large as the rest.
double UsualUp(const VBodyFrame& i_rFrame, double i_Up);

} // namespace SetupProposal
