// Menus, bars and accelerators: the windows and menus that lines become, and what real input tells the wizard.
#include <algorithm>
#include <set>

#include "Page.h"

using Events = std::vector<std::string>;

namespace {

const char MENU[] =
    "MENU_BAR\n"
    "MENU \"&File\"\nITEM 'open' \"&Open\\tCtrl+O\"\nITEM \"Off\", DISABLE ACTION: (off ())\nSEPARATOR\n"
    "SUBMENU \"&More\"\nITEM \"<%v%>\", CHECKED ACTION: (deep (1))\nEND_SUBMENU\nEND_MENU\n"
    "ITEM \"&Quit\" ACTION: (EXIT)\nEND_MENUBAR\n"
    "BUTTON 'b' \"B\" 10 10 75 23\n";

// "text" of each entry, with "-" for a separator, "~" before a disabled and "*" before a ticked one, "[...]" behind one
// that opens a menu.
std::wstring Entries(HMENU hMenu) {
  std::wstring all;
  for (int i = 0; i < GetMenuItemCount(hMenu); i++) {
    wchar_t text[64] = L"";
    MENUITEMINFOW info = {};
    info.cbSize = sizeof(info);
    info.fMask = MIIM_STRING | MIIM_FTYPE | MIIM_STATE | MIIM_SUBMENU;
    info.dwTypeData = text;
    info.cch = 64;
    EXPECT_TRUE(GetMenuItemInfoW(hMenu, static_cast<UINT>(i), TRUE, &info));
    all += i ? L"|" : L"";
    if (info.fType & MFT_SEPARATOR) all += L"-";
    if (info.fState & MFS_DISABLED) all += L"~";
    if (info.fState & MFS_CHECKED) all += L"*";
    all += text;
    if (info.hSubMenu) all += L"[" + Entries(info.hSubMenu) + L"]";
  }
  return all;
}

// Posts the messages one after the other, each when the program has come to rest: a menu that opens takes all keys that
// are there already.
class SlowInput {
 public:
  explicit SlowInput(Screen& screen) : m_Screen(screen) {}
  void Add(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam) {
    m_Messages.push_back({hWnd, uMessage, wParam, lParam, 0, {}});
  }
  void AddKeys(std::initializer_list<WPARAM> keys) {
    for (const WPARAM wKey : keys)
      Add(m_Screen.hWindow(), wKey >= 'a' ? WM_CHAR : WM_KEYDOWN, wKey,
          static_cast<LPARAM>(MapVirtualKeyW(static_cast<UINT>(wKey), 0) << 16 | 1));
  }
  Events Run() {
    s_pRunning = this;
    SetTimer(nullptr, 0, 40, Next);
    m_Screen.wizard.onEvent = [](const std::string& event) {
      if (event == END) PostQuitMessage(0);
    };
    m_Screen.view->iRun();
    MSG message;
    while (PeekMessageW(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE)) {
    }
    m_Screen.wizard.onEvent = nullptr;
    Events events = m_Screen.TakeEvents();
    events.erase(std::remove(events.begin(), events.end(), END), events.end());
    return events;
  }

