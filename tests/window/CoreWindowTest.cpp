// What the wizard's window does as a whole: screen scale, keyboard, labels, tooltips, the system's boxes, the end of
// the session.
#include <oleacc.h>

#include <thread>

#include "../support/TestFolder.h"
#include "Page.h"
#include "controls/ScriptText.h"
#include "window/ScreenScale.h"

using Events = std::vector<std::string>;

namespace {

std::string Scaled(std::initializer_list<int> numbers, double dScale) {
  std::string text;
  for (const int iNumber : numbers) text += " " + std::to_string(ScriptText::iScaleSize(iNumber, dScale));
  return text.substr(1);
}

}  // namespace

// Run at 96, 120, 144 and 192 dots per inch (LogPixels of HKCU\Control Panel\Desktop).
TEST(Scale, EitherTheScriptOrTheSystemEnlarges) {
  double dReal;
  {
    ScaleScope scope(ScreenScaling::ByScript);
    dReal = dScreenScale();
  }
  for (const bool bPixels : {true, false}) {
    Screen screen(nullptr, nullptr, bPixels ? Screen::Layout::Pixels : Screen::Layout::Scaled);
    const double dScale = screen.view->dScale();
    ASSERT_NEAR(dScale, bPixels ? 1.0 : dReal, 0.001);
    Page page(DialogKind::Window, bPixels ? "12 20 300 200, NO_LOGPIXELS" : "12 20 300 200",
              "BUTTON 'b' \"Button\" 10 10 75 23\nCHECK_BOX 'c' \"fixed\" 10 50 75 23, NO_LOGPIXELS\n", dScale);
    screen.Show(page);
    {
      ScaleScope scope(bPixels ? ScreenScaling::BySystem : ScreenScaling::ByScript);
      EXPECT_EQ(PlaceText(AreaOf(screen.hWindow())), Scaled({12, 20, 300, 200}, dScale)) << dReal << bPixels;
      EXPECT_EQ(PlaceText(AreaOf(screen.hChild(L"Button"), screen.hWindow())), Scaled({10, 10, 75, 23}, dScale));
      EXPECT_EQ(PlaceText(AreaOf(screen.hChild(L"fixed"), screen.hWindow())), "10 50 75 23");
    }
    if (bPixels) {  // to eyes that see every pixel, the system has made it larger
      ScaleScope scope(ScreenScaling::ByScript);
      const RECT button = AreaOf(screen.hChild(L"Button"), screen.hWindow());
      EXPECT_NEAR(button.right - button.left, 75 * dReal, 1.0);
      EXPECT_NEAR(button.bottom - button.top, 23 * dReal, 1.0);
    }
    LOGFONTW font;
    GetObjectW(reinterpret_cast<HFONT>(SendMessageW(screen.hChild(L"Button"), WM_GETFONT, 0, 0)), sizeof(font), &font);
    EXPECT_EQ(font.lfHeight, static_cast<LONG>(15 * dScale));
  }
}

TEST(Keyboard, TabFollowsTheLinesAndAltFollowsTheLabels) {
  Screen screen;
  // The labels' lines stand in another order than the fields that they belong to.
  Page page(DialogKind::DialogSys, "0 0 400 300, NO_LOGPIXELS",
            "EDIT_FIELD 'name' 100 10 100 20\n"
            "TEXT_FIELD \"&Folder:\" 10 40 80 15\n"
            "TEXT_FIELD \"&Name:\" 10 10 80 15\n"
            "EDIT_FIELD 'folder' 100 40 100 20\n"
            "TEXT_FIELD \"Link\" 220 40 50 15, LINK ACTION: ()\n"
            "TEXT_FIELD \"&Remarks\" 10 70 80 15\n"
            "LIST_FIELD 'list' \"a\" 10 88 100 60\n"
            "BUTTON 'go' \"&Go\" 10 160 75 23\n");
  screen.Show(page);
  const auto focus = [&] { return PlaceName(screen, GetFocus()); };
  std::string order = focus();
  for (int i = 0; i < 5; i++) {
    screen.Press({VK_TAB});
    order += " " + focus();
  }
  EXPECT_EQ(order, "100,10 100,40 220,40 10,88 10,160 100,10");
  for (const auto& [cLetter, szField] :
       std::vector<std::pair<char, std::string>>{{'f', "100,40"}, {'n', "100,10"}, {'r', "10,88"}, {'g', "10,160"}}) {
    SetFocus(screen.hChildOfClass(L"EDIT"));
    PostMessageW(GetFocus(), WM_SYSCHAR, static_cast<WPARAM>(cLetter), 0x20000001);  // with Alt
    screen.RunQueued();
    EXPECT_EQ(focus(), szField) << cLetter;
  }
}

