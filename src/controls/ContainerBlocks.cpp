// The blocks within a dialog that are open while its lines are read: containers, and tables between their braces. What
// is read belongs to the innermost container; whatever is not closed is reported at its own line when what stands
// around it ends, and what it would hold belongs to the level around it.
#include <cstring>

#include "controls/ContainerKinds.h"
#include "controls/ControlTable.h"
#include "controls/ScriptText.h"
#include "foundation/ResultCodes.h"

using namespace ScriptText;

namespace {

CNLayoutTable& TableOf(const OpenBlock& block) { return static_cast<CNLayoutTable&>(*block.pTable); }

// A table that will not load: the reason is shown once, and the table goes when it is closed.
void DropTable(OpenBlock& block, const ScriptContext& context, const char* szReason) {
  if (block.bDropped) return;
  block.bDropped = true;
  if (context.pReport) context.pReport->Show(szReason, "Syntax Error");
}

void DropIncomplete(OpenBlock& block, const ScriptContext& context, const char* szMissing) {
  CNString csText;
  DropTable(block, context,
            csText.Printf("DialogInfo::iSaveTableBuffer", "csText",
                          "Error: After TABLE_START Missing \"%s\", Tables will not load", szMissing));
}

int iLogDropped() { return iLogReturn(FUNCTION_ERROR, "EXIT: DialogInfo::iSaveTableBuffer-> return FUNCTION_ERROR"); }

}  // namespace

BaseControl* DialogInfo::pAround() const {
  for (int i = m_OpenBlocks.Size() - 1; i >= 0; i--)
    if (m_OpenBlocks[i]->pContainer && !bIsTabControl(m_OpenBlocks[i]->pContainer)) return m_OpenBlocks[i]->pContainer;
  return nullptr;
}

// A control that stands between the braces of a table. The table names it, also when it is written back.
void DialogInfo::AddToTable(BaseControl& control) {
  OpenBlock* pBlock = pInnermost();
  if (!pBlock || !pBlock->pTable) return;
  if (control.m_csName.bEmpty())
    control.m_csName.Printf("DialogInfo::AddToTable", "m_csName", "cell_%d", m_Controls.Size() + 1);
  TableOf(*pBlock).AddCell(control);
}

void DialogInfo::OpenContainer(CNContainer& container, const ControlLine& line) {
  auto* pOpened = new OpenBlock;
  pOpened->pContainer = &container;
  pOpened->begin = line.cursor;
  pOpened->iFirst = m_Controls.Size();
  m_OpenBlocks.Add(pOpened, 1);
  if (m_OpenBlocks.Size() > NESTING_LIMIT) CloseUnclosed(m_OpenBlocks.Size() - 1, line.context);
}

void DialogInfo::CloseUnclosed(int iFirst, const ScriptContext& context) {
  for (int i = iFirst; i < m_OpenBlocks.Size(); i++) {
    OpenBlock& block = *m_OpenBlocks[i];
    if (block.pContainer) context.Fault(FAULT_MISSING_WORD, block.begin, block.pContainer->szEndWord());
    if (!block.pTable) continue;
    DropIncomplete(block, context, "{");
    iLogDropped();
  }
  while (m_OpenBlocks.Size() > iFirst) {
    OpenBlock& block = *pInnermost();
    BaseControl* pTo = block.pContainer ? block.pContainer->m_pParent : nullptr;
    while (bIsTabControl(pTo)) pTo = pTo->m_pParent;
    // The pages of a tab control stay its own.
    for (int i = block.iFirst; block.pContainer && i < m_Controls.Size(); i++)
      if (m_Controls[i]->m_pParent == block.pContainer && m_Controls[i]->Kind() != ControlKind::Tab)
        m_Controls[i]->m_pParent = pTo;
    m_OpenBlocks.Remove(&block);
  }
}

bool DialogInfo::bReadBlockLine(ControlLine& line) {
  if (bCloseContainer(line)) return true;
  OpenBlock* pBlock = pInnermost();
  if (!pBlock) return false;
  return pBlock->pTable ? bReadTableLine(*pBlock, line) : bOpenPage(*pBlock, line);
}

bool DialogInfo::bCloseContainer(const ControlLine& line) {
  const ScriptCursor& cursor = line.cursor;
  if (!bStartsWith(cursor.pPos, cursor.pLineEnd, "END_")) return false;
  for (int i = m_OpenBlocks.Size() - 1; i >= 0; i--) {
    const CNContainer* pContainer = m_OpenBlocks[i]->pContainer;
    if (!pContainer || !bStartsWithWord(cursor.pPos, cursor.pLineEnd, pContainer->szEndWord())) continue;
    CloseUnclosed(i + 1, line.context);
    m_Controls.Add(new CNBlockEnd(*pContainer), 1);
    m_OpenBlocks.Remove(pInnermost());
    return true;
  }
  return false;
}

