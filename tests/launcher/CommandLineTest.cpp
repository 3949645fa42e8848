#include "launcher/CommandLine.h"

#include <gtest/gtest.h>

#include <string>

static std::string First(const char* szLine) {
  const char* pFirst = GetFirstArgument(szLine);
  return pFirst ? pFirst : "none";
}

TEST(CommandLine, TheFirstArgumentIsTheRestOfTheLine) {
  EXPECT_EQ(First("setup.exe C:\\x.exe"), "C:\\x.exe");
  EXPECT_EQ(First("setup.exe   C:\\x.exe  /more "), "C:\\x.exe  /more ");
  EXPECT_EQ(First("setup.exe \"C:\\a b.exe\""), "\"C:\\a b.exe\"");
  EXPECT_EQ(First("setup.exe"), "none");
  EXPECT_EQ(First("setup.exe   "), "none");
  EXPECT_EQ(First(""), "none");
  EXPECT_EQ(First(nullptr), "none");
}

TEST(CommandLine, TheSecondCharacterChoosesWhereTheNameEnds) {
  EXPECT_EQ(First("\"C:\\setup.exe\" C:\\x.exe"), "C:\\x.exe");
  // A quoted program path with blanks ends at its first blank.
  EXPECT_EQ(First("\"C:\\My Files\\setup.exe\" C:\\x.exe"), "Files\\setup.exe\" C:\\x.exe");
  // A double quote in the second place is found there already.
  EXPECT_EQ(First("a\"b c\" d"), "b c\" d");
  EXPECT_EQ(First("\"\" x"), "x");
  EXPECT_EQ(First("\""), "none");
  EXPECT_EQ(First(" setup"), "none");
}

TEST(CommandLine, SurroundingQuotesAreTakenOutOfTheLineToo) {
  SetupCommandLine line;
  ReadCommandLine(L"setup.exe \"C:\\no such \u010Cili.exe\"", line);
  EXPECT_STREQ(line.csArgument.Text(), "C:\\no such \xC8ili.exe");
  EXPECT_STREQ(line.csLine.Text(), "setup.exe C:\\no such \xC8ili.exe");
  SetupCommandLine none;
  ReadCommandLine(L"setup.exe", none);
  EXPECT_EQ(none.csArgument.Ptr(), nullptr);
  EXPECT_STREQ(none.csLine.Text(), "setup.exe");
}
