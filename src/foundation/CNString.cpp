#include "foundation/CNString.h"

#include <climits>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <utility>

#include "foundation/CNStream.h"
#include "foundation/os/Os.h"

namespace {

// Every text is followed by two zero bytes, so that a reading in 16-bit characters finds its end too.
const long TERMINATOR_SIZE = 2;
// vPrintf formats into a block of this size, and into ones larger by as much each time until the result fits:
// deliberate.
const long PRINTF_STEP = 8096;

bool bFormat(char* szBuffer, long lSize, const char* szFormat, va_list args) {
  va_list again;
  va_copy(again, args);
  const int iWritten = iOsFormat(szBuffer, size_t(lSize), szFormat, again);
  va_end(again);
  return iWritten != -1;
}

// Writes szText with newstr in the place of every str. False without memory, which has been told then.
bool bWriteSubstituted(CNBuffer& result, const char* szText, const char* str, const char* newstr) {
  const size_t nFound = std::strlen(str), nNew = std::strlen(newstr);
  size_t nSize = std::strlen(szText);
  for (const char* p = szText; (p = std::strstr(p, str)); p += nFound) nSize += nNew - nFound;
  if (nSize > 0 && nSize <= LONG_MAX) result.Resize(long(nSize));  // at once: the buffer grows in small steps
  const auto bWrite = [&](const char* szFunction, const char* szVariable, const char* pBytes, size_t nBytes) {
    return !nBytes || result.Write(szFunction, szVariable, pBytes, long(nBytes)) != -1;
  };
  while (const char* const pMatch = std::strstr(szText, str)) {
    if (!bWrite("CNString::SubstituteAll -> strstr", "m_szString", szText, size_t(pMatch - szText)) ||
        !bWrite("CNString::SubstituteAll", "newstr", newstr, nNew))
      return false;
    szText = pMatch + nFound;
  }
  return bWrite("CNString::SubstituteAll", "m_szString", szText, std::strlen(szText));
}

}  // namespace

CNString::CNString(const char* szText, int iMode) {
  *this = szText;
  m_iMode = iMode;
}

CNString::CNString(const CNString& csOther) : m_iMode(csOther.m_iMode) {
  // Up to the first zero byte: deliberate, unlike assignment.
  if (csOther.m_szString) Copy(csOther.m_szString, long(std::strlen(csOther.m_szString)));
}

CNString::CNString(CNString&& csOther) noexcept
    : m_szString(std::exchange(csOther.m_szString, nullptr)),
      m_lLength(std::exchange(csOther.m_lLength, 0)),
      m_iMode(csOther.m_iMode) {}

CNString& CNString::operator=(const char* szText) {
  if (szText)
    Copy(szText, long(std::strlen(szText)));
  else
    Free();
  m_iMode = -1;
  return *this;
}

CNString& CNString::operator=(const CNString& csOther) {
  if (this == &csOther) return *this;
  if (csOther.m_szString)
    Copy(csOther.m_szString, csOther.m_lLength);
  else
    Free();
  m_iMode = csOther.m_iMode;
  return *this;
}

CNString& CNString::operator=(CNString&& csOther) noexcept {
  if (this == &csOther) return *this;
  Free();
  m_szString = std::exchange(csOther.m_szString, nullptr);
  m_lLength = std::exchange(csOther.m_lLength, 0);
  m_iMode = csOther.m_iMode;
  return *this;
}

void CNString::Free() {
  std::free(m_szString);
  m_szString = nullptr;
  m_lLength = 0;
}

// The bytes behind the kept text are zero. Exact growth, nothing in reserve: deliberate. On failure nothing has
// changed.
char* CNString::Resize(long lLength) {
  if (lLength < 0 || lLength > LONG_MAX - TERMINATOR_SIZE) return nullptr;
  char* szNew = static_cast<char*>(std::realloc(m_szString, size_t(lLength + TERMINATOR_SIZE)));
  if (!szNew) return nullptr;
  const long lOld = m_szString ? m_lLength : 0;
  const long lKept = lOld < lLength ? lOld : lLength;
  std::memset(szNew + lKept, 0, size_t(lLength + TERMINATOR_SIZE - lKept));
  m_szString = szNew;
  m_lLength = lLength;
  return m_szString;
}

