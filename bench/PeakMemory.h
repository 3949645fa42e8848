// The most memory that this process has had so far.
#pragma once

#include <cstdint>

struct PeakMemory {
  uint64_t workingSet = 0;    // bytes in physical memory
  uint64_t privateBytes = 0;  // bytes of its own; 0 where the system does not tell
};

PeakMemory GetPeakMemory();
