// Lists, combo boxes, list views, trees and headers as real windows: made from their lines, used with mouse and keys.
#include <algorithm>

#include "Page.h"
#include "controls/ItemKinds.h"
#include "wizard/COrbitWizard.h"

using Events = std::vector<std::string>;

namespace {

const char* const TREE =
    "TREE_VIEW 'k' 10 20 200 150, CHECKBOX, DRAG ACTION: ()\nITEM \"Programs\"\nITEM '1,0' \"Plumo\", CHECKED\n"
    "ITEM '1,1' \"Editor\" ACTION: (edit)\nITEM '1,0' \"Zero\", DISABLE\nITEM \"Documents\"\nEND_TREE_VIEW";
const char* const TABLE =
    "LISTVIEW 'k' 10 20 300 150, REPORT, CHECKBOX, SORT, FULL_ROW_SEL ACTION: ()\nCOLUMN \"Name\" 100, EDIT\n"
    "COLUMN \"Size\" \"1\" \"20\" 80, RIGHT, COMBO\nCOLUMN \"Note\" 60\nITEM \"a\" \"10\", VAR(x), CHECKED\nITEM \"b\" "
    "\"9\" ACTION: (open "
    "b)\n"
    "ITEM \"c\" \"100\", DISABLE\nEND_LISTVIEW";

// A page of one control, its items filled in as the wizard does it, and what a person does to it.
struct Shown {
  explicit Shown(const char* szLines) : page(DialogKind::DialogSys, "0 0 500 400", szLines) {
    EXPECT_TRUE(screen.view->bCreateDialog(page.info));
    for (int i = 0; i < page.info.m_Controls.Size(); i++) Fill(*page.info.m_Controls[i]);
    screen.view->ShowDialog();
    hWnd = hOf("k");
    SetFocus(hWnd);
    Told();
  }
  void Fill(const BaseControl& control) {
    CNCharArray texts;
    if (control.bItemTexts(texts)) screen.view->bSetItems(control, texts);
  }
  HWND hOf(const char* szName) { return GetDlgItem(screen.hWindow(), page[szName].m_iID); }
  std::string Value(const char* szName = "k") {
    CNString csText;
    return screen.view->bGetText(page[szName], csText) ? csText.Text() : "(no window)";
  }
  Shown& Mouse(HWND hTarget, UINT uMessage, int x, int y) {
    POINT point = {x, y};
    ClientToScreen(hTarget, &point);
    SetCursorPos(point.x, point.y);
    PostMessageW(hTarget, uMessage, uMessage == WM_MOUSEMOVE ? MK_LBUTTON : 0, MAKELPARAM(x, y));
    return *this;
  }
  Shown& Click(int x, int y) { return Mouse(hWnd, WM_LBUTTONDOWN, x, y).Mouse(hWnd, WM_LBUTTONUP, x, y); }
  Shown& DoubleClick(int x, int y) {
    return Click(x, y).Mouse(hWnd, WM_LBUTTONDBLCLK, x, y).Mouse(hWnd, WM_LBUTTONUP, x, y);
  }
  Shown& Key(WPARAM wKey) {
    screen.Key(wKey);
    screen.RunQueued();
    return *this;
  }
  Events Told() {
    for (int i = 0; i < 3; i++) screen.RunQueued();
    return screen.TakeEvents();
  }
  std::string Written(const char* szName = "k") {
    CNString csOut;
    page[szName].WriteControl(csOut);
    return csOut.Text();
  }

