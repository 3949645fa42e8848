// Trees. A tree's text is the path of the selected item: the texts from the root to it, joined by backslashes. Each
// item's data is its description.
#include "window/TreeViewWindow.h"

#include <algorithm>
#include <cstring>

#include "foundation/os/OsWide.h"

namespace {

const int LEVELS = 64;  // deeper items stand on the last one

}  // namespace

TreeWindow::~TreeWindow() {
  if (m_hTicks) ImageList_Destroy(m_hTicks);
}

void TreeWindow::Created() {
  // Ticks that are asked for when the window is made lose their first states.
  if (Tree().m_dwStyle & STYLE_TVS_CHECKBOXES)
    SetWindowLongW(hWnd(), GWL_STYLE, GetWindowLongW(hWnd(), GWL_STYLE) | TVS_CHECKBOXES);
  if (Tree().m_Background.bSet) TreeView_SetBkColor(hWnd(), ToColorRef(Tree().m_Background));
  if (Tree().m_TextColor.bSet) TreeView_SetTextColor(hWnd(), ToColorRef(Tree().m_TextColor));
}

// ---- walking ----

// The item below, then beside, then beside those around it.
HTREEITEM TreeWindow::hNext(HTREEITEM hItem) const {
  if (const HTREEITEM hChild = hGet(TVGN_CHILD, hItem)) return hChild;
  for (; hItem; hItem = hGet(TVGN_PARENT, hItem))
    if (const HTREEITEM hBeside = hGet(TVGN_NEXT, hItem)) return hBeside;
  return nullptr;
}

CNItem* TreeWindow::pItem(HTREEITEM hItem) const {
  TVITEMW item = {};
  item.mask = TVIF_PARAM;
  item.hItem = hItem;
  return hItem && Send(TVM_GETITEMW, 0, reinterpret_cast<LPARAM>(&item)) ? reinterpret_cast<CNItem*>(item.lParam)
                                                                         : nullptr;
}

HTREEITEM TreeWindow::hFind(const CNItem* pWanted) const {
  HTREEITEM hItem = hGet(TVGN_ROOT);
  while (hItem && pItem(hItem) != pWanted) hItem = hNext(hItem);
  return hItem;
}

void TreeWindow::Path(HTREEITEM hItem, CNString& csPath) const {
  csPath = "";
  ItemLook look;
  for (const CNItem* p; (p = pItem(hItem)); hItem = hGet(TVGN_PARENT, hItem)) {
    if (!csPath.bEmpty()) csPath.iInsert("\\", 0);
    csPath.iInsert(p->szShown(0, look), 0);
  }
}

HTREEITEM TreeWindow::hAt(POINT point, UINT uFlags) const {
  TVHITTESTINFO hit = {};
  hit.pt = point;
  const HTREEITEM hItem = TreeView_HitTest(hWnd(), &hit);
  return hit.flags & uFlags ? hItem : nullptr;
}

// ---- items ----

HTREEITEM TreeWindow::hInsert(CNItem& item, HTREEITEM hParent, HTREEITEM hAfter) {
  ItemLook look;
  const CNWideText text(item.szShown(0, look));
  TVINSERTSTRUCTW insert = {};
  insert.hParent = hParent;
  insert.hInsertAfter = hAfter;
  TVITEMW& row = insert.item;
  row.mask = TVIF_TEXT | TVIF_PARAM | TVIF_IMAGE | TVIF_SELECTEDIMAGE | TVIF_STATE;
  row.pszText = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(text.Ptr()));
  row.lParam = reinterpret_cast<LPARAM>(&item);
  row.iImage = row.iSelectedImage = std::max(0, m_Pictures.iFind(m_Native, look.csPicture));
  // The system measures bold texts by this state.
  if (item.m_Font == FontVariant::Bold || item.m_Font == FontVariant::BigBold) row.state = row.stateMask = TVIS_BOLD;
  const auto hNew = reinterpret_cast<HTREEITEM>(Send(TVM_INSERTITEMW, 0, reinterpret_cast<LPARAM>(&insert)));
  if (Tree().m_dwStyle & STYLE_TVS_CHECKBOXES) TreeView_SetCheckState(hWnd(), hNew, item.bHasFlag("CHECKED"));
  return hNew;
}

