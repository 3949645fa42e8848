// Whole runs without a person, over small scripts.
#include <cstring>

#include "SetupFiles.h"
#include "foundation/os/OsRegistry.h"
#include "launcher/RunGuards.h"
#include "wizard/COrbitWizard.h"

namespace {

const char SCRIPT[] = R"(INIT
  program_name = "OrbitUnattendedTest"
  program_version = "1.10"
  default_path = "x"
  person = "nobody"
  agreed = "0"
  upgrade = "0"
  way = ""
  create_dir1 = "The directory:\n'"
  create_dir2 = "'\ndoes not exist. Make it?"
END_INIT
DIALOG1 DIALOG_SYS 'person' "One" 0 0 300 200
"Arial" 15 500
BEGIN
  START_BEFORE_DRAWING
    START_ACTION
      InitDefaultPath ()
      IF way == "old" THEN CheckForOldVersion ()
    FINISH_ACTION
  EDIT_FIELD 'person' 0 0 10 10
  EDIT_FIELD 'address' 0 0 10 10,MULTILINE
  GROUP
    CHECK_BOX 'yes' "yes" 0 0 10 10,RADIO_BUTTON
    CHECK_BOX 'no' "no" 0 0 10 10,RADIO_BUTTON
  END_GROUP
  COMBO_FIELD 'town' 0 0 10 10
    "Pazin"
    "Split"
  END_COMBO
  BUTTON 'b_cancel' "Cancel" ID_CANCEL 0 0 10 10
  BUTTON 'b_locked' "Locked" 0 0 10 10,DISABLE ACTION: ()
  BUTTON 'b_next' "Next" ID_NEXT 0 0 10 10
END
IF way == "stay" THEN MESSAGE_BOX ('m' "Stop" > Stays.)
IF way == "stay" THEN EnableControl (nothing)
IF way == "busy" THEN CheckIfSoftwareIsRuning (services.exe)
IF way == "circle" THEN DIALOG "person"
IF way == "exit" THEN EXIT
IF way != "stay" THEN CONTINUE
END_DIALOG1
DIALOG2 DIALOG_SYS 'folder' "Two" 0 0 300 200
"Arial" 15 500
BEGIN
  EDIT_FIELD 'default_path' 0 0 10 10
  BUTTON 'b_other' "Other" ID_NEXT 0 0 10 10
  BUTTON 'btn_next_folder' "Next" 0 0 10 10,DEFAULT ACTION: ()
END
CONTINUE
END_DIALOG2
DIALOG3 DIALOG_SYS 'copying' "Three" 0 0 300 200
"Arial" 15 500
BEGIN
  MESSAGE_BOX 'msgBox_err_files' "Error" > <%failed_files%>
  END_MESSAGE_BOX
  PROGRESS_BAR 'progress' 0 0 10 10
  BUTTON 'b_stop' "Stop" ID_CANCEL 0 0 10 10
  START_AFTER_DRAWING
    START_ACTION
      Unzip ()
    FINISH_ACTION
END
CONTINUE
END_DIALOG3
DIALOG4 DIALOG_SYS 'end' "<%person%>" 0 0 300 200
"Arial" 15 500
BEGIN
  START_AFTER_DRAWING
    START_ACTION
      Reboot ()
    FINISH_ACTION
  BUTTON "Close" ID_CANCEL 0 0 10 10,DEFAULT
END
END_DIALOG4
)";

const std::string PRODUCT_KEY = "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\OrbitUnattendedTest";