  Screen screen;
  Page page;
  HWND hWnd = nullptr;
};

struct KindRow {
  const char* szLines;
  const wchar_t* szClass;
  DWORD dwOn, dwOff;
  UINT uCount;
  int iCount;
  const char *szSet, *szRead;
};
const KindRow KINDS[] = {
    {"LIST_FIELD 'k' \"b\" \"<RGB(1,2,3),empty.bmp>a\" 10 20 90 80, OWNER_DRAWN, SORT", L"ListBox",
     LBS_OWNERDRAWFIXED | LBS_SORT | LBS_NOTIFY, LBS_MULTIPLESEL, LB_GETCOUNT, 2, "a", "a"},
    {"SIMULATED_LIST_FIELD 'k' \"a\" \"b\" \"c\" 10 20 90 80, MULTIPLE_SEL, KEYINPUT", L"ListBox",
     LBS_MULTIPLESEL | LBS_WANTKEYBOARDINPUT, LBS_OWNERDRAWFIXED, LB_GETCOUNT, 3, "a\nnone\nc", "a\nc"},
    {"COMBO_FIELD 'k' 10 20 90 20\nITEM \"one\"\n\"two\"\nEND_COMBO", L"ComboBox", CBS_DROPDOWNLIST, CBS_SORT,
     CB_GETCOUNT, 2, "two", "two"},
    {"COMBO_FIELD 'k' 10 20 90 20\n\"one\"\nEND_COMBO", L"ComboBox", 0, 0, CB_GETCOUNT, 1, "other", ""},
    {"COMBO_FIELD 'k' 10 20 90 20, EDIT, SORT\n\"b\"\n\"a\"\nEND_COMBO", L"ComboBox", CBS_DROPDOWN | CBS_SORT, 1,
     CB_GETCOUNT, 2, "Šuma", "Šuma"},
    {"COMBO_FIELD 'k' 10 20 90 20, OWNER_DRAWN\n\"a\", RGB(1,2,3)\nEND_COMBO", L"ComboBox",
     CBS_OWNERDRAWFIXED | CBS_HASSTRINGS, 0, CB_GETCOUNT, 1, "a", "a"},
    {"COMBO_FIELD 'k' 10 20 90 20, IMAGE_COMBO\n\"a\", empty.bmp\n\"b\"\nEND_COMBO", L"ComboBoxEx32", CBS_DROPDOWNLIST,
     0, CB_GETCOUNT, 2, "b", "b"},
    {"COMBO_FIELD 'k' 10 20 90 20, IMAGE_COMBO, EDIT\n\"a\"\nEND_COMBO", L"ComboBoxEx32", CBS_DROPDOWN, 0, CB_GETCOUNT,
     1, "typed", "typed"},
    {TABLE, L"SysListView32", LVS_REPORT, LVS_SINGLESEL | LVS_NOSORTHEADER, LVM_GETITEMCOUNT, 3, "a\nc", "a\nc"},
    {"LISTVIEW 'k' 10 20 90 80, LIST, SINGLE_SEL, SHOW_ALWAYS\nITEM \"a\"\n\"<RGB(9,9,9)>b\"\nEND_LISTVIEW",
     L"SysListView32", LVS_LIST | LVS_SINGLESEL | LVS_SHOWSELALWAYS | LVS_NOSORTHEADER, 0, LVM_GETITEMCOUNT, 2, "b",
     "b"},
    {"LISTVIEW 'k' 10 20 90 80, NOCOLUMNHEADER, DISABLE\nITEM \"a\"\nEND_LISTVIEW", L"SysListView32",
     LVS_NOCOLUMNHEADER | WS_DISABLED, 0, LVM_GETITEMCOUNT, 1, "none", ""},
    {TREE, L"SysTreeView32", TVS_CHECKBOXES | TVS_HASBUTTONS, TVS_DISABLEDRAGDROP, TVM_GETCOUNT, 5, "Programs\\Editor",
     "Programs\\Editor"},
    {"HEADER 'k' \"A\" \"B\" \"C\" 10 20 200 20 50, BUTTONS", L"SysHeader32", HDS_BUTTONS, WS_TABSTOP, HDM_GETITEMCOUNT,
     3, "B", "B"},
};

}  // namespace

