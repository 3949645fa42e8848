// Small things that a person at the screen would miss: a double click turns one page, a bare box shows the keyboard,
// toolbars work without a mouse, modal dialogs of a modeless wizard.
#include "Page.h"
#include "foundation/os/Os.h"

using Events = std::vector<std::string>;

namespace {

POINT MiddleOf(HWND hWnd) {
  const RECT area = AreaOf(hWnd);
  return {(area.left + area.right) / 2, (area.top + area.bottom) / 2};
}

// Clicks as the mouse itself would tell them, all in one: whatever lies there when its turn comes takes each.
struct RealClick {
  POINT at;
  DWORD uTime;
};
void SendClicks(const std::vector<RealClick>& clicks) {
  // Whatever the person, or the one who prepared the machine, has chosen.
  SetDoubleClickTime(500);
  std::vector<INPUT> inputs;
  const LONG lWidth = GetSystemMetrics(SM_CXSCREEN), lHeight = GetSystemMetrics(SM_CYSCREEN);
  for (const RealClick& click : clicks)
    for (const DWORD dwFlag : {MOUSEEVENTF_LEFTDOWN, MOUSEEVENTF_LEFTUP}) {
      INPUT input = {};
      input.type = INPUT_MOUSE;
      input.mi = {(click.at.x * 65536 + lWidth - 1) / lWidth,
                  (click.at.y * 65536 + lHeight - 1) / lHeight,
                  0,
                  dwFlag | MOUSEEVENTF_MOVE | MOUSEEVENTF_ABSOLUTE,
                  click.uTime,
                  0};
      inputs.push_back(input);
    }
  SendInput(static_cast<UINT>(inputs.size()), inputs.data(), sizeof(INPUT));
}

void CALLBACK TooLong(HWND, UINT, UINT_PTR, DWORD) { PostQuitMessage(1); }

// Runs the view's loop until the event comes, half a minute at most.
void RunUntil(Screen& screen, const std::string& last) {
  const auto before = screen.wizard.onEvent;
  screen.wizard.onEvent = [&](const std::string& event) {
    if (before) before(event);
    if (event == last) PostQuitMessage(0);
  };
  const UINT_PTR uBound = SetTimer(nullptr, 0, 30000, TooLong);
  screen.view->iRun();
  KillTimer(nullptr, uBound);
  MSG message;
  while (PeekMessageW(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE)) {
  }
  screen.wizard.onEvent = before;
}

std::vector<COLORREF> PixelsOf(HWND hWnd) {
  RECT client;
  GetClientRect(hWnd, &client);
  std::vector<COLORREF> pixels;
  for (int y = 0; y < client.bottom; y++)
    for (int x = 0; x < client.right; x++) pixels.push_back(PixelOf(hWnd, x, y));
  return pixels;
}

void Press(Screen& screen, WPARAM wKey, bool bShift = false) {
  BYTE keys[256] = {};
  if (bShift) keys[VK_SHIFT] = 0x80;
  SetKeyboardState(keys);
  screen.Key(wKey);
  screen.RunQueued();
  keys[VK_SHIFT] = 0;
  SetKeyboardState(keys);
}

// The variable name of what has the keyboard; of a combo box in a bar its item's.
std::string FocusName(const Page& page) {
  const int iID = GetDlgCtrlID(GetFocus());
  for (int i = 0; i < page.info.m_Controls.Size(); i++) {
    const BaseControl& control = *page.info.m_Controls[i];
    const CNItem* pItem = control.pItemControl() ? control.pItemControl()->pFindItem(iID) : nullptr;
    if (control.m_iID == iID) return control.m_csName.Text();
    if (pItem) return pItem->m_csName.Text();
  }
  return "?";
}

// The names that the Tab key leads to, one after the other.
std::string Walk(Screen& screen, const Page& page, int nSteps, bool bBack) {
  std::string names;
  for (int i = 0; i < nSteps; i++) {
    Press(screen, VK_TAB, bBack);
    names += FocusName(page) + " ";
  }
  return names;
}

}  // namespace

