// Native controls made from script lines: texts, clicks, keys, focus, colours, fonts, pictures.
#include "Page.h"
#include "foundation/os/Os.h"
#include "window/Pictures.h"

using Events = std::vector<std::string>;

namespace {

// The colour behind a control, as its window asks for it.
COLORREF GroundOf(HWND hControl, UINT uMessage) {
  ScreenDC screen;
  const auto hBrush = reinterpret_cast<HBRUSH>(SendMessageW(
      GetParent(hControl), uMessage, reinterpret_cast<WPARAM>(screen.Get()), reinterpret_cast<LPARAM>(hControl)));
  LOGBRUSH brush = {};
  GetObjectW(hBrush, sizeof(brush), &brush);
  return brush.lbColor;
}

LOGFONTW FontOf(HWND hControl) {
  LOGFONTW font = {};
  GetObjectW(reinterpret_cast<HFONT>(SendMessageW(hControl, WM_GETFONT, 0, 0)), sizeof(font), &font);
  return font;
}

const COLORREF GREEN = RGB(227, 241, 228);

}  // namespace

TEST(Controls, TextsKeepTheirCroatianLettersWhateverTheCodePage) {
  ShownPage screen(
      "BUTTON 'b' \"Pokaži\" 1 1 75 23\n"
      "EDIT_FIELD 'e' \"\" 1 30 90 20\n"
      "EDIT_FIELD 'lines' \"\" 1 60 90 60, MULTILINE\n"
      "TEXT_FIELD 't' \"Đurđa\" 1 130 90 15\n");
  EXPECT_NE(screen.hChild(L"Pokaži"), nullptr);
  EXPECT_NE(screen.hChild(L"Đurđa"), nullptr);
  ASSERT_TRUE(screen.bSet("e", "čćžšđ ČĆŽŠĐ €"));
  EXPECT_NE(screen.hChild(L"čćžšđ ČĆŽŠĐ €"), nullptr);
  SetWindowTextW(screen.hChild(L"čćžšđ ČĆŽŠĐ €"), L"Šuma 日");
  EXPECT_EQ(screen.Value("e"), "Šuma ?") << "what the code page cannot hold";
  ASSERT_TRUE(screen.bSet("lines", "a\nb\r\nc"));
  EXPECT_EQ(screen.Value("lines"), "a\r\nb\r\nc");
}

TEST(Controls, ButtonsClickOnceForEachPressAndNavigate) {
  ShownPage screen(
      "BUTTON 'b_next' \"Next\" ID_NEXT 1 1 75 23, BACKGROUND(227,241,228)\n"
      "BUTTON 'run' \"Run\" 1 30 75 23, BACKGROUND(227,241,228)\n"
      "BUTTON 'plain' \"Plain\" 1 60 75 23\n"
      "BUTTON 'off' \"Off\" 1 90 75 23, DISABLE, BACKGROUND(227,241,228)\n");
  Click(screen.hChild(L"Next"));
  Click(screen.hChild(L"Run"));
  Click(screen.hChild(L"Run"), {5, 5}, WM_LBUTTONDBLCLK);  // the second of two quick presses
  Click(screen.hChild(L"Plain"));
  screen.RunQueued();
  EXPECT_EQ(screen.TakeEvents(), (Events{"command 101", "run 0", "run 0", "plain 0"}));
  EXPECT_FALSE(IsWindowEnabled(screen.hChild(L"Off")));
  EXPECT_EQ(GetWindowLongW(screen.hChild(L"Run"), GWL_STYLE) & BS_TYPEMASK, BS_OWNERDRAW);
  EXPECT_EQ(GetWindowLongW(screen.hChild(L"Plain"), GWL_STYLE) & BS_TYPEMASK, BS_DEFPUSHBUTTON) << "it has the focus";
}

TEST(Controls, EnterPressesTheFocusedButtonElseTheDefaultOne) {
  ShownPage screen(
      "EDIT_FIELD 'name' \"\" 1 1 75 20, FOCUS\n"
      "BUTTON 'b_back' \"Back\" ID_BACK 1 30 75 23, BACKGROUND(1,2,3)\n"
      "BUTTON 'go' \"Go\" 1 60 75 23, DEFAULT, BACKGROUND(1,2,3)\n");
  EXPECT_EQ(GetFocus(), screen.hChildOfClass(L"EDIT"));
  screen.Press({VK_RETURN, VK_TAB});
  EXPECT_EQ(GetFocus(), screen.hChild(L"Back")) << "tab order is line order";
  screen.Press({VK_RETURN, VK_TAB, VK_SPACE});
  EXPECT_EQ(screen.TakeEvents(), (Events{"name 256", "go 0", "name 512", "command 102", "go 0"}));
}

