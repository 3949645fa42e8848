// Flow texts whose commands report what no built-in one does, and texts of any shape. The statements themselves are
// tested by scripts (tests/scripts).
#include "WizardFixture.h"

namespace {

using Flow = WizardTest;

TEST_F(Flow, WhatCommandResultsDecide) {
  const struct {
    const char* flow;
    int code, result, counter, history;
    Lines ran;
  } CASES[] = {
      {"", 0, 0, -1, 0, {}},  // END_DIALOG alone
      {"DIALOG \"c\"\n", 0, 1005, 3, 1, {}},
      {"DIALOG \"a\"\n", 0, 1005, 1, 0, {}},
      {"Do1 ()\nx = \"1\"\nDo2 (<%x%>)\nCONTINUE\n", 0, 0, 2, 1, {"Do1()", "Do2(<%x%>)"}},
      {"Result (1)\nCONTINUE\n", 0, 0, 2, 1, {}},
      {"Result (9)\nCONTINUE\n", 9, 9, 1, 0, {}},
      {"Result (3)\nCONTINUE\n", 9, 9, 1, 0, {}},
      {"Fail (1)\nDo ()\n", 9, 9, 1, 0, {}},
      {"Result (7)\nDo ()\n", 0, 7, 1, 0, {}},
      {"Result (5)\nCONTINUE\n", 0, 1001, 2, 1, {}},
      {"Result (1001)\n", 0, 1001, -1, 0, {}},
      {"Result (5)\nDo ()\n", 0, 1001, 2, 1, {}},
      {"IF _TRUE THEN { Do1 (})\n Do2 ()\n}\nELSE {\nDo3 ()\n}\nCONTINUE\n", 0, 0, 2, 1, {"Do1(})", "Do2()"}},
      {"IF _FALSE THEN Do1 () ELSE Do2 ( ELSE )\nCONTINUE\n", 0, 0, 2, 1, {"Do2( ELSE )"}},
      {"IFfive (x)\nSWITCHER (x)\nCONTINUE\n", 0, 0, 2, 1, {}},
      {"SWITCH (_TRUE)\nDEFAULT { Do0 () } CASE (_TRUE) { Do5 () }\nCONTINUE\n", 0, 0, 2, 1, {"Do5()"}},
  };
  for (const auto& test : CASES) {
    wizard.ran.clear();
    const std::string script = Dialog("a", "", test.flow) + Dialog("b", "", "") + Dialog("c", "", "");
    ASSERT_EQ(wizard.iLoadMainList(script.c_str()), 0);
    int iResult = -7;
    EXPECT_EQ(wizard.iDecideNextDialog(1, 0, nullptr, &iResult), test.code) << test.flow;
    EXPECT_EQ(iResult, test.result) << test.flow;
    EXPECT_EQ(wizard.Counter(), test.counter) << test.flow;
    EXPECT_EQ(wizard.HistoryCount(), test.history) << test.flow;
    EXPECT_EQ(wizard.ran, test.ran) << test.flow;
  }
}

TEST_F(Flow, ActionsGoOnBehindAFailure) {
  const struct {
    const char* action;
    int result;
    Lines ran;
  } CASES[] = {
      {"Do1 ()\nFail ()\nnonsense\nIF _TRUE\nResult (9)\nDo2 ()\n", 0, {"Do1()", "Do2()"}},
      {"Do1 ()\nBREAK\nDo2 ()\n", 1004, {"Do1()"}},
      {"EXIT\nDo2 ()\n", 2, {}},
      {"Result (5)\nDo2 ()\n", 1001, {}},
      {"DIALOG \"b\"\nDo2 ()\n", 1005, {}},
  };
  for (const auto& test : CASES) {
    wizard.ran.clear();
    ASSERT_EQ(wizard.iLoadMainList((Dialog("a", "", "", Action(test.action)) + Dialog("b", "", "")).c_str()), 0);
    int iResult = -7;
    EXPECT_EQ(wizard.iDecideNextDialog(1, 1, nullptr, &iResult), 0) << test.action;
    EXPECT_EQ(iResult, test.result) << test.action;
    EXPECT_EQ(wizard.ran, test.ran) << test.action;
    EXPECT_EQ(wizard.HistoryCount(), 0);
  }
}

TEST_F(Flow, EventsHandTheirResultOn) {
  ASSERT_EQ(wizard.iLoadMainList((Dialog("a", "", "") + Dialog("b", "", "")).c_str()), 0);
  const struct {
    const char* text;
    int code, result;
  } CASES[] = {{"x = \"1\"", 0, 1002},    {"Result (5)", 0, 1001}, {"Result (1)", 0, 1},
               {"Result (2)", 0, 2},      {"Fail ()", 9, 9},       {"", 0, 0},
               {"DIALOG \"b\"", 0, 1005}, {"IF _TRUE", 46, 46}};
  for (const auto& test : CASES) {
    int iResult = -7;
    EXPECT_EQ(wizard.iDecideNextDialog(1, 3, test.text, &iResult), test.code) << test.text;
    EXPECT_EQ(iResult, test.result) << test.text;
  }
  EXPECT_EQ(wizard.HistoryCount(), 1);  // of the jump
  int iResult = -7;
  EXPECT_EQ(wizard.iDecideNextDialog(1, 4, "EXIT", &iResult), 0);
  EXPECT_EQ(iResult, 0);
  EXPECT_EQ(wizard.iDecideNextDialog(99, 0, "EXIT", nullptr), 0);
}

TEST_F(Flow, TextsOfAnyShapeEnd) {
  std::string deep, blocks;
  for (int i = 0; i < 5000; i++) deep += "IF _TRUE THEN ", blocks += "{ ";
  int iResult;
  for (const std::string& text :
       {deep + "Do ()\n", std::string("}}}\nCONTINUE\n"), std::string("CASE CASE\nCONTINUE\n"),
        std::string("SWITCH\nCONTINUE\n"), std::string("SWITCH (\nCASE (\nDEFAULT\n"),
        std::string("IF THEN THEN ELSE\n"), std::string("SWITCH (\"5\")\nCASE (\"5\") {\nELSE }\n"),
        std::string("{ELSE }\n"), std::string("{ } { }\n"), std::string("DEFAULT { x = \"1\" } { y = \"2\" }\n")}) {
    ASSERT_EQ(wizard.iLoadMainList(Dialog("a", "", text).c_str()), 0);
    wizard.iDecideNextDialog(1, 0, nullptr, &iResult);
  }
  EXPECT_EQ(wizard.ran, Lines{});
  wizard.iDecideNextDialog(1, 3, blocks.c_str(), &iResult);
  EXPECT_EQ(iResult, 9);
}

// The end of a line is remembered: a DEFAULT that stands before the cases is gone back to, on a line of its own and on
// theirs.
TEST_F(Flow, ADefaultIsGoneBackTo) {
  ASSERT_EQ(wizard.iLoadMainList((Dialog("a", "", "") + Dialog("b", "", "")).c_str()), 0);
  for (const char* szText : {"SWITCH (\"x\") { DEFAULT { Do1 () } CASE (\"y\") { Do2 () } } Do3 ()\nDo4 ()",
                             "SWITCH (\"x\")\n{\nDEFAULT Do1 ()\nCASE (\"y\")\nDo2 ()\n}\nDo3 ()\nDo4 ()"}) {
    int iResult;
    wizard.ran.clear();
    EXPECT_EQ(wizard.iDecideNextDialog(1, 3, szText, &iResult), 0);
    EXPECT_EQ(wizard.ran, (Lines{"Do1()", "Do3()", "Do4()"})) << szText;
  }
}

}  // namespace
