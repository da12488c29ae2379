#pragma once

#include "NVX/ISelectionItem.h"
#include "NVX/Signal.h"
#include "OrlexGraphics/frame/SceneOptions.h"
#include "OrlexGraphics/item/Tracking.h"

#include <QList>
#include <QPointer>
#include <QQmlPropertyMap>
#include <QQuickFramebufferObject>

#include <cstdint>
#include <memory>

namespace CoreGraphics
{
class VCameraController;
}

namespace OrlexGraphics
{

class IManipulator;
class VCameraGrid;
class VCameraObject;
class VOrlexScene;
class VSamples;
class VSubjectObject;
struct VPick;
struct VPickRequest;

/// What the mouse is about in a view.
enum EMouseState : std::uint32_t
{
	EMouseIdle,
	/// A preselection is wanted.
	EMouseHovering,
	/// Of a selection rectangle.
	EMouseDragging,
	/// A click is to be committed.
	EMouseClicked,
	/// A rectangle is to be committed.
	EMouseDragged
};

/// What is to be framed with the next exchange.
enum class EFit : std::uint32_t
{
	None,
	/// All, if nothing is selected.
	Selection,
	All
};

/// The preview: shows a scene in a Qt Quick window, moves its camera, and finds what the mouse points at. All of it
/// runs on the user interface thread, but for the functions that are named as the renderer's: those are called while
/// that thread waits.
class VSceneFramebufferObject : public QQuickFramebufferObject
{
	Q_OBJECT
	Q_PROPERTY(QObject* scene READ GetScene WRITE SetScene)
	Q_PROPERTY(QObject* cameraGrid READ GetCameraGrid WRITE SetCameraGrid)
	/// The members of VSceneOptions by key, see SceneOptionsMap.h. QML reads and writes them.
	Q_PROPERTY(QQmlPropertyMap* sceneOptions READ GetSceneOptions NOTIFY SceneOptionsChanged)
	Q_PROPERTY(QString previewCamera READ GetPreviewCamera WRITE SetPreviewCamera NOTIFY PreviewCameraChanged)
	/// 0 perspective, then seen from the front, back, left, right, top and bottom without perspective.
	Q_PROPERTY(int cameraType READ GetCameraType WRITE SetCameraType)
	Q_PROPERTY(QString toolTipText READ GetToolTipText WRITE SetToolTipText NOTIFY ToolTipTextChanged)
	/// Item pixels.
	Q_PROPERTY(QPoint mousePos READ GetMousePos WRITE SetMousePos NOTIFY MouseMoved)
	Q_PROPERTY(
	    bool showCameraNumbers READ GetShowCameraNumbers WRITE SetShowCameraNumbers NOTIFY ShowCameraNumbersChanged)
	Q_PROPERTY(QList<QObject*> cameraObjects READ GetCameraObjects NOTIFY CamerasChanged)
	Q_PROPERTY(QList<QObject*> subjectObjects READ GetSubjectObjects WRITE SetSubjectObjects NOTIFY SubjectsChanged)
	/// Setting it to true frames the selection, or all that the scene names for it where nothing is selected.
	Q_PROPERTY(bool focusSelection READ GetFocusSelection WRITE SetFocusSelection)
	Q_PROPERTY(OrlexGraphics::ETracking tracking READ GetTracking WRITE SetTracking NOTIFY TrackSelectionChanged)

public:
	explicit VSceneFramebufferObject(QQuickItem* i_pParent = nullptr);
	~VSceneFramebufferObject() override;

	QObject* GetScene() const;
	/// A VOrlexScene that a shared pointer owns; anything else leaves the view without a scene.
	void SetScene(QObject* i_pScene);
	QObject* GetCameraGrid() const;
	void SetCameraGrid(QObject* i_pCameraGrid);
	QQmlPropertyMap* GetSceneOptions() const { return m_pOptionsMap; }
	const QString& GetPreviewCamera() const { return m_PreviewCamera; }
	void SetPreviewCamera(const QString& i_rPreviewCamera);
	int GetCameraType() const;
	void SetCameraType(int i_CameraType);
	const QString& GetToolTipText() const { return m_ToolTipText; }
	void SetToolTipText(const QString& i_rToolTipText);
	const QPoint& GetMousePos() const { return m_MousePos; }
	void SetMousePos(const QPoint& i_rMousePos);
	bool GetShowCameraNumbers() const { return m_bShowCameraNumbers; }
	void SetShowCameraNumbers(bool i_bShowCameraNumbers);
	const QList<QObject*>& GetCameraObjects() const { return m_CameraObjects; }
	const QList<QObject*>& GetSubjectObjects() const { return m_SubjectObjects; }
	void SetSubjectObjects(const QList<QObject*>& i_rSubjectObjects);
	bool GetFocusSelection() const { return false; }
	void SetFocusSelection(bool i_bFocusSelection);
	ETracking GetTracking() const { return m_Tracking; }
	void SetTracking(ETracking i_Tracking);

