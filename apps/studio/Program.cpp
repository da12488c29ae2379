#include "studio/Program.h"

#include "CommandLineText/Display.h"
#include "DebugServices/GlobalLog.h"
#include "studio/Options.h"
#include "studio/host/Module.h"
#include "studio/host/OpenGLCheck.h"
#include "studio/host/QtDispatcher.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/DarkStyle.h"
#include "studio/window/Screenshot.h"
#include "studio/window/StudioWindow.h"

#include <QApplication>
#include <QFileInfo>
#include <QQuickWidget>

#include <atomic>
#include <cstdio>

using CommandLine::EBadInput;
using CommandLine::EBadOutput;
using CommandLine::EFine;

namespace StudioHost
{
namespace
{

constexpr const char* c_pCategory = "retarget-studio";

/// The window's list takes information, too; standard error only what was asked for.
std::shared_ptr<void> ShowMessagesOnTerminal(const CommandLine::VMessageSettings& i_rSettings)
{
	const int level = CommandLine::DefaultLevel(i_rSettings);
	NVX::GlobalLog::SetDefaultLevel(std::max<int>(level, NVX::ELogInformation));
	// Each start reads every preference, set or not.
	if (i_rSettings.m_Verbose == 0)
		NVX::GlobalLog::Category("Store").SetLevel(NVX::ELogWarning);
	for (const auto& [rName, categoryLevel] : i_rSettings.m_CategoryLevels)
		NVX::GlobalLog::Category(rName).SetLevel(categoryLevel);
	return NVX::GlobalLog::AddSink(
	    [level, levels = i_rSettings.m_CategoryLevels](
	        const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
	    {
		    const auto found = levels.find(i_rCategory.Name());
		    if (i_Level <= (found == levels.end() ? level : found->second))
			    CommandLine::PrintMessage(i_rCategory, i_Level, i_rMessage);
	    });
}

/// Counts errors for as long as it lives.
class VErrorCount
{
public:
	VErrorCount()
	    : m_pSink(NVX::GlobalLog::AddSink(
	        [this](const NVX::VLogCategory&, int i_Level, const std::string&)
	        {
		        if (i_Level <= NVX::ELogError)
			        ++m_Count;
	        }))
	{
	}
	int Count() const { return m_Count; }

private:
	std::atomic<int> m_Count{0};
	const std::shared_ptr<void> m_pSink;
};

int Fail(CommandLine::EExitStatus i_Status, const std::string& i_rMessage)
{
	NVX_LOG(c_pCategory, NVX::ELogError, "%1%", i_rMessage);
	return i_Status;
}

std::unique_ptr<QSettings> OpenSettings(const QString& i_rPath)
{
	return i_rPath.isEmpty() ? std::make_unique<QSettings>()
	                         : std::make_unique<QSettings>(i_rPath, QSettings::IniFormat);
}

int RunScreenshot(QApplication& io_rApplication, VStudioWindow& io_rWindow, const QString& i_rPath)
{
	auto* const pPanel =
	    io_rWindow.RetargetPanel() ? qobject_cast<QQuickWidget*>(io_rWindow.RetargetPanel()->Widget()) : nullptr;
	if (!pPanel || !io_rWindow.RetargetPanel()->IsReady())
		return Fail(EBadInput, "There is no panel to take a picture of");
	bool bSaved = false;
	VScreenshot screenshot(io_rWindow, *pPanel, i_rPath);
	QObject::connect(&screenshot, &VScreenshot::done, &io_rApplication,
	    [&](bool i_bSaved)
	    {
		    bSaved = i_bSaved;
		    QApplication::quit();
	    });
	QApplication::exec();
	return bSaved ? EFine : EBadOutput;
}

int RunWindow(QApplication& io_rApplication, const VOptions& i_rOptions)
{
	const VErrorCount errors;
	const std::unique_ptr<QSettings> pSettings = OpenSettings(i_rOptions.m_Settings);
	VStudioWindow window(*pSettings, i_rOptions.m_bDeveloper);
	// From here on messages stand in the window's list, too.
	if (pSettings->status() != QSettings::NoError)
		NVX_LOG(c_pCategory, NVX::ELogWarning, "The settings in %1% cannot be read: what is set now will not be kept",
		    pSettings->fileName().toStdString());
	CheckOpenGL();
	const QString module = i_rOptions.m_Module.isEmpty() ? DefaultModulePath() : i_rOptions.m_Module;
	if (module.isEmpty())
		NVX_LOG(c_pCategory, NVX::ELogError, "The module that comes with this program is not in its place");
	const bool bLoaded = !module.isEmpty() && window.LoadModule(module);

	const bool bScreenshot = !i_rOptions.m_Screenshot.isEmpty();
	if (!bScreenshot)
		window.RestoreLayout();
	if (i_rOptions.m_Size.isValid())
		window.resize(i_rOptions.m_Size);
	window.show();
	if (!bScreenshot)
		window.OfferLeftWork();
	for (const QString& rFile : i_rOptions.m_Files)
		window.Open(rFile);
	if (!i_rOptions.m_Take.isEmpty())
		window.OpenTake(i_rOptions.m_Take, i_rOptions.m_Frame);
	if (!i_rOptions.m_Dialog.empty())
		window.OpenDialogSoon(i_rOptions.m_Dialog);
	if (!bScreenshot)
		return QApplication::exec();
	if (!bLoaded)
		return EBadInput;
	const int status = RunScreenshot(io_rApplication, window, i_rOptions.m_Screenshot);
	return status == EFine && errors.Count() > 0 ? EBadInput : status;
}

} // namespace

int Run(int i_Count, char** i_ppArguments)
{
	std::shared_ptr<void> pMessages = CommandLine::ShowMessages({});
	try
	{
		std::string text;
		const std::optional<VOptions> options = ParseOptions({i_ppArguments + 1, i_ppArguments + i_Count}, text);
		if (!options)
		{
			std::fputs(text.c_str(), stdout);
			return EFine;
		}
		pMessages.reset();
		pMessages = ShowMessagesOnTerminal(options->m_Messages);
		if (!options->m_Messages.m_LogFile.empty())
			CommandLine::KeepMessages(options->m_Messages.m_LogFile);
		CommandLine::PrepareDisplay({c_pCategory, EBadInput,
		    "There is no display to show a window on: set DISPLAY, or use the program retarget"});
		QCoreApplication::setAttribute(Qt::AA_ShareOpenGLContexts);
		QCoreApplication::setOrganizationName(QStringLiteral("RetargetSetup"));
		QCoreApplication::setApplicationName(QStringLiteral("retarget-studio"));
		QCoreApplication::setApplicationVersion(QStringLiteral(RETARGET_VERSION));
		// The command line is ours alone.
		int count = 1;
		QApplication application(count, i_ppArguments);
		ApplyDarkStyle(application);
		return RunWindow(application, *options);
	}
	catch (const CommandLine::VCommandError& rError)
	{
		return Fail(rError.Status(), rError.what());
	}
	catch (const std::exception& rError)
	{
		return Fail(EBadInput, rError.what());
	}
}

} // namespace StudioHost
