// The wizard's variables: reading, writing, substitution into texts, and the value calculator of assignments.
#include "wizard/COrbitWizard.h"
#include "wizard/TextRange.h"

namespace {

// Bounds of one substitution: values within values, replacements in all, and the length of the result.
const int MAX_VALUE_DEPTH = 32;
const int MAX_REPLACEMENTS = 20000;
const long MAX_RESULT_LENGTH = 1L << 20;

// Text subtraction: the first digit of a text is the number of characters to cut off; a number that is not below the
// length cuts nothing.
void CutCharacters(const char* szCount, CNString& csValue) {
  const long lCount = *szCount >= '0' && *szCount <= '9' ? *szCount - '0' : 0;
  if (lCount < csValue.Length()) csValue.SetLength(csValue.Length() - lCount);
}

// The end of a marker's name that begins at p: the next '%', or the place before a character followed by '>'.
const char* MarkerNameEnd(const char* p, const char* pEnd) {
  while (p < pEnd && *p != '%' && !(p + 1 < pEnd && p[1] == '>')) p++;
  return p;
}

}  // namespace

int COrbitWizard::iSetVariable(const char* szVar, const char* szValue) {
  if (!szVar)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iSetVariable -> !szVar -> return PRECONDITIONS_NOT_VALID");
  if (!*szVar)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iSetVariable -> !*szVar  -> return PRECONDITIONS_NOT_VALID");
  if (!szValue)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iSetVariable -> !szValue  -> return PRECONDITIONS_NOT_VALID");
  m_Variables.Set(szVar, szValue);
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iGetVariable(const char* szVar, int, CNString& csValue, char cOperator) {
  if (!szVar)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iGetVariable -> !szVar -> return PRECONDITIONS_NOT_VALID");
  if (!*szVar)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iGetVariable -> !*szVar  -> return PRECONDITIONS_NOT_VALID");
  CNVariable* pVariable = m_Variables.pFind(szVar);
  if (!pVariable)
    return iLogReturn(POSTCONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iGetVariable -> !szValue  -> return POSTCONDITIONS_NOT_VALID");
  if (cOperator == '-')
    CutCharacters(pVariable->csValue.Text(), csValue);
  else if (cOperator == '+')
    csValue.Concat(pVariable->csValue.Text());
  else
    csValue = pVariable->csValue.Text();
  return EVERYTHING_IS_OK;
}

const char* COrbitWizard::szValue(const char* szVar) {
  CNVariable* pVariable = szVar ? m_Variables.pFind(szVar) : nullptr;
  return pVariable ? pVariable->csValue.Text() : "";
}

int COrbitWizard::iReplaceVarWithText(CNString& csText) {
  if (!csText.Ptr())
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iReplaceVarWithText -> !szText -> return PRECONDITIONS_NOT_VALID");
  if (csText.bEmpty())
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iReplaceVarWithText -> !*szText -> return PRECONDITIONS_NOT_VALID");
  if (!strstr(csText.Ptr(), "<%")) return EVERYTHING_IS_OK;
  CNString csOut;
  csOut = "";
  int iBudget = MAX_REPLACEMENTS;
  const bool bDone = bExpand(csText.Ptr(), csText.Ptr() + csText.Length(), csOut, 0, iBudget);
  csText = static_cast<CNString&&>(csOut);
  if (!bDone)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: COrbitWizard::iReplaceVarWithText -> variables refer to each other -> return "
                      "FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}

// Appends the text with its markers replaced. False when a bound was met; the rest is then appended as it stands.
bool COrbitWizard::bExpand(const char* pText, const char* pEnd, CNString& csOut, int iDepth, int& iBudget) {
  const char* pSearch = pText;
  while (const char* pMarker = range::FindText(pSearch, pEnd, "<%")) {
    const char* pName = pMarker + 2;
    const char* pNameEnd = MarkerNameEnd(pName, pEnd);
    if (!range::bStarts(pNameEnd, pEnd, "%>")) {  // no marker after all: the two characters are text
      pSearch = pName;
      continue;
    }
    csOut.Concat(pText, pMarker - pText);
    pText = pSearch = pNameEnd + 2;
    if (iDepth > MAX_VALUE_DEPTH || --iBudget < 0 || csOut.Length() > MAX_RESULT_LENGTH) {
      csOut.Concat(pMarker, pEnd - pMarker);
      return false;
    }
    CNString csName;
    csName.Copy(pName, pNameEnd - pName);
    CNVariable* pVariable = m_Variables.pFind(csName.Text());
    if (!pVariable) {
      LogPrintf("ERROR: COrbitWizard::iReplaceVarWithText -> !%s", csName.Text());
      csOut.Concat(" ");  // deliberately a blank, not an empty text
      continue;
    }
    const char* szValue = pVariable->csValue.Text();
    if (!bExpand(szValue, szValue + strlen(szValue), csOut, iDepth + 1, iBudget)) {
      csOut.Concat(pText, pEnd - pText);
      return false;
    }
  }
  csOut.Concat(pText, pEnd - pText);
  return true;
}

int COrbitWizard::iCalculateValue(const char* szText, CNString& csValue, int iFlag) {
  if (!szText)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iCalculateValue -> !szText -> return PRECONDITIONS_NOT_VALID");
  if (!*szText)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iCalculateValue -> !*szText  -> return PRECONDITIONS_NOT_VALID");
  csValue = "";
  const char* p = szText;
  const char* pEnd = szText + strlen(szText);
  for (char cOperator = '+'; (p = range::SkipSpace(p, pEnd)) < pEnd;) {
    if (*p == '+' || *p == '-') {
      cOperator = *p++;
      continue;
    }
    const char *pOpen, *pClose;
    if (bIsCall(p, pEnd, pOpen, pClose)) {
      CNString csName, csParam, csOutput;
      csName.Copy(p, range::TrimEnd(p, pOpen) - p);
      csParam.Copy(pOpen + 1, pClose - pOpen - 1);
      int iCommandResult = COMMAND_FAILED;
      if (iExecuteFunction(csName.Text(), csParam.Text(), iFlag, &iCommandResult, &csOutput))
        return iLogReturn(FUNCTION_ERROR,
                          "ERROR: COrbitWizard::iCalculateValue -> iExecuteFunction -> return FUNCTION_ERROR");
      csValue = csOutput.Text();
      return EVERYTHING_IS_OK;
    }
    p = pAddTerm(p, pEnd, cOperator, csValue);
    cOperator = '+';
    // A text that doubles itself would otherwise take all the memory there is.
    if (csValue.Length() > MAX_RESULT_LENGTH)
      return iLogReturn(
          FUNCTION_ERROR,
          "ERROR: COrbitWizard::iCalculateValue -> csValue.Length()>MAX_RESULT_LENGTH -> return FUNCTION_ERROR");
  }
  return EVERYTHING_IS_OK;
}

// True when an unquoted term begins at pText and holds a pair of parentheses.
bool COrbitWizard::bIsCall(const char* pText, const char* pEnd, const char*& pOpen, const char*& pClose) const {
  pOpen = pText;
  while (pOpen < pEnd && !strchr("\"+-(", *pOpen)) pOpen++;
  pClose = pOpen < pEnd && *pOpen == '(' ? range::FindChar(pOpen, pEnd, ')') : nullptr;
  return pClose != nullptr;
}

// Adds the literal or the variable at pText to the value; returns the place behind the term.
const char* COrbitWizard::pAddTerm(const char* pText, const char* pEnd, char cOperator, CNString& csValue) {
  const bool bLiteral = *pText == '"';
  const char* pTerm = bLiteral ? pText + 1 : pText;
  const char* pTermEnd = pTerm;
  while (pTermEnd < pEnd && !strchr(bLiteral ? "\"" : "\"+-\r\n", *pTermEnd)) pTermEnd++;
  CNString csTerm;
  csTerm.Copy(pTerm, (bLiteral ? pTermEnd : range::TrimEnd(pTerm, pTermEnd)) - pTerm);
  if (!bLiteral) {
    iGetVariable(csTerm.Text(), 0, csValue, cOperator);
    return pTermEnd;
  }
  if (cOperator == '-')
    CutCharacters(csTerm.Text(), csValue);
  else if (strcmp(csTerm.Text(), "__") != 0)  // "__" stands for an empty text
    csValue.Concat(csTerm.Text());
  return pTermEnd < pEnd ? pTermEnd + 1 : pTermEnd;
}
