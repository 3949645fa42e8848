// The store, and what an assignment that appends in place must have in common with one that does not.
#include "WizardFixture.h"

namespace {

using Variables = WizardTest;

TEST_F(Variables, SetAndGet) {
  EXPECT_NE(wizard.Value("win_ver"), "");
  EXPECT_EQ(wizard.iSetVariable("a", "1"), 0);
  wizard.Variables().AddTable();
  EXPECT_EQ(wizard.iSetVariable("A", "2"), 0);
  EXPECT_EQ(wizard.iSetVariable("a", "3"), 0);  // the record of the earlier table, not a new one
  EXPECT_EQ(wizard.Variables().Size(), 3);
  CNString csValue;
  csValue = "x12345";
  EXPECT_EQ(wizard.iGetVariable("a", 0, csValue, '+'), 0);
  EXPECT_STREQ(csValue.Text(), "x123453");
  EXPECT_EQ(wizard.iGetVariable("a", 0, csValue, '-'), 0);
  EXPECT_STREQ(csValue.Text(), "x123");
  EXPECT_EQ(wizard.iGetVariable("a", 0, csValue), 0);
  EXPECT_STREQ(csValue.Text(), "3");
  EXPECT_EQ(Logged(), Lines{});
}

TEST_F(Variables, BadArguments) {
  CNString csValue;
  csValue = "kept";
  EXPECT_EQ(wizard.iSetVariable(nullptr, ""), 1);
  EXPECT_EQ(wizard.iSetVariable("", ""), 1);
  EXPECT_EQ(wizard.iSetVariable("a", nullptr), 1);
  EXPECT_EQ(wizard.iGetVariable(nullptr, 0, csValue), 1);
  EXPECT_EQ(wizard.iGetVariable("", 0, csValue), 1);
  EXPECT_EQ(wizard.iGetVariable("missing", 0, csValue), POSTCONDITIONS_NOT_VALID);
  EXPECT_EQ(wizard.iCalculateValue(nullptr, csValue, 0), 1);
  EXPECT_EQ(wizard.iCalculateValue("", csValue, 0), 1);
  EXPECT_STREQ(csValue.Text(), "kept");
  CNString csText;
  EXPECT_EQ(wizard.iReplaceVarWithText(csText), 1);
  csText = "";
  EXPECT_EQ(wizard.iReplaceVarWithText(csText), 1);
  EXPECT_EQ(Logged(),
            (Lines{"ERROR: COrbitWizard::iSetVariable -> !szVar -> return PRECONDITIONS_NOT_VALID",
                   "ERROR: COrbitWizard::iSetVariable -> !*szVar  -> return PRECONDITIONS_NOT_VALID",
                   "ERROR: COrbitWizard::iSetVariable -> !szValue  -> return PRECONDITIONS_NOT_VALID",
                   "ERROR: COrbitWizard::iGetVariable -> !szVar -> return PRECONDITIONS_NOT_VALID",
                   "ERROR: COrbitWizard::iGetVariable -> !*szVar  -> return PRECONDITIONS_NOT_VALID",
                   "ERROR: COrbitWizard::iGetVariable -> !szValue  -> return POSTCONDITIONS_NOT_VALID",
                   "ERROR: COrbitWizard::iCalculateValue -> !szText -> return PRECONDITIONS_NOT_VALID",
                   "ERROR: COrbitWizard::iCalculateValue -> !*szText  -> return PRECONDITIONS_NOT_VALID",
                   "ERROR: COrbitWizard::iReplaceVarWithText -> !szText -> return PRECONDITIONS_NOT_VALID",
                   "ERROR: COrbitWizard::iReplaceVarWithText -> !*szText -> return PRECONDITIONS_NOT_VALID"}));
}

// "v = v + ..." appends where the value stands; "v = "__" + v + ..." makes the same value anew.
TEST_F(Variables, AppendingInPlaceGivesTheSame) {
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
  wizard.iSetVariable("v", std::string(1 << 20, 'x').c_str());
  wizard.Variables().MarkPlain("v");
  int iResult;
  EXPECT_EQ(wizard.iExecuteCommand("v = v + \"y\"", 0, &iResult), FUNCTION_ERROR);
  EXPECT_EQ(wizard.Value("v").size(), 1u << 20);
}

}  // namespace
