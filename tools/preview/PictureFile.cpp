#include "PictureFile.h"

#include "OrbitText.h"
// after windows.h, which they build on
#include <objidl.h>
// after objidl.h
#include <gdiplus.h>

namespace {

using namespace Gdiplus;

// The encoder of the system's own for PNG.
const CLSID PNG_ENCODER = {0x557cf406, 0x1a04, 0x11d3, {0x9a, 0x73, 0x00, 0x00, 0xf8, 0x1e, 0xf3, 0x2e}};

class GdiPlus {
 public:
  GdiPlus() { GdiplusStartup(&m_uToken, &m_Input, nullptr); }
  ~GdiPlus() { GdiplusShutdown(m_uToken); }
  GdiPlus(const GdiPlus&) = delete;
  GdiPlus& operator=(const GdiPlus&) = delete;

 private:
  ULONG_PTR m_uToken = 0;
  GdiplusStartupInput m_Input;
};

OwnedBitmap CopyOfScreen(const RECT& area) {
  ScreenDC screen;
  const int iWidth = area.right - area.left, iHeight = area.bottom - area.top;
  OwnedBitmap copy(CreateCompatibleBitmap(screen.Get(), iWidth, iHeight));
  OwnedMemoryDC memory(CreateCompatibleDC(screen.Get()));
  if (!copy || !memory) return OwnedBitmap();
  Selected selected(memory.Get(), copy.Get());
  BitBlt(memory.Get(), 0, 0, iWidth, iHeight, screen.Get(), area.left, area.top, SRCCOPY);
  return copy;
}

}  // namespace

bool bWritePicture(HWND hWnd, const std::string& path) {
  RECT area;
  if (!GetWindowRect(hWnd, &area)) return false;
  const OwnedBitmap copy = CopyOfScreen(area);
  if (!copy) return false;
  const GdiPlus library;
  Bitmap bitmap(copy.Get(), nullptr);
  return bitmap.Save(ToPath(path).c_str(), &PNG_ENCODER, nullptr) == Ok;
}
