// Preloaded into a program, lets the N-th call of a kind fail or end the program there. System calls are caught by a
// filter of the kernel's, so that those are counted which the C library makes for itself.
//
// RETARGET_FAULT holds "KIND ACTION FIRST LAST COUNTER [FOLDER]": the calls FIRST to LAST of that kind, 1 the first,
// are struck; COUNTER is a file of eight bytes in which they are counted, also beyond the program's death. ACTION is
// the number of an error, "kill", "vanish", which gives FOLDER another name and lets the call go on, or "swap", which
// first puts the link FOLDER.link in the place of FOLDER/out.qrr.

#include <cerrno>
#include <csignal>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include <fcntl.h>
#include <linux/filter.h>
#include <linux/seccomp.h>
#include <pthread.h>
#include <sys/mman.h>
#include <sys/prctl.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <ucontext.h>
#include <unistd.h>

#include <dlfcn.h>

extern "C"
{
	void* __libc_malloc(std::size_t);
	void* __libc_calloc(std::size_t, std::size_t);
	void* __libc_realloc(void*, std::size_t);
	void* __libc_memalign(std::size_t, std::size_t);

	// A system call from the one place that the filter lets through.
	long RawCall(long i_Number, long i_A, long i_B, long i_C, long i_D, long i_E, long i_F);
	extern const char c_AfterRawCall[] __attribute__((visibility("hidden")));
}

asm(R"(
	.text
	.globl RawCall
	.hidden RawCall
RawCall:
	mov %rdi, %rax
	mov %rsi, %rdi
	mov %rdx, %rsi
	mov %rcx, %rdx
	mov %r8, %r10
	mov %r9, %r8
	mov 8(%rsp), %r9
	syscall
	.globl c_AfterRawCall
	.hidden c_AfterRawCall
c_AfterRawCall:
	ret
)");

