#pragma once

#include "OrlexGraphics/frame/FrameRenderer.h"
#include "OrlexGraphics/item/Tracking.h"
#include "OrlexGraphics/picking/Picking.h"

#include <QQuickFramebufferObject>
#include <QVector4D>

#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

class QQuickWindow;

namespace OrlexGraphics
{

class VSamples;
class VSceneFramebufferObject;
enum class EFit : std::uint32_t;

/// Draws the scene of one SceneFramebufferObject, on the render thread, and picks from it. It owns the OpenGL objects
/// of the view and lives as long as they do.
class VSceneFramebufferRenderer : public QQuickFramebufferObject::Renderer
{
public:
	VSceneFramebufferRenderer();
	~VSceneFramebufferRenderer() override;

	/// The one place where the two threads exchange anything: the user interface thread waits.
	void synchronize(QQuickFramebufferObject* io_pItem) override;
	QOpenGLFramebufferObject* createFramebufferObject(const QSize& i_rSize) override;
	void render() override;

	/// How many there are in the process, and how many there were.
	static std::uint64_t LivingCount();
	static std::uint64_t MadeCount();

private:
	void TakeScene(VSceneFramebufferObject& io_rItem);
	static void Fit(const VOrlexScene& i_rScene, EFit i_Fit, CoreGraphics::VCameraController& io_rCamera);
	void Track(VSceneFramebufferObject& io_rItem);
	void FollowTracked();

	VFrameRenderer m_Renderer;
	/// Null where they cannot be read.
	std::shared_ptr<VSamples> m_pSamples;
	QQuickWindow* m_pWindow = nullptr;
	bool m_bPickActive = false;
	/// What is to be picked.
	VPickRequest m_Request;
	/// What the last pick found.
	std::optional<VPick> m_Pick;
	bool m_bContinuousUpdate = true;
	bool m_bVisible = false;
	ETracking m_Tracking = ETrackingNone;
	std::vector<NVX::ISelectionItem> m_Tracked;
	std::vector<QVector4D> m_TrackedBounds;
};

} // namespace OrlexGraphics
