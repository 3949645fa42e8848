// Group boxes. Their controls stand in a window of their own inside the border.
#include <algorithm>

#include "window/FrameWindow.h"
#include "window/SimpleWindows.h"

namespace {

const int BORDER = 4;

HWND hInner(NativeControl& native) { return GetWindow(native.hWnd(), GW_CHILD); }

// Under the title and inside the line.
RECT InsideOf(const NativeControl& native) {
  TEXTMETRICW metrics = {};
  {
    ScreenDC screen;
    Selected font(screen.Get(), native.hFont());
    GetTextMetricsW(screen.Get(), &metrics);
  }
  const int iBorder = static_cast<int>(BORDER * native.Dialog().Info().m_dScale);
  RECT area;
  GetClientRect(native.hWnd(), &area);
  return {iBorder, metrics.tmHeight, std::max<LONG>(iBorder, area.right - iBorder),
          std::max(metrics.tmHeight, area.bottom - iBorder)};
}

// The window's own procedure leaves what lies around its line unpainted, where the dialog does not paint either.
LRESULT CALLBACK GroupProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  NativeControl* pNative = NativeControl::pFromWindow(hWnd);
  if (pNative && uMessage == WM_ERASEBKGND) {
    RECT area;
    GetClientRect(hWnd, &area);
    pNative->FillBehind(reinterpret_cast<HDC>(wParam), area);
    area.top = InsideOf(*pNative).top / 2;  // the line is half way down the title
    pNative->FillGround(reinterpret_cast<HDC>(wParam), area);
    return TRUE;
  }
  if (pNative && uMessage == WM_SIZE) {
    const RECT inside = InsideOf(*pNative);
    MoveWindow(hInner(*pNative), inside.left, inside.top, inside.right - inside.left, inside.bottom - inside.top, TRUE);
    InvalidateRect(hWnd, nullptr, TRUE);
  }
  return CallClassProc(hWnd, uMessage, wParam, lParam);
}

void Created(NativeControl& native) {
  const HWND hWnd = native.hWnd();
  hMakeInside(native, reinterpret_cast<HINSTANCE>(GetWindowLongPtrW(hWnd, GWLP_HINSTANCE)));
  PutBefore(hWnd, GroupProc);
  SendMessageW(hWnd, WM_SIZE, 0, 0);
}

}  // namespace

const NativeKind g_GroupBoxWindow = {.kind = ControlKind::GroupBox, .pCreated = Created, .pInner = hInner};
