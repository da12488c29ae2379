#include "CoreOrlexTypesUtils/observations/TargetFrames.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "DebugServices/GlobalLog.h"

#include <algorithm>

namespace CoreOrlexTypesUtils
{

namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

// Targets are left out, so that one which fits nothing cannot stand in the way.

bool Evaluate(const VSubject& i_rSubject, VSubject& o_rSegments)
{
	o_rSegments.m_Segments = i_rSubject.m_Segments;
	return true;
}

bool Evaluate(const VSubjectParametrised& i_rSubject, VSubject& o_rSegments)
{
	VSubjectParametrised segments = i_rSubject;
	segments.m_Targets.clear();
	return SubjectParametrisedConverter::ConvertSubject(segments, o_rSegments);
}

} // namespace

template <typename TSubject>
bool ComputeTargetFrames(const TSubject& i_rSubject, std::vector<Rotation::VPose<double>>& o_rFrames)
{
	VSubject segments;
	bool bGood = Evaluate(i_rSubject, segments);
	if (bGood)
		try
		{
			ComputeSubject::VComputeSubjectFK fk(segments);
			std::vector<double> state;
			for (const VSubject::VSegment& rSegment : segments.m_Segments)
			{
				const std::size_t end = state.size() + CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType);
				state.insert(state.end(), rSegment.m_Joint.m_Mean.begin(), rSegment.m_Joint.m_Mean.end());
				state.resize(end, 0.0);
			}
			bGood = fk.NumberOfSegments() == segments.m_Segments.size() && fk.NumberOfStates() == state.size();
			if (bGood)
			{
				fk.Update(state.data());
				o_rFrames.clear();
				for (std::size_t i = 0; i < fk.NumberOfSegments(); ++i)
					o_rFrames.push_back(Rotation::Compose(fk.Segment(i).WorldPose(), fk.Segment(i).PostPose()));
			}
		}
		catch (const ComputeSubject::VConstructionException&)
		{
			bGood = false;
		}
	if (!bGood)
		NVX_LOG("RigidBodyUtils", NVX::ELogError, "Cannot compute the pose of subject %1%", i_rSubject.m_Name);
	return bGood;
}

template bool ComputeTargetFrames(const VSubject&, std::vector<Rotation::VPose<double>>&);
template bool ComputeTargetFrames(const VSubjectParametrised&, std::vector<Rotation::VPose<double>>&);

} // namespace CoreOrlexTypesUtils
