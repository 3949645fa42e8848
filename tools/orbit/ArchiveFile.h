// Writes the files of a folder as a product archive.
#pragma once

#include "FolderScan.h"
#include "OutputFile.h"

struct ArchiveTotals {
  uint64_t files = 0;
  uint64_t bytesIn = 0;       // content of the files
  uint64_t archiveBytes = 0;  // the product archive
};

// Writes into an empty output and closes it: its temporary file can then be read. The sizes of the files are filled in.
// pProgress null: no progress shown; iLevel: of compression, 0 to 9. Throws OrbitError; `what` names the work.
ArchiveTotals WriteArchive(std::vector<ProductFile>& files, const std::string& what, OutputFile& output,
                           FILE* pProgress, int iLevel);
