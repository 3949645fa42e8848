// Makes a product archive in one pass over its files. Times and sizes of 32 bits are the format's own limits.
// One thread at a time.
#pragma once

#include <zlib.h>

#include <memory>

#include "archive/ArchiveWalk.h"

enum ArchiveWriteResult : int {
  ArchiveWritten = 0,
  ErrArchiveRead = 1,   // a file cannot be read
  ErrArchiveWrite = 2,  // the archive cannot be written
  ErrArchiveLarge = 3,  // a file, or the whole archive, has a size beyond 32 bits
  ErrArchiveName = 4,   // the name is empty, too long, or unsafe as a path
  ErrArchiveMemory = 5,
  ErrArchiveStopped = 6,  // the progress function said so
};

// Compresses in place of zlib, for a host that has something better.
class GzipMaker {
 public:
  static const size_t MOST = 8 * 1024 * 1024;  // a longer content becomes several members

  virtual ~GzipMaker() = default;
  // Makes one gzip member of nBytes (1 to MOST) and points pMember at it; it stays there until the next call. Its size,
  // 0 without memory.
  virtual size_t Make(const unsigned char* pBytes, size_t nBytes, const unsigned char*& pMember) = 0;
};

class ArchiveWriter {
 public:
  // Begins an empty archive in an open, empty file, which must outlive the writer. iLevel is zlib's, 0 to 9; it means
  // nothing with a maker, which must outlive the writer too.
  explicit ArchiveWriter(OsFile& output, int iLevel = 9, GzipMaker* pMaker = nullptr);
  ~ArchiveWriter();
  ArchiveWriter(const ArchiveWriter&) = delete;
  ArchiveWriter& operator=(const ArchiveWriter&) = delete;

  // Told of the bytes taken from the input file, block by block; its answer is whether to go on.
  void SetProgress(bool (*pProgress)(uint32_t nBytes, void* pContext), void* pContext) {
    m_pProgress = pProgress;
    m_pContext = pContext;
  }
  // Appends the input from its position to its end as an entry with this header's name, times and attributes; the sizes
  // are filled in. An empty file is stored as no bytes at all. After a failure, which has written one diagnostic line,
  // the archive is unusable.
  int iAddFile(ArchiveEntryHeader& header, OsFile& input);
  // Writes the terminator, the check value and the first entry's offset (0).
  int iFinish();
  // Bytes written so far.
  uint64_t Size() const { return m_size; }

 private:
  int iStoreContent(ArchiveEntryHeader& header, OsFile& input);
  int iStoreBlock(size_t nBytes, bool bFirst);
  int iDeflate(int iFlush);
  int iPut(const unsigned char* pBytes, size_t nBytes);
  int iPatchSizes(const ArchiveEntryHeader& header, uint64_t place);
  bool bWrite(const unsigned char* pBytes, size_t nBytes);

  OsFile& m_output;
  int m_iLevel;
  GzipMaker* m_pMaker;
  z_stream m_stream = {};
  gz_header m_gzipHeader = {};
  bool m_bStreamReady = false;
  size_t m_nBlock;                             // bytes of input that are compressed at a time
  std::unique_ptr<unsigned char[]> m_pBlocks;  // one for input, one for zlib's output
  uint64_t m_size = 0;
  uint32_t m_sum = 0;
  bool (*m_pProgress)(uint32_t, void*) = nullptr;
  void* m_pContext = nullptr;
};
