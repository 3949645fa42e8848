// Where a dialog's window goes, with which styles, and how its place is kept from one run to the next.
#pragma once

#include "controls/DialogInfo.h"
#include "window/Handles.h"

// What a dialog may inherit. An empty rectangle: nothing.
struct FormerPlace {
  RECT present = {};  // the window as the previous dialog left it
  RECT sized = {};    // as the last dialog with INHERIT_SIZE left it
};

// The window's outer rectangle; workArea is the part of the screen that the task bar leaves free. A dialog with
// INHERIT_POSITION stays where the window is, one with INHERIT_SIZE takes the rectangle of the last dialog that had the
// word, else the window's; one with CENTER comes to the middle. When several are given the first dialog is centred.
RECT PlaceDialog(const DialogInfo& dialog, const FormerPlace& former, const RECT& workArea);
// The style of the wizard's top-level window for this dialog, without WS_VISIBLE.
DWORD TopLevelStyle(const DialogInfo& dialog);
// The part of a screen that the task bar leaves free: of the screen that the window, or the rectangle, is nearest to.
RECT WorkAreaOf(HWND hWnd);
RECT WorkAreaOf(const RECT& area);
// The rectangle moved as little as possible into the other one; its upper left corner wins.
RECT MovedInto(const RECT& area, const RECT& bounds);
// The place of a dialog's background picture in its client area.
RECT PlacePicture(const DialogInfo& dialog, SIZE client, SIZE picture);

// The place of the wizard's window in the configuration file (keys "Position", "LastDialogSize", "Maximized",
// "RestoredPosition"). Changes are remembered and written together: by Save, which the view calls when the window has
// come to rest, when it closes and when the session ends.
class PlaceKeeper {
 public:
  // Reads what the last run left. Null or empty: nothing is read, and nothing will be written.
  void Open(const char* szFile);
  // The window with an INHERIT_SIZE dialog was moved or sized. restored: its rectangle without being maximised.
  void Note(const RECT& area, const RECT& restored, bool bMaximized);
  void Save();
  // True when Save has something to write.
  bool bChanged() const { return m_bChanged; }
  // The rectangle that the next INHERIT_SIZE dialog takes, not that of a maximised window. Empty: none.
  const RECT& Sized() const { return m_Restored; }
  bool bMaximized() const { return m_bMaximized; }

 private:
  CNString m_csFile;
  RECT m_Area = {}, m_Restored = {};
  bool m_bMaximized = false, m_bChanged = false;
};
