// An installation without a screen: the real installer script, a product archive in a fresh folder, and a list of steps
// that press and type what a person would. Names that leave traces outside the folder are the test's own.
#pragma once

#include <functional>
#include <set>
#include <string>
#include <vector>

#include "TestArchive.h"
#include "foundation/os/OsRegistry.h"
#include "installer/CNInstallWizard.h"
#include "support/SourceScripts.h"
#include "support/TestFolder.h"
#include "wizard/HeadlessView.h"

// The installer on drives of a size that the test chooses.
class TestInstaller : public CNInstallWizard {
 public:
  using CNInstallWizard::CNInstallWizard;

  uint64_t freeBytes = uint64_t{1} << 40;

 protected:
  bool bGetFreeSpace(const char*, uint64_t& bytes) override {
    bytes = freeBytes;
    return true;
  }
};

// Keeps every text that a control was given.
class TestView : public HeadlessView {
 public:
  bool bSetText(const BaseControl& control, const char* szText) override {
    CNSemHold hold(m_lock);
    texts.insert(szText);
    return HeadlessView::bSetText(control, szText);
  }

  std::set<std::string> texts;

 private:
  CNSem m_lock;
};

// What a person does, one step each time the wizard waits for it.
using Step = std::function<void(HeadlessView& view)>;
using Steps = std::vector<Step>;

inline Steps operator+(Steps a, const Steps& b) {
  a.insert(a.end(), b.begin(), b.end());
  return a;
}
inline Step Press(const char* szName) {
  return [szName](HeadlessView& shown) { EXPECT_TRUE(shown.bPress(szName)) << szName; };
}
inline Step Type(const char* szName, const std::string& text) {
  return [szName, text](HeadlessView& shown) { EXPECT_TRUE(shown.bType(szName, text.c_str())) << szName; };
}
inline Step CloseBox() {
  return [](HeadlessView& shown) { shown.Close(); };
}

class InstallerRun {
 public:
  static constexpr const char* PRODUCT = "Orbit Test Product";
  static constexpr const char* UNINSTALL_KEY =
      "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\Orbit Test Product";

  InstallerRun() : wizard(view, context, scripts) {
    LoadSourceScripts(scripts);
    SetArchive({{"Plumo.exe", "program"},
                {"UnInstall.exe", "remover"},
                {"OrbitTestUnInstall.exe", "remover 1"},
                {"Help\\Deep\\read me.txt", "help"},
                {"Help\\empty.txt", ""}});
    view.onIdle = [this](HeadlessView& shown) { return bNextStep(shown); };
  }
  ~InstallerRun() {
    COrbitWizard::iDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, UNINSTALL_KEY);
    CNString csWindows(getenv("windir"), 0);
    bOsDeleteFile((std::string(csWindows.Text()) + "\\OrbitTestUnInstall.exe").c_str());
    for (const std::string& link : Links()) bOsDeleteFile(link.c_str());
    bOsDeleteFolder(ProgramFolder().c_str());
  }

  void SetArchive(const std::vector<TestEntry>& entries) { SetArchiveBytes(MakeTestArchive(entries)); }
  void SetArchiveBytes(const std::string& bytes) {
    folder.Write("Records.dat", bytes);
    context.csExpandedFile = folder.Path("Records.dat").c_str();
  }

  // Loads the script as the launcher does, with the test's own names.
  void Load() {
    ASSERT_EQ(wizard.iExecuteInstallWizard(folder.Path("Records.dat").c_str()), 0);
    wizard.iSetVariable("program_name", PRODUCT);
    wizard.iSetVariable("program_folder", "Orbit Test Folder");
    wizard.iSetVariable("uninstall", "OrbitTestUnInstall.exe");
  }
  // Runs the steps, one each time the wizard waits for its user; the window is closed by force when they run out.
  void Run(Steps list) {
    steps = std::move(list);
    m_nStep = 0;
    wizard.iRunInstallWindow();
  }

  std::string Destination() const { return folder.Path("target"); }
  bool Installed(const std::string& name) const { return bOsExists((Destination() + "\\" + name).c_str()); }
  std::string InstalledBytes(const std::string& name) const {
    return TestFolder::ReadFile(Destination() + "\\" + name);
  }
  std::string Value(const char* szName) { return wizard.szValue(szName); }

  static std::string ShellFolder(OsRegKey hRoot, const char* szName) {
    char szPath[512] = "";
    COrbitWizard::iReadRegistryKey(hRoot, "Software\\Microsoft\\Windows\\CurrentVersion\\Explorer\\Shell Folders",
                                   szName, szPath);
    return szPath;
  }
  static std::string ProgramFolder() {
    return ShellFolder(OS_HKEY_LOCAL_MACHINE, "Common Programs") + "\\Orbit Test Folder";
  }
  // Program, uninstall, desktop, quick launch.
  static std::vector<std::string> Links() {
    return {ProgramFolder() + "\\Plumo.lnk", ProgramFolder() + "\\UnInstall plumo.lnk",
            ShellFolder(OS_HKEY_LOCAL_MACHINE, "Common Desktop") + "\\Plumo.lnk",
            ShellFolder(OS_HKEY_CURRENT_USER, "AppData") + "\\Microsoft\\Internet Explorer\\Quick Launch\\Plumo.lnk"};
  }
  static std::string LinksThere() {
    std::string there;
    for (const std::string& link : Links()) there += bOsExists(link.c_str()) ? '1' : '0';
    return there;
  }

  // Whether something like this was shown or asked.
  bool Saw(const std::string& part) const {
    for (const std::string& event : view.events)
      if (event.find(part) != std::string::npos) return true;
    return false;
  }
  std::string Page() const { return view.Dialog() ? view.Dialog()->m_csName.Text() : ""; }

  Step ExpectPage(const char* szPage) {
    return [this, szPage](HeadlessView&) { EXPECT_EQ(Page(), szPage); };
  }
  // From page 1 through page 3, where the path is typed. Later pages are left as they are.
  Steps ThroughDestination(const std::string& path) {
    return {Press("b_next"), Press("b_next"), ExpectPage("PL-dlg3"), Type("default_path", path),
            Press("btn_next_folder")};
  }
  // From page 1 until the files are copied.
  Steps Copying() { return ThroughDestination(Destination()) + Steps{Press("b_next")}; }

  TestFolder folder;
  SfxContext context;
  CarriedScripts scripts;
  TestView view;
  TestInstaller wizard;
  Steps steps;
  bool bRanOut = false;  // the steps ended before the wizard did

 private:
  bool bNextStep(HeadlessView& shown) {
    if (wizard.Extraction().iWorkers) {
      m_bQuiet = false;
      OsSleep(1);
      return true;
    }
    // Twice without workers: their last command, queued before they ended, has been handled in between.
    m_bQuiet = !m_bQuiet;
    if (m_bQuiet) return true;
    if (m_nStep == steps.size()) {
      bRanOut = true;
      return false;
    }
    steps[m_nStep++](shown);
    return true;
  }

  size_t m_nStep = 0;
  bool m_bQuiet = false;
};
