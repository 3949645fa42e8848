#include "InstallerRun.h"
#include "installer/ShellFolder.h"
#include "installer/ShellLinks.h"

class Finalization : public testing::Test {
 protected:
  void SetUp() override {
    m_run.Load();
    m_run.folder.MakeFolder("target");
  }
  // From the first page to the last, with a name and a company.
  void Install(const Steps& onPage4, const Steps& onPage6) {
    m_run.Run(Steps{Press("b_next"), Type("name", "Ivana \xE8i\xE6"), Type("company", "Tavola = d.o.o."),
                    Press("b_next"), Type("default_path", m_run.Destination()), Press("btn_next_folder")} +
              onPage4 + Steps{Press("b_next"), m_run.ExpectPage("PL-dlg6")} + onPage6);
  }

  InstallerRun m_run;
};

TEST_F(Finalization, LeavesAWholeInstallationBehind) {
  const std::string target = m_run.Destination();
  TestFolder::WriteFile(target + "\\Uninstall.log", "an older one");
  Install({}, {Press("web"), Press("run_app")});
  EXPECT_FALSE(m_run.bRanOut);
  EXPECT_FALSE(m_run.Saw("message"));
  EXPECT_TRUE(m_run.Saw("open http://www.orbit-setup.example/plumo"));
  EXPECT_TRUE(m_run.Saw("open " + target + "\\Plumo.exe"));

  EXPECT_EQ(m_run.InstalledBytes("Uninstall.log"),
            "005\r\nprogram_name=Orbit Test Product\r\nprogram_folder=Orbit Test "
            "Folder\r\ndefault_path=" +
                target + "\r\nquick_launch=1\r\ndict_path=none");
  EXPECT_EQ(m_run.InstalledBytes("config.ini"),
            "005\r\nDir=" + target + "\\\r\nUserDir=" + target +
                "\\New\\\r\nFirstTime=1\r\nUser=Ivana \xE8i\xE6\r\nCompany=Tavola = "
                "d.o.o.");
  EXPECT_FALSE(m_run.Installed("OrbitTestUnInstall.exe"));
  EXPECT_EQ(TestFolder::ReadFile(std::string(getenv("windir")) + "\\OrbitTestUnInstall.exe"), "remover 1");

  EXPECT_EQ(InstallerRun::LinksThere(), "1111");
  const std::vector<std::string> links = InstallerRun::Links();
  for (size_t i = 0; i < links.size(); i++) {
    ShellLink link;
    ASSERT_EQ(iResolveIt(links[i].c_str(), link), 0) << links[i];
    const std::string program = target + (i == 1 ? "\\UnInstall.exe" : "\\Plumo.exe");
    EXPECT_STRCASEEQ(link.csTarget.Text(), program.c_str());
    EXPECT_STREQ(link.csWorkingFolder.Text(), target.c_str());
    EXPECT_STREQ(link.csIcon.Text(), program.c_str());
    EXPECT_EQ(std::string(link.csArguments.Text()), i == 1 ? target : "");
    EXPECT_EQ(std::string(link.csDescription.Text()), "Location: " + target);
  }
}

TEST_F(Finalization, ClearedBoxesLeaveTheirShortcutsOut) {
  Install({Press("desktop_shortcut"), Press("quick_launch")}, {Press("run_app")});
  EXPECT_EQ(InstallerRun::LinksThere(), "1100");
  EXPECT_NE(m_run.InstalledBytes("Uninstall.log").find("quick_launch=0"), std::string::npos);
}

TEST_F(Finalization, NamesMayBeEmptyAndTheFolderMayHaveBlanks) {
  m_run.folder.MakeFolder("my target");
  m_run.Run(m_run.ThroughDestination(m_run.folder.Path("my target")) +
            Steps{Press("b_next"), m_run.ExpectPage("PL-dlg6"), CloseBox()});
  EXPECT_FALSE(m_run.bRanOut || m_run.Saw("dialog dlg1")) << "the last page closes without a question";
  ShellLink link;
  ASSERT_EQ(iResolveIt(InstallerRun::Links()[1].c_str(), link), 0);
  EXPECT_EQ(std::string(link.csArguments.Text()), "\"" + m_run.folder.Path("my target") + "\"");
  const std::string settings = m_run.folder.Read("my target\\config.ini");
  EXPECT_NE(settings.find("\r\nUser=\r\nCompany="), std::string::npos) << settings;
}

TEST_F(Finalization, ASecondRunReplacesTheRecord) {
  Install({}, {[this](HeadlessView&) {
            const std::string first = m_run.InstalledBytes("Uninstall.log"),
                              list = m_run.InstalledBytes("Installed.lst");
            int iResult = -1;
            EXPECT_EQ(m_run.wizard.iExecuteFunction("FinalizeInstallation", "", 0, &iResult, nullptr), 0);
            EXPECT_EQ(iResult, COMMAND_DONE);
            EXPECT_EQ(m_run.InstalledBytes("Uninstall.log"), first);
            EXPECT_EQ(m_run.InstalledBytes("Installed.lst"), list);
          }});
}

