#include "window/ScreenScale.h"

namespace {

const double DOTS_TO_SCALE = 0.010416667;  // one ninety-sixth

// The system's numbers for the ways in which a window may be enlarged.
const INT_PTR UNAWARE = -1, SYSTEM_AWARE = -2, UNAWARE_SHARP = -5;

template <class Function>
Function pUserFunction(const char* szName) {
  return reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(GetModuleHandleW(L"user32.dll"), szName)));
}

// The way before, or null when the system does not know the new one.
HANDLE hSetWay(HANDLE hWay) {
  const auto pSet = pUserFunction<HANDLE(WINAPI*)(HANDLE)>("SetThreadDpiAwarenessContext");
  return pSet ? pSet(hWay) : nullptr;
}

HANDLE hSetWay(INT_PTR way) { return hSetWay(reinterpret_cast<HANDLE>(way)); }

// Systems between Vista and 8.1 have one way for the whole process, to be chosen before its first window.
HANDLE hSetProcessAware() {
  if (const auto pSet = pUserFunction<BOOL(WINAPI*)()>("SetProcessDPIAware")) pSet();
  return nullptr;
}

}  // namespace

ScaleScope::ScaleScope(ScreenScaling scaling) {
  if (scaling == ScreenScaling::AsProgram) return;
  m_hFormer = hSetWay(scaling == ScreenScaling::BySystem ? UNAWARE_SHARP : SYSTEM_AWARE);
  if (!m_hFormer) m_hFormer = scaling == ScreenScaling::BySystem ? hSetWay(UNAWARE) : hSetProcessAware();
}

ScaleScope::~ScaleScope() {
  if (m_hFormer) hSetWay(m_hFormer);
}

double dScreenScale() {
  ScreenDC screen;
  return GetDeviceCaps(screen.Get(), LOGPIXELSY) * DOTS_TO_SCALE;
}
