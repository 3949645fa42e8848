// Command lines: the engine's own statements, jumps, assignments and calls. The built-in commands that calls end at are
// in OrbitBuiltIns.cpp.
#include "controls/Kinds.h"
#include "wizard/COrbitWizard.h"
#include "wizard/TextRange.h"

namespace {

// The name between two double quotes at or after p. Returns the place where a quote is missing: 1 the opening one, 2
// the closing one, 0 none.
int iQuotedName(const char* p, CNString& csName) {
  const char* pOpen = strchr(p, '"');
  if (!pOpen) return 1;
  const char* pClose = strchr(pOpen + 1, '"');
  if (!pClose) return 2;
  csName.Copy(pOpen + 1, pClose - pOpen - 1);
  return 0;
}

// The text without blanks, quotes and apostrophes at its ends.
void Unquote(const char* szText, CNString& csOut) {
  const char* pEnd = szText + strlen(szText);
  while (szText < pEnd && strchr(" \t\"'", *szText)) szText++;
  while (pEnd > szText && strchr(" \t\"'", pEnd[-1])) pEnd--;
  csOut.Copy(szText, pEnd - szText);
}

bool bIsBox(const BaseControl& control, const char* szName) {
  return control.Kind() == ControlKind::MsgBox && strcmp(control.m_csName.Text(), szName) == 0;
}

// What the expression appends when it is the assigned variable and texts or variables that are added to it; null for
// any other expression.
const char* szAppended(const char* szName, const char* szExpression) {
  const char* pEnd = szExpression + strlen(szExpression);
  const char* p = range::SkipSpace(szExpression, pEnd);
  if (!*szName || strpbrk(szName, "\"+-()") || !range::bStarts(p, pEnd, szName)) return nullptr;
  p = range::SkipBlanks(p + strlen(szName), pEnd);
  if (p == pEnd || *p != '+') return nullptr;
  const char* szTail = ++p;
  if (range::SkipSpace(p, pEnd) == pEnd) return nullptr;
  for (bool bQuoted = false; p < pEnd; p++) {
    if (*p == '"') bQuoted = !bQuoted;
    if (!bQuoted && (*p == '-' || *p == '(')) return nullptr;
  }
  return szTail;
}

}  // namespace

int COrbitWizard::iExecuteCommand(const char* szCommand, int iFlag, int* pCommandResult) {
  int iUnused;
  if (!pCommandResult) pCommandResult = &iUnused;
  *pCommandResult = COMMAND_FAILED;
  if (!szCommand)
    return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iExecuteCommand -> !szCommand -> return FUNCTION_ERROR");
  if (!*szCommand)
    return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iExecuteCommand -> !*szCommand -> return FUNCTION_ERROR");
  const char* pEnd = szCommand + strlen(szCommand);
  const char* p = range::SkipBlanks(szCommand, pEnd);
  // Deliberately only the first letters count.
  static const struct {
    const char* szWord;
    CommandResult result;
  } STATEMENTS[] = {{"BREAK", COMMAND_BREAK}, {"EXIT", COMMAND_EXIT}};
  for (const auto& row : STATEMENTS)
    if (range::bStarts(p, pEnd, row.szWord)) return *pCommandResult = row.result, EVERYTHING_IS_OK;
  if (range::bStarts(p, pEnd, "DIALOG")) return iJumpStatement(p + strlen("DIALOG"), pCommandResult);

  const char* pName = p;
  while (p < pEnd && *p != ' ' && *p != '\t') p++;
  CNString csName;
  csName.Copy(pName, p - pName);
  p = range::SkipBlanks(p, pEnd);
  if (*p == '=') return iAssign(csName.Text(), p + 1, iFlag, pCommandResult);
  if (*p == '(') return iCall(csName.Text(), p + 1, iFlag, pCommandResult);
  return iLogReturn(FUNCTION_ERROR, "EXIT: COrbitWizard::iExecuteCommand -> return FUNCTION_ERROR");
}

