// Programs that must not run, programs that are to be started, and the browser.
#include <cstdlib>
#include <cstring>

#include "archive/PathGuard.h"
#include "foundation/CNSystem.h"
#include "foundation/os/Os.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"
#include "installer/Programs.h"

// ---- programs that must not run ----

// Asks as long as the user wants to try again; true when none of the programs runs. The script's message box wins over
// the built-in wording.
bool CNInstallWizard::bAskToClose(const char* szBox, const char* szNames, const char* szFolder) {
  CNString csFound, csText;
  for (;;) {
    if (!bFindRunning(szNames, szFolder, csFound)) return true;
    iSetVariable("running_programs", csFound.Text());
    int iAnswer = bHasMessageBox(szBox) ? iShowMessageBox(szBox, MessageIcon::Exclamation) : 0;
    if (!iAnswer) {
      csText.Printf("CNInstallWizard::bAskToClose", "csText",
                    "Setup cannot go on while these programs run:\n\n%s\n\nClose them, then choose Retry.",
                    csFound.Text());
      iAnswer = m_View.iShowMessage(
          {csText.Text(), szValue("msgbox_capt"), MessageIcon::Exclamation, MessageButtons::RetryCancel});
    }
    if (iAnswer == ANSWER_RETRY || iAnswer == ANSWER_TRY_AGAIN || iAnswer == ANSWER_YES) continue;
    // A box with nothing but OK: who has closed the programs meanwhile goes on.
    return iAnswer == ANSWER_OK && !bFindRunning(szNames, szFolder, csFound);
  }
}

bool CNInstallWizard::bHasMessageBox(const char* szName) const {
  for (int i = 1; i <= DialogCount(); i++) {
    const BaseControl* pControl = GetDialog(i)->GetBaseControl(szName);
    if (pControl && pControl->Kind() == ControlKind::MsgBox) return true;
  }
  return false;
}

bool CNInstallWizard::bSoftwareRuns(const char* szPrograms) {
  CNString csFolder, csNames;
  GetDestination(csFolder);
  if (csFolder.Length() < 3) csFolder = "";  // a whole drive is no product's folder
  csNames = szOr(szPrograms, szValue("running_software"));
  if (csNames.bEmpty()) csNames = Joined(szValue("program_file"), ";iexplore.exe");
  return !bAskToClose("msgBox_activeIE", csNames.Text(), csFolder.Text());
}

int CNInstallWizard::iStay(int* pCommandResult) {
  m_bPageStays = true;
  return iAnswer(pCommandResult, COMMAND_EXIT);
}

int CNInstallWizard::iCheckIfSoftwareIsRuning(const char* szParam, int* pCommandResult) {
  return bSoftwareRuns(szParam) ? iStay(pCommandResult) : iAnswer(pCommandResult, COMMAND_DONE);
}

// ---- other products' programs ----

// A file of another product: a full path, or a name in the folder of the variable "halvex_path", which without one is
// where the product "halvex_name" is installed, else the destination. False when there is no such file.
bool CNInstallWizard::bFindProductFile(const char* szName, CNString& csPath) {
  CNString csFolder, csSafe;
  csPath = szName;
  if (!bIsFullPath(szName)) {
    csFolder = szValue("halvex_path");
    if (csFolder.bEmpty() && !bFindInstalled(szOr(szValue("halvex_name"), "Halvex"), csFolder))
      GetDestination(csFolder);
    if (!bMakeSafePath(szName, csSafe)) return false;
    csPath = Joined(csFolder.Text(), "\\", csSafe.Text());
  }
  return bOsExists(csPath.Text()) && !bOsIsFolder(csPath.Text());
}

int CNInstallWizard::iInstallWizard(const char* szParam, int* pCommandResult) {
  CNString csName;
  if (!m_bSeparateSetup) return iAnswer(pCommandResult, COMMAND_DONE);
  const bool bProgram = bMakeSafePath(szParam, csName) && csName.IHas(".exe", false);
  if (bProgram && bStartProgram(Joined(m_Context.csTempFolder.Text(), csName.Text()).Text(), ""))
    return iAnswer(pCommandResult, COMMAND_DONE);
  iAnswer(pCommandResult, COMMAND_NEGATIVE);
  return iLogReturn(EVERYTHING_IS_OK,
                    "ERROR: CNInstallWizard::iInstallWizard -> !bStartProgram(%s) -> COMMAND_NEGATIVE", szParam);
}

// Parameter: "program;library", the library may be missing.
int CNInstallWizard::iRunHalvex(const char* szParam, int* pCommandResult) {
  const TextList files(szParam);
  CNString csProgram, csLibrary;
  if (!files.Size() || !bFindProductFile(files[0], csProgram) || !bStartProgram(csProgram.Text(), ""))
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK,
                      "INFO: CNInstallWizard::iRunHalvex -> !bFindProductFile(%s) -> COMMAND_NEGATIVE", szParam);
  const char* szLibrary = files.Size() > 1 ? files[1] : szValue("toolbar_file");
  iAnswer(pCommandResult, COMMAND_DONE);
  if (!*szLibrary || (bFindProductFile(szLibrary, csLibrary) && bCallLibrary(csLibrary.Text(), "DllRegisterServer")))
    return EVERYTHING_IS_OK;
  const CNString csText = Joined("The toolbar could not be registered:\n\n", szLibrary);
  m_View.iShowMessage({csText.Text(), "Error", MessageIcon::Error});
  return iLogReturn(EVERYTHING_IS_OK,
                    "ERROR: CNInstallWizard::iRunHalvex -> !DllRegisterServer(%s) -> return EVERYTHING_IS_OK",
                    szLibrary);
}

