// Menu bars and right-click menus. A description's lines become menus of the system; entries with a look of their own
// are drawn by MenuDrawing.
#include "window/MenuWindow.h"

#include "foundation/os/OsWide.h"
#include "window/MenuDrawing.h"
#include "window/SimpleWindows.h"

namespace {

class NativeMenu : public NativeState {
 public:
  explicit NativeMenu(const NativeControl& native);
  ~NativeMenu() override {
    EndMenu();  // it may be open, when another thread has led to another page
    DestroyMenu(m_hMenu);
  }
  HMENU hMenu() const { return m_hMenu; }
  HINSTANCE hInstance() const {
    return reinterpret_cast<HINSTANCE>(GetWindowLongPtrW(m_Native.hWnd(), GWLP_HINSTANCE));
  }
  const ItemPictures& Pictures() const { return m_Pictures; }
  // By place among the description's items; null for lines that are no entries.
  MenuEntry* operator[](int i) const { return m_Entries[i]->hMenu ? m_Entries[i] : nullptr; }
  int Size() const { return m_Entries.Size(); }
  void SetText(MenuEntry& entry, const char* szText);

 private:
  void Add(CNItem& item, int& iAround);

  const NativeControl& m_Native;
  const CNBaseMenu& m_Menu;
  const HMENU m_hMenu;
  ItemPictures m_Pictures;
  CNArray<MenuEntry> m_Entries;  // owned; one for each line
};

NativeMenu::NativeMenu(const NativeControl& native)
    : m_Native(native),
      m_Menu(static_cast<const CNBaseMenu&>(native.Control())),
      m_hMenu(m_Menu.Kind() == ControlKind::MenuBar ? CreateMenu() : CreatePopupMenu()) {
  int iAround = -1;
  for (int i = 0; i < m_Menu.m_Items.Size(); i++) Add(*m_Menu.m_Items[i], iAround);
}

void SetEntryText(MENUITEMINFOW& info, const CNWideText& text) {
  info.fMask |= MIIM_STRING;
  info.dwTypeData = const_cast<wchar_t*>(reinterpret_cast<const wchar_t*>(text.Ptr()));
}

UINT EntryState(const CNItem& item) {
  return (item.bHasFlag("DISABLE") ? MFS_DISABLED : 0) | (item.bHasFlag("CHECKED") ? MFS_CHECKED : 0);
}

void NativeMenu::Add(CNItem& item, int& iAround) {
  MenuEntry& entry = *new MenuEntry;
  m_Entries.Add(&entry, 1);
  entry.pItem = &item;
  if (item.Level() == ItemLevel::Closes) {
    iAround = m_Entries[iAround]->iAround;  // never the outermost: the reader takes no line that closes nothing
    return;
  }
  if (item.bIs("BEGIN")) return;
  const bool bSeparator = item.bIs("SEPARATOR");
  entry.iAround = iAround;
  entry.hMenu = iAround < 0 ? m_hMenu : m_Entries[iAround]->hSubMenu;
  entry.iAt = GetMenuItemCount(entry.hMenu);
  // The entries of the bar itself always have the system's look, which the bar's ground belongs to.
  entry.bOwnerDrawn = m_Menu.m_bOwnerDrawn && !bSeparator && !(iAround < 0 && m_Menu.Kind() == ControlKind::MenuBar);
  if (entry.bOwnerDrawn) entry.iImage = m_Pictures.iFind(m_Native, item.m_Look.csPicture);
  if (item.Level() == ItemLevel::Opens) {
    entry.hSubMenu = CreatePopupMenu();
    iAround = m_Entries.Size() - 1;
  }
  MENUITEMINFOW info = {};
  info.cbSize = sizeof(info);
  info.fMask = MIIM_FTYPE | MIIM_STATE | MIIM_ID | MIIM_DATA | (entry.hSubMenu ? MIIM_SUBMENU : 0);
  info.fType = bSeparator ? MFT_SEPARATOR : entry.bOwnerDrawn ? MFT_OWNERDRAW : MFT_STRING;
  info.fState = EntryState(item);
  info.wID = static_cast<UINT>(item.m_iID);
  info.hSubMenu = entry.hSubMenu;
  info.dwItemData = reinterpret_cast<ULONG_PTR>(&entry);
  // One that comes without its text would become a separator.
  const CNWideText text(item.szText());
  entry.csText = item.szText();
  if (!bSeparator) SetEntryText(info, text);
  if (InsertMenuItemW(entry.hMenu, static_cast<UINT>(-1), TRUE, &info)) return;
  DestroyMenu(entry.hSubMenu);  // the system limits how deep menus nest
  entry.hSubMenu = entry.hMenu = nullptr;
}

// An owner-drawn entry has its text too: that is what screen readers say.
void NativeMenu::SetText(MenuEntry& entry, const char* szText) {
  entry.csText = szText;
  const CNWideText text(szText);
  MENUITEMINFOW info = {};
  info.cbSize = sizeof(info);
  SetEntryText(info, text);
  SetMenuItemInfoW(entry.hMenu, static_cast<UINT>(entry.iAt), TRUE, &info);
}

NativeMenu& Menu(const NativeControl& native) { return static_cast<NativeMenu&>(*native.m_pState); }

bool bIsMenu(const BaseControl& control) {
  return control.Kind() == ControlKind::MenuBar || control.Kind() == ControlKind::RightMenu;
}

// The menu's window is never seen: it only stands for the menu among the dialog's controls.
void Created(NativeControl& native) { native.m_pState.reset(new NativeMenu(native)); }

void SetItems(NativeControl& native, const CNCharArray& texts) {
  NativeMenu& menu = Menu(native);
  for (int i = 0; i < menu.Size(); i++)
    if (menu[i] && menu[i]->pItem->m_Texts.Size() > 0) menu.SetText(*menu[i], texts[menu[i]->pItem->m_iFirstText]);
}

bool bCheck(NativeControl& native, int iItem, bool bChecked) {
  const MenuEntry* pEntry = Menu(native)[iItem];
  return pEntry && CheckMenuItem(pEntry->hMenu, static_cast<UINT>(pEntry->pItem->m_iID),
                                 bChecked ? MF_CHECKED : MF_UNCHECKED) != static_cast<DWORD>(-1);
}

bool bIsChecked(NativeControl& native, int iItem, bool& bChecked) {
  const MenuEntry* pEntry = Menu(native)[iItem];
  if (!pEntry) return false;
  bChecked = GetMenuState(pEntry->hMenu, static_cast<UINT>(pEntry->pItem->m_iID), MF_BYCOMMAND) & MF_CHECKED;
  return true;
}

// Calls until one call says that the entry was its own.
template <class Call>
bool bAnyEntry(const ShownDialog& dialog, Call call) {
  const CNArray<BaseControl>& controls = dialog.Info().m_Controls;
  for (int i = 0; i < controls.Size(); i++) {
    NativeControl* pNative = bIsMenu(*controls[i]) ? dialog.pFind(*controls[i]) : nullptr;
    for (int j = 0; pNative && j < Menu(*pNative).Size(); j++)
      if (Menu(*pNative)[j] && call(*pNative, *Menu(*pNative)[j])) return true;
  }
  return false;
}

constexpr NativeKind MakeKind(ControlKind kind) {
  return {.kind = kind,
          .pPrepare = PrepareUnseen,
          .pCreated = Created,
          .pSetItems = SetItems,
          .pCheckItem = bCheck,
          .pIsItemChecked = bIsChecked};
}

}  // namespace

