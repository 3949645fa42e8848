// Reads the stored bytes of one entry as zlib's gzip file reader would, byte for byte, but in place and in blocks:
// several members one after the other, data without a gzip header passed through, garbage after a member ignored, an
// early end kept as far as it goes. One thread at a time.
#pragma once

#include <zlib.h>

#include "archive/BlockReader.h"

class GzipEntryReader {
 public:
  // The least room that Read needs.
  static const size_t OUTPUT_BLOCK = 16384;

  enum class End {
    Complete,    // all there, checks passed (data without a gzip header has none)
    Early,       // the stored bytes end within a member
    Damaged,     // invalid data, or a failed CRC or length
    Unreadable,  // the system failed to read the archive
  };

  GzipEntryReader() = default;
  ~GzipEntryReader();
  GzipEntryReader(const GzipEntryReader&) = delete;
  GzipEntryReader& operator=(const GzipEntryReader&) = delete;

  // Begins with the storedSize bytes at the source's position. The source is the reader's until the last Read and then
  // stands anywhere within those bytes. False when there is no memory.
  bool bStart(BlockReader& source, uint32_t storedSize);
  // Puts decompressed bytes at pBytes, as many as fit in whole output blocks; nBytes is at least OUTPUT_BLOCK. Returns
  // the count, 0 at the end. More room is faster.
  size_t Read(unsigned char* pBytes, size_t nBytes);
  // True when there is no more to read.
  bool bEnded() const { return m_bEnd; }
  // How it ended; valid once it has.
  End Result() const { return m_result; }
  // The content's CRC-32 when it was whole members, else 0.
  uint32_t Sum() const { return m_result == End::Complete && m_iMembers ? m_sum : 0; }

 private:
  void Begin();
  bool bStartsOver();
  size_t Look(unsigned char* pOut, size_t nRoom);
  size_t CopyBlock(unsigned char* pOut, size_t nRoom);
  size_t InflateBlock(unsigned char* pOut, size_t nRoom);
  void TopUp();
  void AddSum();
  size_t Finish(End result);

  z_stream m_stream = {};
  bool m_bInflateReady = false;
  BlockReader* m_pSource = nullptr;
  uint64_t m_start = 0;  // the entry's place in the source
  uint32_t m_storedSize = 0;
  uint64_t m_given = 0;   // bytes that Read has returned
  uint64_t m_again = 0;   // bytes that come once more, to be passed over
  bool m_bExact = false;  // in the file reader's own blocks, as an error has shown
  uint32_t m_left = 0;    // stored bytes from the window's first on
  size_t m_nWindow = 0;   // bytes that the stream was last shown
  int m_iMembers = 0;     // gzip members seen: once there is one, what is no member is garbage
  uint32_t m_sum = 0;     // of the members so far
  bool m_bEnd = false;
  End m_result = End::Complete;
  size_t (GzipEntryReader::*m_pStep)(unsigned char*, size_t) = nullptr;  // what the next block needs
};
