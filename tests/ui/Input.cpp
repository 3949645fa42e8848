#include "Input.h"

#include <algorithm>
#include <cwctype>
#include <vector>

#include "Finder.h"

namespace {

const DWORD PATIENCE = 10000;  // milliseconds for a control to become enabled or a window to come to the front

struct KeyName {
  const wchar_t* szName;
  WORD wKey;
};

const KeyName KEY_NAMES[] = {
    {L"enter", VK_RETURN},  {L"escape", VK_ESCAPE}, {L"tab", VK_TAB},      {L"space", VK_SPACE}, {L"back", VK_BACK},
    {L"delete", VK_DELETE}, {L"home", VK_HOME},     {L"end", VK_END},      {L"left", VK_LEFT},   {L"right", VK_RIGHT},
    {L"up", VK_UP},         {L"down", VK_DOWN},     {L"f1", VK_F1},        {L"f4", VK_F4},       {L"f11", VK_F11},
    {L"pause", VK_PAUSE},   {L"alt", VK_MENU},      {L"ctrl", VK_CONTROL}, {L"shift", VK_SHIFT},
};

WORD KeyByName(const std::wstring& wsName) {
  for (const KeyName& row : KEY_NAMES) {
    if (_wcsicmp(row.szName, wsName.c_str()) == 0) return row.wKey;
  }
  return wsName.size() == 1 && iswalnum(wsName[0]) ? static_cast<WORD>(towupper(wsName[0])) : 0;
}

void SendKey(WORD wKey, DWORD dwFlags) {
  INPUT input = {};
  input.type = INPUT_KEYBOARD;
  bool bUnicode = dwFlags & KEYEVENTF_UNICODE;
  input.ki.wVk = bUnicode ? 0 : wKey;
  input.ki.wScan = bUnicode ? wKey : static_cast<WORD>(MapVirtualKeyW(wKey, MAPVK_VK_TO_VSC));
  input.ki.dwFlags = dwFlags;
  SendInput(1, &input, sizeof(input));
}

// The text may be any character, whatever the keyboard layout.
void SendText(const std::wstring& wsText) {
  for (wchar_t c : wsText) {
    SendKey(c, KEYEVENTF_UNICODE);
    SendKey(c, KEYEVENTF_UNICODE | KEYEVENTF_KEYUP);
  }
}

void SendKeys(const std::vector<WORD>& keys) {
  for (WORD wKey : keys) SendKey(wKey, 0);
  for (auto it = keys.rbegin(); it != keys.rend(); ++it) SendKey(*it, KEYEVENTF_KEYUP);
}

// Every event carries the place: a late report of an earlier movement must not lead it elsewhere.
void SendMouse(POINT at, DWORD dwFlags) {
  const LONG lWidth = GetSystemMetrics(SM_CXSCREEN), lHeight = GetSystemMetrics(SM_CYSCREEN);
  INPUT input = {};
  input.type = INPUT_MOUSE;
  input.mi.dx = (at.x * 65536 + lWidth - 1) / lWidth;
  input.mi.dy = (at.y * 65536 + lHeight - 1) / lHeight;
  input.mi.dwFlags = dwFlags | MOUSEEVENTF_MOVE | MOUSEEVENTF_ABSOLUTE;
  SendInput(1, &input, sizeof(input));
}

// Returns when the window's thread has handled what was sent before.
void Settle(HWND hWindow) {
  DWORD_PTR result = 0;
  SendMessageTimeoutW(hWindow, WM_NULL, 0, 0, SMTO_ABORTIFHUNG, PATIENCE, &result);
}

template <typename Condition>
bool bWaitFor(Condition condition) {
  DWORD dwStart = GetTickCount();
  while (!condition()) {
    if (GetTickCount() - dwStart > PATIENCE) return false;
    Sleep(10);
  }
  return true;
}

bool bReachable(HWND hControl, POINT at) {
  HWND hHit = WindowFromPoint(at);
  if (hHit == hControl || IsChild(hControl, hHit)) return true;
  // A static text lets the mouse through to the window that it lies in.
  return _wcsicmp(ClassOf(hControl).c_str(), L"Static") == 0 && hHit == GetParent(hControl);
}

POINT MiddleOf(HWND hControl) {
  RECT rect = {};
  GetWindowRect(hControl, &rect);
  return {(rect.left + rect.right) / 2, (rect.top + rect.bottom) / 2};
}

// Two presses at one place within the double click time are one double click: whoever means two waits in between. Each
// press comes from a process of its own, so that its time is kept at the desktop.
const wchar_t* const LAST_PRESS = L"ui.LastPress";

void KeepApartFromLastPress() {
  const DWORD dwLast = PtrToUlong(GetPropW(GetDesktopWindow(), LAST_PRESS));
  const DWORD dwSince = GetTickCount() - dwLast, dwApart = GetDoubleClickTime() + 50;
  if (dwSince < dwApart) Sleep(dwApart - dwSince);
}

void NotePress() { SetPropW(GetDesktopWindow(), LAST_PRESS, ULongToPtr(GetTickCount())); }

// To a button the system's own messages are sent: a late report of an earlier movement of the mouse, which comes on a
// busy machine, cannot get in between them and lead the mouse off the button before it is let go.
void PostPress(HWND hButton) {
  RECT rect = {};
  GetClientRect(hButton, &rect);
  const LPARAM at = MAKELPARAM(rect.right / 2, rect.bottom / 2);
  PostMessageW(hButton, WM_LBUTTONDOWN, MK_LBUTTON, at);
  PostMessageW(hButton, WM_LBUTTONUP, 0, at);
}

}  // namespace

