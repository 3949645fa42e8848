#include "ShellLink.h"

#include <windows.h>
// after windows.h
#include <objbase.h>
#include <shlobj.h>

namespace {

template <typename T>
struct ComRelease {
  T* p = nullptr;
  ~ComRelease() {
    if (p) p->Release();
  }
};

bool bLoad(const std::wstring& wsFile, ComRelease<IShellLinkW>& shell) {
  ComRelease<IPersistFile> file;
  return SUCCEEDED(CoCreateInstance(CLSID_ShellLink, nullptr, CLSCTX_INPROC_SERVER, IID_IShellLinkW,
                                    reinterpret_cast<void**>(&shell.p))) &&
         SUCCEEDED(shell.p->QueryInterface(IID_IPersistFile, reinterpret_cast<void**>(&file.p))) &&
         SUCCEEDED(file.p->Load(wsFile.c_str(), STGM_READ));
}

// The item list holds the path in Unicode; the stored path beside it may be in the system's code page only.
std::wstring TargetOf(IShellLinkW* pLink) {
  wchar_t szPath[MAX_PATH] = L"";
  PIDLIST_ABSOLUTE pItems = nullptr;
  bool bFound = pLink->GetIDList(&pItems) == S_OK && SHGetPathFromIDListW(pItems, szPath);
  CoTaskMemFree(pItems);
  if (!bFound) pLink->GetPath(szPath, MAX_PATH, nullptr, 0);
  return szPath;
}

}  // namespace

bool bReadShellLink(const std::wstring& wsFile, ShellLink& link) {
  CoInitialize(nullptr);
  ComRelease<IShellLinkW> shell;
  if (!bLoad(wsFile, shell)) return false;
  wchar_t szText[1024] = L"";
  link.wsTarget = TargetOf(shell.p);
  if (SUCCEEDED(shell.p->GetArguments(szText, 1024))) link.wsArguments = szText;
  if (SUCCEEDED(shell.p->GetWorkingDirectory(szText, 1024))) link.wsFolder = szText;
  return true;
}