TEST(Controls, FocusGoesToTheLastThatAsksElseToTheFirstThatCanTakeIt) {
  Screen screen;
  Page asks(DialogKind::DialogSys, "0 0 400 300",
            "BUTTON 'a' \"A\" 1 1 75 23, FOCUS\nBUTTON 'b' \"B\" 1 30 75 23, FOCUS\n"
            "BUTTON 'c' \"C\" 1 60 75 23, FOCUS, DISABLE\n");
  Page silent(DialogKind::DialogSys, "0 0 400 300",
              "TEXT_FIELD 't' \"T\" 1 1 75 15\nBUTTON 'd' \"D\" 1 20 75 23, DISABLE\n"
              "BUTTON 'e' \"E\" 1 50 75 23\nBUTTON 'f' \"F\" 1 80 75 23\n");
  screen.Show(asks);
  EXPECT_EQ(GetFocus(), screen.hChild(L"B"));
  screen.Show(silent);
  EXPECT_EQ(GetFocus(), screen.hChild(L"E"));
  screen.view->bEnable(silent["e"], false);
  EXPECT_EQ(GetFocus(), screen.hChild(L"F")) << "a disabled control hands the keyboard on";
}

TEST(Controls, OnlyLinksCanBePressedAmongTexts) {
  ShownPage screen(
      "BUTTON 'ok' \"OK\" 1 1 75 23, DEFAULT, FOCUS\n"
      "TEXT_FIELD 'web' \"www\" 1 30 75 15, LINK ACTION: (http://tavola.example)\n"
      "TEXT_FIELD 'tip' \"tip\" TOOLTIP 'more' 1 60 75 15\n");
  const HWND hLink = screen.hChild(L"www"), hText = screen.hChild(L"tip");
  for (const HWND hWnd : {hLink, hText}) PostMessageW(hWnd, WM_LBUTTONDOWN, 0, 0);
  screen.RunQueued();
  EXPECT_EQ(screen.TakeEvents(), Events{"web 0"});
  screen.Press({VK_TAB, VK_RETURN, VK_SPACE, VK_TAB, VK_RETURN});
  EXPECT_EQ(screen.TakeEvents(), (Events{"web 0", "web 0", "ok 0"}));
  EXPECT_EQ(hCursorOver(hLink), LoadCursorW(nullptr, IDC_HAND));
  EXPECT_NE(hCursorOver(hText), LoadCursorW(nullptr, IDC_HAND));
  EXPECT_TRUE(FontOf(hLink).lfUnderline);
  EXPECT_FALSE(FontOf(hText).lfUnderline);
}

TEST(Controls, CheckBoxesSpeakInOnesAndZeros) {
  ShownPage screen("CHECK_BOX 'a' \"A\" 1 1 75 15\nCHECK_BOX 'b' \"<%v%>\" 1 20 75 15\n");
  screen.bSet("a", "1");
  ASSERT_TRUE(screen.view->bSetCaption(screen["b"], "Šuma"));
  const auto states = [&] { return screen.Value("a") + screen.Value("b"); };
  EXPECT_EQ(states(), "10");
  SendMessageW(screen.hChild(L"Šuma"), BM_CLICK, 0, 0);
  EXPECT_EQ(states(), "11");
  SendMessageW(screen.hChild(L"A"), BM_CLICK, 0, 0);
  EXPECT_EQ(states(), "01");
  EXPECT_EQ(screen.TakeEvents(), (Events{"b 0", "a 0"}));
}

TEST(Controls, ABoxWithoutWordsIsNamedByItsLabel) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300",
            "CHECK_BOX 'c' 10 10 13 13\nTEXT_FIELD 't' \"Create <%v%>\" 35 10 90 15\n"
            "CHECK_BOX 'own' \"Own\" 10 40 13 13\nTEXT_FIELD 'u' \"Label\" 35 40 90 15\n");
  ASSERT_TRUE(screen.view->bCreateDialog(page.info));
  screen.view->bSetText(page["t"], "Create shortcut");
  screen.view->ShowDialog();
  EXPECT_EQ(TextOf(ChildWindowFromPoint(screen.hWindow(), {12, 12})), L"Create shortcut");
  EXPECT_EQ(TextOf(ChildWindowFromPoint(screen.hWindow(), {12, 42})), L"Own");
  EXPECT_EQ(PixelOf(ChildWindowFromPoint(screen.hWindow(), {34, 12}), 33, 12), GetSysColor(COLOR_BTNFACE)) << "unseen";
}

