// Texts that stand for the box to their left.
#pragma once

#include "window/Handles.h"

// The property by which such a text and its box know each other's window.
const wchar_t* const LABEL_PARTNER = L"OrbitPartner";
// Has the text drawn with the focus around it while the box has the keyboard.
void ShowFocusOf(HWND hBox, HWND hText);
