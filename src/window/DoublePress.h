// A double click that has turned the page with its first press must not press what then lies under the mouse.
#pragma once

#include "window/Handles.h"

class DoublePress {
 public:
  // To be shown every message before it is dispatched. True for the second press of a double click, by the system's
  // time and distance, when what took the first one has gone or is covered by a wizard within the wizard: it is to be
  // dropped. Keys, presses elsewhere and those that follow are never dropped.
  bool bDrops(const MSG& message);

 private:
  HWND m_hFirst = nullptr;  // what took the last press, unless that was a second one
  POINT m_at = {};          // on the screen
  DWORD m_uTime = 0;
};
