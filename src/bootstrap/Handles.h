// Owners of what the system hands out, released when they go; false when the call that made it failed.
#pragma once

#include <windows.h>

#include <memory>

struct CloseHandleOf {
  void operator()(HANDLE hObject) const { CloseHandle(hObject); }
};
class Handle : public std::unique_ptr<void, CloseHandleOf> {
 public:
  explicit Handle(HANDLE hObject) : unique_ptr(hObject == INVALID_HANDLE_VALUE ? nullptr : hObject) {}
};

struct FreeLocal {
  void operator()(void* pMemory) const { LocalFree(pMemory); }
};
using LocalMemory = std::unique_ptr<void, FreeLocal>;
