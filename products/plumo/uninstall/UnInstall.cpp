// UnInstall.exe and UnInstall01.exe: removes the installation whose folder is the argument.
//
//   UnInstall.exe [SWITCHES] FOLDER [SWITCHES]
//                                      asks once, then removes; with /S (/SILENT, /VERYSILENT, /quiet, /q, /passive) it
//                                      neither asks nor shows anything. /LOG=FILE keeps a log, /norestart changes
//                                      nothing, /? tells the switches; - serves as well as /. FOLDER may stand in
//                                      quotes.
//   COPY /2 PROCESS PROGRAM [/S] FOLDER
//                                      second step: a copy in the temporary folder, started by the first, which cannot
//                                      delete its own file. Waits for that process, deletes PROGRAM, empty folders.
//
// The exit code is 0 when all of the installation is gone; what the user has changed or added is not part of it. It is
// 1602 when the user does not want it, 87 for a wrong switch, 1603 when something stays, is not known, or cannot be
// done. The running program first moves its own file into the temporary folder, so that the code holds for it too; only
// when the two are on different drives the second step removes it from its place, after the code has been given.
#include <windows.h>

#include <cstring>

#include "CommandLine.h"
#include "Removal.h"
#include "System.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsLibraries.h"
#include "foundation/os/OsWide.h"
#include "launcher/RunLog.h"

