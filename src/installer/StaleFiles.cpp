#include "installer/StaleFiles.h"

#include <cstring>

#include "archive/PathGuard.h"

static CNString csJoined(const CNString& csFolder, const char* szName) {
  CNString csPath(csFolder.Text(), 0);
  csPath.Concat(szName);
  return csPath;
}

void StaleFiles::Read(const char* szFolder) {
  m_csFolder = szFolder;
  m_old.bRead(csJoined(m_csFolder, InstalledList::FILE_NAME).Text());
}

void StaleFiles::RemoveAll() {
  InstalledList list;
  const char* szOldName = m_old.szValue("program_name");
  if (!szOldName || !list.bRead(csJoined(m_csFolder, InstalledList::FILE_NAME).Text())) return;
  const char* szNewName = list.szValue("program_name");
  if (!szNewName || strcmp(szOldName, szNewName) != 0) return;
  for (int i = m_old.Size() - 1; i >= 0; i--) {
    if (m_old[i].cKind != 'F') continue;
    const InstalledList::Line* pLast = list.pFile(m_old[i].szText);
    if (pLast && pLast->iNumber == i) RemoveStale(list, *pLast);  // not named again since
  }
}

void StaleFiles::RemoveStale(const InstalledList& list, const InstalledList::Line& line) {
  CNString csPath;
  if (!bMakeSafePath(line.szText, csPath) || !bNoLinkOnPath(m_csFolder.Text(), csPath.Text())) return;
  const CNString csFull = csJoined(m_csFolder, csPath.Text());
  const InstalledFileState state = CheckInstalledFile(csFull.Text(), line);
  if (state == InstalledFileState::Changed)
    LogPrintf("INFO: StaleFiles::RemoveStale -> %s has been changed -> kept", csPath.Text());
  if (state != InstalledFileState::Same) return;
  bOsSetAttributes(csFull.Text(), OS_NORMAL);
  if (!bOsDeleteFile(csFull.Text())) {
    LogPrintf("ERROR: StaleFiles::RemoveStale -> !bOsDeleteFile(%s) -> return", csPath.Text());
    return;
  }
  LogPrintf("INFO: StaleFiles::RemoveStale -> %s -> removed", csPath.Text());
  for (int i = list.Size() - 1; i >= 0; i--) {
    if (list[i].cKind != 'D' || strncmp(list[i].szText, csPath.Text(), strlen(list[i].szText)) != 0) continue;
    CNString csFolder;
    if (csPath.Text()[strlen(list[i].szText)] == '\\' && bMakeSafePath(list[i].szText, csFolder))
      bOsDeleteFolder(csJoined(m_csFolder, csFolder.Text()).Text());  // stays when it is not empty
  }
}
