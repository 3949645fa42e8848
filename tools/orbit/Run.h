// Runs a wizard script without a screen and tells what happens.
#pragma once

#include <cstdio>
#include <string>
#include <vector>

// The words of the command line, UTF-8; what they mean is in RUN_HELP (RunSteps.h).
struct RunJob {
  std::string script;
  std::vector<std::string> settings;  // NAME=VALUE
  std::vector<std::string> answers;
  std::vector<std::string> steps;
};

// Prints what happens to pOut and what is wrong with the job to pErrors. Returns the exit code.
int RunScript(const RunJob& job, FILE* pOut, FILE* pErrors);
