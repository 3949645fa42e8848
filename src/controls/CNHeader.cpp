#include "controls/ItemKinds.h"

namespace {

const FlagRow g_flags[] = {{"BUTTONS", STYLE_HDS_BUTTONS}};

}  // namespace

void CNHeader::ReadOwnFlags(ScriptContext&) {
  m_dwStyle &= ~STYLE_TABSTOP;
  ApplyFlags(g_flags);
}
