// List boxes. A list's text is its selected item, or one line for each where several can be selected.
#include <cstring>
#include <memory>

#include "foundation/os/OsWide.h"
#include "window/NativeControls.h"
#include "wizard/WizardView.h"

namespace {

LRESULT lFindItem(HWND hWnd, const char* szText) {
  const Wide item(szText);
  return SendMessageW(hWnd, LB_FINDSTRINGEXACT, static_cast<WPARAM>(-1),
                      reinterpret_cast<LPARAM>(static_cast<const wchar_t*>(item)));
}

void SelectLines(HWND hWnd, const char* szText) {
  SendMessageW(hWnd, LB_SETSEL, FALSE, -1);
  CNString csLine;
  for (const char* p = szText; *p; p += *p == '\n') {
    const size_t nLength = strcspn(p, "\n");
    csLine.Copy(p, static_cast<long>(nLength));
    p += nLength;
    const LRESULT lIndex = lFindItem(hWnd, csLine.Text());
    if (lIndex != LB_ERR) SendMessageW(hWnd, LB_SETSEL, TRUE, lIndex);
  }
}

bool bSetText(HWND hWnd, const char* szText) {
  if (GetWindowLongW(hWnd, GWL_STYLE) & LBS_MULTIPLESEL)
    SelectLines(hWnd, szText);
  else
    SendMessageW(hWnd, LB_SETCURSEL, static_cast<WPARAM>(lFindItem(hWnd, szText)), 0);  // LB_ERR selects nothing
  return true;
}

bool bGetItem(HWND hWnd, WPARAM wIndex, CNString& csItem) {
  const LRESULT lLength = SendMessageW(hWnd, LB_GETTEXTLEN, wIndex, 0);
  if (lLength == LB_ERR) return false;
  std::unique_ptr<wchar_t[]> pText(new wchar_t[lLength + 1]());
  if (!pText) return false;
  SendMessageW(hWnd, LB_GETTEXT, wIndex, reinterpret_cast<LPARAM>(pText.get()));
  bNarrow(pText.get(), csItem);  // characters without a place in the code page become question marks
  return true;
}

bool bGetText(HWND hWnd, CNString& csText) {
  CNString csItem;
  csText = "";
  const LRESULT lItems = SendMessageW(hWnd, LB_GETCOUNT, 0, 0);
  for (LRESULT l = 0; l < lItems; l++) {
    if (SendMessageW(hWnd, LB_GETSEL, static_cast<WPARAM>(l), 0) <= 0) continue;
    if (!bGetItem(hWnd, static_cast<WPARAM>(l), csItem)) return false;
    if (!csText.bEmpty()) csText.Concat("\n");
    csText.Concat(csItem.Text());
  }
  return true;
}

void SetItems(NativeControl& native, const CNCharArray& texts) {
  SendMessageW(native.hWnd(), LB_RESETCONTENT, 0, 0);
  for (int i = 0; i < texts.Size(); i++)
    SendMessageW(native.hWnd(), LB_ADDSTRING, 0, reinterpret_cast<LPARAM>(static_cast<const wchar_t*>(Wide(texts[i]))));
}

int Notification(NativeControl&, int iCode) {
  return iCode == LBN_SELCHANGE || iCode == LBN_DBLCLK ? iCode : NativeKind::IGNORED;
}

constexpr NativeKind MakeKind(ControlKind kind) {
  return {.kind = kind,
          // Without LBS_NOINTEGRALHEIGHT the list would shrink to whole items.
          .dwStyle = LBS_NOTIFY | LBS_HASSTRINGS | LBS_NOINTEGRALHEIGHT,
          .dwRemovedStyle = LBS_OWNERDRAWFIXED,  // items with pictures are drawn as plain text so far
          .dwExStyle = WS_EX_CLIENTEDGE,
          .bField = true,
          .pSetText = bSetText,
          .pGetText = bGetText,
          .pNotification = Notification,
          .pSetItems = SetItems};
}

}  // namespace

const NativeKind g_ListBoxWindow = MakeKind(ControlKind::ListBox);
const NativeKind g_SimulatedListBoxWindow = MakeKind(ControlKind::SimulatedListBox);
