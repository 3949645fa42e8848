// The kinds of one line that the system draws, and what the older kinds look like: windows against their lines, real
// input against what the wizard was told, values set and read, also over a walk through pages.
#include <algorithm>
#include <cstdio>
#include <cstring>

#include "Page.h"
#include "WalkingWizard.h"
#include "foundation/os/Os.h"
#include "support/TestFolder.h"
// after windows.h, which it builds on
#include <richedit.h>

using Events = std::vector<std::string>;

namespace {

// All lines stand at 10 20 150 40 and are named 'k'.
struct KindRow {
  const char* szLine;
  const wchar_t* szClass;
  DWORD dwStyle, dwWithout;  // bits that are set, bits that are not
  const char* szFirst;       // the value that the line gives, null for a kind without
  const char* szSet;         // a value set by the wizard ...
  const char* szRead;        // ... and what is read then
};

const KindRow KINDS[] = {
    {"RICH_EDIT 'k' \"one\" 10 20 150 40", L"RichEdit20W", WS_TABSTOP | ES_AUTOHSCROLL, ES_READONLY, "one", "Šuma €",
     "Šuma €"},
    {"RICH_EDIT 'k' \"a\" 10 20 150 40,MULTILINE,READ_ONLY,V_SCROLL,FLAT", L"RichEdit20W",
     ES_MULTILINE | ES_READONLY | WS_BORDER, ES_WANTRETURN, "a", "b\r\nc", "b\r\nc"},
    {"TRACKBAR 'k' \"-5 20\" 10 20 150 40,TICK", L"msctls_trackbar32", TBS_AUTOTICKS, TBS_VERT, "-5", "21", "20"},
    {"UP_DOWN 'k' (1,9,4) 10 20 150 40,HORIZONTAL", L"msctls_updown32", UDS_HORZ, WS_TABSTOP, "4", "12", "9"},
    {"DATE_PICKER 'k' \"2026-11-21\" 10 20 150 40", L"SysDateTimePick32", WS_TABSTOP, DTS_TIMEFORMAT, "2026-11-21",
     "2024-02-29", "2024-02-29"},
    {"DATE_PICKER 'k' \"14:05:00\" 10 20 150 40,TIME", L"SysDateTimePick32", DTS_TIMEFORMAT, 0, "14:05:00", "nonsense",
     "14:05:00"},
    {"MONTHCALENDAR 'k' \"2026-11-21\" 10 20 150 40", L"SysMonthCal32", 0, MCS_MULTISELECT, "2026-11-21", "2024-02-29",
     "2024-02-29"},
    {"MONTHCALENDAR 'k' \"2026-11-21\" 10 20 150 40,MULTISELECT,WEEKNUMBERS", L"SysMonthCal32",
     MCS_MULTISELECT | MCS_WEEKNUMBERS, 0, "2026-11-21..2026-11-21", "2026-12-30..2027-01-02",
     "2026-12-30..2027-01-02"},
    {"IPADDRESS 'k' \"10.0.0.1\" 10 20 150 40", L"SysIPAddress32", WS_TABSTOP, 0, "10.0.0.1", "192.168.1.300",
     "192.168.1.255"},
    {"IPADDRESS 'k' 10 20 150 40,DISABLE", L"SysIPAddress32", WS_DISABLED, 0, "", "1.2.3", ""},
    {"HOTKEY 'k' \"F5\" 10 20 150 40,CTRL", L"msctls_hotkey32", WS_TABSTOP, 0, "Ctrl+F5", "Shift+Alt+Del",
     "Shift+Alt+Del"},
    {"PAGER 'k' 10 20 150 40,VERTICAL", L"SysPager", PGS_VERT, PGS_HORZ | WS_TABSTOP, nullptr, nullptr, nullptr},
    {"ANIMATION 'k' IDA_NONE 10 20 150 40,BORDER,TRANSPARENT", L"SysAnimate32", WS_BORDER | ACS_TRANSPARENT, WS_TABSTOP,
     nullptr, nullptr, nullptr},
    {"PROGRESS_BAR 'k' 10 20 150 40,SMOOTH,VERTICAL", L"msctls_progress32", PBS_SMOOTH | PBS_VERTICAL, WS_TABSTOP,
     nullptr, nullptr, nullptr},
    {"EDIT_FIELD 'k' 10 20 150 40,MULTILINE,READ_ONLY,V_SCROLL,AUTOVSCROLL", L"Edit",
     ES_MULTILINE | ES_READONLY | WS_VSCROLL | ES_AUTOVSCROLL, ES_WANTRETURN, "", "x\ny", "x\r\ny"},
};

std::string Read(const Screen& screen, const Page& page) {
  CNString csText;
  return screen.view->bGetText(page["k"], csText) ? csText.Text() : "(no window)";
}

}  // namespace

