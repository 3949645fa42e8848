#include <set>

#include "InstallerRun.h"
#include "installer/InstallJournal.h"

using Steps = std::vector<InstallerRun::Step>;

class Extraction : public testing::Test {
 protected:
  void SetUp() override {
    m_run.Load();
    m_run.folder.MakeFolder("target");
  }
  // Goes to page 5 and waits until extraction has ended.
  void Extract(const Steps& then = {}) {
    m_run.Run(m_run.ToDestination(m_run.Destination()) +
              Steps{InstallerRun::Press("btn_next_folder"), InstallerRun::Press("b_next")} + then);
  }

  InstallerRun m_run;
};

TEST_F(Extraction, InstallsAndListsEveryFile) {
  Extract({m_run.ExpectPage("PL-dlg6")});
  EXPECT_EQ(m_run.InstalledBytes("Plumo.exe"), "program");
  EXPECT_EQ(m_run.InstalledBytes("Help\\Deep\\read me.txt"), "help");
  EXPECT_EQ(m_run.InstalledBytes("Help\\empty.txt"), "");
  EXPECT_EQ(
      m_run.InstalledBytes("Installed.lst"),
      "F Plumo.exe\r\nF UnInstall.exe\r\nF OrbitTestUnInstall.exe\r\nD Help\r\nD Help\\Deep\r\nF Help\\Deep\\read "
      "me.txt\r\nF Help\\empty.txt\r\nW OrbitTestUnInstall.exe\r\n");
  EXPECT_FALSE(m_run.Saw("message"));
}

TEST_F(Extraction, ContinuesTheListOfAnEarlierInstallation) {
  TestFolder::WriteFile(m_run.Destination() + "\\Installed.lst", "F older.dat\r\n");
  m_run.folder.MakeFolder("target/Help");
  m_run.SetArchive({{"Help/new.txt", "x"}});
  Extract();
  EXPECT_EQ(m_run.InstalledBytes("Installed.lst").substr(0, 31), "F older.dat\r\nF Help\\new.txt\r\n");
}

TEST_F(Extraction, AMissingOrDamagedArchiveIsToldAndEnds) {
  std::string wrong = MakeTestArchive({{"Plumo.exe", "program"}});
  wrong[20] ^= 1;
  std::string damaged = Number(500) + "short";
  uint32_t sum = 0;
  for (const char c : damaged) sum += static_cast<unsigned char>(c);
  damaged += Number(0u - sum) + Number(0);  // the check value is right, the entries are not
  const struct {
    const std::string* pBytes;
    const char* szMessage;
  } rows[] = {{nullptr, "Records.dat file is missing."},
              {&wrong, "Records.dat file is corrupted."},
              {&damaged, "Records.dat file is corrupted."}};
  for (const auto& row : rows) {
    InstallerRun run;
    run.Load();
    run.folder.MakeFolder("target");
    if (row.pBytes)
      run.SetArchiveBytes(*row.pBytes);
    else
      run.context.csExpandedFile = run.folder.Path("gone.dat").c_str();
    run.Run(run.ToDestination(run.Destination()) +
            Steps{InstallerRun::Press("btn_next_folder"), InstallerRun::Press("b_next")});
    EXPECT_TRUE(run.Saw(std::string("message Error!|") + row.szMessage)) << row.szMessage;
    EXPECT_FALSE(run.bRanOut);
    EXPECT_FALSE(run.wizard.bHoldsQuit());
    EXPECT_TRUE(run.folder.Names("target").empty());
    EXPECT_EQ(InstallerRun::LinksThere(), "0000");
  }
}

TEST_F(Extraction, FailedEntriesAreNamedAtTheEndAndDoNotStopTheOthers) {
  m_run.SetArchive({{"..\\outside.txt", "x"},
                    {"Plumo.exe", "program"},
                    {"C:\\x", "x"},
                    {"nul", "x"},
                    {"a:b", "x"},
                    {"OrbitTestUnInstall.exe", "remover"}});
  Extract({m_run.ExpectPage("PL-dlg6")});
  EXPECT_TRUE(m_run.Saw("message Error!|Some files could not be installed:\n\n..\\outside.txt\nC:\\x\nnul\na:b\n"));
  EXPECT_EQ(m_run.InstalledBytes("Plumo.exe"), "program");
  EXPECT_FALSE(m_run.folder.Exists("outside.txt"));
}

