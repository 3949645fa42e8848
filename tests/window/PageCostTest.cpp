// What showing pages costs: every control is painted once, a page takes little longer than its windows, and nothing is
// left behind; nor is anything taken away too early. The demonstration wizards, every page of them.
#include <algorithm>
#include <cstring>
#include <map>

#include "UsedPage.h"
#include "controls/ContainerKinds.h"
#include "foundation/os/Os.h"
#include "support/DemoWizard.h"
#include "support/HighestHandle.h"
#include "support/TestFolder.h"

namespace {

std::map<HWND, int> g_paints;  // of a control: how often it was painted; of the wizard's window: its ground
std::map<HWND, WNDPROC> g_procs;

LRESULT CALLBACK CountPaints(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  if (uMessage == (GetParent(hWnd) ? WM_PAINT : WM_ERASEBKGND)) g_paints[hWnd]++;
  return CallWindowProcW(g_procs[hWnd], hWnd, uMessage, wParam, lParam);
}

BOOL CALLBACK Watch(HWND hWnd, LPARAM) {
  g_paints[hWnd] = 0;
  const auto pProc = reinterpret_cast<WNDPROC>(GetWindowLongPtrW(hWnd, GWLP_WNDPROC));
  if (pProc == CountPaints) return TRUE;
  g_procs[hWnd] = pProc;
  SetWindowLongPtrW(hWnd, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(CountPaints));
  return TRUE;
}

void WatchAll(HWND hWindow) {
  g_paints.clear();
  Watch(hWindow, 0);
  EnumChildWindows(hWindow, Watch, 0);
}

// How often the ground was painted, and each control.
std::string Paints(Screen& screen) {
  screen.RunQueued();
  std::string paints = std::to_string(g_paints[screen.hWindow()]) + ":";
  for (const auto& [hWnd, iCount] : g_paints)
    if (hWnd != screen.hWindow() && IsWindow(hWnd)) paints += " " + std::to_string(iCount);
  return paints;
}

const char* const SOME_OF_EACH =
    "TEXT_FIELD \"Text\" 10 10 100 15\nEDIT_FIELD 'e' 10 30 100 20\nCHECK_BOX 'c' \"Check\" 10 60 100 15\n"
    "BUTTON 'b' \"Button\" 10 80 75 23, BACKGROUND(227,241,228)\nBUTTON 'p' \"Plain\" 10 110 75 23\n"
    "LIST_FIELD 'l' \"a\" \"b\" 10 140 100 40\nPROGRESS_BAR 'pr' 10 190 100 15\n";

}  // namespace

// A display may ask for a picture once more, when it is slow: then another change shows what is painted.
TEST(Painting, APageChangePaintsEveryControlOnce) {
  Screen screen;
  Page pages[] = {{DialogKind::Window, "0 0 300 280", SOME_OF_EACH},
                  {DialogKind::Window, "0 0 320 290, BACKGROUND(227,241,228)", SOME_OF_EACH}};
  screen.Show(pages[0]);
  std::string paints;
  int iChanges = 0;
  EXPECT_TRUE(bWaitFor([&] {
    screen.RunQueued();
    EXPECT_TRUE(screen.view->bCreateDialog(pages[++iChanges % 2].info));
    WatchAll(screen.hWindow());
    screen.view->ShowDialog();
    return (paints = Paints(screen)) == "1: 1 1 1 1 1 1 1";
  })) << paints;
  EXPECT_TRUE(bWaitFor([&] {
    WatchAll(screen.hWindow());
    SetWindowPos(screen.hWindow(), nullptr, 0, 0, 360 + iChanges++, 330, SWP_NOMOVE | SWP_NOZORDER);
    return (paints = Paints(screen)) == "1: 0 0 0 0 0 0 0";
  })) << "a larger window leaves its controls alone: "
      << paints;
  SetWindowLongPtrW(screen.hWindow(), GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(g_procs[screen.hWindow()]));
}

namespace {

double dMilliseconds() {
  LARGE_INTEGER now, frequency;
  QueryPerformanceCounter(&now);
  QueryPerformanceFrequency(&frequency);
  return static_cast<double>(now.QuadPart) * 1000 / static_cast<double>(frequency.QuadPart);
}

}  // namespace