// The statement DIALOG "name"; szText is what follows the word.
int COrbitWizard::iJumpStatement(const char* szText, int* pCommandResult) {
  szText += strspn(szText, " \t");
  if (*szText != '"')
    return iLogReturn(FUNCTION_ERROR, "EXIT: COrbitWizard::iExecuteCommand -> Missing \" -> retuirn FUNCTION_ERROR");
  CNString csName;
  if (iQuotedName(szText, csName))
    return iLogReturn(FUNCTION_ERROR,
                      "EXIT: COrbitWizard::iExecuteCommand -> !szSave (missing \") -> return FUNCTION_ERROR");
  if (!iGetDialogNumberByName(csName.Text(), &m_iNextDialog))
    return iLogReturn(FUNCTION_ERROR,
                      "EXIT: COrbitWizard::iExecuteCommand -> iGetDialogNumberByName -> return FUNCTION_ERROR");
  *pCommandResult = COMMAND_GO_TO_DIALOG;
  return EVERYTHING_IS_OK;
}

// A call with the parameters DIALOG "name". An unknown name is told to the user and the action goes on.
int COrbitWizard::iJumpCall(const char* szParam, int* pCommandResult) {
  CNString csName;
  if (const int iMissing = iQuotedName(szParam, csName))
    return iRefuseJump(iMissing == 1 ? "ERROR: COrbitWizard::iExecuteCommand -> !ptrName-> return FUNCTION_ERROR"
                                     : "ERROR: COrbitWizard::iExecuteCommand -> !ptrEnd-> return FUNCTION_ERROR");
  *pCommandResult = COMMAND_GO_TO_DIALOG;
  if (iGetDialogNumberByName(csName.Text(), &m_iNextDialog)) return EVERYTHING_IS_OK;
  *pCommandResult = COMMAND_DONE;
  CNString csMessage;
  csMessage.Printf("COrbitWizard::iExecuteCommand", "csMessage", "Dialog \"%s\" ne postoji!", csName.Text());
  m_View.iShowMessage({csMessage.Text(), "Greška"});
  return iLogReturn(EVERYTHING_IS_OK,
                    "ERROR: COrbitWizard::iExecuteCommand -> iGoToDialogByName -> return EVERYTHING_IS_OK");
}

int COrbitWizard::iRefuseJump(const char* szLine) {
  m_View.iShowMessage({"missing \" in Action parametar", "Syntax Error"});
  return iLogReturn(FUNCTION_ERROR, "%s", szLine);
}

int COrbitWizard::iAssign(const char* szName, const char* szExpression, int iFlag, int* pCommandResult) {
  CNString csValue;
  const char* szTail = szAppended(szName, szExpression);
  bool bAppended = false;
  if (iCalculateValue(szTail ? szTail : szExpression, csValue, iFlag) ||
      (szTail && iAppend(szName, csValue, &bAppended)))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: COrbitWizard::iExecuteCommand -> iCalculateValue -> return FUNCTION_ERROR");
  if (!bAppended) {
    if (!csValue.bEmpty()) iReplaceVarWithText(csValue);
    if (iSetVariable(szName, csValue.Text()))
      return iLogReturn(FUNCTION_ERROR,
                        "ERROR: COrbitWizard::iExecuteCommand -> iSetVariable -> return FUNCTION_ERROR");
    if (!strstr(csValue.Text(), "<%")) m_Variables.MarkPlain(szName);
  }
  *pCommandResult = COMMAND_ASSIGNED;
  return EVERYTHING_IS_OK;
}

// Appends to the variable where it stands, or when that cannot be, makes csTail the whole value. Returns 0, or 9 for a
// value that is too long.
int COrbitWizard::iAppend(const char* szName, CNString& csTail, bool* pAppended) {
  *pAppended = m_Variables.bTakesTail(szName, csTail, MAX_VALUE_LENGTH);
  // The value has no markers, so those of the tail are filled in without it.
  if (*pAppended && strstr(csTail.Text(), "<%")) iReplaceVarWithText(csTail);
  if (*pAppended && m_Variables.bAppendPlain(szName, csTail, MAX_VALUE_LENGTH)) return EVERYTHING_IS_OK;
  CNString csWhole;
  csWhole = "";
  iGetVariable(szName, 0, csWhole);
  csWhole.Concat(csTail.Text());
  if (*pAppended) return iSetVariable(szName, csWhole.Text());
  csTail = static_cast<CNString&&>(csWhole);
  return csTail.Length() > MAX_VALUE_LENGTH ? iRefuseLength() : EVERYTHING_IS_OK;
}

