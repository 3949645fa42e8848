// The blocks of a dialog that are kept as text: its two action texts.
#include "controls/DialogInfo.h"
#include "controls/ScriptText.h"
#include "foundation/ResultCodes.h"

using namespace ScriptText;

namespace {

const char WORD_START[] = "START_ACTION";
const char WORD_FINISH[] = "FINISH_ACTION";

// Leaves the cursor at the end of the line that holds p.
void MoveToLineEnd(ScriptCursor& cursor, const char* p) {
  const char* pFeed = FindChar(p, cursor.pTextEnd, '\n');
  cursor.pPos = cursor.pLineEnd = pFeed ? pFeed : cursor.pTextEnd;
}

void ShowMissing(const ScriptContext& context, const char* szWord, const char* szKeyword) {
  CNString csText;
  csText.Printf("DialogInfo::AddExecuteAction", "csText", "Missing %s after %s!", szWord, szKeyword);
  if (context.pReport) context.pReport->Show(csText.Text(), "Syntax Error");
}

int iMissing(const ScriptContext& context, const char* szWord, const char* szKeyword) {
  ShowMissing(context, szWord, szKeyword);
  return iLogReturn(FUNCTION_ERROR,
                    "ERROR: DialogInfo::AddExecuteAction -> Missing %s after %s! -> return FUNCTION_ERROR", szWord,
                    szKeyword);
}

}  // namespace

int DialogInfo::iAddExecuteAction(ScriptCursor& cursor, const ScriptContext& context, const char* szKeyword,
                                  CNString& csText) {
  // Only the block after drawing has lines and a result of its own for these two: deliberate.
  const bool bAfter = &csText == &m_csAfterDrawing;
  if (bAfter && !cursor.pLineEnd)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT_ERROR: DialogInfo::AddExecuteAction -> (!ptrSearch || !*ptrSearch) -> return "
                      "PRECONDITIONS_NOT_VALID");
  const char* pStart = cursor.pTextEnd ? SkipSpace(cursor.pLineEnd, cursor.pTextEnd) : nullptr;
  if (pStart == cursor.pTextEnd && bAfter) {
    ShowMissing(context, WORD_START, szKeyword);
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT_ERROR: DialogInfo::AddExecuteAction -> (!*szDialogCommands || !**szDialogCommands) -> "
                      "return PRECONDITIONS_NOT_VALID");
  }
  if (!bStartsWith(pStart, cursor.pTextEnd, WORD_START)) return iMissing(context, WORD_START, szKeyword);

  const char* pFeed = FindChar(pStart, cursor.pTextEnd, '\n');
  const char* pFirst = pFeed ? pFeed + 1 : cursor.pTextEnd;
  // A finish that belongs to the next block is none: it would make that block's commands part of this one.
  const char* pNext = FindText(pFirst, cursor.pTextEnd, WORD_START);
  const char* pFinish = FindText(pFirst, pNext ? pNext : cursor.pTextEnd, WORD_FINISH);
  if (!pFinish) return iMissing(context, WORD_FINISH, szKeyword);

  MoveToLineEnd(cursor, pFinish);
  csText.Copy(pFirst, long(cursor.pLineEnd - pFirst));
  return EVERYTHING_IS_OK;
}
