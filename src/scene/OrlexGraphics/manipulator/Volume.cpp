#include "OrlexGraphics/manipulator/Volume.h"

#include <cmath>

namespace OrlexGraphics
{

bool IsValid(const VVolume& i_rVolume)
{
	for (int axis = 0; axis < 3; ++axis)
	{
		const float minimum = i_rVolume.m_Minimum[axis];
		const float maximum = i_rVolume.m_Maximum[axis];
		if (!std::isfinite(minimum) || !std::isfinite(maximum) || !(minimum < maximum))
			return false;
	}
	return true;
}

QMatrix4x4 BoxTransform(const VVolume& i_rVolume)
{
	QMatrix4x4 transform;
	transform.translate(0.5f * (i_rVolume.m_Minimum + i_rVolume.m_Maximum));
	transform.scale(i_rVolume.m_Maximum - i_rVolume.m_Minimum);
	return transform;
}

} // namespace OrlexGraphics
