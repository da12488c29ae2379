#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "CommandLineText/System.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Residuals.h"
#include "retarget/subject/Session.h"
#include "retarget/subject/TargetLines.h"
#include "retarget/text/Output.h"
#include "retarget/text/Table.h"

#include "DebugServices/GlobalLog.h"

#include <unistd.h>

namespace CommandLine
{
namespace
{

struct VTargetsSettings
{
	std::string m_File;
	std::string m_Source;
	bool m_bStates = false;
};

/// A solver goes by the targets' own kinematics, the editing tools store offsets from the segments' poses.
void TellDisagreement(const std::vector<VTargetLine>& i_rLines)
{
	std::vector<VTargetResidual> residuals;
	residuals.reserve(i_rLines.size());
	for (const VTargetLine& rLine : i_rLines)
		residuals.push_back(rLine.m_Residual);
	const std::optional<std::size_t> worst = WorstDisagreement(residuals);
	if (worst)
		NVX_LOG(c_pCategory, NVX::ELogWarning,
		    "A solver sees targets elsewhere than their offsets say, at worst #%1% \"%2%\": %3% by the offset, %4% by "
		    "the target's kinematics; post poses of segments and orientations of rotation targets do this",
		    *worst, i_rLines[*worst].m_Name, ResidualText(residuals[*worst].m_Offset),
		    ResidualText(residuals[*worst].m_Target));
}

VTable LinesToTable(const std::vector<VTargetLine>& i_rLines, bool i_bResiduals, bool i_bStates)
{
	VTable table;
	table.AddColumn("INDEX", VTable::ERight);
	table.AddColumn("TYPE", VTable::ELeft);
	table.AddColumn("SOURCE", VTable::ELeft);
	table.AddColumn("TARGET", VTable::ELeft);
	table.AddColumn("WEIGHT", VTable::ERight);
	if (i_bResiduals)
		table.AddColumn("RESIDUAL", VTable::ERight);
	if (i_bStates)
	{
		table.AddColumn("NAME", VTable::ELeft);
		table.AddColumn("STATE", VTable::ELeft);
	}
	for (std::size_t i = 0; i < i_rLines.size(); ++i)
	{
		const VTargetLine& rLine = i_rLines[i];
		std::vector<std::string> texts{
		    std::to_string(i), rLine.m_Kind, rLine.m_Source, rLine.m_Target, Shortest(rLine.m_Weight)};
		if (i_bResiduals)
			texts.push_back(ResidualText(rLine.m_Residual.m_Offset));
		if (i_bStates)
		{
			texts.push_back(rLine.m_Name);
			std::string state;
			for (const std::string& rExpression : rLine.m_State)
				state += (state.empty() ? "" : " ") + rExpression;
			texts.push_back(state);
		}
		table.AddRow(texts);
	}
	return table;
}

EExitStatus ShowTargets(const VTargetsSettings& i_rSettings)
{
	VSession session;
	session.LoadTarget(i_rSettings.m_File);
	const bool bResiduals = !i_rSettings.m_Source.empty();
	if (bResiduals)
		session.LoadSource(i_rSettings.m_Source);
	const std::vector<VTargetLine> lines = TargetLines(session, bResiduals);
	TellDisagreement(lines);
	VTable table = LinesToTable(lines, bResiduals, true);
	if (!i_rSettings.m_bStates && table.LineWidth() > TerminalWidth())
		table = LinesToTable(lines, bResiduals, false);
	PrintResult(LinesToJson(lines, bResiduals), table.Text(HasColours(STDOUT_FILENO), TerminalWidth()));
	return EFine;
}

} // namespace

VCommand AddTargetsCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "targets",
	    "Show the targets of a retarget subject as a table; with the performer's skeleton also how far each is, in the "
	    "bind poses, from what it asks for: mm for positions, degrees for rotations",
	    {"targets hero.qrr", "targets hero.qrr --source performer.qrs",
	        "targets hero.qrr --source performer.qrs --json | jq '.[] | select(.distance > 1)'"});
	const auto pSettings = std::make_shared<VTargetsSettings>();
	pApp->add_option("FILE.qrr", pSettings->m_File, "The retarget subject, or a legacy one (.qrx); - is standard input")
	    ->required();
	pApp->add_option("--source", pSettings->m_Source, "The performer's skeleton, for the residuals")
	    ->option_text("FILE.qrs")
	    ->check(NotEmpty());
	pApp->add_flag("--states", pSettings->m_bStates,
	    "With the names and states of the targets, which are shown by themselves where the terminal is wide enough");
	return {pApp, [pSettings] { return ShowTargets(*pSettings); }};
}

} // namespace CommandLine
