// Makes a product archive for measuring: the same bytes for the same numbers, every time and everywhere.
#pragma once

#include <cstdint>
#include <string>

struct SampleSize {
  uint64_t bytes = 0;  // of content, about
  int files = 0;
};

// Writes the archive, using a scratch file beside it. Sizes are mixed: many small files, a few that hold most of the
// bytes; about half of the content compresses. False when something cannot be written.
bool bMakeSampleProduct(const std::string& path, const SampleSize& size);
