// Makes a product archive for measuring: the same bytes for the same numbers, every time and everywhere.
#pragma once

#include <cstdint>
#include <string>

struct SampleSize {
  uint64_t bytes = 0;  // of content, about
  int files = 0;
};

class SampleNoise {
 public:
  explicit SampleNoise(uint32_t seed) : m_state(seed * 2654435761u + 1) {}
  uint32_t Next() {
    m_state ^= m_state << 13;
    m_state ^= m_state >> 17;
    return m_state ^= m_state << 5;
  }

 private:
  uint32_t m_state;
};

// Eight files of ten share a tenth of the bytes, the ninth a quarter, the tenth the rest; each between half and one and
// a half times its share.
uint64_t SampleFileSize(const SampleSize& size, int iFile, SampleNoise& noise);

// Writes the archive, using a scratch file beside it. Sizes are mixed: many small files, a few that hold most of the
// bytes; about half of the content compresses. False when something cannot be written.
bool bMakeSampleProduct(const std::string& path, const SampleSize& size);
