// Packs a product file: the starter with the product's icon and version, the bundle (setup program, script, pictures),
// and the product archive as payload. docs/formats.md shows the packed file.
#pragma once

#include "ArchiveFile.h"
#include "Programs.h"

struct ProductJob {
  std::string product;     // the product file; all paths are UTF-8
  SetupPrograms programs;  // what is empty is looked for
  std::string output;      // empty: what the product file says
  FILE* pProgress = nullptr;
  FILE* pFaults = stderr;  // faults of the product file and of its script
};

struct ProductSummary {
  std::string output;
  ArchiveTotals archive, bundle;  // in the bundle the files are counted before packing
  uint64_t starterBytes = 0, payloadBytes = 0, bytesOut = 0;
};

// Throws OrbitError when something is wrong with the product; no file is left behind then.
ProductSummary PackProduct(const ProductJob& job);
