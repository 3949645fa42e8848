// Windows only: an owned handle of the system; empty when the call that made it failed.
#pragma once

#include <windows.h>

#include <memory>

struct CloseSystemHandle {
  using pointer = HANDLE;
  void operator()(HANDLE hObject) const {
    if (hObject != INVALID_HANDLE_VALUE) CloseHandle(hObject);
  }
};
using SystemHandle = std::unique_ptr<HANDLE, CloseSystemHandle>;
