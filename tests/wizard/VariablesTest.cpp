#include "WizardFixture.h"

namespace {

class Variables : public WizardTest {
 protected:
  std::string Replaced(const char* szText, int iExpected = 0) {
    CNString csText;
    csText = szText;
    EXPECT_EQ(wizard.iReplaceVarWithText(csText), iExpected) << szText;
    return csText.Text();
  }
};

TEST_F(Variables, SetAndGet) {
  EXPECT_NE(wizard.Value("win_ver"), "");
  EXPECT_EQ(wizard.iSetVariable("a", "1"), 0);
  wizard.Variables().AddTable();
  EXPECT_EQ(wizard.iSetVariable("A", "2"), 0);
  EXPECT_EQ(wizard.iSetVariable("a", "3"), 0);  // the record of the earlier table, not a new one
  const int nSize = wizard.Variables().Size();
  EXPECT_EQ(wizard.iSetVariable("A", ""), 0);
  EXPECT_EQ(wizard.Variables().Size(), nSize);
  CNString csValue;
  EXPECT_EQ(wizard.iGetVariable("a", 0, csValue), 0);
  EXPECT_STREQ(csValue.Text(), "3");
  csValue = "x12345";
  EXPECT_EQ(wizard.iGetVariable("a", 0, csValue, '+'), 0);
  EXPECT_STREQ(csValue.Text(), "x123453");
  EXPECT_EQ(wizard.iGetVariable("a", 0, csValue, '-'), 0);
  EXPECT_STREQ(csValue.Text(), "x123");
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
  CNString csNull;
  EXPECT_EQ(wizard.iReplaceVarWithText(csNull), 1);
  csNull = "";
  EXPECT_EQ(wizard.iReplaceVarWithText(csNull), 1);
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

TEST_F(Variables, Substitution) {
  wizard.iSetVariable("v", "1.0");
  wizard.iSetVariable("name", "Plumo <%v%>");
  wizard.iSetVariable("empty", "");
  const struct {
    const char *text, *replaced;
  } CASES[] = {
      {"no markers", "no markers"},
      {"<%v%>", "1.0"},
      {"a<%v%>b<%v%>c", "a1.0b1.0c"},
      {"<%name%> for <%v%>", "Plumo 1.0 for 1.0"},
      {"[<%empty%>]", "[]"},
      {"[<%missing%>]", "[ ]"},
      {"5 <% 6 and <%v%>", "5 <% 6 and 1.0"},
      {"<%v", "<%v"},
      {"<%v%", "<%v%"},
      {"<%v>", "<%v>"},
      {"<%n>ame%> <%v%>", "<%n>ame%> 1.0"},
      {"100%> <", "100%> <"},
  };
  for (const auto& test : CASES) EXPECT_EQ(Replaced(test.text), test.replaced) << test.text;
  EXPECT_EQ(Logged(), Lines{"ERROR: COrbitWizard::iReplaceVarWithText -> !missing"});
}

TEST_F(Variables, CirclesEnd) {
  wizard.iSetVariable("self", "x<%self%>");
  wizard.iSetVariable("a", "<%b%><%b%>");
  wizard.iSetVariable("b", "<%a%><%a%>");
  EXPECT_NE(Replaced("<%self%>!", FUNCTION_ERROR).find("<%self%>!"), std::string::npos);
  EXPECT_LT(Replaced("<%a%>", FUNCTION_ERROR).size(), 2000000u);
  EXPECT_EQ(Logged().size(), 2u);
}

TEST_F(Variables, DepthAndSizeOfSubstitution) {
  for (int i = 0; i < 40; i++)
    wizard.iSetVariable(("d" + std::to_string(i)).c_str(), ("<%d" + std::to_string(i + 1) + "%>").c_str());
  wizard.iSetVariable("d32", "end");
  EXPECT_EQ(Replaced("<%d0%>"), "end");
  wizard.iSetVariable("d32", "<%d33%>");
  wizard.iSetVariable("d33", "end");
  EXPECT_EQ(Replaced("<%d0%>", FUNCTION_ERROR), "<%d33%>");
  wizard.iSetVariable("v", "1.0");
  std::string text, expected;
  for (int i = 0; i < 10000; i++) text += "<%v%> and ", expected += "1.0 and ";
  EXPECT_EQ(Replaced(text.c_str()), expected);
}

TEST_F(Variables, Calculation) {
  wizard.iSetVariable("path", "C:\\Dir");
  wizard.iSetVariable("two", "2");
  const struct {
    const char *expression, *value;
    int result;
  } CASES[] = {
      {" \"abc\"", "abc", 0},
      {"\"abc\" - \"1\"", "ab", 0},
      {"\"ab\" - \"5\"", "ab", 0},
      {"\"ab\" - \"2\"", "ab", 0},
      {"\"ab\" - \"1x\"", "a", 0},
      {"\"ab\" - \"\"", "ab", 0},
      {"\"__\"", "", 0},
      {"path + \"\\\\\" + \"a-b+c\"", "C:\\Dir\\\\a-b+c", 0},
      {"path+two", "C:\\Dir2", 0},
      {"path - two", "C:\\D", 0},
      {"path - two + two", "C:\\D2", 0},
      {"\"a\"\n+ \"b\"", "ab", 0},
      {"missing + \"x\"", "x", 0},
      {"Strlen (path)", "6", 0},
      {"Strlen (\"abc\")", "3", 0},
      {"\"n\" + Say (all of it) + \"ignored\"", "all of it", 0},
      {"Fail (x)", "", FUNCTION_ERROR},
      {"\"open", "open", 0},
  };
  for (const auto& test : CASES) {
    CNString csValue;
    EXPECT_EQ(wizard.iCalculateValue(test.expression, csValue, 0), test.result) << test.expression;
    EXPECT_STREQ(csValue.Text(), test.value) << test.expression;
  }
  EXPECT_EQ(Logged(), (Lines{"ERROR: COrbitWizard::iGetVariable -> !szValue  -> return POSTCONDITIONS_NOT_VALID",
                             "ERROR: COrbitWizard::iCalculateValue -> iExecuteFunction -> return FUNCTION_ERROR"}));
}

}  // namespace
