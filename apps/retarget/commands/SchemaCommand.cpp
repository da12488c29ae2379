#include "retarget/commands/Commands.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"

#include "CoreOrlexQRTIO/Reader.h"

namespace CommandLine
{
namespace
{

EExitStatus ShowSchema(const VOutput& i_rOut)
{
	CheckOutput(i_rOut, c_SchemaFile);
	CoreOrlexQRTIO::VReader reader;
	if (i_rOut.m_Path == "-")
		Print(reader.SchemaText());
	else if (!reader.WriteSchema(i_rOut.m_Path))
		throw VCommandError(EBadOutput, "\"" + i_rOut.m_Path + "\" could not be written");
	else
		PrintResult({{"output", i_rOut.m_Path}}, "");
	return EFine;
}

} // namespace

VCommand AddSchemaCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "schema",
	    "Print the XML schema of the skeleton file format. The reader takes more than XML's own tools do with it: "
	    "names with blanks, and targets of different kinds in any order",
	    {"schema > skeleton.xsd", "schema -o skeleton.xsd && xmllint --noout --schema skeleton.xsd performer.qrs"});
	const auto pOut = std::make_shared<VOutput>(VOutput{"-"});
	pApp->add_option("-o,--output", pOut->m_Path, "Where the schema is written; - is standard output (the default)")
	    ->option_text("FILE");
	AddForceOption(*pApp, *pOut);
	return {pApp, [pOut] { return ShowSchema(*pOut); }};
}

} // namespace CommandLine
