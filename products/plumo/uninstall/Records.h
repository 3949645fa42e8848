// What an installation tells about itself: its list of files, Uninstall.log, and its entry among the installed
// programs. Each may be missing or damaged, and the first two may have been changed by anybody.
#pragma once

#include "archive/InstalledList.h"
#include "foundation/CNString.h"
#include "foundation/os/OsRegistry.h"

extern const char PROGRAMS_KEY[];  // of the installed programs, below HKEY_LOCAL_MACHINE, ends with a backslash

class Installation {
 public:
  // False when nothing is known of an installation in szFolder.
  bool bRead(const char* szFolder);

  CNString csFolder;       // full path, ends with a backslash
  CNString csInstalledTo;  // the folder as it was spelled then, without one
  CNString csProgramName;  // its name among the installed programs; empty when it is not known
  InstalledList list;
  CNString csUnknown;  // what is missing in the records, one line each

  // The values of a key of Uninstall.log and of the list, separated by ';'.
  CNString csValues(const char* szKey) const;
  // The one that counts: the log's, else the list's.
  CNString csValue(const char* szKey) const;
  // True when szPath, relative to the folder, is a file of the list; without a list, when it is a program.
  bool bListed(const char* szPath) const;
  bool bHasList() const { return m_bList; }
  // True when a command line names something in the folder.
  bool bLeadsHere(const char* szCommand) const;
  // True for the UninstallString of this installation.
  bool bStartsUs(const char* szCommand) const;

 private:
  bool bReadLog();
  void FindEntry();
  void NoteUnknown(bool bLog);

  CNString m_csLog;
  bool m_bList = false;
  bool m_bEntry = false;
};

// A text value; szName may be "" for the key's own. False when there is none.
bool bReadRegistryText(OsRegKey hRoot, const char* szKey, const char* szName, CNString& csText);
// szA followed by szB and szC.
CNString csJoined(const char* szA, const char* szB, const char* szC = "");
// False also for a folder. To be asked before a file is given to something that makes a missing one.
bool bIsFile(const char* szPath);
// Takes the next of several texts that ';' separates; false at the end. Empty ones are left out.
bool bTakePart(const char*& szParts, CNString& csPart);
