#include <cstring>

#include "controls/Kinds.h"
#include "controls/ScriptText.h"
#include "foundation/Log.h"
#include "foundation/ResultCodes.h"

using namespace ScriptText;

namespace {

const char END_WORD[] = "END_MESSAGE_BOX";

// The first word found wins: a word that holds another stands before it.
struct ButtonsRow {
  const char* szWord;
  MessageButtons buttons;
};
const ButtonsRow g_buttons[] = {
    {"MB_CANCELTRYCONTINUE", MessageButtons::CancelTryContinue},
    {"MB_ABORTRETRYIGNORE", MessageButtons::AbortRetryIgnore},
    {"MB_YESNOCANCEL", MessageButtons::YesNoCancel},
    {"MB_YESNO", MessageButtons::YesNo},
    {"MB_RETRYCANCEL", MessageButtons::RetryCancel},
    {"MB_OKCANCEL", MessageButtons::OkCancel},
    {"MB_OK", MessageButtons::Ok},
};

struct IconRow {
  const char* szWord;
  MessageIcon icon;
};
const IconRow g_icons[] = {
    {"MB_ICONERROR", MessageIcon::Error},
    {"MB_ICONQUESTION", MessageIcon::Question},
    {"MB_ICONEXCLAMATION", MessageIcon::Exclamation},
    {"MB_ICONINFORMATION", MessageIcon::Information},
};

// Appends what a '>' line says: one blank after the sign and quotes around the text are not part of it.
void AppendTextLine(const char* p, const char* pEnd, CNString& csText) {
  p++;
  if (p < pEnd && *p == ' ') p++;
  const char* pLast = pEnd;
  while (pLast > p && (pLast[-1] == ' ' || pLast[-1] == '\t')) pLast--;
  const char* pFirst = SkipBlanks(p, pLast);
  if (pLast - pFirst >= 2 && *pFirst == '"' && pLast[-1] == '"') {
    p = pFirst + 1;
    pEnd = pLast - 1;
  }
  CNString csLine;
  Unescape(p, pEnd, csLine);
  if (csText.Ptr())
    csText.Concat("\n");
  else
    csText.Copy("", 0);
  csText.Concat(csLine.Text());
}

}  // namespace

int CNMessageBox::iReadScript(ScriptCursor& cursor, ScriptContext& context) {
  const int iResult = BaseControl::iReadScript(cursor, context);
  if (iResult != EVERYTHING_IS_OK) return iResult;
  if (iReadLines(cursor, context) == EVERYTHING_IS_OK) return EVERYTHING_IS_OK;
  return iLogReturn(FUNCTION_ERROR, "EXIT: CNMessageBox::iReadScript -> return FUNCTION_ERROR");
}

int CNMessageBox::iReadLines(ScriptCursor& cursor, ScriptContext& context) {
  const char* pEndLine = FindEndLine(cursor.pLineEnd, cursor.pTextEnd, szKeyword(), END_WORD, false);
  if (!pEndLine) {
    context.Fault(FAULT_MISSING_WORD, cursor, END_WORD);
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNMessageBox -> !szClassLines -> return PRECONDITIONS_NOT_VALID");
  }
  while (cursor.bNextLine() && cursor.pLineEnd < pEndLine) {
    const char* p = SkipBlanks(cursor.pPos, cursor.pLineEnd);
    if (p < cursor.pLineEnd && *p == '>') AppendTextLine(p, cursor.pLineEnd, m_csText);
  }
  if (m_csText.Ptr()) return EVERYTHING_IS_OK;
  return iLogReturn(PRECONDITIONS_NOT_VALID, "ERROR: CNMessageBox -> !*szNextLine -> return PRECONDITIONS_NOT_VALID");
}

void CNMessageBox::ReadOwnFlags(ScriptContext&) {
  for (const ButtonsRow& row : g_buttons) {
    if (!bHasFlag(row.szWord)) continue;
    m_Buttons = row.buttons;
    break;
  }
  for (const IconRow& row : g_icons)
    if (bHasFlag(row.szWord)) m_Icon = row.icon;
}

void CNMessageBox::WriteControl(CNString& csOut) const {
  BaseControl::WriteControl(csOut);
  csOut.Concat("\n");
  for (const char* szLine = m_csText.Ptr(); szLine;) {
    const char* pFeed = std::strchr(szLine, '\n');
    csOut.Concat("> \"");
    AppendEscaped(csOut, szLine, pFeed ? size_t(pFeed - szLine) : std::strlen(szLine));
    csOut.Concat("\"\n");
    szLine = pFeed ? pFeed + 1 : nullptr;
  }
  csOut.Concat(END_WORD);
}