class Unattended : public testing::Test {
 protected:
  Unattended() {
    m_files.scripts.csInstaller = SCRIPT;
    m_files.surroundings.uEndPause = 60000;  // a person's; nobody is there
    Pack({{"a.txt", "a"}, {"b/c.txt", "c"}});
  }
  ~Unattended() override { COrbitWizard::iDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, PRODUCT_KEY.c_str()); }

  void Pack(const std::vector<TestEntry>& entries) {
    m_files.folder.Write("setup.exe", Stamped(Compressed(MakeTestArchive(entries))));
  }

  // With the log and the destination in the test's folder, unless the switches say otherwise; the log is in m_log.
  int Run(const std::string& switches, const std::string& answers = "") {
    std::error_code ignored;
    std::filesystem::remove_all(m_files.folder.Path("target"), ignored);
    const std::string log = m_files.folder.Path("log.txt");
    std::string all = switches + " \"/LOG=" + log + "\"";
    if (switches.find("/D") == std::string::npos) all += " \"/DIR=" + m_files.folder.Path("target") + "\"";
    if (!answers.empty()) {
      m_files.folder.Write("answers.txt", answers);
      all += " /ANSWERS=\"" + m_files.folder.Path("answers.txt") + "\"";
    }
    bOsDeleteFile(log.c_str());
    m_files.events.clear();
    const std::wstring wide(all.begin(), all.end());
    m_files.surroundings.pSwitches = wide.c_str();
    const std::string line = "setup.exe " + m_files.folder.Path("setup.exe");
    const int iCode = iRunSetupIn(m_files.surroundings, std::wstring(line.begin(), line.end()).c_str());
    m_log = m_files.folder.Exists("log.txt") ? m_files.folder.Read("log.txt") : "";
    EXPECT_NE(m_log.find("end, exit code " + std::to_string(iCode)), std::string::npos);
    EXPECT_EQ(m_files.NewTempFiles(), 0);
    return iCode;
  }
  bool Logged(const std::string& text) const { return m_log.find(text) != std::string::npos; }

  SetupFiles m_files;
  std::string m_log;
};

TEST_F(Unattended, InstallsWhatAPersonWouldWhoPressesNext) {
  EXPECT_EQ(Run("/S"), 0) << m_log;
  EXPECT_EQ(m_files.folder.Read("target\\a.txt"), "a");
  EXPECT_EQ(m_files.folder.Read("target\\b\\c.txt"), "c");
  EXPECT_TRUE(m_files.events.empty());  // no view with windows was even made
  std::string order;
  for (const char* szPart :
       {"switches: /S", "product OrbitUnattendedTest 1.10", "page person", "command InitDefaultPath () -> 0",
        "press b_next", "page folder", "press btn_next_folder", "message \"\": ", "-> yes", "page copying",
        "command Unzip () -> 0", "copied 0%", "copied 50%", "copied 100%", "page end", "press Close", "exit code 0"}) {
    const size_t nAt = m_log.find(szPart, order.size());
    EXPECT_NE(nAt, std::string::npos) << szPart << " comes not in its turn in\n" << m_log;
    if (nAt != std::string::npos) order = m_log.substr(0, nAt);
  }
}

TEST_F(Unattended, EndsWithTheCodeThatSaysWhatHappened) {
  const struct {
    const char *szSwitches, *szAnswers;
    int iCode;
    const char* szLogged;
  } rows[] = {
      {"/S /SET person=Ana", "page person\nset person = Eva", 0, "page end"},
      {"/S", "page person\nset person = Eva\nset town = Split\nset no = 1\nset yes = 0", 0, "set town = Split"},
      {"/S", "message no = *does not exist*", 1603, "the page folder stays although its button was pressed"},
      {"/S", "page folder\nmessage retry = *", 1603, "the message has no such answer"},
      {"/S", "page nowhere\npress x", 1603, "answers.txt:1: the script has no page nowhere"},
      {"/S", "page person\n\nset nothing = 1", 1603, "answers.txt:3: the page has nothing of that kind named nothing"},
      {"/S", "page person\npress person", 1603, "answers.txt:2: the page has nothing of that kind named person"},
      {"/S", "page person\nset town = Zadar", 1603, "on the page person the answer for town cannot be given"},
      {"/S", "page person\nset yes = 1\nset no = 1", 1603, "on the page person the answer for yes cannot be given"},
      {"/S", "page person\npress b_locked", 1603, "on the page person the button b_locked cannot be pressed"},
      {"/S", "page person\npress b_cancel", 1602, "press b_exit"},
      {"/S", "push x", 87, "answers.txt:1: it begins with none of"},
      {"/S /x", "", 87, "The switch /x is not known."},
      {"/S /?", "", 0, "switches: /S /?"},
      {"/S /SET way=stay", "", 1603, "stays although its button was pressed"},
      {"/S /SET way=busy", "", 1603, "Close them, then choose Retry. -> cancel"},
      {"/S", "page person\nset address = a\n|b", 0, "set address = a | b"},
      {"/S /SET way=circle", "", 1603, "the pages go round in a circle"},
      {"/S /SET way=exit", "", 1602, "press b_next"},
      {"/S /SET upgrade=1", "", 3010, "a restart is needed"},
      {"/S /DIR=C:\\windows\\system.ini", "", 1603, "cannot be used"},
  };
  for (const auto& row : rows) {
    EXPECT_EQ(Run(row.szSwitches, row.szAnswers), row.iCode) << row.szSwitches << " " << row.szAnswers << "\n" << m_log;
    EXPECT_TRUE(Logged(row.szLogged)) << row.szLogged << " is not in\n" << m_log;
    EXPECT_TRUE(m_files.events.empty()) << m_files.events[0];
  }
}

