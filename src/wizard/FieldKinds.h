// Kinds of controls that the engine and a view without a screen tell apart in the same way.
#pragma once

#include "controls/BaseControl.h"

inline bool bIsTextList(ControlKind kind) {
  return kind == ControlKind::ListBox || kind == ControlKind::SimulatedListBox;
}

// Items to choose from that stay in sight.
inline bool bIsList(ControlKind kind) {
  return bIsTextList(kind) || kind == ControlKind::ListView || kind == ControlKind::TreeView;
}

// A value of its own that a person changes at one stroke.
inline bool bIsSetter(ControlKind kind) {
  return kind == ControlKind::Trackbar || kind == ControlKind::UpDown || kind == ControlKind::DatePicker ||
         kind == ControlKind::MonthCalendar || kind == ControlKind::Hotkey || kind == ControlKind::IpAddress ||
         kind == ControlKind::TabControl || kind == ControlKind::PropSheet;
}
