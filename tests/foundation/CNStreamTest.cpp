#include "foundation/CNStream.h"

#include <atomic>
#include <climits>
#include <thread>

#include "support/TestFolder.h"

using Lines = std::vector<std::string>;

namespace {

std::string Text(const char* szLine) { return szLine ? szLine : "(null)"; }

Lines ReadLines(CNStream& stream) {
  Lines lines;
  while (const char* szLine = stream.ReadLine("test", "stream", 1)) lines.push_back(szLine);
  return lines;
}

void Put(CNStream& stream, const std::string& bytes) {
  EXPECT_EQ(stream.Write("test", "stream", bytes.data(), long(bytes.size())), long(bytes.size()));
}

}  // namespace

TEST(CNBuffer, GrowsInBlocksOf4096) {
  CNBuffer buffer;
  EXPECT_EQ(buffer.Capacity(), 0);
  Put(buffer, "x");
  EXPECT_EQ(buffer.Capacity(), 4096);
  Put(buffer, std::string(4095, 'y'));
  EXPECT_EQ(buffer.Capacity(), 4096);
  Put(buffer, "z");
  EXPECT_EQ(buffer.Capacity(), 8192);
  EXPECT_EQ(std::string(buffer.Ptr(), size_t(buffer.Length())), "x" + std::string(4095, 'y') + "z");
  buffer.Resize(1);  // cuts the data with the block
  EXPECT_EQ(buffer.Length(), 4096);
  CNBuffer empty;
  empty.Resize(0);
  EXPECT_EQ(empty.Capacity(), 4096);
}

TEST(CNBuffer, ReadsWhatWasWrittenAndStartsAfreshAfterReset) {
  CNBuffer buffer;
  char bytes[8] = {};
  EXPECT_EQ(buffer.Read("test", "b", bytes, 8), 0);
  EXPECT_EQ(buffer.ReadLine("test", "b", 1), nullptr);
  Put(buffer, std::string("ab\0cd", 5));
  EXPECT_EQ(buffer.Read("test", "b", bytes, 3), 3);
  EXPECT_EQ(buffer.Read("test", "b", bytes + 3, 5), 2);
  EXPECT_EQ(std::string(bytes, 5), std::string("ab\0cd", 5));
  EXPECT_EQ(buffer.Printf("test", "b", "<%d>", 42), 4);
  EXPECT_EQ(buffer.Printf("test", "b", "%s", ""), 0);
  EXPECT_EQ(Text(buffer.ReadLine("test", "b", 1)), "<42>");
  EXPECT_EQ(buffer.iReset(), 0);
  EXPECT_EQ(buffer.Capacity() + buffer.Length(), 0);
  Put(buffer, "kept\r\n");
  EXPECT_EQ(Text(buffer.ReadLine("test", "b", 1)), "kept\r\n") << "a reset clears the trim flag";
}

TEST(Streams, ReadLineOverMemoryAndFile) {
  const struct {
    std::string text;
    Lines trimmed, whole;
  } rows[] = {
      {"a\r\nb", {"a", "b"}, {"a\r\n", "b"}},
      {"a\n\nb \r\r\n", {"a", "", "b "}, {"a\n", "\n", "b \r\r\n"}},
      {"\r\n", {""}, {"\r\n"}},
      {"x", {"x"}, {"x"}},
  };
  TestFolder folder;
  for (const auto& row : rows)
    for (const bool bTrim : {true, false}) {
      CNBuffer buffer;
      Put(buffer, row.text);
      folder.Write("lines", row.text);
      CNFile file(folder.Path("lines").c_str(), "rb");
      buffer.SetTrim(bTrim);
      file.SetTrim(bTrim);
      EXPECT_EQ(ReadLines(buffer), bTrim ? row.trimmed : row.whole) << row.text;
      EXPECT_EQ(ReadLines(file), bTrim ? row.trimmed : row.whole) << row.text;
    }
}

