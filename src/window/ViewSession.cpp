// The end of the session: a wizard that works asks the system to wait.
#include "foundation/os/OsWide.h"
#include "window/SimpleWindows.h"
#include "window/WindowView.h"

// From Windows Vista on the system shows the person who holds the session and why, and ends it once that is taken back.
// Earlier ones take the answer no.
void CNWindowView::HoldSession(bool bHold) {
  const UINT uLook = 250;  // milliseconds from one look at the wizard to the next
  if (bHold == m_bHoldsSession) return;
  m_bHoldsSession = bHold;
  if (!bHold) {
    KillTimer(m_hWindow, SESSION_TIMER);
    const auto pDestroy = pSystemFunction<BOOL(WINAPI*)(HWND)>(L"user32.dll", "ShutdownBlockReasonDestroy");
    if (pDestroy) pDestroy(m_hWindow);
    return;
  }
  SetTimer(m_hWindow, SESSION_TIMER, uLook, nullptr);
  const auto pCreate = pSystemFunction<BOOL(WINAPI*)(HWND, LPCWSTR)>(L"user32.dll", "ShutdownBlockReasonCreate");
  if (pCreate) pCreate(m_hWindow, Wide(m_pEvents->szHoldReason()));
}

bool CNWindowView::bOnQueryEndSession(const WindowMessage&, LRESULT& lResult) {
  lResult = !m_pEvents->bHoldsQuit();
  HoldSession(!lResult);
  return true;
}

// The process may be ended as soon as this returns. Somebody else may have refused, or the person have had enough of
// waiting.
bool CNWindowView::bOnEndSession(const WindowMessage& message, LRESULT&) {
  if (!message.wParam) return HoldSession(false), true;
  m_Places.Save();
  if (m_bClosing) return true;
  if (m_pEvents->bHoldsQuit())
    m_pEvents->OnBreakOff();
  else
    m_pEvents->OnEndSession();
  return true;
}
