#pragma once
// Heap allocation for the engine's work buffers and contexts. Tests make
// chosen allocations fail (posix::SetAllocationFailuresForTesting) to drive
// each step of the buffer degrade path.
#include <cstddef>

void* EngineAlloc(size_t size);
void EngineFree(void* block);

// A work buffer that degrades rather than failing: tries largest (1 MB or
// 64 KB), then 64 KB, 4 KB and 256 bytes, writing each step's message when
// a size is not available. Null with *size 0 when even 256 bytes fail.
char* AllocateWorkBuffer(size_t largest, size_t* size);

// Gives back a buffer from AllocateWorkBuffer with the size it reported.
void ReleaseWorkBuffer(char* buffer, size_t size);
