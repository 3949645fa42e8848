// What the flags that all kinds share mean, and the control's line written back.
#include <algorithm>
#include <cstring>
#include <iterator>

#include "controls/BaseControl.h"
#include "controls/ScriptText.h"
#include "foundation/Log.h"
#include "foundation/ResultCodes.h"

using namespace ScriptText;

namespace {

const FlagRow g_sharedFlags[] = {
    {"HIDE", STYLE_VISIBLE, FlagEffect::Toggle},
    {"DISABLE", STYLE_DISABLED},
};

// The first one found wins, so that BIGBOLD is not taken for BOLD.
struct FontRow {
  const char* szWord;
  FontVariant font;
};
const FontRow g_fonts[] = {
    {"ITALIC", FontVariant::Italic},
    {"UNDERLINE", FontVariant::Underline},
    {"BIGBOLD", FontVariant::BigBold},
    {"BOLD", FontVariant::Bold},
};

// All are tested; the last one found wins.
struct AlignRow {
  const char* szWord;
  ControlAlign align;
};
const AlignRow g_aligns[] = {
    {"ALIGN_RIGHT", ControlAlign::Right},
    {"ALIGN_LEFT", ControlAlign::Left},
    {"ALIGN_TOP", ControlAlign::Top},
    {"ALIGN_BOTTOM", ControlAlign::Bottom},
};

// A number with an optional sign, blanks around it passed over. False without a digit.
bool bReadSigned(const char*& p, const char* pEnd, int& iNumber) {
  p = SkipBlanks(p, pEnd);
  const bool bNegative = p < pEnd && *p == '-';
  if (bNegative) p++;
  if (p == pEnd || !bIsDigit(*p)) return false;
  iNumber = iReadNumber(p, pEnd);
  if (bNegative) iNumber = -iNumber;
  p = SkipBlanks(p, pEnd);
  return true;
}

bool bReadCharacter(const char*& p, const char* pEnd, char c) {
  if (p == pEnd || *p != c) return false;
  p++;
  return true;
}

}  // namespace

bool bReadColor(const char* pText, const char* pEnd, ControlColor& color) {
  while (pText < pEnd && *pText != '(' && *pText != ',') pText++;
  int iPart[3] = {};
  for (int i = 0; i < 3; i++)
    if (!bReadCharacter(pText, pEnd, i == 0 ? '(' : ',') || !bReadSigned(pText, pEnd, iPart[i])) return false;
  if (!bReadCharacter(pText, pEnd, ')')) return false;

  if (std::any_of(iPart, iPart + 3, [](int i) { return i < 0 || i > 255; }))
    LogPrintf("ERROR: color out of range : red=%d, green=%d, blue=%d", iPart[0], iPart[1], iPart[2]);
  // Deliberately wrapped, neither refused nor limited.
  color = {true, uint8_t(iPart[0]), uint8_t(iPart[1]), uint8_t(iPart[2])};
  return true;
}

bool BaseControl::bHasFlag(const char* szWord) const { return std::strstr(m_csFlags.Text(), szWord) != nullptr; }

void BaseControl::ApplyFlag(const FlagRow& row) {
  if (!bHasFlag(row.szWord)) return;
  m_dwStyle = row.effect == FlagEffect::Toggle ? m_dwStyle ^ row.dwStyle : m_dwStyle | row.dwStyle;
}

ControlColor BaseControl::FlagColor(const char* szWord) const {
  const char* pEnd = m_csFlags.Text() + m_csFlags.Length();
  const char* pWord = FindWord(m_csFlags.Text(), pEnd, szWord);
  ControlColor color;
  if (pWord) bReadColor(pWord + std::strlen(szWord), pEnd, color);
  return color;
}

void BaseControl::ReadSharedFlags() {
  ApplyFlags(g_sharedFlags);
  m_bFocus = bHasFlag("FOCUS");
  m_Background = FlagColor("BACKGROUND");
  m_TextColor = FlagColor("TEXT_COLOR");
  for (const FontRow& row : g_fonts) {
    if (!bHasFlag(row.szWord)) continue;
    m_Font = row.font;
    break;
  }
  for (const AlignRow& row : g_aligns)
    if (bHasFlag(row.szWord)) m_Align = row.align;
  ReadMargins();
}

