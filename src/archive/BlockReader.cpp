#include "archive/BlockReader.h"

#include <cstring>
#include <new>

bool BlockReader::bOpen(const char* szPath) {
  if (!m_pBlock) m_pBlock.reset(new (std::nothrow) unsigned char[BLOCK_SIZE]);
  m_blockStart = 0;
  m_nHave = m_nAt = 0;
  m_bFailed = false;
  if (!m_pBlock || !m_file.bOpen(szPath, OsOpenMode::Read)) return false;
  const int64_t size = m_file.Size();
  m_size = size < 0 ? 0 : static_cast<uint64_t>(size);
  return size >= 0;
}

void BlockReader::SeekTo(uint64_t position) {
  if (position >= m_blockStart && position <= m_blockStart + m_nHave) {
    m_nAt = static_cast<size_t>(position - m_blockStart);
    return;
  }
  m_blockStart = position;
  m_nHave = m_nAt = 0;
  if (!m_file.bSeek(position)) m_bFailed = true;
}

size_t BlockReader::Peek(size_t nWanted, const unsigned char*& pBytes) {
  if (m_nHave - m_nAt < nWanted) Fill(nWanted);
  pBytes = m_pBlock.get() + m_nAt;
  const size_t nThere = m_nHave - m_nAt;
  return nThere < nWanted ? nThere : nWanted;
}

// Moves what is left to the front and reads until nWanted bytes are there.
void BlockReader::Fill(size_t nWanted) {
  m_nHave -= m_nAt;
  memmove(m_pBlock.get(), m_pBlock.get() + m_nAt, m_nHave);
  m_blockStart += m_nAt;
  m_nAt = 0;
  while (m_nHave < nWanted && !m_bFailed) {
    const long lRead = m_file.lRead(m_pBlock.get() + m_nHave, BLOCK_SIZE - m_nHave);
    if (lRead < 0) m_bFailed = true;
    if (lRead <= 0) return;
    m_nHave += static_cast<size_t>(lRead);
  }
}
