// The shortcuts of an installation. The last page describes them in two hidden lists, "program" and "deinstall", of
// five items each: where, the folder in the start menu, the target in the destination, the link's file name, the start
// of its description. Every list gets a link in the start menu's folder. "desktop_shortcut" as the first item means: on
// the desktop and in the quick-launch bar too, each if its variable is "1"; "programs_folder" means: nowhere else.
#include <cstring>

#include "archive/PathGuard.h"
#include "controls/Kinds.h"
#include "foundation/os/Os.h"
#include "installer/CNInstallWizard.h"
#include "installer/InstallJournal.h"
#include "installer/ShellFolder.h"
#include "installer/ShellLinks.h"

enum ShortcutItem : int { ITEM_WHERE, ITEM_FOLDER, ITEM_TARGET, ITEM_LINK, ITEM_DESCRIPTION, ITEM_COUNT };

// The list's description in the current dialog; null (logged) when there is none or it has fewer items than needed.
const CNListBox* CNInstallWizard::pShortcutList(const char* szName) const {
  const BaseControl* pControl = m_pWizDialogInfo->GetBaseControl(szName);
  const bool bList = pControl && pControl->Kind() == ControlKind::ListBox;
  const CNListBox* pList = bList ? static_cast<const CNListBox*>(pControl) : nullptr;
  if (pList && pList->m_Items.Size() >= ITEM_COUNT) return pList;
  LogPrintf("INFO: CNInstallWizard::pShortcutList -> no list '%s' -> no shortcut", szName);
  return nullptr;
}

void CNInstallWizard::GetListItem(const CNListBox& list, int iItem, CNString& csText) {
  csText = list.m_Items[iItem];
  if (!csText.bEmpty()) iReplaceVarWithText(csText);
}

// Makes the link that the list describes in szFolder, which is made when missing. A missing list makes no link.
int CNInstallWizard::iCreateShortcut(const char* szList, const char* szFolder) {
  const CNListBox* pList = pShortcutList(szList);
  if (!pList) return EVERYTHING_IS_OK;
  ShellLink link;
  CNString csTarget, csName, csLinkPath;
  GetListItem(*pList, ITEM_TARGET, csTarget);
  GetListItem(*pList, ITEM_LINK, csName);
  GetListItem(*pList, ITEM_DESCRIPTION, link.csDescription);
  GetDestination(link.csWorkingFolder);
  link.csTarget.Printf("iCreateShortcut", "csTarget", "%s\\%s", link.csWorkingFolder.Text(), csTarget.Text());
  link.csIcon = link.csTarget;
  link.csDescription.Concat(link.csWorkingFolder.Text());
  if (strcmp(szList, "deinstall") == 0) {
    const bool bQuote = link.csWorkingFolder.Has(' ') != 0;
    link.csArguments.Printf("iCreateShortcut", "csArguments", bQuote ? "\"%s\"" : "%s", link.csWorkingFolder.Text());
  }
  if (link.csWorkingFolder.EndsWith(":")) link.csWorkingFolder.AddSlash();  // a drive's root, not its current folder
  if (iCreateDirectory(szFolder) != EVERYTHING_IS_OK) return FUNCTION_ERROR;
  csLinkPath.Printf("iCreateShortcut", "csLinkPath", "%s\\%s", szFolder, csName.Text());
  CNString csDestination;
  GetDestination(csDestination);
  csDestination.AddSlash();
  // Half a link leads nowhere: without its name the uninstaller could not tell whose it is.
  if (!bOsExists(csLinkPath.Text())) InstallJournal(csDestination.Text()).bOnValue("links", csLinkPath.Text());
  return iCreateLink(link, csLinkPath.Text());
}

// As the file system does with the name of a folder: the uninstaller is to find the same one.
void CNInstallWizard::TrimProgramFolder() {
  CNString csName(szValue("program_folder"), 0);
  while (csName.EndsWith(" ") || csName.EndsWith(".") || csName.EndsWith("\\")) csName.SetLength(csName.Length() - 1);
  if (csName.Length() < static_cast<long>(strlen(szValue("program_folder"))))
    iSetVariable("program_folder", csName.Text());
}

int CNInstallWizard::iAddToProgramFolders() {
  CNString csPrograms;
  TrimProgramFolder();
  if (!bGetShellFolder("Common Programs", "Programs", csPrograms))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iAddToProgramFolders -> iReadRegistryKey -> return FUNCTION_ERROR");
  for (const char* szList : {"program", "deinstall"}) {
    const CNListBox* pList = pShortcutList(szList);
    if (!pList) continue;
    CNString csFolder = csPrograms, csName, csBelow;
    GetListItem(*pList, ITEM_FOLDER, csName);
    csFolder.AddSlash();
    // What was typed must not lead out of the start menu: nobody would look for the shortcuts elsewhere.
    const bool bSafe = csName.bEmpty() || bMakeSafePath(csName.Text(), csBelow);
    csFolder.Concat(csBelow.Text());
    if (!bSafe || iCreateShortcut(szList, csFolder.Text()) != EVERYTHING_IS_OK)
      return iLogReturn(FUNCTION_ERROR,
                        "ERROR: CNInstallWizard::iAddToProgramFolders -> iCreateLink -> return FUNCTION_ERROR");
  }
  return EVERYTHING_IS_OK;
}

// True when the list asks for more than the program folder and the user has asked for this place.
static bool bWanted(const CNListBox* pList, const char* szChoice) {
  return pList && strcmp(pList->m_Items[ITEM_WHERE], "desktop_shortcut") == 0 && strcmp(szChoice, "1") == 0;
}

int CNInstallWizard::iCreateDesktopShortcut() {
  if (!bWanted(pShortcutList("program"), szValue("desktop_shortcut"))) return EVERYTHING_IS_OK;
  CNString csDesktop;
  if (!bGetShellFolder("Common Desktop", "Desktop", csDesktop))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCreateDesktopShortcut -> iReadRegistryKey -> return FUNCTION_ERROR");
  if (iCreateShortcut("program", csDesktop.Text()) != EVERYTHING_IS_OK)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCreateDesktopShortcut -> iCreateLink -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iCreateQuickLaunchShortcut() {
  if (!bWanted(pShortcutList("program"), szValue("quick_launch"))) return EVERYTHING_IS_OK;
  CNString csFolder;
  if (!bGetShellFolder(nullptr, "AppData", csFolder))
    return iLogReturn(
        FUNCTION_ERROR,
        "ERROR: CNInstallWizard::iCreateQuickLaunchShortcut -> iReadRegistryKey -> return FUNCTION_ERROR");
  csFolder.Concat("\\Microsoft\\Internet Explorer\\Quick Launch");
  if (iCreateShortcut("program", csFolder.Text()) != EVERYTHING_IS_OK)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCreateQuickLaunchShortcut -> iCreateLink -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}
