// The command FinalizeInstallation: one table of steps, run in order. A step that fails makes it fail, and the user is
// told; only behind a shortcut the steps go on, so that an installation without it can still be removed.
#include <windows.h>

#include "foundation/CNConfigFile.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "installer/CNInstallWizard.h"
#include "installer/InstallJournal.h"

// "default_path" without a trailing backslash.
void CNInstallWizard::GetDestination(CNString& csFolder) {
  csFolder = szValue("default_path");
  if (csFolder.EndsWith("\\")) csFolder.SetLength(csFolder.Length() - 1);
}

void CNInstallWizard::ShowNotComplete(const char* szStep) {
  CNString csText;
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

int CNInstallWizard::iCreateUninstallFile() {
  // The last two are for products that have them.
  static const struct {
    const char* szName;
    bool bAlways;
  } KEYS[] = {{"program_name", true}, {"program_folder", true}, {"default_path", true},
              {"quick_launch", true}, {"dict_path", false},     {"context_menu", false}};
  CNString csPath;
  GetDestination(csPath);
  csPath.Concat("\\Uninstall.log");
  bOsSetAttributes(csPath.Text(), OS_NORMAL);
  bOsDeleteFile(csPath.Text());
  CNConfigFile record(csPath.Text());
  for (const auto& key : KEYS)
    if ((key.bAlways || *szValue(key.szName)) &&
        record.iWriteConfigString(key.szName, szValue(key.szName)) != EVERYTHING_IS_OK)
      return iLogReturn(
          FUNCTION_ERROR,
          "ERROR: CNInstallWizard::iFinalizeInstallation -> iCreateUninstallFile -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
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
  const bool bFirst = bOsExists(csFrom.Text());
  if (!bMoveFile(csFrom.Text(), csTo.Text()))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iMoveUninstaller -> !bMoveFile -> return FUNCTION_ERROR");
  if (bFirst) InstallJournal(csDestination.Text()).OnWindowsFile(szProgram);
  return EVERYTHING_IS_OK;
}
