// Packs a product: a folder becomes a product archive, and a setup program with the archive behind it a self-extracting
// setup. Paths are UTF-8. A failure throws OrbitError and leaves no file behind.
#pragma once

#include <cstdint>
#include <cstdio>
#include <string>

struct PackSummary {
  uint64_t files = 0;
  uint64_t bytesIn = 0;       // content of the files
  uint64_t archiveBytes = 0;  // the product archive
  uint64_t bytesOut = 0;      // the output
};

struct PackJob {
  std::string folder;
  std::string setup;  // empty: only the archive is made
  std::string output;
  FILE* pProgress = nullptr;  // null: no progress shown
  int iLevel = 9;             // of compression, 0 to 9
};

// With a setup program: the stamped setup; without: the product archive itself.
PackSummary Pack(const PackJob& job);
