// Mouse and keyboard input as the system delivers it from the devices: it goes to whatever window is in front.
#pragma once

#include <windows.h>

#include <string>

// Moves the mouse to the middle of the control and clicks the left button. Returns an empty text, or why a person could
// not have done that: the control is hidden, disabled, or something lies over it.
std::string Click(HWND hControl);

// Clicks into the control, selects what it holds and types the text over it.
std::string TypeInto(HWND hControl, const std::wstring& wsText);

// Presses and releases a key by its name ("Enter", "Escape", "Tab", "Space", "F4", a letter), with "Alt+", "Ctrl+" or
// "Shift+" before it held down. The window must be in front.
std::string PressKey(HWND hWindow, const std::wstring& wsKey);

// Moves the mouse into the lower right corner, where it covers nothing that a picture is to show.
void ParkMouse();