TEST(ItemKinds, AreTheWindowsOfTheirLines) {
  for (const KindRow& row : KINDS) {
    SCOPED_TRACE(row.szLines);
    Shown shown(row.szLines);
    wchar_t name[64] = L"";
    GetClassNameW(shown.hWnd, name, 64);
    EXPECT_STRCASEEQ(std::string(name, name + lstrlenW(name)).c_str(),
                     std::string(row.szClass, row.szClass + lstrlenW(row.szClass)).c_str());
    const DWORD dwStyle = static_cast<DWORD>(GetWindowLongW(shown.hWnd, GWL_STYLE));
    EXPECT_EQ(dwStyle & (row.dwOn | row.dwOff), row.dwOn) << std::hex << dwStyle;
    EXPECT_EQ(IsWindowEnabled(shown.hWnd), !(row.dwOn & WS_DISABLED));
    RECT place;
    GetWindowRect(shown.hWnd, &place);
    MapWindowPoints(nullptr, shown.screen.hWindow(), reinterpret_cast<POINT*>(&place), 2);
    EXPECT_TRUE(place.left == 10 && place.top == 20 && place.right - place.left == shown.page["k"].m_iSize[2]);
    LOGFONTW font = {};
    GetObjectW(reinterpret_cast<HFONT>(SendMessageW(shown.hWnd, WM_GETFONT, 0, 0)), sizeof(font), &font);
    EXPECT_EQ(font.lfHeight, 15);
    EXPECT_EQ(SendMessageW(shown.hWnd, row.uCount, 0, 0), row.iCount);
    EXPECT_EQ(shown.Value(), row.uCount == TVM_GETCOUNT ? "Programs" : "") << "a tree selects what has the keyboard";
    EXPECT_TRUE(shown.screen.view->bSetText(shown.page["k"], row.szSet));
    EXPECT_EQ(shown.Value(), row.szRead);
    shown.Fill(shown.page["k"]);
    EXPECT_EQ(shown.Value(), row.szRead) << "new texts keep the selection";
    EXPECT_EQ(SendMessageW(shown.hWnd, row.uCount, 0, 0), row.iCount);
    EXPECT_EQ(shown.Told(), Events()) << "what the wizard does itself is not told";
  }
}

TEST(ItemKinds, TellOfWhatAPersonChooses) {
  const struct {
    const char* szLines;
    void (*pDo)(Shown& shown);
    Events told;
    const char* szValue;
  } ROWS[] = {
      {"LIST_FIELD 'k' \"a\" \"b\" 10 20 90 80, DRAG", [](Shown& s) { s.Click(5, 20); }, {"k 1"}, "b"},
      {"LIST_FIELD 'k' \"a\" \"b\" 10 20 90 80", [](Shown& s) { s.DoubleClick(5, 5); }, {"k 1", "k 2"}, "a"},
      {"LIST_FIELD 'k' \"a\" \"b\" 10 20 90 80, KEYINPUT",
       [](Shown& s) { s.Key(VK_DOWN).Key(VK_RETURN); },
       {"k 1", "k 2"},
       "a"},
      {"COMBO_FIELD 'k' 10 20 90 20\n\"a\"\n\"b\"\nEND_COMBO",
       [](Shown& s) { s.Key(VK_F4).Key(VK_ESCAPE); },
       {"k 7", "k 8"},
       ""},
      {"COMBO_FIELD 'k' 10 20 90 20\n\"a\"\n\"b\"\nEND_COMBO",
       [](Shown& s) { s.Key(VK_F4).Key(VK_DOWN).Key(VK_DOWN).Key(VK_RETURN); },
       {"k 7", "k 8", "k 1"},
       "b"},
      {"COMBO_FIELD 'k' 10 20 90 20\n\"a\"\n\"b\"\nEND_COMBO", [](Shown& s) { s.Key(VK_DOWN); }, {"k 1"}, "a"},
      {"COMBO_FIELD 'k' 10 20 90 20, IMAGE_COMBO\n\"a\"\n\"b\"\nEND_COMBO",
       [](Shown& s) { s.Key(VK_F4).Key(VK_ESCAPE).Key(VK_DOWN); },
       {"k 7", "k 8", "k 1"},
       "a"},
      {"COMBO_FIELD 'k' 10 20 90 20, EDIT\n\"a\"\nEND_COMBO",
       [](Shown&) { PostMessageW(GetFocus(), WM_CHAR, 'x', 1); },
       {"k 6", "k 5"},
       "x"},
      {TABLE, [](Shown& s) { s.Click(40, 50); }, {"k 1"}, "b"},
      {TABLE, [](Shown& s) { s.DoubleClick(200, 50); }, {"k 1", "item open b"}, "b"},
      {TABLE, [](Shown& s) { s.Key(VK_DOWN).Key(VK_DOWN).Key(VK_RETURN); }, {"k 1", "k 1", "item open b"}, "b"},
      {TREE, [](Shown& s) { s.Key(VK_DOWN).Key(VK_DOWN); }, {"k 1", "k 1"}, "Programs\\Plumo"},
      {TREE,
       [](Shown& s) { s.screen.view->bSetText(s.page["k"], "Programs\\Editor"), s.Key(VK_RETURN); },
       {"item edit"},
       "Programs\\Editor"},
      {"HEADER 'k' \"A\" \"B\" 10 20 200 20, BUTTONS", [](Shown& s) { s.Click(150, 10); }, {"k 0"}, "B"},
  };
  for (const auto& row : ROWS) {
    SCOPED_TRACE(row.szLines);
    Shown shown(row.szLines);
    row.pDo(shown);
    EXPECT_EQ(shown.Told(), row.told);
    EXPECT_EQ(shown.Value(), row.szValue);
  }
}

