#include "posix/AllocationFailures.h"

namespace posix
{
namespace
{
thread_local int allocationsToSkip = 0;
thread_local int allocationsToFail = 0;
} // namespace

void SetAllocationFailuresForTesting(int skipCount, int failCount)
{
    allocationsToSkip = skipCount;
    allocationsToFail = failCount;
}

bool AllocationShouldFail()
{
    if (allocationsToFail <= 0)
        return false;
    if (allocationsToSkip > 0)
    {
        --allocationsToSkip;
        return false;
    }
    --allocationsToFail;
    return true;
}

bool AllocationFailuresArmed()
{
    return allocationsToFail > 0;
}
} // namespace posix
