// What the installer's commands do to the machine: registry, links, files, processes, tasks. Each on its own names.
#include <windows.h>

#include "CommandsRun.h"
#include "foundation/os/OsWide.h"
#include "installer/ShellLinks.h"
#include "window/Win32View.h"

// A refusal keeps the page, wherever the command stands.
TEST(CommandResults, ARefusalInAFlowKeepsThePage) {
  InstallerRun run;
  ASSERT_EQ(run.wizard.iLoadMainList(
                "DIALOG1 'a' \"A\" 0 0 9 9\nBEGIN\n BUTTON 'b_next' \"N\" ID_NEXT 0 0 9 9\n"
                " MESSAGE_BOX 'msgBox_err_noActiveSync' \"None\"\n > \"no manager\"\n END_MESSAGE_BOX\n"
                "END\nCheckActiveSync ()\nCONTINUE\nEND_DIALOG1\nDIALOG2 'b' \"B\" 0 0 9 9\nBEGIN\nEND\nEND_DIALOG2\n"),
            0);
  static const char APP[] = "SOFTWARE\\Microsoft\\Windows\\CurrentVersion\\App Paths\\CEAPPMGR.EXE";
  run.Run({Press("b_next"), run.ExpectPage("a"),
           [](HeadlessView&) { COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, APP, "", "x", nullptr); },
           Press("b_next"), run.ExpectPage("b")});
  COrbitWizard::iDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, APP);
  EXPECT_TRUE(run.Saw("message None|no manager"));
}

// ---- what the uninstaller reads ----

TEST(CommandRecord, KeepsItsOrderAndTheItemsOfEveryRun) {
  const std::string fonts = InstallerRun::ShellFolder(OS_HKEY_CURRENT_USER, "Fonts");
  static const char FONT_KEY[] = "Software\\Microsoft\\Windows NT\\CurrentVersion\\Fonts";
  CommandsRun commands;
  for (const char* szFont : {"ModGr.ttf", "OrbExample.ttf", "OrbTheirs.ttf"})  // the first is known by its name
    TestFolder::WriteFile(commands.Path(szFont), "new glyphs");
  TestFolder::WriteFile(fonts + "\\OrbTheirs.ttf", "their glyphs");
  commands.Set("fonts", "OrbExample.ttf;OrbTheirs.ttf;..\\x.ttf");
  commands.Set("quick_launch", "0");
  commands.Set("dict_path", "none");
  commands.Set("file_types", ".orbexample|Orbit.Example|Example");
  commands.Set("speech_path", "D:\\speech");
  for (const char* szCommand : {"CopyKVIniFile ()", "UpdateRegistry (CNT)", "AddToContextMenu ()"})
    EXPECT_EQ(commands.Do(szCommand), 0);
  // A run that breaks off here is undone by the list.
  EXPECT_EQ(TestFolder::ReadFile(commands.Path("Installed.lst")),
            "V kv_ini=kv.ini\r\nV registry_key=Software\\Orbit Example\r\nV context_menu=*\\shell\\Orbit Example\r\n");
  commands.OnPage([&] { EXPECT_EQ(commands.Do("FinalizeInstallation ()"), 0); });
  const std::string record = "010\r\nprogram_name=Orbit Example\r\nprogram_folder=Orbit Example\r\ndefault_path=" +
                             commands.run.Destination() +
                             "\r\nquick_launch=0\r\ndict_path=none\r\ncontext_menu=*\\shell\\Orbit Example\r\n";
  const std::string before = "kv_ini=kv.ini\r\nregistry_key=Software\\Orbit Example";
  const std::string later = "file_types=Orbit.Example\r\nfonts=ModGr.ttf;OrbExample.ttf";
  EXPECT_EQ(TestFolder::ReadFile(commands.Path("Uninstall.log")), record + before + "\r\n" + later);
  EXPECT_EQ(TestFolder::ReadFile(fonts + "\\OrbExample.ttf"), "new glyphs");
  EXPECT_EQ(TestFolder::ReadFile(fonts + "\\OrbTheirs.ttf"), "their glyphs");
  EXPECT_EQ(CommandsRun::Registry(FONT_KEY, "OrbExample (TrueType)"), "OrbExample.ttf");

  InstallerRun second;  // another setup over it, which knows of none of these
  second.wizard.iLoadMainList("DIALOG1 'p' \"\" 0 0 9 9\nBEGIN\nEND\nEND_DIALOG1\n");
  for (const char* szName : {"program_name", "program_folder", "default_path", "quick_launch", "dict_path"})
    second.wizard.iSetVariable(szName, commands.Get(szName).c_str());
  second.Run({[&](HeadlessView&) {
    int iResult = -1;
    EXPECT_EQ(second.wizard.iExecuteCommand("FinalizeInstallation ()", 0, &iResult), 0);
    EXPECT_EQ(second.wizard.iExecuteCommand("AddScheduledTask ()", 0, &iResult), 0);
    while (second.wizard.bTaskRuns()) OsSleep(2);
  }});
  EXPECT_EQ(TestFolder::ReadFile(commands.Path("Uninstall.log")),
            "011" + record.substr(3) + later + "\r\n" + before + "\r\nscheduled_task=Orbit Example");
  for (const char* szFont : {"ModGr (TrueType)", "OrbExample (TrueType)"})
    COrbitWizard::iDeleteRegistryValue(OS_HKEY_LOCAL_MACHINE, FONT_KEY, szFont);
  for (const char* szFont : {"\\ModGr.ttf", "\\OrbExample.ttf", "\\OrbTheirs.ttf"}) {
    RemoveFontResourceW(Wide((fonts + szFont).c_str()));
    bOsDeleteFile((fonts + szFont).c_str());
  }
}

