// The message loop of one wizard. Loops nest: that of an owned wizard runs inside its owner's.
#pragma once

class CNWindowView;

// Handles the messages of all windows of this thread until the view has no window. Dialog keys (Tab, Enter, Escape, the
// arrows, mnemonics) go to the wizard whose window has the message.
void RunMessageLoop(CNWindowView& view);
