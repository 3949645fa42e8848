// The setup program's command line: the program's name, then the path of the stamped executable.
#pragma once

#include "foundation/CNString.h"

// Points at the first argument, the rest of the line included; null when there is none. The name's end is deliberately
// chosen by the second character: a double quote there makes a double quote end the name, anything else a blank. So a
// quoted program path with blanks ends at its first blank.
template <class Char>
Char* GetFirstArgument(Char* pCommandLine) {
  if (!pCommandLine || !pCommandLine[0]) return nullptr;
  const Char cEnd = pCommandLine[1] == Char('"') ? Char('"') : Char(' ');
  Char* p = pCommandLine + 1;
  while (*p && *p != cEnd) p++;
  if (!*p) return nullptr;
  for (p++; *p == Char(' ');) p++;
  return *p ? p : nullptr;
}

struct SetupCommandLine {
  CNString csLine;      // the whole line, the argument's surrounding quotes taken out of it
  CNString csArgument;  // null when there is none; a path that code page 1250 cannot hold is its short name
};

// Reads the process's command line. A character that code page 1250 cannot hold is '?' in csLine.
void ReadCommandLine(const wchar_t* pCommandLine, SetupCommandLine& out);
