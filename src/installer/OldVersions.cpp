// Earlier installations and the maker's other products: found, proposed, kept, cleared of their shortcuts.
#include <cstring>

#include "archive/PathGuard.h"
#include "foundation/CNConfigFile.h"
#include "foundation/CNSystem.h"
#include "foundation/os/Os.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"
#include "installer/Programs.h"
#include "installer/ShellFolder.h"
#include "installer/ShellLinks.h"

// ---- what an installation says of itself ----

// A value of the uninstall record in szFolder; empty without one.
static void ReadRecord(const char* szFolder, const char* szKey, CNString& csValue) {
  const CNString csFile = Joined(szFolder, "\\", UninstallRecord::FILE_NAME);
  csValue = "";
  if (bOsExists(csFile.Text())) CNConfigFile(csFile.Text()).iReadConfigString(szKey, csValue);
}

// The folder below the one for programs that an earlier version proposed, when its record is there.
static bool bFindByRecord(const char* szOldDefault, CNString& csFolder) {
  char szPrograms[512] = "";
  if (!*szOldDefault ||
      COrbitWizard::iReadRegistryKey(OS_HKEY_LOCAL_MACHINE, "SOFTWARE\\Microsoft\\Windows\\CurrentVersion",
                                     "ProgramFilesDir", szPrograms) != EVERYTHING_IS_OK)
    return false;
  csFolder = Joined(szPrograms, "\\", szOldDefault);
  CNString csName;
  ReadRecord(csFolder.Text(), "program_name", csName);
  return !csName.bEmpty();
}

bool CNInstallWizard::bFindOldVersion(const char* szNames, CNString& csFolder) {
  const TextList names(szNames);
  for (int i = 0; i < names.Size(); i++)
    if (bFindInstalled(names[i], csFolder)) return true;
  return bFindByRecord(szValue("old_def_path"), csFolder);
}

int CNInstallWizard::iCheckForOldVersion(const char* szParam, int* pCommandResult) {
  CNString csFolder;
  const bool bFound = bFindOldVersion(szOr(szParam, szValue("program_name")), csFolder);
  iSetVariable("upgrade", bFound ? "1" : "0");
  if (!bFound) return iAnswer(pCommandResult, COMMAND_NEGATIVE);
  m_bDefaultPathInitialised = true;  // a full path, which needs nothing in front
  iSetVariable("old_path", csFolder.Text());
  iSetVariable("path", csFolder.Text());
  if (!m_bDestinationGiven) iSetField("default_path", csFolder.Text());
  return iAnswer(pCommandResult, COMMAND_DONE);
}

// ---- old shortcuts ----

namespace {

struct LinkSweep {
  const char* szTarget;  // the folder that the shortcuts lead into
  CNString csPlace;
};

bool bRemoveOldLink(const OsFolderEntry& entry, void* pContext) {
  const LinkSweep& sweep = *static_cast<const LinkSweep*>(pContext);
  const CNString csPath = Joined(sweep.csPlace.Text(), "\\", entry.csName.Text());
  const bool bLink = csPath.Length() > 4 && iOsCompareNoCase(csPath.Text() + csPath.Length() - 4, ".lnk") == 0;
  ShellLink link;
  if (!bLink || iResolveIt(csPath.Text(), link) != EVERYTHING_IS_OK || !bIsBelow(link.csTarget.Text(), sweep.szTarget))
    return true;
  if (!bOsDeleteFile(csPath.Text()))
    LogPrintf("ERROR: CNInstallWizard::iRemoveOldLinks -> !bOsDeleteFile(%s)", csPath.Text());
  return true;
}

const struct {
  const char *szCommon, *szUser, *szBelow;
  bool bProgramFolder;
} LINK_PLACES[] = {{"Common Programs", nullptr, "\\", true},
                   {nullptr, "Programs", "\\", true},
                   {"Common Desktop", nullptr, "", false},
                   {nullptr, "Desktop", "", false},
                   {nullptr, "AppData", "\\Microsoft\\Internet Explorer\\Quick Launch", false}};

void RemoveLinks(const char* szTarget, const char* szProgramFolder) {
  for (const auto& place : LINK_PLACES) {
    LinkSweep sweep = {szTarget, CNString()};
    CNString csSafe;
    if (place.bProgramFolder && !bMakeSafePath(szProgramFolder, csSafe)) continue;
    if (!bGetShellFolder(place.szCommon, place.szUser, sweep.csPlace)) continue;
    sweep.csPlace = Joined(sweep.csPlace.Text(), place.szBelow, csSafe.Text());
    bOsListFolder(sweep.csPlace.Text(), bRemoveOldLink, &sweep);
    if (place.bProgramFolder) bOsDeleteFolder(sweep.csPlace.Text());  // stays when it is not empty
  }
}

}  // namespace

