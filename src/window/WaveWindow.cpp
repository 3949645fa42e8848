// Sounds. An unseen window stands for each one: showing it plays, hiding it stops. PLAY shows it together with its
// dialog.
#include "foundation/os/OsWide.h"
#include "window/SimpleWindows.h"
// after windows.h, which it builds on
#include <mmsystem.h>

namespace {

void Prepare(NativeControl& native, CREATESTRUCTW& window) {
  const bool bPlays = native.m_bVisible && native.Control().bHasFlag("PLAY");
  PrepareUnseen(native, window);
  native.m_bVisible = bPlays;
}

void Play(const wchar_t* pPath, DWORD dwFlags) {
  const auto pPlay = pSystemFunction<BOOL(WINAPI*)(LPCWSTR, HMODULE, DWORD)>(L"winmm.dll", "PlaySoundW");
  if (pPlay) pPlay(pPath, nullptr, dwFlags);
}

void Start(const NativeControl& native) {
  CNString csPath;
  const char* szSource = Simple(native).szSource();
  if (!bFindScriptFile(szSource, csPath)) {
    LogPrintf("ERROR: CNWave::Play -> !bFindScriptFile(%s)", szSource);
    return;
  }
  const bool bAgain = native.Control().bHasFlag("CONTINUOUS");
  Play(Wide(csPath.Text()), SND_FILENAME | SND_ASYNC | SND_NODEFAULT | (bAgain ? SND_LOOP : 0));
}

// A page is hidden before it goes. Only the last one is not, when its wizard ends.
LRESULT CALLBACK SoundProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  const NativeControl* pNative = NativeControl::pFromWindow(hWnd);
  const UINT uChange = uMessage == WM_WINDOWPOSCHANGED ? reinterpret_cast<const WINDOWPOS*>(lParam)->flags : 0;
  if (pNative && uChange & SWP_SHOWWINDOW) Start(*pNative);
  const bool bEnds = uMessage == WM_DESTROY && GetWindowLongW(hWnd, GWL_STYLE) & WS_VISIBLE;
  if (bEnds || uChange & SWP_HIDEWINDOW) Play(nullptr, 0);
  return CallClassProc(hWnd, uMessage, wParam, lParam);
}

void Created(NativeControl& native) { PutBefore(native.hWnd(), SoundProc); }

}  // namespace

const NativeKind g_WaveWindow = {.kind = ControlKind::Wave, .pPrepare = Prepare, .pCreated = Created};
