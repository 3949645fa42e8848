// What the wizard's window does as a whole: screen scale, keyboard, labels, tooltips, message boxes, the end of the
// session, wizards within each other.
#include <oleacc.h>

#include "../support/TestFolder.h"
#include "Page.h"
#include "controls/ScriptText.h"
#include "foundation/os/Os.h"
#include "window/ScreenScale.h"

using Events = std::vector<std::string>;

namespace {

std::string Numbers(const RECT& area) {
  return std::to_string(area.left) + " " + std::to_string(area.top) + " " + std::to_string(area.right - area.left) +
         " " + std::to_string(area.bottom - area.top);
}

std::string Scaled(std::initializer_list<int> numbers, double dScale) {
  std::string text;
  for (const int iNumber : numbers) text += " " + std::to_string(ScriptText::iScaleSize(iNumber, dScale));
  return text.substr(1);
}

}  // namespace

TEST(Header, TheKindAndTheFlagsMakeTheStyle) {
  const DWORD dwFrame = WS_CAPTION | WS_THICKFRAME | WS_SYSMENU | WS_MAXIMIZEBOX | WS_MINIMIZEBOX | WS_CHILD;
  const DWORD dwWindow = WS_OVERLAPPEDWINDOW;
  const struct {
    DialogKind kind;
    const char* szFlags;
    DWORD dwStyle, dwExStyle;
    bool bVisible;
  } ROWS[] = {
      {DialogKind::Window, "", dwWindow, 0, true},
      {DialogKind::Dialog, "", WS_CAPTION, 0, true},
      {DialogKind::DialogSys, "", WS_CAPTION | WS_SYSMENU, 0, true},
      {DialogKind::Popup, "", 0, 0, true},
      {DialogKind::Popup, "FLAT_BORDER", WS_BORDER, 0, true},
      {DialogKind::Flat, "", 0, 0, true},  // an inner window's style makes no frame of its own
      {DialogKind::FlatBorder, "", WS_BORDER, 0, true},
      {DialogKind::Float, "", dwWindow, WS_EX_TOOLWINDOW, true},
      {DialogKind::DialogSys, "FLOATING", WS_CAPTION | WS_SYSMENU, WS_EX_TOOLWINDOW, true},
      {DialogKind::DialogSys, "HIDE", WS_CAPTION | WS_SYSMENU, 0, false},
  };
  Screen screen;
  for (const auto& row : ROWS) {
    Page page(row.kind, (std::string("10 10 300 200, ") + row.szFlags).c_str(), "");
    screen.Show(page);
    const auto dwStyle = static_cast<DWORD>(GetWindowLongW(screen.hWindow(), GWL_STYLE));
    EXPECT_EQ(dwStyle & dwFrame, row.dwStyle) << static_cast<int>(row.kind) << row.szFlags;
    EXPECT_EQ(static_cast<DWORD>(GetWindowLongW(screen.hWindow(), GWL_EXSTYLE)) & WS_EX_TOOLWINDOW, row.dwExStyle);
    EXPECT_EQ(IsWindowVisible(screen.hWindow()) != FALSE, row.bVisible) << row.szFlags;
    EXPECT_TRUE(dwStyle & WS_CLIPCHILDREN);
  }
}

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
      EXPECT_EQ(Numbers(AreaOf(screen.hWindow())), Scaled({12, 20, 300, 200}, dScale)) << dReal << bPixels;
      EXPECT_EQ(Numbers(AreaOf(screen.hChild(L"Button"), screen.hWindow())), Scaled({10, 10, 75, 23}, dScale));
      EXPECT_EQ(Numbers(AreaOf(screen.hChild(L"fixed"), screen.hWindow())), "10 50 75 23");
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

