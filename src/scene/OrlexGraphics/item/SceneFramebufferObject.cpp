#include "OrlexGraphics/item/SceneFramebufferObject.h"

#include "CoreGraphics/CameraController.h"
#include "DebugServices/Assert.h"
#include "OrlexGraphics/frame/OrlexScene.h"
#include "OrlexGraphics/item/CameraGrid.h"
#include "OrlexGraphics/item/NoOpenGLNode.h"
#include "OrlexGraphics/item/Samples.h"
#include "OrlexGraphics/item/SceneFramebufferRenderer.h"
#include "OrlexGraphics/item/SceneOptionsMap.h"
#include "OrlexGraphics/manipulator/IManipulator.h"
#include "OrlexGraphics/overlays/OverlayObjects.h"
#include "OrlexGraphics/overlays/OverlayPlacement.h"

#include <QSGNode>

#include <algorithm>
#include <cmath>

namespace OrlexGraphics
{

VSceneFramebufferObject::VSceneFramebufferObject(QQuickItem* i_pParent)
    : QQuickFramebufferObject(i_pParent), m_pOptionsMap(new QQmlPropertyMap(this)),
      m_pCamera(std::make_shared<CoreGraphics::VCameraController>())
{
	setAcceptedMouseButtons(Qt::AllButtons);
	setAcceptHoverEvents(true);
	setMirrorVertically(true);
	WriteOptionsToMap(m_Options, *m_pOptionsMap);
	connect(m_pOptionsMap, &QQmlPropertyMap::valueChanged, this, &VSceneFramebufferObject::OnSceneOptionsMapChanged,
	    Qt::QueuedConnection);
	connect(this, &QQuickItem::focusChanged, this, &VSceneFramebufferObject::OnFocusChanged);
}

VSceneFramebufferObject::~VSceneFramebufferObject()
{
	m_FrameConnection.Disconnect();
	m_PublishedConnection.Disconnect();
}

QObject* VSceneFramebufferObject::GetScene() const
{
	return m_pScene;
}

void VSceneFramebufferObject::SetScene(QObject* i_pScene)
{
	auto* const pScene = qobject_cast<VOrlexScene*>(i_pScene);
	NVX_ASSERT(!pScene || !pScene->weak_from_this().expired());
	if (m_pScene)
		disconnect(m_pScene, nullptr, this, nullptr);
	m_FrameConnection.Disconnect();
	m_PublishedConnection.Disconnect();
	m_pScene = pScene;
	if (pScene)
	{
		m_Options.m_bYUp = pScene->YUp();
		connect(pScene, &VOrlexScene::RefreshRequested, this, &QQuickItem::update);
		const auto guarded = [pItem = QPointer<VSceneFramebufferObject>(this)](auto i_Call)
		{
			return [pItem, i_Call]
			{
				if (!pItem)
					throw NVX::VDeregisterWeakCallbackException();
				i_Call(*pItem);
			};
		};
		// What the frame brought can be read after one more exchange.
		m_FrameConnection = pScene->FrameChangedSignal().Connect(
		    guarded([](VSceneFramebufferObject& i_rItem) { i_rItem.update(); }), pScene->Dispatcher());
		m_PublishedConnection = pScene->PublishedSignal().Connect(
		    guarded([](VSceneFramebufferObject& i_rItem) { i_rItem.OnFrameChanged(); }), pScene->Dispatcher());
	}
	WriteOptionsToMap(m_Options, *m_pOptionsMap);
	emit SceneOptionsChanged();
	OnFrameChanged();
	update();
}

QObject* VSceneFramebufferObject::GetCameraGrid() const
{
	return m_pCameraGrid;
}

void VSceneFramebufferObject::SetCameraGrid(QObject* i_pCameraGrid)
{
	m_pCameraGrid = dynamic_cast<VCameraGrid*>(i_pCameraGrid);
	update();
}

void VSceneFramebufferObject::SetPreviewCamera(const QString& i_rPreviewCamera)
{
	m_PreviewCamera = i_rPreviewCamera;
	emit PreviewCameraChanged();
	update();
}

int VSceneFramebufferObject::GetCameraType() const
{
	return static_cast<int>(m_pCamera->m_Type);
}

void VSceneFramebufferObject::SetCameraType(int i_CameraType)
{
	if (i_CameraType < 0 || i_CameraType >= static_cast<int>(CoreGraphics::ECameraTypeCount))
		return;
	m_pCamera->m_Type = static_cast<std::uint32_t>(i_CameraType);
	OnFrameChanged();
	update();
}

void VSceneFramebufferObject::SetToolTipText(const QString& i_rToolTipText)
{
	if (m_ToolTipText == i_rToolTipText)
		return;
	m_ToolTipText = i_rToolTipText;
	emit ToolTipTextChanged();
}

void VSceneFramebufferObject::SetMousePos(const QPoint& i_rMousePos)
{
	if (m_MousePos == i_rMousePos)
		return;
	m_MousePos = i_rMousePos;
	emit MouseMoved();
}

void VSceneFramebufferObject::SetShowCameraNumbers(bool i_bShowCameraNumbers)
{
	if (m_bShowCameraNumbers == i_bShowCameraNumbers)
		return;
	m_bShowCameraNumbers = i_bShowCameraNumbers;
	emit ShowCameraNumbersChanged();
}

void VSceneFramebufferObject::SetSubjectObjects(const QList<QObject*>& i_rSubjectObjects)
{
	if (m_SubjectObjects == i_rSubjectObjects)
		return;
	m_SubjectObjects = i_rSubjectObjects;
	emit SubjectsChanged();
}

void VSceneFramebufferObject::SetFocusSelection(bool i_bFocusSelection)
{
	if (!i_bFocusSelection)
		return;
	m_Fit = EFit::Selection;
	update();
}

void VSceneFramebufferObject::FrameAll()
{
	m_Fit = EFit::All;
	update();
}

void VSceneFramebufferObject::SetTracking(ETracking i_Tracking)
{
	m_Tracking = i_Tracking;
	if (i_Tracking == ETrackingSelectionThen || i_Tracking == ETrackingTransform)
		m_bTrackSelectionPending = true;
	emit TrackSelectionChanged();
	update();
}

void VSceneFramebufferObject::ScaleManipulator(double i_Factor)
{
	const double scale = static_cast<double>(m_Options.m_ManipulatorScale) * i_Factor;
	if (!std::isfinite(scale))
		return;
	m_Options.m_ManipulatorScale = std::clamp(static_cast<float>(scale), c_MinManipulatorScale, c_MaxManipulatorScale);
	m_pOptionsMap->insert(QStringLiteral("ManipulatorScale"), m_Options.m_ManipulatorScale);
	update();
}

QQuickFramebufferObject::Renderer* VSceneFramebufferObject::createRenderer() const
{
	return new VSceneFramebufferRenderer;
}

QSGNode* VSceneFramebufferObject::updatePaintNode(QSGNode* io_pNode, UpdatePaintNodeData* io_pData)
{
	if (!HasOpenGL(*window()))
		return UpdateNoOpenGLNode(io_pNode, *window(), size());
	QSGNode* const pNode = QQuickFramebufferObject::updatePaintNode(io_pNode, io_pData);
	if (const std::shared_ptr<const VSamples> pSamples = m_pSamples.lock(); pNode && pSamples)
		ShowSamples(static_cast<QSGGeometryNode&>(*pNode), pSamples);
	return pNode;
}

void VSceneFramebufferObject::OnFocusChanged()
{
	if (!hasFocus())
		m_MouseState = EMouseIdle;
}

void VSceneFramebufferObject::OnSceneOptionsMapChanged(const QString& i_rKey, const QVariant& /*i_rValue*/)
{
	ReadOptionsFromMap(*m_pOptionsMap, m_Options);
	if (i_rKey == QLatin1String("YUp") && m_pScene)
		m_pScene->SetYUp(m_Options.m_bYUp);
	if ((i_rKey == QLatin1String("CameraShowRotated") || i_rKey == QLatin1String("CameraSnap90Degrees"))
	    && m_pCameraGrid)
		m_pCameraGrid->SetRotation(m_Options.m_bCameraShowRotated, m_Options.m_bCameraSnap90Degrees);
	OnFrameChanged();
	update();
}

bool VSceneFramebufferObject::IsCameraView() const
{
	return m_Options.m_bCameraView && m_pCameraGrid;
}

namespace
{

/// Makes the list as long as asked for, with objects that the parent owns.
template <typename TObject>
bool Resize(QList<QObject*>& io_rObjects, std::size_t i_Count, QObject* i_pParent)
{
	const int count = static_cast<int>(i_Count);
	if (io_rObjects.size() == count)
		return false;
	while (io_rObjects.size() > count)
		if (QObject* const pObject = io_rObjects.takeLast(); pObject && pObject->parent() == i_pParent)
			pObject->deleteLater();
	while (io_rObjects.size() < count)
		io_rObjects.append(new TObject(i_pParent));
	return true;
}

} // namespace

void VSceneFramebufferObject::OnFrameChanged()
{
	static const std::vector<VSubjectLabel> s_NoLabels;
	static const std::vector<VCameraDefinition> s_NoCameras;
	if (m_pScene && m_Options.m_bYUp != m_pScene->YUp())
	{
		m_Options.m_bYUp = m_pScene->YUp();
		m_pOptionsMap->insert(QStringLiteral("YUp"), m_Options.m_bYUp);
	}
	m_pCamera->m_bYUp = m_Options.m_bYUp;
	m_pCamera->Update();

	const auto& rCameras = m_pScene ? m_pScene->CameraDefinitions() : s_NoCameras;
	const auto& rSubjects = m_pScene ? m_pScene->SubjectLabels() : s_NoLabels;
	const auto& rProps = m_pScene && m_Options.m_PropSubject.m_bEnabled ? m_pScene->PropLabels() : s_NoLabels;
	const QMatrix4x4 viewProjection = m_pCamera->m_Projection * m_pCamera->m_View;
	const auto place = [&](const QVector3D& i_rPoint)
	{ return PlaceOverlay(viewProjection, size(), i_rPoint, m_Options.m_bYUp); };

	if (Resize<VCameraObject>(m_CameraObjects, rCameras.size(), this))
		emit CamerasChanged();
	for (std::size_t i = 0; i < rCameras.size(); ++i)
	{
		auto& rObject = static_cast<VCameraObject&>(*m_CameraObjects[static_cast<int>(i)]);
		const VOverlayPlace where = place(rCameras[i].m_Position);
		rObject.SetUserId(static_cast<int>(rCameras[i].m_UserId));
		rObject.SetCalibrated(rCameras[i].m_bCalibrated);
		rObject.SetPlace(where.m_Position, where.m_Depth, where.m_RotationDegrees, where.m_bOffscreen);
	}

	if (Resize<VSubjectObject>(m_SubjectObjects, rSubjects.size() + rProps.size(), this))
		emit SubjectsChanged();
	for (std::size_t i = 0; i < rSubjects.size() + rProps.size(); ++i)
	{
		const VSubjectLabel& rLabel = i < rSubjects.size() ? rSubjects[i] : rProps[i - rSubjects.size()];
		auto* const pObject = qobject_cast<VSubjectObject*>(m_SubjectObjects[static_cast<int>(i)]);
		if (!pObject)
			continue;
		const VOverlayPlace where = place(rLabel.m_Position);
		pObject->SetPosition(QVector3D(static_cast<float>(where.m_Position.x()),
		    static_cast<float>(where.m_Position.y()), static_cast<float>(where.m_Depth)));
		pObject->SetName(QString::fromStdString(rLabel.m_Name));
		pObject->SetSelectionItem(rLabel.m_Item);
	}
}

} // namespace OrlexGraphics

#include "moc_SceneFramebufferObject.cpp"
#include "moc_Tracking.cpp"
