// What the uninstaller is asked to do.
#pragma once

#include "foundation/CNString.h"

struct Request {
  bool bSilent = false;
  bool bHelp = false;
  bool bSecondStep = false;
  unsigned long ulFirstProcess = 0;
  CNString csProgram;  // of the first step
  CNString csFolder;   // as given, without quotes and without backslashes at its end
  CNString csLog;      // as given, without quotes; null: no log
  CNString csFault;    // what is wrong with a switch, a sentence that names it; null when nothing is
};

// Reads the process's command line: switches in any order before and behind the folder, which may stand in quotes.
// szOwnPath is this program's: a line that begins with it is split right whatever the path holds. A word with '-'
// behind a folder without quotes that is no switch is part of the folder's name.
Request ParseCommandLine(const char* szLine, const char* szOwnPath);

// What /? shows.
extern const char SWITCHES_HELP[];
