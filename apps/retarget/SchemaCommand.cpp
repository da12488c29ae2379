#include "retarget/Commands.h"
#include "retarget/Output.h"

#include "CoreOrlexQRTIO/Reader.h"

namespace CommandLine
{
namespace
{

EExitStatus ShowSchema(const std::string& i_rOut)
{
	CoreOrlexQRTIO::VReader reader;
	if (i_rOut == "-")
		Print(reader.SchemaText());
	else if (!reader.WriteSchema(i_rOut))
		throw VCommandError(EBadOutput, "\"" + i_rOut + "\" could not be written");
	return EFine;
}

} // namespace

VCommand AddSchemaCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "schema", "Print the XML schema of the skeleton file format",
	    {"schema > skeleton.xsd", "schema -o skeleton.xsd && xmllint --noout --schema skeleton.xsd hero.qrr"});
	const auto pOut = std::make_shared<std::string>("-");
	pApp->add_option("-o,--output", *pOut, "Where the schema is written; - is standard output (the default)")
	    ->option_text("FILE");
	return {pApp, [pOut] { return ShowSchema(*pOut); }};
}

} // namespace CommandLine
