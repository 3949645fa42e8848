// The wizard window's messages: one table, one small method for each.
#include "foundation/ResultCodes.h"
#include "window/WindowView.h"

namespace {

const int FIRST_CONTROL_ID = 501;  // smaller identifiers are the wizard's own commands

}  // namespace

struct MessageRow {
  UINT uMessage;
  // False lets the system's default procedure have the message.
  bool (CNWindowView::*pHandler)(const WindowMessage& message, LRESULT& lResult);

  static const MessageRow ROWS[];
  static const MessageRow* pFind(UINT uMessage);
};

const MessageRow MessageRow::ROWS[] = {
    {WM_COMMAND, &CNWindowView::bOnCommandMessage},
    {WM_CLOSE, &CNWindowView::bOnClose},
    {WM_QUERYENDSESSION, &CNWindowView::bOnQueryEndSession},
    {WM_ERASEBKGND, &CNWindowView::bOnEraseGround},
    {WM_CTLCOLORSTATIC, &CNWindowView::bOnControlColor},
    {WM_CTLCOLORBTN, &CNWindowView::bOnControlColor},
    {WM_CTLCOLOREDIT, &CNWindowView::bOnControlColor},
    {WM_CTLCOLORLISTBOX, &CNWindowView::bOnControlColor},
    {WM_DRAWITEM, &CNWindowView::bOnDrawItem},
    {WM_MEASUREITEM, &CNWindowView::bOnMeasureItem},
    {WM_NOTIFY, &CNWindowView::bOnNotify},
    {WM_HSCROLL, &CNWindowView::bOnScroll},
    {WM_VSCROLL, &CNWindowView::bOnScroll},
    {WM_SETCURSOR, &CNWindowView::bOnSetCursor},
    {WM_ACTIVATE, &CNWindowView::bOnActivate},
    {WM_SETFOCUS, &CNWindowView::bOnSetFocus},
    {DM_GETDEFID, &CNWindowView::bOnGetDefault},
    {DM_SETDEFID, &CNWindowView::bOnSetDefault},
    {WM_DESTROY, &CNWindowView::bOnDestroy},
};

const MessageRow* MessageRow::pFind(UINT uMessage) {
  for (const MessageRow& row : ROWS)
    if (row.uMessage == uMessage) return &row;
  return nullptr;
}

LRESULT CALLBACK CNWindowView::WindowProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  if (uMessage == WM_NCCREATE) {
    auto* pNew = static_cast<CNWindowView*>(reinterpret_cast<const CREATESTRUCTW*>(lParam)->lpCreateParams);
    SetWindowLongPtrW(hWnd, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(pNew));
    pNew->m_hWindow = hWnd;
  }
  auto* pView = reinterpret_cast<CNWindowView*>(GetWindowLongPtrW(hWnd, GWLP_USERDATA));
  LRESULT lResult = 0;
  if (pView && pView->bHandle({uMessage, wParam, lParam}, lResult)) return lResult;
  if (pView && uMessage == WM_NCDESTROY) {
    SetWindowLongPtrW(hWnd, GWLP_USERDATA, 0);
    pView->m_hWindow = nullptr;
    // The loop may be waiting for a message: one that was sent by another thread does not wake it.
    PostThreadMessageW(GetCurrentThreadId(), WM_NULL, 0, 0);
  }
  return DefWindowProcW(hWnd, uMessage, wParam, lParam);
}

bool CNWindowView::bHandle(const WindowMessage& message, LRESULT& lResult) {
  const MessageRow* pRow = MessageRow::pFind(message.uMessage);
  return pRow && (this->*pRow->pHandler)(message, lResult);
}

// Other windows of the process keep other things in their user data: only the window procedure tells ours apart.
CNWindowView* CNWindowView::pFromWindow(HWND hWnd) {
  if (!hWnd || GetClassLongPtrW(hWnd, GCLP_WNDPROC) != reinterpret_cast<ULONG_PTR>(WindowProc)) return nullptr;
  return reinterpret_cast<CNWindowView*>(GetWindowLongPtrW(hWnd, GWLP_USERDATA));
}

bool CNWindowView::bPreTranslate(MSG& message) { return IsDialogMessageW(m_hWindow, &message); }

// After the wizard was told, neither the control nor its dialog may be touched: they may be gone.
bool CNWindowView::bOnCommandMessage(const WindowMessage& message, LRESULT&) {
  if (m_bClosing) return true;
  const int iID = LOWORD(message.wParam);
  const auto hControl = reinterpret_cast<HWND>(message.lParam);
  if (!hControl) {
    if (iID < FIRST_CONTROL_ID) m_pEvents->OnCommand(iID);
    return true;
  }
  NativeControl* pNative = NativeControl::pFromWindow(hControl);
  if (!pNative || !pNative->Kind().pNotification) return true;
  const int iNotification = pNative->Kind().pNotification(*pNative, HIWORD(message.wParam));
  // A page that is going has nothing more to say.
  if (iNotification == NativeKind::IGNORED || &pNative->Dialog() != m_pDialog.get()) return true;
  BaseControl& control = pNative->Control();
  if (control.Kind() == ControlKind::Button && control.m_iID > 0 && control.m_iID < FIRST_CONTROL_ID)
    m_pEvents->OnCommand(control.m_iID);
  else
    m_pEvents->OnControl(control, iNotification);
  return true;
}

// While a message box or an owned wizard waits for its answer the window is disabled and must not be closed under it.
bool CNWindowView::bOnClose(const WindowMessage&, LRESULT&) {
  if (IsWindowEnabled(m_hWindow)) m_pEvents->OnCloseRequest();
  return true;
}

bool CNWindowView::bOnQueryEndSession(const WindowMessage&, LRESULT& lResult) {
  lResult = !m_pEvents->bHoldsQuit();
  return true;
}

