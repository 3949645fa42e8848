#include "window/Fonts.h"

#include "foundation/os/OsWide.h"

namespace {

struct VariantRow {
  FontVariant variant;
  void (*pApply)(LOGFONTW& font);
};

void MakeBigBold(LOGFONTW& font) {
  font.lfWeight = FW_BOLD;
  font.lfHeight += font.lfHeight / 3;
}

const VariantRow VARIANT_ROWS[] = {
    {FontVariant::Italic, [](LOGFONTW& font) { font.lfItalic = TRUE; }},
    {FontVariant::Underline, [](LOGFONTW& font) { font.lfUnderline = TRUE; }},
    {FontVariant::BigBold, MakeBigBold},
    {FontVariant::Bold, [](LOGFONTW& font) { font.lfWeight = FW_BOLD; }},
};

int CALLBACK StopAtFirst(const LOGFONTW*, const TEXTMETRICW*, DWORD, LPARAM pFound) {
  *reinterpret_cast<bool*>(pFound) = true;
  return 0;
}

// A face without the character set would be replaced by another face; it is then better asked for with its own set.
bool bFaceHasCharSet(const LOGFONTW& font) {
  bool bFound = false;
  LOGFONTW wanted = font;
  ScreenDC screen;
  EnumFontFamiliesExW(screen.Get(), &wanted, StopAtFirst, reinterpret_cast<LPARAM>(&bFound), 0);
  return bFound;
}

}  // namespace

LOGFONTW DialogFonts::Describe(FontVariant variant) const {
  LOGFONTW font = {};
  GetObjectW(GetStockObject(DEFAULT_GUI_FONT), sizeof(font), &font);
  // A positive height is that of the character cell: two lines of height 15 fill a text field of height 30.
  if (m_Font.iHeight) font.lfHeight = static_cast<LONG>(m_Font.iHeight * m_dScale);
  if (m_Font.iWeight) font.lfWeight = m_Font.iWeight;
  if (!m_Font.csFace.bEmpty()) lstrcpynW(font.lfFaceName, Wide(m_Font.csFace.Text()), LF_FACESIZE);
  font.lfCharSet = static_cast<BYTE>(m_Font.iCharSet);
  if (!bFaceHasCharSet(font)) font.lfCharSet = DEFAULT_CHARSET;
  for (const VariantRow& row : VARIANT_ROWS)
    if (row.variant == variant) row.pApply(font);
  return font;
}

HFONT DialogFonts::hGet(FontVariant variant) {
  OwnedFont& slot = m_Fonts[static_cast<int>(variant)];
  if (!slot) {
    const LOGFONTW font = Describe(variant);
    slot.Reset(CreateFontIndirectW(&font));
    if (!slot) LogPrintf("ERROR : DialogInfo::iCreateFonts-> m_Font.iCreate ->return EVERYTHING_IS_OK;");
  }
  return slot ? slot.Get() : static_cast<HFONT>(GetStockObject(DEFAULT_GUI_FONT));
}
