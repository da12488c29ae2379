#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/SubjectRecord.h"

#include <optional>
#include <string>
#include <vector>

/// What is told about retarget subjects as they stand in files. Free functions on values, for any thread; nothing is
/// logged.
namespace SetupReview
{

/// All that a retarget subject's file holds.
struct VSetup
{
	CoreOrlexTypes::VSubjectRecord m_Record;
	CoreOrlexQRTIO::VSubjectQRTExtras m_Extras;
};

/// One thing in which two set-ups differ.
struct VSetupChange
{
	/// As scripts know it: "target-added", "target-removed", "weight", "offset", "pose", "joint-pruned", ...; "field"
	/// for what has no words of its own.
	std::string m_Id;
	/// "target", "segment", "marker", ...; "subject" for what no element has.
	std::string m_Element;
	/// Of the element; empty for the subject.
	std::string m_Name;
	/// The keys that lead to the field within its element, as "Joint.BindPose"; empty for a whole element.
	std::string m_Field;
	/// Values as text in the C form, references by name; empty for a whole element.
	std::string m_Before;
	std::string m_After;
	/// How far something moved or turned, where it did.
	std::optional<double> m_Millimetres;
	std::optional<double> m_Degrees;
	/// What happened to the element, in words for the operator.
	std::string m_Words;
};

/// All differences, in the order of the fields. Elements belong together by their names, targets by type, source and
/// segment; where an element only moved to another place of its list, the list's order is told, once. Lengths are
/// compared at the scale of the first.
std::vector<VSetupChange> CompareSetups(const VSetup& i_rBefore, const VSetup& i_rAfter);

/// The change as one sentence with its element. Names stand in it as they are, with whatever bytes they hold.
std::string ChangeLine(const VSetupChange& i_rChange);

/// What a set-up holds, a line for each thing that is not as it is by default, each naming its element, so that a
/// comparison of lines tells what changed.
std::string DescribeSetup(const VSetup& i_rSetup);

} // namespace SetupReview
