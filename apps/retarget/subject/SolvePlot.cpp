#include "retarget/subject/SolvePlot.h"

#include "retarget/report/Page.h"
#include "retarget/text/Table.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace CommandLine
{
namespace
{

/// Pixels.
constexpr double c_Left = 70.0;
constexpr double c_Width = 900.0;
constexpr double c_Names = 260.0;
constexpr double c_Height = 260.0;
constexpr double c_Top = 30.0;
constexpr double c_Gap = 60.0;
/// Points that a line has at most: of more frames the worst of each stretch.
constexpr std::size_t c_Points = 1800;
/// Told apart by people who see no red or no green.
constexpr std::array<const char*, 7> c_Colours{
    "#0072b2", "#d55e00", "#009e73", "#cc79a7", "#e69f00", "#56b4e9", "#000000"};

std::string Text(double i_X, double i_Y, const char* i_pAnchor, const std::string& i_rText, const char* i_pColour)
{
	return "<text x=\"" + Fixed(i_X, 1) + "\" y=\"" + Fixed(i_Y, 1) + "\" text-anchor=\"" + i_pAnchor + "\" fill=\""
	    + i_pColour + "\">" + EscapedForHtml(i_rText) + "</text>\n";
}

std::string Line(double i_X1, double i_Y1, double i_X2, double i_Y2)
{
	return "<line x1=\"" + Fixed(i_X1, 1) + "\" y1=\"" + Fixed(i_Y1, 1) + "\" x2=\"" + Fixed(i_X2, 1) + "\" y2=\""
	    + Fixed(i_Y2, 1) + "\" stroke=\"#cccccc\"/>\n";
}

/// 1, 2 or 5 times a power of ten, so that some five of them make the range.
double StepOf(double i_Range)
{
	const double power = std::pow(10.0, std::floor(std::log10(i_Range / 5.0)));
	const double part = i_Range / 5.0 / power;
	return power * (part < 1.5 ? 1.0 : part < 3.5 ? 2.0 : part < 7.5 ? 5.0 : 10.0);
}

std::string Polyline(const VSolveResult& i_rResult, std::size_t i_Target, double i_Greatest, double i_Top,
    const char* i_pColour, const char* i_pWidth)
{
	const TakeSolve::VSolvedTake& rSolved = i_rResult.m_rSolved;
	const double factor = UnitFactor(i_rResult.m_rTarget.m_Targets[i_Target]);
	const std::size_t step = (rSolved.m_Frames + c_Points - 1) / c_Points;
	const double span = std::max(1.0, double(rSolved.m_Frames - 1));
	std::string points;
	for (std::size_t i = 0; i < rSolved.m_Frames; i += step)
	{
		double worst = -1.0;
		for (std::size_t k = i; k < std::min(i + step, rSolved.m_Frames); ++k)
			if (const double residual = rSolved.Residuals(k)[i_Target]; std::isfinite(residual))
				worst = std::max(worst, factor * residual);
		if (worst >= 0.0)
			points += (points.empty() ? "" : " ") + Fixed(c_Left + c_Width * double(i) / span, 1) + ","
			    + Fixed(i_Top + c_Height * (1.0 - worst / i_Greatest), 1);
	}
	return "<polyline fill=\"none\" stroke=\"" + std::string(i_pColour) + "\" stroke-width=\"" + i_pWidth
	    + "\" points=\"" + points + "\"/>\n";
}

std::string Panel(const VSolveResult& i_rResult, bool i_bRotations, double i_Top)
{
	const auto& rTargets = i_rResult.m_rTarget.m_Targets;
	const auto& rQualities = i_rResult.m_rReport.m_Targets;
	std::vector<std::size_t> targets;
	for (std::size_t i = 0; i < rTargets.size(); ++i)
		if (IsRotationTarget(rTargets[i]) == i_bRotations && rQualities[i].m_Frames > 0)
			targets.push_back(i);
	std::ranges::stable_sort(targets, std::greater(), [&](std::size_t i_Target) { return rQualities[i_Target].m_Rms; });
	double greatest = 1e-3;
	for (const std::size_t target : targets)
		greatest = std::max(greatest, UnitFactor(rTargets[target]) * rQualities[target].m_Max);

	std::string svg = Text(c_Left, i_Top - 8.0, "start", i_bRotations ? "degrees" : "mm", "#000000");
	const double step = StepOf(greatest);
	for (int i = 0; i * step <= greatest; ++i)
	{
		// Three tenths are no sum of tenths, and shall read "0.3".
		const double value = step < 1.0 ? i / std::round(1.0 / step) : i * step;
		const double y = i_Top + c_Height * (1.0 - value / greatest);
		svg += Line(c_Left, y, c_Left + c_Width, y) + Text(c_Left - 6.0, y + 4.0, "end", Shortest(value), "#000000");
	}
	const TakeSolve::VSolvedTake& rSolved = i_rResult.m_rSolved;
	const double span = std::max(1.0, double(rSolved.m_Frames - 1));
	const auto frames = std::size_t(std::max(1.0, StepOf(span)));
	for (std::size_t frame = 0; double(frame) <= span; frame += frames)
		svg += Text(c_Left + c_Width * double(frame) / span, i_Top + c_Height + 16.0, "middle",
		    std::to_string(rSolved.m_First + frame), "#000000");
	for (std::size_t i = targets.size(); i-- > 0;)
	{
		const bool bNamed = i < c_Colours.size();
		const char* const pColour = bNamed ? c_Colours[i] : "#bbbbbb";
		svg += Polyline(i_rResult, targets[i], greatest, i_Top, pColour, bNamed ? "1.5" : "0.7");
		if (bNamed)
			svg += Text(c_Left + c_Width + 12.0, i_Top + 14.0 + 18.0 * double(i), "start",
			    "#" + std::to_string(targets[i]) + " " + SourceOf(i_rResult.m_rTarget, rTargets[targets[i]]) + " to "
			        + TargetOf(i_rResult.m_rTarget, rTargets[targets[i]]),
			    pColour);
	}
	return svg;
}

} // namespace

std::string SolvePlot(const VSolveResult& i_rResult)
{
	const std::string width = Fixed(c_Left + c_Width + c_Names, 0);
	const std::string height = Fixed(2.0 * (c_Top + c_Height) + c_Gap, 0);
	return "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"" + width + "\" height=\"" + height + "\" viewBox=\"0 0 "
	    + width + " " + height + "\" font-family=\"sans-serif\" font-size=\"12\">\n<rect width=\"" + width
	    + "\" height=\"" + height + "\" fill=\"#ffffff\"/>\n" + Panel(i_rResult, false, c_Top)
	    + Panel(i_rResult, true, 2.0 * c_Top + c_Height + 0.5 * c_Gap) + "</svg>\n";
}

} // namespace CommandLine
