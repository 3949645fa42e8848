// The native side of one dialog while it is shown: its background, fonts and control windows, and which of its push
// buttons Enter presses. It belongs to the window's thread; CNWindowView guards the look-up from other threads.
#pragma once

#include "controls/DialogInfo.h"
#include "window/Fonts.h"
#include "window/NativeControls.h"

// Gives the keyboard to a window, with the text of a field selected as dialogs do.
void FocusControl(HWND hControl);

class ShownDialog {
 public:
  // The description must outlive this object.
  explicit ShownDialog(DialogInfo& dialog);
  ~ShownDialog();

  // Makes all windows of the dialog and of its frames, invisible. Returns 0, or FUNCTION_ERROR when a part is missing,
  // which is logged; the others are there.
  int iInitDialog(HWND hParent, HINSTANCE hInstance);
  // Shows those that are to be visible, or hides all; nothing is painted yet.
  void ShowControls(bool bShow);
  // Gives the keyboard to the last control with the flag FOCUS, else to the first that can take it.
  void SetInitialFocus(HWND hParent);

  // For its view, which keeps dialogs that have gone.
  std::unique_ptr<ShownDialog> m_pBefore;

  DialogInfo& Info() const { return m_Info; }
  DialogFonts& Fonts() { return m_Fonts; }
  // What lies behind the controls: the colour, or the colour with the background picture on it, as large as the window.
  HBRUSH hGround();
  bool bHasPicture() const { return m_pPicture != nullptr; }
  // Fills an area of a window (the dialog's, or one in it) with what lies behind it.
  void FillGround(HDC hDC, HWND hWnd, const RECT& area);
  // Has hGround() continue without a seam in that window, whose client area begins at hDC's origin.
  void AlignGround(HDC hDC, HWND hWnd) const;
  COLORREF GroundColor() const { return m_Ground ? ToColorRef(m_Info.m_Background) : GetSysColor(COLOR_BTNFACE); }
  NativeControl* pFind(const BaseControl& control) const;
  // By its identifier.
  HWND hFind(int iID) const;
  const CNArray<NativeControl>& Controls() const { return m_Controls; }
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
  int iCreateControls(HWND hParent, HINSTANCE hInstance);
  int iDestroyWizardControlWnds();
  bool bMakeToolTips(HWND hControl);
  void OrderLabels();
  int iLabelOf(int iField) const;
  int iPaintBitmap(SIZE client);
  void ChangeDefault(HWND hFocusedButton, HWND hDefault);

  DialogInfo& m_Info;
  HWND m_hParent = nullptr;
  OwnedBrush m_Ground;
  std::unique_ptr<Picture> m_pPicture;  // behind the controls; null without one
  OwnedBrush m_PictureGround;           // the ground with the picture, m_PictureSize large
  SIZE m_PictureSize = {};
  std::unique_ptr<RECT[]> m_pPlaces;  // of the controls, while they are being shown
  DialogFonts m_Fonts;
  HWND m_hDefault = nullptr;
  HWND m_hFocusedButton = nullptr;
  CNArray<NativeControl> m_Controls;  // owned; the windows go before what they use
  OwnedWindow m_ToolTips;             // made for the first tooltip
};
