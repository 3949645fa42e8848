// What scripts (tests/scripts) cannot ask of commands: arguments that no script gives, the state that commands leave in
// the view.
#include "WizardFixture.h"

namespace {

class Commands : public WizardTest {
 protected:
  int iRun(const char* szCommand, int iExpected = 0) {
    int iResult = -7;
    EXPECT_EQ(wizard.iExecuteCommand(szCommand, 0, &iResult), iExpected) << (szCommand ? szCommand : "null");
    return iResult;
  }
  int iCall(const char* szName, const char* szParam, int iExpected = 0) {
    int iResult = -7;
    EXPECT_EQ(wizard.COrbitWizard::iExecuteFunction(szName, szParam, 0, &iResult, nullptr), iExpected);
    return iResult;
  }
};

TEST_F(Commands, ArgumentsThatAreNone) {
  EXPECT_EQ(iRun(nullptr, 9), 9);
  EXPECT_EQ(iRun("", 9), 9);
  EXPECT_EQ(iRun("   ", 9), 9);
  EXPECT_EQ(iCall(nullptr, "", 1), 9);
  EXPECT_EQ(iCall("", "", 1), 9);
  EXPECT_EQ(iCall("Next", nullptr, 1), 9);
  EXPECT_EQ(wizard.iShowMessageBox(nullptr, MessageIcon::Error), 0);
  EXPECT_EQ(Logged(), (Lines{"ERROR: COrbitWizard::iExecuteCommand -> !szCommand -> return FUNCTION_ERROR",
                             "ERROR: COrbitWizard::iExecuteCommand -> !*szCommand -> return FUNCTION_ERROR",
                             "EXIT: COrbitWizard::iExecuteCommand -> return FUNCTION_ERROR",
                             "ERROR: COrbitWizard::iExecuteFunction -> !szCommand -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: COrbitWizard::iExecuteFunction -> !*szCommand -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: COrbitWizard::iExecuteFunction -> !szParam -> return PRECONDITIONS_NOT_VALID",
                             "ERROR: COrbitWizard::iShowMessageBox -> ! -> return 0"}));
}

TEST_F(Commands, WithoutAWindow) {
  for (const std::string name : {"HideWizard", "ShowWizard", "EnableControl", "HideControl"}) {
    EXPECT_EQ(iCall(name.c_str(), "none", 9), 9);
    EXPECT_EQ(Logged(), Lines{"ERROR: COrbitWizard::iExecuteFunction -> i" + name + " -> return FUNCTION_ERROR"});
  }
}

TEST_F(Commands, ABoxIsFoundBehindAnotherControlOfItsName) {
  ASSERT_EQ(wizard.iLoadMainList((Dialog("a", " EDIT_FIELD 'ask' 1 1 1 1\n", "") +
                                  Dialog("b",
                                         " EDIT_FIELD 'ask' 1 1 1 1\nMESSAGE_BOX 'ask' \"c\", MB_YESNO\n> t\n"
                                         "END_MESSAGE_BOX\n",
                                         ""))
                                     .c_str()),
            0);
  EXPECT_EQ(wizard.iShowMessageBox("ask", MessageIcon::Error), ANSWER_YES);
  EXPECT_EQ(Events(), Lines{"message c|t -> 6"});
}

TEST_F(Commands, WhatTheyLeaveInTheView) {
  const std::string controls =
      " TEXT_FIELD 'link_web' \"W\" 0 0 1 1,LINK ACTION: (http://example.org//a)\n"
      " TEXT_FIELD 'link_next' \"N\" 0 0 1 1,LINK ACTION: (two)\n";
  Run(Dialog("a", controls, "CONTINUE\n") + Dialog("b", "", ""),
      {[&] {
         EXPECT_TRUE(view.bPress("link_web"));
         EXPECT_TRUE(wizard.GetBaseControl("link_web")->m_bVisited);
         EXPECT_FALSE(wizard.GetBaseControl("link_next")->m_bVisited);
         EXPECT_EQ(iRun("HideWizard ()"), 0);
         EXPECT_FALSE(view.bWindowShown());
         EXPECT_EQ(iRun("ShowWizard ()"), 0);
         EXPECT_TRUE(view.bWindowShown());
         EXPECT_TRUE(view.bPress("link_next"));
         EXPECT_EQ(wizard.CurrentDialogNumber(), 1);  // posted, not done at once
       },
       [&] { EXPECT_EQ(wizard.CurrentDialogNumber(), 2); }});
}

}  // namespace
