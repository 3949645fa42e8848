// Moving between dialogs, showing them and what happens in their controls, beside what scripts (tests/scripts) show.
#include <thread>

#include "WizardFixture.h"

namespace {

class Navigation : public WizardTest {
 protected:
  const std::string pages = "INIT\nname_a = \"first\"\nEND_INIT\n" +
                            Dialog("a", " EDIT_FIELD 'name_a' 1 1 1 1\n", "CONTINUE\n") +
                            Dialog("b", "", "CONTINUE\n") + Dialog("c", "", "");
};

using Showing = WizardTest;

TEST_F(Navigation, ClosingFromOutsideSavesNothing) {
  const struct {
    std::function<void()> act;
    int endedBy;
  } CASES[] = {{[&] { view.Close(); }, ID_CANCEL},
               {[&] { wizard.OnCommand(ID_CLOSE); }, ID_CANCEL},
               {[&] { std::thread([&] { wizard.QuitWizard(); }).join(); }, ID_EXIT}};
  for (const auto& test : CASES) {
    Run(pages, {[&] {
          EXPECT_TRUE(view.bType("name_a", "typed"));
          test.act();
        }});
    EXPECT_EQ(wizard.EndedBy(), test.endedBy);
    EXPECT_EQ(wizard.Value("name_a"), "first");
  }
  Run("DIALOG1 WINDOW 'a' \"a\" 0 0 9 9\nBEGIN\nEND\nEND_DIALOG1", {[&] {
        for (const int iID : {int(ID_CLOSE), 0, 501}) wizard.OnCommand(iID);
        EXPECT_TRUE(view.bHasWindow()) << "Escape is for dialogs";
      }});
  EXPECT_EQ(wizard.EndedBy(), 0);
}

TEST_F(Navigation, EnterPressesTheDefaultButton) {
  const std::string plain = " BUTTON 'x' \"X\" 1 1 1 1 ACTION\n";
  Run(Dialog("p", plain + " BUTTON 'DoGo' \"Go\" 1 1 1 1,DEFAULT,DISABLE ACTION: (here)\n", "CONTINUE\n") +
          Dialog("q", plain + BUTTONS, "CONTINUE\n") + Dialog("r", plain, ""),
      {[&] {
        int iResult;
        for (const char* szCommand : {"ShowControl (x)", "EnableControl (DoGo)", "DisableControl (DoGo)"}) {
          EXPECT_EQ(wizard.iExecuteCommand(szCommand, 0, &iResult), 0);
          wizard.OnCommand(ID_OK);
        }
        EXPECT_EQ(wizard.ran, Lines{"DoGo_OnClick(here)"}) << "while it is enabled";
        wizard.iNextDialog();
        wizard.OnCommand(ID_OK);
        EXPECT_EQ(wizard.CurrentDialogNumber(), 3);
        wizard.OnCommand(ID_OK);
        EXPECT_EQ(wizard.CurrentDialogNumber(), 3);
      }});
}

TEST_F(Navigation, FlowsThatStayLeaveNoTraceOnTheHistory) {
  Run(Dialog("a", "", "CONTINUE\n") + Dialog("b", "", "IF (mode == \"back\") THEN Result (7)\nDIALOG \"b\"\n"), {[&] {
        wizard.iNextDialog();
        wizard.iNextDialog();
        EXPECT_TRUE(wizard.CurrentDialogNumber() == 2 && wizard.HistoryCount() == 1) << "a jump to itself";
        wizard.iSetVariable("mode", "back");
        wizard.iNextDialog();
        EXPECT_TRUE(wizard.CurrentDialogNumber() == 1 && wizard.HistoryCount() == 0);
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
      }});
}

TEST_F(Navigation, ResultsOfEventsMoveTheWizard) {
  Run(Dialog("a", " EDIT_FIELD 'e' \"\" 1 1 1 1\n", "CONTINUE\n") + Dialog("b", "", "CONTINUE\n"), {[&] {
        view.bType("e", "typed");
        for (const int iResult : {0, 3, 46, 1002}) EXPECT_EQ(wizard.iProcessDecideNextDialogAction(iResult), 0);
        EXPECT_EQ(wizard.CurrentDialogNumber(), 1);
        EXPECT_EQ(wizard.iProcessDecideNextDialogAction(5), 0);
        EXPECT_EQ(wizard.CurrentDialogNumber(), 2);
        EXPECT_EQ(wizard.Value("e"), "typed");
        EXPECT_EQ(wizard.iProcessDecideNextDialogAction(7), 0);
        EXPECT_EQ(wizard.CurrentDialogNumber(), 1);
      }});
}

// A worker's commands are handled on the view's thread, sent ones before the call returns.
TEST_F(Navigation, CommandsOfOtherThreads) {
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

TEST_F(Showing, OrderOfShowing) {
  Lines shown;
  view.onEvent = [&](const std::string& event) { shown.push_back(event + " " + Text("t") + " " + Text("e")); };
  const std::string controls =
      " TEXT_FIELD 't' \"<%v%>\" TOOLTIP 'tip <%v%>' 1 1 1 1\n EDIT_FIELD 'e' \"cap\" 1 1 1 1\n"
      " LIST_FIELD 'l' \"<%v%>\" \"two\" 1 1 1 1\n CHECK_BOX 'c' \"I am <%v%>\" 1 1 1 1\n";
  std::string script =
      "INIT\nv = \"old\"\nc = \"1\"\nEND_INIT\n" +
      Dialog("a", controls, "", Action("v = \"new\"\n") + Action("v = \"late\"\nMESSAGE_BOX (\"after\")\n", "AFTER"));
  script.replace(script.find("\"a\""), 3, "\"Title <%v%>\"");
  Run(script, {[&] {
        EXPECT_EQ(shown, (Lines{"open-window (none) (none)", "caption default (none) (none)", "dialog a  ",
                                "caption Title new old cap", "show a new cap", "message after| -> 1 new cap"}));
        EXPECT_EQ(view.pState("l")->items, (Lines{"new", "two"}));
        EXPECT_EQ(view.pState("t")->toolTip, "tip new");
        EXPECT_EQ(Text("c"), "1");
        EXPECT_EQ(view.pState("c")->caption, "I am new") << "its words are not its state";
      }});
}

TEST_F(Showing, ActionsMayLeaveTheDialog) {
  for (const char* szWhen : {"BEFORE", "AFTER"}) {
    Run(Dialog("a", "", "CONTINUE\n") + Dialog("pass", "", "CONTINUE\n", Action("DIALOG \"c\"\nDo (never)\n", szWhen)) +
            Dialog("c", "", "") +
            Dialog("end", "", "", Action("Do (never)\n", "AFTER") + Action("EXIT\nDo (never)\n", szWhen)),
        {[&] {
           EXPECT_EQ(wizard.iNextDialog(), 0);
           EXPECT_EQ(wizard.CurrentDialogNumber(), 3);
         },
         [&] {
           EXPECT_STREQ(view.Dialog()->m_csName.Text(), "c");
           EXPECT_EQ(wizard.HistoryCount(), 1);
           wizard.iPreviousDialog();
           EXPECT_EQ(wizard.CurrentDialogNumber(), 1);
           int iResult;
           wizard.iDecideNextDialog(1, 3, "DIALOG \"end\"", &iResult);
           wizard.iProcessDecideNextDialogAction(iResult);
           EXPECT_TRUE(view.bHasWindow());  // posted
         }});
    EXPECT_EQ(wizard.EndedBy(), ID_EXIT) << szWhen;
    EXPECT_EQ(wizard.ran, Lines{});
  }
}

// The event of the field that gets the keyboard runs while the page is drawn, and may move on.
TEST_F(Showing, LeavingWhileBeingDrawnRunsTheNextPagesActionOnce) {
  view.onEvent = [&](const std::string& event) {
    if (event == "show a") wizard.iNextDialog();
  };
  Run(Dialog("a", "", "CONTINUE\n", Action("Do (a)\n", "AFTER")) + Dialog("b", "", "", Action("Do (b)\n", "AFTER")),
      {[&] { EXPECT_EQ(wizard.ran, Lines{"Do(b)"}); }});
}

TEST_F(Showing, FieldsAndControlsByName) {
  view.choices = {"C:\\Dir"};
  Run("INIT\ne = \"1\"\nt = \"var\"\nEND_INIT\n" +
          Dialog("a", " EDIT_FIELD 'e' 1 1 1 1\n TEXT_FIELD 't' \"cap\" 1 1 1 1\n PROGRESS_BAR 'p' 1 1 1 1\n", ""),
      {[&] {
        CNString csText;
        view.bType("e", "typed");
        EXPECT_TRUE(wizard.csGetField("e", csText));
        EXPECT_STREQ(csText.Text(), "typed");
        EXPECT_EQ(wizard.iSetField("e", "set"), 0);
        EXPECT_EQ(wizard.iSetVariable("e", "variable only"), 0);
        EXPECT_EQ(Text("e"), "set");
        EXPECT_EQ(wizard.iSetField("t", "x"), 0);  // no field: its caption stays
        EXPECT_EQ(Text("t"), "cap");
        EXPECT_TRUE(wizard.csGetField("t", csText));
        EXPECT_STREQ(csText.Text(), "x");
        EXPECT_FALSE(wizard.csGetField("none", csText));
        std::thread([&] {
          EXPECT_TRUE(wizard.CWSetWindowText("t", "50%"));
          EXPECT_TRUE(wizard.CWSetProgress("p", 150));
          EXPECT_FALSE(wizard.CWSetProgress("none", 1));
        }).join();
        EXPECT_TRUE(wizard.CWGetWindowText("t", csText));
        EXPECT_STREQ(csText.Text(), "50%");
        EXPECT_EQ(view.pState("p")->progress, 100);
        EXPECT_EQ(wizard.iGetDirectoryDialog("Choose", csText), 0);
        EXPECT_EQ(wizard.iGetFileDialog("File", csText), POSTCONDITIONS_NOT_VALID);
        EXPECT_STREQ(csText.Text(), "C:\\Dir") << "kept by a person who chooses nothing";
      }});
  EXPECT_EQ(wizard.GetBaseControl("e"), nullptr);
}

}  // namespace
