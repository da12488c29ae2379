#pragma once

#include "SetupIO/Setup.h"

#include <string>

/// Every field of the texts, once: its name, where it stands and what it means.
namespace SetupIO::Fields
{

template <typename TOwner, typename TMember>
struct VField
{
	const char* m_pName;
	TMember TOwner::*m_pMember;
	const char* m_pHelp;
};

inline constexpr const char* c_Comment = "comment";
inline constexpr const char* c_CommentHelp = "For people; nothing looks at it";
inline constexpr const char* c_Root = "root";
inline constexpr const char* c_RootHeight = "root-height";
inline constexpr const char* c_Keep = "keep";
inline constexpr const char* c_Scale = "scale";

/// In the order in which they are written, before pairs, edits and checks.
inline constexpr VField<VSetup, std::string> c_Texts[] = {
    {c_Comment, &VSetup::m_Comment, c_CommentHelp},
    {"fbx", &VSetup::m_Fbx, "The character's FBX file. Paths are relative to the folder of this text"},
    {"subject", &VSetup::m_Subject, "A retarget subject to begin with, in place of an FBX file"},
    {"source", &VSetup::m_Source, "The performer's skeleton"},
    {"output", &VSetup::m_Output, "Where the retarget subject is saved"},
    {c_Root, &VSetup::m_Root, "The bone that becomes the root, by name or by index in the file"},
    {c_RootHeight, &VSetup::m_RootHeight, "What the scale does to the height of the root above the floor"},
};

inline constexpr const char* c_Pairs = "pairs";
inline constexpr const char* c_PairsHelp =
    "What belongs together. Each pair becomes targets of the kinds that have a weight, of a rotation if none has";
inline constexpr VField<VPair, std::string> c_PairTexts[] = {
    {"source", &VPair::m_Source, "A segment of the performer, or a joint of a take"},
    {"target", &VPair::m_Target, "A segment of the character or, for a joint of a take, of the performer"},
    {c_Comment, &VPair::m_Comment, c_CommentHelp},
};
inline constexpr VField<VPair, std::optional<double>> c_PairWeights[] = {
    {"position", &VPair::m_Position, "Weight of a position target"},
    {"rotation", &VPair::m_Rotation, "Weight of a rotation target"},
};

inline constexpr const char* c_Edits = "edits";
inline constexpr const char* c_EditsHelp =
    "Steps in their order, each named as the option of \"retarget edit\": true for one without a value";

inline constexpr const char* c_Checks = "checks";
inline constexpr const char* c_ChecksHelp = "What must hold, or nothing is written";
inline constexpr VField<VChecks, bool> c_CheckFlags[] = {
    {"sound", &VChecks::m_bSound, "\"retarget check\" finds nothing"},
    {"no-warnings", &VChecks::m_bNoWarnings, "No warning has been told"},
};
inline constexpr VField<VChecks, std::optional<std::size_t>> c_CheckCounts[] = {
    {"segments", &VChecks::m_Segments, "How many segments there are"},
    {"joints", &VChecks::m_Joints, "How many of them have a joint"},
    {"targets", &VChecks::m_Targets, "How many targets there are"},
};
inline constexpr VField<VChecks, std::optional<double>> c_CheckLimits[] = {
    {"residual-mm", &VChecks::m_ResidualMm, "Largest distance of a target in the bind poses, in mm"},
    {"residual-degrees", &VChecks::m_ResidualDegrees, "Largest angle of a target in the bind poses, in degrees"},
};
inline constexpr const char* c_Pose = "pose";
inline constexpr const char* c_PoseHelp = "What \"retarget map\" finds fine of the pose";
/// What it looks at.
inline constexpr const char* c_PoseIds[] = {"facing", "sides", "arms", "legs", "scale", "floor", "soles"};

} // namespace SetupIO::Fields
