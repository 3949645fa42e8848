#include "window/SimpleWindows.h"

#include <cstring>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "wizard/WizardView.h"

void PrepareWithoutCaption(NativeControl&, CREATESTRUCTW& window) { window.lpszName = nullptr; }

void PrepareUnseen(NativeControl& native, CREATESTRUCTW& window) {
  native.m_bVisible = false;
  window.lpszClass = L"STATIC";
  window.lpszName = nullptr;
  window.style = WS_CHILD | SS_ICON;
  window.cx = window.cy = 0;
}

void ShowSource(NativeControl& native) {
  const char* szSource = Simple(native).szSource();
  if (*szSource) native.Kind().pSetText(native.hWnd(), szSource);
}

NativeEvent ChangeEvent(bool bChanged) {
  NativeEvent event;
  if (bChanged) event.iNotification = NOTIFY_SELECTION_CHANGED;
  return event;
}

bool bNumberText(LRESULT lNumber, CNString& csText) {
  return csText.Printf("bNumberText", "csText", "%d", static_cast<int>(lNumber)) != nullptr;
}

void AppendDate(const SYSTEMTIME& date, CNString& csText) {
  CNString csDate;
  csText.Concat(csDate.Printf("AppendDate", "csDate", "%04d-%02d-%02d", date.wYear, date.wMonth, date.wDay));
}

void TakeDate(const int (&numbers)[3], SYSTEMTIME& date) {
  date.wYear = static_cast<WORD>(numbers[0]);
  date.wMonth = static_cast<WORD>(numbers[1]);
  date.wDay = static_cast<WORD>(numbers[2]);
}

bool bFindScriptFile(const char* szName, CNString& csPath) {
  if (bFindPictureFile(szName, csPath)) return true;
  if (!bOsGetProgramPath(csPath)) return false;
  csPath.Trim('\\');
  csPath.AddSlash();
  csPath.Concat(szName);
  if (bOsExists(csPath.Text())) return true;
  csPath = szName;
  // What lies in the working folder is not the script's own.
  const bool bWorkingFolder = !strchr(szName, ':') && strncmp(szName, "\\\\", 2) != 0;
  return !(bWorkingFolder && bOnlyPictureFolder()) && bOsExists(szName);
}

HMODULE hSystemLibrary(const wchar_t* szName) {
  wchar_t path[MAX_PATH + 32];
  const UINT uLength = GetSystemDirectoryW(path, MAX_PATH);
  if (!uLength || uLength >= MAX_PATH || lstrlenW(szName) > 30) return nullptr;
  path[uLength] = L'\\';
  lstrcpyW(path + uLength + 1, szName);
  return LoadLibraryW(path);
}

void DropTheme(HWND hWnd) {
  const auto pSetTheme = pSystemFunction<HRESULT(WINAPI*)(HWND, LPCWSTR, LPCWSTR)>(L"uxtheme.dll", "SetWindowTheme");
  if (pSetTheme) pSetTheme(hWnd, L"", L"");
}
