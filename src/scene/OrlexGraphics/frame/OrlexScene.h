#pragma once

#include "NVX/ISelectionItem.h"
#include "NVX/Signal.h"
#include "OrlexGraphics/overlays/CameraDefinition.h"

#include <QMatrix4x4>
#include <QObject>
#include <QString>
#include <QVector4D>

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace CoreGraphics
{
class VShaderLibrary;
}

namespace TesselPluginInterface
{
class IDispatcher;
class ISelectionManager;
} // namespace TesselPluginInterface

namespace OrlexGraphics
{

class IManipulator;
class IRenderType;
class VRenderCameras;
class VSelectionRegistry;
class VSkinCache;
class VSphereHelper;
struct VItemPlaces;

/// What a SceneFramebufferObject shows: lists of what draws itself, in the order of drawing, and what the mouse can
/// find in it. Owned by a shared pointer; made on the user interface thread.
///
/// Two threads know it. The user interface thread asks for frames and reads what the last one brought; the render
/// thread makes frames and draws them. Synchronise, for which the former waits, is where they exchange everything.
class VOrlexScene : public QObject, public std::enable_shared_from_this<VOrlexScene>
{
	Q_OBJECT

public:
	/// @param i_pSkinCache may be null
	/// @param i_pDispatcher brings callbacks to the user interface thread
	VOrlexScene(std::shared_ptr<CoreGraphics::VShaderLibrary> i_pShaderLibrary,
	    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager,
	    std::shared_ptr<VSkinCache> i_pSkinCache, std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
	    bool i_bAllowHiddenPick);
	~VOrlexScene() override;

	/// On the render thread with the context current, while the user interface thread waits; for each renderer that
	/// begins to show the scene. Sees to the shaders, and to the render lists when they are still empty.
	virtual void InitialiseGL();
	/// The frame update, on the render thread.
	virtual void Refresh();
	virtual void LoadFBXScene(const QString& i_rPath);

	/// Bounding spheres of items, as centre and radius, as the last frame placed them.
	virtual std::vector<QVector4D> GetBounds(const std::vector<NVX::ISelectionItem>& i_rSelection) const;
	/// What a view shows in which nothing is selected. Where both threads meet.
	virtual std::vector<NVX::ISelectionItem> ItemsToFrame() const { return {}; }
	/// False for no item and for one without a matrix in the last frame.
	virtual bool GetItemTransform(const std::vector<NVX::ISelectionItem>& i_rSelection, QMatrix4x4& o_rTransform) const;
	/// The items of picked ids, on the render thread.
	/// @param o_rNames what the tool tip says of them
	virtual std::vector<NVX::ISelectionItem> MakeSelection(
	    const std::vector<std::uint32_t>& i_rIds, std::vector<std::string>& o_rNames) const;
	/// Device URN of the selected camera, empty if there is none.
	virtual QString GetSelectedCamera() const;

public slots:
	virtual void SelectCamera(const QString& i_rDeviceURN, bool i_bPreselect);

public:
	/// The exchange, in the render thread while the user interface thread waits.
	/// @return true if the user interface thread has something new to read: then PublishedSignal has been fired.
	virtual bool Synchronise();

	/// Asks for a frame update with the next frame, and all views of the scene to draw one.
	void RequestRefresh();

	/// Fires in the render thread after each frame update. Connect with the dispatcher.
	NVX::VSignal<>& FrameChangedSignal() { return m_FrameChangedSignal; }
	/// Fires in the render thread when the user interface thread can read what a frame update brought. Connect with the
	/// dispatcher.
	NVX::VSignal<>& PublishedSignal() { return m_PublishedSignal; }

	const std::shared_ptr<TesselPluginInterface::IDispatcher>& Dispatcher() const { return m_pDispatcher; }
	const std::shared_ptr<TesselPluginInterface::ISelectionManager>& SelectionManager() const
	{
		return m_pSelectionManager;
	}
	const std::shared_ptr<VSkinCache>& SkinCache() const { return m_pSkinCache; }
	bool AllowHiddenPick() const { return m_bAllowHiddenPick; }

	// For the user interface thread.

