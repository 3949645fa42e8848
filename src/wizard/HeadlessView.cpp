#include "wizard/HeadlessView.h"

#include "controls/ContainerKinds.h"
#include "foundation/ResultCodes.h"
#include "wizard/FieldKinds.h"

namespace {

// What Enter chooses, by MessageButtons.
const int DEFAULT_ANSWERS[] = {ANSWER_OK, ANSWER_OK, ANSWER_ABORT, ANSWER_YES, ANSWER_YES, ANSWER_RETRY, ANSWER_CANCEL};

}  // namespace

HeadlessView& HeadlessView::Root() { return m_pOwner ? m_pOwner->Root() : *this; }

void HeadlessView::Record(const std::string& event) {
  HeadlessView& root = Root();
  {
    CNSemHold hold(root.m_lock);
    root.events.push_back(event);
  }
  if (root.onEvent) root.onEvent(event);
}

// ---- the window ----

bool HeadlessView::bOpenWindow(WizardEvents& events, const WizardWindowOptions&) {
  {
    CNSemHold hold(m_lock);
    m_pEvents = &events;
    m_commands.clear();
    m_uHandled = m_uQueued;
    m_ulThread = OsThreadId();
  }
  Record("open-window");
  return true;
}

void HeadlessView::CloseWindow() {
  if (!m_pEvents) return;
  {
    CNSemHold hold(m_lock);
    m_pEvents = nullptr;
    m_pDialog = nullptr;
    m_states.clear();
    m_bShown = false;
  }
  Record("close-window");
}

int HeadlessView::iRun() {
  unsigned uWaited = 0;
  while (bHasWindow()) {
    int iID;
    if (bTakeCommand(iID)) {
      m_pEvents->OnCommand(iID);
      CNSemHold hold(m_lock);
      m_uHandled++;
      uWaited = 0;
    } else if (!bIdle(uWaited)) {
      CloseWindow();
    }
  }
  return 0;
}

bool HeadlessView::bTakeCommand(int& iID) {
  CNSemHold hold(m_lock);
  if (m_commands.empty()) return false;
  iID = m_commands.front();
  m_commands.erase(m_commands.begin());
  return true;
}

bool HeadlessView::bHasCommand() {
  CNSemHold hold(m_lock);
  return !m_commands.empty();
}

// False when nothing more is to be expected.
bool HeadlessView::bIdle(unsigned& uWaited) {
  const auto& onIdle = Root().onIdle;
  if (onIdle && !onIdle(*this)) return false;
  const unsigned uPause = 1;
  OsSleep(uPause);
  uWaited += uPause;
  return onIdle || uWaited < Root().idleLimit;
}

void HeadlessView::SetCaption(const char* szCaption) {
  m_caption = szCaption;
  Record("caption " + m_caption);
}

void HeadlessView::ShowWindow(bool bShow) {
  m_bShown = bShow;
  Record(bShow ? "show-window" : "hide-window");
}

void HeadlessView::PostCommand(int iID) {
  CNSemHold hold(m_lock);
  if (!m_pEvents) return;
  m_commands.push_back(iID);
  m_uQueued++;
}

void HeadlessView::SendCommand(int iID) {
  if (OsThreadId() == m_ulThread) {
    if (m_pEvents) m_pEvents->OnCommand(iID);
    return;
  }
  unsigned uTicket;
  {
    CNSemHold hold(m_lock);
    if (!m_pEvents) return;
    m_commands.push_back(iID);
    uTicket = ++m_uQueued;
  }
  for (bool bWaiting = true; bWaiting; OsSleep(1)) {
    CNSemHold hold(m_lock);
    bWaiting = m_pEvents && static_cast<int>(uTicket - m_uHandled) > 0;
  }
}

// ---- dialogs and controls ----

bool HeadlessView::bCreateDialog(DialogInfo& dialog) {
  if (!m_pEvents) return false;
  {
    CNSemHold hold(m_lock);
    m_pDialog = &dialog;
    m_states.clear();
    for (int i = 0; i < dialog.m_Controls.Size(); i++) {
      const BaseControl* pControl = dialog.m_Controls[i];
      if (!pControl->szWindowClass() && !pControl->pItemControl()) continue;
      ControlState& state = m_states[pControl];
      state.enabled = !(pControl->m_dwStyle & STYLE_DISABLED);
      state.visible = pControl->m_dwStyle & STYLE_VISIBLE;
      if (pControl->Kind() == ControlKind::CheckBox) state.text = "0";
      if (bIsTabControl(pControl)) state.text = "1";
    }
  }
  Record(std::string("dialog ") + dialog.m_csName.Text());
  return true;
}

void HeadlessView::ShowDialog() {
  if (!m_pDialog) return;
  m_bShown = !m_pDialog->m_bHide;
  Record(std::string("show ") + m_pDialog->m_csName.Text());
}

