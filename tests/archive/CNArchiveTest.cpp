#include "archive/CNArchive.h"

#include <memory>

#include "archive/ArchiveBytes.h"
#include "archive/ArchiveSum.h"
#include "foundation/ResultCodes.h"
#include "support/TestFolder.h"

namespace {

struct Percents : ArchiveProgress {
  void OnPercent(int iPercent) override { values.push_back(iPercent); }
  std::vector<int> values;
};

struct Journal : ArchiveJournal {
  void OnFolder(const char* szPath) override { lines.push_back(std::string("folder ") + szPath); }
  void OnFile(const char* szPath) override { lines.push_back(std::string("file ") + szPath); }
  std::vector<std::string> lines;
};

using Lines = std::vector<std::string>;

class CNArchiveTest : public ::testing::Test {
 protected:
  CNArchive& Open(const std::string& bytes) {
    m_folder.Write("archive", bytes);
    m_pArchive = std::make_unique<CNArchive>(m_folder.Path("archive").c_str());
    return *m_pArchive;
  }
  // The destination, as the installer gives it.
  std::string Destination() const { return m_folder.Path("to") + "\\"; }
  int Extract(const std::string& entries, int iIndex = 0) {
    return Open(Archive(entries)).ExtractEntry(iIndex, Destination().c_str());
  }
  OsFileInfo Info(const std::string& name) const {
    OsFileInfo info;
    EXPECT_TRUE(bOsGetFileInfo(m_folder.Path(name).c_str(), info)) << name;
    return info;
  }

