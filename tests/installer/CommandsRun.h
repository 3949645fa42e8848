// The installer's commands on a page that has every control they work with. Names that leave traces outside the folder
// are the test's own, and are removed again.
#pragma once

#include <map>

#include "InstallerRun.h"

class CommandsRun {
 public:
  static constexpr const char* PRODUCT = "Orbit Example";
  static constexpr const char* CLASSES[] = {"Software\\Classes\\*\\shell\\Orbit Example",
                                            "Software\\Classes\\.orbexample", "Software\\Classes\\Orbit.Example",
                                            "Software\\Orbit Example",
                                            "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\Orbit Example"};
  static constexpr const char* SHARES = "SYSTEM\\CurrentControlSet\\Services\\lanmanserver\\Shares";

  CommandsRun() {
    EXPECT_EQ(run.wizard.iLoadMainList(PAGE), 0);
    run.folder.MakeFolder("target");
    TestFolder::WriteFile(Path("Plumo.exe"), "program");
    Set("program_name", PRODUCT);
    Set("program_folder", PRODUCT);
    Set("program_file", "Plumo.exe");
    Set("colvane_link", "Plumo.lnk");
    Set("msgbox_capt", "Setup");
    Set("default_path", run.Destination().c_str());
    const std::string path = "Path=" + run.folder.Root() + '\0' + "Type=0" + '\0';
    OsRegistryKey shares;
    EXPECT_TRUE(shares.bOpen(OS_HKEY_LOCAL_MACHINE, SHARES, OsRegAccess::Create) &&
                shares.bSet("OrbitExample", OsRegType::MultiString, path.data(), long(path.size())));
  }
  ~CommandsRun() {
    for (const char* szKey : CLASSES) COrbitWizard::iDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, szKey);
    COrbitWizard::iDeleteRegistryValue(OS_HKEY_LOCAL_MACHINE, SHARES, "OrbitExample");
    bOsDeleteFile((Programs() + "\\Plumo.lnk").c_str());
    bOsDeleteFolder(Programs().c_str());
    bOsDeleteFile((std::string(getenv("windir")) + "\\Tasks\\Orbit Example.job").c_str());
  }

  // Shows the page, runs the work there and closes the window.
  void OnPage(const std::function<void()>& work) {
    bool bDone = false;
    run.Run({[&](HeadlessView&) {
      work();
      bDone = true;
    }});
    EXPECT_TRUE(bDone) << "the page was not shown";
  }
  // Runs a command line and waits for its workers. The command result; -1 when the command failed.
  int Do(const std::string& line) {
    int iResult = -1;
    const int iCode = run.wizard.iExecuteCommand(line.c_str(), 0, &iResult);
    while (run.wizard.bTaskRuns() || run.wizard.Extraction().iWorkers) OsSleep(2);
    return iCode == EVERYTHING_IS_OK ? iResult : -1;
  }
  void Set(const char* szName, const std::string& value) { run.wizard.iSetVariable(szName, value.c_str()); }
  std::string Get(const char* szName) { return run.Value(szName); }
  std::string Path(const std::string& name) const { return run.Destination() + "\\" + name; }
  static std::string Programs() {
    return InstallerRun::ShellFolder(OS_HKEY_LOCAL_MACHINE, "Common Programs") + "\\" + PRODUCT;
  }
  static std::string Registry(const std::string& key, const char* szName = "") {
    char szText[512] = "";
    const int iResult = COrbitWizard::iReadRegistryKey(OS_HKEY_LOCAL_MACHINE, key.c_str(), szName, szText);
    return iResult == EVERYTHING_IS_OK ? szText : "none";
  }

  InstallerRun run;

 private:
  static constexpr const char PAGE[] =
      "DIALOG1 'page' \"Page\" 0 0 100 100\nBEGIN\n"
      " LISTVIEW 'lv_net_list' 0 0 9 9\n COLUMN \"Share\"\n END_LISTVIEW\n"
      " LIST_FIELD 'dictionaries' \"\" 0 0 9 9\n COMBO_FIELD 'lang_supp' 0 0 9 9\n END_COMBO\n"
      " LIST_FIELD 'user' \"nobody\" 0 0 9 9\n BUTTON 'b_next' \"Next\" ID_NEXT 0 0 9 9\n"
      " TEXT_FIELD 'to_file' \"\" 0 0 9 9\n PROGRESS_BAR 'progress' 0 0 9 9\n"
      " LIST_FIELD 'program' \"programs_folder\" \"<%program_folder%>\" \"Plumo.exe\" \"Plumo.lnk\" \"At: \" 0 0 0 0,"
      "HIDE\n LIST_FIELD 'deinstall' \"x\" 0 0 0 0,HIDE\n"
      " MESSAGE_BOX 'msgBox_activeSotware1' \"Close\", MB_OK\n > \"<%running_programs%> runs\"\n END_MESSAGE_BOX\n"
      "END\npressed = pressed + \"1\"\nEND_DIALOG1\nDIALOG2 'other' \"\" 0 0 9 9\nBEGIN\nEND\nEND_DIALOG2\n";
};