// ---- registry ----

TEST(CommandRegistry, HoldsWhatTheShellAndTheSystemsListRead) {
  CommandsRun commands;
  const std::string target = commands.run.Destination(), program = target + "\\Plumo.exe";
  const std::string classes = "Software\\Classes\\", entry = CommandsRun::CLASSES[4];
  COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, (classes + ".orbtaken").c_str(), "", "Theirs", nullptr);
  commands.Set("file_types", ".orbexample|Orbit.Example|Example text;.orbtaken|Orbit.Example;x|y;.a|*;.b|c\\d");
  commands.Set("publisher", "Tavola");
  commands.Set("program_version", "2.1");
  commands.Set("proxy", "proxy:8080");
  EXPECT_EQ(commands.Do("AddToContextMenu (Read)"), 0);
  commands.OnPage([&] { EXPECT_EQ(commands.Do("FinalizeInstallation ()"), -1); });  // three pieces cannot be types
  EXPECT_EQ(commands.Do("UpdateRegistry (IT)"), 0);
  const struct {
    std::string key;
    const char* szName;
    std::string value;
  } rows[] = {{classes + "*\\shell\\Orbit Example", "", "Read"},
              {classes + "*\\shell\\Orbit Example\\command", "", "\"" + program + "\" \"%1\""},
              {classes + ".orbexample", "", "Orbit.Example"},
              {classes + ".orbtaken", "", "Theirs"},
              {classes + "Orbit.Example\\DefaultIcon", "", program + ",0"},
              {classes + "Orbit.Example\\shell\\open\\command", "", "\"" + program + "\" \"%1\""},
              {classes + "*\\shell\\open\\command", "", "none"},
              {entry, "DisplayName", "Orbit Example"},
              {entry, "UninstallString", target + "\\UnInstall.exe " + target},
              {entry, "QuietUninstallString", "\"" + target + "\\UnInstall.exe\" /S \"" + target + "\""},
              {entry, "DisplayIcon", program},
              {entry, "DisplayVersion", "2.1"},
              {entry, "Publisher", "Tavola"},
              {entry, "InstallLocation", target},
              {entry, "EstimatedSize", "0"},
              {entry, "NoModify", "1"},
              {entry, "NoRepair", "1"}};
  for (const auto& row : rows)
    EXPECT_EQ(CommandsRun::Registry(row.key, row.szName), row.value) << row.key << row.szName;
  EXPECT_EQ(CommandsRun::Registry(entry, "InstallDate").size(), 8u);
  EXPECT_EQ(TestFolder::ReadFile(commands.Path("config.dat")), "001\r\nProxy=proxy:8080");
  COrbitWizard::iDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, (classes + ".orbtaken").c_str());
}

// ---- earlier versions ----

