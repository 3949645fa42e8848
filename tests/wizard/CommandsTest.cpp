// What scripts (tests/scripts) cannot ask of commands, conditions and
// assignments: arguments that no script gives, single results, limits, the
// state that commands leave in the view.
#include "WizardFixture.h"

namespace {

class Commands : public WizardTest {
 protected:
  int iRun(const std::string& command, int iExpected = 0) {
    int iResult = -7;
    EXPECT_EQ(wizard.iExecuteCommand(command.c_str(), 0, &iResult), iExpected) << command;
    return iResult;
  }
  int iEvaluate(const std::string& text, int iExpected = 0) {
    int iResult = 7;
    EXPECT_EQ(wizard.iEvaluateExpression(text.c_str(), static_cast<int>(text.size()), &iResult), iExpected) << text;
    return iResult;
  }
};

using Flow = WizardTest;

TEST_F(Commands, ABoxIsFoundBehindAnotherControlOfItsName) {
  ASSERT_EQ(wizard.iLoadMainList(
                (Dialog("a", " EDIT_FIELD 'ask' 1 1 1 1\n", "") + Dialog("b",
                                                                         " EDIT_FIELD 'ask' 1 1 1 1\nMESSAGE_BOX "
                                                                         "'ask' \"c\", MB_YESNO\n> t\n"
                                                                         "END_MESSAGE_BOX\n",
                                                                         ""))
                    .c_str()),
            0);
  EXPECT_EQ(wizard.iShowMessageBox("ask", MessageIcon::Error), ANSWER_YES);
  EXPECT_EQ(Events(), Lines{"message c|t -> 6"});
}

TEST_F(Commands, WhatTheyLeaveInTheView) {
  const std::string controls =
      " TEXT_FIELD 'link_web' \"W\" 0 0 1 1,LINK ACTION: "
      "(http://example.org//a)\n"
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

TEST_F(Commands, ResultsOfConditions) {
  const struct {
    const char* text;
    int result;
  } CASES[] = {
      {"\"3000000000\" > \"9\"", 1},
      {"\"a == b\" == \"a == b\"", 1},
      {"[TRUE]", 1},
      {"[]", -1},
      {"(())", -1},
      {"five", 0},
      {"Result (9)", -1},
      {"Fail (x)", -1},
      {"missing1 == missing2", -1},
      {"five == \"5\"\n(never read", 1},
  };
  wizard.iSetVariable("five", "5");
  for (const auto& test : CASES) EXPECT_EQ(iEvaluate(test.text), test.result) << test.text;
  for (const char* szText : {"", "\n(a)", "five == \"(\"", "\"a\" \"b\"", "a == b == c", "& five", "== \"5\" )(",
                             "\"open == \"x", "Do (1)) || (Do (2)"})
    EXPECT_EQ(iEvaluate(szText, 1), -1) << szText;
  EXPECT_EQ(wizard.ran, Lines{"Do(1)"});  // balanced, so it was read until it made no sense
  EXPECT_EQ(iEvaluate(std::string(100000, '(') + "_TRUE" + std::string(100000, ')'), 1), -1);
  std::string chain = "_TRUE";
  for (int i = 0; i < 10000; i++) chain += " && _TRUE";
  EXPECT_EQ(iEvaluate(chain), 1);
}

TEST_F(Commands, AtomsTakeAnyOperator) {
  const struct {
    int op, whenTrue, whenFalse;
  } CASES[] = {{-1, -1, -1}, {0, 1, 0}, {1, 0, 1}, {7, 1, 0}, {8, 1, 1}, {9, -1, -1}};
  for (const auto& test : CASES) {
    int iTrue = 7, iFalse = 7;
    EXPECT_EQ(wizard.iEvaluateAtom("\"TRUE\"", "\"TRUE\"", test.op, &iTrue), 0);
    EXPECT_EQ(wizard.iEvaluateAtom("\"TRUE\"", "\"FALSE\"", test.op, &iFalse), 0);
    EXPECT_TRUE(iTrue == test.whenTrue && iFalse == test.whenFalse) << test.op;
  }
}

// "v = v + ..." appends where the value stands; "v = "__" + v + ..." makes the
// same value anew.
TEST_F(Commands, AppendingInPlaceGivesTheSame) {
  const char* const TAILS[] = {
      "\"b\"", "\"<%x%>\"", "\"<\"",         "\"%x%>\"",        "v", "x + \"<\"", "\"<%l%>\"",        "\"c\"",
      "none",  "\"__\"",    "\"a\" - \"1\"", "\"q\" + Say (z)", "",  "\"open",    "\"<\" + \"%x%>\"", "\"end\""};
  for (const char* szStart : {"a", "", "<%x%>", "<", "<%l%>"}) {
    wizard.iSetVariable("x", "1");
    wizard.iSetVariable("l", "<%l%>");
    wizard.iSetVariable("v", szStart);
    for (const std::string tail : TAILS) {
      const std::string before = wizard.Value("v");
      int iAnew = -7, iInPlace = -7;
      wizard.iExecuteCommand(("v = \"__\" + v + " + tail).c_str(), 0, &iAnew);
      const std::string anew = wizard.Value("v");
      const Lines lines = Logged();
      wizard.iSetVariable("v", before.c_str());
      if (before.find("<%") == std::string::npos) wizard.Variables().MarkPlain("v");
      wizard.iExecuteCommand(("v = v + " + tail).c_str(), 0, &iInPlace);
      EXPECT_EQ(wizard.Value("v"), anew) << before << " + " << tail;
      EXPECT_EQ(iInPlace, iAnew) << before << " + " << tail;
      EXPECT_EQ(Logged(), lines) << before << " + " << tail;
    }
  }
}

// Of each text: its code and command result, the next dialog, the pages on the history, and what ran.
TEST_F(Flow, WhatCommandResultsDecide) {
  const int FLOW = 0, ACTION = 1, EVENT = 3;
  const struct {
    int which;
    const char *text, *outcome;
  } CASES[] = {
      {FLOW, "DIALOG \"a\"\n", "0 1005, 1 0:"},
      {FLOW, "Do1 ()\nx = \"1\"\nDo2 (<%x%>)\nCONTINUE\n", "0 0, 2 1: Do1() Do2(<%x%>)"},
      {FLOW, "Result (1)\nCONTINUE\n", "0 0, 2 1:"},
      {FLOW, "Result (9)\nCONTINUE\n", "9 9, 1 0:"},
      {FLOW, "Result (3)\nCONTINUE\n", "9 9, 1 0:"},
      {FLOW, "Result (7)\nDo ()\n", "0 7, 1 0:"},
      {FLOW, "Result (1001)\n", "0 1001, -1 0:"},
      {FLOW, "Result (5)\nDo ()\n", "0 1001, 2 1:"},
      {FLOW, "IF _TRUE THEN { Do1 (})\n Do2 ()\n}\nELSE {\nDo3 ()\n}\nCONTINUE\n", "0 0, 2 1: Do1(}) Do2()"},
      {FLOW, "IF _FALSE THEN Do1 () ELSE Do2 ( ELSE )\nCONTINUE\n", "0 0, 2 1: Do2( ELSE )"},
      {FLOW, "IFfive (x)\nSWITCHER (x)\nCONTINUE\n", "0 0, 2 1:"},
      {FLOW, "SWITCH (_TRUE)\nDEFAULT { Do0 () } CASE (_TRUE) { Do5 () }\nCONTINUE\n", "0 0, 2 1: Do5()"},
      {ACTION, "Do1 ()\nFail ()\nResult (9)\nDo2 ()\n", "0 0, 1 0: Do1() Do2()"},
      {ACTION, "EXIT\nDo2 ()\n", "0 2, 1 0:"},
      {ACTION, "Result (5)\nDo2 ()\n", "0 1001, 1 0:"},
      {EVENT, "x = \"1\"", "0 1002, 1 0:"},
      {EVENT, "Result (5)", "0 1001, 1 0:"},
      {EVENT, "Fail ()", "9 9, 1 0:"},
      {EVENT, "", "0 0, 1 0:"},
      {EVENT, "DIALOG \"b\"", "0 1005, 2 1:"},
      {EVENT, "IF _TRUE", "46 46, 1 0:"},
      {4, "EXIT", "0 0, 1 0:"},
      // The end of a line is remembered: a DEFAULT before the cases is gone back to, on their line and on its own.
      {EVENT, "SWITCH (\"x\") { DEFAULT { Do1 () } CASE (\"y\") { Do2 () } } Do3 ()\nDo4 ()",
       "0 0, 1 0: Do1() Do3() Do4()"},
      {EVENT, "SWITCH (\"x\")\n{\nDEFAULT y = \"1\"\nCASE (\"y\")\nDo2 ()\n}\nIF y == \"1\" THEN Do1 ()\nDo4 ()",
       "0 0, 1 0: Do1() Do4()"},
  };
  for (const auto& test : CASES) {
    wizard.ran.clear();
    const std::string script = Dialog("a", "", test.which == FLOW ? test.text : "", Action(test.text)) +
                               Dialog("b", "", "") + Dialog("c", "", "");
    ASSERT_EQ(wizard.iLoadMainList(script.c_str()), 0);
    int iResult = -7;
    std::string outcome = std::to_string(wizard.iDecideNextDialog(1, test.which, test.text, &iResult));
    outcome += " " + std::to_string(iResult) + ", " + std::to_string(wizard.Counter()) + " " +
               std::to_string(wizard.HistoryCount()) + ":";
    for (const std::string& ran : wizard.ran) outcome += " " + ran;
    EXPECT_EQ(outcome, test.outcome) << test.text;
  }
  EXPECT_EQ(wizard.iDecideNextDialog(99, 0, "EXIT", nullptr), 0);
}

TEST_F(Flow, TextsOfAnyShapeEnd) {
  std::string deep, blocks;
  for (int i = 0; i < 5000; i++) deep += "IF _TRUE THEN ", blocks += "{ ";
  int iResult;
  for (const std::string& text :
       {deep + "Do ()\n", std::string("CASE CASE\nCONTINUE\n"), std::string("SWITCH (\nCASE (\nDEFAULT\n"),
        std::string("IF THEN THEN ELSE\n"), std::string("SWITCH (\"5\")\nCASE (\"5\") {\nELSE }\n"),
        std::string("DEFAULT { x = \"1\" } { y = \"2\" }\n")}) {
    ASSERT_EQ(wizard.iLoadMainList(Dialog("a", "", text).c_str()), 0);
    wizard.iDecideNextDialog(1, 0, nullptr, &iResult);
  }
  EXPECT_EQ(wizard.ran, Lines{});
  wizard.iDecideNextDialog(1, 3, blocks.c_str(), &iResult);
  EXPECT_EQ(iResult, 9);
}

}  // namespace
