// Every kind as a real window against its script line; what real input tells the wizard; values that stay over pages.
// Kinds that hold others are looked at in LayoutWindowTest.cpp, menus and bars in MenuKindsTest.cpp.
#include "UsedPage.h"
#include "wizard/COrbitWizard.h"
// after windows.h, which it builds on
#include <richedit.h>

using Events = std::vector<std::string>;

namespace {

// All lines name their control 'k' and stand at 10 20.
struct KindRow {
  const char* szLines;
  const wchar_t* szClass;
  DWORD dwOn, dwOff;    // style bits that are set, bits that are not
  const char* szFirst;  // the value that the line gives, null for a kind without
  const char* szSet;    // a value set by the wizard ...
  const char* szRead;   // ... and what is read then
  UINT uCount = 0;      // of a kind with items: the message that counts them
  int nItems = 0;
};
const KindRow KINDS[] = {
    {"LIST_FIELD 'k' \"b\" \"<RGB(1,2,3),empty.bmp>šesti\" 10 20 90 80, OWNER_DRAWN, SORT", L"ListBox",
     LBS_OWNERDRAWFIXED | LBS_SORT | LBS_NOTIFY, LBS_MULTIPLESEL, "", "šesti", "šesti", LB_GETCOUNT, 2},
    {"SIMULATED_LIST_FIELD 'k' \"a\" \"b\" \"c\" 10 20 90 80, MULTIPLE_SEL, KEYINPUT", L"ListBox",
     LBS_MULTIPLESEL | LBS_WANTKEYBOARDINPUT, LBS_OWNERDRAWFIXED, "", "a\nnone\nc", "a\nc", LB_GETCOUNT, 3},
    {"COMBO_FIELD 'k' 10 20 90 20\nITEM \"one\"\n\"two\"\nEND_COMBO", L"ComboBox", CBS_DROPDOWNLIST, CBS_SORT, "",
     "two", "two", CB_GETCOUNT, 2},
    {"COMBO_FIELD 'k' 10 20 90 20\n\"one\"\nEND_COMBO", L"ComboBox", 0, 0, "", "other", "", CB_GETCOUNT, 1},
    {"COMBO_FIELD 'k' 10 20 90 20, EDIT, SORT\n\"b\"\n\"a\"\nEND_COMBO", L"ComboBox", CBS_DROPDOWN | CBS_SORT, 1, "",
     "Šuma", "Šuma", CB_GETCOUNT, 2},
    {"COMBO_FIELD 'k' 10 20 90 20, OWNER_DRAWN\n\"a\", RGB(1,2,3)\nEND_COMBO", L"ComboBox",
     CBS_OWNERDRAWFIXED | CBS_HASSTRINGS, 0, "", "a", "a", CB_GETCOUNT, 1},
    {"COMBO_FIELD 'k' 10 20 90 20, IMAGE_COMBO\n\"a\", empty.bmp\n\"b\"\nEND_COMBO", L"ComboBoxEx32", CBS_DROPDOWNLIST,
     0, "", "b", "b", CB_GETCOUNT, 2},
    {"COMBO_FIELD 'k' 10 20 90 20, IMAGE_COMBO, EDIT\n\"a\"\nEND_COMBO", L"ComboBoxEx32", CBS_DROPDOWN, 0, "", "typed",
     "typed", CB_GETCOUNT, 1},
    {TABLE, L"SysListView32", LVS_REPORT, LVS_SINGLESEL | LVS_NOSORTHEADER, "", "a\nc", "a\nc", LVM_GETITEMCOUNT, 3},
    {"LISTVIEW 'k' 10 20 90 80, LIST, SINGLE_SEL, SHOW_ALWAYS\nITEM \"a\"\n\"<RGB(9,9,9)>b\"\nEND_LISTVIEW",
     L"SysListView32", LVS_LIST | LVS_SINGLESEL | LVS_SHOWSELALWAYS | LVS_NOSORTHEADER, 0, "", "b", "b",
     LVM_GETITEMCOUNT, 2},
    {"LISTVIEW 'k' 10 20 90 80, NOCOLUMNHEADER, DISABLE\nITEM \"a\"\nEND_LISTVIEW", L"SysListView32",
     LVS_NOCOLUMNHEADER | WS_DISABLED, 0, "", "none", "", LVM_GETITEMCOUNT, 1},
    {TREE, L"SysTreeView32", TVS_CHECKBOXES | TVS_HASBUTTONS, TVS_DISABLEDRAGDROP, "Programs", "Programs\\Editor",
     "Programs\\Editor", TVM_GETCOUNT, 5},
    {"HEADER 'k' \"A\" \"B\" \"C\" 10 20 200 20 50, BUTTONS", L"SysHeader32", HDS_BUTTONS, WS_TABSTOP, "", "B", "B",
     HDM_GETITEMCOUNT, 3},
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

}  // namespace

TEST(Kinds, AreTheWindowsAndValuesOfTheirLines) {
  for (const KindRow& row : KINDS) {
    SCOPED_TRACE(row.szLines);
    UsedPage screen(row.szLines);
    ASSERT_NE(screen.hWnd, nullptr);
    wchar_t name[64] = L"";
    GetClassNameW(screen.hWnd, name, 64);
    EXPECT_EQ(lstrcmpiW(name, row.szClass), 0);
    const auto dwStyle = static_cast<DWORD>(GetWindowLongW(screen.hWnd, GWL_STYLE));
    EXPECT_EQ(dwStyle & (row.dwOn | row.dwOff | WS_VISIBLE), row.dwOn | WS_VISIBLE) << std::hex << dwStyle;
    EXPECT_EQ(IsWindowEnabled(screen.hWnd), !(row.dwOn & WS_DISABLED));
    RECT place = AreaOf(screen.hWnd, screen.hWindow());
    const int* const iSize = screen["k"].m_iSize;
    if (row.uCount == LB_GETCOUNT || row.uCount == CB_GETCOUNT)
      place.bottom = 20 + iSize[3];  // lists take whole lines, combo boxes their own height
    EXPECT_EQ(PlaceText(place), "10 20 " + std::to_string(iSize[2]) + " " + std::to_string(iSize[3]));
    if (!row.szFirst) continue;
    EXPECT_EQ(screen.Value("k"), row.szFirst);
    if (row.uCount) screen.bSet("k", "b");  // an item that is not to stay
    EXPECT_TRUE(screen.bSet("k", row.szSet));
    EXPECT_EQ(screen.Value("k"), row.szRead);
    EXPECT_EQ(screen.Told(), Events()) << "what the wizard does itself is not told";
    if (!row.uCount) continue;
    EXPECT_EQ(SendMessageW(screen.hWnd, row.uCount, 0, 0), row.nItems);
    screen.Fill(screen["k"]);
    EXPECT_EQ(screen.Value("k"), row.szRead) << "new texts keep the selection";
    EXPECT_EQ(SendMessageW(screen.hWnd, row.uCount, 0, 0), row.nItems);
    LOGFONTW font = {};
    GetObjectW(reinterpret_cast<HFONT>(SendMessageW(screen.hWnd, WM_GETFONT, 0, 0)), sizeof(font), &font);
    EXPECT_EQ(font.lfHeight, 15);
  }
}

TEST(Kinds, TellOfWhatAPersonDoes) {
  const char* const COMBO = "COMBO_FIELD 'k' 10 20 90 20\n\"a\"\n\"b\"\nEND_COMBO";
  const struct {
    const char* szLines;
    std::vector<WPARAM> keys;
    Events told;
    const char* szValue;  // null: whatever the system makes of it
    POINT at = {};
    int nClicks = 0;    // there, before the keys
    WPARAM wTyped = 0;  // a character, behind them
  } ROWS[] = {
      {"LIST_FIELD 'k' \"a\" \"b\" 10 20 90 80, DRAG", {}, {"k 1"}, "b", {5, 20}, 1},
      {"LIST_FIELD 'k' \"a\" \"b\" 10 20 90 80", {}, {"k 1", "k 2"}, "a", {5, 5}, 2},
      {"LIST_FIELD 'k' \"a\" \"b\" 10 20 90 80, KEYINPUT", {VK_DOWN, VK_RETURN}, {"k 1", "k 2"}, "a"},
      {COMBO, {VK_F4, VK_ESCAPE}, {"k 7", "k 8"}, ""},
      {COMBO, {VK_F4, VK_DOWN, VK_DOWN, VK_RETURN}, {"k 7", "k 8", "k 1"}, "b"},
      {COMBO, {VK_DOWN, VK_HOME}, {"k 1"}, "a"},  // told once
      {"COMBO_FIELD 'k' 10 20 90 20, IMAGE_COMBO\n\"a\"\n\"b\"\nEND_COMBO",
       {VK_F4, VK_ESCAPE, VK_DOWN},
       {"k 7", "k 8", "k 1"},
       "a"},
      {"COMBO_FIELD 'k' 10 20 90 20, EDIT\n\"a\"\nEND_COMBO", {}, {"k 6", "k 5"}, "x", {}, 0, 'x'},
      {TABLE, {}, {"k 1"}, "b", {40, 50}, 1},
      {TABLE, {}, {"k 1", "item open b"}, "b", {200, 50}, 2},
      {TABLE, {VK_DOWN, VK_DOWN, VK_RETURN}, {"k 1", "k 1", "item open b"}, "b"},
      {TREE, {VK_DOWN, VK_DOWN}, {"k 1", "k 1"}, "Programs\\Plumo"},
      {TREE, {VK_DOWN, VK_DOWN, VK_DOWN, VK_RETURN}, {"k 1", "k 1", "k 1", "item edit"}, "Programs\\Editor"},
      {"HEADER 'k' \"A\" \"B\" 10 20 200 20, BUTTONS", {}, {"k 0"}, "B", {150, 10}, 1},
      {"TRACKBAR 'k' \"0 100\" 10 20 150 40", {VK_RIGHT}, {"k 1"}, "1"},
      {"UP_DOWN 'k' (0,9,4) 10 20 20 40", {}, {"k 1"}, "5", {5, 5}, 1},
      {"DATE_PICKER 'k' \"2026-11-21\" 10 20 150 24", {VK_UP}, {"k 1"}, nullptr},
      {"MONTHCALENDAR 'k' \"2026-11-21\" 10 20 0 0", {}, {"k 1"}, nullptr, {60, 90}, 1},
      {"HOTKEY 'k' 10 20 150 24", {VK_F5}, {"k 1"}, "F5"},
      {"RICH_EDIT 'k' 10 20 150 24", {}, {}, "x", {}, 0, 'x'},
  };
  for (const auto& row : ROWS) {
    SCOPED_TRACE(row.szLines);
    UsedPage screen(row.szLines);
    if (row.nClicks == 1) screen.Click(row.at.x, row.at.y);
    if (row.nClicks == 2) screen.DoubleClick(row.at.x, row.at.y);
    for (const WPARAM wKey : row.keys) screen.Press({wKey});
    if (row.wTyped) PostMessageW(GetFocus(), WM_CHAR, row.wTyped, 1);
    EXPECT_EQ(screen.Told(), row.told);
    if (row.szValue) {
      EXPECT_EQ(screen.Value("k"), row.szValue);
    }
  }
}

namespace {

struct WalkedField {
  const char *szName, *szFirst, *szChanged;
  bool bForgets = false;  // it comes back with its first value
};

// A wizard of two pages that walks through them by itself: each call of the command Walk looks at the fields, changes
// them and takes the next step (Next, Back, Next, Back, end).
class WalkingWizard : public COrbitWizard {
 public:
  WalkingWizard(WizardView& view, const std::vector<WalkedField>& fields)
      : COrbitWizard(view), m_View(view), m_Fields(fields) {}
  int iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pCommandResult,
                       CNString* pOutput) override {
    if (strcmp(szCommand, "Walk") != 0)
      return COrbitWizard::iExecuteFunction(szCommand, szParam, iFlag, pCommandResult, pOutput);
    static const int STEPS[] = {ID_NEXT, ID_BACK, ID_NEXT, ID_BACK, ID_EXIT};
    CNString csText;
    for (const WalkedField& field : m_Fields) {
      const BaseControl* pControl = GetBaseControl(field.szName);
      if (!pControl) continue;  // on the other page
      EXPECT_TRUE(m_View.bGetText(*pControl, csText));
      EXPECT_STREQ(csText.Text(), m_iStep && !field.bForgets ? field.szChanged : field.szFirst) << field.szName;
      m_View.bSetText(*pControl, field.szChanged);
    }
    m_View.PostCommand(STEPS[m_iStep++]);
    return 0;
  }
  int m_iStep = 0;

