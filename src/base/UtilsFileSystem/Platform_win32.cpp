#include <windows.h>
// After windows.h, which it needs.
#include <restartmanager.h>

#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/Platform.h"

#include <boost/filesystem/detail/utf8_codecvt_facet.hpp>
#include <boost/filesystem/operations.hpp>
#include <boost/system/error_code.hpp>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <io.h>
#include <iterator>
#include <locale>
#include <utility>

namespace UtilsFileSystem
{
namespace
{

/// Boost's default is whatever code page the system was set up with.
[[maybe_unused]] const std::locale s_Before =
    boost::filesystem::path::imbue(std::locale(std::locale(), new boost::filesystem::detail::utf8_codecvt_facet));

} // namespace

boost::filesystem::path PathFromUtf8(const std::string& i_rText)
{
	const int size = ::MultiByteToWideChar(CP_UTF8, 0, i_rText.data(), int(i_rText.size()), nullptr, 0);
	std::wstring wide(size, L'\0');
	::MultiByteToWideChar(CP_UTF8, 0, i_rText.data(), int(i_rText.size()), wide.data(), size);
	return wide;
}

std::string ToUtf8(const boost::filesystem::path& i_rPath)
{
	const std::wstring& rWide = i_rPath.native();
	const int size = ::WideCharToMultiByte(CP_UTF8, 0, rWide.data(), int(rWide.size()), nullptr, 0, nullptr, nullptr);
	std::string text(size, '\0');
	::WideCharToMultiByte(CP_UTF8, 0, rWide.data(), int(rWide.size()), text.data(), size, nullptr, nullptr);
	return text;
}

namespace Platform
{
namespace
{

/// A handle that is closed when it goes.
class VHandle
{
public:
	explicit VHandle(HANDLE i_Handle) : m_Handle(i_Handle == INVALID_HANDLE_VALUE ? nullptr : i_Handle) {}
	~VHandle() { Close(); }
	VHandle(const VHandle&) = delete;
	VHandle& operator=(const VHandle&) = delete;

	explicit operator bool() const { return m_Handle != nullptr; }
	HANDLE Get() const { return m_Handle; }
	HANDLE Release() { return std::exchange(m_Handle, nullptr); }
	/// @return 0 or an error of the system.
	int Close() { return !m_Handle || ::CloseHandle(Release()) ? 0 : int(::GetLastError()); }

private:
	HANDLE m_Handle;
};

std::uint64_t ToNumber(const FILETIME& i_rTime)
{
	return std::uint64_t(i_rTime.dwHighDateTime) << 32 | i_rTime.dwLowDateTime;
}

class VProcess final : public IProcess
{
public:
	explicit VProcess(HANDLE i_Handle) : m_Handle(i_Handle) {}

	bool GetStartTime(std::uint64_t& o_rTime) override
	{
		FILETIME created, exited, kernel, user;
		if (!::GetProcessTimes(m_Handle.Get(), &created, &exited, &kernel, &user))
			return false;
		o_rTime = ToNumber(created);
		return true;
	}

	bool GetImagePath(std::string& o_rPath) override
	{
		wchar_t path[1024];
		DWORD size = DWORD(std::size(path));
		if (!::QueryFullProcessImageNameW(m_Handle.Get(), 0, path, &size))
			return false;
		o_rPath = ToUtf8(std::wstring(path, size));
		return true;
	}

private:
	VHandle m_Handle;
};

class VProcessTable final : public IProcessTable
{
public:
	bool FindHolders(const boost::filesystem::path& i_rPath, std::vector<VLockHolder>& o_rHolders) override
	{
		DWORD session = 0;
		wchar_t key[CCH_RM_SESSION_KEY + 1] = {};
		if (::RmStartSession(&session, 0, key) != ERROR_SUCCESS)
			return false;
		const std::wstring native = NativePath(i_rPath);
		const wchar_t* const pFile = native.c_str();
		RM_PROCESS_INFO processes[c_MaximumHolders];
		UINT needed = 0;
		UINT count = UINT(std::size(processes));
		DWORD reasons = 0;
		const bool bListed =
		    ::RmRegisterResources(session, 1, const_cast<LPCWSTR*>(&pFile), 0, nullptr, 0, nullptr) == ERROR_SUCCESS
		    && ::RmGetList(session, &needed, &count, processes, &reasons) == ERROR_SUCCESS;
		for (UINT i = 0; bListed && i < count; ++i)
			o_rHolders.push_back({processes[i].Process.dwProcessId, ToNumber(processes[i].Process.ProcessStartTime)});
		::RmEndSession(session);
		return bListed;
	}

