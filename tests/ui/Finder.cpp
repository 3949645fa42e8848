#include "Finder.h"

#include <cwchar>
#include <cwctype>

namespace {

const UINT ANSWER_TIMEOUT = 2000;

BOOL CALLBACK Collect(HWND hWindow, LPARAM pList) {
  reinterpret_cast<std::vector<HWND>*>(pList)->push_back(hWindow);
  return TRUE;
}

bool bSameNoCase(const std::wstring& a, const std::wstring& b) { return _wcsicmp(a.c_str(), b.c_str()) == 0; }

std::wstring WithoutMnemonics(const std::wstring& wsText) {
  std::wstring wsPlain;
  for (size_t i = 0; i < wsText.size(); i++) {
    if (wsText[i] == L'&' && i + 1 < wsText.size()) i++;  // "&&" is one '&', "&N" is an underlined N
    wsPlain += wsText[i];
  }
  return wsPlain;
}

bool bHasId(HWND hControl, const std::wstring& wsNumber) {
  return GetDlgCtrlID(hControl) == wcstol(wsNumber.c_str(), nullptr, 10);
}

// "Edit:0" -> the class and the number; false when the text is not of that form.
bool bSplitClassIndex(const std::wstring& wsControl, std::wstring& wsClass, int& iIndex) {
  size_t colon = wsControl.rfind(L':');
  if (colon == std::wstring::npos || colon == 0 || colon + 1 == wsControl.size()) return false;
  for (size_t i = colon + 1; i < wsControl.size(); i++) {
    if (!iswdigit(wsControl[i])) return false;
  }
  wsClass = wsControl.substr(0, colon);
  iIndex = static_cast<int>(wcstol(wsControl.c_str() + colon + 1, nullptr, 10));
  return true;
}

HWND hFindByIndex(const std::vector<HWND>& controls, const std::wstring& wsClass, int iIndex) {
  for (HWND hControl : controls) {
    if (IsWindowVisible(hControl) && bSameNoCase(ClassOf(hControl), wsClass) && iIndex-- == 0) return hControl;
  }
  return nullptr;
}

}  // namespace

std::wstring Trimmed(const std::wstring& wsText) {
  size_t first = wsText.find_first_not_of(L" \t\r\n");
  if (first == std::wstring::npos) return L"";
  return wsText.substr(first, wsText.find_last_not_of(L" \t\r\n") - first + 1);
}

std::wstring WindowText(HWND hWindow) {
  // GetWindowText does not ask a control of another process; the message does.
  DWORD_PTR nLength = 0;
  if (!SendMessageTimeoutW(hWindow, WM_GETTEXTLENGTH, 0, 0, SMTO_ABORTIFHUNG, ANSWER_TIMEOUT, &nLength)) return L"";
  std::wstring wsText(nLength + 1, L'\0');
  DWORD_PTR nCopied = 0;
  if (!SendMessageTimeoutW(hWindow, WM_GETTEXT, wsText.size(), reinterpret_cast<LPARAM>(wsText.data()),
                           SMTO_ABORTIFHUNG, ANSWER_TIMEOUT, &nCopied)) {
    return L"";
  }
  wsText.resize(wcslen(wsText.c_str()));
  return wsText;
}

std::wstring ClassOf(HWND hWindow) {
  wchar_t szClass[256] = L"";
  GetClassNameW(hWindow, szClass, 256);
  return szClass;
}

std::vector<HWND> TopLevelWindows() {
  std::vector<HWND> all, visible;
  EnumWindows(Collect, reinterpret_cast<LPARAM>(&all));
  for (HWND hWindow : all) {
    if (IsWindowVisible(hWindow) && hWindow != GetDesktopWindow() && hWindow != GetShellWindow())
      visible.push_back(hWindow);
  }
  return visible;
}

HWND hFindWindow(const std::wstring& wsCaption) {
  std::wstring wsWanted = Trimmed(wsCaption);
  for (HWND hWindow : TopLevelWindows()) {
    std::wstring wsText = Trimmed(WindowText(hWindow));
    if (!wsText.empty() && wsText.compare(0, wsWanted.size(), wsWanted) == 0) return hWindow;
  }
  return nullptr;
}

std::vector<HWND> Controls(HWND hWindow) {
  std::vector<HWND> controls;
  EnumChildWindows(hWindow, Collect, reinterpret_cast<LPARAM>(&controls));
  return controls;
}

HWND hFindControl(HWND hWindow, const std::wstring& wsControl) {
  std::vector<HWND> controls = Controls(hWindow);
  std::wstring wsClass;
  int iIndex = 0;
  if (bSplitClassIndex(wsControl, wsClass, iIndex)) return hFindByIndex(controls, wsClass, iIndex);
  bool bId = wsControl.size() > 1 && wsControl[0] == L'#';
  HWND hHidden = nullptr;
  for (HWND hControl : controls) {
    bool bMatch = bId ? bHasId(hControl, wsControl.substr(1))
                      : Trimmed(WithoutMnemonics(WindowText(hControl))) == Trimmed(wsControl);
    if (bMatch && IsWindowVisible(hControl)) return hControl;
    if (bMatch && !hHidden) hHidden = hControl;
  }
  return hHidden;
}

HWND hFocusOf(HWND hWindow) {
  GUITHREADINFO info = {};
  info.cbSize = sizeof(info);
  return GetGUIThreadInfo(GetWindowThreadProcessId(hWindow, nullptr), &info) ? info.hwndFocus : nullptr;
}