// The caller holds the lock.
HeadlessView::ControlState* HeadlessView::pStateOf(const BaseControl& control) {
  const auto found = m_states.find(&control);
  return found == m_states.end() ? nullptr : &found->second;
}

std::string HeadlessView::TextOf(const BaseControl& control) {
  CNSemHold hold(m_lock);
  const ControlState* pState = pStateOf(control);
  return pState ? pState->text : "";
}

template <class Change>
bool HeadlessView::bChange(const BaseControl& control, Change change) {
  CNSemHold hold(m_lock);
  ControlState* pState = pStateOf(control);
  if (pState) change(*pState);
  return pState != nullptr;
}

bool HeadlessView::bSetText(const BaseControl& control, const char* szText) {
  return bChange(control, [=](ControlState& state) { state.text = szText; });
}

bool HeadlessView::bGetText(const BaseControl& control, CNString& csText) {
  bool bKnown = true;
  const bool bDone = bChange(control, [&](ControlState& state) {
    // Without a variable it is what the native control begins with.
    bKnown = !state.text.empty() || !bIsSetter(control.Kind());
    csText = state.text.c_str();
  });
  return bDone && bKnown;
}

bool HeadlessView::bSetCaption(const BaseControl& control, const char* szCaption) {
  return bChange(control, [=](ControlState& state) { state.caption = szCaption; });
}

bool HeadlessView::bSetItems(const BaseControl& control, const CNCharArray& items) {
  if (const CNItemControl* pHolder = control.pItemControl()) pHolder->TakeShown(items);
  return bChange(control, [&items](ControlState& state) {
    state.items.clear();
    for (int i = 0; i < items.Size(); i++) state.items.push_back(items[i]);
  });
}

bool HeadlessView::bCheckItem(const CNItemControl& control, int iItem, bool bChecked) {
  return bChange(control, [=](ControlState& state) { state.ticks[iItem] = bChecked; });
}

bool HeadlessView::bIsItemChecked(const CNItemControl& control, int iItem, bool& bChecked) {
  CNSemHold hold(m_lock);
  const auto state = m_states.find(&control);
  if (state == m_states.end()) return false;
  const auto tick = state->second.ticks.find(iItem);
  bChecked = tick != state->second.ticks.end() ? tick->second : control.m_Items[iItem]->bHasFlag("CHECKED");
  return true;
}

bool HeadlessView::bSetToolTip(const BaseControl& control, const char* szText) {
  return bChange(control, [=](ControlState& state) { state.toolTip = szText; });
}

bool HeadlessView::bSetProgress(const BaseControl& control, int iPercent) {
  return bChange(control, [=](ControlState& state) { state.progress = iPercent; });
}

bool HeadlessView::bEnable(const BaseControl& control, bool bEnabled) {
  return bChange(control, [=](ControlState& state) { state.enabled = bEnabled; });
}

bool HeadlessView::bShow(const BaseControl& control, bool bVisible) {
  return bChange(control, [=](ControlState& state) { state.visible = bVisible; });
}

bool HeadlessView::bSetFocus(const BaseControl& control) {
  return bChange(control, [](ControlState&) {});
}

// ---- the system's dialogs ----

bool HeadlessView::bChoose(const char* szTitle, CNString& csChoice) {
  HeadlessView& root = Root();
  std::string choice;
  const bool bChosen = !root.choices.empty();
  if (bChosen) {
    choice = root.choices.front();
    root.choices.erase(root.choices.begin());
    csChoice = choice.c_str();
  }
  Record(std::string("choose ") + szTitle + " -> " + choice);
  return bChosen;
}

bool HeadlessView::bChooseFolder(const char* szTitle, CNString& csFolder) { return bChoose(szTitle, csFolder); }

bool HeadlessView::bChooseFile(const char* szTitle, CNString& csFile) { return bChoose(szTitle, csFile); }

bool HeadlessView::bOpenLink(const char* szTarget, const char*) {
  Record(std::string("open ") + szTarget);
  return true;
}

int HeadlessView::iShowMessage(const MessageText& message) {
  HeadlessView& root = Root();
  int iAnswer = DEFAULT_ANSWERS[static_cast<int>(message.buttons)];
  {
    CNSemHold hold(root.m_lock);
    if (!root.answers.empty()) {
      iAnswer = root.answers.front();
      root.answers.erase(root.answers.begin());
    }
  }
  Record(std::string("message ") + (message.szCaption ? message.szCaption : "") + "|" +
         (message.szText ? message.szText : "") + " -> " + std::to_string(iAnswer));
  return iAnswer;
}

std::unique_ptr<WizardView> HeadlessView::pMakeOwnedView() {
  auto pView = std::make_unique<HeadlessView>();
  pView->m_pOwner = this;
  pView->scale = scale;
  pView->captionHeight = captionHeight;
  pView->smallCaptionHeight = smallCaptionHeight;
  return pView;
}
