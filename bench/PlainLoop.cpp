#include "PlainLoop.h"

static const size_t BLOCK = 256 * 1024;

PlainLoop::PlainLoop() : m_block(BLOCK) { inflateInit2(&m_stream, 15 + 16); }

PlainLoop::~PlainLoop() { inflateEnd(&m_stream); }

bool PlainLoop::bExtractNext(const std::string& folder) {
  OsFile output;
  return m_walk.Next(m_entry) == ArchiveWalk::Step::Entry &&
         output.bOpen((folder + m_entry.csName.Text()).c_str(), OsOpenMode::Create) &&
         bInflate(m_entry.storedSize, output) && output.bClose();
}

bool PlainLoop::bInflate(uint32_t left, OsFile& output) {
  inflateReset(&m_stream);
  int iResult = Z_OK;
  while (left > 0 && iResult != Z_STREAM_END) {
    const unsigned char* pBytes;
    const size_t nBytes = m_walk.Data().Peek(left < BLOCK ? left : BLOCK, pBytes);
    if (nBytes == 0) return false;
    m_stream.next_in = const_cast<Bytef*>(pBytes);
    m_stream.avail_in = static_cast<uInt>(nBytes);
    while (m_stream.avail_in > 0 && iResult != Z_STREAM_END) {
      m_stream.next_out = m_block.data();
      m_stream.avail_out = BLOCK;
      iResult = inflate(&m_stream, Z_NO_FLUSH);
      if (iResult < 0 || !output.bWrite(m_block.data(), BLOCK - m_stream.avail_out)) return false;
    }
    m_walk.Data().Skip(nBytes);
    left -= static_cast<uint32_t>(nBytes);
  }
  return true;
}
