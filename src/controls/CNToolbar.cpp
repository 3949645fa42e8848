#include "controls/MenuKinds.h"

namespace {

const ItemWord g_words[] = {{"ITEM"}, {"SEPARATOR"}, {"COMBO"}};

}  // namespace

CNToolbar::CNToolbar() : CNItemControl(ControlKind::Toolbar, g_words, "END_TOOLBAR") {}
