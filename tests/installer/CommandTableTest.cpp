// The table of commands and how a command is called; docs/commands.md is held against the program: its examples are
// run, and every command of the table stands in one.
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

// ---- the table ----

TEST(CommandTable, FindsNamesWithoutRegardToCase) {
  const char* const SECOND_NAMES[][2] = {{"install_wizard_OnClick", "INSTALLWIZARD"},
                                         {"BTN_next_folder_onclick", "CheckForFolder"},
                                         {"dictionaries_OnSelChange", "dictionaries_OnClick"},
                                         {"btn_end_OnClick", "StartDorvik"},
                                         {"b_next_Mab_OnClick", "InstallMirab"}};
  for (const auto& names : SECOND_NAMES) {
    EXPECT_NE(iFindInstallCommand(names[0]), -1) << names[0];
    EXPECT_EQ(iFindInstallCommand(names[0]), iFindInstallCommand(names[1])) << names[0];
  }
  EXPECT_EQ(iFindInstallCommand("SETQUITINSTALL"), 0);
  EXPECT_EQ(iFindInstallCommand("run_app_OnClick"), INSTALL_COMMAND_COUNT - 1);
  EXPECT_EQ(iFindInstallCommand("Unzi"), -1);
  EXPECT_EQ(iFindInstallCommand("UnzipAll"), -1);
}

class InstallCommands : public testing::Test {
 protected:
  // The return code; the command result goes to m_iResult.
  int Call(const char* szCommand, const char* szParam = "") {
    return m_run.wizard.iExecuteFunction(szCommand, szParam, 0, &m_iResult, nullptr);
  }

  InstallerRun m_run;
  TestLog m_log{m_run.folder};
  int m_iResult = -1;
};

TEST_F(InstallCommands, UnknownNamesAreLoggedAndGoOn) {
  EXPECT_EQ(Call("MakeCoffee"), EVERYTHING_IS_OK);
  EXPECT_EQ(m_iResult, COMMAND_DONE);
  EXPECT_EQ(m_log.Lines(), std::vector<std::string>{
                               "ERROR: CNInstallWizard::iExecuteFunction -> MakeCoffee -> return FUNCTION_ERROR"});
}

TEST_F(InstallCommands, TheEnginesOwnCommandsAreReached) {
  m_run.wizard.iSetVariable("path", "C:\\Dir\\");
  EXPECT_EQ(Call("EndsWith", "path;\"\\\""), EVERYTHING_IS_OK);
  EXPECT_EQ(m_iResult, 1);
  EXPECT_EQ(Call("btn_set_var_quit_OnClick", "x;y"), EVERYTHING_IS_OK);
  EXPECT_EQ(m_iResult, COMMAND_EXIT);
  EXPECT_EQ(m_run.Value("x"), "y");
  EXPECT_TRUE(m_log.Lines().empty());
}

TEST_F(InstallCommands, TheBusyFlagIsSetByScripts) {
  const struct {
    const char *szCommand, *szParam;
    int iBusy;
  } rows[] = {{"SetQuitInstall", "false", 1}, {"SetQuitInstall", "yes", 1}, {"SetQuitInstall", "TRUE", 0},
              {"SetQuitInstall", "no", 0},    {"SetUnzipVar", "1", 1},      {"SetUnzipVar", "x", 0}};
  for (const auto& row : rows) {
    EXPECT_EQ(Call(row.szCommand, row.szParam), EVERYTHING_IS_OK);
    EXPECT_EQ(m_iResult, COMMAND_DONE);
    EXPECT_EQ(m_run.wizard.Extraction().iBusy, row.iBusy) << row.szCommand << " " << row.szParam;
    EXPECT_EQ(m_run.wizard.bHoldsQuit(), row.iBusy == 1);
  }
}

TEST_F(InstallCommands, TheBackButtonOfAFlowSendsNextAtOnce) {
  m_run.Load();
  m_run.Run({[this](HeadlessView&) {
    EXPECT_EQ(Call("btn_back_OnClick"), EVERYTHING_IS_OK);
    EXPECT_EQ(m_run.Value("back"), "1");
    EXPECT_EQ(m_run.Page(), "PL-dlg2");
  }});
}

TEST_F(InstallCommands, AScriptThatCannotBeLoadedIsAnError) {
  m_run.scripts.csInstaller.Free();
  EXPECT_EQ(m_run.wizard.iExecuteInstallWizard("x"), FUNCTION_ERROR);
  EXPECT_EQ(m_log.Lines().back(),
            "ERROR: CNInstallWizard::iExecuteInstallWizard -> iLoadMainListBuffer -> return FUNCTION_ERROR");
}

TEST_F(InstallCommands, ParseDefaultPathCutsOneBackslash) {
  const struct {
    const char *szBefore, *szAfter;
  } rows[] = {{"C:\\Dir\\", "C:\\Dir"}, {"C:\\Dir\\\\", "C:\\Dir\\"},
              {"C:\\Dir", "C:\\Dir"},   {"x\\", "x\\"},
              {"ab\\", "ab"},           {"C:\\", "C:\\"}};
  for (const auto& row : rows) {
    m_run.wizard.iSetVariable("default_path", row.szBefore);
    EXPECT_EQ(Call("ParseDefaultPath"), EVERYTHING_IS_OK);
    EXPECT_EQ(m_run.Value("default_path"), row.szAfter);
  }
}

TEST_F(InstallCommands, InitDefaultPathWorksOncePerRun) {
  EXPECT_EQ(Call("InitDefaultPath"), FUNCTION_ERROR);
  EXPECT_EQ(m_iResult, COMMAND_FAILED);
  EXPECT_EQ(m_log.Lines().front(),
            "ERROR: CNInstallWizard::iInitDefaultPath -> !default_path -> return FUNCTION_ERROR");
  m_run.wizard.iSetVariable("default_path", "Tavola\\Plumo");
  for (int i = 0; i < 2; i++) EXPECT_EQ(Call("InitDefaultPath"), EVERYTHING_IS_OK);
  EXPECT_EQ(m_run.Value("default_path"), "C:\\Program Files\\Tavola\\Plumo");
}