TEST(ItemKinds, LeaveNoGdiObjectsBehind) {
  // The system gives the lowest free number: it grows with the objects that are left.
  const auto number = [] {
    OwnedBrush brushes[8];
    uintptr_t uHighest = 0;
    for (OwnedBrush& brush : brushes) {
      brush.Reset(CreateSolidBrush(RGB(1, 2, 3)));
      uHighest = std::max(uHighest, reinterpret_cast<uintptr_t>(brush.Get()) & 0xFFFF);
    }
    return static_cast<int>(uHighest);
  };
  for (const KindRow& row : KINDS) {
    Shown shown(row.szLines);
    int iBefore = 0;
    for (int i = 0; i < 40; i++) {
      if (i == 10) iBefore = number();
      shown.screen.Show(shown.page);
      shown.Fill(shown.page["k"]);
    }
    EXPECT_LT(number() - iBefore, 30) << "one for each page: " << row.szLines;
  }
}

TEST(ItemKinds, TicksAreKeptAndThoseOfDisabledItemsStand) {
  for (const char* szLines : {TABLE, TREE}) {
    SCOPED_TRACE(szLines);
    Shown shown(szLines);
    const auto& control = *shown.page["k"].pItemControl();
    std::string ticks;
    bool bChecked = false;
    for (int i = 0; i < control.m_Items.Size(); i++)
      ticks += !shown.screen.view->bIsItemChecked(control, i, bChecked) ? '-' : bChecked ? '1' : '0';
    EXPECT_EQ(ticks, szLines == TREE ? "01000" : "---100");
    const int iOpen = szLines == TREE ? 2 : 4, iDisabled = szLines == TREE ? 3 : 5;
    const char* const PATHS[][2] = {{"Programs\\Editor", "Programs\\Zero"}, {"b", "c"}};
    for (const int iItem : {iOpen, iDisabled}) {
      shown.screen.view->bSetText(shown.page["k"], PATHS[szLines == TABLE][iItem == iDisabled]);
      shown.Key(VK_SPACE);
      EXPECT_TRUE(shown.screen.view->bIsItemChecked(control, iItem, bChecked));
      EXPECT_EQ(bChecked, iItem == iOpen);
    }
    EXPECT_EQ(shown.Told(), Events{"k 1"});
    EXPECT_TRUE(shown.screen.view->bCheckItem(control, iOpen, false));
    EXPECT_TRUE(shown.screen.view->bIsItemChecked(control, iOpen, bChecked) && !bChecked);
  }
}

