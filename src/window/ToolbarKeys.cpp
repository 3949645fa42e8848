// Toolbars by keyboard. Tab leads to a bar as to any control; the arrows, Home and End choose among its buttons, Enter
// and Space press the chosen one, and Tab leads on through its combo boxes.
#include "window/ShownDialog.h"
#include "window/SimpleWindows.h"
#include "window/ToolbarWindow.h"

namespace {

LRESULT Send(HWND hBar, UINT uMessage, WPARAM wParam = 0, LPARAM lParam = 0) {
  return SendMessageW(hBar, uMessage, wParam, lParam);
}

int iButtons(HWND hBar) { return static_cast<int>(Send(hBar, TB_BUTTONCOUNT)); }

TBBUTTON Button(HWND hBar, int i) {
  TBBUTTON button = {};
  Send(hBar, TB_GETBUTTON, static_cast<WPARAM>(i), reinterpret_cast<LPARAM>(&button));
  return button;
}

bool bCanBePressed(const TBBUTTON& button) {
  return !(button.fsStyle & BTNS_SEP) && button.fsState & TBSTATE_ENABLED && !(button.fsState & TBSTATE_HIDDEN);
}

// The next button that can be pressed, from the last one to the first and back; -1 without any.
int iNext(HWND hBar, int iFrom, int iStep) {
  const int nButtons = iButtons(hBar);
  for (int i = 1; i <= nButtons; i++) {
    const int iAt = (iFrom + i * iStep + 2 * nButtons) % nButtons;
    if (bCanBePressed(Button(hBar, iAt))) return iAt;
  }
  return -1;
}

void Choose(HWND hBar, int iButton) {
  Send(hBar, TB_SETHOTITEM, static_cast<WPARAM>(iButton));
  if (iButton >= 0) NotifyWinEvent(EVENT_OBJECT_FOCUS, hBar, OBJID_CLIENT, iButton + 1);  // for screen readers
}

// Afterwards the bar's page may be gone.
void Press(HWND hBar, int iButton) {
  const TBBUTTON button = Button(hBar, iButton);
  const auto wID = static_cast<WPARAM>(button.idCommand);
  if (!bCanBePressed(button)) return;
  if (button.fsStyle & BTNS_CHECK) Send(hBar, TB_CHECKBUTTON, wID, !(button.fsState & TBSTATE_CHECKED));
  Send(GetAncestor(hBar, GA_ROOT), WM_COMMAND, wID, reinterpret_cast<LPARAM>(hBar));
}

bool bPresses(WPARAM wKey) { return wKey == VK_RETURN || wKey == VK_SPACE; }

bool bTakeKey(HWND hBar, WPARAM wKey, bool bHeld) {
  // An end stands for the place before the first button, or behind the last one.
  static const struct {
    WPARAM wKey;
    int iStep;
    bool bFromEnd;
  } MOVES[] = {{VK_RIGHT, 1, false}, {VK_DOWN, 1, false}, {VK_LEFT, -1, false},
               {VK_UP, -1, false},   {VK_HOME, 1, true},  {VK_END, -1, true}};
  const int iHot = static_cast<int>(Send(hBar, TB_GETHOTITEM));
  for (const auto& row : MOVES) {
    if (row.wKey != wKey) continue;
    const int iEnd = row.iStep > 0 ? -1 : iButtons(hBar);
    Choose(hBar, iNext(hBar, row.bFromEnd || iHot < 0 ? iEnd : iHot, row.iStep));
    return true;
  }
  if (!bPresses(wKey)) return false;
  if (!bHeld && iHot >= 0) Press(hBar, iHot);
  return true;
}

LRESULT CALLBACK BarProc(HWND hBar, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  if (uMessage == WM_KEYDOWN && bTakeKey(hBar, wParam, HIWORD(lParam) & KF_REPEAT)) return 0;
  if (uMessage == WM_CHAR && bPresses(wParam)) return 0;
  const LRESULT lResult = CallClassProc(hBar, uMessage, wParam, lParam);
  if (uMessage == WM_SETFOCUS) Choose(hBar, iNext(hBar, -1, 1));
  if (uMessage == WM_KILLFOCUS) Choose(hBar, -1);
  if (uMessage != WM_GETDLGCODE) return lResult;
  // Otherwise Enter would press the default button.
  const auto* pKey = reinterpret_cast<const MSG*>(lParam);
  return lResult | DLGC_WANTARROWS | (pKey && bPresses(pKey->wParam) ? DLGC_WANTMESSAGE : 0);
}

// The bar that is a stop of the Tab key and is, or holds, the window; null without.
HWND hBarOf(HWND hWnd) {
  for (const HWND hBar : {hWnd, GetAncestor(hWnd, GA_PARENT)})
    if (bIsToolbar(hBar) && GetWindowLongW(hBar, GWL_STYLE) & WS_TABSTOP) return hBar;
  return nullptr;
}

// The next stop within the bar, whose own comes first; null beyond its ends.
HWND hNextWithin(HWND hBar, HWND hFrom, bool bBack) {
  const auto bCanBeUsed = [](HWND hWnd) { return IsWindowVisible(hWnd) && IsWindowEnabled(hWnd); };
  const bool bOwn = hFrom == hBar;
  HWND hNext =
      bOwn ? (bBack ? nullptr : GetWindow(hBar, GW_CHILD)) : GetWindow(hFrom, bBack ? GW_HWNDPREV : GW_HWNDNEXT);
  while (hNext && !bCanBeUsed(hNext)) hNext = GetWindow(hNext, bBack ? GW_HWNDPREV : GW_HWNDNEXT);
  return hNext || !bBack || bOwn ? hNext : hBar;
}

HWND hLastWithin(HWND hBar) {
  HWND hLast = hBar;
  while (const HWND hNext = hNextWithin(hBar, hLast, false)) hLast = hNext;
  return hLast;
}

}  // namespace

