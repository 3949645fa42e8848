// Menus, bars and accelerators as their lines describe them.
#include "ControlReader.h"
#include "controls/MenuKinds.h"

namespace {

struct DumpRow {
  const char* szLines;
  const char* szDump;  // null: as the lines
  std::vector<std::string> faults;
};

const char KEY_FAULT[] = "pogresan ID, ili verzija Bafunpraik ne podrzava taj ID";

TEST(MenuKinds, WhatIsReadIsWrittenBack) {
  const DumpRow rows[] = {
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
  for (const DumpRow& row : rows) {
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
  } rows[] = {
      {"a", 'A', 0},
      {"Ctrl+shift+ALT+z", 'Z', KEY_CTRL | KEY_SHIFT | KEY_ALT},
      {" ctrl + 0 ", '0', KEY_CTRL},
      {"F1", 0x70, 0},
      {"f24", 0x87, 0},
      {"F25", 0, 0},
      {"F1x", 0, 0},
      {"Ctrl++", 0xBB, KEY_CTRL},
      {"-", 0xBD, 0},
      {"PGDN", 0x22, 0},
      {"Escape", 0x1B, 0},
      {"Shift+Delete", 0x2E, KEY_SHIFT},
      {"Space", 0x20, 0},
      {"Up", 0x26, 0},
      {"Ctrl+", 0, KEY_CTRL},
      {"Shift F1", 0x70, KEY_SHIFT},
      {"Ctrl", 0, KEY_CTRL},
      {"A+Ctrl", 0, 0},
      {"Enterr", 0, 0},
      {"", 0, 0},
  };
  for (const auto& row : rows) {
    KeyChord chord;
    const std::string text = row.szText;
    EXPECT_EQ(bReadKey(text.data(), text.data() + text.size(), chord), row.iKey != 0) << text;
    EXPECT_EQ(chord.iKey, row.iKey) << text;
    EXPECT_EQ(chord.uModifiers, row.uModifiers) << text;
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