TEST(CommandOldVersions, AreKeptAndClearedOfTheirShortcuts) {
  CommandsRun commands;
  const std::string desktop = InstallerRun::ShellFolder(OS_HKEY_CURRENT_USER, "Desktop");
  const std::string old = InstallerRun::ShellFolder(OS_HKEY_LOCAL_MACHINE, "Common Programs") + "\\Orbit Old Folder";
  const std::string ours = desktop + "\\Orbit ours.lnk", theirs = desktop + "\\Orbit theirs.lnk";
  TestFolder::WriteFile(commands.Path("Uninstall.log"), "001\r\nprogram_folder=Orbit Old Folder");
  TestFolder::WriteFile(commands.run.folder.Path("targets.exe"), "");
  OsMakeFolder(old.c_str());
  ShellLink link;
  link.csTarget = commands.Path("Plumo.exe").c_str();
  for (const std::string& path : {old + "\\Old.lnk", ours}) ASSERT_EQ(iCreateLink(link, path.c_str()), 0);
  link.csTarget = commands.run.folder.Path("targets.exe").c_str();  // begins like the destination
  ASSERT_EQ(iCreateLink(link, theirs.c_str()), 0);
  EXPECT_EQ(commands.Do("RemoveOldLinks ()"), 0);
  EXPECT_FALSE(bOsExists(old.c_str()) || bOsExists(ours.c_str()));
  EXPECT_TRUE(bOsDeleteFile(theirs.c_str()));

  commands.run.folder.MakeFolder("target/deep");
  TestFolder::WriteFile(commands.Path("deep\\data"), "first");
  commands.run.folder.MakeFolder("target.old.part");  // a copy that broke off
  commands.Set("halvex_name", CommandsRun::PRODUCT);
  EXPECT_EQ(commands.Do("UpdateRegistry (ND)"), 0);
  for (const char* szContent : {"second", "third"}) {
    EXPECT_EQ(commands.Do("BackupOldHalvex ()"), 0);
    TestFolder::WriteFile(commands.Path("deep\\data"), szContent);
    EXPECT_EQ(commands.run.folder.Read("target.old\\deep\\data"), "first");
  }
  EXPECT_FALSE(commands.run.folder.Exists("target.old.part"));
}

// ---- speech, network, choices, files ----

TEST(CommandSpeech, CopiesTheTreeAndListsItFirst) {
  CommandsRun commands;
  commands.run.folder.MakeFolder("speech/voice");
  commands.run.folder.Write("speech/EnaSpk.ndx", "index");
  commands.run.folder.Write("speech/voice/a.wav", "sound");
  bOsSetAttributes(commands.run.folder.Path("speech\\EnaSpk.ndx").c_str(), OS_READ_ONLY);
  commands.Set("speech_path", commands.run.folder.Path("speech") + "\\");
  commands.OnPage([&] {
    EXPECT_EQ(commands.Do("CopySpeechFile ()"), 0);
    const std::string shown = commands.run.view.pState("to_file")->text;
    EXPECT_EQ(shown.substr(0, commands.run.Destination().size()), commands.run.Destination());
  });
  EXPECT_FALSE(commands.run.Saw("could not be copied"));
  EXPECT_EQ(TestFolder::ReadFile(commands.Path("voice\\a.wav")), "sound");
  const std::string list = TestFolder::ReadFile(commands.Path("Installed.lst"));
  for (const char* szLine : {"F EnaSpk.ndx\r\n", "D voice\r\n", "F voice\\a.wav\r\n"})
    EXPECT_NE(list.find(szLine), std::string::npos) << szLine << list;
  EXPECT_EQ(commands.Do("SetInterfaceLang (\x9Ai\x9Amanski)"), 0);
  wchar_t szText[99] = L"";
  GetPrivateProfileStringW(L"General", L"InterfaceLanguage", L"", szText, 99, Wide(commands.Path("kv.ini").c_str()));
  EXPECT_STREQ(szText, L"\x0161i\x0161manski");
}

TEST(CommandNetwork, FillsTheListAndMakesTheShortcut) {
  CommandsRun commands;
  wchar_t szComputer[64] = L"";
  DWORD dwSize = 64;
  GetComputerNameW(szComputer, &dwSize);
  CNString csComputer, csRoot;
  bNarrow(szComputer, csComputer);
  const std::string share = std::string("\\\\") + csComputer.Text() + "\\OrbitExample";
  // Wine keeps network paths in a folder of the prefix.
  const auto pUnixName = reinterpret_cast<char*(CDECL*)(const wchar_t*)>(
      reinterpret_cast<void*>(GetProcAddress(GetModuleHandleW(L"kernel32.dll"), "wine_get_unix_file_name")));
  if (char* pRoot = pUnixName ? pUnixName(L"C:\\") : nullptr) {
    csRoot = (std::string("Z:") + pRoot + "/../unc").c_str();
    for (const std::string& step :
         {std::string(), std::string("/") + csComputer.Text(), std::string("/OrbitExample")}) {
      csRoot.Concat(step.c_str());
      OsMakeFolder(csRoot.Text());
    }
  }
  commands.OnPage([&] {
    EXPECT_EQ(commands.Do("SearchNet ()"), 0);
    EXPECT_EQ(commands.Do("AddScheduledTask ()"), 0);
    EXPECT_EQ(commands.Do("FillNetListView ()"), 0);
    const std::vector<std::string> items = commands.run.view.pState("lv_net_list")->items;
    EXPECT_NE(std::find(items.begin(), items.end(), share), items.end());
    commands.run.wizard.iSetField("lv_net_list", share.c_str());
    EXPECT_EQ(commands.Do("CreateNetShortCut ()"), bOsIsFolder(share.c_str()) ? 0 : 1);
    ShellLink link;
    ASSERT_EQ(iResolveIt((share + "\\Plumo.lnk").c_str(), link), 0);
    EXPECT_EQ(std::string(link.csTarget.Text()), share + "\\target\\Plumo.exe");
    commands.Set("default_path", "C:\\nowhere shared");
    EXPECT_EQ(commands.Do("CreateNetShortCut ()"), 1);
  });
  EXPECT_EQ(commands.Get("pressed"), "1");  // Next, once for both workers
  bOsDeleteFile((share + "\\Plumo.lnk").c_str());
}

