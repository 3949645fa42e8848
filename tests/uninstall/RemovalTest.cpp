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
    m_folder.Write("product\\Uninstall.log", "003\r\nprogram_name=" + std::string(PROGRAM) +
                                                 "\r\nprogram_folder=Orbit Test Removal\r\ndefault_path=" + Product());
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
  // What could not be removed; "refused" when there is no whole installation.
  std::string Remove(const std::string& folder) {
    Installation installation;
    if (!bReadInstallation(folder.c_str(), installation)) return "refused";
    Removal removal(installation, (Product() + "\\UnInstall.exe").c_str());
    removal.RemoveAllButOwn();
    m_bOwnRemains = removal.bOwnRemains();
    return removal.Failures().Text();
  }

  TestFolder m_folder;
  std::vector<std::string> m_links;
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

TEST_F(Removing, NothingIsTouchedWithoutTheList) {
  ASSERT_TRUE(bOsDeleteFile((Product() + "\\Installed.lst").c_str()));
  EXPECT_EQ(Remove(Product()), "refused");
  EXPECT_EQ(m_folder.Names("product").size(), 5u);
  EXPECT_FALSE(bThere(Product() + "\\Installed.lst"));
}

TEST_F(Removing, AnotherProgramsSettingsStay) {
  m_folder.Write("product\\config.ini", "[General]\r\nUser=x\r\n[Other]\r\n");
  EXPECT_EQ(Remove(Product()), "");
  EXPECT_TRUE(m_folder.Exists("product\\config.ini"));
}

TEST_F(Removing, AProgramFolderOutsideThePlaceIsReported) {
  m_folder.Write("product\\Uninstall.log",
                 "002\r\nprogram_name=" + std::string(PROGRAM) + "\r\nprogram_folder=..\\..\\x");
  EXPECT_EQ(Remove(Product()), "..\\..\\x\n");
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
