#include "installer/InstallJournal.h"

#include "archive/PathGuard.h"

InstallJournal::InstallJournal(const char* szFolder) : m_csFolder(szFolder, 0), m_csPath(szFolder, 0) {
  m_csPath.Concat(InstalledList::FILE_NAME);
}

static bool bEndsWithinLine(const char* szPath) {
  OsFile file;
  char cLast = '\n';
  const int64_t size = file.bOpen(szPath, OsOpenMode::Read) ? file.Size() : 0;
  if (size > 0 && file.bSeek(static_cast<uint64_t>(size) - 1)) file.lRead(&cLast, 1);
  return cLast != '\n';
}

// A list that is a link would have lines put at the end of some other file.
bool InstallJournal::bOpen() {
  if (m_File.bIsOpen()) return true;
  if (!bNoLinkOnPath(m_csFolder.Text(), InstalledList::FILE_NAME)) return false;
  m_bTorn = bEndsWithinLine(m_csPath.Text());
  return m_File.bOpen(m_csPath.Text(), OsOpenMode::Append);
}

void InstallJournal::OnFileDone(const ArchiveFileMark& mark) {
  m_bytes += mark.size;
  // Goes out together with the next line: a write for each file is enough. A run killed before that left a whole file
  // that counts as half of one.
  m_csPending.Printf("InstallJournal::OnFileDone", "m_csPending", "S %lx%08lx %lx%08lx %lx\r\n",
                     static_cast<unsigned long>(mark.size >> 32), static_cast<unsigned long>(mark.size & 0xffffffff),
                     static_cast<unsigned long>(mark.lastWrite >> 32),
                     static_cast<unsigned long>(mark.lastWrite & 0xffffffff), static_cast<unsigned long>(mark.sum));
}

bool InstallJournal::bOnValue(const char* szKey, const char* szValue) {
  CNString csLine;
  AddLine(csLine, 'V', szKey, szValue);
  return bAddLines(csLine.Text());
}

bool InstallJournal::bAppend(char cKind, const char* szText) {
  CNString csLine;
  AddLine(csLine, cKind, szText);
  return bAddLines(csLine.Text());
}

void InstallJournal::AddLine(CNString& csLines, char cKind, const char* szText, const char* szValue) {
  CNString csLine;
  csLine.Printf("InstallJournal::AddLine", "csLine", szValue ? "%c %s=%s" : "%c %s", cKind, szText, szValue);
  for (char* p = csLine.Ptr(); p && *p; p++)
    if (static_cast<unsigned char>(*p) < ' ') *p = ' ';
  csLines.Concat(csLine.Text());
  csLines.Concat("\r\n");
}

// One write: nothing is held back when the run breaks off. A line that was cut, now or by an earlier run, is ended in a
// way that its reader knows.
bool InstallJournal::bAddLines(const char* szLines) {
  if (!bOpen()) {
    if (!m_bFailed) LogPrintf("ERROR: InstallJournal::bAddLines -> !bOpen(%s) -> return false", m_csPath.Text());
    m_bFailed = true;
    return false;
  }
  CNString csText(m_bTorn ? "|\r\n" : "", 0);
  csText.Concat(m_csPending.Text());
  csText.Concat(szLines);
  m_csPending.Free();
  const bool bWritten = m_File.bWrite(csText.Text(), static_cast<size_t>(csText.Length()));
  m_bTorn = !bWritten;
  if (bWritten) return true;
  if (!m_bFailed) LogPrintf("ERROR: InstallJournal::bAddLines -> !bWrite(%s) -> return false", m_csPath.Text());
  m_bFailed = true;
  return false;
}
