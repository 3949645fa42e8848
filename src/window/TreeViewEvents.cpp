// What a person does to a tree: moving branches, ticking and choosing items; and the drawing of items.
#include "foundation/os/OsWide.h"
#include "window/ShownDialog.h"
#include "window/TreeViewWindow.h"
#include "wizard/WizardView.h"

// ---- moving items ----

TreeWindow::DropPlace TreeWindow::Place(POINT screen) const {
  ScreenToClient(hWnd(), &screen);
  const HTREEITEM hItem = hAt(screen, TVHT_ONITEM | TVHT_ONITEMINDENT | TVHT_ONITEMBUTTON | TVHT_ONITEMRIGHT);
  RECT row = {};
  if (hItem) TreeView_GetItemRect(hWnd(), hItem, &row, FALSE);
  return {hItem, screen.y < (row.top + row.bottom) / 2};
}

void TreeWindow::MarkDrop(const POINT* pScreen) {
  const DropPlace place = pScreen ? Place(*pScreen) : DropPlace{nullptr, false};
  Send(TVM_SETINSERTMARK, FALSE, reinterpret_cast<LPARAM>(place.bBefore ? place.hItem : nullptr));
  Send(TVM_SELECTITEM, TVGN_DROPHILITE, reinterpret_cast<LPARAM>(place.bBefore ? nullptr : place.hItem));
}

HTREEITEM TreeWindow::hCopyBranch(HTREEITEM hItem, TreeWindow& to, HTREEITEM hParent, HTREEITEM hAfter) {
  const HTREEITEM hNew = to.hInsert(*pItem(hItem), hParent, hAfter);
  const bool bTicks = (Tree().m_dwStyle & to.Tree().m_dwStyle & STYLE_TVS_CHECKBOXES) != 0;
  if (bTicks) TreeView_SetCheckState(to.hWnd(), hNew, TreeView_GetCheckState(hWnd(), hItem) == 1);
  for (HTREEITEM h = hGet(TVGN_CHILD, hItem); h; h = hGet(TVGN_NEXT, h)) hCopyBranch(h, to, hNew, TVI_LAST);
  if (TreeView_GetItemState(hWnd(), hItem, TVIS_EXPANDED) & TVIS_EXPANDED) TreeView_Expand(to.hWnd(), hNew, TVE_EXPAND);
  return hNew;
}

void TreeWindow::Drop(LPARAM lItem, ItemWindow& target, POINT screen) {
  auto& to = static_cast<TreeWindow&>(target);
  const auto hMoved = reinterpret_cast<HTREEITEM>(lItem);
  const DropPlace place = to.Place(screen);
  if (!pItem(hMoved)) return;
  for (HTREEITEM h = place.hItem; h && &to == this; h = hGet(TVGN_PARENT, h))
    if (h == hMoved) return;  // nothing moves into itself
  const Quiet quiet(m_nQuiet), quietToo(to.m_nQuiet);
  HTREEITEM hParent = place.bBefore && place.hItem ? to.hGet(TVGN_PARENT, place.hItem) : place.hItem;
  if (!hParent) hParent = TVI_ROOT;
  HTREEITEM hAfter = TVI_LAST;
  if (place.bBefore && place.hItem && !(hAfter = to.hGet(TVGN_PREVIOUS, place.hItem))) hAfter = TVI_FIRST;
  const HTREEITEM hNew = hCopyBranch(hMoved, to, hParent, hAfter);
  TreeView_DeleteItem(hWnd(), hMoved);
  if (to.m_Pictures.hList()) TreeView_SetImageList(to.hWnd(), to.m_Pictures.hList(), TVSIL_NORMAL);
  if (hParent != TVI_ROOT) TreeView_Expand(to.hWnd(), hParent, TVE_EXPAND);
  TreeView_SelectItem(to.hWnd(), hNew);
  CNArray<CNItem> own, others;
  TakeOrder(own);
  to.TakeOrder(others);
  SetOrder(own);
  if (&to != this) to.SetOrder(others);
  to.m_nQuiet--;
  to.Tell(NOTIFY_SELECTION_CHANGED);
  to.m_nQuiet++;
}

// The description follows, so that the tree is the same when its dialog is shown again.
void TreeWindow::TakeOrder(CNArray<CNItem>& items) const {
  for (HTREEITEM h = hGet(TVGN_ROOT); h; h = hNext(h)) {
    int iLevel = 0, iPlace = 0;
    for (HTREEITEM hUp = h; (hUp = hGet(TVGN_PARENT, hUp));) iLevel++;
    for (HTREEITEM hBefore = h; (hBefore = hGet(TVGN_PREVIOUS, hBefore));) iPlace++;
    pItem(h)->m_csName.Printf("TreeWindow::TakeOrder", "m_csName", "%d,%d", iLevel, iPlace);
    items.Add(pItem(h), 0);
  }
  // From now on the items are not owned by the description, until SetOrder.
  CNArray<CNItem>& owned = Tree().m_Items;
  if (owned.Size()) owned.Add(owned[0], 0);
  owned.RemoveAll();
}

void TreeWindow::SetOrder(const CNArray<CNItem>& items) {
  for (int i = 0; i < items.Size(); i++) Tree().m_Items.Add(items[i], 1);
  Tree().CountTexts();
}

// ---- messages ----

bool TreeWindow::bTakesEnter() {
  CNString csCommand;
  if (const CNItem* pSelected = pItem(hGet(TVGN_CARET))) ItemCommand(*pSelected, csCommand);
  return !csCommand.bEmpty();
}

