#pragma once

#include <cstddef>
#include <string>

namespace CoreOrlexTypesUtils
{

/// One thing that is wrong with a subject.
struct VSubjectFinding
{
	enum EElement
	{
		EStaticParameter,
		EMarker,
		ESegment,
		ETarget
	};

	/// What it concerns: the kind of element, its place in its list, and its name. Targets have no name of their own.
	EElement m_Element = ESegment;
	std::size_t m_Index = 0;
	std::string m_Name;
	std::string m_Message;
	/// One line that tells how to mend it.
	std::string m_Remedy;
	/// The element is good in spite of it.
	bool m_bTolerated = false;
};

} // namespace CoreOrlexTypesUtils
