// Commands that start programs, wait for them or want them closed, with real processes.
#include <windows.h>

#include "CommandsRun.h"
#include "foundation/os/OsWide.h"

// For a minute at most.
template <class Condition>
static void WaitUntil(Condition condition) {
  for (int i = 0; i < 6000 && !condition(); i++) OsSleep(10);
}

// The test program under other names is the program that commands start: it writes down which process it is and how it
// was started, and runs until a file appears beside it. Only a child is told to run this test.
TEST(DISABLED_Child, TellsHowItWasStarted) {
  CNString csProgram, csFolder;
  ASSERT_TRUE(bOsGetProgramPath(csProgram) && bOsGetCurrentFolder(csFolder));
  const std::string program = csProgram.Text();
  CNString csLine;
  bNarrow(GetCommandLineW(), csLine);
  const std::string process = std::to_string(GetCurrentProcessId());
  TestFolder::WriteFile(program + ".part", process + "|" + csFolder.Text() + "|" + csLine.Text());
  bOsRename((program + ".part").c_str(), (program + ".ran").c_str());
  const bool bStops = strstr(csLine.Text(), "--deinstall") != nullptr;
  if (!bStops) WaitUntil([&] { return bOsExists((program + ".stop").c_str()); });
}

class Child {
 public:
  explicit Child(const std::string& path) : m_path(path) {
    CNString csProgram;
    bOsGetProgramPath(csProgram);
    EXPECT_TRUE(CopyFileW(WidePath(csProgram.Text()), WidePath(path.c_str()), FALSE));
    SetEnvironmentVariableW(L"GTEST_FILTER", L"DISABLED_Child.*");
    SetEnvironmentVariableW(L"GTEST_ALSO_RUN_DISABLED_TESTS", L"1");
  }
  ~Child() {
    Stop();
    for (const char* szEnd : {"", ".ran", ".stop"})
      WaitUntil([&] { return bOsDeleteFile((m_path + szEnd).c_str()) || !bOsExists((m_path + szEnd).c_str()); });
  }
  // Returns when it has ended.
  void Stop() const {
    TestFolder::WriteFile(m_path + ".stop", "");
    if (!bOsExists((m_path + ".ran").c_str())) return;
    const auto dwProcess = static_cast<DWORD>(atol(TestFolder::ReadFile(m_path + ".ran").c_str()));
    if (const HANDLE hProcess = OpenProcess(SYNCHRONIZE, FALSE, dwProcess)) {
      WaitForSingleObject(hProcess, 60000);
      CloseHandle(hProcess);
    }
  }
  // "folder|command line" once it has run.
  std::string Ran() const {
    WaitUntil([this] { return bOsExists((m_path + ".ran").c_str()); });
    const std::string ran = TestFolder::ReadFile(m_path + ".ran");
    return ran.substr(ran.find('|') + 1);
  }

 private:
  std::string m_path;
};

TEST(CommandPrograms, AreStartedByTheirFullPathInTheirOwnFolder) {
  CommandsRun commands;
  commands.run.folder.MakeFolder("other folder");
  const std::string other = commands.run.folder.Path("other folder"), program = other + "\\halvex.exe";
  const std::string start = other + "|\"" + program + "\"";
  commands.Set("halvex_path", other);
  const struct {
    const char *szCommand, *szArguments;
    int iResult;
  } rows[] = {{"RunHalvex (halvex.exe;bar.dll)", "", 0},
              {"StopHalvex (halvex.exe)", " -server --deinstall", 0},
              {"InstallWizard (halvex.exe)", "", 0},
              {"StartDorvik (http://a.example/b c)", " \"http://a.example/b c\"", 2}};
  static const char APP[] = "SOFTWARE\\Microsoft\\Windows\\CurrentVersion\\App Paths\\orbit-browser.exe";
  COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, APP, "", program.c_str(), nullptr);
  commands.run.context.csTempFolder = (other + "\\").c_str();
  commands.Set("browser", "orbit-browser.exe");
  commands.Do("btn_no_cro_supp_a_OnClick ()");
  for (const auto& row : rows) {
    const Child child(program);
    EXPECT_EQ(commands.Do(row.szCommand), row.iResult);
    const std::string ran = child.Ran();
    EXPECT_EQ(ran.substr(0, start.size()), start) << row.szCommand;
    EXPECT_NE(ran.find(row.szArguments), std::string::npos) << ran;
  }
  EXPECT_TRUE(commands.run.Saw("message Error|The toolbar could not be registered:\n\nbar.dll"));
  EXPECT_FALSE(commands.run.Saw("open "));
  COrbitWizard::iDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, APP);
  const std::string library = std::string(getenv("windir")) + "\\system32\\avifil32.dll";
  EXPECT_EQ(commands.Do("DeinstallToolbar (" + library + ")"), 0);
  EXPECT_EQ(commands.Do("DeinstallToolbar (" + std::string(getenv("windir")) + "\\system32\\user32.dll)"), 1);
}

