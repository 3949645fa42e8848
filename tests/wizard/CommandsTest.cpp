#include "WizardFixture.h"

namespace {

class Commands : public WizardTest {
 protected:
  int iRun(const char* szCommand, int iExpected = 0) {
    int iResult = -7;
    EXPECT_EQ(wizard.iExecuteCommand(szCommand, 0, &iResult), iExpected) << szCommand;
    return iResult;
  }
  int iCall(const char* szName, const char* szParam, int iExpected = 0) {
    int iResult = -7;
    EXPECT_EQ(wizard.COrbitWizard::iExecuteFunction(szName, szParam, 0, &iResult, nullptr), iExpected) << szName;
    return iResult;
  }
};

TEST_F(Commands, StatementsOfALine) {
  ASSERT_EQ(wizard.iLoadMainList((Dialog("a", "", "") + Dialog("b c", "", "")).c_str()), 0);
  const struct {
    const char* command;
    int code, result;
    const char* line;  // of the log, null for none
  } CASES[] = {
      {"BREAK", 0, 1004, nullptr},
      {"  BREAKFAST (x)", 0, 1004, nullptr},
      {"EXIT", 0, 2, nullptr},
      {"EXITS = \"1\"", 0, 2, nullptr},
      {"DIALOG \"b c\"", 0, 1005, nullptr},
      {"DIALOG\"a\" rest", 0, 1005, nullptr},
      {"DIALOG b", 9, 9, "EXIT: COrbitWizard::iExecuteCommand -> Missing \" -> retuirn FUNCTION_ERROR"},
      {"DIALOG \"b", 9, 9, "EXIT: COrbitWizard::iExecuteCommand -> !szSave (missing \") -> return FUNCTION_ERROR"},
      {"DIALOG \"none\"", 9, 9,
       "EXIT: COrbitWizard::iExecuteCommand -> iGetDialogNumberByName -> return FUNCTION_ERROR"},
      {"x = \"1\" + \"2\"", 0, 1002, nullptr},
      {"x =", 9, 9, "ERROR: COrbitWizard::iCalculateValue -> !*szText  -> return PRECONDITIONS_NOT_VALID"},
      {"Do (it (nested) )", 0, 0, nullptr},
      {"Do (open", 9, 9, "ERROR: COrbitWizard::iExecuteCommand -> !ptrSearch -> return FUNCTION_ERROR"},
      {"Do", 9, 9, "EXIT: COrbitWizard::iExecuteCommand -> return FUNCTION_ERROR"},
      {"Do()", 9, 9, "EXIT: COrbitWizard::iExecuteCommand -> return FUNCTION_ERROR"},
      {"Do this", 9, 9, "EXIT: COrbitWizard::iExecuteCommand -> return FUNCTION_ERROR"},
      {"   ", 9, 9, "EXIT: COrbitWizard::iExecuteCommand -> return FUNCTION_ERROR"},
      {"", 9, 9, "ERROR: COrbitWizard::iExecuteCommand -> !*szCommand -> return FUNCTION_ERROR"},
      {nullptr, 9, 9, "ERROR: COrbitWizard::iExecuteCommand -> !szCommand -> return FUNCTION_ERROR"},
      {"Fail (x)", 9, 9, "ERROR: COrbitWizard::iExecuteCommand -> iExecuteFunction -> return FUNCTION_ERROR"},
      {"Do (DIALOG \"a\")", 0, 1005, nullptr},
  };
  for (const auto& test : CASES) {
    const std::string name = test.command ? test.command : "null";
    int iResult = -7;
    EXPECT_EQ(wizard.iExecuteCommand(test.command, 0, &iResult), test.code) << name;
    EXPECT_EQ(iResult, test.result) << name;
    const Lines lines = Logged();
    EXPECT_EQ(lines.empty() ? "" : lines.front(), test.line ? test.line : "") << name;
  }
  EXPECT_EQ(wizard.ran, (Lines{"Do(it (nested)"}));
  EXPECT_EQ(wizard.Counter(), 1);
}

TEST_F(Commands, Assignments) {
  wizard.iSetVariable("v", "1.0");
  EXPECT_EQ(iRun("x = \"version <%v%>\""), 1002);
  EXPECT_EQ(wizard.Value("x"), "version 1.0");
  EXPECT_EQ(iRun("x   = \"__\""), 1002);
  EXPECT_EQ(wizard.Value("x"), "");
  EXPECT_EQ(iRun("n = Strlen (v)"), 1002);
  EXPECT_EQ(wizard.Value("n"), "3");
  EXPECT_EQ(Logged(), Lines{});
  EXPECT_EQ(iRun("= \"1\"", 9), 9);
}

TEST_F(Commands, JumpsInParameters) {
  ASSERT_EQ(wizard.iLoadMainList(Dialog("a", "", "").c_str()), 0);
  EXPECT_EQ(iRun("Do (DIALOG \"none\")"), 0);
  EXPECT_EQ(iRun("Do (DIALOG none)", 9), 9);
  EXPECT_EQ(iRun("Do (DIALOG \"none)", 9), 9);
  EXPECT_EQ(Events(), (Lines{"message Greška|Dialog \"none\" ne postoji! -> 1",
                             "message Syntax Error|missing \" in Action parametar -> 1",
                             "message Syntax Error|missing \" in Action parametar -> 1"}));
  EXPECT_EQ(Logged(), (Lines{"ERROR: COrbitWizard::iExecuteCommand -> iGoToDialogByName -> return EVERYTHING_IS_OK",
                             "ERROR: COrbitWizard::iExecuteCommand -> !ptrName-> return FUNCTION_ERROR",
                             "ERROR: COrbitWizard::iExecuteCommand -> !ptrEnd-> return FUNCTION_ERROR"}));
}

TEST_F(Commands, MessageBoxes) {
  wizard.iSetVariable("v", "1.0");
  ASSERT_EQ(wizard.iLoadMainList((Dialog("a", "", "") + Dialog("b",
                                                               "MESSAGE_BOX 'ask' \"Version <%v%>\", MB_YESNO\n"
                                                               "> Go on\n> with <%v%>?\nEND_MESSAGE_BOX\n",
                                                               ""))
                                     .c_str()),
            0);
  view.answers = {ANSWER_NO};
  for (const char* szCommand : {"MESSAGE_BOX (ask)", "MESSAGE_BOX (\"ask\")", "MESSAGE_BOX ( 'ask' )"})
    EXPECT_EQ(iRun(szCommand), 0);
  const std::string asked = "message Version 1.0|Go on\nwith 1.0? -> ";
  EXPECT_EQ(Events(), (Lines{asked + "7", asked + "6", asked + "6"}));
  EXPECT_EQ(wizard.Value("msgbox_answer"), "6");
  EXPECT_EQ(iRun("MESSAGE_BOX ('x' \"Cap > <%v%>\", MB_OKCANCEL > one > two)"), 0);
  EXPECT_EQ(iRun("MESSAGE_BOX (\"Only\")"), 0);
  EXPECT_EQ(Events(), (Lines{"message Cap > 1.0|one \ntwo -> 1", "message Only| -> 1"}));
  EXPECT_EQ(Logged(), Lines{});
  EXPECT_EQ(iRun("MESSAGE_BOX (none)"), 0);
  EXPECT_EQ(wizard.Value("msgbox_answer"), "0");
  EXPECT_EQ(Logged().size(), 1u);
  EXPECT_EQ(wizard.iShowMessageBox("ask", MessageIcon::Error), ANSWER_YES);
  EXPECT_EQ(wizard.iShowMessageBox("none", MessageIcon::Error), 0);
  EXPECT_EQ(wizard.iShowMessageBox(nullptr, MessageIcon::Error), 0);
}

TEST_F(Commands, BuiltInsThatAnswer) {
  wizard.iSetVariable("path", "a.txt");
  wizard.iSetVariable("ext", ".txt");
  const struct {
    const char *name, *param;
    int result;
  } CASES[] = {
      {"EndsWith", "path;\".txt\"", 1},
      {"EndsWith", "path ; ext", 1},
      {"EndsWith", "path;\".TXT\"", 0},
      {"EndsWith", "ext;path", 0},
      {"EndsWith", "path;\"\"", 1},
      {"EndsWith", "path", 0},
      {"EndsWith", "missing;ext", 0},
      {"NotEndsWith", "path;\".doc\"", 1},
      {"NotEndsWith", "path;ext", 0},
      {"NotEndsWith", "missing;ext", 0},
      {"Strlen", "path", 0},
      {"RecordMacro", "", 0},
      {"PlayMacro", "", 0},
      {"NextPage", "", 0},
      {"next", "", 0},
      {"btn_set_var_quit_OnClick", "", 2},
      {"btn_set_var_quit_OnClick", "a;b", 2},
      {"link_web_OnFocus", "x", 0},
      {"btn_set_var_quit_OnClick", "c;d;e", 2},
  };
  for (const auto& test : CASES) EXPECT_EQ(iCall(test.name, test.param), test.result) << test.name << " " << test.param;
  EXPECT_EQ(wizard.Value("a"), "b");
  EXPECT_EQ(wizard.Variables().pFind("c"), nullptr);
  EXPECT_EQ(Events(), Lines{});
}

TEST_F(Commands, BuiltInsThatFail) {
  const std::string missing = "ERROR: COrbitWizard::iExecuteFunction -> i";
  for (const char* szName : {"EnableControl", "DisableControl", "ShowControl", "HideControl", "HideWizard",
                             "ShowWizard", "FillRecentFiles", "OpenRecentFile"}) {
    EXPECT_EQ(iCall(szName, "none", 9), 9);
    EXPECT_EQ(Logged(), Lines{missing + szName + " -> return FUNCTION_ERROR"});
  }
  EXPECT_EQ(iCall(nullptr, "", 1), 9);
  EXPECT_EQ(iCall("", "", 1), 9);
  EXPECT_EQ(iCall("Next", nullptr, 1), 9);
  EXPECT_EQ(Logged(), (Lines{"ERROR: COrbitWizard::iExecuteFunction -> !szCommand -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: COrbitWizard::iExecuteFunction -> !*szCommand -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: COrbitWizard::iExecuteFunction -> !szParam -> return PRECONDITIONS_NOT_VALID"}));
}

TEST_F(Commands, LinksAndControls) {
  const std::string controls =
      " TEXT_FIELD 'link_web' \"W\" 0 0 1 1,LINK ACTION: (http://example.org//a)\n"
      " TEXT_FIELD 'link_mail_ex' \"M\" 0 0 1 1,LINK ACTION: (mailto:a@example.org)\n"
      " TEXT_FIELD 'link_next' \"N\" 0 0 1 1,LINK ACTION: (two)\n"
      " BUTTON 'b' \"B\" 0 0 1 1\n";
  Run(Dialog("a", controls, "CONTINUE\n") + Dialog("b", "", ""),
      {[&] {
         EXPECT_TRUE(view.bPress("link_web"));
         EXPECT_TRUE(view.bPress("link_mail_ex"));
         EXPECT_TRUE(wizard.GetBaseControl("link_web")->m_bVisited);
         EXPECT_FALSE(wizard.GetBaseControl("link_next")->m_bVisited);
         EXPECT_EQ(iRun("DisableControl ( b )"), 0);
         EXPECT_FALSE(view.bPress("b"));
         EXPECT_EQ(iRun("EnableControl (b)"), 0);
         EXPECT_EQ(iRun("HideControl (b)"), 0);
         EXPECT_FALSE(view.bPress("b"));
         EXPECT_EQ(iRun("ShowControl (b)"), 0);
         EXPECT_TRUE(view.bPress("b"));
         EXPECT_EQ(iRun("HideWizard ()"), 0);
         EXPECT_FALSE(view.bWindowShown());
         EXPECT_EQ(iRun("ShowWizard ()"), 0);
         EXPECT_TRUE(view.bWindowShown());
         EXPECT_TRUE(view.bPress("link_next"));
         EXPECT_EQ(wizard.CurrentDialogNumber(), 1);  // posted, not done at once
       },
       [&] {
         EXPECT_EQ(wizard.Value("link_next_var"), "two");
         EXPECT_EQ(wizard.CurrentDialogNumber(), 2);
         EXPECT_EQ(iRun("Back ()"), 0);
       },
       [&] {
         EXPECT_EQ(wizard.CurrentDialogNumber(), 1);
         EXPECT_EQ(iRun("Next ()"), 0);
       },
       [&] { EXPECT_EQ(wizard.CurrentDialogNumber(), 2); }});
  const Lines events = Events();
  EXPECT_NE(std::find(events.begin(), events.end(), "open http://example.org//a"), events.end());
  EXPECT_NE(std::find(events.begin(), events.end(), "open mailto:a@example.org"), events.end());
}

}  // namespace
