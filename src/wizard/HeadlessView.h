// A view without a screen: it keeps the state of controls in memory, records what it was told, answers message boxes
// from a list, and lets a test or a tool press controls. PostCommand, SendCommand, bSetText, bGetText, bSetCaption,
// bSetProgress, bShow and iShowMessage may be called from any thread. The views of pMakeOwnedView share their owner's
// answers, choices, events and callbacks; the owner must outlive them.
#pragma once

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "foundation/CNSem.h"
#include "wizard/WizardView.h"

class HeadlessView : public WizardView {
 public:
  struct ControlState {
    std::string text;
    std::string caption;  // of a check box
    std::vector<std::string> items;
    std::map<int, bool> ticks;  // of items, by their place
    std::string toolTip;
    int progress = 0;
    bool enabled = true;
    bool visible = true;
  };

  // Answers for message boxes, taken in order; when they run out each box gets its default button.
  std::vector<int> answers;
  // What bChooseFolder and bChooseFile return, in order; when they run out the choice is cancelled.
  std::vector<std::string> choices;
  // Called for every event as it is recorded (may be empty).
  std::function<void(const std::string& event)> onEvent;
  // Called by iRun when no command is queued: press something, or return false to have iRun close the window. Without
  // it iRun waits for commands of other threads for at most idleLimit milliseconds. It is given the view that runs: an
  // owned one while a wizard within the wizard is open.
  std::function<bool(HeadlessView& view)> onIdle;
  unsigned idleLimit = 30000;
  double scale = 1.0;
  int captionHeight = 19, smallCaptionHeight = 16;

  // Everything that was shown or asked, in order: "open-window", "caption TEXT", "dialog NAME", "show NAME",
  // "message CAPTION|TEXT -> ANSWER", "choose TITLE -> PATH", "open TARGET", "close-window".
  std::vector<std::string> events;

  // ---- what a person would do; the control is named by its variable name. False when it is not there to be used: no
  // such control, hidden, disabled, or of a kind that does not take it ----
  bool bPress(const char* szName);  // click a button, link or check box
  bool bPress(BaseControl& control);
  // Replace the text of a field, with its focus events, or of the cell that is the variable's.
  bool bType(const char* szName, const char* szText);
  bool bSelect(const char* szName, const char* szItem);
  // Chooses the item of a menu, toolbar, tree ... that carries the text or the name, or presses an accelerator's key.
  bool bChooseItem(const char* szText);
  // Ticks, or with false unticks, the item whose state is the variable's.
  bool bTick(const char* szVariable, bool bChecked);
  void Close();       // the window's close box
  void EndSession();  // at once, whatever the wizard does
  DialogInfo* Dialog() const { return m_pDialog; }
  const ControlState* pState(const char* szName) const;
  const std::string& Caption() const { return m_caption; }
  bool bWindowShown() const { return m_bShown; }
  // Whether a person can reach the control now: it is shown and enabled, and so is what it stands in.
  bool bUsable(const BaseControl& control);
  // True while the wizard works in the background.
  bool bWorks() const { return m_pEvents && m_pEvents->bWorks(); }
  // True while a command waits to be handled. Asked after bWorks: what ends posts its command first.
  bool bHasCommand();
  // Has a field take a text that no person could enter in one step, with the event of a choice.
  void SetField(BaseControl& control, const char* szText);

  // ---- WizardView ----
  bool bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) override;
  void CloseWindow() override;
  bool bHasWindow() const override { return m_pEvents != nullptr; }  // the view's thread
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
  void Redraw(const BaseControl&) override {}
  bool bChooseFolder(const char* szTitle, CNString& csFolder) override;
  bool bChooseFile(const char* szTitle, CNString& csFile) override;
  bool bOpenLink(const char* szTarget, const char* szFolder) override;
  int iShowMessage(const MessageText& message) override;
  double dScale() const override { return scale; }
  int iCaptionHeight(bool bSmallCaption) const override { return bSmallCaption ? smallCaptionHeight : captionHeight; }
  std::unique_ptr<WizardView> pMakeOwnedView() override;

 private:
  HeadlessView& Root();
  void Record(const std::string& event);
  ControlState* pStateOf(const BaseControl& control);
  BaseControl* pUsable(const char* szName);
  // The first item that matches, when a person can reach it; pHolder and iItem: where it is.
  template <class Match>
  CNItem* pFindItem(Match match, BaseControl*& pHolder, int& iItem);
  bool bTypeCell(const char* szVariable, const char* szText);
  std::string TextOf(const BaseControl& control);
  // Changes the state of a control that is shown; false when it is not.
  template <class Change>
  bool bChange(const BaseControl& control, Change change);
  bool bTakeCommand(int& iID);
  bool bChoose(const char* szTitle, CNString& csChoice);
  bool bIdle(unsigned& uWaited);

  HeadlessView* m_pOwner = nullptr;  // events, answers and idle steps of an owned view are its owner's
  WizardEvents* m_pEvents = nullptr;
  DialogInfo* m_pDialog = nullptr;
  std::map<const BaseControl*, ControlState> m_states;
  std::vector<int> m_commands;
  unsigned m_uQueued = 0, m_uHandled = 0;  // commands so far, for the threads that wait for theirs
  unsigned long m_ulThread = 0;            // the thread that opened the window
  std::string m_caption;
  bool m_bShown = false;
  CNSem m_lock;
};