HTREEITEM TreeWindow::hPlaceAfter(HTREEITEM hParent, int iPlace) const {
  if (iPlace < 0) return TVI_LAST;
  HTREEITEM hAfter = TVI_FIRST;
  for (HTREEITEM h = hParent == TVI_ROOT ? hGet(TVGN_ROOT) : hGet(TVGN_CHILD, hParent); h && iPlace-- > 0;
       h = hGet(TVGN_NEXT, h))
    hAfter = h;
  return hAfter;
}

void TreeWindow::Fill(const CNCharArray& texts) {
  Tree().TakeShown(texts);
  TreeView_DeleteAllItems(hWnd());
  HTREEITEM parents[LEVELS + 1] = {TVI_ROOT};  // of each level, the item that was put there last
  int iDeepest = 0;
  for (int i = 0; i < Tree().m_Items.Size(); i++) {
    CNItem& item = *Tree().m_Items[i];
    int iLevel = 0, iPlace = 0;
    CNTreeView::Position(item, iLevel, iPlace);
    iLevel = std::min({iLevel, iDeepest, LEVELS - 1});
    parents[iLevel + 1] = hInsert(item, parents[iLevel], hPlaceAfter(parents[iLevel], iPlace));
    iDeepest = iLevel + 1;
  }
  if (m_Pictures.hList()) TreeView_SetImageList(hWnd(), m_Pictures.hList(), TVSIL_NORMAL);
  for (HTREEITEM h = hGet(TVGN_ROOT); h; h = hNext(h))
    if (hGet(TVGN_CHILD, h) && !pItem(h)->bHasFlag("COLLAPSED")) TreeView_Expand(hWnd(), h, TVE_EXPAND);
  Send(WM_VSCROLL, SB_TOP);
}

void TreeWindow::SetValue(const char* szText) {
  CNString csPath;
  HTREEITEM hItem = hGet(TVGN_ROOT);
  for (; hItem; hItem = hNext(hItem)) {
    Path(hItem, csPath);
    if (strcmp(csPath.Text(), szText) == 0) break;
  }
  TreeView_SelectItem(hWnd(), hItem);
  Send(WM_HSCROLL, SB_LEFT);  // a long text does not take the lines before it out of sight
}

bool TreeWindow::bCheckItem(NativeControl& native, int iItem, bool bChecked) {
  auto& tree = Of<TreeWindow>(native);
  const Quiet quiet(tree.m_nQuiet);
  const HTREEITEM hItem = tree.hFind(tree.Tree().m_Items[iItem]);
  if (!hItem || !(tree.Tree().m_dwStyle & STYLE_TVS_CHECKBOXES)) return false;
  TreeView_SetCheckState(native.hWnd(), hItem, bChecked);
  return true;
}

bool TreeWindow::bIsItemChecked(NativeControl& native, int iItem, bool& bChecked) {
  const auto& tree = Of<TreeWindow>(native);
  const HTREEITEM hItem = tree.hFind(tree.Tree().m_Items[iItem]);
  if (!hItem || !(tree.Tree().m_dwStyle & STYLE_TVS_CHECKBOXES)) return false;
  bChecked = TreeView_GetCheckState(native.hWnd(), hItem) == 1;
  return true;
}

const NativeKind g_TreeViewWindow = {.kind = ControlKind::TreeView,
                                     .dwRemovedStyle = TVS_CHECKBOXES,
                                     .bField = true,
                                     .pCreated = ItemWindow::Create<TreeWindow>,
                                     .pSetText = ItemWindow::bSetText,
                                     .pGetText = ItemWindow::bGetText,
                                     .pNotify = TreeWindow::Notify,
                                     .pSetItems = ItemWindow::SetItems,
                                     .pCheckItem = TreeWindow::bCheckItem,
                                     .pIsItemChecked = TreeWindow::bIsItemChecked};
