#include "controls/Kinds.h"

namespace {

const FlagRow g_flags[] = {
    {"VERTICAL", STYLE_PBS_VERTICAL},
    {"SMOOTH", STYLE_PBS_SMOOTH},
};

}  // namespace

void CNProgressBar::ReadOwnFlags(ScriptContext&) {
  ApplyFlags(g_flags);
  m_dwStyle &= ~STYLE_TABSTOP;
}
