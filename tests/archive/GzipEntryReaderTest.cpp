// The entry reader must give what zlib's own gzip file reader gives for the same bytes, whatever they are.
#include "archive/GzipEntryReader.h"

#include <algorithm>
#include <random>

#include "archive/ArchiveBytes.h"
#include "support/TestFolder.h"

namespace {

using End = GzipEntryReader::End;

std::string ReadByZlib(const std::string& path) {
  std::string content;
  gzFile file = gzopen(path.c_str(), "rb9");
  EXPECT_NE(file, nullptr);
  for (int c; file && (c = gzgetc(file)) != -1;) content += static_cast<char>(c);
  if (file) gzclose(file);
  return content;
}

struct Outcome {
  std::string content;
  End end;
  uint32_t sum;
};

class GzipEntryReaderTest : public ::testing::Test {
 protected:
  size_t Below(size_t n) { return n ? m_random() % n : 0; }

  std::string Noise(size_t nSize) {
    std::string bytes(nSize, '\0');
    for (size_t i = 0, bits = 0; i < nSize; i++, bits >>= 8) {
      if (i % 4 == 0) bits = m_random();
      bytes[i] = static_cast<char>(bits);
    }
    return bytes;
  }

  // Content of one kind: noise, a single byte, or words; sizes lie around the reader's blocks.
  std::string Content() {
    static const size_t SIZES[] = {0,     1,     2,     9,     300,   8191,  8192,  8193,
                                   16383, 16384, 16385, 32768, 49152, 65536, 70000, 131072};
    const size_t nSize = SIZES[Below(std::size(SIZES))], nKind = Below(3);
    if (nKind == 0) return Noise(nSize);
    std::string text(nSize, static_cast<char>(m_random()));
    for (size_t i = 0; nKind == 2 && i < nSize; i++) text[i] = "install orbit "[i * i % 97 % 14];
    return text;
  }

  // One to three pieces: members mostly, sometimes plain data or garbage.
  std::string Stored() {
    std::string bytes;
    for (size_t nPieces = 1 + Below(3); nPieces > 0; nPieces--)
      bytes += Below(5) ? Gzip(Content(), static_cast<int>(Below(10))) : Below(2) ? Noise(Below(5)) : Content();
    return bytes;
  }

  // Up to three times, anywhere or near the end: cut off, some bytes missing, one bit changed.
  void Damage(std::string& bytes) {
    for (size_t nTimes = Below(4); nTimes > 0 && !bytes.empty(); nTimes--) {
      const size_t nAt = Below(2) ? Below(bytes.size()) : bytes.size() - 1 - Below(std::min<size_t>(bytes.size(), 12));
      const size_t nKind = Below(4);
      if (nKind < 2)
        bytes.erase(nAt, nKind ? 1 + Below(3) : std::string::npos);
      else
        bytes[nAt] = static_cast<char>(bytes[nAt] ^ (1 << Below(8)));
    }
  }

  // Our reading of nStored bytes from nBefore on, with room for nRoom bytes at a time.
  Outcome ReadByUs(size_t nBefore, size_t nStored, size_t nRoom) {
    BlockReader source;
    GzipEntryReader reader;
    EXPECT_TRUE(source.bOpen(m_folder.Path("within").c_str()));
    source.SeekTo(nBefore);
    EXPECT_TRUE(reader.bStart(source, static_cast<uint32_t>(nStored)));
    std::vector<unsigned char> buffer(nRoom);
    Outcome outcome;
    while (const size_t nBytes = reader.Read(buffer.data(), buffer.size()))
      outcome.content.append(reinterpret_cast<char*>(buffer.data()), nBytes);
    outcome.end = reader.Result();
    outcome.sum = reader.Sum();
    return outcome;
  }

  // Holds both readers against each other; ours finds the bytes between others.
  Outcome Compare(const std::string& stored) {
    m_folder.Write("plain", stored);
    const std::string before = Noise(Below(600000) * (Below(8) == 0));
    m_folder.Write("within", before + stored + Noise(Below(40)));
    const std::string expected = ReadByZlib(m_folder.Path("plain"));
    const Outcome outcome =
        ReadByUs(before.size(), stored.size(), Below(2) ? GzipEntryReader::OUTPUT_BLOCK : size_t(100000));
    EXPECT_TRUE(outcome.content == expected) << outcome.content.size() << " bytes, not " << expected.size();
    return outcome;
  }

  std::mt19937 m_random{20040214};
  TestFolder m_folder;
};

TEST_F(GzipEntryReaderTest, GivesWhatZlibsReaderGivesForRandomAndDamagedInput) {
  int iEnds[4] = {};
  for (int i = 0; i < 1500 && !HasFailure(); i++) {
    std::string stored = Stored();
    if (i % 3) Damage(stored);
    SCOPED_TRACE("input " + std::to_string(i));
    iEnds[static_cast<int>(Compare(stored).end)]++;
  }
  for (const End end : {End::Complete, End::Early, End::Damaged})
    EXPECT_GT(iEnds[static_cast<int>(end)], 100) << "the inputs must reach every end";
}

TEST_F(GzipEntryReaderTest, KnownEnds) {
  const std::string member = Gzip("content");
  const std::string badCrc = member.substr(0, member.size() - 8) + Le32(1) + member.substr(member.size() - 4);
  const struct {
    std::string stored, content;
    End end;
  } CASES[] = {
      {"", "", End::Complete},
      {"\x1f", "\x1f", End::Complete},
      {"plain", "plain", End::Complete},
      {member + member, "contentcontent", End::Complete},
      {member + "\x1f", "content", End::Complete},
      {member + "garbage", "content", End::Complete},
      {"plain" + member, "plain" + member, End::Complete},
      {"\x1f\x8b", "", End::Early},
      {member.substr(0, member.size() - 1), "content", End::Early},
      {badCrc, "", End::Damaged},  // the block in which the check fails is dropped
  };
  for (const auto& row : CASES) {
    const Outcome outcome = Compare(row.stored);
    EXPECT_EQ(outcome.content, row.content);
    EXPECT_EQ(outcome.end, row.end) << row.content;
    const bool bMembers = row.end == End::Complete && row.stored.compare(0, 2, "\x1f\x8b") == 0;
    const auto pContent = reinterpret_cast<const Bytef*>(row.content.data());
    EXPECT_EQ(outcome.sum, bMembers ? crc32(0, pContent, static_cast<uInt>(row.content.size())) : 0) << row.content;
  }
}

}  // namespace
