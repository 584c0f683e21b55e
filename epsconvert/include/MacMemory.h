#pragma once
// Stand-ins for the classic pointer allocator: a block or null, with the
// error code of the last call kept for MemError.
#include <cstddef>
#include <cstdint>

constexpr int16_t noErr = 0;
constexpr int16_t paramErr = -50;
constexpr int16_t memFullErr = -108;

void* NewPtr(size_t size);
void DisposePtr(void* block);
int16_t MemError();

// Tests use this to make the next allocations fail.
void SetNewPtrFailureForTesting(bool fail);