TEST_F(Extraction, EntriesNamedLikeSetupsOwnRecordsAreRefused) {
  m_run.SetArchive({{"installed.LST", "F victim.txt\r\n"},
                    {"Uninstall.log", "000"},
                    {"config.ini", "[General]"},
                    {"Help\\Uninstall.log", "help"},
                    {"OrbitTestUnInstall.exe", "remover"}});
  TestLog log(m_run.folder);
  Extract({m_run.ExpectPage("PL-dlg6")});
  EXPECT_TRUE(
      m_run.Saw("message Error!|Some files could not be installed:\n\ninstalled.LST\nUninstall.log\nconfig.ini\n\n"));
  EXPECT_EQ(m_run.InstalledBytes("Installed.lst"),
            "D Help\r\nF Help\\Uninstall.log\r\nF OrbitTestUnInstall.exe\r\nW OrbitTestUnInstall.exe\r\n");
  EXPECT_NE(m_run.InstalledBytes("Uninstall.log").find("program_name="), std::string::npos);
  EXPECT_EQ(m_run.InstalledBytes("config.ini").substr(0, 3), "005");
  const std::vector<std::string> lines = log.Lines();
  for (const char* szName : {"installed.LST", "Uninstall.log", "config.ini"})
    EXPECT_EQ(std::count(lines.begin(), lines.end(),
                         std::string("ERROR: ExtractionPass::ExtractOne -> bIsOwnRecord(") + szName + ") -> return"),
              1);
}

TEST_F(Extraction, SlidesAreShownOnceWhileFilesAreSlowedDown) {
  std::string script = m_run.scripts.csInstaller.Text();
  const std::string at = "  TEXT_FIELD 'files'";
  script.insert(script.find(at), "  TEXT_FIELD 's1' \"one\" 0 0 9 9\n  TEXT_FIELD 's2' \"two\" 0 0 9 9,HIDE\n");
  m_run.scripts.csInstaller = script.c_str();
  m_run.Load();
  m_run.wizard.iSetVariable("commercial", "s1;s2");
  m_run.wizard.Extraction().uSlideInterval = 200;
  m_run.SetArchive({{"a", "1"}, {"OrbitTestUnInstall.exe", "2"}});
  std::set<std::string> seen;
  m_run.whileWorking = [&] {
    CNString csText;
    for (const char* szName : {"percent", "files"})
      if (m_run.wizard.CWGetWindowText(szName, csText)) seen.insert(csText.Text());
  };
  const uint32_t uStart = OsTickCount();
  Extract({m_run.ExpectPage("PL-dlg6")});
  const uint32_t uTime = OsTickCount() - uStart;
  // 400 ms spread over the files: 200 after the first, then 400, cut short when both slides have been shown.
  EXPECT_GE(uTime, 350u);
  EXPECT_LT(uTime, 10000u);
  for (const char* szText : {"a", "50%", "OrbitTestUnInstall.exe", "100%"}) EXPECT_TRUE(seen.count(szText)) << szText;
  EXPECT_EQ(m_run.wizard.Extraction().iSlideCount, 2);
  EXPECT_EQ(m_run.wizard.Extraction().bAllSlidesShown, 1);
}

TEST(InstallJournal, AppendsOneLineAtATime) {
  TestFolder folder;
  {
    InstallJournal journal((folder.Root() + "\\").c_str());
    EXPECT_TRUE(folder.Names().empty());  // nothing is made before there is something to list
    journal.OnFolder("Rje\xE8nik");
    EXPECT_EQ(folder.Read("Installed.lst"), "D Rje\xE8nik\r\n");  // there before the file is filled
    journal.OnFile("Rje\xE8nik\\a.txt");
    EXPECT_FALSE(journal.bFailed());
  }
  InstallJournal((folder.Root() + "\\").c_str()).OnWindowsFile("un.exe");
  EXPECT_EQ(folder.Read("Installed.lst"), "D Rje\xE8nik\r\nF Rje\xE8nik\\a.txt\r\nW un.exe\r\n");
  InstallJournal broken((folder.Root() + "\\missing\\").c_str());
  broken.OnFile("x");
  EXPECT_TRUE(broken.bFailed());
}
