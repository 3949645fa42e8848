#include <climits>
#include <cstdlib>
#include <cstring>

#include "foundation/CNStream.h"

namespace {

const long BLOCK_SIZE = 4096;

// A count of bytes as whole blocks; -1 when that cannot be expressed.
long lWholeBlocks(long lSize) {
  return lSize > LONG_MAX - BLOCK_SIZE ? -1 : ((lSize - 1) / BLOCK_SIZE + 1) * BLOCK_SIZE;
}

}  // namespace

CNBuffer::~CNBuffer() { std::free(m_szBuffer); }

int CNBuffer::iReset() {
  std::free(m_szBuffer);
  m_szBuffer = nullptr;
  m_lBufferSize = m_lDataLength = m_lReadPosition = 0;
  return 0;
}

// Does not log. On failure the block and the data stay as they were.
bool CNBuffer::bReallocate(long lSize) {
  const long lCapacity = lWholeBlocks(lSize);
  void* const pNew = lCapacity < 0 ? nullptr
                     : m_szBuffer  ? std::realloc(m_szBuffer, size_t(lCapacity))
                                   : std::calloc(1, size_t(lCapacity));
  if (!pNew) return false;
  m_szBuffer = static_cast<char*>(pNew);
  m_lBufferSize = lCapacity;
  if (m_lDataLength > m_lBufferSize) m_lDataLength = m_lBufferSize;
  if (m_lReadPosition > m_lDataLength) m_lReadPosition = m_lDataLength;
  return true;
}

void CNBuffer::Resize(long lSize) {
  if (lSize < 0) {
    LogPrintf("ERROR: CNBuffer::Resize(long size) -> size<0L -> return");
    return;
  }
  if (bReallocate(lSize)) return;
  m_szBuffer ? LogPrintf(
                   "ERROR: CNBuffer::Resize(long size) -> !m_szBuffer=(char *)realloc(m_szBuffer, m_lBufferSize) -> "
                   "return")
             : LogPrintf("ERROR: CNBuffer::Resize(long size) -> !m_szBuffer=(char *)malloc(m_lBufferSize) -> return");
}

long CNBuffer::Read(const char* szFunction, const char* szVariable, char* szBuffer, long lMaxReadBufferLength) {
  if (!szBuffer)
    return iLogReturn(-1, "ERROR: CNBuffer::Read -> !szBuffer -> return -1 -> szFunction=%s, szVariable=%s", szFunction,
                      szVariable);
  if (lMaxReadBufferLength < 0)
    return iLogReturn(-1,
                      "ERROR: CNBuffer::Read -> lMaxReadBufferLength<0 -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  const long lLeft = m_lDataLength - m_lReadPosition;
  const long lCount = lMaxReadBufferLength < lLeft ? lMaxReadBufferLength : lLeft;
  if (lCount > 0) std::memcpy(szBuffer, m_szBuffer + m_lReadPosition, size_t(lCount));
  m_lReadPosition += lCount;
  return lCount;
}

long CNBuffer::Write(const char* szFunction, const char* szVariable, const char* szBuffer, long lBufferLength) {
  if (!szBuffer)
    return iLogReturn(-1, "ERROR: CNBuffer::Write -> !szBuffer -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  if (lBufferLength < 1)
    return iLogReturn(-1, "ERROR: CNBuffer::Write -> lBufferLength<=0 -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  const long lNeeded = lBufferLength > LONG_MAX - m_lDataLength ? LONG_MAX : lBufferLength + m_lDataLength;
  if (!m_szBuffer && !bReallocate(lNeeded))
    return iLogReturn(-1,
                      "ERROR: CNBuffer::Write -> !m_szBuffer=(char *)malloc(m_lBufferSize) -> return -1 -> "
                      "szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  if (lNeeded > m_lBufferSize) Resize(lNeeded);
  if (lNeeded > m_lBufferSize)
    return iLogReturn(-1, "ERROR: CNBuffer::Write -> !m_szBuffer -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  std::memcpy(m_szBuffer + m_lDataLength, szBuffer, size_t(lBufferLength));
  m_lDataLength += lBufferLength;
  return lBufferLength;
}

const char* CNBuffer::ReadLine(const char* szFunction, const char* szVariable, int iTimeOut) {
  if (iTimeOut < 1)
    return static_cast<const char*>(
        LogPrintf("ERROR: CNBuffer::ReadLine -> iTimeOut<=0 -> return NULL -> szFunction=%s, szVariable=%s", szFunction,
                  szVariable));
  const long lLeft = m_lDataLength - m_lReadPosition;
  if (lLeft == 0) return nullptr;
  const char* const pLine = m_szBuffer + m_lReadPosition;
  const char* const pEnd = static_cast<const char*>(std::memchr(pLine, '\n', size_t(lLeft)));
  const long lLength = pEnd ? long(pEnd - pLine) + 1 : lLeft;
  m_lReadPosition += lLength;
  return KeepLine(pLine, lLength);
}
