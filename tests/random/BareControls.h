// What the system's own controls leave behind: Wine's calendars lose the font of each WM_SETFONT, its fields for IP
// addresses one font each.
#pragma once

#include <numeric>

#include "support/HighestHandle.h"
// after windows.h, which it builds on
#include <commctrl.h>

// How many objects there are more than before.
inline int iGrowth(const ObjectCounts& before, const ObjectCounts& after) {
  return std::accumulate(after.begin(), after.end(), 0) - std::accumulate(before.begin(), before.end(), 0);
}

// While it lives it counts the controls that the thread makes and the fonts that they are given. One at a time.
class BareControls {
 public:
  BareControls() : m_hHook(SetWindowsHookExW(WH_CALLWNDPROC, Watch, nullptr, GetCurrentThreadId())) {
    for (ClassRow& row : s_classes) row.nMade = row.nFonts = 0;
  }
  ~BareControls() { UnhookWindowsHookEx(m_hHook); }

  // Makes the same number of bare windows of the same classes, gives them as many fonts and destroys them: the number
  // of objects that are there afterwards and were not before.
  int iLeftBehind() const {
    const std::vector<ClassRow> classes(std::begin(s_classes), std::end(s_classes));  // the hook counts on
    const HWND hParent = CreateWindowW(L"STATIC", L"", 0, 0, 0, 300, 300, nullptr, nullptr, nullptr, nullptr);
    const ObjectCounts before = LiveObjects();
    for (const ClassRow& row : classes) MakeBare(row, hParent);
    const ObjectCounts after = LiveObjects();
    DestroyWindow(hParent);
    return iGrowth(before, after);
  }

 private:
  struct ClassRow {
    const wchar_t* szName;
    int nMade, nFonts;
  };
  static inline ClassRow s_classes[] = {{MONTHCAL_CLASSW, 0, 0}, {WC_IPADDRESSW, 0, 0}};

  static LRESULT CALLBACK Watch(int iCode, WPARAM wParam, LPARAM lParam) {
    const auto& message = *reinterpret_cast<const CWPSTRUCT*>(lParam);
    wchar_t name[32];
    if (iCode == HC_ACTION && (message.message == WM_CREATE || message.message == WM_SETFONT) &&
        GetClassNameW(message.hwnd, name, static_cast<int>(std::size(name))))
      for (ClassRow& row : s_classes)
        if (lstrcmpiW(row.szName, name) == 0) (message.message == WM_CREATE ? row.nMade : row.nFonts)++;
    return CallNextHookEx(nullptr, iCode, wParam, lParam);
  }

  // Each window gets its share of the fonts, so that there are never more windows at a time than one.
  static void MakeBare(const ClassRow& row, HWND hParent) {
    for (int i = 0; i < row.nMade; i++) {
      const HWND hWnd =
          CreateWindowW(row.szName, nullptr, WS_CHILD, 0, 0, 200, 150, hParent, nullptr, nullptr, nullptr);
      const int nFonts = row.nFonts * (i + 1) / row.nMade - row.nFonts * i / row.nMade;
      for (int k = 0; k < nFonts; k++)
        SendMessageW(hWnd, WM_SETFONT, reinterpret_cast<WPARAM>(GetStockObject(DEFAULT_GUI_FONT)), FALSE);
      DestroyWindow(hWnd);
    }
  }

  HHOOK m_hHook;
};
