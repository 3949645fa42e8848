// What single kinds do beside having a value (KindsTest.cpp): their keys, colours, sounds, companions, and items that
// are ticked, edited, sorted and moved.
#include <algorithm>

#include "UsedPage.h"
#include "controls/ItemKinds.h"
#include "foundation/os/Os.h"
#include "support/TestFolder.h"
// after windows.h, which it builds on
#include <richedit.h>

using Events = std::vector<std::string>;

// A page may end with the event of a control that is still in the middle of its message.
TEST(SimpleKinds, EventsAreToldWhenTheControlHasFinished) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300", "TRACKBAR 'k' \"0 100\" 10 20 150 40"),
      next(DialogKind::DialogSys, "0 0 400 300", "");
  screen.wizard.onEvent = [&](const std::string&) { screen.Show(next); };
  screen.Show(page);
  SendMessageW(screen.hOf(page["k"]), WM_KEYDOWN, VK_RIGHT, 1);
  EXPECT_EQ(screen.TakeEvents(), Events{});
  screen.RunQueued();
  EXPECT_EQ(screen.TakeEvents(), Events{"k 1"});
}

// Tab and Enter belong to the dialog, whatever a rich edit would do with them.
TEST(SimpleKinds, RichEditsLeaveTheDialogItsKeysAndShowFiles) {
  CNString csFile;
  ASSERT_TRUE(bOsGetProgramPath(csFile));
  csFile.Trim('\\');
  csFile.Concat("\\test.rtf");
  TestFolder::WriteFile(csFile.Text(), "{\\rtf1\\ansi\\ansicpg1250 {\\b Bold} text\\par two}");
  ShownPage screen(
      "RICH_EDIT 'k' \"test.rtf\" 10 10 300 100, READ_ONLY, FOCUS\n"
      "RICH_EDIT 'e' \"x\" 10 120 300 20\nBUTTON 'b' \"B\" 10 150 75 23, DEFAULT\n");
  EXPECT_EQ(screen.Value("k").substr(0, 9), "Bold text");
  screen.bSet("k", "typed");
  EXPECT_EQ(screen.Value("k"), "typed");
  screen.Press({VK_RETURN, VK_TAB, VK_TAB});
  EXPECT_EQ(screen.TakeEvents(), (Events{"k 256", "b 0", "k 512", "e 256", "e 512"}));
  bOsDeleteFile(csFile.Text());
}

TEST(SimpleKinds, ArrowsStepTheFieldBeforeThem) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300", "EDIT_FIELD 'e' \"\" 10 10 80 22\nUP_DOWN 'k' (1,9,4), ALIGNRIGHT\n");
  ASSERT_TRUE(screen.view->bCreateDialog(page.info));
  screen.view->bSetText(page["e"], "");  // as the wizard fills it in
  screen.view->ShowDialog();
  const HWND hField = screen.hChildOfClass(L"EDIT");
  EXPECT_EQ(TextOf(hField), L"4");
  SetWindowTextW(hField, L"7");
  EXPECT_EQ(screen.Value(page["k"]), "7");
  screen.view->bSetText(page["k"], "5");
  EXPECT_EQ(TextOf(hField), L"5");
  const RECT field = AreaOf(hField), arrows = AreaOf(screen.hChildOfClass(UPDOWN_CLASSW));
  EXPECT_GT(arrows.right - arrows.left, 8) << "a size of its own";
  EXPECT_LE(arrows.left - field.right, 2) << "right at the field's edge";
}

TEST(SimpleKinds, AStatusBarFollowsItsWindowAndAPagerHoldsItsControl) {
  ShownPage screen(
      "STATUS_BAR 's' \"Ready\" \"12 files\" 0 0 0 0\n"
      "BUTTON 'wide' \"Wide\" 0 0 300 30\nPAGER 'p' \"wide\" 10 10 100 30\n",
      "0 0 400 300", DialogKind::Window);
  const HWND hBar = screen.hChildOfClass(STATUSCLASSNAMEW);
  const auto edges = [&](int(&found)[4]) {
    return SendMessageW(hBar, SB_GETPARTS, 4, reinterpret_cast<LPARAM>(found));
  };
  int before[4] = {}, after[4] = {};
  ASSERT_EQ(edges(before), 2);
  wchar_t text[32] = L"";
  SendMessageW(hBar, SB_GETTEXTW, 1, reinterpret_cast<LPARAM>(text));
  EXPECT_STREQ(text, L"12 files");
  SetWindowPos(screen.hWindow(), nullptr, 0, 0, 600, 300, SWP_NOMOVE | SWP_NOZORDER);
  EXPECT_EQ(AreaOf(hBar, screen.hWindow()).right, ClientOf(screen.hWindow()).cx);
  ASSERT_EQ(edges(after), 2);
  EXPECT_EQ(after[0] - before[0], 200) << "the first part takes what is free";
  EXPECT_EQ(GetParent(screen.hChild(L"Wide")), screen.hChildOfClass(WC_PAGESCROLLERW));
  SendMessageW(screen.hChild(L"Wide"), BM_CLICK, 0, 0);
  EXPECT_EQ(screen.TakeEvents(), Events{"wide 0"});
}

