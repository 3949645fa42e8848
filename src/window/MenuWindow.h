// The menus of a page: its bar, and those that a right click opens.
#pragma once

#include "window/ShownDialog.h"

// The dialog's menu bar, null without one. It belongs to the dialog; a window must not keep it longer.
HMENU hMenuBar(const ShownDialog& dialog);
// The right-click menu of the control (null: of the dialog itself); null without one.
NativeControl* pRightMenu(const ShownDialog& dialog, const BaseControl* pControl);
// Opens it at a place of the screen and waits for the choice: an item's identifier, 0 for none. The dialog may be gone
// afterwards.
int iAskRightMenu(NativeControl& menu, HWND hOwner, POINT at);
// The item of one of the dialog's menus that has the identifier; null for an unknown one.
CNItem* pMenuItem(const ShownDialog& dialog, int iID);

// For owner-drawn entries: answer the messages of that name. False for an entry of another menu.
bool bMeasureMenuItem(const ShownDialog& dialog, MEASUREITEMSTRUCT& item);
bool bDrawMenuItem(const ShownDialog& dialog, const DRAWITEMSTRUCT& item);
bool bMenuCharacter(const ShownDialog& dialog, HMENU hMenu, wchar_t c, LRESULT& lResult);
