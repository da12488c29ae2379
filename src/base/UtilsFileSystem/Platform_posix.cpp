#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/Platform.h"

#include <boost/system/error_code.hpp>

#include <cerrno>
#include <csignal>
#include <dirent.h>
#include <fcntl.h>
#include <pthread.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <sys/sysmacros.h>
#include <sys/uio.h>
#include <time.h>
#include <unistd.h>

#include <algorithm>
#include <charconv>
#include <cstring>
#include <fstream>
#include <sstream>
#include <utility>

namespace UtilsFileSystem
{

boost::filesystem::path PathFromUtf8(const std::string& i_rText)
{
	return i_rText;
}

std::string ToUtf8(const boost::filesystem::path& i_rPath)
{
	return i_rPath.native();
}

namespace Platform
{
namespace
{

/// A descriptor that is closed when it goes.
class VDescriptor
{
public:
	explicit VDescriptor(int i_Descriptor) : m_Descriptor(i_Descriptor) {}
	~VDescriptor() { Close(); }
	VDescriptor(const VDescriptor&) = delete;
	VDescriptor& operator=(const VDescriptor&) = delete;

	explicit operator bool() const { return m_Descriptor >= 0; }
	int Get() const { return m_Descriptor; }
	int Release() { return std::exchange(m_Descriptor, -1); }
	/// @return 0 or an error.
	int Close() { return m_Descriptor < 0 || ::close(Release()) == 0 ? 0 : errno; }

private:
	int m_Descriptor;
};

/// One process through its folder in /proc: the open folder never comes to mean another process.
class VProcess final : public IProcess
{
public:
	explicit VProcess(int i_Folder) : m_Folder(i_Folder) {}

	bool GetStartTime(std::uint64_t& o_rTime) override
	{
		const VDescriptor file(::openat(m_Folder.Get(), "stat", O_RDONLY | O_CLOEXEC));
		char text[1024];
		const ssize_t size = file ? ::read(file.Get(), text, sizeof(text)) : -1;
		if (size <= 0)
			return false;
		// The program's name, which may hold anything, ends at the last bracket; the start time is the twentieth field
		// after it (proc(5), field 22 of stat).
		std::string_view rest(text, size);
		rest.remove_prefix(std::min(rest.size(), rest.rfind(')') + 1));
		for (int field = 0; field < 20; ++field)
			rest.remove_prefix(std::min(rest.size(), rest.find(' ') + 1));
		return std::from_chars(rest.data(), rest.data() + rest.size(), o_rTime).ec == std::errc();
	}

	bool GetImagePath(std::string& o_rPath) override
	{
		char path[4096];
		const ssize_t size = ::readlinkat(m_Folder.Get(), "exe", path, sizeof(path));
		if (size <= 0 || size == sizeof(path))
			return false;
		o_rPath.assign(path, size);
		return true;
	}

private:
	VDescriptor m_Folder;
};

/// Linux lists who has locked a file, and a file that cannot be written because it is a running program is found among
/// the programs.
class VProcessTable final : public IProcessTable
{
public:
	bool FindHolders(const boost::filesystem::path& i_rPath, std::vector<VLockHolder>& o_rHolders) override
	{
		struct stat file = {};
		if (::stat(i_rPath.c_str(), &file) != 0)
			return false;
		const bool bLocks = FindInLocks(file, o_rHolders);
		return FindInPrograms(file, o_rHolders) || bLocks;
	}

	std::unique_ptr<IProcess> Open(std::uint32_t i_ProcessId) override
	{
		const std::string folder = "/proc/" + std::to_string(i_ProcessId);
		const int descriptor = ::open(folder.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC);
		return descriptor < 0 ? nullptr : std::make_unique<VProcess>(descriptor);
	}

private:
	void Add(std::uint32_t i_ProcessId, std::vector<VLockHolder>& io_rHolders)
	{
		const auto same = [=](const VLockHolder& i_rHolder) { return i_rHolder.m_ProcessId == i_ProcessId; };
		VLockHolder holder{i_ProcessId};
		const std::unique_ptr<IProcess> pProcess = Open(i_ProcessId);
		if (pProcess && pProcess->GetStartTime(holder.m_StartTime)
		    && std::none_of(io_rHolders.begin(), io_rHolders.end(), same))
			io_rHolders.push_back(holder);
	}

	/// Lines as "1: POSIX ADVISORY WRITE 123 fe:00:456 0 EOF"; those with "->" only wait, and a lock that belongs to an
	/// open file has the id -1 (proc(5)).
	bool FindInLocks(const struct stat& i_rFile, std::vector<VLockHolder>& io_rHolders)
	{
		char place[64];
		std::snprintf(place, sizeof(place), "%02x:%02x:%llu", major(i_rFile.st_dev), minor(i_rFile.st_dev),
		    static_cast<unsigned long long>(i_rFile.st_ino));
		std::ifstream locks("/proc/locks");
		std::string number, kind, how, mode, id, where, rest;
		while (locks >> number >> kind && std::getline(locks, rest))
		{
			std::istringstream line(rest);
			std::uint32_t processId = 0;
			if (kind != "->" && line >> how >> mode >> id >> where && where == place
			    && std::from_chars(id.data(), id.data() + id.size(), processId).ec == std::errc())
				Add(processId, io_rHolders);
		}
		return locks.eof();
	}

