// Random clicks and keys on the gallery: the wizard must neither crash nor hang nor leave handles behind. What the
// system's own controls leave behind is measured in the same run, with bare ones (BareControls.h); there must be
// nothing beyond that, but what the system makes once and keeps.
//   random_tests.exe [--steps N] [--seed N] [--page N] [--without N]
// --page stays on the dialog of that number, to find out where something happens. --without never goes to that dialog;
// it is 8 unless it is given (0: all are gone to), because Wine's own field of formatted text, which is there, crashes
// now and then, in a bare window as well.
// The seed and what was done are printed; the exit code is 1 after a failure. A crash shows as the system's exit code.
#include <algorithm>
#include <climits>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <thread>

#include "BareControls.h"
#include "RandomInput.h"
#include "support/DemoWizard.h"

namespace {

const int ID_ANOTHER_PAGE = 490;  // below the first control's identifier
const int ID_STOP = 491;
const int PARTS = 4;  // of a run
const int MOST_PARTS = 16;

class RandomWizard : public DemoWizard {
 public:
  RandomWizard(DemoView& view, unsigned uSeed, int iOnly, int iWithout)
      : DemoWizard(view), m_random(uSeed), m_iOnly(iOnly), m_iWithout(iWithout) {}
  void OnCommand(int iID) override {
    if (iID == ID_STOP) return m_View.CloseWindow();
    iID == ID_ANOTHER_PAGE ? Show(iNextPage()) : DemoWizard::OnCommand(iID);
    LeaveUnwanted();
  }
  void OnControl(BaseControl& control, int iNotification) override {
    DemoWizard::OnControl(control, iNotification);
    LeaveUnwanted();
  }
  void ShowAll() {
    for (int i = 1; i <= DialogCount(); i++) Show(i);
    Show(1);
  }

 private:
  // The gallery's own ways lead there too.
  void LeaveUnwanted() {
    if (m_iWithout && m_iCurrentDialog == m_iWithout) Show(1);
  }
  int iNextPage() {
    if (m_iOnly) return m_iOnly;
    return 1 + static_cast<int>(m_random() % static_cast<unsigned>(DialogCount()));
  }

  std::mt19937 m_random;
  const int m_iOnly;     // 0: all dialogs
  const int m_iWithout;  // 0: none
};

struct Handles {
  ObjectCounts objects = LiveObjects();
  int nWindows = LiveWindows();
};

// The types that grew are a help to find what stays.
void PrintGrowth(const Handles& before, const Handles& after, int iBare) {
  std::printf("windows %d -> %d, objects %+d, those of as many bare controls %+d\n", before.nWindows, after.nWindows,
              iGrowth(before.objects, after.objects), iBare);
  for (size_t i = 0; i < after.objects.size(); i++)
    if (after.objects[i] != before.objects[i])
      std::printf("  objects of type %u: %d -> %d\n", static_cast<unsigned>(i), before.objects[i], after.objects[i]);
}

long lArgument(int argc, char** argv, const char* szName, long lDefault) {
  for (int i = 1; i + 1 < argc; i++)
    if (std::strcmp(argv[i], szName) == 0) return std::atol(argv[i + 1]);
  return lDefault;
}

// Where a thread is and who has called: what on its stack looks like a return address.
void TellPlace(const CONTEXT& context) {
  const auto tell = [](uintptr_t uAddress, const char* szWhat) {
    HMODULE hModule = nullptr;
    if (uAddress < 0x10000) return;
    char name[MAX_PATH] = "";
    if (!GetModuleHandleExA(GET_MODULE_HANDLE_EX_FLAG_FROM_ADDRESS | GET_MODULE_HANDLE_EX_FLAG_UNCHANGED_REFCOUNT,
                            reinterpret_cast<const char*>(uAddress), &hModule))
      return;
    GetModuleFileNameA(hModule, name, MAX_PATH);
    const char* szName = std::strrchr(name, '\\');
    std::printf("%s %s+%zx\n", szWhat, szName ? szName + 1 : name, uAddress - reinterpret_cast<uintptr_t>(hModule));
  };
  tell(context.Eip, "at");
  const auto* pStack = reinterpret_cast<const uintptr_t*>(context.Esp);
  for (int i = 0; i < 1000 && !IsBadReadPtr(pStack + i, sizeof(*pStack)); i++) tell(pStack[i], " ");
}

// Tells where the window's thread hangs.
void TellHang(HWND hWindow, DWORD uThread) {
  GUITHREADINFO info = {};
  info.cbSize = sizeof(info);
  std::printf("  window %p there %d, visible %d, enabled %d, minimised %d\n", static_cast<void*>(hWindow),
              IsWindow(hWindow), IsWindowVisible(hWindow), IsWindowEnabled(hWindow), IsIconic(hWindow));
  if (GetGUIThreadInfo(uThread, &info)) {
    const std::pair<const char*, HWND> windows[] = {
        {"active", info.hwndActive},  {"focus", info.hwndFocus},    {"capture", info.hwndCapture},
        {"menu", info.hwndMenuOwner}, {"moved", info.hwndMoveSize}, {"foreground", GetForegroundWindow()}};
    for (const auto& [szWhat, hWindow] : windows) {
      char name[64] = "";
      GetClassNameA(hWindow, name, sizeof(name));
      std::printf("  %s %p %s\n", szWhat, static_cast<void*>(hWindow), name);
    }
  }
  const HANDLE hThread = OpenThread(THREAD_SUSPEND_RESUME | THREAD_GET_CONTEXT, FALSE, uThread);
  CONTEXT context = {};
  context.ContextFlags = CONTEXT_FULL;
  if (SuspendThread(hThread) != static_cast<DWORD>(-1) && GetThreadContext(hThread, &context)) TellPlace(context);
}

int Fail(const char* szWhat, const RandomInput& input) {
  std::printf("FAILED: %s after %ld steps, the last one: %s\n", szWhat, input.StepsDone(), input.Last().c_str());
  std::fflush(stdout);
  return 1;
}

class RandomRun {
 public:
  RandomRun(unsigned uSeed, int iOnly, int iWithout) : m_wizard(m_view, uSeed, iOnly, iWithout), m_uSeed(uSeed) {}