TEST_F(Unattended, TellsWhatCouldNotBeInstalled) {
  Pack({{"Installed.lst", "evil"}, {"a.txt", "a"}});
  EXPECT_EQ(Run("/S"), 1603);
  EXPECT_TRUE(Logged("failed: the file Installed.lst could not be installed")) << m_log;
  EXPECT_TRUE(Logged("page end")) << "the others are installed all the same";
  m_files.folder.Write("setup.exe", Stamped("no payload"));
  EXPECT_EQ(Run("/S"), 1603);
  EXPECT_FALSE(Logged("page person")) << "nothing is begun";
  m_files.folder.Write("setup.exe", Stamped(Compressed("no archive")));
  EXPECT_EQ(Run("/S"), 1603);
  EXPECT_TRUE(Logged("failed: the product archive is corrupted")) << m_log;
}

TEST_F(Unattended, OneSetupOfAProductAtATime) {
  for (const char* szSwitches : {"/S", "/norestart"}) {
    ProductLock other;
    ASSERT_TRUE(other.bTake("ORBITunattendedtest"));
    EXPECT_EQ(Run(szSwitches), 1618);
    EXPECT_EQ(m_files.Saw("Another setup of this product is running"), szSwitches[1] != 'S');
  }
  EXPECT_EQ(Run("/S"), 0) << m_log;
}

TEST_F(Unattended, AScriptMayRefuseWhatIsInstalled) {
  const struct {
    const char *szInstalled, *szRefuse;
    int iCode;
  } rows[] = {{"1.9", "1", 0}, {"1.10", "1", 1638}, {"1.10", "0", 0}, {"2", "1", 1638}, {"none", "1", 0}};
  for (const auto& row : rows) {
    ASSERT_EQ(COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, PRODUCT_KEY.c_str(), "DisplayVersion",
                                              row.szInstalled, nullptr),
              EVERYTHING_IS_OK);
    EXPECT_EQ(Run(std::string("/S /SET refuse_installed=") + row.szRefuse), row.iCode) << row.szInstalled;
  }
  const struct {
    const char *szA, *szB;
    int iOrder;
  } versions[] = {{"1.2", "1.10", -1}, {"1.2", "1.2.0", 0}, {"", "0.0", 0}, {"3", "2.99", 1},
                  {"1.2.3", "1.2", 1}, {"v1.5", "1.5", 0},  {"x", "", 0}};
  for (const auto& row : versions) {
    EXPECT_EQ(iCompareVersions(row.szA, row.szB), row.iOrder) << row.szA << " " << row.szB;
    EXPECT_EQ(iCompareVersions(row.szB, row.szA), -row.iOrder) << row.szA << " " << row.szB;
  }
}

TEST_F(Unattended, TheGivenFolderWinsOverThatOfAnOlderVersion) {
  ASSERT_EQ(COrbitWizard::iWriteRegistryKey(OS_HKEY_LOCAL_MACHINE, PRODUCT_KEY.c_str(), "InstallLocation",
                                            m_files.folder.Root().c_str(), nullptr),
            EVERYTHING_IS_OK);
  EXPECT_EQ(Run("/S /SET way=old"), 3010) << m_log;  // an upgrade, so that Reboot has something to do
  EXPECT_TRUE(m_files.folder.Exists("target\\a.txt"));
  EXPECT_FALSE(m_files.folder.Exists("a.txt"));
  EXPECT_EQ(Run("/S /SET way=old /SET unused=/D"), 3010) << m_log;  // without /DIR=
  EXPECT_TRUE(m_files.folder.Exists("a.txt"));
  EXPECT_TRUE(Logged("new variable unused")) << m_log;
  EXPECT_EQ(Run("/S /SET way=old /SET unused=/D /SET \"default_path=" + m_files.folder.Path("target") + "\""), 3010);
  EXPECT_TRUE(m_files.folder.Exists("target\\a.txt")) << m_log;
}

