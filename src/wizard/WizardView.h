// The engine's only way to a screen. The window floor implements it with native windows; HeadlessView implements it in
// memory for tests, tools and unattended runs. The engine never sees a window handle.
//
// One view serves one wizard. Unless a call says "any thread", it belongs to the thread that runs iRun.
#pragma once

#include <memory>

#include "controls/ControlItems.h"
#include "controls/DialogInfo.h"
#include "controls/MessageSink.h"
#include "foundation/ResultCodes.h"

// Notifications of controls, in the numbers that the script language's event table is written in.
enum ControlNotification : int {
  NOTIFY_CLICK = 0,
  NOTIFY_SELECTION_CHANGED = 1,
  NOTIFY_DOUBLE_CLICK = 2,
  NOTIFY_EDIT_CHANGE = 5,
  NOTIFY_EDIT_UPDATE = 6,
  NOTIFY_DROP_DOWN = 7,
  NOTIFY_DROP_UP = 8,
  NOTIFY_MOUSE_IN = 100,
  NOTIFY_MOUSE_OUT = 101,
  NOTIFY_MOUSE_UP = 102,
  NOTIFY_MOUSE_DOWN = 103,
  NOTIFY_SET_FOCUS = 0x100,
  NOTIFY_KILL_FOCUS = 0x200,
};

// What a view tells its wizard. Called on the view's thread only.
class WizardEvents {
 public:
  virtual ~WizardEvents() = default;
  // A command message: ID_OK, ID_CLOSE or a navigation identifier.
  virtual void OnCommand(int iID) = 0;
  virtual void OnControl(BaseControl& control, int iNotification) = 0;
  // An item of a menu, toolbar, list view or tree (CNItem) was chosen, or an accelerator's key was pressed.
  virtual void OnItem(BaseControl&) {}
  // A key was pressed: a virtual-key code and the keys held down with it (KeyModifier). EVERYTHING_IS_OK when an
  // accelerator took it, and its command has been run; else FUNCTION_ERROR, or PRECONDITIONS_NOT_VALID without a
  // window.
  virtual int iTranslateKeyAccelerators(int /*iKey*/, unsigned /*uModifiers*/) { return FUNCTION_ERROR; }
  // The window is asked to close (its close box, Alt+F4). The wizard decides by calling WizardView::CloseWindow or not.
  virtual void OnCloseRequest() = 0;
  // True while the session must not be ended under the wizard's feet: the view asks the system to wait.
  virtual bool bHoldsQuit() = 0;
  // What the system tells the person meanwhile, one line.
  virtual const char* szHoldReason() { return "Files are being copied."; }
  // True while work runs in the background whose end the wizard waits for.
  virtual bool bWorks() { return bHoldsQuit(); }
  // The session ends while the wizard does not hold it. What is to be put in order must be so when this returns: the
  // process may not live longer.
  virtual void OnEndSession() {}
  // The session ends although the wizard holds it. Its work is to break off where a later run can take it up; the
  // process may not live longer than this call.
  virtual void OnBreakOff() {}
};

struct WizardWindowOptions {
  const char* szClassName = nullptr;    // window class, unique in the process
  int iIconResource = 0;                // 0: the program's first icon
  const char* szProgramIcon = nullptr;  // icon file in the folder pict; wins over the resource when it can be loaded
  // Keeps the window's place from one run to the next; null or empty: nothing is kept, no file made.
  const char* szConfigurationFile = nullptr;
  bool bModeless = false;  // an owner's window stays usable
};

class WizardView : public MessageSink {
 public:
  // ---- the window ----
  // Makes the wizard's main window, hidden and without size. events must outlive the window. False when it cannot be
  // made.
  virtual bool bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) = 0;
  // Destroys the main window; iRun returns after that. Harmless when there is none.
  virtual void CloseWindow() = 0;
  virtual bool bHasWindow() const = 0;
  // Handles messages until the main window is destroyed. Returns 0.
  virtual int iRun() = 0;
  virtual void SetCaption(const char* szCaption) = 0;
  virtual void ShowWindow(bool bShow) = 0;
  // Queues a command for OnCommand, or has it handled before returning. Any thread.
  virtual void PostCommand(int iID) = 0;
  virtual void SendCommand(int iID) = 0;

  // ---- dialogs ----
  // Replaces the controls of the dialog shown so far by those of this one, all not yet visible, and makes the window
  // what the dialog says (style, size, place, background, font). The description must outlive the showing.
  virtual bool bCreateDialog(DialogInfo& dialog) = 0;
  // Draws the dialog made last and sets the keyboard focus. Called after its texts have been filled in.
  virtual void ShowDialog() = 0;

  // ---- controls of the dialog shown ----
  // Set or read a control's text; for a check box the text is "1" or "0". A list's text is its selected item
  // (items, one a line, in a list of several). False when the control has no window. Any thread.
  virtual bool bSetText(const BaseControl& control, const char* szText) = 0;
  virtual bool bGetText(const BaseControl& control, CNString& csText) = 0;
  // The words beside a check box, whose text is its state. False when the control has no window. Any thread.
  virtual bool bSetCaption(const BaseControl& control, const char* szCaption) = 0;
  // The texts of the control's items, markers filled in, as many and in the order as BaseControl::bItemTexts gives
  // them.
  virtual bool bSetItems(const BaseControl& control, const CNCharArray& items) = 0;
  // The tick of an item, by its place among the control's m_Items. False when it has none.
  virtual bool bCheckItem(const CNItemControl&, int /*iItem*/, bool /*bChecked*/) { return false; }
  virtual bool bIsItemChecked(const CNItemControl&, int /*iItem*/, bool& /*bChecked*/) { return false; }
  virtual bool bSetToolTip(const BaseControl& control, const char* szText) = 0;
  virtual bool bSetProgress(const BaseControl& control, int iPercent) = 0;  // 0 to 100. Any thread.
  virtual bool bEnable(const BaseControl& control, bool bEnabled) = 0;
  virtual bool bShow(const BaseControl& control, bool bVisible) = 0;  // any thread
  virtual bool bSetFocus(const BaseControl& control) = 0;
  // Sends the control's window a message of the system. Returns its answer, -1 when the control has no window. Any
  // thread.
  virtual intptr_t lSendMessage(const BaseControl&, unsigned /*uMessage*/, uintptr_t /*wParam*/, intptr_t /*lParam*/) {
    return -1;
  }
  // Draws the control anew after its description changed (a visited link).
  virtual void Redraw(const BaseControl& control) = 0;

  // ---- the system's own dialogs ----
  // iShowMessage: MessageSink.
  virtual bool bChooseFolder(const char* szTitle, CNString& csFolder) = 0;  // csFolder: where to start; the choice
  virtual bool bChooseFile(const char* szTitle, CNString& csFile) = 0;
  // Opens a program, document, web or mail address with the shell's verb "open". False when the shell refuses.
  virtual bool bOpenLink(const char* szTarget, const char* szFolder = nullptr) = 0;

  // ---- the screen ----
  // Before the dialogs are read: their numbers are pixels (NO_LOGPIXELS), so that the system is to enlarge the window
  // on a fine screen where it can, or they grow by dScale().
  virtual void SetPixelLayout(bool /*bPixels*/) {}
  virtual double dScale() const = 0;                         // dots per inch / 96
  virtual int iCaptionHeight(bool bSmallCaption) const = 0;  // pixels
  // A view for a wizard that is modal to this one: its window is owned by this one's, which is disabled meanwhile.
  virtual std::unique_ptr<WizardView> pMakeOwnedView() = 0;
};
