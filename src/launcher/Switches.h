// The switches of a packed file's command line. Started bare, the setup program knows none.
#pragma once

#include "foundation/CNArray.h"

enum class RunMode {
  Attended,
  Passive,  // only the copying page is seen
  Silent,   // nothing is
};

struct SetVariable {
  CNString csName, csValue;
};

// Paths are full ones, code page 1250; null when the switch was not given.
struct Switches {
  RunMode mode = RunMode::Attended;
  bool bNoRestart = false;
  bool bHelp = false;
  CNString csFolder;       // /DIR= or /D=
  CNString csLog;          // /LOG=
  CNString csAnswers;      // /ANSWERS=
  CNString csSaveAnswers;  // /SAVEANSWERS=
  CNArray<SetVariable> variables;
  CNString csFault;  // what is wrong with the line, a sentence that names the switch; null when nothing is

  bool bUnattended() const { return mode != RunMode::Attended; }
  bool bSets(const char* szVariable) const;
};

// Reads the rest of a command line, behind the program's name. It is read to its end also when something in it is
// wrong: how the fault is to be told depends on the other switches. The first fault is kept.
void ReadSwitches(const wchar_t* pLine, Switches& out);

// What /? shows.
extern const char SWITCHES_HELP[];
