// Where a dialog's window goes, and with which styles.
#pragma once

#include "controls/DialogInfo.h"
#include "window/Handles.h"

// The window's outer rectangle. pPresent is the window as the previous dialog left it, null when there was none;
// workArea the part of the primary screen that the task bar leaves free. A dialog with INHERIT_POSITION stays where
// the window is, one with CENTER comes to the middle; when both are given the first dialog is centred.
RECT PlaceDialog(const DialogInfo& dialog, const RECT* pPresent, const RECT& workArea);
// The style of the wizard's top-level window for this dialog, without WS_VISIBLE.
DWORD TopLevelStyle(const DialogInfo& dialog);
