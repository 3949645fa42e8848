#include "window/ShownDialog.h"

#include <algorithm>
#include <cstdlib>

#include "foundation/ResultCodes.h"
#include "foundation/os/OsWide.h"
#include "window/ButtonWindow.h"
#include "window/FrameWindow.h"
#include "window/Placement.h"
#include "window/ToolbarWindow.h"

namespace {

// What Tab reaches and bears no words of its own.
bool bNeedsLabel(const BaseControl& control) {
  static const ControlKind SPEAKING[] = {ControlKind::Button,     ControlKind::Static,  ControlKind::CheckBox,
                                         ControlKind::Image,      ControlKind::Frame,   ControlKind::GroupBox,
                                         ControlKind::TabControl, ControlKind::Toolbar, ControlKind::PropSheet,
                                         ControlKind::Splitter};
  for (const ControlKind kind : SPEAKING)
    if (kind == control.Kind()) return false;
  return (control.m_dwStyle & STYLE_TABSTOP) != 0;
}

// How far a text is from the field that it stands beside or above; too far when it does neither.
const LONG TOO_FAR = 120;
LONG lLabelDistance(const RECT& label, const RECT& field) {
  const LONG lAbove = 12, lIndent = 24;
  if (IsRectEmpty(&label) || IsRectEmpty(&field)) return TOO_FAR;
  if (label.top < field.bottom && label.bottom > field.top && label.right <= field.left + lAbove)
    return std::max<LONG>(0, field.left - label.right);
  const LONG lGap = field.top - label.bottom;
  const bool bOver = lGap > -4 && lGap <= lAbove && std::abs(label.left - field.left) <= lIndent;
  return bOver ? std::max<LONG>(0, lGap) : TOO_FAR;
}

// Where Tab begins. A bar of buttons has the keyboard at once only when there is nothing else.
HWND hFirstStop(HWND hParent) {
  const HWND hFirst = GetNextDlgTabItem(hParent, nullptr, FALSE);
  HWND hStop = hFirst;
  while (hStop && bIsToolbar(hStop)) {
    hStop = GetNextDlgTabItem(hParent, hStop, FALSE);
    if (hStop == hFirst) break;
  }
  return hStop;
}

}  // namespace

ShownDialog::ShownDialog(DialogInfo& dialog) : m_Info(dialog), m_Fonts(dialog.m_Font, dialog.m_dScale) {
  if (dialog.m_Background.bSet) m_Ground.Reset(CreateSolidBrush(ToColorRef(dialog.m_Background)));
}

ShownDialog::~ShownDialog() { iDestroyWizardControlWnds(); }

// What stands in a container goes before it.
int ShownDialog::iDestroyWizardControlWnds() {
  while (m_Controls.Size() > 0) m_Controls.Remove(m_Controls[m_Controls.Size() - 1]);
  return EVERYTHING_IS_OK;
}

int ShownDialog::iInitDialog(HWND hParent, HINSTANCE hInstance) {
  m_hParent = hParent;
  if (!m_Info.m_csPicture.bEmpty()) m_pPicture.reset(new Picture);
  if (m_pPicture && !m_pPicture->bLoad(hInstance, m_Info.m_csPicture.Text(), ControlColor())) m_pPicture.reset();
  const int iControls = iCreateControls(hParent, hInstance), iFrames = iInitFrameDialog(*this, hParent);
  return iControls ? iControls : iFrames;
}

