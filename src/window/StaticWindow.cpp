// Texts and links. A link is an underlined text that can be clicked.
#include <algorithm>
#include <cstring>

#include "window/NativeControls.h"
#include "window/ShownDialog.h"
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

// A line of text that is wider in the present font than its author's field would be wrapped and lose its last words: it
// is given as much of the free room to its right as it needs.
void WidenForLine(NativeControl& native) {
  if ((GetWindowLongW(native.hWnd(), GWL_STYLE) & SS_TYPEMASK) != SS_LEFT) return;
  const RECT place = native.Place();
  const std::unique_ptr<wchar_t[]> pText = WindowText(native.hWnd());
  RECT needed = {};
  ScreenDC screen;
  Selected font(screen.Get(), native.hFont());
  const int iLine = DrawTextW(screen.Get(), pText.get(), -1, &needed, DT_CALCRECT | DT_SINGLELINE);
  const LONG lWidth = std::min(needed.right, native.Dialog().lFreeRight(native) - place.left);
  if (place.bottom - place.top >= 2 * iLine || lWidth <= place.right - place.left) return;
  SetWindowPos(native.hWnd(), nullptr, 0, 0, lWidth, place.bottom - place.top,
               SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE | SWP_NOREDRAW);
}

int Notification(NativeControl& native, int iCode) {
  return iCode == STN_CLICKED && bIsLink(native.Control()) ? NOTIFY_CLICK : NativeKind::IGNORED;
}

COLORREF TextColor(const BaseControl& control) {
  if (!bIsLink(control)) return GetSysColor(COLOR_BTNTEXT);
  return control.m_bVisited ? VISITED_LINK : LINK;
}

}  // namespace

const NativeKind g_StaticWindow = {.kind = ControlKind::Static,
                                   .dwStyle = 0,
                                   .dwRemovedStyle = WS_TABSTOP,
                                   .dwExStyle = 0,
                                   .bField = false,
                                   .pPrepare = Prepare,
                                   .pBeforeShow = WidenForLine,
                                   .pNotification = Notification,
                                   .pTextColor = TextColor};
