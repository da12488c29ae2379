#include "retarget/subject/TargetKinematics.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/ConstructionException.h"
#include "ComputeSubjectFK/TargetFK.h"

namespace CommandLine
{

ComputeSubject::VSegmentTree SegmentKinematics(const CoreOrlexTypes::VSubject& i_rSubject)
{
	try
	{
		return ComputeSubject::MakeSegmentTree(i_rSubject);
	}
	catch (const ComputeSubject::VConstructionException&)
	{
		return {};
	}
}

std::shared_ptr<ComputeSubject::ITargetFK> TargetKinematics(
    const CoreOrlexTypes::VSubject::VTarget& i_rTarget, const ComputeSubject::VSegmentTree& i_rTree)
{
	const auto* const pFactory = ComputeSubject::TargetFKFactory(i_rTarget.m_Type);
	if (!pFactory)
		return nullptr;
	try
	{
		return pFactory->Create(i_rTarget, i_rTree);
	}
	catch (const ComputeSubject::VConstructionException&)
	{
		return nullptr;
	}
}

} // namespace CommandLine
