#pragma once

#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "SetupIO/Setup.h"
#include "SetupProposal/Proposal.h"

#include <boost/filesystem/path.hpp>

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

/// Presets: which segments a set-up ties, by name, for another character or performer.
namespace RetargetSetup
{

/// The pairs that a subject's position and rotation targets tie, each once, in the order of the targets.
/// @param o_rLeftOut a sentence for each target that no pair can hold.
std::vector<SetupIO::VPair> PairsOf(
    const CoreOrlexTypes::VSubjectParametrised& i_rSubject, std::vector<std::string>& o_rLeftOut);

/// A preset of a subject's pairs, with a comment on what they are of.
SetupIO::VSetup PresetOf(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData, std::vector<std::string>& o_rLeftOut);

/// A pair of a preset that two subjects have.
struct VFittedPair
{
	SetupIO::VPair m_Pair;
	/// Indices of segments.
	std::size_t m_Source = 0;
	std::size_t m_Target = 0;
	/// One of the two names is not there, and the proposal told what stands for it.
	bool m_bProposed = false;
};

struct VMisfit
{
	SetupIO::VPair m_Pair;
	/// A sentence's end: "the target has no segment "ribs"".
	std::string m_Reason;
};

struct VPresetFit
{
	std::vector<VFittedPair> m_Fitted;
	std::vector<VMisfit> m_Misfits;
};

/// The pairs of a file; nothing, with the reason, for one that cannot be read, is none or holds none.
std::optional<std::vector<SetupIO::VPair>> ReadPreset(const boost::filesystem::path& i_rPath, std::string& o_rReason);

/// By names first. Where one of the two is not there, by what is proposed for the other, unless another pair has that.
/// @param i_pProposal of the same two subjects, with indices as theirs; null for names alone.
VPresetFit FitPreset(const std::vector<SetupIO::VPair>& i_rPairs, const CoreOrlexTypes::VSubjectParametrised& i_rSource,
    const CoreOrlexTypes::VSubjectParametrised& i_rTarget, const SetupProposal::VProposal* i_pProposal);

} // namespace RetargetSetup
