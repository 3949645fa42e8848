#include "Removal.h"

#include <windows.h>

#include "System.h"
#include "foundation/os/OsRegistry.h"
#include "foundation/os/OsWide.h"
#include "installer/ShellLinks.h"
#include "support/TestFolder.h"
#include "wizard/COrbitWizard.h"

static const char PROGRAM[] = "Orbit Test Removal";
static const char KEY[] = "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\Orbit Test Removal";

// An installation in "product", with UnInstall.exe as the running program.
class Removing : public testing::Test {
 protected:
  void SetUp() override {
    m_folder.MakeFolder("product");
    for (const char* szFile : {"Plumo.exe", "UnInstall.exe", "old.txt"})
      m_folder.Write(std::string("product\\") + szFile, szFile);
    m_folder.Write("product\\config.ini", "002\r\nDir=" + Product() + "\\\r\nUser=Ana");
    Log("Orbit Test Removal", "");
    List("F Plumo.exe\r\nF UnInstall.exe\r\n");
    Enter(Product() + "\\UnInstall.exe " + Product());
  }
  void TearDown() override {
    COrbitWizard::iDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, KEY);
    for (const std::string& link : m_links) bOsDeleteFile(link.c_str());
  }

  std::string Product() const { return m_folder.Path("product"); }
  void List(const std::string& lines) { m_folder.Write("product\\Installed.lst", lines); }
  static void Enter(const std::string& command) {
    EXPECT_EQ(COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, KEY, "UninstallString", command.c_str(), nullptr),
              0);
  }
  static bool bEntered() { return OsRegistryKey().bOpen(OS_HKEY_LOCAL_MACHINE, KEY, OsRegAccess::Read); }
  // Makes a shortcut on the user's desktop; whether it is there still tells the file's existence.
  std::string Link(const char* szName, const std::string& target) {
    char szDesktop[512] = "";
    COrbitWizard::iReadRegistryKey(OS_HKEY_CURRENT_USER,
                                   "Software\\Microsoft\\Windows\\CurrentVersion\\Explorer\\Shell Folders", "Desktop",
                                   szDesktop);
    ShellLink link;
    link.csTarget = target.c_str();
    m_links.push_back(std::string(szDesktop) + "\\" + szName);
    EXPECT_EQ(iCreateLink(link, m_links.back().c_str()), 0);
    return m_links.back();
  }
  static bool bThere(const std::string& path) { return bOsExists(path.c_str()); }
  // What could not be removed, and what is not known; "refused" when nothing is known of an installation.
  std::string Remove(const std::string& folder) {
    Installation installation;
    if (!installation.bRead(folder.c_str())) return "refused";
    RunLog log;
    Removal removal(installation, (Product() + "\\UnInstall.exe").c_str(), log);
    removal.RemoveAllButOwn();
    m_bOwnRemains = removal.bOwnRemains();
    removal.FindKept();
    m_kept = removal.Kept().Text();
    m_unknown = installation.csUnknown.Text();
    return removal.Failures().Text();
  }
  // A text value of the registry; "" when there is none.
  static std::string Text(OsRegKey hRoot, const std::string& key, const char* szName = "") {
    CNString csText;
    return bReadRegistryText(hRoot, key.c_str(), szName, csText) ? csText.Text() : "";
  }
  static void SetClass(const std::string& key, const std::string& text, const char* szName = "") {
    EXPECT_EQ(COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, ("Software\\Classes\\" + key).c_str(), szName,
                                              text.c_str(), nullptr),
              0);
  }
  void Log(const char* szProgramFolder, const std::string& lines) {
    m_folder.Write("product\\Uninstall.log", std::string("003\r\nprogram_name=") + PROGRAM + "\r\nprogram_folder=" +
                                                 szProgramFolder + "\r\ndefault_path=" + Product() + lines);
  }

  TestFolder m_folder;
  std::vector<std::string> m_links;
  std::string m_kept, m_unknown, m_values;
  bool m_bOwnRemains = false;
};

TEST_F(Removing, TakesWhatWasInstalledAndOnlyShortcutsToIt) {
  const std::string ours = Link("Orbit Test 1.lnk", Product() + "\\Plumo.exe"),
                    users = Link("Orbit Test 2.lnk", Product() + "\\old.txt"),
                    other = Link("Orbit Test 3.lnk", m_folder.Root());
  EXPECT_EQ(Remove(Product()), "");
  EXPECT_TRUE(m_bOwnRemains);
  EXPECT_EQ(m_folder.Names("product"), (std::vector<std::string>{"Installed.lst", "UnInstall.exe", "old.txt"}));
  EXPECT_FALSE(bThere(ours));
  EXPECT_TRUE(bThere(users));
  EXPECT_TRUE(bThere(other));
  EXPECT_FALSE(bEntered());
}

