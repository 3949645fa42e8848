#include "archive/PathGuard.h"

#include "support/TestFolder.h"

namespace {

TEST(PathGuard, KeepsGoodNamesAndTurnsSlashes) {
  for (const char* szName : {"a", "Dir/Sub/file.txt", "mixed/a\\b", "..a\\...b", " leading", "nullable.txt",
                             "com\\com10\\lpt", "\x8amr\xe6.txt", "a;b,c=d'e(f)[g]{h}!@#$%^&~`+-_"}) {
    std::string expected = szName;
    std::replace(expected.begin(), expected.end(), '/', '\\');
    CNString csPath;
    EXPECT_TRUE(bMakeSafePath(szName, csPath)) << szName;
    EXPECT_EQ(csPath.Text(), expected);
  }
}

TEST(PathGuard, RefusesNamesThatLeaveTheFolderOrAreNoFileNames) {
  // clang-format off
  const char* const NAMES[] = {
      nullptr, "", "\\", "/", "\\x", "/x", "\\\\server\\share\\x", "//x", "\\\\?\\C:\\x", "\\??\\C:\\x", "C:\\x",
      "C:x", "c:", "a:b", "a\\b:stream", "dir::$INDEX_ALLOCATION\\x", "..", "..\\..\\x", "../x", "a\\..\\b", "a/..",
      ".", ".\\a", "a\\.\\b", "a\\\\b", "a//b", "a\\/b", "a\\", "a/", "a.", "a ", "dir.\\x", "dir \\x", "...",
      "a\\...\\b", "a\nb", "a\tb", "\x01", "a\x7f", "a<b", "a>b", "a\"b", "a|b", "what?", "*.txt", "nul", "NUL", "Con",
      "prn.txt", "aux.a.b", "dir\\nul", "nul\\x", "nul .txt", "com1", "COM9.dat", "lpt1", "LPT9", "conin$", "CONOUT$",
      "clock$"};
  // clang-format on
  for (const char* szName : NAMES) {
    CNString csPath;
    EXPECT_FALSE(bMakeSafePath(szName, csPath)) << szName;
    EXPECT_EQ(csPath.Ptr(), nullptr) << szName;
  }
}

#ifndef _WIN32
TEST(PathGuard, SeesLinksAnywhereBelowTheFolder) {
  TestFolder folder;
  folder.MakeFolder("in/real");
  folder.MakeFolder("out");
  std::filesystem::create_symlink("../out", folder.Path("in/link"));
  std::filesystem::create_symlink("../../out/x", folder.Path("in/real/file"));
  const std::string in = folder.Path("in") + "\\";
  for (const char* szPath : {"real\\other", "missing\\deep\\file"})
    EXPECT_TRUE(bNoLinkOnPath(in.c_str(), szPath)) << szPath;
  for (const char* szPath : {"link", "link\\x", "link\\missing\\deep", "real\\file"})
    EXPECT_FALSE(bNoLinkOnPath(in.c_str(), szPath)) << szPath;
}
#endif

}  // namespace
