#include "controls/ContainerKinds.h"
#include "foundation/ResultCodes.h"

namespace {

const FlagRow g_flags[] = {{"BORDER", STYLE_BORDER}};

}  // namespace

const SimpleKind g_CNFrame = {
    ControlKind::Frame,     "FRAME", "CNFrame", "FrameWizardClass", STYLE_CLIPCHILDREN, STYLE_TABSTOP,
    STYLE_EX_CONTROLPARENT, g_flags, 1};

int CNContainer::iReadScript(ScriptCursor& cursor, ScriptContext& context) {
  ReadLine(cursor, context);
  return EVERYTHING_IS_OK;
}
