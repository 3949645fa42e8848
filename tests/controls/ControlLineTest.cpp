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

// What only a reader of memory without an end shows, or no script of tests/scripts has.
const LineRow g_lines[] = {
    {"  BUTTON   'b'   \"< Back\"   ID_BACK   370 375 75 23,NO_LOGPIXELS",
     "BUTTON 'b' \"< Back\" ID_BACK 370 375 75 23,NO_LOGPIXELS"},
    {"IMAGE 'img' \"IDB_PLUMO\" 0 0 0 0,CUSTOM,TRANSPARENT(204,204,204)",
     "IMAGE 'img' \"IDB_PLUMO\" 0 0 0 0,CUSTOM,TRANSPARENT(204,204,204)"},
    {"IMAGE 'img' IDB_PLUMO, CUSTOM, TRANSPARENT(204,204,204)",
     "IMAGE 'img' IDB_PLUMO 0 0 0 0,CUSTOM, TRANSPARENT(204,204,204)"},
    {"EDIT_FIELD 'e' -5 2 -3 4 0 6 7 99999999999 9, GRAY", "EDIT_FIELD 'e' 5 2 3 4 0 6 7 100000000,GRAY"},
    {"EDIT_FIELD 'e', 1 2 3 4, GRAY", "EDIT_FIELD 'e' 1 2 3 4,GRAY"},
    // quoted texts that look like something else
    {"TEXT_FIELD 'a1, ACTION' \"5 6, HIDE ACTION: (x) TOOLTIP 'y'\" 1 2 3 4",
     "TEXT_FIELD 'a1, ACTION' \"5 6, HIDE ACTION: (x) TOOLTIP 'y'\" 1 2 3 4"},
    {"EDIT_FIELD 'e' \"\" 1 2 3 4, \"x\"", "EDIT_FIELD 'e' \"\" 1 2 3 4,\"x\""},
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
    {"BUTTON 'b' \"x\" 1 2 3 4 ACTION : (a (b \"x\" 5), c) d", "BUTTON 'b' \"x\" 1 2 3 4 ACTION: (a (b \"x\" 5), c) d"},
    {"BUTTON 'b' \"x\" 1 2 3 4, REACTION, ACTIONS", "BUTTON 'b' \"x\" 1 2 3 4,REACTION, ACTIONS"},
    // lists
    {"LIST_FIELD 'l' \"one\" \"\" \"say \\\"2\\\"\\n\" \"Location: \" 0 0 0 0, HIDE",
     "LIST_FIELD 'l' \"one\" \"\" \"say \\\"2\\\"\\n\" \"Location: \" 0 0 0 0,HIDE"},
    {"SIMULATED_LIST_FIELD 's' \"a, 1\", \"TOOLTIP 2\" TOOLTIP 'say \"x\"' 1 2 3 4",
     "SIMULATED_LIST_FIELD 's' \"a, 1\" \"TOOLTIP 2\" TOOLTIP 'say \"x\"' 1 2 3 4"},
    {"STATUS_BAR 's' \"12, HIDE\" \"\" \"<%n%> \\\"x\\\"\" 0 0 0 0",
     "STATUS_BAR 's' \"12, HIDE\" \"\" \"<%n%> \\\"x\\\"\" 0 0 0 0"},
    {"MESSAGE_BOX 'm' \"Error!\", MB_YESNO\n  >one\n  >  two \n >\n  > \"three \\\"3\\\"\"\nEND_MESSAGE_BOX",
     "MESSAGE_BOX 'm' \"Error!\" 0 0 0 0,MB_YESNO\n> \"one\"\n> \" two \"\n> \"\"\n> \"three "
     "\\\"3\\\"\"\nEND_MESSAGE_BOX"},
};
INSTANTIATE_TEST_SUITE_P(Lines, ControlLine, ::testing::ValuesIn(g_lines));

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
  EXPECT_EQ(TextOf(control.m_csName) + TextOf(control.m_csToolTip) + TextOf(control.m_csAction), "(null)(null)(null)");
  EXPECT_EQ(TextOf(control.m_csCaption), "");
  EXPECT_EQ(control.m_iSize[3], 8);
  EXPECT_FALSE(control.m_Background.bSet);
}

TEST(ControlLineParts, ScaleOnceByTheScreensResolution) {
  const int size[8] = {10, 10, 75, 23};
  const struct {
    const char* szFlags;
    double dReadAt, dResizedAt;
    std::vector<int> read;
    int iResizedWidth;
  } rows[] = {
      {"", 1.0, 1.25, {10, 10, 75, 23}, 93},
      {"", 1.25, 1.25, {12, 12, 93, 28}, 75},
      {",NO_LOGPIXELS", 1.25, 1.25, {10, 10, 75, 23}, 75},
      {"", 0.75, 1.0, {10, 10, 75, 23}, 75},
  };
  for (const auto& row : rows) {
    ControlReader reader(std::string("EDIT_FIELD 'e' 10 10 75 23") + row.szFlags, row.dReadAt);
    BaseControl& control = reader.Read().Control();
    EXPECT_EQ(std::vector<int>(control.m_iSize, control.m_iSize + 4), row.read) << row.dReadAt << row.szFlags;
    EXPECT_EQ(control.m_bScaled, row.read[0] != 10);
    EXPECT_EQ(control.Resize(size, row.dResizedAt), 0);
    EXPECT_EQ(control.m_iSize[2], row.iResizedWidth) << row.dReadAt << row.szFlags;
    EXPECT_EQ(control.Resize(nullptr, 1.0), 1);
    EXPECT_EQ(control.m_iSize[2], row.iResizedWidth);
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

TEST(ControlLineParts, MarginsAndAlignment) {
  const struct {
    const char* szFlags;
    std::vector<int> margins;  // left, left and right, top, top and bottom
  } rows[] = {
      {"MARGIN(5)", {5, 10, 5, 10}},
      {"MARGIN(5), MARGIN_LEFT(2)", {2, 2, 0, 0}},
      {"MARGIN_RIGHT(3), MARGIN_LEFT(2), MARGIN_BOTTOM(7), MARGIN_TOP(1)", {2, 5, 1, 8}},
      {"MARGIN", {0, 0, 0, 0}},
      {"MARGIN(x)", {0, 0, 0, 0}},
  };
  for (const auto& row : rows) {
    ControlReader reader(std::string("EDIT_FIELD 'e' 1 2 3 4,") + row.szFlags);
    const ControlMargins& found = reader.Read().Control().m_Margins;
    EXPECT_EQ((std::vector<int>{found.iLeft, found.iHorizontal, found.iTop, found.iVertical}), row.margins)
        << row.szFlags;
  }
  EXPECT_EQ(ControlReader("PAGER 1 2 3 4,ALIGN_BOTTOM,ALIGN_TOP").Read().Control().m_Align, ControlAlign::Bottom);
  EXPECT_EQ(ControlReader("PAGER 1 2 3 4,ALIGN_LEFT,ALIGN_RIGHT").Read().Control().m_Align, ControlAlign::Left);
}

}  // namespace
