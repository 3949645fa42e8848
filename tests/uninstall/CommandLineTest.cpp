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
    ExpectFolder(program + " " + folder + " /s", OWN, FOLDER, true);
    ExpectFolder(program + " \"" + folder + "\\\" /S", OWN, FOLDER, true);
    ExpectFolder(program + " /verysilent \"" + folder + "\" /quiet", OWN, FOLDER, true);
    ExpectFolder(program + " /SILENT " + folder, OWN, FOLDER, true);
    ExpectFolder(program + " " + folder + " /Silently", OWN, (folder + " /Silently").c_str(), false);
    ExpectFolder(program, OWN, "", false);
    ExpectFolder(program + " /S", OWN, "", true);
  }
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
