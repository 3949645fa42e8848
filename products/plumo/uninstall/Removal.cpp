#include "Removal.h"

#include <cstring>

#include "System.h"
#include "Traces.h"
#include "archive/PathGuard.h"
#include "foundation/CNConfigFile.h"
#include "foundation/CNStream.h"
#include "foundation/ResultCodes.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsRegistry.h"

namespace {

const char LOG_FILE[] = "Uninstall.log";
const char NEW_LOG_FILE[] = "Uninstall.new";  // before it takes the log's place
const char SETTINGS_FILE[] = "config.ini";

bool bEmptyFolder(const char* szPath) {
  bool bEmpty = true;
  auto pVisit = [](const OsFolderEntry&, void* pEmpty) { return *static_cast<bool*>(pEmpty) = false; };
  return bOsListFolder(szPath, pVisit, &bEmpty) && bEmpty;
}

// "config.ini.1a2b3c-4d.tmp" and the like: how a configuration file's new content is called before it takes its place.
bool bIsHalfRecord(const char* szName, const char* szRecord) {
  const size_t nRecord = strlen(szRecord);
  if (strlen(szName) <= nRecord) return false;
  CNString csHead;
  csHead.Copy(szName, static_cast<long>(nRecord));
  if (iOsCompareNoCase(csHead.Text(), szRecord) != 0 || szName[nRecord] != '.') return false;
  const char* sz = szName + nRecord + 1;
  const size_t nTime = strspn(sz, "0123456789abcdef");
  const size_t nThread = sz[nTime] == '-' ? strspn(sz + nTime + 1, "0123456789abcdef") : 0;
  return nTime && nThread && strcmp(sz + nTime + 1 + nThread, ".tmp") == 0;
}

}  // namespace

Removal::Removal(const Installation& installation, const char* szOwnPath, RunLog& log)
    : m_installation(installation), m_list(installation.list), m_log(log), m_csOwnPath(szOwnPath, 0) {}

void Removal::RemoveAllButOwn() {
  // First, while what they lead to is still there.
  RemoveTraces(m_installation, m_csFailures);
  RemoveShortcuts(m_installation, m_csFailures);
  RemoveMadeFolders(m_installation, m_csFailures);
  RemoveFiles();
  RemoveWindowsCopies();
  if (!m_bHeld) RemoveProgramsEntry();
  if (!m_bHeld) RemoveSettings();
  if (!m_bHeld) RemoveRecord(LOG_FILE);
  if (!m_bHeld) RemoveHalfRecords();
  if (m_bHeld || m_bOwnRemains)
    RemoveFolders();
  else
    RemoveLast();
}

void Removal::RemoveLast() {
  RemoveRecord(InstalledList::FILE_NAME);
  RemoveFolders();
  RemoveAnnouncedFolders();
}

void Removal::RemoveOwn(const char* szTwin) {
  if (bSameFile(m_csOwnPath.Text(), szTwin))
    DeleteOrReport(m_csOwnPath.Text());
  else if (bIsFile(m_csOwnPath.Text()))
    Report(m_csOwnPath.Text());
}

// Last first: of a path that stands there several times the last line counts.
void Removal::RemoveFiles() {
  for (int i = m_list.Size() - 1; i >= 0; i--)
    if (m_list[i].cKind == 'F' && m_list.pFile(m_list[i].szText) == &m_list[i]) RemoveFile(m_list[i]);
  // Without a list, this one is known all the same.
  const CNString csUninstaller = csJoined(m_installation.csFolder.Text(), "UnInstall.exe");
  if (m_installation.bHasList() || bIsOwn(csUninstaller.Text())) return;
  if (bSameFile(csUninstaller.Text(), m_csOwnPath.Text())) DeleteOrReport(csUninstaller.Text());
}

bool Removal::bIsOwn(const char* szPath) {
  const bool bOwn = bSameObject(szPath, m_csOwnPath.Text());
  m_bOwnRemains = m_bOwnRemains || bOwn;
  return bOwn;
}

void Removal::RemoveFile(const InstalledList::Line& line) {
  CNString csPath;
  if (!bMakeSafePath(line.szText, csPath) || !bNoLinkOnPath(m_installation.csFolder.Text(), csPath.Text()))
    return Report(line.szText);
  const CNString csFull = csJoined(m_installation.csFolder.Text(), csPath.Text());
  if (bIsOwn(csFull.Text())) return;
  // What has been changed since is the user's.
  if (CheckInstalledFile(csFull.Text(), line) == InstalledFileState::Same) DeleteOrReport(csFull.Text());
}

