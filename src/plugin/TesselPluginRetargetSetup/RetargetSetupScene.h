#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "Flow2Graphics/FlowScene.h"
#include "NVX/Shared.h"
#include "TesselPluginInterface/IItemFactory.h"
#include "TesselPluginInterface/IPreviewFrames.h"
#include "TesselPluginRetargetSetup/ManipulatorMove.h"

#include <QMatrix4x4>
#include <QVariantMap>

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

class VRetargetSetupCore;

namespace Flow2Graphics
{
class VFlowSubjectSceneTransform;
}

/// The preview of the panel: both subjects of the document in their bind poses, and the manipulator that poses the
/// target subject. Made by NVX::MakeShared; follows document, skins and selection from then on. User interface thread
/// only, but for what VFlowScene names as the render thread's.
class VRetargetSetupScene : public Flow2Graphics::VFlowScene, public NVX::VShared
{
	Q_OBJECT
	/// What a view of it begins with, by the keys of the scene's options.
	Q_PROPERTY(QVariantMap viewOptions READ ViewOptions CONSTANT)
	/// Kinds of selection items.
	Q_PROPERTY(unsigned int sourceSegmentKind READ SourceSegmentKind CONSTANT)
	Q_PROPERTY(unsigned int targetKind READ TargetKind CONSTANT)

public:
	VRetargetSetupScene(std::shared_ptr<CoreGraphics::VShaderLibrary> i_pGraphicsContext,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
	    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager,
	    std::shared_ptr<OrlexGraphics::VSkinCache> i_pSkinCache, std::shared_ptr<VRetargetSetupCore> i_pRetargetSetup,
	    NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory, bool i_bAllowHiddenPick);
	~VRetargetSetupScene() override;

	/// What the host shows instead of bind poses; null for a host that shows nothing else.
	void SetPreviewFrames(std::shared_ptr<TesselPluginInterface::IPreviewFrames> i_pPreviewFrames);

	static QVariantMap ViewOptions();
	static unsigned int SourceSegmentKind() { return NVX::ESelectionSourceSegment; }
	static unsigned int TargetKind() { return NVX::ESelectionTarget; }

	/// All segments of both subjects.
	std::vector<NVX::ISelectionItem> ItemsToFrame() const override;

	/// Which side of the target subject a fixed view shows: "front", "back", "left side" or "right side". Empty for the
	/// other views, and where the names of the segments do not tell the sides.
	/// @param i_CameraType CoreGraphics::ECameraType
	Q_INVOKABLE QString SideSeen(int i_CameraType) const;

	/// Shows what the document has now, or what the host has instead. While the manipulator is dragged it is the
	/// former.
	void RefreshScene();

	/// Connects the manipulator, once.
	void InitialiseGL() override;

	void OnSelectionChanged();

	/// Poses the selected target segment, and with joint symmetry the one on the other side.
	/// @param i_rMatrix the new world matrix of the manipulator.
	void OnManipulatorMoved(const QMatrix4x4& i_rMatrix);

	/// The first selected segment of the target subject, -1 if there is none.
	/// @param o_rSelection the selected items before it that are none.
	std::int64_t GetSelectedTargetSegment(std::vector<NVX::ISelectionItem>& o_rSelection) const;

	/// The frame in the world in which a segment's joint turns. The segment must be there.
	void ComputeJointFrame(
	    QMatrix4x4& o_rMatrix, const CoreOrlexTypes::VSubject& i_rSubject, std::size_t i_SegmentIndex) const;

	/// What the mouse points at now is what SelectPointedAt selects.
	Q_INVOKABLE void RememberPointedAt();
	/// Makes it the only one of its kind in the selection.
	/// @return its kind, 0 if the mouse pointed at no segment or target.
	Q_INVOKABLE unsigned int SelectPointedAt();
	/// What the mouse points at: for each segment and target {kind, index, subject}, the name of the performer or of
	/// the character.
	Q_INVOKABLE QVariantList PointedAt() const;
	/// The segment of the same subject on the other side, -1 if there is none.
	Q_INVOKABLE int PartnerOf(bool i_bSource, int i_SegmentIndex) const;

signals:
	/// Performer or character is shown, and there was none before. Where it stands is known with the next frame.
	void subjectAppeared();
	/// Where the segments stand in the last frame can be read.
	void framePublished();

protected:
	void OnShared() override;

private:
	void OnSetupChanged();
	/// The frame that the host has instead of this one; null if it is to be shown as it is.
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> HostsFrame(
	    const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& i_rpDocument);
	/// Whether places in the preview are those of the bind poses.
	bool ShowsBindPoses();
	/// Shows the manipulator where the selected target segment stands in the last frame, or hides it. Not while it is
	/// dragged.
	void UpdateManipulator();
	/// Keeps the pose, and tells of joints that cannot take the manipulator's as it is.
	void OnManipulatorPressed();
	/// The pose is what it was at the press.
	void OnManipulatorCancelled();
	void OnManipulatorReleased();
	/// As if the mouse had let go.
	void EndDrag();
	/// With joint symmetry, what moves with a segment; it takes over the change of a pose rather than the pose where
	/// the host's rules want it and the two are no mirror images of each other at rest, which is told once for a
	/// character.
	RetargetSetup::VMirror MirrorOf(std::size_t i_SegmentIndex);

	/// The answer of MirrorOf for one segment of one character, which a drag asks for again and again.
	struct VMirrorRule
	{
		std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pAtRest;
		std::size_t m_SegmentIndex = 0;
		bool m_bPartnersBySides = false;
		bool m_bMirrorChange = false;
		RetargetSetup::VMirror m_Mirror;
		bool m_bTold = false;
	};

	const std::shared_ptr<VRetargetSetupCore> m_pRetargetSetup;
	const NVX::CountedPointer<TesselPluginInterface::IItemFactory> m_pItemFactory;
	/// Makes what is shown of the document's frames.
	std::shared_ptr<Flow2Graphics::VFlowSubjectSceneTransform> m_pSubjectTransform;
	std::shared_ptr<TesselPluginInterface::IPreviewFrames> m_pPreviewFrames;
	NVX::VConnection m_PreviewConnection;
	/// The host shows something else, or what is seen is still of that time.
	bool m_bHostShows = false;
	/// The first frame of bind poses since; null while the host shows something else.
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> m_pAwaited;
	/// What the selection is of.
	std::string m_SelectedSource;
	std::uint64_t m_SelectedSubject = 0;
	NVX::ISelectionItem m_Pointed;
	bool m_bShowsSource = false;
	bool m_bShowsTarget = false;
	bool m_bConnected = false;
	/// At the last press, and the number of its subject.
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pPressed;
	std::uint64_t m_PressedSubject = 0;
	/// The drags so far, by which the edits of one are told from those of the next.
	std::uint64_t m_Drag = 0;
	/// -1 while the manipulator is hidden.
	std::int64_t m_ManipulatedSegment = -1;
	std::optional<VMirrorRule> m_MirrorRule;
};
