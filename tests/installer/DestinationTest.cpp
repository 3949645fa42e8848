#include "InstallerRun.h"

class Destination : public testing::Test {
 protected:
  void SetUp() override { m_run.Load(); }
  // Types the path on page 3 and presses Next; what follows is looked at by further steps.
  void RunNext(const std::string& path, const std::vector<InstallerRun::Step>& then) {
    m_run.Run(m_run.ToDestination(path) + std::vector<InstallerRun::Step>{InstallerRun::Press("btn_next_folder")} +
              then);
  }
  std::string Field() const {
    const HeadlessView::ControlState* pState = m_run.view.pState("default_path");
    return pState ? pState->text : "no field";
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
    run.Run(run.ToDestination(outside.Path("there\\made\\deep")) +
            std::vector<InstallerRun::Step>{InstallerRun::Press("btn_next_folder"), run.ExpectPage("PL-dlg4"),
                                            InstallerRun::Press("b_cancel"), InstallerRun::Press("b_exit")});
    EXPECT_TRUE(bOsIsFolder(outside.Path("there\\made\\deep").c_str()));
  }
  EXPECT_TRUE(bOsIsFolder(outside.Path("there").c_str()));
  EXPECT_TRUE(outside.Names("there").empty());
}

TEST_F(Destination, StaysAndCreatesNothingOnNo) {
  m_run.view.answers = {ANSWER_NO};
  const std::string path = m_run.Destination();
  RunNext(path, {m_run.ExpectPage("PL-dlg3"), [&](HeadlessView&) { EXPECT_EQ(Field(), path); }});
  EXPECT_FALSE(bOsExists(path.c_str()));
}

TEST_F(Destination, TakesAnExistingFolderWithoutAQuestionAndLeavesItEmpty) {
  m_run.folder.MakeFolder("target");
  RunNext(m_run.Destination() + "\\", {m_run.ExpectPage("PL-dlg4")});
  EXPECT_FALSE(m_run.Saw("message"));
  EXPECT_TRUE(m_run.folder.Names("target").empty());
  EXPECT_EQ(m_run.Value("default_path"), m_run.Destination());
}

TEST_F(Destination, DropsBlanksAtTheEndAsTheFileSystemDoes) {
  m_run.folder.MakeFolder("target");
  RunNext(m_run.Destination() + "\\  ", {m_run.ExpectPage("PL-dlg4")});
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
    run.Run(run.ToDestination(path) +
            std::vector<InstallerRun::Step>{InstallerRun::Press("btn_next_folder"), run.ExpectPage("PL-dlg3")});
    EXPECT_TRUE(run.Saw("message Setup|The directory:\n\n'" + path + "'\n\ncannot be used: ")) << path;
    EXPECT_TRUE(run.bRanOut) << path;
  }
  EXPECT_EQ(m_run.folder.Read("target"), "a file");
}

TEST_F(Destination, AnEmptyFieldIsAnErrorAndAsksWhetherToLeave) {
  RunNext("", {InstallerRun::Press("b_resume"), m_run.ExpectPage("PL-dlg3")});
  EXPECT_TRUE(m_run.Saw("dialog dlg1"));
}

TEST_F(Destination, ABackAfterARefusalGoesToThePageBefore) {
  m_run.view.answers = {ANSWER_NO};
  RunNext(m_run.Destination(), {InstallerRun::Press("b_back"), m_run.ExpectPage("PL-dlg2"),
                                InstallerRun::Press("b_back"), m_run.ExpectPage("PL-dlg1")});
}

TEST_F(Destination, WithoutAnArchiveThePageStaysAndSaysSo) {
  m_run.context.csExpandedFile.Free();
  RunNext(m_run.Destination(),
          {m_run.ExpectPage("PL-dlg3"), InstallerRun::Press("b_back"), m_run.ExpectPage("PL-dlg2")});
  EXPECT_TRUE(m_run.Saw("Records.dat file is missing."));
  EXPECT_FALSE(bOsExists(m_run.Destination().c_str()));
}