TEST(SimpleKinds, CursorsAreThoseOfTheirLines) {
  ShownPage screen(
      "BUTTON 'b' \"B\" 1 1 75 23\nBUTTON 'c' \"C\" 1 30 75 23\nEDIT_FIELD 'e' \"E\" 1 60 75 20\n"
      "TEXT_FIELD 'l' \"L\" 1 90 75 15, LINK ACTION: ()\nCURSOR 'b' \"CROSS\"\nCURSOR \"WAIT\"\n");
  const struct {
    const wchar_t* szText;
    const wchar_t* pCursor;
  } rows[] = {{L"B", IDC_CROSS}, {L"C", IDC_WAIT}, {L"E", IDC_IBEAM}, {L"L", IDC_HAND}};
  for (const auto& row : rows)
    EXPECT_EQ(hCursorOver(screen.hChild(row.szText)), LoadCursorW(nullptr, row.pCursor)) << row.szText;
}

TEST(SimpleKinds, SoundsPlayWhenTheyAreShown) {
  TestFolder folder;
  TestLog log(folder);
  ShownPage screen("WAVE 'w' \"first.wav\", PLAY\nWAVE 'v' \"second.wav\"\nWAVE 'h' \"third.wav\", PLAY, HIDE\n");
  EXPECT_TRUE(screen.view->bShow(screen["v"], true));
  EXPECT_EQ(log.Lines(), (Events{"ERROR: CNWave::Play -> !bFindScriptFile(first.wav)",
                                 "ERROR: CNWave::Play -> !bFindScriptFile(second.wav)"}));
}

// These kinds do not ask their window for colours. Setting a colour answers with the one before it.
TEST(SimpleKinds, ColoursReachEveryKind) {
  const struct {
    const char* szFlags;
    UINT uMessage;
    WPARAM wParam;
    COLORREF color;
  } rows[] = {
      {"PROGRESS_BAR 'k' 10 20 150 40,BACKGROUND(1,2,3)", PBM_SETBKCOLOR, 0, RGB(1, 2, 3)},
      {"PROGRESS_BAR 'k' 10 20 150 40,TEXT_COLOR(4,5,6)", PBM_SETBARCOLOR, 0, RGB(4, 5, 6)},
      {"RICH_EDIT 'k' 10 20 150 40,BACKGROUND(1,2,3)", EM_SETBKGNDCOLOR, 0, RGB(1, 2, 3)},
      {"RICH_EDIT 'k' 10 20 150 40,GRAY", EM_SETBKGNDCOLOR, 0, GetSysColor(COLOR_BTNFACE)},
      {"MONTHCALENDAR 'k' 10 20 150 40,BACKGROUND(1,2,3)", MCM_SETCOLOR, MCSC_MONTHBK, RGB(1, 2, 3)},
      {"MONTHCALENDAR 'k' 10 20 150 40,TEXT_COLOR(4,5,6)", MCM_SETCOLOR, MCSC_TEXT, RGB(4, 5, 6)},
  };
  Screen screen;
  for (const auto& row : rows) {
    Page page(DialogKind::DialogSys, "0 0 400 300", row.szFlags);
    screen.Show(page);
    const LRESULT lColor = SendMessageW(screen.hOf(page["k"]), row.uMessage, row.wParam, 0);
    EXPECT_EQ(static_cast<COLORREF>(lColor), row.color) << row.szFlags;
  }
}

TEST(SimpleKinds, PicturesTellOfTheMouse) {
  ShownPage screen("IMAGE 'i' none.bmp 10 20 40 40, CUSTOM ACTION: ()\nIMAGE 'silent' none.bmp 60 20 40 40, CUSTOM\n");
  for (const char* szName : {"i", "silent"})
    for (const UINT uMessage : {WM_MOUSEMOVE, WM_MOUSEMOVE, WM_LBUTTONDOWN, WM_LBUTTONUP, WM_MOUSELEAVE})
      PostMessageW(screen.hOf(szName), uMessage, 0, MAKELPARAM(5, 5));
  screen.RunQueued();
  Events events = screen.TakeEvents();
  // The mouse of the display is elsewhere: the system may tell of its leaving at once.
  events.erase(std::unique(events.begin(), events.end()), events.end());
  EXPECT_EQ(Events(events.begin(), events.begin() + 1), Events{"i 100"});
  for (const char* szEvent : {"i 101", "i 102", "i 103"})
    EXPECT_NE(std::find(events.begin(), events.end(), szEvent), events.end()) << szEvent;
  for (const std::string& event : events) EXPECT_EQ(event.substr(0, 2), "i ") << "no script waits for the other's";
}

