#include "ScriptRunner.h"

#include <algorithm>
#include <fstream>
#include <iterator>

#include "Dump.h"
#include "OrbitText.h"
#include "Run.h"

namespace {

// The engine's own variable depends on the system.
std::vector<std::string> WithoutSystem(std::vector<std::string> lines) {
  CNString csSystem;
  OsGetSystemName(csSystem);
  const std::string own = std::string("win_ver = \"") + csSystem.Text() + "\"";
  lines.erase(std::remove(lines.begin(), lines.end(), own), lines.end());
  return lines;
}

}  // namespace

ScriptOutcome ScriptRunner::Run(const ScriptCase& script) {
  m_log.Clear();
  ScriptOutcome outcome;
  FILE* const pOut = OsOpenStream("out", "wb");
  FILE* const pErrors = OsOpenStream("errors", "wb");
  outcome.exit = script.bDump ? DumpScript({FILE_NAME, "", false}, pOut, pErrors)
                              : RunScript({FILE_NAME, script.settings, script.answers, script.steps}, pOut, pErrors);
  fclose(pOut);
  fclose(pErrors);
  outcome.out = WithoutSystem(SplitLines(m_folder.Read("out")));
  outcome.errors = SplitLines(m_folder.Read("errors"));
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

std::filesystem::path SourcePath(const char* szPath) {
#ifdef _WIN32
  return std::filesystem::path("Z:" ORBIT_SOURCE_DIR) / szPath;
#else
  return std::filesystem::path(ORBIT_SOURCE_DIR) / szPath;
#endif
}

std::string ReadBytes(const std::filesystem::path& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}
