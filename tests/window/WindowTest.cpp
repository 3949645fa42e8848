// The wizard's window: its styles and place, page changes, commands from other threads, owned wizards.
#include <algorithm>
#include <atomic>
#include <thread>

#include "Page.h"
#include "foundation/ResultCodes.h"

using Events = std::vector<std::string>;

TEST(Window, TheKindAndTheFlagsMakeTheStyle) {
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

TEST(Window, ShowsTheFormerPageUntilTheNextOneIsReady) {
  Screen screen;
  Page first(DialogKind::DialogSys, "0 0 300 200",
             "TEXT_FIELD 'a' \"one\" 1 1 50 15\nEDIT_FIELD 'e' \"\" 1 20 50 20\nBUTTON 'b' \"B\" 1 50 50 20\n");
  Page second(DialogKind::DialogSys, "0 0 300 200", "TEXT_FIELD 'a' \"two\" 1 1 50 15\n");
  screen.view->SetCaption("Prva stranica: greška");
  screen.Show(first);
  ASSERT_TRUE(screen.view->bCreateDialog(second.info));
  screen.view->SetCaption("2");
  EXPECT_TRUE(IsWindowVisible(screen.hChild(L"one")));
  EXPECT_FALSE(IsWindowVisible(screen.hChild(L"two")));
  EXPECT_EQ(TextOf(screen.hWindow()), L"Prva stranica: greška");
  EXPECT_FALSE(screen.view->bSetText(first["a"], "late")) << "the former page takes nothing any more";
  EXPECT_TRUE(screen.view->bSetText(second["a"], "filled"));
  SendMessageW(screen.hChild(L"B"), BM_CLICK, 0, 0);
  screen.view->ShowDialog();
  EXPECT_EQ(screen.TakeEvents(), Events{"e 256"}) << "a page that goes says nothing more";
  EXPECT_EQ(screen.hChild(L"one"), nullptr);
  EXPECT_TRUE(IsWindowVisible(screen.hChild(L"filled")));
  EXPECT_EQ(TextOf(screen.hWindow()), L"2");
}

TEST(Window, TellsOfCommandsEscapeAndTheCloseBox) {
  ShownPage screen("EDIT_FIELD 'e' \"\" 1 1 50 20\n", "0 0 300 200");
  screen.RunQueued();
  screen.TakeEvents();
  screen.view->PostCommand(ID_SHOW_DIALOG);
  PostMessageW(screen.hWindow(), WM_CLOSE, 0, 0);
  screen.Key(VK_ESCAPE);
  screen.Key(VK_RETURN);  // no button to press
  screen.RunQueued();
  EXPECT_EQ(screen.TakeEvents(), (Events{"command 105", "close", "command 2", "command 1"}));
  EXPECT_TRUE(screen.view->bHasWindow()) << "only the wizard closes the window";
}

TEST(Window, KeyboardReturnsToItsControlWithTheActivation) {
  Screen screen, other;
  Page page(DialogKind::DialogSys, "0 0 300 200", "BUTTON 'a' \"A\" 1 1 50 20, FOCUS\nBUTTON 'b' \"B\" 1 30 50 20\n");
  Page elsewhere(DialogKind::DialogSys, "0 0 300 200", "EDIT_FIELD 'e' \"\" 1 1 50 20\n");
  screen.Show(page);
  SetFocus(screen.hChild(L"B"));
  other.Show(elsewhere);
  EXPECT_EQ(GetFocus(), other.hChildOfClass(L"EDIT"));
  SetActiveWindow(screen.hWindow());
  EXPECT_EQ(GetFocus(), screen.hChild(L"B"));
}

// A worker drives the page that is being replaced under its hands.
TEST(Window, WorkersMayUseTheViewWhilePagesChange) {
  Screen screen;
  const char* const szControls = "PROGRESS_BAR 'p' 1 1 90 20\nTEXT_FIELD 't' \"\" 1 30 90 15\n";
  Page pages[] = {{DialogKind::DialogSys, "0 0 300 200", szControls},
                  {DialogKind::DialogSys, "0 0 300 200", szControls}};
  int iChanges = 0;
  intptr_t lPosition = 0;
  std::string text;
  screen.wizard.onEvent = [&](const std::string& event) {
    if (event == "command 105") screen.Show(pages[++iChanges % 2]);
    if (event != "command 104") return;
    const Page& shown = pages[iChanges % 2];  // the one before it may still be there, hidden
    lPosition = screen.view->lSendMessage(shown["p"], PBM_GETPOS, 0, 0);
    text = screen.Value(shown["t"]);
    screen.view->CloseWindow();
  };
  screen.Show(pages[0]);
  std::thread worker([&] {
    for (int i = 1; i <= 103; i++) {
      for (Page& page : pages) {
        screen.view->bSetProgress(page["p"], std::min(i, 100));
        screen.view->bSetText(page["t"], ("žuto & plavo " + std::to_string(i)).c_str());
        screen.view->bShow(page["t"], i % 2 == 0);
      }
      if (i % 10 == 0) screen.view->SendCommand(ID_SHOW_DIALOG);
    }
    screen.view->PostCommand(ID_EXIT);
  });
  screen.view->iRun();
  worker.join();
  EXPECT_EQ(iChanges, 10);
  EXPECT_EQ(lPosition, 100);
  EXPECT_EQ(text, "žuto & plavo 103");
}

// A sent command is handled inside the loop's waiting for messages: the loop must notice that the window is gone.
TEST(Window, AWorkersSentCommandMayEndTheRun) {
  ShownPage screen("", "0 0 300 200");
  screen.RunQueued();  // so that the loop finds nothing else to do
  screen.wizard.onEvent = [&](const std::string&) { screen.view->CloseWindow(); };
  std::atomic<bool> bReturned{false};
  bool bForced = false;
  std::thread worker([&, dwThread = GetCurrentThreadId()] {
    screen.view->SendCommand(ID_EXIT);
    bForced = !bWaitFor([&] { return bReturned.load(); });
    if (bForced) PostThreadMessageW(dwThread, WM_QUIT, 1, 0);
  });
  screen.view->iRun();
  bReturned = true;
  worker.join();
  MSG message;  // the force is not to end the tests that follow
  while (PeekMessageW(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE)) {
  }
  EXPECT_FALSE(bForced) << "the run had to be ended by force";
}

TEST(Window, AskedToCloseOnlyWhileNothingElseIsAsked) {
  ShownPage screen("", "0 0 300 200");
  EnableWindow(screen.hWindow(), FALSE);  // as a message box does
  SendMessageW(screen.hWindow(), WM_CLOSE, 0, 0);
  EXPECT_EQ(screen.TakeEvents(), Events{});
  EnableWindow(screen.hWindow(), TRUE);
  SendMessageW(screen.hWindow(), WM_CLOSE, 0, 0);
  EXPECT_EQ(screen.TakeEvents(), Events{"close"});
}

TEST(Window, ThePlaceOfAnIconIsNotInherited) {
  Screen screen;
  Page first(DialogKind::Window, "50 60 300 200", "");
  Page second(DialogKind::Window, "0 0 400 150, INHERIT_POSITION", "");
  screen.Show(first);
  ShowWindow(screen.hWindow(), SW_MINIMIZE);
  screen.Show(second);
  EXPECT_EQ(PlaceText(AreaOf(screen.hWindow())), "50 60 400 150");
  EXPECT_FALSE(IsIconic(screen.hWindow()));
}

// The focus event of the first field ends the wizard in the middle of its showing.
TEST(Window, MayBeClosedWhileADialogIsBeingShown) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "EDIT_FIELD 'e' \"\" 1 1 50 20\n");
  screen.wizard.onEvent = [&](const std::string&) { screen.view->CloseWindow(); };
  screen.Show(page);
  EXPECT_EQ(screen.TakeEvents(), Events{"e 256"});
  EXPECT_FALSE(screen.view->bHasWindow());
  EXPECT_FALSE(screen.view->bSetText(page["e"], "x"));
}

