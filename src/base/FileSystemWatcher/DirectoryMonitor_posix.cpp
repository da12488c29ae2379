#include "FileSystemWatcher/DirectoryMonitor.h"

#include <boost/system/system_error.hpp>

#include <cerrno>
#include <fcntl.h>
#include <poll.h>
#include <sys/eventfd.h>
#include <sys/inotify.h>
#include <unistd.h>

namespace FileSystemWatcher
{
namespace
{

constexpr std::uint32_t c_Events = IN_CREATE | IN_DELETE | IN_MODIFY | IN_ATTRIB | IN_CLOSE_WRITE | IN_MOVED_FROM
    | IN_MOVED_TO | IN_DELETE_SELF | IN_MOVE_SELF | IN_ONLYDIR;

/// How long an old name waits for its new one, which the system adds right after it.
constexpr int c_PartnerMilliseconds = 20;

[[noreturn]] void Throw()
{
	throw boost::system::system_error(errno, boost::system::generic_category(), c_pMonitorFailure);
}

EFileChange ToChange(std::uint32_t i_Mask)
{
	return i_Mask & IN_CREATE    ? EAdded
	    : i_Mask & IN_DELETE     ? ERemoved
	    : i_Mask & IN_MOVED_FROM ? ERenamedOld
	    : i_Mask & IN_MOVED_TO   ? ERenamedNew
	                             : EModified;
}

class VInotifyMonitor final : public IDirectoryMonitor
{
public:
	VInotifyMonitor()
	    : m_Inotify(::inotify_init1(IN_NONBLOCK | IN_CLOEXEC)), m_Stop(::eventfd(0, EFD_NONBLOCK | EFD_CLOEXEC)),
	      m_Mounts(::open("/proc/self/mountinfo", O_RDONLY | O_CLOEXEC))
	{
		if (m_Inotify >= 0 && m_Stop >= 0)
			return;
		const int error = errno;
		CloseAll();
		errno = error;
		Throw();
	}

	~VInotifyMonitor() override { CloseAll(); }

	int Add(const boost::filesystem::path& i_rDirectory) override
	{
		const int watch = ::inotify_add_watch(m_Inotify, i_rDirectory.c_str(), c_Events);
		if (watch < 0)
			Throw();
		return watch;
	}

	void Remove(int i_Watch) override { ::inotify_rm_watch(m_Inotify, i_Watch); }

	bool Wait(std::vector<VSystemEvent>& o_rEvents) override
	{
		o_rEvents.clear();
		int timeout = -1;
		do
		{
			// One that could not be opened is passed over.
			pollfd files[] = {{m_Inotify, POLLIN, 0}, {m_Stop, POLLIN, 0}, {m_Mounts, POLLPRI, 0}};
			const int ready = ::poll(files, 3, timeout);
			if (ready < 0 && errno == EINTR)
				continue;
			if (files[1].revents != 0)
				return false;
			const bool bMore = files[0].revents != 0 && Read(o_rEvents);
			if (files[2].revents != 0)
			{
				VSystemEvent event;
				event.m_Watch = -1;
				o_rEvents.push_back(std::move(event));
			}
			timeout = PairRenames(o_rEvents, bMore) ? c_PartnerMilliseconds : -1;
		} while (timeout >= 0 || o_rEvents.empty());
		return true;
	}

	void Stop() override
	{
		const std::uint64_t one = 1;
		// It fails only if it is already far from 0.
		(void)!::write(m_Stop, &one, sizeof(one));
	}

private:
	void CloseAll()
	{
		for (const int descriptor : {m_Inotify, m_Stop, m_Mounts})
			if (descriptor >= 0)
				::close(descriptor);
	}

	/// @return false if nothing was there.
	bool Read(std::vector<VSystemEvent>& io_rEvents)
	{
		alignas(inotify_event) char buffer[1 << 14];
		const ssize_t size = ::read(m_Inotify, buffer, sizeof(buffer));
		for (ssize_t at = 0; at < size;)
		{
			const auto* const pEvent = reinterpret_cast<const inotify_event*>(buffer + at);
			at += ssize_t(sizeof(inotify_event) + pEvent->len);
			Translate(*pEvent, io_rEvents);
		}
		return size > 0;
	}

	static void Translate(const inotify_event& i_rEvent, std::vector<VSystemEvent>& io_rEvents)
	{
		VSystemEvent event;
		event.m_Watch = i_rEvent.wd;
		if (i_rEvent.mask & IN_Q_OVERFLOW)
			event.m_Error = "too many changes at once, some are lost";
		else if (i_rEvent.mask & (IN_DELETE_SELF | IN_UNMOUNT | IN_MOVE_SELF))
		{
			event.m_Error = i_rEvent.mask & IN_MOVE_SELF ? "the directory was moved" : "the directory is gone";
			event.m_bEnded = true;
		}
		else if (i_rEvent.len == 0)
			return;
		else
		{
			event.m_Change = ToChange(i_rEvent.mask);
			event.m_Name = i_rEvent.name;
			event.m_bDirectory = (i_rEvent.mask & IN_ISDIR) != 0;
			event.m_Rename = i_rEvent.cookie;
		}
		io_rEvents.push_back(std::move(event));
	}

	const int m_Inotify;
	const int m_Stop;
	/// Ready when a file system is mounted or unmounted, which no directory tells of.
	const int m_Mounts;
};

} // namespace

std::unique_ptr<IDirectoryMonitor> MakeDirectoryMonitor()
{
	return std::make_unique<VInotifyMonitor>();
}

} // namespace FileSystemWatcher