TEST(CNFile, ReadLineHandsLongLinesOutInPieces) {
  TestFolder folder;
  folder.Write("long", std::string(4093, 'a') + std::string(10, 'b') + "\nlast");
  CNFile file(folder.Path("long").c_str(), "rb");
  EXPECT_EQ(ReadLines(file), (Lines{std::string(4093, 'a'), std::string(10, 'b'), "last"}));
}

TEST(CNFile, OpensReopensAndCloses) {
  TestFolder folder;
  const std::string path = folder.Path(
      "\xC8"
      "evap\xE8i\xE6.txt");
  CNFile file;
  EXPECT_EQ(file.Open(path.c_str(), "rb"), 0) << "must not exist yet";
  EXPECT_EQ(file.Open(path.c_str(), "wb"), 1);
  EXPECT_EQ(file.Printf("test", "file", "%s-%.3d\n", "text", 5), 9);
  EXPECT_EQ(file.Printf("test", "file", "%s", ""), 0);
  Put(file, "two\n");
  EXPECT_EQ(file.Open(nullptr, "rb"), 1) << "the last name";
  EXPECT_EQ(file.lSize(), 13);
  EXPECT_EQ(Text(file.ReadLine("test", "file", 1)), "text-005");
  EXPECT_EQ(file.lGetNumLines(), 1);
  EXPECT_EQ(file.lSize(), 13);
  EXPECT_EQ(Text(file.ReadLine("test", "file", 1)), "two") << "counting must not move";
  file.Close();
  EXPECT_EQ(file.bFileOpened(), 0);
  EXPECT_EQ(file.lGetNumLines(), -1);
  EXPECT_EQ(file.Open(folder.Root().c_str(), "rb"), 0) << "a folder is no file";
}

TEST(CNFile, ReadsTheRestInOnePiece) {
  TestFolder folder;
  folder.Write("data", std::string("one\r\ntwo\0three", 14));
  folder.Write("empty", "");
  CNString csAll("old", 0);
  CNFile file(folder.Path("data").c_str(), "rb");
  char bytes[5];
  EXPECT_EQ(file.Read("test", "file", bytes, 5), 5);
  EXPECT_EQ(file.lRead(csAll), 9);
  EXPECT_EQ(std::string(csAll.Ptr(), size_t(csAll.Length())), std::string("two\0three", 9));
  EXPECT_EQ(file.lRead("test", "file", bytes, 5), 0);
  TestLog log(folder);
  EXPECT_EQ(file.Open(folder.Path("empty").c_str(), "rb"), 1);
  EXPECT_EQ(file.lRead(csAll), -1);
  EXPECT_STREQ(csAll.Ptr(), "");
  EXPECT_EQ(log.Lines(), Lines{"INFO: CNFile::lRead -> empty file -> return -1"});
#ifdef _WIN32
  EXPECT_EQ(file.Open(folder.Path("data").c_str(), "r"), 1);
  EXPECT_EQ(file.lRead(csAll), 13) << "text mode turns CR LF into LF";
  EXPECT_EQ(csAll.Length(), 13);
#endif
}

TEST(CNFile, SharedByThreadsWritesWholeLines) {
  TestFolder folder;
  CNFile file(folder.Path("shared").c_str(), "wb");
  std::vector<std::thread> threads;
  for (char c = 'a'; c < 'e'; c++)
    threads.emplace_back([&file, c] {
      for (int i = 0; i < 200; i++) Put(file, std::string(99, c) + "\n");
    });
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(file.Open(nullptr, "rb"), 1);
  int nLines = 0;
  for (const std::string& line : ReadLines(file)) {
    EXPECT_EQ(line, std::string(99, line[0]));
    nLines++;
  }
  EXPECT_EQ(nLines, 800);
}

