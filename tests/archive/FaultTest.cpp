// Every call of the system that an operation makes fails once: the result is a documented one, nothing leaks, and
// success is told only of what is whole.
#include "support/Faults.h"

#include "archive/ArchiveBytes.h"
#include "archive/ArchiveWriter.h"
#include "archive/CNArchive.h"
#include "archive/Payload.h"
#include "support/TestFolder.h"

#ifdef ORBIT_FAULTS

namespace {

using Results = std::vector<int>;

// Stored without compression, the first spans several blocks of the reader.
const struct Item {
  std::string name, content;
  uint32_t attributes;
} ITEMS[] = {{"big", std::string(600000, 'b'), OS_ARCHIVE},
             {"new/sub/read only", "r", OS_READ_ONLY},
             {"new/sub/next", std::string(40000, 'n'), OS_ARCHIVE},
             {"old", "fresh", OS_ARCHIVE}};
const int ITEM_COUNT = sizeof ITEMS / sizeof ITEMS[0];

class ArchiveFaultTest : public testing::Test {
 protected:
  ArchiveFaultTest() {
    std::string entries;
    for (const Item& item : ITEMS)
      entries += RawEntry(item.name, Gzip(item.content, 0), uint32_t(item.content.size()), item.attributes);
    m_bytes = Archive(entries);
    m_folder.Write("archive", m_bytes);
  }
  void ExpectOneOf(int iResult, const Results& documented) const {
    EXPECT_NE(std::find(documented.begin(), documented.end(), iResult), documented.end()) << iResult;
  }
  // Extracts everything into a folder that holds an older file; the results in order.
  Results ExtractAll(const FaultPlan& plan) {
    std::filesystem::remove_all(m_folder.Root() + "/to");
    m_folder.MakeFolder("to");
    m_folder.Write("to/old", std::string(1000, 'o'));
    bOsSetAttributes(m_folder.Path("to/old").c_str(), OS_READ_ONLY);
    m_log.Clear();
    Results results;
    Faults faults(plan);
    CNArchive archive("archive");
    for (int i = 0; i < ITEM_COUNT; i++) results.push_back(archive.ExtractEntry(i, "to\\"));
    return results;
  }

  TestFolder m_folder;
  TestLog m_log{m_folder};
  std::string m_bytes;
};

}  // namespace

TEST_F(ArchiveFaultTest, TheCheckNeverPassesWhatItCouldNotReadAndAListIsWholeOrReported) {
  std::string wrong = m_bytes;
  wrong[wrong.size() / 2]++;
  for (const bool bRight : {true, false}) {
    m_folder.Write("checked", bRight ? m_bytes : wrong);
    ForEveryFault({OsCall::Open, OsCall::Read}, [&](const FaultPlan& plan) {
      m_log.Clear();
      CNArray<CNArchiveEntry> entries;
      int iChecked, iListed;
      {
        Faults faults(plan);
        iChecked = CNArchive("checked").CheckArchive();
        iListed = CNArchive("checked").ListEntries(entries);
      }
      ExpectOneOf(iChecked, {ArchiveOk, ErrZipFileNotFound, ErrCRCError});
      EXPECT_TRUE(iChecked || bRight);
      ExpectOneOf(iListed, {ArchiveOk, ErrArchiveOpen, ErrCRCError});
      EXPECT_TRUE(iListed || entries.Size() == ITEM_COUNT) << entries.Size();
      for (int i = 0; i < entries.Size(); i++) EXPECT_EQ(entries[i]->csName.Text(), ITEMS[i].name);
      const size_t nFailed = (iChecked ? 1 : 0) + (iListed ? 1 : 0);
      EXPECT_TRUE(plan.mode != FaultMode::One || !bRight || m_log.Lines().size() == nFailed);
    });
  }
}

