#include "controls/MenuKinds.h"

namespace {

const ItemWord g_words[] = {
    {"TOOLBAR", ItemLevel::Opens}, {"END_TOOLBAR", ItemLevel::Closes}, {"BAND"}, {"ITEM"}, {"SEPARATOR"}, {"COMBO"}};

}  // namespace

CNRebar::CNRebar() : CNItemControl(ControlKind::Rebar, g_words, "END_REBAR") {}

void CNRebar::ItemsRead(const ScriptCursor& cursor, ScriptContext& context) { ReportOpenBlock(*this, cursor, context); }
