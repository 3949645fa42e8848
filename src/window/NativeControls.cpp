#include "window/NativeControls.h"

#include <cstring>

#include "foundation/os/OsWide.h"
#include "window/ShownDialog.h"

namespace {

const NativeKind* const NATIVE_KINDS[] = {
    &g_ButtonWindow,        &g_StaticWindow,           &g_CheckBoxWindow,   &g_EditWindow,
    &g_ListBoxWindow,       &g_SimulatedListBoxWindow, &g_ProgressWindow,   &g_ImageWindow,
    &g_RtfWindow,           &g_TrackBarWindow,         &g_UpDownWindow,     &g_DateTimeWindow,
    &g_MonthCalendarWindow, &g_IPAddressWindow,        &g_HotKeyWindow,     &g_PagerWindow,
    &g_StatusBarWindow,     &g_AnimationWindow,        &g_CursorWindow,     &g_WaveWindow,
    &g_MenuWindow,          &g_RightMenuWindow,        &g_ToolbarWindow,    &g_RebarWindow,
    &g_FrameWindow,         &g_GroupBoxWindow,         &g_TabControlWindow, &g_PropertySheetWindow,
    &g_TabPageWindow,       &g_SplitterWindow,         &g_ComboWindow,      &g_ListViewWindow,
    &g_TreeViewWindow,      &g_HeaderWindow,
};

}  // namespace

const NativeKind* pFindNativeKind(ControlKind kind) {
  for (const NativeKind* pKind : NATIVE_KINDS)
    if (pKind->kind == kind) return pKind;
  return nullptr;
}

NativeControl::NativeControl(BaseControl& control, const NativeKind& kind, ShownDialog& dialog)
    : m_bVisible((control.m_dwStyle & STYLE_VISIBLE) != 0), m_Control(control), m_Kind(kind), m_Dialog(dialog) {
  if (control.m_Background.bSet) SetGround(ToColorRef(control.m_Background));
}

bool NativeControl::bCreate(HWND hParent, HINSTANCE hInstance) {
  const CNWideText className(m_Control.szWindowClass()), caption(m_Control.m_csCaption.Text());
  CREATESTRUCTW window = {};
  window.lpszClass = reinterpret_cast<const wchar_t*>(className.Ptr());
  window.lpszName = reinterpret_cast<const wchar_t*>(caption.Ptr());
  window.style = static_cast<LONG>((m_Control.m_dwStyle | m_Kind.dwStyle | WS_CHILD) & ~m_Kind.dwRemovedStyle);
  window.dwExStyle = m_Control.m_dwExStyle | m_Kind.dwExStyle;
  window.hInstance = hInstance;
  window.x = m_Control.m_iSize[0];
  window.y = m_Control.m_iSize[1];
  window.cx = m_Control.m_iSize[2];
  window.cy = m_Control.m_iSize[3];
  if (m_Kind.pPrepare) m_Kind.pPrepare(*this, window);
  m_Window.Reset(CreateWindowExW(window.dwExStyle, window.lpszClass, window.lpszName, window.style & ~WS_VISIBLE,
                                 window.x, window.y, window.cx, window.cy, hParent,
                                 reinterpret_cast<HMENU>(static_cast<INT_PTR>(m_Control.m_iID)), hInstance, nullptr));
  if (!m_Window) {
    LogPrintf("ERROR: NativeControl::bCreate -> !m_Window -> szWindowClass = %s -> return FALSE",
              m_Control.szWindowClass());
    return false;
  }
  SetWindowLongPtrW(hWnd(), GWLP_USERDATA, reinterpret_cast<LONG_PTR>(this));
  SendMessageW(hWnd(), WM_SETFONT, reinterpret_cast<WPARAM>(hFont()), FALSE);
  if (m_Kind.pCreated) m_Kind.pCreated(*this);
  return true;
}

NativeControl* NativeControl::pFromWindow(HWND hWnd) {
  return hWnd ? reinterpret_cast<NativeControl*>(GetWindowLongPtrW(hWnd, GWLP_USERDATA)) : nullptr;
}

