#include "InstallerRun.h"
#include "installer/CommandNames.h"

// The vocabulary in the order in which names are compared, second names after their row's first.
static const char VOCABULARY[] =
    "SetQuitInstall InstallWizard install_wizard_OnClick SetVersion btn_no_cro_supp_a_OnClick "
    "btn_no_cro_supp_b_OnClick "
    "BackupOldHalvex SearchNet FillNetListView CreateNetShortCut CheckForMabFon SetUnzipVar CheckForOldVersion "
    "RemoveOldLinks CheckForCDInstallation CopyKVIniFile CopySpeechFile SetInterfaceLang CreateSizeFile "
    "AddToContextMenu UpdateRegistry CheckForFolder btn_next_folder_OnClick FinalizeInstallation Unzip Reboot End "
    "InitDefaultPath GetUsers InstallTessor GetDictionaries GetLangSupport InstallLangSupport WriteUserProfile "
    "dictionaries_OnClick dictionaries_OnSelChange b_browse_OnClick SetAllowedDict SetExpansionCardTotalSize "
    "CheckIfHotSyncInit CheckIfHotSyncIsFinished CheckIfAllIsInstalled RemoveNotInstalledFiles web_OnClick "
    "mail_OnClick "
    "RunHalvex StopHalvex DeinstallToolbar CheckIfSoftwareIsRuning CheckForIEVersion InstallIE "
    "CheckForInstalledSoftware AddColvaneToOldInstallation StartDorvik btn_end_OnClick ParseDefaultPath CheckForProxy "
    "CheckActiveSync InstallMirab b_next_Mab_OnClick btn_next_OnClick btn_back_OnClick AddScheduledTask "
    "CheckRegistryEntry StartHalvexMsg CheckFreeSpace GetFreeMemSize run_app_OnClick ";

TEST(CommandTable, HoldsAllNamesInTheirOrder) {
  std::string names;
  for (const InstallCommandName& row : INSTALL_COMMAND_NAMES) {
    names += std::string(row.szName) + " ";
    if (row.szSecondName) names += std::string(row.szSecondName) + " ";
  }
  EXPECT_EQ(names, VOCABULARY);
}

TEST(CommandTable, FindsNamesWithoutRegardToCase) {
  EXPECT_EQ(iFindInstallCommand("SETQUITINSTALL"), 0);
  EXPECT_EQ(iFindInstallCommand("unzip"), 22);
  EXPECT_EQ(iFindInstallCommand("BTN_next_folder_onclick"), 20);
  EXPECT_EQ(iFindInstallCommand("run_app_OnClick"), 62);
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

TEST_F(InstallCommands, RefusesMissingArguments) {
  const struct {
    const char *szCommand, *szParam, *szCondition;
  } rows[] = {{nullptr, "", "!szCommand"}, {"", "", "!*szCommand"}, {"Unzip", nullptr, "!szParam"}};
  for (const auto& row : rows) {
    m_log.Clear();
    EXPECT_EQ(Call(row.szCommand, row.szParam), PRECONDITIONS_NOT_VALID);
    EXPECT_EQ(m_iResult, COMMAND_FAILED);
    EXPECT_EQ(m_log.Lines(), std::vector<std::string>{std::string("ERROR: CNInstallWizard::iExecuteFunction -> ") +
                                                      row.szCondition + " -> return PRECONDITIONS_NOT_VALID"});
  }
}

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

TEST_F(InstallCommands, SmallCommandsAnswer) {
  EXPECT_EQ(Call("CheckForMabFon"), EVERYTHING_IS_OK);
  EXPECT_EQ(m_iResult, COMMAND_NEGATIVE);
  EXPECT_EQ(Call("btn_no_cro_supp_b_OnClick"), EVERYTHING_IS_OK);
  EXPECT_EQ(m_run.Value("bInstallWizard_B"), "1");
  EXPECT_EQ(Call("mail_OnClick", "mailto:x@y.example"), EVERYTHING_IS_OK);
  EXPECT_TRUE(m_run.Saw("open mailto:x@y.example"));
  m_run.wizard.iSetVariable("upgrade", "0");
  EXPECT_EQ(Call("Reboot"), EVERYTHING_IS_OK);
  EXPECT_TRUE(m_run.folder.Exists("Records.dat"));
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
  EXPECT_EQ(m_log.Lines(),
            (std::vector<std::string>{
                "ERROR: CNInstallWizard::iInitDefaultPath -> !default_path -> return FUNCTION_ERROR",
                "ERROR: CNInstallWizard::iExecuteFunction -> iInitDefaultPath -> return FUNCTION_ERROR"}));
  m_run.wizard.iSetVariable("default_path", "Tavola\\Plumo");
  EXPECT_EQ(Call("InitDefaultPath"), EVERYTHING_IS_OK);
  const std::string first = m_run.Value("default_path");
  EXPECT_NE(first.find(":\\"), std::string::npos);
  EXPECT_EQ(first.substr(first.size() - 13), "\\Tavola\\Plumo");
  EXPECT_EQ(Call("InitDefaultPath"), EVERYTHING_IS_OK);
  EXPECT_EQ(m_run.Value("default_path"), first);
}
