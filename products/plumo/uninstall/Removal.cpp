#include "Removal.h"

#include <cstring>

#include "System.h"
#include "archive/PathGuard.h"
#include "foundation/CNConfigFile.h"
#include "foundation/CNStream.h"
#include "foundation/ResultCodes.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsRegistry.h"

namespace {

const char LIST_FILE[] = "Installed.lst";
const char LOG_FILE[] = "Uninstall.log";
const char SETTINGS_FILE[] = "config.ini";
const char PROGRAMS_KEY[] = "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\";

CNString Joined(const char* szA, const char* szB, const char* szC = "") {
  CNString csText(szA, 0);
  csText.Concat(szB);
  csText.Concat(szC);
  return csText;
}

bool bEmptyFolder(const char* szPath) {
  bool bEmpty = true;
  auto pVisit = [](const OsFolderEntry&, void* pEmpty) { return *static_cast<bool*>(pEmpty) = false; };
  return bOsListFolder(szPath, pVisit, &bEmpty) && bEmpty;
}

// To be asked before a file is given to a configuration file object, which makes a missing one.
bool bIsFile(const char* szPath) {
  OsFileInfo info;
  return bOsGetFileInfo(szPath, info) && !(info.attributes & OS_DIRECTORY);
}

// The entry's argument, or null for a line of another kind.
const char* EntryOf(const char* szLine, char cKind) {
  return szLine[0] == cKind && szLine[1] == ' ' && szLine[2] ? szLine + 2 : nullptr;
}

}  // namespace

bool bReadInstallation(const char* szFolder, Installation& installation) {
  installation.csFolder = szFolder;
  installation.csFolder.AddSlash();
  CNString csLog = Joined(installation.csFolder.Text(), LOG_FILE);
  // Without the list nothing could be removed, and the records, which a repaired list would need, would be lost.
  if (!bIsFile(csLog.Text()) || !bIsFile(Joined(installation.csFolder.Text(), LIST_FILE).Text())) return false;
  CNConfigFile log(csLog.Text());
  return log.iReadConfigString("default_path", installation.csInstalledTo) == EVERYTHING_IS_OK &&
         log.iReadConfigString("program_name", installation.csProgramName) == EVERYTHING_IS_OK &&
         log.iReadConfigString("program_folder", installation.csProgramFolder) == EVERYTHING_IS_OK &&
         !installation.csProgramName.bEmpty();
}

Removal::Removal(const Installation& installation, const char* szOwnPath)
    : m_installation(installation), m_csOwnPath(szOwnPath, 0) {
  ReadList();
}

void Removal::ReadList() {
  CNFile list(Joined(m_installation.csFolder.Text(), LIST_FILE).Text(), "rb");
  if (list.bFileOpened() && list.lRead(m_csListText) > 0) m_lines.Set(m_csListText.Ptr(), "\r\n", false);
}

void Removal::RemoveAllButOwn() {
  // First, while what they lead to is still there.
  const auto pListed = [](const char* szPath, void* p) { return static_cast<Removal*>(p)->bListed(szPath); };
  RemoveShortcuts(m_installation.csFolder.Text(), m_installation.csProgramFolder.Text(), pListed, this, m_csFailures);
  for (int i = m_lines.Size() - 1; i >= 0; i--) {
    if (const char* szFile = EntryOf(m_lines[i], 'F')) RemoveFile(szFile);
    if (const char* szCopy = EntryOf(m_lines[i], 'W')) RemoveWindowsCopy(szCopy);
  }
  if (!m_bHeld) RemoveProgramsEntry();
  if (!m_bHeld) RemoveSettings();
  if (!m_bHeld) RemoveRecord(LOG_FILE);
  if (!m_bHeld && !m_bOwnRemains) RemoveRecord(LIST_FILE);  // the second step needs its folders
  RemoveFolders();
}

void Removal::RemoveOwn(const char* szTwin) {
  if (bSameFile(m_csOwnPath.Text(), szTwin))
    DeleteOrReport(m_csOwnPath.Text());
  else
    Report(m_csOwnPath.Text());
  RemoveRecord(LIST_FILE);
  RemoveFolders();
}

void Removal::RemoveFile(const char* szName) {
  CNString csPath;
  if (!bMakeSafePath(szName, csPath) || !bNoLinkOnPath(m_installation.csFolder.Text(), csPath.Text()))
    return Report(szName);
  CNString csFull = Joined(m_installation.csFolder.Text(), csPath.Text());
  if (bSameObject(csFull.Text(), m_csOwnPath.Text()))
    m_bOwnRemains = true;
  else
    DeleteOrReport(csFull.Text());
}

// The Windows folder belongs to everybody: only a copy of this very program is ours.
void Removal::RemoveWindowsCopy(const char* szName) {
  CNString csName, csPath;
  if (!bMakeSafePath(szName, csName) || strchr(csName.Text(), '\\') || !bWindowsFolder(csPath)) return Report(szName);
  csPath.AddSlash();
  csPath.Concat(csName.Text());
  if (bSameObject(csPath.Text(), m_csOwnPath.Text()))
    m_bOwnRemains = true;
  else if (bSameFile(csPath.Text(), m_csOwnPath.Text()))
    DeleteOrReport(csPath.Text());
}

