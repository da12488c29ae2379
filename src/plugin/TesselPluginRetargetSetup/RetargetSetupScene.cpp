#include "TesselPluginRetargetSetup/RetargetSetupScene.h"

#include "DebugServices/GlobalLog.h"
#include "Flow2Graphics/FlowSubjectSceneTransform.h"
#include "Flow2TypesUtils/ParameterSet.h"
#include "OrlexGraphics/manipulator/RenderManipulator.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/Mirror.h"
#include "RetargetSetupCore/RetargetSetupCore.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupCore/StepNames.h"
#include "RetargetSetupDocument/ShownText.h"
#include "RetargetSetupDocument/StaleSelection.h"
#include "SetupProposal/Side.h"
#include "TesselPluginInterface/ISelectionManager.h"
#include "TesselPluginRetargetSetup/ManipulatorMove.h"
#include "TesselPluginRetargetSetup/SideSeen.h"

#include <utility>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using NVX::ISelectionItem;

namespace
{

/// Among the pose indices of VFlowSubjectSceneTransform.
constexpr std::uint32_t c_BindPose = 6;

/// Masks of the manipulator. The root moves and turns, all others only turn.
constexpr std::uint32_t c_AllHandles = 255;
constexpr std::uint32_t c_Rings = 4;

ISelectionItem TargetSegment(std::size_t i_Index)
{
	return {NVX::ESelectionTargetSegment, RetargetSetup::c_SubjectId, std::uint32_t(i_Index), {}};
}

} // namespace

VRetargetSetupScene::VRetargetSetupScene(std::shared_ptr<CoreGraphics::VShaderLibrary> i_pGraphicsContext,
    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager,
    std::shared_ptr<OrlexGraphics::VSkinCache> i_pSkinCache, std::shared_ptr<VRetargetSetupCore> i_pRetargetSetup,
    NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory, bool i_bAllowHiddenPick)
    : VFlowScene(std::move(i_pGraphicsContext), std::move(i_pSelectionManager), std::move(i_pSkinCache),
        std::move(i_pDispatcher), i_bAllowHiddenPick),
      m_pRetargetSetup(std::move(i_pRetargetSetup)), m_pItemFactory(std::move(i_pItemFactory))
{
}

VRetargetSetupScene::~VRetargetSetupScene()
{
	m_PreviewConnection.Disconnect();
}

void VRetargetSetupScene::SetPreviewFrames(std::shared_ptr<TesselPluginInterface::IPreviewFrames> i_pPreviewFrames)
{
	m_PreviewConnection.Disconnect();
	m_pPreviewFrames = std::move(i_pPreviewFrames);
	if (m_pPreviewFrames)
		m_PreviewConnection =
		    m_pPreviewFrames->ShownChangedSignal().Connect(WeakBind(&VRetargetSetupScene::RefreshScene), Dispatcher());
}

QVariantMap VRetargetSetupScene::ViewOptions()
{
	return {
	    {"LabellingSubject-Enabled", true},
	    {"LabellingSubject-Markers", false},
	    {"LabellingSubject-Sticks", false},
	    {"LabellingSubject-Targets", false},
	    {"LabellingSubject-SkinXRay", true},
	    {"SolvingSubject-Markers", false},
	    {"SolvingSubject-Sticks", false},
	    {"SolvingSubject-MissingMarkers", false},
	    {"SolvingSubject-SkinXRay", true},
	    {"SolvingSubject-Targets", true},
	};
}

std::vector<ISelectionItem> VRetargetSetupScene::ItemsToFrame() const
{
	std::vector<ISelectionItem> items;
	const auto add = [&](const VRetargetSetupCore::VSubjectValues& i_rValues, std::uint32_t i_Kind)
	{
		if (i_rValues.m_pParametrised)
			for (std::uint32_t i = 0; i < i_rValues.m_pParametrised->m_Segments.size(); ++i)
				items.push_back({i_Kind, i_rValues.m_pParametrised->m_SubjectId, i, {}});
	};
	add(m_pRetargetSetup->SourceValues(), NVX::ESelectionSourceSegment);
	add(m_pRetargetSetup->TargetValues(), NVX::ESelectionTargetSegment);
	return items;
}