TEST(Keyboard, ArrowsAndTheChoiceStayWithinAGroupOfRadioButtons) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300",
            "GROUP\nCHECK_BOX 'a' \"A\" 1 1 75 15, RADIO_BUTTON\nCHECK_BOX 'b' \"B\" 1 20 75 15, RADIO_BUTTON\n"
            "CHECK_BOX 'c' \"C\" 1 40 75 15, RADIO_BUTTON\nEND_GROUP\n"
            "GROUP\nCHECK_BOX 'd' \"D\" 1 60 75 15, RADIO_BUTTON\nCHECK_BOX 'e' \"E\" 1 80 75 15, RADIO_BUTTON\n"
            "END_GROUP\nBUTTON 'x' \"X\" 1 100 75 23\n");
  ASSERT_TRUE(screen.view->bCreateDialog(page.info));
  screen.view->bSetText(page["b"], "1");
  screen.view->ShowDialog();
  const struct {
    WPARAM wKey;
    const wchar_t* szFocus;
  } rows[] = {{VK_DOWN, L"C"}, {VK_RIGHT, L"A"}, {VK_TAB, L"D"}, {VK_UP, L"E"}, {VK_TAB, L"X"}, {VK_TAB, L"A"}};
  EXPECT_EQ(TextOf(GetFocus()), L"B") << "the chosen one";
  for (const auto& row : rows) {
    screen.Press({row.wKey});
    EXPECT_EQ(TextOf(GetFocus()), row.szFocus);
  }
  EXPECT_EQ(screen.TakeEvents(), (Events{"c 0", "a 0", "e 0"}));
  SendMessageW(screen.hChild(L"B"), BM_CLICK, 0, 0);
  std::string states;
  for (const char* szName : {"a", "b", "c", "d", "e"}) states += screen.Value(page[szName]);
  EXPECT_EQ(states, "01001");
}

// What a screen reader says of each field: the label beside or above it, wherever its line stands.
TEST(Accessibility, TheNameOfAFieldIsItsLabel) {
  using FromWindow = HRESULT(WINAPI*)(HWND, DWORD, REFIID, void**);
  const IID accessible = {0x618736e0, 0x3c3d, 0x11cf, {0x81, 0x0c, 0x00, 0xaa, 0x00, 0x38, 0x9b, 0x71}};
  const HMODULE hLibrary = LoadLibraryW(L"oleacc.dll");
  const auto pFromWindow =
      reinterpret_cast<FromWindow>(reinterpret_cast<void*>(GetProcAddress(hLibrary, "AccessibleObjectFromWindow")));
  ASSERT_NE(pFromWindow, nullptr);
  CoInitialize(nullptr);
  ShownPage screen(
      "TEXT_FIELD \"Folder:\" 10 40 80 15\n"
      "EDIT_FIELD 'name' 100 10 100 20\n"
      "EDIT_FIELD 'folder' 100 40 100 20\n"
      "TEXT_FIELD \"Name:\" 10 10 80 15\n"
      "EDIT_FIELD 'lines' 10 90 100 50, MULTILINE\n"
      "TEXT_FIELD \"Remarks\" 10 72 80 15\n"
      "EDIT_FIELD 'lonely' 10 200 100 20\n");
  const struct {
    int x, y;
    const wchar_t* szName;
  } ROWS[] = {{100, 10, L"Name:"}, {100, 40, L"Folder:"}, {10, 90, L"Remarks"}};
  for (const auto& row : ROWS) {
    const HWND hField = ChildWindowFromPoint(screen.hWindow(), {row.x + 2, row.y + 2});
    EXPECT_EQ(TextOf(GetWindow(hField, GW_HWNDPREV)), row.szName);
    IAccessible* pObject = nullptr;
    ASSERT_EQ(pFromWindow(hField, static_cast<DWORD>(OBJID_CLIENT), accessible, reinterpret_cast<void**>(&pObject)),
              S_OK);
    VARIANT self = {};
    self.vt = VT_I4;
    BSTR name = nullptr;
    pObject->get_accName(self, &name);
    EXPECT_STREQ(name ? name : L"", row.szName);
    SysFreeString(name);
    pObject->Release();
  }
  CoUninitialize();
}