namespace {

// Alt and a letter, as the keyboard sends it.
void Mnemonic(Screen& screen, char cLetter) {
  const HWND hFocus = GetFocus();
  PostMessageW(hFocus, WM_SYSCHAR, static_cast<WPARAM>(cLetter), 0x20000001);
  screen.RunQueued();
}

}  // namespace

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
    screen.Key(VK_TAB);
    screen.RunQueued();
    order += " " + focus();
  }
  EXPECT_EQ(order, "100,10 100,40 220,40 10,88 10,160 100,10");
  for (const auto& [cLetter, szField] :
       std::vector<std::pair<char, std::string>>{{'f', "100,40"}, {'n', "100,10"}, {'r', "10,88"}, {'g', "10,160"}}) {
    SetFocus(screen.hChildOfClass(L"EDIT"));
    Mnemonic(screen, cLetter);
    EXPECT_EQ(focus(), szField) << cLetter;
  }
}

TEST(Keyboard, ArrowsStayWithinAGroupOfRadioButtons) {
  Screen screen;
  Page page(
      DialogKind::DialogSys, "0 0 400 300",
      "GROUP\nCHECK_BOX 'a' \"A\" 1 1 75 15, RADIO_BUTTON\nCHECK_BOX 'b' \"B\" 1 20 75 15, RADIO_BUTTON\nEND_GROUP\n"
      "GROUP\nCHECK_BOX 'c' \"C\" 1 40 75 15, RADIO_BUTTON\nCHECK_BOX 'd' \"D\" 1 60 75 15, RADIO_BUTTON\n"
      "END_GROUP\nBUTTON 'go' \"Go\" 1 90 75 23\n");
  screen.Show(page);
  SetFocus(screen.hChild(L"A"));
  std::string order;
  for (const WPARAM wKey : {VK_DOWN, VK_DOWN, VK_DOWN, VK_TAB, VK_UP}) {
    screen.Key(wKey);
    screen.RunQueued();
    order += PlaceName(screen, GetFocus()) + " ";
  }
  EXPECT_EQ(order, "1,20 1,1 1,20 1,40 1,60 ");
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
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300",
            "TEXT_FIELD \"Folder:\" 10 40 80 15\n"
            "EDIT_FIELD 'name' 100 10 100 20\n"
            "EDIT_FIELD 'folder' 100 40 100 20\n"
            "TEXT_FIELD \"Name:\" 10 10 80 15\n"
            "EDIT_FIELD 'lines' 10 90 100 50, MULTILINE\n"
            "TEXT_FIELD \"Remarks\" 10 72 80 15\n"
            "EDIT_FIELD 'lonely' 10 200 100 20\n");
  screen.Show(page);
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

TEST(ToolTips, WaitAsLongAsTheDialogSays) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 400 300, TOOLTIP_TIME(1234)", "BUTTON 'b' \"B\" TOOLTIP 'Tip' 1 1 75 23\n");
  screen.Show(page);
  HWND hTips = nullptr;
  for (HWND hWnd = nullptr; (hWnd = FindWindowExW(nullptr, hWnd, TOOLTIPS_CLASSW, nullptr));)
    if (GetWindow(hWnd, GW_OWNER) == screen.hWindow()) hTips = hWnd;
  ASSERT_NE(hTips, nullptr);
  EXPECT_EQ(SendMessageW(hTips, TTM_GETDELAYTIME, TTDT_INITIAL, 0), 1234);
  EXPECT_EQ(SendMessageW(hTips, TTM_GETTOOLCOUNT, 0, 0), 1);
}