TEST(Controls, TheGroundBehindTextsIsTheirsOrTheDialogs) {
  ShownPage screen(
      "TEXT_FIELD 't' \"T\" 1 1 75 15\nTEXT_FIELD 'u' \"U\" 1 20 75 15, BACKGROUND(10,20,30)\n"
      "CHECK_BOX 'c' \"C\" 1 40 75 15\nEDIT_FIELD 'e' \"\" 1 60 75 20\n",
      "0 0 400 300, BACKGROUND(227,241,228)");
  EXPECT_EQ(GroundOf(screen.hChild(L"T"), WM_CTLCOLORSTATIC), GREEN);
  EXPECT_EQ(GroundOf(screen.hChild(L"C"), WM_CTLCOLORSTATIC), GREEN);
  EXPECT_EQ(GroundOf(screen.hChild(L"U"), WM_CTLCOLORSTATIC), RGB(10, 20, 30));
  EXPECT_EQ(GroundOf(screen.hChildOfClass(L"EDIT"), WM_CTLCOLOREDIT), GetSysColor(COLOR_WINDOW));
  EXPECT_EQ(PixelOf(screen.hWindow(), 200, 150), GREEN);
  EXPECT_EQ(PixelOf(screen.hChild(L"U"), 74, 14), RGB(10, 20, 30));
}

TEST(Controls, FontsAreOfTheDialogsCellHeightAndTheFlagsVariant) {
  ShownPage screen(
      "TEXT_FIELD 'n' \"N\" 1 1 75 15\nTEXT_FIELD 'b' \"B\" 1 20 75 15, BOLD\n"
      "TEXT_FIELD 'g' \"G\" 1 40 75 25, BIGBOLD\nTEXT_FIELD 'i' \"I\" 1 70 75 15, ITALIC\n");
  EXPECT_EQ(FontOf(screen.hChild(L"N")).lfHeight, 15);
  EXPECT_EQ(FontOf(screen.hChild(L"N")).lfWeight, 500);
  EXPECT_EQ(FontOf(screen.hChild(L"B")).lfWeight, FW_BOLD);
  EXPECT_GT(FontOf(screen.hChild(L"G")).lfHeight, 15);
  EXPECT_TRUE(FontOf(screen.hChild(L"I")).lfItalic);
}

// With SS_NOPREFIX '&' is a character like others.
TEST(Controls, AmpersandsAreMnemonicsOnlyWhereTheScriptWritesThem) {
  ShownPage screen("TEXT_FIELD 'l' \"&Name\" 1 1 90 15\nTEXT_FIELD 'file' \"f\" 1 20 90 15\n");
  screen.bSet("file", "R&D.txt");
  EXPECT_FALSE(GetWindowLongW(screen.hChild(L"&Name"), GWL_STYLE) & SS_NOPREFIX);
  EXPECT_TRUE(GetWindowLongW(screen.hChild(L"R&D.txt"), GWL_STYLE) & SS_NOPREFIX);
  Page page(DialogKind::DialogSys, "0 0 400 300", "TEXT_FIELD 't' \"<%v%>\" 10 10 40 15\n");
  ASSERT_TRUE(screen.view->bCreateDialog(page.info));
  screen.view->bSetText(page["t"], "&&&&&&&&&&&&&&&&&&&&");
  screen.view->ShowDialog();
  EXPECT_GT(ClientOf(screen.hChild(L"&&&&&&&&&&&&&&&&&&&&")).cx, 130) << "measured as they are drawn";
}

TEST(Controls, OwnerDrawnButtonsShowColourDefaultAndPressedState) {
  ShownPage screen(
      "BUTTON 'a' \" \" 10 10 75 23, BACKGROUND(200,0,0)\n"
      "BUTTON 'b' \"  \" 10 40 75 23, DEFAULT, BACKGROUND(200,0,0)\n"
      "EDIT_FIELD 'e' \"\" 10 70 75 20, FOCUS\n",
      "0 0 400 300, BACKGROUND(227,241,228)");
  const HWND hPlain = screen.hChild(L" "), hDefault = screen.hChild(L"  ");
  const COLORREF face = PixelOf(hPlain, 37, 11);
  EXPECT_TRUE(GetRValue(face) > 180 && GetGValue(face) < 120 && GetBValue(face) < 120) << std::hex << face;
  EXPECT_EQ(PixelOf(hPlain, 0, 0), GREEN) << "the page shows behind the round corners";
  EXPECT_LT(GetRValue(PixelOf(hPlain, 0, 11)), GetRValue(face)) << "a darker border";
  const COLORREF inside = PixelOf(hPlain, 1, 11);
  EXPECT_LT(GetRValue(PixelOf(hDefault, 1, 11)), GetRValue(inside)) << "the default button's border is doubled";
  SetFocus(hPlain);
  EXPECT_LT(GetRValue(PixelOf(hPlain, 1, 11)), GetRValue(inside)) << "the default look follows the focus";
  EXPECT_EQ(PixelOf(hDefault, 1, 11), inside);
  SendMessageW(hPlain, BM_SETSTATE, TRUE, 0);
  EXPECT_LT(GetRValue(PixelOf(hPlain, 37, 11)), GetRValue(face));
}