TEST(ItemKinds, CellsAreEditedAndColumnsSorted) {
  Shown shown(TABLE);
  const auto order = [&] {
    std::string rows;
    for (int i = 0; i < 3; i++) {
      wchar_t text[20] = L"";
      ListView_GetItemText(shown.hWnd, i, 0, text, 20);
      rows += static_cast<char>(text[0]);
    }
    return rows;
  };
  SendMessageW(shown.hWnd, LVM_SETITEMSTATE, 0, 0);
  shown.screen.view->bSetText(shown.page["k"], "a");
  for (const WPARAM wEnd : {VK_ESCAPE, VK_RETURN}) {
    shown.Key(VK_F2);
    ASSERT_NE(GetFocus(), shown.hWnd);
    PostMessageW(GetFocus(), WM_CHAR, 'z', 1);
    shown.Key(wEnd);
    EXPECT_EQ(GetFocus(), shown.hWnd);
    EXPECT_EQ(order(), wEnd == VK_RETURN ? "zbc" : "abc");
  }
  EXPECT_EQ(shown.Told(), Events{"k 5"});
  EXPECT_NE(shown.Written().find("ITEM \"z\" \"10\""), std::string::npos) << shown.Written();
  shown.DoubleClick(120, 50).screen.RunQueued();  // the size of b: a choice of 1 and 20
  shown.Key(VK_DOWN).Key(VK_RETURN);
  EXPECT_NE(shown.Written().find("ITEM \"b\" \"1\""), std::string::npos) << shown.Written();
  const HWND hHeader = ListView_GetHeader(shown.hWnd);
  for (const char* szOrder : {"bzc", "czb"}) {
    shown.Mouse(hHeader, WM_LBUTTONDOWN, 140, 8).Mouse(hHeader, WM_LBUTTONUP, 140, 8).screen.RunQueued();
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
    Shown shown(row.szLines);
    shown.Mouse(shown.hWnd, WM_LBUTTONDOWN, row.from.x, row.from.y);
    shown.Mouse(shown.hWnd, WM_MOUSEMOVE, 40, 40).Mouse(shown.hWnd, WM_MOUSEMOVE, row.to.x, row.to.y);
    shown.screen.RunQueued();
    EXPECT_EQ(GetCapture(), shown.hWnd);
    if (row.bEscape) shown.Key(VK_ESCAPE);
    shown.Mouse(shown.hWnd, WM_LBUTTONUP, row.to.x, row.to.y);
    shown.Told();
    EXPECT_EQ(GetCapture(), nullptr);
    EXPECT_NE(shown.Written().find(row.szWritten), std::string::npos) << shown.Written();
    if (row.to.x != 120) continue;
    EXPECT_NE(shown.Written("other").find("\"x\" \"<RGB(1,2,3)>b\""), std::string::npos);
    EXPECT_EQ(shown.Value("other"), "b");
  }
}