QString VRetargetSetupScene::SideSeen(int i_CameraType) const
{
	const auto pSubject = m_pRetargetSetup->TargetValues().m_pParametrised;
	if (!pSubject)
		return {};
	// Sums, and counts behind them.
	QVector4D left, right;
	for (std::size_t i = 0; i < pSubject->m_Segments.size(); ++i)
	{
		const SetupProposal::ESide side = SetupProposal::SideOfName(pSubject->m_Segments[i].m_Name);
		QMatrix4x4 matrix;
		if (side != SetupProposal::ESide::None && GetItemTransform({TargetSegment(i)}, matrix))
			(side == SetupProposal::ESide::Left ? left : right) += matrix.column(3);
	}
	if (left.w() == 0.0f || right.w() == 0.0f)
		return {};
	return QString::fromUtf8(RetargetSetup::SideSeen(
	    left.toVector3DAffine() - right.toVector3DAffine(), YUp(), static_cast<std::uint32_t>(i_CameraType)));
}

void VRetargetSetupScene::RememberPointedAt()
{
	m_Pointed = {};
	for (const ISelectionItem& rItem : SelectionManager()->PreSelection().Items())
		if (RetargetSetup::IsOfDocument(rItem))
			m_Pointed = rItem;
}

QVariantList VRetargetSetupScene::PointedAt() const
{
	const auto pData = m_pRetargetSetup->TargetValues().m_pApplicationData;
	QVariantList things;
	for (const ISelectionItem& rItem : SelectionManager()->PreSelection().Items())
		if (RetargetSetup::IsOfDocument(rItem))
			things << QVariantMap{{"kind", rItem.m_Kind}, {"index", rItem.m_ElementIndex},
			    {"subject",
			        RetargetSetup::ShownText(rItem.m_Kind == NVX::ESelectionSourceSegment
			                ? m_pRetargetSetup->GetShownSourceName()
			                : pData ? pData->m_Skin
			                        : "")}};
	return things;
}

unsigned int VRetargetSetupScene::SelectPointedAt()
{
	const ISelectionItem item = std::exchange(m_Pointed, {});
	if (item.m_Kind == 0)
		return 0;
	TesselPluginInterface::ISelection& rSelection = SelectionManager()->Selection();
	rSelection.Remove(rSelection.ItemsOfKind(item.m_Kind));
	rSelection.Add({item});
	return item.m_Kind;
}

int VRetargetSetupScene::PartnerOf(bool i_bSource, int i_SegmentIndex) const
{
	return m_pRetargetSetup->PartnerOf(
	    i_bSource ? m_pRetargetSetup->SourceValues() : m_pRetargetSetup->TargetValues(), std::size_t(i_SegmentIndex));
}

void VRetargetSetupScene::OnShared()
{
	auto pPose = std::make_unique<Flow2Utils::VParameterTyped<std::uint32_t>>("PoseIndex");
	pPose->Set(c_BindPose);
	const auto pParameters = std::make_shared<Flow2Utils::VParameterSet>();
	pParameters->Add(std::move(pPose));
	m_pSubjectTransform = std::make_shared<Flow2Graphics::VFlowSubjectSceneTransform>(m_pItemFactory);
	// Source and target stand in one world: what the eye sees is what offsets are measured from.
	m_pSubjectTransform->SetMode(0);
	m_pSubjectTransform->SetParameters(pParameters);

	const auto onSelectionChanged = WeakBind(&VRetargetSetupScene::OnSelectionChanged);
	SelectionManager()->Selection().ChangedSignal().Connect(onSelectionChanged, Dispatcher());
	SelectionManager()->PreSelection().ChangedSignal().Connect(onSelectionChanged, Dispatcher());
	SkinCache()->ChangedSignal().Connect(WeakBind(&VRetargetSetupScene::RefreshScene), Dispatcher());
	m_pRetargetSetup->GetChangedSignal().Connect(WeakBind(&VRetargetSetupScene::OnSetupChanged), Dispatcher());
	m_pRetargetSetup->GetLeavingSignal().Connect(WeakBind(&VRetargetSetupScene::EndDrag));
	PublishedSignal().Connect(WeakBind(&VRetargetSetupScene::UpdateManipulator), Dispatcher());
	PublishedSignal().Connect(WeakBind(&VRetargetSetupScene::framePublished), Dispatcher());
}

