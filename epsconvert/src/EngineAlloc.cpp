#include "EngineAlloc.h"

#include <cstdlib>

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
