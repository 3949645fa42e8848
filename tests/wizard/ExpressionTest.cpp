// Conditions that scripts (tests/scripts) do not write, their limits, and single comparisons.
#include "WizardFixture.h"

namespace {

class Expressions : public WizardTest {
 protected:
  void SetUp() override {
    wizard.iSetVariable("five", "5");
    wizard.iSetVariable("ten", "10");
    wizard.iSetVariable("yes", "TRUE");
  }
  int Evaluate(const std::string& text, int iExpected = 0) {
    int iResult = 7;
    EXPECT_EQ(wizard.iEvaluateExpression(text.c_str(), static_cast<int>(text.size()), &iResult), iExpected) << text;
    return iResult;
  }
};

TEST_F(Expressions, ResultsOfAllThreeKinds) {
  const struct {
    const char* text;
    int result;
  } CASES[] = {
      {"five==\"5\"", 1},
      {"\"99999999999\" > \"9\"", 1},
      {"\"a == b\" == \"a == b\"", 1},
      {"[TRUE]", 1},
      {"[FALSE]", 0},
      {"[]", -1},
      {"(())", -1},
      {"five", 0},
      {"(_TRUE || _TRUE) && _FALSE", 0},
      {"((five > \"4\") && ((ten > \"9\") || _FALSE))", 1},
      {"EndsWith [five;\"6\"]", 0},
      {"(Result (1)) && yes", 1},
      {"Result (9)", -1},
      {"Fail (x)", -1},
      {"missing1 == missing2", -1},
      {"five == \"5\"\n(never read", 1},
  };
  for (const auto& test : CASES) EXPECT_EQ(Evaluate(test.text), test.result) << test.text;
}

TEST_F(Expressions, WhatCannotBeRead) {
  int iResult = 7;
  EXPECT_EQ(wizard.iEvaluateExpression(nullptr, 5, &iResult), 1);
  EXPECT_EQ(iResult, -1);
  for (const char* szText : {"", "\n(a)", "five == \"(\"", "\"a\" \"b\"", "a == b == c", "& five", "== \"5\" )(",
                             "\"open == \"x", "Do (1)) || (Do (2)"})
    EXPECT_EQ(Evaluate(szText, 1), -1) << szText;
  EXPECT_EQ(wizard.ran, Lines{"Do(1)"});  // balanced, so it was read until it made no sense
}

TEST_F(Expressions, LimitOfNesting) {
  const auto nested = [](int iDepth) { return std::string(iDepth, '(') + "_TRUE" + std::string(iDepth, ')'); };
  EXPECT_EQ(Evaluate(nested(100)), 1);
  EXPECT_EQ(Evaluate(nested(101), 1), -1);
  EXPECT_EQ(Evaluate(nested(100000), 1), -1);
  std::string chain = "_TRUE";
  for (int i = 0; i < 10000; i++) chain += " && _TRUE";
  EXPECT_EQ(Evaluate(chain), 1);
}

TEST_F(Expressions, Atoms) {
  int iResult;
  EXPECT_EQ(wizard.iEvaluateAtom(nullptr, "x", 0, &iResult), FUNCTION_ERROR);
  EXPECT_EQ(wizard.iEvaluateAtom("x", nullptr, 0, &iResult), FUNCTION_ERROR);
  EXPECT_EQ(wizard.iEvaluateAtom("", "", 0, &iResult), FUNCTION_ERROR);
  EXPECT_EQ(Logged(), (Lines{"ERROR: COrbitWizard::iEvaluateAtom -> !szVar1 -> return FUNCTION_ERROR",
                             "ERROR: COrbitWizard::iEvaluateAtom -> !szVar2 -> return FUNCTION_ERROR",
                             "ERROR: COrbitWizard::iEvaluateAtom -> !*szVar1 -> return FUNCTION_ERROR"}));
  const struct {
    const char *first, *second;
    int op, result;
  } CASES[] = {
      {"\"a [b]\"", "\"a (b)\"", 0, 1}, {"five", "\"5\"", 0, 1}, {"five", "ten", 2, 0},     {"five", "ten", 4, 1},
      {"five", "ten", 99, -1},          {"five", "ten", -1, -1}, {"yes", "\"TRUE\"", 7, 1}, {"yes", "\"FALSE\"", 7, 0},
      {"yes", "\"FALSE\"", 8, 1},       {"Result", "5", 6, 5},
  };
  for (const auto& test : CASES) {
    EXPECT_EQ(wizard.iEvaluateAtom(test.first, test.second, test.op, &iResult), 0);
    EXPECT_EQ(iResult, test.result) << test.first << " " << test.op << " " << test.second;
  }
}

}  // namespace
