#include "PeVersion.h"

#include <array>
#include <filesystem>

#include "PeBytes.h"

namespace {

const size_t MOST_BYTES = 0xfffc;  // the length of the whole is 16 bits
const uint32_t ENGLISH = 0x409, UNICODE_CODE_PAGE = 0x4b0;

std::u16string ToUtf16(const std::string& utf8) {
  std::u16string text;
  try {
    // The standard library converts paths, and nothing else, between these two.
    text = std::filesystem::path(std::u8string(utf8.begin(), utf8.end())).u16string();
  } catch (const std::exception&) {
    throw OrbitError("a text of the version is no UTF-8");
  }
  if (text.find(u'\0') != text.npos) throw OrbitError("a text of the version has a zero character");
  return text;
}

// The numbers that the text begins with. One that is too large, as in 20261121, ends them.
std::array<uint32_t, 4> Numbers(const std::string& version) {
  std::array<uint32_t, 4> numbers = {};
  size_t at = 0;
  for (uint32_t& number : numbers) {
    const size_t begin = at;
    uint32_t value = 0;
    for (; at < version.size() && version[at] >= '0' && version[at] <= '9' && value <= 0xffff; at++)
      value = value * 10 + static_cast<uint32_t>(version[at] - '0');
    if (at == begin || value > 0xffff) break;
    number = value;
    if (at == version.size() || version[at] != '.') break;
    at++;
  }
  return numbers;
}

// A block: length, length of the value, kind, key; the value and the blocks inside at multiples of 4. The length does
// not count what pads the next block.
class Block {
 public:
  Block(std::vector<uint8_t>& bytes, const std::u16string& key, bool bText, size_t valueLength) : m_bytes(bytes) {
    PadTo(m_bytes, 4);
    m_start = m_bytes.size();
    Append16(m_bytes, 0);
    Append16(m_bytes, static_cast<uint32_t>(valueLength));
    Append16(m_bytes, bText);
    AppendText(key);
    PadTo(m_bytes, 4);
  }
  ~Block() {
    if (m_start + 2 <= m_bytes.size()) Store16(m_bytes, m_start, static_cast<uint32_t>(m_bytes.size() - m_start));
  }
  Block(const Block&) = delete;
  Block& operator=(const Block&) = delete;

  void AppendText(const std::u16string& text) {
    for (const char16_t c : text) Append16(m_bytes, c);
    Append16(m_bytes, 0);
  }

 private:
  std::vector<uint8_t>& m_bytes;
  size_t m_start;
};

void AppendFixed(std::vector<uint8_t>& bytes, const std::array<uint32_t, 4>& numbers) {
  const uint32_t high = numbers[0] << 16 | numbers[1], low = numbers[2] << 16 | numbers[3];
  const uint32_t fields[] = {0xfeef04bd,          // signature
                             0x00010000,          // of this structure's version
                             high,       low,     // the file's
                             high,       low,     // the product's
                             0x3f,       0,       // flags: none of them is set
                             0x00040004, 1,   0,  // a program for Windows
                             0,          0};      // no date
  for (const uint32_t field : fields) Append32(bytes, field);
}
const size_t FIXED_SIZE = 13 * 4;

void AppendString(std::vector<uint8_t>& bytes, const char16_t* pKey, const std::string& utf8) {
  const std::u16string text = ToUtf16(utf8);
  if (text.empty()) return;
  if (bytes.size() + 2 * text.size() > MOST_BYTES) throw OrbitError("the texts of the version are too long");
  Block block(bytes, pKey, true, text.size() + 1);
  block.AppendText(text);
}

void AppendStrings(std::vector<uint8_t>& bytes, const PeVersionInfo& info) {
  const std::string& name = info.originalName;
  const size_t dot = name.rfind('.');
  Block strings(bytes, u"StringFileInfo", true, 0);
  Block table(bytes, u"040904B0", true, 0);  // ENGLISH, UNICODE_CODE_PAGE
  AppendString(bytes, u"CompanyName", info.publisher);
  AppendString(bytes, u"FileDescription", info.description.empty() ? info.product : info.description);
  AppendString(bytes, u"FileVersion", info.version);
  AppendString(bytes, u"InternalName", name.substr(0, dot));
  AppendString(bytes, u"LegalCopyright", info.copyright);
  AppendString(bytes, u"OriginalFilename", name);
  AppendString(bytes, u"ProductName", info.product);
  AppendString(bytes, u"ProductVersion", info.version);
}

}  // namespace

std::vector<uint8_t> EncodeVersion(const PeVersionInfo& info) {
  std::vector<uint8_t> bytes;
  {
    Block root(bytes, u"VS_VERSION_INFO", false, FIXED_SIZE);
    AppendFixed(bytes, Numbers(info.version));
    AppendStrings(bytes, info);
    Block languages(bytes, u"VarFileInfo", true, 0);
    Block translation(bytes, u"Translation", false, 4);
    Append16(bytes, ENGLISH);
    Append16(bytes, UNICODE_CODE_PAGE);
  }
  if (bytes.size() > MOST_BYTES) throw OrbitError("the texts of the version are too long");
  return bytes;
}
