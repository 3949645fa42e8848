#include <thread>

#include "WizardFixture.h"

namespace {

class Navigation : public WizardTest {
 protected:
  // Pages a, b, c with an edit field each; c ends the wizard.
  const std::string pages =
      "INIT\nname_a = \"first\"\ndone = \"0\"\nEND_INIT\n" +
      Dialog("a", std::string(" EDIT_FIELD 'name_a' 1 1 1 1\n") + BUTTONS, "CONTINUE\n") +
      Dialog("b", std::string(" EDIT_FIELD 'name_b' \"none\" 1 1 1 1\n") + BUTTONS, "CONTINUE\n") +
      Dialog("c", std::string(" CHECK_BOX 'done' \"\" 1 1 1 1\n") + BUTTONS, "");
};

TEST_F(Navigation, WaysToEnd) {
  const struct {
    std::function<void()> act;
    int endedBy;
    const char* value;  // of name_a: kept only when nothing was saved
  } CASES[] = {
      {[&] { view.bPress("b_cancel"); }, ID_CANCEL, "first"},
      {[&] { view.bPress("b_exit"); }, ID_EXIT, "first"},
      {[&] { view.Close(); }, ID_CANCEL, "first"},
      {[&] { wizard.OnCommand(ID_CLOSE); }, ID_CANCEL, "first"},
      {[&] { wizard.QuitWizard(); }, ID_EXIT, "first"},
      {[&] { std::thread([&] { wizard.QuitWizard(); }).join(); }, ID_EXIT, "first"},
      {[&] { wizard.iProcessDecideNextDialogAction(2); }, ID_EXIT, "first"},
      {[&] { EXPECT_EQ(wizard.iProcessDecideNextDialogAction(9), 9); }, ID_CANCEL, "first"},
  };
  for (const auto& test : CASES) {
    Run(pages, {[&] {
          EXPECT_TRUE(view.bType("name_a", "typed"));
          test.act();
        }});
    EXPECT_EQ(wizard.EndedBy(), test.endedBy);
    EXPECT_EQ(wizard.Value("name_a"), test.value);
  }
}

TEST_F(Navigation, EscapeIsForDialogs) {
  std::string page = Dialog("a", "", "");
  page.replace(page.find("'a'"), 0, "WINDOW ");
  Run(page, {[&] {
        wizard.OnCommand(ID_CLOSE);
        EXPECT_TRUE(view.bHasWindow());
        wizard.OnCommand(0);
        wizard.OnCommand(501);
      }});
  EXPECT_EQ(wizard.EndedBy(), 0);
}

TEST_F(Navigation, EnterPressesTheDefaultButton) {
  Run(Dialog("p", " BUTTON 'x' \"X\" 1 1 1 1 ACTION\n BUTTON 'DoGo' \"Go\" 1 1 1 1,DEFAULT ACTION: (here)\n", "") +
          Dialog("a", BUTTONS, "DIALOG \"p\"\n"),
      {[&] {
        wizard.OnCommand(ID_OK);
        EXPECT_EQ(wizard.ran, Lines{"DoGo_OnClick(here)"});
        int iResult;
        EXPECT_EQ(wizard.iExecuteCommand("DisableControl (DoGo)", 0, &iResult), 0);
        wizard.OnCommand(ID_OK);
        EXPECT_EQ(wizard.ran.size(), 1u);
        EXPECT_EQ(wizard.iExecuteCommand("EnableControl (DoGo)", 0, &iResult), 0);
        wizard.OnCommand(ID_OK);
        EXPECT_EQ(wizard.ran.size(), 2u);
        wizard.iProcessDecideNextDialogAction(7);
        EXPECT_EQ(wizard.CurrentDialogNumber(), 1);
      }});
  Run(Dialog("q", " BUTTON 'DoQ' \"Q\" 1 1 1 1,DEFAULT,DISABLE ACTION: (q)\n", ""), {[&] {
        int iResult;
        wizard.ran.clear();
        wizard.OnCommand(ID_OK);
        EXPECT_EQ(wizard.ran, Lines{});
        EXPECT_EQ(wizard.iExecuteCommand("EnableControl (DoQ)", 0, &iResult), 0);
        wizard.OnCommand(ID_OK);
        EXPECT_EQ(wizard.ran, Lines{"DoQ_OnClick(q)"}) << "enabled since";
      }});
}

TEST_F(Navigation, FlowsThatStayLeaveNoTraceOnTheHistory) {
  Run(Dialog("a", BUTTONS, "CONTINUE\n") +
          Dialog(
              "b", BUTTONS,
              "IF (mode == \"fail\") THEN Fail ()\nIF (mode == \"stay\") THEN BREAK\nIF (mode == \"back\") THEN Result "
              "(7)\nIF (mode == \"far\") THEN DIALOG \"d\"\nIF (mode == \"self\") THEN DIALOG \"b\"\nCONTINUE\n") +
          Dialog("c", BUTTONS, "CONTINUE\n") + Dialog("d", BUTTONS, "CONTINUE\n"),
      {[&] {
        wizard.iSetVariable("mode", "");
        view.bPress("b_next");
        for (const char* szMode : {"fail", "stay", "self", "fail"}) {
          wizard.iSetVariable("mode", szMode);
          view.bPress("b_next");
          EXPECT_EQ(wizard.CurrentDialogNumber(), 2) << szMode;
          EXPECT_EQ(wizard.HistoryCount(), 1) << szMode;
        }
        wizard.iSetVariable("mode", "back");
        view.bPress("b_next");
        EXPECT_EQ(wizard.CurrentDialogNumber(), 1);
        EXPECT_EQ(wizard.HistoryCount(), 0);
        wizard.iSetVariable("mode", "far");
        view.bPress("b_next");
        view.bPress("b_next");
        EXPECT_EQ(wizard.CurrentDialogNumber(), 4);
        Logged();
        EXPECT_EQ(wizard.iNextDialog(), POSTCONDITIONS_NOT_VALID);  // there is no fifth
        EXPECT_EQ(Logged(), Lines{"ERROR: COrbitWizard::iNextDialog -> iResultDialogNum = 5, window = d -> return "
                                  "POSTCONDITIONS_NOT_VALID"});
        EXPECT_EQ(wizard.HistoryCount(), 2);
        view.bPress("b_back");
        EXPECT_EQ(wizard.CurrentDialogNumber(), 2);
      }});
}

TEST_F(Navigation, Events) {
  const std::string controls =
      " BUTTON 'Do_b' \"B\" 1 1 1 1 ACTION: (Choose directory:)\n BUTTON 'Do_none' \"B\" 1 1 1 1\n"
      " TEXT_FIELD 'Do_l' \"L\" 1 1 1 1,LINK ACTION: ()\n CHECK_BOX 'Do_c' \"\" 1 1 1 1 ACTION\n"
      " EDIT_FIELD 'Do_e' \"\" 1 1 1 1 ACTION: (e)\n LIST_FIELD 'Do_list' \"one\" \"two\" 1 1 1 1 ACTION: ()\n"
      " BUTTON 'DIALOG' \"J\" 1 1 1 1 ACTION: ()\n BUTTON \"nameless\" 1 1 1 1 ACTION: (x)\n";
  Run(Dialog("a", controls, ""), {[&] {
        EXPECT_TRUE(view.bPress("Do_b"));
        EXPECT_TRUE(view.bPress("Do_none"));
        EXPECT_TRUE(view.bPress("Do_l"));
        EXPECT_TRUE(view.bPress("Do_c"));
        EXPECT_TRUE(view.bType("Do_e", "x"));
        EXPECT_TRUE(view.bSelect("Do_list", "two"));
        EXPECT_FALSE(view.bSelect("Do_list", "three"));
        wizard.OnControl(*wizard.GetBaseControl("Do_list"), NOTIFY_DOUBLE_CLICK);
        wizard.OnControl(*wizard.GetBaseControl("Do_list"), NOTIFY_MOUSE_IN);
        wizard.OnControl(*wizard.CurrentDialog()->m_Controls[7], NOTIFY_CLICK);
        EXPECT_EQ(wizard.ran,
                  (Lines{"Do_b_OnClick(Choose directory:)", "Do_l_OnClick()", "Do_c_OnClick()", "Do_e_OnSetFocus(e)",
                         "Do_e_OnKillFocus(e)", "Do_list_OnSelChange()", "Do_list_OnDoubleClick()"}));
        wizard.iSaveVarFromCurrentDlg(wizard.CurrentDialog());
        EXPECT_EQ(wizard.Value("Do_list"), "two");
        EXPECT_EQ(wizard.Value("Do_c"), "1");
      }});
}

TEST_F(Navigation, ResultsOfEventsMoveTheWizard) {
  const std::string controls = " EDIT_FIELD 'e' \"\" 1 1 1 1\n BUTTON 'jump' \"J\" 1 1 1 1 ACTION: (DIALOG \"c\")\n";
  Run(Dialog("a", controls, "CONTINUE\n") + Dialog("b", "", "CONTINUE\n") + Dialog("c", "", ""), {[&] {
        view.bType("e", "typed");
        EXPECT_TRUE(view.bPress("jump"));
        EXPECT_EQ(wizard.CurrentDialogNumber(), 3);
        EXPECT_EQ(wizard.Value("e"), "typed");
        wizard.iPreviousDialog();
        EXPECT_EQ(wizard.CurrentDialogNumber(), 1);
        EXPECT_EQ(wizard.HistoryCount(), 0);
        view.bType("e", "again");
        EXPECT_EQ(wizard.iProcessDecideNextDialogAction(5), 0);
        EXPECT_EQ(wizard.CurrentDialogNumber(), 2);
        EXPECT_EQ(wizard.Value("e"), "again");
        EXPECT_EQ(wizard.iProcessDecideNextDialogAction(46), 0);
        EXPECT_EQ(wizard.iProcessDecideNextDialogAction(0), 0);
        EXPECT_EQ(wizard.CurrentDialogNumber(), 2);
      }});
}

TEST_F(Navigation, WithoutADialogOrAWindow) {
  EXPECT_EQ(wizard.iNextDialog(), 1);
  EXPECT_EQ(wizard.iPreviousDialog(), 1);
  EXPECT_EQ(wizard.iSaveVarFromCurrentDlg(nullptr), 1);
  EXPECT_EQ(wizard.iExecuteWizard("", 0), 1);
  EXPECT_EQ(wizard.iExecuteWizard("no such file", 0), FUNCTION_ERROR);
  EXPECT_EQ(wizard.iShowCurrentDialog(), FUNCTION_ERROR);
  const Lines lines = Logged();
  ASSERT_EQ(lines.size(), 6u);
  EXPECT_EQ(lines[0], "ERROR: COrbitWizard::iNextDialog -> !m_pWizDialogInfo -> return PRECONDITIONS_NOT_VALID");
  EXPECT_EQ(lines[1], "ERROR: COrbitWizard::iPreviousDialog -> !hDlg -> return PRECONDITIONS_NOT_VALID");
  EXPECT_EQ(lines[2],
            "ERROR: COrbitWizard::iSaveVarFromCurrentDlg -> !pWizDialogInfo -> return PRECONDITIONS_NOT_VALID");
  EXPECT_EQ(lines[3],
            "ERROR: COrbitWizard::iExecuteWizard -> !szScript || !*szScript -> return PRECONDITIONS_NOT_VALID");
  // A page that has lost its flow text ends the wizard too, but as a failure.
  Run("DIALOG1 'x' \"x\"\nArial\nBEGIN\n BUTTON 'b' \"N\" ID_NEXT 1 1 1 1\nEND_DIALOG1", {[&] {
        Logged();
        EXPECT_EQ(wizard.iNextDialog(), FUNCTION_ERROR);
        EXPECT_EQ(Logged(), Lines{"ERROR: COrbitWizard::iNextDialog -> iNextDialog==-1 -> ID_CANCEL -> return "
                                  "FUNCTION_ERROR"});
      }});
  EXPECT_EQ(wizard.EndedBy(), ID_NEXT);
}

// A worker's commands are handled on the view's thread, sent ones before the call returns.
TEST_F(Navigation, CommandsOfOtherThreads) {
  view.idleLimit = 10000;
  ASSERT_EQ(wizard.iLoadMainList(pages.c_str()), 0);
  std::thread worker;
  int iSeen = 0;
  view.onEvent = [&](const std::string& event) {
    if (event != "show a") return;
    worker = std::thread([&] {
      view.SendCommand(ID_NEXT);
      iSeen = wizard.CurrentDialogNumber();
      view.PostCommand(ID_NEXT);
      view.PostCommand(ID_EXIT);
    });
  };
  EXPECT_EQ(wizard.iRunWindow("WizardTestClass", 0), 0);
  worker.join();
  EXPECT_EQ(iSeen, 2);
  EXPECT_EQ(wizard.CurrentDialogNumber(), 3);
  EXPECT_EQ(wizard.EndedBy(), ID_EXIT);
}

TEST_F(Navigation, AnOwnedViewSharesItsOwnersScript) {
  view.answers = {ANSWER_OK};
  Lines pressed;
  ASSERT_EQ(wizard.iLoadMainList(Dialog("outer", BUTTONS, "").c_str()), 0);
  view.onIdle = [&](HeadlessView& running) {
    const std::string name = running.Dialog()->m_csName.Text();
    pressed.push_back(name);
    if (name == "inner") return running.bPress("b_exit");
    if (pressed.size() > 1) return running.bPress("b_cancel");
    const std::unique_ptr<WizardView> pOwned = view.pMakeOwnedView();
    TestWizard inner(*pOwned);
    EXPECT_EQ(inner.iExecuteWizard(Dialog("inner", BUTTONS, "", Action("MESSAGE_BOX (\"m\")\n")).c_str(), 0), 0);
    EXPECT_EQ(inner.EndedBy(), ID_EXIT);
    EXPECT_TRUE(view.bHasWindow());
    return true;
  };
  EXPECT_EQ(wizard.iRunWindow("WizardTestClass", 0), 0);
  EXPECT_EQ(pressed, (Lines{"outer", "inner", "outer"}));
  EXPECT_EQ(Events(), (Lines{"open-window", "caption default", "dialog outer", "caption outer", "show outer",
                             "open-window", "caption default", "dialog inner", "message m| -> 1", "caption inner",
                             "show inner", "close-window", "close-window"}));
  EXPECT_EQ(wizard.EndedBy(), ID_CANCEL);
}

}  // namespace
