#pragma once
// Stand-ins for the classic pointer allocator: a block or null, with the
// error code of the last call kept for MemError. Tests make allocations fail
// with posix::SetAllocationFailuresForTesting.
#include <cstddef>
#include <cstdint>

constexpr int16_t noErr = 0;
constexpr int16_t paramErr = -50;
constexpr int16_t memFullErr = -108;

void* NewPtr(size_t size);
void DisposePtr(void* block);
int16_t MemError();
