#include "archive/Payload.h"

#include "archive/ArchiveBytes.h"
#include "support/TestFolder.h"

namespace {

const int ZLIB_STREAM = 15;

// Noise that does not compress, so that damage has no place to hide, behind text that does.
std::string SampleContent() {
  std::string content(9000, 'o');
  uint32_t state = 7;
  for (int i = 0; i < 9000; i++) content += static_cast<char>((state = state * 1664525 + 1013904223) >> 24);
  return content;
}

class PayloadTest : public ::testing::Test {
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

  TestFolder m_folder;
  SfxStreamParams m_params;
  const std::string m_content = SampleContent();
  const std::string m_payload = Gzip(m_content, 6, ZLIB_STREAM);
};

TEST_F(PayloadTest, StampHasItsPlacesAndIsReadBack) {
  unsigned char bytes[SFX_STAMP_SIZE];
  EncodeSfxStamp({0x01020304, 0xa0b0c0d0}, bytes);
  const std::string expected = "rSFX" + std::string(12, '\0') + Le32(0x01020304) + Le32(0xa0b0c0d0) + Le32(0);
  EXPECT_EQ(std::string(reinterpret_cast<char*>(bytes), sizeof bytes), expected);
  const std::string front(28, 'M'), zeros(28, '\0');
  const struct {
    std::string file;
    bool bStamped;
  } CASES[] = {{front + expected + "rest", true},
               {front + expected, true},
               {front + expected.substr(0, 27), false},
               {front + zeros, false},
               {expected + zeros, false},
               {"", false}};
  for (const auto& row : CASES) {
    m_folder.Write("exe", row.file);
    OsFile file;
    ASSERT_TRUE(file.bOpen(m_folder.Path("exe").c_str(), OsOpenMode::Read));
    SfxStamp stamp;
    ASSERT_EQ(bReadSfxStamp(file, stamp), row.bStamped);
    EXPECT_EQ(stamp.payloadOffset, row.bStamped ? 0x01020304u : 0u);
    EXPECT_EQ(stamp.payloadLength, row.bStamped ? 0xa0b0c0d0u : 0u);
  }
}

TEST_F(PayloadTest, ExpandsToTheLastByteWithinItsLength) {
  EXPECT_EQ(Expand("front" + m_payload + "behind", 5), 0);
  EXPECT_EQ(m_folder.Read("out"), m_content);
  EXPECT_EQ(m_params.total, m_content.size());
  EXPECT_EQ(Expand(Gzip("", 6, ZLIB_STREAM)), 0);
  EXPECT_EQ(m_params.total, 0u);
  const uint32_t size = static_cast<uint32_t>(m_payload.size());
  EXPECT_EQ(Expand(m_payload, 0, size), 0);
  EXPECT_NE(Expand(m_payload, 0, size - 1), 0);
  EXPECT_EQ(Expand(m_payload, 0, 0xffffffff), 0);
  EXPECT_NE(Expand(m_payload, size + 1000), 0) << "a place past the end";
}

TEST_F(PayloadTest, EveryTruncationAndEveryDamagedByteFails) {
  for (size_t n = 0; n < m_payload.size(); n += n < 64 ? 1 : 97) {
    EXPECT_NE(Expand(m_payload.substr(0, n)), 0) << n;
    std::string damaged = m_payload;
    damaged[n] = static_cast<char>(damaged[n] ^ 0x10);
    EXPECT_NE(Expand(damaged), 0) << n;
  }
}

TEST_F(PayloadTest, AnOutputThatCannotBeWrittenFails) {
  m_folder.Write("in", m_payload);
  OsFile in, closed;
  ASSERT_TRUE(in.bOpen(m_folder.Path("in").c_str(), OsOpenMode::Read));
  SfxStreamParams params;
  params.pInput = &in;
  EXPECT_NE(ExpandStream(params), 0);
  params.pOutput = &closed;
  EXPECT_NE(ExpandStream(params), 0);
  EXPECT_EQ(params.total, 0u);
}

}  // namespace
