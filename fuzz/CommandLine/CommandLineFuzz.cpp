// Command lines as they are parsed, one argument a line: each is taken, or refused with a sentence. No command runs.
#include "../Require.h"
#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Parsing.h"
#include "DebugServices/GlobalLog.h"
#include "math/VisibleText.h"
#include "retarget/Program.h"

#include <cstdint>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	static const auto s_pSilence = NVX::GlobalLog::AddSink([](const NVX::VLogCategory&, int, const std::string&) {});
	std::vector<std::string> arguments(1);
	for (std::size_t i = 0; i < i_Size; ++i)
		if (i_pData[i] == '\n')
			arguments.emplace_back();
		else if (i_pData[i] != 0)
			arguments.back() += char(i_pData[i]);
	// To make one takes a hundred times as long as a parse; edits pile up in it.
	static CommandLine::VProgram s_Program;
	static unsigned int s_Parses = 0;
	if (s_Parses++ % 64 == 0)
		s_Program = CommandLine::MakeProgram();
	try
	{
		CommandLine::Parse(*s_Program.m_pApp, std::move(arguments));
	}
	catch (const CLI::Success&)
	{
	}
	catch (const CommandLine::VCommandError& rError)
	{
		const std::string text = rError.what();
		Require(!text.empty() && rError.Status() != CommandLine::EFine, "a refusal tells why");
		const std::string line = VisibleText::OnOneLine(text);
		Require(VisibleText::OnOneLine(line) == line, "what is shown has nothing left to be made visible");
	}
	return 0;
}
