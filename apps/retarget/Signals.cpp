#include "retarget/Signals.h"

#include "UtilsFileSystem/SaveFile.h"

#include <csignal>

namespace CommandLine
{
namespace
{

void EndBySignal(int i_Signal)
{
	UtilsFileSystem::RemoveUnfinishedSaves();
	// Its own handling takes effect when this returns.
	std::signal(i_Signal, SIG_DFL);
	std::raise(i_Signal);
}

} // namespace

void LeaveNothingOnSignals()
{
	constexpr int c_Signals[] = {
	    SIGINT,
	    SIGTERM,
#ifdef SIGHUP
	    SIGHUP,
#endif
	};
	for (const int signal : c_Signals)
		if (std::signal(signal, EndBySignal) == SIG_IGN)
			std::signal(signal, SIG_IGN);
}

} // namespace CommandLine