// True when p points into this text, which a resize would move away from under it.
bool CNString::bOwns(const char* p) const {
  const uintptr_t start = reinterpret_cast<uintptr_t>(m_szString), at = reinterpret_cast<uintptr_t>(p);
  return m_szString && at >= start && at < start + uintptr_t(m_lLength + TERMINATOR_SIZE);
}

int CNString::iGetMode(int* pMode) const {
  if (pMode) *pMode = m_iMode;
  return 0;
}

char* CNString::Concat(const char* szText) { return szText ? Concat(szText, long(std::strlen(szText))) : m_szString; }

char* CNString::Concat(const char* pBytes, long lCount) {
  if (!pBytes) return m_szString;
  if (bOwns(pBytes)) {
    CNString csCopy;
    return csCopy.Copy(pBytes, lCount) ? Concat(csCopy.m_szString, lCount) : nullptr;
  }
  const long lOld = m_szString ? m_lLength : 0;
  if (lCount < 0 || lCount > LONG_MAX - lOld || !Resize(lOld + lCount))
    return static_cast<char*>(LogPrintf("ERROR: CNString::Concat -> !m_szString -> return NULL"));
  std::memcpy(m_szString + lOld, pBytes, size_t(lCount));
  return m_szString;
}

char* CNString::Copy(const char* pBytes, long lCount) {
  if (!pBytes) return static_cast<char*>(LogPrintf("ERROR: CNString::Copy -> !mem -> return NULL"));
  CNString csOld(std::move(*this));  // freed last: pBytes may point into it
  if (!Resize(lCount)) {
    m_lLength = lCount;  // the asked length without a text is deliberate: callers test the pointer
    return static_cast<char*>(LogPrintf("ERROR: CNString::Copy -> !m_szString -> return NULL"));
  }
  std::memcpy(m_szString, pBytes, size_t(lCount));
  return m_szString;
}

int CNString::iInsert(const char* szText, int iAt) {
  // Both lines tell of NULL for the number 0: deliberate.
  if (!szText) return iLogReturn(0, "ERROR: CNString::iInsert -> !string -> return NULL");
  if (iAt > m_lLength) return iLogReturn(0, "ERROR: CNString::iInsert -> iAt>m_lLength -> return NULL");
  if (bOwns(szText)) return iInsert(CNString(szText, 0).m_szString, iAt);
  const long lCount = long(std::strlen(szText));
  if (lCount < 1) return 1;
  const long lAt = iAt < 0 ? 0 : iAt;  // a negative position is deliberately not refused
  const long lTail = m_szString ? m_lLength - lAt : 0;
  if (!Resize(lAt + lTail + lCount)) return iLogReturn(0, "ERROR: CNString::iInsert -> !m_szString -> return NULL");
  std::memmove(m_szString + lAt + lCount, m_szString + lAt, size_t(lTail));
  std::memcpy(m_szString + lAt, szText, size_t(lCount));
  return 1;
}

char* CNString::SubstituteAll(const char* szFunction, const char* szVariable, const char* str, const char* newstr) {
  if (!m_szString)
    return static_cast<char*>(
        LogPrintf("ERROR: CNString::SubstituteAll -> !m_szString -> szFunction=%s, szVariable=%s -> return NULL",
                  szFunction, szVariable));
  if (!str || !*str)
    return static_cast<char*>(
        LogPrintf("ERROR: CNString::SubstituteAll -> !str -> szFunction=%s, szVariable=%s -> return NULL", szFunction,
                  szVariable));
  if (!newstr)
    return static_cast<char*>(
        LogPrintf("ERROR: CNString::SubstituteAll -> !newstr -> szFunction=%s, szVariable=%s -> return NULL",
                  szFunction, szVariable));

  if (!std::strstr(m_szString, str)) return Cut(long(std::strlen(m_szString)));
  CNBuffer result;
  if (!bWriteSubstituted(result, m_szString, str, newstr)) return nullptr;
  return result.Length() > 0 ? Copy(result.Ptr(), result.Length()) : Resize(0);
}

