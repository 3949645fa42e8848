#include "CommandLine.h"

#include <gtest/gtest.h>

#include <string>

static const char OWN[] = "C:\\Program Files\\Tavola\\Plumo\\UnInstall.exe";
static const char FOLDER[] = "C:\\Program Files\\Tavola\\Plumo";

static void ExpectFolder(const std::string& line, const char* szOwn, const char* szFolder, bool bSilent) {
  const Request request = ParseCommandLine(line.c_str(), szOwn);
  EXPECT_STREQ(request.csFolder.Text(), szFolder) << line;
  EXPECT_EQ(request.bSilent, bSilent) << line;
  EXPECT_FALSE(request.bSecondStep) << line;
}

TEST(UninstallCommandLine, TheFolderNeedsNoQuotes) {
  const std::string own = OWN, folder = FOLDER, quoted = "\"" + own + "\"";
  for (const std::string& program : {own, quoted, std::string("UnInstall.exe"), std::string("uninstall")}) {
    ExpectFolder(program + " " + folder, OWN, FOLDER, false);
    ExpectFolder(program + " \"" + folder + "\"", OWN, FOLDER, false);
    ExpectFolder(program + "  /S " + folder + "\\", OWN, FOLDER, true);
    ExpectFolder(program + " \"" + folder + "\\\" /s", OWN, FOLDER, true);
    ExpectFolder(program + " /SILENT " + folder, OWN, FOLDER, true);
    ExpectFolder(program + " \"" + folder + "\" /verysilent", OWN, FOLDER, true);
    ExpectFolder(program + " -q -NoRestart \"" + folder + "\" -passive", OWN, FOLDER, true);
    ExpectFolder(program + " " + folder + " -Silently", OWN, (folder + " -Silently").c_str(), false);
    ExpectFolder(program, OWN, "", false);
    ExpectFolder(program + " /S", OWN, "", true);
  }
}

TEST(UninstallCommandLine, SwitchesStandInFrontAndBehind) {
  const struct {
    const char *szLine, *szFolder, *szLog, *szFaulty;
  } ROWS[] = {
      {"u.exe /LOG=C:\\a.txt C:\\my product", "C:\\my product", "C:\\a.txt", nullptr},
      {"u.exe \"C:\\my product\" /S -log=\"C:\\my logs\\a.txt\"", "C:\\my product", "C:\\my logs\\a.txt", nullptr},
      {"u.exe C:\\my product /norestart \"/LOG=C:\\a b.txt\"", "C:\\my product", "C:\\a b.txt", nullptr},
      {"u.exe /Silently C:\\p", "C:\\p", nullptr, "/Silently"},
      {"u.exe C:\\p /DIR=C:\\q /S", "C:\\p", nullptr, "/DIR=C:\\q"},
      {"u.exe -x C:\\p", "C:\\p", nullptr, "-x"},
      {"u.exe C:\\p /LOG=", "C:\\p", nullptr, "/LOG="},
  };
  for (const auto& row : ROWS) {
    const Request request = ParseCommandLine(row.szLine, OWN);
    EXPECT_STREQ(request.csFolder.Text(), row.szFolder) << row.szLine;
    EXPECT_STREQ(request.csLog.Text(), row.szLog ? row.szLog : "") << row.szLine;
    EXPECT_EQ(!request.csFault.bEmpty(), row.szFaulty != nullptr) << row.szLine;
    EXPECT_TRUE(!row.szFaulty || request.csFault.Has(row.szFaulty)) << request.csFault.Text();
  }
  EXPECT_TRUE(ParseCommandLine("u.exe -?", OWN).bHelp);
}

TEST(UninstallCommandLine, OurOwnPathMayHoldTheEndOfAProgramsName) {
  const char szOwn[] = "C:\\My.exe files\\UnInstall.exe";
  ExpectFolder("c:\\my.exe files\\uninstall.exe C:\\My.exe files", szOwn, "C:\\My.exe files", false);
  ExpectFolder("D:\\UnInstall.exe D:\\", "D:\\UnInstall.exe", "D:", false);
}

TEST(UninstallCommandLine, TheSecondStepIsToldWhomToWaitFor) {
  const Request request = ParseCommandLine("\"C:\\Temp\\uni1.tmp\" /2 1234 \"C:\\a b\\UnInstall.exe\" /S \"C:\\a b\"",
                                           "C:\\Temp\\uni1.tmp");
  EXPECT_TRUE(request.bSecondStep && request.bSilent);
  EXPECT_EQ(request.ulFirstProcess, 1234u);
  EXPECT_STREQ(request.csProgram.Text(), "C:\\a b\\UnInstall.exe");
  EXPECT_STREQ(request.csFolder.Text(), "C:\\a b");
}
