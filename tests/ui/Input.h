// Mouse and keyboard input: to whatever window is in front, as the devices deliver it; to a button, its own messages.
#pragma once

#include <windows.h>

#include <string>

// Clicks the middle of the control with the left mouse button. Returns an empty text, or why a person could
// not have done that: the control is hidden, disabled, or something lies over it.
std::string Click(HWND hControl);

// Clicks into the control, selects what it holds and types the text over it.
std::string TypeInto(HWND hControl, const std::wstring& wsText);

// Presses and releases a key by its name ("Enter", "Escape", "Tab", "Space", "F4", a letter), with "Alt+", "Ctrl+" or
// "Shift+" before it held down. The window must be in front.
std::string PressKey(HWND hWindow, const std::wstring& wsKey);

// Moves the mouse into the lower right corner, where it covers nothing that a picture is to show.
void ParkMouse();
