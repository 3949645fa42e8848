// Progress bars, from 0 to 100.
#include "window/SimpleWindows.h"

namespace {

// TEXT_COLOR is that of the bar. The system's themed look has colours of its own.
void Created(NativeControl& native) {
  const BaseControl& control = native.Control();
  SendMessageW(native.hWnd(), PBM_SETRANGE32, 0, 100);
  if (!control.m_Background.bSet && !control.m_TextColor.bSet) return;
  DropTheme(native.hWnd());
  const auto set = [&](UINT uMessage, const ControlColor& color) {
    if (color.bSet) SendMessageW(native.hWnd(), uMessage, 0, static_cast<LPARAM>(ToColorRef(color)));
  };
  set(PBM_SETBKCOLOR, control.m_Background);
  set(PBM_SETBARCOLOR, control.m_TextColor);
}

// The caption is where the bar stands when its page appears, as "<%done%>"; without one it stands at 0.
bool bSetPosition(HWND hWnd, const char* szText) {
  int iPercent = 0;
  if (iNumbersOf(szText, &iPercent, 1)) SendMessageW(hWnd, PBM_SETPOS, static_cast<WPARAM>(iPercent), 0);
  return true;
}

}  // namespace

const NativeKind g_ProgressWindow = {
    .kind = ControlKind::Progress, .dwRemovedStyle = WS_TABSTOP, .pCreated = Created, .pSetText = bSetPosition};
