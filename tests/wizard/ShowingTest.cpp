#include <thread>

#include "WizardFixture.h"

namespace {

using Showing = WizardTest;

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
  Run("INIT\ne = \"1\"\nt = \"var\"\nEND_INIT\n" +
          Dialog("a", " EDIT_FIELD 'e' 1 1 1 1\n TEXT_FIELD 't' \"cap\" 1 1 1 1\n PROGRESS_BAR 'p' 1 1 1 1\n", ""),
      {[&] {
        CNString csText;
        view.bType("e", "typed");
        EXPECT_TRUE(wizard.csGetField("e", csText));
        EXPECT_STREQ(csText.Text(), "typed");
        EXPECT_EQ(wizard.iSetField("e", "set"), 0);
        EXPECT_EQ(Text("e"), "set");
        EXPECT_EQ(wizard.iSetVariable("e", "variable only"), 0);
        EXPECT_EQ(Text("e"), "set");
        EXPECT_EQ(wizard.iSetField("t", "x"), 0);  // no field: its caption stays
        EXPECT_EQ(Text("t"), "cap");
        EXPECT_TRUE(wizard.csGetField("t", csText));
        EXPECT_STREQ(csText.Text(), "x");
        EXPECT_FALSE(wizard.csGetField("none", csText));
        EXPECT_EQ(wizard.iSetField("", "x"), 1);
        std::thread([&] {
          EXPECT_TRUE(wizard.CWSetWindowText("t", "50%"));
          EXPECT_TRUE(wizard.CWSetProgress("p", 150));
          EXPECT_FALSE(wizard.CWSetProgress("none", 1));
        }).join();
        EXPECT_TRUE(wizard.CWGetWindowText("t", csText));
        EXPECT_STREQ(csText.Text(), "50%");
        EXPECT_EQ(view.pState("p")->progress, 100);
        Logged();
        EXPECT_FALSE(wizard.CWSetWindowText("", "x"));
        EXPECT_EQ(wizard.CWSendMessage(nullptr, 1, 2, 3), -1);
        EXPECT_EQ(wizard.CWSendMessage("none", 1, 2, 3), -1);
        EXPECT_EQ(Logged(),
                  (Lines{"ERROR: COrbitWizard::CWSetWindowText -> !szControlName || !*szControlName -> return "
                         "FALSE",
                         "ERROR: COrbitWizard::CWSendMessage -> !szControlName || !*szControlName -> return "
                         "-1"}));
      }});
  EXPECT_EQ(wizard.GetBaseControl("e"), nullptr);
}

TEST_F(Showing, Choosers) {
  CNString csChoice;
  EXPECT_EQ(wizard.iGetDirectoryDialog("", csChoice), 1);
  EXPECT_EQ(wizard.iGetFileDialog("Title", csChoice), 1);
  EXPECT_EQ(
      Logged(),
      (Lines{"ERROR: COrbitWizard::iGetDirectoryDialog -> !szTitle || !*szTitle -> return PRECONDITIONS_NOT_VALID",
             "ERROR: COrbitWizard::iGetFileDialog -> !hDlg -> return PRECONDITIONS_NOT_VALID"}));
  view.choices = {"C:\\Dir"};
  Run(Dialog("a", "", ""), {[&] {
        EXPECT_EQ(wizard.iGetDirectoryDialog("Choose", csChoice), 0);
        EXPECT_STREQ(csChoice.Text(), "C:\\Dir");
        EXPECT_EQ(wizard.iGetFileDialog("File", csChoice), POSTCONDITIONS_NOT_VALID);
        EXPECT_STREQ(csChoice.Text(), "C:\\Dir");
      }});
}

}  // namespace
