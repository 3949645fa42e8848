// Conditions. A group in parentheses is one comparison or several joined by "&&" and "||"; comparisons bind closest,
// then "&&". Every operand is evaluated, whatever the others say, because operands may be commands.
#include <cstdlib>

#include "wizard/COrbitWizard.h"
#include "wizard/TextRange.h"

namespace {

const int UNDECIDABLE = -1;
const int OPERATOR_CALL = 6;

// Tested in this order, so that the longer forms win.
const struct {
  const char* szText;
  int iCode;
} COMPARISONS[] = {{"==", 0}, {"!=", 1}, {">=", 3}, {">", 2}, {"<=", 5}, {"<", 4}};

const char NAME_ENDS[] = "!=<>[]()&|";

bool bEqual(const CNString& csA, const CNString& csB) {
  return csA.Ptr() && csB.Ptr() && strcmp(csA.Ptr(), csB.Ptr()) == 0;  // a missing text equals nothing
}

long long Number(const CNString& cs) { return strtoll(cs.Text(), nullptr, 10); }

// Indexed by operator code.
int (*const COMPARE[])(const CNString& csA, const CNString& csB) = {
    [](const CNString& csA, const CNString& csB) -> int { return bEqual(csA, csB); },
    [](const CNString& csA, const CNString& csB) -> int { return !bEqual(csA, csB); },
    [](const CNString& csA, const CNString& csB) -> int { return Number(csA) > Number(csB); },
    [](const CNString& csA, const CNString& csB) -> int { return Number(csA) >= Number(csB); },
    [](const CNString& csA, const CNString& csB) -> int { return Number(csA) < Number(csB); },
    [](const CNString& csA, const CNString& csB) -> int { return Number(csA) <= Number(csB); },
    [](const CNString&, const CNString&) -> int { return UNDECIDABLE; },
    [](const CNString& csA, const CNString& csB) -> int {
      return strcmp(csA.Text(), "TRUE") == 0 && strcmp(csB.Text(), "TRUE") == 0;
    },
    [](const CNString& csA, const CNString& csB) -> int {
      return strcmp(csA.Text(), "TRUE") == 0 || strcmp(csB.Text(), "TRUE") == 0;
    },
};

int iCount(const char* p, const char* pEnd, char c) {
  int iFound = 0;
  for (; p < pEnd; p++) iFound += *p == c;
  return iFound;
}

}  // namespace

struct COrbitWizard::Expression {
  const char* p;
  const char* pEnd;
  int iDepth = 0;
  bool bFailed = false;

  bool bTake(const char* szText) {
    p = range::SkipBlanks(p, pEnd);
    if (!range::bStarts(p, pEnd, szText)) return false;
    p += strlen(szText);
    return true;
  }
};

// A literal or a name as text, or the result of a group, a comparison or a call.
struct COrbitWizard::Operand {
  CNString csText;  // a literal begins with a double quote
  bool bResult = false;
  int iResult = UNDECIDABLE;

  void SetResult(int iNew) {
    static const char* const TEXTS[] = {"\"\"", "\"FALSE\"", "\"TRUE\""};
    bResult = true;
    iResult = iNew == 0 || iNew == 1 ? iNew : UNDECIDABLE;
    csText = TEXTS[iResult + 1];
  }
};

int COrbitWizard::iEvaluateExpression(const char* szText, int iLength, int* pResult) {
  int iUnused;
  if (!pResult) pResult = &iUnused;
  *pResult = UNDECIDABLE;
  // Parentheses within quotes are counted as well: deliberate.
  const char* pEnd = szText && iLength > 0 ? range::LineEnd(szText, szText + iLength) : szText;
  if (!szText || range::SkipBlanks(szText, pEnd) == pEnd || iCount(szText, pEnd, '(') != iCount(szText, pEnd, ')'))
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iEvaluateExpression -> !szText -> return PRECONDITIONS_NOT_VALID");
  Expression run{szText, range::TrimEnd(szText, pEnd)};
  Operand operand;
  ParseOr(run, operand);
  if (run.bFailed || range::SkipBlanks(run.p, run.pEnd) < run.pEnd)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iEvaluateExpression -> *szText -> return PRECONDITIONS_NOT_VALID");
  *pResult = operand.bResult ? operand.iResult : bIsTrue(operand);
  return EVERYTHING_IS_OK;
}

void COrbitWizard::ParseOr(Expression& run, Operand& out) {
  for (ParseAnd(run, out); run.bTake("||");) {
    Operand right;
    ParseAnd(run, right);
    const bool bRight = bIsTrue(right);
    out.SetResult(bIsTrue(out) || bRight);
  }
}

void COrbitWizard::ParseAnd(Expression& run, Operand& out) {
  for (ParseComparison(run, out); run.bTake("&&");) {
    Operand right;
    ParseComparison(run, right);
    const bool bRight = bIsTrue(right);
    out.SetResult(bIsTrue(out) && bRight);
  }
}

void COrbitWizard::ParseComparison(Expression& run, Operand& out) {
  ParseOperand(run, out);
  for (const auto& row : COMPARISONS) {
    if (!run.bTake(row.szText)) continue;
    Operand right;
    ParseOperand(run, right);
    int iResult = UNDECIDABLE;
    if (!run.bFailed && iEvaluateAtom(out.csText.Text(), right.csText.Text(), row.iCode, &iResult)) run.bFailed = true;
    out.SetResult(iResult);
    return;
  }
}