// The box is too narrow for a focus of its own.
TEST(SimpleKinds, TheTextBesideABareBoxShowsItsFocus) {
  ShownPage screen(
      "CHECK_BOX 'c' 10 10 13 13\nTEXT_FIELD 't' \" \" 35 10 90 15\nBUTTON 'b' \"B\" 10 40 75 23, FOCUS\n");
  const HWND hText = screen.hOf("t");
  const auto isMarked = [&] {
    for (int x = 0; x < 6; x++)
      if (PixelOf(hText, x, 0) != GetSysColor(COLOR_BTNFACE)) return true;
    return false;
  };
  EXPECT_FALSE(isMarked());
  SetFocus(screen.hOf("c"));
  EXPECT_TRUE(isMarked());
  SetFocus(screen.hChild(L"B"));
  EXPECT_FALSE(isMarked());
  screen.TakeEvents();
  for (const UINT uMessage : {WM_LBUTTONDOWN, WM_LBUTTONUP, WM_LBUTTONDBLCLK, WM_LBUTTONUP})
    PostMessageW(screen.hOf("c"), uMessage, 0, MAKELPARAM(5, 5));
  screen.RunQueued();
  EXPECT_EQ(screen.TakeEvents(), (Events{"c 0", "c 0"})) << "two quick clicks";
}

TEST(ItemKinds, TicksAreKeptAndThoseOfDisabledItemsStand) {
  for (const char* szLines : {TABLE, TREE}) {
    SCOPED_TRACE(szLines);
    UsedPage screen(szLines);
    const auto& control = *screen["k"].pItemControl();
    std::string ticks;
    bool bChecked = false;
    for (int i = 0; i < control.m_Items.Size(); i++)
      ticks += !screen.view->bIsItemChecked(control, i, bChecked) ? '-' : bChecked ? '1' : '0';
    EXPECT_EQ(ticks, szLines == TREE ? "01000" : "---100");
    const int iOpen = szLines == TREE ? 2 : 4, iDisabled = szLines == TREE ? 3 : 5;
    const char* const PATHS[][2] = {{"Programs\\Editor", "Programs\\Zero"}, {"b", "c"}};
    for (const int iItem : {iOpen, iDisabled}) {
      screen.bSet("k", PATHS[szLines == TABLE][iItem == iDisabled]);
      screen.Press({VK_SPACE});
      EXPECT_TRUE(screen.view->bIsItemChecked(control, iItem, bChecked));
      EXPECT_EQ(bChecked, iItem == iOpen);
    }
    EXPECT_EQ(screen.Told(), Events{"k 1"});
    EXPECT_TRUE(screen.view->bCheckItem(control, iOpen, false));
    EXPECT_TRUE(screen.view->bIsItemChecked(control, iOpen, bChecked) && !bChecked);
  }
}

TEST(ItemKinds, CellsAreEditedAndColumnsSorted) {
  UsedPage screen(TABLE);
  const auto order = [&] {
    std::string rows;
    for (int i = 0; i < 3; i++) {
      wchar_t text[20] = L"";
      ListView_GetItemText(screen.hWnd, i, 0, text, 20);
      rows += static_cast<char>(text[0]);
    }
    return rows;
  };
  SendMessageW(screen.hWnd, LVM_SETITEMSTATE, 0, 0);
  screen.bSet("k", "a");
  for (const WPARAM wEnd : {VK_ESCAPE, VK_RETURN}) {
    screen.Press({VK_F2});
    ASSERT_NE(GetFocus(), screen.hWnd);
    PostMessageW(GetFocus(), WM_CHAR, 'z', 1);
    screen.Press({wEnd});
    EXPECT_EQ(GetFocus(), screen.hWnd);
    EXPECT_EQ(order(), wEnd == VK_RETURN ? "zbc" : "abc");
  }
  EXPECT_EQ(screen.Told(), Events{"k 5"});
  EXPECT_NE(screen.Written().find("ITEM \"z\" \"10\""), std::string::npos) << screen.Written();
  screen.DoubleClick(120, 50).RunQueued();  // the size of b: a choice of 1 and 20
  screen.Press({VK_DOWN, VK_RETURN});
  EXPECT_NE(screen.Written().find("ITEM \"b\" \"1\""), std::string::npos) << screen.Written();
  const HWND hHeader = ListView_GetHeader(screen.hWnd);
  for (const char* szOrder : {"bzc", "czb"}) {
    screen.Mouse(hHeader, WM_LBUTTONDOWN, 140, 8).Mouse(hHeader, WM_LBUTTONUP, 140, 8).RunQueued();
    EXPECT_EQ(order(), szOrder) << "numbers by their size: 1, 10, 100";
  }
}

