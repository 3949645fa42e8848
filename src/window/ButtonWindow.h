// What the dialog needs to know about push buttons besides their table row.
#pragma once

#include "window/Handles.h"

// Draws the button as the one that Enter presses, or as any other. hButton may be null.
void ShowDefaultLook(HWND hButton, bool bDefault);