TEST(Controls, ALineOfTextTakesTheFreeRoomThatItNeeds) {
  ShownPage screen(
      "TEXT_FIELD 'free' \"Enter your name and your company name.\" 10 10 40 15\n"
      "TEXT_FIELD 'short' \"Name:\" 10 40 90 15\n"
      "TEXT_FIELD 'stopped' \"Enter your name and your company name!\" 10 70 40 15\n"
      "EDIT_FIELD 'e' \"\" 80 70 50 20\n"
      "TEXT_FIELD 'lines' \"Enter your name and your company name?\" 10 100 90 45\n");
  const auto width = [&](const wchar_t* szText) { return ClientOf(screen.hChild(szText)).cx; };
  EXPECT_GT(width(L"Enter your name and your company name."), 150);
  EXPECT_EQ(width(L"Name:"), 90);
  EXPECT_EQ(width(L"Enter your name and your company name!"), 70) << "up to its neighbour";
  EXPECT_EQ(width(L"Enter your name and your company name?"), 90) << "several lines wrap";
}

TEST(Controls, HiddenOnesStayHiddenUntilShown) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300",
            "TEXT_FIELD 'h' \"H\" 1 1 75 15, HIDE\nTEXT_FIELD 'v' \"V\" 1 20 75 15\n"
            "TEXT_FIELD 'w' \"W\" 1 40 75 15, HIDE\n");
  ASSERT_TRUE(screen.view->bCreateDialog(page.info));
  screen.view->bShow(page["v"], false);  // commands before the drawing
  screen.view->bShow(page["w"], true);
  EXPECT_FALSE(GetWindowLongW(screen.hChild(L"W"), GWL_STYLE) & WS_VISIBLE) << "nothing shows before its page does";
  screen.view->ShowDialog();
  EXPECT_FALSE(IsWindowVisible(screen.hChild(L"H")));
  EXPECT_FALSE(IsWindowVisible(screen.hChild(L"V")));
  EXPECT_TRUE(IsWindowVisible(screen.hChild(L"W")));
  screen.view->bShow(page["h"], true);
  EXPECT_TRUE(IsWindowVisible(screen.hChild(L"H")));
}

TEST(Controls, PicturesTakeTheirOwnSizeAndLeaveTheirGroundOut) {
  CNString csFile;
  WritePicture("test.bmp", csFile);
  ShownPage screen(
      "IMAGE 'i' test.bmp 10 20 0 0, CUSTOM, TRANSPARENT(204,204,204)\n"
      "IMAGE 'wide' test.bmp 50 20 80 40, CUSTOM, STRETCH, TRANSPARENT(204,204,204)\n"
      "IMAGE 'none' missing.bmp 10 80 20 20, CUSTOM\n"
      "IMAGE 'plain' test.bmp 10 120 4 2, TRANSPARENT(204,204,204)\n",
      "0 0 400 300, BACKGROUND(227,241,228)");
  const auto child = [&](int x, int y) { return ChildWindowFromPoint(screen.hWindow(), {x, y}); };
  EXPECT_EQ(PlaceText(child(11, 21)), "10 20 4 2");
  EXPECT_EQ(PixelOf(child(11, 21), 0, 0), RGB(255, 0, 0));
  EXPECT_EQ(PixelOf(child(11, 21), 3, 1), GREEN);
  EXPECT_EQ(PixelOf(child(60, 30), 39, 20), RGB(255, 0, 0));
  EXPECT_EQ(PixelOf(child(60, 30), 41, 20), GREEN);
  EXPECT_EQ(PixelOf(child(15, 85), 5, 5), GREEN) << "a missing picture leaves the ground";
  EXPECT_EQ(PixelOf(child(11, 121), 3, 1), RGB(204, 204, 204)) << "only CUSTOM ones leave a colour out";
  bOsDeleteFile(csFile.Text());
}
