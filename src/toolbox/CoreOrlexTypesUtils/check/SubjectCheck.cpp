#include "CoreOrlexTypesUtils/check/SubjectCheck.h"

#include "CoreOrlexTypesUtils/check/SubjectCheckRules.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"

namespace CoreOrlexTypesUtils
{

using namespace SubjectCheck;

namespace
{

bool CheckNumbers(const VSubject& i_rSubject, IFindings& io_rFindings)
{
	return io_rFindings.InTurn([&] { return SubjectCheck::CheckMarkers(i_rSubject.m_Markers, io_rFindings); },
	    [&]
	    {
		    return io_rFindings.ForEach(i_rSubject.m_Targets.size(),
		        [&](std::size_t i) { return SubjectCheck::CheckTarget(i_rSubject, i, io_rFindings); });
	    },
	    [&]
	    {
		    return io_rFindings.ForEach(
		        i_rSubject.m_Segments.size(), [&](std::size_t i) { return CheckSegment(i_rSubject, i, io_rFindings); });
	    });
}

/// Goes on whatever fails, and tells nothing: each cause of a failure is found by a check of its own.
VSubject ConvertEverything(const VSubjectParametrised& i_rSubject)
{
	VSubject converted;
	VDynamicExpressionParserSimple parser;
	std::vector<std::string> ignored;
	parser.Initialise(i_rSubject, ignored);
	for (const auto& rSegment : i_rSubject.m_Segments)
		SubjectParametrisedConverter::ConvertSegment(
		    parser, rSegment, converted.m_Segments.emplace_back(), false, ignored);
	for (const auto& rMarker : i_rSubject.m_Markers)
		SubjectParametrisedConverter::ConvertMarker(rMarker, converted.m_Markers.emplace_back());
	converted.m_Rotations.resize(i_rSubject.m_Rotations.size());
	for (const auto& rTarget : i_rSubject.m_Targets)
		SubjectParametrisedConverter::ConvertTarget(
		    parser, rTarget, converted.m_Targets.emplace_back(), false, ignored);
	return converted;
}

bool CheckAllOf(const VSubjectParametrised& i_rSubject, IFindings& io_rFindings)
{
	bool bGood = true;
	if (io_rFindings.GoesOn())
		bGood = CheckNumbers(ConvertEverything(i_rSubject), io_rFindings);
	else
	{
		VSubject converted;
		bGood = SubjectParametrisedConverter::ConvertSubject(i_rSubject, converted)
		    && CheckNumbers(converted, io_rFindings);
	}
	for (std::size_t i = 0; i < i_rSubject.m_Segments.size(); ++i)
	{
		const std::string& rName = i_rSubject.m_Segments[i].m_Name;
		if (SubjectCheck::CheckJointTemplate(
		        i_rSubject.m_Segments[i].m_Joint, VReport(io_rFindings, VSubjectFinding::ESegment, i, rName)))
			continue;
		io_rFindings.Line("Segment " + rName + ", invalid template values");
		bGood = false;
	}
	for (std::size_t i = 0; i < i_rSubject.m_Targets.size(); ++i)
	{
		if (SubjectCheck::CheckTargetTemplate(
		        i_rSubject.m_Targets[i], VReport(io_rFindings, VSubjectFinding::ETarget, i)))
			continue;
		io_rFindings.Line("Target " + std::to_string(i) + ", invalid weights or template values");
		bGood = false;
	}
	return CheckExpressions(i_rSubject, io_rFindings) && bGood;
}

/// Of an element on its own.
template <typename TElement>
bool CheckAlone(bool (*i_pCheck)(const TElement&, const VReport&), const TElement& i_rElement)
{
	VLoggedFindings findings;
	return i_pCheck(i_rElement, VReport(findings, VSubjectFinding::ESegment, 0));
}

} // namespace

bool CheckSubject(const VSubject& i_rSubject)
{
	VLoggedFindings findings;
	return CheckNumbers(i_rSubject, findings);
}

bool CheckMarkers(const std::vector<VSubject::VMarker>& i_rMarkers)
{
	VLoggedFindings findings;
	return SubjectCheck::CheckMarkers(i_rMarkers, findings);
}

bool CheckTarget(const VSubject& i_rSubject, std::size_t i_TargetIndex)
{
	VLoggedFindings findings;
	return SubjectCheck::CheckTarget(i_rSubject, i_TargetIndex, findings);
}

bool CheckJoint(const VSubject::VJoint& i_rJoint)
{
	return CheckAlone(&SubjectCheck::CheckJoint, i_rJoint);
}

bool CheckSubjectParametrised(const VSubjectParametrised& i_rSubject)
{
	VLoggedFindings findings;
	return CheckAllOf(i_rSubject, findings);
}

bool CheckJointTemplate(const VSubjectParametrised::VJoint& i_rJoint)
{
	return CheckAlone(&SubjectCheck::CheckJointTemplate, i_rJoint);
}

bool CheckTargetTemplate(const VSubjectParametrised::VTarget& i_rTarget)
{
	return CheckAlone(&SubjectCheck::CheckTargetTemplate, i_rTarget);
}

std::vector<VSubjectFinding> FindSubjectFaults(const VSubjectParametrised& i_rSubject)
{
	VListedFindings findings;
	CheckAllOf(i_rSubject, findings);
	return findings.Take();
}

} // namespace CoreOrlexTypesUtils
