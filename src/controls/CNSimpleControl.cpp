#include <algorithm>
#include <cstring>

#include "controls/ScriptText.h"
#include "controls/SimpleKinds.h"

using namespace ScriptText;

namespace {

// The end of one word at p; a group in parentheses is one word, and none (p itself) when it is not closed.
const char* pWordEnd(const char* p, const char* pEnd) {
  if (*p != '(') return SkipWord(p, pEnd);
  const char* pClose = FindChar(p, pEnd, ')');
  return !pClose || FindChar(p, pClose, '"') || FindChar(p, pClose, '\'') ? p : pClose + 1;
}

}  // namespace

CNSimpleControl::CNSimpleControl(const SimpleKind& kind) : BaseControl(kind.kind), m_Row(kind) {
  m_dwStyle = (m_dwStyle | kind.dwStyle) & ~kind.dwRemovedStyle;
  m_dwExStyle |= kind.dwExStyle;
}

// Words up to the first that is a number of the size.
void CNSimpleControl::ReadOwnWords(ScriptCursor& cursor, ScriptContext&) {
  const char* pAction = FindWord(cursor.pPos, cursor.pLineEnd, "ACTION");
  const char* pEnd = pAction ? pAction : cursor.pLineEnd;
  const char* pFirst = SkipBlanks(cursor.pPos, pEnd);
  for (const char* p = pFirst; p < pEnd; p = SkipBlanks(cursor.pPos, pEnd)) {
    const char* pAfter = pWordEnd(p, pEnd);
    if (std::all_of(p, pAfter, bIsDigit)) break;
    cursor.pPos = pAfter;
  }
  if (cursor.pPos > pFirst) CopyTrimmed(pFirst, cursor.pPos, m_csOwnWords);
}

void CNSimpleControl::WriteOwnWords(CNString& csOut) const {
  if (m_csOwnWords.bEmpty()) return;
  csOut.Concat(" ");
  csOut.Concat(m_csOwnWords.Ptr());
}

void CNSimpleControl::ReadOwnFlags(ScriptContext&) {
  for (int i = 0; i < m_Row.nFlags; i++) ApplyFlag(m_Row.pFlags[i]);
}

bool CNSimpleControl::bHasWord(const char* szWord) const {
  return bHasFlag(szWord) || std::strstr(m_csOwnWords.Text(), szWord);
}

int iNumbersOf(const char* szText, int* pNumbers, int nNumbers) {
  const char* const pEnd = szText + std::strlen(szText);
  int nFound = 0;
  for (const char* p = szText; nFound < nNumbers && (p = std::find_if(p, pEnd, bIsDigit)) < pEnd; nFound++) {
    const bool bNegative = p > szText && p[-1] == '-' && (p - szText < 2 || !bIsDigit(p[-2]));
    const int iNumber = iReadNumber(p, pEnd);
    pNumbers[nFound] = bNegative ? -iNumber : iNumber;
  }
  return nFound;
}