HFONT NativeControl::hFont() const {
  const bool bLink = m_Control.Kind() == ControlKind::Static && static_cast<CNStatic&>(m_Control).m_bLink;
  const bool bUnderline = bLink && m_Control.m_Font == FontVariant::Normal;
  return m_Dialog.Fonts().hGet(bUnderline ? FontVariant::Underline : m_Control.m_Font);
}

RECT NativeControl::Place() const {
  RECT place = {};
  GetWindowRect(hWnd(), &place);
  MapWindowPoints(nullptr, GetParent(hWnd()), reinterpret_cast<POINT*>(&place), 2);
  return place;
}

void NativeControl::FillGround(HDC hDC, HWND hInside, const RECT& area) const {
  m_Dialog.AlignGround(hDC, hInside);
  FillRect(hDC, &area, hGround());
}

void NativeControl::FillBehind(HDC hDC, const RECT& area) const {
  const NativeControl* pAround = m_Control.m_pParent ? m_Dialog.pFind(*m_Control.m_pParent) : nullptr;
  if (pAround)
    pAround->FillGround(hDC, hWnd(), area);
  else
    m_Dialog.FillGround(hDC, hWnd(), area);
}

void NativeControl::SetGround(COLORREF color) {
  m_BackgroundColor = color;
  m_Background.Reset(CreateSolidBrush(color));
}

const NativeControl* NativeControl::pColored() const {
  const NativeControl* p = this;
  while (p && !p->m_Background) p = p->m_Control.m_pParent ? m_Dialog.pFind(*p->m_Control.m_pParent) : nullptr;
  return p;
}

HBRUSH NativeControl::hGround() const {
  const NativeControl* pFrom = pColored();
  return pFrom ? pFrom->m_Background.Get() : m_Dialog.hGround();
}

HBRUSH NativeControl::hColors(HDC hDC, UINT uMessage) const {
  COLORREF textColor = GetSysColor(m_Kind.bField ? COLOR_WINDOWTEXT : COLOR_BTNTEXT);
  if (m_Kind.pTextColor) textColor = m_Kind.pTextColor(m_Control);
  SetTextColor(hDC,
               m_Control.m_TextColor.bSet && !m_Control.m_bVisited ? ToColorRef(m_Control.m_TextColor) : textColor);
  const NativeControl* pFrom = m_Kind.bField && !m_Background ? nullptr : pColored();
  if (!pFrom && !m_Kind.bField && m_Dialog.bHasPicture()) {
    m_Dialog.AlignGround(hDC, hWnd());
    SetBkMode(hDC, TRANSPARENT);
    return hGround();
  }
  if (pFrom || !m_Kind.bField) {
    SetBkColor(hDC, pFrom ? pFrom->m_BackgroundColor : m_Dialog.GroundColor());
    return hGround();
  }
  // A field that cannot be typed into asks as a static text does.
  int iColor = uMessage == WM_CTLCOLORSTATIC ? COLOR_BTNFACE : COLOR_WINDOW;
  if (m_iSystemGround >= 0) iColor = m_iSystemGround;
  SetBkColor(hDC, GetSysColor(iColor));
  return GetSysColorBrush(iColor);
}

bool bSetWindowText(HWND hWnd, const char* szText) {
  CNString csPresent;
  if (bGetWindowText(hWnd, csPresent) && strcmp(csPresent.Text(), szText) == 0) return true;
  return SetWindowTextW(hWnd, Wide(szText)) != FALSE;
}

std::unique_ptr<wchar_t[]> WindowText(HWND hWnd) {
  const int iLength = GetWindowTextLengthW(hWnd);
  std::unique_ptr<wchar_t[]> pText(new wchar_t[iLength + 1]());
  if (pText) GetWindowTextW(hWnd, pText.get(), iLength + 1);
  return pText;
}

bool bGetWindowText(HWND hWnd, CNString& csText) {
  const std::unique_ptr<wchar_t[]> pText = WindowText(hWnd);
  if (!pText) return false;
  bNarrow(pText.get(), csText);  // characters without a place in the code page become question marks
  return true;
}
