#include "TakeSolve/JointPairs.h"

#include "SetupProposal/Proposal.h"

#include <algorithm>
#include <map>

namespace TakeSolve
{
namespace
{

using SetupProposal::VRestSkeleton;

/// Without a namespace, in lower case.
std::string Plain(const std::string& i_rName)
{
	std::string plain = i_rName.substr(i_rName.rfind(':') + 1);
	for (char& rByte : plain)
		if (rByte >= 'A' && rByte <= 'Z')
			rByte = char(rByte - 'A' + 'a');
	return plain;
}

/// Indices by plain names; of several the first.
std::map<std::string, std::int32_t> ByName(const VRestSkeleton& i_rSkeleton)
{
	std::map<std::string, std::int32_t> names;
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
		names.emplace(Plain(i_rSkeleton[i].m_Name), std::int32_t(i));
	return names;
}

/// Joints by segments and segments by joints.
struct VPairs
{
	VPairs(std::size_t i_Joints, std::size_t i_Segments) : m_OfSegment(i_Segments, -1), m_OfJoint(i_Joints, -1) {}

	bool Add(std::int32_t i_Joint, std::int32_t i_Segment)
	{
		if (m_OfSegment[std::size_t(i_Segment)] >= 0 || m_OfJoint[std::size_t(i_Joint)] >= 0)
			return false;
		m_OfSegment[std::size_t(i_Segment)] = i_Joint;
		m_OfJoint[std::size_t(i_Joint)] = i_Segment;
		return true;
	}

	std::vector<std::int32_t> m_OfSegment;
	std::vector<std::int32_t> m_OfJoint;
};

/// Reads one of a pair by its whole name or, where none has it, its plain one; -1 for none.
std::int32_t Find(const VRestSkeleton& i_rSkeleton, const std::string& i_rName)
{
	for (std::size_t i = 0; i < i_rSkeleton.size(); ++i)
		if (i_rSkeleton[i].m_Name == i_rName)
			return std::int32_t(i);
	const auto names = ByName(i_rSkeleton);
	const auto found = names.find(Plain(i_rName));
	return found == names.end() ? -1 : found->second;
}

bool AddGiven(const VRestSkeleton& i_rJoints, const VRestSkeleton& i_rSegments, const std::vector<VNamedPair>& i_rGiven,
    VPairs& io_rPairs, std::string& o_rError)
{
	for (const VNamedPair& rPair : i_rGiven)
	{
		const std::int32_t joint = Find(i_rJoints, rPair.m_Joint);
		const std::int32_t segment = Find(i_rSegments, rPair.m_Segment);
		if (joint < 0)
			o_rError = "The take has no joint \"" + rPair.m_Joint + "\"";
		else if (segment < 0)
			o_rError = "The performer has no segment \"" + rPair.m_Segment + "\"";
		else if (!io_rPairs.Add(joint, segment))
			o_rError = "One of \"" + rPair.m_Joint + "\" and \"" + rPair.m_Segment + "\" stands in two pairs";
		else
			continue;
		return false;
	}
	return true;
}

/// The pair of the joint above this one's that drives a segment above, if the tree of the take has it above, too.
void TellTree(const VRestSkeleton& i_rJoints, const VRestSkeleton& i_rSegments, const VPairs& i_rPairs,
    std::vector<VFinding>& io_rFindings)
{
	for (std::size_t i = 0; i < i_rSegments.size(); ++i)
	{
		if (i_rPairs.m_OfSegment[i] < 0)
			continue;
		std::int64_t above = i_rSegments[i].m_Parent;
		while (above >= 0 && i_rPairs.m_OfSegment[std::size_t(above)] < 0)
			above = i_rSegments[std::size_t(above)].m_Parent;
		if (above < 0)
			continue;
		const std::int64_t expected = i_rPairs.m_OfSegment[std::size_t(above)];
		std::int64_t joint = i_rPairs.m_OfSegment[i];
		while (joint >= 0 && joint != expected)
			joint = i_rJoints[std::size_t(joint)].m_Parent;
		if (joint < 0)
			io_rFindings.push_back({"tree",
			    "The joint " + i_rJoints[std::size_t(i_rPairs.m_OfSegment[i])].m_Name + " drives the segment "
			        + i_rSegments[i].m_Name + ", but does not hang on " + i_rJoints[std::size_t(expected)].m_Name
			        + ", which drives " + i_rSegments[std::size_t(above)].m_Name
			        + " above it. See whether they are the right pairs."});
	}
}

} // namespace

bool PairJoints(const VRestSkeleton& i_rJoints, const VRestSkeleton& i_rSegments,
    const std::vector<VNamedPair>& i_rGiven, std::vector<std::int32_t>& o_rJointOfSegment,
    std::vector<VFinding>& io_rFindings, std::string& o_rError)
{
	VPairs pairs(i_rJoints.size(), i_rSegments.size());
	if (!AddGiven(i_rJoints, i_rSegments, i_rGiven, pairs, o_rError))
		return false;

	const SetupProposal::VProposal proposal = SetupProposal::Propose(i_rJoints, i_rSegments);
	std::vector<std::int32_t> proposed(i_rSegments.size(), -1);
	for (const auto& rPair : proposal.m_Pairs)
		proposed[rPair.m_Target] = std::int32_t(rPair.m_Source);
	const auto jointNames = ByName(i_rJoints);
	const auto segmentNames = ByName(i_rSegments);
	const auto addProposed = [&](std::size_t i_Segment)
	{ return proposed[i_Segment] >= 0 && pairs.Add(proposed[i_Segment], std::int32_t(i_Segment)); };

	// A segment whose joint by name is a part of the body that another joint fits better, which has no segment of its
	// own name: the names of two schools that overlap.
	for (std::size_t i = 0; i < i_rSegments.size(); ++i)
	{
		const auto named = jointNames.find(Plain(i_rSegments[i].m_Name));
		if (named == jointNames.end() || proposed[i] < 0 || proposed[i] == named->second
		    || segmentNames.contains(Plain(i_rJoints[std::size_t(proposed[i])].m_Name)))
			continue;
		if (addProposed(i))
			io_rFindings.push_back({"name",
			    "The segment " + i_rSegments[i].m_Name + " is driven by the joint "
			        + i_rJoints[std::size_t(proposed[i])].m_Name
			        + ", as the shape of the body and the other names tell, and not by the joint of its own name."});
	}
	for (std::size_t i = 0; i < i_rSegments.size(); ++i)
		if (const auto named = jointNames.find(Plain(i_rSegments[i].m_Name)); named != jointNames.end())
			pairs.Add(named->second, std::int32_t(i));
	for (std::size_t i = 0; i < i_rSegments.size(); ++i)
		addProposed(i);

	TellTree(i_rJoints, i_rSegments, pairs, io_rFindings);
	std::string undriven;
	for (std::size_t i = 0; i < i_rSegments.size(); ++i)
		if (pairs.m_OfSegment[i] < 0)
			undriven += (undriven.empty() ? "" : ", ") + i_rSegments[i].m_Name;
	if (!undriven.empty())
		io_rFindings.push_back({"undriven",
		    "No joint of the take drives these segments, which go along with those above: " + undriven + "."});
	o_rJointOfSegment = std::move(pairs.m_OfSegment);
	return true;
}

} // namespace TakeSolve
