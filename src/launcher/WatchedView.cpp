#include "launcher/WatchedView.h"

#include <cstring>

#include "controls/Kinds.h"
#include "launcher/PageName.h"
#include "wizard/FieldKinds.h"

bool WatchedView::bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) {
  m_pEvents = &events;
  return m_pView->bOpenWindow(*this, options);
}

void WatchedView::CloseWindow() {
  if (bHasWindow()) LeavePage();
  m_pDialog = nullptr;
  m_pView->CloseWindow();
}

bool WatchedView::bCreateDialog(DialogInfo& dialog) {
  LeavePage();
  m_pDialog = &dialog;
  m_csPage = csPageName(m_pWizard, dialog);
  m_Log.Line("page %s", m_csPage.Text());
  return m_pView->bCreateDialog(dialog);
}

// ---- what a person chooses ----

static const CNButton* pButton(const BaseControl& control) {
  return control.Kind() == ControlKind::Button ? static_cast<const CNButton*>(&control) : nullptr;
}

// What the wizard sends itself is no press of a button that has the same identifier.
std::atomic<int>* WatchedView::pOwnCommands(int iID) {
  return iID >= ID_NEXT && iID <= ID_SHOW_DIALOG ? &m_OwnCommands[iID - ID_NEXT] : nullptr;
}

void WatchedView::PostCommand(int iID) {
  if (std::atomic<int>* pOwn = pOwnCommands(iID)) ++*pOwn;
  m_pView->PostCommand(iID);
}

void WatchedView::SendCommand(int iID) {
  if (std::atomic<int>* pOwn = pOwnCommands(iID)) ++*pOwn;
  m_pView->SendCommand(iID);
}

void WatchedView::OnCommand(int iID) {
  std::atomic<int>* const pOwn = pOwnCommands(iID);
  const bool bOwn = pOwn && *pOwn > 0;
  if (bOwn) --*pOwn;
  for (int i = 0; !bOwn && m_pDialog && i < m_pDialog->m_Controls.Size(); i++) {
    const CNButton* pPressed = pButton(*m_pDialog->m_Controls[i]);
    // Enter presses the default button.
    if (!pPressed || (iID == ID_OK ? !pPressed->m_bDefault : pPressed->m_iNavigationID != iID)) continue;
    OnPress(*m_pDialog->m_Controls[i]);
    break;
  }
  m_pEvents->OnCommand(iID);
}

void WatchedView::OnControl(BaseControl& control, int iNotification) {
  if (iNotification == NOTIFY_CLICK && pButton(control)) OnPress(control);
  m_pEvents->OnControl(control, iNotification);
}

void WatchedView::OnEndSession() {
  m_Log.Line("the session ends");
  m_pEvents->OnEndSession();
}

// Before the wizard acts on it: afterwards the page may be gone.
void WatchedView::OnPress(BaseControl& button) {
  if (m_Pressed.Size() && m_Pressed.Find(&button) >= 0) m_Pressed.Remove(&button);
  m_Pressed.Add(&button, 0);
  m_Log.Line("press %s", button.m_csName.bEmpty() ? button.m_csCaption.Text() : button.m_csName.Text());
  NoteFields();
}

static bool bKeeps(const BaseControl& control) {
  const ControlKind kind = control.Kind();
  // What nobody can change is nobody's choice.
  const bool bTyped = kind == ControlKind::Edit || kind == ControlKind::RichEdit;
  if (control.m_csName.bEmpty() || control.m_bDisabledNow) return false;
  if (bTyped && control.m_dwStyle & STYLE_ES_READONLY) return false;
  if (kind == ControlKind::Edit) return true;
  if (kind == ControlKind::RichEdit) return control.bHasFlag("REMEMBER");
  if (control.bHasFlag("NO_VAR_SAVE") || (bIsTextList(kind) && control.bHasFlag("HIDE"))) return false;
  return kind == ControlKind::Combo || kind == ControlKind::CheckBox || bIsList(kind) || bIsSetter(kind);
}

