#pragma once

#include "NVX/CountedPointer.h"
#include "OrlexGraphics/OrlexScene.h"
#include "TesselPluginInterface/IFlowFrame.h"

namespace OrlexGraphics
{
class VRenderManipulator;
}

namespace Flow2Graphics
{

/// A scene that gets its content from the host's frames.
class VFlowScene : public OrlexGraphics::VOrlexScene
{
	Q_OBJECT

public:
	using VOrlexScene::VOrlexScene;
	~VFlowScene() override;

	/// Null before the first frame.
	const std::shared_ptr<OrlexGraphics::VRenderManipulator>& RenderManipulator() const { return m_pRenderManipulator; }

	/// What is to be shown from the next exchange on. User interface thread.
	void SetFrame(NVX::CountedPointer<TesselPluginInterface::IFlowFrame> i_pFrame);

	void InitialiseGL() override;
	bool Synchronise() override;
	/// The frame update.
	void Refresh() override;

	std::vector<QVector4D> GetBounds(const std::vector<NVX::ISelectionItem>& i_rSelection) const override;
	bool GetItemTransform(
	    const std::vector<NVX::ISelectionItem>& i_rSelection, QMatrix4x4& o_rTransform) const override;
	std::vector<NVX::ISelectionItem> MakeSelection(
	    const std::vector<std::uint32_t>& i_rIds, std::vector<std::string>& o_rNames) const override;

private:
	std::shared_ptr<OrlexGraphics::VRenderManipulator> m_pRenderManipulator;
	/// Of the user interface thread.
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> m_pPendingFrame;
	/// Of the render thread.
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> m_pFrame;
};

} // namespace Flow2Graphics
