// The wizard window's messages: one table, one small method for each.
#include "foundation/ResultCodes.h"
#include "window/CursorWindow.h"
#include "window/LayoutWindow.h"
#include "window/MenuWindow.h"
#include "window/TabWindow.h"
#include "window/ToolbarWindow.h"
#include "window/WindowView.h"

namespace {

const int FIRST_CONTROL_ID = 501;          // smaller identifiers are the wizard's own commands
const UINT TELL_CONTROL = WM_APP + 0x320;  // wParam: notification, lParam: the control's window

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
    {WM_ENDSESSION, &CNWindowView::bOnEndSession},
    {WM_MOVE, &CNWindowView::bOnPlaced},
    {WM_SIZE, &CNWindowView::bOnSized},
    {WM_GETMINMAXINFO, &CNWindowView::bOnLimitSize},
    {WM_TIMER, &CNWindowView::bOnTimer},
    {WM_ERASEBKGND, &CNWindowView::bOnEraseGround},
    {WM_CTLCOLORSTATIC, &CNWindowView::bOnControlColor},
    {WM_CTLCOLORBTN, &CNWindowView::bOnControlColor},
    {WM_CTLCOLOREDIT, &CNWindowView::bOnControlColor},
    {WM_CTLCOLORLISTBOX, &CNWindowView::bOnControlColor},
    {WM_DRAWITEM, &CNWindowView::bOnDrawItem},
    {WM_MEASUREITEM, &CNWindowView::bOnMeasureItem},
    {WM_NOTIFY, &CNWindowView::bOnNotify},
    {TELL_CONTROL, &CNWindowView::bOnTellControl},
    {WM_HSCROLL, &CNWindowView::bOnScroll},
    {WM_VSCROLL, &CNWindowView::bOnScroll},
    {WM_CONTEXTMENU, &CNWindowView::bOnContextMenu},
    {WM_MENUCHAR, &CNWindowView::bOnMenuCharacter},
    {WM_SETCURSOR, &CNWindowView::bOnSetCursor},
    {WM_ACTIVATE, &CNWindowView::bOnActivate},
    {WM_SETFOCUS, &CNWindowView::bOnSetFocus},
    {WM_NEXTDLGCTL, &CNWindowView::bOnNextControl},
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

bool CNWindowView::bPreTranslate(MSG& message) {
  CNWindowView* pOutermost = this;
  while (pOutermost->m_pOwner) pOutermost = pOutermost->m_pOwner;
  return pOutermost->m_DoublePress.bDrops(message) || bTakeAccelerator(message) || bTakeContextKey(message) ||
         (m_pDialog && bTurnPage(*m_pDialog, message)) || bTabThroughBar(m_hWindow, message) ||
         IsDialogMessageW(m_hWindow, &message);
}

// After the wizard was told, neither the control nor its dialog may be touched: they may be gone.
bool CNWindowView::bOnCommandMessage(const WindowMessage& message, LRESULT&) {
  if (m_bClosing) return true;
  const int iID = LOWORD(message.wParam);
  auto hControl = reinterpret_cast<HWND>(message.lParam);
  // Enter presses the default button, whose window the system does not find when it stands in a frame.
  if (!hControl && m_pDialog && iID >= FIRST_CONTROL_ID) hControl = m_pDialog->hFind(iID);
  if (!hControl) {
    CNItem* pItem = m_bPending || !m_pDialog ? nullptr : pMenuItem(*m_pDialog, iID);
    if (pItem) m_pEvents->OnItem(*pItem);
    if (iID < FIRST_CONTROL_ID) m_pEvents->OnCommand(iID);
    return true;
  }
  NativeControl* pNative = NativeControl::pFromWindow(hControl);
  CNItem* pItem = pNative ? pToolbarChoice(*pNative, hControl, iID, HIWORD(message.wParam)) : nullptr;
  if (pItem && &pNative->Dialog() == m_pDialog.get()) m_pEvents->OnItem(*pItem);
  if (pItem || !pNative || !pNative->Kind().pNotification) return true;
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

bool CNWindowView::bOnPlaced(const WindowMessage&, LRESULT&) {
  NotePlace();
  return false;
}

bool CNWindowView::bOnSized(const WindowMessage& message, LRESULT&) {
  if (m_pDialog && message.wParam != SIZE_MINIMIZED) LayOutInside(*m_pDialog, nullptr, m_hWindow);
  NotePlace();
  return false;
}

bool CNWindowView::bOnLimitSize(const WindowMessage& message, LRESULT&) {
  if (m_pDialog) LimitSize(*m_pDialog, m_hWindow, *reinterpret_cast<MINMAXINFO*>(message.lParam));
  return false;
}

bool CNWindowView::bOnTimer(const WindowMessage& message, LRESULT&) {
  if (message.wParam == SESSION_TIMER && !m_pEvents->bHoldsQuit()) HoldSession(false);
  if (message.wParam != PLACE_TIMER) return false;
  KillTimer(m_hWindow, PLACE_TIMER);
  m_Places.Save();
  return true;
}

bool CNWindowView::bOnEraseGround(const WindowMessage& message, LRESULT& lResult) {
  ShownDialog* pVisible = m_bPending && m_pFormer ? m_pFormer.get() : m_pDialog.get();
  if (!pVisible) return false;
  RECT client;
  GetClientRect(m_hWindow, &client);
  pVisible->FillGround(reinterpret_cast<HDC>(message.wParam), m_hWindow, client);
  lResult = TRUE;
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
  lResult = TRUE;
  if (item.CtlType == ODT_MENU) return m_pDialog && bDrawMenuItem(*m_pDialog, item);
  NativeControl* pNative = NativeControl::pFromWindow(item.hwndItem);
  if (!pNative || !pNative->Kind().pDraw) return false;
  pNative->Kind().pDraw(*pNative, item);
  return true;
}

bool CNWindowView::bOnMeasureItem(const WindowMessage& message, LRESULT& lResult) {
  auto& item = *reinterpret_cast<MEASUREITEMSTRUCT*>(message.lParam);
  lResult = TRUE;
  return item.CtlType == ODT_MENU && m_pDialog && bMeasureMenuItem(*m_pDialog, item);
}

bool CNWindowView::bOnNotify(const WindowMessage& message, LRESULT& lResult) {
  auto& header = *reinterpret_cast<NMHDR*>(message.lParam);
  NativeControl* pNative = m_pDialog ? m_pDialog->pFindWindow(header.hwndFrom) : nullptr;
  if (m_bClosing || !pNative || !pNative->Kind().pNotify) return false;
  return bTell(*pNative, pNative->Kind().pNotify(*pNative, header), lResult);
}

bool CNWindowView::bOnScroll(const WindowMessage& message, LRESULT& lResult) {
  NativeControl* pNative = m_pDialog ? m_pDialog->pFindWindow(reinterpret_cast<HWND>(message.lParam)) : nullptr;
  if (m_bClosing || !pNative || !pNative->Kind().pScrolled) return false;
  return bTell(*pNative, pNative->Kind().pScrolled(*pNative, LOWORD(message.wParam)), lResult);
}

// The wizard is told of a control's event when the control has finished with it: the library's controls do not bear it
// that their window goes while they notify. A page that is not shown yet has nothing to say.
bool CNWindowView::bTell(const NativeControl& native, const NativeEvent& event, LRESULT& lResult) {
  lResult = event.lResult;
  if (event.pItem)
    m_pEvents->OnItem(*event.pItem);
  else if (event.bSettled && event.iNotification != NativeKind::IGNORED)
    m_pEvents->OnControl(native.Control(), event.iNotification);
  else if (event.iNotification != NativeKind::IGNORED && !m_bPending)
    PostMessageW(m_hWindow, TELL_CONTROL, static_cast<WPARAM>(event.iNotification),
                 reinterpret_cast<LPARAM>(native.hWnd()));
  return event.bAnswered;
}

bool CNWindowView::bOnTellControl(const WindowMessage& message, LRESULT&) {
  const auto hWnd = reinterpret_cast<HWND>(message.lParam);
  const NativeControl* pNative = m_bPending || m_bClosing || !m_pDialog ? nullptr : m_pDialog->pFindWindow(hWnd);
  if (pNative && pNative->hWnd() == hWnd) m_pEvents->OnControl(pNative->Control(), static_cast<int>(message.wParam));
  return true;
}

bool CNWindowView::bOnSetCursor(const WindowMessage& message, LRESULT& lResult) {
  if (!m_pDialog || LOWORD(message.lParam) != HTCLIENT) return false;
  lResult = bSetScriptCursor(*m_pDialog, reinterpret_cast<HWND>(message.wParam));
  return lResult != 0;
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

// How the system leads the Alt key of a label on to its field.
bool CNWindowView::bOnNextControl(const WindowMessage& message, LRESULT&) {
  const HWND hNext = LOWORD(message.lParam) ? reinterpret_cast<HWND>(message.wParam)
                                            : GetNextDlgTabItem(m_hWindow, GetFocus(), message.wParam != 0);
  FocusControl(hNext ? hNext : m_hWindow.load());
  return true;
}

bool CNWindowView::bOnGetDefault(const WindowMessage&, LRESULT& lResult) {
  const HWND hButton = m_pDialog ? m_pDialog->hDefaultButton() : nullptr;
  lResult = hButton ? MAKELRESULT(GetDlgCtrlID(hButton), DC_HASDEFID) : 0;
  return true;
}

bool CNWindowView::bOnSetDefault(const WindowMessage& message, LRESULT& lResult) {
  if (m_pDialog) m_pDialog->SetDefault(m_pDialog->hFind(static_cast<int>(message.wParam)));
  lResult = TRUE;
  return true;
}

bool CNWindowView::bOnDestroy(const WindowMessage&, LRESULT&) {
  HoldOwner(false);
  HoldSession(false);
  DropFormerDialogs();
  m_Places.Save();
  SetMenu(m_hWindow, nullptr);                    // it goes with its page
  std::unique_ptr<ShownDialog> pDialog, pFormer;  // these go last, when the lock is free
  CNSemHold hold(m_lock);
  pDialog.swap(m_pDialog);
  pFormer.swap(m_pFormer);
  m_bPending = m_bPlaced = false;
  return true;
}