// A page within another page: that one was not closed.
bool DialogInfo::bOpenPage(const OpenBlock& block, ControlLine& line) {
  BaseControl* pParent = block.pContainer;
  const bool bInPage = pParent->Kind() == ControlKind::Tab;
  if (bInPage) pParent = pParent->m_pParent;
  if (!bIsTabControl(pParent)) return false;
  auto& tabs = static_cast<CNTabControl&>(*pParent);
  CNContainer* pPage = tabs.pMakePage(line.cursor.pPos, line.cursor.pLineEnd);
  if (!pPage) return false;
  if (bInPage) CloseUnclosed(m_OpenBlocks.Size() - 1, line.context);
  line.cursor.pPos += std::strlen(pPage->szKeyword());
  pPage->iReadScript(line.cursor, line.context);
  pPage->m_pParent = &tabs;
  pPage->TakeIDs(line.iNewIDNum);
  tabs.m_Pages.Add(pPage, 0);
  m_Controls.Add(pPage, 1);
  OpenContainer(*pPage, line);
  return true;
}

// ---- tables ----

int DialogInfo::iAddTable(ScriptCursor& cursor, const ScriptContext& context) {
  if (!cursor.pPos)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: DialogInfo::iSaveTableBuffer-> !ptrMove-> return PRECONDITIONS_NOT_VALID");
  auto* pBlock = new OpenBlock;
  pBlock->pTable.reset(new CNLayoutTable);
  pBlock->pTable->m_pParent = pAround();
  const char* pOpen = SkipSpace(cursor.pPos, cursor.pTextEnd);
  // Looked for once, not again for each of many tables.
  if (m_pBrace < pOpen) m_pBrace = FindChar(pOpen, cursor.pTextEnd, '}');
  if (!m_pBrace) m_pBrace = cursor.pTextEnd;
  const bool bBraces = pOpen < cursor.pTextEnd && *pOpen == '{' && m_pBrace < cursor.pTextEnd;
  m_OpenBlocks.Add(pBlock, 1);
  if (!bBraces) {
    CloseUnclosed(m_OpenBlocks.Size() - 1, context);
    return FUNCTION_ERROR;
  }
  // The brace may stand on the line of TABLE_START, with what follows.
  if (pOpen < cursor.pLineEnd) {
    cursor.pPos = pOpen;
    ReadTablePart(*pBlock, cursor, context);
  }
  return EVERYTHING_IS_OK;
}

// False for the lines that are read as everywhere else: a container is a cell, all other controls have no business
// here, but are not lost.
bool DialogInfo::bReadTableLine(OpenBlock& block, const ControlLine& line) {
  const ScriptCursor& cursor = line.cursor;
  if (ControlRow::pFindContainer(cursor.pPos, cursor.pLineEnd)) return false;  // all of these make cells
  if (const ControlRow* pRow = ControlRow::pFind(cursor.pPos, cursor.pLineEnd)) {
    if (pRow->pRead == ControlRow::iAddTable)
      CloseUnclosed(m_OpenBlocks.Size() - 1, line.context);
    else if (!pRow->bMakesCell())
      ReadTablePart(block, cursor, line.context);
    return false;
  }
  ReadTablePart(block, cursor, line.context);
  return true;
}

void DialogInfo::ReadTablePart(OpenBlock& block, const ScriptCursor& cursor, const ScriptContext& context) {
  CNLayoutTable& table = TableOf(block);
  if (!table.bReadLine(cursor.pPos, cursor.pLineEnd)) {
    CNString csLine, csText;
    csLine.Copy(cursor.pPos, long(cursor.pLineEnd - cursor.pPos));
    DropTable(block, context,
              csText.Printf("DialogInfo::iSaveTableBuffer", "csText",
                            "Missing single quotation marks (') in line: \n\n\"%s\"\n", csLine.Text()));
  }
  if (!table.bClosed()) return;
  if (table.m_Rows.Size() == 0) DropIncomplete(block, context, "TABLE_ROW");
  if (table.m_Columns.Size() == 0) DropIncomplete(block, context, "TABLE_COLUMN");
  if (block.bDropped) {
    iLogDropped();
  } else {
    m_Tables.Add(&table, 0);
    m_Controls.Add(block.pTable.release(), 1);
  }
  m_OpenBlocks.Remove(&block);
}

// The cells' names, once all controls are read. A table places the controls of its own level only.
void DialogInfo::FindCells() {
  for (int iTable = 0; iTable < m_Tables.Size(); iTable++) {
    const CNLayoutTable& table = *m_Tables[iTable];
    for (int i = 0; i < table.m_Cells.Size(); i++) {
      BaseControl* pControl = GetBaseControl(table.m_Cells[i]->csName.Text());
      if (pControl && pControl->szWindowClass() && pControl->m_pParent == table.m_pParent)
        table.m_Cells[i]->pControl = pControl;
    }
  }
}
