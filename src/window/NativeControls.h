// The native half of control descriptions. One NativeControl stands for one window; what is special about a kind is one
// NativeKind, kept in the kind's own unit (ButtonWindow.cpp, EditWindow.cpp ...) and listed once in NativeControls.cpp.
#pragma once

#include <atomic>
#include <memory>

#include "controls/ControlItems.h"
#include "controls/Kinds.h"
#include "window/Handles.h"
#include "window/Pictures.h"

class NativeControl;
class ShownDialog;

// What a notification comes to. An event of the control and the choice of an item exclude each other.
struct NativeEvent {
  int iNotification = -1;        // ControlNotification; -1: none
  BaseControl* pItem = nullptr;  // the item that was chosen
  bool bSettled = false;         // the window has finished with what it notifies of, and may go
  bool bAnswered = false;        // lResult is the answer to the message
  LRESULT lResult = 0;
};

// What a kind adds to a plain native window; a null function stands for the common behaviour.
struct NativeKind {
  ControlKind kind;
  DWORD dwStyle = 0;         // added to the description's style
  DWORD dwRemovedStyle = 0;  // taken away from it
  DWORD dwExStyle = 0;
  bool bField = false;  // has the system's field colours unless its description gives a background
  // Changes class, style or size before the window is made.
  void (*pPrepare)(NativeControl& native, CREATESTRUCTW& window) = nullptr;
  void (*pCreated)(NativeControl& native) = nullptr;
  // Once, right before the dialog is shown with its texts filled in.
  void (*pBeforeShow)(NativeControl& native) = nullptr;
  // Any thread. Common: the window's text.
  bool (*pSetText)(HWND hWnd, const char* szText) = nullptr;
  bool (*pGetText)(HWND hWnd, CNString& csText) = nullptr;
  // The script's number (ControlNotification) for a notification code of the native window, or IGNORED.
  int (*pNotification)(NativeControl& native, int iCode) = nullptr;
  // A WM_NOTIFY of the native window (or of one inside it), a WM_HSCROLL or WM_VSCROLL (code: the low word).
  NativeEvent (*pNotify)(NativeControl& native, NMHDR& message) = nullptr;
  NativeEvent (*pScrolled)(NativeControl& native, int iCode) = nullptr;
  // The texts of the items, markers filled in, as BaseControl::bItemTexts gives them. The window's thread.
  void (*pSetItems)(NativeControl& native, const CNCharArray& texts) = nullptr;
  // The tick of an item, by its place among the description's items; false when it has none.
  bool (*pCheckItem)(NativeControl& native, int iItem, bool bChecked) = nullptr;
  bool (*pIsItemChecked)(NativeControl& native, int iItem, bool& bChecked) = nullptr;
  // The window that the controls within it are children of. Common: none, the control holds no others.
  HWND (*pInner)(NativeControl& native) = nullptr;
  // The control got another rectangle from the layout, or its dialog's window another size (bars at its edge).
  void (*pResized)(NativeControl& native) = nullptr;
  COLORREF (*pTextColor)(const BaseControl& control) = nullptr;
  void (*pDraw)(NativeControl& native, const DRAWITEMSTRUCT& item) = nullptr;

  static const int IGNORED = -1;
};

// The native half of a kind, or null when it is not drawn.
const NativeKind* pFindNativeKind(ControlKind kind);

// One per unit.
extern const NativeKind g_ButtonWindow, g_StaticWindow, g_CheckBoxWindow, g_EditWindow, g_ListBoxWindow,
    g_SimulatedListBoxWindow, g_ProgressWindow, g_ImageWindow;
extern const NativeKind g_FrameWindow, g_GroupBoxWindow, g_TabControlWindow, g_PropertySheetWindow, g_TabPageWindow,
    g_SplitterWindow;
extern const NativeKind g_MenuWindow, g_RightMenuWindow, g_ToolbarWindow, g_RebarWindow;
extern const NativeKind g_RtfWindow, g_TrackBarWindow, g_UpDownWindow, g_DateTimeWindow, g_MonthCalendarWindow,
    g_IPAddressWindow, g_HotKeyWindow, g_PagerWindow, g_StatusBarWindow, g_AnimationWindow, g_CursorWindow,
    g_WaveWindow;
extern const NativeKind g_ComboWindow, g_ListViewWindow, g_TreeViewWindow, g_HeaderWindow;

// What a kind keeps for a window of its; it goes after the window.
struct NativeState {
  virtual ~NativeState() = default;
};

class NativeControl {
 public:
  // All three must outlive the control.
  NativeControl(BaseControl& control, const NativeKind& kind, ShownDialog& dialog);

  // Makes the window, invisible whatever its description says. False after logging.
  bool bCreate(HWND hParent, HINSTANCE hInstance);
  // The control that a child of a wizard window stands for; null for any other window.
  static NativeControl* pFromWindow(HWND hWnd);

  HWND hWnd() const { return m_Window.Get(); }
  BaseControl& Control() const { return m_Control; }
  const NativeKind& Kind() const { return m_Kind; }
  ShownDialog& Dialog() const { return m_Dialog; }
  // What lies behind the control's text: its own background, else that of the nearest container that has one, else the
  // dialog's.
  HBRUSH hGround() const;
  // Paints it, also where the dialog has a picture.
  void FillGround(HDC hDC, const RECT& area) const { FillGround(hDC, hWnd(), area); }
  // The same in a window within this one.
  void FillGround(HDC hDC, HWND hInside, const RECT& area) const;
  // Paints what lies behind the window itself.
  void FillBehind(HDC hDC, const RECT& area) const;
  // Answers a WM_CTLCOLOR message: sets text and background colour and returns the brush.
  HBRUSH hColors(HDC hDC, UINT uMessage) const;
  HFONT hFont() const;
  // The window's rectangle within the dialog's client area.
  RECT Place() const;
  // Replaces the background of a control that gives none by a colour of the system (COLOR_...).
  void UseSystemGround(int iColor) { m_iSystemGround = iColor; }

  std::atomic<bool> m_bVisible;  // as the description and later calls want it; takes effect when the dialog is shown
  std::unique_ptr<Picture> m_pPicture;
  std::unique_ptr<NativeState> m_pState;

  // The control, or the nearest container around it, that has a background of its own; null: the dialog's shows.
  const NativeControl* pColored() const;
  void SetGround(COLORREF color);

 private:
  BaseControl& m_Control;
  const NativeKind& m_Kind;
  ShownDialog& m_Dialog;
  OwnedBrush m_Background;
  COLORREF m_BackgroundColor = 0;  // of m_Background
  int m_iSystemGround = -1;
  OwnedWindow m_Window;
};

inline COLORREF ToColorRef(const ControlColor& color) { return RGB(color.red, color.green, color.blue); }

// A window's text; null when there is no memory for it. Any thread.
std::unique_ptr<wchar_t[]> WindowText(HWND hWnd);
// A window's text as code page 1250, and back; setting the same text again draws nothing. Any thread.
bool bSetWindowText(HWND hWnd, const char* szText);
bool bGetWindowText(HWND hWnd, CNString& csText);
