#include "retarget/commands/Commands.h"
#include "retarget/subject/Edits.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"

#include "CoreOrlexQRTIO/Reader.h"

namespace CommandLine
{
namespace
{

constexpr const char* c_pSetup = "setup";

EExitStatus ShowSchema(const std::string& i_rOf, const VOutput& i_rOut)
{
	const bool bSetup = i_rOf == c_pSetup;
	CheckOutput(i_rOut, bSetup ? c_SetupFile : c_SchemaFile);
	WriteText(bSetup ? SetupIO::SchemaText(EditForms()) : CoreOrlexQRTIO::VReader().SchemaText(), i_rOut.m_Path);
	if (i_rOut.m_Path != "-")
		PrintResult({{"output", i_rOut.m_Path}}, "");
	return EFine;
}

} // namespace

VCommand AddSchemaCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "schema",
	    "Print the XML schema of the skeleton file format, or the JSON schema of set-ups: mappings, presets, files of "
	    "edits and recipes. The reader of skeleton files takes more than XML's own tools do with it: names with "
	    "blanks, "
	    "and targets of different kinds in any order",
	    {"schema > skeleton.xsd", "schema -o skeleton.xsd && xmllint --noout --schema skeleton.xsd performer.qrs",
	        "schema setup -o setup.json"});
	const auto pOf = std::make_shared<std::string>("skeleton");
	pApp->add_option("KIND", *pOf, "What the schema is of: skeleton or setup (default: skeleton)")
	    ->option_text("skeleton|setup")
	    ->check(CLI::IsMember({"skeleton", c_pSetup}));
	const auto pOut = std::make_shared<VOutput>(VOutput{"-"});
	pApp->add_option("-o,--output", pOut->m_Path, "Where the schema is written; - is standard output (the default)")
	    ->option_text("FILE");
	AddForceOption(*pApp, *pOut);
	return {pApp, [pOf, pOut] { return ShowSchema(*pOf, *pOut); }};
}

} // namespace CommandLine