TEST(SimpleKinds, WindowsAndValuesAreThoseOfTheirLines) {
  Screen screen;
  for (const KindRow& row : KINDS) {
    Page page(DialogKind::DialogSys, "0 0 400 300", row.szLine);
    screen.Show(page);
    const HWND hControl = GetDlgItem(screen.hWindow(), page["k"].m_iID);
    ASSERT_NE(hControl, nullptr) << row.szLine;
    wchar_t name[64] = L"";
    GetClassNameW(hControl, name, 64);
    EXPECT_EQ(lstrcmpiW(name, row.szClass), 0) << row.szLine;
    const auto dwStyle = static_cast<DWORD>(GetWindowLongW(hControl, GWL_STYLE));
    EXPECT_EQ(dwStyle & (row.dwStyle | row.dwWithout | WS_VISIBLE), row.dwStyle | WS_VISIBLE) << row.szLine;
    EXPECT_EQ(IsWindowEnabled(hControl), !(row.dwStyle & WS_DISABLED)) << row.szLine;
    RECT place;
    GetWindowRect(hControl, &place);
    MapWindowPoints(nullptr, screen.hWindow(), reinterpret_cast<POINT*>(&place), 2);
    EXPECT_TRUE(place.left == 10 && place.top == 20 && place.right == 160 && place.bottom == 60)
        << row.szLine << ": " << place.left << " " << place.top << " " << place.right << " " << place.bottom;
    if (!row.szFirst) continue;
    EXPECT_EQ(Read(screen, page), row.szFirst) << row.szLine;
    screen.view->bSetText(page["k"], row.szSet);
    EXPECT_EQ(Read(screen, page), row.szRead) << row.szLine;
  }
}

TEST(SimpleKinds, RealInputIsTold) {
  const struct {
    const char* szLine;
    UINT uMessage;
    WPARAM wKey;
    LPARAM lParam;
    Events events;
    const char* szRead;
  } rows[] = {
      {"TRACKBAR 'k' \"0 100\" 10 20 150 40", WM_KEYDOWN, VK_RIGHT, 1, {"k 1"}, "1"},
      {"UP_DOWN 'k' (0,9,4) 10 20 20 40", WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(5, 5), {"k 1"}, "5"},
      {"DATE_PICKER 'k' \"2026-11-21\" 10 20 150 24", WM_KEYDOWN, VK_UP, 1, {"k 1"}, nullptr},
      {"MONTHCALENDAR 'k' \"2026-11-21\" 10 20 0 0", WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(60, 90), {"k 1"}, nullptr},
      {"HOTKEY 'k' 10 20 150 24", WM_KEYDOWN, VK_F5, 1, {"k 1"}, "F5"},
      {"RICH_EDIT 'k' 10 20 150 24", WM_CHAR, 'x', 1, {}, "x"},
  };
  for (const auto& row : rows) {
    Screen screen;
    Page page(DialogKind::DialogSys, "0 0 400 300", row.szLine);
    screen.Show(page);
    const HWND hControl = GetDlgItem(screen.hWindow(), page["k"].m_iID);
    SetFocus(hControl);
    screen.TakeEvents();
    PostMessageW(hControl, row.uMessage, row.wKey, row.lParam);
    if (row.uMessage == WM_LBUTTONDOWN) PostMessageW(hControl, WM_LBUTTONUP, 0, row.lParam);
    if (row.uMessage == WM_KEYDOWN) PostMessageW(hControl, WM_KEYUP, row.wKey, static_cast<LPARAM>(0xC0000001u));
    screen.RunQueued();
    EXPECT_EQ(screen.TakeEvents(), row.events) << row.szLine;
    if (row.szRead) {
      EXPECT_EQ(Read(screen, page), row.szRead) << row.szLine;
    }
  }
}

// A page may end with the event of a control that is still in the middle of its message.
TEST(SimpleKinds, EventsAreToldWhenTheControlHasFinished) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300", "TRACKBAR 'k' \"0 100\" 10 20 150 40"),
      next(DialogKind::DialogSys, "0 0 400 300", "");
  screen.wizard.onEvent = [&](const std::string&) { screen.Show(next); };
  screen.Show(page);
  SendMessageW(GetDlgItem(screen.hWindow(), page["k"].m_iID), WM_KEYDOWN, VK_RIGHT, 1);
  EXPECT_EQ(screen.TakeEvents(), Events{});
  screen.RunQueued();
  EXPECT_EQ(screen.TakeEvents(), Events{"k 1"});
}

