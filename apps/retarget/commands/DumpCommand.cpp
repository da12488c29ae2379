#include "retarget/commands/Commands.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/text/JsonDump.h"

#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"

namespace CommandLine
{
namespace
{

struct VDumpSettings
{
	std::string m_File;
	bool m_bEvaluated = false;
};

EExitStatus ShowSubject(const VDumpSettings& i_rSettings)
{
	const VSubjectFile file = ReadSubjectFile(i_rSettings.m_File);
	if (!i_rSettings.m_bEvaluated)
	{
		PrintJson(Dump(file.m_Record));
		return EFine;
	}
	CoreOrlexTypes::VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(file.m_Record.m_SubjectParametrised, subject);
	PrintJson(Dump(subject));
	return EFine;
}

} // namespace

VCommand AddDumpCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "dump",
	    "Show what a skeleton or retarget file holds as JSON: positions in millimetres, rotations as angle-axis "
	    "vectors "
	    "in radians",
	    {"dump performer.qrs", "dump hero.qrr | jq '.SubjectParametrised.Segments[].Name'",
	        "dump --evaluated performer.qrs"});
	const auto pSettings = std::make_shared<VDumpSettings>();
	pApp->add_option("FILE", pSettings->m_File, c_pSkeletonFileHelp)->required();
	pApp->add_flag("--evaluated", pSettings->m_bEvaluated, "With all expressions evaluated to numbers");
	return {pApp, [pSettings] { return ShowSubject(*pSettings); }};
}

} // namespace CommandLine