std::string Click(HWND hControl) {
  if (!bWaitFor([&] { return IsWindowVisible(hControl); })) return "the control is hidden";
  if (!bWaitFor([&] { return IsWindowEnabled(hControl) && IsWindowEnabled(GetAncestor(hControl, GA_ROOT)); }))
    return "the control is disabled";
  Settle(hControl);  // what its window does on coming up is done
  if (!bWaitFor([&] { return bReachable(hControl, MiddleOf(hControl)); }))
    return "something lies over the control, or it is outside the screen";
  KeepApartFromLastPress();
  if (_wcsicmp(ClassOf(hControl).c_str(), L"Button") == 0) {
    PostPress(hControl);
  } else {
    SendMouse(MiddleOf(hControl), 0);
    SendMouse(MiddleOf(hControl), MOUSEEVENTF_LEFTDOWN);
    SendMouse(MiddleOf(hControl), MOUSEEVENTF_LEFTUP);
  }
  NotePress();
  return "";
}

std::string TypeInto(HWND hControl, const std::wstring& wsText) {
  std::string sError = Click(hControl);
  if (!sError.empty()) return sError;
  const HWND hWindow = GetAncestor(hControl, GA_ROOT);
  if (!bWaitFor([&] { return hFocusOf(hControl) == hControl && GetForegroundWindow() == hWindow; }))
    return "the control did not take the focus";
  SendKeys({VK_HOME});
  SendKeys({VK_SHIFT, VK_END});
  SendKeys({VK_DELETE});
  SendText(wsText);
  if (!bWaitFor([&] { return WindowText(hControl) == wsText; })) return "the control did not take the text";
  return "";
}

std::string PressKey(HWND hWindow, const std::wstring& wsKey) {
  std::vector<WORD> keys;
  for (size_t from = 0; from <= wsKey.size();) {
    size_t plus = std::min(wsKey.find(L'+', from), wsKey.size());
    keys.push_back(KeyByName(wsKey.substr(from, plus - from)));
    if (!keys.back()) return "there is no key of this name";
    from = plus + 1;
  }
  if (!bWaitFor([&] { return GetForegroundWindow() == hWindow; })) return "the window is not in front";
  SendKeys(keys);
  return "";
}

void ParkMouse() { SendMouse({GetSystemMetrics(SM_CXSCREEN) - 1, GetSystemMetrics(SM_CYSCREEN) - 1}, 0); }
