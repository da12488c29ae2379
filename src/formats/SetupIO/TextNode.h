#pragma once

#include "SetupIO/ReadSetup.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace SetupIO
{

/// A value of a JSON text, with the line that it stands in.
struct VTextNode
{
	enum EKind
	{
		ENull,
		EBoolean,
		ENumber,
		EText,
		EList,
		EObject
	};

	EKind m_Kind = ENull;
	std::size_t m_Line = 0;
	/// Of the member of an object that it is.
	std::string m_Name;
	/// A text, or a number as it is written.
	std::string m_Text;
	double m_Number = 0.0;
	bool m_bTrue = false;
	/// Of a list or an object, in the order of the text.
	std::vector<VTextNode> m_Items;
};

/// @param o_rFault what is wrong with the text, if it is no JSON, goes beyond a limit or names a member twice.
bool ParseText(std::string_view i_Text, VTextNode& o_rNode, VFault& o_rFault);

} // namespace SetupIO
