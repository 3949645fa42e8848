// Combo boxes, also those of the class with pictures. A combo's text is what was typed or chosen. Each item's data is
// its description.
#include <algorithm>
#include <cstring>

#include "foundation/os/OsWide.h"
#include "window/ItemWindow.h"
#include "window/ShownDialog.h"
#include "wizard/WizardView.h"

namespace {

const int LINES_SHOWN = 10;

class ComboWindow : public ItemWindow {
 public:
  using ItemWindow::ItemWindow;
  static int Notification(NativeControl& native, int iCode);
  static void Draw(NativeControl& native, const DRAWITEMSTRUCT& item);
  static void Resized(NativeControl& native) { Of<ComboWindow>(native).FitList(); }

 protected:
  void Created() override;
  void Fill(const CNCharArray& texts) override;
  void SetValue(const char* szText) override;
  void GetValue(CNString& csText) override;

 private:
  CNCombo& Combo() const { return static_cast<CNCombo&>(m_Native.Control()); }
  int iSelected() const { return static_cast<int>(Send(CB_GETCURSEL)); }
  const CNItem* pItem(int i) const {
    const LRESULT lData = i < 0 ? 0 : Send(CB_GETITEMDATA, static_cast<WPARAM>(i));
    return lData == CB_ERR ? nullptr : reinterpret_cast<const CNItem*>(lData);
  }
  void Put(CNItem& item);
  void FitList();

  int m_iTold = -1;  // the selection that the script knows of
};

void ComboWindow::Created() {
  // The parts of the control ask for their colours in their own name.
  COMBOBOXINFO parts = {};
  parts.cbSize = sizeof(parts);
  if (Combo().m_bPictures || !GetComboBoxInfo(hWnd(), &parts)) return;
  for (const HWND hPart : {parts.hwndItem, parts.hwndList})
    if (hPart && hPart != hWnd()) SetWindowLongPtrW(hPart, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(&m_Native));
}

void ComboWindow::Put(CNItem& item) {
  ItemLook look;
  const CNWideText text(item.szShown(0, look));
  const int iPicture = m_Pictures.iFind(m_Native, look.csPicture);
  auto* const pText = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(text.Ptr()));
  const auto lData = reinterpret_cast<LPARAM>(&item);
  if (!Combo().m_bPictures) {
    const LRESULT lAt = Send(CB_ADDSTRING, 0, reinterpret_cast<LPARAM>(pText));
    if (lAt >= 0) Send(CB_SETITEMDATA, static_cast<WPARAM>(lAt), lData);
    return;
  }
  COMBOBOXEXITEMW row = {};
  row.mask = CBEIF_TEXT | CBEIF_LPARAM | CBEIF_IMAGE | CBEIF_SELECTEDIMAGE;
  row.iItem = -1;
  row.pszText = pText;
  row.lParam = lData;
  row.iImage = row.iSelectedImage = std::max(0, iPicture);
  if (iPicture >= 0) Send(CBEM_SETIMAGELIST, 0, reinterpret_cast<LPARAM>(m_Pictures.hList()));
  Send(CBEM_INSERTITEMW, 0, reinterpret_cast<LPARAM>(&row));
}

void ComboWindow::Fill(const CNCharArray& texts) {
  Combo().TakeShown(texts);
  Send(CB_RESETCONTENT);
  for (int i = 0; i < Combo().m_Items.Size(); i++) Put(*Combo().m_Items[i]);
  FitList();
}

// The system's height of a combo is that of the field and the list together. A script's height that leaves no room for
// a list is that of the field alone; the list is then as high as its items, up to ten.
void ComboWindow::FitList() {
  const int iLine = iItemHeight(m_Native, m_Pictures);
  if (GetWindowLongW(hWnd(), GWL_STYLE) & CBS_OWNERDRAWFIXED)
    for (const WPARAM wPart : {static_cast<WPARAM>(-1), static_cast<WPARAM>(0)}) Send(CB_SETITEMHEIGHT, wPart, iLine);
  RECT place;
  GetWindowRect(hWnd(), &place);
  const int nLines = std::clamp(Combo().m_Items.Size(), 1, LINES_SHOWN);
  const int iClosed = place.bottom - place.top, iWanted = m_Native.Control().m_iSize[3];
  const int iHeight = iWanted >= 3 * iLine ? iWanted : iClosed + nLines * iLine + 4;
  SetWindowPos(hWnd(), nullptr, 0, 0, place.right - place.left, iHeight, SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
}

void ComboWindow::SetValue(const char* szText) {
  int iFound = -1;
  ItemLook look;
  const int nItems = static_cast<int>(Send(CB_GETCOUNT));
  for (int i = 0; iFound < 0 && i < nItems; i++)
    if (const CNItem* p = pItem(i); p && strcmp(p->szShown(0, look), szText) == 0) iFound = i;
  Send(CB_SETCURSEL, static_cast<WPARAM>(iFound));
  if (Combo().m_bEditable && iFound < 0) bSetWindowText(hWnd(), szText);
  m_iTold = iFound;
}

void ComboWindow::GetValue(CNString& csText) {
  ItemLook look;
  if (Combo().m_bEditable)
    bGetWindowText(hWnd(), csText);
  else if (const CNItem* p = pItem(iSelected()))
    csText = p->szShown(0, look);
}

// A selection is told when it is final and another one: the system tells of each that the keyboard passes in the open
// list, and of none when that list is closed with Escape.
int ComboWindow::Notification(NativeControl& native, int iCode) {
  if (!native.m_pState || Of<ComboWindow>(native).m_nQuiet) return NativeKind::IGNORED;
  auto& combo = Of<ComboWindow>(native);
  const HWND hCombo = native.hWnd();
  if (iCode == CBN_CLOSEUP)
    PostMessageW(GetParent(hCombo), WM_COMMAND, MAKEWPARAM(GetDlgCtrlID(hCombo), CBN_SELCHANGE),
                 reinterpret_cast<LPARAM>(hCombo));
  if (iCode == CBN_SELCHANGE) {
    if (combo.Send(CB_GETDROPPEDSTATE) || combo.iSelected() == combo.m_iTold) return NativeKind::IGNORED;
    combo.m_iTold = combo.iSelected();
    return NOTIFY_SELECTION_CHANGED;
  }
  // The pointer may still be the one that another window left.
  if (iCode == CBN_DROPDOWN) SetCursor(LoadCursorW(nullptr, IDC_ARROW));
  const bool bTold =
      iCode == CBN_DROPDOWN || iCode == CBN_CLOSEUP || iCode == CBN_EDITCHANGE || iCode == CBN_EDITUPDATE;
  return bTold ? iCode : NativeKind::IGNORED;
}

void ComboWindow::Draw(NativeControl& native, const DRAWITEMSTRUCT& item) {
  if (!native.m_pState) return;
  auto& combo = Of<ComboWindow>(native);
  ItemLook look;
  const CNItem* pDrawn = combo.pItem(static_cast<int>(item.itemID));
  const char* szText = pDrawn ? pDrawn->szShown(0, look) : "";
  DrawItem(native, item, szText, look, combo.m_Pictures);
}

}  // namespace

const NativeKind g_ComboWindow = {.kind = ControlKind::Combo,
                                  .bField = true,
                                  .pCreated = ItemWindow::Create<ComboWindow>,
                                  .pSetText = ItemWindow::bSetText,
                                  .pGetText = ItemWindow::bGetText,
                                  .pNotification = ComboWindow::Notification,
                                  .pSetItems = ItemWindow::SetItems,
                                  .pResized = ComboWindow::Resized,
                                  .pDraw = ComboWindow::Draw};
