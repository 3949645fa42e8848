// Commands that start programs, wait for them or want them closed, with real processes.
#include <windows.h>

#include "CommandsRun.h"
#include "foundation/os/OsWide.h"

// The test program under other names is the program that commands start: it writes down how, and runs until a file
// appears beside it. Only a child is told to run this test.
TEST(DISABLED_Child, TellsHowItWasStarted) {
  CNString csProgram, csFolder;
  ASSERT_TRUE(bOsGetProgramPath(csProgram) && bOsGetCurrentFolder(csFolder));
  const std::string program = csProgram.Text();
  CNString csLine;
  bNarrow(GetCommandLineW(), csLine);
  TestFolder::WriteFile(program + ".part", std::string(csFolder.Text()) + "|" + csLine.Text());
  bOsRename((program + ".part").c_str(), (program + ".ran").c_str());
  const bool bStops = strstr(csLine.Text(), "--deinstall") != nullptr;
  for (int i = 0; !bStops && i < 2000 && !bOsExists((program + ".stop").c_str()); i++) OsSleep(10);
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
    for (int i = 0; i < 500 && !bOsDeleteFile(m_path.c_str()); i++) OsSleep(10);
  }
  void Stop() const { TestFolder::WriteFile(m_path + ".stop", ""); }
  // "folder|command line" once it has run.
  std::string Ran() const {
    OsFile file;
    for (int i = 0; i < 1000 && !file.bOpen((m_path + ".ran").c_str(), OsOpenMode::Read); i++) OsSleep(10);
    return file.bIsOpen() ? TestFolder::ReadFile(m_path + ".ran") : "never";
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
    child.Stop();
    for (const char* szEnd : {".ran", ".stop"})
      for (int i = 0; i < 300 && !bOsDeleteFile((program + szEnd).c_str()); i++) OsSleep(10);
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
              {"CheckIfSoftwareIsRuning ()", {ANSWER_RETRY, ANSWER_RETRY}, true, 0, 1}};
  commands.OnPage([&] {
    for (const auto& row : rows) {
      view.events.clear();
      view.answers = row.answers;
      view.onEvent = [&](const std::string& event) {
        if (!row.bStopsAtFirst || event.find("message") == std::string::npos) return;
        child.Stop();
        OsSleep(1500);
      };
      EXPECT_EQ(commands.Do(row.szCommand), row.iResult) << row.szCommand;
      size_t nBoxes = 0;
      for (const std::string& event : view.events) nBoxes += event.find("while these programs run:") != event.npos;
      if (row.bStopsAtFirst)
        EXPECT_GE(nBoxes, row.nBoxes);
      else
        EXPECT_EQ(nBoxes, row.nBoxes) << row.szCommand;
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
  for (const char* szEnd : {".ran", ".stop"}) bOsDeleteFile((folder + "\\ie6setup.exe" + szEnd).c_str());
  EXPECT_TRUE(bOsDeleteFolder(folder.c_str()));
}
