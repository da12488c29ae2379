#pragma once

#include "SetupProposal/RestSkeleton.h"

#include <cstddef>
#include <map>
#include <string>
#include <vector>

namespace SetupProposal
{

struct VMappedJoints
{
	std::size_t m_Source = 0;
	std::size_t m_Target = 0;
};

struct VAlignmentRequest
{
	/// A joint of the target stands in one at most.
	std::vector<VMappedJoints> m_Pairs;
	/// The chains that are wanted. The back brings the body's facing along; others are what no part of a body was
	/// recognised in.
	bool m_bSpine = true;
	bool m_bArms = true;
	bool m_bLegs = true;
	bool m_bOthers = true;
	/// Whether feet lean as the shins do, seen from ahead; else they keep their tilt.
	bool m_bFeetWithShins = false;
	/// Joints of the target that keep their pose against their parent, and why: "is locked".
	std::map<std::size_t, std::string> m_Held;
};

/// A joint that points somewhere: to the next mapped joint of its chain.
struct VAlignedJoint
{
	std::size_t m_Source = 0;
	std::size_t m_Target = 0;
	/// Between where it points and where the source's does, in degrees; of feet as seen from above.
	double m_Before = 0.0;
	double m_After = 0.0;
	/// What is particular, as a phrase; mostly empty.
	std::string m_Note;
};

struct VRefusedChain
{
	/// "left arm".
	std::string m_Chain;
	/// A sentence for the operator.
	std::string m_Reason;
};

/// How a target is brought to the pose of a source.
struct VAlignment
{
	/// For each joint of the target how it turns in the world, with what it hangs on.
	std::vector<Rotation::VMatrix3> m_Turns;
	/// Where the joints then stand, in mm.
	std::vector<Rotation::VVector3> m_Places;
	/// In the order of the target.
	std::vector<VAlignedJoint> m_Joints;
	/// Chains that would stand worse than they do, and stay as they are.
	std::vector<VRefusedChain> m_Refused;
	/// Of the whole about the vertical, to the left as seen from above.
	double m_TurnDegrees = 0.0;
	/// Of the root: along the floor, so that the feet stand where the source's do, and up, so that the skin of the feet
	/// touches the floor. Where no skin is known, they stand as high as they did or, if that was not the floor, on it.
	Rotation::VVector3 m_MoveMm{};
};

/// Turns each joint of a chain by the smallest angle that lets it point where the source's points, from the root on:
/// what it is turned about its own length stays. Clavicles and what is no part of a chain keep their pose against their
/// parent; so does a pelvis, whose hips are brought level with the source's. Head and feet keep their tilt in the
/// world, a foot turns about the vertical: their slopes are of the build, not of the pose. A foot whose sole was more
/// level when its skin was bound is held as it was then, and so are its toes: the pose is a stride. Where the source's
/// soles lean outwards with splayed shins, which no joint's place tells, feet go with the shins on request.
///
/// The whole is moved to where the source's feet stand. Offsets of targets turn with their segments: a foot whose ankle
/// stands 50 mm behind the source's would be lifted by 25 mm with each heel.
VAlignment Align(const VRestSkeleton& i_rSource, const VRestSkeleton& i_rTarget, const VAlignmentRequest& i_rRequest);

} // namespace SetupProposal
