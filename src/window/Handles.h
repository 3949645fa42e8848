// Owners of the system's handles, one line for each type. An owner releases its handle when it goes.
#pragma once

#include <windows.h>
// after windows.h, which they build on
#include <commctrl.h>
#include <objbase.h>

#undef PropertySheet  // a control kind has this name

template <class T, class Closer>
class Owned {
 public:
  explicit Owned(T handle = nullptr) : m_handle(handle) {}
  ~Owned() { Reset(); }
  Owned(Owned&& other) noexcept : m_handle(other.m_handle) { other.m_handle = nullptr; }
  Owned& operator=(Owned&& other) noexcept {
    if (this != &other) {
      Reset(other.m_handle);
      other.m_handle = nullptr;
    }
    return *this;
  }
  Owned(const Owned&) = delete;
  Owned& operator=(const Owned&) = delete;

  T Get() const { return m_handle; }
  explicit operator bool() const { return m_handle != nullptr; }
  void Reset(T handle = nullptr) {
    if (m_handle) Closer::Close(m_handle);
    m_handle = handle;
  }

 private:
  T m_handle;
};

struct CloseGdiObject {
  static void Close(HGDIOBJ handle) { DeleteObject(handle); }
};
struct CloseMemoryDC {
  static void Close(HDC handle) { DeleteDC(handle); }
};
struct CloseIcon {
  static void Close(HICON handle) { DestroyIcon(handle); }
};
struct CloseWindowHandle {
  static void Close(HWND handle) { DestroyWindow(handle); }
};
struct CloseTaskMemory {
  static void Close(void* pMemory) { CoTaskMemFree(pMemory); }
};

using OwnedBrush = Owned<HBRUSH, CloseGdiObject>;
using OwnedPen = Owned<HPEN, CloseGdiObject>;
using OwnedFont = Owned<HFONT, CloseGdiObject>;
using OwnedBitmap = Owned<HBITMAP, CloseGdiObject>;
using OwnedMemoryDC = Owned<HDC, CloseMemoryDC>;
using OwnedIcon = Owned<HICON, CloseIcon>;
using OwnedWindow = Owned<HWND, CloseWindowHandle>;
using OwnedTaskMemory = Owned<void*, CloseTaskMemory>;

// The device context of the whole screen.
class ScreenDC {
 public:
  ScreenDC() : m_hDC(GetDC(nullptr)) {}
  ~ScreenDC() { ReleaseDC(nullptr, m_hDC); }
  ScreenDC(const ScreenDC&) = delete;
  ScreenDC& operator=(const ScreenDC&) = delete;
  HDC Get() const { return m_hDC; }

 private:
  HDC m_hDC;
};

// Selects an object into a device context for one scope.
class Selected {
 public:
  Selected(HDC hDC, HGDIOBJ hObject) : m_hDC(hDC), m_hFormer(SelectObject(hDC, hObject)) {}
  ~Selected() { SelectObject(m_hDC, m_hFormer); }
  Selected(const Selected&) = delete;
  Selected& operator=(const Selected&) = delete;

 private:
  HDC m_hDC;
  HGDIOBJ m_hFormer;
};

// Collects the drawing of a rectangle in memory and puts it on the target in one go, when it is destroyed.
class BufferedDC {
 public:
  BufferedDC(HDC hTarget, const RECT& area)
      : m_hTarget(hTarget),
        m_Area(area),
        m_DC(CreateCompatibleDC(hTarget)),
        m_Bitmap(CreateCompatibleBitmap(hTarget, area.right - area.left, area.bottom - area.top)),
        m_hFormer(SelectObject(m_DC.Get(), m_Bitmap.Get())) {
    SetViewportOrgEx(m_DC.Get(), -area.left, -area.top, nullptr);
  }
  ~BufferedDC() {
    BitBlt(m_hTarget, m_Area.left, m_Area.top, m_Area.right - m_Area.left, m_Area.bottom - m_Area.top, m_DC.Get(),
           m_Area.left, m_Area.top, SRCCOPY);
    SelectObject(m_DC.Get(), m_hFormer);
  }
  BufferedDC(const BufferedDC&) = delete;
  BufferedDC& operator=(const BufferedDC&) = delete;
  HDC Get() const { return m_DC.Get(); }

 private:
  HDC m_hTarget;
  RECT m_Area;
  OwnedMemoryDC m_DC;
  OwnedBitmap m_Bitmap;
  HGDIOBJ m_hFormer;
};