char* CNString::Trim(char c) {
  if (!m_szString) return static_cast<char*>(LogPrintf("ERROR: CNString::Trim -> !m_szString -> return NULL"));
  long i = m_lLength;
  while (i > 0 && m_szString[i] != c) i--;
  return Cut(i);
}

char* CNString::TrimRight() {
  if (!m_szString) return static_cast<char*>(LogPrintf("ERROR: CNString::TrimRight -> !m_szString -> return NULL"));
  long i = m_lLength;
  while (i > 0 && (m_szString[i - 1] == '\n' || m_szString[i - 1] == '\r')) i--;
  return Cut(i);
}

// Ends the text at lLength without moving it.
char* CNString::Cut(long lLength) {
  std::memset(m_szString + lLength, 0, size_t(m_lLength + TERMINATOR_SIZE - lLength));
  m_lLength = lLength;
  return m_szString;
}

char* CNString::AddSlash() {
  if (!m_szString) return static_cast<char*>(LogPrintf("ERROR: CNString::AddSlash -> !m_szString -> return NULL"));
  if (m_lLength > 0 && m_szString[m_lLength - 1] == '/') m_szString[m_lLength - 1] = '\\';
  if (m_lLength > 0 && m_szString[m_lLength - 1] == '\\') return m_szString;
  if (!Resize(m_lLength + 1))
    return static_cast<char*>(LogPrintf("ERROR: CNString::AddSlash -> !m_szString -> return NULL"));
  m_szString[m_lLength - 1] = '\\';
  return m_szString;
}

char* CNString::SetLength(long lLength) {
  if (lLength == m_lLength) return m_szString;
  if (Resize(lLength)) return m_szString;
  Free();
  return static_cast<char*>(LogPrintf("ERROR: CNString::SetLength -> !m_szString -> return NULL"));
}

char* CNString::MakeLower(char* szText) {
  for (char* p = szText ? szText : m_szString; p && *p; p++)
    if (*p >= 'A' && *p <= 'Z') *p = char(*p - 'A' + 'a');
  return m_szString;
}

char* CNString::vPrintf(const char* szFunction, const char* szVariable, const char* szFormat, va_list args) {
  if (!szFormat)
    return static_cast<char*>(
        LogPrintf("ERROR: CNString::vPrintf(char *str, va_list args) -> !str -> return NULL -> szFunction=%s, "
                  "szVariable=%s",
                  szFunction, szVariable));
  char szShort[PRINTF_STEP];
  if (bFormat(szShort, PRINTF_STEP, szFormat, args)) return Copy(szShort, long(std::strlen(szShort)));
  CNString csScratch;
  for (long lBufLen = 2 * PRINTF_STEP;; lBufLen += PRINTF_STEP) {
    if (!csScratch.Resize(lBufLen))
      return static_cast<char*>(LogPrintf(
          "ERROR: CNString::vPrintf(char *str, va_list args) -> !szBuffer & lBufLen=%li -> return NULL", lBufLen));
    if (bFormat(csScratch.m_szString, lBufLen, szFormat, args))
      return Copy(csScratch.m_szString, long(std::strlen(csScratch.m_szString)));
  }
}

char* CNString::Printf(const char* szFunction, const char* szVariable, const char* szFormat, ...) {
  if (!szFormat || !*szFormat) return nullptr;
  va_list args;
  va_start(args, szFormat);
  char* const szResult = vPrintf(szFunction, szVariable, szFormat, args);
  va_end(args);
  return szResult;
}