TEST(CommandChoices, FillListsAndEnableNext) {
  CommandsRun commands;
  commands.run.folder.MakeFolder("dicts/English");
  commands.run.folder.MakeFolder("dicts/Hrvatski");
  commands.run.folder.MakeFolder("target/English/deep");
  TestFolder::WriteFile(commands.Path("English\\a.pdb"), "12345");
  TestFolder::WriteFile(commands.Path("English\\deep\\b.PDB"), "678");
  TestFolder::WriteFile(commands.Path("English\\c.txt"), "no");
  commands.Set("dict_source", commands.run.folder.Path("dicts"));
  commands.OnPage([&] {
    const auto pState = [&](const char* szName) { return commands.run.view.pState(szName); };
    EXPECT_EQ(commands.Do("GetDictionaries ()"), 0);
    EXPECT_EQ(pState("dictionaries")->items, (std::vector<std::string>{"English", "Hrvatski"}));
    EXPECT_EQ(commands.Do("dictionaries_OnClick ()"), 0);
    EXPECT_FALSE(pState("b_next")->enabled);
    commands.run.wizard.iSetField("dictionaries", "English");
    EXPECT_EQ(commands.Do("dictionaries_OnSelChange ()"), 0);
    EXPECT_TRUE(pState("b_next")->enabled);
    EXPECT_EQ(commands.Do("SetExpansionCardTotalSize ()"), 0);
    EXPECT_EQ(commands.Get("total_size"), "8");
    EXPECT_EQ(commands.Do("GetUsers ()"), 1);
    EXPECT_TRUE(pState("user")->items.empty());
    commands.Do("GetLangSupport ()");
    for (const std::string& language : pState("lang_supp")->items) EXPECT_NE(language, "");
  });
}

// On real windows, which point to the items that are exchanged.
TEST(CommandChoices, ExchangeTheItemsOfWindows) {
  struct Installer : CNInstallWizard {
    using CNInstallWizard::CNInstallWizard;
    int iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pResult, CNString* pOut) override {
      if (strcmp(szCommand, "TestStep") != 0)
        return CNInstallWizard::iExecuteFunction(szCommand, szParam, iFlag, pResult, pOut);
      step();
      *pResult = COMMAND_EXIT;
      return EVERYTHING_IS_OK;
    }
    std::function<void()> step;
  };
  TestFolder folder;
  for (const char* szFolder : {"a/English", "a/Hrvatski", "b/Deutsch", "b/Hrvatski", "b/Italiano"})
    folder.MakeFolder(szFolder);
  for (const char* szList : {"LISTVIEW 'dictionaries' 9 9 200 99\n COLUMN \"Name\"\n ITEM \"old\"\n END_LISTVIEW",
                             "COMBO_FIELD 'dictionaries' 9 9 200 99\n ITEM \"old\"\n END_COMBO",
                             "LIST_FIELD 'dictionaries' \"old\" 9 9 200 99"}) {
    const std::unique_ptr<WizardView> pView = pMakeWin32View(GetModuleHandleW(nullptr));
    const SfxContext context;
    const CarriedScripts scripts;
    Installer wizard(*pView, context, scripts);
    const std::string page = std::string("DIALOG1 'p' \"P\" 0 0 300 200\nBEGIN\n ") + szList +
                             "\n START_AFTER_DRAWING\n START_ACTION\n TestStep ()\n FINISH_ACTION\n"
                             "END\nCONTINUE\nEND_DIALOG1\n";
    ASSERT_EQ(wizard.iLoadMainList(page.c_str()), 0);
    std::string chosen;
    wizard.step = [&] {
      int iResult = -1;
      CNString csChosen;
      for (const char* szSource : {"a", "b"}) {
        wizard.iSetVariable("dict_source", folder.Path(szSource).c_str());
        EXPECT_EQ(wizard.iExecuteCommand("GetDictionaries ()", 0, &iResult), 0);
        EXPECT_EQ(iResult, COMMAND_DONE);
        for (const char* szName : {"Hrvatski", "Italiano"}) {
          wizard.iSetField("dictionaries", szName);
          wizard.csGetField("dictionaries", csChosen);
          chosen += std::string(csChosen.Text()) + ",";
        }
      }
    };
    wizard.iRunWindow("OrbitChoicesTest", 0);
    // A name that is not among the items chooses nothing.
    EXPECT_EQ(chosen, "Hrvatski,,Hrvatski,Italiano,") << szList;
  }
}

