#pragma once

#include "TesselPluginInterface/IPlugin.h"

#include <QString>

#include <memory>

namespace TesselPluginInterface
{
class IPluginContext;
class IPluginGui;
} // namespace TesselPluginInterface

namespace StudioHost
{

/// A plug-in of a shared library. Its end is the unload: ReleaseContent, then DestroyPlugin. The library itself stays
/// in the process, since types that it has registered with Qt outlive the plug-in. User interface thread only.
class VModule
{
public:
	/// Loads the library, checks that it is a module for this host, makes its plug-in and has it register its QML
	/// types.
	/// @param o_rWhy why there is no module, for the operator.
	/// @return null if there is none.
	static std::unique_ptr<VModule> Load(const QString& i_rPath, QString& o_rWhy);

	VModule(const VModule&) = delete;
	VModule& operator=(const VModule&) = delete;
	~VModule();

	/// @return false if the module says that it could not.
	bool CreateContent(TesselPluginInterface::IPluginContext& i_rContext, TesselPluginInterface::IPluginGui& i_rGui);

	const QString& Path() const { return m_Path; }

private:
	VModule(QString i_Path, TesselPluginInterface::IPlugin& i_rPlugin, VDestroyPlugin& i_rDestroy);

	const QString m_Path;
	TesselPluginInterface::IPlugin& m_rPlugin;
	VDestroyPlugin& m_rDestroy;
	bool m_bContent = false;
};

/// Where the module of this program stands: beside it in the build tree, in the library folder once installed. Empty if
/// it is at neither place.
QString DefaultModulePath();

} // namespace StudioHost
