// The grammar of one line: rows of {line, what is written back}. What is written back must read the same again.
#include "ControlReader.h"

namespace {

struct LineRow {
  const char* szLine;
  const char* szWritten;
};

class ControlLine : public ::testing::TestWithParam<LineRow> {};

TEST_P(ControlLine, IsWrittenBack) {
  ControlReader first(GetParam().szLine);
  EXPECT_EQ(first.ReadTight().Dump(), GetParam().szWritten);
  EXPECT_EQ(first.sink.shown, std::vector<std::string>());
  ControlReader second(first.Dump());
  EXPECT_EQ(second.ReadTight().Dump(), first.Dump());
}

const LineRow g_plain[] = {
    {"TEXT_FIELD 't' \"a\" \"b\" 1 2 3 4", "TEXT_FIELD 't' \"ab\" 1 2 3 4"},
    {"TEXT_FIELD \"Setup is complete\" 10 20 270 30, ACENTER", "TEXT_FIELD \"Setup is complete\" 10 20 270 30,ACENTER"},
    {"  BUTTON   'b'   \"< Back\"   ID_BACK   370 375 75 23,NO_LOGPIXELS",
     "BUTTON 'b' \"< Back\" ID_BACK 370 375 75 23,NO_LOGPIXELS"},
    {"EDIT_FIELD 'name' 180 179 330 20, FOCUS", "EDIT_FIELD 'name' 180 179 330 20,FOCUS"},
    {"PROGRESSIVE 'p' 1 2 3 4, SMOOTH", "PROGRESS_BAR 'p' 1 2 3 4,SMOOTH"},
    {"BUTTONS 'b' \"x\" 1 2 3 4", "BUTTON 'b' \"x\" 1 2 3 4"},
    {"IMAGE 'img' \"IDB_PLUMO\" 0 0 0 0,CUSTOM,TRANSPARENT(204,204,204)",
     "IMAGE 'img' \"IDB_PLUMO\" 0 0 0 0,CUSTOM,TRANSPARENT(204,204,204)"},
    {"IMAGE 'img' IDB_PLUMO2 0 0 0 0", "IMAGE 'img' IDB_PLUMO2 0 0 0 0"},
    {"IMAGE 'img' IDB_PLUMO, CUSTOM, TRANSPARENT(204,204,204)",
     "IMAGE 'img' IDB_PLUMO 0 0 0 0,CUSTOM, TRANSPARENT(204,204,204)"},
    // eight numbers, and no more than eight
    {"EDIT_FIELD 'e' 1 2 3 4 5 6 7 8 9, GRAY", "EDIT_FIELD 'e' 1 2 3 4 5 6 7 8,GRAY"},
    {"EDIT_FIELD 'e' 1 2 3 4 0 6", "EDIT_FIELD 'e' 1 2 3 4 0 6"},
    {"EDIT_FIELD 'e' 1 2", "EDIT_FIELD 'e' 1 2 0 0"},
    // a minus sign is no part of a number; a number is bounded
    {"EDIT_FIELD 'e' -5 10 -20 99999999999", "EDIT_FIELD 'e' 5 10 20 100000000"},
    // no numbers: those of the flags are not taken for the size
    {"TEXT_FIELD 't' \"x\", BACKGROUND(227,241,228)", "TEXT_FIELD 't' \"x\" 0 0 0 0,BACKGROUND(227,241,228)"},
    {"EDIT_FIELD 'e', 1 2 3 4, GRAY", "EDIT_FIELD 'e' 1 2 3 4,GRAY"},
    // quoted texts that look like something else
    {"TEXT_FIELD 'a1, ACTION' \"5 6, HIDE ACTION: (x) TOOLTIP 'y'\" 1 2 3 4",
     "TEXT_FIELD 'a1, ACTION' \"5 6, HIDE ACTION: (x) TOOLTIP 'y'\" 1 2 3 4"},
    {"TEXT_FIELD 't' \"say \\\"hi\\\"\\n\" 1 2 3 4", "TEXT_FIELD 't' \"say \\\"hi\\\"\\n\" 1 2 3 4"},
    {"TEXT_FIELD 't' \"C:\\dir\" 1 2 3 4", "TEXT_FIELD 't' \"C:\\dir\" 1 2 3 4"},
    {"EDIT_FIELD 'e' 1 2 3 4, GRAY ACTION: (say \"x\" 5)", "EDIT_FIELD 'e' 1 2 3 4,GRAY ACTION: (say \"x\" 5)"},
    // tooltip, in its place and elsewhere
    {"EDIT_FIELD 'e' TOOLTIP '9 lives, HIDE ACTION' 1 2 3 4,GRAY",
     "EDIT_FIELD 'e' TOOLTIP '9 lives, HIDE ACTION' 1 2 3 4,GRAY"},
    {"BUTTON 'b' \"x\" ID_NEXT TOOLTIP '9 lives' 1 2 3 4", "BUTTON 'b' \"x\" TOOLTIP '9 lives' ID_NEXT 1 2 3 4"},
    {"EDIT_FIELD 'e' 1 2 3 4, GRAY TOOLTIP 'HIDE (3,4)' ACTION: ()",
     "EDIT_FIELD 'e' TOOLTIP 'HIDE (3,4)' 1 2 3 4,GRAY ACTION: ()"},
    {"EDIT_FIELD 'e' 1 2 3 4 ACTION: (Show TOOLTIP 'x')", "EDIT_FIELD 'e' 1 2 3 4 ACTION: (Show TOOLTIP 'x')"},
    // action
    {"BUTTON 'b' \"x\" 1 2 3 4, BACKGROUND(227,241,228) ACTION",
     "BUTTON 'b' \"x\" 1 2 3 4,BACKGROUND(227,241,228) ACTION: ()"},
    {"BUTTON 'b' \"x\" 1 2 3 4, DEFAULT, ACTION:(Choose directory:)",
     "BUTTON 'b' \"x\" 1 2 3 4,DEFAULT ACTION: (Choose directory:)"},
    {"BUTTON 'b' \"x\" 1 2 3 4 ACTION : (a (b), c) d", "BUTTON 'b' \"x\" 1 2 3 4 ACTION: (a (b), c) d"},
    {"BUTTON 'b' \"x\" 1 2 3 4, REACTION, ACTIONS", "BUTTON 'b' \"x\" 1 2 3 4,REACTION, ACTIONS"},
    // an empty caption in front of a quote that is none
    {"EDIT_FIELD 'e' \"\" 1 2 3 4, \"x\"", "EDIT_FIELD 'e' \"\" 1 2 3 4,\"x\""},
    // lists
    {"LIST_FIELD 'program' \"desktop_shortcut\" \"<%program_folder%>\" \"Plumo.exe\" \"\" \"Location: \" 0 0 0 0, HIDE",
     "LIST_FIELD 'program' \"desktop_shortcut\" \"<%program_folder%>\" \"Plumo.exe\" \"\" \"Location: \" 0 0 0 0,HIDE"},
    {"SIMULATED_LIST_FIELD 's' \"a, 1\", \"TOOLTIP 2\" TOOLTIP 'say \"x\"' 1 2 3 4",
     "SIMULATED_LIST_FIELD 's' \"a, 1\" \"TOOLTIP 2\" TOOLTIP 'say \"x\"' 1 2 3 4"},
    // deferred kinds keep the words before their size
    {"UP_DOWN 'u' (0, 100, 5) 1 2 3 4, HORIZONTAL", "UP_DOWN 'u' (0, 100, 5) 1 2 3 4,HORIZONTAL"},
    {"ANIMATION 'a' clip1.avi 1 2 3 4, PLAY", "ANIMATION 'a' clip1.avi 1 2 3 4,PLAY"},
    {"HOTKEY 'h' \"A\" CTRL SHIFT 1 2 3 4", "HOTKEY 'h' \"A\" CTRL SHIFT 1 2 3 4"},
    {"ACCELERATOR Shift F1 ACTION: (help)", "ACCELERATOR \"Shift F1\" ACTION: (help)"},
};
INSTANTIATE_TEST_SUITE_P(Plain, ControlLine, ::testing::ValuesIn(g_plain));

const LineRow g_blocks[] = {
    {"FRAME 'f' 1 2 3 4\n  BUTTON 'in' \"x\" 1 1 1 1\n  FRAME 'g' 5 6 7 8\n  END_FRAME\n END_FRAME\nPAGER 'p' 1 2 3 4",
     "FRAME 'f' 1 2 3 4\nBUTTON 'in' \"x\" 1 1 1 1\nFRAME 'g' 5 6 7 8\nEND_FRAME\nEND_FRAME\nPAGER 'p' 1 2 3 4"},
    {"MENU_BAR\nMENU \"File\"\nEND_MENU\nEND_MENUBAR", "MENU_BAR\nMENU \"File\"\nEND_MENU\nEND_MENUBAR"},
    {"TAB_CONTROL 't' 1 2 3 4\nTAB\nEND_TAB\nEND_TAB_CONTROL",
     "TAB_CONTROL 't' 1 2 3 4\nTAB\nEND_TAB\nEND_TAB_CONTROL"},
    {"MESSAGE_BOX 'm' \"Error!\", MB_YESNO\n  >one\n  >  two \n >\n  > \"three \\\"3\\\"\"\nEND_MESSAGE_BOX",
     "MESSAGE_BOX 'm' \"Error!\" 0 0 0 0,MB_YESNO\n> \"one\"\n> \" two \"\n> \"\"\n> \"three "
     "\\\"3\\\"\"\nEND_MESSAGE_BOX"},
};
INSTANTIATE_TEST_SUITE_P(Blocks, ControlLine, ::testing::ValuesIn(g_blocks));

TEST(ControlLineParts, FieldsOfAWholeLine) {
  ControlReader reader(
      "BUTTON 'b_browse' \"Bro\\\"wse\\n\\r\" TOOLTIP 'Other folder' 433 334 75 20, HIDE, DISABLE, FOCUS,"
      "BACKGROUND(227,241,228),TEXT_COLOR( 1, 2, 3 ),BIGBOLD ACTION: (Choose directory:)  ");
  BaseControl& control = reader.Read().Control();
  EXPECT_EQ(TextOf(control.m_csName), "b_browse");
  EXPECT_EQ(TextOf(control.m_csCaption), "Bro\"wse\n\r");
  EXPECT_EQ(TextOf(control.m_csToolTip), "Other folder");
  EXPECT_EQ(TextOf(control.m_csAction), " (Choose directory:)  ");
  EXPECT_EQ(std::vector<int>(control.m_iSize, control.m_iSize + 8), (std::vector<int>{433, 334, 75, 20, 0, 0, 0, 0}));
  EXPECT_EQ(control.m_dwStyle & ~0xFu, uint32_t(STYLE_CHILD | STYLE_CLIPSIBLINGS | STYLE_TABSTOP | STYLE_DISABLED));
  EXPECT_TRUE(control.m_bFocus);
  EXPECT_TRUE(control.m_Background.bSet);
  EXPECT_EQ(control.m_Background.green, 241);
  EXPECT_EQ(control.m_TextColor.blue, 3);
  EXPECT_EQ(control.m_Font, FontVariant::BigBold);
}

TEST(ControlLineParts, AreNullWhenTheLineHasNone) {
  ControlReader reader("CHECK_BOX 5 6 7 8");
  BaseControl& control = reader.Read().Control();
  EXPECT_EQ(TextOf(control.m_csName), "(null)");
  EXPECT_EQ(TextOf(control.m_csCaption), "");
  EXPECT_EQ(TextOf(control.m_csToolTip), "(null)");
  EXPECT_EQ(TextOf(control.m_csAction), "(null)");
  EXPECT_EQ(control.m_iSize[3], 8);
  EXPECT_FALSE(control.m_Background.bSet);
}

struct ScaleRow {
  double dScale;
  const char* szFlags;
  std::vector<int> size;
};

TEST(ControlLineParts, ScaleByTheScreensResolution) {
  const ScaleRow rows[] = {
      {1.25, "", {12, 12, 93, 28}},
      {1.25, ", NO_LOGPIXELS", {10, 10, 75, 23}},
      {1.0, "", {10, 10, 75, 23}},
      {0.75, "", {10, 10, 75, 23}},
  };
  for (const ScaleRow& row : rows) {
    const std::string line = std::string("EDIT_FIELD 'e' 10 10 75 23") + row.szFlags;
    ControlReader reader(line, row.dScale);
    BaseControl& control = reader.Read().Control();
    EXPECT_EQ(std::vector<int>(control.m_iSize, control.m_iSize + 4), row.size) << row.dScale << row.szFlags;
    EXPECT_EQ(control.m_bScaled, row.size[0] != 10);
  }
}

TEST(ControlLineParts, UnscaledSizesAreWrittenBackAtEveryFactor) {
  for (double dScale : {1.041666, 1.1, 1.25, 4.0 / 3, 1.5, 2.0, 3.7}) {
    std::string lines;
    for (int i = 0; i < 500; i++) lines += "PAGER 'p' 0 1 99 " + std::to_string(i) + (i < 499 ? "\n" : "");
    ControlReader reader(lines, dScale);
    EXPECT_EQ(reader.Read().Dump(), lines) << dScale;
  }
}

struct MarginRow {
  const char* szFlags;
  int iLeft, iHorizontal, iTop, iVertical;
};

TEST(ControlLineParts, MarginsAndAlignment) {
  const MarginRow rows[] = {
      {"MARGIN(5)", 5, 10, 5, 10},
      {"MARGIN(5), MARGIN_LEFT(2)", 2, 2, 0, 0},
      {"MARGIN_RIGHT(3), MARGIN_LEFT(2), MARGIN_BOTTOM(7), MARGIN_TOP(1)", 2, 5, 1, 8},
      {"MARGIN", 0, 0, 0, 0},
      {"MARGIN(x)", 0, 0, 0, 0},
  };
  for (const MarginRow& row : rows) {
    ControlReader reader(std::string("EDIT_FIELD 'e' 1 2 3 4,") + row.szFlags);
    const ControlMargins& margins = reader.Read().Control().m_Margins;
    EXPECT_EQ(margins.iLeft, row.iLeft) << row.szFlags;
    EXPECT_EQ(margins.iHorizontal, row.iHorizontal) << row.szFlags;
    EXPECT_EQ(margins.iTop, row.iTop) << row.szFlags;
    EXPECT_EQ(margins.iVertical, row.iVertical) << row.szFlags;
  }
  EXPECT_EQ(ControlReader("PAGER 1 2 3 4,ALIGN_BOTTOM,ALIGN_TOP").Read().Control().m_Align, ControlAlign::Bottom);
  EXPECT_EQ(ControlReader("PAGER 1 2 3 4,ALIGN_LEFT,ALIGN_RIGHT").Read().Control().m_Align, ControlAlign::Left);
}

}  // namespace
