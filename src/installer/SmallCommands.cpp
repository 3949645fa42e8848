// Commands that need no more than a few lines each.
#include <windows.h>

#include <cstdlib>
#include <cstring>

#include "foundation/os/Os.h"
#include "installer/CNInstallWizard.h"
#include "installer/SystemLibrary.h"

int CNInstallWizard::iSetQuitInstall(const char* szParam, int* pCommandResult) {
  // Deliberately inverted: "false" holds quitting back.
  if (iOsCompareNoCase(szParam, "false") == 0) m_Extraction.iBusy = 1;
  if (iOsCompareNoCase(szParam, "true") == 0) m_Extraction.iBusy = 0;
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iSetUnzipVar(const char* szParam, int* pCommandResult) {
  m_Extraction.iBusy = atoi(szParam);
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iSetVersion(const char* /*szParam*/, int* pCommandResult) {
  *pCommandResult = COMMAND_DONE;
  if (!CurrentDialog() || CurrentDialog()->m_csCaption.bEmpty()) return EVERYTHING_IS_OK;
  CNString csCaption = CurrentDialog()->m_csCaption;
  csCaption.SubstituteAll("CNInstallWizard::iSetVersion", "csCaption", "<%version%>", m_csVersion.Text());
  if (!csCaption.bEmpty()) iReplaceVarWithText(csCaption);
  m_View.SetCaption(csCaption.Text());
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iRequestSetupA(const char* /*szParam*/, int* pCommandResult) {
  m_bSeparateSetup = true;
  *pCommandResult = COMMAND_DONE;
  return iSetVariable("bInstallWizard_A", "1");
}

int CNInstallWizard::iRequestSetupB(const char* /*szParam*/, int* pCommandResult) {
  m_bSeparateSetup = true;
  *pCommandResult = COMMAND_DONE;
  return iSetVariable("bInstallWizard_B", "1");
}

int CNInstallWizard::iCheckForMabFon(const char* /*szParam*/, int* pCommandResult) {
  *pCommandResult = COMMAND_NEGATIVE;
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iEnd(const char* /*szParam*/, int* pCommandResult) {
  *pCommandResult = COMMAND_EXIT;
  return EVERYTHING_IS_OK;
}

// Asks the system to offer a restart. False when its library has no such function.
static bool bPromptReboot() {
  const SystemLibrary setup(L"setupapi.dll");
  using Prompt = int(WINAPI*)(void* hQueue, HWND hOwner, BOOL bScanOnly);
  const auto pPrompt = setup.Find<Prompt>("SetupPromptReboot");
  if (!pPrompt) return false;
  pPrompt(nullptr, nullptr, FALSE);
  return true;
}

int CNInstallWizard::iReboot(const char* /*szParam*/, int* pCommandResult) {
  *pCommandResult = COMMAND_DONE;
  if (atoi(szValue("upgrade")) == 0) return EVERYTHING_IS_OK;
  Tell(InstallEvent::Restart);
  if (!m_bNoRestart && !bPromptReboot())
    LogPrintf("INFO: CNInstallWizard::iReboot -> !bPromptReboot -> the user restarts the computer");
  if (m_Context.GetExpandedFile()) bOsDeleteFile(m_Context.GetExpandedFile());
  m_View.PostCommand(ID_EXIT);
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iOpenAddress(const char* szParam, int* pCommandResult) {
  *pCommandResult = COMMAND_DONE;
  if (!m_View.bOpenLink(szParam))
    LogPrintf("ERROR: CNInstallWizard::iOpenAddress -> !bOpenLink(%s) -> return", szParam);
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iCheckForProxy(const char* /*szParam*/, int* pCommandResult) {
  static const char SETTINGS[] = "Software\\Microsoft\\Windows\\CurrentVersion\\Internet Settings";
  char szEnabled[512] = "", szServer[512] = "";
  *pCommandResult = COMMAND_NEGATIVE;
  if (iReadRegistryKey(OS_HKEY_CURRENT_USER, SETTINGS, "ProxyEnable", szEnabled) != EVERYTHING_IS_OK ||
      atoi(szEnabled) == 0 ||
      iReadRegistryKey(OS_HKEY_CURRENT_USER, SETTINGS, "ProxyServer", szServer) != EVERYTHING_IS_OK)
    return EVERYTHING_IS_OK;
  *pCommandResult = COMMAND_DONE;
  return iSetVariable("proxy", szServer);
}

int CNInstallWizard::iNextPage(const char* /*szParam*/, int* pCommandResult) {
  m_View.PostCommand(ID_NEXT);
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iBackPage(const char* /*szParam*/, int* pCommandResult) {
  iSetVariable("back", "1");
  m_View.SendCommand(ID_NEXT);  // deliberately 101: the script's flow looks at "back" and goes back by itself
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iRunApp(const char* /*szParam*/, int* pCommandResult) {
  CNString csFolder, csProgram, csText;
  GetDestination(csFolder);
  csProgram.Printf("CNInstallWizard::iRunApp", "csProgram", "%s\\%s", csFolder.Text(), szValue("program_file"));
  *pCommandResult = COMMAND_EXIT;
  if (csFolder.EndsWith(":")) csFolder.AddSlash();  // a drive's root, not its current folder
  if (m_View.bOpenLink(csProgram.Text(), csFolder.Text())) return EVERYTHING_IS_OK;
  csText.Printf("CNInstallWizard::iRunApp", "csText", "The program could not be started:\n\n%s", csProgram.Text());
  m_View.iShowMessage({csText.Text(), szValue("msgbox_capt"), MessageIcon::Error});
  return iLogReturn(EVERYTHING_IS_OK, "ERROR: CNInstallWizard::iRunApp -> !bOpenLink(%s) -> return EVERYTHING_IS_OK",
                    csProgram.Text());
}
