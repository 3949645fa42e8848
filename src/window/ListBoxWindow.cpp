// List boxes. A list's text is its selected item, or one line for each where several can be selected. Each item's data
// is its text with the look in front of it.
#include <algorithm>
#include <cstring>

#include "foundation/os/OsWide.h"
#include "window/ItemWindow.h"
#include "window/ShownDialog.h"
#include "window/SimpleWindows.h"
#include "wizard/WizardView.h"

namespace {

const int TEXT_MARGIN = 10;  // what an item needs beside its text and picture

class ListWindow : public ItemWindow {
 public:
  using ItemWindow::ItemWindow;
  static int Notification(NativeControl&, int iCode) {
    return iCode == LBN_SELCHANGE || iCode == LBN_DBLCLK ? iCode : NativeKind::IGNORED;
  }
  static void Draw(NativeControl& native, const DRAWITEMSTRUCT& item);

 protected:
  void Fill(const CNCharArray& texts) override;
  void SetValue(const char* szText) override;
  void GetValue(CNString& csText) override;
  bool bTakesEnter() override { return List().bHasFlag("KEYINPUT"); }
  bool bMessage(const MSG& message, LRESULT& lResult) override;
  void MarkDrop(const POINT* pScreen) override;
  void Drop(LPARAM lItem, ItemWindow& target, POINT screen) override;

 private:
  CNListBox& List() const { return static_cast<CNListBox&>(m_Native.Control()); }
  bool bSeveral() const { return (GetWindowLongW(hWnd(), GWL_STYLE) & LBS_MULTIPLESEL) != 0; }
  int iCount() const { return static_cast<int>(Send(LB_GETCOUNT)); }
  const char* szFull(int iItem) const {
    return reinterpret_cast<const char*>(Send(LB_GETITEMDATA, static_cast<WPARAM>(iItem)));
  }
  const char* szPlain(int iItem, ItemLook& look) const;
  int iFindText(const char* szText) const;
  void Select(int iItem);
  void Put(int iAt, const char* szText);
  void Resize();
  void Move(int iFrom, ListWindow& to, int iTo);
  void NoteOrder();
  void Notify(int iCode) {
    PostMessageW(GetParent(hWnd()), WM_COMMAND, MAKEWPARAM(GetDlgCtrlID(hWnd()), iCode),
                 reinterpret_cast<LPARAM>(hWnd()));
  }
  bool bPress(const MSG& message);
  bool bKey(WPARAM wKey, bool bAlt);

