#include "Page.h"

#include <cstring>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "support/TestFolder.h"

Page::Page(DialogKind kind, const char* szHeader, const char* szControls, double dScale) : m_Controls(szControls) {
  ScriptContext context{&m_Report, &m_Variables, dScale};
  info.m_Kind = kind;
  info.m_Font.csFace = "Arial";
  info.m_Font.iHeight = 15;
  info.m_Font.iWeight = 500;
  info.ReadHeader(szHeader, szHeader + strlen(szHeader), context);
  info.ReadControls(m_Controls.data(), m_Controls.data() + m_Controls.size(), context);
}

BaseControl& Page::operator[](const char* szName) const {
  BaseControl* pControl = info.GetBaseControl(szName);
  if (!pControl) ADD_FAILURE() << "no control " << szName;
  return *pControl;
}

Screen::Screen(WizardView* pOwner, const char* szConfigurationFile, Layout layout, bool bModeless)
    : view(pMakeWin32View(GetModuleHandleW(nullptr), pOwner)) {
  if (layout != Layout::NotSaid) view->SetPixelLayout(layout == Layout::Pixels);
  static int iScreens = 0;
  m_ClassName = "OrbitTestClass" + std::to_string(++iScreens);
  WizardWindowOptions options;
  options.szClassName = m_ClassName.c_str();
  options.szConfigurationFile = szConfigurationFile;
  options.bModeless = bModeless;
  EXPECT_TRUE(view->bOpenWindow(wizard, options));
}

bool bWaitFor(const std::function<bool()>& condition) {
  const DWORD HALF_A_MINUTE = 30000, dwStart = GetTickCount();
  for (; !condition(); Sleep(10)) {
    if (GetTickCount() - dwStart > HALF_A_MINUTE) return false;
    MSG message;
    while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) DispatchMessageW(&message);
  }
  return true;
}

// It has its caption before its buttons, and is visible when it has all.
HWND hWaitForDialog(const wchar_t* szCaption) {
  HWND hFound = nullptr;
  bWaitFor([&] { return (hFound = FindWindowW(L"#32770", szCaption)) && IsWindowVisible(hFound); });
  EXPECT_NE(hFound, nullptr);
  return hFound;
}

void Screen::Show(Page& page) {
  ASSERT_TRUE(view->bCreateDialog(page.info));
  for (int i = 0; i < page.info.m_Controls.Size(); i++) Fill(*page.info.m_Controls[i]);
  view->ShowDialog();
}

void Screen::Fill(const BaseControl& control) {
  CNCharArray texts;
  if (control.bItemTexts(texts)) view->bSetItems(control, texts);
}

std::string Screen::Value(const BaseControl& control) const {
  CNString csText;
  return view->bGetText(control, csText) ? csText.Text() : "(no window)";
}

HWND Screen::hWindow() const { return FindWindowW(Wide(m_ClassName.c_str()), nullptr); }

namespace {

struct Search {
  const wchar_t* szText;
  const wchar_t* szClass;
  HWND hFound;
};

HWND hFindByID(HWND hParent, int iID) {
  HWND hFound = GetDlgItem(hParent, iID);
  for (HWND hChild = GetWindow(hParent, GW_CHILD); hChild && !hFound; hChild = GetWindow(hChild, GW_HWNDNEXT))
    hFound = hFindByID(hChild, iID);
  return hFound;
}

BOOL CALLBACK Compare(HWND hWnd, LPARAM lParam) {
  auto& search = *reinterpret_cast<Search*>(lParam);
  wchar_t name[64] = L"";
  GetClassNameW(hWnd, name, 64);
  const bool bMatch = search.szText ? TextOf(hWnd) == search.szText : lstrcmpiW(name, search.szClass) == 0;
  if (bMatch) search.hFound = hWnd;
  return !bMatch;
}

HWND hFind(HWND hParent, const wchar_t* szText, const wchar_t* szClass) {
  Search search = {szText, szClass, nullptr};
  EnumChildWindows(hParent, Compare, reinterpret_cast<LPARAM>(&search));
  return search.hFound;
}

}  // namespace

HWND Screen::hOf(const BaseControl& control) const { return hFindByID(hWindow(), control.m_iID); }
HWND Screen::hChild(const wchar_t* szText) const { return hFind(hWindow(), szText, nullptr); }
HWND Screen::hChildOfClass(const wchar_t* szClass) const { return hFind(hWindow(), nullptr, szClass); }

