// Runs every script of this folder through `orbit run` and `orbit dump` and holds what comes out against the comments
// in the script: see README.md. One test for each file.
#include <algorithm>

#include "OrbitText.h"
#include "ScriptRunner.h"

namespace {

namespace fs = std::filesystem;

std::vector<std::string> AllScripts() {
  std::vector<std::string> names;
  for (const auto& entry : fs::directory_iterator(SourcePath("tests/scripts")))
    if (entry.path().extension() == ".txt") names.push_back(FromPath(entry.path().stem()));
  std::sort(names.begin(), names.end());
  return names;
}

class Scripts : public testing::TestWithParam<std::string> {
 protected:
  void SetUp() override {
    m_text = ReadBytes(SourcePath("tests/scripts") / ToPath(GetParam() + ".txt"));
    m_runner.Write(m_text);
  }

  ScriptRunner m_runner;
  std::string m_text;
};

TEST_P(Scripts, DoWhatTheirCommentsSay) {
  const ScriptExpectations expected(m_text);
  EXPECT_EQ(expected.Problem(), "");
  for (const ScriptCase& script : expected.Cases()) m_runner.Expect(script);
}

// The dump loads and gives itself again; and a script without faults does the same when its dump is run.
TEST_P(Scripts, AreWhatTheirDumpSays) {
  ScriptCase dump;
  dump.bDump = true;
  const ScriptOutcome first = m_runner.Run(dump);
  if (first.exit) return;
  m_runner.Write(JoinLines(first.out));
  const ScriptOutcome second = m_runner.Run(dump);
  EXPECT_EQ(second.exit, 0);
  EXPECT_EQ(second.out, first.out);
  const auto isMessage = [](const std::string& line) { return line.rfind("message ", 0) == 0; };
  if (std::any_of(first.errors.begin(), first.errors.end(), isMessage)) return;
  const ScriptExpectations expected(m_text);
  for (const ScriptCase& script : expected.Cases()) {
    SCOPED_TRACE(script.shown);
    if (script.bDump) continue;
    const ScriptOutcome outcome = m_runner.Run(script);
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
