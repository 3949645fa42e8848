#include "controls/SimpleKinds.h"

// The caption is the first key, as "A" or "Ctrl+F5". The words CTRL, SHIFT and ALT, before the size or among the flags,
// add their keys to it; NONE says that there is none.
const SimpleKind g_CNHotKey = {.kind = ControlKind::Hotkey,
                               .szKeyword = "HOTKEY",
                               .szClassName = "CNHotKey",
                               .szWindowClass = "msctls_hotkey32",
                               .dwExStyle = STYLE_EX_CLIENTEDGE};
