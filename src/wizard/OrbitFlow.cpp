// Flow and action texts. Statements run one after the other until one of them decides what happens next or the text
// ends. Parts that are not to run are read all the same, to find where they end.
#include "wizard/COrbitWizard.h"
#include "wizard/TextRange.h"

struct COrbitWizard::FlowRun {
  const char* p;
  const char* pEnd;
  int iWhich;
  int iResult = COMMAND_DONE;  // what the last statement reported
  int iCode = EVERYTHING_IS_OK;
  bool bDecided = false;
  int iDepth = 0;                    // statements within statements
  int iBlocks = 0;                   // braces that are open
  int iThens = 0;                    // IF statements whose THEN is being read
  const char* pKnownFrom = nullptr;  // where the end of a line was looked for, and where it was found: a line of many
  const char* pKnownEnd = nullptr;   // statements is not searched again for each of them

  bool bAt(const char* szWord) {
    p = range::SkipSpace(p, pEnd);
    return range::bStartsWord(p, pEnd, szWord);
  }
  const char* LineEnd() {
    if (pKnownFrom && p >= pKnownFrom && p <= pKnownEnd) return pKnownEnd;
    pKnownFrom = p;
    return pKnownEnd = range::LineEnd(p, pEnd);
  }
  bool bTake(char c) {
    p = range::SkipSpace(p, pEnd);
    const bool bFound = p < pEnd && *p == c;
    if (bFound) p++;
    return bFound;
  }
  // Actions go on behind a failure: each step of an installation stands for itself.
  bool bIsAction() const { return iWhich == 1 || iWhich == 2; }
  void Decide(int iNewResult) {
    iResult = iNewResult;
    bDecided = true;
  }
  // The end of the command at p: of its line, of its block, or the ELSE behind it; quoted text and parameters hide the
  // last two.
  const char* CommandEnd() {
    const char* pLineEnd = LineEnd();
    bool bQuoted = false, bParam = false;
    for (const char* q = p; q < pLineEnd; q++) {
      if (*q == '"') bQuoted = !bQuoted;
      if (bQuoted) continue;
      if (*q == '(' || *q == ')') bParam = *q == '(';
      if (bParam) continue;
      if (*q == '}' && iBlocks) return q;
      if (iThens && q > p && q[-1] == ' ' && range::bStartsWord(q, pLineEnd, "ELSE")) return q;
    }
    return pLineEnd;
  }
};

// The statements that begin with a word, in the order in which they are tested.
struct COrbitWizard::FlowWord {
  const char* szWord;
  bool bWhole;  // false: deliberately only the first letters count
  void (COrbitWizard::*pRun)(FlowRun& run, bool bExecute);
};

const COrbitWizard::FlowWord COrbitWizard::FLOW_WORDS[] = {
    {"END_DIALOG", false, &COrbitWizard::FlowEndDialog},
    {"FINISH_ACTION", false, &COrbitWizard::FlowFinish},
    {"CONTINUE", false, &COrbitWizard::FlowContinue},
    {"SWITCH", true, &COrbitWizard::FlowSwitch},
    {"IF", true, &COrbitWizard::FlowIf},
};

int COrbitWizard::iDecideNextDialog(int iDialogNumber, int iWhich, const char* szText, int* pCommandResult) {
  int iUnused;
  if (!pCommandResult) pCommandResult = &iUnused;
  *pCommandResult = COMMAND_DONE;
  const DialogInfo* pDialog = GetDialog(iDialogNumber);
  const char* const TEXTS[] = {pDialog ? pDialog->m_csFlow.Ptr() : nullptr,
                               pDialog ? pDialog->m_csBeforeDrawing.Ptr() : nullptr,
                               pDialog ? pDialog->m_csAfterDrawing.Ptr() : nullptr, szText};
  CNString csText;  // a copy: a command may load another script
  csText = iWhich >= 0 && iWhich <= 3 ? TEXTS[iWhich] : nullptr;
  if (csText.bEmpty()) return EVERYTHING_IS_OK;

  if (iWhich == 0) {
    PushHistory(iDialogNumber);
    m_iNextDialog = iDialogNumber;
  }
  FlowRun run{csText.Text(), csText.Text() + csText.Length(), iWhich};
  RunFlow(run);
  *pCommandResult = run.iResult;
  const bool bMoved = m_iNextDialog != iDialogNumber && m_iNextDialog >= 1 && m_iNextDialog <= DialogCount();
  const bool bMoves =
      bMoved && run.iCode == EVERYTHING_IS_OK && run.iResult != COMMAND_EXIT && run.iResult != COMMAND_BACK;
  // The page that is left stands on the history once; a page that stays must not.
  if (iWhich == 0 && !bMoves) PopHistory();
  if (iWhich == 3 && bMoved && run.iResult == COMMAND_GO_TO_DIALOG) PushHistory(iDialogNumber);
  return run.iCode;
}

