#pragma once

#include "studio/motion/CurvePlot.h"

#include <memory>
#include <vector>

namespace StudioHost
{

class VResidualModel;
class VTakePlayer;
struct VJudgedTake;

/// How far chosen targets are off over the take, with a cursor where it plays, and the worst frame of each marked. A
/// press of the left button or a drag shows the frame under the mouse, on a mark the worst one.
class VResidualPlot : public VCurvePlot
{
	Q_OBJECT

public:
	VResidualPlot(VTakePlayer& i_rPlayer, const VResidualModel& i_rModel, QWidget* i_pParent = nullptr);

	/// By number of target; for none of them it shows the position and the rotation that are furthest off.
	void Choose(std::vector<int> i_Targets);

private:
	void Draw();
	std::vector<int> Shown() const;

	VTakePlayer& m_rPlayer;
	const VResidualModel& m_rModel;
	std::vector<int> m_Targets;
	/// Not held: what was solved before is large, and is given back by the thread that solves.
	std::weak_ptr<const VJudgedTake> m_pDrawn;
	bool m_bDrawn = false;
};

} // namespace StudioHost
