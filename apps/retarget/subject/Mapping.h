#pragma once

#include "retarget/subject/Session.h"

#include "SetupIO/Setup.h"
#include "SetupProposal/Proposal.h"

#include <string>

/// Pairs of segments that the program proposes. All throw VCommandError to fail.
namespace CommandLine
{

/// "--min-score": a number from 0 to 1.
double ParseScore(const std::string& i_rWord);

struct VMapped
{
	SetupProposal::VRestSkeleton m_Source;
	SetupProposal::VRestSkeleton m_Target;
	SetupProposal::VProposal m_Proposal;
	/// The root of the target that the body hangs on, -1 for none.
	std::int64_t m_Root = -1;
};

/// Of the session's source and the bones of its FBX file, as they stand there, by the session's minimum score.
/// @param i_rRoot all below it, with indices as its subject has them; without one all bones of the file.
VMapped ProposeForFile(VSession& io_rSession, const std::optional<std::size_t>& i_rRoot = std::nullopt);

/// Of the session's source and its target subject: as the file has it where it was made, in its bind pose where it was
/// loaded.
VMapped ProposeForSubject(VSession& io_rSession);

/// As "map --json" prints it, but for how the two stand.
VJson MappedToJson(const VMapped& i_rMapped);

/// Adds the targets of all pairs that are proposed for the session's target subject, with their weights, and tells how
/// many. EFindings if no pair scores enough.
void AddProposedTargets(VSession& io_rSession);

/// Adds the targets of a pair of segments, with their weights; a target that is there stays as it is.
void AddPairTargets(VSession& io_rSession, const SetupIO::VPair& i_rPair, std::size_t i_Source, std::size_t i_Target);

/// "--preset": adds the targets of its pairs, reports what was found by proposal and warns of what was not found.
void ApplyPreset(VSession& io_rSession, const std::string& i_rPath);

} // namespace CommandLine