// szPath is relative to the folder.
bool Removal::bListed(const char* szPath) const {
  for (int i = 0; i < m_lines.Size(); i++) {
    const char* szFile = EntryOf(m_lines[i], 'F');
    if (szFile && iOsCompareNoCase(szFile, szPath) == 0) return true;
  }
  return false;
}

// Only what setup wrote: the folder may have held another program's file of that name.
void Removal::RemoveSettings() {
  CNString csPath = Joined(m_installation.csFolder.Text(), SETTINGS_FILE), csDir, csUser;
  if (!bIsFile(csPath.Text())) return;
  CNConfigFile settings(csPath.Text());
  const bool bRead = settings.iReadConfigString("Dir", csDir) == EVERYTHING_IS_OK &&
                     settings.iReadConfigString("User", csUser) == EVERYTHING_IS_OK;
  if (bRead && !(csDir.bEmpty() && csUser.bEmpty())) RemoveRecord(SETTINGS_FILE);
}

void Removal::RemoveRecord(const char* szName) {
  DeleteOrReport(Joined(m_installation.csFolder.Text(), szName).Text());
}

void Removal::DeleteOrReport(const char* szPath) {
  OsFileInfo info;
  if (!bOsGetFileInfo(szPath, info)) return;  // somebody was faster
  if (info.attributes & OS_DIRECTORY) return Report(szPath);
  bOsSetAttributes(szPath, OS_NORMAL);
  // A program that has just ended may be held for a moment longer.
  for (int i = 0; i < 20; i++) {
    if (bOsDeleteFile(szPath)) return;
    OsSleep(50);
  }
  m_bHeld = true;
  Report(szPath);
}

void Removal::RemoveFolders() {
  for (int i = m_lines.Size() - 1; i >= 0; i--) {
    if (const char* szFolder = EntryOf(m_lines[i], 'D')) RemoveEmptyFolder(szFolder);
    if (const char* szFile = EntryOf(m_lines[i], 'F')) RemoveFoldersAbove(szFile);
  }
  RemoveDestination();
}

void Removal::RemoveFoldersAbove(const char* szName) {
  CNString csFolder(szName, 0);
  while (csFolder.Has('\\')) {
    csFolder.Trim('\\');
    RemoveEmptyFolder(csFolder.Text());
  }
}

// A folder that holds a user's file, or the running program, stays: that is no failure.
void Removal::RemoveEmptyFolder(const char* szName) {
  CNString csPath;
  if (!bMakeSafePath(szName, csPath) || !bNoLinkOnPath(m_installation.csFolder.Text(), csPath.Text())) return;
  CNString csFull = Joined(m_installation.csFolder.Text(), csPath.Text());
  if (!bEmptyFolder(csFull.Text())) return;
  bOsSetAttributes(csFull.Text(), OS_NORMAL);
  if (!bOsDeleteFolder(csFull.Text())) Report(csFull.Text());
}

// The destination, and the maker's folder around it when no other product is left there.
void Removal::RemoveDestination() {
  CNString csFolder(m_installation.csFolder.Text(), 0);
  csFolder.Trim('\\');
  if (!bEmptyFolder(csFolder.Text()) || !bOsDeleteFolder(csFolder.Text())) return;
  csFolder.Trim('\\');
  if (csFolder.EndsWith("\\Tavola") && bEmptyFolder(csFolder.Text())) bOsDeleteFolder(csFolder.Text());
}

// The command may spell the folder as it was given to setup or as it was given to us.
bool Removal::bStartsUs(const char* szCommand) const {
  CNString csFolder(m_installation.csFolder.Text(), 0);
  csFolder.Trim('\\');
  const char* szThen = m_installation.csInstalledTo.Text();
  const char* const spellings[] = {csFolder.Text(), szThen};
  for (const char* szFolder : spellings) {
    CNString csOurs = Joined(szFolder, "\\UnInstall.exe ", szFolder);
    if (iOsCompareNoCase(szCommand, csOurs.Text()) != 0) continue;
    return szFolder != szThen || bSameObject(szThen, m_installation.csFolder.Text());
  }
  return false;
}

// Only the entry that starts this folder's uninstaller: another installation may bear the same name.
void Removal::RemoveProgramsEntry() {
  if (m_installation.csProgramName.Has('\\')) return Report(m_installation.csProgramName.Text());
  CNString csKey = Joined(PROGRAMS_KEY, m_installation.csProgramName.Text());
  char szCommand[1024] = "";
  {
    OsRegistryKey key;
    OsRegType type = OsRegType::None;
    long lSize = 0;
    if (!key.bOpen(OS_HKEY_LOCAL_MACHINE, csKey.Text(), OsRegAccess::Read)) return;
    if (!key.bQuery("UninstallString", type, szCommand, sizeof(szCommand), lSize) || type != OsRegType::String) return;
  }
  if (bStartsUs(szCommand) && !bOsDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, csKey.Text())) Report(csKey.Text());
}

void Removal::Report(const char* szWhat) {
  m_csFailures.Concat(szWhat);
  m_csFailures.Concat("\n");
}
