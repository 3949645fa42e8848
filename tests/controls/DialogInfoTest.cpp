// The dialog around its controls: header, dispatch, groups, action blocks, tables, the end of the control part.
#include <random>
#include <sstream>

#include "ControlReader.h"
#include "controls/ScriptText.h"

namespace {

// The other kinds are looked at on real windows.
TEST(DialogHeader, StylesFollowFromKindAndFlags) {
  const struct {
    DialogKind kind;
    bool bKindWord;
    const char* szFlags;
    uint32_t dwStyle, dwExStyle;
  } rows[] = {
      {DialogKind::DialogSys, true, ",HIDE", 0x00C80000, 0}, {DialogKind::Dialog, true, ",FLOATING", 0x10C00000, 0x80},
      {DialogKind::Popup, true, "", 0x90000000, 0},          {DialogKind::Flat, true, "", 0x56000000, 0},
      {DialogKind::FlatBorder, true, "", 0x56800000, 0},     {DialogKind::Float, true, "", 0x10CF0000, 0x80},
      {DialogKind::Dialog, false, "", 0x10C80000, 0},
  };
  for (const auto& row : rows) {
    DialogInfo dialog;
    dialog.m_Kind = row.kind;
    dialog.m_bKindWord = row.bKindWord;
    const std::string rest = std::string(" 200 200 320 200") + row.szFlags;
    dialog.ReadHeader(rest.data(), rest.data() + rest.size(), {});
    EXPECT_EQ(dialog.m_dwStyle, row.dwStyle) << int(row.kind) << row.szFlags;
    EXPECT_EQ(dialog.m_dwExStyle, row.dwExStyle) << int(row.kind) << row.szFlags;
  }
}

TEST(DialogHeader, NumbersAndFlags) {
  const std::string rest =
      " 200 200 541 441 ,CENTER,INHERIT_POSITION,INHERIT_SIZE,MAXIMIZE,MODELESS,FOCUS,TOOLTIP_TIME(700),"
      "BACKGROUND(-1,241,484)";
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
    EXPECT_EQ(dialog.m_Background.red, 255);
    EXPECT_EQ(dialog.m_Background.blue, 484 % 256);
  }
  DialogInfo bare;
  const std::string flags = ",BACKGROUND(1,2,3)";
  bare.ReadHeader(flags.data(), flags.data() + flags.size(), {});
  EXPECT_EQ(bare.m_iSize[0], 0);
}

// Every keyword begins a line that a test of this folder writes back.
TEST(DialogDispatch, OnlyWholeKeywordsInTheirPlaceCount) {
  ControlReader reader(
      "  PROGRE 'p' 1 2 3 4\nbutton 'b' 1 2 3 4\nUNKNOWN 'x' 1 2 3 4\n\n   \nBUTTO 'b'\nX BUTTON 'b' 1 1");
  ASSERT_EQ(reader.Read().Count(), 1);
  EXPECT_EQ(reader.Control().Kind(), ControlKind::Progress);
  EXPECT_TRUE(reader.sink.shown.empty());
}

std::string Partners(const ControlReader& reader, int iBox) {
  std::string places;
  const ControlPartners& partners = reader.Control(iBox).m_Partners;
  for (int i = 0; i < partners.Size(); i++)
    for (int j = 0; j < reader.Count(); j++)
      if (partners[i] == &reader.Control(j)) places += std::to_string(j);
  EXPECT_EQ(partners[partners.Size()], nullptr);
  EXPECT_EQ(partners[-1], nullptr);
  return places;
}

TEST(DialogGroups, PartnersAreTheOtherBoxesOfTheGroup) {
  ControlReader reader(
      "CHECK_BOX 'out' 1 2 3 4\nGROUP\n CHECK_BOX 'b' 1 2 3 4\n TEXT_FIELD 't' \"x\" 1 2 3 4\n CHECK_BOX 'a' 1 2 3 4\n"
      " CHECK_BOX 'b' 9 9 9 9\n CHECK_BOX 'c' 9 9 9 9\n CHECK_BOX 'b' 9 9 9 9\nEND_GROUP\n"
      "CHECK_BOX 'next' 1 2 3 4\nGROUP\nEND_GROUP\nGROUP\nCHECK_BOX 'd' 1 2 3 4");
  reader.Read();
  ASSERT_EQ(reader.Count(), 9);
  EXPECT_TRUE(reader.dialog.m_bHasCheckGroups);
  // Boxes of one name are no partners; the last group was never closed.
  const char* const PARTNERS[] = {"", "35", "", "1456", "35", "1346", "35", "", ""};
  for (int i = 0; i < reader.Count(); i++) {
    EXPECT_EQ(Partners(reader, i), PARTNERS[i]) << i;
    EXPECT_EQ(reader.Control(i).m_bGrouped, *PARTNERS[i] != 0) << i;
  }
  std::string starts;
  for (int i = 0; i < reader.Count(); i++) starts += reader.Control(i).m_dwStyle & STYLE_GROUP ? '1' : '0';
  EXPECT_EQ(starts, "010000011") << "a group and what follows it are groups for the system too";
  EXPECT_EQ(reader.dialog.GetBaseControl("b"), &reader.Control(1));
  EXPECT_EQ(reader.dialog.GetBaseControl("next"), &reader.Control(7));
}