	const VSceneOptions& Options() const { return m_Options; }
	EMouseState MouseState() const { return m_MouseState; }
	CoreGraphics::VCameraController& Camera() const { return *m_pCamera; }

	/// The wheel goes nearer and farther in the fixed views, too.
	void SetWheelInFixedViews(bool i_bWheel) { m_bWheelInFixedViews = i_bWheel; }

	/// Frames all that the scene names for it, in the free view and in the fixed ones.
	Q_INVOKABLE void FrameAll();

	/// Makes the manipulator larger or smaller, within its limits, and tells the option map.
	Q_INVOKABLE void ScaleManipulator(double i_Factor);

	Renderer* createRenderer() const override;

signals:
	void SceneOptionsChanged();
	void PreviewCameraChanged();
	void ToolTipTextChanged();
	void MouseMoved();
	void CamerasChanged();
	void SubjectsChanged();
	void ShowCameraNumbersChanged();
	void TrackSelectionChanged();

public slots:
	void OnFocusChanged();
	void OnSceneOptionsMapChanged(const QString& i_rKey, const QVariant& i_rValue);

protected:
	QSGNode* updatePaintNode(QSGNode* io_pNode, UpdatePaintNodeData* io_pData) override;
	void mousePressEvent(QMouseEvent* io_pEvent) override;
	void mouseMoveEvent(QMouseEvent* io_pEvent) override;
	void mouseReleaseEvent(QMouseEvent* io_pEvent) override;
	void mouseDoubleClickEvent(QMouseEvent* io_pEvent) override;
	void mouseUngrabEvent() override;
	void wheelEvent(QWheelEvent* io_pEvent) override;
	void keyPressEvent(QKeyEvent* io_pEvent) override;
	void keyReleaseEvent(QKeyEvent* io_pEvent) override;
	void hoverEnterEvent(QHoverEvent* io_pEvent) override;
	void hoverMoveEvent(QHoverEvent* io_pEvent) override;
	void hoverLeaveEvent(QHoverEvent* io_pEvent) override;

private:
	friend class VSceneFramebufferRenderer;

	/// Places the labels of cameras and subjects over the view.
	void OnFrameChanged();
	void SetModifiers(Qt::KeyboardModifiers i_Modifiers);
	/// Ends a drag of a manipulator, or a rectangle, as if it had not begun. False if there is none.
	bool CancelDrag();
	/// Nothing is pointed at.
	void ClearPreview();
	/// The manipulator that a condition holds for, null if there is none.
	IManipulator* FindManipulator(bool (IManipulator::*i_pCondition)() const) const;
	bool IsCameraView() const;

	// For the renderer.

	/// What the mouse wants to be picked, with the camera as it is now.
	VPickRequest MakePickRequest(std::uint64_t i_Frame) const;
	/// Shows or commits what was picked, if it is still what is wanted. What others are told is posted.
	void CommitPick(const VPick& i_rPick, const VPickRequest& i_rWanted);
	void PreviewPick(const VPick& i_rPick);

	QPointer<VOrlexScene> m_pScene;
	QPointer<VCameraGrid> m_pCameraGrid;
	VSceneOptions m_Options;
	QQmlPropertyMap* const m_pOptionsMap;
	const std::shared_ptr<CoreGraphics::VCameraController> m_pCamera;
	QPoint m_MousePos;
	/// Where the preselection was picked.
	QPoint m_PreviewPos;
	EMouseState m_MouseState = EMouseIdle;
	/// CoreGraphics::EModifierState.
	std::uint32_t m_ModifierState = 0;
	/// Where the left button went down.
	QPoint m_PressPos;
	/// Of the click or rectangle that is to be committed.
	QPoint m_ReleasePos;
	std::uint32_t m_ReleaseModifierState = 0;
	/// A press that has not moved anything yet: its release is a click.
	bool m_bPressPending = false;
	bool m_bShowCameraNumbers = false;
	QString m_PreviewCamera;
	QString m_ToolTipText;
	bool m_bContinuousUpdate = true;
	QList<QObject*> m_CameraObjects;
	QList<QObject*> m_SubjectObjects;
	ETracking m_Tracking = ETrackingNone;
	bool m_bTrackSelectionPending = false;
	EFit m_Fit = EFit::None;
	bool m_bWheelInFixedViews = false;
	/// What the renderer draws into, if that can be read; the renderer and the node own it, as they end in its context.
	std::weak_ptr<const VSamples> m_pSamples;
	NVX::VConnection m_FrameConnection;
	NVX::VConnection m_PublishedConnection;
};

} // namespace OrlexGraphics
