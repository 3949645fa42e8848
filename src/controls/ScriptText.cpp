#include "controls/ScriptText.h"

#include <algorithm>
#include <cstring>

namespace {

// What the three escapes of captions stand for.
struct EscapeRow {
  char cWritten;
  char cMeant;
};
const EscapeRow g_escapes[] = {{'"', '"'}, {'n', '\n'}, {'r', '\r'}};

bool bIsWordLetter(char c) { return IsLetter(static_cast<unsigned char>(c)) || c == '_'; }

}  // namespace

bool ScriptText::bIsDigit(char c) { return c >= '0' && c <= '9'; }

const char* ScriptText::SkipBlanks(const char* p, const char* pEnd) {
  while (p < pEnd && (*p == ' ' || *p == '\t')) p++;
  return p;
}

const char* ScriptText::SkipSpace(const char* p, const char* pEnd) {
  while (p < pEnd && (*p == ' ' || *p == '\t' || *p == '\n' || *p == '\r')) p++;
  return p;
}

const char* ScriptText::SkipWord(const char* p, const char* pEnd) {
  while (p < pEnd && *p != ' ' && *p != '\t' && *p != ',' && *p != '"' && *p != '\'') p++;
  return p;
}

bool ScriptText::bStartsWith(const char* p, const char* pEnd, const char* szText, size_t nLength) {
  return size_t(pEnd - p) >= nLength && std::memcmp(p, szText, nLength) == 0;
}

bool ScriptText::bStartsWith(const char* p, const char* pEnd, const char* szText) {
  return bStartsWith(p, pEnd, szText, std::strlen(szText));
}

bool ScriptText::bStartsWithWord(const char* p, const char* pEnd, const char* szWord) {
  const char* pAfter = p + std::strlen(szWord);
  return bStartsWith(p, pEnd, szWord) && (pAfter == pEnd || (!bIsWordLetter(*pAfter) && !bIsDigit(*pAfter)));
}

const char* ScriptText::FindChar(const char* p, const char* pEnd, char c) {
  return p < pEnd ? static_cast<const char*>(std::memchr(p, c, size_t(pEnd - p))) : nullptr;
}

const char* ScriptText::FindText(const char* p, const char* pEnd, const char* szText) {
  if (p >= pEnd) return nullptr;
  const char* pFound = std::search(p, pEnd, szText, szText + std::strlen(szText));
  return pFound == pEnd ? nullptr : pFound;
}

const char* ScriptText::FindWord(const char* p, const char* pEnd, const char* szWord) {
  const size_t nLength = std::strlen(szWord);
  for (const char* pFound = p; (pFound = FindText(pFound, pEnd, szWord)); pFound++) {
    const char* pAfter = pFound + nLength;
    if (pFound > p && bIsWordLetter(pFound[-1])) continue;
    if (pAfter == pEnd || (!bIsWordLetter(*pAfter) && !bIsDigit(*pAfter))) return pFound;
  }
  return nullptr;
}

const char* ScriptText::FindClosingQuote(const char* p, const char* pEnd) {
  for (const char* pQuote = p; (pQuote = FindChar(pQuote, pEnd, '"')); pQuote++)
    if (pQuote == p || pQuote[-1] != '\\') return pQuote;
  return nullptr;
}

int ScriptText::iReadNumber(const char*& p, const char* pEnd) {
  int iNumber = 0;
  for (; p < pEnd && bIsDigit(*p); p++) iNumber = std::min(NUMBER_LIMIT, iNumber * 10 + (*p - '0'));
  return iNumber;
}

const char* ScriptText::FindEndLine(const char* pLineEnd, const char* pEnd, const char* szKeyword,
                                    const char* szEndWord, bool bNests) {
  int nOpen = 1;
  while (pLineEnd < pEnd) {
    const char* pLine = SkipBlanks(pLineEnd + 1, pEnd);
    if (bStartsWith(pLine, pEnd, szEndWord)) {
      if (--nOpen == 0) return pLine;
    } else if (bStartsWith(pLine, pEnd, szKeyword)) {
      if (!bNests || ++nOpen > NESTING_LIMIT) return nullptr;
    }
    pLineEnd = FindChar(pLine, pEnd, '\n');
    if (!pLineEnd) return nullptr;
  }
  return nullptr;
}

void ScriptText::Unescape(const char* p, const char* pEnd, CNString& csOut) {
  char* szOut = csOut.SetLength(long(pEnd - p));
  if (!szOut) return;
  long lLength = 0;
  for (; p < pEnd; p++) {
    szOut[lLength] = *p;
    if (*p == '\\' && p + 1 < pEnd) {
      for (const EscapeRow& row : g_escapes) {
        if (p[1] != row.cWritten) continue;
        szOut[lLength] = row.cMeant;
        p++;
        break;
      }
    }
    lLength++;
  }
  csOut.SetLength(lLength);
}

void ScriptText::AppendEscaped(CNString& csOut, const char* szText, size_t nLength) {
  size_t nFrom = 0;
  for (size_t i = 0; i < nLength; i++) {
    for (const EscapeRow& row : g_escapes) {
      if (szText[i] != row.cMeant) continue;
      const char szEscape[] = {'\\', row.cWritten};
      csOut.Concat(szText + nFrom, long(i - nFrom));
      csOut.Concat(szEscape, 2);
      nFrom = i + 1;
      break;
    }
  }
  csOut.Concat(szText + nFrom, long(nLength - nFrom));
}

namespace {

void CopyWithout(const char* szEdges, const char* p, const char* pEnd, CNString& csOut) {
  while (p < pEnd && *p && std::strchr(szEdges, *p)) p++;
  while (pEnd > p && pEnd[-1] && std::strchr(szEdges, pEnd[-1])) pEnd--;
  csOut.Copy(p, long(pEnd - p));
}

}  // namespace

void ScriptText::CopyTrimmed(const char* p, const char* pEnd, CNString& csOut) { CopyWithout(" \t", p, pEnd, csOut); }

void ScriptText::CopyFlagList(const char* p, const char* pEnd, CNString& csOut) { CopyWithout(" \t,", p, pEnd, csOut); }

int ScriptText::iScaleSize(int iNumber, double dFactor) {
  return int(std::min(double(NUMBER_LIMIT), iNumber * dFactor));
}
