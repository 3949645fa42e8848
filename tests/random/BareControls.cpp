#include "BareControls.h"

#include <commctrl.h>

#include <numeric>

namespace {

struct ClassRow {
  const wchar_t* szName;
  int nMade = 0, nFonts = 0;
};

ClassRow g_classes[] = {{MONTHCAL_CLASSW}, {WC_IPADDRESSW}};

ClassRow* pClassOf(HWND hWnd) {
  wchar_t name[32];
  if (!GetClassNameW(hWnd, name, static_cast<int>(std::size(name)))) return nullptr;
  for (ClassRow& row : g_classes)
    if (lstrcmpiW(row.szName, name) == 0) return &row;
  return nullptr;
}

// Each window gets its share of the fonts, so that there are never more windows at a time than one.
void MakeBare(const ClassRow& row, HWND hParent) {
  for (int i = 0; i < row.nMade; i++) {
    const HWND hWnd = CreateWindowW(row.szName, nullptr, WS_CHILD, 0, 0, 200, 150, hParent, nullptr, nullptr, nullptr);
    const int nFonts = row.nFonts * (i + 1) / row.nMade - row.nFonts * i / row.nMade;
    for (int k = 0; k < nFonts; k++)
      SendMessageW(hWnd, WM_SETFONT, reinterpret_cast<WPARAM>(GetStockObject(DEFAULT_GUI_FONT)), FALSE);
    DestroyWindow(hWnd);
  }
}

}  // namespace

BareControls::BareControls() : m_hHook(SetWindowsHookExW(WH_CALLWNDPROC, Watch, nullptr, GetCurrentThreadId())) {
  for (ClassRow& row : g_classes) row.nMade = row.nFonts = 0;
}

BareControls::~BareControls() { UnhookWindowsHookEx(m_hHook); }

LRESULT CALLBACK BareControls::Watch(int iCode, WPARAM wParam, LPARAM lParam) {
  const auto& message = *reinterpret_cast<const CWPSTRUCT*>(lParam);
  if (iCode == HC_ACTION && (message.message == WM_CREATE || message.message == WM_SETFONT))
    if (ClassRow* pClass = pClassOf(message.hwnd)) (message.message == WM_CREATE ? pClass->nMade : pClass->nFonts)++;
  return CallNextHookEx(nullptr, iCode, wParam, lParam);
}

int BareControls::iLeftBehind() const {
  // The hook counts on.
  const std::vector<ClassRow> classes(std::begin(g_classes), std::end(g_classes));
  const HWND hParent = CreateWindowW(L"STATIC", L"", 0, 0, 0, 300, 300, nullptr, nullptr, nullptr, nullptr);
  const ObjectCounts before = LiveObjects();
  for (const ClassRow& row : classes) MakeBare(row, hParent);
  const ObjectCounts after = LiveObjects();
  DestroyWindow(hParent);
  return iGrowth(before, after);
}

int iGrowth(const ObjectCounts& before, const ObjectCounts& after) {
  return std::accumulate(after.begin(), after.end(), 0) - std::accumulate(before.begin(), before.end(), 0);
}
