// What the wizard does to the controls of the dialog made last. A control is looked up under the lock; messages to its
// window are sent without it, so that the window's thread can always go on.
#include "foundation/os/OsWide.h"
#include "window/WindowView.h"

CNWindowView::ControlWindow CNWindowView::Find(const BaseControl& control) {
  CNSemHold hold(m_lock);
  const NativeControl* pNative = m_pDialog ? m_pDialog->pFind(control) : nullptr;
  return pNative ? ControlWindow{pNative->hWnd(), &pNative->Kind()} : ControlWindow();
}

bool CNWindowView::bSetText(const BaseControl& control, const char* szText) {
  const ControlWindow found = Find(control);
  if (!found.hWnd) return false;
  return (found.pKind->pSetText ? found.pKind->pSetText : bSetWindowText)(found.hWnd, szText ? szText : "");
}

bool CNWindowView::bGetText(const BaseControl& control, CNString& csText) {
  const ControlWindow found = Find(control);
  if (!found.hWnd) return false;
  return (found.pKind->pGetText ? found.pKind->pGetText : bGetWindowText)(found.hWnd, csText);
}

bool CNWindowView::bSetCaption(const BaseControl& control, const char* szCaption) {
  const ControlWindow found = Find(control);
  return found.hWnd && bSetWindowText(found.hWnd, szCaption ? szCaption : "");
}

bool CNWindowView::bSetItems(const BaseControl& control, const CNCharArray& items) {
  NativeControl* pNative = m_pDialog ? m_pDialog->pFind(control) : nullptr;
  if (!pNative || !pNative->Kind().pSetItems) return false;
  pNative->Kind().pSetItems(*pNative, items);
  return true;
}

bool CNWindowView::bCheckItem(const CNItemControl& control, int iItem, bool bChecked) {
  NativeControl* pNative = m_pDialog ? m_pDialog->pFind(control) : nullptr;
  return pNative && pNative->Kind().pCheckItem && pNative->Kind().pCheckItem(*pNative, iItem, bChecked);
}

bool CNWindowView::bIsItemChecked(const CNItemControl& control, int iItem, bool& bChecked) {
  NativeControl* pNative = m_pDialog ? m_pDialog->pFind(control) : nullptr;
  return pNative && pNative->Kind().pIsItemChecked && pNative->Kind().pIsItemChecked(*pNative, iItem, bChecked);
}

bool CNWindowView::bSetToolTip(const BaseControl& control, const char* szText) {
  const ControlWindow found = Find(control);
  return found.hWnd && m_pDialog->bSetToolTip(found.hWnd, szText);
}

bool CNWindowView::bSetProgress(const BaseControl& control, int iPercent) {
  const ControlWindow found = Find(control);
  if (!found.hWnd) return false;
  SendMessageW(found.hWnd, PBM_SETPOS, static_cast<WPARAM>(iPercent), 0);
  return true;
}

// A control that can no longer be used hands the keyboard on; otherwise no key would reach the window.
void CNWindowView::LeaveFocus(HWND hControl) {
  if (GetFocus() != hControl) return;
  const HWND hNext = GetNextDlgTabItem(m_hWindow, hControl, FALSE);
  SetFocus(hNext && hNext != hControl ? hNext : m_hWindow.load());
}

bool CNWindowView::bEnable(const BaseControl& control, bool bEnabled) {
  const ControlWindow found = Find(control);
  if (!found.hWnd) return false;
  if (!bEnabled) LeaveFocus(found.hWnd);
  EnableWindow(found.hWnd, bEnabled);
  return true;
}

bool CNWindowView::bShow(const BaseControl& control, bool bVisible) {
  HWND hWnd = nullptr;
  bool bNow = false;
  {
    CNSemHold hold(m_lock);
    if (NativeControl* pNative = m_pDialog ? m_pDialog->pFind(control) : nullptr) {
      pNative->m_bVisible = bVisible;
      hWnd = pNative->hWnd();
      bNow = !m_bPending;
    }
  }
  if (!hWnd) return false;
  if (bNow && !bVisible) LeaveFocus(hWnd);
  if (bNow) ::ShowWindow(hWnd, bVisible ? SW_SHOW : SW_HIDE);
  return true;
}

bool CNWindowView::bSetFocus(const BaseControl& control) {
  const ControlWindow found = Find(control);
  if (!found.hWnd) return false;
  SetFocus(found.hWnd);
  return true;
}

intptr_t CNWindowView::lSendMessage(const BaseControl& control, unsigned uMessage, uintptr_t wParam, intptr_t lParam) {
  const HWND hWnd = Find(control).hWnd;
  return hWnd ? SendMessageW(hWnd, uMessage, wParam, lParam) : -1;
}

void CNWindowView::Redraw(const BaseControl& control) {
  if (const HWND hWnd = Find(control).hWnd) InvalidateRect(hWnd, nullptr, TRUE);
}
