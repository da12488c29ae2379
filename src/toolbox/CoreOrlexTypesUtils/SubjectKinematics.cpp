#include "CoreOrlexTypesUtils/SubjectKinematics.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectFK/TargetFK.h"
#include "CoreOrlexTypesUtils/observations/UnusedObservations.h"

#include <algorithm>

namespace CoreOrlexTypesUtils
{

namespace
{

using CoreOrlexTypes::VSubject;

bool FitsItsType(const VSubject& i_rSubject, const VSubject::VTarget& i_rTarget,
    const ComputeSubject::ITargetFKFactory<VSubject::VTarget>& i_rFactory, const ComputeSubject::VSegmentTree& i_rTree)
{
	try
	{
		i_rFactory.Create(i_rTarget, i_rTree);
	}
	catch (const ComputeSubject::VConstructionException&)
	{
		return false;
	}
	return std::ranges::all_of(
	    i_rTarget.m_MarkerIndices, [&](std::uint32_t i_Index) { return i_Index < i_rSubject.m_Markers.size(); });
}

ComputeSubject::VSegmentTree Tree(const VSubject& i_rSubject)
{
	try
	{
		return ComputeSubject::MakeSegmentTree(i_rSubject);
	}
	catch (const ComputeSubject::VConstructionException&)
	{
		return {};
	}
}

/// Brings values that stand at the new indices to the old ones. In place: no element moves towards the front, so that
/// those that are still to be read stand before those that are written.
template <typename T>
void Spread(const VRenumbering& i_rRenumbering, std::size_t i_Count, const T& i_rWithout, std::vector<T>& io_rValues,
    std::vector<bool>& io_rValid)
{
	const std::size_t known = io_rValues.size();
	io_rValues.resize(i_Count, i_rWithout);
	io_rValid.resize(i_Count, false);
	for (std::size_t i = i_Count; i-- > 0;)
	{
		auto from = static_cast<std::uint32_t>(i);
		i_rRenumbering.Renumber(from);
		io_rValid[i] = from < known && io_rValid[from];
		io_rValues[i] = io_rValid[i] ? io_rValues[from] : i_rWithout;
	}
}

} // namespace

VSubjectKinematics::VSubjectKinematics(const VSubject& i_rSubject)
    : m_MarkerCount(i_rSubject.m_Markers.size()), m_RotationCount(i_rSubject.m_Rotations.size())
{
	const ComputeSubject::VSegmentTree tree = Tree(i_rSubject);
	if (tree.empty() || tree.size() != i_rSubject.m_Segments.size())
		return;
	std::vector<bool> keep(i_rSubject.m_Targets.size(), false);
	for (std::size_t i = 0; i < keep.size(); ++i)
	{
		const VSubject::VTarget& rTarget = i_rSubject.m_Targets[i];
		const auto* const pFactory = ComputeSubject::TargetFKFactory(rTarget.m_Type);
		keep[i] = pFactory && FitsItsType(i_rSubject, rTarget, *pFactory, tree);
		if (pFactory && !keep[i])
			m_Misfits.push_back(i);
	}
	VSubject subject = i_rSubject;
	m_Targets = VRenumbering(keep);
	m_Targets.Close(subject.m_Targets);
	m_Markers = NamedMarkers(subject);
	m_Rotations = NamedRotations(subject);
	for (VSubject::VTarget& rTarget : subject.m_Targets)
	{
		m_Markers.Renumber(rTarget.m_MarkerIndices);
		m_Rotations.Renumber(rTarget.m_RotationObservationIndices);
	}
	m_pKinematics = std::make_unique<ComputeSubject::VComputeSubjectFK>(subject);
}

VSubjectKinematics::VSubjectKinematics(VSubjectKinematics&&) noexcept = default;

VSubjectKinematics::~VSubjectKinematics() = default;

const ComputeSubject::ITargetFK* VSubjectKinematics::Target(std::size_t i_Index) const
{
	auto index = static_cast<std::uint32_t>(i_Index);
	m_Targets.Renumber(index);
	return m_pKinematics && index < m_pKinematics->NumberOfTargets() ? m_pKinematics->Target(index) : nullptr;
}

const ComputeSubject::IComputeSegmentFK& VSubjectKinematics::Segment(std::size_t i_Index) const
{
	return m_pKinematics->Segment(i_Index);
}

std::size_t VSubjectKinematics::NumberOfStates() const
{
	return m_pKinematics->NumberOfStates();
}

void VSubjectKinematics::Update(const double* i_pState)
{
	m_pKinematics->Update(i_pState);
}

void VSubjectKinematics::UpdateMany(
    std::span<const double> i_States, std::span<Rotation::VPose<double>> o_Poses, unsigned i_Threads) const
{
	m_pKinematics->UpdateMany(i_States, o_Poses, i_Threads);
}

void VSubjectKinematics::ComputeMarkers(
    std::vector<Rotation::VVector3>& io_rPositions, std::vector<bool>& o_rValid) const
{
	m_pKinematics->ComputeMarkers(io_rPositions, o_rValid);
	Spread(m_Markers, m_MarkerCount, {}, io_rPositions, o_rValid);
}

void VSubjectKinematics::ComputeRotations(
    std::vector<Rotation::VMatrix3>& io_rRotations, std::vector<bool>& o_rValid) const
{
	m_pKinematics->ComputeRotations(io_rRotations, o_rValid);
	Spread(m_Rotations, m_RotationCount, Rotation::c_Identity3, io_rRotations, o_rValid);
}

} // namespace CoreOrlexTypesUtils