const NativeKind g_MenuWindow = MakeKind(ControlKind::MenuBar);
const NativeKind g_RightMenuWindow = MakeKind(ControlKind::RightMenu);

HMENU hMenuBar(const ShownDialog& dialog) {
  const CNArray<BaseControl>& controls = dialog.Info().m_Controls;
  for (int i = 0; i < controls.Size(); i++)
    if (controls[i]->Kind() == ControlKind::MenuBar)
      if (const NativeControl* pNative = dialog.pFind(*controls[i])) return Menu(*pNative).hMenu();
  return nullptr;
}

NativeControl* pRightMenu(const ShownDialog& dialog, const BaseControl* pControl) {
  const CNArray<BaseControl>& controls = dialog.Info().m_Controls;
  const char* szName = pControl ? pControl->m_csName.Text() : "";
  for (int i = 0; i < controls.Size(); i++)
    if (controls[i]->Kind() == ControlKind::RightMenu && (!pControl || *szName) &&
        strcmp(static_cast<const CNRightMenu*>(controls[i])->m_csControl.Text(), szName) == 0)
      return dialog.pFind(*controls[i]);
  return nullptr;
}

int iAskRightMenu(NativeControl& menu, HWND hOwner, POINT at) {
  return TrackPopupMenuEx(Menu(menu).hMenu(), TPM_RIGHTBUTTON | TPM_RETURNCMD, at.x, at.y, hOwner, nullptr);
}

CNItem* pMenuItem(const ShownDialog& dialog, int iID) {
  CNItem* pFound = nullptr;
  bAnyEntry(dialog, [&](NativeControl&, const MenuEntry& entry) {
    if (entry.pItem->m_iID == iID) pFound = entry.pItem;
    return pFound != nullptr;
  });
  return pFound;
}

bool bMeasureMenuItem(const ShownDialog& dialog, MEASUREITEMSTRUCT& item) {
  return bAnyEntry(dialog, [&](NativeControl& native, const MenuEntry& entry) {
    const bool bOwn = reinterpret_cast<ULONG_PTR>(&entry) == item.itemData;
    if (bOwn) MeasureMenuEntry(entry, Menu(native).Pictures(), item);
    return bOwn;
  });
}

bool bDrawMenuItem(const ShownDialog& dialog, const DRAWITEMSTRUCT& item) {
  return bAnyEntry(dialog, [&](NativeControl& native, const MenuEntry& entry) {
    const bool bOwn = reinterpret_cast<ULONG_PTR>(&entry) == item.itemData;
    if (bOwn) DrawMenuEntry(entry, Menu(native).Pictures(), Menu(native).hInstance(), item);
    return bOwn;
  });
}

// The system looks for mnemonics in the entries only that it draws itself.
bool bMenuCharacter(const ShownDialog& dialog, HMENU hMenu, wchar_t c, LRESULT& lResult) {
  const auto upper = [](wchar_t cLetter) {
    return LOWORD(CharUpperW(reinterpret_cast<wchar_t*>(MAKELONG(cLetter, 0))));
  };
  return bAnyEntry(dialog, [&](NativeControl&, const MenuEntry& entry) {
    const char* szMnemonic = entry.hMenu == hMenu ? strchr(entry.csText.Text(), '&') : nullptr;
    if (!szMnemonic || szMnemonic[1] == '&' || upper(*Wide(szMnemonic + 1)) != upper(c)) return false;
    lResult = MAKELRESULT(entry.iAt, MNC_EXECUTE);
    return true;
  });
}
