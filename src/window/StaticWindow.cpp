// Texts and links. A link is an underlined text that can be clicked, or reached with Tab and pressed with Enter or
// Space.
#include "window/StaticWindow.h"

#include <algorithm>
#include <cstring>

#include "window/ShownDialog.h"
#include "window/SimpleWindows.h"
#include "wizard/WizardView.h"

namespace {

const COLORREF LINK = RGB(0, 0, 255);  // the system's own link colour is too pale in some of its themes
const COLORREF VISITED_LINK = RGB(128, 0, 128);

bool bIsLink(const BaseControl& control) { return static_cast<const CNStatic&>(control).m_bLink; }

void Prepare(NativeControl& native, CREATESTRUCTW& window) {
  const auto& text = static_cast<const CNStatic&>(native.Control());
  // Without SS_NOTIFY the mouse falls through to the dialog: no click, no tooltip.
  if (text.m_bLink || !text.m_csToolTip.bEmpty()) window.style |= SS_NOTIFY;
  if (text.m_bFrame) window.style |= WS_BORDER;
  // A caption with a mnemonic keeps it; in any other text '&' is a character like others, as in file names.
  if (!strchr(text.m_csCaption.Text(), '&')) window.style |= SS_NOPREFIX;
}

// Where the free room to the right of a control ends: at the next control on its height, else at the window's edge.
LONG lFreeRight(const NativeControl& native) {
  if (const NativeControl* pNext = native.Dialog().pNextOnRight(native)) return pNext->Place().left;
  RECT client;
  GetClientRect(GetParent(native.hWnd()), &client);
  return client.right;
}

// A line of text that is wider in the present font than its author's field would be wrapped and lose its last words: it
// is given as much of the free room to its right as it needs.
void WidenForLine(NativeControl& native) {
  const LONG lStyle = GetWindowLongW(native.hWnd(), GWL_STYLE);
  if ((lStyle & SS_TYPEMASK) != SS_LEFT) return;
  const RECT place = native.Place();
  const std::unique_ptr<wchar_t[]> pText = WindowText(native.hWnd());
  RECT needed = {};
  ScreenDC screen;
  Selected font(screen.Get(), native.hFont());
  const int iLine = DrawTextW(screen.Get(), pText.get(), -1, &needed,
                              DT_CALCRECT | DT_SINGLELINE | (lStyle & SS_NOPREFIX ? DT_NOPREFIX : 0));
  const LONG lWidth = std::min(needed.right, lFreeRight(native) - place.left);
  if (place.bottom - place.top >= 2 * iLine || lWidth <= place.right - place.left) return;
  SetWindowPos(native.hWnd(), nullptr, 0, 0, lWidth, place.bottom - place.top,
               SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE | SWP_NOREDRAW);
}

void DrawFocus(HWND hWnd) {
  RECT client;
  GetClientRect(hWnd, &client);
  const HDC hDC = GetDC(hWnd);
  DrawFocusRect(hDC, &client);
  ReleaseDC(hWnd, hDC);
}

// A link with the focus, and the text beside a box with it.
bool bShowsFocus(HWND hWnd) {
  const HWND hFocus = GetFocus();
  return hFocus && (hFocus == hWnd || hFocus == GetPropW(hWnd, LABEL_PARTNER));
}

bool bPresses(WPARAM wKey) { return wKey == VK_RETURN || wKey == VK_SPACE; }

// What a link does beyond a text, which takes no keys.
LRESULT CALLBACK LinkProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  if (uMessage == WM_KEYDOWN && bPresses(wParam) && HIWORD(lParam) & KF_REPEAT) return 0;  // a key that is held
  if (uMessage == WM_KEYDOWN && bPresses(wParam))  // afterwards the link may be gone
    return SendMessageW(GetParent(hWnd), WM_COMMAND, MAKEWPARAM(GetDlgCtrlID(hWnd), STN_CLICKED),
                        reinterpret_cast<LPARAM>(hWnd));
  // The focus is drawn by inverting pixels: all of them must be new.
  const bool bFocusPaint = uMessage == WM_PAINT && bShowsFocus(hWnd);
  if (bFocusPaint || uMessage == WM_SETFOCUS || uMessage == WM_KILLFOCUS) InvalidateRect(hWnd, nullptr, TRUE);
  const LRESULT lResult = CallClassProc(hWnd, uMessage, wParam, lParam);
  if (bFocusPaint) DrawFocus(hWnd);
  // Otherwise Enter would press the default button.
  const auto* pKey = reinterpret_cast<const MSG*>(lParam);
  const bool bWants = uMessage == WM_GETDLGCODE && pKey && pKey->message == WM_KEYDOWN && bPresses(pKey->wParam);
  return bWants ? lResult | DLGC_WANTMESSAGE : lResult;
}

// Also for a text that a box may take as its label: a procedure put in later would cut off the tooltip's.
void Created(NativeControl& native) { PutBefore(native.hWnd(), LinkProc); }

int Notification(NativeControl& native, int iCode) {
  return iCode == STN_CLICKED && bIsLink(native.Control()) ? NOTIFY_CLICK : NativeKind::IGNORED;
}

COLORREF TextColor(const BaseControl& control) {
  if (!bIsLink(control)) return GetSysColor(COLOR_BTNTEXT);
  return control.m_bVisited ? VISITED_LINK : LINK;
}

}  // namespace

void ShowFocusOf(HWND hBox, HWND hText) {
  SetPropW(hBox, LABEL_PARTNER, hText);
  SetPropW(hText, LABEL_PARTNER, hBox);
}

const NativeKind g_StaticWindow = {.kind = ControlKind::Static,
                                   .pPrepare = Prepare,
                                   .pCreated = Created,
                                   .pBeforeShow = WidenForLine,
                                   .pNotification = Notification,
                                   .pTextColor = TextColor};
