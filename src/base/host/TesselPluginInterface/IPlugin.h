#pragma once

#include <cstdint>
#include <string>

namespace TesselPluginInterface
{

class IPluginContext;
class IPluginGui;

/// What PluginBuildRevision of a module for this host returns.
inline constexpr std::uint64_t c_PluginBuildRevision = 125783;

/// What the host sees of a module: it calls by slot, so the order of the declarations is part of the interface.
/// All calls come on the user interface thread: RegisterQmlTypes, CreateContent, then ReleaseContent before the end.
class IPlugin
{
public:
	virtual ~IPlugin() = default;

	virtual const std::string& FirstText() const { return EmptyText(); }
	virtual const std::string& SecondText() const { return EmptyText(); }
	virtual bool FirstHook() { return true; }
	virtual bool SecondHook() { return true; }
	virtual bool ThirdHook() { return true; }
	virtual bool FourthHook() { return true; }
	virtual bool FifthHook() { return true; }

	/// Before any QML of the module is compiled.
	virtual bool RegisterQmlTypes() { return true; }

	/// Builds what the module shows, and hands it to the host.
	virtual bool CreateContent(IPluginContext& /*i_rContext*/, IPluginGui& /*i_rGui*/) { return true; }

	virtual bool ReleaseContent() { return true; }
	virtual void LastHook() {}

private:
	static const std::string& EmptyText()
	{
		static const std::string s_Empty;
		return s_Empty;
	}
};

} // namespace TesselPluginInterface

/// The plain functions that a module exports, by name, with C linkage.
using VCreatePlugin = TesselPluginInterface::IPlugin*();
using VDestroyPlugin = void(TesselPluginInterface::IPlugin*);
using VPluginBuildRevision = std::uint64_t();