void VRetargetSetupScene::OnSetupChanged()
{
	const std::uint64_t subject = m_pRetargetSetup->TargetSubjectIdentity();
	const std::string& rSource = m_pRetargetSetup->GetShownSourceName();
	// What was selected of one character is nothing of the next.
	RetargetSetup::DropStaleItems(*m_pRetargetSetup, *SelectionManager(),
	    {std::exchange(m_SelectedSource, rSource) != rSource, std::exchange(m_SelectedSubject, subject) != subject});
	RefreshScene();
}

void VRetargetSetupScene::RefreshScene()
{
	const auto pFrame = m_pRetargetSetup->GetCurrentFrame();
	if (const auto pHosts = HostsFrame(pFrame))
		SetFrame(pHosts);
	else if (pFrame)
	{
		NVX::CountedPointer<TesselPluginInterface::IFlowFrame> pPosed;
		m_pSubjectTransform->Transform(pPosed, pFrame, 0);
		if (m_bHostShows)
		{
			// The host's subjects go.
			SetWholeFrame(pPosed);
			m_pAwaited = pPosed;
		}
		else
			SetFrame(pPosed);
	}
	const auto appears = [](const VRetargetSetupCore::VSubjectValues& i_rValues, bool& io_rbShown)
	{
		const bool bShown = i_rValues.m_pParametrised && !i_rValues.m_pParametrised->m_Segments.empty();
		return !std::exchange(io_rbShown, bShown) && bShown;
	};
	const bool bSource = appears(m_pRetargetSetup->SourceValues(), m_bShowsSource);
	const bool bTarget = appears(m_pRetargetSetup->TargetValues(), m_bShowsTarget);
	if (bSource || bTarget)
		emit subjectAppeared();
}

NVX::CountedPointer<TesselPluginInterface::IFlowFrame> VRetargetSetupScene::HostsFrame(
    const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& i_rpDocument)
{
	auto pHosts = m_pPreviewFrames ? m_pPreviewFrames->Shown(i_rpDocument) : nullptr;
	// The drag goes on from the bind pose that it began in.
	if (RenderManipulator() && RenderManipulator()->IsDragging())
		pHosts.reset();
	SetPickingRests(bool(pHosts));
	if (!pHosts)
		return pHosts;
	m_pAwaited.reset();
	if (!std::exchange(m_bHostShows, true))
	{
		SelectionManager()->PreSelection().Replace({});
		UpdateManipulator();
	}
	return pHosts;
}

bool VRetargetSetupScene::ShowsBindPoses()
{
	if (m_bHostShows && m_pAwaited && PublishedFrame() == m_pAwaited)
	{
		m_bHostShows = false;
		m_pAwaited.reset();
	}
	return !m_bHostShows;
}

std::int64_t VRetargetSetupScene::GetSelectedTargetSegment(std::vector<ISelectionItem>& o_rSelection) const
{
	for (const ISelectionItem& rItem : SelectionManager()->Selection().ItemsOfKind(NVX::ESelectionTargetSegment))
	{
		if (rItem.m_SubjectId == RetargetSetup::c_SubjectId)
			return rItem.m_ElementIndex;
		o_rSelection.push_back(rItem);
	}
	return -1;
}

void VRetargetSetupScene::InitialiseGL()
{
	// Manipulator and connections live on when another view begins to show the scene.
	if (m_bConnected)
		return;
	m_bConnected = true;
	VFlowScene::InitialiseGL();
	if (RenderManipulator())
	{
		RenderManipulator()->BeginSignal().Connect(WeakBind(&VRetargetSetupScene::OnManipulatorPressed));
		RenderManipulator()->ChangedSignal().Connect(WeakBind(&VRetargetSetupScene::OnManipulatorMoved));
		RenderManipulator()->CancelSignal().Connect(WeakBind(&VRetargetSetupScene::OnManipulatorCancelled));
		RenderManipulator()->EndSignal().Connect(WeakBind(&VRetargetSetupScene::OnManipulatorReleased));
	}
	Dispatcher()->Post(
	    [pWeak = weak_from_this()]
	    {
		    if (const auto pScene = pWeak.lock())
			    static_cast<VRetargetSetupScene&>(*pScene).RefreshScene();
	    });
}