bool BaseControl::bReadMargin(const char* szWord, int& iMargin) const {
  const char* pEnd = m_csFlags.Text() + m_csFlags.Length();
  const char* p = FindWord(m_csFlags.Text(), pEnd, szWord);
  if (!p) return false;
  p += std::strlen(szWord);
  return bReadCharacter(p, pEnd, '(') && bReadSigned(p, pEnd, iMargin);
}

void BaseControl::ReadMargins() {
  int iMargin = 0;
  if (!bHasFlag("MARGIN_")) {
    if (bReadMargin("MARGIN", iMargin)) m_Margins = {iMargin, 2 * iMargin, iMargin, 2 * iMargin};
    return;
  }
  m_Margins = {};
  if (bReadMargin("MARGIN_LEFT", iMargin)) m_Margins.iLeft = m_Margins.iHorizontal = iMargin;
  if (bReadMargin("MARGIN_RIGHT", iMargin)) m_Margins.iHorizontal += iMargin;
  if (bReadMargin("MARGIN_TOP", iMargin)) m_Margins.iTop = m_Margins.iVertical = iMargin;
  if (bReadMargin("MARGIN_BOTTOM", iMargin)) m_Margins.iVertical += iMargin;
}

void BaseControl::Scale(double dFactor) {
  if (dFactor <= 1.0 || m_bScaled || bHasFlag("NO_LOGPIXELS")) return;
  for (int& iNumber : m_iSize) iNumber = iScaleSize(iNumber, dFactor);
  m_dScale = dFactor;
  m_bScaled = true;
}

int BaseControl::Resize(const int* size, double dScale) {
  if (!size) return iLogReturn(PRECONDITIONS_NOT_VALID, "ERROR: BaseControl::Resize -> !size");
  std::copy_n(size, std::size(m_iSize), m_iSize);
  Scale(dScale);
  return EVERYTHING_IS_OK;
}

// The only number that scales to iPixels: every factor that is applied is greater than 1.
int BaseControl::iUnscaled(int iPixels) const {
  if (!m_bScaled) return iPixels;
  int iNumber = int(iPixels / m_dScale);
  while (iScaleSize(iNumber, m_dScale) < iPixels) iNumber++;
  return iNumber;
}

void BaseControl::WriteSize(CNString& csOut) const {
  int nNumbers = 8;
  while (nNumbers > 4 && m_iSize[nNumbers - 1] == 0) nNumbers--;
  CNString csNumber;
  for (int i = 0; i < nNumbers; i++)
    csOut.Concat(csNumber.Printf("BaseControl::WriteSize", "csNumber", " %d", iUnscaled(m_iSize[i])));
}

int BaseControl::iWriteControlCaption(CNString& csOut) const {
  // An empty caption is written only where another quote could be taken for it.
  if (m_csCaption.bEmpty() && !std::strchr(m_csFlags.Text(), '"')) return EVERYTHING_IS_OK;
  csOut.Concat(" \"");
  AppendEscaped(csOut, m_csCaption.Text(), size_t(m_csCaption.Length()));
  csOut.Concat("\"");
  return EVERYTHING_IS_OK;
}

void BaseControl::WriteControl(CNString& csOut) const {
  csOut.Concat(szKeyword());
  const long lStart = csOut.Length();
  if (m_csName.Ptr()) {
    csOut.Concat(" '");
    csOut.Concat(m_csName.Ptr());
    csOut.Concat("'");
  }
  WriteText(csOut);
  if (m_csToolTip.Ptr()) {
    csOut.Concat(" TOOLTIP '");
    csOut.Concat(m_csToolTip.Ptr());
    csOut.Concat("'");
  }
  WriteOwnWords(csOut);
  // A flag that begins with a digit would be taken for the size.
  if (bWritesSize() || bIsDigit(*m_csFlags.Text())) WriteSize(csOut);
  if (!m_csFlags.bEmpty()) {
    // An apostrophe behind the line's first blank would begin a name.
    csOut.Concat(csOut.Length() == lStart ? " ," : ",");
    csOut.Concat(m_csFlags.Ptr());
  }
  if (m_csAction.Ptr()) {
    csOut.Concat(" ACTION:");
    csOut.Concat(m_csAction.Ptr());
  }
}
