#include "window/Win32View.h"

#include "foundation/os/OsWide.h"
#include "window/LayoutWindow.h"
#include "window/MenuWindow.h"
#include "window/MessageLoop.h"
#include "window/SystemDialogs.h"
#include "window/WindowView.h"

namespace {

// List view, bars, tooltips, animation, date, combo, rebar, IP address, pager; tree, tab, up-down, progress, hot key.
const DWORD COMMON_CONTROLS = 0x1F85 | ICC_WIN95_CLASSES;

// A window's rectangle without being maximised. The system tells it in coordinates of the work area.
RECT RestoredArea(HWND hWnd) {
  WINDOWPLACEMENT placement = {};
  placement.length = sizeof(placement);
  GetWindowPlacement(hWnd, &placement);
  MONITORINFO screen = {};
  screen.cbSize = sizeof(screen);
  if (!(GetWindowLongW(hWnd, GWL_EXSTYLE) & WS_EX_TOOLWINDOW) &&
      GetMonitorInfoW(MonitorFromWindow(hWnd, MONITOR_DEFAULTTONEAREST), &screen))
    OffsetRect(&placement.rcNormalPosition, screen.rcWork.left - screen.rcMonitor.left,
               screen.rcWork.top - screen.rcMonitor.top);
  return placement.rcNormalPosition;
}

}  // namespace

std::unique_ptr<WizardView> pMakeWin32View(void* hInstance, WizardView* pOwner) {
  return std::unique_ptr<WizardView>(
      new CNWindowView(static_cast<HINSTANCE>(hInstance), static_cast<CNWindowView*>(pOwner)));
}

CNWindowView::CNWindowView(HINSTANCE hInstance, CNWindowView* pOwner) : m_hInstance(hInstance), m_pOwner(pOwner) {
  const INITCOMMONCONTROLSEX classes = {sizeof(classes), COMMON_CONTROLS};
  InitCommonControlsEx(&classes);
  m_dScale = dScreenScale();
}

// The factor becomes 1 where the system enlarges: to the thread, the screen then has 96 dots per inch.
void CNWindowView::SetPixelLayout(bool bPixels) {
  if (m_hWindow) return;
  m_Scaling = bPixels ? ScreenScaling::BySystem : ScreenScaling::ByScript;
  ScaleScope scope(m_Scaling);
  m_dScale = dScreenScale();
}

CNWindowView::~CNWindowView() { CloseWindow(); }

std::unique_ptr<WizardView> CNWindowView::pMakeOwnedView() { return pMakeWin32View(m_hInstance, this); }

bool CNWindowView::bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) {
  ScaleScope scope(m_Scaling);
  if (m_hWindow || m_Class.iInitWindowClass(m_hInstance, options, WindowProc) != EVERYTHING_IS_OK) return false;
  m_FrameClass.bUse(m_hInstance);
  m_pEvents = &events;
  m_bClosing = false;
  const HWND hOwner = m_pOwner ? m_pOwner->m_hWindow.load() : nullptr;
  CreateWindowExW(0, m_Class.Atom(), L"default", WS_OVERLAPPEDWINDOW, 0, 0, 0, 0, hOwner, nullptr, m_hInstance, this);
  if (!m_hWindow)
    return iLogReturn(0,
                      "ERROR: DialogInfo::iCreate -> !handle -> szClassName = %s , pParent = %s -> return "
                      "EVERYTHING_IS_OK",
                      options.szClassName, hOwner ? "owner" : "NULL");
  m_Places.Open(options.szConfigurationFile);
  m_bModeless = options.bModeless;
  HoldOwner(!m_bModeless);
  return true;
}