void Screen::Key(WPARAM wKey) {
  const HWND hFocus = GetFocus();
  PostMessageW(hFocus ? hFocus : hWindow(), WM_KEYDOWN, wKey, 1);
  PostMessageW(hFocus ? hFocus : hWindow(), WM_KEYUP, wKey, static_cast<LPARAM>(0xC0000001u));
}

void Screen::Press(std::initializer_list<WPARAM> keys) {
  for (const WPARAM wKey : keys) {
    Key(wKey);
    RunQueued();
  }
}

// The loop ends with the window only, so the queue is emptied message by message as the loop would.
void Screen::RunQueued() {
  const auto before = wizard.onEvent;
  const std::string end = "command " + std::to_string(END_OF_QUEUE);
  wizard.onEvent = [&](const std::string& event) {
    MSG later;  // what the view has told itself meanwhile
    if (event == end && PeekMessageW(&later, nullptr, WM_APP, 0xBFFF, PM_NOREMOVE))
      view->PostCommand(END_OF_QUEUE);
    else if (event == end)
      PostQuitMessage(0);
    if (event != end && before) before(event);
  };
  view->PostCommand(END_OF_QUEUE);
  view->iRun();
  MSG message;
  while (PeekMessageW(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE)) {
  }
  wizard.onEvent = before;
}

std::vector<std::string> Screen::TakeEvents() {
  std::vector<std::string> taken;
  for (const std::string& event : wizard.events)
    if (event != "command " + std::to_string(END_OF_QUEUE)) taken.push_back(event);
  wizard.events.clear();
  return taken;
}

std::wstring TextOf(HWND hWnd) {
  std::wstring text(static_cast<size_t>(GetWindowTextLengthW(hWnd)) + 1, L'\0');
  text.resize(static_cast<size_t>(GetWindowTextW(hWnd, text.data(), static_cast<int>(text.size()))));
  return text;
}

COLORREF PixelOf(HWND hWnd, int x, int y) {
  UpdateWindow(hWnd);
  const HDC hDC = GetDC(hWnd);
  const COLORREF color = GetPixel(hDC, x, y);
  ReleaseDC(hWnd, hDC);
  return color;
}

void WritePicture(const char* szName, CNString& csPath) {
  ASSERT_TRUE(bOsGetProgramPath(csPath));
  csPath.Trim('\\');
  csPath.Concat("\\pict");
  OsMakeFolder(csPath.Text());
  csPath.Concat("\\");
  csPath.Concat(szName);
  std::string bytes(54, '\0');
  const std::pair<size_t, char> HEADER[] = {{0, 'B'}, {1, 'M'}, {2, 78}, {10, 54}, {14, 40},
                                            {18, 4},  {22, 2},  {26, 1}, {28, 24}, {34, 24}};
  for (const auto& [nAt, cByte] : HEADER) bytes[nAt] = cByte;
  for (int i = 0; i < 8; i++) bytes += i % 4 < 2 ? std::string("\0\0\xFF", 3) : "\xCC\xCC\xCC";
  TestFolder::WriteFile(csPath.Text(), bytes);
}

RECT AreaOf(HWND hWnd, HWND hWithin) {
  RECT area;
  GetWindowRect(hWnd, &area);
  MapWindowPoints(nullptr, hWithin, reinterpret_cast<POINT*>(&area), 2);
  return area;
}

SIZE ClientOf(HWND hWnd) {
  RECT client;
  GetClientRect(hWnd, &client);
  return {client.right, client.bottom};
}

std::string PlaceText(const RECT& area) {
  return std::to_string(area.left) + " " + std::to_string(area.top) + " " + std::to_string(area.right - area.left) +
         " " + std::to_string(area.bottom - area.top);
}
std::string PlaceText(HWND hWnd) { return PlaceText(AreaOf(hWnd, GetParent(hWnd))); }

std::string PlaceName(const Screen& screen, HWND hWnd) {
  const RECT area = AreaOf(hWnd, screen.hWindow());
  return std::to_string(area.left) + "," + std::to_string(area.top);
}

void Click(HWND hWnd, POINT at, UINT uDown) {
  PostMessageW(hWnd, uDown, MK_LBUTTON, MAKELPARAM(at.x, at.y));
  PostMessageW(hWnd, WM_LBUTTONUP, 0, MAKELPARAM(at.x, at.y));
}

HCURSOR hCursorOver(HWND hWnd) {
  SetCursor(nullptr);
  SendMessageW(hWnd, WM_SETCURSOR, reinterpret_cast<WPARAM>(hWnd), MAKELPARAM(HTCLIENT, WM_MOUSEMOVE));
  return GetCursor();
}
