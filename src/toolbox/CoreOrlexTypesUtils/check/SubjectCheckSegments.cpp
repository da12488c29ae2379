#include "CoreOrlexTypesUtils/check/SubjectCheckRules.h"

namespace CoreOrlexTypesUtils::SubjectCheck
{
namespace
{

using CoreOrlexTypes::c_NoParent;

bool CheckRoot(const VSubject::VSegment& i_rRoot, const VReport& i_rReport)
{
	return i_rReport.Findings().InTurn(
	    [&]
	    {
		    return i_rRoot.m_ParentSegmentIndex == c_NoParent
		        || i_rReport.Fail("The parent segment of the root segment must not be set.",
		            "Set ParentSegmentIndex to 4294967295, which means none: the first segment is the root.");
	    },
	    [&]
	    {
		    return i_rRoot.m_TreeDepth == 0
		        || i_rReport.Fail("The tree depth of the root must be equal to 0.", "Set TreeDepth to 0.");
	    });
}

bool CheckChild(const VSubject& i_rSubject, std::size_t i_SegmentIndex, const VReport& i_rReport)
{
	const VSubject::VSegment& rChild = i_rSubject.m_Segments[i_SegmentIndex];
	const std::size_t parentIndex = rChild.m_ParentSegmentIndex;
	if (rChild.m_ParentSegmentIndex == c_NoParent)
		return i_rReport.Fail("The parent segment of a child segment must be set.",
		    "Put it below a segment that stands before it: only the first may have no parent.");
	if (parentIndex >= i_rSubject.m_Segments.size())
		return i_rReport.Fail("Out-of-range parent segment index.",
		    "Set ParentSegmentIndex to a segment that stands before this one; there is no segment #"
		        + std::to_string(parentIndex) + ".");
	if (parentIndex >= i_SegmentIndex)
		return i_rReport.Fail("The segments are not in depth-first order.",
		    "Move the segment behind its parent, which is segment #" + std::to_string(parentIndex) + ".");
	const std::uint64_t depth = std::uint64_t(i_rSubject.m_Segments[parentIndex].m_TreeDepth) + 1;
	return rChild.m_TreeDepth == depth
	    || i_rReport.Fail("The tree depth of a child must be equal to the parent depth + 1",
	        "Set TreeDepth to " + std::to_string(depth) + "; it is " + std::to_string(rChild.m_TreeDepth) + ".");
}

} // namespace

bool CheckSegment(const VSubject& i_rSubject, std::size_t i_SegmentIndex, IFindings& io_rFindings)
{
	const VSubject::VSegment& rSegment = i_rSubject.m_Segments[i_SegmentIndex];
	const VReport report(io_rFindings, VSubjectFinding::ESegment, i_SegmentIndex, rSegment.m_Name);
	return io_rFindings.InTurn([&] { return CheckJoint(rSegment.m_Joint, report); },
	    [&]
	    {
		    return rSegment.m_SegmentIndex == i_SegmentIndex
		        || report.Fail("Inconsistent segment index.",
		            "Set SegmentIndex to " + std::to_string(i_SegmentIndex)
		                + ", the segment's place in the list; it is " + std::to_string(rSegment.m_SegmentIndex) + ".");
	    },
	    [&]
	    { return i_SegmentIndex == 0 ? CheckRoot(rSegment, report) : CheckChild(i_rSubject, i_SegmentIndex, report); });
}

} // namespace CoreOrlexTypesUtils::SubjectCheck
