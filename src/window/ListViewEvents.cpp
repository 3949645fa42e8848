// What a person does to a list view: editing cells, choosing rows, sorting; and the drawing of cells.
#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <iterator>

#include "foundation/os/OsWide.h"
#include "window/CellEditor.h"
#include "window/ListViewWindow.h"
#include "window/ShownDialog.h"
#include "wizard/WizardView.h"

// ---- editing cells ----

void ListViewWindow::Edit(int iRow, int iColumn) {
  const CNItem* pEdited = pItem(iRow);
  if (!pEdited || pEdited->bHasFlag("DISABLE")) return;
  EndEdit(true);
  ListView_EnsureVisible(hWnd(), iRow, FALSE);
  RECT cell;
  ListView_GetSubItemRect(hWnd(), iRow, iColumn, iColumn ? LVIR_BOUNDS : LVIR_LABEL, &cell);
  RECT row;  // the label of the first cell may end with its text
  ListView_GetItemRect(hWnd(), iRow, &row, LVIR_BOUNDS);
  if (!iColumn) cell.right = row.left + ListView_GetColumnWidth(hWnd(), 0);
  ItemLook look;
  m_iEditRow = iRow;
  m_iEditColumn = iColumn;
  m_hEditor =
      hOpenCellEditor(hWnd(), List().Editor(iColumn), cell, pEdited->szShown(iColumn, look), List().pColumn(iColumn));
}

void ListViewWindow::EndEdit(bool bKeep) {
  const HWND hEditor = m_hEditor;
  if (!hEditor) return;
  m_hEditor = nullptr;  // the field's going must not end the editing again
  CNString csText;
  ItemLook look;
  CNItem* pEdited = pItem(m_iEditRow);
  const bool bNothingChosen =
      List().Editor(m_iEditColumn) == CellEditor::Combo && SendMessageW(hEditor, CB_GETCURSEL, 0, 0) < 0;
  if (bKeep && pEdited && !bNothingChosen && bGetWindowText(hEditor, csText) &&
      strcmp(csText.Text(), pEdited->szShown(m_iEditColumn, look)) != 0) {
    pEdited->SetText(m_iEditColumn, csText.Text());
    List().CountTexts();
    PutCell(*pEdited, m_iEditRow, m_iEditColumn, LVM_SETITEMW);
    Tell(NOTIFY_EDIT_CHANGE);
  }
  if (GetFocus() == hEditor) SetFocus(hWnd());
  DestroyWindow(hEditor);
}

bool ListViewWindow::bTakesEnter() {
  CNString csCommand;
  if (const CNItem* pFocused = pItem(iNext(-1, LVNI_FOCUSED))) ItemCommand(*pFocused, csCommand);
  return !csCommand.bEmpty();
}

bool ListViewWindow::bMessage(const MSG& message, LRESULT&) {
  static const UINT MOVES[] = {WM_VSCROLL, WM_HSCROLL, WM_MOUSEWHEEL, WM_SIZE};
  if (std::find(std::begin(MOVES), std::end(MOVES), message.message) != std::end(MOVES)) EndEdit(true);
  // The window destroys what image lists it has: that of the ticks is its own, that of the pictures is not.
  if (message.message == WM_DESTROY) ListView_SetImageList(hWnd(), nullptr, LVSIL_SMALL);
  if (message.message == CELL_EDITED) {
    if (reinterpret_cast<HWND>(message.lParam) == m_hEditor) EndEdit(message.wParam != 0);
    return true;
  }
  if (message.message != WM_KEYDOWN) return false;
  const int iFocused = iNext(-1, LVNI_FOCUSED);
  if (message.wParam == VK_RETURN && bTakesEnter()) {
    TellChosen(pItem(iFocused));
    return true;
  }
  if (message.wParam != VK_F2) return false;
  for (int i = 0; List().pColumn(i); i++) {
    if (!List().bCanEdit(i)) continue;
    Edit(iFocused, i);
    break;
  }
  return true;
}

// ---- notifications ----

void ListViewWindow::DrawBar(const NMLVCUSTOMDRAW& draw, const char* szText) {
  RECT cell;
  ListView_GetSubItemRect(hWnd(), static_cast<int>(draw.nmcd.dwItemSpec), draw.iSubItem,
                          draw.iSubItem ? LVIR_BOUNDS : LVIR_LABEL, &cell);
  InflateRect(&cell, -3, -2);
  FillRect(draw.nmcd.hdc, &cell, GetSysColorBrush(COLOR_BTNFACE));
  FrameRect(draw.nmcd.hdc, &cell, GetSysColorBrush(COLOR_BTNSHADOW));
  InflateRect(&cell, -1, -1);
  cell.right = cell.left + (cell.right - cell.left) * std::clamp(atoi(szText), 0, 100) / 100;
  FillRect(draw.nmcd.hdc, &cell, GetSysColorBrush(COLOR_HIGHLIGHT));
}

