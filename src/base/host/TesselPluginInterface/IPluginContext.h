#pragma once

#include "TesselPluginInterface/IDispatcher.h"
#include "TesselPluginInterface/IFlowFrame.h"
#include "TesselPluginInterface/IItemFactory.h"
#include "TesselPluginInterface/IPreferenceFolders.h"

#include <memory>

namespace TesselPluginInterface
{

class IApplicationObject;
class IDataStore;
class IParameterRegistry;
class ISelectionManager;

/// The host's services that need no window, in slot order. Each call hands out a new owner.
class IPluginContext
{
public:
	virtual ~IPluginContext() = default;

	virtual std::shared_ptr<IApplicationObject> GetApplicationObject() = 0;
	virtual std::shared_ptr<IPreferenceFolders> GetPreferenceFolders() = 0;
	virtual std::shared_ptr<IDataStore> GetDataStore() = 0;
	/// Accepts parameter groups.
	virtual std::shared_ptr<IParameterRegistry> GetParameterRegistry() = 0;
	virtual std::shared_ptr<IDispatcher> GetDispatcher() = 0;
	virtual NVX::CountedPointer<IItemFactory> GetItemFactory() = 0;
	virtual NVX::CountedPointer<IFrameFactory> GetFrameFactory() = 0;
	/// The host's selection and pre-selection.
	virtual std::shared_ptr<ISelectionManager> GetSelectionManager() = 0;
	/// Handed unread to the scene.
	virtual bool GetSceneFlag() = 0;
};

} // namespace TesselPluginInterface
