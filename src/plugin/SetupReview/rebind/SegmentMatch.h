#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"
#include "SetupProposal/RestSkeleton.h"
#include "SetupReview/rebind/Rebind.h"

namespace SetupReview
{

/// One side of a comparison of two skeletons.
struct VMatchSide
{
	const CoreOrlexTypes::VSubjectParametrised& m_rSubject;
	SetupProposal::VRestSkeleton m_Rest;
	/// Where each segment stands in its parent, in mm at scale 1.
	std::vector<Rotation::VVector3> m_Offsets;
};

struct VSegmentMatch
{
	/// Index of the new segment, -1 for none.
	std::int64_t m_New = -1;
	ERebindRule m_Rule = ERebindRule::None;
	double m_Score = 0.0;
};

/// For each old segment the new one; no new one twice.
std::vector<VSegmentMatch> MatchSegments(const VMatchSide& i_rOld, const VMatchSide& i_rNew, double i_LeastScore);

} // namespace SetupReview
