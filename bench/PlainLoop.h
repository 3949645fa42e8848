// What extraction is held against: for every entry merely inflate, create and write. Every needed folder must be there
// already; no name is looked at, no time or attribute set, nothing reported.
#pragma once

#include <zlib.h>

#include <string>
#include <vector>

#include "archive/ArchiveWalk.h"

class PlainLoop {
 public:
  PlainLoop();
  ~PlainLoop();
  PlainLoop(const PlainLoop&) = delete;
  PlainLoop& operator=(const PlainLoop&) = delete;

  bool bOpen(const std::string& archive) { return m_walk.bOpen(archive.c_str()); }
  // The next entry into a folder that ends with a backslash. False when there is none or something fails.
  bool bExtractNext(const std::string& folder);

 private:
  bool bInflate(uint32_t storedSize, OsFile& output);

  ArchiveWalk m_walk;
  ArchiveEntryHeader m_entry;
  std::vector<unsigned char> m_block;
  z_stream m_stream = {};
};
