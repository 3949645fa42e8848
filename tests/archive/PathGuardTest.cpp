#include "archive/PathGuard.h"

#include "support/TestFolder.h"

namespace {

TEST(PathGuard, KeepsGoodNamesAndTurnsSlashes) {
  const struct {
    const char *szName, *szPath;
  } CASES[] = {
      {"a", "a"},
      {"Dir\\Sub\\file.txt", "Dir\\Sub\\file.txt"},
      {"Dir/Sub/file.txt", "Dir\\Sub\\file.txt"},
      {"mixed/a\\b", "mixed\\a\\b"},
      {"..a\\...b", "..a\\...b"},
      {" leading", " leading"},
      {"nullable.txt", "nullable.txt"},
      {"com\\com10\\lpt", "com\\com10\\lpt"},
      {"\x8a"
       "e\xe6"
       "er.txt",
       "\x8a"
       "e\xe6"
       "er.txt"},
      {"a;b,c=d'e(f)[g]{h}!@#$%^&~`+-_", "a;b,c=d'e(f)[g]{h}!@#$%^&~`+-_"},
  };
  for (const auto& row : CASES) {
    CNString csPath;
    EXPECT_TRUE(bMakeSafePath(row.szName, csPath)) << row.szName;
    EXPECT_STREQ(csPath.Text(), row.szPath);
  }
}

TEST(PathGuard, RefusesNamesThatLeaveTheFolderOrAreNoFileNames) {
  const char* const NAMES[] = {"",          "\\",           "/",
                               "\\x",       "/x",           "\\\\server\\share\\x",
                               "//x",       "\\\\?\\C:\\x", "\\??\\C:\\x",
                               "C:\\x",     "C:x",          "c:",
                               "a:b",       "a\\b:stream",  "dir::$INDEX_ALLOCATION\\x",
                               "..",        "..\\..\\x",    "../x",
                               "a\\..\\b",  "a/..",         ".",
                               ".\\a",      "a\\.\\b",      "a\\\\b",
                               "a//b",      "a\\/b",        "a\\",
                               "a/",        "a.",           "a ",
                               "dir.\\x",   "dir \\x",      "...",
                               "a\\...\\b", "a\nb",         "a\tb",
                               "\x01",      "a\x7f",        "a<b",
                               "a>b",       "a\"b",         "a|b",
                               "what?",     "*.txt",        "nul",
                               "NUL",       "Con",          "prn.txt",
                               "aux.a.b",   "dir\\nul",     "nul\\x",
                               "nul .txt",  "com1",         "COM9.dat",
                               "lpt1",      "LPT9",         "conin$",
                               "CONOUT$",   "clock$"};
  for (const char* szName : NAMES) {
    CNString csPath;
    EXPECT_FALSE(bMakeSafePath(szName, csPath)) << szName;
    EXPECT_EQ(csPath.Ptr(), nullptr) << szName;
  }
  CNString csPath;
  EXPECT_FALSE(bMakeSafePath(nullptr, csPath));
}

#ifndef _WIN32
TEST(PathGuard, SeesLinksAnywhereBelowTheFolder) {
  TestFolder folder;
  folder.MakeFolder("in/real");
  folder.MakeFolder("out");
  std::filesystem::create_symlink("../out", folder.Path("in/link"));
  std::filesystem::create_symlink("../../out/x", folder.Path("in/real/file"));
  const std::string in = folder.Path("in") + "\\";
  EXPECT_TRUE(bNoLinkOnPath(in.c_str(), "real\\other"));
  EXPECT_TRUE(bNoLinkOnPath(in.c_str(), "missing\\deep\\file"));
  EXPECT_FALSE(bNoLinkOnPath(in.c_str(), "link"));
  EXPECT_FALSE(bNoLinkOnPath(in.c_str(), "link\\x"));
  EXPECT_FALSE(bNoLinkOnPath(in.c_str(), "link\\missing\\deep"));
  EXPECT_FALSE(bNoLinkOnPath(in.c_str(), "real\\file"));
}
#endif

}  // namespace
