#include "Allocations.h"

#include <cstdlib>
#include <new>

static thread_local std::size_t g_Allocations = 0;

std::size_t AllocationCount()
{
	return g_Allocations;
}

#if defined(__has_feature)
#if __has_feature(thread_sanitizer)
#define COUNTS_NOTHING
#endif
#endif
#ifndef COUNTS_NOTHING

namespace
{

void* Allocate(std::size_t i_Size)
{
	++g_Allocations;
	if (void* pMemory = std::malloc(i_Size ? i_Size : 1))
		return pMemory;
	throw std::bad_alloc();
}

} // namespace

void* operator new(std::size_t i_Size)
{
	return Allocate(i_Size);
}
void* operator new[](std::size_t i_Size)
{
	return Allocate(i_Size);
}
// The software renderer's compiler allocates with these, and frees with those below.
void* operator new(std::size_t i_Size, const std::nothrow_t&) noexcept
{
	return std::malloc(i_Size ? i_Size : 1);
}
void* operator new[](std::size_t i_Size, const std::nothrow_t&) noexcept
{
	return std::malloc(i_Size ? i_Size : 1);
}
void operator delete(void* i_pMemory) noexcept
{
	std::free(i_pMemory);
}
void operator delete[](void* i_pMemory) noexcept
{
	std::free(i_pMemory);
}
void operator delete(void* i_pMemory, std::size_t) noexcept
{
	std::free(i_pMemory);
}
void operator delete[](void* i_pMemory, std::size_t) noexcept
{
	std::free(i_pMemory);
}

#endif
