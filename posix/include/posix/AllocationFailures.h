#pragma once
// Allocation failures on demand, so tests can drive the out-of-memory paths.
// The switch is per thread: a test arms it on the thread that then calls the
// code under test, and other threads allocate as usual.

namespace posix
{
// Lets the next skipCount allocations succeed, then fails the failCount
// allocations after them. failCount 0 switches the failures off.
void SetAllocationFailuresForTesting(int skipCount, int failCount);

// Asked by an allocator before each allocation: true when this one is to
// fail. Counts the allocation.
bool AllocationShouldFail();

// True while failures are still to come; caches step aside then.
bool AllocationFailuresArmed();
} // namespace posix
