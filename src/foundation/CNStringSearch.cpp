// The queries of CNString.
#include <cstdint>
#include <cstring>

#include "foundation/CNString.h"

namespace {

unsigned char Lower(char c) { return static_cast<unsigned char>(c >= 'A' && c <= 'Z' ? c - 'A' + 'a' : c); }

bool bStartsWithNoCase(const char* szText, const char* szStart) {
  for (; *szStart; szText++, szStart++)
    if (Lower(*szText) != Lower(*szStart)) return false;
  return true;
}

// A 16-bit character at any address.
uint16_t UnitAt(const char* pText, long lUnit) {
  uint16_t unit;
  std::memcpy(&unit, pText + lUnit * 2, sizeof unit);
  return unit;
}

// Units before the terminating one, at most lMax.
long lCountUnits(const char* pText, long lMax) {
  long lUnits = 0;
  while (lUnits < lMax && UnitAt(pText, lUnits)) lUnits++;
  return lUnits;
}

// Like strstr, with 16-bit characters. pText has lLength bytes and two zero bytes behind them.
bool bHasUnits(const char* pText, long lLength, const char* pSearch) {
  const long lText = lCountUnits(pText, (lLength + 1) / 2), lSearch = lCountUnits(pSearch, INT32_MAX);
  for (long at = 0; at + lSearch <= lText; at++)
    if (std::memcmp(pText + at * 2, pSearch, size_t(lSearch) * 2) == 0) return true;
  return false;
}

struct LetterRange {
  unsigned char first, last;
};
const LetterRange CP1250_LETTERS[] = {{'A', 'Z'},   {'a', 'z'},   {0x8A, 0x8A}, {0x8C, 0x8F}, {0x9A, 0x9A},
                                      {0x9C, 0x9F}, {0xA3, 0xA3}, {0xA5, 0xA5}, {0xAA, 0xAA}, {0xAF, 0xAF},
                                      {0xB3, 0xB3}, {0xB9, 0xBA}, {0xBC, 0xBC}, {0xBE, 0xBF}, {0xC0, 0xD6},
                                      {0xD8, 0xDE}, {0xE0, 0xF6}, {0xF8, 0xFE}};

}  // namespace

bool IsLetter(unsigned char c) {
  for (const LetterRange& range : CP1250_LETTERS)
    if (c >= range.first && c <= range.last) return true;
  return false;
}

// The terminator counts as one of the characters: deliberate.
int CNString::Has(char c) const { return m_szString && std::strchr(m_szString, c) ? 1 : 0; }

int CNString::Has(const char* szText) const {
  if (!m_szString || !szText) return 0;
  if (m_iMode == 1) return bHasUnits(m_szString, m_lLength, szText) ? 1 : 0;
  return std::strstr(m_szString, szText) ? 1 : 0;
}

long CNString::Find(const char* szText) const {
  const char* p = m_szString && szText && *szText ? std::strstr(m_szString, szText) : nullptr;
  return p ? long(p - m_szString) : -1;
}

const char* CNString::IHas(const char* szSubStr, bool bWholeWord) const {
  if (!m_szString || !szSubStr)  // the line tells of 0 for the null pointer: deliberate
    return static_cast<const char*>(LogPrintf("ERROR: CNString::IHas -> !m_szString || !szSubStr-> return 0"));
  const size_t nLength = std::strlen(szSubStr);
  for (const char* p = m_szString; *p && nLength; p++) {
    if (!bStartsWithNoCase(p, szSubStr)) continue;
    const bool bLetterBefore = p > m_szString && IsLetter(static_cast<unsigned char>(p[-1]));
    if (!bWholeWord || (!bLetterBefore && !IsLetter(static_cast<unsigned char>(p[nLength])))) return p;
  }
  return nullptr;
}

int CNString::EndsWith(const char* szText) const {
  if (!m_szString || !szText) return iLogReturn(0, "ERROR: CNString::EndsWith -> !m_szString || !str -> return 0");
  const long lCount = long(std::strlen(szText));
  return lCount <= m_lLength && std::memcmp(m_szString + m_lLength - lCount, szText, size_t(lCount)) == 0;
}

int CNString::IsEqual(const char* szText) const {
  return m_szString && szText && std::strcmp(m_szString, szText) == 0 ? 1 : 0;
}
