#include "MacMemory.h"

#include <cstdlib>

#include "posix/AllocationFailures.h"

namespace
{
thread_local int16_t lastError = noErr;
} // namespace

void* NewPtr(size_t size)
{
    void* block = posix::AllocationShouldFail() ? nullptr : std::malloc(size);
    lastError = block ? noErr : memFullErr;
    return block;
}

void DisposePtr(void* block)
{
    std::free(block);
    lastError = noErr;
}

int16_t MemError()
{
    return lastError;
}
