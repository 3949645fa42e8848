#include "foundation/CNStream.h"

#include <climits>

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
  CNBuffer buffer, empty;
  std::string all;
  for (const size_t nBytes : {1, 4095, 1}) {
    Put(buffer, std::string(nBytes, char('a' + nBytes % 7)));
    all += std::string(nBytes, char('a' + nBytes % 7));
    EXPECT_EQ(buffer.Capacity(), all.size() > 4096 ? 8192 : 4096);
  }
  EXPECT_EQ(std::string(buffer.Ptr(), size_t(buffer.Length())), all);
  buffer.Resize(1);
  EXPECT_EQ(buffer.Length(), 4096) << "cut with the block";
  for (const long lSize : {0L, 4096L}) {
    empty.Resize(lSize);
    EXPECT_EQ(empty.Capacity(), 4096);
  }
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
  EXPECT_EQ(Text(buffer.ReadLine("test", "b", 1)), "<42>");
  EXPECT_EQ(buffer.iReset(), 0);
  EXPECT_EQ(buffer.Capacity() + buffer.Length(), 0);
  Put(buffer, "again\r\n");
  EXPECT_EQ(ReadLines(buffer), Lines{"again"});
}

TEST(CNBuffer, ARefusedGrowthKeepsTheData) {
  TestFolder folder;
  TestLog log(folder);
  CNBuffer buffer, empty;
  EXPECT_EQ(empty.Write("F", "V", "x", LONG_MAX), -1);
  Put(buffer, "data");
  EXPECT_EQ(buffer.Write("F", "V", "x", LONG_MAX), -1);
  EXPECT_EQ(log.Lines(), (Lines{"ERROR: CNBuffer::Write -> !m_szBuffer=(char *)malloc(m_lBufferSize) -> return -1 -> "
                                "szFunction=F, szVariable=V",
                                "ERROR: CNBuffer::Resize(long size) -> !m_szBuffer=(char *)realloc(m_szBuffer, "
                                "m_lBufferSize) -> return",
                                "ERROR: CNBuffer::Write -> !m_szBuffer -> return -1 -> szFunction=F, szVariable=V"}));
  EXPECT_EQ(std::string(buffer.Ptr(), size_t(buffer.Length())), "data");
}

TEST(Streams, ReadLineOverMemoryAndFile) {
  const struct {
    std::string text;
    Lines trimmed, whole;
  } rows[] = {
      {"a\r\nb", {"a", "b"}, {"a\r\n", "b"}},
      {"a\n\nb \r\r\n", {"a", "", "b "}, {"a\n", "\n", "b \r\r\n"}},
      {"\r\n", {""}, {"\r\n"}},
  };
  TestFolder folder;
  for (const auto& row : rows)
    for (const bool bTrim : {true, false}) {
      CNBuffer buffer;
      Put(buffer, row.text);
      folder.Write("lines", row.text);
      CNFile file(folder.Path("lines").c_str(), "rb");
      buffer.SetTrim(bTrim);
      bTrim ? 0 : file.iReset();  // clears the flag too
      EXPECT_EQ(ReadLines(buffer), bTrim ? row.trimmed : row.whole) << row.text;
      EXPECT_EQ(ReadLines(file), bTrim ? row.trimmed : row.whole) << row.text;
    }
  folder.Write("long", std::string(4093, 'a') + std::string(10, 'b') + "\nlast");
  CNFile file(folder.Path("long").c_str(), "rb");
  EXPECT_EQ(ReadLines(file), (Lines{std::string(4093, 'a'), std::string(10, 'b'), "last"})) << "in pieces";
}

TEST(CNFile, OpensReopensAndCloses) {
  TestFolder folder;
  const std::string path = folder.Path("\xC8ovjek.txt");
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
  EXPECT_EQ(file.Open(folder.Root().c_str(), "rb"), 0) << "a folder is no file";
}

TEST(CNFile, ReadsTheRestInOnePiece) {
  TestFolder folder;
  TestLog log(folder);
  folder.Write("data", std::string("one\r\ntwo\0three", 14));
  folder.Write("empty", "");
  CNString csAll("old", 0);
  CNFile file("data", "rb");
  char bytes[5];
  EXPECT_EQ(file.Read("test", "file", bytes, 5), 5);
  EXPECT_EQ(file.lRead(csAll), 9);
  EXPECT_EQ(std::string(csAll.Ptr(), size_t(csAll.Length())), std::string("two\0three", 9));
  EXPECT_EQ(file.lRead("test", "file", bytes, 5), 0);
  EXPECT_EQ(file.Open("empty", "rb"), 1);
  EXPECT_EQ(file.lRead(csAll), -1);
  EXPECT_STREQ(csAll.Ptr(), "");
  EXPECT_EQ(log.Lines(), Lines{"INFO: CNFile::lRead -> empty file -> return -1"});
#ifdef _WIN32
  EXPECT_EQ(file.Open("data", "r"), 1);
  EXPECT_EQ(file.lRead(csAll), 13) << "text mode turns CR LF into LF";
  EXPECT_EQ(csAll.Length(), 13);
#endif
}
