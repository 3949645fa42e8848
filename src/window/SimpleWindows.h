// What the native halves of several kinds share: values that are numbers and dates, files that a line names, functions
// of the system that are looked up when they are needed. DropTheme serves every kind whose themed look has no colours.
#pragma once

#include "controls/SimpleKinds.h"
#include "window/NativeControls.h"

inline const CNSimpleControl& Simple(const NativeControl& native) {
  return static_cast<const CNSimpleControl&>(native.Control());
}

// Leaves the caption out: it is a value or a file, and would be read out as the field's name.
void PrepareWithoutCaption(NativeControl& native, CREATESTRUCTW& window);
// For a kind without a window class: a window that nobody sees. It lives as long as its dialog and can be shown and
// hidden by its name.
void PrepareUnseen(NativeControl& native, CREATESTRUCTW& window);
// Gives the window the value that its line names, when it names one.
void ShowSource(NativeControl& native);
// The event of a value that changed, or none.
NativeEvent ChangeEvent(bool bChanged);

// csText becomes the number; true.
bool bNumberText(LRESULT lNumber, CNString& csText);
// Appends "2026-11-21".
void AppendDate(const SYSTEMTIME& date, CNString& csText);
// Year, month, day.
void TakeDate(const int (&numbers)[3], SYSTEMTIME& date);

// Looks for a file in the folder pict, beside the program and at the place itself. False when it is nowhere.
bool bFindScriptFile(const char* szName, CNString& csPath);
// Loads a library by its full path in the system's folder; it stays loaded. Null when there is none.
HMODULE hSystemLibrary(const wchar_t* szName);
template <class Function>
Function pSystemFunction(const wchar_t* szLibrary, const char* szName) {
  const HMODULE hLibrary = hSystemLibrary(szLibrary);
  return hLibrary ? reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(hLibrary, szName))) : nullptr;
}
// Gives the control its look without visual styles, in which it can have colours of its own.
void DropTheme(HWND hWnd);
// The procedure of the window's class, behind one that a unit has put before it.
inline LRESULT CallClassProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  return CallWindowProcW(reinterpret_cast<WNDPROC>(GetClassLongPtrW(hWnd, GCLP_WNDPROC)), hWnd, uMessage, wParam,
                         lParam);
}
inline void PutBefore(HWND hWnd, WNDPROC pProc) {
  SetWindowLongPtrW(hWnd, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(pProc));
}
