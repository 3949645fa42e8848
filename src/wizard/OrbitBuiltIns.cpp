// The commands that every wizard has.
#include "wizard/COrbitWizard.h"
#include "wizard/TextRange.h"

struct COrbitWizard::BuiltIn {
  const char* szName;
  const char* szAlso;  // null: the name must be equal; else it must contain both texts
  int (COrbitWizard::*pHandler)(const char* szParam, int* pCommandResult, CNString* pOutput);
  const char* szFailure;  // the line for a handler that fails
};

// The first row that matches wins. A name with "link_mail_ex" is a "link_mail" and deliberately has no row.
const COrbitWizard::BuiltIn COrbitWizard::BUILT_INS[] = {
    {"FillRecentFiles", nullptr, &COrbitWizard::iFillRecent,
     "ERROR: COrbitWizard::iExecuteFunction -> iFillRecentFiles -> return FUNCTION_ERROR"},
    {"OpenRecentFile", nullptr, &COrbitWizard::iOpenRecent,
     "ERROR: COrbitWizard::iExecuteFunction -> iOpenRecentFile -> return FUNCTION_ERROR"},
    {"RecordMacro", nullptr, &COrbitWizard::iRecordMacro, nullptr},
    {"PlayMacro", nullptr, &COrbitWizard::iPlayMacro, nullptr},
    {"link_next", "_OnClick", &COrbitWizard::iLinkNext, nullptr},
    {"link_web", "_OnClick", &COrbitWizard::iLinkWeb, nullptr},
    {"link_mail", "_OnClick", &COrbitWizard::iLinkMail, nullptr},
    {"Next", nullptr, &COrbitWizard::iPostNext, nullptr},
    {"Back", nullptr, &COrbitWizard::iPostBack, nullptr},
    {"EnableControl", nullptr, &COrbitWizard::iEnableControl,
     "ERROR: COrbitWizard::iExecuteFunction -> iEnableControl -> return FUNCTION_ERROR"},
    {"DisableControl", nullptr, &COrbitWizard::iDisableControl,
     "ERROR: COrbitWizard::iExecuteFunction -> iDisableControl -> return FUNCTION_ERROR"},
    {"ShowControl", nullptr, &COrbitWizard::iShowControl,
     "ERROR: COrbitWizard::iExecuteFunction -> iShowControl -> return FUNCTION_ERROR"},
    {"HideControl", nullptr, &COrbitWizard::iHideControl,
     "ERROR: COrbitWizard::iExecuteFunction -> iHideControl -> return FUNCTION_ERROR"},
    {"HideWizard", nullptr, &COrbitWizard::iHideWizard,
     "ERROR: COrbitWizard::iExecuteFunction -> iHideWizard -> return FUNCTION_ERROR"},
    {"ShowWizard", nullptr, &COrbitWizard::iShowWizard,
     "ERROR: COrbitWizard::iExecuteFunction -> iShowWizard -> return FUNCTION_ERROR"},
    {"EndsWith", nullptr, &COrbitWizard::iEndsWith, nullptr},
    {"NotEndsWith", nullptr, &COrbitWizard::iNotEndsWith, nullptr},
    {"Strlen", nullptr, &COrbitWizard::iStrlen, nullptr},
    {"btn_set_var_quit_OnClick", nullptr, &COrbitWizard::iSetVarAndQuit, nullptr},
};

const COrbitWizard::BuiltIn* COrbitWizard::pFindBuiltIn(const char* szCommand) {
  for (const BuiltIn& row : BUILT_INS)
    if (row.szAlso ? strstr(szCommand, row.szName) && strstr(szCommand, row.szAlso)
                   : strcmp(szCommand, row.szName) == 0)
      return &row;
  return nullptr;
}

bool COrbitWizard::bIsBuiltIn(const char* szCommand) { return pFindBuiltIn(szCommand) != nullptr; }