 private:
  static constexpr const char* END = "command 499";
  static void CALLBACK Next(HWND, UINT, UINT_PTR uTimer, DWORD) {
    std::vector<MSG>& messages = s_pRunning->m_Messages;
    if (messages.empty()) {
      KillTimer(nullptr, uTimer);
      EndMenu();
      s_pRunning->m_Screen.view->PostCommand(499);
      return;
    }
    const MSG first = messages.front();
    messages.erase(messages.begin());
    PostMessageW(first.hwnd, first.message, first.wParam, first.lParam);
  }
  static SlowInput* s_pRunning;
  Screen& m_Screen;
  std::vector<MSG> m_Messages;
};
SlowInput* SlowInput::s_pRunning;

// Opens the bar's menu by its letter, then presses the keys in it.
Events ChooseByKeys(Screen& screen, wchar_t cMnemonic, std::initializer_list<WPARAM> keys) {
  SlowInput input(screen);
  input.Add(screen.hWindow(), WM_SYSCOMMAND, SC_KEYMENU, cMnemonic);
  input.AddKeys(keys);
  return input.Run();
}

void ClickButton(Screen& screen, HWND hToolbar, const CNItem& item) {
  RECT area = {};
  SendMessageW(hToolbar, TB_GETRECT, static_cast<WPARAM>(item.m_iID), reinterpret_cast<LPARAM>(&area));
  const POINT middle = {(area.left + area.right) / 2, (area.top + area.bottom) / 2};
  PostMessageW(hToolbar, WM_MOUSEMOVE, 0, MAKELPARAM(middle.x, middle.y));
  Click(hToolbar, middle);
  screen.RunQueued();
}

// Holds keys down, as far as the program can tell, and presses one.
void PressWith(Screen& screen, std::initializer_list<int> held, WPARAM wKey) {
  BYTE keys[256] = {};
  for (const int iHeld : held) keys[iHeld] = 0x80;
  SetKeyboardState(keys);
  screen.Press({wKey});
  for (const int iHeld : held) keys[iHeld] = 0;
  SetKeyboardState(keys);
}

}  // namespace

TEST(Menus, TheBarShowsItsItemsAndBelongsToItsPage) {
  Screen screen;
  Page with(DialogKind::DialogSys, "20 20 300 200", MENU);
  Page without(DialogKind::DialogSys, "20 20 300 200", "BUTTON 'b' \"B\" 10 10 75 23\n");
  screen.Show(with);
  const HWND hWnd = screen.hWindow();
  const CNItemControl& menu = *with.info.m_Controls[0]->pItemControl();
  CNCharArray texts;
  for (const char* szText : {"Datoteka", "Š\tCtrl+O", "Off", "More", "inner", "Quit"}) texts.Add(szText, 1);
  EXPECT_EQ(Entries(GetMenu(hWnd)), L"&File[&Open\tCtrl+O|~Off|-|&More[*<%v%>]]|&Quit");
  EXPECT_TRUE(screen.view->bSetItems(menu, texts));
  EXPECT_EQ(Entries(GetMenu(hWnd)), L"Datoteka[Š\tCtrl+O|~Off|-|More[*inner]]|Quit");
  bool bChecked = true;
  EXPECT_TRUE(screen.view->bCheckItem(menu, 1, true));
  EXPECT_TRUE(screen.view->bCheckItem(menu, 5, false));
  EXPECT_EQ(Entries(GetMenu(hWnd)), L"Datoteka[*Š\tCtrl+O|~Off|-|More[inner]]|Quit");
  EXPECT_TRUE(screen.view->bIsItemChecked(menu, 5, bChecked));
  EXPECT_FALSE(bChecked);
  EXPECT_FALSE(screen.view->bIsItemChecked(menu, 6, bChecked)) << "END_SUBMENU is no entry";
  const SIZE small = ClientOf(hWnd);
  const RECT area = AreaOf(hWnd);
  screen.Show(without);
  EXPECT_EQ(GetMenu(hWnd), nullptr);
  EXPECT_TRUE(EqualRect(&area, &static_cast<const RECT&>(AreaOf(hWnd))));
  EXPECT_GE(ClientOf(hWnd).cy - small.cy, GetSystemMetrics(SM_CYMENU));
  EXPECT_EQ(ClientOf(hWnd).cx, small.cx);
}

TEST(Menus, KeysChooseItemsAlsoAmongOwnerDrawnOnes) {
  for (const char* szFlags : {"", ",OWNER_DRAWN"}) {
    Screen screen;
    Page page(DialogKind::DialogSys, "20 20 300 200", ("MENU_BAR" + std::string(szFlags) + (MENU + 8)).c_str());
    screen.Show(page);
    SCOPED_TRACE(szFlags);
    EXPECT_EQ(ChooseByKeys(screen, L'f', {VK_RETURN}), Events{"item open ()"});
    EXPECT_EQ(ChooseByKeys(screen, L'f', {'o'}), Events{"item open ()"});
    EXPECT_EQ(ChooseByKeys(screen, L'f', {'m', VK_RETURN}), Events{"item deep (1)"});
    EXPECT_EQ(ChooseByKeys(screen, L'f', {VK_DOWN, VK_RETURN}), Events{}) << "a disabled one is not chosen";
    EXPECT_EQ(ChooseByKeys(screen, L'q', {}), Events{"item EXIT"});
  }
}