TEST(Window, OwnedWizardDisablesItsOwnerAndGivesTheKeyboardBack) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "EDIT_FIELD 'e' \"\" 1 1 50 20\nBUTTON 'b' \"Quit\" 1 40 50 20\n");
  Page question(DialogKind::Dialog, "50 50 200 100", "BUTTON 'yes' \"Yes\" ID_CANCEL 1 1 50 20, DEFAULT, FOCUS\n");
  screen.Show(page);
  bool bOwnerEnabled = true;
  HWND hOwner = nullptr;
  screen.wizard.onEvent = [&](const std::string& event) {
    if (event != "b 0") return;
    Screen inner(screen.view.get());
    inner.Show(question);
    bOwnerEnabled = IsWindowEnabled(screen.hWindow());
    hOwner = GetWindow(inner.hWindow(), GW_OWNER);
    inner.wizard.onEvent = [&](const std::string&) { inner.view->CloseWindow(); };
    inner.Key(VK_RETURN);
    inner.view->iRun();
    EXPECT_EQ(inner.TakeEvents(), Events{"command 103"});
  };
  SetFocus(screen.hChildOfClass(L"EDIT"));
  PostMessageW(screen.hChild(L"Quit"), BM_CLICK, 0, 0);
  screen.RunQueued();
  EXPECT_FALSE(bOwnerEnabled);
  EXPECT_EQ(hOwner, screen.hWindow());
  EXPECT_TRUE(IsWindowEnabled(screen.hWindow()));
  EXPECT_EQ(GetActiveWindow(), screen.hWindow());
  EXPECT_EQ(GetFocus(), screen.hChild(L"Quit"));
}

TEST(Window, AModelessWizardLeavesItsOwnerUsableAndBothGoOn) {
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
