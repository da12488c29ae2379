#pragma once

#include <string>

namespace TakeSolve
{

/// Something that the operator ought to know of a take and a subject together.
struct VFinding
{
	/// As scripts know it.
	const char* m_pId = "";
	/// A sentence, or a few.
	std::string m_Message;
};

} // namespace TakeSolve
