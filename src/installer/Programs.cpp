#include "installer/Programs.h"

#include <windows.h>
// after windows.h
#include <shellapi.h>
#include <tlhelp32.h>

#include <cstring>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "installer/CommandTools.h"
#include "installer/SystemLibrary.h"
#include "wizard/COrbitWizard.h"

// ---- starting ----

bool bStartProgram(const char* szPath, const char* szArguments, SystemHandle* pProcess) {
  if (!bIsFullPath(szPath) || bOsIsFolder(szPath) || !bOsExists(szPath))
    return iLogReturn(0, "ERROR: bStartProgram -> !bOsExists(%s) -> return false", szPath);
  CNString csFolder(szPath, 0);
  csFolder.Trim('\\');
  csFolder.AddSlash();
  const Wide path(szPath), arguments(szArguments), folder(csFolder.Text());
  SHELLEXECUTEINFOW info = {};
  info.cbSize = sizeof(info);
  // The shell quotes the path, and asks for consent where a program wants it.
  info.fMask = SEE_MASK_NOCLOSEPROCESS | SEE_MASK_FLAG_NO_UI | SEE_MASK_FLAG_DDEWAIT;
  info.lpFile = path;
  info.lpParameters = arguments;
  info.lpDirectory = folder;
  info.nShow = SW_SHOWNORMAL;
  if (!ShellExecuteExW(&info))
    return iLogReturn(0, "ERROR: bStartProgram -> !ShellExecuteEx(%s) -> return false", szPath);
  SystemHandle process(info.hProcess);
  if (pProcess) process.swap(*pProcess);
  return true;
}

bool bCallLibrary(const char* szPath, const char* szFunction) {
  if (!bIsFullPath(szPath)) return false;
  const HMODULE hLibrary = LoadLibraryExW(WidePath(szPath), nullptr, LOAD_WITH_ALTERED_SEARCH_PATH);
  if (!hLibrary) return false;
  using Call = HRESULT(WINAPI*)();
  const auto pCall = reinterpret_cast<Call>(reinterpret_cast<void*>(GetProcAddress(hLibrary, szFunction)));
  const bool bDone = pCall && SUCCEEDED(pCall());
  FreeLibrary(hLibrary);
  return bDone;
}

// ---- running ----

namespace {

// Where a process's program is; the first system that can tell without reading the process's memory is Vista.
class ProcessPaths {
 public:
  ProcessPaths() : m_Kernel(L"kernel32.dll"), m_Psapi(L"psapi.dll") {}

  bool bGet(DWORD dwProcess, CNString& csPath) const {
    const auto pQuery = m_Kernel.Find<BOOL(WINAPI*)(HANDLE, DWORD, wchar_t*, DWORD*)>("QueryFullProcessImageNameW");
    const auto pModule = m_Psapi.Find<DWORD(WINAPI*)(HANDLE, HMODULE, wchar_t*, DWORD)>("GetModuleFileNameExW");
    const DWORD QUERY_LIMITED = 0x1000;
    const SystemHandle process(
        OpenProcess(pQuery ? QUERY_LIMITED : PROCESS_QUERY_INFORMATION | PROCESS_VM_READ, FALSE, dwProcess));
    wchar_t szPath[MAX_PATH] = L"";
    DWORD dwSize = MAX_PATH;
    if (!process) return false;
    const bool bTold = pQuery ? pQuery(process.get(), 0, szPath, &dwSize) != FALSE
                              : pModule && pModule(process.get(), nullptr, szPath, MAX_PATH);
    return bTold && bNarrow(szPath, csPath);
  }

 private:
  const SystemLibrary m_Kernel, m_Psapi;
};

}  // namespace

bool bFindRunning(const char* szNames, const char* szFolder, CNString& csFound) {
  const TextList names(szNames);
  const ProcessPaths paths;
  const SystemHandle snapshot(CreateToolhelp32Snapshot(TH32CS_SNAPPROCESS, 0));
  PROCESSENTRY32W entry = {};
  entry.dwSize = sizeof(entry);
  csFound = "";
  for (BOOL bMore = Process32FirstW(snapshot.get(), &entry); bMore; bMore = Process32NextW(snapshot.get(), &entry)) {
    CNString csName, csPath;
    bNarrow(entry.szExeFile, csName);
    if (entry.th32ProcessID == GetCurrentProcessId()) continue;
    const bool bNamed = names.bHas(csName.Text());
    if (!bNamed && (!*szFolder || !paths.bGet(entry.th32ProcessID, csPath) || !bIsBelow(csPath.Text(), szFolder)))
      continue;
    if (TextList(csFound.Text(), "\n").bHas(csName.Text())) continue;  // one program, several processes
    if (!csFound.bEmpty()) csFound.Concat("\n");
    csFound.Concat(csName.Text());
  }
  return !csFound.bEmpty();
}

// ---- installed ----

const char INSTALLED_PROGRAMS[] = "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\";

// The folder of the program that a command line starts, quoted or not.
static void FolderOfCommand(const char* szCommand, CNString& csFolder) {
  csFolder = szCommand + (*szCommand == '"');
  const char* pEnd = csFolder.bEmpty() ? nullptr : csFolder.IHas(".exe", false);
  if (pEnd) csFolder.SetLength(static_cast<long>(pEnd - csFolder.Text()));
  if (pEnd) csFolder.Trim('\\');
}

bool bFindInstalled(const char* szName, CNString& csFolder) {
  const CNString csKey = Joined(INSTALLED_PROGRAMS, szName);
  if (!*szName || strchr(szName, '\\')) return false;
  for (const OsRegKey hRoot : {OS_HKEY_LOCAL_MACHINE, OS_HKEY_CURRENT_USER})
    for (const char* szValue : {"InstallLocation", "UninstallString"}) {
      char szText[512] = "";
      if (COrbitWizard::iReadRegistryKey(hRoot, csKey.Text(), szValue, szText) != EVERYTHING_IS_OK) continue;
      csFolder = szText;
      if (*szValue == 'U') FolderOfCommand(szText, csFolder);
      if (csFolder.EndsWith("\\")) csFolder.SetLength(csFolder.Length() - 1);
      if (bIsFullPath(csFolder.Text()) && bOsIsFolder(csFolder.Text())) return true;
    }
  return false;
}
