// Frames, group boxes, tab controls and what stands in them; layout tables in a real window; splitters.
#include "Page.h"
#include "controls/Layout.h"

using Events = std::vector<std::string>;

namespace {

void ClickTab(HWND hTabs, int iTab) {
  RECT area;
  SendMessageW(hTabs, TCM_GETITEMRECT, static_cast<WPARAM>(iTab), reinterpret_cast<LPARAM>(&area));
  Click(hTabs, {(area.left + area.right) / 2, (area.top + area.bottom) / 2});
}

void ResizeClient(HWND hWnd, int iWidth, int iHeight) {
  const RECT window = AreaOf(hWnd);
  const SIZE client = ClientOf(hWnd);
  SetWindowPos(hWnd, nullptr, 0, 0, window.right - window.left - client.cx + iWidth,
               window.bottom - window.top - client.cy + iHeight, SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
}

const char* const NESTED =
    "BUTTON 'first' \"First\" 1 1 60 20\n"
    "FRAME 'f' 10 30 300 240, BACKGROUND(1,2,3)\n"
    "  TEXT_FIELD 'label' \"Label\" 5 6 70 15\n"
    "  GROUP_BOX 'g' \"&Title\" 10 30 280 60\n"
    "    CHECK_BOX 'c' \"Check\" 5 6 70 15\n"
    "  END_GROUP_BOX\n"
    "  TAB_CONTROL 't' 10 100 280 130, FOCUS\n"
    "    TAB 'one' \"One\"\n"
    "      BUTTON 'in' \"In\" 5 6 70 20\n"
    "      BUTTON 'go' \"Go\" 5 36 70 20, DEFAULT\n"
    "    END_TAB\n"
    "    TAB 'two' \"Two\", BACKGROUND(4,5,6)\n"
    "      EDIT_FIELD 'e' 5 6 70 20\n"
    "      TEXT_FIELD 'text' \"Text\" 5 36 70 15\n"
    "    END_TAB\n"
    "  END_TAB_CONTROL\n"
    "END_FRAME\n"
    "BUTTON 'last' \"Last\" 80 1 60 20\n";

}  // namespace

TEST(LayoutWindow, ContainersAreWindowsOfTheirKindAndHoldTheirControls) {
  ShownPage screen(NESTED, "0 0 400 340");
  const struct {
    const char* szName;
    const wchar_t* szClass;
    DWORD dwStyle, dwWithout, dwExStyle;
    const char* szPlace;   // in its parent window; null: wherever
    const char* szParent;  // the control whose window is the parent, null: not looked at
  } rows[] = {
      {"f", L"FrameWizardClass", WS_VISIBLE | WS_CLIPCHILDREN, WS_TABSTOP, WS_EX_CONTROLPARENT, "10 30 300 240",
       nullptr},
      {"label", L"Static", WS_VISIBLE, WS_TABSTOP, 0, "5 6 70 15", "f"},
      {"g", L"Button", WS_VISIBLE | BS_GROUPBOX, WS_TABSTOP, WS_EX_CONTROLPARENT, "10 30 280 60", "f"},
      {"c", L"Button", WS_VISIBLE | WS_TABSTOP, 0, 0, "5 6 70 15", nullptr},
      {"t", L"SysTabControl32", WS_VISIBLE | WS_TABSTOP, 0, 0, "10 100 280 130", "f"},
      {"one", L"FrameWizardClass", WS_VISIBLE, WS_TABSTOP, WS_EX_CONTROLPARENT, nullptr, "f"},
      {"two", L"FrameWizardClass", 0, WS_VISIBLE, WS_EX_CONTROLPARENT, nullptr, "f"},
      {"in", L"Button", WS_VISIBLE, 0, 0, "5 6 70 20", "one"},
      {"e", L"Edit", WS_VISIBLE, 0, 0, "5 6 70 20", "two"},
  };
  for (const auto& row : rows) {
    const HWND hWnd = screen.hOf(row.szName);
    ASSERT_NE(hWnd, nullptr) << row.szName;
    wchar_t name[64];
    GetClassNameW(hWnd, name, 64);
    EXPECT_STREQ(name, row.szClass) << row.szName;
    const auto dwStyle = static_cast<DWORD>(GetWindowLongW(hWnd, GWL_STYLE));
    EXPECT_EQ(dwStyle & row.dwStyle, row.dwStyle) << row.szName;
    EXPECT_EQ(dwStyle & row.dwWithout, 0u) << row.szName;
    EXPECT_EQ(static_cast<DWORD>(GetWindowLongW(hWnd, GWL_EXSTYLE)) & WS_EX_CONTROLPARENT, row.dwExStyle) << row.szName;
    if (row.szPlace) {
      EXPECT_EQ(PlaceText(hWnd), row.szPlace) << row.szName;
    }
    if (row.szParent) {
      EXPECT_EQ(GetParent(hWnd), screen.hOf(row.szParent)) << row.szName;
    }
  }
  const HWND hGroup = screen.hOf("g"), hCheck = screen.hOf("c");
  EXPECT_EQ(GetParent(GetParent(hCheck)), hGroup) << "inside the box is a window of its own";
  RECT inside = AreaOf(GetParent(hCheck), hGroup), page1 = AreaOf(screen.hOf("one"), screen.hOf("t"));
  EXPECT_GE(inside.top, 10) << "under the title";
  EXPECT_TRUE(inside.left > 0 && inside.right < 280 && inside.bottom < 60);
  EXPECT_TRUE(page1.left > 0 && page1.top > 15 && page1.right < 280 && page1.bottom < 130) << PlaceText(page1);
  EXPECT_EQ(GetFocus(), screen.hOf("t"));
}

TEST(LayoutWindow, GroundsComeFromTheNearestContainerWithAColour) {
  ShownPage screen(NESTED, "0 0 400 340, BACKGROUND(9,9,9)");
  EXPECT_EQ(PixelOf(screen.hWindow(), 2, 25), RGB(9, 9, 9));
  EXPECT_EQ(PixelOf(screen.hOf("f"), 1, 1), RGB(1, 2, 3));
  EXPECT_EQ(PixelOf(screen.hOf("label"), 68, 13), RGB(1, 2, 3)) << "behind a text in the frame";
  EXPECT_EQ(PixelOf(GetParent(screen.hOf("c")), 100, 10), RGB(1, 2, 3)) << "in the group box";
  EXPECT_EQ(PixelOf(screen.hOf("one"), 100, 50), RGB(1, 2, 3));
  screen.bSet("t", "2");
  EXPECT_EQ(PixelOf(screen.hOf("two"), 100, 50), RGB(4, 5, 6)) << "a page in its own colour";
  EXPECT_EQ(PixelOf(screen.hOf("text"), 68, 13), RGB(4, 5, 6));
}

TEST(LayoutWindow, EventsOfInnerControlsReachTheWizard) {
  ShownPage screen(NESTED, "0 0 400 340");
  Click(screen.hOf("in"));
  Click(screen.hOf("c"));
  screen.RunQueued();
  EXPECT_EQ(screen.TakeEvents(), (Events{"in 0", "c 0"}));
  ClickTab(screen.hOf("t"), 1);
  screen.RunQueued();
  EXPECT_EQ(screen.TakeEvents(), (Events{"t 1"}));
  EXPECT_FALSE(IsWindowVisible(screen.hOf("in")));
  EXPECT_TRUE(IsWindowVisible(screen.hOf("e")));
  EXPECT_EQ(screen.Value("t"), "2");
  screen.view->bShow(screen["t"], false);
  EXPECT_FALSE(IsWindowVisible(screen.hOf("e"))) << "the pages go with the tabs";
  screen.view->bShow(screen["t"], true);
  EXPECT_TRUE(IsWindowVisible(screen.hOf("e")));
  EXPECT_FALSE(IsWindowVisible(screen.hOf("in")));
  SetFocus(screen.hOf("e"));
  screen.bSet("t", "1");
  EXPECT_EQ(GetFocus(), screen.hOf("t")) << "its field went with the page";
  screen.bSet("t", "7");
  EXPECT_EQ(screen.Value("t"), "1") << "there is no such page";
  ASSERT_TRUE(screen.view->bCreateDialog(screen.page.info));
  screen.bSet("t", "2");  // as the wizard does before it shows the dialog
  screen.view->ShowDialog();
  EXPECT_TRUE(IsWindowVisible(screen.hOf("e")));
  EXPECT_FALSE(IsWindowVisible(screen.hOf("in")));
}

TEST(LayoutWindow, TabAndEnterWorkThroughContainers) {
  ShownPage screen(NESTED, "0 0 400 340");
  SetFocus(screen.hOf("first"));
  for (const char* szNext : {"c", "t", "in", "go", "last", "first", "c"}) {
    screen.Press({VK_TAB});
    EXPECT_EQ(GetFocus(), screen.hOf(szNext)) << szNext;
  }
  screen.TakeEvents();
  screen.Press({VK_RETURN});  // in the check box: the default button, which stands on a page
  EXPECT_EQ(screen.TakeEvents(), (Events{"go 0"}));
  SetFocus(screen.hOf("go"));
  BYTE keys[256] = {};
  keys[VK_CONTROL] = 0x80;
  SetKeyboardState(keys);
  screen.Press({VK_TAB});
  keys[VK_CONTROL] = 0;
  SetKeyboardState(keys);
  EXPECT_EQ(screen.TakeEvents(), (Events{"t 1"}));
  EXPECT_TRUE(IsWindowVisible(screen.hOf("e")));
  EXPECT_EQ(GetFocus(), screen.hOf("t"));
}

// The whole window through ten sizes: every control where the numbers say.
TEST(LayoutWindow, TablesFollowTheWindow) {
  ShownPage screen(
      "EDIT_FIELD 'top' 0 0 50 20, RIGHTRESIZABLE, MARGIN(4)\n"
      "LIST_FIELD 'left' \"a\" 0 0 60 80, RIGHTRESIZABLE, BOTTOMRESIZABLE\n"
      "SPLITTER 's' 0 0 6 10, BOTTOMRESIZABLE\n"
      "EDIT_FIELD 'gone' 0 0 50 20\n"
      "BUTTON 'ok' \"OK\" 0 0 75 23, ALIGN_RIGHT, MARGIN_RIGHT(10)\n"
      "TABLE_START\n{\n"
      "TABLE_COLUMN (width=1%)\nTABLE_COLUMN (width=6p)\nTABLE_COLUMN (width=2%)\n"
      "TABLE_ROW (height=28p)\n'top' SPAN(3)\nTABLE_ROW (height=*)\n'left'\n's'\n"
      "FRAME 'f' 0 0 10 10, RIGHTRESIZABLE, BOTTOMRESIZABLE, BACKGROUND(255,255,255)\n"
      "  BUTTON 'x' \"X\" 0 0 40 20, ALIGN_BOTTOM\n"
      "  EDIT_FIELD 'y' 0 0 40 20, RIGHTRESIZABLE, BOTTOMRESIZABLE, MULTILINE\n"
      "  TABLE_START\n  {\n  TABLE_COLUMN (width=50%)\n  TABLE_COLUMN (width=*)\n  TABLE_ROW (height=*)\n"
      "  'x'\n  'y'\n  }\nEND_FRAME\n"
      "TABLE_ROW (height=40p)\n-\n-\n'ok'\nTABLE_ROW (height=50p, hide=1)\n'gone'\n}\n",
      "0 0 500 400", DialogKind::Window);
  const int sizes[][2] = {{484, 362}, {600, 400}, {601, 401}, {602, 403}, {800, 600},
                          {401, 333}, {333, 250}, {300, 200}, {777, 555}, {500, 360}};
  for (const auto& size : sizes) {
    ResizeClient(screen.hWindow(), size[0], size[1]);
    const BaseControl* const levels[] = {nullptr, &screen["f"]};
    RECT room = {0, 0, size[0], size[1]};
    for (const BaseControl* pLevel : levels) {
      if (pLevel) GetClientRect(screen.hOf(*pLevel), &room);
      CNArray<LayoutPlace> places;
      LayOut(screen.page.info, pLevel, room.right, room.bottom, LayoutSizes(), places);
      EXPECT_EQ(places.Size(), pLevel ? 2 : 6);
      for (int i = 0; i < places.Size(); i++) {
        const LayoutPlace& place = *places[i];
        const HWND hWnd = screen.hOf(*place.pControl);
        EXPECT_EQ(IsWindowVisible(hWnd), !place.bHidden) << place.pControl->m_csName.Text();
        const RECT expected = {place.iX, place.iY, place.iX + place.iWidth, place.iY + place.iHeight};
        // A list takes whole lines only.
        RECT real = AreaOf(hWnd, GetParent(hWnd));
        if (place.pControl->Kind() == ControlKind::ListBox && real.bottom < expected.bottom)
          real.bottom = expected.bottom;
        if (place.bHidden) continue;
        EXPECT_EQ(PlaceText(real), PlaceText(expected)) << place.pControl->m_csName.Text() << " at " << size[0];
      }
    }
  }
  ResizeClient(screen.hWindow(), 20, 20);
  const SIZE least = ClientOf(screen.hWindow());
  EXPECT_GE(least.cx, 85 * 3 / 2 + 6) << "the button keeps its place";
  EXPECT_GE(least.cy, 28 + 40 + 20);
}

TEST(LayoutWindow, SplittersMoveWithMouseAndKeys) {
  Screen screen;
  Page page(
      DialogKind::DialogSys, "0 0 400 340",
      "EDIT_FIELD 'a' 10 10 100 90, MULTILINE\nSPLITTER 's' 110 10 6 90\nEDIT_FIELD 'b' 116 10 100 90, MULTILINE\n"
      "EDIT_FIELD 'far' 300 10 50 90\nSPLITTER 'h' 10 100 206 6, HORIZONTAL, BORDER\n"
      "FRAME 'f' 0 110 300 90\n  BUTTON 'x' \"X\" 0 0 20 20, RIGHTRESIZABLE\n  SPLITTER 'in' 0 0 6 90\n"
      "  BUTTON 'y' \"Y\" 0 0 30 20\n"
      "  TABLE_START\n  {\n  TABLE_COLUMN (width=*)\n  TABLE_COLUMN (width=6p)\n  TABLE_COLUMN (width=*)\n"
      "  TABLE_ROW (height=*) 'x' 'in' 'y'\n  }\nEND_FRAME\n");
  screen.Show(page);
  const auto drag = [&](const char* szName, int x, int y) {
    const HWND hBar = screen.hOf(page[szName]);
    SendMessageW(hBar, WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(3, 3));
    SendMessageW(hBar, WM_MOUSEMOVE, MK_LBUTTON, MAKELPARAM(3 + x, 3 + y));
    SendMessageW(hBar, WM_LBUTTONUP, 0, MAKELPARAM(3, 3));
    EXPECT_EQ(GetCapture(), nullptr);
  };
  const auto expect = [&](const char* szName, const char* szPlace) {
    EXPECT_EQ(PlaceText(screen.hOf(page[szName])), szPlace) << szName;
  };
  drag("s", 30, 0);
  expect("a", "10 10 130 90");
  expect("s", "140 10 6 90");
  expect("b", "146 10 70 90");
  expect("far", "300 10 50 90");
  drag("s", 500, 0);
  expect("b", "200 10 16 90");
  drag("h", 0, -20);
  expect("a", "10 10 184 70");
  expect("s", "194 10 6 70");
  expect("h", "10 80 206 6");
  drag("in", -30, 0);
  expect("x", "0 0 117 20");
  expect("in", "117 0 6 90");
  expect("y", "123 0 30 20");
  SetFocus(screen.hOf(page["in"]));
  screen.Press({VK_RIGHT});
  expect("in", "125 0 6 90");
  EXPECT_EQ(hCursorOver(screen.hOf(page["h"])), LoadCursorW(nullptr, IDC_SIZENS));
  screen.Show(page);
  expect("in", "147 0 6 90");
}
