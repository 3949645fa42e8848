#include "controls/ItemKinds.h"

namespace {

const ItemWord g_words[] = {{"COLUMN"}, {"ITEM"}};

const FlagRow g_flags[] = {
    {"SINGLE_SEL", STYLE_LVS_SINGLESEL},
    {"SHOW_ALWAYS", STYLE_LVS_SHOWSELALWAYS},
    {"NOCOLUMNHEADER", STYLE_LVS_NOCOLUMNHEADER},
};

struct ExtendedRow {
  const char* szWord;
  uint32_t dwStyle;
};
const ExtendedRow g_extendedFlags[] = {
    {"FULL_ROW_SEL", STYLE_LVS_EX_FULLROWSELECT},
    {"GRID_LINES", STYLE_LVS_EX_GRIDLINES},
    {"FLAT_SB", STYLE_LVS_EX_FLATSB},
    {"CHECKBOX", STYLE_LVS_EX_CHECKBOXES},
};

// The first one found wins, so that RE_EDIT is not taken for EDIT.
struct EditorRow {
  const char* szWord;
  CellEditor editor;
};
const EditorRow g_editors[] = {
    {"RE_EDIT", CellEditor::RichEdit},
    {"EDIT", CellEditor::Edit},
    {"COMBO", CellEditor::Combo},
    {"PROGRESS", CellEditor::Progress},
};

CellEditor EditorOf(const BaseControl& control) {
  for (const EditorRow& row : g_editors)
    if (control.bHasFlag(row.szWord)) return row.editor;
  return CellEditor::None;
}

}  // namespace

CNListView::CNListView() : CNItemControl(ControlKind::ListView, g_words, "END_LISTVIEW") {}

void CNListView::ReadOwnFlags(ScriptContext&) {
  m_dwExStyle |= STYLE_EX_CLIENTEDGE;
  m_dwStyle |= bHasFlag("LIST") && !bHasFlag("REPORT") ? STYLE_LVS_LIST : STYLE_LVS_REPORT;
  ApplyFlags(g_flags);
  m_bSorts = bHasFlag("SORT");
  if (!m_bSorts) m_dwStyle |= STYLE_LVS_NOSORTHEADER;
  for (const ExtendedRow& row : g_extendedFlags)
    if (bHasFlag(row.szWord)) m_dwExtendedList |= row.dwStyle;
}

void CNListView::ItemsRead(const ScriptCursor&, ScriptContext&) {
  for (int i = 0; i < m_Items.Size(); i++)
    if (m_Items[i]->bIs("COLUMN")) m_Columns.Add(m_Items[i], 0);
}

CellEditor CNListView::Editor(int iColumn) const {
  const CNItem* pOwn = pColumn(iColumn);
  const CellEditor editor = pOwn ? EditorOf(*pOwn) : CellEditor::None;
  return editor == CellEditor::None ? EditorOf(*this) : editor;
}

bool CNListView::bCanEdit(int iColumn) const {
  const CellEditor editor = Editor(iColumn);
  return editor != CellEditor::None && editor != CellEditor::Progress;
}
