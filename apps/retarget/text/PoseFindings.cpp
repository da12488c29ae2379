#include "retarget/text/PoseFindings.h"

#include <cmath>

namespace CommandLine
{

VJson PoseJson(const std::vector<SetupProposal::VPoseFinding>& i_rFindings)
{
	VJson list = VJson::array();
	for (const auto& rFinding : i_rFindings)
	{
		VJson numbers = VJson::object();
		for (const auto& [pName, value] : rFinding.m_Numbers)
			numbers[pName] = std::round(1e4 * value) / 1e4;
		list.push_back({{"id", rFinding.m_pId}, {"fine", rFinding.m_bFine}, {"message", rFinding.m_Message},
		    {"numbers", numbers}, {"options", rFinding.m_Options}});
	}
	return list;
}

std::string PoseText(const std::vector<SetupProposal::VPoseFinding>& i_rFindings)
{
	std::string text;
	for (const auto& rFinding : i_rFindings)
	{
		text += std::string(rFinding.m_bFine ? "  fine  " : "  look  ") + rFinding.m_pId + ": "
		    + Printable(rFinding.m_Message) + "\n";
		if (!rFinding.m_Options.empty())
			text += "        " + Printable(rFinding.m_Options) + "\n";
	}
	return text.empty() ? text : "\nAt rest, with the options of create and edit that mend it\n" + text;
}

} // namespace CommandLine
