// The pages before anything is copied: the destination, and leaving the wizard.
#include "InstallerRun.h"
#include "installer/CNExitInstallWizard.h"

class Destination : public testing::Test {
 protected:
  void SetUp() override { m_run.Load(); }
  // Types the path on page 3 and presses Next; what follows is looked at by further steps.
  void RunNext(const std::string& path, const Steps& then) { m_run.Run(m_run.ThroughDestination(path) + then); }
  Step ExpectField(const std::string& path) {
    return [this, path](HeadlessView& view) { EXPECT_EQ(view.pState("default_path")->text, path); };
  }

  InstallerRun m_run;
};

TEST_F(Destination, CreatesAMissingFolderOnYes) {
  m_run.view.answers = {ANSWER_YES};
  const std::string path = m_run.Destination() + "\\deep\\er";
  RunNext(path + "\\", {m_run.ExpectPage("PL-dlg4")});
  EXPECT_TRUE(bOsIsFolder(path.c_str()));
  EXPECT_TRUE(m_run.Saw("message Setup|The directory:\n\n'" + path +
                        "'\n\ndoes not exist. Do you want the directory to be created? -> 6"));
  EXPECT_EQ(m_run.Value("default_path"), path);
}

TEST(DestinationLeft, TheFoldersMadeForNothingGoAtTheEndAndOthersStay) {
  TestFolder outside;
  outside.MakeFolder("there");
  {
    InstallerRun run;
    run.Load();
    run.view.answers = {ANSWER_YES};
    run.Run(run.ThroughDestination(outside.Path("there\\made\\deep")) +
            Steps{run.ExpectPage("PL-dlg4"), Press("b_cancel"), Press("b_exit")});
    EXPECT_TRUE(bOsIsFolder(outside.Path("there\\made\\deep").c_str()));
  }
  EXPECT_TRUE(bOsIsFolder(outside.Path("there").c_str()));
  EXPECT_TRUE(outside.Names("there").empty());
}

TEST_F(Destination, StaysAndCreatesNothingOnNo) {
  m_run.view.answers = {ANSWER_NO};
  RunNext(m_run.Destination(), {m_run.ExpectPage("PL-dlg3"), ExpectField(m_run.Destination()), Press("b_back"),
                                m_run.ExpectPage("PL-dlg2"), Press("b_back"), m_run.ExpectPage("PL-dlg1")});
  EXPECT_FALSE(bOsExists(m_run.Destination().c_str()));
}

TEST_F(Destination, TakesAnExistingFolderWithoutAQuestionAndLeavesItEmpty) {
  m_run.folder.MakeFolder("target");
  RunNext(m_run.Destination() + "\\  ", {m_run.ExpectPage("PL-dlg4")});  // the file system drops blanks too
  EXPECT_FALSE(m_run.Saw("message"));
  EXPECT_TRUE(m_run.folder.Names("target").empty());
  EXPECT_EQ(m_run.Value("default_path"), m_run.Destination());
}

TEST_F(Destination, RefusesWhatCannotBeAFolder) {
  m_run.folder.Write("target", "a file");
  const std::string longPath = m_run.folder.Path(std::string(300, 'x'));
  for (const std::string& path : {m_run.Destination(), m_run.Destination() + "\\below", std::string("Tavola\\Plumo"),
                                  std::string("Q:\\no\\drive"), std::string("\\rooted"), longPath}) {
    InstallerRun run;
    run.Load();
    run.view.answers = {ANSWER_YES, ANSWER_OK};
    run.Run(run.ThroughDestination(path) + Steps{run.ExpectPage("PL-dlg3")});
    EXPECT_TRUE(run.Saw("message Setup|The directory:\n\n'" + path + "'\n\ncannot be used: ")) << path;
    EXPECT_TRUE(run.bRanOut) << path;
  }
  EXPECT_EQ(m_run.folder.Read("target"), "a file");
}

TEST_F(Destination, AnEmptyFieldIsAnErrorAndAsksWhetherToLeave) {
  RunNext("", {Press("b_resume"), m_run.ExpectPage("PL-dlg3")});
  EXPECT_TRUE(m_run.Saw("dialog dlg1"));
}

TEST_F(Destination, WithoutAnArchiveThePageStaysAndSaysSo) {
  m_run.context.csExpandedFile.Free();
  RunNext(m_run.Destination(), {m_run.ExpectPage("PL-dlg3"), Press("b_back"), m_run.ExpectPage("PL-dlg2")});
  EXPECT_TRUE(m_run.Saw("Records.dat file is missing."));
  EXPECT_FALSE(bOsExists(m_run.Destination().c_str()));
}

TEST_F(Destination, BrowsePutsTheChoiceIntoFieldAndVariable) {
  const std::string chosen = m_run.folder.Path("chosen");
  m_run.folder.MakeFolder("chosen");
  m_run.view.choices = {chosen};
  m_run.Run({Press("b_next"), Press("b_next"), Press("b_browse"), m_run.ExpectPage("PL-dlg3"), ExpectField(chosen),
             Press("b_browse"),  // cancelled
             Press("btn_next_folder"), m_run.ExpectPage("PL-dlg4")});
  EXPECT_TRUE(m_run.Saw("choose Choose directory:"));
  EXPECT_EQ(m_run.Value("default_path"), chosen);
}

