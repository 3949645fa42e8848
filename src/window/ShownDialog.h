// The native side of one dialog while it is shown: its background, fonts and control windows, and which of its push
// buttons Enter presses. It belongs to the window's thread; CNWindowView guards the look-up from other threads.
#pragma once

#include "controls/DialogInfo.h"
#include "window/Fonts.h"
#include "window/NativeControls.h"

class ShownDialog {
 public:
  // The description must outlive this object.
  explicit ShownDialog(DialogInfo& dialog);

  // Makes all control windows, invisible, in line order, which is the tab order. A control that cannot be made is
  // logged and left out.
  void CreateControls(HWND hParent, HINSTANCE hInstance);
  // Shows those that are to be visible, or hides all; nothing is painted yet.
  void ShowControls(bool bShow);
  // Gives the keyboard to the last control with the flag FOCUS, else to the first that can take it.
  void SetInitialFocus(HWND hParent);

  DialogInfo& Info() const { return m_Info; }
  DialogFonts& Fonts() { return m_Fonts; }
  HBRUSH hGround() const { return m_Ground ? m_Ground.Get() : GetSysColorBrush(COLOR_BTNFACE); }
  COLORREF GroundColor() const { return m_Ground ? ToColorRef(m_Info.m_Background) : GetSysColor(COLOR_BTNFACE); }
  NativeControl* pFind(const BaseControl& control) const;
  // The control whose window this is, or stands around it (a list's header, a combo's field); null without.
  NativeControl* pFindWindow(HWND hWnd) const;
  // The nearest control to the right of a control on its height, or null.
  const NativeControl* pNextOnRight(const NativeControl& native) const;
  bool bSetToolTip(HWND hControl, const char* szText);

  // The button that Enter presses: the focused push button, else the dialog's DEFAULT one. Null without either.
  HWND hDefaultButton() const { return m_hFocusedButton ? m_hFocusedButton : m_hDefault; }
  // A push button got or lost the focus; moves the default look.
  void OnButtonFocus(HWND hButton, bool bFocused);
  // Makes another button the dialog's DEFAULT one.
  void SetDefault(HWND hButton);

 private:
  bool bMakeToolTips(HWND hControl);
  void ChangeDefault(HWND hFocusedButton, HWND hDefault);

  DialogInfo& m_Info;
  OwnedBrush m_Ground;
  DialogFonts m_Fonts;
  HWND m_hDefault = nullptr;
  HWND m_hFocusedButton = nullptr;
  CNArray<NativeControl> m_Controls;  // owned; the windows go before what they use
  OwnedWindow m_ToolTips;             // made for the first tooltip
};
