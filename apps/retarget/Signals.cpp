#include "retarget/Signals.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/ProgressBar.h"
#include "CommandLineText/System.h"

#include "UtilsFileSystem/SaveFile.h"

#include <csignal>
#include <cstdlib>
#include <cxxabi.h>
#include <exception>
#include <new>
#include <typeinfo>
#include <unistd.h>

namespace CommandLine
{
namespace
{

void EndBySignal(int i_Signal)
{
	LeaveProgress();
	UtilsFileSystem::RemoveUnfinishedSaves();
	// Its own handling takes effect when this returns.
	static_cast<void>(std::signal(i_Signal, SIG_DFL));
	std::raise(i_Signal);
}

std::terminate_handler s_pTerminateBefore = nullptr;

/// For an allocation that fails where nothing can be thrown, or while a failure is told. Nothing here needs memory.
/// Other reasons for std::terminate end the program as before.
[[noreturn]] void EndWithoutMemory()
{
	// Where there is no room for the exception either, none is thrown.
	const std::type_info* const pThrown = abi::__cxa_current_exception_type();
	void* const pRoom = std::malloc(1 << 12);
	if (pThrown ? *pThrown != typeid(std::bad_alloc) : pRoom != nullptr)
	{
		std::free(pRoom);
		s_pTerminateBefore();
		std::abort();
	}
	UtilsFileSystem::RemoveUnfinishedSaves();
	WriteAtOnce(STDERR_FILENO, "error retarget: Out of memory\n");
	std::_Exit(EBadInput);
}

/// Before everything else: libraries allocate before main begins.
struct VHandlesTermination
{
	VHandlesTermination() { s_pTerminateBefore = std::set_terminate(EndWithoutMemory); }
};
[[gnu::init_priority(101)]] VHandlesTermination s_HandlesTermination;

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
			static_cast<void>(std::signal(signal, SIG_IGN));
}

} // namespace CommandLine
