// The bound on the process's memory that a read of rows must not take it past: 4 GB or a
// quarter of the physical memory, whichever is less.
#pragma once

#include <cstddef>

// True if the process's resident memory is past the bound.
bool PastMemoryBound();
// A bound of `bytes` instead; 0 gives the usual one back.
void SetMemoryBoundForTesting(size_t bytes);
