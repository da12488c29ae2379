#pragma once

#include "Flow2TypesUtils/ItemCache.h"
#include "Flow2TypesUtils/SceneItems.h"
#include "NVX/CountedPointer.h"
#include "OrlexGraphics/frame/OrlexScene.h"
#include "TesselPluginInterface/IFlowFrame.h"

namespace OrlexGraphics
{
class VRenderManipulator;
class VRenderFBXScene;
class VRenderVolumeManipulator;
} // namespace OrlexGraphics

namespace Flow2Graphics
{

class IFlowRenderType;
class VFlowRenderSubjectDynamics;

/// A scene that gets its content from the host's frames.
class VFlowScene : public OrlexGraphics::VOrlexScene
{
	Q_OBJECT

public:
	/// As VOrlexScene.
	VFlowScene(std::shared_ptr<CoreGraphics::VShaderLibrary> i_pShaderLibrary,
	    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager,
	    std::shared_ptr<OrlexGraphics::VSkinCache> i_pSkinCache,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher, bool i_bAllowHiddenPick);
	~VFlowScene() override;

	/// Null before the first frame.
	const std::shared_ptr<OrlexGraphics::VRenderManipulator>& RenderManipulator() const { return m_pRenderManipulator; }

	/// Hidden until someone shows them. Null before the first frame.
	const std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator>& RenderReconstructionVolumeManipulator() const
	{
		return m_pRenderReconstructionVolumeManipulator;
	}
	const std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator>& RenderHotspotVolumeManipulator() const
	{
		return m_pRenderHotspotVolumeManipulator;
	}

	/// What is to be shown from the next exchange on. User interface thread.
	void SetFrame(NVX::CountedPointer<TesselPluginInterface::IFlowFrame> i_pFrame);
	/// The same of a frame that holds all subjects: one that it lacks is drawn no more, where it otherwise stays.
	void SetWholeFrame(NVX::CountedPointer<TesselPluginInterface::IFlowFrame> i_pFrame);

	/// The frame that bounds and matrices of items are of; null before the first. User interface thread.
	const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& PublishedFrame() const { return m_pPublishedFrame; }

	void InitialiseGL() override;
	bool Synchronise() override;
	/// The frame update.
	void Refresh() override;
	/// Shows the meshes of a file beside the subjects, instead of those before; none of a file that cannot be read, and
	/// for an empty path.
	void LoadFBXScene(const QString& i_rPath) override;

	std::vector<QVector4D> GetBounds(const std::vector<NVX::ISelectionItem>& i_rSelection) const override;
	bool GetItemTransform(
	    const std::vector<NVX::ISelectionItem>& i_rSelection, QMatrix4x4& o_rTransform) const override;
	std::vector<NVX::ISelectionItem> MakeSelection(
	    const std::vector<std::uint32_t>& i_rIds, std::vector<std::string>& o_rNames) const override;
	QString GetSelectedCamera() const override;
	/// Alone; no camera for an empty URN.
	void SelectCamera(const QString& i_rDeviceURN, bool i_bPreselect) override;

private:
	void AddSubjects();
	template <typename TFlowType, typename TPartner, typename... TArguments>
	std::shared_ptr<TFlowType> AddFlowType(std::shared_ptr<TPartner> i_pPartner, TArguments&&... i_rArguments);
	void OnFrame();

	std::shared_ptr<OrlexGraphics::VRenderManipulator> m_pRenderManipulator;
	std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> m_pRenderReconstructionVolumeManipulator;
	std::shared_ptr<OrlexGraphics::VRenderVolumeManipulator> m_pRenderHotspotVolumeManipulator;
	/// In the order in which they were made.
	std::vector<std::shared_ptr<IFlowRenderType>> m_FlowTypes;
	std::shared_ptr<VFlowRenderSubjectDynamics> m_pDynamics;
	std::shared_ptr<OrlexGraphics::VRenderFBXScene> m_pFBXScene;
	Flow2TypesUtils::VItemCacheTyped<Flow2TypesUtils::FlowUpAxisItem> m_UpAxis;
	NVX::VConnection m_SkinConnection;
	/// Of the user interface thread.
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> m_pPendingFrame;
	bool m_bForget = false;
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> m_pPublishedFrame;
	struct VFBXMeshes;
	/// Of the user interface thread; null when there are no new ones.
	std::unique_ptr<VFBXMeshes> m_pPendingMeshes;
	/// Of the render thread; the other one is that of the last frame update.
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> m_pFrame;
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> m_pUpdatedFrame;
};

} // namespace Flow2Graphics