void Removal::RemoveWindowsCopies() {
  for (int i = 0; i < m_list.Size(); i++)
    if (m_list[i].cKind == 'W') RemoveWindowsCopy(m_list[i].szText);
  // The one that setup was about to make, or, when the records do not say, under its usual name.
  const CNString csUninstall = m_installation.csValue("uninstall");
  RemoveWindowsCopy(csUninstall.bEmpty() ? "UnInstall01.exe" : csUninstall.Text());
}

// The Windows folder belongs to everybody: only a copy of what was installed, or the first half of one, is ours.
void Removal::RemoveWindowsCopy(const char* szName) {
  CNString csName, csPath;
  if (!bMakeSafePath(szName, csName) || strchr(csName.Text(), '\\') || !bWindowsFolder(csPath)) return Report(szName);
  csPath.AddSlash();
  csPath.Concat(csName.Text());
  if (!bIsOwn(csPath.Text()) && bOurWindowsCopy(csPath.Text(), szName)) DeleteOrReport(csPath.Text());
}

bool Removal::bOurWindowsCopy(const char* szPath, const char* szName) const {
  const InstalledList::Line* pLine = m_list.pFile(szName);
  const bool bAsListed = pLine && pLine->bMarked && CheckInstalledFile(szPath, *pLine) == InstalledFileState::Same;
  return bAsListed || bBeginsWith(m_csOwnPath.Text(), szPath);
}

// Only what setup wrote: the folder may have held another program's file of that name.
void Removal::RemoveSettings() {
  const CNString csPath = csJoined(m_installation.csFolder.Text(), SETTINGS_FILE);
  CNString csDir, csUser;
  if (!bIsFile(csPath.Text())) return;
  for (int i = 0; i < m_list.Size(); i++)
    if (m_list[i].cKind == 'R' && iOsCompareNoCase(m_list[i].szText, SETTINGS_FILE) == 0)
      return RemoveRecord(SETTINGS_FILE);
  CNConfigFile settings(csPath.Text());
  const bool bRead = settings.iReadConfigString("Dir", csDir) == EVERYTHING_IS_OK &&
                     settings.iReadConfigString("User", csUser) == EVERYTHING_IS_OK;
  if (bRead && !(csDir.bEmpty() && csUser.bEmpty())) RemoveRecord(SETTINGS_FILE);
}

// A run that was killed while it wrote a record has left the new content beside it.
void Removal::RemoveHalfRecords() {
  const auto visit = [](const OsFolderEntry& entry, void* pContext) {
    const bool bFile = !(entry.info.attributes & (OS_DIRECTORY | OS_REPARSE_POINT));
    for (const char* szRecord : {LOG_FILE, NEW_LOG_FILE, SETTINGS_FILE})
      if (bFile && bIsHalfRecord(entry.csName.Text(), szRecord))
        static_cast<Removal*>(pContext)->RemoveRecord(entry.csName.Text());
    return true;
  };
  bOsListFolder(m_installation.csFolder.Text(), visit, this);
  if (m_list.szValue("program_name")) RemoveRecord(NEW_LOG_FILE);
}

void Removal::RemoveRecord(const char* szName) {
  DeleteOrReport(csJoined(m_installation.csFolder.Text(), szName).Text());
}

void Removal::DeleteOrReport(const char* szPath) {
  OsFileInfo info;
  if (!bOsGetFileInfo(szPath, info)) return;  // somebody was faster
  if (info.attributes & OS_DIRECTORY) return Report(szPath);
  bOsSetAttributes(szPath, OS_NORMAL);
  // A program that has just ended may be held for a moment longer.
  for (int i = 0; i < 20; i++) {
    if (bOsDeleteFile(szPath)) return m_log.Line("deleted: %s", szPath);
    OsSleep(50);
  }
  m_bHeld = true;
  Report(szPath);
}