int CNInstallWizard::iRemoveOldLinks(const char* /*szParam*/, int* pCommandResult) {
  CNString csDestination, csOldFolder;
  GetDestination(csDestination);
  if (csDestination.bEmpty())
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iRemoveOldLinks -> !default_path -> return FUNCTION_ERROR");
  for (const char* szTarget : {static_cast<const char*>(csDestination.Text()), szValue("old_path")}) {
    if (!*szTarget) continue;
    ReadRecord(szTarget, "program_folder", csOldFolder);
    RemoveLinks(szTarget, szValue("program_folder"));
    if (!csOldFolder.bEmpty() && !csOldFolder.IsEqual(szValue("program_folder")))
      RemoveLinks(szTarget, csOldFolder.Text());
  }
  return iAnswer(pCommandResult, COMMAND_DONE);
}

// ---- other products ----

// Copied under another name first: only a whole copy gets the name that counts.
int CNInstallWizard::iBackupOldHalvex(const char* /*szParam*/, int* pCommandResult) {
  CNString csFolder;
  if (!bFindInstalled(szOr(szValue("halvex_name"), "Halvex"), csFolder))
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iBackupOldHalvex -> !halvex_name -> nothing to keep");
  const CNString csBackup = Joined(csFolder.Text(), ".old"), csPart = Joined(csBackup.Text(), ".part");
  iSetVariable("halvex_backup", csBackup.Text());
  if (bOsIsFolder(csBackup.Text())) return iAnswer(pCommandResult, COMMAND_DONE);  // never over an older copy
  if (bOsIsFolder(csPart.Text())) CNSystem::iDeleteFolderAndSubFolders(csPart.Text());
  if (OsMakeFolder(csPart.Text()) != OsMakeFolderResult::Made || !CNSystem::CopyAll(csFolder.Text(), csPart.Text()) ||
      FolderBytes(csPart.Text(), "*") != FolderBytes(csFolder.Text(), "*") ||
      !bOsRename(csPart.Text(), csBackup.Text()))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iBackupOldHalvex -> !CopyAll(%s) -> return FUNCTION_ERROR",
                      csFolder.Text());
  return iAnswer(pCommandResult, COMMAND_DONE);
}

// In the system's list, or with a folder of its name in the start menu.
static bool bIsInstalled(const char* szProduct) {
  CNString csFolder, csSafe;
  if (bFindInstalled(szProduct, csFolder)) return true;
  for (const auto& place : LINK_PLACES)
    if (place.bProgramFolder && bMakeSafePath(szProduct, csSafe) &&
        bGetShellFolder(place.szCommon, place.szUser, csFolder) &&
        bOsIsFolder(Joined(csFolder.Text(), "\\", csSafe.Text()).Text()))
      return true;
  return false;
}

int CNInstallWizard::iCheckForInstalledSoftware(const char* /*szParam*/, int* pCommandResult) {
  const TextList products(szOr(szValue("products"), szValue("program_name")));
  CNString csFound;
  csFound = "";
  for (int i = 0; i < products.Size(); i++)
    if (bIsInstalled(products[i])) csFound = Joined(csFound.Text(), csFound.bEmpty() ? "" : ";", products[i]);
  iSetVariable("installed_products", csFound.Text());
  return iAnswer(pCommandResult, csFound.bEmpty() ? COMMAND_NEGATIVE : COMMAND_DONE);
}