	std::unique_ptr<IProcess> Open(std::uint32_t i_ProcessId) override
	{
		const HANDLE handle = ::OpenProcess(PROCESS_QUERY_LIMITED_INFORMATION, FALSE, i_ProcessId);
		return handle ? std::make_unique<VProcess>(handle) : nullptr;
	}
};

/// The C runtime's number for the last error of the system, which is kept for IsSharingViolation.
int RuntimeError()
{
	const DWORD error = ::GetLastError();
	_doserrno = error;
	switch (error)
	{
	case ERROR_FILE_NOT_FOUND:
	case ERROR_PATH_NOT_FOUND: return ENOENT;
	case ERROR_SHARING_VIOLATION:
	case ERROR_LOCK_VIOLATION:
	case ERROR_ACCESS_DENIED: return EACCES;
	case ERROR_DISK_FULL: return ENOSPC;
	default: return EIO;
	}
}

int WriteAll(HANDLE i_File, std::string_view i_Bytes)
{
	constexpr std::size_t c_Step = 64u << 20;
	while (!i_Bytes.empty())
	{
		const DWORD part = DWORD(std::min(i_Bytes.size(), c_Step));
		DWORD written = 0;
		if (!::WriteFile(i_File, i_Bytes.data(), part, &written, nullptr))
			return int(::GetLastError());
		if (written == 0)
			return ERROR_WRITE_FAULT;
		i_Bytes.remove_prefix(written);
	}
	return ::FlushFileBuffers(i_File) ? 0 : int(::GetLastError());
}

int CopyRights(const std::wstring& i_rTo, const std::wstring& i_rModel)
{
	DWORD size = 0;
	::GetFileSecurityW(i_rModel.c_str(), DACL_SECURITY_INFORMATION, nullptr, 0, &size);
	std::string descriptor(size, '\0');
	const bool bCopied = ::GetFileSecurityW(i_rModel.c_str(), DACL_SECURITY_INFORMATION, descriptor.data(), size, &size)
	    && ::SetFileSecurityW(i_rTo.c_str(), DACL_SECURITY_INFORMATION, descriptor.data());
	return bCopied ? 0 : int(::GetLastError());
}

} // namespace

std::shared_ptr<IProcessTable> GetProcessTable()
{
	return std::make_shared<VProcessTable>();
}

std::uint32_t ProcessId()
{
	return ::GetCurrentProcessId();
}

bool IsProcessGone(std::uint32_t i_ProcessId)
{
	const VHandle process(::OpenProcess(SYNCHRONIZE, FALSE, i_ProcessId));
	if (!process)
		return ::GetLastError() == ERROR_INVALID_PARAMETER;
	return ::WaitForSingleObject(process.Get(), 0) == WAIT_OBJECT_0;
}

std::string MachineName()
{
	char name[MAX_COMPUTERNAME_LENGTH + 1] = {};
	DWORD size = sizeof(name);
	return ::GetComputerNameA(name, &size) ? name : "";
}

std::wstring NativePath(const boost::filesystem::path& i_rPath)
{
	boost::system::error_code error;
	boost::filesystem::path full = boost::filesystem::absolute(i_rPath, error).lexically_normal();
	// Of a slash at the end; behind the prefix it would be a name.
	if (full.filename_is_dot())
		full = full.parent_path();
	return error ? i_rPath.native() : AddLongPathPrefix(full.native(), MAX_PATH);
}

std::FILE* Open(const boost::filesystem::path& i_rPath, const char* i_pMode, int& o_rError)
{
	const std::wstring mode(i_pMode, i_pMode + std::char_traits<char>::length(i_pMode));
	std::FILE* pFile = nullptr;
	o_rError = ::_wfopen_s(&pFile, NativePath(i_rPath).c_str(), mode.c_str());
	return o_rError == 0 ? pFile : nullptr;
}

std::FILE* OpenRegular(const boost::filesystem::path& i_rPath, int& o_rError)
{
	std::FILE* const pFile = Open(i_rPath, "rb", o_rError);
	const HANDLE handle = pFile ? reinterpret_cast<HANDLE>(::_get_osfhandle(::_fileno(pFile))) : nullptr;
	if (!pFile || ::GetFileType(handle) == FILE_TYPE_DISK)
		return pFile;
	std::fclose(pFile);
	o_rError = EINVAL;
	return nullptr;
}

bool IsSharingViolation(int i_Error)
{
	const unsigned long error = _doserrno;
	return i_Error == EACCES && (error == ERROR_SHARING_VIOLATION || error == ERROR_LOCK_VIOLATION);
}

int OpenMapped(const boost::filesystem::path& i_rPath, bool i_bWrite, std::uint64_t i_Size, VMapped& o_rMapped)
{
	VHandle file(::CreateFileW(NativePath(i_rPath).c_str(), i_bWrite ? GENERIC_READ | GENERIC_WRITE : GENERIC_READ,
	    i_bWrite ? 0 : FILE_SHARE_READ, nullptr, i_bWrite ? CREATE_ALWAYS : OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL,
	    nullptr));
	if (!file)
		return RuntimeError();
	LARGE_INTEGER size = {};
	size.QuadPart = LONGLONG(i_Size);
	if (!i_bWrite && !::GetFileSizeEx(file.Get(), &size))
		return RuntimeError();
	// An empty file has no mapping.
	HANDLE mapping = nullptr;
	if (size.QuadPart > 0)
	{
		mapping = ::CreateFileMappingW(file.Get(), nullptr, i_bWrite ? PAGE_READWRITE : PAGE_READONLY,
		    DWORD(size.HighPart), size.LowPart, nullptr);
		if (!mapping)
			return RuntimeError();
	}
	o_rMapped = {reinterpret_cast<std::intptr_t>(file.Release()), reinterpret_cast<std::intptr_t>(mapping),
	    std::uint64_t(size.QuadPart), i_bWrite};
	return 0;
}

void* MapView(const VMapped& i_rMapped, std::uint64_t i_Offset, std::size_t i_Length)
{
	return ::MapViewOfFile(reinterpret_cast<HANDLE>(i_rMapped.m_Mapping),
	    i_rMapped.m_bWrite ? FILE_MAP_WRITE : FILE_MAP_READ, DWORD(i_Offset >> 32), DWORD(i_Offset), i_Length);
}

std::size_t CopyFromView(const char* i_pBytes, std::size_t i_Count, void* o_pBytes)
{
	// A file that is mapped cannot be cut short here.
	std::memcpy(o_pBytes, i_pBytes, i_Count);
	return i_Count;
}

void UnmapView(void* i_pView, std::size_t)
{
	::UnmapViewOfFile(i_pView);
}

void CloseMapped(VMapped& io_rMapped)
{
	if (io_rMapped.m_Mapping != 0)
		::CloseHandle(reinterpret_cast<HANDLE>(io_rMapped.m_Mapping));
	if (io_rMapped.m_File != -1)
		::CloseHandle(reinterpret_cast<HANDLE>(io_rMapped.m_File));
	io_rMapped = {};
}

std::size_t GetMappingGranularity()
{
	SYSTEM_INFO info = {};
	::GetSystemInfo(&info);
	return info.dwAllocationGranularity;
}

int WriteNewFile(
    const boost::filesystem::path& i_rPath, std::string_view i_Bytes, const boost::filesystem::path* i_pModel)
{
	const std::wstring native = NativePath(i_rPath);
	VHandle file(::CreateFileW(native.c_str(), GENERIC_WRITE, 0, nullptr, CREATE_NEW, FILE_ATTRIBUTE_NORMAL, nullptr));
	if (!file)
		return int(::GetLastError());
	int failure = WriteAll(file.Get(), i_Bytes);
	if (const int closing = file.Close(); failure == 0)
		failure = closing;
	if (failure == 0 && i_pModel)
		failure = CopyRights(native, NativePath(*i_pModel));
	if (failure != 0)
		::DeleteFileW(native.c_str());
	return failure;
}

bool IsReadOnly(const boost::filesystem::path& i_rFile)
{
	const DWORD attributes = ::GetFileAttributesW(NativePath(i_rFile).c_str());
	return attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_READONLY) != 0;
}

int Replace(const boost::filesystem::path& i_rFrom, const boost::filesystem::path& i_rTo)
{
	return ::MoveFileExW(NativePath(i_rFrom).c_str(), NativePath(i_rTo).c_str(),
	           MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH)
	    ? 0
	    : int(::GetLastError());
}

int SyncFolder(const boost::filesystem::path&)
{
	// The move itself waits for the disk.
	return 0;
}

void Unlink(const wchar_t* i_pNative) noexcept
{
	::DeleteFileW(i_pNative);
}

std::string ErrorText(int i_Error)
{
	return boost::system::system_category().message(i_Error);
}

} // namespace Platform
} // namespace UtilsFileSystem
