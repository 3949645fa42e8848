#include <iterator>

#include "controls/SimpleKinds.h"

namespace {

const FlagRow g_flags[] = {
    {"READ_ONLY", STYLE_ES_READONLY},      {"V_SCROLL", STYLE_VSCROLL},
    {"H_SCROLL", STYLE_HSCROLL},           {"CENTER", STYLE_ES_CENTER},
    {"AUTOVSCROLL", STYLE_ES_AUTOVSCROLL}, {"AUTOHSCROLL", STYLE_ES_AUTOHSCROLL},
    {"MULTILINE", STYLE_ES_MULTILINE},     {"FLAT", STYLE_BORDER},
};

}  // namespace

const SimpleKind g_CNRtf = {.kind = ControlKind::RichEdit,
                            .szKeyword = "RICH_EDIT",
                            .szClassName = "CNRtf",
                            .szWindowClass = "RichEdit20A",
                            .pFlags = g_flags,
                            .nFlags = std::size(g_flags)};

bool CNRtf::bIsFile() const {
  CNString csLower(m_csCaption);
  return !csLower.bEmpty() && csLower.MakeLower() && csLower.EndsWith(".rtf");
}

void CNRtf::ReadOwnFlags(ScriptContext& context) {
  CNSimpleControl::ReadOwnFlags(context);
  if (!bHasFlag("FLAT")) m_dwExStyle |= STYLE_EX_CLIENTEDGE;
  // A document has more than one line; one line takes a text longer than the field.
  if (bIsFile()) m_dwStyle |= STYLE_ES_MULTILINE;
  if (!(m_dwStyle & STYLE_ES_MULTILINE)) m_dwStyle |= STYLE_ES_AUTOHSCROLL;
}
