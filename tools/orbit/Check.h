// Checks wizard scripts without running them: everything that would go wrong is reported at its place.
#pragma once

#include <cstdio>
#include <string>
#include <vector>

#include "CheckNames.h"

struct CheckJob {
  std::vector<std::string> scripts;  // UTF-8 paths
  CheckOptions options;
};

// Prints the faults of each script in order of place. Returns 1 when there is an error or a script cannot be read,
// else 0.
int CheckScripts(const CheckJob& job, FILE* pOut, FILE* pErrors);

// For --help: what is an error and what a warning.
std::string CheckHelp();
