// Holds docs/commands.md against the program: its examples are run, and every command of the table stands in one; and
// runs the whole table in three spellings.
#include <set>

#include "CommandsRun.h"
#include "installer/CommandNames.h"

namespace {

std::vector<std::string> Lines(const std::string& text) {
  std::vector<std::string> lines;
  for (size_t at = 0, end; at < text.size(); at = end + 1) {
    end = std::min(text.find('\n', at), text.size());
    lines.push_back(text.substr(at, end - at));
  }
  return lines;
}

// The blocks between "```orbit" and "```".
std::vector<std::vector<std::string>> Examples() {
  std::vector<std::vector<std::string>> examples;
  bool bInside = false;
  for (const std::string& line : Lines(ReadSource("docs/commands.md"))) {
    const bool bFence = line.rfind("```", 0) == 0;
    if (bFence && !bInside) examples.emplace_back();
    if (!bFence && bInside) examples.back().push_back(line);
    if (bFence) bInside = !bInside;
  }
  return examples;
}

// "command   // result", or "// name = "value"" for what holds then; an assignment has no result behind it.
void RunLine(CommandsRun& commands, const std::string& line) {
  if (line.rfind("// ", 0) == 0) {
    const size_t equals = line.find(" = \"");
    ASSERT_NE(equals, std::string::npos) << line;
    EXPECT_EQ(commands.Get(line.substr(3, equals - 3).c_str()), line.substr(equals + 4, line.size() - equals - 5));
    return;
  }
  const size_t comment = line.rfind(" // ");
  std::string command = line.substr(0, comment);
  command.erase(command.find_last_not_of(' ') + 1);
  const std::string expected = comment == std::string::npos ? "1002" : line.substr(comment + 4);
  const int iResult = commands.Do(command);
  EXPECT_EQ(iResult == -1 ? "failed" : std::to_string(iResult), expected) << line;
}

}  // namespace

TEST(CommandDocs, ExamplesDoWhatTheyPromise) {
  std::set<int> called;
  for (const auto& example : Examples()) {
    CommandsRun commands;
    commands.OnPage([&] {
      for (const std::string& line : example) RunLine(commands, line);
    });
    for (const std::string& line : example)
      for (size_t at = line.rfind("// ", 0) == 0 ? line.size() : 0; at < line.size(); at = line.find(' ', at) + 1) {
        const size_t end = std::min(line.find(' ', at), line.size());
        called.insert(iFindInstallCommand(line.substr(at, end - at).c_str()));
        if (end == line.size()) break;
      }
  }
  for (int i = 0; i < INSTALL_COMMAND_COUNT; i++) EXPECT_TRUE(called.count(i)) << INSTALL_COMMAND_NAMES[i].szName;
}

// Each command on a page of its own, so that no answer depends on one before.
TEST(CommandDocs, EveryNameIsKnownInAnySpelling) {
  const auto Spell = [](std::string name, int iSpelling) {
    for (char& c : name) c = char(iSpelling == 1 ? toupper(c) : iSpelling == 2 ? tolower(c) : c);
    return name;
  };
  for (const InstallCommandName& row : INSTALL_COMMAND_NAMES)
    for (const char* szName : {row.szName, row.szSecondName}) {
      std::vector<int> results;
      for (int iSpelling = 0; szName && iSpelling < 3; iSpelling++) {
        CommandsRun commands;
        TestLog log(commands.run.folder);
        commands.Set("browser", "none.exe");
        const std::string name = Spell(szName, iSpelling);
        commands.OnPage([&] { results.push_back(commands.Do(name + " (ND)")); });
        for (const std::string& line : log.Lines())
          EXPECT_NE(line, "ERROR: CNInstallWizard::iExecuteFunction -> " + name + " -> return FUNCTION_ERROR");
        EXPECT_EQ(results.back(), results.front()) << name;
      }
    }
}
