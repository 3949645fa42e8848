// Containers and layout tables: what the lines become, and where tables put their controls, in numbers.
#include "ControlReader.h"
#include "controls/ContainerKinds.h"
#include "controls/Layout.h"

namespace {

using Texts = std::vector<std::string>;

// Each control with the names of what it stands in, the outermost last: "e:page:tabs".
std::string Tree(const ControlReader& reader) {
  std::string tree;
  for (int i = 0; i < reader.Count(); i++) {
    const BaseControl* p = &reader.Control(i);
    if (p->m_csName.bEmpty()) continue;
    tree += tree.empty() ? "" : " ";
    for (const char* szColon = ""; p; p = p->m_pParent, szColon = ":")
      tree += szColon + std::string(p->m_csName.Text());
  }
  return tree;
}

std::string Missing(int iLine, const char* szWord) {
  return "syntax error|U datoteci setup.txt, u liniji " + std::to_string(iLine) + ",nedostaje " + szWord + "!";
}
std::string TableFault(const char* szMissing) {
  return std::string("Syntax Error|Error: After TABLE_START Missing \"") + szMissing + "\", Tables will not load";
}

TEST(Containers, HoldWhatStandsBetweenTheirLines) {
  const struct {
    const char* szText;
    const char* szTree;
    Texts faults;
  } rows[] = {
      {"FRAME 'f' 1 2 3 4\nEDIT_FIELD 'a' 1 2 3 4\nGROUP_BOX 'g' 1 2 3 4\nEDIT_FIELD 'b' 1 2 3 4\nEND_GROUP_BOX\n"
       "EDIT_FIELD 'c' 1 2 3 4\nEND_FRAME\nEDIT_FIELD 'd' 1 2 3 4",
       "f a:f g:f b:g:f c:f d",
       {}},
      {"TAB_CONTROL 't' 1 2 3 4\nTAB 'p' \"One\"\nEDIT_FIELD 'a' 1 2 3 4\nEND_TAB\nEDIT_FIELD 'between' 1 2 3 4\n"
       "TAB 'q'\nTABLE_START\n{\nTABLE_COLUMN ()\nTABLE_ROW ()\n}\nEND_TAB\nEND_TAB_CONTROL",
       "t p:t a:p:t between q:t",
       {}},
      {"PROPERTY_SHEET 's' 1 2 3 4\nSHEET 'p'\nFRAME 'f' 1 2 3 4\nEDIT_FIELD 'a' 1 2 3 4\nEND_FRAME\nEND_SHEET\n"
       "TAB 'none' 1 2 3 4\nEND_PROPERTY_SHEET",
       "s p:s f:p:s a:f:p:s",
       {}},
      {"FRAME 'f' 1 2 3 4\nGROUP_BOX 'g' 1 2 3 4\nEDIT_FIELD 'a' 1 2 3 4\nEND_FRAME\nEDIT_FIELD 'b' 1 2 3 4",
       "f g:f a:f b",
       {Missing(2, "END_GROUP_BOX")}},
      {"EDIT_FIELD 'a' 1 2 3 4\nFRAME 'f' 1 2 3 4\nFRAME 'g' 1 2 3 4\nEDIT_FIELD 'b' 1 2 3 4\nEND_GROUP_BOX\nEND_TAB",
       "a f g b",
       {Missing(2, "END_FRAME"), Missing(3, "END_FRAME")}},
      {"TAB_CONTROL 't' 1 2 3 4\nTAB 'p'\nEDIT_FIELD 'a' 1 2 3 4\nTAB 'q'\nEDIT_FIELD 'b' 1 2 3 4\nEND_TAB",
       "t p:t a q:t b:q:t",
       {Missing(2, "END_TAB"), Missing(1, "END_TAB_CONTROL")}},
      {"GROUP\nFRAME 'f' 1 2 3 4\nCHECK_BOX 'a' 1 2 3 4\nCHECK_BOX 'b' 1 2 3 4\nEND_GROUP\nEND_FRAME", "f a:f b:f", {}},
  };
  for (const auto& row : rows) {
    ControlReader reader(row.szText);
    EXPECT_EQ(Tree(reader.Read()), row.szTree) << row.szText;
    EXPECT_EQ(reader.sink.shown, row.faults) << row.szText;
    ControlReader again(reader.Dump());
    EXPECT_EQ(Tree(again.Read()), row.szTree) << reader.Dump();
    EXPECT_EQ(again.Dump(), reader.Dump());
  }
}

// The containers of cells and a quote that is missing: tests/scripts/blocks-tables.txt.
TEST(LayoutTables, AreReadAndWrittenBack) {
  const struct {
    const char* szText;
    const char* szDump;  // of what is left
    Texts faults;
  } rows[] = {
      {"TABLE_START\n {\n TABLE_COLUMN (width=100p, hide=0)\nTABLE_COLUMN (width=2%, hide=1)\nTABLE_COLUMN (width=3)\n"
       "TABLE_COLUMN (width=4*)\nTABLE_ROW (height=30p, hide=0) 'a'\n-\n'b' SPAN(9)\nTABLE_ROW (height=*, hide=2)\n''\n"
       "'c' SPAN(2)\n 'd'\n'too many'\n}",
       "TABLE_START\n{\nTABLE_COLUMN (width=100p)\nTABLE_COLUMN (width=2% hide=1)\nTABLE_COLUMN (width=3%)\n"
       "TABLE_COLUMN (width=*)\nTABLE_ROW (height=30p)\n'a'\n-\n'b' SPAN(2)\nTABLE_ROW (height=* hide=1)\n-\n"
       "'c' SPAN(2)\n'd'\n}",
       {}},
      {"FRAME 'f' 1 2 3 4\nTABLE_START\n{\nTABLE_COLUMN (width=1p)\nTABLE_ROW (height=1p)\nEND_FRAME\nPAGER 1 2 3 4\n}",
       "FRAME 'f' 1 2 3 4\nEND_FRAME\nPAGER 1 2 3 4",
       {TableFault("{")}},
      {"TABLE_START\n{\nPAGER 1 2 3 4", "PAGER 1 2 3 4", {TableFault("{")}},
      {"TABLE_START\n{\nTABLE_COLUMN (width=1p)\n'a'\n}\nPAGER 1 2 3 4", "PAGER 1 2 3 4", {TableFault("TABLE_ROW")}},
      {"TABLE_START\n{\nTABLE_ROW (height=1p)\n'a'\n}", "", {TableFault("TABLE_COLUMN")}},
  };
  for (const auto& row : rows) {
    ControlReader reader(row.szText);
    EXPECT_EQ(reader.Read().Dump(), row.szDump) << row.szText;
    EXPECT_EQ(reader.sink.shown, row.faults) << row.szText;
    EXPECT_EQ(ControlReader(reader.Dump()).Read().Dump(), reader.Dump());
  }
}

// "name x y w h" of each control that a table places; "name hidden".
std::string Places(const ControlReader& reader, const BaseControl* pContainer, int iWidth, int iHeight) {
  CNArray<LayoutPlace> places;
  LayOut(reader.dialog, pContainer, iWidth, iHeight, LayoutSizes(), places);
  std::string text;
  for (int i = 0; i < places.Size(); i++) {
    const LayoutPlace& at = *places[i];
    text += (i ? "; " : "") + std::string(at.pControl->m_csName.Text());
    if (at.bHidden)
      text += " hidden";
    else
      for (const int iNumber : {at.iX, at.iY, at.iWidth, at.iHeight}) text += " " + std::to_string(iNumber);
  }
  return text;
}

std::string Table(const char* szColumns, const char* szRows) {
  return std::string("TABLE_START\n{\n") + szColumns + "\n" + szRows + "\n}\n";
}

// A fixed column, two shares, a hidden one and a star: every pixel belongs to somebody.
TEST(Layout, ColumnsShareTheWidth) {
  std::string fields;
  for (const char* szName : {"a", "b", "c", "d"})
    fields += std::string("EDIT_FIELD '") + szName + "' 0 0 9 9,RIGHTRESIZABLE\n";
  const char* const ROW = "TABLE_ROW (height=9p) 'a' 'b' 'c' 'd'";
  ControlReader shares(fields + Table("TABLE_COLUMN (width=100p)\nTABLE_COLUMN (width=1%)\n"
                                      "TABLE_COLUMN (width=50p, hide=1)\nTABLE_COLUMN (width=2%)",
                                      ROW));
  ControlReader stars(fields + Table("TABLE_COLUMN (width=*)\nTABLE_COLUMN (width=25%)\n"
                                     "TABLE_COLUMN (width=*)\nTABLE_COLUMN (width=10p)",
                                     ROW));
  shares.Read();
  stars.Read();
  const struct {
    int iWidth;
    const char* szShares;
    const char* szStars;
  } rows[] = {
      {0, "a 0 0 100 9; b 100 0 0 9; c hidden; d 100 0 0 9", "a 0 0 0 9; b 0 0 0 9; c 0 0 0 9; d 0 0 10 9"},
      {100, "a 0 0 100 9; b 100 0 0 9; c hidden; d 100 0 0 9", "a 0 0 34 9; b 34 0 22 9; c 56 0 34 9; d 90 0 10 9"},
      {103, "a 0 0 100 9; b 100 0 1 9; c hidden; d 101 0 2 9", "a 0 0 35 9; b 35 0 23 9; c 58 0 35 9; d 93 0 10 9"},
      {200, "a 0 0 100 9; b 100 0 33 9; c hidden; d 133 0 67 9", "a 0 0 71 9; b 71 0 47 9; c 118 0 72 9; d 190 0 10 9"},
      {201, "a 0 0 100 9; b 100 0 33 9; c hidden; d 133 0 68 9", "a 0 0 72 9; b 72 0 47 9; c 119 0 72 9; d 191 0 10 9"},
      {640, "a 0 0 100 9; b 100 0 180 9; c hidden; d 280 0 360 9",
       "a 0 0 236 9; b 236 0 157 9; c 393 0 237 9; d 630 0 10 9"},
  };
  for (const auto& row : rows) {
    EXPECT_EQ(Places(shares, nullptr, row.iWidth, 9), row.szShares) << row.iWidth;
    EXPECT_EQ(Places(stars, nullptr, row.iWidth, 9), row.szStars) << row.iWidth;
  }
}

// One control in a cell of 100 by 60: what its words make of it.
TEST(Layout, ControlsStandInTheirCellsAsTheirWordsSay) {
  const struct {
    const char* szFlags;
    const char* szPlace;
  } rows[] = {
      {"", "a 0 0 20 10"},
      {"RIGHTRESIZABLE", "a 0 0 100 10"},
      {"BOTTOMRESIZABLE", "a 0 0 20 60"},
      {"RIGHTRESIZABLE,BOTTOMRESIZABLE,MARGIN(5)", "a 5 5 90 50"},
      {"RIGHTRESIZABLE,FIXED,MARGIN_LEFT(7)", "a 7 0 20 10"},
      {"ALIGN_LEFT", "a 0 25 20 10"},
      {"ALIGN_RIGHT,MARGIN_RIGHT(3)", "a 77 25 20 10"},
      {"ALIGN_TOP", "a 40 0 20 10"},
      {"ALIGN_BOTTOM,MARGIN_BOTTOM(4)", "a 40 46 20 10"},
      {"RIGHTRESIZABLE,MARGIN(80)", "a 80 80 0 10"},
  };
  for (const auto& row : rows) {
    ControlReader reader(std::string("EDIT_FIELD 'a' 3 4 20 10,") + row.szFlags + "\n" +
                         Table("TABLE_COLUMN (width=*)", "TABLE_ROW (height=*) 'a'"));
    EXPECT_EQ(Places(reader.Read(), nullptr, 100, 60), row.szPlace) << row.szFlags;
  }
}

TEST(Layout, TablesInsideContainersPlaceWhatStandsThere) {
  ControlReader reader(
      "EDIT_FIELD 'out' 0 0 30 20\n"
      "TABLE_START\n{\nTABLE_COLUMN (width=*)\nTABLE_ROW (height=40p)\n'out'\nTABLE_ROW (height=*)\n"
      "FRAME 'f' 0 0 9 9,RIGHTRESIZABLE,BOTTOMRESIZABLE,MARGIN(10)\n"
      "  BUTTON 'ok' \"OK\" 0 0 75 23\n  BUTTON 'no' \"No\" 0 0 75 23\n  TABLE_START\n  {\n"
      "  TABLE_COLUMN (width=*)\n  TABLE_COLUMN (width=80p)\n  TABLE_COLUMN (width=75p)\n  TABLE_ROW (height=*) - 'ok' "
      "'no'\n"
      "  TABLE_ROW (height=30p, hide=1) 'out'\n  }\nEND_FRAME\n}\n",
      1.5);
  reader.dialog.m_dScale = 1.5;
  reader.Read();
  EXPECT_TRUE(reader.sink.shown.empty());
  const BaseControl* pFrame = reader.dialog.GetBaseControl("f");
  EXPECT_EQ(Places(reader, nullptr, 400, 300), "out 0 0 45 30; f 15 75 370 210") << "scaled as the dialog";
  EXPECT_EQ(Places(reader, pFrame, 370, 210), "ok 138 0 112 34; no 258 0 112 34");
  int iWidth, iHeight;
  LeastSize(reader.dialog, nullptr, LayoutSizes(), iWidth, iHeight);
  EXPECT_EQ(iWidth, 30 + 120 + 112);
  EXPECT_EQ(iHeight, 60 + 30 + 34);
}

TEST(Layout, LeastSizesKeepFixedControlsInTheirCells) {
  ControlReader reader("EDIT_FIELD 'a' 0 0 30 20\nEDIT_FIELD 'b' 0 0 50 20\nEDIT_FIELD 'c' 0 0 200 20\n" +
                       Table("TABLE_COLUMN (width=1%)\nTABLE_COLUMN (width=3%)\nTABLE_COLUMN (width=10p)",
                             "TABLE_ROW (height=1%) 'a' 'b'\nTABLE_ROW (height=1%) 'c' SPAN(2)"));
  reader.Read();
  int iWidth, iHeight;
  LeastSize(reader.dialog, nullptr, LayoutSizes(), iWidth, iHeight);
  EXPECT_EQ(iWidth, 210);
  EXPECT_EQ(iHeight, 40);
}

TEST(Layout, SplittersMoveTheBorderBetweenTheirNeighbours) {
  ControlReader reader("EDIT_FIELD 'a' 0 0 9 9,RIGHTRESIZABLE\nSPLITTER 's' 0 0 6 9\nEDIT_FIELD 'b' 0 0 30 9\n" +
                       Table("TABLE_COLUMN (width=*)\nTABLE_COLUMN (width=6p)\nTABLE_COLUMN (width=9p, hide=1)\n"
                             "TABLE_COLUMN (width=*)",
                             "TABLE_ROW (height=9p) 'a' 's' - 'b'"));
  reader.Read();
  const BaseControl& splitter = *reader.dialog.GetBaseControl("s");
  const auto move = [&](int iPixels) {
    EXPECT_TRUE(bMoveSplitter(reader.dialog, splitter, LayoutSizes(), iPixels, 206));
    return Places(reader, nullptr, 206, 9);
  };
  EXPECT_EQ(move(0), "a 0 0 100 9; s 100 0 6 9; b 106 0 30 9");
  EXPECT_EQ(move(20), "a 0 0 120 9; s 120 0 6 9; b 126 0 30 9");
  EXPECT_EQ(move(500), "a 0 0 170 9; s 170 0 6 9; b 176 0 30 9") << "b keeps the room that it needs";
  EXPECT_EQ(Places(reader, nullptr, 66, 9), "a 0 0 60 9; s 60 0 6 9; b 66 0 30 9") << "no pixel is lost";
  EXPECT_EQ(move(-500), "a 0 0 0 9; s 0 0 6 9; b 6 0 30 9");
  ForgetMoves(reader.dialog);
  EXPECT_EQ(move(0), "a 0 0 100 9; s 100 0 6 9; b 106 0 30 9");
  EXPECT_FALSE(bMoveSplitter(reader.dialog, *reader.dialog.GetBaseControl("a"), LayoutSizes(), 5, 206));
}

}  // namespace
