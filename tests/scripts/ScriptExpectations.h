// What the comments of a test script ask for: README.md tells how they are written.
#pragma once

#include <string>
#include <vector>

std::vector<std::string> SplitLines(const std::string& text);
std::string JoinLines(const std::vector<std::string>& lines);

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
  // What is wrong with the comments, or empty.
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