TEST_F(Destination, BrowsePutsTheChoiceIntoFieldAndVariable) {
  m_run.folder.MakeFolder("chosen");
  m_run.view.choices = {m_run.folder.Path("chosen")};
  m_run.Run(m_run.ToDestination("C:\\typed") +
            std::vector<InstallerRun::Step>{InstallerRun::Press("b_browse"), m_run.ExpectPage("PL-dlg3"),
                                            [this](HeadlessView&) { EXPECT_EQ(Field(), m_run.folder.Path("chosen")); },
                                            InstallerRun::Press("b_browse"),  // cancelled
                                            InstallerRun::Press("btn_next_folder"), m_run.ExpectPage("PL-dlg4")});
  EXPECT_TRUE(m_run.Saw("choose Choose directory:"));
  EXPECT_EQ(m_run.Value("default_path"), m_run.folder.Path("chosen"));
}

TEST_F(Destination, AFullDriveKeepsThePageAndItsWayBack) {
  m_run.folder.Write("Records.dat", std::string(100000, 'x'));
  m_run.wizard.freeBytes = 179999;
  RunNext(m_run.Destination(), {m_run.ExpectPage("PL-dlg3"), InstallerRun::Press("b_back"), m_run.ExpectPage("PL-dlg2"),
                                InstallerRun::Press("b_next"), m_run.ExpectPage("PL-dlg3"),
                                [this](HeadlessView&) { m_run.wizard.freeBytes = 180000; },
                                InstallerRun::Press("btn_next_folder"), m_run.ExpectPage("PL-dlg4")});
  const std::string drive = m_run.Destination().substr(0, 1);
  EXPECT_TRUE(m_run.Saw("message Setup|You do not have enough place on your " + drive +
                        ": drive.\nPlease exit the Setup program and free 195 KB of space on your hard disk."));
}

TEST_F(Destination, AFullTemporaryDriveIsToldBeforeTheFirstPage) {
  InstallerRun run;
  run.folder.Write("Records.dat", std::string(100000, 'x'));
  run.wizard.freeBytes = 10;
  EXPECT_EQ(run.wizard.iExecuteInstallWizard(run.folder.Path("Records.dat").c_str()), 0);
  EXPECT_TRUE(run.Saw("free 292 KB of space"));
  EXPECT_EQ(run.Value("version"), "");
}

TEST_F(Destination, SpaceCheckRefusesItsArgumentsAndIgnoresOtherModes) {
  TestLog log(m_run.folder);
  EXPECT_FALSE(m_run.wizard.bCheckForDiskSpace(true, "", "x", SPACE_ON_DESTINATION));
  EXPECT_FALSE(m_run.wizard.bCheckForDiskSpace(true, "C:\\", nullptr, SPACE_ON_DESTINATION));
  EXPECT_EQ(log.Lines(), (std::vector<std::string>{
                             "ERROR: CNInstallWizard::bCheckForDiskSpace -> !szDrive || !*szDrive -> return FALSE",
                             "ERROR: CNInstallWizard::bCheckForDiskSpace -> !szFile || !*szFile -> return FALSE"}));
  EXPECT_TRUE(m_run.wizard.bCheckForDiskSpace(true, "C:\\", "no such file", SPACE_ON_DESTINATION));
  m_run.wizard.freeBytes = 0;
  EXPECT_TRUE(m_run.wizard.bCheckForDiskSpace(true, "C:\\", m_run.context.GetExpandedFile(), 2));
  EXPECT_TRUE(m_run.view.events.empty());
}

TEST(CreateDirectory, MakesEveryMissingFolder) {
  TestFolder folder;
  TestLog log(folder);
  EXPECT_EQ(CNInstallWizard::iCreateDirectory(folder.Path("a\\b\\c\\").c_str()), 0);
  EXPECT_TRUE(folder.Exists("a\\b\\c"));
  EXPECT_EQ(CNInstallWizard::iCreateDirectory(folder.Path("a\\b").c_str()), 0);
  EXPECT_TRUE(log.Lines().empty());
  EXPECT_EQ(CNInstallWizard::iCreateDirectory(nullptr), PRECONDITIONS_NOT_VALID);
  EXPECT_EQ(CNInstallWizard::iCreateDirectory(""), PRECONDITIONS_NOT_VALID);
  folder.Write("file", "");
  EXPECT_EQ(CNInstallWizard::iCreateDirectory(folder.Path("file\\x").c_str()), FUNCTION_ERROR);
  EXPECT_EQ(log.Lines().size(), 3u);
}
