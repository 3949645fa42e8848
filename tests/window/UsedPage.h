// A page whose first control is 'k', which has the keyboard, and what a person does to it.
#pragma once

#include <string>

#include "Page.h"

inline constexpr char TREE[] =
    "TREE_VIEW 'k' 10 20 200 150, CHECKBOX, DRAG ACTION: ()\nITEM \"Programs\"\nITEM '1,0' \"Plumo\", CHECKED\n"
    "ITEM '1,1' \"Editor\" ACTION: (edit)\nITEM '1,0' \"Zero\", DISABLE\nITEM \"Documents\"\nEND_TREE_VIEW";
inline constexpr char TABLE[] =
    "LISTVIEW 'k' 10 20 300 150, REPORT, CHECKBOX, SORT, FULL_ROW_SEL ACTION: ()\nCOLUMN \"Name\" 100, EDIT\n"
    "COLUMN \"Size\" \"1\" \"20\" 80, RIGHT, COMBO\nCOLUMN \"Note\" 60\nITEM \"a\" \"10\", VAR(x), CHECKED\n"
    "ITEM \"b\" \"9\" ACTION: (open b)\nITEM \"c\" \"100\", DISABLE\nEND_LISTVIEW";

struct UsedPage : ShownPage {
  explicit UsedPage(const char* szLines) : ShownPage(szLines, "0 0 500 400"), hWnd(hOf("k")) {
    SetFocus(hWnd);
    Told();
  }
  // The mouse goes there as well.
  UsedPage& Mouse(HWND hTarget, UINT uMessage, int x, int y) {
    POINT point = {x, y};
    ClientToScreen(hTarget, &point);
    SetCursorPos(point.x, point.y);
    PostMessageW(hTarget, uMessage, uMessage == WM_MOUSEMOVE ? MK_LBUTTON : 0, MAKELPARAM(x, y));
    return *this;
  }
  UsedPage& Click(int x, int y) { return Mouse(hWnd, WM_LBUTTONDOWN, x, y).Mouse(hWnd, WM_LBUTTONUP, x, y); }
  UsedPage& DoubleClick(int x, int y) {
    return Click(x, y).Mouse(hWnd, WM_LBUTTONDBLCLK, x, y).Mouse(hWnd, WM_LBUTTONUP, x, y);
  }
  std::vector<std::string> Told() {
    for (int i = 0; i < 3; i++) RunQueued();
    return TakeEvents();
  }
  // Its lines, written back as they are now.
  std::string Written(const char* szName = "k") {
    CNString csOut;
    page[szName].WriteControl(csOut);
    return csOut.Text();
  }

  const HWND hWnd;
};
