// Finds the files of a product's folder and holds them against what a product archive can carry.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "archive/ArchiveWalk.h"

struct ProductFile {
  std::string path;           // for the foundation's file functions
  std::string shownPath;      // UTF-8, for messages
  ArchiveEntryHeader header;  // name with backslashes, times and attributes
  uint64_t size = 0;
};

// All files below the folder (UTF-8), sorted by name, so that the same folder gives the same archive. Throws OrbitError
// for what an archive cannot carry: no files at all, an empty folder, a link or another special file, a file beyond 32
// bits, a name outside code page 1250, one that extraction would refuse, two names that Windows takes for one; and for
// a name in the folder itself under which setup keeps a file of its own (config.ini, Installed.lst, Uninstall.log).
std::vector<ProductFile> ScanFolder(const std::string& folder);

// By their names' bytes, so that the same files give the same archive.
void SortByName(std::vector<ProductFile>& files);

// Windows' view of a name: letters of code page 1250 in lower case, slashes as backslashes.
std::string FoldName(const std::string& name);
