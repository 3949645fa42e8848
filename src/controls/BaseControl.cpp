#include "controls/BaseControl.h"

#include <algorithm>

#include "controls/ScriptText.h"
#include "foundation/Log.h"
#include "foundation/ResultCodes.h"

using namespace ScriptText;

namespace {

const char WORD_TOOLTIP[] = "TOOLTIP";
const char WORD_ACTION[] = "ACTION";

// Where the parts before the action end.
const char* pActionOrEnd(const ScriptCursor& cursor) {
  const char* pAction = FindWord(cursor.pPos, cursor.pLineEnd, WORD_ACTION);
  return pAction ? pAction : cursor.pLineEnd;
}

// The word TOOLTIP that belongs to the line and not to its action, or null.
const char* pFindToolTip(const ScriptCursor& cursor) {
  return FindWord(cursor.pPos, pActionOrEnd(cursor), WORD_TOOLTIP);
}

// The size stands before the comma of the flag list. A comma that a number follows is no such comma.
const char* pSizeEnd(const ScriptCursor& cursor) {
  const char* pEnd = pActionOrEnd(cursor);
  for (const char* p = cursor.pPos; (p = FindChar(p, pEnd, ',')); p++) {
    const char* pNext = SkipBlanks(p + 1, pEnd);
    if (pNext == pEnd || !bIsDigit(*pNext)) return p;
  }
  return pEnd;
}

}  // namespace

void ScriptContext::Fault(ScriptFault fault, const ScriptCursor& cursor, const char* szWord) const {
  if (pReport) pReport->iReport(fault, cursor.pPlace(), szWord);
}

bool ScriptCursor::bNextLine() {
  pCut = pCutEnd = nullptr;
  if (pTextEnd - pLineEnd < 2) {
    pPos = pLineEnd = pTextEnd;
    return false;
  }
  pPos = pLineEnd + 1;
  const char* pFeed = FindChar(pPos, pTextEnd, '\n');
  pLineEnd = pFeed ? pFeed : pTextEnd;
  return true;
}

void BaseControl::TakeIDs(int& iNewIDNum) {
  if (szWindowClass() && m_iID == 0) m_iID = iNewIDNum++;
}

int BaseControl::iReadScript(ScriptCursor& cursor, ScriptContext& context) {
  if (!cursor.pPos || SkipBlanks(cursor.pPos, cursor.pLineEnd) == cursor.pLineEnd)
    return iLogReturn(PRECONDITIONS_NOT_VALID, "ERROR: %s -> !szClassLines -> return PRECONDITIONS_NOT_VALID",
                      szClassName());
  ReadLine(cursor, context);
  return EVERYTHING_IS_OK;
}

void BaseControl::ReadLine(ScriptCursor& cursor, ScriptContext& context) {
  // An item that begins with its text has no name, whatever its text says.
  if (m_Kind != ControlKind::Item || *cursor.pPos != '"') iAddControlVariable(cursor, context);
  ReadText(cursor, context);
  iAddToolTip(cursor, context);

  ScriptCursor rest = cursor;
  CNString csWithoutToolTip;
  if (cursor.pCut) {
    // A tooltip may stand anywhere in the line; what it says must not be taken for a number or a flag.
    csWithoutToolTip.Copy(cursor.pPos, long(cursor.pCut - cursor.pPos));
    csWithoutToolTip.Concat(cursor.pCutEnd, long(cursor.pLineEnd - cursor.pCutEnd));
    rest.pOrigin = cursor.pPos;
    rest.pPos = csWithoutToolTip.Text();
    rest.pLineEnd = rest.pTextEnd = rest.pPos + csWithoutToolTip.Length();
  }
  ReadOwnWords(rest, context);
  iAddSize(rest, context);
  iAddStyle(rest, context);
  ReadSharedFlags();
  ReadOwnFlags(context);
  Scale(context.dScale);
  iReadAction(rest, context);
  cursor.pPos = cursor.pLineEnd;
}

int BaseControl::iAddControlVariable(ScriptCursor& cursor, ScriptContext& context) {
  if (!cursor.pPos)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT_ERROR: BaseControl::iAddControlVariable -> !szSave -> return PRECONDITIONS_NOT_VALID");
  const char* p = cursor.pPos;
  while (p < cursor.pLineEnd && *p != ' ' && *p != '\t') p++;
  p = SkipBlanks(p, cursor.pLineEnd);
  if (p == cursor.pLineEnd || *p != '\'') return EVERYTHING_IS_OK;

  const char* pClose = FindChar(p + 1, cursor.pLineEnd, '\'');
  if (pClose)
    m_csName.Copy(p + 1, long(pClose - p - 1));
  else
    context.Fault(FAULT_APOSTROPHE, cursor);
  cursor.pPos = pClose ? pClose + 1 : p + 1;
  return EVERYTHING_IS_OK;
}