TEST_F(Destination, AFullDriveKeepsThePageAndItsWayBack) {
  m_run.folder.Write("Records.dat", std::string(100000, 'x'));
  m_run.wizard.freeBytes = 179999;
  RunNext(m_run.Destination(),
          {m_run.ExpectPage("PL-dlg3"), Press("b_back"), m_run.ExpectPage("PL-dlg2"), Press("b_next"),
           m_run.ExpectPage("PL-dlg3"), [this](HeadlessView&) { m_run.wizard.freeBytes = 180000; },
           Press("btn_next_folder"), m_run.ExpectPage("PL-dlg4")});
  const std::string drive = m_run.Destination().substr(0, 1);
  EXPECT_TRUE(m_run.Saw("message Setup|You do not have enough place on your " + drive +
                        ": drive.\nPlease exit the Setup program and free 195 KB of space on your hard disk."));
}

TEST(DestinationSpace, AFullTemporaryDriveIsToldBeforeTheFirstPage) {
  InstallerRun run;
  run.folder.Write("Records.dat", std::string(100000, 'x'));
  run.wizard.freeBytes = 10;
  EXPECT_EQ(run.wizard.iExecuteInstallWizard(run.folder.Path("Records.dat").c_str()), 0);
  EXPECT_TRUE(run.Saw("free 292 KB of space"));
  EXPECT_EQ(run.Value("version"), "");
  EXPECT_TRUE(run.wizard.bCheckForDiskSpace(true, "C:\\", run.context.GetExpandedFile(), 2)) << "another mode";
}

// ---- leaving ----

class Leaving : public testing::Test {
 protected:
  void SetUp() override { m_run.Load(); }

  InstallerRun m_run;
};

TEST_F(Leaving, ResumeStaysOnEveryPageAndExitEnds) {
  for (const char* szBack : {"b_cancel", "close box"}) {
    InstallerRun run;
    run.Load();
    const auto leave = std::string(szBack) == "b_cancel" ? Press("b_cancel") : CloseBox();
    run.folder.MakeFolder("target");
    run.Run(Steps{leave, Press("b_resume"), run.ExpectPage("PL-dlg1"), Press("b_next"), leave, CloseBox(),
                  run.ExpectPage("PL-dlg2"), Press("b_next"), Type("default_path", run.Destination()), leave,
                  Press("b_resume"), run.ExpectPage("PL-dlg3"), Press("btn_next_folder"), leave, Press("b_resume"),
                  run.ExpectPage("PL-dlg4"), leave, Press("b_exit")});
    EXPECT_FALSE(run.bRanOut) << szBack;
    EXPECT_FALSE(run.view.bHasWindow());
    EXPECT_TRUE(run.folder.Names("target").empty());
    EXPECT_EQ(InstallerRun::LinksThere(), "0000");
  }
}

TEST_F(Leaving, IsHeldBackWhileBusy) {
  m_run.Run(Steps{[this](HeadlessView&) { m_run.wizard.Extraction().iBusy = 1; }, Press("b_cancel"), CloseBox(),
                  [](HeadlessView& view) { view.PostCommand(ID_EXIT); }, m_run.ExpectPage("PL-dlg1"),
                  [this](HeadlessView&) {
                    EXPECT_TRUE(m_run.wizard.bHoldsQuit());
                    m_run.wizard.Extraction().iBusy = 0;
                  },
                  [](HeadlessView& view) { view.PostCommand(ID_EXIT); }});
  EXPECT_FALSE(m_run.bRanOut);
  EXPECT_FALSE(m_run.Saw("dialog dlg1"));
}

TEST_F(Leaving, AnUnaskableUserIsLetGo) {
  m_run.scripts.csExit.Free();
  m_run.Run(Steps{Press("b_cancel")});
  EXPECT_FALSE(m_run.bRanOut);
}

TEST_F(Leaving, AFlowThatEndsEarlyAsksToo) {
  std::string script = m_run.scripts.csInstaller.Text();
  const size_t nFlow = script.find("CONTINUE");
  script.replace(nFlow, 8, "");  // page 1 ends the wizard
  m_run.scripts.csInstaller = script.c_str();
  m_run.Load();
  m_run.Run(Steps{Press("b_next"), Press("b_resume"), m_run.ExpectPage("PL-dlg1"), Press("b_next"), Press("b_exit")});
  EXPECT_FALSE(m_run.bRanOut);
}

TEST(ExpansionPage, StaysWhileTheExpansionRunsAndClosesAfterAFailure) {
  CarriedScripts scripts;
  HeadlessView view;
  LoadSourceScripts(scripts);
  struct Work {
    std::atomic<int> iTries{0};
  } work;
  view.onIdle = [&work](HeadlessView& shown) {
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
  CNExitInstallWizard wizard(view, expand, &work);
  EXPECT_EQ(wizard.iExecuteWizard(scripts.csPleaseWait.Text(), 0), 0);
  EXPECT_GE(work.iTries, 5);
  EXPECT_EQ(wizard.ExpansionResult(), 7);
  EXPECT_EQ(wizard.ExitConfirmed(), 0);
}
