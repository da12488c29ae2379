#include "ComputeSubjectFK/NearestRevolution.h"

#include "DebugServices/Assert.h"

#include <numbers>

namespace ComputeSubject
{
namespace
{

constexpr double c_Turn = 2.0 * std::numbers::pi;
constexpr double c_InverseTurn = 0.15915494309189535;
constexpr double c_SmallestPrevious = 1e-5;

struct VAngleAxis
{
	bool is_zero() const { return m_Vector == Rotation::VVector3{}; }
	double Length() const { return std::sqrt(Dot(*this)); }
	double Dot(const VAngleAxis& i_rOther) const
	{
		return m_Vector[0] * i_rOther.m_Vector[0] + m_Vector[1] * i_rOther.m_Vector[1]
		    + m_Vector[2] * i_rOther.m_Vector[2];
	}
	void Scale(double i_Factor)
	{
		for (double& rValue : m_Vector)
			rValue *= i_Factor;
	}
	/// i_Revolutions more turns about the same axis; the length must not be 0.
	void Turn(double i_Revolutions)
	{
		if (i_Revolutions != 0.0)
			Scale(c_Turn * i_Revolutions / Length() + 1.0);
	}
	Rotation::VVector3 m_Vector;
};

} // namespace

Rotation::VVector3 NearestRevolution(const Rotation::VVector3& i_rState, const Rotation::VVector3& i_rPrevious)
{
	VAngleAxis InputRAA{i_rState};
	const VAngleAxis previous{i_rPrevious};
	const bool bPrevious = previous.Length() > c_SmallestPrevious;

	InputRAA.Turn(-std::rint(InputRAA.Length() * c_InverseTurn));
	const double length = InputRAA.Length();
	if (length > 0.0)
	{
		if (bPrevious)
			InputRAA.Turn(std::rint((previous.Dot(InputRAA) / length - length) * c_InverseTurn));
	}
	else if (bPrevious)
	{
		InputRAA = previous;
		InputRAA.Scale(c_Turn * std::rint(previous.Length() * c_InverseTurn) / previous.Length());
	}
	else
		NVX_ASSERT(InputRAA.is_zero());
	return InputRAA.m_Vector;
}

} // namespace ComputeSubject
