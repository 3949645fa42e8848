#include "controls/Kinds.h"

namespace {

const FlagRow g_flags[] = {
    {"MULTILINE", STYLE_BS_MULTILINE},
};

}  // namespace

void CNCheckBox::ReadOwnFlags(ScriptContext&) {
  m_bRadio = bHasFlag("RADIO_BUTTON");
  m_dwStyle |= m_bRadio ? STYLE_BS_AUTORADIOBUTTON : STYLE_BS_AUTOCHECKBOX;
  ApplyFlags(g_flags);
}
