// List views. A list view's text is the first cell of the selected row, or one line for each of several. Each row's
// data is its description.
#include "window/ListViewWindow.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>

#include "foundation/os/OsWide.h"

namespace {

const int LIST_MARGIN = 14;  // beside a text in the kind LIST

}  // namespace

void ListViewWindow::Created() {
  const DWORD dwStyle = List().m_dwExtendedList | LVS_EX_DOUBLEBUFFER | LVS_EX_INFOTIP | LVS_EX_LABELTIP;
  ListView_SetExtendedListViewStyle(hWnd(), dwStyle);
  const ControlColor &ground = List().m_Background, &text = List().m_TextColor;
  if (ground.bSet) ListView_SetBkColor(hWnd(), ToColorRef(ground));
  if (ground.bSet) ListView_SetTextBkColor(hWnd(), ToColorRef(ground));
  if (text.bSet) ListView_SetTextColor(hWnd(), ToColorRef(text));
}

CNItem* ListViewWindow::pItem(int iRow) const {
  LVITEMW row = {};
  row.mask = LVIF_PARAM;
  row.iItem = iRow;
  return iRow >= 0 && Send(LVM_GETITEMW, 0, reinterpret_cast<LPARAM>(&row)) ? reinterpret_cast<CNItem*>(row.lParam)
                                                                            : nullptr;
}

int ListViewWindow::iRowOf(const CNItem* pItem) const {
  LVFINDINFOW find = {};
  find.flags = LVFI_PARAM;
  find.lParam = reinterpret_cast<LPARAM>(pItem);
  return static_cast<int>(Send(LVM_FINDITEMW, static_cast<WPARAM>(-1), reinterpret_cast<LPARAM>(&find)));
}

// ---- rows and columns ----

int ListViewWindow::iInsertColumns() {
  while (ListView_DeleteColumn(hWnd(), 0)) {
  }
  int nColumns = 0;
  for (; const CNItem* pColumn = List().pColumn(nColumns); nColumns++) {
    ItemLook look;
    const CNWideText text(pColumn->szShown(0, look));
    LVCOLUMNW column = {};
    column.mask = LVCF_TEXT | LVCF_WIDTH | LVCF_FMT | LVCF_SUBITEM;
    column.fmt = look.bRight ? LVCFMT_RIGHT : pColumn->bHasFlag("CENTER") ? LVCFMT_CENTER : LVCFMT_LEFT;
    column.cx = pColumn->m_iSize[0];
    column.iSubItem = nColumns;
    column.pszText = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(text.Ptr()));
    Send(LVM_INSERTCOLUMNW, static_cast<WPARAM>(nColumns), reinterpret_cast<LPARAM>(&column));
  }
  if (nColumns) return nColumns;
  LVCOLUMNW column = {};  // rows without columns are shown all the same
  Send(LVM_INSERTCOLUMNW, 0, reinterpret_cast<LPARAM>(&column));
  return 1;
}

// A picture that no cell names leaves the room that the list keeps for one.
void ListViewWindow::PutCell(CNItem& item, int iRow, int iColumn, UINT uMessage) {
  ItemLook look;
  const CNWideText text(item.szShown(iColumn, look));
  LVITEMW cell = {};
  cell.mask = LVIF_TEXT | LVIF_IMAGE | (iColumn ? 0 : LVIF_PARAM);
  cell.iItem = iRow;
  cell.iSubItem = iColumn;
  cell.pszText = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(text.Ptr()));
  cell.iImage = m_Pictures.iFind(m_Native, look.csPicture);
  if (iColumn && strcmp(item.m_Look.csPicture.Text(), look.csPicture.Text()) == 0) cell.iImage = -1;  // the row's own
  if (cell.iImage < 0) cell.iImage = iColumn ? I_IMAGENONE : 0;
  // The class keeps room for a picture in every cell once one may have it.
  if (iColumn && cell.iImage >= 0)
    ListView_SetExtendedListViewStyleEx(hWnd(), LVS_EX_SUBITEMIMAGES, LVS_EX_SUBITEMIMAGES);
  cell.lParam = reinterpret_cast<LPARAM>(&item);
  Send(uMessage, 0, reinterpret_cast<LPARAM>(&cell));
}

void ListViewWindow::InsertRow(CNItem& item, int iRow, int nColumns) {
  for (int i = 0; i < nColumns; i++) PutCell(item, iRow, i, i ? LVM_SETITEMW : LVM_INSERTITEMW);
  if (item.bHasFlag("CHECKED")) ListView_SetCheckState(hWnd(), iRow, TRUE);
}

void ListViewWindow::Fill(const CNCharArray& texts) {
  EndEdit(false);
  List().TakeShown(texts);
  ListView_DeleteAllItems(hWnd());
  const int nColumns = iInsertColumns();
  int nRows = 0, iWidest = 0;
  ItemLook look;
  for (int i = 0; i < List().m_Items.Size(); i++) {
    CNItem& item = *List().m_Items[i];
    if (!item.bIs("ITEM")) continue;
    InsertRow(item, nRows++, bReport() ? nColumns : 1);
    iWidest = std::max(iWidest, iTextWidth(m_Native, item.szShown(0, look)));
  }
  if (m_Pictures.hList()) ListView_SetImageList(hWnd(), m_Pictures.hList(), LVSIL_SMALL);
  if (!bReport()) ListView_SetColumnWidth(hWnd(), 0, iWidest + m_Pictures.Size().cx + 2 * LIST_MARGIN);
  for (int i = 0; bReport() && i < nColumns; i++)
    if (const CNItem* pColumn = List().pColumn(i); !pColumn || !pColumn->m_iSize[0])
      ListView_SetColumnWidth(hWnd(), i, LVSCW_AUTOSIZE_USEHEADER);
  Sort();
}

