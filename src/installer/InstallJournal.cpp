#include "installer/InstallJournal.h"

#include "archive/PathGuard.h"

const char InstallJournal::FILE_NAME[] = "Installed.lst";

InstallJournal::InstallJournal(const char* szFolder) : m_csFolder(szFolder, 0), m_csPath(szFolder, 0) {
  m_csPath.Concat(FILE_NAME);
}

// A list that is a link would have lines put at the end of some other file.
bool InstallJournal::bOpen() {
  return m_File.bIsOpen() ||
         (bNoLinkOnPath(m_csFolder.Text(), FILE_NAME) && m_File.bOpen(m_csPath.Text(), OsOpenMode::Append));
}

void InstallJournal::Append(char cKind, const char* szPath) {
  CNString csLine;
  if (m_bFailed) return;
  csLine.Printf("InstallJournal::Append", "csLine", "%c %s\r\n", cKind, szPath);
  // One write for each line: nothing is held back when the run breaks off.
  if (bOpen() && m_File.bWrite(csLine.Text(), static_cast<size_t>(csLine.Length()))) return;
  m_bFailed = true;
  LogPrintf("ERROR: InstallJournal::Append -> !bWrite(%s) -> return", m_csPath.Text());
}
