// Showing a dialog, filling its controls in, reading its fields back, and the doors to its controls for commands.
#include "controls/Kinds.h"
#include "wizard/COrbitWizard.h"
#include "wizard/FieldKinds.h"
#include "wizard/TextRange.h"

namespace {

bool bIsEdit(const BaseControl& control) { return control.Kind() == ControlKind::Edit; }
bool bIsKeptRichEdit(const BaseControl& control) {
  return control.Kind() == ControlKind::RichEdit && control.bHasFlag("REMEMBER");
}
bool bIsCombo(const BaseControl& control) {
  return control.Kind() == ControlKind::Combo && !control.bHasFlag("NO_VAR_SAVE");
}
// Check boxes, lists and the like; a hidden list carries data for commands and has no value.
bool bIsOtherField(const BaseControl& control) {
  const ControlKind kind = control.Kind();
  if (control.bHasFlag("NO_VAR_SAVE") || (bIsTextList(kind) && control.bHasFlag("HIDE"))) return false;
  return kind == ControlKind::CheckBox || bIsList(kind) || bIsSetter(kind);
}
// The controls that show and edit the variable of their name.
bool bIsField(const BaseControl& control) {
  return bIsEdit(control) || control.Kind() == ControlKind::RichEdit || control.Kind() == ControlKind::Combo ||
         bIsOtherField(control);
}
bool bHasCaption(const BaseControl& control) {
  return control.Kind() == ControlKind::Button || control.Kind() == ControlKind::Static ||
         control.Kind() == ControlKind::GroupBox || control.Kind() == ControlKind::RichEdit ||
         control.Kind() == ControlKind::Progress || bIsEdit(control);
}

}  // namespace

// ---- showing ----

int COrbitWizard::iShowCurrentDialog() {
  DialogInfo* pDialog = GetDialog(m_iCurrentDialog);
  if (!pDialog)
    return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iShowCurrentDialog -> !pDialog -> return FUNCTION_ERROR");
  m_pShownDialog = nullptr;
  for (int i = 0; i < pDialog->m_Controls.Size(); i++)
    pDialog->m_Controls[i]->m_bDisabledNow = (pDialog->m_Controls[i]->m_dwStyle & STYLE_DISABLED) != 0;
  m_FilledTexts.RemoveAll();
  m_bOutOfDialogs = false;
  if (!m_View.bCreateDialog(*pDialog))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: COrbitWizard::iShowCurrentDialog -> !m_View.bCreateDialog -> return FUNCTION_ERROR");
  m_pWizDialogInfo = pDialog;
  m_pShownDialog = pDialog;
  m_iNextDialog = m_iCurrentDialog;
  const unsigned uShowing = ++m_uShowings;
  FillControls();
  const int iBefore = iRunAction(1);
  // A command may have shown another dialog, or ended the wizard.
  const auto bGone = [&] { return uShowing != m_uShowings || !m_View.bHasWindow(); };
  if (bGone()) return EVERYTHING_IS_OK;
  CNString csCaption;
  Substitute(pDialog->m_csCaption, csCaption);
  m_View.SetCaption(csCaption.Text());
  FillControls();
  m_View.ShowDialog();
  // So may the event of the field that gets the keyboard.
  if (bGone()) return EVERYTHING_IS_OK;
  // A dialog that is to be left at once is drawn all the same: the wizard may refuse to leave it.
  if (iBefore == COMMAND_DONE) iRunAction(2);
  return EVERYTHING_IS_OK;
}

// Runs an action text and asks for what it decided; COMMAND_DONE when the dialog stays.
int COrbitWizard::iRunAction(int iWhich) {
  static const int LEAVING[] = {COMMAND_EXIT, COMMAND_BACK, COMMAND_CONTINUE, COMMAND_NEXT, COMMAND_GO_TO_DIALOG};
  int iResult = COMMAND_DONE;
  iDecideNextDialog(m_iCurrentDialog, iWhich, nullptr, &iResult);
  for (const int iLeaving : LEAVING) {
    if (iLeaving != iResult) continue;
    m_bShowing = true;
    iProcessDecideNextDialogAction(iResult);
    m_bShowing = false;
    return iResult;
  }
  return COMMAND_DONE;
}

