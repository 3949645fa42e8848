// The fonts of one dialog: its own and the variants that its controls ask for, each made on first demand.
#pragma once

#include "controls/DialogInfo.h"
#include "window/Handles.h"

class DialogFonts {
 public:
  // The description must outlive the fonts.
  DialogFonts(const DialogFont& font, double dScale) : m_Font(font), m_dScale(dScale) {}
  // Never null: a font that cannot be made is logged and the system's takes its place. Owned by this object.
  HFONT hGet(FontVariant variant);

 private:
  static const int VARIANTS = 5;

  LOGFONTW Describe(FontVariant variant) const;

  const DialogFont& m_Font;
  const double m_dScale;  // of the dialog's numbers
  OwnedFont m_Fonts[VARIANTS];
};
