// The sum that an archive's check value brings to 0.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>

// The sum of nBytes unsigned bytes, wrapping at 32 bits.
inline uint32_t ArchiveSum(const unsigned char* pBytes, size_t nBytes) {
  uint32_t sum = 0;
  // Four bytes at a time in two pairs of 16-bit lanes; 128 rounds of at most 2 * 255 each fit into a lane.
  while (nBytes >= 4) {
    uint32_t lanes = 0;
    for (int i = 0; i < 128 && nBytes >= 4; i++, pBytes += 4, nBytes -= 4) {
      uint32_t word;
      memcpy(&word, pBytes, 4);
      lanes += (word & 0x00ff00ff) + (word >> 8 & 0x00ff00ff);
    }
    sum += (lanes & 0xffff) + (lanes >> 16);
  }
  while (nBytes-- > 0) sum += *pBytes++;
  return sum;
}
