#include "studio/motion/ResidualPlot.h"

#include "studio/motion/ResidualModel.h"
#include "studio/motion/TakePlayer.h"
#include "studio/window/Named.h"

#include <QTransform>

#include <algorithm>
#include <cmath>
#include <numbers>

namespace StudioHost
{

VResidualPlot::VResidualPlot(VTakePlayer& i_rPlayer, const VResidualModel& i_rModel, QWidget* i_pParent)
    : VCurvePlot(tr("Frame"), tr("mm"), QStringLiteral("°"), i_pParent), m_rPlayer(i_rPlayer), m_rModel(i_rModel)
{
	Named(this, "ResidualPlot", tr("How far the chosen targets are off over the take"));
	setToolTip(tr("Click or drag to look at a frame; a dot is the worst one of its target"));
	connect(this, &VCurvePlot::pressed, &m_rPlayer, [this](double i_X) { m_rPlayer.Seek(std::llround(i_X)); });
	connect(&m_rPlayer, &VTakePlayer::solvedChanged, this, &VResidualPlot::Draw);
	connect(&m_rPlayer, &VTakePlayer::takeChanged, this, &VResidualPlot::Draw);
	for (const auto signal : {&VTakePlayer::frameChanged, &VTakePlayer::takeChanged})
		connect(&m_rPlayer, signal, this, [this] { SetCursorAt(m_rPlayer.Take() ? double(m_rPlayer.Frame()) : -1.0); });
	SetCurves({}, 1.0);
}

void VResidualPlot::Choose(std::vector<int> i_Targets)
{
	if (m_Targets == i_Targets)
		return;
	m_Targets = std::move(i_Targets);
	m_bDrawn = false;
	Draw();
}

std::vector<int> VResidualPlot::Shown() const
{
	const auto& rQualities = m_rPlayer.Judged()->m_Report.m_Targets;
	std::vector<int> shown;
	for (const int target : m_Targets)
		if (std::size_t(target) < rQualities.size())
			shown.push_back(target);
	if (!shown.empty())
		return shown;
	for (const bool bRotation : {false, true})
	{
		int worst = -1;
		for (int i = 0; i < int(rQualities.size()); ++i)
			if (m_rModel.IsRotation(i) == bRotation && rQualities[std::size_t(i)].m_Frames > 0
			    && (worst < 0 || rQualities[std::size_t(i)].m_Max > rQualities[std::size_t(worst)].m_Max))
				worst = i;
		if (worst >= 0)
			shown.push_back(worst);
	}
	return shown;
}

void VResidualPlot::Draw()
{
	const auto& rpJudged = m_rPlayer.Judged();
	// What was drawn stays until the next is solved; progress alone changes nothing.
	const bool bSame = !m_pDrawn.owner_before(rpJudged) && !rpJudged.owner_before(m_pDrawn);
	if (m_rPlayer.IsJudging() || (m_bDrawn && bSame))
		return;
	m_bDrawn = true;
	m_pDrawn = rpJudged;
	QVector<VCurve> curves;
	for (const int target : rpJudged ? Shown() : std::vector<int>())
	{
		const TakeSolve::VTargetQuality& rQuality = rpJudged->m_Report.m_Targets[std::size_t(target)];
		if (rQuality.m_Frames == 0)
			continue;
		const bool bRotation = m_rModel.IsRotation(target);
		const double factor = bRotation ? 180.0 / std::numbers::pi : 1.0;
		curves << VCurve{m_rModel.Name(target),
		    QTransform::fromScale(1.0, factor).map(rpJudged->m_Curves[std::size_t(target)]),
		    QPointF(double(rQuality.m_MaxFrame), factor * rQuality.m_Max), bRotation};
	}
	SetCurves(curves, double(std::max<std::size_t>(m_rPlayer.Frames(), 2) - 1));
}

} // namespace StudioHost

#include "moc_ResidualPlot.cpp"