TEST(Streams, RefusalsLogTheirLine) {
  TestFolder folder;
  TestLog log(folder);
  char bytes[4] = "abc";
  CNBuffer buffer;
  CNFile closed, file(folder.Path("f").c_str(), "wb+");
  const auto expect = [&](long lResult, const char* szLine) {
    EXPECT_EQ(lResult, -1) << szLine;
    EXPECT_EQ(log.Lines(), Lines{szLine});
    log.Clear();
  };
  const auto expectNull = [&](const char* szResult, const char* szLine) { expect(szResult ? 0 : -1, szLine); };
#define NAMES " -> szFunction=F, szVariable=V"
  expect(buffer.Read("F", "V", nullptr, 1), "ERROR: CNBuffer::Read -> !szBuffer -> return -1" NAMES);
  expect(buffer.Read("F", "V", bytes, -1), "ERROR: CNBuffer::Read -> lMaxReadBufferLength<0 -> return -1" NAMES);
  expect(buffer.Write("F", "V", nullptr, 1), "ERROR: CNBuffer::Write -> !szBuffer -> return -1" NAMES);
  expect(buffer.Write("F", "V", bytes, 0), "ERROR: CNBuffer::Write -> lBufferLength<=0 -> return -1" NAMES);
  expectNull(buffer.ReadLine("F", "V", 0), "ERROR: CNBuffer::ReadLine -> iTimeOut<=0 -> return NULL" NAMES);
  expect((buffer.Resize(-1), -1), "ERROR: CNBuffer::Resize(long size) -> size<0L -> return");
  expect(buffer.Printf("F", "V", nullptr), "ERROR: CNStream::Printf -> !format || !*format -> return -1" NAMES);
  expect(file.Write("F", "V", "", 1), "ERROR: CNFile::Write -> !szBuffer || !*szBuffer -> return -1" NAMES);
  expect(file.Write("F", "V", bytes, 0), "ERROR: CNFile::Write -> lBufferLength<0 -> return -1" NAMES);
  expect(closed.Write("F", "V", bytes, 1), "ERROR: CNFile::Write -> !m_File -> return -1" NAMES);
  expect(closed.Printf("F", "V", "x"), "ERROR: CNFile::Printf -> !m_File -> return -1" NAMES);
  expect(file.lRead("F", "V", nullptr, 1), "ERROR: CNFile::lRead -> !szBuffer -> return -1" NAMES);
  expect(file.lRead("F", "V", bytes, -1), "ERROR: CNFile::lRead -> lMaxReadBufferLength-> return -1" NAMES);
  expect(closed.lRead("F", "V", bytes, 1), "ERROR: CNFile::lRead -> !m_File -> return 0");
  expectNull(file.ReadLine("F", "V", 0), "ERROR: CNFile::ReadLine -> iTimeOut<=0 -> return NULL" NAMES);
  expectNull(closed.ReadLine("F", "V", 1), "ERROR: CNFile::ReadLine -> !m_File -> return NULL" NAMES);
  expect(closed.lGetNumLines(), "ERROR: CNFile::lGetNumLines -> !m_File -> return -1");
  expect(closed.Open("f", "") - 1, "ERROR: CNFile::Open -> !type || !*type -> return 0");
  expect(closed.Open(nullptr, "rb") - 1, "ERROR: CNFile::Open -> !m_csFileName.Length() -> return 0");
  expect(CNFile("", "rb").bFileOpened() - 1,
         "ERROR: CNFile::CNFile(char *file, char *type) -> !file || !*file -> return");
  expect(CNFile("f", "").bFileOpened() - 1,
         "ERROR: CNFile::CNFile(char *file, char *type) -> !type || !*type -> return");
#undef NAMES
}

TEST(CNBuffer, ARefusedGrowthKeepsTheData) {
  TestFolder folder;
  TestLog log(folder);
  CNBuffer buffer, empty;
  EXPECT_EQ(empty.Write("F", "V", "x", LONG_MAX), -1);
  EXPECT_EQ(log.Lines(), Lines{"ERROR: CNBuffer::Write -> !m_szBuffer=(char *)malloc(m_lBufferSize) -> return -1 -> "
                               "szFunction=F, szVariable=V"});
  log.Clear();
  Put(buffer, "data");
  EXPECT_EQ(buffer.Write("F", "V", "x", LONG_MAX), -1);
  EXPECT_EQ(log.Lines().size(), 2u) << "the failed growth and the failed write";
  EXPECT_EQ(std::string(buffer.Ptr(), size_t(buffer.Length())), "data");
  EXPECT_EQ(buffer.Capacity(), 4096);
}