// Tab and Enter belong to the dialog, whatever a rich edit would do with them.
TEST(SimpleKinds, RichEditsLeaveTheDialogItsKeysAndShowFiles) {
  CNString csFolder, csFile;
  ASSERT_TRUE(bOsGetProgramPath(csFolder));
  csFile = csFolder.Text();
  csFile.Trim('\\');
  csFile.Concat("\\test.rtf");
  FILE* pFile = OsOpenStream(csFile.Text(), "wb");
  ASSERT_TRUE(pFile);
  fputs("{\\rtf1\\ansi\\ansicpg1250 {\\b Bold} text\\par two}", pFile);
  fclose(pFile);
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300",
            "RICH_EDIT 'k' \"test.rtf\" 10 10 300 100, READ_ONLY, FOCUS\n"
            "RICH_EDIT 'e' \"x\" 10 120 300 20\nBUTTON 'b' \"B\" 10 150 75 23, DEFAULT\n");
  screen.Show(page);
  EXPECT_EQ(Read(screen, page).substr(0, 9), "Bold text");
  screen.view->bSetText(page["k"], "typed");
  EXPECT_EQ(Read(screen, page), "typed");
  for (const WPARAM wKey : {VK_RETURN, VK_TAB, VK_TAB}) {
    screen.Key(wKey);
    screen.RunQueued();
  }
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
  EXPECT_EQ(Read(screen, page), "7");
  screen.view->bSetText(page["k"], "5");
  EXPECT_EQ(TextOf(hField), L"5");
  RECT field, arrows;
  GetWindowRect(hField, &field);
  GetWindowRect(screen.hChildOfClass(UPDOWN_CLASSW), &arrows);
  EXPECT_GT(arrows.right - arrows.left, 8) << "a size of its own";
  EXPECT_LE(arrows.left - field.right, 2) << "right at the field's edge";
}

TEST(SimpleKinds, AStatusBarFollowsItsWindowAndAPagerHoldsItsControl) {
  Screen screen;
  Page page(DialogKind::Window, "0 0 400 300",
            "STATUS_BAR 's' \"Ready\" \"12 files\" 0 0 0 0\n"
            "BUTTON 'wide' \"Wide\" 0 0 300 30\nPAGER 'p' \"wide\" 10 10 100 30\n");
  CNCharArray texts;
  page["s"].bItemTexts(texts);
  ASSERT_TRUE(screen.view->bCreateDialog(page.info));
  screen.view->bSetItems(page["s"], texts);
  screen.view->ShowDialog();
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
  RECT bar, client;
  GetWindowRect(hBar, &bar);
  GetClientRect(screen.hWindow(), &client);
  EXPECT_EQ(bar.right - bar.left, client.right);
  ASSERT_EQ(edges(after), 2);
  EXPECT_EQ(after[0] - before[0], 200) << "the first part takes what is free";
  EXPECT_EQ(GetParent(screen.hChild(L"Wide")), screen.hChildOfClass(WC_PAGESCROLLERW));
  SendMessageW(screen.hChild(L"Wide"), BM_CLICK, 0, 0);
  EXPECT_EQ(screen.TakeEvents(), Events{"wide 0"});
}

TEST(SimpleKinds, CursorsAreThoseOfTheirLines) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300",
            "BUTTON 'b' \"B\" 1 1 75 23\nBUTTON 'c' \"C\" 1 30 75 23\nEDIT_FIELD 'e' \"E\" 1 60 75 20\n"
            "TEXT_FIELD 'l' \"L\" 1 90 75 15, LINK ACTION: ()\nCURSOR 'b' \"CROSS\"\nCURSOR \"WAIT\"\n");
  screen.Show(page);
  const struct {
    const wchar_t* szText;
    const wchar_t* pCursor;
  } rows[] = {{L"B", IDC_CROSS}, {L"C", IDC_WAIT}, {L"E", IDC_IBEAM}, {L"L", IDC_HAND}};
  for (const auto& row : rows) {
    const HWND hControl = screen.hChild(row.szText);
    SendMessageW(hControl, WM_SETCURSOR, reinterpret_cast<WPARAM>(hControl), MAKELPARAM(HTCLIENT, WM_MOUSEMOVE));
    EXPECT_EQ(GetCursor(), LoadCursorW(nullptr, row.pCursor)) << row.szText;
  }
}

TEST(SimpleKinds, SoundsPlayWhenTheyAreShown) {
  TestFolder folder;
  TestLog log(folder);
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300",
            "WAVE 'w' \"first.wav\", PLAY\nWAVE 'v' \"second.wav\"\nWAVE 'h' \"third.wav\", PLAY, HIDE\n");
  screen.Show(page);
  EXPECT_TRUE(screen.view->bShow(page["v"], true));
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
    const HWND hControl = GetDlgItem(screen.hWindow(), page["k"].m_iID);
    EXPECT_EQ(static_cast<COLORREF>(SendMessageW(hControl, row.uMessage, row.wParam, 0)), row.color) << row.szFlags;
  }
}

