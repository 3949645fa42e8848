#include "controls/ContainerKinds.h"

namespace {

const FlagRow g_flags[] = {{"BORDER", STYLE_BORDER}};

}  // namespace

const SimpleKind g_CNSplitter = {ControlKind::Splitter, "SPLITTER", "CNSplitter", "SizerClass", 0, 0, 0, g_flags, 1};