TEST(Endurance, AThousandPageChangesLeaveNoHandleBehind) {
  CNString csFile;
  WritePicture("leak.bmp", csFile);
  Screen screen;
  Page pages[] = {
      {DialogKind::Window, "0 0 300 280, BACKGROUND(1,2,3), PICTURE(leak.bmp)", SOME_OF_EACH},
      {DialogKind::Window, "0 0 320 290",
       "BUTTON 'g' \"Gradient\" TOOLTIP 'tip' 1 1 75 23, GRADIENT TOP(1,2,3) BOTTOM(4,5,6), BOLD\n"
       "TEXT_FIELD \"Link\" 1 30 75 15, LINK, ITALIC, BACKGROUND(1,2,3) ACTION: ()\n"},
      {DialogKind::Window, "0 0 320 290",
       (std::string(TABLE) + "\n" + TREE + "\nLIST_FIELD \"<RGB(1,2,3),leak.bmp>a\" 1 1 90 80, OWNER_DRAWN\n" +
        "COMBO_FIELD 1 90 90 20, IMAGE_COMBO\n\"a\", leak.bmp\nEND_COMBO\nHEADER \"A\" 1 120 90 20\n")
           .c_str()},
      {DialogKind::Window, "0 0 320 290",
       "MENU_BAR,OWNER_DRAWN\nMENU \"&File\"\nITEM \"a\"\nSUBMENU \"b\"\nITEM "
       "\"c\"\nEND_SUBMENU\nEND_MENU\nEND_MENUBAR\n"
       "RIGHT_CLICK_MENU\nSUBMENU \"a\"\nEND_SUBMENU\nEND_RIGHT_CLICK_MENU\n"
       "TOOLBAR 't' 0 0 0 0\nITEM \"a\", IDB_NONE\nEND_TOOLBAR\n"}};
  const auto highest = [] {
    const auto make = [] { return CreateMenu(); };
    return std::vector<unsigned>{HighestObject(), HighestWindow(), HighestHandle(make, DestroyMenu),
                                 static_cast<unsigned>(GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS))};
  };
  const auto change = [&](int iTimes) {
    for (int i = 0; i < iTimes; i++) screen.Show(pages[i % 10 < 8 ? i % 2 : i % 10 - 6]);  // the dear ones less often
    screen.RunQueued();
  };
  change(40);
  const std::vector<unsigned> before = highest();
  change(1000);
  const std::vector<unsigned> after = highest();
  for (size_t i = 0; i < after.size(); i++) EXPECT_LT(after[i], before[i] + 60) << i;
  bOsDeleteFile(csFile.Text());
}

namespace {

// The same windows as those of a page, made and drawn without anything around them.
double dBareTime(const Page& page, HFONT hFont) {
  const double dStart = dMilliseconds();
  const HWND hParent = CreateWindowW(L"STATIC", L"", WS_OVERLAPPEDWINDOW | WS_CLIPCHILDREN, 0, 0, 900, 700, nullptr,
                                     nullptr, nullptr, nullptr);
  for (int i = 0; i < page.info.m_Controls.Size(); i++) {
    const BaseControl& control = *page.info.m_Controls[i];
    const HWND hWnd = CreateWindowExA(control.m_dwExStyle, control.szWindowClass(), control.m_csCaption.Text(),
                                      control.m_dwStyle, control.m_iSize[0], control.m_iSize[1], control.m_iSize[2],
                                      control.m_iSize[3], hParent, nullptr, nullptr, nullptr);
    SendMessageW(hWnd, WM_SETFONT, reinterpret_cast<WPARAM>(hFont), FALSE);
  }
  ShowWindow(hParent, SW_SHOW);
  RedrawWindow(hParent, nullptr, nullptr, RDW_INVALIDATE | RDW_ERASE | RDW_ALLCHILDREN | RDW_UPDATENOW);
  const double dTime = dMilliseconds() - dStart;
  DestroyWindow(hParent);
  return dTime;
}

}  // namespace

