// List boxes. A list's text is its selected item.
#include <memory>

#include "foundation/os/OsWide.h"
#include "window/NativeControls.h"
#include "wizard/WizardView.h"

namespace {

bool bSetText(HWND hWnd, const char* szText) {
  const Wide item(szText);
  const LRESULT lIndex = SendMessageW(hWnd, LB_FINDSTRINGEXACT, static_cast<WPARAM>(-1),
                                      reinterpret_cast<LPARAM>(static_cast<const wchar_t*>(item)));
  SendMessageW(hWnd, LB_SETCURSEL, static_cast<WPARAM>(lIndex), 0);  // LB_ERR selects nothing
  return true;
}

bool bGetText(HWND hWnd, CNString& csText) {
  const LRESULT lIndex = SendMessageW(hWnd, LB_GETCURSEL, 0, 0);
  const LRESULT lLength = lIndex == LB_ERR ? 0 : SendMessageW(hWnd, LB_GETTEXTLEN, static_cast<WPARAM>(lIndex), 0);
  std::unique_ptr<wchar_t[]> pText(new wchar_t[lLength + 1]());
  if (!pText) return false;
  if (lIndex != LB_ERR)
    SendMessageW(hWnd, LB_GETTEXT, static_cast<WPARAM>(lIndex), reinterpret_cast<LPARAM>(pText.get()));
  bNarrow(pText.get(), csText);
  return true;
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
          .pNotification = Notification};
}

}  // namespace

const NativeKind g_ListBoxWindow = MakeKind(ControlKind::ListBox);
const NativeKind g_SimulatedListBoxWindow = MakeKind(ControlKind::SimulatedListBox);