bool bIsToolbar(HWND hWnd) {
  wchar_t szClass[32];
  return GetClassNameW(hWnd, szClass, 32) && lstrcmpiW(szClass, TOOLBARCLASSNAMEW) == 0;
}

// What holds stops is none itself, so a bar with buttons does not tell the system of its combo boxes.
void AddToolbarKeys(HWND hBar) {
  bool bButtons = false;
  for (int i = 0; i < iButtons(hBar); i++) bButtons = bButtons || !(Button(hBar, i).fsStyle & BTNS_SEP);
  if (!bButtons) return;
  PutBefore(hBar, BarProc);
  SetWindowLongW(hBar, GWL_STYLE, GetWindowLongW(hBar, GWL_STYLE) | WS_TABSTOP);
  SetWindowLongW(hBar, GWL_EXSTYLE, GetWindowLongW(hBar, GWL_EXSTYLE) & ~WS_EX_CONTROLPARENT);
}

bool bTabThroughBar(HWND hDialog, MSG& message) {
  if (message.message != WM_KEYDOWN || message.wParam != VK_TAB || GetKeyState(VK_CONTROL) < 0) return false;
  const bool bBack = GetKeyState(VK_SHIFT) < 0;
  const HWND hFocus = GetFocus(), hFrom = hBarOf(hFocus);
  HWND hNext = hFrom ? hNextWithin(hFrom, hFocus, bBack) : nullptr;
  const auto lKeys = static_cast<UINT>(Send(hFocus, WM_GETDLGCODE, VK_TAB, reinterpret_cast<LPARAM>(&message)));
  if (!hNext && !(lKeys & (DLGC_WANTTAB | DLGC_WANTMESSAGE))) {
    hNext = GetNextDlgTabItem(hDialog, hFrom ? hFrom : hFocus, bBack);
    const HWND hInto = hNext ? hBarOf(hNext) : nullptr;
    if (hInto && bBack)
      hNext = hLastWithin(hInto);
    else if (!hFrom)
      return false;  // the system's own way
  }
  if (hNext) FocusControl(hNext);
  return hNext != nullptr;
}
