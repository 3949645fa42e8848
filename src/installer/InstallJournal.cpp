#include "installer/InstallJournal.h"

const char InstallJournal::FILE_NAME[] = "Installed.lst";

InstallJournal::InstallJournal(const char* szFolder) {
  m_csPath = szFolder;
  m_csPath.Concat(FILE_NAME);
}

void InstallJournal::Append(char cKind, const char* szPath) {
  CNString csLine;
  if (m_bFailed) return;
  csLine.Printf("InstallJournal::Append", "csLine", "%c %s\r\n", cKind, szPath);
  // One write for each line: nothing is held back when the run breaks off.
  if ((m_File.bIsOpen() || m_File.bOpen(m_csPath.Text(), OsOpenMode::Append)) &&
      m_File.bWrite(csLine.Text(), static_cast<size_t>(csLine.Length())))
    return;
  m_bFailed = true;
  LogPrintf("ERROR: InstallJournal::Append -> !bWrite(%s) -> return", m_csPath.Text());
}
