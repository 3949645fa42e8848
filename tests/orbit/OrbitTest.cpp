// The work of the orbit tool: what it makes is what the reader takes, and what it refuses leaves nothing behind.
#include <csignal>
#include <functional>

#include "FolderScan.h"
#include "Interrupt.h"
#include "List.h"
#include "OrbitText.h"
#include "Pack.h"
#include "PackedFile.h"
#include "archive/ArchiveBytes.h"
#include "archive/CNArchive.h"
#include "orbit/ToolFixture.h"

namespace fs = std::filesystem;

namespace {

// The least that a Windows program is: "MZ", the place of the new header, "PE", and something behind.
std::string SmallProgram(uint32_t newHeader = 64) {
  std::string program = "MZ" + std::string(58, '\0') + Le32(newHeader);
  program.resize(std::max<size_t>(newHeader, 64), '\0');
  return program + std::string("PE\0\0", 4) + std::string(500, 'c');
}

class OrbitTest : public ::testing::Test {
 protected:
  OrbitTest() {
    m_folder.MakeFolder("product/docs");
    m_folder.Write("product/plain.txt", "plain");
    m_folder.Write("product/docs/pomo\xe6 \x9a.txt", std::string(50000, 'p'));
    m_folder.Write("product/docs/empty", "");
    bOsSetAttributes(m_folder.Path("product/plain.txt").c_str(), OS_READ_ONLY);
    m_folder.Write("setup.exe", SmallProgram());
  }
  PackJob Job(bool bWithSetup = true) const {
    PackJob job;
    job.folder = m_folder.Path("product");
    job.setup = bWithSetup ? m_folder.Path("setup.exe") : "";
    job.output = m_folder.Path("out");
    return job;
  }
  // The message with which a job is refused; nothing but what was there before may be there after it.
  std::string Refusal(const PackJob& job) {
    const std::vector<std::string> before = m_folder.Names();
    std::string message = "accepted";
    try {
      Pack(job);
    } catch (const OrbitError& error) {
      message = error.what();
    }
    EXPECT_EQ(m_folder.Names(), before);
    return message;
  }
  // What List prints, its problems first.
  std::string Listed(const std::string& name, int& iProblems) const {
    const auto printed = Capture([&](FILE* pOut, FILE* pErrors) { return List(m_folder.Path(name), pOut, pErrors); });
    iProblems = printed.iResult;
    return printed.errors + printed.out;
  }
  void ExpectGoodListing(const std::string& name, const std::string& part) const {
    int iProblems = -1;
    const std::string text = Listed(name, iProblems);
    EXPECT_EQ(iProblems, 0) << text;
    for (const char* szPart : {part.c_str(), "pomo\xc4\x87 \xc5\xa1.txt", "R--A", "3 files, 50005 bytes unpacked"})
      EXPECT_NE(text.find(szPart), std::string::npos) << szPart << " in " << text;
  }
  void ExpectProductAt(const std::string& archive) {
    CNArchive reader(m_folder.Path(archive).c_str());
    EXPECT_EQ(reader.CheckArchive(), ArchiveOk);
    const std::string to = m_folder.Path("to") + "\\";
    for (int i = 0; i < 3; i++) EXPECT_EQ(reader.ExtractEntry(i, to.c_str()), ArchiveOk);
    EXPECT_EQ(reader.ExtractEntry(3, to.c_str()), ErrZipFileNotFound);
    for (const char* szName : {"plain.txt", "docs/pomo\xe6 \x9a.txt", "docs/empty"})
      EXPECT_EQ(m_folder.Read(std::string("to/") + szName), m_folder.Read(std::string("product/") + szName));
    OsFileInfo info;
    EXPECT_TRUE(bOsGetFileInfo(m_folder.Path("to/plain.txt").c_str(), info) && (info.attributes & OS_READ_ONLY));
  }