  // The exit code. A leak grows in every part, what the system makes once and keeps (the brushes of its colours, its
  // cursors, the pictures and the font of its menus) in few: parts are added until one leaves nothing behind.
  int iRun(long lSteps) {
    if (!m_wizard.bOpen("gallery")) return std::printf("FAILED: the gallery cannot be opened\n"), 1;
    for (int i = 0; i < 3; i++) m_wizard.ShowAll();
    int iLeast = INT_MAX, iPart = 0;
    for (; iPart < PARTS || (iLeast > 0 && iPart < MOST_PARTS); iPart++)
      if (!bPart(lSteps / PARTS, m_uSeed + static_cast<unsigned>(iPart), iLeast)) return 1;
    std::printf("%ld steps in %d parts, seed %u, messages %u\n", lSteps / PARTS * iPart, iPart, m_uSeed,
                static_cast<unsigned>(m_view.messages.size()));
    return iLeast > 0 ? std::printf("FAILED: every part leaves handles behind\n"), 1 : 0;
  }

 private:
  bool bPart(long lSteps, unsigned uSeed, int& iLeast) {
    const Handles before;
    const BareControls bare;
    RandomInput input(m_wizard.hWindow(), uSeed, ID_ANOTHER_PAGE);
    std::atomic<bool> bEnded{false};
    const DWORD uThread = GetCurrentThreadId();
    const auto end = [&](const char* szWhat) {
      TellHang(m_wizard.hWindow(), uThread);
      std::_Exit(Fail(szWhat, input));
    };
    std::thread hand([&] {
      // A window that hangs takes nothing any more: only the whole program can end.
      if (!input.bRun(lSteps)) end("no answer");
      m_view.PostCommand(ID_STOP);
      if (!input.bLetGo(bEnded)) end("the wizard does not end");
    });
    m_view.iRun();
    bEnded = true;
    hand.join();
    if (input.StepsDone() < lSteps) return Fail("the window has closed", input), false;
    if (!m_wizard.bOpenWindow()) return Fail("the window cannot be opened again", input), false;
    m_wizard.ShowAll();
    const Handles after;
    const int iBare = bare.iLeftBehind();
    PrintGrowth(before, after, iBare);
    iLeast = std::min(iLeast, iGrowth(before.objects, after.objects) - iBare);
    return after.nWindows <= before.nWindows || (Fail("windows are left behind", input), false);
  }

  DemoView m_view;
  RandomWizard m_wizard;
  const unsigned m_uSeed;
};

LONG WINAPI TellCrash(EXCEPTION_POINTERS* pException) {
  std::printf("CRASH %lx\n", pException->ExceptionRecord->ExceptionCode);
  TellPlace(*pException->ContextRecord);
  std::fflush(stdout);
  return EXCEPTION_EXECUTE_HANDLER;
}

}  // namespace

int main(int argc, char** argv) {
  SetUnhandledExceptionFilter(TellCrash);
  const auto uSeed = static_cast<unsigned>(lArgument(argc, argv, "--seed", 20261121));
  const auto iPage = static_cast<int>(lArgument(argc, argv, "--page", 0));
  const auto iWithout = static_cast<int>(lArgument(argc, argv, "--without", 8));
  return RandomRun(uSeed, iPage, iWithout).iRun(lArgument(argc, argv, "--steps", 4000));
}
