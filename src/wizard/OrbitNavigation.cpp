// What the window side does: commands of the wizard's window, events of its controls, moving between dialogs.
#include "controls/Kinds.h"
#include "wizard/COrbitWizard.h"
#include "wizard/FieldKinds.h"
#include "wizard/TextRange.h"

namespace {

// The control kinds of one set of events.
bool bClickable(ControlKind kind) {
  return kind == ControlKind::Button || kind == ControlKind::Static || kind == ControlKind::CheckBox ||
         kind == ControlKind::Header;
}
bool bEditable(ControlKind kind) { return kind == ControlKind::Edit || kind == ControlKind::RichEdit; }
bool bCombo(ControlKind kind) { return kind == ControlKind::Combo; }
bool bListView(ControlKind kind) { return kind == ControlKind::ListView; }
bool bPicture(ControlKind kind) { return kind == ControlKind::Image; }

const struct {
  bool (*pIsKind)(ControlKind kind);
  int iNotification;
  const char* szSuffix;
} EVENTS[] = {
    {bClickable, NOTIFY_CLICK, "_OnClick"},
    {bEditable, NOTIFY_SET_FOCUS, "_OnSetFocus"},
    {bEditable, NOTIFY_KILL_FOCUS, "_OnKillFocus"},
    {bCombo, NOTIFY_SELECTION_CHANGED, "_OnSelChange"},
    {bCombo, NOTIFY_EDIT_UPDATE, "_OnEditUpdate"},
    {bCombo, NOTIFY_EDIT_CHANGE, "_OnEditChange"},
    {bCombo, NOTIFY_DROP_UP, "_OnDropUp"},
    {bCombo, NOTIFY_DROP_DOWN, "_OnDropDown"},
    {bIsList, NOTIFY_DOUBLE_CLICK, "_OnDoubleClick"},
    {bIsList, NOTIFY_SELECTION_CHANGED, "_OnSelChange"},
    {bListView, NOTIFY_EDIT_CHANGE, "_OnEditChange"},
    {bIsSetter, NOTIFY_SELECTION_CHANGED, "_OnSelChange"},
    {bPicture, NOTIFY_MOUSE_IN, "_OnMouseIn"},
    {bPicture, NOTIFY_MOUSE_OUT, "_OnMouseOut"},
    {bPicture, NOTIFY_MOUSE_UP, "_OnMouseUp"},
    {bPicture, NOTIFY_MOUSE_DOWN, "_OnMouseDown"},
};

}  // namespace

// ---- the window's commands ----

void COrbitWizard::OnCommand(int iID) {
  static const struct {
    int iID;
    int (COrbitWizard::*pHandler)();
  } COMMANDS[] = {
      {ID_OK, &COrbitWizard::iOnOK},
      {ID_CLOSE, &COrbitWizard::iOnEscape},
      {ID_NEXT, &COrbitWizard::iNextDialog},
      {ID_BACK, &COrbitWizard::iPreviousDialog},
      {ID_CANCEL, &COrbitWizard::iOnCancel},
      {ID_EXIT, &COrbitWizard::iOnExit},
      {ID_SHOW_DIALOG, &COrbitWizard::iShowCurrentDialog},
  };
  for (const auto& row : COMMANDS)
    if (row.iID == iID) {
      (this->*row.pHandler)();
      return;
    }
}

void COrbitWizard::OnControl(BaseControl& control, int iNotification) {
  if (iNotification == NOTIFY_CLICK && control.m_bGrouped) UncheckPartners(control);
  iProcessID(control, iNotification);
}

void COrbitWizard::OnCloseRequest() { iOnCancel(); }

const char* COrbitWizard::szHoldReason() {
  const CNVariable* pReason = m_Variables.pFind("hold_reason");
  return pReason && !pReason->csValue.bEmpty() ? pReason->csValue.Text() : WizardEvents::szHoldReason();
}

void COrbitWizard::OnEndSession() { iLeave(ID_EXIT); }

