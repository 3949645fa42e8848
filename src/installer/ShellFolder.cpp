#include "installer/ShellFolder.h"

#include <windows.h>

#include <memory>

#include "foundation/os/OsWide.h"

namespace {

const wchar_t SHELL_FOLDERS[] = L"Software\\Microsoft\\Windows\\CurrentVersion\\Explorer\\Shell Folders";
const DWORD PATH_SIZE = 1024;

struct CloseKey {
  using pointer = HKEY;
  void operator()(HKEY hKey) const { RegCloseKey(hKey); }
};

bool bIsAbsolute(const wchar_t* pPath) {
  return pPath[0] && (pPath[1] == L':' || (pPath[0] == L'\\' && pPath[1] == L'\\'));
}

// Read as Unicode, for a user's folders bear the user's name.
bool bRead(HKEY hRoot, const char* szName, CNString& csFolder) {
  HKEY hOpened = nullptr;
  if (!szName || RegOpenKeyExW(hRoot, SHELL_FOLDERS, 0, KEY_READ, &hOpened) != ERROR_SUCCESS) return false;
  const std::unique_ptr<HKEY, CloseKey> key(hOpened);
  wchar_t text[PATH_SIZE] = L"", path[PATH_SIZE] = L"";
  DWORD dwType = REG_NONE, dwBytes = sizeof(text) - sizeof(*text);  // it need not come with a terminator
  if (RegQueryValueExW(hOpened, Wide(szName), nullptr, &dwType, reinterpret_cast<BYTE*>(text), &dwBytes) !=
          ERROR_SUCCESS ||
      (dwType != REG_SZ && dwType != REG_EXPAND_SZ))
    return false;
  const DWORD dwLength = ExpandEnvironmentStringsW(text, path, PATH_SIZE);
  return dwLength && dwLength <= PATH_SIZE && bIsAbsolute(path) && bNarrowPath(path, csFolder);
}

}  // namespace

bool bGetShellFolder(const char* szCommonName, const char* szUserName, CNString& csFolder) {
  return bRead(HKEY_LOCAL_MACHINE, szCommonName, csFolder) || bRead(HKEY_CURRENT_USER, szUserName, csFolder);
}
