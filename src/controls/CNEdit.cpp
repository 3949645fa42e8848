#include "controls/Kinds.h"

namespace {

const FlagRow g_flags[] = {
    {"READ_ONLY", STYLE_ES_READONLY},
    {"V_SCROLL", STYLE_VSCROLL},
    {"AUTOVSCROLL", STYLE_ES_AUTOVSCROLL},
    {"MULTILINE", STYLE_ES_MULTILINE},
};

}  // namespace

void CNEdit::ReadOwnFlags(ScriptContext&) {
  ApplyFlags(g_flags);
  m_bGray = bHasFlag("GRAY");
  m_dwExStyle |= STYLE_EX_CLIENTEDGE;
  // One line takes a text longer than the field; several lines wrap instead.
  if (!(m_dwStyle & STYLE_ES_MULTILINE)) m_dwStyle |= STYLE_ES_AUTOHSCROLL;
}
