#include "studio/host/Module.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QLibrary>
#include <QStringList>

namespace StudioHost
{
namespace
{

/// Null, with its name added to the missing ones, if the library has no such function.
template <typename TFunction>
TFunction* Resolve(QLibrary& io_rLibrary, const char* i_pName, QStringList& io_rMissing)
{
	auto* const pFunction = reinterpret_cast<TFunction*>(io_rLibrary.resolve(i_pName));
	if (!pFunction)
		io_rMissing << QLatin1String(i_pName);
	return pFunction;
}

} // namespace

std::unique_ptr<VModule> VModule::Load(const QString& i_rPath, QString& o_rWhy)
{
	const auto refuse = [&](const QString& i_rWhy)
	{
		o_rWhy = i_rWhy;
		return nullptr;
	};
	const QFileInfo file(i_rPath);
	const QString path = file.absoluteFilePath();
	if (!file.exists())
		return refuse(QStringLiteral("%1 does not exist").arg(path));
	if (!file.isFile())
		return refuse(QStringLiteral("%1 is no file").arg(path));

	QLibrary library(path);
	library.setLoadHints(QLibrary::ResolveAllSymbolsHint | QLibrary::PreventUnloadHint);
	if (!library.load())
		return refuse(QStringLiteral("%1 is no library that can be loaded: %2").arg(path, library.errorString()));

	QStringList missing;
	const auto pRevision = Resolve<VPluginBuildRevision>(library, "PluginBuildRevision", missing);
	const auto pCreate = Resolve<VCreatePlugin>(library, "CreatePlugin", missing);
	const auto pDestroy = Resolve<VDestroyPlugin>(library, "DestroyPlugin", missing);
	if (!missing.isEmpty())
		return refuse(QStringLiteral("%1 is no module: it has no function %2").arg(path, missing.join(" and ")));
	// Of another revision not even the order of the virtual functions is known.
	if (const std::uint64_t revision = pRevision(); revision != TesselPluginInterface::c_PluginBuildRevision)
	{
		return refuse(QStringLiteral("%1 is of revision %2, this program works with modules of revision %3")
		                  .arg(path)
		                  .arg(revision)
		                  .arg(TesselPluginInterface::c_PluginBuildRevision));
	}
	TesselPluginInterface::IPlugin* const pPlugin = pCreate();
	if (!pPlugin)
		return refuse(QStringLiteral("%1 made no plug-in").arg(path));
	std::unique_ptr<VModule> pModule(new VModule(path, *pPlugin, *pDestroy));
	if (!pPlugin->RegisterQmlTypes())
		return refuse(QStringLiteral("%1 could not register its types").arg(path));
	return pModule;
}

VModule::VModule(QString i_Path, TesselPluginInterface::IPlugin& i_rPlugin, VDestroyPlugin& i_rDestroy)
    : m_Path(std::move(i_Path)), m_rPlugin(i_rPlugin), m_rDestroy(i_rDestroy)
{
}

VModule::~VModule()
{
	if (m_bContent)
		m_rPlugin.ReleaseContent();
	m_rDestroy(&m_rPlugin);
}

bool VModule::CreateContent(
    TesselPluginInterface::IPluginContext& i_rContext, TesselPluginInterface::IPluginGui& i_rGui)
{
	// What a failed attempt has made is released, too.
	m_bContent = true;
	return m_rPlugin.CreateContent(i_rContext, i_rGui);
}

QString DefaultModulePath()
{
	const QDir program(QCoreApplication::applicationDirPath());
	for (const char* pFolder : {RETARGET_MODULE_IN_BUILD, RETARGET_MODULE_INSTALLED})
	{
		QString path = QDir::cleanPath(program.filePath(QLatin1String(pFolder)));
		if (QFileInfo(path).isFile())
			return path;
	}
	return {};
}

} // namespace StudioHost