// In line order, which is the tab order. A control that cannot be made is logged and left out.
int ShownDialog::iCreateControls(HWND hParent, HINSTANCE hInstance) {
  int iResult = EVERYTHING_IS_OK;
  for (int i = 0; i < m_Info.m_Controls.Size(); i++) {
    BaseControl& control = *m_Info.m_Controls[i];
    const NativeKind* pKind = pFindNativeKind(control.Kind());
    if (!pKind) continue;
    std::unique_ptr<NativeControl> pNative(new NativeControl(control, *pKind, *this));
    const NativeControl* pAround = control.m_pParent ? pFind(*control.m_pParent) : nullptr;
    const bool bInside = pAround && pAround->Kind().pInner;
    if (!pNative->bCreate(bInside ? pAround->Kind().pInner(*const_cast<NativeControl*>(pAround)) : hParent,
                          hInstance)) {
      iResult = FUNCTION_ERROR;
      continue;
    }
    if (control.Kind() == ControlKind::Button && static_cast<CNButton&>(control).m_bDefault)
      m_hDefault = pNative->hWnd();
    if (!control.m_csToolTip.bEmpty()) bSetToolTip(pNative->hWnd(), control.m_csToolTip.Text());
    m_Controls.Add(pNative.release(), true);
  }
  return iResult;
}

void ShownDialog::ShowControls(bool bShow) {
  const UINT uQuietly = SWP_NOMOVE | SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE | SWP_NOREDRAW;
  // What the controls do before they show asks for all places again and again.
  if (bShow) m_pPlaces.reset(new RECT[static_cast<size_t>(m_Controls.Size())]);
  for (int i = 0; bShow && i < m_Controls.Size(); i++) m_pPlaces[i] = m_Controls[i]->Place();
  for (int i = 0; i < m_Controls.Size(); i++) {
    if (bShow && m_Controls[i]->Kind().pBeforeShow) m_Controls[i]->Kind().pBeforeShow(*m_Controls[i]);
    const bool bVisible = bShow && m_Controls[i]->m_bVisible;
    SetWindowPos(m_Controls[i]->hWnd(), nullptr, 0, 0, 0, 0, uQuietly | (bVisible ? SWP_SHOWWINDOW : SWP_HIDEWINDOW));
  }
  if (bShow) OrderLabels();
  m_pPlaces.reset();
}

// The control that is the field's label by its place, or -1.
int ShownDialog::iLabelOf(int iField) const {
  int iNearest = -1;
  LONG lNearest = TOO_FAR;
  for (int i = 0; i < m_Controls.Size(); i++) {
    const BaseControl& control = m_Controls[i]->Control();
    if (control.Kind() != ControlKind::Static || static_cast<const CNStatic&>(control).m_bLink) continue;
    if (control.m_pParent != m_Controls[iField]->Control().m_pParent || !m_Controls[i]->m_bVisible) continue;
    const LONG lDistance = lLabelDistance(m_pPlaces[i], m_pPlaces[iField]);
    if (lDistance >= lNearest) continue;
    lNearest = lDistance;
    iNearest = i;
  }
  return iNearest;
}

// The text right before a field in the order of the windows is what screen readers call the field, and its Alt key
// leads there. Where the lines of a script stand in another order the text is moved; texts are no stops of the Tab key.
void ShownDialog::OrderLabels() {
  for (int i = 0; i < m_Controls.Size(); i++) {
    const int iLabel = bNeedsLabel(m_Controls[i]->Control()) ? iLabelOf(i) : -1;
    if (iLabel < 0) continue;
    SetRectEmpty(&m_pPlaces[iLabel]);  // it is the label of one field only
    const HWND hLabel = m_Controls[iLabel]->hWnd(), hBefore = GetWindow(m_Controls[i]->hWnd(), GW_HWNDPREV);
    if (hBefore != hLabel)
      SetWindowPos(hLabel, hBefore ? hBefore : HWND_TOP, 0, 0, 0, 0,
                   SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE | SWP_NOREDRAW);
  }
}

