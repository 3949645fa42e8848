#include "launcher/Switches.h"

#include <gtest/gtest.h>

#include <string>

#include "foundation/os/Os.h"
#include "launcher/CommandLine.h"

// Everything that was read, in one text.
static std::string Read(const wchar_t* pLine) {
  Switches s;
  ReadSwitches(pLine, s);
  std::string text = std::string(s.mode == RunMode::Silent ? "silent " : "") +
                     (s.mode == RunMode::Passive ? "passive " : "") + (s.bNoRestart ? "norestart " : "") +
                     (s.bHelp ? "help " : "");
  const struct {
    const char* szName;
    const CNString& csText;
  } texts[] = {{"dir", s.csFolder}, {"log", s.csLog}, {"answers", s.csAnswers}, {"save", s.csSaveAnswers}};
  for (const auto& row : texts)
    if (!row.csText.bEmpty()) text += std::string(row.szName) + "=" + row.csText.Text() + " ";
  for (int i = 0; i < s.variables.Size(); i++)
    text += std::string("<") + s.variables[i]->csName.Text() + "=" + s.variables[i]->csValue.Text() + "> ";
  text += s.csFault.Text();
  while (!text.empty() && text.back() == ' ') text.pop_back();
  return text;
}

TEST(Switches, AreReadAsWindowsProgramsReadThem) {
  const struct {
    const wchar_t* pLine;
    std::string read;
  } rows[] = {
      {L"", ""},
      {L"/S", "silent"},
      {L" -s  /SILENT -veryQUIET", "silent The switch -veryQUIET is not known."},
      {L"/verysilent -Quiet /q", "silent"},
      {L"/PASSIVE /NoRestart", "passive norestart"},
      {L"/S /passive", "silent The switch /passive contradicts an earlier one."},
      {L"/S -?", "silent help"},
      {L"/DIR=C:\\Apps\\Plumo", "dir=C:\\Apps\\Plumo"},
      {L"/dir=\"C:\\a b\"", "dir=C:\\a b"},
      {L"\"/DIR=C:\\a b\" /S", "silent dir=C:\\a b"},
      {L"/DIR=\"C:\\a b\\\" /S", "silent dir=C:\\a b\\"},
      {L"\"/LOG=C:\\a\\\" /S /D=C:\\b c", "silent dir=C:\\b c log=C:\\a\\"},
      {L"/SET \"b=say \\\"x\\\" /S\"", "<b=say \"x\" /S>"},
      {L"/DIR=C:\\a b", "dir=C:\\a \"b\" is not a switch."},
      {L"/DIR=C:\\Apps\\Plumo \u010D", "dir=C:\\Apps\\Plumo \"\xE8\" is not a switch."},
      {L"\"/DIR=C:\\Apps\\Plumo \u010D\"", "dir=C:\\Apps\\Plumo \xE8"},
      {L"/DIR=C:/Apps/../Plumo", "dir=C:\\Plumo"},
      {L"/DIR=\"C:\\\u4E2D\\x\"", "The path of the switch /DIR cannot be used."},
      {L"/DIR=", "The switch /DIR needs a value."},
      {L"/DIR", "The switch /DIR needs a value."},
      {L"/DIR=C:\\a /DIR=C:\\a", "dir=C:\\a"},
      {L"/DIR=C:\\a /D=C:\\b", "dir=C:\\a The switch /D contradicts an earlier one."},
      {L"/S /D=C:\\Program Files\\a /S  ", "silent dir=C:\\Program Files\\a \\S"},
      {L"-d=C:\\a b\\ ", "dir=C:\\a b\\"},
      {L"/D=\"C:\\a b\"", "dir=C:\\a b"},
      {L"/D=", "The switch /D needs a value."},
      {L"\"/LOG=C:\\x /D=y.txt\" /S", "silent log=C:\\x \\D=y.txt"},
      {L"/LOG=C:\\l.txt /S /ANSWERS=C:\\a.txt", "silent log=C:\\l.txt answers=C:\\a.txt"},
      {L"/ANSWERS=C:\\a.txt", "answers=C:\\a.txt The switch /ANSWERS needs /S or /passive beside it."},
      {L"/SAVEANSWERS=C:\\a.txt", "save=C:\\a.txt"},
      {L"/q /SAVEANSWERS=C:\\a.txt", "silent save=C:\\a.txt The switch /SAVEANSWERS is for a run with windows."},
      {L"/SET a=1 -set \"b=two words\" /set \"c=say \\\"x\\\"\"", "<a=1> <b=two words> <c=say \"x\">"},
      {L"/SET a= /S", "silent <a=>"},
      {L"/SET a=b=c", "<a=b=c>"},
      {L"/SET", "The switch /SET needs NAME=VALUE, not \"\"."},
      {L"/SET=a=1", "The switch /SET needs a blank and NAME=VALUE behind it."},
      {L"/SET =x /S", "silent The switch /SET needs NAME=VALUE, not \"=x\"."},
      {L"/SET /S", "The switch /SET needs NAME=VALUE, not \"/S\"."},
      {L"/S=1", "The switch /S takes no value."},
      {L"/", "The switch / is not known."},
      {L"/NCRC /S /x", "silent The switch /NCRC is not known."},
      {L"setup /S", "silent \"setup\" is not a switch."},
      {L"\"\" /S", "silent \"\" is not a switch."},
  };
  for (const auto& row : rows) EXPECT_EQ(Read(row.pLine), row.read);
}

TEST(Switches, RelativePathsAreThoseOfTheWorkingFolder) {
  CNString csFolder;
  bOsGetCurrentFolder(csFolder);
  EXPECT_EQ(Read(L"/LOG=x\\y.txt"), std::string("log=") + csFolder.Text() + "\\x\\y.txt");
}

// ---- the command line of a run without switches: the program's name and one path ----

static std::string First(const char* szLine) {
  const char* pFirst = GetFirstArgument(szLine);
  return pFirst ? pFirst : "none";
}

TEST(CommandLine, TheFirstArgumentIsTheRestOfTheLine) {
  EXPECT_EQ(First("setup.exe C:\\x.exe"), "C:\\x.exe");
  EXPECT_EQ(First("setup.exe   C:\\x.exe  /more "), "C:\\x.exe  /more ");
  EXPECT_EQ(First("setup.exe \"C:\\a b.exe\""), "\"C:\\a b.exe\"");
  for (const char* szNone : {"setup.exe", "setup.exe   ", "", "\"", " setup"}) EXPECT_EQ(First(szNone), "none");
  EXPECT_EQ(First(nullptr), "none");
}

TEST(CommandLine, TheSecondCharacterChoosesWhereTheNameEnds) {
  EXPECT_EQ(First("\"C:\\setup.exe\" C:\\x.exe"), "C:\\x.exe");
  // A quoted program path with blanks ends at its first blank.
  EXPECT_EQ(First("\"C:\\My Files\\setup.exe\" C:\\x.exe"), "Files\\setup.exe\" C:\\x.exe");
  // A double quote in the second place is found there already.
  EXPECT_EQ(First("a\"b c\" d"), "b c\" d");
  EXPECT_EQ(First("\"\" x"), "x");
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
