#pragma once

#include "TakeIO/Take.h"

namespace TakeIO
{

/// From the rest pose, which is in the file's axes and unit: the axis along which it reaches further, Y if it is no
/// pose of a person at all.
EUp GuessUp(const VTake& i_rTake);

/// How far the first joint stands above the lowest point, in the file's unit; 0 if nothing is below it.
double HipsHeight(const VTake& i_rTake, EUp i_Up);

struct VUnit
{
	const char* m_pName;
	/// Millimetres.
	double m_Size;
	/// Whether hips of a person can stand so high.
	bool m_bFits = true;
};

/// The unit in which hips that stand so high are those of a person, or come closest.
VUnit GuessUnit(double i_HipsHeight);

} // namespace TakeIO