int CALLBACK ListViewWindow::Compare(LPARAM lFirst, LPARAM lSecond, LPARAM lWindow) {
  const auto& window = *reinterpret_cast<const ListViewWindow*>(lWindow);
  ItemLook look;
  const char* szFirst = reinterpret_cast<const CNItem*>(lFirst)->szShown(window.m_iSorted, look);
  const char* szSecond = reinterpret_cast<const CNItem*>(lSecond)->szShown(window.m_iSorted, look);
  const auto isDigit = [](char c) { return c >= '0' && c <= '9'; };
  int iOrder = 0;
  if (isDigit(*szFirst) && isDigit(*szSecond)) iOrder = atoi(szFirst) - atoi(szSecond);
  if (!iOrder) iOrder = lstrcmpiW(Wide(szFirst), Wide(szSecond));
  return window.m_bDown ? -iOrder : iOrder;
}

void ListViewWindow::Sort() {
  if (m_iSorted < 0) return;
  ListView_SortItems(hWnd(), Compare, reinterpret_cast<LPARAM>(this));
  const HWND hHeader = ListView_GetHeader(hWnd());
  HDITEMW heading = {};
  heading.mask = HDI_FORMAT;
  for (int i = 0; SendMessageW(hHeader, HDM_GETITEMW, static_cast<WPARAM>(i), reinterpret_cast<LPARAM>(&heading));
       i++) {
    heading.fmt &= ~(HDF_SORTUP | HDF_SORTDOWN);
    if (i == m_iSorted) heading.fmt |= m_bDown ? HDF_SORTDOWN : HDF_SORTUP;
    SendMessageW(hHeader, HDM_SETITEMW, static_cast<WPARAM>(i), reinterpret_cast<LPARAM>(&heading));
  }
}

// ---- value and ticks ----

void ListViewWindow::SetValue(const char* szText) {
  ListView_SetItemState(hWnd(), -1, 0, LVIS_SELECTED);
  const int nRows = ListView_GetItemCount(hWnd());
  CNString csLine;
  ItemLook look;
  for (const char* p = szText; *p; p += *p == '\n') {
    const size_t nLength = strcspn(p, "\n");
    csLine.Copy(p, static_cast<long>(nLength));
    p += nLength;
    int iRow = 0;
    while (iRow < nRows && strcmp(pItem(iRow)->szShown(0, look), csLine.Text()) != 0) iRow++;
    if (iRow == nRows) continue;
    ListView_SetItemState(hWnd(), iRow, LVIS_SELECTED | LVIS_FOCUSED, LVIS_SELECTED | LVIS_FOCUSED);
    ListView_EnsureVisible(hWnd(), iRow, FALSE);
  }
}

// A page may be left by a key that does not end the editing.
void ListViewWindow::GetValue(CNString& csText) {
  EndEdit(true);
  ItemLook look;
  for (int i = -1; (i = iNext(i, LVNI_SELECTED)) >= 0;) {
    if (!csText.bEmpty()) csText.Concat("\n");
    csText.Concat(pItem(i)->szShown(0, look));
  }
}

bool ListViewWindow::bCheckItem(NativeControl& native, int iItem, bool bChecked) {
  auto& list = Of<ListViewWindow>(native);
  const int iRow = list.iRowOf(list.List().m_Items[iItem]);
  const Quiet quiet(list.m_nQuiet);
  if (iRow >= 0) ListView_SetCheckState(native.hWnd(), iRow, bChecked);
  return iRow >= 0;
}

bool ListViewWindow::bIsItemChecked(NativeControl& native, int iItem, bool& bChecked) {
  const auto& list = Of<ListViewWindow>(native);
  const int iRow = list.iRowOf(list.List().m_Items[iItem]);
  if (iRow < 0 || !(list.List().m_dwExtendedList & STYLE_LVS_EX_CHECKBOXES)) return false;
  bChecked = ListView_GetCheckState(native.hWnd(), static_cast<UINT>(iRow)) == 1;
  return true;
}

const NativeKind g_ListViewWindow = {.kind = ControlKind::ListView,
                                     .dwStyle = WS_CLIPCHILDREN,
                                     .bField = true,
                                     .pCreated = ItemWindow::Create<ListViewWindow>,
                                     .pSetText = ItemWindow::bSetText,
                                     .pGetText = ItemWindow::bGetText,
                                     .pNotify = ListViewWindow::Notify,
                                     .pSetItems = ItemWindow::SetItems,
                                     .pCheckItem = ListViewWindow::bCheckItem,
                                     .pIsItemChecked = ListViewWindow::bIsItemChecked};
