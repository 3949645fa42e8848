// UnInstall.exe and UnInstall01.exe: removes the installation whose folder is the argument.
//
//   UnInstall.exe [/S] FOLDER          asks once, then removes; /S neither asks nor shows anything
//   COPY /2 PROCESS PROGRAM [/S] FOLDER
//                                      second step: a copy in the temporary folder, started by the first, which cannot
//                                      delete its own file. Waits for that process, deletes PROGRAM, empty folders.
//
// The exit code is 0 when everything that should go is gone (but for what the second step does), else 1.
#include <windows.h>

#include "CommandLine.h"
#include "Removal.h"
#include "System.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"

namespace {

int iSay(const Request& request, const char* szText, UINT uType, int iSilentAnswer) {
  if (request.bSilent) return iSilentAnswer;
  return MessageBoxW(nullptr, Wide(szText), L"Uninstall", uType | MB_SETFOREGROUND);
}

int iRefuse(const Request& request, const char* szText) {
  iSay(request, szText, MB_OK | MB_ICONERROR, IDOK);
  return 1;
}

int iReportEnd(const Request& request, const CNString& csFailures) {
  if (csFailures.bEmpty()) {
    iSay(request, "The program has been removed.", MB_OK | MB_ICONINFORMATION, IDOK);
    return 0;
  }
  CNString csText("These could not be removed:\n\n", 0);
  csText.Concat(csFailures.Text());
  if (csText.Length() > 1500) {  // more would not fit on the screen
    csText.SetLength(1500);
    csText.Concat("...");
  }
  return iRefuse(request, csText.Text());
}

// Starts a copy of this program that goes on when this one has ended. The copy goes with its last open handle, which it
// inherits from here and which lets nobody write, rename or replace it meanwhile.
bool bStartSecondStep(const Request& request, const char* szOwnPath) {
  CNString csTemp, csCopy, csCommand;
  if (!bOsGetTempFolder(csTemp) || !bOsMakeTempFile(csTemp.Text(), "uni", csCopy)) return false;
  if (!CopyFileW(Wide(szOwnPath), Wide(csCopy.Text()), FALSE)) return false;
  SetFileAttributesW(Wide(csCopy.Text()), FILE_ATTRIBUTE_NORMAL);
  SECURITY_ATTRIBUTES inherit = {sizeof(inherit), nullptr, TRUE};
  HANDLE hDelete = CreateFileW(Wide(csCopy.Text()), GENERIC_READ | DELETE, FILE_SHARE_READ, &inherit, OPEN_EXISTING,
                               FILE_FLAG_DELETE_ON_CLOSE, nullptr);
  csCommand.Printf("bStartSecondStep", "csCommand", "\"%s\" /2 %lu \"%s\" %s\"%s\"", csCopy.Text(),
                   GetCurrentProcessId(), szOwnPath, request.bSilent ? "/S " : "", request.csFolder.Text());
  STARTUPINFOW start = {};
  start.cb = sizeof(start);
  PROCESS_INFORMATION process = {};
  CNWideText command(csCommand.Text());
  auto pCommand = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(command.Ptr()));
  // The current folder must not be the one that is to go.
  bool bStarted = CreateProcessW(Wide(csCopy.Text()), pCommand, nullptr, nullptr, TRUE, 0, nullptr, Wide(csTemp.Text()),
                                 &start, &process);
  if (bStarted) {
    CloseHandle(process.hThread);
    CloseHandle(process.hProcess);
  }
  if (hDelete != INVALID_HANDLE_VALUE) CloseHandle(hDelete);
  return bStarted;
}

int iFirstStep(const Request& request, const char* szOwnPath) {
  if (request.csFolder.bEmpty())
    return iRefuse(request, "Tell which installation to remove: the argument is its folder.\n\nNothing was removed.");
  Installation installation;
  if (!bReadInstallation(request.csFolder.Text(), installation)) {
    CNString csText("There is no Uninstall.log and Installed.lst of an installation in the folder:\n\n", 0);
    csText.Concat(request.csFolder.Text());
    csText.Concat("\n\nNothing was removed.");
    return iRefuse(request, csText.Text());
  }
  CNString csQuestion("Do you want to remove ", 0);
  csQuestion.Concat(installation.csProgramName.Text());
  csQuestion.Concat(" from your computer?\n\nFiles that the installation did not make will stay.");
  if (iSay(request, csQuestion.Text(), MB_YESNO | MB_ICONQUESTION, IDYES) != IDYES) return 1;
  Removal removal(installation, szOwnPath);
  removal.RemoveAllButOwn();
  CNString csFailures(removal.Failures().Text(), 0);
  if (removal.bCanBeRepeated()) csFailures.Concat("\nClose what uses them, then remove the program once more.\n");
  bool bGoesOn = removal.bOwnRemains() && bStartSecondStep(request, szOwnPath);
  if (removal.bOwnRemains() && !bGoesOn) csFailures.Concat(szOwnPath);
  if (bGoesOn && csFailures.bEmpty()) return 0;  // the second step says the last word
  return iReportEnd(request, csFailures);
}

int iSecondStep(const Request& request, const char* szOwnPath) {
  HANDLE hFirst = OpenProcess(SYNCHRONIZE, FALSE, request.ulFirstProcess);
  if (hFirst) {
    WaitForSingleObject(hFirst, 60000);
    CloseHandle(hFirst);
  }
  Installation installation;
  installation.csFolder = request.csFolder;
  installation.csFolder.AddSlash();
  Removal removal(installation, request.csProgram.Text());
  removal.RemoveOwn(szOwnPath);
  return iReportEnd(request, removal.Failures());
}

// The copy runs from the temporary folder: nothing that lies there may be loaded in place of a system library.
void SearchSystemFolderOnly() {
  SetDllDirectoryW(L"");
  using SetDirectories = BOOL(WINAPI*)(DWORD);
  auto pProcedure = GetProcAddress(GetModuleHandleW(L"kernel32.dll"), "SetDefaultDllDirectories");
  if (pProcedure) reinterpret_cast<SetDirectories>(reinterpret_cast<void*>(pProcedure))(0x800);  // system folder
}

}  // namespace

int WINAPI wWinMain(HINSTANCE, HINSTANCE, LPWSTR, int) {
  SearchSystemFolderOnly();
  CNString csOwnPath, csLine;
  bNarrow(GetCommandLineW(), csLine);  // a program's path that code page 1250 cannot hold does no harm there
  const bool bOwnPath = bOsGetProgramPath(csOwnPath);
  Request request = ParseCommandLine(csLine.Text(), csOwnPath.Text());
  MakeFullPath(request.csFolder);
  if (!bOwnPath) return iRefuse(request, "This program's own path cannot be used.\n\nNothing was removed.");
  return request.bSecondStep ? iSecondStep(request, csOwnPath.Text()) : iFirstStep(request, csOwnPath.Text());
}
