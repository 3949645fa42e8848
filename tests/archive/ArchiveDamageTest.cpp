// Archives from strangers: whatever is wrong with them, reading ends in a result and nothing happens outside the
// destination folder.
#include <set>

#include "archive/ArchiveBytes.h"
#include "archive/CNArchive.h"
#include "support/TestFolder.h"

#ifndef _WIN32
#include <signal.h>
#include <sys/resource.h>
#endif

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

#ifndef _WIN32
TEST_F(ArchiveDamageTest, LinksInTheDestinationAreNotFollowed) {
  m_folder.MakeFolder("to");
  m_folder.MakeFolder("outside");
  m_folder.Write("outside/file", "untouched");
  std::filesystem::create_symlink("../outside", m_folder.Path("to/dir"));
  std::filesystem::create_symlink("../outside/file", m_folder.Path("to/file"));
  const std::string archive = Archive(Entry("dir/file", "x") + Entry("dir/sub/new", "x") + Entry("file", "x"));
  EXPECT_EQ(ReadAll(archive), (std::set<int>{ArchiveOk, ErrUnsafeName, ErrZipFileNotFound}));
  EXPECT_EQ(m_folder.Names("outside"), Lines{"file"});
  EXPECT_EQ(m_folder.Read("outside/file"), "untouched");
  EXPECT_EQ(m_log.Lines().size(), 4u);
}

TEST_F(ArchiveDamageTest, AFullDriveFailsTheEntryAndTakesOnlyItsOwnHalfAway) {
  m_folder.MakeFolder("to");
  m_folder.Write("to/old", "was here");
  m_folder.Write("archive", Archive(Entry("new", std::string(900000, 'n')) + Entry("old", std::string(900000, 'o')) +
                                    Entry("small", "fits")));
  CNArchive archive("archive");
  // A limit on file sizes stands for the drive's end: writing past it fails.
  rlimit before;
  getrlimit(RLIMIT_FSIZE, &before);
  rlimit limit = before;
  limit.rlim_cur = 500000;
  signal(SIGXFSZ, SIG_IGN);
  setrlimit(RLIMIT_FSIZE, &limit);
  std::vector<int> results;
  for (int i = 0; i < 3; i++) results.push_back(archive.ExtractEntry(i, "to\\"));
  setrlimit(RLIMIT_FSIZE, &before);
  EXPECT_EQ(results, (std::vector<int>{ErrDestinationFile, ErrDestinationFile, ArchiveOk}));
  EXPECT_EQ(m_folder.Names("to"), (Lines{"old", "small"}));
  EXPECT_EQ(m_log.Lines(), (Lines{"ERROR: CNArchive::ExtractEntry -> !bWrite (new) -> return ErrDestinationFile",
                                  "ERROR: CNArchive::ExtractEntry -> !bWrite (old) -> return ErrDestinationFile"}));
}
#endif

}  // namespace
