// Sliders. Their text is their number.
#include <algorithm>
#include <cstdlib>

#include "window/SimpleWindows.h"

namespace {

const int TICKS = 10;

void Created(NativeControl& native) {
  int range[2] = {0, 100};
  iNumbersOf(Simple(native).szSource(), range, 2);
  SendMessageW(native.hWnd(), TBM_SETRANGEMIN, FALSE, range[0]);
  SendMessageW(native.hWnd(), TBM_SETRANGEMAX, FALSE, range[1]);
  SendMessageW(native.hWnd(), TBM_SETPOS, TRUE, range[0]);
  SendMessageW(native.hWnd(), TBM_SETTICFREQ, static_cast<WPARAM>(std::max(1, (range[1] - range[0]) / TICKS)), 0);
}

bool bSetText(HWND hWnd, const char* szText) {
  SendMessageW(hWnd, TBM_SETPOS, TRUE, atoi(szText));
  return true;
}

bool bGetText(HWND hWnd, CNString& csText) { return bNumberText(SendMessageW(hWnd, TBM_GETPOS, 0, 0), csText); }

NativeEvent Scrolled(NativeControl&, int iCode) { return ChangeEvent(iCode != TB_ENDTRACK); }

}  // namespace

const NativeKind g_TrackBarWindow = {.kind = ControlKind::Trackbar,
                                     .pPrepare = PrepareWithoutCaption,
                                     .pCreated = Created,
                                     .pSetText = bSetText,
                                     .pGetText = bGetText,
                                     .pScrolled = Scrolled};