TEST(KeyboardAndMouse, ADoubleClickTurnsOnePageAndLosesNoOtherPress) {
  Screen screen;
  const char szControls[] =
      "BUTTON 'next' \"Next >\" ID_NEXT 20 20 75 23, FOCUS\nBUTTON 'done' \"Done\" 150 20 75 23\n";
  Page pages[] = {{DialogKind::DialogSys, "100 100 300 200", szControls},
                  {DialogKind::DialogSys, "100 100 300 200, INHERIT_POSITION", szControls},
                  {DialogKind::DialogSys, "100 100 300 200, INHERIT_POSITION", szControls},
                  {DialogKind::DialogSys, "100 100 300 200, INHERIT_POSITION", szControls}};
  int iPage = 0;
  screen.wizard.onEvent = [&](const std::string& event) {
    if (event == "command 101" && iPage < 3) screen.Show(pages[++iPage]);
  };
  screen.Show(pages[0]);
  const POINT next = MiddleOf(screen.hChild(L"Next >")), done = MiddleOf(screen.hChild(L"Done"));
  const POINT shaken = {next.x + 1, next.y - 1};
  const DWORD uNow = GetTickCount();
  // The second press belongs to the first. The third is one by itself, and so is one elsewhere.
  SendClicks({{next, uNow}, {shaken, uNow + 90}, {next, uNow + 180}, {done, uNow + 200}});
  RunUntil(screen, "done 0");
  EXPECT_EQ(screen.TakeEvents(), (Events{"command 101", "command 101", "done 0"}));
  EXPECT_EQ(iPage, 2);
  // Two presses that are no double click; keys are not waited for.
  SendClicks({{next, uNow + 10000}, {done, uNow + 20000}});
  RunUntil(screen, "done 0");
  SendClicks({{next, uNow + 30000}, {next, uNow + 30100}, {done, uNow + 30200}});  // the page stays
  RunUntil(screen, "done 0");
  Press(screen, VK_RETURN);
  EXPECT_EQ(screen.TakeEvents(), (Events{"command 101", "done 0", "command 101", "command 101", "done 0", "done 0"}));
}

TEST(KeyboardAndMouse, ADoubleClickDoesNotAnswerTheWizardWithinTheWizard) {
  Screen screen;
  Page page(DialogKind::DialogSys, "100 100 300 200", "BUTTON 'go' \"Go\" 20 20 75 23\n");
  Page question(DialogKind::DialogSys, "100 100 300 200",
                "BUTTON 'no' \"No\" 20 20 75 23\nBUTTON 'done' \"Done\" 150 20 75 23\n");
  screen.Show(page);
  Events asked;
  screen.wizard.onEvent = [&](const std::string&) {
    Screen inner(screen.view.get());
    inner.Show(question);
    const POINT done = MiddleOf(inner.hChild(L"Done"));
    SendClicks({{done, GetTickCount() + 20000}});
    RunUntil(inner, "done 0");
    asked = inner.TakeEvents();
  };
  const POINT go = MiddleOf(screen.hChild(L"Go"));
  SendClicks({{go, GetTickCount()}, {go, GetTickCount() + 90}});
  RunUntil(screen, "go 0");
  EXPECT_EQ(asked, Events{"done 0"});
}

TEST(KeyboardAndMouse, ABoxWithoutWordsShowsTheKeyboard) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200",
            "CHECK_BOX 'wide' 10 10 60 24\nCHECK_BOX 'bare' 10 50 13 13\nCHECK_BOX 'radio' 10 80 20 20, RADIO_BUTTON\n"
            "BUTTON 'b' \"B\" 10 120 75 23, FOCUS\n");
  screen.Show(page);
  for (const char* szName : {"wide", "bare", "radio"}) {
    const HWND hBox = GetDlgItem(screen.hWindow(), page[szName].m_iID);
    const auto before = PixelsOf(hBox);
    SetFocus(hBox);
    EXPECT_NE(PixelsOf(hBox), before) << szName;
    SendMessageW(hBox, BM_SETCHECK, BST_CHECKED, 0);
    const auto marked = PixelsOf(hBox);
    SetFocus(screen.hChild(L"B"));
    EXPECT_NE(PixelsOf(hBox), marked) << szName << ": also when its state changes";
    SendMessageW(hBox, BM_SETCHECK, BST_UNCHECKED, 0);
    EXPECT_EQ(PixelsOf(hBox), before) << szName;
  }
}