TEST(CommandPrograms, ThatRunAreToBeClosedFirst) {
  CommandsRun commands;
  const Child child(commands.Path("Plumo.exe"));
  HeadlessView& view = commands.run.view;
  EXPECT_EQ(commands.Do("RunHalvex (Plumo.exe)"), 0);
  child.Ran();
  commands.Set("browser", "Plumo.exe");
  const std::string toolbar = "DeinstallToolbar (" + std::string(getenv("windir")) + "\\system32\\avifil32.dll)";
  commands.OnPage([&] {  // the script's own box, with nothing but OK
    view.answers = {ANSWER_OK};
    EXPECT_EQ(commands.Do(toolbar), 2);
    EXPECT_TRUE(commands.run.Saw("message Close|Plumo.exe runs"));
  });
  const struct {
    const char* szCommand;
    std::vector<int> answers;
    bool bStopsAtFirst;
    int iResult;
    size_t nBoxes;
  } rows[] = {{"CheckIfSoftwareIsRuning (nobody.exe)", {ANSWER_RETRY, ANSWER_CANCEL}, false, 2, 2},  // by its folder
              {"CheckIfSoftwareIsRuning (x.exe; PLUMO.EXE)", {ANSWER_CANCEL}, false, 2, 1},
              {"CheckForFolder (Plumo.exe)", {ANSWER_CANCEL}, false, 0, 1},
              {"CheckForFolder ()", {}, false, 5, 0},
              {"CheckIfSoftwareIsRuning ()", std::vector<int>(1000, ANSWER_RETRY), true, 0, 1}};
  commands.OnPage([&] {
    for (const auto& row : rows) {
      view.events.clear();
      view.answers = row.answers;
      view.onEvent = [&](const std::string& event) {
        if (!row.bStopsAtFirst || event.find("message") == std::string::npos) return;
        child.Stop();
        OsSleep(10);  // the system may still list it for a moment: then the box comes once more
      };
      EXPECT_EQ(commands.Do(row.szCommand), row.iResult) << row.szCommand;
      size_t nBoxes = 0;
      for (const std::string& event : view.events) nBoxes += event.find("while these programs run:") != event.npos;
      EXPECT_TRUE(nBoxes == row.nBoxes || (row.bStopsAtFirst && nBoxes > row.nBoxes)) << row.szCommand << nBoxes;
    }
    EXPECT_EQ(commands.Get("running_programs"), "Plumo.exe");
  });
}

TEST(CommandBrowser, ItsSetupRunsBehindDisabledButtons) {
  CommandsRun commands;
  CNString csProgram;
  bOsGetProgramPath(csProgram);
  csProgram.Trim('\\');
  const std::string folder = std::string(csProgram.Text()) + "\\IE 6.0";
  OsMakeFolder(folder.c_str());
  {
    const Child child(folder + "\\ie6setup.exe");
    commands.OnPage([&] {
      int iResult = -1;
      EXPECT_EQ(commands.run.wizard.iExecuteCommand("InstallIE ()", 0, &iResult), 0);
      EXPECT_EQ(iResult, COMMAND_DONE);
      EXPECT_EQ(child.Ran().substr(0, folder.size()), folder);
      EXPECT_FALSE(commands.run.view.pState("b_next")->enabled);
      EXPECT_TRUE(commands.run.wizard.bTaskRuns());
      child.Stop();
      while (commands.run.wizard.bTaskRuns()) OsSleep(5);
    });
    EXPECT_EQ(commands.Get("pressed"), "1");
  }
  EXPECT_TRUE(bOsDeleteFolder(folder.c_str()));
}