 private:
  WizardView& m_View;
  const std::vector<WalkedField>& m_Fields;
};

// The fields' values stay over Next and Back. szInit: the script's variables; szControls: the first page's lines.
void ExpectValuesStay(const char* szInit, const std::string& controls, const std::vector<WalkedField>& fields) {
  const std::unique_ptr<WizardView> view = pMakeWin32View(GetModuleHandleW(nullptr));
  WalkingWizard wizard(*view, fields);
  const std::string walk = "START_AFTER_DRAWING\nSTART_ACTION\nWalk ()\nFINISH_ACTION\nEND\nCONTINUE\n";
  const std::string script = std::string("INIT\n") + szInit + "END_INIT\nDIALOG1 'a' \"\" 0 0 400 400\nBEGIN\n" +
                             controls + walk + "END_DIALOG1\nDIALOG2 'b' \"\" 0 0 400 300\nBEGIN\n" + walk +
                             "END_DIALOG2\n";
  EXPECT_EQ(wizard.iExecuteWizard(script.c_str(), 0), 0);
  EXPECT_EQ(wizard.m_iStep, 5);
}

}  // namespace

TEST(Kinds, ValuesStayOverNextAndBack) {
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

TEST(Kinds, ItemsThatAreChosenStayOverNextAndBack) {
  ExpectValuesStay("names = \"b\"\n",
                   "LISTVIEW 'names' 10 10 200 100, CHECKBOX\nCOLUMN \"N\" 90\nITEM \"a\"\nITEM \"<%names%>\"\n"
                   "END_LISTVIEW\nTREE_VIEW 'tree' 10 120 200 100\nITEM \"T\"\nITEM '1,0' \"U\"\nEND_TREE_VIEW\n"
                   "COMBO_FIELD 'combo' 220 10 100 20, EDIT\n\"c\"\nEND_COMBO\n",
                   {{"names", "b", "a"}, {"tree", "", "T\\U"}, {"combo", "", "typed"}});
}

TEST(Kinds, InnerValuesStayOverNextAndBack) {
  ExpectValuesStay("in = \"x\"\n",
                   "FRAME 'f' 1 1 300 100\nEDIT_FIELD 'name' 1 1 100 20\nGROUP_BOX 'g' 1 30 200 60\n"
                   "CHECK_BOX 'box' 1 1 90 15\nEND_GROUP_BOX\nEND_FRAME\nTAB_CONTROL 'tabs' 1 110 200 90\n"
                   "TAB \"<%in%>\"\nEDIT_FIELD 'in' 1 1 60 20\nEND_TAB\nTAB \"B\"\nEND_TAB\nEND_TAB_CONTROL\n",
                   {{"name", "", "Ana"}, {"box", "0", "1"}, {"tabs", "1", "2"}, {"in", "x", "y"}});
}