namespace
{

struct VKind
{
	const char* m_pName;
	/// Ends in -1.
	int m_Calls[32];
};

constexpr VKind c_Kinds[] = {
    {"open", {SYS_open, SYS_openat, SYS_creat, -1}},
    {"read", {SYS_read, SYS_pread64, SYS_readv, -1}},
    {"write", {SYS_write, SYS_pwrite64, SYS_writev, -1}},
    {"sync", {SYS_fsync, SYS_fdatasync, -1}},
    {"rename", {SYS_rename, SYS_renameat, SYS_renameat2, -1}},
    {"map", {SYS_mmap, -1}},
    {"file",
        {SYS_open, SYS_openat, SYS_creat, SYS_read, SYS_pread64, SYS_readv, SYS_write, SYS_pwrite64, SYS_writev,
            SYS_fsync, SYS_fdatasync, SYS_rename, SYS_renameat, SYS_renameat2, SYS_close, SYS_unlink, SYS_unlinkat,
            SYS_stat, SYS_lstat, SYS_fstat, SYS_newfstatat, SYS_statx, SYS_access, SYS_faccessat, SYS_faccessat2,
            SYS_fchmod, SYS_fchown, SYS_getdents64, SYS_readlink, SYS_ftruncate, -1}},
};

constexpr int c_Kill = -1;
constexpr int c_Vanish = -2;
constexpr int c_Swap = -3;

struct VPlan
{
	bool m_bAllocations = false;
	bool m_bThreads = false;
	int m_Action = 0;
	std::uint64_t m_First = 0;
	std::uint64_t m_Last = 0;
	/// Null while nothing is counted.
	std::uint64_t* m_pCounter = nullptr;
	/// The old and the new name of what is renamed.
	char m_From[1040] = {};
	char m_To[1040] = {};
};
VPlan s_Plan;
std::uint64_t* s_pCounter = nullptr;

/// Counts a call. @return the error that it shall fail with; 0 if it shall go on
int Strike(bool i_bWrites = false, const long* i_pArguments = nullptr)
{
	if (!s_Plan.m_pCounter)
		return 0;
	const std::uint64_t count = __atomic_add_fetch(s_Plan.m_pCounter, 1, __ATOMIC_RELAXED);
	if (count < s_Plan.m_First || count > s_Plan.m_Last)
		return 0;
	if (s_Plan.m_Action == c_Kill)
	{
		// A power cut comes in the middle of a write.
		if (i_bWrites)
			RawCall(SYS_write, i_pArguments[0], i_pArguments[1], i_pArguments[2] / 2, 0, 0, 0);
		RawCall(SYS_kill, getpid(), SIGKILL, 0, 0, 0, 0);
	}
	if (s_Plan.m_Action == c_Vanish || s_Plan.m_Action == c_Swap)
		RawCall(SYS_rename, long(s_Plan.m_From), long(s_Plan.m_To), 0, 0, 0, 0);
	return s_Plan.m_Action > 0 ? s_Plan.m_Action : 0;
}

void HandleCall(int, siginfo_t* i_pInfo, void* io_pContext)
{
	greg_t* const pRegisters = static_cast<ucontext_t*>(io_pContext)->uc_mcontext.gregs;
	const long arguments[] = {pRegisters[REG_RDI], pRegisters[REG_RSI], pRegisters[REG_RDX], pRegisters[REG_R10],
	    pRegisters[REG_R8], pRegisters[REG_R9]};
	const int call = i_pInfo->si_syscall;
	const int failure = Strike(call == SYS_write, arguments);
	pRegisters[REG_RAX] = failure
	    ? -failure
	    : RawCall(call, arguments[0], arguments[1], arguments[2], arguments[3], arguments[4], arguments[5]);
}

[[noreturn]] void GiveUp(const char* i_pText)
{
	static_cast<void>(write(STDERR_FILENO, i_pText, std::strlen(i_pText)));
	_exit(99);
}

void CatchCalls(const VKind& i_rKind)
{
	struct sigaction action = {};
	action.sa_sigaction = HandleCall;
	action.sa_flags = SA_SIGINFO | SA_NODEFER;
	sigaction(SIGSYS, &action, nullptr);

	const auto address = std::uint64_t(c_AfterRawCall);
	sock_filter filter[96];
	unsigned short size = 0;
	const auto add = [&](std::uint16_t i_Code, std::uint32_t i_Value, std::uint8_t i_Yes = 0, std::uint8_t i_No = 0) {
		filter[size++] = {i_Code, i_Yes, i_No, i_Value};
	};
	constexpr std::uint16_t c_Load = BPF_LD | BPF_W | BPF_ABS;
	constexpr std::uint16_t c_Equal = BPF_JMP | BPF_JEQ | BPF_K;
	constexpr std::uint16_t c_Return = BPF_RET | BPF_K;
	constexpr std::uint32_t c_Address = offsetof(seccomp_data, instruction_pointer);
	add(c_Load, c_Address);
	add(c_Equal, std::uint32_t(address), 0, 3);
	add(c_Load, c_Address + 4);
	add(c_Equal, std::uint32_t(address >> 32), 0, 1);
	add(c_Return, SECCOMP_RET_ALLOW);
	add(c_Load, offsetof(seccomp_data, nr));
	for (const int* pCall = i_rKind.m_Calls; *pCall >= 0; ++pCall)
	{
		add(c_Equal, std::uint32_t(*pCall), 0, 1);
		add(c_Return, SECCOMP_RET_TRAP);
		if (size + 3u > sizeof(filter) / sizeof(*filter))
			GiveUp("faults: a kind has too many calls\n");
	}
	add(c_Return, SECCOMP_RET_ALLOW);
	const sock_fprog program{size, filter};
	if (prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0) != 0 || prctl(PR_SET_SECCOMP, SECCOMP_MODE_FILTER, &program) != 0)
		GiveUp("faults: the kernel refuses the filter\n");
}