	bool YUp() const { return m_bYUp; }
	void SetYUp(bool i_bYUp);
	/// Nothing is picked, and what was is forgotten.
	void SetPickingRests(bool i_bRests) { m_bPickingRests = i_bRests; }
	bool PickingRests() const { return m_bPickingRests; }
	const std::vector<VCameraDefinition>& CameraDefinitions() const { return m_Published.m_Cameras; }
	const std::vector<VSubjectLabel>& SubjectLabels() const { return m_Published.m_SubjectLabels; }
	const std::vector<VSubjectLabel>& PropLabels() const { return m_Published.m_PropLabels; }
	/// Null before the first frame of a scene that has one.
	const std::shared_ptr<IManipulator>& Manipulator() const { return m_pManipulator; }
	const std::shared_ptr<IManipulator>& ReconstructionVolumeManipulator() const
	{
		return m_pReconstructionVolumeManipulator;
	}
	const std::shared_ptr<IManipulator>& HotspotVolumeManipulator() const { return m_pHotspotVolumeManipulator; }

	// For the render thread.

	bool NeedsRefresh() const { return m_bNeedsRefresh; }
	void SetNeedsRefresh() { m_bNeedsRefresh = true; }
	/// As the frame update has it.
	bool FrameYUp() const { return m_bFrameYUp; }
	bool ExactPick() const { return m_bExactPick; }
	const std::vector<std::shared_ptr<IRenderType>>& RenderList() const { return m_RenderList; }
	const std::vector<std::shared_ptr<IRenderType>>& PostList() const { return m_PostList; }
	/// Null in a scene without cameras.
	const std::shared_ptr<VRenderCameras>& CameraType() const { return m_pCameraType; }
	/// Null before InitialiseGL.
	const std::shared_ptr<VSphereHelper>& SphereHelper() const { return m_pSphereHelper; }
	VSelectionRegistry& Registry() const { return *m_pRegistry; }
	CoreGraphics::VShaderLibrary& ShaderLibrary() const { return *m_pShaderLibrary; }

signals:
	/// The user interface thread wants a frame.
	void RefreshRequested();

protected:
	/// As the last frame placed the items; empty before the first one.
	const VItemPlaces& Places() const { return *m_pPlaces; }

	/// What a frame update makes beside what is drawn.
	struct VOverlay
	{
		std::vector<VCameraDefinition> m_Cameras;
		std::vector<VSubjectLabel> m_SubjectLabels;
		std::vector<VSubjectLabel> m_PropLabels;
	};

	const std::shared_ptr<CoreGraphics::VShaderLibrary> m_pShaderLibrary;
	/// Walked by the passes, in this order.
	std::vector<std::shared_ptr<IRenderType>> m_RenderList;
	/// Walked once after the passes.
	std::vector<std::shared_ptr<IRenderType>> m_PostList;
	std::shared_ptr<VRenderCameras> m_pCameraType;
	/// Of the render thread.
	VOverlay m_Overlay;
	const std::shared_ptr<VSelectionRegistry> m_pRegistry;
	std::shared_ptr<VSphereHelper> m_pSphereHelper;
	std::shared_ptr<IManipulator> m_pManipulator;
	std::shared_ptr<IManipulator> m_pReconstructionVolumeManipulator;
	std::shared_ptr<IManipulator> m_pHotspotVolumeManipulator;
	/// Of the render thread; a frame update that knows better sets it.
	bool m_bFrameYUp = false;
	/// Picks with each pixel, without looking for what lies behind.
	bool m_bExactPick = false;

private:
	const std::shared_ptr<TesselPluginInterface::ISelectionManager> m_pSelectionManager;
	const std::shared_ptr<VSkinCache> m_pSkinCache;
	const std::shared_ptr<TesselPluginInterface::IDispatcher> m_pDispatcher;
	const bool m_bAllowHiddenPick;
	std::vector<NVX::VConnection> m_Connections;
	NVX::VSignal<> m_FrameChangedSignal;
	NVX::VSignal<> m_PublishedSignal;

	// Of the user interface thread.
	bool m_bRefreshRequested = false;
	bool m_bYUp = false;
	bool m_bYUpSet = false;
	bool m_bPickingRests = false;
	VOverlay m_Published;
	std::shared_ptr<const VItemPlaces> m_pPlaces;

	// Of the render thread.
	bool m_bNeedsRefresh = false;
	bool m_bFrameUpdated = false;
};

} // namespace OrlexGraphics
