// The wizard's window: its styles and place, page changes, commands from other threads, owned wizards.
#include "Page.h"
#include "foundation/ResultCodes.h"
#include "foundation/os/Os.h"

using Events = std::vector<std::string>;

static bool bEqual(const RECT& a, const RECT& b) { return EqualRect(&a, &b); }

TEST(Window, TakesStyleSizeAndCaptionOfEachDialog) {
  Screen screen;
  Page first(DialogKind::DialogSys, "50 60 300 200, NO_LOGPIXELS", "");
  Page second(DialogKind::Dialog, "0 0 400 150, INHERIT_POSITION", "");
  first.info.m_dwStyle = STYLE_CAPTION | STYLE_SYSMENU | STYLE_VISIBLE;
  second.info.m_dwStyle = STYLE_CAPTION | STYLE_VISIBLE;
  screen.view->SetCaption("Prva stranica: greška");
  screen.Show(first);
  RECT place;
  GetWindowRect(screen.hWindow(), &place);
  EXPECT_TRUE(bEqual(place, {50, 60, 350, 260}));
  EXPECT_EQ(TextOf(screen.hWindow()), L"Prva stranica: greška");
  EXPECT_TRUE(GetWindowLongW(screen.hWindow(), GWL_STYLE) & WS_SYSMENU);
  EXPECT_TRUE(IsWindowVisible(screen.hWindow()));
  screen.Show(second);
  GetWindowRect(screen.hWindow(), &place);
  EXPECT_TRUE(bEqual(place, {50, 60, 450, 210}));
  EXPECT_FALSE(GetWindowLongW(screen.hWindow(), GWL_STYLE) & WS_SYSMENU);
}

TEST(Window, ShowsTheFormerPageUntilTheNextOneIsReady) {
  Screen screen;
  Page first(DialogKind::DialogSys, "0 0 300 200",
             "TEXT_FIELD 'a' \"one\" 1 1 50 15\nEDIT_FIELD 'e' \"\" 1 20 50 20\nBUTTON 'b' \"B\" 1 50 50 20\n");
  Page second(DialogKind::DialogSys, "0 0 300 200", "TEXT_FIELD 'a' \"two\" 1 1 50 15\n");
  screen.view->SetCaption("1");
  screen.Show(first);
  ASSERT_TRUE(screen.view->bCreateDialog(second.info));
  screen.view->SetCaption("2");
  EXPECT_TRUE(IsWindowVisible(screen.hChild(L"one")));
  EXPECT_FALSE(IsWindowVisible(screen.hChild(L"two")));
  EXPECT_EQ(TextOf(screen.hWindow()), L"1");
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
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "EDIT_FIELD 'e' \"\" 1 1 50 20\n");
  screen.Show(page);
  screen.RunQueued();
  screen.TakeEvents();
  screen.view->PostCommand(ID_SHOW_DIALOG);
  PostMessageW(screen.hWindow(), WM_CLOSE, 0, 0);
  screen.Key(VK_ESCAPE);
  screen.Key(VK_RETURN);  // no button to press
  screen.RunQueued();
  EXPECT_EQ(screen.TakeEvents(), (Events{"command 105", "close", "command 2", "command 1"}));
  EXPECT_TRUE(screen.view->bHasWindow()) << "only the wizard closes the window";
  EXPECT_TRUE(SendMessageW(screen.hWindow(), WM_QUERYENDSESSION, 0, 0));
  screen.wizard.holdsQuit = true;
  EXPECT_FALSE(SendMessageW(screen.hWindow(), WM_QUERYENDSESSION, 0, 0));
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

TEST(Window, RunEndsWhenTheWizardClosesTheWindow) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "BUTTON 'b_next' \"Next\" ID_NEXT 1 1 50 20, DEFAULT, FOCUS\n");
  screen.wizard.onEvent = [&](const std::string& event) {
    if (event == "command 101") screen.view->CloseWindow();
  };
  screen.Show(page);
  screen.Key(VK_RETURN);
  EXPECT_EQ(screen.view->iRun(), 0);
  EXPECT_FALSE(screen.view->bHasWindow());
  EXPECT_FALSE(screen.view->bSetText(page["b_next"], "x"));
}

// A worker drives the page that is being replaced under its hands.
TEST(Window, WorkersMayUseTheViewWhilePagesChange) {
  Screen screen;
  const char* const szControls = "PROGRESS_BAR 'p' 1 1 90 20\nTEXT_FIELD 't' \"\" 1 30 90 15\n";
  Page pages[] = {{DialogKind::DialogSys, "0 0 300 200", szControls},
                  {DialogKind::DialogSys, "0 0 300 200", szControls}};
  struct Work {
    WizardView* view;
    Page* pages;
  } work = {screen.view.get(), pages};
  int iChanges = 0;
  screen.wizard.onEvent = [&](const std::string& event) {
    if (event == "command 105") screen.Show(pages[++iChanges % 2]);
    if (event == "command 104") screen.view->CloseWindow();
  };
  screen.Show(pages[0]);
  ASSERT_TRUE(bOsStartThread(
      [](void* pContext) {
        const Work& work = *static_cast<Work*>(pContext);
        for (int i = 1; i <= 100; i++) {
          for (int j = 0; j < 2; j++) {
            work.view->bSetProgress(work.pages[j]["p"], i);
            work.view->bSetText(work.pages[j]["t"], std::to_string(i).c_str());
            work.view->bShow(work.pages[j]["t"], i % 2 == 0);
          }
          if (i % 10 == 0) work.view->SendCommand(ID_SHOW_DIALOG);
        }
        work.view->PostCommand(ID_EXIT);
      },
      &work));
  screen.view->iRun();
  EXPECT_EQ(iChanges, 10);
}