// True when a tick is not to change. The system would change it whatever a notification says.
bool TreeWindow::bKeepsTick(const MSG& message) {
  const bool bKey = (message.message == WM_KEYDOWN || message.message == WM_CHAR) && message.wParam == VK_SPACE;
  const bool bMouse = message.message == WM_LBUTTONDOWN || message.message == WM_LBUTTONDBLCLK;
  const POINT point = {static_cast<short>(LOWORD(message.lParam)), static_cast<short>(HIWORD(message.lParam))};
  const CNItem* pTicked = nullptr;
  if (bKey) pTicked = pItem(hGet(TVGN_CARET));
  if (bMouse) pTicked = pItem(hAt(point, TVHT_ONITEMSTATEICON));
  if (!pTicked || !(Tree().m_dwStyle & STYLE_TVS_CHECKBOXES)) return false;
  if (pTicked->bHasFlag("DISABLE")) return true;
  if (message.message != WM_CHAR) Tell(NOTIFY_SELECTION_CHANGED);
  return false;
}

bool TreeWindow::bMessage(const MSG& message, LRESULT&) {
  if (message.message == WM_DESTROY) m_hTicks = TreeView_GetImageList(hWnd(), TVSIL_STATE);
  if (bKeepsTick(message)) return true;
  if (message.message != WM_KEYDOWN || message.wParam != VK_RETURN || !bTakesEnter()) return false;
  TellChosen(pItem(hGet(TVGN_CARET)));
  return true;
}

void TreeWindow::OnCustomDraw(NMHDR& message, NativeEvent& event) {
  auto& draw = reinterpret_cast<NMTVCUSTOMDRAW&>(message);
  event.bAnswered = true;
  if (draw.nmcd.dwDrawStage == CDDS_PREPAINT) event.lResult = CDRF_NOTIFYITEMDRAW;
  const auto* pDrawn = reinterpret_cast<const CNItem*>(draw.nmcd.lItemlParam);
  if (draw.nmcd.dwDrawStage != CDDS_ITEMPREPAINT || !pDrawn) return;
  ItemLook look;
  pDrawn->szShown(0, look);
  if (!(draw.nmcd.uItemState & CDIS_SELECTED)) {
    if (look.text.bSet) draw.clrText = ToColorRef(look.text);
    if (pDrawn->bHasFlag("DISABLE") || !IsWindowEnabled(hWnd())) draw.clrText = GetSysColor(COLOR_GRAYTEXT);
  }
  if (pDrawn->m_Font != FontVariant::Italic && pDrawn->m_Font != FontVariant::Underline) return;
  SelectObject(draw.nmcd.hdc, m_Native.Dialog().Fonts().hGet(pDrawn->m_Font));
  event.lResult = CDRF_NEWFONT;
}

void TreeWindow::OnSelected(NMHDR& message, NativeEvent&) {
  if (reinterpret_cast<const NMTREEVIEWW&>(message).action != TVC_UNKNOWN) Tell(NOTIFY_SELECTION_CHANGED);
}

// An item that does something is not opened and closed as well.
void TreeWindow::OnDoubleClick(NMHDR&, NativeEvent& event) {
  POINT point;
  GetCursorPos(&point);
  ScreenToClient(hWnd(), &point);
  CNItem* pChosen = pItem(hAt(point, TVHT_ONITEM & ~TVHT_ONITEMSTATEICON));
  if (!pChosen) return;
  TellChosen(pChosen);
  event.bAnswered = true;
  event.lResult = bTakesEnter();
}

void TreeWindow::OnInfoTip(NMHDR& message, NativeEvent&) {
  const auto& tip = reinterpret_cast<const NMTVGETINFOTIPW&>(message);
  const auto* pTipped = reinterpret_cast<const CNItem*>(tip.lParam);
  if (pTipped && !pTipped->m_csShownToolTip.bEmpty())
    lstrcpynW(tip.pszText, Wide(pTipped->m_csShownToolTip.Text()), tip.cchTextMax);
}

void TreeWindow::OnBeginDrag(NMHDR& message, NativeEvent&) {
  const auto& drag = reinterpret_cast<const NMTREEVIEWW&>(message);
  if (m_Dragging.bAny && m_Dragging.bRightButton == (message.code == static_cast<UINT>(TVN_BEGINRDRAGW)))
    StartDrag(reinterpret_cast<LPARAM>(drag.itemNew.hItem), drag.ptDrag);
}

NativeEvent TreeWindow::Notify(NativeControl& native, NMHDR& message) {
  static const Row ROWS[] = {
      {static_cast<UINT>(NM_CUSTOMDRAW), &TreeWindow::OnCustomDraw},
      {static_cast<UINT>(TVN_SELCHANGEDW), &TreeWindow::OnSelected},
      {static_cast<UINT>(NM_DBLCLK), &TreeWindow::OnDoubleClick},
      {static_cast<UINT>(TVN_GETINFOTIPW), &TreeWindow::OnInfoTip},
      {static_cast<UINT>(TVN_BEGINDRAGW), &TreeWindow::OnBeginDrag},
      {static_cast<UINT>(TVN_BEGINRDRAGW), &TreeWindow::OnBeginDrag},
  };
  NativeEvent event = Told(message);
  if (message.hwndFrom != native.hWnd() || !native.m_pState) return event;
  for (const Row& row : ROWS)
    if (row.uCode == message.code) (Of<TreeWindow>(native).*row.pHandler)(message, event);
  return event;
}
