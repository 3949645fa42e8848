// Archives from strangers: whatever is wrong with them, reading ends in a result and nothing happens outside the
// destination folder.
#include <set>

#include "archive/ArchiveBytes.h"
#include "archive/CNArchive.h"
#include "archive/PathGuard.h"
#include "support/TestFolder.h"

namespace {

using Lines = std::vector<std::string>;

class ArchiveDamageTest : public ::testing::Test {
 protected:
  // Lists and extracts everything that the archive lets find; all results.
  std::set<int> ReadAll(const std::string& bytes) {
    m_folder.Write("archive", bytes);
    CNArchive archive("archive");
    CNArray<CNArchiveEntry> entries;
    std::set<int> results{archive.ListEntries(entries)};
    for (int i = 0; i <= entries.Size(); i++) results.insert(archive.ExtractEntry(i, "to\\"));
    return results;
  }

  TestFolder m_folder;
  TestLog m_log{m_folder};
};

TEST_F(ArchiveDamageTest, EveryTruncationAndEveryChangedByteEnds) {
  const std::string good = Archive(Entry("dir/one", "first content") + Entry("two", "") + Entry("three", "third"));
  ASSERT_EQ(ReadAll(good), (std::set<int>{ArchiveOk, ErrZipFileNotFound}));
  for (size_t n = 0; n < good.size(); n++) {
    for (const int iResult : ReadAll(good.substr(0, n)))
      EXPECT_TRUE(iResult == ArchiveOk || iResult == ErrZipFileNotFound || iResult == ErrCRCError ||
                  iResult == ErrUnsafeName)
          << iResult;
    for (const int iChange : {0x01, 0x2e, 0x80, 0xff}) {
      std::string changed = good;
      changed[n] = static_cast<char>(changed[n] ^ iChange);
      ReadAll(changed);
    }
  }
  EXPECT_EQ(m_folder.Names(), (Lines{"archive", "execution.log", "to"}));
}

TEST_F(ArchiveDamageTest, LengthsThatLieAreDamage) {
  const std::string good = Entry("good", "G");
  const std::string cases[] = {
      good + Le32(0xffffffff) + "name",                                 // a name longer than the file
      good + Le32(4097) + std::string(5000, 'n'),                       // than any path
      good + Le32(100) + "short",                                       // than what is left
      good + RawEntry("a", "", 0).substr(0, 20),                        // fields cut off
      good + Le32(1) + "a" + std::string(20, '\0') + Le32(0xffffff00),  // data past the end
      good,                                                             // no terminator, but see the check value
  };
  for (const std::string& entries : cases) {
    m_folder.Write("archive", Seal(entries));
    CNArchive archive("archive");
    CNArray<CNArchiveEntry> list;
    EXPECT_EQ(archive.CheckArchive(), ArchiveOk);
    EXPECT_EQ(archive.ListEntries(list), ErrCRCError);
    EXPECT_EQ(list.Size(), 1);
    EXPECT_EQ(archive.ExtractEntry(0, "to\\"), ArchiveOk);
    EXPECT_EQ(archive.ExtractEntry(1, "to\\"), ErrCRCError);
  }
  EXPECT_EQ(ReadAll(Seal(good + Le32(0), 0xfffffff0)), (std::set<int>{ErrCRCError}));
  CNArray<CNArchiveEntry> list;
  m_folder.Write("archive", Archive(Entry(std::string(4096, 'n'), "x")));
  EXPECT_EQ(CNArchive("archive").ListEntries(list), ArchiveOk);
  EXPECT_TRUE(list.Size() == 1 && list[0]->csName.Length() == 4096) << "the longest name is read";
}

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
TEST_F(ArchiveDamageTest, LinksInTheDestinationAreNotFollowed) {
  m_folder.MakeFolder("to/real");
  m_folder.MakeFolder("outside");
  m_folder.Write("outside/file", "untouched");
  std::filesystem::create_symlink("../outside", m_folder.Path("to/dir"));
  std::filesystem::create_symlink("../outside/file", m_folder.Path("to/file"));
  std::filesystem::create_symlink("../../outside", m_folder.Path("to/real/dir"));
  const std::string archive = Archive(Entry("dir/file", "x") + Entry("dir/sub/new", "x") + Entry("file", "x") +
                                      Entry("real/dir/new", "x") + Entry("real/dir/sub/sub/new", "x"));
  EXPECT_EQ(ReadAll(archive), (std::set<int>{ArchiveOk, ErrUnsafeName, ErrZipFileNotFound}));
  EXPECT_EQ(m_folder.Names("outside"), Lines{"file"});
  EXPECT_EQ(m_folder.Read("outside/file"), "untouched");
  EXPECT_EQ(m_log.Lines().size(), 6u);
}
#endif

}  // namespace