void COrbitWizard::RunFlow(FlowRun& run) {
  while (!run.bDecided && (run.p = range::SkipSpace(run.p, run.pEnd)) < run.pEnd) {
    const char* pStatement = run.p;
    RunStatement(run, true);
    if (run.p > pStatement) continue;
    LogPrintf("ERROR: COrbitWizard::iDecideNextDialog -> a statement without its beginning");
    run.p = range::NextLine(run.p, run.pEnd);
  }
}

void COrbitWizard::RunStatement(FlowRun& run, bool bExecute) {
  run.p = range::SkipSpace(run.p, run.pEnd);
  bExecute = bExecute && !run.bDecided;
  // These belong to the statement around this one, which is empty here.
  if (run.p == run.pEnd || *run.p == '}' || run.bAt("ELSE") || run.bAt("CASE") || run.bAt("DEFAULT")) return;
  if (run.iDepth >= MAX_NESTING) {
    run.p = run.pEnd;
    LogPrintf("ERROR: COrbitWizard::iDecideNextDialog -> too many statements within each other");
    return FailFlow(run, FUNCTION_ERROR);
  }
  run.iDepth++;
  void (COrbitWizard::*pRun)(FlowRun&, bool) = *run.p == '{' ? &COrbitWizard::RunBlock : &COrbitWizard::RunCommand;
  for (const FlowWord& row : FLOW_WORDS) {
    if (!(row.bWhole ? range::bStartsWord : range::bStarts)(run.p, run.pEnd, row.szWord)) continue;
    run.p += strlen(row.szWord);
    pRun = row.pRun;
    break;
  }
  (this->*pRun)(run, bExecute);
  run.iDepth--;
}

void COrbitWizard::RunBlock(FlowRun& run, bool bExecute) {
  run.p++;
  run.iBlocks++;
  const int iThens = run.iThens;
  run.iThens = 0;
  while (!run.bTake('}') && run.p < run.pEnd) {
    const char* pStatement = run.p;
    RunStatement(run, bExecute);
    if (run.p == pStatement) run.p = range::NextLine(run.p, run.pEnd);
  }
  run.iThens = iThens;
  run.iBlocks--;
}

void COrbitWizard::RunCommand(FlowRun& run, bool bExecute) {
  const char* pCommand = run.p;
  const char* pCommandEnd = run.CommandEnd();
  run.p = pCommandEnd;
  if (!bExecute) return;
  CNString csCommand;
  csCommand.Copy(pCommand, range::TrimEnd(pCommand, pCommandEnd) - pCommand);
  int iResult = COMMAND_FAILED;
  const int iCode = iExecuteCommand(csCommand.Text(), 0, &iResult);
  TakeResult(run, iCode, iResult);
}

// Results that end the text, and what they are handed on as. Any other lets the next statement run.
void COrbitWizard::TakeResult(FlowRun& run, int iCode, int iResult) {
  static const struct {
    int iResult, iHandedOn;
  } DECIDING[] = {{COMMAND_EXIT, COMMAND_EXIT}, {COMMAND_GO_TO_DIALOG, COMMAND_GO_TO_DIALOG},
                  {COMMAND_NEXT, COMMAND_NEXT}, {COMMAND_CONTINUE, COMMAND_NEXT},
                  {COMMAND_BACK, COMMAND_BACK}, {COMMAND_BREAK, COMMAND_BREAK}};
  const int iAlsoFailed = 3;
  if (iCode || iResult == COMMAND_FAILED || iResult == iAlsoFailed) {
    LogPrintf("ERROR: COrbitWizard::iDecideNextDialog -> return FUNCTION_ERROR");
    return FailFlow(run, FUNCTION_ERROR);
  }
  run.iResult = iResult;
  for (const auto& row : DECIDING)
    if (row.iResult == iResult) run.Decide(row.iHandedOn);
  if (run.iResult == COMMAND_NEXT && run.iWhich == 0) MoveAfterNext(run);
}

// The line behind a command that moves on says where to.
void COrbitWizard::MoveAfterNext(FlowRun& run) {
  run.p = range::SkipSpace(run.p, run.pEnd);
  m_iNextDialog = range::bStarts(run.p, run.pEnd, "END_DIALOG") ? -1 : m_iNextDialog + 1;
}

// The fault's line has been logged.
void COrbitWizard::FailFlow(FlowRun& run, int iCode) {
  if (run.bIsAction()) return;
  run.iCode = iCode;
  run.Decide(iCode);  // the two codes are command results as well
}

