#include "Flow2Graphics/FlowRenderSubject.h"

#include "ComputeSubjectFK/ComputeSegmentFK.h"
#include "ComputeSubjectFK/TargetFKInterfaces.h"
#include "CoreGraphics/Skin.h"
#include "DebugServices/GlobalLog.h"
#include "Flow2Graphics/SubjectShapes.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "numerics/AllFinite.h"

#include <algorithm>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;

namespace Flow2Graphics
{

namespace
{

/// Of the whole subject.
constexpr float c_SubjectRadius = 1000.0f;
constexpr float c_StickRadius = 3.0f;
constexpr float c_SingleBone = 100.0f;
/// What clusters of markers on a subject look like, and the one segment that they have.
constexpr const char* c_pClusterSkin = "OrlexBeacon";
constexpr const char* c_pClusterSegment = "root";
/// Half of the diagonals of an origin plate and of a target's box.
constexpr float c_OriginReach = 54.0f;
constexpr float c_TargetReach = 0.8660254f * c_TargetEdge;
/// Tip of a rotation target's arrow.
constexpr float c_ArrowReach = 101.0f;
/// More than half of a bone's thickness.
constexpr float c_BoneReach = 20.0f;

template <typename T>
CoreOrlexTypes::VColour ColourOf(const std::vector<T>& i_rData, std::size_t i_Index)
{
	return i_Index < i_rData.size() ? i_rData[i_Index].m_Colour : CoreOrlexTypes::VColour();
}

} // namespace

VFlowRenderSubject::VFlowRenderSubject(std::shared_ptr<const VSubject> i_pSubject,
    std::shared_ptr<const VSubjectApplicationData> i_pData,
    std::shared_ptr<const ISubjectSelectionMaker> i_pSelectionMaker)
    : m_pSubject(std::move(i_pSubject)),
      m_pData(i_pData ? std::move(i_pData) : std::make_shared<const VSubjectApplicationData>()),
      m_pSelectionMaker(std::move(i_pSelectionMaker)), m_Kinematics(*m_pSubject),
      m_Radii(SegmentRadii(*m_pSubject, *m_pData)), m_Origins(OriginSegments(*m_pSubject)),
      m_SegmentHealth(m_pSubject->m_Segments.size(), 1.0f), m_MarkerStates(m_pSubject->m_Markers.size())
{
	const std::string prefix = m_pSubject->m_Name + " : ";
	for (const VSubject::VSegment& rSegment : m_pSubject->m_Segments)
		m_SegmentNames.push_back(prefix + rSegment.m_Name);
	for (const VSubject::VMarker& rMarker : m_pSubject->m_Markers)
		m_MarkerNames.push_back(prefix + rMarker.m_Name);
	Build();
}

VFlowRenderSubject::~VFlowRenderSubject() = default;

void VFlowRenderSubject::Build()
{
	if (!m_Kinematics.IsBuilt())
	{
		NVX_LOG("Tessel", NVX::ELogError, "The subject %1% is not shown: its segments or joints contradict each other",
		    m_pSubject->m_Name);
		return;
	}
	m_State.resize(m_Kinematics.NumberOfStates());
	for (std::size_t i = 0; i < m_pSubject->m_Targets.size(); ++i)
		if (m_pSubject->m_Targets[i].m_Type == VSubject::VTarget::ERigidBody && m_Kinematics.Target(i))
			m_Clusters.push_back(i);
	for (const std::size_t misfit : m_Kinematics.MisfitTargets())
		NVX_LOG("Tessel", NVX::ELogError,
		    "Target #%1% \"%2%\" of the subject %3% is not shown: its values do not fit its type", misfit,
		    misfit < m_pData->m_Targets.size() ? m_pData->m_Targets[misfit].m_Name : std::string(), m_pSubject->m_Name);
}

bool VFlowRenderSubject::Evaluate(const CoreOrlexTypes::VSubjectDynamicParameters* i_pPose)
{
	if (!m_Kinematics.IsBuilt())
		return false;
	if (!i_pPose || i_pPose->m_SubjectId != m_pSubject->m_SubjectId || !AllFinite(i_pPose->m_State))
		return m_bPosed;
	const std::size_t count = std::min(m_State.size(), i_pPose->m_State.size());
	std::copy_n(i_pPose->m_State.begin(), count, m_State.begin());
	std::fill(m_State.begin() + static_cast<std::ptrdiff_t>(count), m_State.end(), 0.0);
	m_Kinematics.Update(m_State.data());
	std::fill(m_SegmentHealth.begin(), m_SegmentHealth.end(), 1.0f);
	m_bPosed = true;
	return true;
}

void VFlowRenderSubject::Update(
    const VPoseData& i_rPoseData, OrlexGraphics::VSelectionRegistry& io_rRegistry, const QMatrix4x4& i_rSceneTransform)
{
	m_pRenderData->Clear();
	m_pMarkerData->Clear();
	if (!Evaluate(i_rPoseData.m_pPose))
		return;
	TakeMatrices(i_rSceneTransform);

	const NVX::ISelectionItem item = m_pSelectionMaker->Subject(m_pSubject->m_SubjectId);
	io_rRegistry.Allocate(item, m_pSubject->m_Name);
	m_pRenderData->m_Id = io_rRegistry.GetId(item);
	FillMarkers(i_rPoseData.m_pLabels, io_rRegistry, i_rSceneTransform);
	FillTargets(io_rRegistry, i_rSceneTransform);
	FillSegments(io_rRegistry);
	UpdateSkins();
}

bool VFlowRenderSubject::BindSkins(OrlexGraphics::VSkinCache& io_rCache)
{
	const bool bMain = m_pData->m_Skin.empty() || BindMainSkin(io_rCache);
	return BindClusterSkins(io_rCache) && bMain;
}

bool VFlowRenderSubject::BindMainSkin(OrlexGraphics::VSkinCache& io_rCache)
{
	std::shared_ptr<CoreGraphics::VSkin> pSkin;
	const std::uint32_t status = io_rCache.GetSkin(pSkin, m_pData->m_Skin, OrlexGraphics::c_pSubjectSkins);
	if (status == OrlexGraphics::SkinStatus::c_Loading)
		return false;
	if (status == OrlexGraphics::SkinStatus::c_NotFound)
		io_rCache.WarnOfMissing(m_pData->m_Skin, OrlexGraphics::c_pSubjectSkins);
	m_pRenderData->m_pSkin.reset();
	if (!pSkin)
		return true;
	std::vector<std::string> names;
	std::vector<QVector3D> offsets;
	for (const VSubject::VSegment& rSegment : m_pSubject->m_Segments)
	{
		names.push_back(rSegment.m_Name);
		offsets.push_back(ToVector(rSegment.m_PreTranslation));
	}
	m_pRenderData->m_pSkin = std::make_unique<CoreGraphics::VSkinInstance>();
	m_pRenderData->m_pSkin->Bind(std::move(pSkin), names, offsets);
	m_pRenderData->m_pSkin->SetUserColours(ToColour(m_pData->m_SkinColourA), ToColour(m_pData->m_SkinColourB));
	return true;
}

bool VFlowRenderSubject::BindClusterSkins(OrlexGraphics::VSkinCache& io_rCache)
{
	if (m_Clusters.empty())
		return true;
	std::shared_ptr<CoreGraphics::VSkin> pSkin;
	if (io_rCache.GetSkin(pSkin, c_pClusterSkin, OrlexGraphics::c_pSubjectSkins)
	    == OrlexGraphics::SkinStatus::c_Loading)
		return false;
	m_pRenderData->m_ClusterSkins.clear();
	if (!pSkin)
		return true;
	for (const std::size_t cluster : m_Clusters)
	{
		CoreGraphics::VSkinInstance& rInstance = m_pRenderData->m_ClusterSkins.emplace_back();
		rInstance.Bind(pSkin, {c_pClusterSegment}, {QVector3D()});
		const QVector4D colour = ToColour(ColourOf(m_pData->m_Targets, cluster));
		rInstance.SetUserColours(colour, colour);
	}
	return true;
}

void VFlowRenderSubject::UpdateSkins()
{
	m_pRenderData->m_bSkin = m_pRenderData->m_pSkin || !m_pRenderData->m_ClusterSkins.empty();
	if (m_pRenderData->m_pSkin)
	{
		for (std::size_t i = 0; i < m_SegmentHealth.size(); ++i)
			m_pRenderData->m_pSkin->SetHealth(i, m_SegmentHealth[i]);
		m_pRenderData->m_pSkin->UpdatePose(m_SegmentMatrices);
	}
	for (std::size_t i = 0; i < m_pRenderData->m_ClusterSkins.size(); ++i)
	{
		const VSubject::VTarget& rTarget = m_pSubject->m_Targets[m_Clusters[i]];
		const auto state = [&rTarget](std::size_t i_At) {
			return Rotation::VVector3{rTarget.m_State[i_At], rTarget.m_State[i_At + 1], rTarget.m_State[i_At + 2]};
		};
		const QMatrix4x4 pose =
		    m_SegmentMatrices[rTarget.m_SegmentIndices[0]] * ToMatrix(Rotation::PoseFromAngleAxis(state(3), state(0)));
		m_pRenderData->m_ClusterSkins[i].UpdatePose({&pose, 1});
	}
}

void VFlowRenderSubject::TakeMatrices(const QMatrix4x4& i_rSceneTransform)
{
	m_SegmentMatrices.resize(m_pSubject->m_Segments.size());
	for (std::size_t i = 0; i < m_SegmentMatrices.size(); ++i)
		m_SegmentMatrices[i] = i_rSceneTransform * ToMatrix(m_Kinematics.Segment(i).SegmentPose());
}

void VFlowRenderSubject::FillMarkers(const CoreOrlexTypes::VReconstructionLabelSet* i_pLabels,
    OrlexGraphics::VSelectionRegistry& io_rRegistry, const QMatrix4x4& i_rSceneTransform)
{
	m_Kinematics.ComputeMarkers(m_ExpectedMarkers, m_ExpectedValid);
	for (std::size_t i = 0; i < m_MarkerStates.size(); ++i)
	{
		VMarkerState& rState = m_MarkerStates[i];
		rState.m_bPresent = !i_pLabels;
		rState.m_bPlaced = m_ExpectedValid[i];
		if (rState.m_bPlaced)
			rState.m_Position = i_rSceneTransform.map(ToVector(m_ExpectedMarkers[i]));
	}
	if (i_pLabels)
		for (const auto& rLabel : i_pLabels->m_Labels)
			if (rLabel.m_SubjectId == m_pSubject->m_SubjectId && rLabel.m_MarkerIndex < m_MarkerStates.size())
				m_MarkerStates[rLabel.m_MarkerIndex] = {i_rSceneTransform.map(ToVector(rLabel.m_Position)), true, true};

	for (std::size_t i = 0; i < m_MarkerStates.size(); ++i)
	{
		const VMarkerState& rState = m_MarkerStates[i];
		const VSubject::VMarker& rMarker = m_pSubject->m_Markers[i];
		// One that is known not to be worn is not looked for.
		if (!rState.m_bPlaced || (rMarker.m_Missing && !rState.m_bPresent))
			continue;
		const NVX::ISelectionItem item = m_pSelectionMaker->Marker(m_pSubject->m_SubjectId, i);
		io_rRegistry.Allocate(item, m_MarkerNames[i]);
		const QVector4D sphere(rState.m_Position, static_cast<float>(rMarker.m_Radius));
		io_rRegistry.SetItemBound(item, sphere);
		(rState.m_bPresent ? m_pMarkerData->m_Markers : m_pRenderData->m_MissingMarkers)
		    .push_back({sphere, ToColour(ColourOf(m_pData->m_Markers, i)), io_rRegistry.GetId(item)});
	}
	FillSticks();
}

void VFlowRenderSubject::FillSticks()
{
	for (const bool bGaps : {false, true})
	{
		for (const VSubjectApplicationData::VStick& rStick : m_pData->m_Sticks)
		{
			if (std::max(rStick.m_MarkerIndexA, rStick.m_MarkerIndexB) >= m_MarkerStates.size())
				continue;
			const VMarkerState& rA = m_MarkerStates[rStick.m_MarkerIndexA];
			const VMarkerState& rB = m_MarkerStates[rStick.m_MarkerIndexB];
			if (rA.m_bPlaced && rB.m_bPlaced && bGaps == !(rA.m_bPresent && rB.m_bPresent))
				m_pMarkerData->m_Sticks.push_back({StickMatrix(rA.m_Position, rB.m_Position, c_StickRadius),
				    ToColour(rStick.m_ColourA), ToColour(rStick.m_ColourB)});
		}
		if (!bGaps)
			m_pMarkerData->m_SticksWithoutGaps = m_pMarkerData->m_Sticks.size();
	}
}

void VFlowRenderSubject::FillTargets(
    OrlexGraphics::VSelectionRegistry& io_rRegistry, const QMatrix4x4& i_rSceneTransform)
{
	for (std::size_t i = 0; i < m_pSubject->m_Targets.size(); ++i)
	{
		CheckHealth(m_pSubject->m_Targets[i]);
		if (i >= m_pData->m_Targets.size() || m_pData->m_Targets[i].m_Visible)
			FillTarget(i, io_rRegistry, i_rSceneTransform);
	}
}

void VFlowRenderSubject::CheckHealth(const VSubject::VTarget& i_rTarget)
{
	if (i_rTarget.m_SegmentIndices.size() != 1 || i_rTarget.m_SegmentIndices[0] >= m_SegmentHealth.size())
		return;
	const bool bAllPresent = std::all_of(i_rTarget.m_MarkerIndices.begin(), i_rTarget.m_MarkerIndices.end(),
	    [this](std::uint32_t i_Marker)
	    { return i_Marker < m_MarkerStates.size() ? m_MarkerStates[i_Marker].m_bPresent : true; });
	if (!bAllPresent)
		m_SegmentHealth[i_rTarget.m_SegmentIndices[0]] = 0.0f;
}

void VFlowRenderSubject::FillTarget(
    std::size_t i_Index, OrlexGraphics::VSelectionRegistry& io_rRegistry, const QMatrix4x4& i_rSceneTransform)
{
	const VSubject::VTarget& rTarget = m_pSubject->m_Targets[i_Index];
	const ComputeSubject::ITargetFK* const pTarget = m_Kinematics.Target(i_Index);
	if (!pTarget || rTarget.m_SegmentIndices.empty() || rTarget.m_SegmentIndices[0] >= m_SegmentMatrices.size())
		return;
	const QMatrix4x4& rSegment = m_SegmentMatrices[rTarget.m_SegmentIndices[0]];
	const NVX::ISelectionItem item = m_pSelectionMaker->Target(m_pSubject->m_SubjectId, i_Index);
	io_rRegistry.Allocate(item, i_Index < m_pData->m_Targets.size() ? m_pData->m_Targets[i_Index].m_Name : "");
	const CoreGraphics::VSelectionId id = io_rRegistry.GetId(item);
	const QVector4D colour = ToColour(ColourOf(m_pData->m_Targets, i_Index));

	// Its first place is the item's.
	bool bFirst = true;
	const auto addPosition = [&](const QVector3D& i_rPlace)
	{
		m_pRenderData->m_PositionTargets.push_back({QVector4D(i_rPlace, c_TargetEdge), colour, id});
		if (std::exchange(bFirst, false))
		{
			QMatrix4x4 matrix = rSegment;
			matrix.setColumn(3, QVector4D(i_rPlace, 1.0f));
			io_rRegistry.SetItemMatrix(item, matrix);
			io_rRegistry.SetItemBound(item, QVector4D(i_rPlace, c_TargetReach));
		}
	};
	const auto toWorld = [&](const Rotation::VVector3& i_rPoint) { return i_rSceneTransform.map(ToVector(i_rPoint)); };

	if (pTarget->FromLocalPoint())
	{
		const QVector3D place = toWorld(pTarget->FromLocalPoint()->WorldPoint());
		addPosition(place);
		if (const auto matrix = CovarianceMatrix(rSegment, place, rTarget.m_Covariance))
			m_pRenderData->m_Covariances.push_back(*matrix);
	}
	else if (pTarget->FromLocalLine())
	{
		const QVector3D a = toWorld(pTarget->FromLocalLine()->WorldPoint1());
		const QVector3D b = toWorld(pTarget->FromLocalLine()->WorldPoint2());
		addPosition(a);
		addPosition(b);
		io_rRegistry.SetPickBound(item, QVector4D(a, (b - a).length() + c_TargetReach));
	}
	else if (pTarget->FromLocalPlane())
		addPosition(rSegment.map(ToVector({rTarget.m_State[0], rTarget.m_State[1], rTarget.m_State[2]})));
	else if (pTarget->FromPointGroup())
		addPosition(toWorld(pTarget->FromPointGroup()->WorldOrigin()));
	else if (pTarget->FromLocalRotation())
	{
		QMatrix4x4 matrix =
		    i_rSceneTransform * ToMatrix({pTarget->FromLocalRotation()->WorldRotation(), {0.0, 0.0, 0.0}});
		matrix.setColumn(3, rSegment.column(3));
		m_pRenderData->m_RotationTargets.push_back({matrix, rSegment, id});
		io_rRegistry.SetItemMatrix(item, matrix);
		io_rRegistry.SetItemBound(item, QVector4D(Translation(rSegment), c_ArrowReach));
	}
}

void VFlowRenderSubject::FillSegments(OrlexGraphics::VSelectionRegistry& io_rRegistry)
{
	const std::size_t count = m_SegmentMatrices.size();
	m_SegmentIds.resize(count);
	m_Reach.assign(count, c_JointRadius);
	float subjectReach = c_SubjectRadius;
	const NVX::ISelectionItem subject = m_pSelectionMaker->Subject(m_pSubject->m_SubjectId);

	for (std::size_t i = 0; i < count; ++i)
	{
		const QMatrix4x4& rMatrix = m_SegmentMatrices[i];
		const QVector3D position = Translation(rMatrix);
		const QVector4D colour = ToColour(SegmentData(*m_pData, i).m_Colour);
		const NVX::ISelectionItem item = m_pSelectionMaker->Segment(m_pSubject->m_SubjectId, i);
		io_rRegistry.Allocate(item, m_SegmentNames[i]);
		const CoreGraphics::VSelectionId id = m_SegmentIds[i] = io_rRegistry.GetId(item);

		m_pRenderData->m_Axes.push_back(rMatrix);
		io_rRegistry.SetItemMatrix(item, rMatrix);
		if (i == 0)
			io_rRegistry.SetItemBound(subject, QVector4D(position, c_SubjectRadius));
		io_rRegistry.SetItemBound(item, QVector4D(position, m_Radii[i]));
		subjectReach =
		    std::max(subjectReach, (position - Translation(m_SegmentMatrices[0])).length() + c_SubjectRadius);

		m_pRenderData->m_BoneSpheres.push_back({QVector4D(position, m_Radii[i]), colour, id});
		if (m_pSubject->m_Segments[i].m_Joint.m_JointType != CoreOrlexTypes::VSubjectParametrised::VJoint::EDummy)
			m_pRenderData->m_Joints.push_back({QVector4D(position, c_JointRadius), colour, id});
		if (m_Origins[i])
		{
			QMatrix4x4 plate = rMatrix;
			plate.scale(c_OriginSide, c_OriginSide, c_OriginHeight);
			m_pRenderData->m_Boxes.push_back(
			    {plate, QVector4D(colour.toVector3D(), i == 0 ? 1.0f : 0.5f), i == 0 ? m_pRenderData->m_Id : id});
			m_Reach[i] = std::max(m_Reach[i], c_OriginReach);
		}
		FillBone(i);
	}
	for (std::size_t i = 0; i < count; ++i)
		io_rRegistry.SetPickBound(m_pSelectionMaker->Segment(m_pSubject->m_SubjectId, i),
		    QVector4D(Translation(m_SegmentMatrices[i]), m_Reach[i]));
	if (count > 0)
		io_rRegistry.SetPickBound(subject, QVector4D(Translation(m_SegmentMatrices[0]), subjectReach));
}

void VFlowRenderSubject::FillBone(std::size_t i_Index)
{
	const auto add = [&](std::size_t i_Owner, const QMatrix4x4& i_rMatrix, float i_Length)
	{
		m_pRenderData->m_Bones.push_back(
		    {i_rMatrix, ToColour(SegmentData(*m_pData, i_Owner).m_Colour), m_SegmentIds[i_Owner]});
		m_Reach[i_Owner] = std::max(m_Reach[i_Owner], i_Length + c_BoneReach);
	};
	if (m_SegmentMatrices.size() == 1
	    && SegmentData(*m_pData, 0).m_DrawStyle == VSubjectApplicationData::VSegment::EDrawStyleTetraStripe)
	{
		QMatrix4x4 matrix = m_SegmentMatrices[0];
		matrix.scale(c_SingleBone);
		add(0, matrix, c_SingleBone);
	}
	const std::size_t parent = m_pSubject->m_Segments[i_Index].m_ParentSegmentIndex;
	if (parent >= i_Index || !SegmentData(*m_pData, parent).m_Visible)
		return;
	const QVector3D end = Translation(m_SegmentMatrices[i_Index]);
	if (const auto matrix =
	        BoneMatrix(m_SegmentMatrices[parent], end, static_cast<float>(SegmentData(*m_pData, parent).m_DrawTwist)))
		add(parent, *matrix, (end - Translation(m_SegmentMatrices[parent])).length());
}

std::optional<OrlexGraphics::VSubjectLabel> VFlowRenderSubject::Label(bool i_bYUp) const
{
	if (!m_bPosed || m_SegmentMatrices.empty())
		return {};
	// Above the root, as high as the subject.
	QVector3D place = Translation(m_SegmentMatrices[0]);
	const int up = i_bYUp ? 1 : 2;
	for (const QMatrix4x4& rMatrix : m_SegmentMatrices)
		place[up] = std::max(place[up], Translation(rMatrix)[up]);
	return OrlexGraphics::VSubjectLabel{m_pSubject->m_Name, place, m_pSelectionMaker->Subject(m_pSubject->m_SubjectId)};
}

} // namespace Flow2Graphics
