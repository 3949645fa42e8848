// Bars of buttons: alone, and as bands of a rebar.
#pragma once

#include "controls/MenuKinds.h"
#include "window/ItemLooks.h"

// What a toolbar or rebar keeps: the pictures of all its buttons.
struct BarState : NativeState {
  ItemPictures m_Pictures;
};

// The look of a toolbar as its line says.
struct ToolbarLook {
  explicit ToolbarLook(const BaseControl& line) : bLarge(line.bHasFlag("LARGE")), bLabels(line.bHasFlag("LABEL")) {}
  bool bLarge;   // the texts stand below the pictures
  bool bLabels;  // all buttons show their texts, not only those without a picture
  DWORD dwStyle() const;
};

// Fills a toolbar that was just made with the items of its control, from iFirst to the line that closes a block.
void FillToolbar(HWND hToolbar, NativeControl& native, int iFirst, const ToolbarLook& look);
// ToolbarKeys.cpp: has a bar with buttons be a stop of the Tab key; true when the Tab key has led into, through or out
// of one.
void AddToolbarKeys(HWND hToolbar);
bool bTabThroughBar(HWND hDialog, MSG& message);
bool bIsToolbar(HWND hWnd);
// Gives its buttons and combo boxes their texts.
void SetToolbarTexts(HWND hToolbar, const CNItemControl& holder, const CNCharArray& texts);
// The size that shows all buttons.
SIZE ToolbarSize(HWND hToolbar);

// For the table of both kinds. An item belongs to the control's own toolbar or to one in it.
bool bCheckToolbarItem(NativeControl& native, int iItem, bool bChecked);
bool bIsToolbarItemChecked(NativeControl& native, int iItem, bool& bChecked);
NativeEvent ToolbarNotify(NativeControl& native, NMHDR& message);
// Shows the chosen text of each combo box.
void ShowToolbarChoices(NativeControl& native);
// The item of the control that a command message chooses: a button, or a combo box whose choice changed. Null for any
// other message.
CNItem* pToolbarChoice(const NativeControl& native, HWND hFrom, int iID, int iCode);
// The size that the control's line says; what it leaves out is as wide as the window around it, and as high as needed.
void FitBar(NativeControl& native, int iNeededHeight);
