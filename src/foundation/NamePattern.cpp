#include "foundation/NamePattern.h"

#include <cstring>
#include <memory>
#include <new>

namespace {

// Pairs of one letter that lie at no regular distance.
struct CaseRow {
  unsigned char upper, lower;
};
const CaseRow CASE_ROWS[] = {{0xA3, 0xB3}, {0xA5, 0xB9}, {0xAA, 0xBA}, {0xAF, 0xBF}, {0xBC, 0xBE}};

unsigned char ToLower(char cLetter) {
  const unsigned char c = static_cast<unsigned char>(cLetter);
  if ((c >= 'A' && c <= 'Z') || (c >= 0xC0 && c <= 0xDE && c != 0xD7)) return c + 0x20;
  if (c >= 0x8A && c <= 0x8F && c != 0x8B) return c + 0x10;
  for (const CaseRow& row : CASE_ROWS)
    if (row.upper == c) return row.lower;
  return c;
}

bool bIsWildcard(char c) { return c == '*' || c == '?'; }

// The places in a pattern that one may stand at after some characters of a name.
class Places {
 public:
  explicit Places(size_t nPattern) : m_nPattern(nPattern), m_pThere(new (std::nothrow) bool[nPattern + 1]()) {}

  bool bReady() const { return m_pThere != nullptr; }
  bool bAtEnd() const { return m_pThere[m_nPattern]; }
  void SetStart() { m_pThere[0] = true; }

  // Passes over what may stand for nothing in front of cNext, 0 at the end of the name.
  void PassOver(const char* pPattern, char cNext) {
    for (size_t i = 0; i < m_nPattern; i++) {
      const bool bNothing = pPattern[i] == '*' || (pPattern[i] == '?' && (!cNext || cNext == '.')) ||
                            (pPattern[i] == '.' && !cNext && i + 1 < m_nPattern && bIsWildcard(pPattern[i + 1]));
      if (m_pThere[i] && bNothing) m_pThere[i + 1] = true;
    }
  }

  // Takes the character c. Backwards, so that no place takes it twice.
  void Take(const char* pPattern, char c, bool bLastDot) {
    m_pThere[m_nPattern] = false;
    for (size_t i = m_nPattern; i-- > 0;) {
      if (!m_pThere[i]) continue;
      const bool bDotFollows = i + 1 < m_nPattern && pPattern[i + 1] == '.';
      const bool bStays = pPattern[i] == '*' && !(bLastDot && bDotFollows);
      const bool bGoesOn = pPattern[i] == '?' ? c != '.' : pPattern[i] != '*' && ToLower(pPattern[i]) == ToLower(c);
      m_pThere[i] = bStays;
      if (bGoesOn) m_pThere[i + 1] = true;
    }
  }

 private:
  size_t m_nPattern;
  std::unique_ptr<bool[]> m_pThere;
};

}  // namespace

bool bMatchesPattern(const char* szName, const char* szPattern) {
  const char* const pLastDot = std::strrchr(szName, '.');
  size_t nPattern = std::strlen(szPattern);
  if (nPattern > 0 && szPattern[nPattern - 1] == '.') {
    if (pLastDot) return false;
    nPattern--;
  }
  Places places(nPattern);
  if (!places.bReady()) return false;
  places.SetStart();
  for (const char* p = szName; *p; p++) {
    places.PassOver(szPattern, *p);
    places.Take(szPattern, *p, p == pLastDot);
  }
  places.PassOver(szPattern, 0);
  return places.bAtEnd();
}
