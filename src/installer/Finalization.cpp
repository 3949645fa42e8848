// The command FinalizeInstallation: one table of steps, run in order. A step that fails makes it fail, and the user is
// told; only behind a shortcut the steps go on, so that an installation without it can still be removed.
#include <windows.h>

#include <cstring>

#include "foundation/CNConfigFile.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"
#include "installer/InstallJournal.h"

// "default_path" without a trailing backslash.
void CNInstallWizard::GetDestination(CNString& csFolder) {
  csFolder = szValue("default_path");
  if (csFolder.EndsWith("\\")) csFolder.SetLength(csFolder.Length() - 1);
}

void CNInstallWizard::ShowNotComplete(const char* szStep) {
  CNString csText;
  Tell(InstallEvent::StepFailed, szStep);
  csText.Printf(
      "CNInstallWizard::ShowNotComplete", "csText",
      "The installation is not complete.\n\nThis step failed: %s.\n\nThe files that were installed stay where "
      "they are. Please run Setup again.",
      szStep);
  m_View.iShowMessage({csText.Text(), szValue("msgbox_capt"), MessageIcon::Error});
}

int CNInstallWizard::iFinalizeInstallation(const char* szParam, int* pCommandResult) {
  struct Step {
    int (CNInstallWizard::*pRun)();
    const char* szWhat;
    bool bGoesOn;  // the next steps do not need this one
  };
  static const Step STEPS[] = {
      {&CNInstallWizard::iAddToProgramFolders, "making the shortcuts in the program folder", true},
      {&CNInstallWizard::iCreateDesktopShortcut, "making the desktop shortcut", true},
      {&CNInstallWizard::iCreateQuickLaunchShortcut, "making the Quick Launch shortcut", true},
      {&CNInstallWizard::iCheckNames, "reading the product's names from the installation script", false},
      {&CNInstallWizard::iCreateUninstallFile, "writing the uninstall record", false},
      {&CNInstallWizard::iRegisterWithShell, "registering file types and the context menu", true},
      {&CNInstallWizard::iInstallFonts, "installing the fonts", false},
      {&CNInstallWizard::iMoveUninstaller, "moving the uninstall program into the Windows folder", false},
  };
  if (!szParam)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNInstallWizard::iFinalizeInstallation -> !szParam -> return PRECONDITIONS_NOT_VALID");
  if (!m_pWizDialogInfo)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iFinalizeInstallation -> !m_pWizDialogInfo -> return FUNCTION_ERROR");
  CNString csFailed;
  for (const Step& step : STEPS) {
    if ((this->*step.pRun)() == EVERYTHING_IS_OK) continue;
    if (!csFailed.bEmpty()) csFailed.Concat(", ");
    csFailed.Concat(step.szWhat);
    if (!step.bGoesOn) break;
  }
  if (!csFailed.bEmpty()) {
    ShowNotComplete(csFailed.Text());
    return FUNCTION_ERROR;
  }
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iCheckNames() {
  if (!*szValue("program_name"))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iFinalizeInstallation -> !program_name -> return FUNCTION_ERROR");
  if (!*szValue("default_path"))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iFinalizeInstallation -> !default_path -> return FUNCTION_ERROR");
  if (!*szValue("program_folder"))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iFinalizeInstallation -> !program_folder -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}

// ---- the uninstall record ----

void CNInstallWizard::AddUndo(const char* szKey, const char* szItem) {
  CNString csFolder;
  GetDestination(csFolder);
  m_Record.Add(szKey, szItem, csFolder.Text());
}

// Writes the keys in their order; those behind the fourth only when they have something.
bool CNInstallWizard::bWriteRecord(const char* szFile) {
  static const char* const FIRST_KEYS[] = {"program_name", "program_folder", "default_path", "quick_launch"};
  CNConfigFile record(szFile);
  const auto bWrite = [&record](const char* szKey, const char* szText) {
    return !*szText || record.iWriteConfigString(szKey, szText) == EVERYTHING_IS_OK;
  };
  for (const char* szKey : FIRST_KEYS)
    if (record.iWriteConfigString(szKey, szValue(szKey)) != EVERYTHING_IS_OK) return false;
  bool bDone = bWrite("dict_path", szValue("dict_path"));
  for (int i = 0; i < UninstallRecord::KEY_COUNT; i++)
    bDone = bDone && bWrite(UninstallRecord::KEYS[i], m_Record.szItems(UninstallRecord::KEYS[i]));
  return bDone;
}

// Takes the old record's place in one step: whatever happens, there is a whole one.
int CNInstallWizard::iCreateUninstallFile() {
  CNString csFolder, csKey;
  GetDestination(csFolder);
  m_Record.Merge(csFolder.Text());
  GetMenuKey(csKey);
  // Made by a later step, but its place in the record is before the other things of later steps.
  if (strcmp(szValue("context_menu"), "1") == 0) AddUndo("context_menu", csKey.Text());
  const CNString csRecord = Joined(csFolder.Text(), "\\", UninstallRecord::FILE_NAME);
  const CNString csNew = Joined(csFolder.Text(), "\\Uninstall.new");
  bOsDeleteFile(csNew.Text());
  bOsSetAttributes(csRecord.Text(), OS_NORMAL);
  if (bWriteRecord(csNew.Text()) && bOsRename(csNew.Text(), csRecord.Text())) return EVERYTHING_IS_OK;
  bOsDeleteFile(csNew.Text());
  return iLogReturn(FUNCTION_ERROR,
                    "ERROR: CNInstallWizard::iFinalizeInstallation -> iCreateUninstallFile -> return FUNCTION_ERROR");
}

// ---- the uninstaller ----

static bool bGetWindowsFolder(CNString& csFolder) {
  wchar_t szFolder[260] = L"";
  const UINT uLength = GetWindowsDirectoryW(szFolder, 260);
  return uLength && uLength < 260 && bNarrowPath(szFolder, csFolder);
}

// Copies and then deletes, for the Windows folder may be on another drive. A second run finds the program moved
// already, which is as good.
static bool bMoveFile(const char* szFrom, const char* szTo) {
  if (!bOsExists(szFrom)) return bOsExists(szTo);
  bOsSetAttributes(szTo, OS_NORMAL);
  if (!CopyFileW(WidePath(szFrom), WidePath(szTo), FALSE)) return false;
  bOsSetAttributes(szFrom, OS_NORMAL);
  return bOsDeleteFile(szFrom);
}

int CNInstallWizard::iMoveUninstaller() {
  const char* szProgram = szValue("uninstall");
  if (!*szProgram) return EVERYTHING_IS_OK;  // a product without one
  CNString csDestination, csFrom, csTo;
  GetDestination(csDestination);
  csDestination.AddSlash();
  if (!bGetWindowsFolder(csTo))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iMoveUninstaller -> !bGetWindowsFolder -> return FUNCTION_ERROR");
  csFrom = csDestination;
  csFrom.Concat(szProgram);
  csTo.AddSlash();
  csTo.Concat(szProgram);
  // A product in the Windows folder has it there already, and listed as one of its files.
  if (iOsCompareNoCase(csFrom.Text(), csTo.Text()) == 0) return EVERYTHING_IS_OK;
  const bool bListed = !bOsExists(csFrom.Text()) || InstallJournal(csDestination.Text()).OnWindowsFile(szProgram);
  if (!bListed || !bMoveFile(csFrom.Text(), csTo.Text()))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iMoveUninstaller -> !bMoveFile -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}
