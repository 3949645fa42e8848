#include <iterator>

#include "controls/SimpleKinds.h"

namespace {

const FlagRow g_flags[] = {
    {"VERTICAL", STYLE_PGS_HORIZONTAL, FlagEffect::Toggle},
};

}  // namespace

// The caption names the control of the dialog that the pager scrolls.
const SimpleKind g_CNPager = {.kind = ControlKind::Pager,
                              .szKeyword = "PAGER",
                              .szClassName = "CNPager",
                              .szWindowClass = "SysPager",
                              .dwStyle = STYLE_PGS_HORIZONTAL,
                              .dwRemovedStyle = STYLE_TABSTOP,
                              .pFlags = g_flags,
                              .nFlags = std::size(g_flags)};
