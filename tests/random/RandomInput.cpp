#include "RandomInput.h"

namespace {

const UINT ANSWER_TIME = 30000;  // milliseconds, on a machine that does much else
const int RECOVER_EVERY = 50;    // steps
const POINT HOME = {120, 80};

// Tab, Enter, Escape, Space and the like; Windows keys and Alt+Tab would lead out of the program.
const WORD KEYS[] = {VK_TAB,  VK_TAB,    VK_RETURN, VK_ESCAPE, VK_SPACE,    VK_LEFT,    VK_RIGHT, VK_UP,
                     VK_DOWN, VK_HOME,   VK_END,    VK_PRIOR,  VK_NEXT,     VK_F2,      VK_F4,    VK_F10,
                     VK_BACK, VK_DELETE, VK_APPS,   VK_ADD,    VK_MULTIPLY, VK_SUBTRACT};

}  // namespace

struct RandomInput::StepRow {
  const char* szName;
  int iShare;
  void (RandomInput::*pMake)();
  WORD wHeld = 0;  // a key that is held down meanwhile
};

const RandomInput::StepRow RandomInput::STEPS[] = {
    {"click", 30, &RandomInput::Click},
    {"double click", 6, &RandomInput::DoubleClick},
    {"right click", 5, &RandomInput::RightClick},
    {"drag", 8, &RandomInput::Drag},
    {"wheel", 4, &RandomInput::Wheel},
    {"key", 24, &RandomInput::Key},
    {"type", 10, &RandomInput::Type},
    {"Alt", 4, &RandomInput::Type, VK_MENU},
    {"Ctrl and a character", 2, &RandomInput::Type, VK_CONTROL},
    {"Ctrl", 2, &RandomInput::Key, VK_CONTROL},
    {"Shift", 3, &RandomInput::Key, VK_SHIFT},
    {"new page", 2, &RandomInput::NewPage},
};

RandomInput::RandomInput(HWND hWindow, unsigned uSeed, UINT uShowCommand)
    : m_hWindow(hWindow),
      m_uThread(GetWindowThreadProcessId(hWindow, nullptr)),
      m_uShowCommand(uShowCommand),
      m_random(uSeed) {}

bool RandomInput::bRun(long lSteps) {
  for (; m_lDone < lSteps; m_lDone++) {
    if (m_lDone % RECOVER_EVERY == 0) Recover();
    Step();
    if (!bAnswers()) return false;
  }
  return true;
}

bool RandomInput::bLetGo(const std::atomic<bool>& bDone) {
  const DWORD dwStart = GetTickCount();
  for (; !bDone && GetTickCount() - dwStart < ANSWER_TIME; Sleep(50)) {
    // The system's loop of a press on the frame's own buttons waits for nothing else, and may have lost the mouse.
    PostThreadMessageW(m_uThread, WM_LBUTTONUP, 0, 0);
    Recover();
    MoveTo(Place());
    Button(MOUSEEVENTF_LEFTUP);
    Button(MOUSEEVENTF_RIGHTUP);
  }
  return bDone;
}

// Menus, drags and open lists have message loops of their own: they answer as well.
bool RandomInput::bAnswers() const {
  DWORD_PTR uResult;
  return SendMessageTimeoutW(m_hWindow, WM_NULL, 0, 0, SMTO_NORMAL, ANSWER_TIME, &uResult) != 0;
}

void RandomInput::Step() {
  int iTotal = 0;
  for (const StepRow& row : STEPS) iTotal += row.iShare;
  int iChosen = Number(iTotal);
  for (const StepRow& row : STEPS) {
    iChosen -= row.iShare;
    if (iChosen >= 0) continue;
    m_last = row.szName;
    if (row.wHeld) Press(row.wHeld, true);
    (this->*row.pMake)();
    if (row.wHeld) Press(row.wHeld, false);
    return;
  }
}

// A window that was minimised, moved away or covered is brought back.
void RandomInput::Recover() {
  if (IsIconic(m_hWindow)) ShowWindowAsync(m_hWindow, SW_RESTORE);
  SetWindowPos(m_hWindow, HWND_TOPMOST, HOME.x, HOME.y, 0, 0,
               SWP_NOSIZE | SWP_ASYNCWINDOWPOS | (IsZoomed(m_hWindow) ? SWP_NOMOVE : 0));
  if (GetForegroundWindow() != m_hWindow) SetForegroundWindow(m_hWindow);
}

POINT RandomInput::Place() {
  RECT area;
  GetWindowRect(m_hWindow, &area);
  const int iWidth = area.right - area.left, iHeight = area.bottom - area.top;
  if (iWidth <= 0 || iHeight <= 0) return HOME;
  return {area.left + Number(iWidth), area.top + Number(iHeight)};
}

void RandomInput::MoveTo(POINT place) { SetCursorPos(place.x, place.y); }

void RandomInput::Button(DWORD dwFlags) { mouse_event(dwFlags, 0, 0, 0, 0); }

void RandomInput::Press(WORD wKey, bool bDown) {
  keybd_event(static_cast<BYTE>(wKey), static_cast<BYTE>(MapVirtualKeyW(wKey, 0)), bDown ? 0 : KEYEVENTF_KEYUP, 0);
}

void RandomInput::Click() {
  MoveTo(Place());
  Button(MOUSEEVENTF_LEFTDOWN), Button(MOUSEEVENTF_LEFTUP);
}

void RandomInput::DoubleClick() {
  Click();
  Button(MOUSEEVENTF_LEFTDOWN), Button(MOUSEEVENTF_LEFTUP);
}

void RandomInput::RightClick() {
  MoveTo(Place());
  Button(MOUSEEVENTF_RIGHTDOWN), Button(MOUSEEVENTF_RIGHTUP);
}

void RandomInput::Drag() {
  const bool bRight = Number(4) == 0;
  MoveTo(Place());
  Button(bRight ? MOUSEEVENTF_RIGHTDOWN : MOUSEEVENTF_LEFTDOWN);
  for (int i = 0; i < 3 && bAnswers(); i++) MoveTo(Place());
  Button(bRight ? MOUSEEVENTF_RIGHTUP : MOUSEEVENTF_LEFTUP);
}

void RandomInput::Wheel() {
  MoveTo(Place());
  mouse_event(MOUSEEVENTF_WHEEL, 0, 0, static_cast<DWORD>(Number(2) ? WHEEL_DELTA : -WHEEL_DELTA), 0);
}

void RandomInput::Tap(WORD wKey) { Press(wKey, true), Press(wKey, false); }

void RandomInput::Key() { Tap(KEYS[Number(static_cast<int>(std::size(KEYS)))]); }

void RandomInput::Type() { Tap(static_cast<WORD>(Number(3) ? 'A' + Number(26) : '0' + Number(10))); }

void RandomInput::NewPage() { PostMessageW(m_hWindow, WM_COMMAND, m_uShowCommand, 0); }