TEST(Menus, ARightClickOpensTheMenuOfTheControlElseOfTheDialog) {
  ShownPage screen(
      "RIGHT_CLICK_MENU 'edit'\nBEGIN\nITEM 'edit_menu' \"E\"\nEND_RIGHT_CLICK_MENU\n"
      "RIGHT_CLICK_MENU 'text'\nITEM 'text_menu' \"T\"\nEND_RIGHT_CLICK_MENU\n"
      "RIGHT_CLICK_MENU\nSUBMENU \"D\"\nITEM 'dialog_menu' \"D\"\nEND_SUBMENU\nEND_RIGHT_CLICK_MENU\n"
      "EDIT_FIELD 'edit' 10 10 90 20, FOCUS\nTEXT_FIELD 'text' \"Text\" 10 40 90 20\n"
      "BUTTON 'button' \"Button\" 10 70 90 23\n",
      "20 20 300 200");
  const HWND hWnd = screen.hWindow();
  const struct {
    HWND hWnd;
    POINT at;
    const char* szChosen;
    bool bSubMenu;
  } rows[] = {{screen.hChildOfClass(L"EDIT"), {5, 5}, "item edit_menu ()", false},
              {hWnd, {20, 45}, "item text_menu ()", false},
              {screen.hChild(L"Button"), {5, 5}, "item dialog_menu ()", true},
              {hWnd, {200, 120}, "item dialog_menu ()", true}};
  for (const auto& row : rows) {
    SlowInput input(screen);
    for (const UINT uMessage : {WM_RBUTTONDOWN, WM_RBUTTONUP})
      input.Add(row.hWnd, uMessage, 0, MAKELPARAM(row.at.x, row.at.y));
    input.AddKeys({VK_DOWN, VK_RETURN});
    if (row.bSubMenu) input.AddKeys({VK_RETURN});
    const Events events = input.Run();
    ASSERT_FALSE(events.empty()) << row.szChosen;
    EXPECT_EQ(events.back(), row.szChosen);
  }
  SetFocus(screen.hChildOfClass(L"EDIT"));
  SlowInput input(screen);
  input.Add(GetFocus(), WM_KEYUP, VK_APPS, static_cast<LPARAM>(0xC0000001u));
  input.AddKeys({VK_DOWN, VK_RETURN});
  EXPECT_EQ(input.Run().back(), "item edit_menu ()") << "the menu key";
}