int BaseControl::iAddControlCaption(ScriptCursor& cursor, ScriptContext& context) {
  if (!cursor.pPos)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: BaseControl::iAddControlCaption-> !szSave -> return PRECONDITIONS_NOT_VALID");
  m_csCaption.Copy("", 0);
  const char* pToolTip = pFindToolTip(cursor);
  const char* pQuote = FindChar(cursor.pPos, pToolTip ? pToolTip : pActionOrEnd(cursor), '"');
  CNString csJoined;
  while (pQuote) {
    const char* pClose = FindClosingQuote(pQuote + 1, cursor.pLineEnd);
    if (!pClose) {
      context.Fault(FAULT_QUOTE, cursor);
      cursor.pPos = pQuote + 1;
      break;
    }
    csJoined.Concat(pQuote + 1, long(pClose - pQuote - 1));
    cursor.pPos = pClose + 1;
    const char* pNext = SkipBlanks(cursor.pPos, cursor.pLineEnd);
    pQuote = pNext < cursor.pLineEnd && *pNext == '"' ? pNext : nullptr;
  }
  if (!csJoined.bEmpty()) Unescape(csJoined.Text(), csJoined.Text() + csJoined.Length(), m_csCaption);
  return EVERYTHING_IS_OK;
}

int BaseControl::iAddToolTip(ScriptCursor& cursor, ScriptContext& context) {
  if (!cursor.pPos)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: BaseControl::iAddToolTip-> !szSave -> return PRECONDITIONS_NOT_VALID");
  const char* const pEnd = pActionOrEnd(cursor);
  const char* p = cursor.pPos;
  while (const char* pWord = FindWord(p, pEnd, WORD_TOOLTIP)) {
    p = pWord + sizeof(WORD_TOOLTIP) - 1;
    const char* pOpen = SkipBlanks(p, cursor.pLineEnd);
    const bool bOpens = pOpen < cursor.pLineEnd && *pOpen == '\'';
    const char* pClose = bOpens ? FindChar(pOpen + 1, cursor.pLineEnd, '\'') : nullptr;
    if (!pClose) {
      context.Fault(FAULT_APOSTROPHE, cursor);
      continue;
    }
    m_csToolTip.Copy(pOpen + 1, long(pClose - pOpen - 1));
    if (SkipBlanks(cursor.pPos, pWord) == pWord) {
      cursor.pPos = pClose + 1;
    } else {
      cursor.pCut = pWord;
      cursor.pCutEnd = pClose + 1;
    }
    break;
  }
  return EVERYTHING_IS_OK;
}

int BaseControl::iAddSize(ScriptCursor& cursor, ScriptContext&) {
  if (!cursor.pPos)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT_ERROR: BaseControl::iAddSize -> !szSave -> return PRECONDITIONS_NOT_VALID");
  const char* pEnd = pSizeEnd(cursor);
  const char* p = std::find_if(cursor.pPos, pEnd, bIsDigit);
  if (p == pEnd) return EVERYTHING_IS_OK;
  for (int& iNumber : m_iSize) {
    // The grammar has no negative numbers: a minus sign is passed over like a blank.
    const char* pNumber = p;
    while (pNumber < pEnd && (*pNumber == ' ' || *pNumber == '\t' || *pNumber == '-')) pNumber++;
    if (pNumber == pEnd || !bIsDigit(*pNumber)) break;
    p = pNumber;
    iNumber = iReadNumber(p, pEnd);
  }
  cursor.pPos = p;
  return EVERYTHING_IS_OK;
}

int BaseControl::iAddStyle(ScriptCursor& cursor, ScriptContext&) {
  if (!cursor.pPos)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: BaseControl::iAddStyle-> !szSave -> return PRECONDITIONS_NOT_VALID");
  const char* pEnd = pActionOrEnd(cursor);
  const char* pComma = FindChar(cursor.pPos, pEnd, ',');
  if (pComma) CopyFlagList(pComma, pEnd, m_csFlags);
  cursor.pPos = pEnd;
  return EVERYTHING_IS_OK;
}

int BaseControl::iReadAction(ScriptCursor& cursor, ScriptContext& context) {
  if (!cursor.pPos)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: BaseControl::iReadAction-> !szSave -> return PRECONDITIONS_NOT_VALID");
  const char* pAction = FindWord(cursor.pPos, cursor.pLineEnd, WORD_ACTION);
  if (!pAction) return EVERYTHING_IS_OK;
  cursor.pPos = pAction + sizeof(WORD_ACTION) - 1;
  return iAddSingleLineAction(cursor, context);
}

int BaseControl::iAddSingleLineAction(ScriptCursor& cursor, ScriptContext& context) {
  if (!cursor.pPos)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: BaseControl::iAddSingleLineAction-> !szSave -> return PRECONDITIONS_NOT_VALID");
  const char* pOpen = FindChar(cursor.pPos, cursor.pLineEnd, '(');
  if (!pOpen) {
    m_csAction = " ()";
  } else if (!FindChar(pOpen, cursor.pLineEnd, ')')) {
    context.Fault(FAULT_PARENTHESIS, cursor);
  } else {
    m_csAction = " ";
    m_csAction.Concat(pOpen, long(cursor.pLineEnd - pOpen));
  }
  cursor.pPos = cursor.pLineEnd;
  return EVERYTHING_IS_OK;
}
