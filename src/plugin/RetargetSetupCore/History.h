#pragma once

#include "RetargetSetupCore/TargetState.h"
#include "SetupIO/Setup.h"

#include <cstddef>
#include <cstdint>
#include <deque>
#include <vector>

namespace RetargetSetup
{

/// That old states may take where a program does not say: more than a thousand edits of a character of 70 segments.
inline constexpr std::size_t c_HistoryBytes = std::size_t(256) << 20;

/// An edit as the history knows it.
struct VEdit
{
	/// In the operator's words, as behind "Undo"; of static life.
	const char* m_pName = "Edit";
	/// Edits of one name and one number in a row are one step, such as those of a drag; 0 for an edit by itself.
	std::uint64_t m_Way = 0;
	/// Brings the name of another source along.
	bool m_bNamesSource = false;
	/// As recipes have it; empty for what is seen from what has changed.
	std::vector<SetupIO::VEdit> m_Commands = {};
};

/// The states of a target subject that edits have taken the place of, and those that were gone back from. Values are
/// shared, so that a state costs what it alone holds; beyond a limit the oldest ones go.
class VHistory
{
public:
	explicit VHistory(std::size_t i_MostBytes) : m_MostBytes(i_MostBytes) {}

	/// The edit goes on with the step that was added last.
	bool GoesOn(const VEdit& i_rEdit) const;

	/// An edit was made. What was gone back from is gone, for good once the step ends.
	/// @param i_Before what stood before it.
	/// @return false if old steps had to go.
	bool Add(const VEdit& i_rEdit, VTargetState i_Before, const VTargetState& i_rNow);

	/// No edit goes on with the last step any more. A step that has come back to where it began is none.
	void EndStep(const VTargetState& i_rNow);

	/// Puts what stood before the last step, or behind the one that was gone back from last, in the place of what is.
	/// @param io_rNow complete with what a state holds that is left.
	/// @return the step's name; null, with no change, if there is none.
	const char* Move(bool i_bBack, VTargetState& io_rNow);

	/// Null if there is none.
	const char* NextName(bool i_bBack) const;
	/// The next state; there must be one.
	const VTargetState& Next(bool i_bBack) const { return StepsOf(i_bBack).back().m_State; }

	void Clear();

	std::size_t Bytes() const { return m_Bytes; }
	std::size_t MostBytes() const { return m_MostBytes; }

private:
	struct VStep
	{
		VEdit m_Edit;
		VTargetState m_State;
		std::size_t m_Bytes = 0;
	};
	using VSteps = std::deque<VStep>;

	VSteps& StepsOf(bool i_bBack) { return i_bBack ? m_Back : m_Forward; }
	const VSteps& StepsOf(bool i_bBack) const { return i_bBack ? m_Back : m_Forward; }
	void Drop(VSteps& io_rSteps);

	const std::size_t m_MostBytes;
	std::size_t m_Bytes = 0;
	/// The last one is the next to be undone.
	VSteps m_Back;
	VSteps m_Forward;
	/// What was gone back from, while the last step may still turn out to be none.
	VSteps m_Held;
	bool m_bOpen = false;
};

} // namespace RetargetSetup