TEST(Menus, OwnerDrawnEntriesShowTheirLook) {
  ShownPage screen(
      "MENU_BAR\nMENU \"&File\"\nITEM \"WWWW\\tCtrl+O\", RGB(200,0,0), CHECKED\nITEM \"WWWW\", BOLD, DISABLE\n"
      "END_MENU\nEND_MENUBAR\n",
      "20 20 300 200");
  const HMENU hMenu = GetSubMenu(GetMenu(screen.hWindow()), 0);
  ScreenDC source;
  const OwnedMemoryDC memory(CreateCompatibleDC(source.Get()));
  const OwnedBitmap bitmap(CreateCompatibleBitmap(source.Get(), 400, 100));
  Selected target(memory.Get(), bitmap.Get());
  // The colours of an entry, as the wizard answers the system's messages for it.
  const auto draw = [&](UINT uAt, UINT uState, SIZE& size) {
    MENUITEMINFOW info = {};
    info.cbSize = sizeof(info);
    info.fMask = MIIM_DATA | MIIM_FTYPE | MIIM_STATE | MIIM_ID;
    GetMenuItemInfoW(hMenu, uAt, TRUE, &info);
    EXPECT_TRUE(info.fType & MFT_OWNERDRAW);
    MEASUREITEMSTRUCT measure = {ODT_MENU, 0, info.wID, 0, 0, info.dwItemData};
    EXPECT_TRUE(SendMessageW(screen.hWindow(), WM_MEASUREITEM, 0, reinterpret_cast<LPARAM>(&measure)));
    size = {static_cast<LONG>(measure.itemWidth), static_cast<LONG>(measure.itemHeight)};
    DRAWITEMSTRUCT item = {
        ODT_MENU,       0, info.wID, 0, uState, reinterpret_cast<HWND>(hMenu), memory.Get(), {0, 0, 200, 24},
        info.dwItemData};
    EXPECT_TRUE(SendMessageW(screen.hWindow(), WM_DRAWITEM, 0, reinterpret_cast<LPARAM>(&item)));
    std::set<COLORREF> colors;
    for (int i = 0; i < 200 * 24; i++) colors.insert(GetPixel(memory.Get(), i % 200, i / 200));
    return colors;
  };
  SIZE first, second;
  EXPECT_TRUE(draw(0, ODS_CHECKED, first).count(RGB(200, 0, 0)));
  EXPECT_EQ(GetPixel(memory.Get(), 1, 1), GetSysColor(COLOR_MENU));
  EXPECT_TRUE(draw(0, ODS_SELECTED, first).count(GetSysColor(COLOR_HIGHLIGHTTEXT)));
  EXPECT_FALSE(draw(0, ODS_SELECTED, first).count(RGB(200, 0, 0)));
  EXPECT_TRUE(draw(1, ODS_GRAYED, second).count(GetSysColor(COLOR_GRAYTEXT)));
  EXPECT_GT(first.cx, second.cx) << "room for the key";
  EXPECT_GE(first.cy, GetSystemMetrics(SM_CYMENUCHECK));
}

TEST(Bars, ToolbarButtonsTellTheirItems) {
  Screen screen;
  Page page(DialogKind::DialogSys, "20 20 400 200",
            "FRAME 'f' 5 30 380 120\nTOOLBAR 'bar' 10 20 300 0\nITEM 'go' \"&Go\" TOOLTIP 'now'\nITEM 'off' \"Off\", "
            "DISABLE\nSEPARATOR\nITEM 'tick' \"Tick\", VAR(v)\nCOMBO 'size' \"8\" \"10\" 60\nEND_TOOLBAR\nEND_FRAME\n");
  page["bar"].pItemControl()->m_Items[4]->m_csCaption = "8";  // as the wizard leaves its variable there
  page["bar"].pItemControl()->m_Items[0]->m_csShownToolTip = "now";
  screen.Show(page);
  const HWND hBar = screen.hChildOfClass(TOOLBARCLASSNAMEW), hCombo = screen.hChildOfClass(L"COMBOBOX");
  const CNItemControl& bar = *page["bar"].pItemControl();
  ASSERT_NE(hBar, nullptr);
  EXPECT_EQ(GetDlgCtrlID(hBar), page["bar"].m_iID);
  const LONG lStyle = GetWindowLongW(hBar, GWL_STYLE);
  EXPECT_EQ(lStyle & (TBSTYLE_FLAT | TBSTYLE_LIST | CCS_NORESIZE), TBSTYLE_FLAT | TBSTYLE_LIST | CCS_NORESIZE);
  const RECT area = AreaOf(hBar, GetParent(hBar));
  EXPECT_EQ(PlaceText(RECT{area.left, area.top, area.right, 20}), "10 20 300 0");
  EXPECT_GT(area.bottom, 35) << "as high as needed";
  EXPECT_EQ(SendMessageW(hBar, TB_BUTTONCOUNT, 0, 0), 5);
  for (int i : {0, 1, 3}) ClickButton(screen, hBar, *bar.m_Items[i]);
  EXPECT_EQ(screen.TakeEvents(), (Events{"item go ()", "item tick ()"}));
  bool bTicked = false;
  EXPECT_TRUE(screen.view->bIsItemChecked(bar, 3, bTicked) && bTicked);
  wchar_t text[32] = L"";
  SendMessageW(hBar, TB_GETBUTTONTEXTW, static_cast<WPARAM>(bar.m_Items[1]->m_iID), reinterpret_cast<LPARAM>(text));
  EXPECT_STREQ(text, L"Off");
  SetFocus(hCombo);
  screen.Press({VK_DOWN});
  EXPECT_EQ(screen.TakeEvents(), Events{"item size ()"});
  EXPECT_STREQ(bar.m_Items[4]->m_csCaption.Text(), "10");
  NMTBGETINFOTIPW tip = {
      {hBar, static_cast<UINT_PTR>(page["bar"].m_iID), TBN_GETINFOTIPW}, text, 32, bar.m_Items[0]->m_iID, 0};
  SendMessageW(GetParent(hBar), WM_NOTIFY, 0, reinterpret_cast<LPARAM>(&tip));
  EXPECT_STREQ(text, L"now");
}