int COrbitWizard::iExecuteFunction(const char* szCommand, const char* szParam, int, int* pCommandResult,
                                   CNString* pOutput) {
  int iUnused;
  if (!pCommandResult) pCommandResult = &iUnused;
  *pCommandResult = COMMAND_FAILED;
  if (!szCommand)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iExecuteFunction -> !szCommand -> return PRECONDITIONS_NOT_VALID");
  if (!*szCommand)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iExecuteFunction -> !*szCommand -> return PRECONDITIONS_NOT_VALID");
  if (!szParam)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iExecuteFunction -> !szParam -> return PRECONDITIONS_NOT_VALID");
  const BuiltIn* pRow = pFindBuiltIn(szCommand);
  if (!pRow) {
    *pCommandResult = COMMAND_DONE;  // an unknown name is deliberately no error
    return EVERYTHING_IS_OK;
  }
  if ((this->*pRow->pHandler)(szParam, pCommandResult, pOutput))
    return iLogReturn(FUNCTION_ERROR, "%s", pRow->szFailure ? pRow->szFailure : szCommand);
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iFillRecentFiles(const char*, int*) { return FUNCTION_ERROR; }

int COrbitWizard::iOpenRecentFile(const char*, int*) { return FUNCTION_ERROR; }

int COrbitWizard::iFillRecent(const char* szParam, int* pCommandResult, CNString*) {
  return iFillRecentFiles(szParam, pCommandResult);
}

int COrbitWizard::iOpenRecent(const char* szParam, int* pCommandResult, CNString*) {
  return iOpenRecentFile(szParam, pCommandResult);
}

int COrbitWizard::iRecordMacro(const char*, int* pCommandResult, CNString*) {
  *pCommandResult = COMMAND_DONE;
  return iLogReturn(EVERYTHING_IS_OK, "INFO: COrbitWizard::iExecuteFunction -> RecordMacro -> no macro recorder");
}

int COrbitWizard::iPlayMacro(const char*, int* pCommandResult, CNString*) {
  *pCommandResult = COMMAND_DONE;
  return iLogReturn(EVERYTHING_IS_OK, "INFO: COrbitWizard::iExecuteFunction -> PlayMacro -> no macro recorder");
}

// Marks the control whose event is being run as a link that was followed.
void COrbitWizard::VisitLink() {
  if (!m_pEventControl) return;
  m_pEventControl->m_bVisited = true;
  m_View.Redraw(*m_pEventControl);
}

int COrbitWizard::iLinkNext(const char* szParam, int* pCommandResult, CNString*) {
  VisitLink();
  iSetVariable("link_next_var", szParam);
  m_View.PostCommand(ID_NEXT);
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

// A shell that refuses must not end the wizard: the line in the log is all that comes of it.
int COrbitWizard::iOpenLink(const char* szParam, int* pCommandResult) {
  VisitLink();
  *pCommandResult = COMMAND_DONE;
  if (!m_View.bOpenLink(szParam))
    return iLogReturn(EVERYTHING_IS_OK, "ERROR: COrbitWizard::iOpenLink -> !m_View.bOpenLink(%s)", szParam);
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iLinkWeb(const char* szParam, int* pCommandResult, CNString*) {
  return iOpenLink(szParam, pCommandResult);
}

int COrbitWizard::iLinkMail(const char* szParam, int* pCommandResult, CNString*) {
  return iOpenLink(szParam, pCommandResult);
}

int COrbitWizard::iPostNext(const char*, int* pCommandResult, CNString*) {
  m_View.PostCommand(ID_NEXT);
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iPostBack(const char*, int* pCommandResult, CNString*) {
  m_View.PostCommand(ID_BACK);
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iSetControlState(const char* szParam, bool (WizardView::*pSet)(const BaseControl&, bool), bool bOn,
                                   int* pResult) {
  CNString csName;
  ScriptText::CopyTrimmed(szParam, szParam + strlen(szParam), csName);
  BaseControl* pControl = csName.bEmpty() ? nullptr : GetBaseControl(csName.Text());
  if (!pControl || !(m_View.*pSet)(*pControl, bOn)) return FUNCTION_ERROR;
  *pResult = COMMAND_DONE;
  if (pSet == &WizardView::bEnable) pControl->m_bDisabledNow = !bOn;
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iEnableControl(const char* szParam, int* pCommandResult, CNString*) {
  return iSetControlState(szParam, &WizardView::bEnable, true, pCommandResult);
}

int COrbitWizard::iDisableControl(const char* szParam, int* pCommandResult, CNString*) {
  return iSetControlState(szParam, &WizardView::bEnable, false, pCommandResult);
}

int COrbitWizard::iShowControl(const char* szParam, int* pCommandResult, CNString*) {
  return iSetControlState(szParam, &WizardView::bShow, true, pCommandResult);
}

int COrbitWizard::iHideControl(const char* szParam, int* pCommandResult, CNString*) {
  return iSetControlState(szParam, &WizardView::bShow, false, pCommandResult);
}

int COrbitWizard::iHideWizard(const char*, int* pCommandResult, CNString*) {
  if (!m_View.bHasWindow()) return FUNCTION_ERROR;
  m_View.ShowWindow(false);
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iShowWizard(const char*, int* pCommandResult, CNString*) {
  if (!m_View.bHasWindow()) return FUNCTION_ERROR;
  m_View.ShowWindow(true);
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

// A literal in double quotes, or the value of a variable. False (logged) for a missing one.
bool COrbitWizard::bOperandValue(const char* pText, const char* pEnd, CNString& csValue) {
  CNString csOperand;
  ScriptText::CopyTrimmed(pText, pEnd, csOperand);
  if (*csOperand.Text() != '"') return iGetVariable(csOperand.Text(), 0, csValue) == EVERYTHING_IS_OK;
  csValue = csOperand.Text();
  csValue.SubstituteAll("COrbitWizard::bOperandValue", "csValue", "\"", "");
  return true;
}

void COrbitWizard::CompareEnds(const char* szParam, int iWhenEqual, int* pCommandResult) {
  *pCommandResult = COMMAND_DONE;
  const char* pSeparator = strchr(szParam, ';');
  CNString csText, csEnd;
  if (!pSeparator || !bOperandValue(szParam, pSeparator, csText) ||
      !bOperandValue(pSeparator + 1, szParam + strlen(szParam), csEnd))
    return;
  const long lOffset = csText.Length() - csEnd.Length();
  const bool bEqual = lOffset >= 0 && strcmp(csText.Text() + lOffset, csEnd.Text()) == 0;
  *pCommandResult = bEqual ? iWhenEqual : 1 - iWhenEqual;
}

int COrbitWizard::iEndsWith(const char* szParam, int* pCommandResult, CNString*) {
  CompareEnds(szParam, 1, pCommandResult);
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iNotEndsWith(const char* szParam, int* pCommandResult, CNString*) {
  CompareEnds(szParam, 0, pCommandResult);
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iStrlen(const char* szParam, int* pCommandResult, CNString* pOutput) {
  *pCommandResult = COMMAND_DONE;
  CNString csValue;
  if (bOperandValue(szParam, szParam + strlen(szParam), csValue) && pOutput)
    pOutput->Printf("COrbitWizard::iStrlen", "pOutput", "%d", static_cast<int>(csValue.Length()));
  return EVERYTHING_IS_OK;
}

// name;value sets a variable, any other number of parts sets none; the wizard ends in either case: deliberate.
int COrbitWizard::iSetVarAndQuit(const char* szParam, int* pCommandResult, CNString*) {
  const char* pSeparator = strchr(szParam, ';');
  if (pSeparator && !strchr(pSeparator + 1, ';')) {
    CNString csName;
    csName.Copy(szParam, pSeparator - szParam);
    iSetVariable(csName.Text(), pSeparator + 1);
  }
  *pCommandResult = COMMAND_EXIT;
  return EVERYTHING_IS_OK;
}