void VRetargetSetupScene::OnSelectionChanged()
{
	if (!Manipulator())
		return;
	UpdateManipulator();
	RefreshScene();
}

void VRetargetSetupScene::UpdateManipulator()
{
	if (!RenderManipulator() || RenderManipulator()->IsDragging())
		return;
	std::vector<ISelectionItem> others;
	std::int64_t segment = GetSelectedTargetSegment(others);
	const auto pSubject = m_pRetargetSetup->TargetValues().m_pParametrised;
	QMatrix4x4 matrix;
	// A segment that is not drawn yet has no matrix; it gets one with the frame that draws it.
	if (!ShowsBindPoses() || segment < 0 || !pSubject || std::size_t(segment) >= pSubject->m_Segments.size()
	    || pSubject->m_Segments[std::size_t(segment)].m_Joint.m_JointType == VSubjectParametrised::VJoint::EDummy
	    || !GetItemTransform({TargetSegment(std::size_t(segment))}, matrix))
		segment = -1;
	const bool bSame =
	    segment == m_ManipulatedSegment && (segment == -1 || matrix == RenderManipulator()->GivenTransform());
	m_ManipulatedSegment = segment;
	if (segment != -1)
	{
		RenderManipulator()->SetTransform(matrix);
		RenderManipulator()->SetModeMask(segment == 0 ? c_AllHandles : c_Rings);
	}
	RenderManipulator()->SetVisible(segment != -1);
	if (!bSame)
		emit RefreshRequested();
}

void VRetargetSetupScene::OnManipulatorPressed()
{
	const auto pSubject = m_pRetargetSetup->TargetValues().m_pParametrised;
	m_pPressed = pSubject;
	++m_Drag;
	m_PressedSubject = m_pRetargetSetup->TargetSubjectIdentity();
	if (!pSubject || std::size_t(m_ManipulatedSegment) >= pSubject->m_Segments.size())
		return;
	const VSubjectParametrised::VSegment& rSegment = pSubject->m_Segments[std::size_t(m_ManipulatedSegment)];
	using VJoint = VSubjectParametrised::VJoint;
	constexpr std::array<double, 3> c_None{};
	const bool bTurnsFreely =
	    rSegment.m_Joint.m_JointType == VJoint::EBall || rSegment.m_Joint.m_JointType == VJoint::EFree;
	if (!bTurnsFreely || rSegment.m_Joint.m_JointOrientation != c_None || rSegment.m_InversePostRotation != c_None
	    || rSegment.m_InversePostTranslation != c_None)
		NVX_LOG("RetargetSetup", NVX::ELogWarning,
		    "The segment '%1%' does not follow the manipulator exactly: its joint is not a plain ball joint",
		    rSegment.m_Name);
}

void VRetargetSetupScene::OnManipulatorCancelled()
{
	const auto pSubject = m_pRetargetSetup->TargetValues().m_pParametrised;
	const auto pPressed = std::exchange(m_pPressed, nullptr);
	if (!pSubject || !pPressed || m_PressedSubject != m_pRetargetSetup->TargetSubjectIdentity()
	    || pSubject->m_Segments.size() != pPressed->m_Segments.size())
		return;
	// What else was edited since stays.
	VSubjectParametrised subject = *pSubject;
	for (std::size_t i = 0; i < subject.m_Segments.size(); ++i)
	{
		const VSubjectParametrised::VJoint& rPressed = pPressed->m_Segments[i].m_Joint;
		VSubjectParametrised::VJoint& rJoint = subject.m_Segments[i].m_Joint;
		if (rJoint.m_JointType != rPressed.m_JointType)
			continue;
		rJoint.m_BindPose = rPressed.m_BindPose;
		rJoint.m_Mean = rPressed.m_Mean;
	}
	m_pRetargetSetup->SetTargetSubjectParametrised(std::move(subject), {RetargetSetup::Steps::c_Pose, m_Drag});
	RefreshScene();
}

void VRetargetSetupScene::OnManipulatorReleased()
{
	m_pRetargetSetup->EndStep();
}

void VRetargetSetupScene::EndDrag()
{
	if (RenderManipulator())
		RenderManipulator()->Release();
}

