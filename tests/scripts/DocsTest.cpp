// Holds docs/script-language.md against the program: every example of the page is a script that tests itself, and the
// page's tables name every command, keyword and flag that there is.
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

TEST(DocsTables, SayWhichInstallerCommandsWork) {
  for (const InstallCommandName& command : INSTALL_COMMAND_NAMES) {
    const std::string row = Row(command.szName);
    const std::string last = row.size() > 8 ? row.substr(row.rfind("| ", row.size() - 3)) : "";
    EXPECT_EQ(last, command.bWorks ? "| yes |" : "| no |") << command.szName << ": " << row;
    EXPECT_EQ(Row(command.szSecondName ? command.szSecondName : command.szName), row);
  }
}

}  // namespace