bool CNWindowView::bOnEraseGround(const WindowMessage& message, LRESULT& lResult) {
  const ShownDialog* pVisible = m_bPending && m_pFormer ? m_pFormer.get() : m_pDialog.get();
  if (!pVisible) return false;
  RECT client;
  GetClientRect(m_hWindow, &client);
  lResult = FillRect(reinterpret_cast<HDC>(message.wParam), &client, pVisible->hGround());
  return true;
}

bool CNWindowView::bOnControlColor(const WindowMessage& message, LRESULT& lResult) {
  const NativeControl* pNative = NativeControl::pFromWindow(reinterpret_cast<HWND>(message.lParam));
  if (!pNative) return false;
  lResult = reinterpret_cast<LRESULT>(pNative->hColors(reinterpret_cast<HDC>(message.wParam), message.uMessage));
  return true;
}

bool CNWindowView::bOnDrawItem(const WindowMessage& message, LRESULT& lResult) {
  const auto& item = *reinterpret_cast<const DRAWITEMSTRUCT*>(message.lParam);
  NativeControl* pNative = NativeControl::pFromWindow(item.hwndItem);
  if (!pNative || !pNative->Kind().pDraw) return false;
  pNative->Kind().pDraw(*pNative, item);
  lResult = TRUE;
  return true;
}

bool CNWindowView::bOnMeasureItem(const WindowMessage& message, LRESULT& lResult) {
  auto& item = *reinterpret_cast<MEASUREITEMSTRUCT*>(message.lParam);
  NativeControl* pNative = m_pDialog && item.CtlType != ODT_MENU
                               ? NativeControl::pFromWindow(GetDlgItem(m_hWindow, static_cast<int>(item.CtlID)))
                               : nullptr;
  if (!pNative || !pNative->Kind().pMeasure) return false;
  pNative->Kind().pMeasure(*pNative, item);
  lResult = TRUE;
  return true;
}

bool CNWindowView::bOnNotify(const WindowMessage& message, LRESULT& lResult) {
  auto& header = *reinterpret_cast<NMHDR*>(message.lParam);
  NativeControl* pNative = m_pDialog ? m_pDialog->pFindWindow(header.hwndFrom) : nullptr;
  if (m_bClosing || !pNative || !pNative->Kind().pNotify) return false;
  return bTell(pNative->Control(), pNative->Kind().pNotify(*pNative, header), lResult);
}

bool CNWindowView::bOnScroll(const WindowMessage& message, LRESULT& lResult) {
  NativeControl* pNative = m_pDialog ? m_pDialog->pFindWindow(reinterpret_cast<HWND>(message.lParam)) : nullptr;
  if (m_bClosing || !pNative || !pNative->Kind().pScrolled) return false;
  return bTell(pNative->Control(), pNative->Kind().pScrolled(*pNative, LOWORD(message.wParam)), lResult);
}

// After the wizard was told, neither the control nor its dialog may be touched: they may be gone.
bool CNWindowView::bTell(BaseControl& control, const NativeEvent& event, LRESULT& lResult) {
  lResult = event.lResult;
  if (event.pItem)
    m_pEvents->OnItem(*event.pItem);
  else if (event.iNotification != NativeKind::IGNORED)
    m_pEvents->OnControl(control, event.iNotification);
  return event.bAnswered;
}

bool CNWindowView::bOnSetCursor(const WindowMessage& message, LRESULT& lResult) {
  const NativeControl* pNative = NativeControl::pFromWindow(reinterpret_cast<HWND>(message.wParam));
  if (reinterpret_cast<HWND>(message.wParam) == m_hWindow || LOWORD(message.lParam) != HTCLIENT) return false;
  if (!pNative || pNative->Control().Kind() != ControlKind::Static) return false;
  if (!static_cast<const CNStatic&>(pNative->Control()).m_bLink) return false;
  SetCursor(LoadCursorW(nullptr, IDC_HAND));
  lResult = TRUE;
  return true;
}

// Keeps the place of the keyboard while another window is active.
bool CNWindowView::bOnActivate(const WindowMessage& message, LRESULT&) {
  const HWND hFocus = GetFocus();
  if (LOWORD(message.wParam) == WA_INACTIVE && IsChild(m_hWindow, hFocus)) m_hLastFocus = hFocus;
  return false;
}

bool CNWindowView::bOnSetFocus(const WindowMessage&, LRESULT&) {
  if (m_bPending || !m_pDialog) return true;
  if (m_hLastFocus && IsWindowVisible(m_hLastFocus) && IsWindowEnabled(m_hLastFocus))
    SetFocus(m_hLastFocus);
  else
    m_pDialog->SetInitialFocus(m_hWindow);
  return true;
}

bool CNWindowView::bOnGetDefault(const WindowMessage&, LRESULT& lResult) {
  const HWND hButton = m_pDialog ? m_pDialog->hDefaultButton() : nullptr;
  lResult = hButton ? MAKELRESULT(GetDlgCtrlID(hButton), DC_HASDEFID) : 0;
  return true;
}

bool CNWindowView::bOnSetDefault(const WindowMessage& message, LRESULT& lResult) {
  if (m_pDialog) m_pDialog->SetDefault(GetDlgItem(m_hWindow, static_cast<int>(message.wParam)));
  lResult = TRUE;
  return true;
}

bool CNWindowView::bOnDestroy(const WindowMessage&, LRESULT&) {
  ReleaseOwner();
  std::unique_ptr<ShownDialog> pDialog, pFormer;  // these go last, when the lock is free
  CNSemHold hold(m_lock);
  pDialog.swap(m_pDialog);
  pFormer.swap(m_pFormer);
  m_bPending = m_bPlaced = false;
  return true;
}