TEST(Bars, RebarsHoldToolbarsAndControlsOfTheDialog) {
  ShownPage screen(
      "REBAR 'bands'\nTOOLBAR 't' \"Bar\" 200 0, Standard\nITEM 'go' \"Go\"\nEND_TOOLBAR\n"
      "BAND 'where' \"To:\" 80\nEND_REBAR\nEDIT_FIELD 'where' 10 100 90 20\n",
      "20 20 500 300", DialogKind::Window);
  EXPECT_EQ(screen.TakeEvents(), Events{"where 256"});
  const HWND hRebar = screen.hChildOfClass(REBARCLASSNAMEW), hBar = screen.hChildOfClass(TOOLBARCLASSNAMEW);
  ASSERT_NE(hRebar, nullptr);
  EXPECT_EQ(SendMessageW(hRebar, RB_GETBANDCOUNT, 0, 0), 2);
  EXPECT_EQ(GetParent(hBar), hRebar);
  EXPECT_EQ(GetParent(screen.hChildOfClass(L"EDIT")), hRebar);
  EXPECT_EQ(ClientOf(hRebar).cx, ClientOf(screen.hWindow()).cx);
  EXPECT_EQ(ClientOf(hRebar).cy, SendMessageW(hRebar, RB_GETBARHEIGHT, 0, 0));
  ClickButton(screen, hBar, *screen["bands"].pItemControl()->m_Items[1]);
  EXPECT_EQ(screen.TakeEvents(), Events{"item go ()"});
  SetFocus(screen.hWindow());
  EXPECT_EQ(screen.TakeEvents().front(), "where 512") << "a control in a band still speaks";
  SetWindowPos(screen.hWindow(), nullptr, 0, 0, 600, 300, SWP_NOMOVE | SWP_NOZORDER);
  EXPECT_EQ(ClientOf(hRebar).cx, ClientOf(screen.hWindow()).cx) << "it follows the window";
}

TEST(Accelerators, KeysComeToTheWizardBeforeAllElse) {
  ShownPage screen("EDIT_FIELD 'e' 10 10 90 20, FOCUS\nBUTTON 'b' \"B\" 10 40 9 9\n", "20 20 300 200");
  std::string seen;
  screen.wizard.onKey = [&](int iKey, unsigned uModifiers) {
    seen += std::to_string(iKey) + "/" + std::to_string(uModifiers) + " ";
    return iKey == VK_TAB;
  };
  const HWND hFocus = GetFocus();
  PressWith(screen, {VK_CONTROL, VK_SHIFT}, VK_F5);
  PressWith(screen, {}, VK_ADD);
  PressWith(screen, {}, VK_TAB);
  EXPECT_EQ(seen, "116/3 187/0 9/0 ");
  EXPECT_EQ(GetFocus(), hFocus) << "a key that was taken does nothing else";
}