void COrbitWizard::ParseOperand(Expression& run, Operand& out) {
  if (run.bTake("(")) return ParseGroup(run, out);
  if (run.bTake("[")) {  // a result that was computed before
    const char* pClose = range::FindChar(run.p, run.pEnd, ']');
    const char* pTextEnd = pClose ? pClose : run.pEnd;
    const bool bTrue = range::bStartsWord(run.p, pTextEnd, "TRUE");
    out.SetResult(bTrue ? 1 : range::bStartsWord(run.p, pTextEnd, "FALSE") ? 0 : UNDECIDABLE);
    run.p = pClose ? pClose + 1 : run.pEnd;
    return;
  }
  if (run.bTake("\"")) {
    if (run.p < run.pEnd && *run.p == '*') run.p++;
    const char* pClose = range::FindChar(run.p, run.pEnd, '"');
    out.csText = "\"";
    out.csText.Concat(run.p, (pClose ? pClose : run.pEnd) - run.p);
    out.csText.Concat("\"");
    run.p = pClose ? pClose + 1 : run.pEnd;
    return;
  }
  ParseName(run, out);
}

// Behind an opening parenthesis.
void COrbitWizard::ParseGroup(Expression& run, Operand& out) {
  if (run.bTake(")")) return out.SetResult(UNDECIDABLE);
  if (run.iDepth >= MAX_NESTING) {
    run.bFailed = true;
    run.p = run.pEnd;
    return out.SetResult(UNDECIDABLE);
  }
  run.iDepth++;
  ParseOr(run, out);
  run.iDepth--;
  if (!run.bTake(")")) run.bFailed = true;
  if (!out.bResult) out.SetResult(bIsTrue(out));
}

// A variable, a boolean word, or a command with its parameters.
void COrbitWizard::ParseName(Expression& run, Operand& out) {
  const char* pName = run.p;
  while (run.p < run.pEnd && !strchr(NAME_ENDS, *run.p)) run.p++;
  out.csText.Copy(pName, range::TrimEnd(pName, run.p) - pName);
  const bool bCall = run.p < run.pEnd && (*run.p == '(' || *run.p == '[') && !out.csText.bEmpty();
  if (strcmp(out.csText.Text(), "_TRUE") == 0) return out.SetResult(1);
  if (strcmp(out.csText.Text(), "_FALSE") == 0) return out.SetResult(0);
  if (!bCall) return;
  const char* pOpen = run.p;
  const char* pClose =
      *pOpen == '(' ? range::ClosingParenthesis(pOpen, run.pEnd) : range::FindChar(pOpen, run.pEnd, ']');
  run.p = pClose ? pClose + 1 : run.pEnd;
  if (!pClose) {
    run.bFailed = true;
    return;
  }
  CNString csParam;
  csParam.Copy(pOpen + 1, pClose - pOpen - 1);
  int iResult = UNDECIDABLE;
  iEvaluateAtom(out.csText.Text(), csParam.Text(), OPERATOR_CALL, &iResult);
  out.SetResult(iResult);
}

bool COrbitWizard::bIsTrue(const Operand& operand) {
  if (operand.bResult) return operand.iResult == 1;
  CNString csValue;
  PrepareOperand(operand.csText.Text(), csValue);
  return strcmp(csValue.Text(), "TRUE") == 0;
}

// The text of a literal or the value of a variable; null for a missing one.
void COrbitWizard::PrepareOperand(const char* szOperand, CNString& csValue) {
  CNString csOperand;
  csOperand = szOperand;
  const bool bLiteral = *szOperand == '"';
  if (bLiteral) csOperand.SubstituteAll("COrbitWizard::iEvaluateAtom", "csOperand", "\"", "");
  if (strchr(szOperand, '[') && strchr(szOperand, ']')) {
    csOperand.SubstituteAll("COrbitWizard::iEvaluateAtom", "csOperand", "[", "(");
    csOperand.SubstituteAll("COrbitWizard::iEvaluateAtom", "csOperand", "]", ")");
  }
  if (bLiteral)
    csValue = csOperand.Text();
  else
    iGetVariable(csOperand.Text(), 0, csValue);
}

int COrbitWizard::iEvaluateAtom(const char* szVar1, const char* szVar2, int iOperator, int* pResult) {
  int iUnused;
  if (!pResult) pResult = &iUnused;
  *pResult = UNDECIDABLE;
  if (!szVar1)
    return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iEvaluateAtom -> !szVar1 -> return FUNCTION_ERROR");
  if (!szVar2)
    return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iEvaluateAtom -> !szVar2 -> return FUNCTION_ERROR");
  if (!*szVar1 && !*szVar2)
    return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iEvaluateAtom -> !*szVar1 -> return FUNCTION_ERROR");
  if (iOperator == OPERATOR_CALL) {
    if (iExecuteFunction(szVar1, szVar2, 0, pResult, nullptr))
      return iLogReturn(FUNCTION_ERROR,
                        "ERROR: COrbitWizard::iEvaluateAtom -> iExecuteFunction -> return FUNCTION_ERROR");
    return EVERYTHING_IS_OK;
  }
  CNString csValue1, csValue2;
  PrepareOperand(szVar1, csValue1);
  PrepareOperand(szVar2, csValue2);
  if (!csValue1.Ptr() && !csValue2.Ptr())
    return iLogReturn(EVERYTHING_IS_OK,
                      "EXIT: COrbitWizard::iEvaluateAtom -> !csValue1.Ptr() || !csValue2.Ptr() -> return "
                      "EVERYTHING_IS_OK");
  if (iOperator >= 0 && iOperator < static_cast<int>(sizeof COMPARE / sizeof *COMPARE))
    *pResult = COMPARE[iOperator](csValue1, csValue2);
  return EVERYTHING_IS_OK;
}