void VRetargetSetupScene::ComputeJointFrame(
    QMatrix4x4& o_rMatrix, const VSubject& i_rSubject, std::size_t i_SegmentIndex) const
{
	const VSubject::VSegment& rSegment = i_rSubject.m_Segments[i_SegmentIndex];
	QMatrix4x4 parent;
	if (rSegment.m_ParentSegmentIndex != CoreOrlexTypes::c_NoParent)
		GetItemTransform({TargetSegment(rSegment.m_ParentSegmentIndex)}, parent);
	o_rMatrix = RetargetSetup::JointFrame(parent, rSegment);
}

RetargetSetup::VMirror VRetargetSetupScene::MirrorOf(std::size_t i_SegmentIndex)
{
	if (!m_pRetargetSetup->JointSymmetry())
		return {};
	const VRetargetSetupCore::VSubjectValues& rAtRest = m_pRetargetSetup->TargetAtRest();
	const TesselPluginInterface::VHostRules rules = m_pRetargetSetup->HostRules();
	const bool bSameCharacter = m_MirrorRule && m_MirrorRule->m_pAtRest == rAtRest.m_pParametrised;
	if (bSameCharacter && m_MirrorRule->m_SegmentIndex == i_SegmentIndex
	    && m_MirrorRule->m_bPartnersBySides == rules.m_bPartnersBySides
	    && m_MirrorRule->m_bMirrorChange == rules.m_bMirrorChange)
		return m_MirrorRule->m_Mirror;
	bool bTold = bSameCharacter && m_MirrorRule->m_bTold;
	RetargetSetup::VMirror mirror{m_pRetargetSetup->PartnerOf(rAtRest, i_SegmentIndex)};
	if (rules.m_bMirrorChange && mirror.m_SegmentIndex != -1)
	{
		const auto partner = std::size_t(mirror.m_SegmentIndex);
		mirror.m_bMirrorsChange =
		    !RetargetSetup::AreMirrorImages(*rAtRest.m_pParametrised, *rAtRest.m_pSubject, i_SegmentIndex, partner);
		if (mirror.m_bMirrorsChange && !std::exchange(bTold, true))
			NVX_LOG("RetargetSetup", NVX::ELogInformation,
			    "The joints of '%1%' and '%2%' are no mirror images of each other at rest: joint symmetry mirrors what "
			    "changes in a pose, not the whole pose",
			    rAtRest.m_pParametrised->m_Segments[i_SegmentIndex].m_Name,
			    rAtRest.m_pParametrised->m_Segments[partner].m_Name);
	}
	m_MirrorRule.emplace(VMirrorRule{
	    rAtRest.m_pParametrised, i_SegmentIndex, rules.m_bPartnersBySides, rules.m_bMirrorChange, mirror, bTold});
	return mirror;
}

void VRetargetSetupScene::OnManipulatorMoved(const QMatrix4x4& i_rMatrix)
{
	const VRetargetSetupCore::VSubjectValues target = m_pRetargetSetup->TargetValues();
	if (!target.m_pSubject || !target.m_pParametrised)
		return;
	VSubjectParametrised subject = *target.m_pParametrised;
	std::vector<ISelectionItem> others;
	// No segment, -1, is beyond all segments.
	const auto segment = std::size_t(GetSelectedTargetSegment(others));
	QMatrix4x4 parent;
	if (segment < target.m_pSubject->m_Segments.size())
		if (const std::uint32_t index = target.m_pSubject->m_Segments[segment].m_ParentSegmentIndex;
		    index != CoreOrlexTypes::c_NoParent && !GetItemTransform({TargetSegment(index)}, parent))
			return;
	const QMatrix4x4 origin = RenderManipulator() ? RenderManipulator()->GivenTransform() : i_rMatrix;
	RetargetSetup::MoveSegment(subject, segment, i_rMatrix, origin, MirrorOf(segment),
	    [&](std::size_t i_SegmentIndex)
	    {
		    QMatrix4x4 frame;
		    ComputeJointFrame(frame, *target.m_pSubject, i_SegmentIndex);
		    return frame;
	    });
	m_pRetargetSetup->SetTargetSubjectParametrised(std::move(subject), {RetargetSetup::Steps::c_Pose, m_Drag});
	RefreshScene();
}

#include "moc_RetargetSetupScene.cpp"
