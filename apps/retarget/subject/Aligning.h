#pragma once

#include "retarget/subject/Session.h"

#include "SetupProposal/PoseCheck.h"

#include <string>
#include <vector>

/// The bind pose of the target subject, brought to the source's. All throw VCommandError to fail.
namespace CommandLine
{

/// "--chain": from here on only what is told, "all" or some of "arms", "legs", "spine", "others".
void ChooseChain(VSession& io_rSession, const std::string& i_rChain);

/// "--feet": from here on feet keep their tilt, "level", or lean as the shins do, "shins".
void ChooseFeet(VSession& io_rSession, const std::string& i_rFeet);

/// "--lock": a segment of the target subject that keeps its joint as it is.
void LockSegment(VSession& io_rSession, const std::string& i_rSegment);

/// "--unlock": it no longer does.
void UnlockSegment(VSession& io_rSession, const std::string& i_rSegment);

/// "--on-joints".
void StandOnJoints(VSession& io_rSession, const std::string&);

/// "--as-it-stands": no pose of the FBX file comes before.
void AlignAsItStands(VSession& io_rSession, const std::string&);

/// "--align": with the angles before and after in what the session reports. Chains that would stand worse stay, which
/// is a warning. A subject that stands as it was made takes the pose of its FBX file first, and where the session fits
/// scales, the size of the source, which is reported.
void AlignTarget(VSession& io_rSession);

/// After all edits: how the two stand, into what the session reports, if it was aligned.
void ReportPose(VSession& io_rSession);

/// How source and target subject stand now.
std::vector<SetupProposal::VPoseFinding> PoseFindingsOf(VSession& io_rSession);

/// The scale with which the hips of the target subject stand as high above its feet as the source's. EFindings if one
/// of the two has no hips or feet.
double ScaleThatFits(VSession& io_rSession);

} // namespace CommandLine
