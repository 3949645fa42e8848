// The command UpdateRegistry: the entry in the system's list of installed programs and the product's settings file.
#include <cstring>

#include "foundation/CNConfigFile.h"
#include "foundation/os/Os.h"
#include "installer/CNInstallWizard.h"

int CNInstallWizard::iUpdateRegistry(const char* szParam, int* pCommandResult) {
  static const char UNINSTALL_KEY[] = "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\";
  const char* szName = szValue("program_name");
  CNString csKey, csFolder;
  if (!szParam)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNInstallWizard::iUpdateRegistry -> !szParam -> return PRECONDITIONS_NOT_VALID");
  *pCommandResult = COMMAND_DONE;
  if (strcmp(szParam, "ND") != 0)  // other products' branches
    return iLogReturn(EVERYTHING_IS_OK,
                      "INFO: CNInstallWizard::iUpdateRegistry -> %s is not in this build -> return EVERYTHING_IS_OK",
                      szParam);
  *pCommandResult = COMMAND_FAILED;
  if (!*szName)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iUpdateRegistry -> !program_name -> return FUNCTION_ERROR");
  GetDestination(csFolder);
  if (csFolder.bEmpty())
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iUpdateRegistry -> !default_path -> return FUNCTION_ERROR");
  csKey = UNINSTALL_KEY;
  csKey.Concat(szName);
  if (iAddRemoveProgram(csKey.Text(), csFolder.Text(), szName) != EVERYTHING_IS_OK) {
    ShowNotComplete("entering the program in the list of installed programs");
    return FUNCTION_ERROR;
  }
  if (iWriteSettings() != EVERYTHING_IS_OK) {
    ShowNotComplete("writing the settings file config.ini");
    return FUNCTION_ERROR;
  }
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iAddRemoveProgram(const char* szKey, const char* szPath, const char* szProgram) {
  if (!szKey || !*szKey)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: CNInstallWizard::iAddRemoveProgram -> !szKey || !*szKey -> return PRECONDITIONS_NOT_VALID");
  if (!szPath || !*szPath)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: CNInstallWizard::iAddRemoveProgram -> !szPath || !*szPath -> return PRECONDITIONS_NOT_VALID");
  if (!szProgram || !*szProgram)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: CNInstallWizard::iAddRemoveProgram -> !szProgram || !*szProgram -> return PRECONDITIONS_NOT_VALID");
  CNString csCommand;  // deliberately without quotes: the uninstaller takes the rest of its command line as the folder
  csCommand.Printf("CNInstallWizard::iAddRemoveProgram", "csCommand", "%s\\UnInstall.exe %s", szPath, szPath);
  const int iResult = iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, szKey, "DisplayName", szProgram, nullptr);
  if (iResult != EVERYTHING_IS_OK) return iResult;
  return iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, szKey, "UninstallString", csCommand.Text(), nullptr);
}

// True when there is no such file or one that begins like a configuration file, with the count of its entries. Another
// program's would be spoilt.
static bool bMayWriteSettings(const char* szFile) {
  OsFile file;
  char szCount[4] = {};
  if (!bOsExists(szFile)) return true;
  if (!file.bOpen(szFile, OsOpenMode::Read)) return false;
  return file.lRead(szCount, 3) == 0 || strspn(szCount, "0123456789") == 3;
}

int CNInstallWizard::iWriteSettings() {
  CNString csFolder, csFile, csDir, csUserDir;
  GetDestination(csFolder);
  csFile.Printf("CNInstallWizard::iWriteSettings", "csFile", "%s\\config.ini", csFolder.Text());
  csDir.Printf("CNInstallWizard::iWriteSettings", "csDir", "%s\\", csFolder.Text());
  csUserDir.Printf("CNInstallWizard::iWriteSettings", "csUserDir", "%s\\New\\", csFolder.Text());
  const struct {
    const char* szKey;
    const char* szText;
  } entries[] = {{"Dir", csDir.Text()},
                 {"UserDir", csUserDir.Text()},
                 {"FirstTime", "1"},
                 {"User", szValue("name")},
                 {"Company", szValue("company")}};
  if (!bMayWriteSettings(csFile.Text()))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iWriteSettings -> !bMayWriteSettings(%s) -> return FUNCTION_ERROR",
                      csFile.Text());
  CNConfigFile settings(csFile.Text());
  for (const auto& entry : entries)
    if (settings.iWriteConfigString(entry.szKey, entry.szText) != EVERYTHING_IS_OK)
      return iLogReturn(FUNCTION_ERROR,
                        "ERROR: CNInstallWizard::iWriteSettings -> iWriteConfigString(%s) -> return FUNCTION_ERROR",
                        entry.szKey);
  return EVERYTHING_IS_OK;
}