namespace {

HWND hTipsOf(const Screen& screen) {
  HWND hWnd = nullptr;
  while ((hWnd = FindWindowExW(nullptr, hWnd, TOOLTIPS_CLASSW, nullptr)) &&
         GetWindow(hWnd, GW_OWNER) != screen.hWindow())
    ;
  return hWnd;
}

}  // namespace

TEST(ToolTips, WaitAsLongAsTheDialogSays) {
  ShownPage screen("BUTTON 'b' \"B\" TOOLTIP 'Tip' 1 1 75 23\n", "0 0 400 300, TOOLTIP_TIME(1234)");
  ASSERT_NE(hTipsOf(screen), nullptr);
  EXPECT_EQ(SendMessageW(hTipsOf(screen), TTM_GETDELAYTIME, TTDT_INITIAL, 0), 1234);
  EXPECT_EQ(SendMessageW(hTipsOf(screen), TTM_GETTOOLCOUNT, 0, 0), 1);
}

// Both get procedures of the wizard, which must not stand in the tooltip's way.
TEST(ToolTips, ShowOverABoxThatTakesItsNameFromAText) {
  ShownPage screen("CHECK_BOX 'b' TOOLTIP 'Tip' 10 10 14 14\nTEXT_FIELD 't' \"Words\" TOOLTIP 'Tip' 30 10 75 14\n",
                   "100 100 400 300, TOOLTIP_TIME(1)");
  for (const char* szName : {"b", "t"}) {
    const HWND hControl = screen.hOf(szName), hTips = hTipsOf(screen);
    POINT at = {5, 5};
    ClientToScreen(hControl, &at);
    int iWaits = 0;
    EXPECT_TRUE(bWaitFor([&] {
      if (iWaits++ % 100 == 0) {
        SetCursorPos(at.x, at.y);
        SendMessageW(hControl, WM_MOUSEMOVE, 0, MAKELPARAM(5 + iWaits / 100 % 2, 5));
      }
      return IsWindowVisible(hTips);
    })) << szName;
    SendMessageW(hTips, TTM_POP, 0, 0);
  }
}

// Who is asked and told is in EndSessionTest.cpp.
TEST(Session, ItsEndMayCloseTheWindow) {
  ShownPage screen("", "0 0 300 200");
  screen.wizard.onEvent = [&](const std::string&) { screen.view->CloseWindow(); };
  SendMessageW(screen.hWindow(), WM_ENDSESSION, TRUE, 0);
  EXPECT_EQ(screen.TakeEvents(), Events{"end session"});
  EXPECT_FALSE(screen.view->bHasWindow());
}

