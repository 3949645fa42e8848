#include "foundation/Text.h"

#include <cstdint>
#include <cstdlib>
#include <cstring>

namespace {

// The characters of bytes 0x80 to 0xFF. The five bytes without a character stand for their C1 control code, so that
// every text survives the way out and back.
const char16_t CP1250_UPPER_HALF[] = {
    0x20AC, 0x0081, 0x201A, 0x0083, 0x201E, 0x2026, 0x2020, 0x2021, 0x0088, 0x2030, 0x0160, 0x2039, 0x015A,
    0x0164, 0x017D, 0x0179, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014, 0x0098, 0x2122,
    0x0161, 0x203A, 0x015B, 0x0165, 0x017E, 0x017A, 0x00A0, 0x02C7, 0x02D8, 0x0141, 0x00A4, 0x0104, 0x00A6,
    0x00A7, 0x00A8, 0x00A9, 0x015E, 0x00AB, 0x00AC, 0x00AD, 0x00AE, 0x017B, 0x00B0, 0x00B1, 0x02DB, 0x0142,
    0x00B4, 0x00B5, 0x00B6, 0x00B7, 0x00B8, 0x0105, 0x015F, 0x00BB, 0x013D, 0x02DD, 0x013E, 0x017C, 0x0154,
    0x00C1, 0x00C2, 0x0102, 0x00C4, 0x0139, 0x0106, 0x00C7, 0x010C, 0x00C9, 0x0118, 0x00CB, 0x011A, 0x00CD,
    0x00CE, 0x010E, 0x0110, 0x0143, 0x0147, 0x00D3, 0x00D4, 0x0150, 0x00D6, 0x00D7, 0x0158, 0x016E, 0x00DA,
    0x0170, 0x00DC, 0x00DD, 0x0162, 0x00DF, 0x0155, 0x00E1, 0x00E2, 0x0103, 0x00E4, 0x013A, 0x0107, 0x00E7,
    0x010D, 0x00E9, 0x0119, 0x00EB, 0x011B, 0x00ED, 0x00EE, 0x010F, 0x0111, 0x0144, 0x0148, 0x00F3, 0x00F4,
    0x0151, 0x00F6, 0x00F7, 0x0159, 0x016F, 0x00FA, 0x0171, 0x00FC, 0x00FD, 0x0163, 0x02D9};
static_assert(sizeof CP1250_UPPER_HALF == 128 * sizeof(char16_t));

char16_t ToUnicode(unsigned char c) { return c < 0x80 ? char16_t(c) : CP1250_UPPER_HALF[c - 0x80]; }

// The byte of a character, or -1.
int iFromUnicode(uint32_t character) {
  if (character < 0x80) return int(character);
  for (int i = 0; i < 128; i++)
    if (CP1250_UPPER_HALF[i] == character) return 0x80 + i;
  return -1;
}

// Fills a text that can only shrink: at most one byte for each unit of the input.
class Narrowing {
 public:
  Narrowing(CNString& csOut, size_t nMaxLength) : m_csOut(csOut) {
    m_csOut = "";
    m_pBytes = m_csOut.SetLength(long(nMaxLength));
    if (!m_pBytes) m_bComplete = false;
  }
  void Put(uint32_t character) {
    const int iByte = iFromUnicode(character);
    if (iByte < 0) m_bComplete = false;
    if (m_pBytes) m_pBytes[m_lLength++] = char(iByte < 0 ? '?' : iByte);
  }
  bool bFinish() {
    if (m_pBytes) m_csOut.SetLength(m_lLength);
    return m_bComplete;
  }

 private:
  CNString& m_csOut;
  char* m_pBytes = nullptr;
  long m_lLength = 0;
  bool m_bComplete = true;
};

const uint32_t MALFORMED = 0xFFFFFFFF;

// Sequences by their first byte: its fixed bits, the bytes that follow, and the smallest character that needs so many.
struct Utf8Length {
  unsigned char mask, lead;
  int nFollowing;
  uint32_t smallest;
};
const Utf8Length UTF8_LENGTHS[] = {
    {0x80, 0x00, 0, 0}, {0xE0, 0xC0, 1, 0x80}, {0xF0, 0xE0, 2, 0x800}, {0xF8, 0xF0, 3, 0x10000}};

// Takes one character; a malformed one costs its first byte and the bytes that seemed to continue it.
uint32_t NextUtf8(const unsigned char*& p) {
  const unsigned char cFirst = *p++;
  for (const Utf8Length& row : UTF8_LENGTHS) {
    if ((cFirst & row.mask) != row.lead) continue;
    uint32_t character = cFirst & static_cast<unsigned char>(~row.mask);
    for (int i = 0; i < row.nFollowing; i++) {
      if ((*p & 0xC0) != 0x80) return MALFORMED;
      character = character << 6 | (*p++ & 0x3F);
    }
    const bool bSurrogate = character >= 0xD800 && character < 0xE000;
    return character < row.smallest || bSurrogate ? MALFORMED : character;
  }
  return MALFORMED;
}

bool bHighSurrogate(char16_t unit) { return (unit & 0xFC00) == 0xD800; }
bool bLowSurrogate(char16_t unit) { return (unit & 0xFC00) == 0xDC00; }

}  // namespace

CNWideText::CNWideText(const char* szText) {
  if (!szText) return;
  const size_t nLength = std::strlen(szText);
  m_pText = static_cast<char16_t*>(std::malloc((nLength + 1) * sizeof(char16_t)));
  for (size_t i = 0; m_pText && i <= nLength; i++) m_pText[i] = ToUnicode(static_cast<unsigned char>(szText[i]));
}

CNWideText::~CNWideText() { std::free(m_pText); }

bool bUtf16ToCp1250(const char16_t* pText, CNString& csOut) {
  size_t nLength = 0;
  while (pText && pText[nLength]) nLength++;
  Narrowing out(csOut, nLength);
  for (size_t i = 0; i < nLength; i++) {
    out.Put(pText[i]);
    if (bHighSurrogate(pText[i]) && bLowSurrogate(pText[i + 1])) i++;  // a pair is one character
  }
  return out.bFinish();
}

bool bUtf8ToCp1250(const char* szText, CNString& csOut) {
  const CNString csInput(szText, 0);  // a copy: csOut may own szText
  Narrowing out(csOut, size_t(csInput.Length()));
  for (const unsigned char* p = reinterpret_cast<const unsigned char*>(csInput.Text()); *p;) out.Put(NextUtf8(p));
  return out.bFinish();
}

void Cp1250ToUtf8(const char* szText, CNString& csOut) {
  const CNString csInput(szText, 0);
  csOut = "";
  char* pOut = csOut.SetLength(csInput.Length() * 3);
  if (!pOut) return;
  char* const pStart = pOut;
  for (const char* p = csInput.Text(); *p; p++) {
    const unsigned character = ToUnicode(static_cast<unsigned char>(*p));
    if (character < 0x80) {
      *pOut++ = char(character);
    } else if (character < 0x800) {
      *pOut++ = char(0xC0 | character >> 6);
      *pOut++ = char(0x80 | (character & 0x3F));
    } else {
      *pOut++ = char(0xE0 | character >> 12);
      *pOut++ = char(0x80 | (character >> 6 & 0x3F));
      *pOut++ = char(0x80 | (character & 0x3F));
    }
  }
  csOut.SetLength(long(pOut - pStart));
}
