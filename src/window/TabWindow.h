// The keys of tab controls.
#pragma once

#include "window/ShownDialog.h"

// Ctrl+Tab, Ctrl+Shift+Tab, Ctrl+Page Down and Ctrl+Page Up turn the pages of the tab control that the keyboard is in,
// or on. True when they did: the dialog may be gone then.
bool bTurnPage(const ShownDialog& dialog, const MSG& message);
