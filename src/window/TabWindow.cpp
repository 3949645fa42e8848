// Tab controls, and property sheets, which look the same, with their pages. A page is a window beside the tab control,
// right behind it in the order of the windows, so that Tab leads from the tabs into the page; it shows through a hole
// in the tab control's region. A tab control's text is the number of its page, from 1.
#include "window/TabWindow.h"

#include <algorithm>
#include <cstdlib>

#include "controls/ContainerKinds.h"
#include "foundation/os/OsWide.h"
#include "window/FrameWindow.h"
#include "window/SimpleWindows.h"
#include "wizard/WizardView.h"

namespace {

const CNTabControl& Tabs(const NativeControl& native) { return static_cast<const CNTabControl&>(native.Control()); }

int iPageOf(HWND hWnd) { return static_cast<int>(SendMessageW(hWnd, TCM_GETCURSEL, 0, 0)); }

// The window of a page; null while the dialog is being made.
NativeControl* pPage(const NativeControl& native, int i) { return native.Dialog().pFind(*Tabs(native).m_Pages[i]); }

const int GAP = 2;  // that tab controls leave between their line and their page

// The pages' place in the tab control.
RECT PageArea(HWND hWnd) {
  RECT area;
  GetClientRect(hWnd, &area);
  SendMessageW(hWnd, TCM_ADJUSTRECT, FALSE, reinterpret_cast<LPARAM>(&area));
  InflateRect(&area, GAP, GAP);
  area.top++;  // under the tabs the line is nearer
  area.right = std::max(area.left, area.right);
  area.bottom = std::max(area.top, area.bottom);
  return area;
}

RECT PagePlace(HWND hWnd) {
  RECT area = PageArea(hWnd);
  MapWindowPoints(hWnd, GetParent(hWnd), reinterpret_cast<POINT*>(&area), 2);
  return area;
}

// The shape that the tab control has.
struct Shape : NativeState {
  RECT whole = {}, hole = {};
};

// The page is there already, so the tabs must not be painted over it.
void CutHole(NativeControl& native) {
  const HWND hWnd = native.hWnd();
  if (!native.m_pState) native.m_pState.reset(new Shape);
  auto& shape = static_cast<Shape&>(*native.m_pState);
  const RECT hole = PageArea(hWnd);
  RECT whole;
  GetClientRect(hWnd, &whole);
  if (EqualRect(&whole, &shape.whole) && EqualRect(&hole, &shape.hole)) return;
  shape.whole = whole;
  shape.hole = hole;
  const HRGN hShape = CreateRectRgnIndirect(&whole), hHole = CreateRectRgnIndirect(&hole);
  CombineRgn(hShape, hShape, hHole, RGN_DIFF);
  DeleteObject(hHole);
  SetWindowRgn(hWnd, hShape, FALSE);  // which belongs to the window from now on
  InvalidateRect(hWnd, nullptr, TRUE);
}

void PlacePages(const NativeControl& native) {
  const RECT place = PagePlace(native.hWnd());
  for (int i = 0; i < Tabs(native).m_Pages.Size(); i++)
    if (const NativeControl* pNative = pPage(native, i))
      SetWindowPos(pNative->hWnd(), nullptr, place.left, place.top, place.right - place.left, place.bottom - place.top,
                   SWP_NOZORDER | SWP_NOACTIVATE);
}

// Not while the system still moves the window: a shape that it gets then is not painted.
void Fit(NativeControl& native) {
  CutHole(native);
  PlacePages(native);
}

// The pages are seen when the tabs are: before the dialog is shown, none.
void ShowPages(const NativeControl& native) {
  const bool bNow = (GetWindowLongW(native.hWnd(), GWL_STYLE) & WS_VISIBLE) != 0;
  for (int i = 0; i < Tabs(native).m_Pages.Size(); i++) {
    NativeControl* pNative = pPage(native, i);
    if (!pNative) continue;
    pNative->m_bVisible = native.m_bVisible && i == iPageOf(native.hWnd());
    ShowWindow(pNative->hWnd(), bNow && pNative->m_bVisible ? SW_SHOWNA : SW_HIDE);
  }
}

// In one go: the tabs must not vanish between the ground and their drawing.
void Paint(HWND hWnd, const NativeControl& native) {
  PAINTSTRUCT paint;
  const HDC hTarget = BeginPaint(hWnd, &paint);
  RECT client;
  GetClientRect(hWnd, &client);
  {
    BufferedDC buffer(hTarget, client);
    native.FillGround(buffer.Get(), hWnd, client);
    CallClassProc(hWnd, WM_PRINTCLIENT, reinterpret_cast<WPARAM>(buffer.Get()), PRF_CLIENT);
  }
  EndPaint(hWnd, &paint);
}

LRESULT CALLBACK TabProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  const NativeControl* pNative = NativeControl::pFromWindow(hWnd);
  if (pNative && uMessage == WM_ERASEBKGND) return TRUE;  // Paint covers everything
  if (pNative && uMessage == WM_PAINT) return Paint(hWnd, *pNative), 0;
  const LRESULT lResult = CallClassProc(hWnd, uMessage, wParam, lParam);
  if (pNative && uMessage == WM_WINDOWPOSCHANGED &&
      reinterpret_cast<const WINDOWPOS*>(lParam)->flags & (SWP_SHOWWINDOW | SWP_HIDEWINDOW))
    ShowPages(*pNative);
  for (int i = 0; pNative && uMessage == WM_ENABLE && i < Tabs(*pNative).m_Pages.Size(); i++)
    if (const NativeControl* pShown = pPage(*pNative, i)) EnableWindow(pShown->hWnd(), wParam != 0);
  return lResult;
}

