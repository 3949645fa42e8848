// Keys that the script gives commands to.
#pragma once

#include "controls/MenuKinds.h"
#include "window/Handles.h"

// The key that the message presses, with the keys that are held down with it. False when it presses none that a script
// can name, or only one of those that are held.
bool bPressedKey(const MSG& message, KeyChord& chord);
