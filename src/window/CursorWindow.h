// The mouse cursor over a dialog and its controls.
#pragma once

#include "window/ShownDialog.h"

// Sets the cursor that the script wants over a window of the dialog, or over the dialog itself: the one of a CURSOR
// line with the control's name, the hand over a link, the one of a nameless CURSOR line (over all but fields). False
// when the window has its usual one.
bool bSetScriptCursor(const ShownDialog& dialog, HWND hOver);
