#pragma once

#include "NVX/Signal.h"
#include "TesselPluginInterface/IApplicationObject.h"
#include "TesselPluginInterface/IFlowFrame.h"

#include <memory>

namespace TesselPluginInterface
{

/// What a host may show in a preview instead of bind poses, such as recorded motion: the application object of such a
/// host implements this, too. User interface thread.
class IPreviewFrames
{
public:
	virtual ~IPreviewFrames() = default;

	/// Asked for each frame that the preview would show, so that the host knows what is edited.
	/// @param i_rpDocument the subjects as the document has them, without poses; it stays as it is. Null as long as it
	/// has none.
	/// @return what is drawn, with its poses; null for the bind poses. While it is not null nothing can be picked or
	/// moved by the mouse.
	virtual NVX::CountedPointer<IFlowFrame> Shown(const NVX::CountedPointer<IFlowFrame>& i_rpDocument) = 0;

	/// The answer would be another one.
	virtual NVX::VSignal<>& ShownChangedSignal() = 0;
};

/// Null for a host that gives none.
inline std::shared_ptr<IPreviewFrames> PreviewFramesOf(const std::shared_ptr<IApplicationObject>& i_rpApplication)
{
	return std::dynamic_pointer_cast<IPreviewFrames>(i_rpApplication);
}

} // namespace TesselPluginInterface
