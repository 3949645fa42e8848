// Writes back, as a script, what the engine has understood of a script file.
#pragma once

#include <cstdio>
#include <string>

struct DumpJob {
  std::string script;  // UTF-8 path
  std::string output;  // a file to write in code page 1250, or empty: print in UTF-8
  bool bTime = false;  // tell how long the loading took
};

// Prints the script to pOut (or writes the file), and what the loader has to say, with the time, to pErrors. Returns
// the loader's result; nothing is written when it is not 0. Throws OrbitError when the output cannot be written, or is
// the script itself.
int DumpScript(const DumpJob& job, FILE* pOut, FILE* pErrors);

extern const char* const DUMP_HELP;
