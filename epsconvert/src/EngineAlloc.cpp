#include "EngineAlloc.h"

#include <cstdlib>
#include <utility>

#include "EngineMessages.h"
#include "posix/AllocationFailures.h"

namespace
{
// One released work buffer of up to 64 KB kept per thread: detection runs
// once for every arriving file, and a fresh 64 KB from malloc each time
// costs more than the scan of a typical header.
constexpr size_t kLargestKept = 65536;
struct KeptBuffer
{
    char* block = nullptr;
    size_t size = 0;
    ~KeptBuffer() { std::free(block); }
};
thread_local KeptBuffer kept;
} // namespace

void* EngineAlloc(size_t size)
{
    if (posix::AllocationShouldFail())
        return nullptr;
    return std::malloc(size);
}

void EngineFree(void* block)
{
    std::free(block);
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
        // A kept buffer serves a request of its own size, but never while a
        // test is making allocations fail.
        if (kept.block && kept.size == step.size && !posix::AllocationFailuresArmed())
        {
            *size = kept.size;
            return std::exchange(kept.block, nullptr);
        }
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

void ReleaseWorkBuffer(char* buffer, size_t size)
{
    if (buffer && !kept.block && size <= kLargestKept)
    {
        kept.block = buffer;
        kept.size = size;
        return;
    }
    EngineFree(buffer);
}
