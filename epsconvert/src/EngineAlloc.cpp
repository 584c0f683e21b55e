#include "EngineAlloc.h"

#include <cstdlib>

#include "EngineMessages.h"

namespace
{
// Only tests arm this, from the thread that then calls the engine.
thread_local int allocationsToSkip = 0;
thread_local int allocationsToFail = 0;
} // namespace

void* EngineAlloc(size_t size)
{
    if (allocationsToFail > 0)
    {
        if (allocationsToSkip > 0)
            --allocationsToSkip;
        else
        {
            --allocationsToFail;
            return nullptr;
        }
    }
    return std::malloc(size);
}

void EngineFree(void* block)
{
    std::free(block);
}

void SetEngineAllocFailuresForTesting(int skipCount, int failCount)
{
    allocationsToSkip = skipCount;
    allocationsToFail = failCount;
}

char* AllocateWorkBuffer(size_t largest, size_t* size)
{
    static const struct
    {
        size_t size;
        const char* failure;
    } steps[] = {
        {1048576, "1MB not available from malloc; trying smaller amount\n"},
        {65536, "64KB not available from malloc; trying smaller amount\n"},
        {4096, "4KB not available from malloc; trying smaller amount\n"},
        // The copy routine's words, also when the line buffer fails: callers match on it.
        {256, "Even 256 bytes not available for copy buffer in ExtractEPSfromTIFFpreview\n"},
    };
    for (const auto& step : steps)
    {
        if (step.size > largest)
            continue;
        if (char* buffer = static_cast<char*>(EngineAlloc(step.size)))
        {
            *size = step.size;
            return buffer;
        }
        WriteEngineMessage(step.failure);
    }
    *size = 0;
    return nullptr;
}
