#include <iterator>

#include "controls/SimpleKinds.h"

namespace {

const FlagRow g_flags[] = {
    {"TIME", STYLE_DTS_TIMEFORMAT},
};

}  // namespace

// The caption is the first value, as "2026-11-21" or "14:05:00"; without one it is now.
const SimpleKind g_CNDateTime = {.kind = ControlKind::DatePicker,
                                 .szKeyword = "DATE_PICKER",
                                 .szClassName = "CNDateTime",
                                 .szWindowClass = "SysDateTimePick32",
                                 .pFlags = g_flags,
                                 .nFlags = std::size(g_flags)};
