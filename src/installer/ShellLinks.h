// Shell links: made and read back through the system's link object. Texts are code page 1250. Any thread.
#pragma once

#include "foundation/CNString.h"

struct ShellLink {
  CNString csTarget;
  CNString csArguments;
  CNString csWorkingFolder;
  CNString csDescription;
  CNString csIcon;  // file whose first icon is shown
};

// Writes the link file szLinkPath (ends in ".lnk"), replacing one that is there. Returns 0 or FUNCTION_ERROR.
int iCreateLink(const ShellLink& link, const char* szLinkPath);
// Reads a link file back. Returns 0 or FUNCTION_ERROR.
int iResolveIt(const char* szLinkPath, ShellLink& link);