// Both get procedures of the wizard, which must not stand in the tooltip's way.
TEST(ToolTips, ShowOverABoxThatTakesItsNameFromAText) {
  Screen screen;
  Page page(DialogKind::DialogSys, "100 100 400 300, TOOLTIP_TIME(1)",
            "CHECK_BOX 'b' TOOLTIP 'Tip' 10 10 14 14\nTEXT_FIELD 't' \"Words\" TOOLTIP 'Tip' 30 10 75 14\n");
  screen.Show(page);
  for (const char* szName : {"b", "t"}) {
    const HWND hControl = GetDlgItem(screen.hWindow(), page[szName].m_iID);
    HWND hTips = nullptr;
    for (HWND hWnd = nullptr; (hWnd = FindWindowExW(nullptr, hWnd, TOOLTIPS_CLASSW, nullptr));)
      if (GetWindow(hWnd, GW_OWNER) == screen.hWindow()) hTips = hWnd;
    POINT at = {5, 5};
    ClientToScreen(hControl, &at);
    SetCursorPos(at.x, at.y);
    MSG message;
    for (int i = 0; i < 300 && !IsWindowVisible(hTips); i++, Sleep(10)) {
      if (i % 50 == 0) SendMessageW(hControl, WM_MOUSEMOVE, 0, MAKELPARAM(5 + i / 50, 5));
      while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) DispatchMessageW(&message);
    }
    EXPECT_TRUE(IsWindowVisible(hTips)) << szName;
    SendMessageW(hTips, TTM_POP, 0, 0);
  }
}

TEST(Session, EndsTheWizardThatDoesNotHoldIt) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "");
  screen.wizard.onEvent = [&](const std::string&) { screen.view->CloseWindow(); };
  screen.Show(page);
  SendMessageW(screen.hWindow(), WM_ENDSESSION, FALSE, 0);  // somebody else refused
  screen.wizard.holdsQuit = true;
  SendMessageW(screen.hWindow(), WM_ENDSESSION, TRUE, 0);
  EXPECT_EQ(screen.TakeEvents(), Events{});
  screen.wizard.holdsQuit = false;
  SendMessageW(screen.hWindow(), WM_ENDSESSION, TRUE, 0);
  EXPECT_EQ(screen.TakeEvents(), Events{"end session"});
  EXPECT_FALSE(screen.view->bHasWindow());
}

namespace {

// Answers the chooser that comes: types a name into the file chooser, or presses a button.
struct Chooser {
  const wchar_t* szTitle;
  const wchar_t* szName;
  WPARAM wButton;
  bool bOwnerDisabled = false;

  static void Run(void* pContext) {
    auto& chooser = *static_cast<Chooser*>(pContext);
    HWND hBox = nullptr;
    for (int i = 0; i < 300 && !hBox; i++, OsSleep(10)) hBox = FindWindowW(L"#32770", chooser.szTitle);
    const int FILE_NAME_COMBO = 0x47C, FILE_NAME = 0x480;
    OsSleep(100);  // until it has filled itself in
    HWND hName = GetDlgItem(hBox, FILE_NAME_COMBO);
    if (!hName) hName = GetDlgItem(hBox, FILE_NAME);
    if (chooser.szName) SendMessageW(hName, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(chooser.szName));
    chooser.bOwnerDisabled = !IsWindowEnabled(GetWindow(hBox, GW_OWNER));
    PostMessageW(hBox, WM_COMMAND, chooser.wButton, 0);
  }
};

}  // namespace

TEST(SystemDialogs, ChoosersReturnTheChoiceOrLeaveTheText) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "");
  screen.Show(page);
  TestFolder folder;
  folder.Write("choice.txt", "x");
  const std::string path = folder.Path("choice.txt");
  const std::wstring widePath(path.begin(), path.end());
  CNString csChoice;
  csChoice = "";
  Chooser file = {L"Pick one", widePath.c_str(), IDOK};
  ASSERT_TRUE(bOsStartThread(Chooser::Run, &file));
  EXPECT_TRUE(screen.view->bChooseFile("Pick one", csChoice));
  EXPECT_STREQ(csChoice.Text(), path.c_str());
  EXPECT_TRUE(file.bOwnerDisabled);
  Chooser cancelled = {L"Pick again", nullptr, IDCANCEL};
  ASSERT_TRUE(bOsStartThread(Chooser::Run, &cancelled));
  EXPECT_FALSE(screen.view->bChooseFile("Pick again", csChoice));
  EXPECT_STREQ(csChoice.Text(), path.c_str());
  EXPECT_TRUE(IsWindowEnabled(screen.hWindow()));
}