TEST(DialogBlocks, NestToALimit) {
  for (int nBlocks : {ScriptText::NESTING_LIMIT, ScriptText::NESTING_LIMIT + 1}) {
    std::string text;
    for (int i = 1; i < nBlocks; i++) text += "\nBLOCK";
    for (int i = 0; i < nBlocks; i++) text += "\n END_BLOCK";
    const char* pEnd = text.data() + text.size();
    const char* pFound = ScriptText::FindEndLine(text.data(), pEnd, "BLOCK", "END_BLOCK", true);
    EXPECT_EQ(pFound, nBlocks > ScriptText::NESTING_LIMIT ? nullptr : pEnd - strlen("END_BLOCK"));
  }
}

TEST(DialogEnd, IsAWordOfItsOwn) {
  const struct {
    const char* szText;
    int iAt;  // -1: none
  } rows[] = {
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
  for (const auto& row : rows) {
    const std::vector<char> text(row.szText, row.szText + strlen(row.szText));
    const char* pEnd = DialogInfo::pFindEnd(text.data(), text.data() + text.size());
    EXPECT_EQ(pEnd ? pEnd - text.data() : -1, row.iAt) << row.szText;
  }
}

std::vector<std::string> Split(const std::string& text) {
  std::istringstream stream(text);
  std::vector<std::string> parts;
  for (std::string part; std::getline(stream, part, '|');) parts.push_back(part);
  return parts;
}

// Lines put together at random from what the readers look for: nothing is read beyond the text, and what is written
// back reads the same again.
TEST(DialogInfo, RandomTextsAreReadWithinTheirBounds) {
  const std::vector<std::string> keywords = Split(
      "BUTTON |TEXT_FIELD |LIST_FIELD |IMAGE |EDIT_FIELD |MESSAGE_BOX |FRAME |UP_DOWN |COMBO_FIELD |GROUP\n|CHECK_BOX |"
      "TABLE_START|TABLE_START\n{\n|TAB_CONTROL |GROUP_BOX |LISTVIEW |TREE_VIEW |MENU_BAR |RIGHT_CLICK_MENU |TOOLBAR |"
      "REBAR |HEADER |STATUS_BAR |ACCELERATOR |CURSOR |PAGER |PROPERTY_SHEET ");
  const std::vector<std::string> pieces = Split(
      "\nEND_MESSAGE_BOX|\nEND_FRAME|\nEND_COMBO|\nEND_LISTVIEW|\nEND_TREE_VIEW|\nEND_MENUBAR|\nEND_RIGHT_CLICK_MENU|"
      "\nEND_TOOLBAR|\nEND_REBAR|\nEND_GROUP\n|TABLE_COLUMN (width=|TABLE_ROW (height=2)|'a' SPAN(|TAB |\nEND_TAB|"
      "\nEND_TAB_CONTROL\n|SHEET |\nEND_PROPERTY_SHEET|\nEND_GROUP_BOX\n|\nITEM |\nITEM '1,0' |\nCOLUMN |\nMENU |"
      "\nSUBMENU |\nEND_MENU|\nEND_SUBMENU|\nSEPARATOR|\nBAND |\nCOMBO |\n\"|\nBEGIN|\\t|Ctrl+|F5|#65|<RGB(1,2,3)>|"
      "VAR(v)|x.bmp|<%v%>|START_BEFORE_DRAWING|START_ACTION|FINISH_ACTION|'|'|'|\"|\"|\"|\\|n|>|\n|\n| | "
      "|,|,|(|)|{|}|1|"
      "20 30|-7|TOOLTIP |ACTION|ACTION: (|ID_NEXT |ID_|IDB_X|HIDE|BACKGROUND(|MARGIN(|x|abc|END");
  std::mt19937 random(20);
  for (int iRound = 0; iRound < 30000; iRound++) {
    std::string text = keywords[random() % keywords.size()];
    for (unsigned n = random() % 30; n > 0; n--)
      text += random() % 8 ? pieces[random() % pieces.size()] : keywords[random() % keywords.size()];
    ControlReader first(text, iRound % 2 ? 1.0 : 1.25);
    first.ReadTight();
    ControlReader second(first.Dump(), iRound % 2 ? 1.0 : 1.25);
    ASSERT_EQ(second.ReadTight().Dump(), first.Dump()) << text;
  }
}

}  // namespace
