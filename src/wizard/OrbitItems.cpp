// Items of menus, bars and the like that were chosen, and keys that the script gives commands to.
#include <cstring>

#include "controls/MenuKinds.h"
#include "wizard/COrbitWizard.h"

void COrbitWizard::OnItem(BaseControl& item) {
  if (item.Kind() == ControlKind::Item) KeepChoice(static_cast<CNItem&>(item));
  CNString csCommand;
  ItemCommand(item, csCommand);
  iProcessCommand(item, csCommand);
}

// A choice in a menu or bar holds at once, also for the command that follows: nothing of it is left to be saved.
void COrbitWizard::KeepChoice(CNItem& item) {
  if (item.bIs("COMBO") && !item.m_csName.bEmpty()) iSetVariable(item.m_csName.Text(), item.m_csCaption.Text());
  CNString csVariable;
  item.FlagArgument("VAR", csVariable);
  const DialogInfo* pDialog = csVariable.bEmpty() ? nullptr : m_pShownDialog.load();
  for (int i = 0; pDialog && i < pDialog->m_Controls.Size(); i++) {
    const BaseControl& control = *pDialog->m_Controls[i];
    const bool bKind = control.Kind() == ControlKind::MenuBar || control.Kind() == ControlKind::RightMenu ||
                       control.Kind() == ControlKind::Toolbar || control.Kind() == ControlKind::Rebar;
    const int iItem = bKind ? control.pItemControl()->m_Items.Find(&item) : -1;
    if (iItem < 0) continue;
    const bool bTicked = strcmp(szValue(csVariable.Text()), "1") != 0;
    iSetVariable(csVariable.Text(), bTicked ? "1" : "0");
    m_View.bCheckItem(*control.pItemControl(), iItem, bTicked);
  }
}

// The wizard's own table comes first, in the order of the lines; then that of the dialog.
int COrbitWizard::iTranslateKeyAccelerators(int iKey, unsigned uModifiers) {
  if (!m_View.bHasWindow())
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iTranslateKeyAccelerators -> !m_hDlg -> return PRECONDITIONS_NOT_VALID");
  BaseControl* pFound = nullptr;
  for (int i = 1; i <= DialogCount() && !pFound; i++)
    pFound = pAccelerator(*GetDialog(i), ControlKind::GlobalAccelerator, {iKey, uModifiers});
  if (!pFound && m_pShownDialog) pFound = pAccelerator(*m_pShownDialog, ControlKind::Accelerator, {iKey, uModifiers});
  if (!pFound) return FUNCTION_ERROR;
  OnItem(*pFound);
  return EVERYTHING_IS_OK;
}

BaseControl* COrbitWizard::pAccelerator(const DialogInfo& dialog, ControlKind kind, const KeyChord& chord) {
  for (int i = 0; i < dialog.m_Controls.Size(); i++) {
    BaseControl* pControl = dialog.m_Controls[i];
    if (pControl->Kind() == kind && static_cast<const CNKeyAccelerators*>(pControl)->bIs(chord)) return pControl;
  }
  return nullptr;
}