// A product in a drive's root: everything else on the drive lies inside its folder.
TEST_F(Removing, LeavesOtherProgramsShortcutsWhenTheFolderIsTheirsToo) {
  m_folder.Write("another.exe", "x");
  for (const char* szFile : {"Uninstall.log", "Installed.lst"})
    m_folder.Write(szFile, m_folder.Read(std::string("product\\") + szFile));
  const std::string other = Link("Orbit Test 4.lnk", m_folder.Path("another.exe"));
  EXPECT_EQ(Remove(m_folder.Root()), "");
  EXPECT_TRUE(bThere(other));
  EXPECT_TRUE(m_folder.Exists("product\\Plumo.exe"));
  EXPECT_TRUE(bEntered());  // it starts another folder's uninstaller
}

TEST_F(Removing, KnowsItselfHoweverTheFolderIsSpelled) {
  std::string folder = m_folder.Path("product\\..\\PRODUCT");
  EXPECT_EQ(Remove(folder), "");
  EXPECT_TRUE(m_bOwnRemains);
  EXPECT_TRUE(m_folder.Exists("product\\UnInstall.exe"));
  EXPECT_FALSE(bEntered());
}

TEST_F(Removing, CanBeRepeatedWhenAFileIsHeld) {
  const HANDLE hHolder = CreateFileW(Wide((Product() + "\\Plumo.exe").c_str()), GENERIC_READ, FILE_SHARE_READ, nullptr,
                                     OPEN_EXISTING, 0, nullptr);
  EXPECT_EQ(Remove(Product()), Product() + "\\Plumo.exe\n");
  EXPECT_FALSE(m_bOwnRemains);
  EXPECT_EQ(m_folder.Names("product").size(), 6u);
  EXPECT_TRUE(bEntered());
  CloseHandle(hHolder);
  EXPECT_EQ(Remove(Product()), "");
  EXPECT_TRUE(m_bOwnRemains);
  EXPECT_FALSE(bEntered());
}

TEST_F(Removing, WhatTheUserChangedOrAddedStaysAndIsNamed) {
  OsFileInfo info;
  ASSERT_TRUE(bOsGetFileInfo((Product() + "\\Plumo.exe").c_str(), info));
  char szTime[32];
  snprintf(szTime, sizeof(szTime), "%lx%08lx", static_cast<unsigned long>(info.times.lastWrite >> 32),
           static_cast<unsigned long>(info.times.lastWrite));
  const std::string time = szTime;
  m_folder.MakeFolder("product/mine");
  for (const char* szFile : {"product\\changed.txt", "product\\again.txt", "product\\mine\\added.txt"})
    m_folder.Write(szFile, "the user's");
  // Of "again" only the last line counts, and that run did not touch it.
  List("F Plumo.exe\r\nS 9 " + time + " 0\r\nF changed.txt\r\nF changed.txt\r\nS 8 " + time +
       " 0\r\nF again.txt\r\nS 8 " + time + " 0\r\nF again.txt\r\nN\r\nF UnInstall.exe\r\nD mine\r\n");
  EXPECT_EQ(Remove(Product()), "");
  EXPECT_FALSE(m_folder.Exists("product\\Plumo.exe"));
  for (const char* szName : {"changed.txt\n", "again.txt\n", "mine\\added.txt\n", "old.txt\n"})
    EXPECT_NE(m_kept.find(Product() + "\\" + szName), std::string::npos) << szName;
  EXPECT_EQ(std::count(m_kept.begin(), m_kept.end(), '\n'), 4);
  EXPECT_EQ(m_unknown, "");
}