// Substitution for showing: a null text gives a null text.
void COrbitWizard::Substitute(const CNString& csIn, CNString& csOut) {
  csOut = csIn.Ptr();
  if (!csOut.bEmpty()) iReplaceVarWithText(csOut);
}

// The first call fills every control in; a further one those whose text has changed since.
void COrbitWizard::FillControls() {
  for (int i = 0; i < m_pWizDialogInfo->m_Controls.Size(); i++) {
    if (i >= m_FilledTexts.Size()) m_FilledTexts.Add(new CNString, 1);
    FillControl(*m_pWizDialogInfo->m_Controls[i], *m_FilledTexts[i]);
  }
}

// csBefore is what the control was given last, everything in one text.
void COrbitWizard::FillControl(const BaseControl& control, CNString& csBefore) {
  if (!control.szWindowClass() && !control.pItemControl()) return;
  CNString csText, csCaption, csToolTip, csAll, csItem;
  CNCharArray items;
  csAll = "";
  const bool bText = bShownText(control, csText);
  if (control.Kind() == ControlKind::CheckBox) Substitute(control.m_csCaption, csCaption);
  Substitute(control.m_csToolTip, csToolTip);
  CNCharArray written;
  const bool bItems = control.bItemTexts(written);
  for (int i = 0; i < written.Size(); i++) {
    csItem = written[i];
    if (!csItem.bEmpty()) iReplaceVarWithText(csItem);
    items.Add(csItem.Text(), 1);
    csAll.Concat(csItem.Text());
    csAll.Concat("\n");
  }
  for (const CNString* pPart : {&csToolTip, &csCaption}) {
    csAll.Concat(pPart->Text());
    csAll.Concat("\n");
  }
  csAll.Concat(bText ? csText.Text() : "");
  const bool bSame = csBefore.Ptr() && strcmp(csBefore.Ptr(), csAll.Text()) == 0;
  if (bItems && !bSame) m_View.bSetItems(control, items);
  if (const CNItemControl* pHolder = control.pItemControl()) CheckItems(*pHolder);
  if (bSame) return;
  csBefore = static_cast<CNString&&>(csAll);
  if (!csToolTip.bEmpty()) m_View.bSetToolTip(control, csToolTip.Text());
  if (csCaption.Ptr()) m_View.bSetCaption(control, csCaption.Text());
  if (bText) m_View.bSetText(control, csText.Text());
}

// The items that have a variable of their own are ticked when it is "1"; their tooltips are filled in.
void COrbitWizard::CheckItems(const CNItemControl& control) {
  CNString csVariable;
  for (int i = 0; i < control.m_Items.Size(); i++) {
    Substitute(control.m_Items[i]->m_csToolTip, control.m_Items[i]->m_csShownToolTip);
    control.m_Items[i]->FlagArgument("VAR", csVariable);
    const CNVariable* pVariable = csVariable.bEmpty() ? nullptr : m_Variables.pFind(csVariable.Text());
    if (pVariable) m_View.bCheckItem(control, i, strcmp(pVariable->csValue.Text(), "1") == 0);
    // The choice in a bar's box is kept with the item.
    if (control.m_Items[i]->bIs("COMBO"))
      control.m_Items[i]->m_csCaption = szValue(control.m_Items[i]->m_csName.Text());
  }
}

void COrbitWizard::SaveItems(const CNItemControl& control) {
  CNString csVariable;
  for (int i = 0; i < control.m_Items.Size(); i++) {
    control.m_Items[i]->FlagArgument("VAR", csVariable);
    bool bChecked = false;
    if (!csVariable.bEmpty() && m_View.bIsItemChecked(control, i, bChecked))
      iSetVariable(csVariable.Text(), bChecked ? "1" : "0");
  }
}

