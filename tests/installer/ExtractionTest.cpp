#include <sstream>

#include "InstallerRun.h"
#include "installer/InstallJournal.h"

class Extraction : public testing::Test {
 protected:
  void SetUp() override {
    m_run.Load();
    m_run.folder.MakeFolder("target");
  }
  // The files are copied, by the fixture's run unless told otherwise, always to its destination.
  void Extract() { ExtractBy(m_run); }
  void ExtractBy(InstallerRun& run) {
    run.Run(run.ThroughDestination(m_run.Destination()) + Steps{Press("b_next"), run.ExpectPage("PL-dlg6")});
  }

  // The list's lines of these kinds, without their ends.
  std::string Listed(const std::string& kinds = "FDWN") const {
    std::string lines, line;
    for (std::istringstream list(m_run.InstalledBytes("Installed.lst")); std::getline(list, line);)
      if (kinds.find(line[0]) != std::string::npos) lines += line.substr(0, line.size() - 1) + ";";
    return lines;
  }

  InstallerRun m_run;
};

TEST_F(Extraction, InstallsAndListsEveryFile) {
  Extract();
  EXPECT_EQ(m_run.InstalledBytes("Plumo.exe"), "program");
  EXPECT_EQ(m_run.InstalledBytes("Help\\Deep\\read me.txt"), "help");
  EXPECT_EQ(m_run.InstalledBytes("Help\\empty.txt"), "");
  EXPECT_EQ(Listed(),
            "F Plumo.exe;F UnInstall.exe;F OrbitTestUnInstall.exe;D Help;D Help\\Deep;F Help\\Deep\\read me.txt;"
            "F Help\\empty.txt;W OrbitTestUnInstall.exe;");
  EXPECT_EQ(Listed("S").find("S 000000007 1c0000000000000 0;S 000000007 "), 0u);
  EXPECT_EQ(Listed("R"), "R Uninstall.log;R config.ini;");
  EXPECT_EQ(Listed("V").find("V program_name=Orbit Test Product;V program_folder=Orbit Test Folder;V "), 0u);
  EXPECT_FALSE(m_run.Saw("message"));
}

TEST_F(Extraction, ContinuesTheListOfAnEarlierInstallationAndTakesAwayWhatOnlyThatHad) {
  const std::string list = m_run.Destination() + "\\Installed.lst";
  for (const char* szProduct : {"Another Product", "Orbit Test Product"}) {
    m_run.folder.MakeFolder("target/Old");
    for (const char* szFile : {"stale.dat", "Old\\stale.dat", "edited.dat", "unlisted.dat", "unmade.dat"})
      TestFolder::WriteFile(m_run.Destination() + "\\" + szFile, "old");
    TestFolder::WriteFile(list,
                          "V program_name=" + std::string(szProduct) +
                              "\r\nF older.dat\r\nD Old\r\nF Old\\stale.dat\r\nF stale.dat\r\nF edited.dat\r\nS 2 0 "
                              "0\r\nF unmade.dat\r\nN\r\nF ..\\Records.dat\r\nF cut");
    InstallerRun run;
    run.Load();
    run.SetArchive({{"Help/new.txt", "x"}, {"OrbitTestUnInstall.exe", "x"}});
    ExtractBy(run);
    EXPECT_EQ(Listed("F").find("F older.dat;F Old\\stale.dat;F stale.dat;F edited.dat;F unmade.dat;"
                               "F ..\\Records.dat;F cut|;F Help\\new.txt;"),
              0u);
    const bool bSame = *szProduct == 'O';
    EXPECT_EQ(m_run.Installed("stale.dat"), !bSame);
    EXPECT_EQ(m_run.Installed("Old"), !bSame);
    for (const char* szStays : {"edited.dat", "unlisted.dat", "unmade.dat"}) EXPECT_TRUE(m_run.Installed(szStays));
    EXPECT_TRUE(m_run.folder.Exists("Records.dat"));
  }
}

