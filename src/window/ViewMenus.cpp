// What the wizard's window does for menus: exchanging the bar with the page, opening right-click menus.
#include <windowsx.h>

#include "window/MenuWindow.h"
#include "window/WindowView.h"

namespace {

// Texts and disabled controls let the mouse through to the window around them.
HWND hDeepestAt(HWND hWnd, const POINT& screen) {
  for (;;) {
    POINT at = screen;
    ScreenToClient(hWnd, &at);
    const HWND hChild = ChildWindowFromPointEx(hWnd, at, CWP_SKIPINVISIBLE);
    if (!hChild || hChild == hWnd) return hWnd;
    hWnd = hChild;
  }
}

}  // namespace

// Without a painting in between: everything is drawn at once when the page appears.
void CNWindowView::ExchangeMenu(HMENU hNew) {
  const HWND hWnd = m_hWindow;
  if (GetMenu(hWnd) == hNew) return;
  const bool bVisible = IsWindowVisible(hWnd);
  if (bVisible) SendMessageW(hWnd, WM_SETREDRAW, FALSE, 0);
  SetMenu(hWnd, hNew);
  if (bVisible) SendMessageW(hWnd, WM_SETREDRAW, TRUE, 0);
}

bool CNWindowView::bOnMenuCharacter(const WindowMessage& message, LRESULT& lResult) {
  return m_pDialog && bMenuCharacter(*m_pDialog, reinterpret_cast<HMENU>(message.lParam),
                                     static_cast<wchar_t>(LOWORD(message.wParam)), lResult);
}

// A right click, or the keys that stand for one. The menu of the control comes first, then those of what it stands in.
bool CNWindowView::bOnContextMenu(const WindowMessage& message, LRESULT&) {
  const ShownDialog* const pDialog = m_pDialog.get();
  if (m_bPending || m_bClosing || !pDialog) return false;
  auto hOver = reinterpret_cast<HWND>(message.wParam);
  POINT at = {GET_X_LPARAM(message.lParam), GET_Y_LPARAM(message.lParam)};
  RECT area;
  if (message.lParam == -1) {
    GetWindowRect(hOver, &area);
    at = {area.left + 8, area.top + 8};
  } else {
    GetClientRect(hOver, &area);
    MapWindowPoints(hOver, nullptr, reinterpret_cast<POINT*>(&area), 2);
    if (!PtInRect(&area, at)) return false;  // the caption has the system's menu
    hOver = hDeepestAt(hOver, at);
  }
  const NativeControl* pOver = pDialog->pFindWindow(hOver);
  NativeControl* pMenu = nullptr;
  for (const BaseControl* p = pOver ? &pOver->Control() : nullptr; p && !pMenu; p = p->m_pParent)
    pMenu = pRightMenu(*pDialog, p);
  if (!pMenu) pMenu = pRightMenu(*pDialog, nullptr);
  if (!pMenu) return false;
  const int iID = iAskRightMenu(*pMenu, m_hWindow, at);
  // Another thread may have led to another page meanwhile.
  if (iID == 0 || m_bClosing || m_pDialog.get() != pDialog) return true;
  if (CNItem* pItem = pMenuItem(*pDialog, iID)) m_pEvents->OnItem(*pItem);
  return true;
}

// A control that has a menu of its own is not asked: fields have one that would come first.
bool CNWindowView::bTakeContextKey(const MSG& message) {
  const bool bClick = message.message == WM_RBUTTONUP;
  const bool bShiftF10 = message.message == WM_SYSKEYDOWN && message.wParam == VK_F10 && GetKeyState(VK_SHIFT) < 0;
  const bool bMenuKey = message.message == WM_KEYUP && message.wParam == VK_APPS;
  if ((!bClick && !bShiftF10 && !bMenuKey) || m_bPending || m_bClosing || !m_pDialog) return false;
  const NativeControl* pNative = m_pDialog->pFindWindow(message.hwnd);
  if (!pNative || !pRightMenu(*m_pDialog, &pNative->Control())) return false;
  POINT at = {GET_X_LPARAM(message.lParam), GET_Y_LPARAM(message.lParam)};
  ClientToScreen(message.hwnd, &at);
  SendMessageW(m_hWindow, WM_CONTEXTMENU, reinterpret_cast<WPARAM>(message.hwnd), bClick ? MAKELPARAM(at.x, at.y) : -1);
  return true;
}