// A cell that can be edited and says nothing but <%name%> is that variable, once the person has changed it.
void COrbitWizard::SaveCells(const CNListView& list) {
  CNString csVariable, csBefore;
  ItemLook look;
  for (int i = 0; i < list.m_Items.Size(); i++) {
    const CNItem& item = *list.m_Items[i];
    for (int j = 0; item.bIs("ITEM") && j < item.m_Shown.Size(); j++) {
      item.MarkedVariable(j, csVariable);
      if (csVariable.bEmpty() || !list.bCanEdit(j)) continue;
      csBefore = item.szText(j);
      iReplaceVarWithText(csBefore);
      const char* szNow = item.szShown(j, look);
      if (strcmp(szBehindLook(csBefore.Text(), look), szNow) != 0) iSetVariable(csVariable.Text(), szNow);
    }
  }
}

// What the control is to show; false when it shows no text of ours.
bool COrbitWizard::bShownText(const BaseControl& control, CNString& csText) {
  CNVariable* pVariable =
      bIsField(control) && !control.m_csName.bEmpty() ? m_Variables.pFind(control.m_csName.Text()) : nullptr;
  if (pVariable)
    Substitute(pVariable->csValue, csText);
  else if (bHasCaption(control))
    Substitute(control.m_csCaption, csText);
  else
    return false;
  return true;
}

// ---- fields ----

int COrbitWizard::iSaveVarFromCurrentDlg(DialogInfo* pWizDialogInfo) {
  if (!pWizDialogInfo)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: COrbitWizard::iSaveVarFromCurrentDlg -> !pWizDialogInfo -> return PRECONDITIONS_NOT_VALID");
  for (const auto pIsKind : {bIsEdit, bIsKeptRichEdit, bIsCombo, bIsOtherField}) SaveKind(*pWizDialogInfo, pIsKind);
  return EVERYTHING_IS_OK;
}

void COrbitWizard::SaveKind(const DialogInfo& dialog, bool (*pIsKind)(const BaseControl& control)) {
  CNString csText;
  for (int i = 0; i < dialog.m_Controls.Size(); i++) {
    const BaseControl& control = *dialog.m_Controls[i];
    if (!pIsKind(control)) continue;
    if (const CNItemControl* pHolder = control.pItemControl()) SaveItems(*pHolder);
    if (control.Kind() == ControlKind::ListView) SaveCells(static_cast<const CNListView&>(control));
    if (control.m_csName.bEmpty()) continue;
    if (m_View.bGetText(control, csText)) iSetVariable(control.m_csName.Text(), csText.Text());
  }
}

BaseControl* COrbitWizard::pFieldShown(const char* szName) const {
  const DialogInfo* pDialog = m_pShownDialog;
  for (int i = 0; pDialog && szName && *szName && i < pDialog->m_Controls.Size(); i++) {
    BaseControl* pControl = pDialog->m_Controls[i];
    if (bIsField(*pControl) && strcmp(pControl->m_csName.Text(), szName) == 0) return pControl;
  }
  return nullptr;
}

int COrbitWizard::iSetField(const char* szName, const char* szValue) {
  const int iResult = iSetVariable(szName, szValue);
  const BaseControl* pControl = iResult ? nullptr : pFieldShown(szName);
  if (pControl) m_View.bSetText(*pControl, szValue);
  return iResult;
}

bool COrbitWizard::csGetField(const char* szName, CNString& csValue) {
  const BaseControl* pControl = pFieldShown(szName);
  if (pControl && m_View.bGetText(*pControl, csValue)) return true;
  CNVariable* pVariable = szName ? m_Variables.pFind(szName) : nullptr;
  if (pVariable) csValue = pVariable->csValue.Text();
  return pVariable != nullptr;
}