void Removal::RemoveFolders() {
  for (int i = m_list.Size() - 1; i >= 0; i--) {
    if (m_list[i].cKind == 'D') RemoveEmptyFolder(m_list[i].szText);
    if (m_list[i].cKind == 'F') RemoveFoldersAbove(m_list[i].szText);
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

bool Removal::bDeleteFolder(const char* szPath) {
  if (!bOsDeleteFolder(szPath)) return false;
  m_log.Line("deleted: %s", szPath);
  return true;
}

// A folder that holds a user's file, or the running program, stays: that is no failure.
void Removal::RemoveEmptyFolder(const char* szName) {
  CNString csPath;
  if (!bMakeSafePath(szName, csPath) || !bNoLinkOnPath(m_installation.csFolder.Text(), csPath.Text())) return;
  CNString csFull = csJoined(m_installation.csFolder.Text(), csPath.Text());
  if (!bEmptyFolder(csFull.Text())) return;
  bOsSetAttributes(csFull.Text(), OS_NORMAL);
  if (!bDeleteFolder(csFull.Text())) Report(csFull.Text());
}

namespace {

// The folders of the list that szFolder lies in, or that are it, when they are empty. True when there is any such line.
bool bRemoveFoldersAround(const InstalledList& list, const char* szFolder) {
  bool bAny = false;
  for (int i = list.Size() - 1; i >= 0; i--) {
    const size_t nLength = strlen(list[i].szText);
    if (list[i].cKind != 'P' || nLength > strlen(szFolder) || (szFolder[nLength] && szFolder[nLength] != '\\'))
      continue;
    CNString csHead;
    csHead.Copy(szFolder, static_cast<long>(nLength));
    if (iOsCompareNoCase(csHead.Text(), list[i].szText) != 0) continue;
    bAny = true;
    if (bEmptyFolder(csHead.Text())) bOsDeleteFolder(csHead.Text());
  }
  return bAny;
}

}  // namespace

// The destination, what was made to hold it, and the maker's folder around it when no other product is left there.
void Removal::RemoveDestination() {
  CNString csFolder(m_installation.csFolder.Text(), 0);
  csFolder.Trim('\\');
  if (!bEmptyFolder(csFolder.Text()) || !bDeleteFolder(csFolder.Text())) return;
  CNString csAbove(csFolder.Text(), 0);
  csAbove.Trim('\\');
  if (csAbove.EndsWith("\\Tavola") && bEmptyFolder(csAbove.Text())) bDeleteFolder(csAbove.Text());
  bRemoveFoldersAround(m_list, csFolder.Text());
}

// A run that was killed early has told in the temporary folder what it was about to make.
void Removal::RemoveAnnouncedFolders() {
  CNString csFile, csFolder(m_installation.csFolder.Text(), 0);
  InstalledList announced;
  csFolder.Trim('\\');
  if (!bOsGetTempFolder(csFile)) return;
  csFile.Concat(InstalledList::FOLDERS_FILE);
  if (announced.bRead(csFile.Text()) && bRemoveFoldersAround(announced, csFolder.Text())) bOsDeleteFile(csFile.Text());
}

// Only the entry that starts this folder's uninstaller, for another installation may bear the same name, or one that
// starts nothing, as a broken installation leaves it.
void Removal::RemoveProgramsEntry() {
  const CNString& csName = m_installation.csProgramName;
  if (csName.Has('\\')) return Report(csName.Text());
  if (csName.bEmpty()) return;
  const CNString csKey = csJoined(PROGRAMS_KEY, csName.Text());
  CNString csCommand, csShown;
  const bool bCommand = bReadRegistryText(OS_HKEY_LOCAL_MACHINE, csKey.Text(), "UninstallString", csCommand);
  const bool bShown = bReadRegistryText(OS_HKEY_LOCAL_MACHINE, csKey.Text(), "DisplayName", csShown);
  const bool bHalf = !bCommand && bShown && csShown.IsEqual(csName.Text());
  if (!bHalf && !(bCommand && m_installation.bStartsUs(csCommand.Text()))) return;
  if (!bOsDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, csKey.Text())) return Report(csKey.Text());
  m_log.Line("deleted: %s", csKey.Text());
}

namespace {

struct KeptWalk {
  CNString csFolder;
  CNString* pKept;
  const char* szOwnPath;
  int iCount;
};

bool bVisitKept(const OsFolderEntry& entry, void* pContext) {
  KeptWalk& walk = *static_cast<KeptWalk*>(pContext);
  const CNString csPath = csJoined(walk.csFolder.Text(), entry.csName.Text());
  if ((entry.info.attributes & (OS_DIRECTORY | OS_REPARSE_POINT)) == OS_DIRECTORY) {
    KeptWalk below = {csJoined(csPath.Text(), "\\"), walk.pKept, walk.szOwnPath, walk.iCount};
    bOsListFolder(csPath.Text(), bVisitKept, &below);
    walk.iCount = below.iCount;
  } else if (!bSameObject(csPath.Text(), walk.szOwnPath) &&
             iOsCompareNoCase(entry.csName.Text(), InstalledList::FILE_NAME) != 0) {
    walk.pKept->Concat(csJoined(csPath.Text(), "\n").Text());
    walk.iCount++;
  }
  return walk.iCount < 20;  // more would not fit on the screen
}

}  // namespace

void Removal::FindKept() {
  KeptWalk walk = {m_installation.csFolder, &m_csKept, m_csOwnPath.Text(), 0};
  bOsListFolder(m_installation.csFolder.Text(), bVisitKept, &walk);
}

void Removal::Report(const char* szWhat) {
  m_csFailures.Concat(szWhat);
  m_csFailures.Concat("\n");
}