TEST_F(Finalization, TheProgramFolderStaysInTheStartMenu) {
  const auto Folder = [](const char* szName) { return Steps{Type("program_folder", szName)}; };
  Install(Folder("..\\Orbit Test Outside"), {CloseBox()});
  EXPECT_TRUE(m_run.Saw("This step failed: making the shortcuts in the program folder"));
  const std::string programs = InstallerRun::ShellFolder(OS_HKEY_LOCAL_MACHINE, "Common Programs");
  EXPECT_FALSE(bOsExists((programs + "\\..\\Orbit Test Outside").c_str()));
  EXPECT_EQ(InstallerRun::LinksThere(), "0011");
  EXPECT_TRUE(m_run.Installed("Uninstall.log"));  // it can be removed all the same

  InstallerRun run;
  run.Load();
  run.folder.MakeFolder("target");
  run.Run(run.ThroughDestination(run.Destination()) + Folder("Orbit Test Folder. ") +
          Steps{Press("b_next"), run.ExpectPage("PL-dlg6"), CloseBox()});
  EXPECT_FALSE(run.Saw("message"));
  EXPECT_EQ(InstallerRun::LinksThere(), "1111");
  // The uninstaller refuses a name that ends in a dot or a blank.
  EXPECT_NE(run.InstalledBytes("Uninstall.log").find("\r\nprogram_folder=Orbit Test Folder\r\n"), std::string::npos);
}

TEST_F(Finalization, AnotherProgramsSettingsAreNotTouched) {
  const std::string settings = "[General]\r\nColour=green\r\n";
  TestFolder::WriteFile(m_run.Destination() + "\\config.ini", settings);
  Install({}, {CloseBox()});
  EXPECT_TRUE(m_run.Saw("This step failed: writing the settings file config.ini"));
  EXPECT_EQ(m_run.InstalledBytes("config.ini"), settings);
}

TEST_F(Finalization, TheUninstallerStaysWhereItIsInTheWindowsFolder) {
  const std::string windows = getenv("windir"), uninstaller = windows + "\\OrbitTestUnInstall.exe";
  Install({}, {[&](HeadlessView&) {
            int iResult = -1;
            m_run.wizard.iSetVariable("default_path", windows.c_str());
            EXPECT_EQ(m_run.wizard.iExecuteFunction("FinalizeInstallation", "", 0, &iResult, nullptr), 0);
            EXPECT_EQ(TestFolder::ReadFile(uninstaller), "remover 1");
            bOsDeleteFile((windows + "\\Uninstall.log").c_str());
          }});
}

TEST(ShellFolder, IsAnAbsolutePathWithItsVariablesFilledIn) {
  static const char KEY[] = "Software\\Microsoft\\Windows\\CurrentVersion\\Explorer\\Shell Folders";
  const struct {
    std::string value, folder;
  } rows[] = {{"%windir%\\x", std::string(getenv("windir")) + "\\x"},
              {"C:\\a b", "C:\\a b"},
              {"\\\\server\\share", "\\\\server\\share"},
              {"%no such variable%\\x", "none"},
              {"relative", "none"},
              {"", "none"}};
  for (const auto& row : rows) {
    COrbitWizard::iWriteRegistryKey(OS_HKEY_CURRENT_USER, KEY, "Orbit Test", row.value.c_str(), nullptr);
    CNString csFolder;
    const bool bFound = bGetShellFolder("Orbit Test", "Orbit Test", csFolder);
    EXPECT_EQ(bFound ? csFolder.Text() : "none", row.folder);
  }
  COrbitWizard::iDeleteRegistryValue(OS_HKEY_CURRENT_USER, KEY, "Orbit Test");
  CNString csFolder;
  EXPECT_FALSE(bGetShellFolder(nullptr, "Orbit Test", csFolder));
}

TEST_F(Finalization, AFailedStepIsTold) {
  m_run.SetArchive({{"Plumo.exe", "program"}});  // the uninstaller is not there to be moved
  TestLog log(m_run.folder);
  Install({}, {});
  EXPECT_TRUE(
      m_run.Saw("message Setup|The installation is not complete.\n\nThis step failed: moving the uninstall program"));
  const std::vector<std::string> lines = log.Lines();
  EXPECT_NE(std::find(lines.begin(), lines.end(),
                      "ERROR: CNInstallWizard::iExecuteFunction -> iFinalizeInstallation -> return FUNCTION_ERROR"),
            lines.end());
}

TEST_F(Finalization, MissingNamesFailWithTheirLine) {
  TestLog log(m_run.folder);
  int iResult = 0;
  m_run.wizard.iSetVariable("program_name", "");
  EXPECT_EQ(m_run.wizard.iExecuteFunction("UpdateRegistry", "ND", 0, &iResult, nullptr), FUNCTION_ERROR);
  EXPECT_EQ(iResult, COMMAND_FAILED);
  EXPECT_EQ(m_run.wizard.iExecuteFunction("FinalizeInstallation", "", 0, &iResult, nullptr), FUNCTION_ERROR);
  EXPECT_EQ(log.Lines(),
            (std::vector<std::string>{
                "ERROR: CNInstallWizard::iUpdateRegistry -> !program_name -> return FUNCTION_ERROR",
                "ERROR: CNInstallWizard::iExecuteFunction -> iUpdateRegistry -> return FUNCTION_ERROR",
                "ERROR: CNInstallWizard::iFinalizeInstallation -> !m_pWizDialogInfo -> return FUNCTION_ERROR",
                "ERROR: CNInstallWizard::iExecuteFunction -> iFinalizeInstallation -> return FUNCTION_ERROR"}));
}