void SetCaptions(NativeControl& native, const CNCharArray& texts) {
  for (int i = 0; i < texts.Size(); i++) {
    const CNWideText text(texts[i]);
    TCITEMW item = {};
    item.mask = TCIF_TEXT;
    item.pszText = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(text.Ptr()));
    const bool bNew = i >= SendMessageW(native.hWnd(), TCM_GETITEMCOUNT, 0, 0);
    SendMessageW(native.hWnd(), bNew ? TCM_INSERTITEMW : TCM_SETITEMW, static_cast<WPARAM>(i),
                 reinterpret_cast<LPARAM>(&item));
  }
  Fit(native);  // the tabs may need more lines
}

void Created(NativeControl& native) {
  CNCharArray texts;
  native.Control().bItemTexts(texts);
  PutBefore(native.hWnd(), TabProc);
  SetCaptions(native, texts);
}

// The pages are windows beside the tab control.
HWND hBeside(NativeControl& native) { return GetParent(native.hWnd()); }

NativeEvent Notify(NativeControl& native, NMHDR& message) {
  if (message.code != TCN_SELCHANGE || message.hwndFrom != native.hWnd()) return {};
  ShowPages(native);
  return {.iNotification = NOTIFY_SELECTION_CHANGED};
}

bool bSetText(HWND hWnd, const char* szText) {
  const int iPage = atoi(szText) - 1;
  if (iPage < 0 || iPage >= SendMessageW(hWnd, TCM_GETITEMCOUNT, 0, 0)) return true;  // no such page: as it was
  const HWND hFocus = GetFocus();
  SendMessageW(hWnd, TCM_SETCURSEL, static_cast<WPARAM>(iPage), 0);
  if (const NativeControl* pNative = NativeControl::pFromWindow(hWnd)) ShowPages(*pNative);
  if (hFocus && !IsWindowVisible(hFocus) && IsWindowVisible(hWnd)) SetFocus(hWnd);  // its page has gone
  return true;
}

bool bGetText(HWND hWnd, CNString& csText) {
  csText.Printf("TabWindow::bGetText", "csText", "%d", iPageOf(hWnd) + 1);
  return true;
}

// By how many pages the key turns, 0 for any other.
int iPagesTurned(const MSG& message) {
  if (message.message != WM_KEYDOWN || GetKeyState(VK_CONTROL) >= 0) return 0;
  if (message.wParam == VK_TAB) return GetKeyState(VK_SHIFT) < 0 ? -1 : 1;
  return message.wParam == VK_NEXT ? 1 : message.wParam == VK_PRIOR ? -1 : 0;
}

// ---- pages ----

HWND hPage(NativeControl& native) { return native.hWnd(); }

// The system's look draws tab controls as white sheets. Colours of the script go before it.
bool bWhite(const NativeControl& page) {
  const ShownDialog& dialog = page.Dialog();
  if (page.pColored() || dialog.Info().m_Background.bSet || dialog.bHasPicture()) return false;
  const auto pIsThemed = pSystemFunction<BOOL(WINAPI*)()>(L"uxtheme.dll", "IsAppThemed");
  return pIsThemed && pIsThemed();
}

void PreparePage(NativeControl& native, CREATESTRUCTW& window) {
  const BaseControl* pTabs = native.Control().m_pParent;
  const NativeControl* pNative = pTabs ? native.Dialog().pFind(*pTabs) : nullptr;
  window.lpszName = nullptr;
  if (!pNative) return;
  const RECT place = PagePlace(pNative->hWnd());
  window.x = place.left;
  window.y = place.top;
  window.cx = place.right - place.left;
  window.cy = place.bottom - place.top;
  if (bWhite(native)) native.SetGround(GetSysColor(COLOR_WINDOW));
  native.m_bVisible = pNative->m_bVisible && Tabs(*pNative).m_Pages[iPageOf(pNative->hWnd())] == &native.Control();
}

}  // namespace

bool bTurnPage(const ShownDialog& dialog, const MSG& message) {
  const int iStep = iPagesTurned(message);
  const NativeControl* pAround = iStep ? dialog.pFindWindow(GetFocus()) : nullptr;
  while (pAround && !bIsTabControl(&pAround->Control()))
    pAround = pAround->Control().m_pParent ? dialog.pFind(*pAround->Control().m_pParent) : nullptr;
  const int nPages = pAround ? Tabs(*pAround).m_Pages.Size() : 0;
  if (nPages == 0) return false;
  const HWND hTabs = pAround->hWnd();
  SetFocus(hTabs);
  SendMessageW(hTabs, TCM_SETCURSEL, static_cast<WPARAM>((iPageOf(hTabs) + iStep + nPages) % nPages), 0);
  // The system tells of what the user does with the tabs only.
  NMHDR header = {hTabs, static_cast<UINT_PTR>(GetDlgCtrlID(hTabs)), static_cast<UINT>(TCN_SELCHANGE)};
  SendMessageW(GetParent(hTabs), WM_NOTIFY, header.idFrom, reinterpret_cast<LPARAM>(&header));
  return true;
}

static constexpr NativeKind MakeTabs(ControlKind kind) {
  return {.kind = kind,
          .pCreated = Created,
          .pSetText = bSetText,
          .pGetText = bGetText,
          .pNotify = Notify,
          .pSetItems = SetCaptions,
          .pInner = hBeside,
          .pResized = Fit};
}

const NativeKind g_TabControlWindow = MakeTabs(ControlKind::TabControl);
const NativeKind g_PropertySheetWindow = MakeTabs(ControlKind::PropSheet);

const NativeKind g_TabPageWindow = {.kind = ControlKind::Tab, .pPrepare = PreparePage, .pInner = hPage};
