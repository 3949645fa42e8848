// What the system's own controls leave behind: Wine's calendars lose the font of each WM_SETFONT, its fields for IP
// addresses one font each.
#pragma once

#include "support/HighestHandle.h"

// While it lives it counts the controls that the thread makes and the fonts that they are given. One at a time.
class BareControls {
 public:
  BareControls();
  ~BareControls();

  // Makes the same number of bare windows of the same classes, gives them as many fonts and destroys them: the number
  // of objects that are there afterwards and were not before.
  int iLeftBehind() const;

 private:
  static LRESULT CALLBACK Watch(int iCode, WPARAM wParam, LPARAM lParam);

  HHOOK m_hHook;
};

// How many objects there are more than before.
int iGrowth(const ObjectCounts& before, const ObjectCounts& after);