int CNInstallWizard::iAddColvaneToOldInstallation(const char* /*szParam*/, int* pCommandResult) {
  const char* szName = szValue("program_name");
  CNString csOld, csFolder, csSafe, csPrograms;
  csOld = szValue("old_path");
  if (csOld.bEmpty() && !bFindOldVersion(szName, csOld)) csOld = "";
  ReadRecord(csOld.Text(), "program_folder", csFolder);
  if (!bMakeSafePath(csFolder.Text(), csSafe) || !bGetShellFolder("Common Programs", "Programs", csPrograms))
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK,
                      "INFO: CNInstallWizard::iAddColvaneToOldInstallation -> !program_folder -> no shortcut");
  char szVersion[512] = "";
  iReadRegistryKey(OS_HKEY_LOCAL_MACHINE, Joined(INSTALLED_PROGRAMS, szName).Text(), "DisplayVersion", szVersion);
  iSetVariable("colvane_ver", szVersion);
  csFolder = Joined(csPrograms.Text(), "\\", csSafe.Text());
  if (iCreateDirectory(csFolder.Text()) != EVERYTHING_IS_OK || !bAddLink(csFolder.Text(), "")) return FUNCTION_ERROR;
  return iAnswer(pCommandResult, COMMAND_DONE);
}

// Makes a shortcut to the program in a folder where the uninstaller does not look by itself. An empty target is the
// program in the destination.
bool CNInstallWizard::bAddLink(const char* szFolder, const char* szTarget) {
  ShellLink link;
  CNString csName;
  csName = szValue("colvane_link");
  if (csName.bEmpty()) csName = Joined(szValue("program_name"), ".lnk");
  GetDestination(link.csWorkingFolder);
  link.csTarget =
      *szTarget ? Joined(szTarget, "")
                : Joined(link.csWorkingFolder.Text(), "\\", szOr(szValue("colvane_file"), szValue("program_file")));
  if (*szTarget) link.csWorkingFolder = "";
  link.csIcon = link.csTarget;
  const CNString csPath = Joined(szFolder, "\\", csName.Text());
  AddUndo("net_links", csPath.Text());
  return iCreateLink(link, csPath.Text()) == EVERYTHING_IS_OK;
}

// ---- registry ----

// Parameter: "ROOT\key", "ROOT\key;value" or "ROOT\key;value;text".
int CNInstallWizard::iCheckRegistryEntry(const char* szParam, int* pCommandResult) {
  static const struct {
    const char* szName;
    OsRegKey hRoot;
  } ROOTS[] = {{"HKLM", OS_HKEY_LOCAL_MACHINE}, {"HKEY_LOCAL_MACHINE", OS_HKEY_LOCAL_MACHINE},
               {"HKCU", OS_HKEY_CURRENT_USER},  {"HKEY_CURRENT_USER", OS_HKEY_CURRENT_USER},
               {"HKCR", OS_HKEY_CLASSES_ROOT},  {"HKEY_CLASSES_ROOT", OS_HKEY_CLASSES_ROOT}};
  CNString csParam(szParam, 0), csRoot;
  CNCharArray parts;  // the second may be empty: the key's default value
  parts.Set(csParam.Ptr(), ";", false);
  const char* pKey = parts.Size() ? strchr(parts[0], '\\') : nullptr;
  if (pKey) csRoot.Copy(parts[0], static_cast<long>(pKey - parts[0]));
  for (const auto& row : ROOTS) {
    if (!pKey || iOsCompareNoCase(csRoot.Text(), row.szName) != 0) continue;
    char szText[512] = "";
    OsRegistryKey key;
    bool bThere = key.bOpen(row.hRoot, pKey + 1, OsRegAccess::Read);
    if (bThere && parts.Size() > 1)
      bThere = iReadRegistryKey(row.hRoot, pKey + 1, parts[1], szText) == EVERYTHING_IS_OK &&
               (parts.Size() == 2 || strcmp(szText, parts[2]) == 0);
    return iAnswer(pCommandResult, bThere ? COMMAND_DONE : COMMAND_NEGATIVE);
  }
  return iLogReturn(PRECONDITIONS_NOT_VALID,
                    "ERROR: CNInstallWizard::iCheckRegistryEntry -> !szRoot(%s) -> return PRECONDITIONS_NOT_VALID",
                    szParam);
}
