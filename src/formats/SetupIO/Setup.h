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

/// What belongs together: segments of a performer and of a character, or joints of a take and segments.
struct VPair
{
	std::string m_Source;
	std::string m_Target;
	/// Weights of the targets of either kind; nothing for none. A pair of neither kind asks for a rotation.
	std::optional<double> m_Position;
	std::optional<double> m_Rotation;
	std::string m_Comment;
	/// Of the text that it was read from, from 1; 0 for none.
	std::size_t m_Line = 0;

	bool operator==(const VPair& i_rOther) const
	{
		return m_Source == i_rOther.m_Source && m_Target == i_rOther.m_Target && m_Position == i_rOther.m_Position
		    && m_Rotation == i_rOther.m_Rotation && m_Comment == i_rOther.m_Comment;
	}
};

/// One step, as "retarget edit" has it as an option.
struct VEdit
{
	/// Of the option, without dashes.
	std::string m_Name;
	/// As the option takes it; nothing for one that takes none.
	std::optional<std::string> m_Value;
	std::string m_Comment;
	std::size_t m_Line = 0;

	bool operator==(const VEdit& i_rOther) const
	{
		return m_Name == i_rOther.m_Name && m_Value == i_rOther.m_Value && m_Comment == i_rOther.m_Comment;
	}
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

	/// Which fields the text had, with their lines.
	std::vector<std::pair<std::string, std::size_t>> m_Fields;

	/// Lines and which fields are there but empty do not count.
	bool operator==(const VSetup& i_rOther) const
	{
		return m_Comment == i_rOther.m_Comment && m_Fbx == i_rOther.m_Fbx && m_Subject == i_rOther.m_Subject
		    && m_Source == i_rOther.m_Source && m_Output == i_rOther.m_Output && m_Root == i_rOther.m_Root
		    && m_RootHeight == i_rOther.m_RootHeight && m_Pairs == i_rOther.m_Pairs && m_Edits == i_rOther.m_Edits
		    && m_Checks == i_rOther.m_Checks;
	}
};

} // namespace SetupIO