TEST(Endurance, APageOfTwoHundredControlsCostsLittleMoreThanItsWindows) {
  std::string lines;
  const char* const KINDS[] = {"TEXT_FIELD 't%d' \"Text %d\"", "EDIT_FIELD 'e%d' \"Edit %d\"",
                               "CHECK_BOX 'c%d' \"Check %d\"", "BUTTON 'b%d' \"Button %d\""};
  for (int i = 0; i < 200; i++) {
    char line[128];
    snprintf(line, sizeof(line), KINDS[i % 4], i, i);
    lines += line + (" " + std::to_string(i % 10 * 85) + " " + std::to_string(i / 10 * 30) + " 80 20\n");
  }
  Page page(DialogKind::Window, "0 0 900 700", lines.c_str());
  // The quickest of each: a busy machine takes longer for either now and then, a slow page always does.
  double dBare = 1e9, dShown = 1e9;
  EXPECT_TRUE(bWaitFor([&] {
    Screen screen;
    const double dStart = dMilliseconds();
    screen.Show(page);
    dShown = std::min(dShown, dMilliseconds() - dStart);
    const auto hFont = reinterpret_cast<HFONT>(SendMessageW(screen.hChild(L"Button 3"), WM_GETFONT, 0, 0));
    dBare = std::min(dBare, dBareTime(page, hFont));
    return dShown < 1.3 * dBare;
  })) << "bare "
      << dBare << " ms, shown " << dShown << " ms";
}

// The picture lies behind the controls without a seam, at the place that its word says, also after a resize.
TEST(Painting, ABackgroundPictureLiesBehindEverything) {
  const COLORREF ground = RGB(10, 20, 30), red = RGB(255, 0, 0);
  CNString csFile;
  WritePicture("ground.bmp", csFile);
  Screen screen;
  Page moved(DialogKind::Window, "0 0 300 280, BACKGROUND(10,20,30), PICTURE(ground.bmp,change_position,7,9)",
             "TEXT_FIELD \"\" 5 6 50 20\nCHECK_BOX 'c' \"\" 100 6 50 20\n");
  Page corner(DialogKind::Window, "0 0 300 280, BACKGROUND(10,20,30), PICTURE(ground.bmp,right_down)", "");
  screen.Show(moved);
  EXPECT_EQ(PixelOf(screen.hWindow(), 2, 2), ground);
  EXPECT_EQ(PixelOf(screen.hChildOfClass(L"STATIC"), 2, 3), red) << "seen through the text";
  EXPECT_EQ(PixelOf(screen.hChildOfClass(L"STATIC"), 1, 3), ground);
  EXPECT_EQ(PixelOf(screen.hChildOfClass(L"BUTTON"), 40, 10), ground);
  screen.Show(corner);
  for (const int iWider : {0, 60}) {
    SetWindowPos(screen.hWindow(), nullptr, 0, 0, 300 + iWider, 280, SWP_NOMOVE | SWP_NOZORDER);
    screen.RunQueued();
    const SIZE client = ClientOf(screen.hWindow());
    EXPECT_EQ(PixelOf(screen.hWindow(), client.cx - 4, client.cy - 1), red);
    EXPECT_EQ(PixelOf(screen.hWindow(), client.cx - 5, client.cy - 1), ground);
  }
  bOsDeleteFile(csFile.Text());
}

namespace {

// Goes on in the middle of a press of its button, as a list does that has a message loop of its own.
class LeavingWizard : public COrbitWizard {
 public:
  explicit LeavingWizard(WizardView& view) : COrbitWizard(view), m_View(view) {}
  int iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pCommandResult,
                       CNString* pOutput) override {
    if (strcmp(szCommand, "Press") == 0) {
      EnumThreadWindows(GetCurrentThreadId(), FindButton, reinterpret_cast<LPARAM>(&hButton));
      PostMessageW(hButton, BM_CLICK, 0, 0);
    } else if (strcmp(szCommand, "b_OnClick") == 0) {
      m_View.SendCommand(ID_NEXT);
      bKept = IsWindow(hButton) && !IsWindowVisible(hButton);
    } else if (strcmp(szCommand, "Leave") == 0) {
      m_View.PostCommand(ID_SHOW_DIALOG);
      m_View.PostCommand(ID_EXIT);
    } else {
      return COrbitWizard::iExecuteFunction(szCommand, szParam, iFlag, pCommandResult, pOutput);
    }
    return 0;
  }
  HWND hButton = nullptr;
  bool bKept = false;