void COrbitWizard::FlowContinue(FlowRun& run, bool bExecute) {
  run.p = run.CommandEnd();
  if (!bExecute) return;
  m_iNextDialog++;
  run.Decide(COMMAND_DONE);
}

void COrbitWizard::FlowEndDialog(FlowRun& run, bool bExecute) {
  run.p = run.CommandEnd();
  if (!bExecute) return;
  m_iNextDialog = -1;
  run.Decide(COMMAND_DONE);
}

void COrbitWizard::FlowFinish(FlowRun& run, bool bExecute) {
  run.p = run.CommandEnd();
  if (bExecute) run.Decide(COMMAND_DONE);
}

// IF condition THEN statement, with ELSE statement behind it or on the next line. An ELSE belongs to the nearest IF.
void COrbitWizard::FlowIf(FlowRun& run, bool bExecute) {
  const char* pCondition = run.p;
  const char* pLineEnd = run.LineEnd();
  const char* pThen = pCondition;
  for (bool bQuoted = false; pThen < pLineEnd; pThen++) {
    if (*pThen == '"') bQuoted = !bQuoted;
    if (!bQuoted && strchr(" )", pThen[-1]) && range::bStartsWord(pThen, pLineEnd, "THEN")) break;
  }
  run.p = pThen;
  if (pThen == pLineEnd) {
    if (!bExecute) return;
    LogPrintf("ERROR: COrbitWizard::iDecideNextDialog -> Missing THEN -> return SYNTAX_ERROR");
    return FailFlow(run, SYNTAX_ERROR);
  }
  int iTrue = -1;
  if (bExecute && iEvaluateExpression(pCondition, static_cast<int>(pThen - pCondition), &iTrue)) {
    FailFlow(run, FUNCTION_ERROR);
    bExecute = false;
  }
  run.p += strlen("THEN");
  run.iThens++;
  RunStatement(run, bExecute && iTrue == 1);
  run.iThens--;
  if (!run.bAt("ELSE")) return;
  run.p += strlen("ELSE");
  RunStatement(run, bExecute && iTrue != 1);
}

// SWITCH (expression), then CASE (value) and DEFAULT with a statement each; braces may stand around them all.
void COrbitWizard::FlowSwitch(FlowRun& run, bool bExecute) {
  run.p = range::SkipBlanks(run.p, run.pEnd);
  const char* pOpen = run.p;
  const char* pClose = run.p < run.pEnd && *run.p == '(' ? range::ClosingParenthesis(run.p, run.LineEnd()) : nullptr;
  run.p = pClose ? pClose + 1 : run.LineEnd();
  const bool bBraces = run.bTake('{');
  run.iBlocks += bBraces;
  const char* pDefault = nullptr;
  bool bChosen = false;
  for (;;) {
    if (run.bAt("CASE")) {
      run.p += strlen("CASE");
      bChosen |= bFlowCase(run, bExecute && pClose && !bChosen, pOpen, pClose);
    } else if (run.bAt("DEFAULT")) {
      pDefault = run.p += strlen("DEFAULT");
      RunStatement(run, false);
    } else {
      break;
    }
  }
  const char* pAfter = run.p;
  if (bExecute && !bChosen && pDefault) {
    run.p = pDefault;
    RunStatement(run, true);
    run.p = pAfter;
  }
  if (bBraces) run.bTake('}');
  run.iBlocks -= bBraces;
  if (!bExecute || bChosen || pDefault) return;
  LogPrintf("ERROR: COrbitWizard::iDecideNextDialog -> return FUNCTION_ERROR");
  FailFlow(run, FUNCTION_ERROR);
}

// Reads a CASE from its value on; true when its value is the expression's. pExpression is the '(' before it.
bool COrbitWizard::bFlowCase(FlowRun& run, bool bExecute, const char* pExpression, const char* pExpressionEnd) {
  run.p = range::SkipBlanks(run.p, run.pEnd);
  const char* pClose = run.p < run.pEnd && *run.p == '(' ? range::ClosingParenthesis(run.p, run.LineEnd()) : nullptr;
  int iTrue = 0;
  if (bExecute && pClose) {
    CNString csText;
    csText.Copy(pExpression, pExpressionEnd - pExpression);
    csText.Concat(" == ");
    csText.Concat(run.p + 1, pClose - run.p - 1);
    csText.Concat(" )");
    iEvaluateExpression(csText.Text(), static_cast<int>(csText.Length()), &iTrue);
  }
  run.p = pClose ? pClose + 1 : run.LineEnd();
  RunStatement(run, iTrue == 1);
  return iTrue == 1;
}
