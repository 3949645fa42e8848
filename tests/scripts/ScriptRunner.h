// A script that tests itself: what its comments ask for (README.md tells how they are written), and its runs.
#pragma once

#include <string>
#include <vector>

#include "orbit/ToolFixture.h"

std::vector<std::string> SplitLines(const std::string& text);

// One run (or dump) of the script and what must come of it; texts are UTF-8.
struct ScriptCase {
  std::string shown;  // the line that asks for it
  bool bDump = false;
  std::vector<std::string> settings, answers, steps;
  int exit = 0;
  std::vector<std::string> out, errors, log;
  bool bLog = false;   // the log is compared
  bool bNote = false;  // the errors are not compared: the file's encoding is told there
};

class ScriptExpectations {
 public:
  explicit ScriptExpectations(const std::string& script);
  const std::vector<ScriptCase>& Cases() const { return m_cases; }
  // What is wrong with the comments themselves, or empty.
  const std::string& Problem() const { return m_problem; }

 private:
  void Read(const std::vector<std::string>& lines, size_t from, size_t to);
  size_t Repeat(const std::vector<std::string>& lines, size_t at, size_t to, const std::string& count);
  void Directive(const std::string& word, const std::string& argument);
  void BeginRun(const std::string& words);
  void SetProblem(const std::string& problem) {
    if (m_problem.empty()) m_problem = problem;
  }

  std::vector<ScriptCase> m_cases;
  std::string m_problem;
  bool m_bNote = false;
};

struct ScriptOutcome {
  int exit = 0;
  std::vector<std::string> out, errors, log;  // UTF-8
};

// Runs cases in a folder of its own. Made once for each test.
class ScriptRunner {
 public:
  // The file's name is what messages call the script.
  void Write(const std::string& script) { m_folder.Write(FILE_NAME, script); }
  ScriptOutcome Run(const ScriptCase& script);
  // Fails the test where the case's expectations are not met.
  void Expect(const ScriptCase& script);

 private:
  static constexpr const char* FILE_NAME = "script.txt";

  TestFolder m_folder;
  TestLog m_log{m_folder};
};