TEST(ItemKinds, ItemsAreMovedWithTheMouse) {
  const char* const LISTS =
      "LIST_FIELD 'k' \"a\" \"<RGB(1,2,3)>b\" \"c\" 10 20 90 80, GLOBAL_DRAG\n"
      "LIST_FIELD 'other' \"x\" 110 20 90 80, GLOBAL_DRAG\nLIST_FIELD 'alone' \"x\" 210 20 90 80, DRAG\n";
  const struct {
    const char* szLines;
    POINT from, to;
    bool bEscape;
    const char* szWritten;
  } ROWS[] = {
      {LISTS, {5, 20}, {5, 5}, false, "\"<RGB(1,2,3)>b\" \"a\" \"c\" 10"},
      {LISTS, {5, 5}, {5, 35}, false, "\"<RGB(1,2,3)>b\" \"c\" \"a\" 10"},
      {LISTS, {5, 20}, {5, 5}, true, "\"a\" \"<RGB(1,2,3)>b\" \"c\" 10"},
      {LISTS, {5, 5}, {250, 5}, false, "\"a\" \"<RGB(1,2,3)>b\" \"c\" 10"},  // no list of the kind that takes it
      {LISTS, {5, 20}, {120, 60}, false, "\"a\" \"c\" 10"},
      {"LIST_FIELD 'k' \"a\" \"b\" 10 20 90 80, DRAG, NO_REORDER_LIST", {5, 20}, {5, 5}, false, "\"a\" \"b\" 10"},
  };
  for (const auto& row : ROWS) {
    UsedPage screen(row.szLines);
    screen.Mouse(screen.hWnd, WM_LBUTTONDOWN, row.from.x, row.from.y);
    screen.Mouse(screen.hWnd, WM_MOUSEMOVE, 40, 40).Mouse(screen.hWnd, WM_MOUSEMOVE, row.to.x, row.to.y);
    screen.RunQueued();
    EXPECT_EQ(GetCapture(), screen.hWnd);
    if (row.bEscape) screen.Press({VK_ESCAPE});
    screen.Mouse(screen.hWnd, WM_LBUTTONUP, row.to.x, row.to.y);
    screen.Told();
    EXPECT_EQ(GetCapture(), nullptr);
    EXPECT_NE(screen.Written().find(row.szWritten), std::string::npos) << screen.Written();
    if (row.to.x != 120) continue;
    EXPECT_NE(screen.Written("other").find("\"x\" \"<RGB(1,2,3)>b\""), std::string::npos);
    EXPECT_EQ(screen.Value("other"), "b");
  }
}

TEST(ItemKinds, BranchesOfATreeAreMovedWithTheMouse) {
  UsedPage screen(TREE);
  const auto middle = [&](const char* szPath, int iBelow) {
    screen.bSet("k", szPath);
    RECT row;
    TreeView_GetItemRect(screen.hWnd, TreeView_GetSelection(screen.hWnd), &row, TRUE);
    return POINT{row.left + 5, (row.top + row.bottom) / 2 + iBelow};
  };
  const auto move = [&](POINT from, POINT to) {
    screen.Mouse(screen.hWnd, WM_LBUTTONDOWN, from.x, from.y);
    for (const POINT p : {POINT{from.x + 20, from.y}, to, to}) screen.Mouse(screen.hWnd, WM_MOUSEMOVE, p.x, p.y);
    screen.Mouse(screen.hWnd, WM_LBUTTONUP, to.x, to.y);
    return screen.Told();
  };
  const POINT programs = middle("Programs", 0), documents = middle("Documents", 4);
  move(programs, documents);
  EXPECT_EQ(screen.Value("k"), "Documents\\Programs");
  EXPECT_NE(screen.Written().find("ITEM '0,0' \"Documents\"\nITEM '1,0' \"Programs\"\nITEM '2,0' \"Zero\",DISABLE\n"
                                  "ITEM '2,1' \"Plumo\",CHECKED\nITEM '2,2' \"Editor\" ACTION: (edit)\n"),
            std::string::npos)
      << screen.Written();
  const POINT outer = middle("Documents", 0), inner = middle("Documents\\Programs\\Plumo", 4);
  move(outer, inner);
  EXPECT_NE(screen.Written().find("ITEM '0,0' \"Documents\"\n"), std::string::npos) << "nothing moves into itself";
}