	bool FindInPrograms(const struct stat& i_rFile, std::vector<VLockHolder>& io_rHolders)
	{
		DIR* const pFolder = ::opendir("/proc");
		if (!pFolder)
			return false;
		while (const dirent* const pEntry = ::readdir(pFolder))
		{
			const std::string_view name = pEntry->d_name;
			std::uint32_t processId = 0;
			struct stat program = {};
			if (std::from_chars(name.data(), name.data() + name.size(), processId).ec == std::errc()
			    && ::stat(("/proc/" + std::string(name) + "/exe").c_str(), &program) == 0
			    && program.st_dev == i_rFile.st_dev && program.st_ino == i_rFile.st_ino)
				Add(processId, io_rHolders);
		}
		::closedir(pFolder);
		return true;
	}
};

/// Keeps the signal of a file size limit from ending the process: the write then fails as on a full disk.
class VSizeSignalBlock
{
public:
	VSizeSignalBlock()
	{
		sigemptyset(&m_Signal);
		sigaddset(&m_Signal, SIGXFSZ);
		pthread_sigmask(SIG_BLOCK, &m_Signal, &m_Before);
	}
	~VSizeSignalBlock()
	{
		if (sigismember(&m_Before, SIGXFSZ))
			return;
		const timespec c_AtOnce = {};
		while (sigtimedwait(&m_Signal, nullptr, &c_AtOnce) == -1 && errno == EINTR)
			;
		pthread_sigmask(SIG_SETMASK, &m_Before, nullptr);
	}
	VSizeSignalBlock(const VSizeSignalBlock&) = delete;
	VSizeSignalBlock& operator=(const VSizeSignalBlock&) = delete;

private:
	sigset_t m_Signal;
	sigset_t m_Before;
};

int WriteAll(int i_Descriptor, std::string_view i_Bytes)
{
	const VSizeSignalBlock block;
	while (!i_Bytes.empty())
	{
		const ssize_t written = ::write(i_Descriptor, i_Bytes.data(), i_Bytes.size());
		if (written < 0 && errno == EINTR)
			continue;
		if (written <= 0)
			return written < 0 ? errno : EIO;
		i_Bytes.remove_prefix(written);
	}
	return ::fsync(i_Descriptor) == 0 ? 0 : errno;
}

/// The owner is kept where this process may give files away; the rights are kept or it is an error.
int CopyRights(int i_Descriptor, const boost::filesystem::path& i_rModel)
{
	struct stat model = {};
	if (::lstat(i_rModel.c_str(), &model) != 0)
		return errno;
	// Links were followed before: this one came since, and what it leads to is not what is saved.
	if (S_ISLNK(model.st_mode))
		return ELOOP;
	const bool bOwner = ::fchown(i_Descriptor, model.st_uid, model.st_gid) == 0;
	const bool bGroup = bOwner || ::fchown(i_Descriptor, uid_t(-1), model.st_gid) == 0;
	// With another owner, the marks that run a program as its owner must not stay.
	return ::fchmod(i_Descriptor, model.st_mode & (bOwner && bGroup ? 07777 : 0777)) == 0 ? 0 : errno;
}

} // namespace

std::shared_ptr<IProcessTable> GetProcessTable()
{
	return std::make_shared<VProcessTable>();
}

std::uint32_t ProcessId()
{
	return std::uint32_t(::getpid());
}

bool IsProcessGone(std::uint32_t i_ProcessId)
{
	// 0 and negative numbers would mean groups of processes.
	return pid_t(i_ProcessId) > 0 && ::kill(pid_t(i_ProcessId), 0) != 0 && errno == ESRCH;
}

std::string MachineName()
{
	char name[256] = {};
	return ::gethostname(name, sizeof(name) - 1) == 0 ? name : "";
}

boost::filesystem::path::string_type NativePath(const boost::filesystem::path& i_rPath)
{
	return i_rPath.native();
}

std::FILE* Open(const boost::filesystem::path& i_rPath, const char* i_pMode, int& o_rError)
{
	std::FILE* const pFile = std::fopen(i_rPath.c_str(), i_pMode);
	o_rError = pFile ? 0 : errno;
	struct stat about = {};
	if (!pFile || ::fstat(::fileno(pFile), &about) != 0 || !S_ISDIR(about.st_mode))
		return pFile;
	std::fclose(pFile);
	o_rError = EISDIR;
	return nullptr;
}

std::FILE* OpenRegular(const boost::filesystem::path& i_rPath, int& o_rError)
{
	VDescriptor file(::open(i_rPath.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY));
	struct stat about = {};
	if (!file || ::fstat(file.Get(), &about) != 0)
		o_rError = errno;
	else if (!S_ISREG(about.st_mode))
		o_rError = S_ISDIR(about.st_mode) ? EISDIR : EINVAL;
	else if (std::FILE* const pFile = ::fdopen(file.Get(), "rb"))
	{
		file.Release();
		o_rError = 0;
		return pFile;
	}
	else
		o_rError = errno;
	return nullptr;
}

bool IsSharingViolation(int i_Error)
{
	return i_Error == EBUSY || i_Error == ETXTBSY || i_Error == EAGAIN;
}

int OpenMapped(const boost::filesystem::path& i_rPath, bool i_bWrite, std::uint64_t i_Size, VMapped& o_rMapped)
{
	VDescriptor file(
	    ::open(i_rPath.c_str(), (i_bWrite ? O_RDWR | O_CREAT | O_TRUNC : O_RDONLY) | O_CLOEXEC | O_NONBLOCK, 0666));
	struct stat about = {};
	if (!file || ::fstat(file.Get(), &about) != 0)
		return errno;
	if (!S_ISREG(about.st_mode))
		return S_ISDIR(about.st_mode) ? EISDIR : EINVAL;
	// Room is taken now: a disk that is full later would end the process in the middle of a store.
	if (i_bWrite && i_Size > 0)
		if (const int failure = ::posix_fallocate(file.Get(), 0, i_Size))
			return failure;
	o_rMapped = {file.Release(), 0, i_bWrite ? i_Size : std::uint64_t(about.st_size), i_bWrite};
	return 0;
}

void* MapView(const VMapped& i_rMapped, std::uint64_t i_Offset, std::size_t i_Length)
{
	void* const pView = ::mmap(nullptr, i_Length, i_rMapped.m_bWrite ? PROT_READ | PROT_WRITE : PROT_READ, MAP_SHARED,
	    int(i_rMapped.m_File), off_t(i_Offset));
	return pView == MAP_FAILED ? nullptr : pView;
}

std::size_t CopyFromView(const char* i_pBytes, std::size_t i_Count, void* o_pBytes)
{
	// The kernel copies as between two processes, and finds out what is no more.
	const iovec to{o_pBytes, i_Count};
	const iovec from{const_cast<char*>(i_pBytes), i_Count};
	const ssize_t copied = ::process_vm_readv(::getpid(), &to, 1, &from, 1, 0);
	if (copied >= 0)
		return std::size_t(copied);
	if (errno == EFAULT)
		return 0;
	// Some sandboxes refuse it, and then nothing protects.
	std::memcpy(o_pBytes, i_pBytes, i_Count);
	return i_Count;
}

void UnmapView(void* i_pView, std::size_t i_Length)
{
	::munmap(i_pView, i_Length);
}

void CloseMapped(VMapped& io_rMapped)
{
	if (io_rMapped.m_File >= 0)
		::close(int(io_rMapped.m_File));
	io_rMapped = {};
}

std::size_t GetMappingGranularity()
{
	return ::sysconf(_SC_PAGESIZE);
}

int WriteNewFile(
    const boost::filesystem::path& i_rPath, std::string_view i_Bytes, const boost::filesystem::path* i_pModel)
{
	VDescriptor file(::open(i_rPath.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666));
	if (!file)
		return errno;
	int failure = i_pModel ? CopyRights(file.Get(), *i_pModel) : 0;
	if (failure == 0)
		failure = WriteAll(file.Get(), i_Bytes);
	if (const int closing = file.Close(); failure == 0)
		failure = closing;
	if (failure != 0)
		::unlink(i_rPath.c_str());
	return failure;
}

bool IsReadOnly(const boost::filesystem::path& i_rFile)
{
	// The superuser may write to any file; one without a right to write was still meant to stay as it is.
	struct stat about = {};
	return ::access(i_rFile.c_str(), W_OK) != 0
	    || (::stat(i_rFile.c_str(), &about) == 0 && (about.st_mode & (S_IWUSR | S_IWGRP | S_IWOTH)) == 0);
}

int Replace(const boost::filesystem::path& i_rFrom, const boost::filesystem::path& i_rTo)
{
	return ::rename(i_rFrom.c_str(), i_rTo.c_str()) == 0 ? 0 : errno;
}

int SyncFolder(const boost::filesystem::path& i_rFolder)
{
	const VDescriptor folder(::open(i_rFolder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
	if (!folder)
		return errno == EACCES ? 0 : errno;
	return ::fsync(folder.Get()) == 0 || errno == EINVAL || errno == ENOTSUP ? 0 : errno;
}

void Unlink(const char* i_pNative) noexcept
{
	::unlink(i_pNative);
}

std::string ErrorText(int i_Error)
{
	return boost::system::generic_category().message(i_Error);
}

} // namespace Platform
} // namespace UtilsFileSystem