// Draws the ground with the picture in memory once for each size of the window; the brush of it then paints any part of
// the window in one go.
int ShownDialog::iPaintBitmap(SIZE client) {
  ScreenDC screen;
  const OwnedBitmap bitmap(CreateCompatibleBitmap(screen.Get(), client.cx, client.cy));
  const OwnedMemoryDC memory(CreateCompatibleDC(screen.Get()));
  if (!bitmap || !memory) return FUNCTION_ERROR;
  {
    Selected scope(memory.Get(), bitmap.Get());
    const RECT whole = {0, 0, client.cx, client.cy};
    FillRect(memory.Get(), &whole, m_Ground ? m_Ground.Get() : GetSysColorBrush(COLOR_BTNFACE));
    const SIZE own = m_pPicture->Size();
    const double dScale = m_Info.m_dScale;
    m_pPicture->Draw(memory.Get(), PlacePicture(m_Info, client, {LONG(own.cx * dScale), LONG(own.cy * dScale)}));
  }
  m_PictureGround.Reset(CreatePatternBrush(bitmap.Get()));
  m_PictureSize = client;
  return m_PictureGround ? EVERYTHING_IS_OK : FUNCTION_ERROR;
}

HBRUSH ShownDialog::hGround() {
  const HBRUSH hPlain = m_Ground ? m_Ground.Get() : GetSysColorBrush(COLOR_BTNFACE);
  RECT client;
  if (!m_pPicture || !GetClientRect(m_hParent, &client) || IsRectEmpty(&client)) return hPlain;
  const bool bFits = m_PictureGround && m_PictureSize.cx == client.right && m_PictureSize.cy == client.bottom;
  return bFits || iPaintBitmap({client.right, client.bottom}) == EVERYTHING_IS_OK ? m_PictureGround.Get() : hPlain;
}

void ShownDialog::AlignGround(HDC hDC, HWND hWnd) const {
  if (!m_pPicture) return;
  POINT origin = {0, 0};
  MapWindowPoints(m_hParent, hWnd, &origin, 1);
  LPtoDP(hDC, &origin, 1);
  SetBrushOrgEx(hDC, origin.x, origin.y, nullptr);
}

void ShownDialog::FillGround(HDC hDC, HWND hWnd, const RECT& area) {
  AlignGround(hDC, hWnd);
  FillRect(hDC, &area, hGround());
}

NativeControl* ShownDialog::pFind(const BaseControl& control) const {
  for (int i = 0; i < m_Controls.Size(); i++)
    if (&m_Controls[i]->Control() == &control) return m_Controls[i];
  return nullptr;
}

HWND ShownDialog::hFind(int iID) const {
  for (int i = 0; i < m_Controls.Size(); i++)
    if (iID != 0 && m_Controls[i]->Control().m_iID == iID) return m_Controls[i]->hWnd();
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
  LONG lNearest = 0;
  for (int i = 0; i < m_Controls.Size(); i++) {
    if (m_Controls[i]->Control().m_pParent != native.Control().m_pParent) continue;
    const RECT other = m_pPlaces ? m_pPlaces[i] : m_Controls[i]->Place();
    if (other.left < own.right || other.top >= own.bottom || other.bottom <= own.top) continue;
    if (pNearest && other.left >= lNearest) continue;
    pNearest = m_Controls[i];
    lNearest = other.left;
  }
  return pNearest;
}

void ShownDialog::SetInitialFocus(HWND hParent) {
  HWND hFocus = nullptr;
  for (int i = 0; i < m_Controls.Size(); i++) {
    const HWND hWnd = m_Controls[i]->hWnd();
    if (m_Controls[i]->Control().m_bFocus && IsWindowVisible(hWnd) && IsWindowEnabled(hWnd)) hFocus = hWnd;
  }
  if (!hFocus) hFocus = hFirstStop(hParent);
  FocusControl(hFocus ? hFocus : hParent);
}

void FocusControl(HWND hControl) {
  SetFocus(hControl);
  if (SendMessageW(hControl, WM_GETDLGCODE, 0, 0) & DLGC_HASSETSEL) SendMessageW(hControl, EM_SETSEL, 0, -1);
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
  // Line feeds of a tip are obeyed only in tips with a width.
  SendMessageW(m_ToolTips.Get(), TTM_SETMAXTIPWIDTH, 0, static_cast<LPARAM>(400 * m_Info.m_dScale));
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