void ListViewWindow::OnCustomDraw(NMHDR& message, NativeEvent& event) {
  auto& draw = reinterpret_cast<NMLVCUSTOMDRAW&>(message);
  event.bAnswered = true;
  if (draw.nmcd.dwDrawStage == CDDS_PREPAINT) event.lResult = CDRF_NOTIFYITEMDRAW;
  if (!(draw.nmcd.dwDrawStage & CDDS_ITEM)) return;
  const bool bCell = (draw.nmcd.dwDrawStage & CDDS_SUBITEM) != 0;
  const int iColumn = bCell ? draw.iSubItem : 0;
  const auto* pDrawn = reinterpret_cast<const CNItem*>(draw.nmcd.lItemlParam);
  if (!pDrawn) return;
  ItemLook look;
  const char* szText = pDrawn->szShown(iColumn, look);
  if (bCell && List().Editor(iColumn) == CellEditor::Progress) {
    DrawBar(draw, szText);
    event.lResult = CDRF_SKIPDEFAULT;
    return;
  }
  draw.clrText = ListView_GetTextColor(hWnd());
  if (look.text.bSet) draw.clrText = ToColorRef(look.text);
  if (pDrawn->bHasFlag("DISABLE") || !IsWindowEnabled(hWnd())) draw.clrText = GetSysColor(COLOR_GRAYTEXT);
  event.lResult = CDRF_NOTIFYSUBITEMDRAW;
  if (pDrawn->m_Font == FontVariant::Normal) return;
  SelectObject(draw.nmcd.hdc, m_Native.Dialog().Fonts().hGet(pDrawn->m_Font));
  event.lResult |= CDRF_NEWFONT;
}

// An item that is disabled keeps its tick.
void ListViewWindow::OnChanging(NMHDR& message, NativeEvent& event) {
  const auto& change = reinterpret_cast<const NMLISTVIEW&>(message);
  const bool bTick = ((change.uOldState ^ change.uNewState) & LVIS_STATEIMAGEMASK) != 0;
  const CNItem* pChanged = pItem(change.iItem);
  if (m_nQuiet || !bTick || !pChanged || !pChanged->bHasFlag("DISABLE")) return;
  event.bAnswered = true;
  event.lResult = TRUE;
}

void ListViewWindow::OnChanged(NMHDR& message, NativeEvent&) {
  const auto& change = reinterpret_cast<const NMLISTVIEW&>(message);
  if ((change.uOldState ^ change.uNewState) & (LVIS_SELECTED | LVIS_STATEIMAGEMASK)) Tell(NOTIFY_SELECTION_CHANGED);
}

void ListViewWindow::OnColumn(NMHDR& message, NativeEvent&) {
  const int iColumn = reinterpret_cast<const NMLISTVIEW&>(message).iSubItem;
  EndEdit(true);
  m_bDown = iColumn == m_iSorted && !m_bDown;
  m_iSorted = iColumn;
  Sort();
}

void ListViewWindow::OnDoubleClick(NMHDR& message, NativeEvent&) {
  LVHITTESTINFO hit = {};
  hit.pt = reinterpret_cast<const NMITEMACTIVATE&>(message).ptAction;
  ListView_SubItemHitTest(hWnd(), &hit);
  if (hit.flags & LVHT_ONITEMSTATEICON && !(hit.flags & LVHT_ONITEMLABEL)) return;  // ticked twice
  if (hit.iItem >= 0 && List().bCanEdit(hit.iSubItem))
    Edit(hit.iItem, hit.iSubItem);
  else
    TellChosen(pItem(hit.iItem));
}

void ListViewWindow::OnInfoTip(NMHDR& message, NativeEvent&) {
  const auto& tip = reinterpret_cast<const NMLVGETINFOTIPW&>(message);
  const CNItem* pTipped = pItem(tip.iItem);
  if (pTipped && !pTipped->m_csShownToolTip.bEmpty())
    lstrcpynW(tip.pszText, Wide(pTipped->m_csShownToolTip.Text()), tip.cchTextMax);
}

NativeEvent ListViewWindow::Notify(NativeControl& native, NMHDR& message) {
  static const Row ROWS[] = {
      {static_cast<UINT>(NM_CUSTOMDRAW), &ListViewWindow::OnCustomDraw},
      {static_cast<UINT>(LVN_ITEMCHANGING), &ListViewWindow::OnChanging},
      {static_cast<UINT>(LVN_ITEMCHANGED), &ListViewWindow::OnChanged},
      {static_cast<UINT>(LVN_COLUMNCLICK), &ListViewWindow::OnColumn},
      {static_cast<UINT>(NM_DBLCLK), &ListViewWindow::OnDoubleClick},
      {static_cast<UINT>(LVN_GETINFOTIPW), &ListViewWindow::OnInfoTip},
  };
  NativeEvent event = Told(message);
  if (message.hwndFrom != native.hWnd() || !native.m_pState) return event;
  for (const Row& row : ROWS)
    if (row.uCode == message.code) (Of<ListViewWindow>(native).*row.pHandler)(message, event);
  return event;
}
