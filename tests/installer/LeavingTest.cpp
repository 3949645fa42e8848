#include "InstallerRun.h"
#include "installer/CNExitInstallWizard.h"

using Steps = std::vector<InstallerRun::Step>;

class Leaving : public testing::Test {
 protected:
  void SetUp() override { m_run.Load(); }

  InstallerRun m_run;
};

TEST_F(Leaving, ResumeStaysOnEveryPageAndExitEnds) {
  for (const char* szBack : {"b_cancel", "close box"}) {
    InstallerRun run;
    run.Load();
    const auto leave = std::string(szBack) == "b_cancel" ? InstallerRun::Press("b_cancel") : InstallerRun::CloseBox();
    run.folder.MakeFolder("target");
    run.Run(Steps{leave, InstallerRun::Press("b_resume"), run.ExpectPage("PL-dlg1"), InstallerRun::Press("b_next"),
                  leave, InstallerRun::CloseBox(), run.ExpectPage("PL-dlg2"), InstallerRun::Press("b_next"),
                  InstallerRun::Type("default_path", run.Destination()), leave, InstallerRun::Press("b_resume"),
                  run.ExpectPage("PL-dlg3"), InstallerRun::Press("btn_next_folder"), leave,
                  InstallerRun::Press("b_resume"), run.ExpectPage("PL-dlg4"), leave, InstallerRun::Press("b_exit")});
    EXPECT_FALSE(run.bRanOut) << szBack;
    EXPECT_FALSE(run.view.bHasWindow());
    EXPECT_TRUE(run.folder.Names("target").empty());
    EXPECT_EQ(InstallerRun::LinksThere(), "0000");
  }
}

TEST_F(Leaving, ResumeKeepsWhatWasTyped) {
  m_run.Run(Steps{InstallerRun::Press("b_next"), InstallerRun::Type("name", "Ivana \xE8i\xE6"),
                  InstallerRun::Press("b_cancel"), InstallerRun::Press("b_resume"), InstallerRun::Press("b_next"),
                  InstallerRun::Press("b_back"),
                  [](HeadlessView& view) { EXPECT_EQ(view.pState("name")->text, "Ivana \xE8i\xE6"); }});
  EXPECT_EQ(m_run.Value("name"), "Ivana \xE8i\xE6");
}

TEST_F(Leaving, IsHeldBackWhileBusy) {
  m_run.Run(Steps{[this](HeadlessView&) { m_run.wizard.Extraction().iBusy = 1; }, InstallerRun::Press("b_cancel"),
                  InstallerRun::CloseBox(), [](HeadlessView& view) { view.PostCommand(ID_EXIT); },
                  m_run.ExpectPage("PL-dlg1"),
                  [this](HeadlessView&) {
                    EXPECT_TRUE(m_run.wizard.bHoldsQuit());
                    m_run.wizard.Extraction().iBusy = 0;
                  },
                  [](HeadlessView& view) { view.PostCommand(ID_EXIT); }});
  EXPECT_FALSE(m_run.bRanOut);
  EXPECT_FALSE(m_run.Saw("dialog dlg1"));
}

TEST_F(Leaving, TheLastPageClosesWithoutAQuestion) {
  m_run.folder.MakeFolder("target");
  m_run.Run(m_run.ToEnd() + Steps{InstallerRun::CloseBox()});
  EXPECT_FALSE(m_run.bRanOut);
  EXPECT_FALSE(m_run.Saw("dialog dlg1"));
}

TEST_F(Leaving, AnUnaskableUserIsLetGo) {
  m_run.scripts.csExit.Free();
  m_run.Run(Steps{InstallerRun::Press("b_cancel")});
  EXPECT_FALSE(m_run.bRanOut);
}

TEST_F(Leaving, AFlowThatEndsEarlyAsksToo) {
  std::string script = m_run.scripts.csInstaller.Text();
  const size_t nFlow = script.find("CONTINUE");
  script.replace(nFlow, 8, "");  // page 1 ends the wizard
  m_run.scripts.csInstaller = script.c_str();
  m_run.Load();
  m_run.Run(Steps{InstallerRun::Press("b_next"), InstallerRun::Press("b_resume"), m_run.ExpectPage("PL-dlg1"),
                  InstallerRun::Press("b_next"), InstallerRun::Press("b_exit")});
  EXPECT_FALSE(m_run.bRanOut);
}

// ---- the exit confirmation and the expansion page by themselves ----

class ExitWizard : public testing::Test {
 protected:
  ExitWizard() { LoadSourceScripts(m_scripts); }

  CarriedScripts m_scripts;
  HeadlessView m_view;
};

TEST_F(ExitWizard, ConfirmsOnlyByItsButton) {
  for (const char* szButton : {"b_exit", "b_resume", "close box"}) {
    HeadlessView view;
    CNExitInstallWizard wizard(view);
    view.onIdle = [szButton](HeadlessView& shown) {
      if (!shown.bPress(szButton)) shown.Close();
      return true;
    };
    EXPECT_EQ(wizard.iExecuteWizard(m_scripts.csExit.Text(), 0), 0);
    EXPECT_EQ(wizard.ExitConfirmed(), std::string(szButton) == "b_exit") << szButton;
  }
}

TEST_F(ExitWizard, AnswersItsTwoCommandsOnly) {
  TestFolder folder;
  TestLog log(folder);
  CNExitInstallWizard wizard(m_view);
  int iResult = 0;
  EXPECT_EQ(wizard.iExecuteFunction("", "", 0, &iResult, nullptr), PRECONDITIONS_NOT_VALID);
  EXPECT_EQ(wizard.iExecuteFunction("ExpandStream", nullptr, 0, &iResult, nullptr), PRECONDITIONS_NOT_VALID);
  EXPECT_EQ(iResult, COMMAND_FAILED);
  EXPECT_EQ(wizard.iExecuteFunction("Next", "", 0, &iResult, nullptr), FUNCTION_ERROR);
  EXPECT_EQ(iResult, COMMAND_FAILED);
  EXPECT_EQ(wizard.iExecuteFunction("b_exit_OnClick", "", 0, &iResult, nullptr), EVERYTHING_IS_OK);
  EXPECT_EQ(iResult, COMMAND_EXIT);
  EXPECT_EQ(log.Lines(),
            (std::vector<std::string>{"ERROR: CNExitInstallWizard::iExecuteFunction -> !szCommand || !*szCommand -> "
                                      "return PRECONDITIONS_NOT_VALID",
                                      "ERROR: CNExitInstallWizard::iExecuteFunction -> !szParam -> return "
                                      "PRECONDITIONS_NOT_VALID"}));
}

TEST_F(ExitWizard, ThePageStaysWhileTheExpansionRunsAndClosesAfterAFailure) {
  struct Work {
    std::atomic<int> iTries{0};
  } work;
  m_view.onIdle = [&work](HeadlessView& shown) {
    shown.Close();
    shown.PostCommand(ID_CLOSE);
    work.iTries++;
    OsSleep(1);
    return true;
  };
  const auto expand = [](void* pContext) {
    while (static_cast<Work*>(pContext)->iTries < 5) OsSleep(1);
    return 7;
  };
  CNExitInstallWizard wizard(m_view, expand, &work);
  EXPECT_EQ(wizard.iExecuteWizard(m_scripts.csPleaseWait.Text(), 0), 0);
  EXPECT_GE(work.iTries, 5);
  EXPECT_EQ(wizard.ExpansionResult(), 7);
  EXPECT_EQ(wizard.ExitConfirmed(), 0);
}
