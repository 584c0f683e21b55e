#include "MacMemory.h"

#include <cstdlib>

namespace
{
thread_local int16_t lastError = noErr;
bool failNext = false;
} // namespace

void* NewPtr(size_t size)
{
    void* block = failNext ? nullptr : std::malloc(size);
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

void SetNewPtrFailureForTesting(bool fail)
{
    failNext = fail;
}
