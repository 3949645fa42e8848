#include "window/ShownDialog.h"

#include "foundation/os/OsWide.h"
#include "window/ButtonWindow.h"

ShownDialog::ShownDialog(DialogInfo& dialog) : m_Info(dialog), m_Fonts(dialog.m_Font) {
  if (dialog.m_Background.bSet) m_Ground.Reset(CreateSolidBrush(ToColorRef(dialog.m_Background)));
}

void ShownDialog::CreateControls(HWND hParent, HINSTANCE hInstance) {
  for (int i = 0; i < m_Info.m_Controls.Size(); i++) {
    BaseControl& control = *m_Info.m_Controls[i];
    const NativeKind* pKind = pFindNativeKind(control.Kind());
    if (!pKind) continue;
    std::unique_ptr<NativeControl> pNative(new NativeControl(control, *pKind, *this));
    const NativeControl* pAround = control.m_pParent ? pFind(*control.m_pParent) : nullptr;
    const bool bInside = pAround && pAround->Kind().pInner;
    if (!pNative->bCreate(bInside ? pAround->Kind().pInner(*const_cast<NativeControl*>(pAround)) : hParent, hInstance))
      continue;
    if (control.Kind() == ControlKind::Button && static_cast<CNButton&>(control).m_bDefault)
      m_hDefault = pNative->hWnd();
    if (!control.m_csToolTip.bEmpty()) bSetToolTip(pNative->hWnd(), control.m_csToolTip.Text());
    m_Controls.Add(pNative.release(), true);
  }
}

void ShownDialog::ShowControls(bool bShow) {
  const UINT uQuietly = SWP_NOMOVE | SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE | SWP_NOREDRAW;
  for (int i = 0; i < m_Controls.Size(); i++) {
    if (bShow && m_Controls[i]->Kind().pBeforeShow) m_Controls[i]->Kind().pBeforeShow(*m_Controls[i]);
    const bool bVisible = bShow && m_Controls[i]->m_bVisible;
    SetWindowPos(m_Controls[i]->hWnd(), nullptr, 0, 0, 0, 0, uQuietly | (bVisible ? SWP_SHOWWINDOW : SWP_HIDEWINDOW));
  }
}

NativeControl* ShownDialog::pFind(const BaseControl& control) const {
  for (int i = 0; i < m_Controls.Size(); i++)
    if (&m_Controls[i]->Control() == &control) return m_Controls[i];
  return nullptr;
}

NativeControl* ShownDialog::pFindWindow(HWND hWnd) const {
  for (; hWnd; hWnd = GetAncestor(hWnd, GA_PARENT))
    for (int i = 0; i < m_Controls.Size(); i++)
      if (m_Controls[i]->hWnd() == hWnd) return m_Controls[i];
  return nullptr;
}

const NativeControl* ShownDialog::pNextOnRight(const NativeControl& native) const {
  const RECT own = native.Place();
  const NativeControl* pNearest = nullptr;
  for (int i = 0; i < m_Controls.Size(); i++) {
    const RECT other = m_Controls[i]->Place();
    if (other.left < own.right || other.top >= own.bottom || other.bottom <= own.top) continue;
    if (!pNearest || other.left < pNearest->Place().left) pNearest = m_Controls[i];
  }
  return pNearest;
}

void ShownDialog::SetInitialFocus(HWND hParent) {
  HWND hFocus = nullptr;
  for (int i = 0; i < m_Controls.Size(); i++) {
    const HWND hWnd = m_Controls[i]->hWnd();
    if (m_Controls[i]->Control().m_bFocus && IsWindowVisible(hWnd) && IsWindowEnabled(hWnd)) hFocus = hWnd;
  }
  if (!hFocus) hFocus = GetNextDlgTabItem(hParent, nullptr, FALSE);
  SetFocus(hFocus ? hFocus : hParent);
  if (hFocus && SendMessageW(hFocus, WM_GETDLGCODE, 0, 0) & DLGC_HASSETSEL) SendMessageW(hFocus, EM_SETSEL, 0, -1);
}

void ShownDialog::OnButtonFocus(HWND hButton, bool bFocused) {
  if (bFocused)
    ChangeDefault(hButton, m_hDefault);
  else if (hButton == m_hFocusedButton)
    ChangeDefault(nullptr, m_hDefault);
}

void ShownDialog::SetDefault(HWND hButton) { ChangeDefault(m_hFocusedButton, hButton); }

void ShownDialog::ChangeDefault(HWND hFocusedButton, HWND hDefault) {
  const HWND hBefore = hDefaultButton();
  m_hFocusedButton = hFocusedButton;
  m_hDefault = hDefault;
  if (hBefore == hDefaultButton()) return;
  ShowDefaultLook(hBefore, false);
  ShowDefaultLook(hDefaultButton(), true);
}

bool ShownDialog::bMakeToolTips(HWND hControl) {
  if (m_ToolTips) return true;
  m_ToolTips.Reset(CreateWindowExW(WS_EX_TOPMOST, TOOLTIPS_CLASSW, nullptr, WS_POPUP | TTS_NOPREFIX | TTS_ALWAYSTIP,
                                   CW_USEDEFAULT, CW_USEDEFAULT, CW_USEDEFAULT, CW_USEDEFAULT, GetParent(hControl),
                                   nullptr, nullptr, nullptr));
  if (m_ToolTips && m_Info.m_iToolTipTime >= 0)
    SendMessageW(m_ToolTips.Get(), TTM_SETDELAYTIME, TTDT_INITIAL, MAKELPARAM(m_Info.m_iToolTipTime, 0));
  return static_cast<bool>(m_ToolTips);
}

bool ShownDialog::bSetToolTip(HWND hControl, const char* szText) {
  if (!bMakeToolTips(hControl)) return false;
  const CNWideText text(szText);
  TOOLINFOW tool = {};
  tool.cbSize = TTTOOLINFOW_V2_SIZE;  // the size that every version of the library accepts
  tool.uFlags = TTF_IDISHWND | TTF_SUBCLASS;
  tool.hwnd = GetParent(hControl);
  tool.uId = reinterpret_cast<UINT_PTR>(hControl);
  SendMessageW(m_ToolTips.Get(), TTM_DELTOOLW, 0, reinterpret_cast<LPARAM>(&tool));
  tool.lpszText = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(text.Ptr()));
  return SendMessageW(m_ToolTips.Get(), TTM_ADDTOOLW, 0, reinterpret_cast<LPARAM>(&tool)) != FALSE;
}
