#include "window/DoublePress.h"

#include <windowsx.h>

#include <cstdlib>

namespace {

bool bNear(POINT a, POINT b) {
  return std::abs(a.x - b.x) <= GetSystemMetrics(SM_CXDOUBLECLK) / 2 &&
         std::abs(a.y - b.y) <= GetSystemMetrics(SM_CYDOUBLECLK) / 2;
}

bool bThere(HWND hWnd) { return IsWindowVisible(hWnd) && IsWindowEnabled(GetAncestor(hWnd, GA_ROOT)); }

}  // namespace

bool DoublePress::bDrops(const MSG& message) {
  if (message.message != WM_LBUTTONDOWN && message.message != WM_LBUTTONDBLCLK) return false;
  POINT at = {GET_X_LPARAM(message.lParam), GET_Y_LPARAM(message.lParam)};
  ClientToScreen(message.hwnd, &at);
  const bool bSecond = m_hFirst && message.time - m_uTime <= GetDoubleClickTime() && bNear(at, m_at);
  const bool bDrop = bSecond && message.hwnd != m_hFirst && !bThere(m_hFirst);
  m_hFirst = bSecond ? nullptr : message.hwnd;
  m_at = at;
  m_uTime = message.time;
  return bDrop;
}