// The threads answer the boxes that come.
TEST(SystemDialogs, ChoosersReturnTheChoiceOrLeaveTheText) {
  ShownPage screen("", "0 0 300 200");
  TestFolder folder;
  folder.Write("choice.txt", "x");
  const std::string path = folder.Path("choice.txt");
  const std::wstring widePath(path.begin(), path.end());
  CNString csChoice;
  csChoice = "";
  bool bOwnerDisabled = false;
  std::thread person([&] {
    const HWND hBox = hWaitForDialog(L"Pick one");
    const int FILE_NAME_COMBO = 0x47C, FILE_NAME = 0x480;
    HWND hName = nullptr;
    bWaitFor([&] { return (hName = GetDlgItem(hBox, FILE_NAME_COMBO)) || (hName = GetDlgItem(hBox, FILE_NAME)); });
    // The chooser fills its field in when it likes.
    bWaitFor([&] {
      SendMessageW(hName, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(widePath.c_str()));
      return TextOf(hName) == widePath;
    });
    bOwnerDisabled = !IsWindowEnabled(GetWindow(hBox, GW_OWNER));
    PostMessageW(hBox, WM_COMMAND, IDOK, 0);
  });
  EXPECT_TRUE(screen.view->bChooseFile("Pick one", csChoice));
  person.join();
  EXPECT_STREQ(csChoice.Text(), path.c_str());
  EXPECT_TRUE(bOwnerDisabled);
  std::thread refusal([] { PostMessageW(hWaitForDialog(L"Pick again"), WM_COMMAND, IDCANCEL, 0); });
  EXPECT_FALSE(screen.view->bChooseFile("Pick again", csChoice));
  refusal.join();
  EXPECT_STREQ(csChoice.Text(), path.c_str());
  EXPECT_TRUE(IsWindowEnabled(screen.hWindow()));
}

TEST(SystemDialogs, EveryKindOfMessageBoxHasItsTextItsButtonsAndItsIcon) {
  ShownPage screen("", "0 0 300 200");
  const struct {
    MessageButtons buttons;
    MessageIcon icon;
    const char* szButtons;
    int iAnswer;
    bool bOwned = false;
  } ROWS[] = {
      {MessageButtons::Ok, MessageIcon::None, "1 ", ANSWER_OK},
      {MessageButtons::OkCancel, MessageIcon::Error, "1 2 ", ANSWER_CANCEL},
      {MessageButtons::AbortRetryIgnore, MessageIcon::Question, "3 4 5 ", ANSWER_IGNORE},
      {MessageButtons::YesNoCancel, MessageIcon::Exclamation, "2 6 7 ", ANSWER_NO},
      {MessageButtons::YesNo, MessageIcon::Information, "6 7 ", ANSWER_YES, true},
      {MessageButtons::RetryCancel, MessageIcon::None, "2 4 ", ANSWER_RETRY},
      {MessageButtons::CancelTryContinue, MessageIcon::Error, "2 10 11 ", ANSWER_CONTINUE},
  };
  for (const auto& row : ROWS) {
    std::string buttons;
    bool bIcon = false;
    std::wstring text;
    HWND hOwner = nullptr;
    std::thread person([&] {
      const HWND hBox = hWaitForDialog(L"Greška!");
      for (int iID = 1; iID <= 11; iID++)
        if (IsWindowVisible(GetDlgItem(hBox, iID))) buttons += std::to_string(iID) + " ";
      bIcon = SendMessageW(GetDlgItem(hBox, 1088), STM_GETICON, 0, 0) != 0;
      text = TextOf(GetDlgItem(hBox, 0xFFFF));
      hOwner = GetWindow(hBox, GW_OWNER);
      PostMessageW(hBox, WM_COMMAND, static_cast<WPARAM>(row.iAnswer), 0);
    });
    EXPECT_EQ(screen.view->iShowMessage({"Prva\ndruga š", "Greška!", row.icon, row.buttons, row.bOwned}), row.iAnswer);
    person.join();
    EXPECT_EQ(buttons, row.szButtons);
    EXPECT_EQ(bIcon, row.icon != MessageIcon::None);
    EXPECT_EQ(text, L"Prva\ndruga š");
    EXPECT_EQ(hOwner, row.bOwned ? screen.hWindow() : nullptr);
  }
}