// Waits for it, but not for ever: its files are to be replaced next.
int CNInstallWizard::iStopHalvex(const char* szParam, int* pCommandResult) {
  const DWORD LONGEST_WAIT = 30000;
  CNString csProgram;
  SystemHandle process;
  if (*szParam && bFindProductFile(szParam, csProgram) &&
      bStartProgram(csProgram.Text(), "-server --deinstall", &process)) {
    if (process) WaitForSingleObject(process.get(), LONGEST_WAIT);
    return iAnswer(pCommandResult, COMMAND_DONE);
  }
  iAnswer(pCommandResult, COMMAND_NEGATIVE);
  return iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iStopHalvex -> !bFindProductFile(%s) -> nothing to stop",
                    szParam);
}

int CNInstallWizard::iDeinstallToolbar(const char* szParam, int* pCommandResult) {
  CNString csLibrary;
  const char* szLibrary = szOr(szParam, szValue("toolbar_file"));
  if (!*szLibrary || !bFindProductFile(szLibrary, csLibrary))
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK,
                      "INFO: CNInstallWizard::iDeinstallToolbar -> !bFindProductFile(%s) -> nothing to take off",
                      szLibrary);
  if (!bAskToClose("msgBox_activeSotware1", szOr(szValue("browser"), "iexplore.exe"), "")) return iStay(pCommandResult);
  if (bCallLibrary(csLibrary.Text(), "DllUnregisterServer")) return iAnswer(pCommandResult, COMMAND_DONE);
  iAnswer(pCommandResult, COMMAND_NEGATIVE);
  return iLogReturn(EVERYTHING_IS_OK,
                    "ERROR: CNInstallWizard::iDeinstallToolbar -> !DllUnregisterServer(%s) -> COMMAND_NEGATIVE",
                    csLibrary.Text());
}

static bool bIsSet(const char* szNumber) { return atoi(szNumber) != 0; }

int CNInstallWizard::iStartHalvexMsg(const char* /*szParam*/, int* pCommandResult) {
  const bool bShow =
      bIsSet(szValue("servis_install")) || bIsSet(szValue("servis_task")) || bIsSet(szValue("server_task"));
  iSetVariable("start_halvex_msg", bShow ? "1" : "0");
  return iAnswer(pCommandResult, COMMAND_DONE);
}

// ---- the browser ----

// The browser by its registered path; without one the system opens the address with whatever it has.
int CNInstallWizard::iStartDorvik(const char* szParam, int* pCommandResult) {
  static const char APP_PATHS[] = "SOFTWARE\\Microsoft\\Windows\\CurrentVersion\\App Paths\\";
  const char* szAddress = szOr(szParam, szOr(szValue("start_page"), "about:blank"));
  char szBrowser[512] = "";
  const CNString csKey = Joined(APP_PATHS, szOr(szValue("browser"), "iexplore.exe"));
  iAnswer(pCommandResult, COMMAND_EXIT);
  if (strchr(szAddress, '"'))  // would end the argument that it is
    return iLogReturn(EVERYTHING_IS_OK, "ERROR: CNInstallWizard::iStartDorvik -> strchr(%s) -> return EVERYTHING_IS_OK",
                      szAddress);
  if (iReadRegistryKey(OS_HKEY_LOCAL_MACHINE, csKey.Text(), "", szBrowser) == EVERYTHING_IS_OK) {
    const TextList path(szBrowser, "\"");
    if (path.Size() && bStartProgram(path[0], Joined("\"", szAddress, "\"").Text())) return EVERYTHING_IS_OK;
  }
  return iOpenAddress(szAddress, pCommandResult), iAnswer(pCommandResult, COMMAND_EXIT);
}

int CNInstallWizard::iCheckForIEVersion(const char* /*szParam*/, int* pCommandResult) {
  char szVersion[512] = "";
  iReadRegistryKey(OS_HKEY_LOCAL_MACHINE, "SOFTWARE\\Microsoft\\Internet Explorer\\Version Vector", "IE", szVersion);
  const char* pDot = strchr(szVersion, '.');
  const int iMajor = atoi(szVersion), iMinor = pDot ? pDot[1] - '0' : 0;
  if (m_pOutput) *m_pOutput = iMajor < 5 || (iMajor == 5 && iMinor < 5) ? "install_IE" : "version_ok";
  iSetVariable("IE_version", szVersion);
  return iAnswer(pCommandResult, COMMAND_DONE);
}

void CNInstallWizard::InstallIEWork() {
  SystemHandle process;
  bStartProgram(m_csBrowserSetup.Text(), "", &process);
  while (process && !m_bEnding && WaitForSingleObject(process.get(), 100) == WAIT_TIMEOUT) {
  }
  PostWorkDone();
}

int CNInstallWizard::iInstallIE(const char* /*szParam*/, int* pCommandResult) {
  CNString csFolder;
  if (CNSystem::GetCurrentApplicationDir(csFolder) != EVERYTHING_IS_OK) return iAnswer(pCommandResult, COMMAND_EXIT);
  m_csBrowserSetup = Joined(csFolder.Text(), "IE 6.0\\ie6setup.exe");
  if (!bOsExists(m_csBrowserSetup.Text()))
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iInstallIE -> !bOsExists(%s) -> COMMAND_NEGATIVE",
                      m_csBrowserSetup.Text());
  for (const char* szButton : {"b_back", "b_next", "b_cancel"})
    if (GetBaseControl(szButton)) EnableControl(szButton, false);
  if (!bStartTask(&CNInstallWizard::InstallIEWork))
    return iLogReturn(FUNCTION_ERROR, "ERROR: CNInstallWizard::iInstallIE -> !bStartTask -> return FUNCTION_ERROR");
  return iAnswer(pCommandResult, COMMAND_DONE);
}
