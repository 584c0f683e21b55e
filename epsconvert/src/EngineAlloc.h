#pragma once
// Heap allocation for the engine's work buffers and contexts. Tests can make
// chosen allocations fail to drive each step of the buffer degrade path.
#include <cstddef>

void* EngineAlloc(size_t size);
void EngineFree(void* block);

// Lets the next skipCount allocations succeed, then fails the failCount
// allocations after them. failCount 0 switches the failures off.
void SetEngineAllocFailuresForTesting(int skipCount, int failCount);

// A work buffer that degrades rather than failing: tries largest (1 MB or
// 64 KB), then 64 KB, 4 KB and 256 bytes, writing each step's message when
// a size is not available. Null with *size 0 when even 256 bytes fail.
char* AllocateWorkBuffer(size_t largest, size_t* size);

// Gives back a buffer from AllocateWorkBuffer with the size it reported.
void ReleaseWorkBuffer(char* buffer, size_t size);
