// What the uninstaller is asked to do.
#pragma once

#include "foundation/CNString.h"

struct Request {
  bool bSilent = false;
  bool bSecondStep = false;
  unsigned long ulFirstProcess = 0;
  CNString csProgram;  // of the first step
  CNString csFolder;   // as given, without quotes and without backslashes at its end
};

// Reads the process's command line. szOwnPath is this program's: a line that begins with it is split right whatever the
// path holds.
Request ParseCommandLine(const char* szLine, const char* szOwnPath);
