// Holds docs/script-language.md against the program: every example of the page is a script that tests itself, and the
// page's tables name every command, keyword and flag that there is.
#include <algorithm>
#include <ostream>

#include "CheckWords.h"
#include "ScriptRunner.h"
#include "installer/CommandNames.h"

namespace {

struct Example {
  size_t line;  // of the page
  std::string script;
};

// How a failed test names it.
void PrintTo(const Example& example, std::ostream* pOut) { *pOut << "the example of line " << example.line; }

const std::string& Page() {
  static const std::string page = ReadBytes(SourcePath("docs/script-language.md"));
  return page;
}

// What stands between "```orbit" and "```".
std::vector<Example> Examples() {
  std::vector<Example> examples;
  bool bInside = false;
  size_t number = 0;
  for (const std::string& line : SplitLines(Page())) {
    number++;
    if (line == "```orbit") examples.push_back({number, ""});
    const bool bFence = line.rfind("```", 0) == 0;
    if (bInside && !bFence) examples.back().script += line + "\n";
    if (bFence) bInside = line == "```orbit";
  }
  return examples;
}

bool bNames(const std::string& word) { return Page().find("`" + word + "`") != std::string::npos; }

// The line of a table whose first cell names the word, or empty.
std::string Row(const std::string& word) {
  for (const std::string& line : SplitLines(Page()))
    if (line.rfind("| ", 0) == 0 && line.substr(0, line.find(" | ")).find("`" + word + "`") != std::string::npos)
      return line;
  return "";
}

class Docs : public testing::TestWithParam<Example> {};

TEST_P(Docs, ExampleDoesWhatItsCommentsSay) {
  const ScriptExpectations expected(GetParam().script);
  EXPECT_EQ(expected.Problem(), "");
  ScriptRunner runner;
  runner.Write(GetParam().script);
  for (const ScriptCase& script : expected.Cases()) runner.Expect(script);
}

std::string TestName(const testing::TestParamInfo<Example>& info) { return "line_" + std::to_string(info.param.line); }

INSTANTIATE_TEST_SUITE_P(ScriptLanguage, Docs, testing::ValuesIn(Examples()), TestName);

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
  const std::vector<std::string> page = SplitLines(ReadBytes(SourcePath("docs/commands.md")));
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
