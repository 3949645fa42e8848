// The dialog around its controls: header, dispatch, groups, action blocks, tables, the end of the control part.
#include <random>

#include "ControlReader.h"

namespace {

struct HeaderRow {
  DialogKind kind;
  const char* szRest;
  uint32_t dwStyle, dwExStyle;
};

TEST(DialogHeader, StylesFollowFromKindAndFlags) {
  const HeaderRow rows[] = {
      {DialogKind::Window, "1 2 3 4", 0x10CF0000, 0},
      {DialogKind::Dialog, "1 2 3 4", 0x10C00000, 0},
      {DialogKind::DialogSys, "1 2 3 4", 0x10C80000, 0},
      {DialogKind::DialogSys, "1 2 3 4,HIDE", 0x00C80000, 0},
      {DialogKind::Popup, "1 2 3 4", 0x90000000, 0},
      {DialogKind::Flat, "1 2 3 4", 0x56000000, 0},
      {DialogKind::FlatBorder, "1 2 3 4", 0x56800000, 0},
      {DialogKind::Float, "1 2 3 4", 0x10CF0000, 0x80},
      {DialogKind::Dialog, "1 2 3 4,FLOATING", 0x10C00000, 0x80},
  };
  for (const HeaderRow& row : rows) {
    DialogInfo dialog;
    dialog.m_Kind = row.kind;
    dialog.ReadHeader(row.szRest, row.szRest + strlen(row.szRest), {});
    EXPECT_EQ(dialog.m_dwStyle, row.dwStyle) << int(row.kind) << row.szRest;
    EXPECT_EQ(dialog.m_dwExStyle, row.dwExStyle) << int(row.kind) << row.szRest;
  }
  DialogInfo unnamed;
  unnamed.m_bKindWord = false;
  const std::string rest = " 200 200 320 200";
  unnamed.ReadHeader(rest.data(), rest.data() + rest.size(), {});
  EXPECT_EQ(unnamed.m_dwStyle, 0x10C80000u);
}

TEST(DialogHeader, NumbersAndFlags) {
  const std::string rest =
      " 200 200 541 441 ,CENTER,INHERIT_POSITION,INHERIT_SIZE,MAXIMIZE,MODELESS,FOCUS,TOOLTIP_TIME(700),"
      "BACKGROUND(227,241,484)";
  for (bool bScaling : {true, false}) {
    const std::string whole = rest + (bScaling ? "" : ",NO_LOGPIXELS");
    DialogInfo dialog;
    dialog.ReadHeader(whole.data(), whole.data() + whole.size(), {nullptr, nullptr, 1.5});
    EXPECT_EQ(std::vector<int>(dialog.m_iSize, dialog.m_iSize + 4),
              bScaling ? (std::vector<int>{300, 300, 811, 661}) : (std::vector<int>{200, 200, 541, 441}));
    EXPECT_TRUE(dialog.m_bCenter && dialog.m_bInheritPosition && dialog.m_bInheritSize && dialog.m_bMaximize &&
                dialog.m_bModeless && dialog.m_bFocus);
    EXPECT_FALSE(dialog.m_bHide);
    EXPECT_EQ(dialog.m_bNoScaling, !bScaling);
    EXPECT_EQ(dialog.m_iToolTipTime, 700);
    EXPECT_TRUE(dialog.m_Background.bSet);
    EXPECT_EQ(dialog.m_Background.blue, 484 % 256);
  }
  DialogInfo bare;
  const std::string flags = ",BACKGROUND(1,2,3)";
  bare.ReadHeader(flags.data(), flags.data() + flags.size(), {});
  EXPECT_EQ(bare.m_iSize[0], 0);
}

struct DispatchRow {
  const char* szLine;
  ControlKind kind;
};

TEST(DialogDispatch, FirstMatchingKeywordDecides) {
  const DispatchRow rows[] = {
      {"BUTTON", ControlKind::Button},
      {"TEXT_FIELD", ControlKind::Static},
      {"PROGRE", ControlKind::Progress},
      {"CHECK_BOX", ControlKind::CheckBox},
      {"EDIT_FIELD", ControlKind::Edit},
      {"RICH_EDIT", ControlKind::RichEdit},
      {"LIST_FIELD", ControlKind::ListBox},
      {"SIMULATED_LIST_FIELD", ControlKind::SimulatedListBox},
      {"COMBO_FIELD", ControlKind::Combo},
      {"MENU_BAR", ControlKind::MenuBar},
      {"RIGHT_CLICK_MENU", ControlKind::RightMenu},
      {"GROUP_BOX", ControlKind::GroupBox},
      {"FRAME", ControlKind::Frame},
      {"TRACKBAR", ControlKind::Trackbar},
      {"LISTVIEW", ControlKind::ListView},
      {"REBAR", ControlKind::Rebar},
      {"UP_DOWN", ControlKind::UpDown},
      {"ACCELERATOR", ControlKind::Accelerator},
      {"GLOBAL_ACCELERATOR", ControlKind::GlobalAccelerator},
      {"CURSOR", ControlKind::Cursor},
      {"SPLITTER", ControlKind::Splitter},
      {"WAVE", ControlKind::Wave},
      {"TREE_VIEW", ControlKind::TreeView},
      {"IMAGE", ControlKind::Image},
      {"IPADDRESS", ControlKind::IpAddress},
      {"MONTHCALENDAR", ControlKind::MonthCalendar},
      {"ANIMATION", ControlKind::Animation},
      {"DATE_PICKER", ControlKind::DatePicker},
      {"HOTKEY", ControlKind::Hotkey},
      {"HEADER", ControlKind::Header},
      {"PAGER", ControlKind::Pager},
      {"STATUS_BAR", ControlKind::StatusBar},
  };
  for (const DispatchRow& row : rows) {
    ControlReader reader(std::string("  ") + row.szLine + " 'x' 1 2 3 4");
    ASSERT_EQ(reader.Read().Count(), 1) << row.szLine;
    EXPECT_EQ(reader.Control().Kind(), row.kind) << row.szLine;
    EXPECT_EQ(reader.Control().m_iSize[3], 4) << row.szLine;
  }
  ControlReader ignored("button 'b' 1 2 3 4\nUNKNOWN 'x' 1 2 3 4\n\n   \nBUTTO 'b'\nX BUTTON 'b' 1 2 3 4");
  EXPECT_EQ(ignored.Read().Count(), 0);
  EXPECT_TRUE(ignored.sink.shown.empty());
}

TEST(DialogGroups, PartnersAreTheOtherBoxesOfTheGroup) {
  ControlReader reader(
      "CHECK_BOX 'out' 1 2 3 4\nGROUP\n CHECK_BOX 'a' 1 2 3 4\n TEXT_FIELD 't' \"x\" 1 2 3 4\n CHECK_BOX 'b' 1 2 3 4\n"
      " CHECK_BOX 'a' 9 9 9 9\nEND_GROUP\n"
      "CHECK_BOX 'next' 1 2 3 4\nGROUP\nCHECK_BOX 'c' 1 2 3 4");
  reader.Read();
  ASSERT_EQ(reader.Count(), 7);
  EXPECT_TRUE(reader.dialog.m_bHasCheckGroups);
  EXPECT_EQ(reader.Control(0).m_Partners.Size(), 0);
  ASSERT_EQ(reader.Control(1).m_Partners.Size(), 1);  // the box of the same name is no partner
  EXPECT_EQ(reader.Control(1).m_Partners[0], &reader.Control(3));
  EXPECT_EQ(reader.Control(3).m_Partners.Size(), 2);
  EXPECT_TRUE(reader.Control(3).m_bGrouped);
  EXPECT_EQ(reader.Control(6).m_Partners.Size(), 0);  // its group was never closed
  EXPECT_FALSE(reader.Control(6).m_bGrouped);
  std::string starts;
  for (int i = 0; i < reader.Count(); i++) starts += reader.Control(i).m_dwStyle & STYLE_GROUP ? '1' : '0';
  EXPECT_EQ(starts, "0100010") << "a group and what follows it are groups for the system too";
}

TEST(DialogActions, BlocksAreKeptUpToTheirFinish) {
  ControlReader reader(
      "START_BEFORE_DRAWING\n\n   START_ACTION here\n  One ()\n  Two ()\n FINISH_ACTION x\nPAGER 'p' 1 2 3 4\n"
      "START_AFTER_DRAWING\nSTART_ACTION\nFINISH_ACTION\nSTART_BEFORE_DRAWING\nSTART_ACTION\nThree ()\nFINISH_ACTION");
  EXPECT_EQ(reader.Read().Count(), 1);
  EXPECT_EQ(TextOf(reader.dialog.m_csBeforeDrawing), "Three ()\nFINISH_ACTION");
  EXPECT_EQ(TextOf(reader.dialog.m_csAfterDrawing), "FINISH_ACTION");
  EXPECT_TRUE(reader.sink.shown.empty());
}

TEST(DialogActions, MissingWordsAreReportedAndReadingGoesOn) {
  const char* rows[][2] = {
      {"START_BEFORE_DRAWING\nPAGER 'p' 1 2 3 4", "Missing START_ACTION after START_BEFORE_DRAWING!"},
      {"START_AFTER_DRAWING\nPAGER 'p' 1 2 3 4", "Missing START_ACTION after START_AFTER_DRAWING!"},
      {"PAGER 'p' 1 2 3 4\nSTART_AFTER_DRAWING", "Missing START_ACTION after START_AFTER_DRAWING!"},
      {"START_BEFORE_DRAWING\nSTART_ACTION\nOne ()\nPAGER 'p' 1 2 3 4",
       "Missing FINISH_ACTION after START_BEFORE_DRAWING!"},
      {"PAGER 'p' 1 2 3 4\nSTART_AFTER_DRAWING\nSTART_ACTION", "Missing FINISH_ACTION after START_AFTER_DRAWING!"},
  };
  for (auto& row : rows) {
    ControlReader reader(row[0]);
    EXPECT_EQ(reader.ReadTight().Count(), 1) << row[0];
    EXPECT_EQ(reader.sink.shown, std::vector<std::string>{std::string("Syntax Error|") + row[1]});
    EXPECT_EQ(TextOf(reader.dialog.m_csBeforeDrawing), "(null)");
  }
  ControlReader two(
      "START_BEFORE_DRAWING\nSTART_ACTION\nOne ()\nSTART_AFTER_DRAWING\nSTART_ACTION\nTwo ()\nFINISH_ACTION");
  two.Read();
  EXPECT_EQ(two.sink.shown.size(), 1u);
  EXPECT_EQ(TextOf(two.dialog.m_csBeforeDrawing), "(null)");
  EXPECT_EQ(TextOf(two.dialog.m_csAfterDrawing), "Two ()\nFINISH_ACTION");
}

TEST(DialogTables, AreKeptAsText) {
  ControlReader reader("TABLE_START\n {\nTABLE_COLUMN (width=100p, hide=0)\n}\nPAGER 'p' 1 2 3 4");
  EXPECT_EQ(reader.Read().Count(), 1);
  EXPECT_EQ(TextOf(reader.dialog.m_csTables), "TABLE_START\n{\nTABLE_COLUMN (width=100p, hide=0)\n}");
  for (const char* szText : {"TABLE_START\nPAGER 'p' 1 2 3 4", "TABLE_START\n{\nPAGER 'p' 1 2 3 4"}) {
    ControlReader bad(szText);
    EXPECT_EQ(bad.ReadTight().Count(), 1);
    EXPECT_EQ(bad.report.FaultCount(), 1);
    EXPECT_EQ(TextOf(bad.dialog.m_csTables), "(null)");
  }
}

struct EndRow {
  const char* szText;
  int iAt;  // -1: none
};

TEST(DialogEnd, IsAWordOfItsOwn) {
  const EndRow rows[] = {
      {"END\n", 0},
      {"END", 0},
      {" END x", 1},
      {"END_GROUP\nEND\n", 10},
      {"ENDS\nXEND\n", -1},
      {"'END' END.\n", -1},
      {"\"THE END OF\"\nEND", 13},
      {"> THE END\nEND", 10},
      {"\"THE END", 5},
      {"", -1},
  };
  for (const EndRow& row : rows) {
    const std::vector<char> text(row.szText, row.szText + strlen(row.szText));
    const char* pEnd = DialogInfo::pFindEnd(text.data(), text.data() + text.size());
    EXPECT_EQ(pEnd ? pEnd - text.data() : -1, row.iAt) << row.szText;
  }
}

// Lines put together at random from what the readers look for: nothing is read beyond the text, and what is written
// back reads the same again.
TEST(DialogInfo, RandomTextsAreReadWithinTheirBounds) {
  const char* const pieces[] = {
      "BUTTON ",
      "TEXT_FIELD ",
      "LIST_FIELD ",
      "IMAGE ",
      "EDIT_FIELD ",
      "MESSAGE_BOX ",
      "END_MESSAGE_BOX",
      "FRAME ",
      "END_FRAME",
      "UP_DOWN ",
      "COMBO_FIELD ",
      "END_COMBO",
      "GROUP\n",
      "END_GROUP\n",
      "CHECK_BOX ",
      "TABLE_START",
      "START_BEFORE_DRAWING",
      "START_ACTION",
      "FINISH_ACTION",
      "'",
      "'",
      "\"",
      "\"",
      "\\",
      "n",
      ">",
      "\n",
      "\n",
      " ",
      " ",
      ",",
      "(",
      ")",
      "{",
      "}",
      "1",
      "20 30",
      "-7",
      "TOOLTIP ",
      "ACTION",
      "ACTION: (",
      "ID_NEXT ",
      "ID_",
      "IDB_X",
      "HIDE",
      "BACKGROUND(",
      "MARGIN(",
      "x",
      "abc",
      "END",
  };
  std::mt19937 random(20);
  for (int iRound = 0; iRound < 20000; iRound++) {
    std::string text = pieces[random() % 16];  // a keyword
    for (unsigned n = random() % 30; n > 0; n--) text += pieces[random() % std::size(pieces)];
    ControlReader first(text, iRound % 2 ? 1.0 : 1.25);
    first.ReadTight();
    ControlReader second(first.Dump(), iRound % 2 ? 1.0 : 1.25);
    ASSERT_EQ(second.ReadTight().Dump(), first.Dump()) << text;
  }
}

}  // namespace
