// The panel's document without a panel, for faults: builds a target subject of an FBX file and saves it, and reads it
// back, once or as often as it is told. FILE.qrr is replaced. Exit statuses are those of the contract.

#include "CommandLineText/ExitStatus.h"
#include "InMemoryHost/PluginContext.h"
#include "RetargetSetupDocument/RetargetSetup.h"

#include <QUrl>

#include <dlfcn.h>

#include <cstdio>
#include <cstdlib>
#include <functional>
#include <new>

namespace
{

/// Without memory a step is taken back whole: the second time it does what it should have done the first time.
void Step(const std::function<void()>& i_rStep)
{
	try
	{
		i_rStep();
	}
	catch (const std::bad_alloc&)
	{
		std::fputs("out of memory\n", stderr);
		i_rStep();
	}
}

int Run(char** i_ppArguments)
{
	const QUrl file = QUrl::fromLocalFile(QString::fromLocal8Bit(i_ppArguments[1]));
	InMemoryHost::VPluginContext host;
	VRetargetSetup document(host.GetDispatcher(), host.GetFrameFactory(), host.GetItemFactory());
	// Full before long.
	document.KeepHistory(nullptr, std::size_t(8) << 20);
	bool bSaved = false;
	bool bLoaded = false;
	bool bIgnored = false;
	QObject::connect(&document, &VRetargetSetup::targetSubjectSaved, [&] { bSaved = true; });
	QObject::connect(&document, &VRetargetSetup::targetSubjectLoaded, [&] { bLoaded = true; });
	QObject::connect(&document, &VRetargetSetup::commandIgnored,
	    [&](const QString& i_rCommand, const QString& i_rReason)
	    {
		    bIgnored = true;
		    std::fprintf(stderr, "%s: %s\n", qPrintable(i_rCommand), qPrintable(i_rReason));
	    });
	// That a QObject can be made without memory is Qt's affair.
	if (const auto pCount = reinterpret_cast<void (*)()>(::dlsym(RTLD_DEFAULT, "CountFaultsFromHere")))
		pCount();
	bool bRead = true;
	Step([&] { bRead = document.LoadSourceSubject(i_ppArguments[3], "performer"); });
	Step([&] { bRead = bRead && document.LoadTargetFBX(i_ppArguments[2]); });
	if (!bRead)
	{
		std::fputs("a file cannot be read\n", stderr);
		return CommandLine::EBadInput;
	}
	Step([&] { document.CreateTargetSubject(); });
	// An edit that stands may still fail to be shown.
	Step(
	    [&]
	    {
		    if (document.TargetValues().m_pParametrised->m_Targets.empty())
			    document.AddTarget(1, 1, true, false);
	    });
	Step([&] { document.RemoveUnnecessaryJoints(); });
	Step([&] { document.SetTargetScale(1.25); });
	if (bIgnored)
		return CommandLine::EBadInput;
	for (long times = i_ppArguments[4] ? std::atol(i_ppArguments[4]) : 1; times > 0; --times)
	{
		bSaved = bLoaded = false;
		Step([&] { document.SaveTargetSubjectURL(file); });
		if (!bSaved)
			return CommandLine::EBadOutput;
		Step([&] { document.LoadTargetSubjectURL(file); });
		if (!bLoaded || bIgnored)
			return CommandLine::EBadInput;
		Step([&] { host.Dispatcher().RunPending(); });
	}
	return CommandLine::EFine;
}

} // namespace

/// Leaves without Qt's own cleaning up.
int main(int i_Count, char** i_ppArguments)
{
	if (i_Count != 4 && i_Count != 5)
	{
		std::fputs("usage: document_job FILE.qrr CHARACTER.fbx PERFORMER.qrs [TIMES]\n", stderr);
		return CommandLine::EWrongUsage;
	}
	try
	{
		std::_Exit(Run(i_ppArguments));
	}
	catch (const std::bad_alloc&)
	{
		std::fputs("out of memory\n", stderr);
		return CommandLine::EBadInput;
	}
}
