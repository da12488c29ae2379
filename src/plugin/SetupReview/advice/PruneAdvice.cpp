#include "SetupReview/advice/PruneAdvice.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "RetargetSetupCore/Joints.h"
#include "RetargetSetupCore/SessionSteps.h"
#include "RetargetSetupCore/TargetConstruction.h"
#include "SetupIO/CommandText.h"

#include <unordered_map>

namespace SetupReview
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using VJoint = VSubjectParametrised::VJoint;

/// Of a body, and what comes with it, there are some hundred; each joint takes all of them once more.
constexpr std::size_t c_MostSegments = 1000;

std::vector<Rotation::VPose<double>> PosesOf(const VSubjectParametrised& i_rSubject)
{
	CoreOrlexTypes::VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rSubject, subject);
	const auto pFK = RetargetSetup::KinematicsInBindPose(i_rSubject, subject, "target");
	return pFK ? RetargetSetup::SegmentPoses(*pFK) : std::vector<Rotation::VPose<double>>();
}

/// For each segment the targets on it and beneath it.
std::vector<std::vector<std::size_t>> TargetsFrom(const VSubjectParametrised& i_rSubject)
{
	std::vector<std::vector<std::size_t>> targets(i_rSubject.m_Segments.size());
	for (std::size_t i = 0; i < i_rSubject.m_Targets.size(); ++i)
		for (const std::uint32_t segment : i_rSubject.m_Targets[i].m_SegmentIndices)
			for (std::size_t at = segment; at < targets.size(); at = i_rSubject.m_Segments[at].m_ParentSegmentIndex)
			{
				if (targets[at].empty() || targets[at].back() != i)
					targets[at].push_back(i);
				// Parents stand before their children; where they do not, there is no tree.
				if (i_rSubject.m_Segments[at].m_ParentSegmentIndex >= at)
					break;
			}
	return targets;
}

std::string WordsFor(const VPruneAdvice& i_rAdvice, bool i_bSkin)
{
	const std::string below = std::to_string(i_rAdvice.m_TargetsBelow.size())
	    + (i_rAdvice.m_TargetsBelow.size() == 1 ? " target beneath it moves it" : " targets beneath it move it");
	const std::string vertices = std::to_string(i_rAdvice.m_Vertices) + " vertices of the skin";
	switch (i_rAdvice.m_Verdict)
	{
	case EPruneVerdict::Go:
		return "no target moves it"
		    + (i_rAdvice.m_Vertices > 0 ? ": " + vertices + " then go stiffly with its parent" : std::string());
	case EPruneVerdict::May:
		return below + ", which would be left to fewer joints"
		    + (i_bSkin ? "; no skin bends there" : "; whether skin bends there is not known");
	case EPruneVerdict::Stay: return below + ", and " + vertices + " bend there";
	}
	return "";
}

} // namespace

const char* NameOf(EPruneVerdict i_Verdict)
{
	switch (i_Verdict)
	{
	case EPruneVerdict::Go: return "go";
	case EPruneVerdict::May: return "may go";
	case EPruneVerdict::Stay: break;
	}
	return "stay";
}

std::vector<std::size_t> SkinVertices(const VSubjectParametrised& i_rSubject, const FBXIO::VSkin& i_rSkin)
{
	std::vector<std::size_t> vertices(i_rSubject.m_Segments.size());
	if (!i_rSkin.m_pSkeleton)
		return vertices;
	std::unordered_map<std::string_view, std::size_t> segments;
	for (std::size_t i = 0; i < vertices.size(); ++i)
		segments.emplace(i_rSubject.m_Segments[i].m_Name, i);
	std::vector<std::size_t> segmentOfBone;
	for (const FBXIO::VSkinBone& rBone : *i_rSkin.m_pSkeleton)
	{
		const auto found = segments.find(RetargetSetup::StripNamespace(rBone.m_Name));
		segmentOfBone.push_back(found == segments.end() ? vertices.size() : found->second);
	}
	for (const FBXIO::VSkinMesh& rMesh : i_rSkin.m_Meshes)
		for (const FBXIO::VSkinVertex& rVertex : rMesh.m_Vertices)
			for (std::size_t i = 0; i < rVertex.m_BoneWeights.size(); ++i)
				if (const std::size_t bone = rVertex.m_BoneIndices[i]; rVertex.m_BoneWeights[i] > 0
				    && bone < segmentOfBone.size() && segmentOfBone[bone] < vertices.size())
					++vertices[segmentOfBone[bone]];
	return vertices;
}

std::vector<VPruneAdvice> AdvisePruning(
    const VSubjectParametrised& i_rSubject, const std::vector<std::size_t>& i_rVertices)
{
	std::vector<VPruneAdvice> advice;
	const std::vector<Rotation::VPose<double>> poses = PosesOf(i_rSubject);
	const std::vector<std::vector<std::size_t>> targets = TargetsFrom(i_rSubject);
	const std::vector<bool> used = RetargetSetup::SegmentsWithTargets(i_rSubject);
	VSubjectParametrised pruned = i_rSubject;
	for (std::size_t i = 1; i < i_rSubject.m_Segments.size(); ++i)
	{
		if (used[i] || i_rSubject.m_Segments[i].m_Joint.m_JointType == VJoint::EDummy)
			continue;
		VPruneAdvice& rAdvice = advice.emplace_back();
		rAdvice.m_Segment = i;
		rAdvice.m_TargetsBelow = targets[i];
		rAdvice.m_Vertices = i < i_rVertices.size() ? i_rVertices[i] : 0;
		rAdvice.m_Verdict = rAdvice.m_TargetsBelow.empty() ? EPruneVerdict::Go
		    : rAdvice.m_Vertices > 0                       ? EPruneVerdict::Stay
		                                                   : EPruneVerdict::May;
		rAdvice.m_bPoseKnown = poses.size() <= c_MostSegments;
		if (rAdvice.m_bPoseKnown)
		{
			RetargetSetup::RemoveJoint(pruned.m_Segments[i]);
			rAdvice.m_PoseChange = RetargetSetup::WorstPoseDifference(poses, PosesOf(pruned));
			pruned.m_Segments[i] = i_rSubject.m_Segments[i];
		}
		rAdvice.m_Words = WordsFor(rAdvice, !i_rVertices.empty());
		if (rAdvice.m_Verdict != EPruneVerdict::Stay)
			rAdvice.m_Options = "--prune-joint " + SetupIO::ForShell(RetargetSetup::WordOf(i, i_rSubject));
	}
	return advice;
}

} // namespace SetupReview
