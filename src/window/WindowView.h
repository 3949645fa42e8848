// The native view of one wizard: a top-level window that is restyled and resized for each dialog, with the dialog's
// controls as its children. The window part is in Win32View.cpp, the message table in ViewMessages.cpp, the control
// operations in ViewControls.cpp.
#pragma once

#include <atomic>

#include "foundation/CNSem.h"
#include "window/DoublePress.h"
#include "window/FrameWindow.h"
#include "window/Placement.h"
#include "window/ScreenScale.h"
#include "window/ShownDialog.h"
#include "window/WindowClasses.h"
#include "wizard/WizardView.h"

struct WindowMessage {
  UINT uMessage;
  WPARAM wParam;
  LPARAM lParam;
};

class CNWindowView : public WizardView {
 public:
  CNWindowView(HINSTANCE hInstance, CNWindowView* pOwner);
  ~CNWindowView() override;

  // The view of a wizard's top-level window; null for any other window.
  static CNWindowView* pFromWindow(HWND hWnd);
  // Lets the dialog's keys have the message. True when they took it.
  bool bPreTranslate(MSG& message);
  // To be called by the view's own message loop, between messages.
  void DropFormerDialogs();

  // ---- WizardView ----
  bool bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) override;
  void CloseWindow() override;
  bool bHasWindow() const override { return m_hWindow != nullptr; }
  int iRun() override;
  void SetCaption(const char* szCaption) override;
  void ShowWindow(bool bShow) override;
  void PostCommand(int iID) override;
  void SendCommand(int iID) override;
  bool bCreateDialog(DialogInfo& dialog) override;
  void ShowDialog() override;
  bool bSetText(const BaseControl& control, const char* szText) override;
  bool bGetText(const BaseControl& control, CNString& csText) override;
  bool bSetCaption(const BaseControl& control, const char* szCaption) override;
  bool bSetItems(const BaseControl& control, const CNCharArray& items) override;
  bool bCheckItem(const CNItemControl& control, int iItem, bool bChecked) override;
  bool bIsItemChecked(const CNItemControl& control, int iItem, bool& bChecked) override;
  bool bSetToolTip(const BaseControl& control, const char* szText) override;
  bool bSetProgress(const BaseControl& control, int iPercent) override;
  bool bEnable(const BaseControl& control, bool bEnabled) override;
  bool bShow(const BaseControl& control, bool bVisible) override;
  bool bSetFocus(const BaseControl& control) override;
  intptr_t lSendMessage(const BaseControl& control, unsigned uMessage, uintptr_t wParam, intptr_t lParam) override;
  void Redraw(const BaseControl& control) override;
  bool bChooseFolder(const char* szTitle, CNString& csFolder) override;
  bool bChooseFile(const char* szTitle, CNString& csFile) override;
  bool bOpenLink(const char* szTarget, const char* szFolder) override;
  int iShowMessage(const MessageText& message) override;
  void SetPixelLayout(bool bPixels) override;
  double dScale() const override { return m_dScale; }
  int iCaptionHeight(bool bSmallCaption) const override;
  std::unique_ptr<WizardView> pMakeOwnedView() override;

 private:
  friend struct MessageRow;
  static const UINT_PTR PLACE_TIMER = 1;
  static const UINT PLACE_REST = 400;  // milliseconds without a further movement
  static const UINT_PTR SESSION_TIMER = 2;
  struct ControlWindow {
    HWND hWnd = nullptr;
    const NativeKind* pKind = nullptr;
  };

  static LRESULT CALLBACK WindowProc(HWND hWnd, UINT uMessage, WPARAM wParam, LPARAM lParam);
  bool bHandle(const WindowMessage& message, LRESULT& lResult);
  bool bOnCommandMessage(const WindowMessage& message, LRESULT& lResult);
  bool bOnClose(const WindowMessage& message, LRESULT& lResult);
  bool bOnQueryEndSession(const WindowMessage& message, LRESULT& lResult);
  bool bOnEndSession(const WindowMessage& message, LRESULT& lResult);
  bool bOnPlaced(const WindowMessage& message, LRESULT& lResult);
  bool bOnSized(const WindowMessage& message, LRESULT& lResult);
  bool bOnLimitSize(const WindowMessage& message, LRESULT& lResult);
  bool bOnTimer(const WindowMessage& message, LRESULT& lResult);
  bool bOnEraseGround(const WindowMessage& message, LRESULT& lResult);
  bool bOnControlColor(const WindowMessage& message, LRESULT& lResult);
  bool bOnDrawItem(const WindowMessage& message, LRESULT& lResult);
  bool bOnMeasureItem(const WindowMessage& message, LRESULT& lResult);
  bool bOnNotify(const WindowMessage& message, LRESULT& lResult);
  bool bOnScroll(const WindowMessage& message, LRESULT& lResult);
  bool bOnContextMenu(const WindowMessage& message, LRESULT& lResult);
  bool bOnMenuCharacter(const WindowMessage& message, LRESULT& lResult);
  bool bOnTellControl(const WindowMessage& message, LRESULT& lResult);
  bool bTell(const NativeControl& native, const NativeEvent& event, LRESULT& lResult);
  bool bOnSetCursor(const WindowMessage& message, LRESULT& lResult);
  bool bOnActivate(const WindowMessage& message, LRESULT& lResult);
  bool bOnSetFocus(const WindowMessage& message, LRESULT& lResult);
  bool bOnNextControl(const WindowMessage& message, LRESULT& lResult);
  bool bOnGetDefault(const WindowMessage& message, LRESULT& lResult);
  bool bOnSetDefault(const WindowMessage& message, LRESULT& lResult);
  bool bOnDestroy(const WindowMessage& message, LRESULT& lResult);

  // The window of a control of the dialog made last; empty when it has none. Any thread.
  ControlWindow Find(const BaseControl& control);
  void FitWindow(const DialogInfo& dialog, bool bMaximized);
  bool bToBeMaximized(const DialogInfo& dialog) const;
  void NotePlace();
  void HoldOwner(bool bHold);
  void HoldSession(bool bHold);
  void LeaveFocus(HWND hControl);
  // Accelerators.cpp, ViewMenus.cpp: each takes the message, or says that it is not its own.
  bool bTakeAccelerator(const MSG& message);
  bool bTakeContextKey(const MSG& message);
  void ExchangeMenu(HMENU hNew);
  HWND hMessageOwner() const;

  const HINSTANCE m_hInstance;
  CNWindowView* const m_pOwner;
  ScreenScaling m_Scaling = ScreenScaling::AsProgram;
  double m_dScale = 1.0;
  WizardEvents* m_pEvents = nullptr;
  bool m_bModeless = false;
  bool m_bHoldsOwner = false;    // the owner's window was disabled by this one
  bool m_bHoldsSession = false;  // the system has been asked not to end the session
  bool m_bClosing = false;       // the window is on its way out: the wizard is not told what its controls say
  bool m_bPlaced = false;        // a dialog has been shown: the window's place may be inherited
  PlaceKeeper m_Places;
  DoublePress m_DoublePress;    // of the outermost view: a double click may lead from one wizard into the next
  HWND m_hLastFocus = nullptr;  // the control that gets the keyboard back when the window is activated
  CNString m_csCaption;         // of the dialog that is not shown yet
  WizardClass m_Class;
  FrameClass m_FrameClass;
  std::atomic<HWND> m_hWindow{nullptr};

  CNSem m_lock;  // guards the pointers below against other threads; never held while a message is sent
  std::unique_ptr<ShownDialog> m_pDialog;  // made last
  std::unique_ptr<ShownDialog> m_pFormer;  // still on the screen until m_pDialog is shown
  std::atomic<bool> m_bPending{false};     // m_pDialog is not shown yet
  // Left while the view's loop runs, each with those before it. The change may have come in the middle of a message of
  // one of their controls (a list view that waits for a drag has a loop of its own), so they stay, hidden, until the
  // view's loop has its turn.
  std::unique_ptr<ShownDialog> m_pGone;
  int m_nLoops = 0;  // of the view that run: one within another
};
