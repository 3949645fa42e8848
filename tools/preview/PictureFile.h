// Pictures of windows as they are on the screen.
#pragma once

#include <string>

#include "window/Handles.h"

// Writes what the screen shows of a window, frame included, as a PNG file (UTF-8 path). False when it cannot.
bool bWritePicture(HWND hWnd, const std::string& path);
