#include "CommandLineText/ManualPage.h"
#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/text/Documentation.h"
#include "retarget/text/Output.h"

namespace CommandLine
{

VCommand AddDocumentationCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "documentation", "Print the manual page or the shell completion",
	    {"documentation man", "documentation bash > ~/.local/share/bash-completion/completions/retarget",
	        "documentation zsh > ~/.zfunc/_retarget", "documentation fish > ~/.config/fish/completions/retarget.fish"});
	pApp->group("");
	const auto pForm = std::make_shared<std::string>();
	pApp->add_option("FORM", *pForm, "man, bash, zsh or fish")
	    ->option_text("man|bash|zsh|fish")
	    ->required()
	    ->check(OneOf({"man", "bash", "zsh", "fish"}));
	return {pApp,
	    [pForm]
	    {
		    if (*pForm == "man")
			    Print(ManualPage(*MakeProgram().m_pApp, "build and edit retarget subjects", RETARGET_VERSION));
		    else
			    Print(*pForm == "bash" ? BashCompletion() : *pForm == "zsh" ? ZshCompletion() : FishCompletion());
		    return EFine;
	    }};
}

} // namespace CommandLine