  CNCharArray m_Texts;  // what the items' data point to; grows until the window goes
};

const char* ListWindow::szPlain(int iItem, ItemLook& look) const {
  look.Read(List().m_csFlags.Text(), List().m_csFlags.Text() + List().m_csFlags.Length());
  return szBehindLook(szFull(iItem), look);
}

void ListWindow::Draw(NativeControl& native, const DRAWITEMSTRUCT& item) {
  if (!native.m_pState) return;
  auto& list = Of<ListWindow>(native);
  ItemLook look;
  const bool bItem = static_cast<int>(item.itemID) >= 0 && static_cast<int>(item.itemID) < list.iCount();
  const char* szText = bItem ? list.szPlain(static_cast<int>(item.itemID), look) : "";
  DRAWITEMSTRUCT wide = item;  // the system gives no more than what the window shows
  wide.rcItem.right = std::max(item.rcItem.right, item.rcItem.left + LONG(list.Send(LB_GETHORIZONTALEXTENT)));
  DrawItem(native, wide, szText, look, list.m_Pictures);
}

// ---- items ----

// iAt: where, -1 at the end; a sorted list decides itself.
void ListWindow::Put(int iAt, const char* szText) {
  m_Texts.Add(szText, 1);
  const char* szKept = m_Texts[m_Texts.Size() - 1];
  ItemLook look;
  const Wide text(szBehindLook(szKept, look));
  const bool bAdd = iAt < 0 || List().bHasFlag("SORT");
  const LRESULT lItem = Send(bAdd ? LB_ADDSTRING : LB_INSERTSTRING, static_cast<WPARAM>(iAt),
                             reinterpret_cast<LPARAM>(static_cast<const wchar_t*>(text)));
  if (lItem < 0) return;
  Send(LB_SETITEMDATA, static_cast<WPARAM>(lItem), reinterpret_cast<LPARAM>(szKept));
  m_Pictures.iFind(m_Native, look.csPicture);
}

void ListWindow::Fill(const CNCharArray& texts) {
  Send(LB_RESETCONTENT);
  m_Texts.RemoveAll();
  for (int i = 0; i < texts.Size(); i++) Put(-1, texts[i]);
  Resize();
}

// A picture at the right edge stays in sight: such a list does not scroll to the side.
void ListWindow::Resize() {
  if (List().m_dwStyle & STYLE_LBS_OWNERDRAWFIXED) Send(LB_SETITEMHEIGHT, 0, iItemHeight(m_Native, m_Pictures));
  int iWidth = 0;
  bool bScrolls = (List().m_dwStyle & STYLE_HSCROLL) != 0;
  for (int i = 0; bScrolls && i < iCount(); i++) {
    ItemLook look;
    iWidth = std::max(iWidth, iTextWidth(m_Native, szPlain(i, look)));
    bScrolls = !look.bRight || look.csPicture.bEmpty();
  }
  Send(LB_SETHORIZONTALEXTENT, static_cast<WPARAM>(bScrolls ? iWidth + m_Pictures.Size().cx + TEXT_MARGIN : 0));
}

// ---- value ----

int ListWindow::iFindText(const char* szText) const {
  ItemLook look;
  for (int i = 0; i < iCount(); i++)
    if (strcmp(szPlain(i, look), szText) == 0) return i;
  return -1;
}

void ListWindow::Select(int iItem) {
  if (!bSeveral())
    Send(LB_SETCURSEL, static_cast<WPARAM>(iItem));
  else if (iItem >= 0)
    Send(LB_SETSEL, TRUE, iItem);
}

void ListWindow::SetValue(const char* szText) {
  if (!bSeveral()) return Select(iFindText(szText));
  Send(LB_SETSEL, FALSE, -1);
  CNString csLine;
  for (const char* p = szText; *p; p += *p == '\n') {
    const size_t nLength = strcspn(p, "\n");
    csLine.Copy(p, static_cast<long>(nLength));
    p += nLength;
    Select(iFindText(csLine.Text()));
  }
}

void ListWindow::GetValue(CNString& csText) {
  ItemLook look;
  for (int i = 0; i < iCount(); i++) {
    if (Send(LB_GETSEL, static_cast<WPARAM>(i)) <= 0) continue;
    if (!csText.bEmpty()) csText.Concat("\n");
    csText.Concat(szPlain(i, look));
  }
}

// ---- keys and mouse ----

bool ListWindow::bMessage(const MSG& message, LRESULT&) {
  if (message.message == WM_KEYDOWN || message.message == WM_SYSKEYDOWN)
    return bKey(message.wParam, message.message == WM_SYSKEYDOWN);
  const UINT uDown = m_Dragging.bRightButton ? WM_RBUTTONDOWN : WM_LBUTTONDOWN;
  return m_Dragging.bAny && message.message == uDown && bPress(message);
}

bool ListWindow::bKey(WPARAM wKey, bool bAlt) {
  if (wKey == VK_RETURN && bTakesEnter()) {
    Notify(LBN_DBLCLK);
    return true;
  }
  const int iStep = wKey == VK_UP ? -1 : wKey == VK_DOWN ? 1 : 0;
  if (!bAlt || !iStep || !m_Dragging.bReorders) return false;
  const int iFrom = static_cast<int>(Send(LB_GETCARETINDEX)), iTo = iFrom + iStep;
  if (iFrom >= 0 && iTo >= 0 && iTo < iCount()) Move(iFrom, *this, iTo);
  return true;
}

// The class would follow the mouse with its selection, so the press is over for it before the item is moved.
bool ListWindow::bPress(const MSG& message) {
  const HWND hList = hWnd();
  POINT point = {static_cast<short>(LOWORD(message.lParam)), static_cast<short>(HIWORD(message.lParam))};
  POINT screen = point;
  ClientToScreen(hList, &screen);
  const int iItem = LBItemFromPt(hList, screen, FALSE);
  if (iItem < 0) return false;
  if (message.message == WM_LBUTTONDOWN) {
    CallClassProc(hList, WM_LBUTTONDOWN, message.wParam, message.lParam);
    if (IsWindow(hList)) CallClassProc(hList, WM_LBUTTONUP, 0, message.lParam);
  } else {
    SetFocus(hList);
  }
  if (IsWindow(hList)) StartDrag(iItem, point);
  return true;
}

void ListWindow::MarkDrop(const POINT* pScreen) {
  DrawInsert(GetParent(hWnd()), hWnd(), pScreen ? LBItemFromPt(hWnd(), *pScreen, TRUE) : -1);
}

void ListWindow::Drop(LPARAM lItem, ItemWindow& target, POINT screen) {
  auto& to = static_cast<ListWindow&>(target);
  const int iTo = LBItemFromPt(to.hWnd(), screen, FALSE);
  if (&to != this || iTo != lItem) Move(static_cast<int>(lItem), to, iTo);
}

// The item takes the place of the one that is there, or the last place for -1.
void ListWindow::Move(int iFrom, ListWindow& to, int iTo) {
  const char* szText = szFull(iFrom);
  if (iFrom >= iCount() || (List().bHasFlag("SORT") && &to == this)) return;
  Send(LB_DELETESTRING, static_cast<WPARAM>(iFrom));
  to.Put(iTo, szText);
  ItemLook look;
  if (to.bSeveral()) to.Send(LB_SETSEL, FALSE, -1);
  to.Select(to.iFindText(szBehindLook(szText, look)));
  for (ListWindow* pList : {this, &to}) {
    pList->Resize();
    pList->NoteOrder();
  }
  to.Notify(LBN_SELCHANGE);
}

// The description follows, so that the list is the same when its dialog is shown again.
void ListWindow::NoteOrder() {
  List().m_Items.RemoveAll();
  for (int i = 0; i < iCount(); i++) List().m_Items.Add(szFull(i), 1);
}

constexpr NativeKind MakeKind(ControlKind kind) {
  return {.kind = kind,
          // Without LBS_NOINTEGRALHEIGHT the list would shrink to whole items.
          .dwStyle = LBS_NOTIFY | LBS_HASSTRINGS | LBS_NOINTEGRALHEIGHT,
          .dwExStyle = WS_EX_CLIENTEDGE,
          .bField = true,
          .pCreated = ItemWindow::Create<ListWindow>,
          .pSetText = ItemWindow::bSetText,
          .pGetText = ItemWindow::bGetText,
          .pNotification = ListWindow::Notification,
          .pSetItems = ItemWindow::SetItems,
          .pDraw = ListWindow::Draw};
}

}  // namespace

const NativeKind g_ListBoxWindow = MakeKind(ControlKind::ListBox);
const NativeKind g_SimulatedListBoxWindow = MakeKind(ControlKind::SimulatedListBox);