TEST(SimpleKinds, ArrowsMoveWithinAGroupOfRadioButtonsAndTabLeavesIt) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300",
            "GROUP\nCHECK_BOX 'a' \"A\" 1 1 75 15, RADIO_BUTTON\nCHECK_BOX 'b' \"B\" 1 20 75 15, RADIO_BUTTON\n"
            "CHECK_BOX 'c' \"C\" 1 40 75 15, RADIO_BUTTON\nEND_GROUP\nBUTTON 'x' \"X\" 1 60 75 23\n");
  ASSERT_TRUE(screen.view->bCreateDialog(page.info));
  for (const char* szName : {"a", "b", "c"}) screen.view->bSetText(page[szName], *szName == 'b' ? "1" : "0");
  screen.view->ShowDialog();
  EXPECT_EQ(GetFocus(), screen.hChild(L"B"));
  const struct {
    WPARAM wKey;
    const wchar_t* szFocus;
  } rows[] = {{VK_DOWN, L"C"}, {VK_RIGHT, L"A"}, {VK_TAB, L"X"}, {VK_TAB, L"A"}};
  for (const auto& row : rows) {
    screen.Key(row.wKey);
    screen.RunQueued();
    EXPECT_EQ(TextOf(GetFocus()), row.szFocus);
  }
  EXPECT_EQ(screen.TakeEvents(), (Events{"c 0", "a 0"}));
}

TEST(SimpleKinds, PicturesTellOfTheMouse) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300",
            "IMAGE 'i' none.bmp 10 20 40 40, CUSTOM ACTION: ()\nIMAGE 'silent' none.bmp 60 20 40 40, CUSTOM\n");
  screen.Show(page);
  for (const char* szName : {"i", "silent"})
    for (const UINT uMessage : {WM_MOUSEMOVE, WM_MOUSEMOVE, WM_LBUTTONDOWN, WM_LBUTTONUP, WM_MOUSELEAVE})
      PostMessageW(GetDlgItem(screen.hWindow(), page[szName].m_iID), uMessage, 0, MAKELPARAM(5, 5));
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
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300",
            "CHECK_BOX 'c' 10 10 13 13\nTEXT_FIELD 't' \" \" 35 10 90 15\nBUTTON 'b' \"B\" 10 40 75 23, FOCUS\n");
  screen.Show(page);
  const HWND hText = GetDlgItem(screen.hWindow(), page["t"].m_iID);
  const auto isMarked = [&] {
    for (int x = 0; x < 6; x++)
      if (PixelOf(hText, x, 0) != GetSysColor(COLOR_BTNFACE)) return true;
    return false;
  };
  EXPECT_FALSE(isMarked());
  SetFocus(GetDlgItem(screen.hWindow(), page["c"].m_iID));
  EXPECT_TRUE(isMarked());
  SetFocus(screen.hChild(L"B"));
  EXPECT_FALSE(isMarked());
  screen.TakeEvents();
  for (const UINT uMessage : {WM_LBUTTONDOWN, WM_LBUTTONUP, WM_LBUTTONDBLCLK, WM_LBUTTONUP})
    PostMessageW(GetDlgItem(screen.hWindow(), page["c"].m_iID), uMessage, 0, MAKELPARAM(5, 5));
  screen.RunQueued();
  EXPECT_EQ(screen.TakeEvents(), (Events{"c 0", "c 0"})) << "two quick clicks";
}

TEST(SimpleKinds, ValuesStayOverNextAndBack) {
  ExpectValuesStay("track = \"3\"\n",
                   "TRACKBAR 'track' 1 1 100 20\nUP_DOWN 'arrows' (0,9,4) 1 30 20 20\n"
                   "DATE_PICKER 'date' \"2026-11-21\" 1 60 100 20\n"
                   "MONTHCALENDAR 'month' \"2026-11-21\" 1 90 200 160\n"
                   "IPADDRESS 'ip' \"10.0.0.1\" 1 260 150 20\nHOTKEY 'key' \"A\" 1 290 100 20, CTRL\n"
                   "RICH_EDIT 'rich' \"kept\" 1 320 100 20, REMEMBER\nRICH_EDIT 'loose' \"given\" 1 350 100 20\n",
                   {{"track", "3", "8"},
                    {"arrows", "4", "6"},
                    {"date", "2026-11-21", "2026-12-24"},
                    {"month", "2026-11-21", "2026-11-30"},
                    {"ip", "10.0.0.1", "127.0.0.1"},
                    {"key", "Ctrl+A", "Alt+F4"},
                    {"rich", "kept", "kept too"},
                    {"loose", "given", "typed", true}});
}