namespace {

enum ExitCode : int { DONE = 0, WRONG_SWITCH = 87, NOT_WANTED = 1602, FAILED = 1603 };

struct Run {
  Request request;
  CNString csOwnPath;
  RunLog log;
};

int iSay(Run& run, const char* szText, UINT uType, int iSilentAnswer) {
  const int iAnswer =
      run.request.bSilent ? iSilentAnswer : MessageBoxW(nullptr, Wide(szText), L"Uninstall", uType | MB_SETFOREGROUND);
  run.log.Line("message: %s -> %s", szText, iAnswer == IDYES ? "Yes" : iAnswer == IDNO ? "No" : "OK");
  return iAnswer;
}

int iRefuse(Run& run, const char* szText, ExitCode code = FAILED) {
  iSay(run, szText, MB_OK | MB_ICONERROR, IDOK);
  return code;
}

void AddSection(CNString& csText, const char* szTitle, const CNString& csLines) {
  if (csLines.bEmpty()) return;
  csText.Concat(csText.bEmpty() ? "" : "\n");
  csText.Concat(szTitle);
  csText.Concat("\n\n");
  csText.Concat(csLines.Text());
  if (csText.Length() > 1500) {  // more would not fit on the screen
    csText.SetLength(1500);
    csText.Concat("...\n");
  }
}

void LogLines(RunLog& log, const char* szTitle, const CNString& csLines) {
  for (const char* sz = csLines.Text(); *sz; sz += strspn(sz, "\n")) {
    const int iLength = static_cast<int>(strcspn(sz, "\n"));
    log.Line("%s: %.*s", szTitle, iLength, sz);
    sz += iLength;
  }
}

// csUnknown: what the records did not tell.
int iReportEnd(Run& run, const Removal& removal, const CNString& csUnknown) {
  CNString csText;
  LogLines(run.log, "not removed", removal.Failures());
  LogLines(run.log, "kept", removal.Kept());
  AddSection(csText, "These could not be removed:", removal.Failures());
  AddSection(csText, "Something may be left, because records of the installation are not whole:", csUnknown);
  const bool bAll = csText.bEmpty();
  if (bAll) csText = "The program has been removed.\n";
  if (removal.bCanBeRepeated()) csText.Concat("\nClose what uses them, then remove the program once more.\n");
  if (!removal.bCanBeRepeated()) AddSection(csText, "These files were changed or added, and stay:", removal.Kept());
  if (!bAll) return iRefuse(run, csText.Text());
  iSay(run, csText.Text(), MB_OK | MB_ICONINFORMATION, IDOK);
  return DONE;
}

// Starts a copy of this program that goes on when this one has ended. The copy goes with its last open handle, which it
// inherits from here and which lets nobody write, rename or replace it meanwhile.
// szOwnPath: where this program's file is by now.
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

// The program's own file is all that is left. True when it is out of the way.
bool bRemoveOwn(const Request& request, Removal& removal, const char* szOwnPath) {
  CNString csMoved;
  if (!bMoveAside(szOwnPath, csMoved)) return bStartSecondStep(request, szOwnPath);
  removal.RemoveLast();
  Request silent;  // nothing is left to be said, and the folder may be another installation's a moment later
  silent.bSilent = true;
  if (!bStartSecondStep(silent, csMoved.Text())) bDeleteAtRestart(csMoved.Text());
  return true;
}

bool bAgrees(Run& run, const Installation& installation) {
  CNString csQuestion("Do you want to remove ", 0);
  csQuestion.Concat(installation.csProgramName.bEmpty() ? installation.csFolder.Text()
                                                        : installation.csProgramName.Text());
  csQuestion.Concat(" from your computer?\n\nFiles that you have changed or added will stay.");
  if (!installation.csUnknown.bEmpty()) csQuestion.Concat("\n\n");
  csQuestion.Concat(installation.csUnknown.Text());
  return iSay(run, csQuestion.Text(), MB_YESNO | MB_ICONQUESTION, IDYES) == IDYES;
}

int iFirstStep(Run& run) {
  const Request& request = run.request;
  const char* szOwnPath = run.csOwnPath.Text();
  if (request.csFolder.bEmpty())
    return iRefuse(run, "Tell which installation to remove: the argument is its folder.\n\nNothing was removed.");
  Installation installation;
  if (!installation.bRead(request.csFolder.Text())) {
    CNString csText("There is no Uninstall.log and Installed.lst of an installation in the folder:\n\n", 0);
    csText.Concat(request.csFolder.Text());
    csText.Concat("\n\nNothing was removed.");
    return iRefuse(run, csText.Text());
  }
  if (!bAgrees(run, installation)) return NOT_WANTED;
  Removal removal(installation, szOwnPath, run.log);
  removal.RemoveAllButOwn();
  RemoveTempFiles(szOwnPath);
  if (removal.bOwnRemains() && !bRemoveOwn(request, removal, szOwnPath)) removal.ReportOwn();
  removal.FindKept();
  return iReportEnd(run, removal, installation.csUnknown);
}

// Silent whatever happens: the first step has said how it ended.
int iSecondStep(Run& run) {
  const Request& request = run.request;
  HANDLE hFirst = OpenProcess(SYNCHRONIZE, FALSE, request.ulFirstProcess);
  if (hFirst) {
    WaitForSingleObject(hFirst, 60000);
    CloseHandle(hFirst);
  }
  Installation installation;
  if (!request.csFolder.bEmpty()) installation.bRead(request.csFolder.Text());
  Removal removal(installation, request.csProgram.Text(), run.log);
  removal.RemoveOwn(run.csOwnPath.Text());
  if (!request.csFolder.bEmpty()) removal.RemoveLast();
  return removal.Failures().bEmpty() ? DONE : FAILED;
}

int iRun(Run& run) {
  Request& request = run.request;
  MakeFullPath(request.csFolder);
  MakeFullPath(request.csLog);
  if (run.csOwnPath.bEmpty()) return iRefuse(run, "This program's own path cannot be used.\n\nNothing was removed.");
  if (!request.csFault.bEmpty()) return iRefuse(run, request.csFault.Text(), WRONG_SWITCH);
  if (request.bHelp) return iSay(run, SWITCHES_HELP, MB_OK | MB_ICONINFORMATION, IDOK), DONE;
  if (!request.csLog.bEmpty() && !run.log.bOpen(request.csLog.Text()))
    return iRefuse(run, "The log cannot be written.\n\nNothing was removed.");
  if (request.bSecondStep) return iSecondStep(run);
  run.log.Line("removal of %s by %s", request.csFolder.Text(), run.csOwnPath.Text());
  const int iCode = iFirstStep(run);
  run.log.Line("end, exit code %d", iCode);
  return iCode;
}

}  // namespace

int WINAPI wWinMain(HINSTANCE, HINSTANCE, LPWSTR, int) {
  LoadLibrariesFromSystemOnly();  // the copy runs from the temporary folder
  Run run;
  CNString csLine;
  bNarrow(GetCommandLineW(), csLine);  // a program's path that code page 1250 cannot hold does no harm there
  bOsGetProgramPath(run.csOwnPath);
  run.request = ParseCommandLine(csLine.Text(), run.csOwnPath.Text());
  return iRun(run);
}
