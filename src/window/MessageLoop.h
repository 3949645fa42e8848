// The message loop of one wizard. Loops nest: that of an owned wizard runs inside its owner's.
#pragma once

#include <atomic>

#include "window/Handles.h"

// Handles the messages of all windows of this thread until hWindow becomes null. Dialog keys (Tab, Enter, Escape, the
// arrows, mnemonics) go to the wizard whose window has the message.
void RunMessageLoop(const std::atomic<HWND>& hWindow);
