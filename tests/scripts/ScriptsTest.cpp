// Runs every script of this folder through `orbit run` and `orbit dump` and holds what comes out against the comments
// in the script: see README.md. One test for each file.
#include <fstream>
#include <iterator>

#include "Dump.h"
#include "OrbitText.h"
#include "Run.h"
#include "ScriptExpectations.h"
#include "support/TestFolder.h"

namespace {

namespace fs = std::filesystem;

const char SCRIPT[] = "script.txt";
const char DUMPED[] = "dumped.txt";

std::string ReadBytes(const fs::path& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

// Drive letters and current folders differ under Wine: a path of the source tree is taken from the tree's drive.
fs::path SourceFolder() {
#ifdef _WIN32
  return fs::path("Z:" ORBIT_SOURCE_DIR) / "tests" / "scripts";
#else
  return fs::path(ORBIT_SOURCE_DIR) / "tests" / "scripts";
#endif
}

std::vector<std::string> AllScripts() {
  std::vector<std::string> names;
  for (const auto& entry : fs::directory_iterator(SourceFolder()))
    if (entry.path().extension() == ".txt") names.push_back(FromPath(entry.path().stem()));
  std::sort(names.begin(), names.end());
  return names;
}

struct Outcome {
  int exit = 0;
  std::vector<std::string> out, errors, log;
};

class Scripts : public testing::TestWithParam<std::string> {
 protected:
  void SetUp() override {
    m_text = ReadBytes(SourceFolder() / ToPath(GetParam() + ".txt"));
    m_folder.Write(SCRIPT, m_text);
  }
  Outcome Run(const ScriptCase& script, const char* szFile) {
    m_log.Clear();
    Outcome outcome;
    FILE* const pOut = OsOpenStream("out", "wb");
    FILE* const pErrors = OsOpenStream("errors", "wb");
    outcome.exit = script.bDump ? DumpScript({szFile, "", false}, pOut, pErrors)
                                : RunScript({szFile, script.settings, script.answers, script.steps}, pOut, pErrors);
    fclose(pOut);
    fclose(pErrors);
    outcome.out = WithoutSystem(SplitLines(m_folder.Read("out")));
    outcome.errors = SplitLines(m_folder.Read("errors"));
    for (const std::string& line : m_log.Lines()) outcome.log.push_back(ToUtf8(line.c_str()));
    return outcome;
  }
  // The engine's own variable depends on the system.
  static std::vector<std::string> WithoutSystem(std::vector<std::string> lines) {
    CNString csSystem;
    OsGetSystemName(csSystem);
    const std::string own = std::string("win_ver = \"") + csSystem.Text() + "\"";
    lines.erase(std::remove(lines.begin(), lines.end(), own), lines.end());
    return lines;
  }

  TestFolder m_folder;
  TestLog m_log{m_folder};
  std::string m_text;
};

TEST_P(Scripts, DoWhatTheirCommentsSay) {
  const ScriptExpectations expected(m_text);
  EXPECT_EQ(expected.Problem(), "");
  for (const ScriptCase& script : expected.Cases()) {
    SCOPED_TRACE(script.shown);
    const Outcome outcome = Run(script, SCRIPT);
    EXPECT_EQ(outcome.exit, script.exit);
    EXPECT_EQ(outcome.out, script.out);
    EXPECT_EQ(script.bNote ? script.errors : outcome.errors, script.errors);
    EXPECT_EQ(script.bLog ? outcome.log : script.log, script.log);
  }
}

// The dump loads and gives itself again; and a script without faults does the same when its dump is run.
TEST_P(Scripts, AreWhatTheirDumpSays) {
  ScriptCase dump;
  dump.bDump = true;
  const Outcome first = Run(dump, SCRIPT);
  if (first.exit) return;
  m_folder.Write(DUMPED, JoinLines(first.out));
  const Outcome second = Run(dump, DUMPED);
  EXPECT_EQ(second.exit, 0);
  EXPECT_EQ(second.out, first.out);
  const auto isMessage = [](const std::string& line) { return line.rfind("message ", 0) == 0; };
  if (std::any_of(first.errors.begin(), first.errors.end(), isMessage)) return;
  const ScriptExpectations expected(m_text);
  for (const ScriptCase& script : expected.Cases()) {
    SCOPED_TRACE(script.shown);
    if (script.bDump) continue;
    const Outcome outcome = Run(script, DUMPED);
    EXPECT_EQ(outcome.exit, script.exit);
    EXPECT_EQ(outcome.out, script.out);
    const bool bLog = script.bLog && first.log.empty();  // the dump has nothing to be logged while it is loaded
    EXPECT_EQ(bLog ? outcome.log : script.log, script.log);
  }
}

std::string TestName(const testing::TestParamInfo<std::string>& info) {
  std::string name = info.param;
  for (char& c : name)
    if (!isalnum(static_cast<unsigned char>(c))) c = '_';
  return name;
}

INSTANTIATE_TEST_SUITE_P(All, Scripts, testing::ValuesIn(AllScripts()), TestName);

}  // namespace
