// Windows only: where the process looks for libraries. For the first line of a program that runs from a download or
// temporary folder, where anybody may have put one.
#pragma once

#include <windows.h>

// From now on no library is loaded from anywhere but the system folder. Older systems have only some of these
// functions, so each is asked for by name.
inline void LoadLibrariesFromSystemOnly() {
  const DWORD SEARCH_SYSTEM_FOLDER_ONLY = 0x800;  // LOAD_LIBRARY_SEARCH_SYSTEM32
  const DWORD SAFE_SEARCH_FOR_GOOD = 0x8001;  // BASE_SEARCH_PATH_ENABLE_SAFE_SEARCHMODE | BASE_SEARCH_PATH_PERMANENT
  const HMODULE hKernel = GetModuleHandleW(L"kernel32.dll");
  const auto pFind = [&](const char* szName) { return reinterpret_cast<void*>(GetProcAddress(hKernel, szName)); };
  using SetNumber = BOOL(WINAPI*)(DWORD);
  using SetText = BOOL(WINAPI*)(const wchar_t*);
  if (const auto pSet = reinterpret_cast<SetNumber>(pFind("SetDefaultDllDirectories"))) pSet(SEARCH_SYSTEM_FOLDER_ONLY);
  if (const auto pSet = reinterpret_cast<SetText>(pFind("SetDllDirectoryW"))) pSet(L"");
  if (const auto pSet = reinterpret_cast<SetNumber>(pFind("SetSearchPathMode"))) pSet(SAFE_SEARCH_FOR_GOOD);
}
