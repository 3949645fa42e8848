#include "controls/DialogInfo.h"

#include <algorithm>
#include <cstring>
#include <memory>

#include "controls/ControlTable.h"
#include "controls/ScriptText.h"
#include "foundation/ResultCodes.h"

using namespace ScriptText;

namespace {

const int FIRST_ID = 501;

bool bIsSpace(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r'; }

// Where END may stand in one line: in a quoted text and in a message box's text it is a word like any other.
const char* pFindEndInLine(const char* pText, const char* pLine, const char* pLineEnd, const char* pTextEnd) {
  const char* p = SkipBlanks(pLine, pLineEnd);
  if (p < pLineEnd && *p == '>') return nullptr;
  for (bool bCloses = true; p < pLineEnd; p++) {
    if (*p == '"') {
      // A quote that nothing closes is text, and so are all behind it: they are not looked for again.
      const char* pClose = bCloses ? FindClosingQuote(p + 1, pLineEnd) : nullptr;
      bCloses = pClose != nullptr;
      if (pClose) p = pClose;
    } else if (bStartsWith(p, pLineEnd, "END", 3) && (p == pText || bIsSpace(p[-1])) &&
               (p + 3 == pTextEnd || bIsSpace(p[3]))) {
      return p;
    }
  }
  return nullptr;
}

void MoveBehindKeyword(ScriptCursor& cursor, int iLength) {
  cursor.pPos += iLength;
  while (cursor.pPos < cursor.pLineEnd &&
         (IsLetter(static_cast<unsigned char>(*cursor.pPos)) || *cursor.pPos == '_' || bIsDigit(*cursor.pPos)))
    cursor.pPos++;
}

}  // namespace

const char* DialogInfo::pFindEnd(const char* pText, const char* pTextEnd) {
  for (const char* pLine = pText; pLine < pTextEnd;) {
    const char* pFeed = FindChar(pLine, pTextEnd, '\n');
    const char* pLineEnd = pFeed ? pFeed : pTextEnd;
    const char* pEnd = pFindEndInLine(pText, pLine, pLineEnd, pTextEnd);
    if (pEnd || !pFeed) return pEnd;
    pLine = pFeed + 1;
  }
  return nullptr;
}

void DialogInfo::ReadControls(const char* pText, const char* pTextEnd, ScriptContext& context) {
  if (!pText || pText >= pTextEnd) return;
  int iNewIDNum = FIRST_ID;
  int bGroupCheck = 0;
  m_pBrace = nullptr;
  const char* pFeed = FindChar(pText, pTextEnd, '\n');
  ScriptCursor cursor{pText, pFeed ? pFeed : pTextEnd, pTextEnd};
  do {
    cursor.pPos = SkipBlanks(cursor.pPos, cursor.pLineEnd);
    ControlLine line{cursor, context, iNewIDNum, bGroupCheck};
    if (bReadBlockLine(line)) continue;
    if (const ControlRow* pRow = ControlRow::pFindContainer(cursor.pPos, cursor.pLineEnd)) {
      MoveBehindKeyword(cursor, pRow->iLength);
      pRow->pRead(*this, *pRow, line);
    } else if (cursor.pPos < cursor.pLineEnd) {
      iAddControls(&cursor, &iNewIDNum, &bGroupCheck, &context);
    }
  } while (cursor.bNextLine());
  CloseUnclosed(0, context);
  // A GROUP that was not closed leaves its boxes without partners.
  m_OpenGroup.RemoveAll();
  // Now and not when the first name is looked up, because threads do that.
  m_pByName = PlacesByName(m_Controls);
  m_nIndexed = m_Controls.Size();
  FindCells();
}

int DialogInfo::iAddControls(ScriptCursor* pCursor, int* iNewIDNum, int* bGroupCheck, ScriptContext* pContext) {
  if (!pCursor)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: DialogInfo::iAddControls -> !szDialog -> return PRECONDITIONS_NOT_VALID");
  if (!pCursor->pPos)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: DialogInfo::iAddControls -> !ptrFind -> return PRECONDITIONS_NOT_VALID");
  if (!iNewIDNum)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: DialogInfo::iAddControls -> !iNewIDNum -> return PRECONDITIONS_NOT_VALID");
  if (!bGroupCheck)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: DialogInfo::iAddControls -> !bGroupCheck -> return PRECONDITIONS_NOT_VALID");
  if (!pContext)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: DialogInfo::iAddControls -> !Dialog -> return PRECONDITIONS_NOT_VALID");
  pCursor->pPos = SkipBlanks(pCursor->pPos, pCursor->pLineEnd);
  const ControlRow* pRow = ControlRow::pFind(pCursor->pPos, pCursor->pLineEnd);
  if (!pRow) return EVERYTHING_IS_OK;
  MoveBehindKeyword(*pCursor, pRow->iLength);
  ControlLine line{*pCursor, *pContext, *iNewIDNum, *bGroupCheck};
  pRow->pRead(*this, *pRow, line);
  return EVERYTHING_IS_OK;
}

int DialogInfo::iAddControl(const ControlRow& row, ControlLine& line) {
  if (!row.szEndWord && SkipBlanks(line.cursor.pPos, line.cursor.pLineEnd) == line.cursor.pLineEnd)
    return iLogReturn(PRECONDITIONS_NOT_VALID, "ERROR: DialogInfo::%s -> !text -> return PRECONDITIONS_NOT_VALID",
                      row.szAdd);
  if (row.bNeedsVariables && !line.context.pVarInfo)
    return iLogReturn(PRECONDITIONS_NOT_VALID, "ERROR: DialogInfo::%s -> !pVarInfo -> return PRECONDITIONS_NOT_VALID",
                      row.szAdd);
  std::unique_ptr<BaseControl> pControl(row.pMake(row));
  const bool bReadsOn = row.szEndWord || pControl->pItemControl() || pControl->Kind() == ControlKind::MsgBox;
  if (bReadsOn && !line.cursor.pTextEnd)
    return iLogReturn(PRECONDITIONS_NOT_VALID, "ERROR: DialogInfo::%s -> !end -> return PRECONDITIONS_NOT_VALID",
                      row.szAdd);
  // Other results are the reader's own fault reports: the control is kept with what could be read.
  if (pControl->iReadScript(line.cursor, line.context) == PRECONDITIONS_NOT_VALID) return PRECONDITIONS_NOT_VALID;
  pControl->TakeIDs(line.iNewIDNum);
  if (m_bGroupClosed && pControl->szWindowClass()) {
    pControl->m_dwStyle |= STYLE_GROUP;
    m_bGroupClosed = false;
  }
  pControl->m_pParent = pAround();
  if (row.bMakesCell()) AddToTable(*pControl);
  m_Controls.Add(pControl.release(), 1);
  return EVERYTHING_IS_OK;
}

void DialogInfo::CloseGroup() {
  if (m_OpenGroup.Size() > 0) m_Groups.Add(new CheckGroup(m_OpenGroup), 1);
  for (int i = 0; i < m_OpenGroup.Size(); i++) m_OpenGroup[i]->m_bGrouped = true;
  // Radio buttons switch each other off up to the next control that begins a group.
  if (m_OpenGroup.Size() > 0) m_OpenGroup[0]->m_dwStyle |= STYLE_GROUP;
  m_bGroupClosed = true;
  m_OpenGroup.RemoveAll();
}

BaseControl* DialogInfo::GetBaseControl(const char* szControlName) const {
  if (!szControlName || !*szControlName)
    return static_cast<BaseControl*>(
        LogPrintf("ERROR: DialogInfo::GetBaseControl -> !szControlName || !*szControlName-> return NULL"));
  const auto iOrder = [&](int i) { return std::strcmp(m_Controls[i]->m_csName.Text(), szControlName); };
  const int* const pEnd = m_pByName.get() + m_nIndexed;
  const int* const pFound =
      std::partition_point<const int*>(m_pByName.get(), pEnd, [&](int i) { return iOrder(i) < 0; });
  if (pFound < pEnd && iOrder(*pFound) == 0) return m_Controls[*pFound];
  for (int i = m_nIndexed; i < m_Controls.Size(); i++)
    if (std::strcmp(m_Controls[i]->m_csName.Text(), szControlName) == 0) return m_Controls[i];
  return nullptr;
}

BaseControl* DialogInfo::GetBaseControl(int iID) const {
  for (int i = 0; i < m_Controls.Size(); i++)
    if (iID != 0 && m_Controls[i]->m_iID == iID) return m_Controls[i];
  return nullptr;
}
