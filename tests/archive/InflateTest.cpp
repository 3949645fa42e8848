// What inflates: the entry reader, which must give what zlib's own gzip file reader gives for the same bytes, whatever
// they are; and the expander of the payload.
#include <algorithm>
#include <random>

#include "archive/ArchiveBytes.h"
#include "archive/GzipEntryReader.h"
#include "archive/Payload.h"
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

  // Noise, a single byte, or words; sizes lie around the reader's blocks.
  std::string Content() {
    const size_t nSize = Below(3) ? (1 + Below(9)) * 8192 + Below(3) - 1 : Below(300), nKind = Below(3);
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

  // Holds both readers against each other; ours finds the bytes between others.
  Outcome Compare(const std::string& stored) {
    const std::string before = Noise(Below(600000) * (Below(8) == 0));
    m_folder.Write("plain", stored);
    m_folder.Write("within", before + stored + Noise(Below(40)));
    BlockReader source;
    GzipEntryReader reader;
    EXPECT_TRUE(source.bOpen(m_folder.Path("within").c_str()));
    source.SeekTo(before.size());
    EXPECT_TRUE(reader.bStart(source, static_cast<uint32_t>(stored.size())));
    std::vector<unsigned char> buffer(Below(2) ? GzipEntryReader::OUTPUT_BLOCK : size_t(100000));
    Outcome outcome;
    while (const size_t nBytes = reader.Read(buffer.data(), buffer.size()))
      outcome.content.append(reinterpret_cast<char*>(buffer.data()), nBytes);
    outcome.end = reader.Result();
    outcome.sum = reader.Sum();
    const std::string expected = ReadByZlib(m_folder.Path("plain"));
    EXPECT_TRUE(outcome.content == expected) << outcome.content.size() << " bytes, not " << expected.size();
    return outcome;
  }

  std::mt19937 m_random{20040214};
  TestFolder m_folder;
};

TEST_F(GzipEntryReaderTest, GivesWhatZlibsReaderGivesForRandomAndDamagedInput) {
  int iEnds[4] = {};
  for (int i = 0; i < 600 && !HasFailure(); i++) {
    std::string stored = Stored();
    if (i % 3) Damage(stored);
    SCOPED_TRACE("input " + std::to_string(i));
    iEnds[static_cast<int>(Compare(stored).end)]++;
  }
  for (const End end : {End::Complete, End::Early, End::Damaged})
    EXPECT_GT(iEnds[static_cast<int>(end)], 50) << "the inputs must reach every end";
}

TEST_F(GzipEntryReaderTest, TellsHowItEndedAndTheSumOfWholeMembers) {
  const std::string member = Gzip("content");
  const struct {
    std::string stored;
    End end;
    bool bSum;
  } rows[] = {
      {"", End::Complete, false},
      {"\x1f", End::Complete, false},
      {"plain" + member, End::Complete, false},
      {member + Gzip("and more"), End::Complete, true},
      {member + "garbage", End::Complete, true},
      {"\x1f\x8b", End::Early, false},
      {member.substr(0, member.size() - 1), End::Early, false},
      {member.substr(0, member.size() - 8) + Le32(1) + Le32(7), End::Damaged, false},
  };
  for (const auto& row : rows) {
    SCOPED_TRACE(testing::PrintToString(row.stored));
    const Outcome outcome = Compare(row.stored);
    const auto pContent = reinterpret_cast<const Bytef*>(outcome.content.data());
    EXPECT_EQ(outcome.end, row.end);
    EXPECT_EQ(outcome.sum, row.bSum ? crc32(0, pContent, static_cast<uInt>(outcome.content.size())) : 0);
  }
}

class PayloadTest : public GzipEntryReaderTest {
 protected:
  // Expands what lies in the file "in" from nOffset on into "out".
  int Expand(const std::string& input, uint64_t offset = 0, uint32_t length = 0) {
    m_folder.Write("in", input);
    OsFile in, out;
    EXPECT_TRUE(in.bOpen(m_folder.Path("in").c_str(), OsOpenMode::Read) && in.bSeek(offset));
    EXPECT_TRUE(out.bOpen(m_folder.Path("out").c_str(), OsOpenMode::Create));
    m_params = SfxStreamParams();
    m_params.pInput = &in;
    m_params.pOutput = &out;
    m_params.payloadLength = length;
    return ExpandStream(m_params);
  }

  SfxStreamParams m_params;
  // Noise does not compress, so that damage has no place to hide, behind text that does.
  const std::string m_content = std::string(9000, 'o') + Noise(9000);
  const std::string m_payload = Gzip(m_content, 6, 15);
};

TEST_F(PayloadTest, StampHasItsPlacesAndIsReadBack) {
  unsigned char bytes[SFX_STAMP_SIZE];
  EncodeSfxStamp({0x01020304, 0xa0b0c0d0}, bytes);
  const std::string stamp = "rSFX" + std::string(12, '\0') + Le32(0x01020304) + Le32(0xa0b0c0d0) + Le32(0);
  EXPECT_EQ(std::string(reinterpret_cast<char*>(bytes), sizeof bytes), stamp);
  const std::string front(28, 'M');
  for (const std::string& program : {front + stamp, front + stamp.substr(0, 27), stamp + front, std::string()}) {
    m_folder.Write("exe", program);
    OsFile file;
    ASSERT_TRUE(file.bOpen(m_folder.Path("exe").c_str(), OsOpenMode::Read));
    SfxStamp read;
    const bool bStamped = program == front + stamp;
    ASSERT_EQ(bReadSfxStamp(file, read), bStamped);
    EXPECT_EQ(read.payloadOffset, bStamped ? 0x01020304u : 0u);
    EXPECT_EQ(read.payloadLength, bStamped ? 0xa0b0c0d0u : 0u);
  }
}

TEST_F(PayloadTest, ExpandsToTheLastByteWithinItsLength) {
  EXPECT_EQ(Expand("front" + m_payload + "behind", 5), 0);
  EXPECT_EQ(m_folder.Read("out"), m_content);
  EXPECT_EQ(m_params.total, m_content.size());
  EXPECT_EQ(Expand(Gzip("", 6, 15)), 0);
  EXPECT_EQ(m_params.total, 0u);
  const uint32_t size = static_cast<uint32_t>(m_payload.size());
  EXPECT_EQ(Expand(m_payload, 0, size), 0);
  EXPECT_NE(Expand(m_payload, 0, size - 1), 0);
  EXPECT_EQ(Expand(m_payload, 0, 0xffffffff), 0);
  EXPECT_NE(Expand(m_payload, size + 1000), 0) << "a place past the end";
  m_params = SfxStreamParams();
  EXPECT_NE(ExpandStream(m_params), 0) << "neither input nor output";
}

TEST_F(PayloadTest, EveryTruncationAndEveryDamagedByteFails) {
  for (size_t n = 0; n < m_payload.size(); n += n < 64 ? 1 : 97) {
    EXPECT_NE(Expand(m_payload.substr(0, n)), 0) << n;
    std::string damaged = m_payload;
    damaged[n] = static_cast<char>(damaged[n] ^ 0x10);
    EXPECT_NE(Expand(damaged), 0) << n;
  }
}

}  // namespace
