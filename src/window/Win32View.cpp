#include "window/Win32View.h"

#include "foundation/os/OsWide.h"
#include "window/MessageLoop.h"
#include "window/Placement.h"
#include "window/SystemDialogs.h"
#include "window/WindowView.h"

namespace {

const DWORD COMMON_CONTROLS = 0x1F85;  // list view, progress, hot key, animation, date, combo, rebar, IP address, pager
const double DOTS_TO_SCALE = 0.010416667;  // one ninety-sixth

}  // namespace

std::unique_ptr<WizardView> pMakeWin32View(void* hInstance, WizardView* pOwner) {
  return std::unique_ptr<WizardView>(
      new CNWindowView(static_cast<HINSTANCE>(hInstance), static_cast<CNWindowView*>(pOwner)));
}

CNWindowView::CNWindowView(HINSTANCE hInstance, CNWindowView* pOwner) : m_hInstance(hInstance), m_pOwner(pOwner) {
  const INITCOMMONCONTROLSEX classes = {sizeof(classes), COMMON_CONTROLS};
  InitCommonControlsEx(&classes);
  ScreenDC screen;
  m_dScale = GetDeviceCaps(screen.Get(), LOGPIXELSY) * DOTS_TO_SCALE;
}

CNWindowView::~CNWindowView() { CloseWindow(); }

std::unique_ptr<WizardView> CNWindowView::pMakeOwnedView() { return pMakeWin32View(m_hInstance, this); }

bool CNWindowView::bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) {
  if (m_hWindow || !m_Class.bRegister(m_hInstance, options, WindowProc)) return false;
  m_pEvents = &events;
  m_bClosing = false;
  const HWND hOwner = m_pOwner ? m_pOwner->m_hWindow.load() : nullptr;
  CreateWindowExW(0, m_Class.Atom(), L"default", WS_OVERLAPPEDWINDOW, 0, 0, 0, 0, hOwner, nullptr, m_hInstance, this);
  if (!m_hWindow) {
    LogPrintf("ERROR: CNWindowView::bOpenWindow -> !m_hWindow -> return FALSE");
    return false;
  }
  m_bHoldsOwner = hOwner && !EnableWindow(hOwner, FALSE);
  return true;
}

// Must come before the window goes: the system gives the activation to an enabled window only.
void CNWindowView::ReleaseOwner() {
  if (m_bHoldsOwner && m_pOwner->m_hWindow) EnableWindow(m_pOwner->m_hWindow, TRUE);
  m_bHoldsOwner = false;
}

void CNWindowView::CloseWindow() {
  if (!m_hWindow) return;
  ReleaseOwner();
  // The wizard that opens its window after this one is to have the foreground that the user gave to this one.
  if (GetForegroundWindow() == m_hWindow) AllowSetForegroundWindow(GetCurrentProcessId());
  m_bClosing = true;
  DestroyWindow(m_hWindow);
}

int CNWindowView::iRun() {
  RunMessageLoop(m_hWindow);
  return 0;
}

// The caption of a dialog that is still being made appears together with it.
void CNWindowView::SetCaption(const char* szCaption) {
  m_csCaption = szCaption;
  if (!m_bPending && m_hWindow) SetWindowTextW(m_hWindow, Wide(m_csCaption.Text()));
}

void CNWindowView::ShowWindow(bool bShow) {
  if (m_hWindow) ::ShowWindow(m_hWindow, bShow ? SW_SHOW : SW_HIDE);
}

void CNWindowView::PostCommand(int iID) {
  if (const HWND hWnd = m_hWindow) PostMessageW(hWnd, WM_COMMAND, static_cast<WPARAM>(iID), 0);
}

void CNWindowView::SendCommand(int iID) {
  if (const HWND hWnd = m_hWindow) SendMessageW(hWnd, WM_COMMAND, static_cast<WPARAM>(iID), 0);
}

bool CNWindowView::bCreateDialog(DialogInfo& dialog) {
  if (!m_hWindow) {
    LogPrintf("ERROR: CNWindowView::bCreateDialog -> !m_hWindow -> return FALSE");
    return false;
  }
  std::unique_ptr<ShownDialog> pDialog(new ShownDialog(dialog));
  pDialog->CreateControls(m_hWindow, m_hInstance);
  // pDialog then holds what is to go, and goes after the lock is free.
  CNSemHold hold(m_lock);
  // One that was never shown makes room at once, the one on the screen when its successor is shown.
  if (!m_bPending) m_pFormer.swap(m_pDialog);
  m_pDialog.swap(pDialog);
  m_bPending = true;
  return true;
}

