#include "CoreOrlexTypesUtils/rigidbody/RigidBody.h"

#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyRefusal.h"

#include "DebugServices/GlobalLog.h"
#include "math/NumberText.h"

#include <algorithm>

namespace CoreOrlexTypesUtils::RigidBodyUtils
{

namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using Rotation::VMatrix3;
using Rotation::VVector3;

/// Of a marker that nothing is known about, in mm squared.
constexpr VMatrix3 c_DefaultCovariance{5.0, 0, 0, 0, 5.0, 0, 0, 0, 5.0};

const std::vector<double>& StateOf(const VSubject::VTarget& i_rTarget)
{
	return i_rTarget.m_State;
}

std::vector<double> StateOf(const VSubjectParametrised::VTarget& i_rTarget)
{
	const VDynamicExpressionParserSimple parser;
	std::vector<double> state;
	std::string error;
	for (const std::string& rExpression : i_rTarget.m_StateExpressions)
		if (!parser.Evaluate(rExpression, state.emplace_back(), error))
			return {};
	return state;
}

void SetState(VSubject::VTarget& io_rTarget, std::vector<double> i_State)
{
	io_rTarget.m_State = std::move(i_State);
}

void SetState(VSubjectParametrised::VTarget& io_rTarget, const std::vector<double>& i_rState)
{
	io_rTarget.m_StateExpressions.clear();
	for (const double value : i_rState)
		io_rTarget.m_StateExpressions.push_back(NumberText::PrintG17(value));
}

std::size_t StateSizeOf(const VSubject::VTarget& i_rTarget)
{
	return i_rTarget.m_State.size();
}

std::size_t StateSizeOf(const VSubjectParametrised::VTarget& i_rTarget)
{
	return i_rTarget.m_StateExpressions.size();
}

} // namespace

template <typename TTarget>
bool ReadRigidBody(const TTarget& i_rTarget, Rotation::VPose<double>& o_rPose, std::vector<VVector3>& o_rLocalPositions,
    VPoseCovariance& o_rPoseCovariance, std::vector<VMatrix3>& o_rMarkerCovariance)
{
	const std::size_t markers = i_rTarget.m_MarkerIndices.size();
	if (i_rTarget.m_Type != TTarget::ERigidBody)
		return Refuse("Cannot read rigid body information, this target is not a rigid body!");
	if (markers < c_MarkersOfBody)
		return Refuse(
		    "Cannot read rigid body information, the rigid body does not define a sufficient number of markers!");
	if (StateSizeOf(i_rTarget) != 3 * (markers + 2))
		return Refuse("Cannot read rigid body information, Incorrect state size!");
	if (i_rTarget.m_Covariance.size() != 9 * (markers + 4))
		return Refuse("Cannot read rigid body information, Incorrect covariance size!");
	const std::vector<double>& rState = StateOf(i_rTarget);
	if (rState.size() != 3 * (markers + 2))
		return Refuse("Could not evaluate state expressions in target");

	o_rPose = Rotation::PoseFromAngleAxis({rState[3], rState[4], rState[5]}, {rState[0], rState[1], rState[2]});
	std::copy_n(i_rTarget.m_Covariance.begin(), 36, o_rPoseCovariance.begin());
	o_rLocalPositions.resize(markers);
	o_rMarkerCovariance.resize(markers);
	for (std::size_t i = 0; i < markers; ++i)
	{
		std::copy_n(rState.begin() + std::ptrdiff_t(6 + 3 * i), 3, o_rLocalPositions[i].begin());
		std::copy_n(i_rTarget.m_Covariance.begin() + std::ptrdiff_t(36 + 9 * i), 9, o_rMarkerCovariance[i].begin());
		if (o_rMarkerCovariance[i] != VMatrix3{})
			continue;
		NVX_LOG("RigidBodyUtils", NVX::ELogWarning, "Zero covariance on rigid body marker, filling up with default!");
		o_rMarkerCovariance[i] = c_DefaultCovariance;
	}
	return true;
}

template <typename TTarget>
bool WriteRigidBody(TTarget& io_rTarget, const Rotation::VPose<double>& i_rPose,
    const std::vector<VVector3>& i_rLocalPositions, const VPoseCovariance& i_rPoseCovariance,
    const std::vector<VMatrix3>& i_rMarkerCovariance)
{
	if (io_rTarget.m_Type != TTarget::ERigidBody)
		return Refuse("Cannot write rigid body information, this target is not a rigid body!");
	if (i_rLocalPositions.size() != i_rMarkerCovariance.size())
		return Refuse("Cannot write rigid body information, different number of marker positions and covariances!");
	if (i_rLocalPositions.size() < c_MarkersOfBody)
		return Refuse(
		    "Cannot write rigid body information, the rigid body does not define a sufficient number of markers!");
	std::vector<double> state(i_rPose.t.begin(), i_rPose.t.end());
	const VVector3 angleAxis = Rotation::AngleAxisFromRotationMatrix(i_rPose.R);
	state.insert(state.end(), angleAxis.begin(), angleAxis.end());
	for (const VVector3& rPosition : i_rLocalPositions)
		state.insert(state.end(), rPosition.begin(), rPosition.end());
	SetState(io_rTarget, std::move(state));
	io_rTarget.m_Covariance.assign(i_rPoseCovariance.begin(), i_rPoseCovariance.end());
	for (const VMatrix3& rCovariance : i_rMarkerCovariance)
		io_rTarget.m_Covariance.insert(io_rTarget.m_Covariance.end(), rCovariance.begin(), rCovariance.end());
	return true;
}

template bool ReadRigidBody(const VSubject::VTarget&, Rotation::VPose<double>&, std::vector<VVector3>&,
    VPoseCovariance&, std::vector<VMatrix3>&);
template bool ReadRigidBody(const VSubjectParametrised::VTarget&, Rotation::VPose<double>&, std::vector<VVector3>&,
    VPoseCovariance&, std::vector<VMatrix3>&);
template bool WriteRigidBody(VSubject::VTarget&, const Rotation::VPose<double>&, const std::vector<VVector3>&,
    const VPoseCovariance&, const std::vector<VMatrix3>&);
template bool WriteRigidBody(VSubjectParametrised::VTarget&, const Rotation::VPose<double>&,
    const std::vector<VVector3>&, const VPoseCovariance&, const std::vector<VMatrix3>&);

} // namespace CoreOrlexTypesUtils::RigidBodyUtils
