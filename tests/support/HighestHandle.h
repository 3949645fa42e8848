// How far the process has got with its handles: one that is never closed pushes new ones up. (Not every system counts
// what a process holds.)
#pragma once

#include <algorithm>
#include <array>
#include <vector>

#include "window/Handles.h"

template <class Make, class Close>
unsigned HighestHandle(Make make, Close close) {
  std::vector<decltype(make())> handles;
  unsigned uHighest = 0;
  for (int i = 0; i < 64; i++) {
    handles.push_back(make());
    uHighest = std::max<unsigned>(uHighest, LOWORD(reinterpret_cast<uintptr_t>(handles.back())));
  }
  for (const auto handle : handles) close(handle);
  return uHighest;
}

inline unsigned HighestObject() {
  return HighestHandle([] { return CreateSolidBrush(1); }, DeleteObject);
}
inline unsigned HighestWindow() {
  return HighestHandle([] { return CreateWindowW(L"STATIC", L"", 0, 0, 0, 1, 1, nullptr, nullptr, nullptr, nullptr); },
                       DestroyWindow);
}

// What the process holds, to the last one. GDI objects stand under their type (OBJ_FONT and the like): a system that
// does not count them finds an object by the lower half of its handle. One that does gives all of them together, under
// 0.
using ObjectCounts = std::array<int, OBJ_ENHMETAFILE + 2>;

inline ObjectCounts LiveObjects() {
  ObjectCounts counts = {};
  counts[0] = static_cast<int>(GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS));
  for (UINT_PTR uIndex = 1; !counts[0] && uIndex <= 0xFFFF; uIndex++)
    if (const DWORD dwType = GetObjectType(reinterpret_cast<HGDIOBJ>(uIndex)))
      counts[std::min<size_t>(dwType, counts.size() - 1)]++;
  return counts;
}

inline BOOL CALLBACK CountWindow(HWND, LPARAM pCount) { return ++*reinterpret_cast<int*>(pCount); }

inline BOOL CALLBACK CountWithInner(HWND hWnd, LPARAM pCount) {
  EnumChildWindows(hWnd, CountWindow, pCount);
  return CountWindow(hWnd, pCount);
}

// The windows of the calling thread, with those inside them.
inline int LiveWindows() {
  int nWindows = 0;
  EnumThreadWindows(GetCurrentThreadId(), CountWithInner, reinterpret_cast<LPARAM>(&nWindows));
  return nWindows;
}
