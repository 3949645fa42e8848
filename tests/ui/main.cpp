// ui.exe: presses the controls of another program's windows as a person would, by mouse and keyboard.
//
//   ui [--desktop NAME] VERB [ARGUMENT...]
//
// A window is named by the beginning of its caption; how a control is named is told in Finder.h. The exit code is 0, or
// 1 with one line on the error output that says what was not as asked. Run without arguments for the verbs.
#include <windows.h>
// after windows.h
#include <fcntl.h>
#include <io.h>

#include <cstdio>
#include <cwchar>
#include <string>
#include <vector>

#include "Finder.h"
#include "Input.h"
#include "ShellLink.h"

namespace {

using Arguments = std::vector<std::wstring>;

const DWORD PATIENCE = 30000;  // milliseconds: a busy machine must not make a test fail

std::string Utf8(const std::wstring& wsText) {
  int iLength =
      WideCharToMultiByte(CP_UTF8, 0, wsText.data(), static_cast<int>(wsText.size()), nullptr, 0, nullptr, nullptr);
  std::string sText(static_cast<size_t>(iLength), '\0');
  WideCharToMultiByte(CP_UTF8, 0, wsText.data(), static_cast<int>(wsText.size()), sText.data(), iLength, nullptr,
                      nullptr);
  return sText;
}

int iFail(const std::string& sWhy) {
  fprintf(stderr, "ui: %s\n", sWhy.c_str());
  return 1;
}

DWORD MillisecondsOr(const Arguments& args, size_t nAt, DWORD dwDefault) {
  return args.size() > nAt ? wcstoul(args[nAt].c_str(), nullptr, 10) : dwDefault;
}

template <typename Condition>
bool bWithin(DWORD dwMilliseconds, Condition condition) {
  DWORD dwStart = GetTickCount();
  while (!condition()) {
    if (GetTickCount() - dwStart >= dwMilliseconds) return false;
    Sleep(15);
  }
  return true;
}

std::string TitlesNow() {
  std::string sTitles;
  for (HWND hWindow : TopLevelWindows()) {
    std::wstring wsText = WindowText(hWindow);
    if (!wsText.empty()) sTitles += " \"" + Utf8(wsText) + "\"";
  }
  return sTitles.empty() ? " none" : sTitles;
}

// Runs the action on the window, and on the control when one is named, waiting a little for both to be there.
template <typename Action>
int iWithControl(const Arguments& args, Action action) {
  HWND hWindow = nullptr, hControl = nullptr;
  if (!bWithin(20000, [&] { return (hWindow = hFindWindow(args[0])) != nullptr; }))
    return iFail("no window \"" + Utf8(args[0]) + "\"; there are:" + TitlesNow());
  if (args.size() > 1 && !bWithin(10000, [&] { return (hControl = hFindControl(hWindow, args[1])) != nullptr; }))
    return iFail("window \"" + Utf8(args[0]) + "\" has no control \"" + Utf8(args[1]) + "\"");
  std::string sError = action(hWindow, hControl);
  return sError.empty() ? 0 : iFail("\"" + Utf8(args[0]) + "\": " + sError);
}

int iWait(const Arguments& args) {
  HWND hWindow = nullptr;
  if (!bWithin(MillisecondsOr(args, 1, PATIENCE), [&] { return (hWindow = hFindWindow(args[0])) != nullptr; }))
    return iFail("window \"" + Utf8(args[0]) + "\" did not appear; there are:" + TitlesNow());
  DWORD_PTR result = 0;  // until its thread answers, so that what it does on showing is done
  SendMessageTimeoutW(hWindow, WM_NULL, 0, 0, SMTO_ABORTIFHUNG, 5000, &result);
  return 0;
}

int iGone(const Arguments& args) {
  if (bWithin(MillisecondsOr(args, 1, PATIENCE), [&] { return !hFindWindow(args[0]); })) return 0;
  return iFail("window \"" + Utf8(args[0]) + "\" is still there");
}

// Prints the caption that came first, as it was given.
int iFirst(const Arguments& args) {
  const std::wstring* pFound = nullptr;
  auto bAny = [&] {
    for (const std::wstring& wsCaption : args) {
      if (hFindWindow(wsCaption)) pFound = &wsCaption;
    }
    return pFound != nullptr;
  };
  if (!bWithin(PATIENCE, bAny)) return iFail("no such window appeared; there are:" + TitlesNow());
  printf("%s\n", Utf8(*pFound).c_str());
  return 0;
}

int iClick(const Arguments& args) {
  return iWithControl(args, [](HWND, HWND hControl) { return Click(hControl); });
}

int iType(const Arguments& args) {
  return iWithControl({args[0], args[1]}, [&](HWND, HWND hControl) { return TypeInto(hControl, args[2]); });
}

int iKey(const Arguments& args) {
  return iWithControl({args[0]}, [&](HWND hWindow, HWND) { return PressKey(hWindow, args[1]); });
}

// Without a control: the window's own text.
int iText(const Arguments& args) {
  return iWithControl(args, [](HWND hWindow, HWND hControl) {
    printf("%s\n", Utf8(WindowText(hControl ? hControl : hWindow)).c_str());
    return std::string();
  });
}

int iClose(const Arguments& args) {
  return iWithControl(args, [](HWND hWindow, HWND) {
    if (!IsWindowEnabled(hWindow)) return std::string("the window is disabled");
    PostMessageW(hWindow, WM_SYSCOMMAND, SC_CLOSE, 0);
    return std::string();
  });
}

std::string OneLine(std::string sText) {
  for (char& c : sText) {
    if (c == '\r' || c == '\n') c = ' ';
  }
  return sText;
}

void PrintControl(HWND hControl, bool bFocused) {
  RECT rect = {};
  GetWindowRect(hControl, &rect);
  MapWindowPoints(nullptr, GetAncestor(hControl, GA_ROOT), reinterpret_cast<POINT*>(&rect), 2);
  LONG lStyle = GetWindowLongW(hControl, GWL_STYLE);
  bool bChecked = ClassOf(hControl) == L"Button" && SendMessageW(hControl, BM_GETCHECK, 0, 0) == BST_CHECKED;
  printf("%-18s #%-5d %4ld,%4ld %4ldx%-4ld style=%08lx%s%s%s%s \"%s\"\n", Utf8(ClassOf(hControl)).c_str(),
         GetDlgCtrlID(hControl), rect.left, rect.top, rect.right - rect.left, rect.bottom - rect.top,
         static_cast<unsigned long>(lStyle), IsWindowVisible(hControl) ? "" : " hidden",
         IsWindowEnabled(hControl) ? "" : " disabled", bChecked ? " checked" : "", bFocused ? " focus" : "",
         OneLine(Utf8(WindowText(hControl))).c_str());
}

int iList(const Arguments& args) {
  return iWithControl(args, [](HWND hWindow, HWND) {
    HWND hFocus = hFocusOf(hWindow);
    for (HWND hControl : Controls(hWindow)) PrintControl(hControl, hControl == hFocus);
    return std::string();
  });
}

int iWindows(const Arguments&) {
  for (HWND hWindow : TopLevelWindows()) {
    RECT rect = {};
    GetWindowRect(hWindow, &rect);
    printf("%-22s %4ld,%4ld %4ldx%-4ld%s \"%s\"\n", Utf8(ClassOf(hWindow)).c_str(), rect.left, rect.top,
           rect.right - rect.left, rect.bottom - rect.top, IsWindowEnabled(hWindow) ? "" : " disabled",
           Utf8(WindowText(hWindow)).c_str());
  }
  return 0;
}

int iLink(const Arguments& args) {
  ShellLink link;
  if (!bReadShellLink(args[0], link)) return iFail("\"" + Utf8(args[0]) + "\" is no shortcut");
  printf("target=%s\narguments=%s\nfolder=%s\n", Utf8(link.wsTarget).c_str(), Utf8(link.wsArguments).c_str(),
         Utf8(link.wsFolder).c_str());
  return 0;
}

int iStat(const Arguments& args) {
  int iResult = 0;
  for (const std::wstring& wsPath : args) {
    WIN32_FILE_ATTRIBUTE_DATA data = {};
    if (!GetFileAttributesExW(wsPath.c_str(), GetFileExInfoStandard, &data)) {
      iResult = iFail("no file \"" + Utf8(wsPath) + "\"");
      continue;
    }
    printf("%08lx %08lx %08lx %lu %s\n", data.dwFileAttributes, data.ftLastAccessTime.dwHighDateTime,
           data.ftLastWriteTime.dwHighDateTime, data.nFileSizeLow, Utf8(wsPath).c_str());
  }
  return iResult;
}

int iPark(const Arguments&) {
  ParkMouse();
  return 0;
}

// On this thread's desktop, with this program's own output.
int iRun(const Arguments& args) {
  std::wstring wsCommand;
  for (size_t i = 1; i < args.size(); i++) {
    bool bQuote = args[i].empty() || args[i].find(L' ') != std::wstring::npos;
    wsCommand += (i > 1 ? L" " : L"") + (bQuote ? L"\"" + args[i] + L"\"" : args[i]);
  }
  wchar_t szDesktop[256] = L"";
  GetUserObjectInformationW(GetThreadDesktop(GetCurrentThreadId()), UOI_NAME, szDesktop, sizeof(szDesktop), nullptr);
  STARTUPINFOW start = {};
  start.cb = sizeof(start);
  start.lpDesktop = szDesktop;
  PROCESS_INFORMATION process = {};
  if (!CreateProcessW(nullptr, wsCommand.data(), nullptr, nullptr, TRUE, 0, nullptr, args[0].c_str(), &start, &process))
    return iFail("cannot start " + Utf8(wsCommand) + " (error " + std::to_string(GetLastError()) + ")");
  WaitForSingleObject(process.hProcess, INFINITE);
  DWORD dwCode = 0;
  GetExitCodeProcess(process.hProcess, &dwCode);
  printf("exit code %ld\n", static_cast<long>(dwCode));
  return dwCode != 0;
}

int iHold(const Arguments&) {
  Sleep(INFINITE);
  return 0;
}

struct Verb {
  const wchar_t* szName;
  size_t nLeast, nMost;
  int (*pRun)(const Arguments& args);
  const char* szHelp;
};

const Verb VERBS[] = {
    {L"wait", 1, 2, iWait, "WINDOW [MS]           until the window is there (30000)"},
    {L"first", 2, 9, iFirst, "WINDOW WINDOW...      until one of them is there; prints which"},
    {L"gone", 1, 2, iGone, "WINDOW [MS]           until no such window is there (30000)"},
    {L"click", 2, 2, iClick, "WINDOW CONTROL        the left mouse button"},
    {L"type", 3, 3, iType, "WINDOW CONTROL TEXT   click into it and type over what it holds"},
    {L"key", 2, 2, iKey, "WINDOW KEY            e.g. Enter, Alt+F4; the window must be in front"},
    {L"text", 1, 2, iText, "WINDOW [CONTROL]      prints the text in UTF-8"},
    {L"list", 1, 1, iList, "WINDOW                prints its controls"},
    {L"close", 1, 1, iClose, "WINDOW                the close box"},
    {L"windows", 0, 0, iWindows, "                      prints the visible windows"},
    {L"park", 0, 0, iPark, "                      moves the mouse out of the picture"},
    {L"hold", 0, 0, iHold,
     "                      keeps the desktop, which ends a second after its last program, until killed"},
    {L"run", 2, 99, iRun, "FOLDER PROGRAM [ARGUMENT...]  runs it in that folder and prints its exit code"},
    {L"link", 1, 1, iLink, "FILE                  prints where a shortcut leads"},
    {L"stat", 1, 999, iStat, "FILE...               attributes, access and write time (upper halves), size"},
};

int iUsage() {
  fprintf(stderr, "usage: ui [--desktop NAME] VERB [ARGUMENT...]\n");
  for (const Verb& verb : VERBS) fprintf(stderr, "  %-8s %s\n", Utf8(verb.szName).c_str(), verb.szHelp);
  return 1;
}

// The windows of a virtual desktop are out of reach for a thread of another one. Must come before any window call.
bool bEnterDesktop(const std::wstring& wsName) {
  HDESK hDesktop = OpenDesktopW(wsName.c_str(), 0, FALSE, GENERIC_ALL);
  return hDesktop && SetThreadDesktop(hDesktop);
}

}  // namespace

int wmain(int argc, wchar_t** argv) {
  _setmode(_fileno(stdout), _O_BINARY);  // host scripts read it: no carriage returns
  Arguments args(argv + 1, argv + argc);
  if (args.size() > 1 && args[0] == L"--desktop") {
    if (!bWithin(10000, [&] { return bEnterDesktop(args[1]); }))
      return iFail("no desktop \"" + Utf8(args[1]) + "\" (error " + std::to_string(GetLastError()) + ")");
    args.erase(args.begin(), args.begin() + 2);
  }
  for (const Verb& verb : VERBS) {
    if (args.empty() || args[0] != verb.szName) continue;
    args.erase(args.begin());
    return args.size() < verb.nLeast || args.size() > verb.nMost ? iUsage() : verb.pRun(args);
  }
  return iUsage();
}
