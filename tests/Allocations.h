#pragma once

#include <cstddef>

/// How often this thread has asked for memory. Counts in programs that Allocations.cpp is part of, but not
/// where ThreadSanitizer allocates.
std::size_t AllocationCount();