// Released before the window goes: the system gives the activation to an enabled window only. An owner that somebody
// else has disabled stays so.
void CNWindowView::HoldOwner(bool bHold) {
  const HWND hOwner = m_pOwner ? m_pOwner->m_hWindow.load() : nullptr;
  if (bHold == m_bHoldsOwner) return;
  m_bHoldsOwner = bHold && hOwner && !EnableWindow(hOwner, FALSE);
  if (!bHold && hOwner) EnableWindow(hOwner, TRUE);
}

void CNWindowView::CloseWindow() {
  if (!m_hWindow) return;
  HoldOwner(false);
  // The wizard that opens its window after this one is to have the foreground that the user gave to this one.
  if (GetForegroundWindow() == m_hWindow) AllowSetForegroundWindow(GetCurrentProcessId());
  m_bClosing = true;
  DestroyWindow(m_hWindow);
}

int CNWindowView::iRun() {
  ScaleScope scope(m_Scaling);
  m_nLoops++;
  RunMessageLoop(*this);
  m_nLoops--;
  DropFormerDialogs();
  return 0;
}

// Each is out of the list before it goes: what its windows do meanwhile may lead back here.
void CNWindowView::DropFormerDialogs() {
  while (m_pGone) {
    const std::unique_ptr<ShownDialog> pGone = std::move(m_pGone);
    m_pGone = std::move(pGone->m_pBefore);
  }
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
  ScaleScope scope(m_Scaling);
  std::unique_ptr<ShownDialog> pDialog(new ShownDialog(dialog));
  pDialog->iInitDialog(m_hWindow, m_hInstance);
  // pDialog then holds what is to go, and goes after the lock is free.
  CNSemHold hold(m_lock);
  // One that was never shown makes room at once, the one on the screen when its successor is shown.
  if (!m_bPending) m_pFormer.swap(m_pDialog);
  m_pDialog.swap(pDialog);
  m_bPending = true;
  return true;
}

// A dialog that inherits the size of a maximised window is as large; the first one asks the last run.
bool CNWindowView::bToBeMaximized(const DialogInfo& dialog) const {
  return dialog.m_bMaximize || (dialog.m_bInheritSize && (m_bPlaced ? IsZoomed(m_hWindow) : m_Places.bMaximized()));
}

void CNWindowView::FitWindow(const DialogInfo& dialog, bool bMaximized) {
  const HWND hWnd = m_hWindow;
  const bool bVisible = IsWindowVisible(hWnd);
  if (IsIconic(hWnd)) ::ShowWindow(hWnd, SW_SHOWNOACTIVATE);  // its place as an icon is not to be inherited
  if (IsZoomed(hWnd) && !bMaximized) ::ShowWindow(hWnd, SW_RESTORE);
  FormerPlace former;
  former.present = former.sized = m_Places.Sized();
  if (m_bPlaced) GetWindowRect(hWnd, &former.present);
  const RECT workArea = WorkAreaOf(m_bPlaced || !m_pOwner ? hWnd : m_pOwner->m_hWindow.load());
  const RECT place = PlaceDialog(dialog, former, workArea);
  SetWindowLongW(hWnd, GWL_STYLE, static_cast<LONG>(TopLevelStyle(dialog) | (bVisible ? WS_VISIBLE : 0)));
  SetWindowLongW(hWnd, GWL_EXSTYLE, static_cast<LONG>(dialog.m_dwExStyle));
  SetWindowPos(hWnd, nullptr, place.left, place.top, place.right - place.left, place.bottom - place.top,
               SWP_NOZORDER | SWP_NOACTIVATE | SWP_FRAMECHANGED | (bVisible ? SWP_NOREDRAW | SWP_NOCOPYBITS : 0) |
                   (IsZoomed(hWnd) ? SWP_NOMOVE | SWP_NOSIZE : 0));
  m_bPlaced = true;
}

