// The wizard's variables: reading, writing, substitution into texts, and the value calculator of assignments.
#include "wizard/COrbitWizard.h"
#include "wizard/TextRange.h"

namespace {

// Bounds of one substitution beside the length of its result: values within values, replacements in all.
const int MAX_VALUE_DEPTH = 32;
const int MAX_REPLACEMENTS = 20000;

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

// Where a call of the unquoted term at pText opens, or null when it is none. pLastClose is the text's last ')'.
const char* pCallOpens(const char* pText, const char* pLastClose) {
  while (pText < pLastClose && !strchr("\"+-(", *pText)) pText++;
  return pText < pLastClose && *pText == '(' ? pText : nullptr;
}

}  // namespace

struct COrbitWizard::Substitution {
  CNString csOut;
  int iBudget = MAX_REPLACEMENTS;
  bool bBounded = false;
  CNVariables missing;  // the names that were told: each of them once
};

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
  Substitution run;
  run.csOut = "";
  const bool bDone = bExpand(run, csText.Ptr(), csText.Ptr() + csText.Length(), 0);
  csText = static_cast<CNString&&>(run.csOut);
  if (!bDone)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: COrbitWizard::iReplaceVarWithText -> variables refer to each other -> return "
                      "FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}

// Appends the text with its markers replaced. False when a bound was met; the rest is then appended as it stands.
bool COrbitWizard::bExpand(Substitution& run, const char* pText, const char* pEnd, int iDepth) {
  const char* pSearch = pText;
  while (const char* pMarker = range::FindText(pSearch, pEnd, "<%")) {
    const char* pNameEnd = MarkerNameEnd(pMarker + 2, pEnd);
    if (!range::bStarts(pNameEnd, pEnd, "%>")) {  // no marker after all: the two characters are text
      pSearch = pMarker + 2;
      continue;
    }
    run.csOut.Concat(pText, pMarker - pText);
    pText = pSearch = pReplaceMarker(run, pMarker, pNameEnd, iDepth);
    if (!run.bBounded) continue;
    run.csOut.Concat(pText, pEnd - pText);
    return false;
  }
  run.csOut.Concat(pText, pEnd - pText);
  return true;
}

// Appends the value of the marker, in turn with its markers replaced, and returns the place behind the marker. When a
// bound is met here the marker stays text.
const char* COrbitWizard::pReplaceMarker(Substitution& run, const char* pMarker, const char* pNameEnd, int iDepth) {
  if (iDepth > MAX_VALUE_DEPTH || --run.iBudget < 0 || run.csOut.Length() > MAX_VALUE_LENGTH) {
    run.bBounded = true;
    return pMarker;
  }
  CNString csName;
  csName.Copy(pMarker + 2, pNameEnd - pMarker - 2);
  const CNVariable* pVariable = m_Variables.pFind(csName.Text());
  if (pVariable) {
    bExpand(run, pVariable->csValue.Text(), pVariable->csValue.Text() + strlen(pVariable->csValue.Text()), iDepth + 1);
    return pNameEnd + 2;
  }
  run.csOut.Concat(" ");  // deliberately a blank, not an empty text
  if (run.missing.pFind(csName.Text())) return pNameEnd + 2;
  run.missing.Set(csName.Text(), "");
  LogPrintf("ERROR: COrbitWizard::iReplaceVarWithText -> !%s", csName.Text());
  return pNameEnd + 2;
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
  const char* pLastClose = strrchr(szText, ')');
  for (char cOperator = '+'; (p = range::SkipSpace(p, pEnd)) < pEnd;) {
    if (*p == '+' || *p == '-') {
      cOperator = *p++;
      continue;
    }
    if (const char* pOpen = pCallOpens(p, pLastClose)) {
      const char* pClose = range::FindChar(pOpen, pEnd, ')');
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
    if (csValue.Length() > MAX_VALUE_LENGTH) return iRefuseLength();
  }
  return EVERYTHING_IS_OK;
}

// A text that doubles itself would otherwise take all the memory there is.
int COrbitWizard::iRefuseLength() {
  return iLogReturn(
      FUNCTION_ERROR,
      "ERROR: COrbitWizard::iCalculateValue -> csValue.Length()>MAX_VALUE_LENGTH -> return FUNCTION_ERROR");
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