TEST(Owned, AModelessWizardLeavesItsOwnerUsableAndBothGoOn) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "BUTTON 'b' \"Below\" 1 1 75 23\n");
  Page above(DialogKind::DialogSys, "50 50 200 100, MODELESS", "BUTTON 'a' \"Above\" 1 1 75 23\n");
  screen.Show(page);
  {
    Screen inner(screen.view.get(), nullptr, Screen::Layout::NotSaid, above.info.m_bModeless);
    inner.Show(above);
    EXPECT_TRUE(IsWindowEnabled(screen.hWindow()));
    PostMessageW(screen.hChild(L"Below"), BM_CLICK, 0, 0);
    PostMessageW(inner.hChild(L"Above"), BM_CLICK, 0, 0);
    inner.RunQueued();  // one loop serves both
    EXPECT_EQ(screen.TakeEvents(), Events{"b 0"});
    EXPECT_EQ(inner.TakeEvents(), Events{"a 0"});
    EXPECT_TRUE(screen.view->bSetText(page["b"], "Changed"));
    EXPECT_FALSE(screen.view->bSetText(above["a"], "x")) << "a control of another wizard";
  }
  EXPECT_TRUE(screen.view->bHasWindow());
  EXPECT_TRUE(IsWindowEnabled(screen.hWindow()));
}

namespace {

// Presses a button of the message box that comes, after having looked at all of them.
struct BoxReader {
  int iAnswer;
  std::string buttons;
  bool bIcon = false;

  static void Run(void* pContext) {
    auto& reader = *static_cast<BoxReader*>(pContext);
    HWND hBox = nullptr;
    for (int i = 0; i < 200 && !hBox; i++, OsSleep(10)) hBox = FindWindowW(L"#32770", L"Kinds of boxes");
    for (int iID = 1; iID <= 11; iID++) {
      const HWND hButton = GetDlgItem(hBox, iID);
      if (hButton && GetWindowLongW(hButton, GWL_STYLE) & WS_VISIBLE) reader.buttons += std::to_string(iID) + " ";
    }
    const HWND hIcon = GetDlgItem(hBox, 1088);
    reader.bIcon = SendMessageW(hIcon, STM_GETICON, 0, 0) != 0;
    PostMessageW(hBox, WM_COMMAND, static_cast<WPARAM>(reader.iAnswer), 0);
    for (int i = 0; i < 200 && IsWindow(hBox); i++) OsSleep(10);
  }
};

}  // namespace

TEST(SystemDialogs, EveryKindOfMessageBoxHasItsButtonsAndItsIcon) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "");
  screen.Show(page);
  const struct {
    MessageButtons buttons;
    MessageIcon icon;
    const char* szButtons;
    int iAnswer;
  } ROWS[] = {
      {MessageButtons::Ok, MessageIcon::None, "1 ", ANSWER_OK},
      {MessageButtons::OkCancel, MessageIcon::Error, "1 2 ", ANSWER_CANCEL},
      {MessageButtons::AbortRetryIgnore, MessageIcon::Question, "3 4 5 ", ANSWER_IGNORE},
      {MessageButtons::YesNoCancel, MessageIcon::Exclamation, "2 6 7 ", ANSWER_NO},
      {MessageButtons::YesNo, MessageIcon::Information, "6 7 ", ANSWER_YES},
      {MessageButtons::RetryCancel, MessageIcon::None, "2 4 ", ANSWER_RETRY},
      {MessageButtons::CancelTryContinue, MessageIcon::Error, "2 10 11 ", ANSWER_CONTINUE},
  };
  for (const auto& row : ROWS) {
    BoxReader reader = {row.iAnswer, ""};
    ASSERT_TRUE(bOsStartThread(BoxReader::Run, &reader));
    EXPECT_EQ(screen.view->iShowMessage({"Text", "Kinds of boxes", row.icon, row.buttons}), row.iAnswer);
    OsSleep(50);  // the thread's last look at the box
    EXPECT_EQ(reader.buttons, row.szButtons);
    EXPECT_EQ(reader.bIcon, row.icon != MessageIcon::None);
  }
}
