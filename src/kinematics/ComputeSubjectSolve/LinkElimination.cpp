#include "ComputeSubjectSolve/LinkElimination.h"

#include "ComputeSubjectSolve/SolveObjective.h"

#include <Eigen/Cholesky>

namespace ComputeSubject
{
namespace
{

/// What a link's change makes of its twist.
template <int t_Size>
Eigen::Matrix<double, 6, t_Size> MotionOf(const VSolveLink& i_rLink)
{
	Eigen::Matrix<double, 3, t_Size> axes;
	if constexpr (t_Size == 1)
		axes = i_rLink.m_Axis;
	else
		axes.setIdentity();
	Eigen::Matrix<double, 6, t_Size> motion;
	if (i_rLink.m_bTurn)
		motion << axes, Cross(i_rLink.m_Centre) * axes;
	else
		motion << Eigen::Matrix<double, 3, t_Size>::Zero(), axes;
	return motion;
}

/// Second derivatives of half the cost, by a turn above and the link's own change.
Eigen::Matrix3d BendOf(const VSolveLink& i_rLink, const VLinkTerms& i_rBelow)
{
	if (!i_rLink.m_bTurn)
		return -Cross(i_rBelow.m_Force);
	Eigen::Matrix3d bend = i_rBelow.m_Moment - i_rLink.m_Centre * i_rBelow.m_Force.transpose();
	const double trace = bend.trace();
	bend.diagonal().array() -= trace;
	return bend - 0.5 * Cross(i_rBelow.m_Torque);
}

double DampingOf(const VSolveLink& i_rLink, double i_Damping)
{
	return i_rLink.m_bTurn ? i_Damping : i_Damping / (c_RotationLength * c_RotationLength);
}

} // namespace

void VLinkTerms::SetZero()
{
	m_Hessian.setZero();
	m_Gradient.setZero();
	m_Moment.setZero();
	m_Force.setZero();
	m_Torque.setZero();
	m_OwnHessian.setZero();
	m_OwnGradient.setZero();
}

VLinkElimination::VLinkElimination(std::size_t i_Links)
    : m_Terms(i_Links), m_Work(i_Links), m_Eliminated(i_Links), m_Twists(i_Links), m_Changes(i_Links)
{
}

template <int t_Size>
bool VLinkElimination::Eliminate(const VSolveLink& i_rLink, std::size_t i_Index, double i_Damping, bool i_bBend)
{
	using VColumns = Eigen::Matrix<double, 6, t_Size>;
	using VBlock = Eigen::Matrix<double, t_Size, t_Size>;
	VLinkTerms& rTerms = m_Work[i_Index];
	const VColumns motion = MotionOf<t_Size>(i_rLink);
	VColumns coupling = rTerms.m_Hessian * motion;
	VBlock block = motion.transpose() * coupling;
	if (i_bBend)
	{
		Eigen::Matrix<double, 3, t_Size> bend;
		if constexpr (t_Size == 1)
			bend = BendOf(i_rLink, rTerms) * i_rLink.m_Axis;
		else
			bend = BendOf(i_rLink, rTerms);
		if (i_rLink.m_bTurn)
		{
			const VBlock own = motion.template topRows<3>().transpose() * bend;
			block += 0.5 * (own + own.transpose());
		}
		coupling.template topRows<3>() += bend;
	}
	block += rTerms.m_OwnHessian.template topLeftCorner<t_Size, t_Size>();
	block.diagonal().array() += DampingOf(i_rLink, i_Damping);
	const Eigen::Matrix<double, t_Size, 1> gradient =
	    motion.transpose() * rTerms.m_Gradient + rTerms.m_OwnGradient.template head<t_Size>();

	const Eigen::LLT<VBlock> factor(block);
	if (factor.info() != Eigen::Success)
		return false;
	const Eigen::Matrix<double, t_Size, 6> solved = factor.solve(coupling.transpose());
	const Eigen::Matrix<double, t_Size, 1> step = factor.solve(gradient);
	m_Eliminated[i_Index].m_Solved.template leftCols<t_Size>() = solved.transpose();
	m_Eliminated[i_Index].m_Step.template head<t_Size>() = step;
	m_Promise += 0.5 * gradient.dot(step);
	if (i_rLink.m_Parent == c_NoLink)
		return true;
	VLinkTerms& rParent = m_Work[i_rLink.m_Parent];
	rParent.m_Hessian += rTerms.m_Hessian - coupling * solved;
	rParent.m_Gradient += rTerms.m_Gradient - coupling * step;
	rParent.m_Moment += rTerms.m_Moment;
	rParent.m_Force += rTerms.m_Force;
	rParent.m_Torque += rTerms.m_Torque;
	return true;
}

bool VLinkElimination::Solve(const VSolveLinks& i_rLinks, double i_Damping, bool i_bBend)
{
	m_Promise = 0.0;
	std::copy(m_Terms.begin(), m_Terms.end(), m_Work.begin());
	for (std::size_t i = m_Terms.size(); i-- > 0;)
	{
		const VSolveLink& rLink = i_rLinks.m_Links[i];
		const bool bDone =
		    rLink.m_Size == 1 ? Eliminate<1>(rLink, i, i_Damping, i_bBend) : Eliminate<3>(rLink, i, i_Damping, i_bBend);
		if (!bDone)
			return false;
	}
	for (std::size_t i = 0; i < m_Terms.size(); ++i)
	{
		const VSolveLink& rLink = i_rLinks.m_Links[i];
		const bool bRoot = rLink.m_Parent == c_NoLink;
		const auto follow = [&](auto i_Size)
		{
			constexpr int c_Size = i_Size();
			Eigen::Matrix<double, c_Size, 1> change = -m_Eliminated[i].m_Step.template head<c_Size>();
			m_Twists[i].setZero();
			if (!bRoot)
			{
				change -= m_Eliminated[i].m_Solved.template leftCols<c_Size>().transpose() * m_Twists[rLink.m_Parent];
				m_Twists[i] = m_Twists[rLink.m_Parent];
			}
			m_Twists[i] += MotionOf<c_Size>(rLink) * change;
			m_Changes[i].setZero();
			m_Changes[i].template head<c_Size>() = change;
			m_Promise += 0.5 * DampingOf(rLink, i_Damping) * change.squaredNorm();
		};
		if (rLink.m_Size == 1)
			follow(std::integral_constant<int, 1>());
		else
			follow(std::integral_constant<int, 3>());
	}
	return true;
}

} // namespace ComputeSubject
