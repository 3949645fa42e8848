// Writes one entry of the bundle into a folder. The archive floor's own extractor does far more than a bundle needs,
// and brings a decompressor of three times the size: of that floor the starter uses ArchiveWalk, PathGuard and headers
// only.
#pragma once

#include <memory>

#include "archive/ArchiveWalk.h"

enum class UnpackResult { Unpacked, Damaged, NotWritten };

class EntryUnpacker {
 public:
  // source stands at the entry's data: one gzip member whose header is as short as can be, or the plain content.
  // szFolder ends with a backslash; the name, which is checked as in any archive, must not be there yet.
  UnpackResult Unpack(const ArchiveEntryHeader& entry, BlockReader& source, const char* szFolder);

 private:
  UnpackResult Inflate(const ArchiveEntryHeader& entry, BlockReader& source);
  UnpackResult Copy(const ArchiveEntryHeader& entry, BlockReader& source);

  std::unique_ptr<unsigned char[]> m_pWindow;
  OsFile m_output;
};