// A sent command is handled inside the loop's waiting for messages: the loop must notice that the window is gone.
TEST(Window, AWorkersSentCommandMayEndTheRun) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "");
  screen.wizard.onEvent = [&](const std::string&) { screen.view->CloseWindow(); };
  screen.Show(page);
  std::atomic<bool> bReturned{false};
  struct Work {
    WizardView* view;
    std::atomic<bool>* pReturned;
    DWORD dwThread;
  } work = {screen.view.get(), &bReturned, GetCurrentThreadId()};
  ASSERT_TRUE(bOsStartThread(
      [](void* pContext) {
        const Work& work = *static_cast<Work*>(pContext);
        OsSleep(100);  // until the loop waits
        work.view->SendCommand(ID_EXIT);
        for (int i = 0; i < 100 && !*work.pReturned; i++) OsSleep(20);
        if (!*work.pReturned) PostThreadMessageW(work.dwThread, WM_QUIT, 1, 0);
        *work.pReturned = true;
      },
      &work));
  screen.view->iRun();
  EXPECT_FALSE(bReturned.exchange(true)) << "the run had to be ended by force";
  OsSleep(100);
}

TEST(Window, AskedToCloseOnlyWhileNothingElseIsAsked) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "");
  screen.Show(page);
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
  RECT place;
  GetWindowRect(screen.hWindow(), &place);
  EXPECT_TRUE(bEqual(place, {50, 60, 450, 210})) << place.left << " " << place.top;
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
}

TEST(Window, ProgressAndTextArriveFromAnotherThread) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200",
            "PROGRESS_BAR 'p' 1 1 90 20, SMOOTH\nTEXT_FIELD 't' \"\" 1 30 90 15\n");
  struct Work {
    WizardView* view;
    Page* page;
  } work = {screen.view.get(), &page};
  LRESULT lPosition = 0;
  std::wstring text;
  screen.wizard.onEvent = [&](const std::string&) {
    lPosition = SendMessageW(screen.hChildOfClass(L"msctls_progress32"), PBM_GETPOS, 0, 0);
    text = TextOf(screen.hChildOfClass(L"STATIC"));
    screen.view->CloseWindow();
  };
  screen.Show(page);
  ASSERT_TRUE(bOsStartThread(
      [](void* pContext) {
        const Work& work = *static_cast<Work*>(pContext);
        work.view->bSetProgress((*work.page)["p"], 42);
        work.view->bSetText((*work.page)["t"], "žuto & plavo");
        work.view->PostCommand(ID_NEXT);
      },
      &work));
  screen.view->iRun();
  EXPECT_EQ(lPosition, 42);
  EXPECT_EQ(text, L"žuto & plavo");
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

namespace {

// Waits for a message box with this caption, keeps its text and presses the button.
struct BoxPresser {
  const wchar_t* szCaption;
  WPARAM wButton;
  std::wstring text;
  HWND hOwner = nullptr;

  static void Run(void* pContext) {
    auto& presser = *static_cast<BoxPresser*>(pContext);
    HWND hBox = nullptr;
    for (int i = 0; i < 200 && !hBox; i++, OsSleep(20)) hBox = FindWindowW(L"#32770", presser.szCaption);
    const HWND hText = hBox ? GetDlgItem(hBox, 0xFFFF) : nullptr;
    if (hText) presser.text = TextOf(hText);
    if (hBox) presser.hOwner = GetWindow(hBox, GW_OWNER);
    if (hBox) PostMessageW(hBox, WM_COMMAND, presser.wButton, 0);
  }
};

}  // namespace

TEST(Window, MessageBoxShowsItsTextAndReturnsTheAnswer) {
  Screen screen;
  Page page(DialogKind::DialogSys, "0 0 300 200", "");
  screen.Show(page);
  BoxPresser presser = {L"Greška!", IDNO, L"", nullptr};
  ASSERT_TRUE(bOsStartThread(BoxPresser::Run, &presser));
  const MessageText message = {"Prva\ndruga š", "Greška!", MessageIcon::Question, MessageButtons::YesNo, true};
  EXPECT_EQ(screen.view->iShowMessage(message), ANSWER_NO);
  EXPECT_EQ(presser.text, L"Prva\ndruga š");
  EXPECT_EQ(presser.hOwner, screen.hWindow());
}
