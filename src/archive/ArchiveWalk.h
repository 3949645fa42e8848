// Walks the entries of a product archive from the first to the terminator. Every length is held against the file's size
// before it is used, so that any damage ends in Step::Damaged. One thread at a time.
#pragma once

#include "archive/BlockReader.h"

// Longer names are taken for damage: no path of the system is as long.
const uint32_t ARCHIVE_MAX_NAME = 4096;
const size_t ARCHIVE_FIELDS_SIZE = 24;  // the six numbers between an entry's name and its data
const size_t ARCHIVE_TRAILER_SIZE = 8;  // check value and offset of the first entry
const size_t ARCHIVE_TERMINATOR_SIZE = 4;

// What stands in front of an entry's data. The times are the upper halves of file times.
struct ArchiveEntryHeader {
  CNString csName;  // may hold any bytes, zeros included
  uint32_t creationTimeHigh = 0;
  uint32_t lastAccessTimeHigh = 0;
  uint32_t lastWriteTimeHigh = 0;
  uint32_t attributes = 0;
  uint32_t unpackedSize = 0;  // a claim of the archive's maker: nothing may be allocated by it
  uint32_t storedSize = 0;    // lies within the file
};

class ArchiveWalk {
 public:
  enum class Step { Entry, End, Damaged };

  // False when the file cannot be opened. An archive without a usable trailer opens and is Damaged at the first step.
  bool bOpen(const char* szPath);
  // Reads the header of entry NextIndex() and stands at its data. End and Damaged repeat themselves.
  Step Next(ArchiveEntryHeader& entry);
  // Index of the entry that the coming Next reads, from 0.
  int NextIndex() const { return m_iNext; }
  // The archive, at the data of the entry just read. It may be read and skipped at will until the next step.
  BlockReader& Data() { return m_file; }

 private:
  bool bHas(size_t nBytes, const unsigned char*& pBytes) { return m_file.Peek(nBytes, pBytes) == nBytes; }
  bool bReadHeader(uint32_t nameLength, ArchiveEntryHeader& entry);

  BlockReader m_file;
  uint64_t m_nextEntry = 0;
  int m_iNext = 0;
  bool m_bDamaged = false;
};
