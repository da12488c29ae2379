#include <windows.h>

#include "FileSystemWatcher/DirectoryMonitor.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/Platform.h"

#include <boost/filesystem/operations.hpp>
#include <boost/system/system_error.hpp>

#include <iterator>
#include <map>
#include <mutex>
#include <set>
#include <string>

namespace FileSystemWatcher
{
namespace
{

/// All that may change: names, attributes, sizes, times, security; and extended attributes, which wine refuses.
constexpr DWORD c_AllChanges = 511;
constexpr DWORD c_NamedChanges = c_AllChanges & ~0x80u;
/// Ends the wait; watches count from 1.
constexpr ULONG_PTR c_StopKey = 0;

[[noreturn]] void Throw()
{
	throw boost::system::system_error(int(::GetLastError()), boost::system::system_category(), c_pMonitorFailure);
}

std::string ErrorText(DWORD i_Error)
{
	return boost::system::system_category().message(int(i_Error));
}

/// A directory with the read that the system holds on its buffer.
struct VRead
{
	~VRead()
	{
		if (m_Directory != INVALID_HANDLE_VALUE)
			::CloseHandle(m_Directory);
	}

	bool Arm() { return Arm(c_AllChanges) || (::GetLastError() == ERROR_INVALID_PARAMETER && Arm(c_NamedChanges)); }
	bool Arm(DWORD i_Changes)
	{
		m_Overlapped = {};
		return ::ReadDirectoryChangesW(
		    m_Directory, m_Buffer, sizeof(m_Buffer), FALSE, i_Changes, nullptr, &m_Overlapped, nullptr);
	}

	/// What is gone cannot be asked any more whether it was a directory.
	void LearnDirectories()
	{
		m_Directories.clear();
		boost::system::error_code error;
		for (boost::filesystem::directory_iterator it(m_Path, error), end; !error && it != end; it.increment(error))
			if (boost::system::error_code unknown; boost::filesystem::is_directory(it->status(unknown)))
				m_Directories.insert(it->path().filename().native());
	}

	/// Whether an event is of a directory: one that came and was gone again before it was asked is taken for a file.
	bool Learn(EFileChange i_Change, const std::wstring& i_rName)
	{
		if (i_Change == ERemoved || i_Change == ERenamedOld)
			return m_Directories.erase(i_rName) > 0;
		boost::system::error_code error;
		if (boost::filesystem::is_directory(m_Path / i_rName, error))
			return m_Directories.insert(i_rName), true;
		// It may have gone again.
		return m_Directories.contains(i_rName);
	}

	boost::filesystem::path m_Path;
	std::set<std::wstring> m_Directories;
	HANDLE m_Directory = INVALID_HANDLE_VALUE;
	OVERLAPPED m_Overlapped = {};
	alignas(DWORD) char m_Buffer[1024];
	bool m_bRemoved = false;
};

class VCompletionPortMonitor final : public IDirectoryMonitor
{
public:
	VCompletionPortMonitor() : m_Port(::CreateIoCompletionPort(INVALID_HANDLE_VALUE, nullptr, c_StopKey, 1))
	{
		if (!m_Port)
			Throw();
	}

	~VCompletionPortMonitor() override
	{
		// A buffer must stay until the system has let go of it: closing the directory completes its read.
		std::size_t open = 0;
		for (auto& [watch, rpRead] : m_Reads)
		{
			::CancelIoEx(rpRead->m_Directory, &rpRead->m_Overlapped);
			++open;
		}
		while (open > 0)
		{
			DWORD bytes = 0;
			ULONG_PTR key = c_StopKey;
			OVERLAPPED* pOverlapped = nullptr;
			::GetQueuedCompletionStatus(m_Port, &bytes, &key, &pOverlapped, INFINITE);
			if (pOverlapped)
				--open;
		}
		::CloseHandle(m_Port);
	}

	int Add(const boost::filesystem::path& i_rDirectory) override
	{
		auto pRead = std::make_unique<VRead>();
		pRead->m_Path = i_rDirectory;
		pRead->m_Directory = ::CreateFileW(UtilsFileSystem::Platform::NativePath(i_rDirectory).c_str(),
		    FILE_LIST_DIRECTORY, FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr, OPEN_EXISTING,
		    FILE_FLAG_BACKUP_SEMANTICS | FILE_FLAG_OVERLAPPED, nullptr);
		if (pRead->m_Directory == INVALID_HANDLE_VALUE)
			Throw();
		// The system opens files so, too.
		if (boost::system::error_code error; !boost::filesystem::is_directory(i_rDirectory, error))
			throw boost::system::system_error(make_error_code(boost::system::errc::not_a_directory), c_pMonitorFailure);
		const std::lock_guard lock(m_Mutex);
		const int watch = ++m_LastWatch;
		if (!::CreateIoCompletionPort(pRead->m_Directory, m_Port, ULONG_PTR(watch), 1) || !pRead->Arm())
			Throw();
		pRead->LearnDirectories();
		m_Reads.emplace(watch, std::move(pRead));
		return watch;
	}

