#include "controls/Kinds.h"

namespace {

const FlagRow g_flags[] = {
    {"ALEFT", STYLE_SS_LEFT}, {"ARIGHT", STYLE_SS_RIGHT}, {"ACENTER", STYLE_SS_CENTER},
    {"FRAME", STYLE_BORDER},  {"LINK", STYLE_SS_NOTIFY},
};

}  // namespace

void CNStatic::ReadOwnFlags(ScriptContext&) {
  ApplyFlags(g_flags);
  m_bLink = bHasFlag("LINK");
  m_bFrame = bHasFlag("FRAME");
  // The Tab key stops at what a person can press.
  if (!m_bLink) m_dwStyle &= ~STYLE_TABSTOP;
}
