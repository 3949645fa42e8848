// What holds items as its lines describe it: lists, combo boxes, list views, trees, headers, menus, bars; and keys.
#include "controls/ItemKinds.h"

#include "ControlReader.h"
#include "controls/MenuKinds.h"

namespace {

TEST(ItemKinds, WhatIsReadIsWrittenBack) {
  const uint32_t REPORT = STYLE_LVS_REPORT | STYLE_LVS_NOSORTHEADER;
  const struct {
    const char* szLines;
    const char* szDump;  // null: as the lines
    uint32_t dwStyle;    // beside the one that every control begins with
  } rows[] = {
      {"COMBO_FIELD 'c' 1 2 3 4\n \"one\"\nnoise\nITEM \"<RGB(1,2,3)>two\" TOOLTIP 'tip',x.bmp\nEND_COMBO_FIELD",
       "COMBO_FIELD 'c' 1 2 3 4\nITEM \"one\"\nITEM \"<RGB(1,2,3)>two\" TOOLTIP 'tip',x.bmp\nEND_COMBO",
       STYLE_VSCROLL | STYLE_CBS_DROPDOWNLIST},
      {"COMBO_FIELD 'c' 1 2 3 4,EDIT, SORT, OWNER_DRAWN\nEND_COMBO", nullptr,
       STYLE_VSCROLL | STYLE_CBS_DROPDOWN | STYLE_CBS_AUTOHSCROLL | STYLE_CBS_SORT | STYLE_CBS_OWNERDRAWFIXED |
           STYLE_CBS_HASSTRINGS},
      {"COMBO_FIELD 'c' 1 2 3 4,IMAGE_COMBO, OWNER_DRAWN\nEND_COMBO", nullptr, STYLE_VSCROLL | STYLE_CBS_DROPDOWNLIST},
      {"LISTVIEW 'l' 1 2 3 4,REPORT, LIST, NOCOLUMNHEADER\nCOLUMN \"A\" 90 0 0 0,RIGHT\nITEM \"a\" \"\" \"1\",CHECKED\n"
       "ITEM 'open' \"b\" ACTION: (b)\nEND_LISTVIEW",
       nullptr, REPORT | STYLE_LVS_NOCOLUMNHEADER},
      {"LISTVIEW 'l' 1 2 3 4,LIST, SORT, SINGLE_SEL, SHOW_ALWAYS\nEND_LISTVIEW", nullptr,
       STYLE_LVS_LIST | STYLE_LVS_SINGLESEL | STYLE_LVS_SHOWSELALWAYS},
      {"TREE_VIEW 't' 1 2 3 4\nITEM \"a\"\nITEM '1,0' \"b\",VAR(v), DISABLE ACTION: (go)\nEND_TREE_VIEW", nullptr,
       STYLE_TVS_LOOK | STYLE_TVS_DISABLEDRAGDROP},
      {"TREE_VIEW 't' 1 2 3 4,CHECKBOX, GLOBAL_R_DRAG\nEND_TREE_VIEW", nullptr, STYLE_TVS_LOOK | STYLE_TVS_CHECKBOXES},
      {"HEADER 'h' \"a\" \"<RIGHT,x.bmp>b\" 1 2 3 4 50 60,BUTTONS", nullptr, STYLE_HDS_BUTTONS},
  };
  for (const auto& row : rows) {
    ControlReader reader(row.szLines);
    reader.ReadTight();
    ASSERT_EQ(reader.Count(), 1) << row.szLines;
    EXPECT_EQ(reader.Dump(), row.szDump ? row.szDump : row.szLines);
    EXPECT_EQ(ControlReader(reader.Dump()).Read().Dump(), reader.Dump());
    EXPECT_EQ(reader.sink.shown.size(), 0u) << row.szLines;
    const uint32_t dwBase =
        reader.Control().Kind() == ControlKind::Header ? STYLE_CONTROL_DEFAULT & ~STYLE_TABSTOP : STYLE_CONTROL_DEFAULT;
    EXPECT_EQ(reader.Control().m_dwStyle, dwBase | row.dwStyle) << row.szLines;
  }
}

TEST(ItemKinds, ColumnsHaveEditorsAndWidthsOfTheirOwn) {
  const char* const COLUMNS = "\nCOLUMN \"a\" 50\nCOLUMN \"b\",RE_EDIT\nCOLUMN \"c\",COMBO\nEND_LISTVIEW";
  ControlReader own(std::string("LISTVIEW 'l' 1 2 3 4") + COLUMNS, 1.5);
  CNListView& list = own.Read().As<CNListView>();
  EXPECT_EQ(list.Editor(0), CellEditor::None);
  EXPECT_EQ(list.Editor(1), CellEditor::RichEdit);
  EXPECT_EQ(list.Editor(2), CellEditor::Combo);
  EXPECT_EQ(list.pColumn(0)->m_iSize[0], 75);
  EXPECT_EQ(list.pColumn(3), nullptr);
  ControlReader all(std::string("LISTVIEW 'l' 1 2 3 4, NO_LOGPIXELS, EDIT") + COLUMNS, 1.5);
  EXPECT_EQ(all.Read().As<CNListView>().Editor(0), CellEditor::Edit) << "what the list says holds for all";
  EXPECT_EQ(all.As<CNListView>().Editor(2), CellEditor::Combo);
  EXPECT_EQ(all.As<CNListView>().pColumn(0)->m_iSize[0], 50) << "scaled as the list";
}

TEST(ItemKinds, ItemsOfATreeHavePlacesAndCommands) {
  ControlReader reader(
      "TREE_VIEW 't' 1 2 3 4\nITEM \"a\" ACTION: (go (1))\nITEM '2 , 3' \"b\" ACTION: (go)\nITEM '1' \"c\"\n"
      "ITEM 'run' \"d\" ACTION: (x)\nITEM '1,x' \"e\"\nEND_TREE_VIEW");
  const struct {
    int iLevel, iPlace;
    const char* szCommand;
  } rows[] = {{0, -1, "go (1)"}, {2, 3, "go"}, {1, -1, ""}, {0, -1, "run (x)"}, {1, -1, ""}};
  const CNTreeView& tree = reader.Read().As<CNTreeView>();
  for (int i = 0; i < 5; i++) {
    int iLevel = 9, iPlace = 9;
    CNString csCommand;
    CNTreeView::Position(*tree.m_Items[i], iLevel, iPlace);
    ItemCommand(*tree.m_Items[i], csCommand);
    EXPECT_EQ(iLevel, rows[i].iLevel) << i;
    EXPECT_EQ(iPlace, rows[i].iPlace) << i;
    EXPECT_STREQ(csCommand.Text(), rows[i].szCommand);
  }
}

TEST(ItemKinds, TextsCarryTheirLook) {
  ControlReader reader(
      "LISTVIEW 'l' 1 2 3 4\nITEM \"<RGB(7,8,9),a.bmp,RIGHT>x\" \"<b>bold</b>\" \"<%v%>\",RGB(1,2,3),row.bmp\n"
      "END_LISTVIEW");
  CNListView& list = reader.Read().As<CNListView>();
  CNItem& item = *list.m_Items[0];
  CNCharArray shown;
  for (const char* szText : {"<RGB(7,8,9),a.bmp,RIGHT>x", "<b>bold</b>", "<IDB_V>value"}) shown.Add(szText, 1);
  list.TakeShown(shown);
  const struct {
    const char *szText, *szPicture;
    int iRed;
    bool bRight;
  } rows[] = {{"x", "a.bmp", 7, true},
              {"<b>bold</b>", "row.bmp", 1, false},
              {"value", "IDB_V", 1, false},
              {"", "row.bmp", 1, false}};
  for (int i = 0; i < 4; i++) {
    ItemLook look;
    EXPECT_STREQ(item.szShown(i, look), rows[i].szText);
    EXPECT_EQ(TextOf(look.csPicture), rows[i].szPicture);
    EXPECT_EQ(look.text.red, rows[i].iRed);
    EXPECT_EQ(look.bRight, rows[i].bRight);
  }
  item.SetText(0, "new");
  item.SetText(4, "far");
  list.CountTexts();
  EXPECT_EQ(reader.Dump(),
            "LISTVIEW 'l' 1 2 3 4\nITEM \"<RGB(7,8,9),a.bmp,RIGHT>new\" \"<b>bold</b>\" \"<%v%>\" \"\" \"far\","
            "RGB(1,2,3),row.bmp\nEND_LISTVIEW");
  ItemLook look;
  EXPECT_STREQ(item.szShown(0, look), "new");
}

TEST(ItemKinds, DragWordsAreFoundInEachOther) {
  const struct {
    const char* szFlags;
    const char* szMeaning;  // any, the right button, to other lists, reorders
  } rows[] = {{"", "0000"},
              {"DRAG", "1001"},
              {"R_DRAG", "1101"},
              {"GLOBAL_DRAG,NO_REORDER_LIST", "1010"},
              {"GLOBAL_R_DRAG", "1111"}};
  for (const auto& row : rows) {
    ControlReader reader(std::string("LIST_FIELD 'l' \"a\" 1 2 3 4, HIDE, ") + row.szFlags);
    const ItemDragging dragging(reader.Read().Control());
    std::string meaning;
    for (const bool bIt : {dragging.bAny, dragging.bRightButton, dragging.bGlobal, dragging.bReorders})
      meaning += bIt ? '1' : '0';
    EXPECT_EQ(meaning, row.szMeaning) << row.szFlags;
  }
}

const char KEY_FAULT[] = "pogresan ID, ili verzija Bafunpraik ne podrzava taj ID";

TEST(MenuKinds, WhatIsReadIsWrittenBack) {
  const struct {
    const char* szLines;
    const char* szDump;  // null: as the lines
    std::vector<std::string> faults;
  } rows[] = {
      {"MENU_BAR\nMENU \"&File\"\nITEM \"&Open\" ACTION: (open ())\nSUBMENU \"More\"\n\"x\"\nEND_SUBMENU\nSEPARATOR\n"
       "END_MENU\nEND_MENUBAR",
       "MENU_BAR\nMENU \"&File\"\nITEM \"&Open\" ACTION: (open ())\nSUBMENU \"More\"\nITEM \"x\"\nEND_SUBMENU\n"
       "SEPARATOR\nEND_MENU\nEND_MENUBAR",
       {}},
      {"MENU_BAR 'm' 1 2 3 4, OWNER_DRAWN\nMENU \"a\"\nITEM \"n\\tCtrl+N\" \"\",RGB(1,2,3),new.bmp,DISABLE\nEND_MENU\n"
       "END_MENU\nEND_MENUBAR",
       "MENU_BAR 'm',OWNER_DRAWN\nMENU \"a\"\nITEM \"n\tCtrl+N\" "
       "\"\",RGB(1,2,3),new.bmp,DISABLE\nEND_MENU\nEND_MENUBAR",
       {}},
      {"RIGHT_CLICK_MENU 'list'\nBEGIN\nITEM 'cut' \"Cut\",VAR(v)\nEND_RIGHT_CLICK_MENU", nullptr, {}},
      {"RIGHT_CLICK_MENU\nSUBMENU \"a\"\nEND_RIGHT_CLICK_MENU", nullptr, {"nedostaje END_SUBMENU!"}},
      {"TOOLBAR 't' 1 2 3 4,LARGE\nITEM 'go' \"Go\" TOOLTIP 'now',go.bmp\nSEPARATOR\nCOMBO 'size' \"8\" \"9\" 60 0 0 "
       "0\n"
       "END_TOOLBAR",
       nullptr,
       {}},
      {"REBAR 'r' 0 0 0 0\nTOOLBAR 't' \"Bar\" 90 24 0 0,Standard,minWidth(20)\nITEM 'a' \"A\"\nEND_TOOLBAR\n"
       "BAND 'edit' \"Go:\" 50 0 0 0\nEND_REBAR",
       nullptr,
       {}},
      {"REBAR\nTOOLBAR\nEND_REBAR", "REBAR 0 0 0 0\nTOOLBAR\nEND_REBAR", {"nedostaje END_TOOLBAR!"}},
      {"ACCELERATOR \"Ctrl+F5\",Shift ACTION: (run ())", nullptr, {}},
      {"ACCELERATOR F1 0 0 0 0 ACTION: (help)", "ACCELERATOR \"F1\" ACTION: (help)", {}},
      {"GLOBAL_ACCELERATOR 'quit' 5, ALT ACTION: ()", "GLOBAL_ACCELERATOR 'quit' \"5\",ALT ACTION: ()", {}},
      {"ACCELERATOR \"Ctrl+Foo\" ACTION: (x)", nullptr, {KEY_FAULT}},
      {"ACCELERATOR ACTION: (x)", "ACCELERATOR \" \" ACTION: (x)", {KEY_FAULT}},
      // flags that look like something else where nothing stands before them
      {"ACCELERATOR F1,2,3)", "ACCELERATOR \"F1\" 2 0 0 0,3)", {}},
      {"MENU_BAR 1,GRAY 'x\nEND_MENUBAR", "MENU_BAR ,GRAY 'x\nEND_MENUBAR", {}},
      {"MENU_BAR\nITEM ACTIONS,\"x\nEND_MENUBAR", "MENU_BAR\nITEM 0 0 0 0,\"x\nEND_MENUBAR", {}},
  };
  for (const auto& row : rows) {
    ControlReader reader(row.szLines);
    const char* szDump = row.szDump ? row.szDump : row.szLines;
    EXPECT_EQ(reader.Read().Dump(), szDump);
    ASSERT_EQ(reader.sink.shown.size(), row.faults.size()) << row.szLines;
    for (size_t i = 0; i < row.faults.size(); i++)
      EXPECT_NE(reader.sink.shown[i].find(row.faults[i]), std::string::npos) << reader.sink.shown[i];
    EXPECT_EQ(ControlReader(szDump).ReadTight().Dump(), szDump) << "written back, it reads the same";
  }
}

TEST(MenuKinds, KeysHaveNames) {
  const struct {
    const char* szText;
    int iKey;  // 0: no key
    unsigned uModifiers;
    const char* szWritten;
  } rows[] = {
      {"a", 'A', 0, "A"},
      {"Ctrl+shift+ALT+z", 'Z', KEY_CTRL | KEY_SHIFT | KEY_ALT, "Ctrl+Shift+Alt+Z"},
      {" ctrl + 0 ", '0', KEY_CTRL, "Ctrl+0"},
      {"f24", 0x87, 0, "F24"},
      {"F25", 0, 0, ""},
      {"F1x", 0, 0, ""},
      {"Ctrl++", 0xBB, KEY_CTRL, "Ctrl+Plus"},
      {"PGDN", 0x22, 0, "PgDn"},
      {"Shift+Delete", 0x2E, KEY_SHIFT, "Shift+Del"},
      {"Ctrl+", 0, KEY_CTRL, ""},
      {"Shift F1", 0x70, KEY_SHIFT, "Shift+F1"},
      {"Ctrl", 0, KEY_CTRL, ""},
      {"A+Ctrl", 0, 0, ""},
      {"Enterr", 0, 0, ""},
      {"Ctrl+#186", 186, KEY_CTRL, "Ctrl+#186"},
      {"#256", 0, 0, ""},
      {"", 0, 0, ""},
  };
  for (const auto& row : rows) {
    KeyChord chord;
    const std::string text = row.szText;
    EXPECT_EQ(bReadKey(text.data(), text.data() + text.size(), chord), row.iKey != 0) << text;
    EXPECT_EQ(chord.iKey, row.iKey) << text;
    EXPECT_EQ(chord.uModifiers, row.uModifiers) << text;
    CNString csWritten;
    WriteKey(chord, csWritten);
    EXPECT_STREQ(csWritten.Text(), row.szWritten) << text;
  }
}

TEST(MenuKinds, ItemsHaveIdentifiersAndTheMenuNoName) {
  ControlReader reader(
      "RIGHT_CLICK_MENU 'e'\nITEM \"a\"\nEND_RIGHT_CLICK_MENU\nEDIT_FIELD 'e' 1 2 3 4\n"
      "TOOLBAR 't' 1 2 3 4\nITEM 'go' \"Go\"\nEND_TOOLBAR");
  reader.Read();
  EXPECT_EQ(reader.dialog.GetBaseControl("e"), &reader.Control(1)) << "the field, not its menu";
  EXPECT_EQ(reader.Control(0).pItemControl()->m_Items[0]->m_iID, 501);
  EXPECT_EQ(reader.Control(1).m_iID, 502);
  EXPECT_EQ(reader.Control(2).m_iID, 503);
  EXPECT_EQ(reader.Control(2).pItemControl()->pFindItem(504), reader.Control(2).pItemControl()->m_Items[0]);
}

TEST(MenuKinds, OneLookMakesTheWizardDrawTheMenu) {
  const struct {
    const char* szFlags;
    bool bOwnerDrawn;
  } rows[] = {{"", false}, {",DISABLE,CHECKED", false}, {",BOLD", true}, {",RGB(1,2,3)", true}, {",empty.bmp", true}};
  for (const auto& row : rows) {
    ControlReader reader(std::string("MENU_BAR\nMENU \"a\"\nITEM \"b\"") + row.szFlags + "\nEND_MENU\nEND_MENUBAR");
    EXPECT_EQ(reader.Read().As<CNMenu>().m_bOwnerDrawn, row.bOwnerDrawn) << row.szFlags;
  }
}

}  // namespace
