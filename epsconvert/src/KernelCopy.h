#pragma once
// Copies a byte range of one regular file to the end of another without
// passing the bytes through user space.
#include <cstdio>

// Copies length bytes from offset of in to the end of out and leaves both
// streams where a buffered copy would have left them. False, with out as
// it was before, when the kernel cannot do it (not regular files, the
// range not all present, a pipe or a file system that refuses, a failed
// write): the caller then copies through its buffer, which reports errors.
bool CopyRangeInKernel(FILE* in, FILE* out, long offset, unsigned long length);
