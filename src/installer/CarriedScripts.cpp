#include "installer/CarriedScripts.h"

#include <windows.h>

#include "foundation/os/Os.h"

static bool bLoadText(HMODULE hModule, const wchar_t* szName, CNString& csText) {
  const HRSRC hFound = FindResourceW(hModule, szName, MAKEINTRESOURCEW(10));  // 10: RT_RCDATA as a wide name
  const HGLOBAL hLoaded = hFound ? LoadResource(hModule, hFound) : nullptr;
  const void* pText = hLoaded ? LockResource(hLoaded) : nullptr;
  // The text has no terminator of its own: the resource's size is its only bound.
  const DWORD dwSize = pText ? SizeofResource(hModule, hFound) : 0;
  return dwSize && csText.Copy(static_cast<const char*>(pText), static_cast<long>(dwSize));
}

bool CarriedScripts::bLoad(void* hInstance) {
  const HMODULE hModule = static_cast<HMODULE>(hInstance);
  if (bLoadText(hModule, L"SCRIPT_INSTALLER", csInstaller) && bLoadText(hModule, L"SCRIPT_PLEASE_WAIT", csPleaseWait) &&
      bLoadText(hModule, L"SCRIPT_EXIT", csExit))
    return true;
  LogPrintf("ERROR: CarriedScripts::bLoad -> !bLoadText -> return false");
  return false;
}

bool CarriedScripts::bLoadInstallerFrom(const char* szPath) {
  OsFile file;
  const int64_t size = file.bOpen(szPath, OsOpenMode::Read) ? file.Size() : -1;
  csInstaller.Free();
  if (size > 0 && size <= MOST_SCRIPT) csInstaller.SetLength(static_cast<long>(size));
  if (csInstaller.Ptr() && file.lRead(csInstaller.Ptr(), static_cast<size_t>(size)) == size) return true;
  csInstaller.Free();
  LogPrintf("ERROR: CarriedScripts::bLoadInstallerFrom -> !lRead(%s) -> return false", szPath);
  return false;
}
