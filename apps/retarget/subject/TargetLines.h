#pragma once

#include "retarget/subject/Residuals.h"
#include "retarget/text/Output.h"

#include <string>
#include <vector>

namespace CommandLine
{

/// What is shown of one target; empty texts for what it does not have.
struct VTargetLine
{
	std::string m_Name;
	std::string m_Type;
	/// As RetargetSetup::TargetKindName.
	std::string m_Kind;
	std::string m_Source;
	std::string m_Target;
	double m_Weight = 0.0;
	std::vector<std::string> m_State;
	VTargetResidual m_Residual;
};

/// One for each target of the session.
/// @param i_bResiduals needs a source.
std::vector<VTargetLine> TargetLines(VSession& io_rSession, bool i_bResiduals);

/// One object for each, with what "targets --json" shows.
VJson LinesToJson(const std::vector<VTargetLine>& i_rLines, bool i_bResiduals);

double AsDegrees(double i_Radians);

/// "1.250 mm", "0.300 deg", "-" for none.
std::string ResidualText(const VResidual& i_rResidual);

} // namespace CommandLine