	void Remove(int i_Watch) override
	{
		const std::lock_guard lock(m_Mutex);
		const auto it = m_Reads.find(i_Watch);
		if (it == m_Reads.end())
			return;
		it->second->m_bRemoved = true;
		::CancelIoEx(it->second->m_Directory, &it->second->m_Overlapped);
	}

	bool Wait(std::vector<VSystemEvent>& o_rEvents) override
	{
		o_rEvents.clear();
		while (o_rEvents.empty())
		{
			DWORD bytes = 0;
			ULONG_PTR key = c_StopKey;
			OVERLAPPED* pOverlapped = nullptr;
			const BOOL bDone = ::GetQueuedCompletionStatus(m_Port, &bytes, &key, &pOverlapped, INFINITE);
			const DWORD error = bDone ? ERROR_SUCCESS : ::GetLastError();
			if (!pOverlapped)
				return false;
			Complete(int(key), bytes, error, o_rEvents);
		}
		return true;
	}

	void Stop() override { ::PostQueuedCompletionStatus(m_Port, 0, c_StopKey, nullptr); }

private:
	void Complete(int i_Watch, DWORD i_Bytes, DWORD i_Error, std::vector<VSystemEvent>& io_rEvents)
	{
		const std::lock_guard lock(m_Mutex);
		const auto it = m_Reads.find(i_Watch);
		if (it == m_Reads.end())
			return;
		VRead& rRead = *it->second;
		if (rRead.m_bRemoved)
		{
			m_Reads.erase(it);
			return;
		}
		if (i_Error == ERROR_SUCCESS && i_Bytes > 0)
			Translate(i_Watch, rRead, io_rEvents);
		else if (i_Error == ERROR_SUCCESS || i_Error == ERROR_NOTIFY_ENUM_DIR)
		{
			rRead.LearnDirectories();
			io_rEvents.push_back(Failure(i_Watch, "too many changes at once, some are lost", false));
		}
		else
		{
			io_rEvents.push_back(Failure(i_Watch, ErrorText(i_Error), true));
			m_Reads.erase(it);
			return;
		}
		if (!rRead.Arm())
		{
			io_rEvents.push_back(Failure(i_Watch, ErrorText(::GetLastError()), true));
			m_Reads.erase(it);
		}
	}

	static VSystemEvent Failure(int i_Watch, const std::string& i_rText, bool i_bEnded)
	{
		VSystemEvent event;
		event.m_Watch = i_Watch;
		event.m_Error = i_rText;
		event.m_bEnded = i_bEnded;
		return event;
	}

	/// The system's kinds have our numbers, and it tells a rename as old and new name in a row.
	static void Translate(int i_Watch, VRead& io_rRead, std::vector<VSystemEvent>& io_rEvents)
	{
		const char* p = io_rRead.m_Buffer;
		for (;;)
		{
			const auto* const pInformation = reinterpret_cast<const FILE_NOTIFY_INFORMATION*>(p);
			const std::wstring name(pInformation->FileName, pInformation->FileNameLength / sizeof(wchar_t));
			VSystemEvent event;
			event.m_Watch = i_Watch;
			event.m_Change = EFileChange(pInformation->Action);
			event.m_Name = UtilsFileSystem::ToUtf8(name);
			event.m_bDirectory = io_rRead.Learn(event.m_Change, name);
			// One that came and was renamed at once.
			if (event.m_Change == ERenamedNew && !io_rEvents.empty() && io_rEvents.back().m_Change == ERenamedOld)
				io_rEvents.back().m_bDirectory = event.m_bDirectory;
			io_rEvents.push_back(std::move(event));
			if (pInformation->NextEntryOffset == 0)
				return;
			p += pInformation->NextEntryOffset;
		}
	}

	const HANDLE m_Port;
	std::mutex m_Mutex;
	int m_LastWatch = 0;
	std::map<int, std::unique_ptr<VRead>> m_Reads;
};

} // namespace

std::unique_ptr<IDirectoryMonitor> MakeDirectoryMonitor()
{
	return std::make_unique<VCompletionPortMonitor>();
}

} // namespace FileSystemWatcher