__attribute__((constructor)) void Begin()
{
	const char* const pText = std::getenv("RETARGET_FAULT");
	if (!pText)
		return;
	char text[4096] = {};
	std::strncpy(text, pText, sizeof(text) - 1);
	const char* fields[6] = {};
	char* pRest = text;
	for (const char*& rpField : fields)
		rpField = strsep(&pRest, " ");
	if (!fields[4])
		GiveUp("faults: RETARGET_FAULT has too few fields\n");
	const char* const pAction = fields[1];
	s_Plan.m_Action = std::strcmp(pAction, "kill") == 0 ? c_Kill
	    : std::strcmp(pAction, "vanish") == 0           ? c_Vanish
	    : std::strcmp(pAction, "swap") == 0             ? c_Swap
	                                                    : std::atoi(pAction);
	s_Plan.m_First = std::strtoull(fields[2], nullptr, 10);
	s_Plan.m_Last = std::strtoull(fields[3], nullptr, 10);
	if (fields[5])
	{
		const bool bSwap = s_Plan.m_Action == c_Swap;
		std::snprintf(s_Plan.m_From, sizeof(s_Plan.m_From), "%s%s", fields[5], bSwap ? ".link" : "");
		std::snprintf(s_Plan.m_To, sizeof(s_Plan.m_To), "%s%s", fields[5], bSwap ? "/out.qrr" : ".gone");
	}
	const int counter = open(fields[4], O_RDWR | O_CLOEXEC);
	void* const pCounter = mmap(nullptr, sizeof(std::uint64_t), PROT_READ | PROT_WRITE, MAP_SHARED, counter, 0);
	if (counter < 0 || pCounter == MAP_FAILED)
		GiveUp("faults: the counter cannot be opened\n");
	close(counter);
	s_Plan.m_bAllocations = std::strcmp(fields[0], "allocation") == 0;
	s_Plan.m_bThreads = std::strcmp(fields[0], "thread") == 0;
	const VKind* pKind = nullptr;
	for (const VKind& rKind : c_Kinds)
		if (std::strcmp(fields[0], rKind.m_pName) == 0)
			pKind = &rKind;
	if (!pKind && !s_Plan.m_bAllocations && !s_Plan.m_bThreads)
		GiveUp("faults: there is no such kind of call\n");
	if (pKind)
		CatchCalls(*pKind);
	s_pCounter = static_cast<std::uint64_t*>(pCounter);
	if (!std::getenv("RETARGET_FAULT_WAITS"))
		s_Plan.m_pCounter = s_pCounter;
}

/// @return false, with errno, if this allocation shall fail
bool MayAllocate()
{
	if (!s_Plan.m_bAllocations || Strike() == 0)
		return true;
	errno = ENOMEM;
	return false;
}

} // namespace

extern "C"
{
	/// With RETARGET_FAULT_WAITS in its environment a program says when what it begins with is over.
	void CountFaultsFromHere()
	{
		s_Plan.m_pCounter = s_pCounter;
	}

	void* malloc(std::size_t i_Size)
	{
		return MayAllocate() ? __libc_malloc(i_Size) : nullptr;
	}

	void* calloc(std::size_t i_Count, std::size_t i_Size)
	{
		return MayAllocate() ? __libc_calloc(i_Count, i_Size) : nullptr;
	}

	void* realloc(void* io_pBytes, std::size_t i_Size)
	{
		return MayAllocate() ? __libc_realloc(io_pBytes, i_Size) : nullptr;
	}

	void* memalign(std::size_t i_Alignment, std::size_t i_Size)
	{
		return MayAllocate() ? __libc_memalign(i_Alignment, i_Size) : nullptr;
	}

	void* aligned_alloc(std::size_t i_Alignment, std::size_t i_Size)
	{
		return memalign(i_Alignment, i_Size);
	}

	int posix_memalign(void** o_ppBytes, std::size_t i_Alignment, std::size_t i_Size)
	{
		*o_ppBytes = memalign(i_Alignment, i_Size);
		return *o_ppBytes ? 0 : ENOMEM;
	}

	int pthread_create(pthread_t* o_pThread, const pthread_attr_t* i_pAttributes, void* (*i_pRun)(void*), void* i_pData)
	{
		static const auto s_pCreate = reinterpret_cast<decltype(&pthread_create)>(dlsym(RTLD_NEXT, "pthread_create"));
		const int failure = s_Plan.m_bThreads ? Strike() : 0;
		return failure ? failure : s_pCreate(o_pThread, i_pAttributes, i_pRun, i_pData);
	}
}
