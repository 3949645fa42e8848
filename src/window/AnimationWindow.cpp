// Clips without sound. PLAY runs one when its dialog is shown, CONTINUOUS again and again; without either its first
// picture stands still.
#include <cstring>

#include "foundation/os/OsWide.h"
#include "window/SimpleWindows.h"

namespace {

// Without a size the clip's own is taken, else the clip stands in the middle.
void Prepare(NativeControl&, CREATESTRUCTW& window) {
  window.lpszName = nullptr;
  if (window.cx || window.cy) window.style |= ACS_CENTER;
}

void Created(NativeControl& native) {
  const char* szClip = Simple(native).szSource();
  const auto wInstance = static_cast<WPARAM>(GetWindowLongPtrW(native.hWnd(), GWLP_HINSTANCE));
  CNString csPath;
  const bool bResource = strncmp(szClip, "IDA_", 4) == 0;
  const bool bFound = bResource || bFindScriptFile(szClip, csPath);
  const Wide name(bResource ? szClip : csPath.Text());
  if (!bFound || !SendMessageW(native.hWnd(), ACM_OPENW, bResource ? wInstance : 0,
                               reinterpret_cast<LPARAM>(static_cast<const wchar_t*>(name))))
    LogPrintf("ERROR: CNAnimation::Create -> !bOpen(%s)", szClip);
}

void BeforeShow(NativeControl& native) {
  const bool bAgain = native.Control().bHasFlag("CONTINUOUS");
  if (bAgain || native.Control().bHasFlag("PLAY"))
    SendMessageW(native.hWnd(), ACM_PLAY, bAgain ? static_cast<WPARAM>(-1) : 1, MAKELPARAM(0, -1));
}

}  // namespace

const NativeKind g_AnimationWindow = {.kind = ControlKind::Animation,
                                      .dwRemovedStyle = WS_TABSTOP,
                                      .pPrepare = Prepare,
                                      .pCreated = Created,
                                      .pBeforeShow = BeforeShow};
