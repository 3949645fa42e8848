#include "bootstrap/OwnCommandLine.h"

#include <cwchar>

namespace {

const wchar_t BLANKS[] = L" \t";
const wchar_t* const SILENT[] = {L"S", L"SILENT", L"VERYSILENT", L"quiet", L"q", L"passive"};

// Up to the blank outside quotes that ends it.
size_t WordLength(const wchar_t* pWord) {
  bool bQuoted = false;
  size_t n = 0;
  for (; pWord[n] && (bQuoted || !wcschr(BLANKS, pWord[n])); n++)
    if (pWord[n] == L'"') bQuoted = !bQuoted;
  return n;
}

}  // namespace

const wchar_t* pSkipProgramName(const wchar_t* pLine) {
  pLine += WordLength(pLine);
  return pLine + wcsspn(pLine, BLANKS);
}

bool bAsksForSilence(const wchar_t* pSwitches) {
  for (const wchar_t* p = pSwitches; *p; p = pSkipProgramName(p)) {
    if (*p != L'-' && *p != L'/') continue;
    if (_wcsnicmp(p + 1, L"D=", 2) == 0) return false;  // a folder's name to the end of the line
    for (const wchar_t* szName : SILENT)
      if (WordLength(p + 1) == wcslen(szName) && _wcsnicmp(p + 1, szName, wcslen(szName)) == 0) return true;
  }
  return false;
}
