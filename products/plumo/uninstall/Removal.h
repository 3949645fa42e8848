// Takes an installation away again: exactly what it made, as its own list says, and nothing outside its folder.
//
// The list and the log are files that anybody may have changed, so every entry is checked before it is acted upon. What
// cannot be removed is remembered by name and does not stop the rest. One thread.
#pragma once

#include "foundation/CNArray.h"
#include "foundation/CNString.h"

struct Installation {
  CNString csFolder;         // full path, ends with a backslash
  CNString csProgramName;    // its name among the installed programs
  CNString csProgramFolder;  // its folder in the start menu
  CNString csInstalledTo;    // the folder as it was spelled then
};

// Reads szFolder's Uninstall.log. False when there is none, it does not name a program, or the list of files is
// missing.
bool bReadInstallation(const char* szFolder, Installation& installation);

class Removal {
 public:
  // szOwnPath: this running program, which the system does not let go before it has ended.
  Removal(const Installation& installation, const char* szOwnPath);

  // The shortcuts, the files of the list, the entry among the installed programs, the records, and the folders that are
  // then empty. The program itself and the folders that hold it are left for the second step. When a file is held by
  // somebody, the program, the entry and the records stay: removing can then be repeated.
  void RemoveAllButOwn();
  // Once the program at szOwnPath has ended: it, the list and the folders that are then empty. Called by its copy
  // szTwin: a file that is not the same as that one is not ours to delete.
  void RemoveOwn(const char* szTwin);
  // True when the running program is the one thing that is still to be removed.
  bool bOwnRemains() const { return m_bOwnRemains && !m_bHeld; }
  bool bCanBeRepeated() const { return m_bHeld; }

  // One line for each thing that is still there against the intention; empty when all went well.
  const CNString& Failures() const { return m_csFailures; }

 private:
  void ReadList();
  void RemoveFile(const char* szName);
  void RemoveWindowsCopy(const char* szName);
  bool bListed(const char* szPath) const;
  void RemoveRecord(const char* szName);
  void RemoveSettings();
  void RemoveFolders();
  void RemoveEmptyFolder(const char* szName);
  void RemoveFoldersAbove(const char* szName);
  void RemoveDestination();
  void RemoveProgramsEntry();
  bool bStartsUs(const char* szCommand) const;
  void DeleteOrReport(const char* szPath);
  void Report(const char* szWhat);

  const Installation& m_installation;
  CNString m_csOwnPath;
  CNString m_csListText;
  CNCharArray m_lines;  // of the list: "F path", "D path", "W name"
  CNString m_csFailures;
  bool m_bOwnRemains = false;
  bool m_bHeld = false;
};
