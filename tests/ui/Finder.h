// Finds the windows and controls of other programs by what a person sees of them.
#pragma once

#include <windows.h>

#include <string>
#include <vector>

// All visible top-level windows of the thread's desktop, the topmost first; the desktop's own windows are left out.
std::vector<HWND> TopLevelWindows();

// The topmost visible window whose caption begins with wsCaption, blanks around both ignored; null when there is none.
HWND hFindWindow(const std::wstring& wsCaption);

// A window's controls at every depth, in their own order.
std::vector<HWND> Controls(HWND hWindow);

// A control by its text ("Next >": whole, without mnemonic marks), its identifier ("#101") or its class and place among
// the visible controls of that class ("Edit:0"). Visible controls come first. Null when there is none.
HWND hFindControl(HWND hWindow, const std::wstring& wsControl);

// The text that the window itself reports, whichever program owns it; empty after two seconds without an answer.
std::wstring WindowText(HWND hWindow);
std::wstring ClassOf(HWND hWindow);
std::wstring Trimmed(const std::wstring& wsText);

// The control that has the keyboard in the window's thread, or null.
HWND hFocusOf(HWND hWindow);
