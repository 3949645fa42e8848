// Windows only: a library of the system, loaded from the system folder by its full path and released at the end.
#pragma once

#include <windows.h>

class SystemLibrary {
 public:
  explicit SystemLibrary(const wchar_t* szName) {
    wchar_t szPath[MAX_PATH + 32];
    const UINT uLength = GetSystemDirectoryW(szPath, MAX_PATH);
    if (!uLength || uLength >= MAX_PATH || lstrlenW(szName) > 30) return;
    szPath[uLength] = L'\\';
    lstrcpyW(szPath + uLength + 1, szName);
    m_hModule = LoadLibraryW(szPath);
  }
  ~SystemLibrary() {
    if (m_hModule) FreeLibrary(m_hModule);
  }
  SystemLibrary(const SystemLibrary&) = delete;
  SystemLibrary& operator=(const SystemLibrary&) = delete;

  // The function, or null.
  template <class Function>
  Function Find(const char* szName) const {
    return m_hModule ? reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(m_hModule, szName))) : nullptr;
  }

 private:
  HMODULE m_hModule = nullptr;
};
