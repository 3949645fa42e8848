#include "WizardFixture.h"

namespace {

class Flow : public WizardTest {
 protected:
  void SetUp() override { wizard.iSetVariable("five", "5"); }
  // Decides from the first of three dialogs whose flow text is given.
  int iDecide(const std::string& flow, int iExpected = 0) {
    wizard.ran.clear();
    EXPECT_EQ(wizard.iLoadMainList((Dialog("a", "", flow) + Dialog("b", "", "") + Dialog("c", "", "")).c_str()), 0);
    int iResult = -7;
    EXPECT_EQ(wizard.iDecideNextDialog(1, 0, nullptr, &iResult), iExpected) << flow;
    return iResult;
  }
  int iAct(const std::string& lines, int iWhich = 1) {
    wizard.ran.clear();
    const std::string action = Action(lines, iWhich == 1 ? "BEFORE" : "AFTER");
    EXPECT_EQ(wizard.iLoadMainList((Dialog("a", "", "", action) + Dialog("b", "", "")).c_str()), 0);
    int iResult = -7;
    EXPECT_EQ(wizard.iDecideNextDialog(1, iWhich, nullptr, &iResult), 0) << lines;
    return iResult;
  }
};

TEST_F(Flow, WhatAFlowTextDecides) {
  const struct {
    const char* flow;
    int code, result, counter, history;
    Lines ran;
  } CASES[] = {
      {"", 0, 0, -1, 0, {}},  // END_DIALOG alone
      {"CONTINUE\n", 0, 0, 2, 1, {}},
      {"  \n\n CONTINUE\nDo (never)\n", 0, 0, 2, 1, {}},
      {"EXIT\n", 0, 2, 1, 0, {}},
      {"BREAK\nCONTINUE\n", 0, 1004, 1, 0, {}},
      {"FINISH_ACTION\nCONTINUE\n", 0, 0, 1, 0, {}},
      {"DIALOG \"c\"\n", 0, 1005, 3, 1, {}},
      {"DIALOG \"a\"\n", 0, 1005, 1, 0, {}},
      {"DIALOG \"none\"\nCONTINUE\n", 9, 9, 1, 0, {}},
      {"Do1 ()\nx = \"1\"\nDo2 (<%x%>)\nCONTINUE\n", 0, 0, 2, 1, {"Do1()", "Do2(<%x%>)"}},
      {"Result (1)\nCONTINUE\n", 0, 0, 2, 1, {}},
      {"Result (9)\nCONTINUE\n", 9, 9, 1, 0, {}},
      {"Result (3)\nCONTINUE\n", 9, 9, 1, 0, {}},
      {"Fail (1)\nDo ()\n", 9, 9, 1, 0, {}},
      {"Result (7)\nDo ()\n", 0, 7, 1, 0, {}},
      {"Result (5)\nCONTINUE\n", 0, 1001, 2, 1, {}},
      {"Result (1001)\n", 0, 1001, -1, 0, {}},
      {"Result (5)\nDo ()\n", 0, 1001, 2, 1, {}},
      {"nonsense\n", 9, 9, 1, 0, {}},
  };
  for (const auto& test : CASES) {
    EXPECT_EQ(iDecide(test.flow, test.code), test.result) << test.flow;
    EXPECT_EQ(wizard.Counter(), test.counter) << test.flow;
    EXPECT_EQ(wizard.HistoryCount(), test.history) << test.flow;
    EXPECT_EQ(wizard.ran, test.ran) << test.flow;
  }
}

TEST_F(Flow, IfAndElse) {
  const struct {
    const char* flow;
    int code, result, counter;
    Lines ran;
  } CASES[] = {
      {"IF (five == \"5\") THEN Do1 ()\nELSE Do2 ()\nCONTINUE\n", 0, 0, 2, {"Do1()"}},
      {"IF (five != \"5\") THEN Do1 ()\nELSE Do2 ()\nCONTINUE\n", 0, 0, 2, {"Do2()"}},
      {"IF five == \"5\" THEN CONTINUE\nELSE ", 0, 0, 2, {}},
      {"IF five == \"6\" THEN CONTINUE\nELSE ", 0, 0, -1, {}},
      {"IF (five == \"6\") THEN EXIT\nDIALOG \"c\"\n", 0, 1005, 3, {}},
      {"IF (five == \"6\") THEN Do1 () ELSE Do2 ( ELSE )\nCONTINUE\n", 0, 0, 2, {"Do2( ELSE )"}},
      {"IF (five == \"5\")THEN { Do1 (})\n Do2 ()\n}\nELSE {\nDo3 ()\n}\nDo4 ()\nCONTINUE\n",
       0,
       0,
       2,
       {"Do1(})", "Do2()", "Do4()"}},
      {"IF (five == \"6\") THEN IF _TRUE THEN Do1 ()\nELSE Do2 ()\nDo3 ()\nCONTINUE\n", 0, 0, 2, {"Do3()"}},
      {"IF (five == \"5\") THEN IF _FALSE THEN Do1 ()\nELSE Do2 ()\nDo3 ()\nCONTINUE\n", 0, 0, 2, {"Do2()", "Do3()"}},
      {"IF (a == b) THEN Do1 ()\nELSE Do2 ()\nCONTINUE\n", 0, 0, 2, {"Do2()"}},
      {"IF (x == \" THEN \") THEN Do1 ()\nELSE Do2 ()\nCONTINUE\n", 0, 0, 2, {"Do2()"}},
      {"IF (five == \"5\") Do1 ()\nCONTINUE\n", 46, 46, 1, {}},
      {"IF (five == \"5\" THEN Do1 ()\nCONTINUE\n", 9, 9, 1, {}},
      {"IFfive (x)\nCONTINUE\n", 0, 0, 2, {}},
  };
  for (const auto& test : CASES) {
    EXPECT_EQ(iDecide(test.flow, test.code), test.result) << test.flow;
    EXPECT_EQ(wizard.Counter(), test.counter) << test.flow;
    EXPECT_EQ(wizard.ran, test.ran) << test.flow;
  }
}

TEST_F(Flow, Switch) {
  const std::string tail = "Do9 ()\nCONTINUE\n";
  const struct {
    const char* flow;
    int code;
    Lines ran;
  } CASES[] = {
      {"SWITCH (five)\nCASE (\"4\")\n{\nDo4 ()\n}\nCASE (\"5\")\n{\nDo5 ()\n}\nDEFAULT\n{\nDo0 ()\n}\n",
       0,
       {"Do5()", "Do9()"}},
      {"SWITCH (five)\nCASE (\"4\") { Do4 () }\nDEFAULT { Do0 () }\n", 0, {"Do0()", "Do9()"}},
      {"SWITCH (five)\nDEFAULT { Do0 () }\nCASE (\"5\") { Do5 () }\n", 0, {"Do5()", "Do9()"}},
      {"SWITCH (five) {\nCASE (\"5\")\n{ Do5 ()\nDo6 () }\nCASE (\"5\") { Do7 () }\n}\n",
       0,
       {"Do5()", "Do6()", "Do9()"}},
      {"SWITCH (five)\nCASE (\"5\")\n{\nSWITCH (\"x\")\nCASE (\"y\") { Do1 () }\nCASE (\"x\") { IF _TRUE THEN { Do2 () "
       "} }\n}\nCASE (\"6\") { Do6 () }\n",
       0,
       {"Do2()", "Do9()"}},
      {"SWITCH (five)\nCASE (\"4\")\n{\nSWITCH (five)\nCASE (\"5\") { Do1 () }\n}\nDEFAULT\n{ Do0 () }\n",
       0,
       {"Do0()", "Do9()"}},
      {"SWITCH (five)\nCASE (\"4\") { Do4 () }\n", 9, {}},
      {"SWITCH five\nCASE (\"5\") { Do5 () }\n", 9, {}},
  };
  for (const auto& test : CASES) {
    EXPECT_EQ(iDecide(test.flow + tail, test.code), test.code) << test.flow;
    EXPECT_EQ(wizard.ran, test.ran) << test.flow;
  }
  EXPECT_EQ(iDecide("SWITCH (five)\nCASE (\"5\")\n{\nDIALOG \"c\"\nDo ()\n}\n" + tail), 1005);
  EXPECT_EQ(wizard.ran, Lines{});
}

TEST_F(Flow, ActionsGoOnBehindAFailure) {
  EXPECT_EQ(iAct("Do1 ()\nFail ()\nnonsense\nIF _TRUE\nResult (9)\nDo2 ()\n"), 0);
  EXPECT_EQ(wizard.ran, (Lines{"Do1()", "Do2()"}));
  EXPECT_EQ(iAct("Do1 ()\nBREAK\nDo2 ()\n", 2), 1004);
  EXPECT_EQ(wizard.ran, Lines{"Do1()"});
  EXPECT_EQ(iAct("EXIT\nDo2 ()\n"), 2);
  EXPECT_EQ(iAct("Result (5)\nDo2 ()\n"), 1001);
  EXPECT_EQ(iAct("DIALOG \"b\"\nDo2 ()\n"), 1005);
  EXPECT_EQ(wizard.Counter(), 2);
  EXPECT_EQ(wizard.HistoryCount(), 0);
  EXPECT_EQ(wizard.ran, Lines{});
}

TEST_F(Flow, EventsHandTheirResultOn) {
  ASSERT_EQ(wizard.iLoadMainList((Dialog("a", "", "") + Dialog("b", "", "")).c_str()), 0);
  const struct {
    const char* text;
    int code, result;
  } CASES[] = {{"b_OnClick (Choose directory:)", 0, 0},
               {"x = \"1\"", 0, 1002},
               {"Result (5)", 0, 1001},
               {"Result (1)", 0, 1},
               {"Result (2)", 0, 2},
               {"Fail ()", 9, 9},
               {"", 0, 0},
               {"DIALOG \"b\"", 0, 1005},
               {"IF _TRUE", 46, 46}};
  for (const auto& test : CASES) {
    int iResult = -7;
    EXPECT_EQ(wizard.iDecideNextDialog(1, 3, test.text, &iResult), test.code) << test.text;
    EXPECT_EQ(iResult, test.result) << test.text;
  }
  EXPECT_EQ(wizard.HistoryCount(), 1);  // of the jump
  int iResult = -7;
  EXPECT_EQ(wizard.iDecideNextDialog(1, 4, "EXIT", &iResult), 0);
  EXPECT_EQ(wizard.iDecideNextDialog(99, 0, "EXIT", nullptr), 0);
  EXPECT_EQ(iResult, 0);
}

TEST_F(Flow, LinesOfFailures) {
  iDecide("IF (five == \"5\") EXIT\n", 46);
  EXPECT_EQ(Logged(), Lines{"ERROR: COrbitWizard::iDecideNextDialog -> Missing THEN -> return SYNTAX_ERROR"});
  iDecide("Result (9)\n", 9);
  EXPECT_EQ(Logged(), Lines{"ERROR: COrbitWizard::iDecideNextDialog -> return FUNCTION_ERROR"});
}

TEST_F(Flow, TextsOfAnyShapeEnd) {
  std::string deep, blocks;
  for (int i = 0; i < 5000; i++) deep += "IF _TRUE THEN ", blocks += "{ ";
  iDecide(deep + "Do ()\n", 9);
  EXPECT_EQ(wizard.ran, Lines{});
  for (const std::string text :
       {"}}}\nCONTINUE\n", "ELSE\nELSE Do ()\nCONTINUE\n", "{ CONTINUE\n", "CASE CASE\nCONTINUE\n",
        "SWITCH\nCONTINUE\n", "SWITCH (\nCASE (\nDEFAULT\n", "IF THEN THEN ELSE\n",
        "SWITCH (five)\nCASE (\"5\") {\nELSE }\n", "{ELSE }\n", "{ } { }\n"}) {
    int iResult;
    ASSERT_EQ(wizard.iLoadMainList(Dialog("a", "", text).c_str()), 0);
    wizard.iDecideNextDialog(1, 0, nullptr, &iResult);
  }
  int iResult;
  wizard.iDecideNextDialog(1, 3, blocks.c_str(), &iResult);
  EXPECT_EQ(iResult, 9);
}

}  // namespace
