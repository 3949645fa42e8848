// Menu entries that the wizard measures and draws itself.
#pragma once

#include "controls/MenuKinds.h"
#include "window/ItemLooks.h"

// One entry of a menu of the page.
struct MenuEntry {
  CNItem* pItem = nullptr;
  HMENU hMenu = nullptr;     // that it stands in
  HMENU hSubMenu = nullptr;  // that it opens
  int iAt = 0;               // its place in hMenu
  int iAround = -1;          // the entry that opens hMenu, -1 for those of the bar or pop-up menu itself
  bool bOwnerDrawn = false;
  int iImage = -1;  // of the page's pictures, -1 for none
  CNString csText;  // as shown, the key behind a tab
};

void MeasureMenuEntry(const MenuEntry& entry, const ItemPictures& pictures, MEASUREITEMSTRUCT& item);
void DrawMenuEntry(const MenuEntry& entry, const ItemPictures& pictures, HINSTANCE hInstance,
                   const DRAWITEMSTRUCT& item);