// A file that is in use: it is named, counted, and kept as it was known; the next run replaces it.
TEST_F(Extraction, WhatIsHeldIsToldAndTheNextRunCompletesIt) {
  TestFolder::WriteFile(m_run.Destination() + "\\Plumo.exe", "old");
  TestFolder::WriteFile(m_run.Destination() + "\\Installed.lst", "V program_name=Orbit Test Product\r\nF gone.dat\r\n");
  TestFolder::WriteFile(m_run.Destination() + "\\gone.dat", "old");
  TestLog log(m_run.folder);
  {
    OsFile held;
    ASSERT_TRUE(held.bOpen((m_run.Destination() + "\\Plumo.exe").c_str(), OsOpenMode::Truncate));
    Extract();
  }
  EXPECT_TRUE(m_run.Saw("message Error!|Some files could not be installed:\n\nPlumo.exe\n\n"));
  const std::vector<std::string> lines = log.Lines();
  EXPECT_EQ(std::count(lines.begin(), lines.end(),
                       "ERROR: CNInstallWizard::iUnzipThread -> 1 of 5 entries not installed -> return "
                       "EVERYTHING_IS_OK"),
            1);
  EXPECT_EQ(Listed().find("F gone.dat;F Plumo.exe;N;F UnInstall.exe;"), 0u);
  EXPECT_TRUE(m_run.Installed("gone.dat")) << "nothing is taken away by a run that is not whole";
  InstallerRun again;
  again.Load();
  ExtractBy(again);
  EXPECT_EQ(m_run.InstalledBytes("Plumo.exe"), "program");
  EXPECT_FALSE(m_run.Installed("gone.dat"));
  EXPECT_FALSE(again.Saw("message"));
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
    run.Run(run.Copying());
    EXPECT_TRUE(run.Saw(std::string("message Error!|") + row.szMessage)) << row.szMessage;
    EXPECT_FALSE(run.bRanOut);
    EXPECT_FALSE(run.wizard.bHoldsQuit());
    EXPECT_TRUE(run.folder.Names("target").empty());
    EXPECT_EQ(InstallerRun::LinksThere(), "0000");
  }
}

TEST_F(Extraction, WhatMayNotBeMadeIsNamedAtTheEndAndDoesNotStopTheOthers) {
  m_run.SetArchive({{"..\\outside.txt", "x"},
                    {"Plumo.exe", "program"},
                    {"C:\\x", "x"},
                    {"nul", "x"},
                    {"installed.LST", "F victim.txt\r\n"},  // setup's own records
                    {"Uninstall.log", "000"},
                    {"config.ini", "[General]"},
                    {"Help\\Uninstall.log", "help"},
                    {"OrbitTestUnInstall.exe", "remover"}});
  TestLog log(m_run.folder);
  Extract();
  EXPECT_TRUE(
      m_run.Saw("message Error!|Some files could not be installed:\n\n..\\outside.txt\nC:\\x\nnul\ninstalled.LST\n"
                "Uninstall.log\nconfig.ini\n\n"));
  EXPECT_EQ(m_run.InstalledBytes("Plumo.exe"), "program");
  EXPECT_FALSE(m_run.folder.Exists("outside.txt"));
  EXPECT_EQ(Listed(), "F Plumo.exe;D Help;F Help\\Uninstall.log;F OrbitTestUnInstall.exe;W OrbitTestUnInstall.exe;");
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
  m_run.SetArchive({{"a", "1"}, {"b", "2"}, {"c", "3"}, {"OrbitTestUnInstall.exe", "4"}});
  const uint32_t uStart = OsTickCount();
  Extract();
  // 400 ms spread over the files: 100 after the first, up to 400 after the last; cut short when both have been shown.
  EXPECT_GE(OsTickCount() - uStart, 350u);
  for (const char* szText : {"a", "50%", "OrbitTestUnInstall.exe", "100%"})
    EXPECT_TRUE(m_run.view.texts.count(szText)) << szText;
  EXPECT_EQ(m_run.wizard.Extraction().iSlideCount, 2);
  EXPECT_EQ(m_run.wizard.Extraction().bAllSlidesShown, 1);
}

TEST(InstallJournal, AppendsOneLineAtATime) {
  TestFolder folder;
  {
    InstallJournal journal((folder.Root() + "\\").c_str());
    EXPECT_TRUE(folder.Names().empty());  // nothing is made before there is something to list
    journal.bOnFolder("Rje\xE8nik");
    EXPECT_EQ(folder.Read("Installed.lst"), "D Rje\xE8nik\r\n");  // there before the folder is made
    EXPECT_TRUE(journal.bOnFile("Rje\xE8nik\\a.txt"));
    journal.OnFileDone({uint64_t{5} << 32, 7, 0xabc});
    EXPECT_TRUE(journal.bOnFile("b"));
    journal.OnFileNotMade();
    EXPECT_TRUE(journal.bOnValue("key", "two\r\nlines"));
    EXPECT_FALSE(journal.bFailed());
  }
  std::string bytes =
      "D Rje\xE8nik\r\nF Rje\xE8nik\\a.txt\r\nS 500000000 000000007 abc\r\nF b\r\nN\r\nV key=two  lines\r\n";
  EXPECT_EQ(folder.Read("Installed.lst"), bytes);
  folder.Write("Installed.lst", bytes + "F cut");
  InstallJournal((folder.Root() + "\\").c_str()).OnWindowsFile("un.exe");
  EXPECT_EQ(folder.Read("Installed.lst"), bytes + "F cut|\r\nW un.exe\r\n");
  InstallJournal broken((folder.Root() + "\\missing\\").c_str());
  EXPECT_FALSE(broken.bOnFile("x"));
  EXPECT_TRUE(broken.bFailed());
}
