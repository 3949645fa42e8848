// The list of what an installation made, kept in the destination while extraction runs (see docs/formats.md).
#pragma once

#include "archive/CNArchive.h"

class InstallJournal : public ArchiveJournal {
 public:
  static const char FILE_NAME[];  // "Installed.lst"

  // szFolder ends with a backslash and must exist by the first entry. A list that is there already is continued.
  explicit InstallJournal(const char* szFolder);

  void OnFolder(const char* szPath) override { Append('D', szPath); }
  void OnFile(const char* szPath) override { Append('F', szPath); }
  // A file that setup moved into the Windows folder; only its name.
  void OnWindowsFile(const char* szName) { Append('W', szName); }

  // True when a line could not be written.
  bool bFailed() const { return m_bFailed; }

 private:
  void Append(char cKind, const char* szPath);
  bool bOpen();

  CNString m_csFolder;
  CNString m_csPath;
  OsFile m_File;
  bool m_bFailed = false;
};