  TestFolder m_folder;
};

TEST_F(OrbitTest, AnArchiveHoldsTheFolderAndIsTheSameEveryTime) {
  const PackSummary summary = Pack(Job(false));
  EXPECT_EQ(summary.archive.files, 3u);
  EXPECT_EQ(summary.archive.bytesIn, 50005u);
  EXPECT_EQ(summary.bytesOut, m_folder.Read("out").size());
  ExpectProductAt("out");
  ExpectGoodListing("out", "docs\\pomo");
  const std::string first = m_folder.Read("out");
  Pack(Job(false));
  EXPECT_EQ(m_folder.Read("out"), first);
  EXPECT_EQ(m_folder.Names(), (std::vector<std::string>{"out", "product", "setup.exe", "to"}));
}

TEST_F(OrbitTest, AStampedSetupCarriesTheArchive) {
  const PackSummary summary = Pack(Job());
  const std::string setup = m_folder.Read("setup.exe"), out = m_folder.Read("out");
  const uint32_t length = static_cast<uint32_t>(out.size() - setup.size());
  EXPECT_EQ(summary.bytesOut, out.size());
  const std::string stamp =
      "rSFX" + std::string(12, '\0') + Le32(static_cast<uint32_t>(setup.size())) + Le32(length) + Le32(0);
  EXPECT_EQ(out.substr(0, setup.size()), setup.substr(0, 28) + stamp + setup.substr(56));
  TakeOutArchive(m_folder.Path("out"), m_folder.Path("archive"));
  EXPECT_EQ(m_folder.Read("archive").size(), summary.archive.archiveBytes);
  ExpectProductAt("archive");
  ExpectGoodListing("out", "stamp: payload at 568");
}

TEST_F(OrbitTest, ListFindsWhatIsWrong) {
  Pack(Job());
  const std::string good = m_folder.Read("out");
  std::string pastTheEnd = good, damaged = good;
  pastTheEnd.replace(48, 4, Le32(static_cast<uint32_t>(good.size() - SmallProgram().size() + 1)));
  damaged[good.size() - 40] ^= 1;
  const std::string entry = Entry("a", "content"), badCrc = Gzip("content").substr(0, 19) + "12345678";
  const struct {
    std::string file;
    int iProblems;
    const char* szSaid;
  } CASES[] = {
      {pastTheEnd, 1, "points past the end"},
      {damaged, 1, "cannot be expanded"},
      {Archive(entry) + "x", 2, "check value"},
      {Seal(entry + Le32(77)), 1, "are damaged"},
      {Archive(Entry("..\\x", "content")), 1, "unsafe"},
      {Archive(RawEntry("a", Gzip("content"), 8)), 1, "holds 7 bytes, not 8"},
      {Archive(Le32(1) + "a" + std::string(12, '\xff') + Le32(0x20) + Le32(1) + Le32(0)), 1,
       "---A  after 9999        a"},
      {Archive(RawEntry("a", Gzip("content").substr(0, 20), 7)), 1, "ends early"},
      {Archive(RawEntry("a", badCrc, 0)), 1, "is damaged"},
  };
  for (const auto& row : CASES) {
    m_folder.Write("bad", row.file);
    int iProblems = -1;
    const std::string text = Listed("bad", iProblems);
    EXPECT_EQ(iProblems, row.iProblems) << text;
    EXPECT_NE(text.find(row.szSaid), std::string::npos) << row.szSaid << " in " << text;
  }
  int iProblems;
  EXPECT_THROW(Listed("setup.exe", iProblems), OrbitError);
  EXPECT_THROW(Listed("missing", iProblems), OrbitError);
}

TEST_F(OrbitTest, SetupProgramsThatCannotBeStampedAreRefused) {
  Pack(Job());
  std::string noRoom = SmallProgram();
  noRoom[40] = 1;
  const std::pair<std::string, const char*> CASES[] = {
      {m_folder.Read("out"), "stamped already"},
      {"MZ", "no Windows program"},
      {"#!/bin/sh" + std::string(200, ' '), "no Windows program"},
      {"MZ" + std::string(200, '\0'), "no Windows program"},  // its new header is its first byte
      {SmallProgram().substr(0, 66), "no Windows program"},
      {noRoom, "no room"},
  };
  PackJob job = Job();
  job.setup = m_folder.Path("bad.exe");
  job.output = m_folder.Path("refused");
  for (const auto& [program, szSaid] : CASES) {
    m_folder.Write("bad.exe", program);
    EXPECT_NE(Refusal(job).find(szSaid), std::string::npos) << szSaid << ": " << Refusal(job);
  }
  job.setup = m_folder.Path("missing.exe");
  EXPECT_NE(Refusal(job).find("cannot open"), std::string::npos);
}

TEST_F(OrbitTest, OutputsThatWouldOverwriteAnInputAreRefused) {
  const std::pair<const char*, const char*> CASES[] = {{"setup.exe", "would overwrite"},
                                                       {"product/plain.txt", "in the folder that is packed"},
                                                       {"product/docs/new.exe", "in the folder that is packed"},
                                                       {"product", "is a folder"},
                                                       {"missing/out", "there is no folder"}};
  PackJob job = Job();
  for (const auto& [szOutput, szSaid] : CASES) {
    job.output = m_folder.Path(szOutput);
    EXPECT_NE(Refusal(job).find(szSaid), std::string::npos) << szOutput;
  }
  {
    TestLog here(m_folder);
    fs::current_path(ToPath(m_folder.Path("product")));
    job.output = "new.exe";
    EXPECT_NE(Refusal(job).find("in the folder that is packed"), std::string::npos);
  }
  EXPECT_EQ(m_folder.Read("setup.exe"), SmallProgram());
  EXPECT_EQ(m_folder.Names("product"), (std::vector<std::string>{"docs", "plain.txt"}));
}

TEST_F(OrbitTest, FoldersThatAnArchiveCannotCarryAreRefused) {
  PackJob job = Job();
  job.folder = m_folder.Path("setup.exe");
  EXPECT_NE(Refusal(job).find("no folder"), std::string::npos);
  m_folder.MakeFolder("product/docs/none");
  EXPECT_NE(Refusal(Job()).find("is empty"), std::string::npos);
#ifndef _WIN32
  // Names that only other systems know, a link, and a file beyond 32 bits.
  const auto write = [](const char* szName) {
    return [szName](const std::string& at) {
      TestFolder::WriteFile(at + "x", "");
      fs::rename(at + "x", at + szName);
    };
  };
  const std::pair<const char*, std::function<void(const std::string& at)>> CASES[] = {
      {"code page 1250", write("\xd1\x8f")},
      {"no file name on Windows", write("nul.txt")},
      {"no file name on Windows", write("a\\b")},
      {"for the same",
       [](const std::string& at) {
         TestFolder::WriteFile(at + "\x8a", "");
         TestFolder::WriteFile(at + "\x9a", "");
       }},
      {"is a link", [](const std::string& at) { fs::create_symlink("../plain.txt", at + "link"); }},
      {"4 GB",
       [](const std::string& at) {
         TestFolder::WriteFile(at + "big", "");
         fs::resize_file(at + "big", 1ull << 32);
       }},
  };
  for (const auto& [szSaid, make] : CASES) {
    fs::remove_all(m_folder.Path("product/docs/none"));
    m_folder.MakeFolder("product/docs/none");
    make(m_folder.Path("product/docs/none") + "/");
    EXPECT_NE(Refusal(Job()).find(szSaid), std::string::npos) << szSaid << ": " << Refusal(Job());
  }
#endif
}

TEST_F(OrbitTest, NamesOfSetupsOwnFilesAreRefusedAtTheTop) {
  unsigned iDeeper = 0;
  for (const char* szName : {"Installed.lst", "UNINSTALL.LOG", "config.ini"}) {
    m_folder.Write(std::string("product/docs/") + szName, "deeper it is a file like others");
    EXPECT_EQ(ScanFolder(m_folder.Path("product")).size(), 3u + ++iDeeper);
    m_folder.Write(std::string("product/") + szName, "x");
    EXPECT_NE(Refusal(Job()).find(std::string("file of its own named ") + szName), std::string::npos) << szName;
    bOsDeleteFile(m_folder.Path(std::string("product/") + szName).c_str());
  }
}

// The request comes before the first block is through: by then the temporary file is there.
TEST_F(OrbitTest, AnInterruptionLeavesNothingBehind) {
  std::signal(SIGINT, SIG_DFL);  // a job in the background ignores it
  for (const bool bWithSetup : {false, true}) {
    const InterruptWatch watch;
    std::raise(SIGINT);
    EXPECT_EQ(Refusal(Job(bWithSetup)), "interrupted");
  }
  Pack(Job());
  const InterruptWatch watch;
  std::raise(SIGTERM);
  int iProblems = -1;
  EXPECT_THROW(Listed("out", iProblems), OrbitError);
}

TEST_F(OrbitTest, NamesFoldAsWindowsFoldsThem) {
  EXPECT_EQ(FoldName("ABC/\x8a\x8e\xc6\xc8\xd0\xa3\xa5\xbc"), "abc\\\x9a\x9e\xe6\xe8\xf0\xb3\xb9\xbe");
  EXPECT_EQ(FoldName("abc\xd7\xdf\x8b\x99\x80_1"), "abc\xd7\xdf\x8b\x99\x80_1");
}

TEST_F(OrbitTest, ProgressGoesOutInLinesWhereThereIsNoTerminal) {
  m_folder.Write("product/big", std::string(9000000, 'b'));
  PackJob job = Job();
  job.pProgress = OsOpenStream(m_folder.Path("progress").c_str(), "wb");
  Pack(job);
  fclose(job.pProgress);
  const std::string text = m_folder.Read("progress");
  EXPECT_EQ(text.find("packing 0%\n"), 0u);
  EXPECT_GT(text.find("packing 100%\n"), strlen("packing 0%\n")) << "nothing in between: " << text;
  EXPECT_NE(text.find("packing 100%\ncompressing 0%\n"), std::string::npos) << text;
  EXPECT_NE(text.find("compressing 100%\n"), std::string::npos);
}

#ifndef _WIN32
// A writer that shares no code with the reader and knows the format from its page alone.
TEST_F(OrbitTest, AnArchiveOfAnotherMakerIsReadAndListedAlike) {
  const std::string script = std::string(ORBIT_SOURCE_DIR) + "/tests/archive/make_archive.py";
  const std::string command =
      "python3 '" + script + "' '" + m_folder.Path("product") + "' '" + m_folder.Path("other") + "'";
  ASSERT_EQ(std::system(command.c_str()), 0);
  ExpectProductAt("other");
  ExpectGoodListing("other", "docs/pomo");
}
#endif

}  // namespace
