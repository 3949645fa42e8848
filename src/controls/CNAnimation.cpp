#include <iterator>

#include "controls/SimpleKinds.h"

namespace {

const FlagRow g_flags[] = {
    {"TRANSPARENT", STYLE_ACS_TRANSPARENT},
    {"BORDER", STYLE_BORDER},
};

}  // namespace

// The source is the clip: IDA_... is a resource of the program, anything else a file in the folder pict.
const SimpleKind g_CNAnimation = {.kind = ControlKind::Animation,
                                  .szKeyword = "ANIMATION",
                                  .szClassName = "CNAnimation",
                                  .szWindowClass = "SysAnimate32",
                                  .dwRemovedStyle = STYLE_TABSTOP,
                                  .pFlags = g_flags,
                                  .nFlags = std::size(g_flags)};