TEST_F(ArchiveFaultTest, AnExtractedEntryIsWholeOrReported) {
  const std::set<OsCall> kinds = {OsCall::Open,    OsCall::Read,  OsCall::Write,         OsCall::SetTimes,
                                  OsCall::GetInfo, OsCall::Close, OsCall::SetAttributes, OsCall::MakeFolder};
  ForEveryFault(kinds, [&](const FaultPlan& plan) {
    const Results results = ExtractAll(plan);
    size_t nFailed = 0;
    for (int i = 0; i < ITEM_COUNT; i++) {
      const std::string path = "to/" + ITEMS[i].name;
      ExpectOneOf(results[i], {ArchiveOk, ErrArchiveOpen, ErrDestinationFile, ErrDestinationFolder, ErrCRCError});
      nFailed += results[i] ? 1 : 0;
      const bool bThere = m_folder.Exists(path);
      EXPECT_TRUE(bThere || results[i]) << path;
      // A failed entry leaves no half of a new file, unless that could not be taken away either.
      const bool bWhole = !results[i] || (bThere && plan.mode == FaultMode::One && i < 3);
      EXPECT_TRUE(!bWhole || m_folder.Read(path) == ITEMS[i].content) << path;
      EXPECT_TRUE(bThere || i != 3) << "a file that was there is not taken away";
    }
    // Attributes that could not be set are told only.
    const size_t nLines = m_log.Lines().size();
    EXPECT_TRUE(plan.mode != FaultMode::One || nLines == nFailed || (!nFailed && nLines == 1)) << nLines;
    EXPECT_EQ(ExtractAll(FaultPlan()), Results(ITEM_COUNT, ArchiveOk)) << "a second try";
  });
}

TEST_F(ArchiveFaultTest, AnArchiveIsWrittenWholeOrReported) {
  m_folder.Write("input", std::string(300000, 'i'));
  std::string whole;
  ForEveryFault({OsCall::Open, OsCall::Read, OsCall::Write, OsCall::Close}, [&](const FaultPlan& plan) {
    int iResult = ArchiveWritten;
    bool bDone = false;
    {
      Faults faults(plan);
      OsFile input, output;
      if (input.bOpen("input", OsOpenMode::Read) && output.bOpen("written", OsOpenMode::Create)) {
        ArchiveWriter writer(output, 0);
        ArchiveEntryHeader header;
        header.csName = "name";
        iResult = writer.iAddFile(header, input);
        if (!iResult) iResult = writer.iFinish();
        bDone = output.bClose() && !iResult;
      }
    }
    ExpectOneOf(iResult, {ArchiveWritten, ErrArchiveRead, ErrArchiveWrite});
    if (!plan.iCall) whole = m_folder.Read("written");
    EXPECT_TRUE(!bDone || m_folder.Read("written") == whole);
  });
}

TEST_F(ArchiveFaultTest, APayloadIsExpandedWholeOrReported) {
  const std::string stream = Gzip(m_bytes, 1, 15);
  m_folder.Write("program", std::string(SFX_STAMP_OFFSET, 'M') + "rSFX" + std::string(12, 0) + Le32(64) +
                                Le32(uint32_t(stream.size())) + std::string(12, 0) + stream);
  const std::set<OsCall> kinds = {OsCall::Open, OsCall::Seek, OsCall::Read, OsCall::Write, OsCall::Close};
  ForEveryFault(kinds, [&](const FaultPlan& plan) {
    bool bDone = false;
    {
      Faults faults(plan);
      OsFile input, output;
      SfxStreamParams params;
      SfxStamp found;
      params.pInput = &input;
      params.pOutput = &output;
      params.chunkSize = 65536;
      bDone = input.bOpen("program", OsOpenMode::Read) && bReadSfxStamp(input, found) &&
              input.bSeek(found.payloadOffset) && output.bOpen("expanded", OsOpenMode::Create) &&
              ExpandStream(params) == 0 && output.bClose();
    }
    EXPECT_TRUE(bDone || plan.iCall);
    EXPECT_TRUE(!bDone || m_folder.Read("expanded") == m_bytes);
  });
}

#endif
