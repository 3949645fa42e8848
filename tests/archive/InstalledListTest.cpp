#include "archive/InstalledList.h"

#include "archive/ArchiveBytes.h"
#include "archive/TempArchives.h"
#include "support/TestFolder.h"

namespace {

// Kind and text of every line, "!" before a marked one, and the count of bad lines.
std::string Dump(const InstalledList& list) {
  std::string dump;
  for (int i = 0; i < list.Size(); i++)
    dump += std::string(list[i].bMarked ? "!" : "") + list[i].cKind + list[i].szText + " ";
  return dump + std::to_string(list.iBadLines());
}

}  // namespace

TEST(InstalledList, SurvivesWhatKillsAndPowerCutsLeave) {
  const struct {
    std::string bytes;
    const char* szDump;
  } rows[] = {
      {"", "0"},
      {"F a\r\nS 1 2 3\r\nD b\r\nW c\r\nP d\r\nR e\r\nV f=g\r\n", "!Fa Db Wc Pd Re Vf=g 0"},
      {"F a\r\nN\r\nF b\r\n", "Fb 0"},
      {"F a\r\nF half", "Fa 0"},
      {"F a\r\nF half|\r\nF b\r\n", "Fa Fb 0"},
      {std::string("F a\r\n\0\0\0\0F b\r\n", 14), "Fa Fb 0"},
      {"x\r\nF\r\nF \r\nS 1 2 3\r\nN\r\nD a\r\nS 1 2 3\r\n", "Da 6"},
      {"F a\n\nF b\n", "Fa Fb 0"},
  };
  TestFolder folder;
  for (const auto& row : rows) {
    InstalledList list;
    folder.Write("list", row.bytes);
    EXPECT_TRUE(list.bRead(folder.Path("list").c_str()));
    EXPECT_EQ(Dump(list), row.szDump);
  }
  InstalledList list;
  EXPECT_FALSE(list.bRead(folder.Path("missing").c_str()));
  EXPECT_EQ(list.Size(), 0);
}

TEST(InstalledList, TheLastLineOfAPathAndAValueCounts) {
  TestFolder folder;
  InstalledList list;
  folder.Write("list", "V k=1\r\nV kk=2\r\nF b\r\nF Dir\\A\r\nS 1 2 3\r\nF c\r\nV k=3=3\r\nF dir\\a\r\nF b\r\nN\r\n");
  ASSERT_TRUE(list.bRead(folder.Path("list").c_str()));
  ASSERT_NE(list.pFile("DIR\\a"), nullptr);
  EXPECT_EQ(list.pFile("DIR\\a")->iNumber, 6);
  EXPECT_EQ(list.pFile("b")->iNumber, 2);
  EXPECT_EQ(list.pFile("d"), nullptr);
  EXPECT_STREQ(list.szValue("k"), "3=3");
  EXPECT_EQ(list.szValue("q"), nullptr);
}

TEST(InstalledList, AFileIsTheUsersOnlyWhenItHasOtherContent) {
  TestFolder folder;
  folder.Write("file", "content");
  const std::string path = folder.Path("file");
  OsFileInfo info;
  ASSERT_TRUE(bOsGetFileInfo(path.c_str(), info));
  const uint64_t time = info.times.lastWrite, hour = 36000000000;
  const uint32_t sum = 0xfec530a9;  // CRC-32 of "content", wrong in the rows that add 1
  const struct {
    bool bMarked;
    ArchiveFileMark mark;
    InstalledFileState state;
  } rows[] = {
      {false, {}, InstalledFileState::Same},
      {true, {7, time, 0}, InstalledFileState::Same},
      {true, {7, time + 20000000, sum + 1}, InstalledFileState::Same},  // even seconds; not read
      {true, {7, time - hour, sum}, InstalledFileState::Same},
      {true, {7, time - hour, sum + 1}, InstalledFileState::Changed},
      {true, {7, time - hour, 0}, InstalledFileState::Changed},
      {true, {8, time, sum}, InstalledFileState::Changed},
  };
  for (const auto& row : rows) {
    InstalledList::Line line;
    line.bMarked = row.bMarked;
    line.mark = row.mark;
    EXPECT_EQ(CheckInstalledFile(path.c_str(), line), row.state) << row.mark.size << ' ' << row.mark.sum;
  }
  EXPECT_EQ(CheckInstalledFile(folder.Path("gone").c_str(), {}), InstalledFileState::Gone);
  EXPECT_EQ(CheckInstalledFile(folder.Root().c_str(), {}), InstalledFileState::Changed) << "a folder";
}

TEST(TempArchives, OnlyLeftArchivesGo) {
  TestFolder folder;
  const std::string archive = Archive(Entry("Plumo.exe", "content"));
  const struct {
    const char* szName;
    std::string bytes;
    bool bGoesAtOnce, bGoesLater;
  } rows[] = {
      {"@1A2.tmp", archive, true, true},
      {"@1.tmp", archive.substr(0, 60), true, true},  // half of one
      {"@2.tmp", archive.substr(0, 20), false, true},
      {"@3.TMP", "", false, true},
      {"@4.tmp", std::string(200, 'x'), false, false},
      {"@5.tmp", Le32(3) + "nul" + archive.substr(13), false, false},
      {"@6.txt", archive, false, false},
      {"@7x.tmp", archive, false, false},
      {"x@8.tmp", archive, false, false},
      {"@.tmp", archive, false, false},
      {"@123456789.tmp", archive, false, false},
  };
  for (const auto& row : rows) folder.Write(row.szName, row.bytes);
  OsFileInfo info;
  ASSERT_TRUE(bOsGetFileInfo(folder.Path("@3.TMP").c_str(), info));
  for (const bool bLater : {false, true}) {
    RemoveLeftTempArchives((folder.Root() + "\\").c_str(), info.times.lastWrite + (bLater ? 7000000000 : 0));
    for (const auto& row : rows)
      EXPECT_NE(folder.Exists(row.szName), bLater ? row.bGoesLater : row.bGoesAtOnce) << row.szName;
  }
}