// szText is what follows the opening parenthesis. The first ')' ends the parameters, even a quoted one: deliberate.
int COrbitWizard::iCall(const char* szName, const char* szText, int iFlag, int* pCommandResult) {
  const char* pClose = strchr(szText, ')');
  if (!pClose)
    return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iExecuteCommand -> !ptrSearch -> return FUNCTION_ERROR");
  CNString csParam;
  csParam.Copy(szText, pClose - szText);
  if (strncmp(szName, "MESSAGE_BOX", strlen("MESSAGE_BOX")) == 0)
    return iMessageBoxCommand(csParam.Text(), pCommandResult);
  if (strncmp(csParam.Text(), "DIALOG", strlen("DIALOG")) == 0) return iJumpCall(csParam.Text(), pCommandResult);
  if (iExecuteFunction(szName, csParam.Text(), iFlag, pCommandResult, nullptr))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: COrbitWizard::iExecuteCommand -> iExecuteFunction -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}

// The parameter names a box of the script, or describes one as a control line does. The answer becomes the variable
// msgbox_answer.
int COrbitWizard::iMessageBoxCommand(const char* szParam, int* pCommandResult) {
  CNString csName, csAnswer;
  Unquote(szParam, csName);
  CNMessageBox* pBox = pFindMessageBox(csName.Text());
  CNMessageBox inlineBox;
  const bool bInline = !pBox && strchr(szParam, '"');
  if (bInline) ReadInlineBox(szParam, inlineBox);
  if (!pBox && !bInline)
    LogPrintf("ERROR: COrbitWizard::iExecuteCommand -> MESSAGE_BOX -> !%s -> return EVERYTHING_IS_OK", csName.Text());
  const int iAnswer = pBox || bInline ? iShowBox(pBox ? *pBox : inlineBox, MessageIcon::None) : 0;
  csAnswer.Printf("COrbitWizard::iMessageBoxCommand", "csAnswer", "%d", iAnswer);
  iSetVariable("msgbox_answer", csAnswer.Text());
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

// 'name' "caption", FLAGS > text > text: the control's grammar with its lines on one.
void COrbitWizard::ReadInlineBox(const char* szParam, CNMessageBox& box) {
  CNString csLines;
  csLines = " ";
  bool bQuoted = false;
  const char* pRest = szParam;
  for (const char* p = szParam; *p; p++) {
    if (*p == '"') bQuoted = !bQuoted;
    const bool bMarkerEnd = p > szParam && p[-1] == '%';
    if (*p != '>' || bQuoted || bMarkerEnd) continue;
    csLines.Concat(pRest, p - pRest);
    csLines.Concat("\n");
    pRest = p;
  }
  csLines.Concat(pRest);
  csLines.Concat(strchr(csLines.Text(), '\n') ? "\nEND_MESSAGE_BOX\n" : "\n>\nEND_MESSAGE_BOX\n");
  ScriptReport report(&m_View);
  report.Setup(csLines.Text(), nullptr);
  ScriptContext context{&report, &m_Variables, 1.0};
  const char* pEnd = csLines.Text() + csLines.Length();
  ScriptCursor cursor{csLines.Text(), range::LineEnd(csLines.Text(), pEnd), pEnd};
  box.iReadScript(cursor, context);
}

// In the current dialog, else in any.
CNMessageBox* COrbitWizard::pFindMessageBox(const char* szName) const {
  const int nDialogs = *szName ? DialogCount() : 0;
  for (int i = 0; i <= nDialogs; i++) {
    const DialogInfo* pDialog = i == 0 ? m_pShownDialog.load() : m_Dialogs[i - 1];
    BaseControl* pControl = pDialog && nDialogs ? pDialog->GetBaseControl(szName) : nullptr;
    // Another control of the name does not hide the box.
    for (int j = 0; pControl && !bIsBox(*pControl, szName); j++) pControl = pDialog->m_Controls[j];
    if (pControl) return static_cast<CNMessageBox*>(pControl);
  }
  return nullptr;
}

int COrbitWizard::iShowBox(const CNMessageBox& box, MessageIcon icon) {
  CNString csText, csCaption;
  Substitute(box.m_csText, csText);
  Substitute(box.m_csCaption, csCaption);
  return m_View.iShowMessage(
      {csText.Text(), csCaption.Ptr(), icon == MessageIcon::None ? box.m_Icon : icon, box.m_Buttons});
}

int COrbitWizard::iShowMessageBox(const char* szControlName, MessageIcon icon) {
  const CNMessageBox* pBox = szControlName ? pFindMessageBox(szControlName) : nullptr;
  if (!pBox)
    return iLogReturn(0, "ERROR: COrbitWizard::iShowMessageBox -> !%s -> return 0", szControlName ? szControlName : "");
  return iShowBox(*pBox, icon);
}
