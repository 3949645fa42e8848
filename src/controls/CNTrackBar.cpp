#include <iterator>

#include "controls/SimpleKinds.h"

namespace {

const FlagRow g_flags[] = {
    {"VERTICAL", STYLE_TBS_VERTICAL},
    {"TICK", STYLE_TBS_AUTOTICKS},  // NO_TICK counts as TICK, which then shows nothing
    {"NO_TICK", STYLE_TBS_NOTICKS},
};

}  // namespace

// The range is "low high", in quotes or parentheses.
const SimpleKind g_CNTrackBar = {.kind = ControlKind::Trackbar,
                                 .szKeyword = "TRACKBAR",
                                 .szClassName = "CNTrackBar",
                                 .szWindowClass = "msctls_trackbar32",
                                 .pFlags = g_flags,
                                 .nFlags = std::size(g_flags)};
