// Plumo.exe: a small reader of plain texts.
//
//   Plumo.exe [FILE]
//
// The user's name comes from config.ini beside the program and stands in the title and the about box.
#include <windows.h>
// after windows.h
#include <commdlg.h>
#include <shellapi.h>

#include <cstring>

#include "TextFile.h"
#include "foundation/CNConfigFile.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "resource.h"

namespace {

const wchar_t WINDOW_CLASS[] = L"PlumoWindow";

struct Reader {
  HINSTANCE hInstance = nullptr;
  HWND hWindow = nullptr;
  HWND hText = nullptr;
  CNString csUser;
  CNString csFileName;
};

// Without looking first, the configuration file object would make a missing one.
void ReadUserName(CNString& csUser) {
  CNString csPath;
  if (!bOsGetProgramPath(csPath)) return;
  csPath.Trim('\\');
  csPath.Concat("\\config.ini");
  if (bOsExists(csPath.Text())) CNConfigFile(csPath.Text()).iReadConfigString("User", csUser);
}

void UpdateTitle(Reader& reader) {
  CNString csTitle;
  if (!reader.csFileName.bEmpty()) {
    csTitle.Concat(reader.csFileName.Text());
    csTitle.Concat(" - ");
  }
  csTitle.Concat("Plumo");
  if (!reader.csUser.bEmpty()) {
    csTitle.Concat(" - ");
    csTitle.Concat(reader.csUser.Text());
  }
  SetWindowTextW(reader.hWindow, Wide(csTitle.Text()));
}

struct FailureText {
  TextFileResult result;
  const wchar_t* szText;
};

const FailureText FAILURES[] = {
    {TextFileResult::CannotOpen, L"The file cannot be opened:\n\n"},
    {TextFileResult::TooLong, L"The file is longer than 16 MB:\n\n"},
    {TextFileResult::NoMemory, L"There is not enough memory for the file:\n\n"},
};

void ShowFailure(Reader& reader, TextFileResult result, const wchar_t* szPath) {
  wchar_t szText[MAX_PATH + 64] = L"";
  for (const FailureText& row : FAILURES) {
    if (row.result == result) lstrcpynW(szText, row.szText, 64);
  }
  lstrcpynW(szText + lstrlenW(szText), szPath, MAX_PATH);
  MessageBoxW(reader.hWindow, szText, L"Plumo", MB_OK | MB_ICONERROR);
}

void OpenText(Reader& reader, const wchar_t* szPath) {
  WideText text;
  TextFileResult result = ReadTextFile(szPath, text);
  if (result != TextFileResult::Read) return ShowFailure(reader, result, szPath);
  SetWindowTextW(reader.hText, text.Ptr());
  const wchar_t* pName = wcsrchr(szPath, L'\\');
  bNarrow(pName ? pName + 1 : szPath, reader.csFileName);
  UpdateTitle(reader);
}

void OnFileOpen(Reader& reader) {
  wchar_t szPath[MAX_PATH] = L"";
  OPENFILENAMEW choice = {};
  choice.lStructSize = sizeof(choice);
  choice.hwndOwner = reader.hWindow;
  choice.lpstrFilter = L"Texts (*.txt)\0*.txt\0All files\0*.*\0";
  choice.lpstrFile = szPath;
  choice.nMaxFile = MAX_PATH;
  choice.Flags = OFN_FILEMUSTEXIST | OFN_HIDEREADONLY;
  if (GetOpenFileNameW(&choice)) OpenText(reader, szPath);
}

void OnFileExit(Reader& reader) { SendMessageW(reader.hWindow, WM_CLOSE, 0, 0); }

void OnHelpAbout(Reader& reader) {
  CNString csText("Plumo 1.0\nA reader of plain texts.\n\nThis copy belongs to: ", 0);
  csText.Concat(reader.csUser.bEmpty() ? "(nobody)" : reader.csUser.Text());
  MessageBoxW(reader.hWindow, Wide(csText.Text()), L"About Plumo", MB_OK | MB_ICONINFORMATION);
}

struct Command {
  int iID;
  void (*pRun)(Reader& reader);
};

const Command COMMANDS[] = {
    {ID_FILE_OPEN, OnFileOpen},
    {ID_FILE_EXIT, OnFileExit},
    {ID_HELP_ABOUT, OnHelpAbout},
};

void OnCreate(Reader& reader) {
  const DWORD dwStyle =
      WS_CHILD | WS_VISIBLE | WS_VSCROLL | WS_HSCROLL | ES_MULTILINE | ES_READONLY | ES_AUTOVSCROLL | ES_AUTOHSCROLL;
  reader.hText = CreateWindowExW(WS_EX_CLIENTEDGE, L"EDIT", L"", dwStyle, 0, 0, 0, 0, reader.hWindow, nullptr,
                                 reader.hInstance, nullptr);
  SendMessageW(reader.hText, EM_SETLIMITTEXT, MAX_TEXT_FILE, 0);
  SendMessageW(reader.hText, WM_SETFONT, reinterpret_cast<WPARAM>(GetStockObject(DEFAULT_GUI_FONT)), TRUE);
}

LRESULT CALLBACK WindowProcedure(HWND hWindow, UINT uMessage, WPARAM wParam, LPARAM lParam) {
  auto pReader = reinterpret_cast<Reader*>(GetWindowLongPtrW(hWindow, GWLP_USERDATA));
  if (uMessage == WM_NCCREATE) {
    pReader = static_cast<Reader*>(reinterpret_cast<CREATESTRUCTW*>(lParam)->lpCreateParams);
    pReader->hWindow = hWindow;
    SetWindowLongPtrW(hWindow, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(pReader));
  }
  if (uMessage == WM_CREATE) OnCreate(*pReader);
  if (uMessage == WM_SIZE) MoveWindow(pReader->hText, 0, 0, LOWORD(lParam), HIWORD(lParam), TRUE);
  if (uMessage == WM_SETFOCUS) SetFocus(pReader->hText);
  if (uMessage == WM_DESTROY) PostQuitMessage(0);
  if (uMessage == WM_COMMAND) {
    for (const Command& command : COMMANDS) {
      if (command.iID == LOWORD(wParam)) command.pRun(*pReader);
    }
  }
  return DefWindowProcW(hWindow, uMessage, wParam, lParam);
}

bool bMakeWindow(Reader& reader) {
  WNDCLASSW windowClass = {};
  windowClass.lpfnWndProc = WindowProcedure;
  windowClass.hInstance = reader.hInstance;
  windowClass.hIcon = LoadIconW(reader.hInstance, MAKEINTRESOURCEW(IDI_PLUMO));
  windowClass.hCursor = LoadCursorW(nullptr, IDC_ARROW);
  windowClass.lpszMenuName = MAKEINTRESOURCEW(IDR_MENU);
  windowClass.lpszClassName = WINDOW_CLASS;
  return RegisterClassW(&windowClass) &&
         CreateWindowExW(0, WINDOW_CLASS, L"Plumo", WS_OVERLAPPEDWINDOW, CW_USEDEFAULT, CW_USEDEFAULT, 640, 480,
                         nullptr, nullptr, reader.hInstance, &reader);
}

void OpenArgument(Reader& reader) {
  int iCount = 0;
  wchar_t** ppArguments = CommandLineToArgvW(GetCommandLineW(), &iCount);
  if (ppArguments && iCount > 1) OpenText(reader, ppArguments[1]);
  LocalFree(ppArguments);
}

}  // namespace

int WINAPI wWinMain(HINSTANCE hInstance, HINSTANCE, LPWSTR, int iShow) {
  SetDllDirectoryW(L"");
  Reader reader;
  reader.hInstance = hInstance;
  ReadUserName(reader.csUser);
  if (!bMakeWindow(reader)) return 1;
  UpdateTitle(reader);
  ShowWindow(reader.hWindow, iShow);
  OpenArgument(reader);
  HACCEL hKeys = LoadAcceleratorsW(hInstance, MAKEINTRESOURCEW(IDR_KEYS));
  MSG message;
  while (GetMessageW(&message, nullptr, 0, 0) > 0) {
    if (TranslateAcceleratorW(reader.hWindow, hKeys, &message)) continue;
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
  return 0;
}