TEST_F(Removing, SurvivesRecordsThatAreMissingOrDamaged) {
  const std::string log = m_folder.Read("product\\Uninstall.log"), list = m_folder.Read("product\\Installed.lst");
  const char szNoLog[] = "Uninstall.log is missing or damaged", szNoList[] = "Installed.lst is missing";
  const std::string values = "V program_name=" + std::string(PROGRAM) + "\r\nV default_path=" + Product() + "\r\n";
  const struct {
    const char *szLog, *szList;  // null: missing
    bool bEntry;
    const char* szUnknown;
    bool bPlumoGoes, bEntryGoes;
  } rows[] = {
      {nullptr, list.c_str(), true, szNoLog, true, true},  // its name is found by the entry
      {nullptr, list.c_str(), false, szNoLog, true, true},
      {"\x01\x02garbage", list.c_str(), true, szNoLog, true, true},
      {nullptr, (m_values = values + list).c_str(), false, "", true, true},  // broke off before the log
      {nullptr, m_values.c_str(), true, szNoLog, true, true},                // did not: the entry comes after the log
      {log.c_str(), nullptr, true, szNoList, false, true},
      {nullptr, nullptr, true, szNoLog, false, true},
      {log.c_str(), "F Plumo.exe\r\nrubbish\r\nF UnIn", true, "1 of its lines", true, true},
  };
  for (const auto& row : rows) {
    SCOPED_TRACE(&row - rows);
    for (const char* szFile : {"Plumo.exe", "UnInstall.exe"}) m_folder.Write(std::string("product\\") + szFile, szFile);
    const struct {
      const char *szName, *szBytes;
    } records[] = {{"product\\Uninstall.log", row.szLog}, {"product\\Installed.lst", row.szList}};
    for (const auto& record : records)
      if (record.szBytes)
        m_folder.Write(record.szName, record.szBytes);
      else
        bOsDeleteFile(m_folder.Path(record.szName).c_str());
    COrbitWizard::iDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, KEY);
    if (row.bEntry) Enter(Product() + "\\UnInstall.exe " + Product());
    EXPECT_EQ(Remove(Product()), "");
    EXPECT_EQ(*row.szUnknown != 0, m_unknown != "") << m_unknown;
    EXPECT_NE(m_unknown.find(row.szUnknown), std::string::npos) << m_unknown;
    EXPECT_EQ(m_folder.Exists("product\\Plumo.exe"), !row.bPlumoGoes);
    EXPECT_EQ(bEntered(), !row.bEntryGoes);
    EXPECT_FALSE(m_folder.Exists("product\\Uninstall.log"));
  }
  for (const char* szName : {"Uninstall.log", "Installed.lst"})
    bOsDeleteFile(m_folder.Path(std::string("product\\") + szName).c_str());
  EXPECT_EQ(Remove(Product()), "refused");
}

TEST_F(Removing, HalfWrittenRecordsGoAndNothingThatOnlyLooksLikeThem) {
  const std::vector<std::string> half = {"config.ini.1a2b-3c.tmp", "Uninstall.log.0-0.tmp", "Uninstall.new"},
                                 other = {"config.ini.bak", "config.ini.1a2b.tmp", "config.ini.x-1.tmp", "my.1-1.tmp"};
  List("V program_name=" + std::string(PROGRAM) + "\r\nR config.ini\r\nF UnInstall.exe\r\n");
  m_folder.Write("product\\config.ini", "000");
  for (const auto* pNames : {&half, &other})
    for (const std::string& name : *pNames) m_folder.Write("product\\" + name, "x");
  EXPECT_EQ(Remove(Product()), "");
  for (const std::string& name : half) EXPECT_FALSE(m_folder.Exists("product\\" + name)) << name;
  for (const std::string& name : other) EXPECT_TRUE(m_folder.Exists("product\\" + name)) << name;
  EXPECT_FALSE(m_folder.Exists("product\\config.ini"));
}

TEST_F(Removing, WhatIsRegisteredGoesOnlyWhenItLeadsHere) {
  const std::string here = "\"" + Product() + "\\Plumo.exe\" \"%1\"", elsewhere = "\"D:\\other.exe\"";
  SetClass("*\\shell\\OrbitTestA\\command", here);
  SetClass("*\\shell\\OrbitTestB\\command", elsewhere);
  SetClass("OrbitTest.A\\shell\\open\\command", here);
  SetClass("OrbitTest.A\\DefaultIcon", "x");
  SetClass("OrbitTest.B\\shell\\open\\command", elsewhere);
  SetClass("OrbitTest.C\\shell\\open", "half made");
  SetClass(".orbitta", "OrbitTest.A");
  SetClass(".orbittb", "OrbitTest.A");
  SetClass(".orbittb", "text/plain", "Content Type");
  SetClass(".orbittc", "OrbitTest.B");
  SetClass("OrbitTest.D\\CLSID", "not a type of ours");
  Log("Orbit Test Removal",
      "\r\ncontext_menu=*\\shell\\OrbitTestA;*\\shell\\OrbitTestB\r\n"
      "file_types=OrbitTest.A;OrbitTest.B;OrbitTest.C;OrbitTest.D;.orbittc\r\n"
      "registry_key=Software\\Orbit Test\\Removal;Software\\Orbit Test B;SYSTEM\\X\r\nkv_ini=kv.ini");
  COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, "Software\\Orbit Test\\Removal", "Dir",
                                  (Product() + "\\").c_str(), nullptr);
  COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, "Software\\Orbit Test B", "Dir", "D:\\x\\", nullptr);
  m_folder.Write("product\\kv.ini", "[General]\r\nSpeechPath=D:\\speech\r\nInterfaceLanguage=hr\r\n");
  EXPECT_EQ(Remove(Product()), "OrbitTest.D\n.orbittc\nSYSTEM\\X\n");
  const OsRegKey classes = OS_HKEY_CLASSES_ROOT;
  EXPECT_EQ(Text(classes, "*\\shell\\OrbitTestA\\command"), "");
  EXPECT_EQ(Text(classes, "*\\shell\\OrbitTestB\\command"), elsewhere);
  for (const char* szGone : {"*\\shell\\OrbitTestA", "OrbitTest.A", "OrbitTest.C", ".orbitta"})
    EXPECT_FALSE(OsRegistryKey().bOpen(classes, szGone, OsRegAccess::Read)) << szGone;
  EXPECT_EQ(Text(classes, ".orbittb"), "");
  EXPECT_EQ(Text(classes, ".orbittb", "Content Type"), "text/plain");
  EXPECT_EQ(Text(classes, ".orbittc"), "OrbitTest.B");
  EXPECT_EQ(Text(classes, "OrbitTest.D\\CLSID"), "not a type of ours");
  EXPECT_FALSE(OsRegistryKey().bOpen(OS_HKEY_LOCAL_MACHINE, "Software\\Orbit Test", OsRegAccess::Read));
  EXPECT_EQ(Text(OS_HKEY_LOCAL_MACHINE, "Software\\Orbit Test B", "Dir"), "D:\\x\\");
  EXPECT_FALSE(m_folder.Exists("product\\kv.ini"));
}

