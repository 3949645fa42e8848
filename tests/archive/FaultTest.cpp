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

struct Item {
  std::string name, content;
  uint32_t attributes;
};

// Stored without compression, the first spans several blocks of the reader.
const Item ITEMS[] = {
    {"big", std::string(600000, 'b'), OS_ARCHIVE},
    {"new/sub/read only", "r", OS_READ_ONLY},
    {"new/sub/next", std::string(40000, 'n'), OS_ARCHIVE},
    {"old", "fresh", OS_ARCHIVE},
};
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

TEST_F(ArchiveFaultTest, TheCheckNeverPassesWhatItCouldNotRead) {
  std::string wrong = m_bytes;
  wrong[wrong.size() / 2]++;
  for (const bool bRight : {true, false}) {
    m_folder.Write("checked", bRight ? m_bytes : wrong);
    const int nCalls = ForEveryFault([&](const FaultPlan& plan) {
      m_log.Clear();
      int iResult;
      {
        Faults faults(plan);
        iResult = CNArchive("checked").CheckArchive();
      }
      ExpectOneOf(iResult, {ArchiveOk, ErrZipFileNotFound, ErrCRCError});
      EXPECT_TRUE(iResult || bRight);
      if (plan.mode == FaultMode::One && bRight) {
        EXPECT_EQ(m_log.Lines().size(), iResult ? 1u : 0u);
      }
    });
    EXPECT_GT(nCalls, 6);
  }
}

TEST_F(ArchiveFaultTest, AListIsWholeOrReported) {
  const int nCalls = ForEveryFault([&](const FaultPlan& plan) {
    CNArray<CNArchiveEntry> entries;
    int iResult;
    {
      Faults faults(plan);
      iResult = CNArchive("archive").ListEntries(entries);
    }
    ExpectOneOf(iResult, {ArchiveOk, ErrArchiveOpen, ErrCRCError});
    EXPECT_TRUE(entries.Size() == ITEM_COUNT || iResult) << entries.Size();
    for (int i = 0; i < entries.Size(); i++) EXPECT_EQ(entries[i]->csName.Text(), ITEMS[i].name);
  });
  EXPECT_GT(nCalls, 5);
}

TEST_F(ArchiveFaultTest, AnExtractedEntryIsWholeOrReported) {
  const int nCalls = ForEveryFault([&](const FaultPlan& plan) {
    const Results results = ExtractAll(plan);
    size_t nFailed = 0;
    for (int i = 0; i < ITEM_COUNT; i++) {
      const std::string path = "to/" + ITEMS[i].name;
      ExpectOneOf(results[i], {ArchiveOk, ErrArchiveOpen, ErrDestinationFile, ErrDestinationFolder, ErrCRCError});
      nFailed += results[i] ? 1 : 0;
      const bool bThere = m_folder.Exists(path);
      EXPECT_TRUE(bThere || results[i]) << path;
      // A failed entry leaves no half of a new file, unless that could not be taken away either.
      if (!results[i] || (bThere && plan.mode == FaultMode::One && i < 3)) {
        EXPECT_TRUE(m_folder.Read(path) == ITEMS[i].content) << path;
      }
    }
    if (plan.mode == FaultMode::One) {
      EXPECT_GE(m_log.Lines().size(), nFailed);
      EXPECT_LE(m_log.Lines().size(), nFailed + (nFailed ? 0 : 1));  // attributes that could not be set are told only
    }
    EXPECT_EQ(ExtractAll(FaultPlan()), Results(ITEM_COUNT, ArchiveOk)) << "a second try";
  });
  EXPECT_GT(nCalls, 30);
}

TEST_F(ArchiveFaultTest, AnArchiveIsWrittenWholeOrReported) {
  m_folder.Write("input", std::string(300000, 'i'));
  std::string whole;
  const int nCalls = ForEveryFault([&](const FaultPlan& plan) {
    bool bOpened = false;
    int iResult = ArchiveWritten;
    bool bClosed = false;
    {
      Faults faults(plan);
      OsFile input, output;
      bOpened = input.bOpen("input", OsOpenMode::Read) && output.bOpen("written", OsOpenMode::Create);
      if (bOpened) {
        ArchiveWriter writer(output, 0);
        ArchiveEntryHeader header;
        header.csName = "name";
        iResult = writer.iAddFile(header, input);
        if (!iResult) iResult = writer.iFinish();
        bClosed = output.bClose();
      }
    }
    ExpectOneOf(iResult, {ArchiveWritten, ErrArchiveRead, ErrArchiveWrite});
    if (!plan.iCall) whole = m_folder.Read("written");
    if (bOpened && !iResult && bClosed) {
      EXPECT_TRUE(m_folder.Read("written") == whole);
    }
  });
  EXPECT_GT(nCalls, 12);
}

TEST_F(ArchiveFaultTest, APayloadIsExpandedWholeOrReported) {
  const std::string content = m_bytes;
  const std::string stream = Gzip(content, 1, 15);
  SfxStamp stamp;
  stamp.payloadOffset = 64;
  stamp.payloadLength = uint32_t(stream.size());
  unsigned char bytes[SFX_STAMP_SIZE];
  EncodeSfxStamp(stamp, bytes);
  std::string program(64, 'M');
  program.replace(SFX_STAMP_OFFSET, SFX_STAMP_SIZE, reinterpret_cast<const char*>(bytes), SFX_STAMP_SIZE);
  m_folder.Write("program", program + stream);
  const int nCalls = ForEveryFault([&](const FaultPlan& plan) {
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
    if (bDone) {
      EXPECT_TRUE(m_folder.Read("expanded") == content);
    }
  });
  EXPECT_GT(nCalls, 15);
}

#endif
