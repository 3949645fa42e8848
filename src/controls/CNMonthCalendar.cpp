#include <iterator>

#include "controls/SimpleKinds.h"

namespace {

const FlagRow g_flags[] = {
    {"MULTISELECT", STYLE_MCS_MULTISELECT},
    {"WEEKNUMBERS", STYLE_MCS_WEEKNUMBERS},
};

}  // namespace

// The caption is the first value, as "2026-11-21" or, with MULTISELECT, "2026-11-21..2026-11-24".
const SimpleKind g_CNMonthCalendar = {.kind = ControlKind::MonthCalendar,
                                      .szKeyword = "MONTHCALENDAR",
                                      .szClassName = "CNMonthCalendar",
                                      .szWindowClass = "SysMonthCal32",
                                      .pFlags = g_flags,
                                      .nFlags = std::size(g_flags)};
