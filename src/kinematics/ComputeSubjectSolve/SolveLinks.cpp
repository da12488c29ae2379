#include "ComputeSubjectSolve/SolveLinks.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/Subject.h"

#include <cmath>

namespace ComputeSubject
{

using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

VSolveLinks MakeLinks(const CoreOrlexTypes::VSubject& i_rSubject, const std::vector<bool>& i_rActive)
{
	VSolveLinks links;
	std::size_t state = 0;
	for (std::size_t i = 0; i < i_rSubject.m_Segments.size(); ++i)
	{
		const auto& rSegment = i_rSubject.m_Segments[i];
		std::size_t last = rSegment.m_ParentSegmentIndex == CoreOrlexTypes::c_NoParent
		    ? c_NoLink
		    : links.m_LinkOfSegment[rSegment.m_ParentSegmentIndex];
		const auto append = [&](bool i_bTurn, int i_Size, std::size_t i_Offset)
		{
			VSolveLink link;
			link.m_bTurn = i_bTurn;
			link.m_Size = i_Size;
			link.m_Segment = i;
			link.m_State = state + i_Offset;
			link.m_Parent = last;
			last = links.m_Links.size();
			links.m_Links.push_back(link);
		};
		if (i_rActive[i])
			switch (rSegment.m_Joint.m_JointType)
			{
			case VJoint::EFree:
				append(false, 3, 3);
				append(true, 3, 0);
				break;
			case VJoint::EBall: append(true, 3, 0); break;
			case VJoint::EHardySpicer:
				append(true, 1, 0);
				append(true, 1, 1);
				break;
			case VJoint::EHinge: append(true, 1, 0); break;
			case VJoint::ESlider: append(false, 1, 0); break;
			default: break;
			}
		links.m_LinkOfSegment.push_back(last);
		state += CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType);
	}
	return links;
}

void PlaceLinks(const VComputeSubjectFK& i_rKinematics, std::span<const double> i_States, VSolveLinks& io_rLinks)
{
	if (io_rLinks.m_Links.empty())
		return;
	io_rLinks.m_Reference = ToEigen(i_rKinematics.Segment(io_rLinks.m_Links.front().m_Segment).WorldPose().t);
	const VSolveLink* pBefore = nullptr;
	for (VSolveLink& rLink : io_rLinks.m_Links)
	{
		const IComputeSegmentFK& rSegment = i_rKinematics.Segment(rLink.m_Segment);
		const bool bSecond = pBefore && pBefore->m_Segment == rLink.m_Segment;
		rLink.m_Base = bSecond ? pBefore->m_Base : ToEigen(rSegment.JointBasePose().R);
		rLink.m_Centre = ToEigen(rSegment.WorldPose().t) - io_rLinks.m_Reference;
		rLink.m_Axis = rLink.m_Base.col(2);
		if (rLink.m_Size == 1 && bSecond)
		{
			const double first = i_States[pBefore->m_State];
			rLink.m_Axis = std::cos(first) * rLink.m_Base.col(1) - std::sin(first) * rLink.m_Base.col(0);
		}
		pBefore = &rLink;
	}
}

void MoveLink(const VSolveLink& i_rLink, const Eigen::Vector3d& i_rChange, double* io_pStates)
{
	double* const pState = io_pStates + i_rLink.m_State;
	if (i_rLink.m_Size == 1)
	{
		*pState += i_rChange[0];
		return;
	}
	const Eigen::Vector3d change = i_rLink.m_Base.transpose() * i_rChange;
	Rotation::VVector3 state{pState[0] + change[0], pState[1] + change[1], pState[2] + change[2]};
	if (i_rLink.m_bTurn)
		state = Rotation::AngleAxisFromRotationMatrix(
		    Rotation::Product(Rotation::RotationMatrixFromAngleAxis(FromEigen(change)),
		        Rotation::RotationMatrixFromAngleAxis({pState[0], pState[1], pState[2]})));
	std::copy(state.begin(), state.end(), pState);
}

} // namespace ComputeSubject
