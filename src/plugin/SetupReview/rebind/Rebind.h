#pragma once

#include "FBXIO/SkinSkeleton.h"
#include "SetupProposal/Proposal.h"
#include "SetupReview/compare/Comparison.h"
#include "numerics/Matrix4.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

/// Retarget subjects that go on with another file of their character or their performer.
namespace SetupReview
{

enum class ERebindRule
{
	None,
	Name,
	/// At the same place beneath the same parent.
	Place,
	/// As the same part of a body.
	Proposal
};

/// What became of a segment: of the character by indices, of the performer by names.
struct VRebindMatch
{
	std::string m_Old;
	/// Empty if there is none.
	std::string m_New;
	ERebindRule m_Rule = ERebindRule::None;
	/// From 0 to 1; 1 by names and places.
	double m_Score = 0.0;
};

struct VRebound
{
	/// Why nothing was done, a sentence; empty if it was.
	std::string m_Refusal;
	VSetup m_Setup;
	/// One for each old segment of the character, or for each segment of the performer that targets follow.
	std::vector<VRebindMatch> m_Matches;
	/// Segments of the character that have no old one.
	std::vector<std::string> m_Added;
	/// What could not be kept, a sentence each.
	std::vector<std::string> m_Lost;
	/// What was recomputed or kept, beside names.
	std::vector<VSetupChange> m_Changes;
};

struct VNewCharacter
{
	/// All bones of the file.
	const FBXIO::VSkinSkeleton& m_rBones;
	/// Turns the file's space into the system's Z-up space.
	Rotation::VMatrix4 m_Axis;
	/// The file's stem, which the skin is found by.
	std::string m_Name;
	/// The bone that the segments begin at; without one the old root's, by name or by what it is of the body.
	std::optional<std::size_t> m_Root;
};

/// Segments are matched by name, then by place, then by what they are of a body. Targets, joints and bind poses are
/// kept: every segment keeps its orientation in the world, and every target what it follows, so that offsets change by
/// as much as the new lengths move their segments. The lowest segment keeps its height. Segments that are new have a
/// joint if all old ones had, and stand as in the file. The same file again changes nothing.
/// Refused for subjects with joints that no FBX file gives.
/// @param i_LeastScore of pairs that are matched as parts of a body
VRebound RebindCharacter(const VSetup& i_rSetup, const VNewCharacter& i_rCharacter,
    double i_LeastScore = SetupProposal::c_DefaultLeastScore);

/// Targets follow the segments of the same names of another performer, and where there is none the one that would be
/// proposed for their segment of the character. Offsets stay as they are. A target whose source finds none keeps the
/// name that it has.
/// @param i_rSource, i_rTarget at rest; the segments of i_rTarget are those of the set-up.
/// @param i_rName stem of the performer's file.
VRebound RebindPerformer(const VSetup& i_rSetup, const SetupProposal::VRestSkeleton& i_rSource,
    const SetupProposal::VRestSkeleton& i_rTarget, const std::string& i_rName,
    double i_LeastScore = SetupProposal::c_DefaultLeastScore);

} // namespace SetupReview