TEST(CommandFiles, AreExact) {
  CommandsRun commands;
  commands.Set("user_profile_path", "user.xml");
  commands.Set("name", "A & \"B\" <\x9A\x01>");
  commands.Set("fax", "01'2");
  EXPECT_EQ(commands.Do("WriteUserProfile ()"), 0);
  EXPECT_EQ(TestFolder::ReadFile(commands.Path("user.xml")),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<userprofile>\n"
            "  <commonname>A &amp; &quot;B&quot; &lt;\xC5\xA1 &gt;</commonname>\n  <company></company>\n"
            "  <address></address>\n  <locality></locality>\n  <postalcode></postalcode>\n  <country></country>\n"
            "  <telephonenumber></telephonenumber>\n  <facsimiletelephonenumber>01&apos;2</facsimiletelephonenumber>\n"
            "  <mail></mail>\n</userprofile>\n");
  EXPECT_EQ(commands.Do("CreateSizeFile ()"), 0);
  const std::string size = std::to_string(TestFolder::ReadFile(commands.Path("user.xml")).size());
  EXPECT_EQ(TestFolder::ReadFile(commands.Path("size.dat")), "Plumo.exe=7\nuser.xml=" + size + "\n");
  EXPECT_NE(TestFolder::ReadFile(commands.Path("Installed.lst")).find("F size.dat"), std::string::npos);
  commands.Set("lang_supp", "Korean");
  commands.Set("lang_supp1", "Simplified Chinese");
  EXPECT_EQ(commands.Do("InstallLangSupport ()"), 0);
  EXPECT_EQ(TestFolder::ReadFile(commands.Path("lang_support.txt")), "[RegionalSettings]\r\nLanguageGroup=8,10\r\n");
  for (const char* szPath : {"..\\user.xml", "a:b"}) {
    commands.Set("user_profile_path", szPath);
    EXPECT_EQ(commands.Do("WriteUserProfile ()"), -1);
  }
}

TEST(CommandTask, StandsInTheSystemsFolder) {
  CommandsRun commands;
  const std::string job = std::string(getenv("windir")) + "\\Tasks\\Orbit Example.job";
  commands.Set("task_time", "6:30");
  commands.Set("task_arguments", "/update");
  for (int i = 0; i < 2; i++) EXPECT_EQ(commands.Do("AddScheduledTask ()"), 0);  // the second replaces the first
  std::string wide;
  for (const char c : commands.Path("Plumo.exe")) wide += {c, '\0'};
  EXPECT_NE(TestFolder::ReadFile(job).find(wide), std::string::npos);
}

TEST(CommandBrowser, VersionDecidesWhereToGo) {
  static const char KEY[] = "SOFTWARE\\Microsoft\\Internet Explorer\\Version Vector";
  CommandsRun commands;
  const std::string before = CommandsRun::Registry(KEY, "IE");
  const struct {
    const char *szVersion, *szTarget;
  } rows[] = {{"5.4900", "install_IE"}, {"5.50", "version_ok"}, {"11.0", "version_ok"}, {"", "install_IE"}};
  for (const auto& row : rows) {
    COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, KEY, "IE", row.szVersion, nullptr);
    EXPECT_EQ(commands.Do("go = CheckForIEVersion ()"), COMMAND_ASSIGNED);
    EXPECT_EQ(commands.Get("go"), row.szTarget);
    EXPECT_EQ(commands.Get("IE_version"), row.szVersion);
  }
  if (before == "none")
    COrbitWizard::iDeleteRegistryValue(OS_HKEY_LOCAL_MACHINE, KEY, "IE");
  else
    COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, KEY, "IE", before.c_str(), nullptr);
}
