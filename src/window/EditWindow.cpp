// Edit fields of one or more lines.
#include "window/NativeControls.h"
#include "wizard/WizardView.h"

namespace {

void Prepare(NativeControl& native, CREATESTRUCTW& window) {
  // A line longer than the field scrolls; only several lines wrap.
  if (!(window.style & ES_MULTILINE))
    window.style |= ES_AUTOHSCROLL;
  else if (!(window.style & ES_READONLY))
    window.style |= ES_WANTRETURN;  // in a text that is only read Enter presses the default button
  if (static_cast<CNEdit&>(native.Control()).m_bGray) native.UseSystemGround(COLOR_BTNFACE);
}

// An edit window's lines end in two characters; scripts write one.
void MakeLineEnds(const char* szText, CNString& csOut) {
  csOut = "";
  for (const char* p = szText; *p; p++) {
    if (*p == '\n' && (p == szText || p[-1] != '\r')) csOut.Concat("\r");
    csOut.Concat(p, 1);
  }
}

bool bSetText(HWND hWnd, const char* szText) {
  if (!(GetWindowLongW(hWnd, GWL_STYLE) & ES_MULTILINE)) return bSetWindowText(hWnd, szText);
  CNString csLines;
  MakeLineEnds(szText, csLines);
  return bSetWindowText(hWnd, csLines.Text());
}

int Notification(NativeControl&, int iCode) {
  return iCode == EN_SETFOCUS || iCode == EN_KILLFOCUS ? iCode : NativeKind::IGNORED;
}

}  // namespace

const NativeKind g_EditWindow = {.kind = ControlKind::Edit,
                                 .dwExStyle = WS_EX_CLIENTEDGE,
                                 .bField = true,
                                 .pPrepare = Prepare,
                                 .pSetText = bSetText,
                                 .pNotification = Notification};
