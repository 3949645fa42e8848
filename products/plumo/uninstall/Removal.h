// Takes an installation away again: exactly what it made, as its own records say, and nothing outside its folder that
// does not lead into it.
//
// The records are files that anybody may have changed, so every entry is checked before it is acted upon. What cannot
// be removed is remembered by name and does not stop the rest. One thread.
#pragma once

#include "Records.h"
#include "launcher/RunLog.h"

class Removal {
 public:
  // szOwnPath: this running program, which the system does not let go before it has ended. log is told of everything
  // that is deleted; it must outlive this object.
  Removal(const Installation& installation, const char* szOwnPath, RunLog& log);

  // What was registered, the shortcuts, the files of the list, the entry among the installed programs, the records, and
  // the folders that are then empty. The program itself, the list and the folders that hold them are left for
  // RemoveOwn. When a file is held by somebody, the program, the entry and the records stay: removing can then be
  // repeated.
  void RemoveAllButOwn();
  // The list and the folders, once the running program has been moved aside or has ended.
  void RemoveLast();
  // The second step: the program at szOwnPath has ended. Called by its copy szTwin: a file that is not the same as that
  // one is not ours to delete.
  void RemoveOwn(const char* szTwin);
  // True when the running program is the one thing that is still to be removed.
  bool bOwnRemains() const { return m_bOwnRemains && !m_bHeld; }
  bool bCanBeRepeated() const { return m_bHeld; }

  void ReportOwn() { Report(m_csOwnPath.Text()); }

  // One line for each thing that is still there against the intention; empty when all went well.
  const CNString& Failures() const { return m_csFailures; }
  // The files that stay because they are the user's: changed since they were installed, or added. One line each.
  const CNString& Kept() const { return m_csKept; }
  void FindKept();

 private:
  void RemoveFiles();
  void RemoveFile(const InstalledList::Line& line);
  void RemoveWindowsCopies();
  void RemoveWindowsCopy(const char* szName);
  bool bOurWindowsCopy(const char* szPath, const char* szName) const;
  bool bIsOwn(const char* szPath);
  void RemoveRecord(const char* szName);
  void RemoveSettings();
  void RemoveHalfRecords();
  void RemoveFolders();
  void RemoveEmptyFolder(const char* szName);
  void RemoveFoldersAbove(const char* szName);
  void RemoveDestination();
  void RemoveAnnouncedFolders();
  void RemoveProgramsEntry();
  bool bDeleteFolder(const char* szPath);
  void DeleteOrReport(const char* szPath);
  void Report(const char* szWhat);

  const Installation& m_installation;
  const InstalledList& m_list;
  RunLog& m_log;
  CNString m_csOwnPath;
  CNString m_csFailures;
  CNString m_csKept;
  bool m_bOwnRemains = false;
  bool m_bHeld = false;
};
