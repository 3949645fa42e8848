#include "ScriptRunner.h"

#include <algorithm>
#include <cstdlib>

#include "Dump.h"
#include "OrbitText.h"
#include "Run.h"

namespace {

// Words between blanks; apostrophes hold one word together.
std::vector<std::string> SplitWords(const std::string& text) {
  std::vector<std::string> words;
  bool bWord = false, bQuoted = false;
  for (const char c : text) {
    if (c == '\'') {
      bQuoted = !bQuoted;
    } else if (c == ' ' && !bQuoted) {
      bWord = false;
      continue;
    }
    if (!bWord) words.emplace_back();
    bWord = true;
    if (c != '\'') words.back() += c;
  }
  return words;
}

// "next*3" is three times "next".
void AddSteps(const std::string& word, std::vector<std::string>& steps) {
  const size_t star = word.find('*');
  const bool bTimes = star != std::string::npos &&
                      std::all_of(word.begin(), word.begin() + long(star), [](char c) { return c >= 'a' && c <= 'z'; });
  steps.insert(steps.end(), bTimes ? strtoul(word.c_str() + star + 1, nullptr, 10) : 1,
               bTimes ? word.substr(0, star) : word);
}

const struct {
  const char* szWord;
  std::function<void(ScriptCase& script, const std::string& argument)> Apply;
} EXPECTATIONS[] = {
    {"expect", [](ScriptCase& script, const std::string& argument) { script.out.push_back(argument); }},
    {"expect-error",
     [](ScriptCase& script, const std::string& argument) {
       script.errors.push_back(argument);
       if (argument.rfind("error: ", 0) == 0 && !script.exit) script.exit = 2;  // wrong usage
     }},
    {"expect-exit", [](ScriptCase& script, const std::string& argument) { script.exit = atoi(argument.c_str()); }},
    {"expect-log",
     [](ScriptCase& script, const std::string& argument) {
       script.bLog = true;
       if (!argument.empty()) script.log.push_back(argument);
     }},
};

// The engine's own variable depends on the system.
std::vector<std::string> WithoutSystem(std::vector<std::string> lines) {
  CNString csSystem;
  OsGetSystemName(csSystem);
  const std::string own = std::string("win_ver = \"") + csSystem.Text() + "\"";
  lines.erase(std::remove(lines.begin(), lines.end(), own), lines.end());
  return lines;
}

}  // namespace

std::vector<std::string> SplitLines(const std::string& text) {
  std::vector<std::string> lines;
  for (size_t at = 0; at < text.size();) {
    const size_t end = std::min(text.find('\n', at), text.size());
    lines.push_back(text.substr(at, end - at));
    at = end + 1;
  }
  return lines;
}

ScriptExpectations::ScriptExpectations(const std::string& script) {
  m_bNote = std::any_of(script.begin(), script.end(), [](char c) { return (c & 0x80) != 0; });
  const std::vector<std::string> lines = SplitLines(script);
  Read(lines, 0, lines.size());
  if (m_cases.empty()) SetProblem("the script has no run");
}

// Lines are "// word: argument"; other comments begin with another word or have no colon.
void ScriptExpectations::Read(const std::vector<std::string>& lines, size_t from, size_t to) {
  for (size_t i = from; i < to; i++) {
    const std::string& line = lines[i];
    const size_t colon = line.find(':');
    if (line.rfind("// ", 0) != 0 || colon == std::string::npos) continue;
    const std::string word = line.substr(3, colon - 3);
    const std::string argument = line.size() > colon + 2 ? line.substr(colon + 2) : "";
    if (word == "repeat")
      i = Repeat(lines, i + 1, to, argument);
    else
      Directive(word, argument);
  }
}

// Returns the line of "// end-repeat".
size_t ScriptExpectations::Repeat(const std::vector<std::string>& lines, size_t at, size_t to,
                                  const std::string& count) {
  const auto end = std::find(lines.begin() + long(at), lines.begin() + long(to), "// end-repeat");
  if (end == lines.begin() + long(to)) SetProblem("a repeat without its end");
  const size_t endLine = size_t(end - lines.begin());
  for (int i = atoi(count.c_str()); i > 0; i--) Read(lines, at, endLine);
  return endLine;
}

void ScriptExpectations::Directive(const std::string& word, const std::string& argument) {
  if (word == "run" || word == "dump") {
    BeginRun(argument);
    m_cases.back().bDump = word == "dump";
    return;
  }
  for (const auto& row : EXPECTATIONS) {
    if (word != row.szWord) continue;
    if (m_cases.empty()) return SetProblem("an expectation before the first run");
    return row.Apply(m_cases.back(), argument);
  }
  if (word.rfind("expect", 0) == 0) SetProblem("unknown: " + word);
}

void ScriptExpectations::BeginRun(const std::string& words) {
  m_cases.emplace_back();
  ScriptCase& script = m_cases.back();
  script.shown = words;
  script.bNote = m_bNote;
  std::vector<std::string>* pList = nullptr;  // of the option before
  for (const std::string& word : SplitWords(words)) {
    if (pList)
      pList->push_back(word);
    else if (word != "--set" && word != "--answer")
      AddSteps(word, script.steps);
    pList = pList ? nullptr : word == "--set" ? &script.settings : word == "--answer" ? &script.answers : nullptr;
  }
}

ScriptOutcome ScriptRunner::Run(const ScriptCase& script) {
  m_log.Clear();
  ScriptOutcome outcome;
  const Printed printed = Capture([&](FILE* pOut, FILE* pErrors) {
    return script.bDump ? DumpScript({FILE_NAME, "", false}, pOut, pErrors)
                        : RunScript({FILE_NAME, script.settings, script.answers, script.steps}, pOut, pErrors);
  });
  outcome.exit = printed.iResult;
  outcome.out = WithoutSystem(SplitLines(printed.out));
  outcome.errors = SplitLines(printed.errors);
  for (const std::string& line : m_log.Lines()) outcome.log.push_back(ToUtf8(line.c_str()));
  return outcome;
}

void ScriptRunner::Expect(const ScriptCase& script) {
  SCOPED_TRACE(script.shown);
  const ScriptOutcome outcome = Run(script);
  EXPECT_EQ(outcome.exit, script.exit);
  EXPECT_EQ(outcome.out, script.out);
  EXPECT_EQ(script.bNote ? script.errors : outcome.errors, script.errors);
  EXPECT_EQ(script.bLog ? outcome.log : script.log, script.log);
}