TEST_F(Removing, FontsTasksAndLinksElsewhereGo) {
  CNString csFonts;
  ASSERT_TRUE(bFontsFolder(csFonts));
  const char szFonts[] = "Software\\Microsoft\\Windows NT\\CurrentVersion\\Fonts";
  const std::string ours = csFonts.Text() + std::string("OrbitTestA.ttf"),
                    other = csFonts.Text() + std::string("OrbitTestB.ttf");
  for (const char* szFile : {"OrbitTestA", "OrbitTestB"}) {
    m_folder.Write("product\\" + std::string(szFile) + ".ttf", "font");
    COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, szFonts, (szFile + std::string(" (TrueType)")).c_str(),
                                    (szFile + std::string(".ttf")).c_str(), nullptr);
  }
  TestFolder::WriteFile(ours, "font");
  TestFolder::WriteFile(other, "another version");
  m_folder.MakeFolder("share");
  const std::string link = Link("Orbit Test 5.lnk", Product() + "\\Plumo.exe"),
                    there = m_folder.Path("share\\Plumo.lnk");
  ASSERT_TRUE(bOsRename(link.c_str(), there.c_str()));
  Log("Orbit Test Removal",
      "\r\nfonts=OrbitTestA.ttf;OrbitTestB.ttf;..\\x.ttf\r\nscheduled_task=Orbit Test no such task\r\nnet_links=" +
          there + ";\\\\no such computer\\share\\Plumo.lnk");
  EXPECT_EQ(Remove(Product()), "..\\x.ttf\n\\\\no such computer\\share\\Plumo.lnk\n");
  EXPECT_FALSE(bThere(ours));
  EXPECT_TRUE(bThere(other));
  EXPECT_EQ(Text(OS_HKEY_LOCAL_MACHINE, szFonts, "OrbitTestA (TrueType)"), "");
  EXPECT_EQ(Text(OS_HKEY_LOCAL_MACHINE, szFonts, "OrbitTestB (TrueType)"), "OrbitTestB.ttf");
  EXPECT_FALSE(bThere(there));
  bOsDeleteFile(other.c_str());
}

TEST_F(Removing, AnotherProgramsSettingsAndFoldersStay) {
  m_folder.Write("product\\config.ini", "[General]\r\nUser=x\r\n[Other]\r\n");
  Log("..\\..\\x", "");
  EXPECT_EQ(Remove(Product()), "..\\..\\x\n");
  EXPECT_TRUE(m_folder.Exists("product\\config.ini"));
}

TEST(UninstallSystem, FullPathsStandForThemselves) {
  const struct {
    const char *szPath, *szFull;
  } rows[] = {{"", ""}, {"C:", "C:\\"}, {"C:/a/./b\\..\\c\\", "C:\\a\\c"}, {"C:\\a", "C:\\a"}};
  for (const auto& row : rows) {
    CNString csPath(row.szPath, 0);
    MakeFullPath(csPath);
    EXPECT_STREQ(csPath.Text(), row.szFull);
  }
}
