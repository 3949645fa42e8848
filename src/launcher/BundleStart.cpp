#include "launcher/BundleStart.h"

#include <windows.h>

#include <new>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "window/Pictures.h"

namespace {

// Takes a variable out of the environment; null when it was not there, or without memory.
std::unique_ptr<wchar_t[]> pTakeVariable(const wchar_t* szName) {
  const DWORD dwSize = GetEnvironmentVariableW(szName, nullptr, 0);  // 1 for an empty one
  std::unique_ptr<wchar_t[]> pValue(dwSize ? new (std::nothrow) wchar_t[dwSize] : nullptr);
  if (pValue && GetEnvironmentVariableW(szName, pValue.get(), dwSize) >= dwSize) pValue.reset();
  SetEnvironmentVariableW(szName, nullptr);
  return pValue;
}

// By what the paths lead to: the system may spell a program's path in another way than the one who started it.
bool bIsOwnFolder(const wchar_t* szFolder, CNString& csFolder) {
  CNString csOwn;
  if (!bNarrowPath(szFolder, csFolder) || !bOsGetProgramPath(csOwn)) return false;
  csOwn.Trim('\\');
  return bOsIsSameFile(csOwn.Text(), csFolder.Text());
}

// Held without a share for deletion until the process ends: should the starter be killed, the next one sees that its
// folder is still in use.
void HoldFolder(const wchar_t* szFolder) {
  CreateFileW(szFolder, FILE_LIST_DIRECTORY, FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr, OPEN_EXISTING,
              FILE_FLAG_BACKUP_SEMANTICS, nullptr);
}

}  // namespace

void ReadBundleStart(BundleStart& start) {
  const std::unique_ptr<wchar_t[]> pFolder = pTakeVariable(BUNDLE_VARIABLE);
  std::unique_ptr<wchar_t[]> pSwitches = pTakeVariable(SWITCHES_VARIABLE);
  start.bStarted = pFolder && pSwitches && *pFolder.get() && bIsOwnFolder(pFolder.get(), start.csFolder);
  if (!start.bStarted) return start.csFolder.Free();
  start.pSwitches = std::move(pSwitches);
  HoldFolder(pFolder.get());
}

void TellEnd(const BundleStart& start) {
  CNString csFile;
  OsFile file;
  if (!start.bStarted) return;
  csFile = start.csFolder;
  csFile.Concat(ENDED_FILE);
  file.bOpen(csFile.Text(), OsOpenMode::CreateNew);
}

bool bUseBundle(const BundleStart& start, CarriedScripts& scripts) {
  if (!start.bStarted) return true;
  static CNString s_csPictures;  // looked at as long as there are windows
  s_csPictures = start.csFolder;
  s_csPictures.Concat("\\pict");
  SetPictureFolder(s_csPictures.Text(), true);
  CNString csScript;
  csScript = start.csFolder;
  csScript.Concat("\\wizard.txt");
  return scripts.bLoadInstallerFrom(csScript.Text());
}
