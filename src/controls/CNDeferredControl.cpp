#include <algorithm>

#include "controls/Kinds.h"
#include "controls/ScriptText.h"
#include "foundation/ResultCodes.h"

using namespace ScriptText;

namespace {

// The end of one word at p; a group in parentheses is one word, and none (p itself) when it is not closed.
const char* pWordEnd(const char* p, const char* pEnd) {
  if (*p != '(') return SkipWord(p, pEnd);
  const char* pClose = FindChar(p, pEnd, ')');
  return !pClose || FindChar(p, pClose, '"') || FindChar(p, pClose, '\'') ? p : pClose + 1;
}

}  // namespace

int CNDeferredControl::iReadScript(ScriptCursor& cursor, ScriptContext& context) {
  // A block may do without anything behind its keyword.
  if (!m_szEndWord) return BaseControl::iReadScript(cursor, context);
  ReadLine(cursor, context);
  const char* pEndLine = FindEndLine(cursor.pLineEnd, cursor.pTextEnd, m_szKeyword, m_szEndWord, m_bNests);
  if (!pEndLine) {
    context.Fault(FAULT_MISSING_WORD, cursor, m_szEndWord);
    return EVERYTHING_IS_OK;
  }
  const char* pFirst = cursor.pLineEnd + 1;
  cursor.pPos = pEndLine;
  const char* pFeed = FindChar(pEndLine, cursor.pTextEnd, '\n');
  cursor.pLineEnd = pFeed ? pFeed : cursor.pTextEnd;
  m_csLines.Copy(pFirst, long(cursor.pLineEnd - pFirst));
  return EVERYTHING_IS_OK;
}

void CNDeferredControl::WriteControl(CNString& csOut) const {
  BaseControl::WriteControl(csOut);
  if (!m_csLines.Ptr()) return;
  csOut.Concat("\n");
  csOut.Concat(m_csLines.Ptr());
}

// Words up to the first that is a number of the size.
void CNDeferredControl::ReadOwnWords(ScriptCursor& cursor, ScriptContext&) {
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

void CNDeferredControl::WriteOwnWords(CNString& csOut) const {
  if (m_csOwnWords.bEmpty()) return;
  csOut.Concat(" ");
  csOut.Concat(m_csOwnWords.Ptr());
}
