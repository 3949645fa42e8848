// Runs every script of this folder, and every example of docs/script-language.md, through `orbit run` and `orbit dump`
// and holds what comes out against the comments in the script: see README.md. The page's tables, and that of
// docs/commands.md, name every command, keyword and flag that there is.
#include <algorithm>
#include <ostream>

#include "CheckWords.h"
#include "OrbitText.h"
#include "ScriptRunner.h"
#include "installer/CommandNames.h"

namespace {

namespace fs = std::filesystem;

struct Script {
  std::string name, text;
};

// How a failed test names it.
void PrintTo(const Script& script, std::ostream* pOut) { *pOut << script.name; }

const std::string& Page() {
  static const std::string page = TestFolder::ReadFile(SourcePath("docs/script-language.md"));
  return page;
}

// What stands between "```orbit" and "```", named by the line.
void AddExamples(std::vector<Script>& scripts) {
  bool bInside = false;
  size_t number = 0;
  for (const std::string& line : SplitLines(Page())) {
    number++;
    if (line == "```orbit") scripts.push_back({"script_language_line_" + std::to_string(number), ""});
    const bool bFence = line.rfind("```", 0) == 0;
    if (bInside && !bFence) scripts.back().text += line + "\n";
    if (bFence) bInside = line == "```orbit";
  }
}

std::vector<Script> AllScripts() {
  std::vector<Script> scripts;
  for (const auto& entry : fs::directory_iterator(ToPath(SourcePath("tests/scripts"))))
    if (entry.path().extension() == ".txt")
      scripts.push_back(
          {Replaced(FromPath(entry.path().stem()), "-", "_"), TestFolder::ReadFile(FromPath(entry.path()))});
  std::sort(scripts.begin(), scripts.end(), [](const Script& a, const Script& b) { return a.name < b.name; });
  AddExamples(scripts);
  return scripts;
}

class Scripts : public testing::TestWithParam<Script> {
 protected:
  Scripts() : m_expected(GetParam().text) { m_runner.Write(GetParam().text); }
  // Leaves the dump behind as the script. Returns what the first dump printed.
  ScriptOutcome DumpTwice(const std::string& text) {
    ScriptCase dump;
    dump.bDump = true;
    m_runner.Write(text);
    const ScriptOutcome first = m_runner.Run(dump);
    if (first.exit) return first;
    std::string written;
    for (const std::string& line : first.out) written += line + "\n";
    m_runner.Write(written);
    const ScriptOutcome second = m_runner.Run(dump);
    EXPECT_EQ(second.exit, 0) << written;
    EXPECT_EQ(second.out, first.out);
    return first;
  }

  const ScriptExpectations m_expected;
  ScriptRunner m_runner;
};

TEST_P(Scripts, DoWhatTheirCommentsSay) {
  EXPECT_EQ(m_expected.Problem(), "");
  for (const ScriptCase& script : m_expected.Cases()) m_runner.Expect(script);
}

// The dump loads and gives itself again; and a script without faults does the same when its dump is run.
TEST_P(Scripts, AreWhatTheirDumpSays) {
  const ScriptOutcome first = DumpTwice(GetParam().text);
  const auto isMessage = [](const std::string& line) { return line.rfind("message ", 0) == 0; };
  if (first.exit || std::any_of(first.errors.begin(), first.errors.end(), isMessage)) return;
  for (ScriptCase script : m_expected.Cases()) {
    if (script.bDump) continue;
    script.bNote = true;                             // a dump is in the encoding of the system
    script.bLog = script.bLog && first.log.empty();  // it has nothing to be logged while it is loaded
    m_runner.Expect(script);
  }
}

// The dump of a script that lost a line loads and gives itself again.
TEST_P(Scripts, AreDumpedWithoutALine) {
  const std::vector<std::string> lines = SplitLines(GetParam().text);
  for (size_t gone = 0; gone < lines.size() && !HasFailure(); gone += 2) {
    if (lines[gone].rfind("//", 0) == 0) continue;
    SCOPED_TRACE("without line " + std::to_string(gone + 1));
    std::string text;
    for (size_t i = 0; i < lines.size(); i++) text += i == gone ? "" : lines[i] + "\n";
    DumpTwice(text);
  }
}

INSTANTIATE_TEST_SUITE_P(All, Scripts, testing::ValuesIn(AllScripts()),
                         [](const auto& info) { return info.param.name; });

bool bNames(const std::string& word) { return Page().find("`" + word + "`") != std::string::npos; }

// The line of a table whose first cell names the word, or empty.
std::string Row(const std::string& word) {
  for (const std::string& line : SplitLines(Page()))
    if (line.rfind("| ", 0) == 0 && line.substr(0, line.find(" | ")).find("`" + word + "`") != std::string::npos)
      return line;
  return "";
}

TEST(DocsTables, NameEveryKindFlagAndEvent) {
  for (const KindRow& row : ControlKinds()) EXPECT_NE(Row(std::string(row.keyword)), "") << row.keyword;
  for (const auto& flag : AllFlags()) {
    const std::string word(flag);
    EXPECT_TRUE(bNames(word) || Page().find("`" + word + "(") != std::string::npos) << word;
  }
  for (const KindRow& row : ControlKinds())
    for (Piece events = row.events, word; !(word = piece::Word(events)).empty();
         events = piece::TrimFront(events.substr(word.size())))
      EXPECT_TRUE(bNames(std::string(word))) << word;
}

// Their page is docs/commands.md; its examples are run with the installer.
TEST(DocsTables, TellWhatEachInstallerCommandDoes) {
  const std::vector<std::string> page = SplitLines(TestFolder::ReadFile(SourcePath("docs/commands.md")));
  for (int i = 0; i < INSTALL_COMMAND_COUNT; i++) {
    const InstallCommandName& command = INSTALL_COMMAND_NAMES[i];
    std::string head = std::string("| `") + command.szName + "`";
    if (command.szSecondName) head += std::string(", `") + command.szSecondName + "`";
    const auto row = std::find_if(page.begin(), page.end(),
                                  [&head](const std::string& line) { return line.rfind(head + " |", 0) == 0; });
    ASSERT_NE(row, page.end()) << head;
    EXPECT_NE(row->find(std::string("| ") + INSTALL_COMMAND_HELP[i]), std::string::npos) << *row;
    EXPECT_EQ(row->compare(head.size(), 5, " | | ") != 0, command.bTakesParameter) << *row;
  }
}

}  // namespace
