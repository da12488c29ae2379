#include "SetupReview/advice/Advice.h"

#include "FBXIO/FBXReader.h"
#include "SetupReview/compare/ValueText.h"

#include <numbers>
#include <set>

namespace SetupReview
{

std::optional<VAdvice> AdviceOn(const VRetargetSetupCore::VSubjectValues& i_rSource,
    const VRetargetSetupCore::VSubjectValues& i_rTarget, const boost::filesystem::path& i_rFbx)
{
	VAdvice advice;
	std::vector<std::size_t> vertices;
	if (!i_rFbx.empty())
	{
		FBXIO::FBXReader reader;
		reader.SetMeshRules(FBXIO::c_FaithfulMeshes);
		if (!reader.LoadFile(i_rFbx.string()) || !reader.IsComplete())
			return std::nullopt;
		FBXIO::VSkin skin;
		reader.ReadSkin(skin);
		vertices = SkinVertices(*i_rTarget.m_pParametrised, skin);
		advice.m_bSkin = !skin.m_Meshes.empty();
	}
	advice.m_Prune = AdvisePruning(*i_rTarget.m_pParametrised, vertices);
	if (i_rSource.m_pParametrised)
		advice.m_Range = GoThroughRange(i_rSource, i_rTarget);
	return advice;
}

std::string PoseChangeText(const VPruneAdvice& i_rAdvice, const CoreOrlexTypes::VSubjectParametrised& i_rSubject)
{
	if (!i_rAdvice.m_PoseChange)
		return i_rAdvice.m_bPoseKnown ? "as it is" : "not computed";
	return i_rSubject.m_Segments[i_rAdvice.m_PoseChange->m_SegmentIndex].m_Name + " by "
	    + FixedText(i_rAdvice.m_PoseChange->m_Distance, 1) + " mm and "
	    + FixedText(i_rAdvice.m_PoseChange->m_Angle * 180.0 / std::numbers::pi, 1) + " degrees";
}

std::string RangeSummary(const VRangeOfMotion& i_rRange)
{
	if (!i_rRange.m_Refusal.empty())
		return "No range of motion: " + i_rRange.m_Refusal;
	std::set<std::size_t> against;
	for (const VRangeConflict& rConflict : i_rRange.m_Conflicts)
		against.insert(rConflict.m_Against);
	if (i_rRange.m_Poses == 0)
		return "No range of motion: no target follows a segment of this performer that can turn";
	const std::size_t pullers = against.size();
	const std::string fights = pullers == 0
	    ? "no target pulls against another"
	    : std::to_string(pullers) + (pullers == 1 ? " target pulls" : " targets pull") + " against "
	        + std::to_string(i_rRange.m_Conflicts.size())
	        + " others: a lower weight, or lengths that are more alike, helps";
	return "Range of motion: " + std::to_string(i_rRange.m_Poses) + " poses, in "
	    + (i_rRange.m_NotConverged == 0
	            ? "all of which the solve came to its end"
	            : std::to_string(i_rRange.m_NotConverged) + " of which the solve found only the best it could")
	    + "; " + fights
	    + (i_rRange.m_Unopposed == 0 ? ""
	                                 : "; " + std::to_string(i_rRange.m_Unopposed)
	                + " more are missed by 10 mm or 5 degrees more than at rest, with no single one against them")
	    + (i_rRange.m_bCutShort ? "; there is more than was looked at" : "");
}

} // namespace SetupReview
