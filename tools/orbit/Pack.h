// Packs a folder: it becomes a product archive, and a setup program with the archive behind it a self-extracting setup.
// Paths are UTF-8. A failure throws OrbitError and leaves no file behind.
#pragma once

#include "ArchiveFile.h"

struct PackSummary {
  ArchiveTotals archive;
  uint64_t bytesOut = 0;  // the output
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
