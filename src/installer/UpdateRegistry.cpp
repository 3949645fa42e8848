// The command UpdateRegistry: the entry in the system's list of installed programs and the product's settings file.
#include <windows.h>

#include <cstring>
#include <iterator>

#include "foundation/CNConfigFile.h"
#include "foundation/os/Os.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"
#include "installer/Programs.h"

int CNInstallWizard::iUpdateRegistry(const char* szParam, int* pCommandResult) {
  // "IT" are products that go online, "CNT" those that read dictionaries.
  static const struct {
    const char* szBranch;
    int (CNInstallWizard::*pMore)();
    const char* szWhat;
  } BRANCHES[] = {{"ND", nullptr, ""},
                  {"IT", &CNInstallWizard::iWriteOnlineSettings, "writing the settings file config.dat"},
                  {"CNT", &CNInstallWizard::iWriteProductKey, "writing the program's registry entries"}};
  const char* szName = szValue("program_name");
  CNString csKey, csFolder;
  if (!szParam)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNInstallWizard::iUpdateRegistry -> !szParam -> return PRECONDITIONS_NOT_VALID");
  const auto* pBranch = BRANCHES;
  while (pBranch != std::end(BRANCHES) && strcmp(szParam, pBranch->szBranch) != 0) pBranch++;
  if (pBranch == std::end(BRANCHES)) {
    *pCommandResult = COMMAND_NEGATIVE;
    return iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iUpdateRegistry -> !%s -> COMMAND_NEGATIVE", szParam);
  }
  if (!*szName)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iUpdateRegistry -> !program_name -> return FUNCTION_ERROR");
  GetDestination(csFolder);
  if (csFolder.bEmpty())
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iUpdateRegistry -> !default_path -> return FUNCTION_ERROR");
  csKey = Joined(INSTALLED_PROGRAMS, szName);
  const char* szFailed = nullptr;
  if (iAddRemoveProgram(csKey.Text(), csFolder.Text(), szName) != EVERYTHING_IS_OK)
    szFailed = "entering the program in the list of installed programs";
  else if (iWriteSettings() != EVERYTHING_IS_OK)
    szFailed = "writing the settings file config.ini";
  else if (pBranch->pMore && (this->*pBranch->pMore)() != EVERYTHING_IS_OK)
    szFailed = pBranch->szWhat;
  if (!szFailed) return iAnswer(pCommandResult, COMMAND_DONE);
  ShowNotComplete(szFailed);
  return FUNCTION_ERROR;
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
  const int iUninstall = iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, szKey, "UninstallString", csCommand.Text(), nullptr);
  return iUninstall == EVERYTHING_IS_OK ? iWriteEntryDetails(szKey, szPath) : iUninstall;
}

// What the system's list shows besides, and what programs that manage many computers read.
int CNInstallWizard::iWriteEntryDetails(const char* szKey, const char* szPath) {
  SYSTEMTIME now;
  CNString csQuiet, csDate, csSize, csIcon;
  GetLocalTime(&now);
  csQuiet.Printf("iWriteEntryDetails", "csQuiet", "\"%s\\UnInstall.exe\" /S \"%s\"", szPath, szPath);
  csDate.Printf("iWriteEntryDetails", "csDate", "%04d%02d%02d", now.wYear, now.wMonth, now.wDay);
  // Looking at thousands of files again would take longer than all the rest of the entry.
  uint64_t size = m_Extraction.copiedBytes;
  if (!size && strlen(szPath) > 2) size = FolderBytes(szPath, "*");
  csSize.Printf("iWriteEntryDetails", "csSize", "%u", static_cast<unsigned>(size / 1024));
  if (*szValue("program_file")) csIcon = Joined(szPath, "\\", szValue("program_file"));
  const struct {
    const char *szName, *szText, *szType;
  } values[] = {{"DisplayIcon", csIcon.Text(), nullptr},
                {"DisplayVersion", szValue("program_version"), nullptr},
                {"Publisher", szValue("publisher"), nullptr},
                {"InstallLocation", szPath, nullptr},
                {"InstallDate", csDate.Text(), nullptr},
                {"EstimatedSize", csSize.Text(), "HEX_VALUE"},
                {"NoModify", "1", "HEX_VALUE"},
                {"NoRepair", "1", "HEX_VALUE"},
                {"QuietUninstallString", csQuiet.Text(), nullptr}};
  for (const auto& value : values) {
    if (!*value.szText) continue;  // what the script does not give
    const int iResult = iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, szKey, value.szName, value.szText, value.szType);
    if (iResult != EVERYTHING_IS_OK) return iResult;
  }
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iWriteOnlineSettings() {
  CNString csFolder;
  GetDestination(csFolder);
  const CNString csFile = Joined(csFolder.Text(), "\\config.dat");
  InstallJournal journal(Joined(csFolder.Text(), "\\").Text());
  if (!journal.bOnFile("config.dat") ||
      CNConfigFile(csFile.Text()).iWriteConfigString("Proxy", szValue("proxy")) != EVERYTHING_IS_OK)
    return FUNCTION_ERROR;
  NoteWhole(journal, csFile.Text());
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iWriteProductKey() {
  CNString csFolder;
  GetDestination(csFolder);
  const bool bWritten = bWriteProductValue("Dir", Joined(csFolder.Text(), "\\").Text()) &&
                        bWriteProductValue("DictDir", Joined(csFolder.Text(), "\\dicts\\").Text());
  return bWritten ? EVERYTHING_IS_OK : FUNCTION_ERROR;
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