void CNWindowView::FitWindow(const DialogInfo& dialog) {
  const HWND hWnd = m_hWindow;
  RECT present, workArea;
  const bool bVisible = IsWindowVisible(hWnd);
  if (IsIconic(hWnd)) ::ShowWindow(hWnd, SW_SHOWNOACTIVATE);  // its place as an icon is not to be inherited
  if (IsZoomed(hWnd) && !dialog.m_bMaximize) ::ShowWindow(hWnd, SW_RESTORE);
  GetWindowRect(hWnd, &present);
  SystemParametersInfoW(SPI_GETWORKAREA, 0, &workArea, 0);
  const RECT place = PlaceDialog(dialog, m_bPlaced ? &present : nullptr, workArea);
  SetWindowLongW(hWnd, GWL_STYLE, static_cast<LONG>(TopLevelStyle(dialog) | (bVisible ? WS_VISIBLE : 0)));
  SetWindowLongW(hWnd, GWL_EXSTYLE, static_cast<LONG>(dialog.m_dwExStyle));
  SetWindowPos(hWnd, nullptr, place.left, place.top, place.right - place.left, place.bottom - place.top,
               SWP_NOZORDER | SWP_NOACTIVATE | SWP_FRAMECHANGED | (bVisible ? SWP_NOREDRAW | SWP_NOCOPYBITS : 0));
  m_bPlaced = true;
}

// The new controls take the old ones' place without a painting in between; then everything is drawn at once.
void CNWindowView::ShowDialog() {
  const HWND hWnd = m_hWindow;
  if (!hWnd || !m_pDialog) return;
  const DialogInfo& info = m_pDialog->Info();
  SetWindowTextW(hWnd, Wide(m_csCaption.Text()));
  FitWindow(info);
  if (m_pFormer) m_pFormer->ShowControls(false);
  m_hLastFocus = nullptr;
  m_bPending = false;  // before the controls appear: from now on other threads show and hide them themselves
  m_pDialog->ShowControls(true);
  const int iShow = info.m_bHide ? SW_HIDE : info.m_bMaximize ? SW_MAXIMIZE : SW_SHOW;
  // A window that is there already is not shown again: that could bring it before the one the user works in.
  const bool bAppears = !info.m_bHide && !IsWindowVisible(hWnd);
  if (iShow != SW_SHOW || bAppears) ::ShowWindow(hWnd, iShow);
  if (bAppears) SetForegroundWindow(hWnd);
  if (!info.m_bHide && m_pDialog) m_pDialog->SetInitialFocus(hWnd);  // gone when the first focus ended the wizard
  RedrawWindow(hWnd, nullptr, nullptr, RDW_INVALIDATE | RDW_ERASE | RDW_FRAME | RDW_ALLCHILDREN | RDW_UPDATENOW);
  m_pFormer.reset();
}

bool CNWindowView::bChooseFolder(const char* szTitle, CNString& csFolder) {
  return bSystemChooseFolder(hMessageOwner(), szTitle, csFolder);
}

bool CNWindowView::bChooseFile(const char* szTitle, CNString& csFile) {
  return bSystemChooseFile(hMessageOwner(), szTitle, csFile);
}

bool CNWindowView::bOpenLink(const char* szTarget, const char* szFolder) {
  return bSystemOpen(hMessageOwner(), szTarget, szFolder);
}

int CNWindowView::iShowMessage(const MessageText& message) {
  return iSystemMessage(message.bOwned ? hMessageOwner() : nullptr, message);
}

// A hidden window cannot own a dialog that a person is to see.
HWND CNWindowView::hMessageOwner() const {
  const HWND hWnd = m_hWindow;
  if (hWnd && IsWindowVisible(hWnd)) return hWnd;
  return m_pOwner ? m_pOwner->hMessageOwner() : nullptr;
}

int CNWindowView::iCaptionHeight(bool bSmallCaption) const {
  return GetSystemMetrics(bSmallCaption ? SM_CYSMCAPTION : SM_CYCAPTION);
}
