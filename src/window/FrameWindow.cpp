// Frames. What their controls tell them they pass on to the wizard's window, which knows all controls; what lies behind
// their controls they paint, and when their size changes they lay their tables out.
#include "window/FrameWindow.h"

#include "foundation/ResultCodes.h"
#include "window/LayoutWindow.h"
#include "window/WindowClasses.h"

namespace {

const char FRAME_CLASS[] = "FrameWizardClass";
const wchar_t FRAME_CLASS_NAME[] = L"FrameWizardClass";

int g_nUsers = 0;
WizardClass* g_pClass = nullptr;  // while there are users

bool bForWizard(UINT uMessage) {
  static const UINT MESSAGES[] = {WM_COMMAND, WM_NOTIFY, WM_DRAWITEM, WM_MEASUREITEM, WM_HSCROLL, WM_VSCROLL};
  for (const UINT uForwarded : MESSAGES)
    if (uForwarded == uMessage) return true;
  return uMessage >= WM_CTLCOLORMSGBOX && uMessage <= WM_CTLCOLORSTATIC;
}

LRESULT CALLBACK FrameProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  if (bForWizard(uMessage)) return SendMessageW(GetAncestor(hWnd, GA_ROOT), uMessage, wParam, lParam);
  NativeControl* pNative = NativeControl::pFromWindow(hWnd);
  if (pNative && uMessage == WM_ERASEBKGND) {
    RECT area;
    GetClientRect(hWnd, &area);
    pNative->FillGround(reinterpret_cast<HDC>(wParam), hWnd, area);
    return TRUE;
  }
  if (pNative && uMessage == WM_SIZE) LayOutInside(pNative->Dialog(), &pNative->Control(), hWnd);
  return DefWindowProcW(hWnd, uMessage, wParam, lParam);
}

HWND hInner(NativeControl& native) { return native.hWnd(); }

// A caption would be read out, and is nowhere to be seen.
void Prepare(NativeControl&, CREATESTRUCTW& window) { window.lpszName = nullptr; }

}  // namespace

FrameClass::~FrameClass() {
  if (!m_bUses || --g_nUsers > 0) return;
  delete g_pClass;
  g_pClass = nullptr;
}

bool FrameClass::bUse(HINSTANCE hInstance) {
  if (m_bUses) return true;
  WizardWindowOptions options;
  options.szClassName = FRAME_CLASS;
  if (!g_pClass) g_pClass = new WizardClass;
  m_bUses = g_nUsers > 0 || g_pClass->iInitWindowClass(hInstance, options, FrameProc) == EVERYTHING_IS_OK;
  if (m_bUses) g_nUsers++;
  return m_bUses;
}

int iInitFrameDialog(const ShownDialog& dialog, HWND hDlg) {
  const DialogInfo& info = dialog.Info();
  if (!hDlg)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iInitFrameDialog -> !hDlg window = %s -> return PRECONDITIONS_NOT_VALID",
                      info.m_csName.Text());
  int nFrames = 0;
  for (int i = 0; i < info.m_Controls.Size(); i++) {
    if (info.m_Controls[i]->Kind() != ControlKind::Frame) continue;
    nFrames++;
    if (!dialog.pFind(*info.m_Controls[i]))
      return iLogReturn(FUNCTION_ERROR,
                        "ERROR: COrbitWizard::iInitFrameDialog -> iCreateControls -> return FUNCTION_ERROR");
  }
  if (info.m_bHasFrames && nFrames == 0)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: COrbitWizard::iInitFrameDialog -> !pWizDialogInfo->frames -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}

HWND hMakeInside(NativeControl& native, HINSTANCE hInstance) {
  const HWND hWnd = CreateWindowExW(WS_EX_CONTROLPARENT, FRAME_CLASS_NAME, nullptr,
                                    WS_CHILD | WS_VISIBLE | WS_CLIPCHILDREN | WS_CLIPSIBLINGS, 0, 0, 0, 0,
                                    native.hWnd(), nullptr, hInstance, nullptr);
  if (hWnd) SetWindowLongPtrW(hWnd, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(&native));
  return hWnd;
}

const NativeKind g_FrameWindow = {.kind = ControlKind::Frame, .pPrepare = Prepare, .pInner = hInner};
