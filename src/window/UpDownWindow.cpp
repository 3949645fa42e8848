// Arrows that step the number of a field: the edit field on the line before. Their text is the number.
#include <cstdlib>

#include "window/ShownDialog.h"
#include "window/SimpleWindows.h"

namespace {

HWND hBuddy(const NativeControl& native) {
  return reinterpret_cast<HWND>(SendMessageW(native.hWnd(), UDM_GETBUDDY, 0, 0));
}

struct Steps {
  int numbers[3] = {0, 100, 0};  // lowest, highest, first

  explicit Steps(const NativeControl& native) {
    if (iNumbersOf(Simple(native).szSource(), numbers, 3) < 3) numbers[2] = numbers[0];
  }
};

void ShowNumber(HWND hWnd, int iNumber) { SendMessageW(hWnd, UDM_SETPOS32, 0, iNumber); }

void Created(NativeControl& native) {
  const CNArray<BaseControl>& controls = native.Dialog().Info().m_Controls;
  const NativeControl* pBefore = nullptr;
  for (int i = 1; i < controls.Size(); i++)
    if (controls[i] == &native.Control() && controls[i - 1]->Kind() == ControlKind::Edit)
      pBefore = native.Dialog().pFind(*controls[i - 1]);
  const Steps steps(native);
  if (pBefore) SendMessageW(native.hWnd(), UDM_SETBUDDY, reinterpret_cast<WPARAM>(pBefore->hWnd()), 0);
  SendMessageW(native.hWnd(), UDM_SETRANGE32, static_cast<WPARAM>(steps.numbers[0]), steps.numbers[1]);
  ShowNumber(native.hWnd(), steps.numbers[2]);
}

// A field that the wizard left empty begins with the first number.
void BeforeShow(NativeControl& native) {
  const HWND hField = hBuddy(native);
  if (hField && GetWindowTextLengthW(hField) == 0) ShowNumber(native.hWnd(), Steps(native).numbers[2]);
}

bool bSetText(HWND hWnd, const char* szText) {
  if (*szText) ShowNumber(hWnd, atoi(szText));
  return true;
}

bool bGetText(HWND hWnd, CNString& csText) { return bNumberText(SendMessageW(hWnd, UDM_GETPOS32, 0, 0), csText); }

NativeEvent Scrolled(NativeControl&, int iCode) { return ChangeEvent(iCode == SB_THUMBPOSITION); }

}  // namespace

const NativeKind g_UpDownWindow = {.kind = ControlKind::UpDown,
                                   .dwRemovedStyle = WS_TABSTOP,
                                   .pPrepare = PrepareWithoutCaption,
                                   .pCreated = Created,
                                   .pBeforeShow = BeforeShow,
                                   .pSetText = bSetText,
                                   .pGetText = bGetText,
                                   .pScrolled = Scrolled};
