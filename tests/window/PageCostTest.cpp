// What showing pages costs: every control is painted once, a page takes little longer than its windows, and nothing is
// left behind; nor is anything taken away too early.
#include <algorithm>
#include <cstring>
#include <map>

#include "Page.h"
#include "foundation/os/Os.h"
#include "support/HighestHandle.h"
#include "wizard/COrbitWizard.h"

namespace {

std::map<HWND, int> g_paints;  // of a control: how often it was painted; of the wizard's window: its ground
std::map<HWND, WNDPROC> g_procs;

LRESULT CALLBACK CountPaints(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  if (uMessage == (GetParent(hWnd) ? WM_PAINT : WM_ERASEBKGND)) g_paints[hWnd]++;
  return CallWindowProcW(g_procs[hWnd], hWnd, uMessage, wParam, lParam);
}

BOOL CALLBACK Watch(HWND hWnd, LPARAM) {
  g_paints[hWnd] = 0;
  g_procs[hWnd] =
      reinterpret_cast<WNDPROC>(SetWindowLongPtrW(hWnd, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(CountPaints)));
  return TRUE;
}

const char* const SOME_OF_EACH =
    "TEXT_FIELD \"Text\" 10 10 100 15\nEDIT_FIELD 'e' 10 30 100 20\nCHECK_BOX 'c' \"Check\" 10 60 100 15\n"
    "BUTTON 'b' \"Button\" 10 80 75 23, BACKGROUND(227,241,228)\nBUTTON 'p' \"Plain\" 10 110 75 23\n"
    "LIST_FIELD 'l' \"a\" \"b\" 10 140 100 40\nPROGRESS_BAR 'pr' 10 190 100 15\n";

}  // namespace

TEST(Painting, APageChangePaintsEveryControlOnce) {
  Screen screen;
  Page pages[] = {{DialogKind::Window, "0 0 300 280", SOME_OF_EACH},
                  {DialogKind::Window, "0 0 320 290, BACKGROUND(227,241,228)", SOME_OF_EACH}};
  screen.Show(pages[0]);
  screen.RunQueued();
  ASSERT_TRUE(screen.view->bCreateDialog(pages[1].info));
  g_paints.clear();
  EnumChildWindows(screen.hWindow(), Watch, 0);
  Watch(screen.hWindow(), 0);
  screen.view->ShowDialog();
  screen.RunQueued();
  int iPainted = 0;
  for (const auto& [hWnd, iCount] : g_paints) {
    if (!IsWindow(hWnd)) continue;
    iPainted++;
    EXPECT_EQ(iCount, 1) << PlaceName(screen, hWnd);
  }
  EXPECT_EQ(iPainted, 8);
  for (auto& [hWnd, iCount] : g_paints) iCount = 0;
  SetWindowPos(screen.hWindow(), nullptr, 0, 0, 360, 330, SWP_NOMOVE | SWP_NOZORDER);
  screen.RunQueued();
  for (const auto& [hWnd, iCount] : g_paints)
    EXPECT_EQ(iCount, hWnd == screen.hWindow() ? 1 : 0) << "a larger window leaves its controls alone";
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
  Page pages[] = {{DialogKind::Window, "0 0 300 280, BACKGROUND(1,2,3), PICTURE(leak.bmp)", SOME_OF_EACH},
                  {DialogKind::Window, "0 0 320 290",
                   "BUTTON 'g' \"Gradient\" TOOLTIP 'tip' 1 1 75 23, GRADIENT TOP(1,2,3) BOTTOM(4,5,6), BOLD\n"
                   "TEXT_FIELD \"Link\" 1 30 75 15, LINK, ITALIC, BACKGROUND(1,2,3) ACTION: ()\n"}};
  const auto change = [&](int iTimes) {
    for (int i = 0; i < iTimes; i++) screen.Show(pages[i % 2]);
    screen.RunQueued();
  };
  change(20);
  const unsigned uObjects = HighestObject(), uWindows = HighestWindow();
  const DWORD dwObjects = GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS);
  const double dStart = dMilliseconds();
  change(1000);
  printf("1000 changes: %.0f ms, objects %u -> %u, windows %u -> %u, system %lu\n", dMilliseconds() - dStart, uObjects,
         HighestObject(), uWindows, HighestWindow(), dwObjects);
  EXPECT_LT(HighestObject(), uObjects + 100);
  EXPECT_LT(HighestWindow(), uWindows + 100);
  EXPECT_LE(GetGuiResources(GetCurrentProcess(), GR_GDIOBJECTS), dwObjects + 100);
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
  double dBare = 1e9, dShown = 1e9;
  for (int i = 0; i < 5; i++) {
    Screen screen;
    const double dStart = dMilliseconds();
    screen.Show(page);
    dShown = std::min(dShown, dMilliseconds() - dStart);
    const auto hFont = reinterpret_cast<HFONT>(SendMessageW(screen.hChild(L"Button 3"), WM_GETFONT, 0, 0));
    dBare = std::min(dBare, dBareTime(page, hFont));
  }
  printf("200 controls: bare %.1f ms, shown %.1f ms, %.2f times\n", dBare, dShown, dShown / dBare);
  EXPECT_LT(dShown, 1.3 * dBare);
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
    RECT client;
    GetClientRect(screen.hWindow(), &client);
    EXPECT_EQ(PixelOf(screen.hWindow(), client.right - 4, client.bottom - 1), red);
    EXPECT_EQ(PixelOf(screen.hWindow(), client.right - 5, client.bottom - 1), ground);
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