// Remembers what the next dialog, and the next run, may inherit; written when the window has come to rest.
void CNWindowView::NotePlace() {
  const HWND hWnd = m_hWindow;
  if (!hWnd || m_bPending || !m_pDialog || !m_pDialog->Info().m_bInheritSize) return;
  if (IsIconic(hWnd) || !IsWindowVisible(hWnd)) return;
  RECT area;
  GetWindowRect(hWnd, &area);
  m_Places.Note(area, IsZoomed(hWnd) ? RestoredArea(hWnd) : area, IsZoomed(hWnd));
  if (m_Places.bChanged()) SetTimer(hWnd, PLACE_TIMER, PLACE_REST, nullptr);
}

// The new controls take the old ones' place without a painting in between; then everything is drawn at once.
void CNWindowView::ShowDialog() {
  const HWND hWnd = m_hWindow;
  if (!hWnd || !m_pDialog) return;
  ScaleScope scope(m_Scaling);
  const DialogInfo& info = m_pDialog->Info();
  const bool bMaximized = bToBeMaximized(info);
  SetWindowTextW(hWnd, Wide(m_csCaption.Text()));
  ExchangeMenu(hMenuBar(*m_pDialog));
  FitWindow(info, bMaximized);
  LayOutDialog(*m_pDialog, hWnd);
  if (m_pFormer) m_pFormer->ShowControls(false);
  m_hLastFocus = nullptr;
  m_bPending = false;  // before the controls appear: from now on other threads show and hide them themselves
  m_pDialog->ShowControls(true);
  HoldOwner(!m_bModeless || info.m_csFlags.Has("MODAL"));
  LayOutInside(*m_pDialog, nullptr, hWnd);  // bars may have taken controls in
  const int iShow = info.m_bHide ? SW_HIDE : bMaximized ? SW_MAXIMIZE : SW_SHOW;
  // A window that is there already is not shown again: that could bring it before the one the user works in.
  const bool bAppears = !info.m_bHide && !IsWindowVisible(hWnd);
  if (iShow != SW_SHOW || bAppears) ::ShowWindow(hWnd, iShow);
  if (bAppears || info.m_bFocus) SetForegroundWindow(hWnd);
  NotePlace();
  if (!info.m_bHide && m_pDialog) m_pDialog->SetInitialFocus(hWnd);  // gone when the first focus ended the wizard
  RedrawWindow(hWnd, nullptr, nullptr, RDW_INVALIDATE | RDW_ERASE | RDW_FRAME | RDW_ALLCHILDREN | RDW_UPDATENOW);
  if (m_nLoops && m_pFormer) {
    m_pFormer->m_pBefore = std::move(m_pGone);
    m_pGone = std::move(m_pFormer);
  }
  m_pFormer.reset();
}

bool CNWindowView::bChooseFolder(const char* szTitle, CNString& csFolder) {
  ScaleScope scope(m_Scaling);
  return bSystemChooseFolder(hMessageOwner(), szTitle, csFolder);
}

bool CNWindowView::bChooseFile(const char* szTitle, CNString& csFile) {
  ScaleScope scope(m_Scaling);
  return bSystemChooseFile(hMessageOwner(), szTitle, csFile);
}

bool CNWindowView::bOpenLink(const char* szTarget, const char* szFolder) {
  return bSystemOpen(hMessageOwner(), szTarget, szFolder);
}

int CNWindowView::iShowMessage(const MessageText& message) {
  ScaleScope scope(m_Scaling);
  return iSystemMessage(message.bOwned ? hMessageOwner() : nullptr, message);
}

// A hidden window cannot own a dialog that a person is to see.
HWND CNWindowView::hMessageOwner() const {
  const HWND hWnd = m_hWindow;
  if (hWnd && IsWindowVisible(hWnd)) return hWnd;
  return m_pOwner ? m_pOwner->hMessageOwner() : nullptr;
}

int CNWindowView::iCaptionHeight(bool bSmallCaption) const {
  ScaleScope scope(m_Scaling);
  return GetSystemMetrics(bSmallCaption ? SM_CYSMCAPTION : SM_CYCAPTION);
}