// A box of a group that has just been checked is the group's only one.
void COrbitWizard::UncheckPartners(const BaseControl& control) {
  CNString csState;
  if (!m_View.bGetText(control, csState) || strcmp(csState.Text(), "1") != 0) return;
  for (int i = 0; i < control.m_Partners.Size(); i++) m_View.bSetText(*control.m_Partners[i], "0");
}

// ---- controls by name ----

BaseControl* COrbitWizard::GetBaseControl(const char* szControlName) const {
  const DialogInfo* pDialog = m_pShownDialog;
  return pDialog ? pDialog->GetBaseControl(szControlName) : nullptr;
}

bool COrbitWizard::CWSetWindowText(const char* szControlName, const char* szText) {
  if (!szControlName || !*szControlName)
    return iLogReturn(0, "ERROR: COrbitWizard::CWSetWindowText -> !szControlName || !*szControlName -> return FALSE");
  const BaseControl* pControl = GetBaseControl(szControlName);
  return pControl && szText && m_View.bSetText(*pControl, szText);
}

bool COrbitWizard::CWGetWindowText(const char* szControlName, CNString& csText) {
  if (!szControlName || !*szControlName)
    return iLogReturn(0, "ERROR: COrbitWizard::CWGetWindowText -> !szControlName || !*szControlName -> return FALSE");
  const BaseControl* pControl = GetBaseControl(szControlName);
  return pControl && m_View.bGetText(*pControl, csText);
}

bool COrbitWizard::CWSetProgress(const char* szControlName, int iPercent) {
  if (!szControlName || !*szControlName)
    return iLogReturn(0, "ERROR: COrbitWizard::CWSetProgress -> !szControlName || !*szControlName -> return FALSE");
  const BaseControl* pControl = GetBaseControl(szControlName);
  return pControl && m_View.bSetProgress(*pControl, iPercent < 0 ? 0 : iPercent > 100 ? 100 : iPercent);
}

intptr_t COrbitWizard::CWSendMessage(const char* szControlName, unsigned uMessage, uintptr_t wParam, intptr_t lParam) {
  if (!szControlName || !*szControlName)
    return iLogReturn(-1, "ERROR: COrbitWizard::CWSendMessage -> !szControlName || !*szControlName -> return -1");
  const BaseControl* pControl = GetBaseControl(szControlName);
  return pControl ? m_View.lSendMessage(*pControl, uMessage, wParam, lParam) : -1;
}

int COrbitWizard::iGetDirectoryDialog(const char* szTitle, CNString& csFolder) {
  if (!szTitle || !*szTitle)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: COrbitWizard::iGetDirectoryDialog -> !szTitle || !*szTitle -> return PRECONDITIONS_NOT_VALID");
  if (!m_View.bHasWindow())
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iGetDirectoryDialog -> !hDlg -> return PRECONDITIONS_NOT_VALID");
  if (!m_View.bChooseFolder(szTitle, csFolder))
    return iLogReturn(POSTCONDITIONS_NOT_VALID,
                      "INFO: COrbitWizard::iGetDirectoryDialog -> !bChooseFolder -> return POSTCONDITIONS_NOT_VALID");
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iGetFileDialog(const char* szTitle, CNString& csFile) {
  if (!szTitle || !*szTitle)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iGetFileDialog -> !szTitle || !*szTitle -> return PRECONDITIONS_NOT_VALID");
  if (!m_View.bHasWindow())
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iGetFileDialog -> !hDlg -> return PRECONDITIONS_NOT_VALID");
  if (!m_View.bChooseFile(szTitle, csFile))
    return iLogReturn(POSTCONDITIONS_NOT_VALID,
                      "INFO: COrbitWizard::iGetFileDialog -> !bChooseFile -> return POSTCONDITIONS_NOT_VALID");
  return EVERYTHING_IS_OK;
}
