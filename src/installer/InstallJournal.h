// The list of what an installation made, kept in the destination while extraction runs (see docs/formats.md). Every
// line is in the file before the thing that it names is on the disk. One thread at a time.
#pragma once

#include "archive/InstalledList.h"

class InstallJournal : public ArchiveJournal {
 public:
  // szFolder ends with a backslash and must exist by the first entry. A list that is there already is continued.
  explicit InstallJournal(const char* szFolder);
  ~InstallJournal() override { bFlush(); }

  bool bOnFolder(const char* szPath) override { return bAppend('D', szPath); }
  bool bOnFile(const char* szPath) override { return bAppend('F', szPath); }
  void OnFileDone(const ArchiveFileMark& mark) override;
  void OnFileNotMade() override { m_csPending = "N\r\n"; }
  // A file that setup moves into the Windows folder; only its name.
  bool OnWindowsFile(const char* szName) { return bAppend('W', szName); }
  // Something for the uninstaller that is not a file in the destination: "key" as in Uninstall.log, and its value. For
  // a command that changes the machine before Uninstall.log is written: to be called before the change.
  bool bOnValue(const char* szKey, const char* szValue);
  // Whole lines made by AddLine.
  bool bAddLines(const char* szLines);
  // Writes what is held back: how it went with the last file.
  bool bFlush() { return m_csPending.bEmpty() || bAddLines(""); }

  // Of the files that were done.
  uint64_t ContentBytes() const { return m_bytes; }
  // True when a line could not be written.
  bool bFailed() const { return m_bFailed; }

  // Puts a line at the end of csLines. Control characters, which would end it early, become blanks.
  static void AddLine(CNString& csLines, char cKind, const char* szText, const char* szValue = nullptr);

 private:
  bool bAppend(char cKind, const char* szText);
  bool bOpen();

  CNString m_csFolder;
  CNString m_csPath;
  CNString m_csPending;
  OsFile m_File;
  uint64_t m_bytes = 0;
  bool m_bTorn = false;  // the last line in the file has no end
  bool m_bFailed = false;
};
