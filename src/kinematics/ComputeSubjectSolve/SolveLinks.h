#pragma once

#include "numerics/Rotation.h"

#include <Eigen/Core>

#include <cstddef>
#include <span>
#include <vector>

namespace CoreOrlexTypes
{
struct VSubject;
}

namespace ComputeSubject
{

class VComputeSubjectFK;

inline Eigen::Vector3d ToEigen(const Rotation::VVector3& i_rVector)
{
	return Eigen::Map<const Eigen::Vector3d>(i_rVector.data());
}

inline Eigen::Matrix3d ToEigen(const Rotation::VMatrix3& i_rMatrix)
{
	return Eigen::Map<const Eigen::Matrix<double, 3, 3, Eigen::RowMajor>>(i_rMatrix.data());
}

inline Rotation::VVector3 FromEigen(const Eigen::Vector3d& i_rVector)
{
	return {i_rVector[0], i_rVector[1], i_rVector[2]};
}

/// The matrix of the cross product with a vector.
inline Eigen::Matrix3d Cross(const Eigen::Vector3d& i_rVector)
{
	Eigen::Matrix3d matrix;
	matrix << 0.0, -i_rVector[2], i_rVector[1], i_rVector[2], 0.0, -i_rVector[0], -i_rVector[1], i_rVector[0], 0.0;
	return matrix;
}

inline constexpr std::size_t c_NoLink = static_cast<std::size_t>(-1);

/// The smallest part of a joint that moves: a free joint is a move and a turn, a Hardy Spicer joint two turns about an
/// axis. Small changes of a link are vectors in the world, or of one axis their length along it; what is done to a link
/// is done to all that hangs on it.
struct VSolveLink
{
	bool m_bTurn = false;
	/// 3, or 1 for an axis.
	int m_Size = 3;
	std::size_t m_Segment = 0;
	/// Where its states begin, and which axis of the joint's own it moves along or about.
	std::size_t m_State = 0;
	std::size_t m_Parent = c_NoLink;

	/// Of the latest PlaceLinks: the axes in which the joint moves, by columns, a single link's axis, and for turns the
	/// point that stays, from the reference point.
	Eigen::Matrix3d m_Base = Eigen::Matrix3d::Identity();
	Eigen::Vector3d m_Axis = Eigen::Vector3d::Zero();
	Eigen::Vector3d m_Centre = Eigen::Vector3d::Zero();
};

struct VSolveLinks
{
	/// Parents before their children.
	std::vector<VSolveLink> m_Links;
	/// For each segment the link that moves it last, c_NoLink if none does.
	std::vector<std::size_t> m_LinkOfSegment;
	/// What all vectors to points are measured from, near the subject to keep digits.
	Eigen::Vector3d m_Reference = Eigen::Vector3d::Zero();
};

/// @param i_rActive for each segment whether its joint is solved for.
VSolveLinks MakeLinks(const CoreOrlexTypes::VSubject& i_rSubject, const std::vector<bool>& i_rActive);

/// Brings axes and centres up to the latest update of the kinematics, whose states these are.
void PlaceLinks(const VComputeSubjectFK& i_rKinematics, std::span<const double> i_States, VSolveLinks& io_rLinks);

/// Changes the states of a link.
void MoveLink(const VSolveLink& i_rLink, const Eigen::Vector3d& i_rChange, double* io_pStates);

} // namespace ComputeSubject
