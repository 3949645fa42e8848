#include <iterator>

#include "controls/SimpleKinds.h"

namespace {

const FlagRow g_flags[] = {
    {"ALIGNRIGHT", STYLE_UDS_ALIGNRIGHT},
    {"ALIGNLEFT", STYLE_UDS_ALIGNLEFT},
    {"HORIZONTAL", STYLE_UDS_HORIZONTAL},
};

}  // namespace

// The words before the size are "(low,high,first value)". The arrows belong to the field on the line before.
const SimpleKind g_CNUpDown = {.kind = ControlKind::UpDown,
                               .szKeyword = "UP_DOWN",
                               .szClassName = "CNUpDown",
                               .szWindowClass = "msctls_updown32",
                               .dwStyle = STYLE_UDS_SETBUDDYINT | STYLE_UDS_ARROWKEYS | STYLE_UDS_NOTHOUSANDS,
                               .dwRemovedStyle = STYLE_TABSTOP,
                               .pFlags = g_flags,
                               .nFlags = std::size(g_flags)};