  TestFolder m_folder;
  TestLog m_log{m_folder};
  std::unique_ptr<CNArchive> m_pArchive;
};

TEST_F(CNArchiveTest, CheckTellsRightFromWrong) {
  const std::string right = Archive(Entry("a", "content") + Entry("b", std::string(300000, 'b')));
  EXPECT_EQ(Open(right).CheckArchive(), ArchiveOk);
  EXPECT_EQ(Open(Seal("in front" + Le32(0), 8)).CheckArchive(), ArchiveOk);
  for (size_t n = right.size() - 8; n < right.size(); n++) {
    std::string wrong = right;
    wrong[n]++;
    EXPECT_EQ(Open(wrong).CheckArchive(), ErrCRCError) << n;
  }
  for (size_t n = 0; n < 12; n++) EXPECT_EQ(Open(std::string(n, 'x')).CheckArchive(), ErrCRCError) << n;
  EXPECT_EQ(CNArchive(m_folder.Path("missing").c_str()).CheckArchive(), ErrZipFileNotFound);
  EXPECT_EQ(CNArchive(nullptr).CheckArchive(), ErrZipFileNotFound);
}

TEST_F(CNArchiveTest, SumMatchesAddingByteByByte) {
  std::string bytes(3000, '\xff');
  for (size_t i = 1500; i < bytes.size(); i++) bytes[i] = static_cast<char>(i * 7);
  for (size_t n = 0; n < bytes.size(); n += n < 20 ? 1 : 119) {
    uint32_t sum = 0;
    for (size_t i = 0; i < n; i++) sum += static_cast<unsigned char>(bytes[i]);
    EXPECT_EQ(ArchiveSum(reinterpret_cast<const unsigned char*>(bytes.data()), n), sum) << n;
  }
}

TEST_F(CNArchiveTest, CheckProgressRisesToAHundred) {
  Percents percents;
  Open(Archive(RawEntry("big", std::string(3000000, 'x'), 3000000))).CheckArchive(&percents);
  ASSERT_GT(percents.values.size(), 5u);
  EXPECT_EQ(percents.values.back(), 100);
  for (size_t i = 1; i < percents.values.size(); i++) EXPECT_GT(percents.values[i], percents.values[i - 1]);
}

TEST_F(CNArchiveTest, ListsNamesAndSizes) {
  CNArray<CNArchiveEntry> entries;
  EXPECT_EQ(Open(Archive(Entry("a\\b", "content") + Entry("empty", ""))).ListEntries(entries), ArchiveOk);
  ASSERT_EQ(entries.Size(), 2);
  EXPECT_STREQ(entries[0]->csName.Text(), "a\\b");
  EXPECT_EQ(entries[0]->unpackedSize, 7u);
  EXPECT_EQ(entries[0]->storedSize, Gzip("content").size());
  EXPECT_EQ(entries[1]->storedSize, 0u);
}

TEST_F(CNArchiveTest, AnEmptyArchiveListsNothingAndHasNoEntry) {
  CNArray<CNArchiveEntry> entries;
  EXPECT_EQ(Open(Archive("")).ListEntries(entries), ArchiveOk);
  EXPECT_EQ(entries.Size(), 0);
  EXPECT_EQ(m_pArchive->ExtractEntry(0, Destination().c_str()), ErrZipFileNotFound);
  EXPECT_EQ(CNArchive(nullptr).ListEntries(entries), FUNCTION_ERROR);
  EXPECT_EQ(CNArchive(m_folder.Path("missing").c_str()).ListEntries(entries), ErrArchiveOpen);
  EXPECT_EQ(CNArchive(m_folder.Path("missing").c_str()).ExtractEntry(0, Destination().c_str()), ErrArchiveOpen);
  EXPECT_EQ(m_log.Lines().size(), 4u);
}

TEST_F(CNArchiveTest, ExtractsContentTimesAndAttributes) {
  const std::string content(700000, 'c');
  ASSERT_EQ(Extract(Entry("Dir\\Sub\\file.txt", content, OS_READ_ONLY | OS_ARCHIVE)), ArchiveOk);
  ASSERT_EQ(m_pArchive->ExtractEntry(0, Destination().c_str()), ArchiveOk);  // over its own read-only file
  // The creation time is left out: not every file system keeps one.
  const OsFileInfo info = Info("to/Dir/Sub/file.txt");
  EXPECT_TRUE(info.attributes & OS_READ_ONLY);
  EXPECT_EQ(info.times.lastWrite, static_cast<uint64_t>(TEST_WRITTEN) << 32);
  EXPECT_EQ(info.times.lastAccess, static_cast<uint64_t>(TEST_ACCESSED) << 32);
  EXPECT_EQ(m_folder.Read("to/Dir/Sub/file.txt"), content);
  EXPECT_TRUE(m_log.Lines().empty());
}

TEST_F(CNArchiveTest, AnOlderFileIsReplacedWithItsAttributes) {
  m_folder.MakeFolder("to");
  m_folder.Write("to/file", std::string(100, 'o'));
  bOsSetAttributes(m_folder.Path("to/file").c_str(), OS_READ_ONLY);
  EXPECT_EQ(Extract(Entry("file", "new", OS_ARCHIVE)), ArchiveOk);
  EXPECT_EQ(m_folder.Read("to/file"), "new");
  EXPECT_FALSE(Info("to/file").attributes & OS_READ_ONLY);
  m_folder.Write("to/empty", "something");
  EXPECT_EQ(Extract(Entry("empty", "")), ArchiveOk);
  EXPECT_EQ(Info("to/empty").size, 0u);
  EXPECT_EQ(Info("to/empty").times.lastWrite, static_cast<uint64_t>(TEST_WRITTEN) << 32);
}

TEST_F(CNArchiveTest, AnEntryNamedTwiceIsOverwritten) {
  Open(Archive(Entry("new/a", "first", OS_READ_ONLY) + Entry("new/b", "B") + Entry("new/a", "second")));
  for (int i = 0; i < 3; i++) EXPECT_EQ(m_pArchive->ExtractEntry(i, Destination().c_str()), ArchiveOk) << i;
  EXPECT_EQ(m_folder.Read("to/new/a"), "second");
  EXPECT_FALSE(Info("to/new/a").attributes & OS_READ_ONLY);
  EXPECT_TRUE(m_log.Lines().empty());
}

TEST_F(CNArchiveTest, EntriesComeInAnyOrderAndPassThroughData) {
  Open(Seal("garbage in front" + Entry("a", "A") + RawEntry("b", "no gzip", 7) +
                RawEntry("c", Gzip("two ") + Gzip("members"), 11) + Le32(0),
            16));
  for (const int i : {2, 0, 1, 1, 2, 0}) EXPECT_EQ(m_pArchive->ExtractEntry(i, Destination().c_str()), ArchiveOk);
  EXPECT_EQ(m_folder.Read("to/a"), "A");
  EXPECT_EQ(m_folder.Read("to/b"), "no gzip");
  EXPECT_EQ(m_folder.Read("to/c"), "two members");
  for (const int i : {3, 1000000, -1})
    EXPECT_EQ(m_pArchive->ExtractEntry(i, Destination().c_str()), ErrZipFileNotFound) << i;
}

TEST_F(CNArchiveTest, ProgressRunsOverItsSpanWhateverTheClaimedSize) {
  for (const uint32_t claimed : {2000000u, 0u, 1u, 0xffffffffu}) {
    Percents percents;
    Open(Archive(RawEntry("a", Gzip(std::string(2000000, 'a')), claimed)));
    ASSERT_EQ(m_pArchive->ExtractEntry(0, Destination().c_str(), &percents, 40, 20), ArchiveOk);
    ASSERT_FALSE(percents.values.empty());
    EXPECT_EQ(percents.values.back(), claimed == 0xffffffffu ? 40 : 60) << claimed;
    EXPECT_GE(percents.values.front(), 40);
  }
}

TEST_F(CNArchiveTest, TheJournalHearsOfWhatIsMade) {
  Journal journal;
  m_folder.MakeFolder("to/old");
  Open(Archive(Entry("new/sub/a", "A") + Entry("new/sub/b", "B") + Entry("old/c", "C") + Entry("../d", "D")));
  m_pArchive->SetJournal(&journal);
  for (int i = 0; i < 4; i++) m_pArchive->ExtractEntry(i, Destination().c_str());
  EXPECT_EQ(journal.lines,
            (Lines{"folder new", "folder new\\sub", "file new\\sub\\a", "file new\\sub\\b", "file old\\c"}));
}

TEST_F(CNArchiveTest, KeepFolderPutsTheDestinationsNameInFront) {
  Open(Archive(Entry("x/a", "A")));
  EXPECT_EQ(m_pArchive->ExtractEntry(0, Destination().c_str(), nullptr, 0, 100, true), ArchiveOk);
  EXPECT_EQ(m_folder.Read("to/to/x/a"), "A");
}

TEST_F(CNArchiveTest, DamagedDataIsKeptAsFarAsItGoesAndLogged) {
  const std::string member = Gzip(std::string(40000, 'z'), 0);
  EXPECT_EQ(Extract(RawEntry("early", member.substr(0, 30000), 40000)), ArchiveOk);
  EXPECT_GT(Info("to/early").size, 16384u);
  EXPECT_EQ(m_log.Lines(), Lines{"ERROR: CNArchive::ExtractEntry -> data ends early (early) -> return ArchiveOk"});
  m_log.Clear();
  EXPECT_EQ(Extract(RawEntry("crc", member.substr(0, member.size() - 8) + "12345678", 40000)), ArchiveOk);
  EXPECT_EQ(Info("to/crc").size, 32768u);
  EXPECT_EQ(m_log.Lines(), Lines{"ERROR: CNArchive::ExtractEntry -> data damaged (crc) -> return ArchiveOk"});
}

TEST_F(CNArchiveTest, UnsafeNamesAreRefusedWithOneLineEach) {
  const std::string names[] = {"..\\..\\x",  "C:\\x", "\\x", "a:b", "nul", "a/../../x", std::string("a\0b", 3),
                               "a\nERROR: b"};
  for (const std::string& name : names) {
    m_log.Clear();
    EXPECT_EQ(Extract(Entry(name, "outside")), ErrUnsafeName) << name;
    ASSERT_EQ(m_log.Lines().size(), 1u) << name;
    EXPECT_NE(m_log.Lines()[0].find("ErrUnsafeName"), std::string::npos);
    EXPECT_EQ(m_log.Lines()[0].find('\n'), std::string::npos);
  }
  EXPECT_EQ(m_folder.Names(), (Lines{"archive", "execution.log"}));
}

TEST_F(CNArchiveTest, WhatStandsInTheWayIsReported) {
  m_folder.Write("to", "a file where the destination should be");
  EXPECT_EQ(Extract(Entry("a", "A")), ErrDestinationFolder);
  ASSERT_TRUE(bOsDeleteFile(m_folder.Path("to").c_str()));
  m_folder.MakeFolder("to/a");
  m_folder.Write("to/b", "a file where a folder should be");
  EXPECT_EQ(Extract(Entry("a", "A")), ErrDestinationFile);
  EXPECT_EQ(Extract(Entry("b/c", "C")), ErrDestinationFolder);
  EXPECT_EQ(Extract(Entry("b/c/d", "D")), ErrDestinationFolder);
  EXPECT_EQ(m_log.Lines().size(), 4u);
  EXPECT_EQ(m_folder.Read("to/b"), "a file where a folder should be");
}

}  // namespace