 private:
  static BOOL CALLBACK FindButton(HWND hWindow, LPARAM pButton) {
    if (const HWND hFound = FindWindowExW(hWindow, nullptr, L"BUTTON", nullptr))
      *reinterpret_cast<HWND*>(pButton) = hFound;
    return TRUE;
  }
  WizardView& m_View;
};

}  // namespace

TEST(PageChange, KeepsAControlThatIsInTheMiddleOfAMessage) {
  const std::unique_ptr<WizardView> view = pMakeWin32View(GetModuleHandleW(nullptr));
  LeavingWizard wizard(*view);
  const char* szScript =
      "DIALOG1 'a' \"\" 0 0 400 400\nBEGIN\nBUTTON 'b' \"B\" 1 1 75 23 ACTION\nSTART_AFTER_DRAWING\nSTART_ACTION\n"
      "Press ()\nFINISH_ACTION\nEND\nCONTINUE\nEND_DIALOG1\nDIALOG2 'c' \"\" 0 0 400 300\nBEGIN\n"
      "START_AFTER_DRAWING\nSTART_ACTION\nLeave ()\nFINISH_ACTION\nEND\nCONTINUE\nEND_DIALOG2\n";
  EXPECT_EQ(wizard.iExecuteWizard(szScript, 0), 0);
  EXPECT_TRUE(wizard.bKept);
  EXPECT_FALSE(IsWindow(wizard.hButton));
}

namespace {

// Every page, and every page of its tab controls. What a script means to be seen has a window of its own.
void ShowAll(DemoView& view, DemoWizard& wizard) {
  for (int i = 1; i <= wizard.DialogCount(); i++) {
    wizard.Show(i);
    const DialogInfo& dialog = *wizard.GetDialog(i);
    for (int k = 0; k < dialog.m_Controls.Size(); k++) {
      const BaseControl& control = *dialog.m_Controls[k];
      CNString csText;
      if (control.szWindowClass() && !control.bHasFlag("HIDE")) {
        EXPECT_TRUE(view.bGetText(control, csText)) << dialog.m_csName.Text() << ": no " << control.m_csName.Text();
      }
      if (!bIsTabControl(&control)) continue;
      const auto& tabs = static_cast<const CNTabControl&>(control);
      for (int iPage = tabs.m_Pages.Size(); iPage; iPage--)
        EXPECT_TRUE(view.bSetText(tabs, std::to_string(iPage).c_str())) << tabs.m_csName.Text();
    }
    MSG message;
    while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) DispatchMessageW(&message);
    ASSERT_EQ(wizard.CurrentDialog(), &dialog);
  }
}

class GalleryTest : public testing::TestWithParam<const char*> {};

}  // namespace

TEST_P(GalleryTest, ShowsEveryPageWithoutAFaultOrALeak) {
  DemoView view;
  DemoWizard wizard(view);
  ASSERT_TRUE(wizard.bOpen(GetParam()));
  TestFolder folder;
  TestLog log(folder);
  ShowAll(view, wizard);
  EXPECT_EQ(view.messages, std::vector<std::string>());
  EXPECT_EQ(log.Lines(), std::vector<std::string>());
  // What leaks does so in every round; what the system itself opens late, on a slow machine, does not. (Some of its
  // controls leave a font or two behind each time.)
  int nGrown = 0;
  for (int iRound = 0; iRound < 5; iRound++) {
    const unsigned uObjects = HighestObject(), uWindows = HighestWindow();
    ShowAll(view, wizard);
    nGrown += HighestObject() > uObjects + 16 || HighestWindow() > uWindows + 16;
  }
  EXPECT_LT(nGrown, 5);
}

INSTANTIATE_TEST_SUITE_P(Products, GalleryTest, testing::Values("gallery", "wizard97"));