// Enter: what a press of the dialog's default button does.
int COrbitWizard::iOnOK() {
  for (int i = 0; m_pWizDialogInfo && i < m_pWizDialogInfo->m_Controls.Size(); i++) {
    BaseControl* pControl = m_pWizDialogInfo->m_Controls[i];
    if (pControl->Kind() != ControlKind::Button) continue;
    const CNButton& button = static_cast<const CNButton&>(*pControl);
    if (!button.m_bDefault) continue;
    if (pControl->m_bDisabledNow) return EVERYTHING_IS_OK;
    if (!button.m_iNavigationID) return iProcessID(*pControl, NOTIFY_CLICK);
    OnCommand(button.m_iNavigationID);
    return EVERYTHING_IS_OK;
  }
  return EVERYTHING_IS_OK;
}

// Escape closes only the windows that are dialogs by their kind word.
int COrbitWizard::iOnEscape() {
  if (m_pWizDialogInfo && strstr(m_pWizDialogInfo->m_csKind.Text(), "DIALOG")) OnCloseRequest();
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iLeave(int iEndedBy) {
  m_bOutOfDialogs = false;
  m_iEndedBy = iEndedBy;
  m_View.CloseWindow();
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iOnCancel() { return iLeave(m_bOutOfDialogs ? ID_NEXT : ID_CANCEL); }

int COrbitWizard::iOnExit() { return iLeave(ID_EXIT); }

// ---- events ----

int COrbitWizard::iProcessID(BaseControl& control, int iNotification) {
  const char* szSuffix = nullptr;
  for (const auto& row : EVENTS)
    if (!szSuffix && row.iNotification == iNotification && row.pIsKind(control.Kind())) szSuffix = row.szSuffix;
  // A control without a name or an action has no command: most fields, and every plain text.
  if (!szSuffix || control.m_csName.bEmpty() || !control.m_csAction.Ptr()) return EVERYTHING_IS_OK;
  CNString csCommand;
  csCommand = control.m_csName.Text();
  csCommand.Concat(szSuffix);
  if (!strchr(csCommand.Text(), '(')) csCommand.Concat(control.m_csAction.Text());
  return iProcessCommand(control, csCommand);
}

int COrbitWizard::iProcessCommand(BaseControl& control, const CNString& csCommand) {
  if (csCommand.bEmpty()) return EVERYTHING_IS_OK;
  BaseControl* const pOuterControl = m_pEventControl;
  m_pEventControl = &control;
  int iResult = COMMAND_DONE;
  iDecideNextDialog(m_iCurrentDialog, 3, csCommand.Text(), &iResult);
  m_pEventControl = pOuterControl;
  return iProcessDecideNextDialogAction(iResult);
}

int COrbitWizard::iProcessDecideNextDialogAction(int iResult) {
  static const struct {
    int iResult, iSent;
    bool bSaves;
  } ACTIONS[] = {{COMMAND_FAILED, ID_CANCEL, false}, {COMMAND_EXIT, ID_EXIT, false},
                 {COMMAND_BACK, ID_BACK, false},     {COMMAND_CONTINUE, ID_NEXT, true},
                 {COMMAND_NEXT, ID_NEXT, true},      {COMMAND_GO_TO_DIALOG, ID_SHOW_DIALOG, true}};
  if (iResult == COMMAND_FAILED)
    LogPrintf(
        "ERROR: COrbitWizard::iProcessDecideNextDialogAction -> iDecideNextDialog -> ID_CANCEL -> return "
        "FUNCTION_ERROR");
  if (iResult == COMMAND_EXIT) LogPrintf("EXIT: COrbitWizard::iProcessDecideNextDialogAction -> return ID_EXIT");
  for (const auto& row : ACTIONS) {
    if (row.iResult != iResult) continue;
    if (row.bSaves) iSaveVarFromCurrentDlg(m_pWizDialogInfo);
    if (row.iSent == ID_SHOW_DIALOG) m_iCurrentDialog = m_iNextDialog;
    SendOrPost(row.iSent);
  }
  return iResult == COMMAND_FAILED ? FUNCTION_ERROR : EVERYTHING_IS_OK;
}

void COrbitWizard::SendOrPost(int iID) {
  if (m_bShowing)
    m_View.PostCommand(iID);
  else
    m_View.SendCommand(iID);
}

// ---- forward and back ----

int COrbitWizard::iNextDialog() {
  if (!m_pWizDialogInfo)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iNextDialog -> !m_pWizDialogInfo -> return PRECONDITIONS_NOT_VALID");
  if (!m_View.bHasWindow())
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iNextDialog -> !hDlg -> return PRECONDITIONS_NOT_VALID");
  iSaveVarFromCurrentDlg(m_pWizDialogInfo);
  if (m_pWizDialogInfo->m_csFlow.bEmpty()) {
    iOutOfDialogs();
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: COrbitWizard::iNextDialog -> iNextDialog==-1 -> ID_CANCEL -> return FUNCTION_ERROR");
  }
  int iResult = COMMAND_DONE;
  const int iCode = iDecideNextDialog(m_iCurrentDialog, 0, nullptr, &iResult);
  if (iResult == COMMAND_EXIT) {
    m_iNextDialog = m_iCurrentDialog;
    LogPrintf("EXIT: COrbitWizard::iNextDialog -> return ID_EXIT");
    m_View.SendCommand(ID_EXIT);
    return EVERYTHING_IS_OK;
  }
  if (iCode) {
    m_iNextDialog = m_iCurrentDialog;
    return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iNextDialog -> iDecideNextDialog -> return FUNCTION_ERROR");
  }
  if (iResult == COMMAND_BACK) {
    m_View.SendCommand(ID_BACK);
    return EVERYTHING_IS_OK;
  }
  const bool bStays = m_iNextDialog == m_iCurrentDialog && iResult != COMMAND_GO_TO_DIALOG;
  return bStays ? EVERYTHING_IS_OK : iShowDecided();
}

// Acts on the counter that the flow text left.
int COrbitWizard::iShowDecided() {
  const int iNext = m_iNextDialog;
  m_iNextDialog = m_iCurrentDialog;
  if (iNext == -1) {
    LogPrintf("INFO: COrbitWizard::iNextDialog -> ID_CANCEL");
    return iOutOfDialogs();
  }
  if (iNext < 1 || iNext > DialogCount())
    return iLogReturn(POSTCONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iNextDialog -> iResultDialogNum = %d, window = %s -> return "
                      "POSTCONDITIONS_NOT_VALID",
                      iNext, m_pWizDialogInfo->m_csName.Text());
  m_iCurrentDialog = m_iNextDialog = iNext;
  m_View.SendCommand(ID_SHOW_DIALOG);
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iOutOfDialogs() {
  m_bOutOfDialogs = true;
  m_View.PostCommand(ID_CANCEL);
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iPreviousDialog() {
  if (!m_View.bHasWindow())
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iPreviousDialog -> !hDlg -> return PRECONDITIONS_NOT_VALID");
  iSaveVarFromCurrentDlg(m_pWizDialogInfo);
  if (m_iNumLastDialog == 0)
    return iLogReturn(FUNCTION_ERROR,
                      "EXIT: COrbitWizard::iPreviousDialog -> m_iNumLastDialog==0 (ID_BACK)-> return FUNCTION_ERROR");
  m_iCurrentDialog = m_iNextDialog = m_LastDialogs[m_iNumLastDialog - 1];
  PopHistory();
  m_View.SendCommand(ID_SHOW_DIALOG);
  return EVERYTHING_IS_OK;
}

void COrbitWizard::PushHistory(int iDialog) {
  if (m_iNumLastDialog == MAX_HISTORY)
    memmove(m_LastDialogs, m_LastDialogs + 1, sizeof *m_LastDialogs * static_cast<size_t>(--m_iNumLastDialog));
  m_LastDialogs[m_iNumLastDialog++] = iDialog;
}

void COrbitWizard::PopHistory() {
  if (m_iNumLastDialog > 0) m_iNumLastDialog--;
}
