// Lists, combo boxes, list views, trees and headers as their lines describe them.
#include "controls/ItemKinds.h"

#include "ControlReader.h"

namespace {

struct KindRow {
  const char* szLines;
  const char* szDump;  // null: as the lines
  uint32_t dwStyle;    // beside the one that every control begins with
};

TEST(ItemKinds, WhatIsReadIsWrittenBack) {
  const uint32_t REPORT = STYLE_LVS_REPORT | STYLE_LVS_NOSORTHEADER;
  const KindRow rows[] = {
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
  for (const KindRow& row : rows) {
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
    bool bAny, bRight, bGlobal, bReorders;
  } rows[] = {{"", false, false, false, false},
              {"DRAG", true, false, false, true},
              {"R_DRAG", true, true, false, true},
              {"GLOBAL_DRAG,NO_REORDER_LIST", true, false, true, false},
              {"GLOBAL_R_DRAG", true, true, true, true}};
  for (const auto& row : rows) {
    ControlReader reader(std::string("LIST_FIELD 'l' \"a\" 1 2 3 4, HIDE, ") + row.szFlags);
    const ItemDragging dragging(reader.Read().Control());
    EXPECT_EQ(dragging.bAny, row.bAny) << row.szFlags;
    EXPECT_EQ(dragging.bRightButton, row.bRight) << row.szFlags;
    EXPECT_EQ(dragging.bGlobal, row.bGlobal) << row.szFlags;
    EXPECT_EQ(dragging.bReorders, row.bReorders) << row.szFlags;
  }
}

}  // namespace
