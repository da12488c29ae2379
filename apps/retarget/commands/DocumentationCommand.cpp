#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/text/Documentation.h"
#include "retarget/text/Output.h"

namespace CommandLine
{

VCommand AddDocumentationCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "documentation", "Print the manual page or the shell completion",
	    {"documentation man", "documentation bash"});
	pApp->group("");
	const auto pForm = std::make_shared<std::string>();
	pApp->add_option("FORM", *pForm, "man or bash")->required()->check(OneOf({"man", "bash"}));
	return {pApp,
	    [pForm]
	    {
		    const VProgram program = MakeProgram();
		    Print(*pForm == "man" ? ManualPage(*program.m_pApp) : BashCompletion(*program.m_pApp));
		    return EFine;
	    }};
}

} // namespace CommandLine