TEST_F(Unattended, APassiveRunShowsTheCopyingAndCanBeCancelled) {
  static bool s_bClose;
  m_files.surroundings.pMakeView = [](void* pFiles) -> std::unique_ptr<WizardView> {
    auto pView = std::make_unique<HeadlessView>();
    auto& events = static_cast<SetupFiles*>(pFiles)->events;
    pView->onEvent = [pShown = pView.get(), &events](const std::string& event) {
      events.push_back(event);
      if (event != "show copying") return;
      EXPECT_FALSE(pShown->bPress("b_stop"));
      if (s_bClose) pShown->Close();
    };
    return pView;
  };
  for (const bool bClose : {false, true}) {
    bOsDeleteFile(m_files.folder.Path("target\\a.txt").c_str());
    s_bClose = bClose;
    EXPECT_EQ(Run("/passive"), bClose ? 1602 : 0) << m_log;
    EXPECT_EQ(m_files.folder.Exists("target\\a.txt"), !bClose);
    std::string shown;
    for (const std::string& event : m_files.events)
      if (event.compare(0, 7, "caption") != 0) shown += event + ",";
    EXPECT_EQ(shown, "open-window,dialog copying,show copying,close-window,");
  }
}

TEST_F(Unattended, SavedAnswersDoWhatAPersonDid) {
  const std::string saved = m_files.folder.Path("saved.txt"), target = m_files.folder.Path("target");
  bool bLeave = true, bRefused = false;
  const auto person = [&](HeadlessView& view) {
    const std::string page = view.Dialog() ? view.Dialog()->m_csName.Text() : "";
    if (page == "dlg1") return view.bPress("b_exit");
    if (page == "person" && bLeave) return view.bPress("b_cancel");
    if (page == "person")
      return view.bType("person", "Ana \xC8i\xE6") && view.bPress("no") && view.bSelect("town", "Split") &&
             view.bPress("b_next");
    if (page == "folder") {
      const bool bTyped = view.bType("default_path", bRefused ? target.c_str() : "no full path");
      bRefused = true;
      return bTyped && view.bPress("btn_next_folder");
    }
    return page != "end" || view.bPress(*view.Dialog()->m_Controls[0]);
  };
  m_files.surroundings.uEndPause = 0;
  m_files.surroundings.pMakeView = [](void* pFiles) -> std::unique_ptr<WizardView> {
    auto pView = std::make_unique<HeadlessView>();
    pView->onIdle = static_cast<SetupFiles*>(pFiles)->onIdle;
    return pView;
  };
  m_files.onIdle = person;
  EXPECT_EQ(Run("\"/SAVEANSWERS=" + saved + "\""), 0);
  EXPECT_FALSE(m_files.folder.Exists("saved.txt")) << "of a run that was cancelled";
  bLeave = false;
  EXPECT_EQ(Run("\"/SAVEANSWERS=" + saved + "\""), 0) << m_log;
  const std::string answers = m_files.folder.Exists("saved.txt") ? m_files.folder.Read("saved.txt") : "";
  EXPECT_EQ(answers,
            "# Answers for an unattended run of OrbitUnattendedTest, read by /ANSWERS=FILE.\r\n\r\npage person\r\n"
            "  set person = Ana \xC4\x8Ci\xC4\x87\r\n  set address = \r\n  set yes = 0\r\n  set no = 1\r\n  set town = "
            "Split\r\n"
            "  press b_next\r\n\r\npage folder\r\n  message yes = The directory:\r\n  | '" +
                target + "'\r\n  | does not exist. Make it?\r\n  set default_path = " + target +
                "\r\n  press btn_next_folder\r\n");
  // Without /DIR=, so that the folder comes from the answers.
  EXPECT_EQ(Run("/S /SET unused=/D", answers), 0) << m_log;
  EXPECT_TRUE(Logged("set default_path = " + target)) << m_log;
  EXPECT_TRUE(m_files.folder.Exists("target\\a.txt"));
}

}  // namespace