// The fields whose values the wizard saves, and the ticks and cells that are variables.
void WatchedView::NoteFields() {
  CNString csText;
  m_Noted.lines.RemoveAll();
  for (int i = 0; m_pDialog && i < m_pDialog->m_Controls.Size(); i++) {
    const BaseControl& control = *m_pDialog->m_Controls[i];
    if (bKeeps(control) && m_pView->bGetText(control, csText))
      Answers::Add(m_Noted, AnswerKind::Set, control.m_csName.Text(), csText.Text());
    if (bIsList(control.Kind()) && control.pItemControl()) NoteItems(*control.pItemControl());
  }
}

void WatchedView::NoteItems(const CNItemControl& control) {
  CNString csVariable;
  ItemLook look;
  for (int i = 0; i < control.m_Items.Size(); i++) {
    const CNItem& item = *control.m_Items[i];
    bool bChecked = false;
    item.FlagArgument("VAR", csVariable);
    if (!csVariable.bEmpty() && !item.bHasFlag("DISABLE") && m_pView->bIsItemChecked(control, i, bChecked))
      Answers::Add(m_Noted, AnswerKind::Tick, csVariable.Text(), bChecked ? "1" : "0");
    const bool bCells = control.Kind() == ControlKind::ListView && item.bIs("ITEM");
    for (int j = 0; bCells && j < item.m_Shown.Size(); j++) {
      item.MarkedVariable(j, csVariable);
      if (!csVariable.bEmpty() && static_cast<const CNListView&>(control).bCanEdit(j))
        Answers::Add(m_Noted, AnswerKind::Set, csVariable.Text(), item.szShown(j, look));
    }
  }
}

// What a person has chosen holds when a press has led away from the page, other than back.
void WatchedView::LeavePage() {
  const BaseControl* pLast = m_Pressed[m_Pressed.Size() - 1];
  const int iID = pLast ? static_cast<const CNButton*>(pLast)->m_iNavigationID : ID_BACK;
  if (m_pDialog && iID != ID_BACK && !m_csPage.bEmpty()) {
    CNSemHold hold(m_Lock);
    AnswerPage& page = m_Answers.StartPage(m_csPage.Text());
    for (int i = 0; i + 1 < m_Pressed.Size(); i++)
      if (!m_Pressed[i]->m_csName.bEmpty()) Answers::Add(page, AnswerKind::Press, m_Pressed[i]->m_csName.Text(), "");
    for (int i = 0; i < m_Noted.lines.Size(); i++)
      Answers::Add(page, m_Noted.lines[i]->kind, m_Noted.lines[i]->csName.Text(), m_Noted.lines[i]->csValue.Text());
    if (!pLast->m_csName.bEmpty()) Answers::Add(page, AnswerKind::Press, pLast->m_csName.Text(), "");
  }
  m_Pressed.RemoveAll();
  m_Noted.lines.RemoveAll();
}

// ---- what the system asks ----

int WatchedView::iShowMessage(const MessageText& message) {
  const int iAnswer = m_pView->iShowMessage(message);
  const char* szText = message.szText ? message.szText : "";
  m_Log.Line("message \"%s\": %s -> %s", message.szCaption ? message.szCaption : "", szText, Answers::szWord(iAnswer));
  // One with a single button needs no answer.
  CNSemHold hold(m_Lock);
  if (message.buttons != MessageButtons::Ok && m_pDialog) m_Answers.KeepMessage(m_csPage.Text(), szText, iAnswer);
  return iAnswer;
}

// The button that leads to one of the system's dialogs is not to be pressed again: the choice is in a field.
bool WatchedView::bChooseFolder(const char* szTitle, CNString& csFolder) {
  if (m_Pressed.Size()) m_Pressed.Remove(m_Pressed[m_Pressed.Size() - 1]);
  return m_pView->bChooseFolder(szTitle, csFolder);
}

bool WatchedView::bChooseFile(const char* szTitle, CNString& csFile) {
  if (m_Pressed.Size()) m_Pressed.Remove(m_Pressed[m_Pressed.Size() - 1]);
  return m_pView->bChooseFile(szTitle, csFile);
}