TEST(ItemKinds, BranchesOfATreeAreMovedWithTheMouse) {
  Shown shown(TREE);
  const auto middle = [&](const char* szPath, int iBelow) {
    shown.screen.view->bSetText(shown.page["k"], szPath);
    RECT row;
    TreeView_GetItemRect(shown.hWnd, TreeView_GetSelection(shown.hWnd), &row, TRUE);
    return POINT{row.left + 5, (row.top + row.bottom) / 2 + iBelow};
  };
  const auto move = [&](POINT from, POINT to) {
    shown.Mouse(shown.hWnd, WM_LBUTTONDOWN, from.x, from.y);
    for (const POINT p : {POINT{from.x + 20, from.y}, to, to}) shown.Mouse(shown.hWnd, WM_MOUSEMOVE, p.x, p.y);
    shown.Mouse(shown.hWnd, WM_LBUTTONUP, to.x, to.y);
    return shown.Told();
  };
  const POINT programs = middle("Programs", 0), documents = middle("Documents", 4);
  move(programs, documents);
  EXPECT_EQ(shown.Value(), "Documents\\Programs");
  EXPECT_NE(shown.Written().find("ITEM '0,0' \"Documents\"\nITEM '1,0' \"Programs\"\nITEM '2,0' \"Zero\",DISABLE\n"
                                 "ITEM '2,1' \"Plumo\",CHECKED\nITEM '2,2' \"Editor\" ACTION: (edit)\n"),
            std::string::npos)
      << shown.Written();
  const POINT outer = middle("Documents", 0), inner = middle("Documents\\Programs\\Plumo", 4);
  move(outer, inner);
  EXPECT_NE(shown.Written().find("ITEM '0,0' \"Documents\"\n"), std::string::npos) << "nothing moves into itself";
}

namespace {

// Does one step each time the wizard's loop is idle for a moment.
std::vector<std::function<void()>> g_steps;

void CALLBACK Step(HWND, UINT, UINT_PTR idTimer, DWORD) {
  if (g_steps.empty()) {
    KillTimer(nullptr, idTimer);
    return;
  }
  const auto step = g_steps.front();
  g_steps.erase(g_steps.begin());
  step();
}

}  // namespace

TEST(ItemKinds, ValuesAndTicksAreKeptFromPageToPage) {
  const char* const SCRIPT =
      "INIT\nfull = \"1\"\nnames = \"b\"\nEND_INIT\nDIALOG1 DIALOG_SYS 'one' \"\" 0 0 500 400\nBEGIN\n"
      "LISTVIEW 'names' 10 10 200 100, CHECKBOX\nCOLUMN \"N\" 90\nITEM \"a\"\nITEM \"<%names%>\", VAR(full)\n"
      "END_LISTVIEW\nTREE_VIEW 'tree' 10 120 200 100\nITEM \"T\"\nITEM '1,0' \"U\"\nEND_TREE_VIEW\n"
      "COMBO_FIELD 'combo' 220 10 100 20, EDIT\n\"c\"\nEND_COMBO\nEND\nCONTINUE\nEND_DIALOG1\n"
      "DIALOG2 DIALOG_SYS 'two' \"\" 0 0 300 200\nBEGIN\nEND\nCONTINUE\nEND_DIALOG2\n";
  const std::unique_ptr<WizardView> view = pMakeWin32View(GetModuleHandleW(nullptr));
  COrbitWizard wizard(*view);
  Events seen;
  const auto see = [&] {
    CNString csText;
    std::string state;
    for (const char* szName : {"names", "tree", "combo"})
      state += view->bGetText(*wizard.GetBaseControl(szName), csText) ? csText.Text() : "?";
    bool bChecked = false;
    view->bIsItemChecked(*wizard.GetBaseControl("names")->pItemControl(), 2, bChecked);
    seen.push_back(state + (bChecked ? "1" : "0"));
  };
  g_steps = {see,
             [&] {
               view->bSetText(*wizard.GetBaseControl("names"), "a");
               view->bSetText(*wizard.GetBaseControl("tree"), "T\\U");
               view->bSetText(*wizard.GetBaseControl("combo"), "typed");
               view->bCheckItem(*wizard.GetBaseControl("names")->pItemControl(), 2, false);
             },
             [&] { view->PostCommand(ID_NEXT); },
             [&] { seen.push_back(std::string(wizard.szValue("tree")) + wizard.szValue("full")); },
             [&] { view->PostCommand(ID_BACK); },
             see,
             [&] { wizard.QuitWizard(); }};
  SetTimer(nullptr, 0, 50, Step);
  EXPECT_EQ(wizard.iExecuteWizard(SCRIPT, 0), 0);
  EXPECT_EQ(seen, (Events{"b1", "T\\U0", "aT\\Utyped0"}));
}