TEST(KeyboardAndMouse, AToolbarIsAStopOfTheTabKeyAndItsButtonsArePressedByKeys) {
  Screen screen;
  Page page(
      DialogKind::DialogSys, "20 20 500 200",
      "TOOLBAR 'bar' 0 0 400 0\nITEM 'one' \"One\"\nITEM 'off' \"Off\", DISABLE\nSEPARATOR\nITEM 'tick' \"Tick\", "
      "VAR(v)\nCOMBO 'size' \"8\" \"10\" 60\nCOMBO 'dead' \"8\" 60, DISABLE\nCOMBO 'face' \"A\" \"B\" 60\n"
      "END_TOOLBAR\nBUTTON 'a' \"A\" 10 60 75 23, DEFAULT\nBUTTON 'z' \"Z\" 100 60 75 23\n");
  screen.Show(page);
  EXPECT_EQ(FocusName(page), "a") << "not at once";
  EXPECT_EQ(Walk(screen, page, 6, false), "z bar size face a z ");
  EXPECT_EQ(Walk(screen, page, 6, true), "a face size bar z a ");
  const HWND hBar = screen.hChildOfClass(TOOLBARCLASSNAMEW);
  const CNItemControl& bar = *page["bar"].pItemControl();
  SetFocus(hBar);
  std::string chosen;
  for (const WPARAM wKey : {VK_RIGHT, VK_RIGHT, VK_LEFT, VK_UP, VK_HOME, VK_END}) {
    Press(screen, wKey);
    chosen += std::to_string(SendMessageW(hBar, TB_GETHOTITEM, 0, 0));
  }
  EXPECT_EQ(chosen, "303003") << "those that cannot be pressed are passed over";
  Press(screen, VK_RETURN);
  PostMessageW(hBar, WM_KEYDOWN, VK_RETURN, 0x40000001);  // held
  Press(screen, VK_HOME);
  Press(screen, VK_SPACE);
  bool bTicked = false;
  EXPECT_TRUE(screen.view->bIsItemChecked(bar, 3, bTicked) && bTicked);
  EXPECT_EQ(screen.TakeEvents(), (Events{"item tick ()", "item one ()"})) << "and the default button is not pressed";
  Page other(DialogKind::DialogSys, "20 20 500 200, INHERIT_POSITION",
             "BUTTON 'b' \"B\" 10 60 75 23\nREBAR 'bands' 0 0 0 0\nTOOLBAR 't' \"Bar\" 200 0\nITEM 'go' \"Go\"\n"
             "END_TOOLBAR\nEND_REBAR\n");
  screen.wizard.onEvent = [&](const std::string&) { screen.Show(other); };
  Press(screen, VK_SPACE);  // leads to another page from within
  screen.wizard.onEvent = nullptr;
  EXPECT_EQ(Walk(screen, other, 3, false), "t b t ");
  Press(screen, VK_RETURN);
  EXPECT_EQ(screen.TakeEvents(), (Events{"item one ()", "item go ()"}));
  SetFocus(screen.hChild(L"B"));
  EXPECT_EQ(SendMessageW(screen.hChildOfClass(TOOLBARCLASSNAMEW), TB_GETHOTITEM, 0, 0), -1);
}

TEST(KeyboardAndMouse, AModalDialogOfAModelessWizardHoldsItsOwnerWhileItIsShown) {
  Screen owner;
  Page below(DialogKind::DialogSys, "0 0 300 200", "EDIT_FIELD 'e' 1 1 50 20\n");
  Page free(DialogKind::Popup, "50 50 200 100, MODELESS", "BUTTON 'a' \"A\" 1 1 75 23\n");
  Page modal(DialogKind::Popup, "50 50 200 100, MODAL", "BUTTON 'm' \"M\" 1 1 75 23\n");
  owner.Show(below);
  Screen inner(&*owner.view, nullptr, Screen::Layout::NotSaid, true);
  const struct {
    Page& page;
    bool bOwnerEnabled;
  } STEPS[] = {{free, true}, {modal, false}, {modal, false}, {free, true}, {modal, false}};
  for (const auto& step : STEPS) {
    inner.Show(step.page);
    EXPECT_EQ(IsWindowEnabled(owner.hWindow()) != 0, step.bOwnerEnabled) << &step - STEPS;
    EXPECT_EQ(GetActiveWindow(), inner.hWindow());
  }
  inner.view->CloseWindow();
  EXPECT_TRUE(IsWindowEnabled(owner.hWindow()));
  EXPECT_EQ(GetActiveWindow(), owner.hWindow());
  EXPECT_EQ(GetFocus(), owner.hChildOfClass(L"EDIT"));
}
