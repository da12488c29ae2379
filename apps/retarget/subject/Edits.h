#pragma once

#include "retarget/subject/Session.h"

#include "SetupIO/WriteSetup.h"

#include <CLI/CLI.hpp>

#include <memory>
#include <string>
#include <vector>

namespace CommandLine
{

/// One kind of edit: its option, and what it does to a session. Throws VCommandError to fail.
struct VEditKind
{
	const char* m_pName;
	/// What its value is called in the help, null for an edit without one.
	const char* m_pValue;
	const char* m_pHelp;
	void (*m_pApply)(VSession& io_rSession, const std::string& i_rValue);
	/// Needs the FBX file beside the subject.
	bool m_bOfCreate = false;
	/// Its value is a path, which in a text is relative to the text's folder.
	bool m_bFile = false;
};

struct VEdit
{
	/// Null for a pair.
	const VEditKind* m_pKind = nullptr;
	std::string m_Value;
	/// Where it stands in a file of edits, as "FILE:LINE: "; empty for one of the command line.
	std::string m_Where;
	/// Becomes targets.
	SetupIO::VPair m_Pair = {};
};

/// Edits in the order in which they stand on the line.
using VEdits = std::vector<VEdit>;

/// Pairs and edits of a text, pairs first. Throws VCommandError with EBadInput for an edit that there is not.
/// @param i_rPath of the text.
VEdits EditsOf(const SetupIO::VSetup& i_rSetup, const std::string& i_rPath, bool i_bOfCreate);

/// All edits, as texts have them.
std::vector<SetupIO::VEditForm> EditForms();

/// Adds the options of all edits to a command; parsing appends to the list.
void AddEditOptions(CLI::App& io_rApp, const std::shared_ptr<VEdits>& i_rpEdits, bool i_bOfCreate);

/// Whether one of them looks at what is proposed, which needs a source, and the root that the body hangs on.
bool TakesProposal(const VEdits& i_rEdits);

/// Whether --auto and --align stand on the command line itself, and nothing tells of the scale: then it is left open.
bool LeavesScale(const VEdits& i_rEdits);

/// "--root-height", which is no edit: it counts for all of them.
/// @param o_rWord must outlive the parsing.
void AddRootHeightOption(CLI::App& io_rApp, std::string& o_rWord);
inline constexpr const char* c_pScaleRootHeight = "scale";

/// Runs them in order, with the document's callbacks after each. Throws VCommandError with EFindings if --symmetry
/// found no partner for a target of one side.
void ApplyEdits(VSession& io_rSession, const VEdits& i_rEdits);

} // namespace CommandLine
