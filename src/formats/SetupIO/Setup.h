#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <utility>
#include <vector>

/// Set-ups as texts. A mapping holds pairs; a preset pairs that have become targets; a file of edits edits, pairs or
/// both; a recipe all that makes a retarget subject of files.
namespace SetupIO
{

/// What is known of the text that something was read from, and no part of what it says: two compare equal.
template <typename T>
struct VOfText
{
	T m_Value{};

	bool operator==(const VOfText&) const { return true; }
};

/// What belongs together: segments of a performer and of a character, or joints of a take and segments.
struct VPair
{
	std::string m_Source;
	std::string m_Target;
	/// Weights of the targets of either kind; nothing for none. A pair of neither kind asks for a rotation.
	std::optional<double> m_Position;
	std::optional<double> m_Rotation;
	std::string m_Comment;
	/// From 1; 0 for none.
	VOfText<std::size_t> m_Line{};

	bool operator==(const VPair&) const = default;
};

/// One step, as "retarget edit" has it as an option.
struct VEdit
{
	/// Of the option, without dashes.
	std::string m_Name;
	/// As the option takes it; nothing for one that takes none.
	std::optional<std::string> m_Value;
	std::string m_Comment;
	VOfText<std::size_t> m_Line{};

	bool operator==(const VEdit&) const = default;
};

/// What must hold of what a recipe makes, or nothing is written.
struct VChecks
{
	/// "retarget check" finds nothing.
	bool m_bSound = false;
	/// No warning has been told.
	bool m_bNoWarnings = false;
	std::optional<std::size_t> m_Segments;
	std::optional<std::size_t> m_Joints;
	std::optional<std::size_t> m_Targets;
	/// Largest residual of a target in the bind poses, in mm and in degrees.
	std::optional<double> m_ResidualMm;
	std::optional<double> m_ResidualDegrees;
	/// What "retarget map" finds fine of the pose: "arms", "floor".
	std::vector<std::string> m_Pose;

	bool operator==(const VChecks&) const = default;
};

struct VSetup
{
	std::string m_Comment;
	/// Paths, relative to the folder of the text. A character's FBX file, or a retarget subject in its place, and the
	/// performer's skeleton.
	std::string m_Fbx;
	std::string m_Subject;
	std::string m_Source;
	/// Where the subject is saved.
	std::string m_Output;
	/// A bone by name, or "#" and its index.
	std::string m_Root;
	/// "keep" or "scale"; empty as the former.
	std::string m_RootHeight;
	/// Become targets before the edits are run.
	std::vector<VPair> m_Pairs;
	std::vector<VEdit> m_Edits;
	std::optional<VChecks> m_Checks;

	/// Which fields there are, also empty ones, with their lines.
	VOfText<std::vector<std::pair<std::string, std::size_t>>> m_Fields{};

	bool operator==(const VSetup&) const = default;
};

} // namespace SetupIO
