#include "../Require.h"

#include "SetupIO/ReadSetup.h"
#include "SetupIO/WriteSetup.h"

#include <algorithm>

/// What is refused has a reason and a line of the text; what is read can be written, and reads back equal.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	const std::string_view text(reinterpret_cast<const char*>(i_pData), i_Size);
	SetupIO::VSetup setup;
	SetupIO::VFault fault;
	if (!SetupIO::ReadSetup(text, setup, fault))
	{
		Require(!fault.m_Reason.empty() && fault.m_Line >= 1, "a reason and a line");
		Require(fault.m_Line <= 1 + std::size_t(std::count(text.begin(), text.end(), '\n')), "a line of the text");
		Require(setup == SetupIO::VSetup(), "nothing of what was refused");
		return 0;
	}
	SetupIO::VSetup back;
	Require(SetupIO::ReadSetup(SetupIO::WriteSetup(setup), back, fault), "what is written can be read");
	Require(setup == back, "it reads back equal");
	return 0;
}
