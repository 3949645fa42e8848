#include "archive/CNArchive.h"

#include <memory>

#include "archive/ArchiveBytes.h"
#include "foundation/ResultCodes.h"
#include "support/TestFolder.h"

namespace {

using Lines = std::vector<std::string>;

struct Percents : ArchiveProgress {
  void OnPercent(int iPercent) override { values.push_back(iPercent); }
  std::vector<int> values;
};

struct Journal : ArchiveJournal {
  bool bOnFolder(const char* szPath) override { return bNote(std::string("folder ") + szPath); }
  bool bOnFile(const char* szPath) override { return bNote(std::string("file ") + szPath); }
  void OnFileDone(const ArchiveFileMark& mark) override { done = mark, lines.push_back("done"); }
  void OnFileNotMade() override { lines.push_back("not made"); }
  // Nothing may be there before it is noted, and nothing that could not be noted may be made.
  bool bNote(const std::string& line) {
    EXPECT_FALSE(bFresh && bOsExists(("to\\" + line.substr(line.find(' ') + 1)).c_str())) << line;
    lines.push_back(line);
    return line != refused;
  }
  bool bFresh = true;
  std::string refused;
  ArchiveFileMark done;
  Lines lines;
};

// Every test with and without a thread that reads ahead.
class CNArchiveTest : public ::testing::TestWithParam<bool> {
 protected:
  CNArchive& Open(const std::string& bytes) {
    m_folder.Write("archive", bytes);
    m_pArchive = std::make_unique<CNArchive>("archive");
    if (GetParam()) m_pArchive->StartReadAhead();
    return *m_pArchive;
  }
  // Into the destination, as the installer gives it.
  int Extract(int iIndex, ArchiveProgress* pProgress = nullptr, int iBase = 0, int iSpan = 100, bool bKeep = false) {
    return m_pArchive->ExtractEntry(iIndex, (m_folder.Path("to") + "\\").c_str(), pProgress, iBase, iSpan, bKeep);
  }
  int ExtractFirst(const std::string& entries) {
    Open(Archive(entries));
    return Extract(0);
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

TEST_P(CNArchiveTest, CheckTellsRightFromWrong) {
  const std::string right = Archive(Entry("a", "content") + Entry("b", std::string(300000, 'b')));
  EXPECT_EQ(Open(right).CheckArchive(), ArchiveOk);
  EXPECT_EQ(Open(Seal("in front" + Le32(0), 8)).CheckArchive(), ArchiveOk);
  for (size_t n = right.size() - 8; n < right.size(); n++) {
    std::string wrong = right;
    wrong[n]++;
    EXPECT_EQ(Open(wrong).CheckArchive(), ErrCRCError) << n;
  }
  for (size_t n = 0; n < 12; n++) EXPECT_EQ(Open(std::string(n, 'x')).CheckArchive(), ErrCRCError) << n;
  for (const char* szPath : {"missing", static_cast<const char*>(nullptr)})
    EXPECT_EQ(CNArchive(szPath).CheckArchive(), ErrZipFileNotFound);
  // Past what a lane of the sum holds, ending at every place of a word.
  for (size_t n = 3000; n < 3008; n++)
    EXPECT_EQ(Open(Archive(RawEntry("a", std::string(n, '\xff'), 0))).CheckArchive(), ArchiveOk) << n;
}

TEST_P(CNArchiveTest, ProgressRisesOverItsSpanWhateverTheClaimedSize) {
  Percents check;
  Open(Archive(RawEntry("big", std::string(3000000, 'x'), 3000000))).CheckArchive(&check);
  ASSERT_GT(check.values.size(), 5u);
  EXPECT_EQ(check.values.back(), 100);
  for (size_t i = 1; i < check.values.size(); i++) EXPECT_GT(check.values[i], check.values[i - 1]);
  for (const uint32_t claimed : {2000000u, 0u, 1u, 0xffffffffu}) {
    Percents percents;
    Open(Archive(RawEntry("a", Gzip(std::string(2000000, 'a')), claimed)));
    ASSERT_EQ(Extract(0, &percents, 40, 20), ArchiveOk);
    ASSERT_FALSE(percents.values.empty());
    EXPECT_EQ(percents.values.back(), claimed == 0xffffffffu ? 40 : 60) << claimed;
    EXPECT_GE(percents.values.front(), 40);
  }
}

TEST_P(CNArchiveTest, ListsNamesAndSizes) {
  CNArray<CNArchiveEntry> entries, none;
  EXPECT_EQ(Open(Archive(Entry("a\\b", "content") + Entry("empty", ""))).ListEntries(entries), ArchiveOk);
  ASSERT_EQ(entries.Size(), 2);
  EXPECT_STREQ(entries[0]->csName.Text(), "a\\b");
  EXPECT_TRUE(entries[0]->unpackedSize == 7 && entries[0]->storedSize == Gzip("content").size());
  EXPECT_EQ(entries[1]->storedSize, 0u);
  EXPECT_EQ(Open(Archive("")).ListEntries(none), ArchiveOk);
  EXPECT_EQ(none.Size(), 0);
  EXPECT_EQ(Extract(0), ErrZipFileNotFound);
  EXPECT_EQ(CNArchive(nullptr).ListEntries(none), FUNCTION_ERROR);
  EXPECT_EQ(CNArchive("missing").ListEntries(none), ErrArchiveOpen);
  EXPECT_EQ(CNArchive("missing").ExtractEntry(0, "to\\"), ErrArchiveOpen);
  EXPECT_EQ(m_log.Lines().size(), 4u);
}

TEST_P(CNArchiveTest, ExtractsContentTimesAndAttributesOverWhatIsThere) {
  m_folder.MakeFolder("to");
  m_folder.Write("to/file", std::string(100, 'o'));
  m_folder.Write("to/empty", "something");
  bOsSetAttributes(m_folder.Path("to/file").c_str(), OS_READ_ONLY);
  const struct {
    std::string name, content;
    uint32_t attributes;
  } rows[] = {
      {"Dir\\Sub\\a.txt", std::string(700000, 'c'), OS_READ_ONLY | OS_ARCHIVE},
      {"Dir\\Sub\\a.txt", "over its own read-only file", OS_READ_ONLY | OS_ARCHIVE},
      {"file", "new", OS_ARCHIVE},
      {"empty", "", OS_ARCHIVE},
      {"new/a", "first", OS_READ_ONLY},
      {"new/b", "B", OS_ARCHIVE},
      {"new/a", "named twice", OS_ARCHIVE},
  };
  std::string entries;
  for (const auto& row : rows) entries += Entry(row.name, row.content, row.attributes);
  Open(Archive(entries));
  for (int i = 0; i < int(std::size(rows)); i++) {
    EXPECT_EQ(Extract(i), ArchiveOk) << i;
    const std::string path = "to/" + rows[i].name;
    EXPECT_TRUE(m_folder.Read(path) == rows[i].content) << path;
    const OsFileInfo info = Info(path);
    EXPECT_EQ(info.attributes & OS_READ_ONLY, rows[i].attributes & OS_READ_ONLY) << path;
    // The creation time is left out: not every file system keeps one; that of access: it has been read above.
    EXPECT_EQ(info.times.lastWrite, static_cast<uint64_t>(TEST_WRITTEN) << 32);
  }
  EXPECT_EQ(Extract(3), ArchiveOk);
  EXPECT_EQ(Info("to/empty").times.lastAccess, static_cast<uint64_t>(TEST_ACCESSED) << 32);
  EXPECT_TRUE(m_log.Lines().empty());
}

TEST_P(CNArchiveTest, EntriesComeInAnyOrderAndPassThroughData) {
  Open(Seal("garbage in front" + Entry("a", "A") + RawEntry("b", "no gzip", 7) +
                RawEntry("c", Gzip("two ") + Gzip("members"), 11) + Le32(0),
            16));
  for (const int i : {2, 0, 1, 1, 2, 0}) EXPECT_EQ(Extract(i), ArchiveOk);
  EXPECT_EQ(m_folder.Read("to/a") + m_folder.Read("to/b") + m_folder.Read("to/c"), "Ano gziptwo members");
  for (const int i : {3, 1000000, -1}) EXPECT_EQ(Extract(i), ErrZipFileNotFound) << i;
  EXPECT_EQ(Extract(0, nullptr, 0, 100, true), ArchiveOk);
  EXPECT_EQ(m_folder.Read("to/to/a"), "A") << "the destination's name in front";
}

TEST_P(CNArchiveTest, TheJournalHearsOfWhatIsMade) {
  Journal journal;
  m_folder.MakeFolder("to/old");
  Open(Archive(Entry("new/sub/a", "A") + Entry("new/sub/b", "B") + Entry("old/c", "C") + Entry("../d", "D")));
  m_pArchive->SetJournal(&journal);
  for (int i = 0; i < 4; i++) Extract(i);
  EXPECT_EQ(journal.lines, (Lines{"folder new", "folder new\\sub", "file new\\sub\\a", "done", "file new\\sub\\b",
                                  "done", "file old\\c", "done"}));
  const OsFileInfo info = Info("to/old/c");
  EXPECT_TRUE(journal.done.size == 1 && journal.done.lastWrite == info.times.lastWrite);
  EXPECT_EQ(journal.done.sum, 0x3dd7ffa7u) << "CRC-32 of C";
  const struct {
    const char* szRefused;
    int iFirst, iSecond;
  } rows[] = {
      {"folder f", ErrDestinationFolder, 0}, {"file f\\a", ErrDestinationFile, 0}, {"file g", 0, ErrDestinationFile}};
  for (const auto& row : rows) {
    Journal strict;
    strict.refused = row.szRefused;
    Open(Archive(Entry("f/a", "A") + Entry("g", "G")));
    m_pArchive->SetJournal(&strict);
    EXPECT_EQ(Extract(0), row.iFirst);
    EXPECT_EQ(Extract(1), row.iSecond);
    EXPECT_EQ(m_folder.Exists("to/g"), !row.iSecond);
    for (const char* szMade : {"to/f/a", "to/f", "to/g"}) std::filesystem::remove(m_folder.Path(szMade));
  }
  m_folder.MakeFolder("to/a");  // in the way of the file
  Journal failing;
  failing.bFresh = false;
  Open(Archive(Entry("a", "A")));
  m_pArchive->SetJournal(&failing);
  EXPECT_EQ(Extract(0), ErrDestinationFile);
  EXPECT_EQ(failing.lines, (Lines{"file a", "not made"}));
}

TEST_P(CNArchiveTest, DamagedDataIsKeptAsFarAsItGoesAndLogged) {
  const std::string member = Gzip(std::string(40000, 'z'), 0);
  EXPECT_EQ(ExtractFirst(RawEntry("early", member.substr(0, 30000), 40000)), ArchiveOk);
  EXPECT_GT(Info("to/early").size, 16384u);
  EXPECT_EQ(ExtractFirst(RawEntry("crc", member.substr(0, member.size() - 8) + "12345678", 40000)), ArchiveOk);
  EXPECT_EQ(Info("to/crc").size, 32768u);
  EXPECT_EQ(m_log.Lines(), (Lines{"ERROR: CNArchive::ExtractEntry -> data ends early (early) -> return ArchiveOk",
                                  "ERROR: CNArchive::ExtractEntry -> data damaged (crc) -> return ArchiveOk"}));
}

TEST_P(CNArchiveTest, UnsafeNamesAreRefusedWithOneLineEach) {
  for (const std::string& name : Lines{"..\\..\\x", std::string("a\0b", 3), "a\nERROR: b"}) {
    m_log.Clear();
    EXPECT_EQ(ExtractFirst(Entry(name, "outside")), ErrUnsafeName) << name;
    ASSERT_EQ(m_log.Lines().size(), 1u) << name;
    EXPECT_NE(m_log.Lines()[0].find("ErrUnsafeName"), std::string::npos);
    EXPECT_EQ(m_log.Lines()[0].find('\n'), std::string::npos);
  }
  EXPECT_EQ(m_folder.Names(), (Lines{"archive", "execution.log"}));
}

TEST_P(CNArchiveTest, WhatStandsInTheWayIsReported) {
  m_folder.Write("to", "a file where the destination should be");
  EXPECT_EQ(ExtractFirst(Entry("a", "A")), ErrDestinationFolder);
  ASSERT_TRUE(bOsDeleteFile("to"));
  m_folder.MakeFolder("to/a");
  m_folder.Write("to/b", "a file where a folder should be");
  EXPECT_EQ(ExtractFirst(Entry("a", "A")), ErrDestinationFile);
  for (const char* szName : {"b/c", "b/c/d"}) EXPECT_EQ(ExtractFirst(Entry(szName, "C")), ErrDestinationFolder);
  EXPECT_EQ(m_log.Lines().size(), 4u);
  EXPECT_EQ(m_folder.Read("to/b"), "a file where a folder should be");
}

// More than the thread can hold, in entries of all sizes, some of them refused or damaged; left at any of them.
TEST_P(CNArchiveTest, ALongArchiveComesWholeAndMayBeLeftAnywhere) {
  std::string entries;
  std::vector<std::string> contents;
  for (size_t i = 0; i < 120; i++) {
    contents.push_back(std::string(i % 7 * i % 9 * 20000 + i, static_cast<char>(i)));
    entries += i % 10 == 3 ? RawEntry("f" + std::to_string(i), Gzip(contents[i]).substr(0, 15), 1)
                           : Entry((i % 10 == 5 ? "../f" : "f") + std::to_string(i), contents[i]);
  }
  const std::string bytes = Archive(entries);
  for (const int iEnd : {0, 1, 50, 120}) {
    Open(bytes);
    for (int i = 0; i < iEnd; i++) {
      EXPECT_EQ(Extract(i), i % 10 == 5 ? ErrUnsafeName : ArchiveOk) << i;
      const bool bWhole = i % 10 != 5 && i % 10 != 3;
      EXPECT_TRUE(!bWhole || m_folder.Read("to/f" + std::to_string(i)) == contents[static_cast<size_t>(i)]) << i;
    }
    EXPECT_TRUE(iEnd != 50 || Extract(110) == ArchiveOk) << "passed over many";
  }
  EXPECT_EQ(Extract(120), ErrZipFileNotFound);
}

INSTANTIATE_TEST_SUITE_P(ReadAhead, CNArchiveTest, ::testing::Bool());

}  // namespace
