#pragma once
// Heap allocation for the engine's work buffers and contexts. Tests can make
// chosen allocations fail to drive each step of the buffer degrade path.
#include <cstddef>

void* EngineAlloc(size_t size);
void EngineFree(void* block);

// Lets the next skipCount allocations succeed, then fails the failCount
// allocations after them. failCount 0 switches the failures off.
void SetEngineAllocFailuresForTesting(int skipCount, int failCount);
