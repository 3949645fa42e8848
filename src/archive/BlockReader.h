// A file read forward in big blocks by readers that look at its bytes in place. One thread at a time.
#pragma once

#include <cstdint>
#include <memory>

#include "foundation/os/Os.h"

class BlockReader {
 public:
  static const size_t BLOCK_SIZE = 256 * 1024;

  // False when the file cannot be opened or there is no memory for the block.
  bool bOpen(const char* szPath);
  uint64_t Size() const { return m_size; }
  uint64_t Position() const { return m_blockStart + m_nAt; }
  // Any place; a place inside the present block costs nothing.
  void SeekTo(uint64_t position);
  // Points pBytes at the bytes at the position, which stay there until the next call. Returns how many there are: at
  // most nWanted (up to BLOCK_SIZE), fewer only at the end of the file or after a failed read.
  size_t Peek(size_t nWanted, const unsigned char*& pBytes);
  // Passes over bytes that the last Peek has shown.
  void Skip(size_t nBytes) { m_nAt += nBytes; }
  // True once the system has failed to read.
  bool bFailed() const { return m_bFailed; }

 private:
  void Fill(size_t nWanted);

  OsFile m_file;
  std::unique_ptr<unsigned char[]> m_pBlock;
  uint64_t m_size = 0;
  uint64_t m_blockStart = 0;  // place in the file of the block's first byte
  size_t m_nHave = 0;         // bytes in the block
  size_t m_nAt = 0;           // the position within it
  bool m_bFailed = false;
};

// A 32-bit little-endian number.
inline uint32_t LittleEndian32(const unsigned char* p) {
  return p[0] | p[1] << 8 | p[2] << 16 | static_cast<uint32_t>(p[3]) << 24;
}
inline void StoreLittleEndian32(unsigned char* p, uint32_t value) {
  for (int i = 0; i < 4; i++) p[i] = static_cast<unsigned char>(value >> (8 * i));
}
