// The statements of flow and action texts, found the way the engine finds them.
#include "CheckPasses.h"
#include "wizard/TextRange.h"

namespace {

const int MAX_NESTING = 100;

class FlowCheck {
 public:
  FlowCheck(CheckReport& report, CommandCheck& commands, Piece text, FlowKind kind)
      : m_report(report), m_commands(commands), m_p(text.data()), m_pEnd(piece::End(text)), m_kind(kind) {}

  void Run() {
    bool bDecided = false, bReported = false;
    while (m_p = range::SkipSpace(m_p, m_pEnd), m_p < m_pEnd) {
      if (bDecided && !bReported) bReported = bReportUnreachable();
      const char* const pStatement = m_p;
      bDecided |= bStatement();
      if (m_p > pStatement) continue;
      ReportAlone();
      m_p = range::NextLine(m_p, m_pEnd);
    }
  }

 private:
  // Statements that begin with a word, in the order in which the engine tests them.
  struct Word {
    Piece word;
    bool bWhole;
    bool (FlowCheck::*pCheck)();
  };

  bool bAt(const char* szWord) {
    m_p = range::SkipSpace(m_p, m_pEnd);
    return range::bStartsWord(m_p, m_pEnd, szWord);
  }
  bool bTake(char c) {
    m_p = range::SkipSpace(m_p, m_pEnd);
    const bool bFound = m_p < m_pEnd && *m_p == c;
    m_p += bFound;
    return bFound;
  }
  Piece Rest() const { return piece::Between(m_p, m_pEnd); }

  // What other languages write for ELSE IF, when it stands at p; or empty. All of them end in IF.
  static Piece ElseIf(const char* p, const char* pEnd) {
    for (const Piece word : {Piece("ELSEIF"), Piece("ELSIF"), Piece("ELIF")})
      if (range::bStartsWord(p, pEnd, word.data())) return word;
    return {};
  }

  // A word or brace without the statement that it belongs to.
  void ReportAlone() {
    static const struct {
      const char* szWord;
      const char* szOwner;
    } ROWS[] = {{"ELSE", "IF"}, {"CASE", "SWITCH"}, {"DEFAULT", "SWITCH"}};
    for (const auto& row : ROWS)
      if (bAt(row.szWord)) return m_report.Add(Rule::StatementAlone, m_p, {row.szWord, row.szOwner});
    if (m_p < m_pEnd && *m_p == '}') m_report.Add(Rule::StatementAlone, m_p, {"'}'", "'{'"});
  }

  // A control is in the wrong place anyhow.
  bool bReportUnreachable() {
    if (!bBeginsControl(Rest())) m_report.Add(Rule::Unreachable, m_p);
    return true;
  }

  // True when nothing behind the statement runs.
  bool bStatement() {
    static const Word WORDS[] = {{"END_DIALOG", false, &FlowCheck::bEnd},
                                 {"FINISH_ACTION", false, &FlowCheck::bEnd},
                                 {"CONTINUE", false, &FlowCheck::bContinue},
                                 {"SWITCH", true, &FlowCheck::bSwitch},
                                 {"IF", true, &FlowCheck::bIf}};
    m_p = range::SkipSpace(m_p, m_pEnd);
    if (m_p == m_pEnd || *m_p == '}' || bAt("ELSE") || bAt("CASE") || bAt("DEFAULT")) return false;
    if (m_iDepth >= MAX_NESTING) {
      m_report.Add(Rule::TooDeep, m_p);
      m_p = m_pEnd;
      m_bTooDeep = true;
      return false;
    }
    if (const Piece word = ElseIf(m_p, m_pEnd); !word.empty()) {
      m_report.Add(Rule::NotStatement, m_p, {word}, " (did you mean 'ELSE IF'?)");
      m_p += word.size() - 2;
    }
    bool (FlowCheck::*pCheck)() = *m_p == '{' ? &FlowCheck::bBlock : &FlowCheck::bCommand;
    for (const Word& row : WORDS) {
      if (!(row.bWhole ? range::bStartsWord : range::bStarts)(m_p, m_pEnd, row.word.data())) continue;
      const Piece word = piece::Word(Rest());
      if (!row.bWhole && word != row.word) m_report.Add(Rule::ReadAs, word, {word, row.word});
      m_pWord = m_p;
      m_p += row.bWhole ? row.word.size() : word.size();
      pCheck = row.pCheck;
      break;
    }
    m_iDepth++;
    const bool bDecides = (this->*pCheck)();
    m_iDepth--;
    return bDecides;
  }

  // The end of the command at m_p, as the engine finds it, or in front of an ELSEIF, which is reported.
  const char* CommandEnd() const {
    const char* const pLineEnd = range::LineEnd(m_p, m_pEnd);
    bool bQuoted = false, bParameters = false;
    for (const char* p = m_p; p < pLineEnd; p++) {
      if (*p == '"') bQuoted = !bQuoted;
      if (bQuoted) continue;
      if (*p == '(' || *p == ')') bParameters = *p == '(';
      if (bParameters) continue;
      if (*p == '}' && m_iBlocks) return p;
      if (!m_iThens || p == m_p || p[-1] != ' ') continue;
      if (range::bStartsWord(p, pLineEnd, "ELSE") || !ElseIf(p, pLineEnd).empty()) return p;
    }
    return pLineEnd;
  }

  Piece TakeCommand() {
    const char* const pCommand = m_p;
    m_p = CommandEnd();
    return piece::Trim(piece::Between(pCommand, m_p));
  }

  bool bCommand() { return m_commands.bCommand(TakeCommand()); }

  bool bEnd() {
    const Piece tail = TakeCommand();
    if (!tail.empty()) m_report.Add(Rule::TextIgnored, tail);
    return true;
  }

  bool bContinue() {
    if (m_kind == FlowKind::LastFlow) m_report.Add(Rule::NoNextDialog, m_pWord);
    return bEnd();
  }

  bool bBlock() {
    const char* const pOpen = m_p++;
    const int iThens = m_iThens;
    bool bDecides = false, bReported = false, bClosed;
    m_iThens = 0;
    m_iBlocks++;
    while (!(bClosed = bTake('}')) && m_p < m_pEnd) {
      if (bDecides && !bReported) bReported = bReportUnreachable();
      const char* const pStatement = m_p;
      bDecides |= bStatement();
      if (m_p > pStatement) continue;
      ReportAlone();
      m_p = range::NextLine(m_p, m_pEnd);
    }
    m_iThens = iThens;
    m_iBlocks--;
    if (!bClosed) ReportOpen(pOpen);
    return bDecides;
  }

  void ReportOpen(const char* pBrace) {
    if (!m_bTooDeep) m_report.Add(Rule::BraceOpen, pBrace);
  }

  // IF condition THEN statement ELSE statement.
  bool bIf() {
    const char* const pIf = m_pWord;
    const char* const pCondition = m_p;
    const char* const pLineEnd = range::LineEnd(m_p, m_pEnd);
    const char* pQuote = nullptr;  // the one that is open
    for (; m_p < pLineEnd; m_p++) {
      if (*m_p == '"') pQuote = pQuote ? nullptr : m_p;
      if (!pQuote && strchr(" )", m_p[-1]) && range::bStartsWord(m_p, pLineEnd, "THEN")) break;
    }
    if (m_p == pLineEnd) {
      m_report.Add(pQuote ? Rule::QuoteMissing : Rule::ThenMissing, pQuote ? pQuote : pIf);
      if (bAt("THEN")) m_p = range::LineEnd(m_p, m_pEnd);
      return false;
    }
    m_commands.Condition(piece::Between(pCondition, m_p));
    m_p += 4;
    m_iThens++;
    const bool bThenDecides = bStatement();
    m_iThens--;
    if (bAt("ELSE"))
      m_p += 4;
    else if (ElseIf(m_p, m_pEnd).empty())
      return false;
    const bool bElseDecides = bStatement();
    return bThenDecides && bElseDecides;
  }

  // The text between the parentheses behind SWITCH or CASE, which begins at pWord; the condition's faults are reported.
  void ReadValue(const char* pWord, Piece word) {
    m_p = range::SkipBlanks(m_p, m_pEnd);
    const char* const pLineEnd = range::LineEnd(m_p, m_pEnd);
    const char* const pClose = m_p < m_pEnd && *m_p == '(' ? range::ClosingParenthesis(m_p, pLineEnd) : nullptr;
    if (pClose)
      m_commands.Condition(piece::Between(m_p + 1, pClose));
    else
      m_report.Add(Rule::ValueForm, pWord, {word});
    m_p = pClose ? pClose + 1 : pLineEnd;
  }

  bool bSwitch() {
    const char* const pSwitch = m_pWord;
    ReadValue(pSwitch, "SWITCH");
    const char* const pBrace = range::SkipSpace(m_p, m_pEnd);
    const bool bBraces = bTake('{');
    m_iBlocks += bBraces;
    bool bDefault = false, bDecides = true;
    for (;;) {
      if (bAt("CASE")) {
        m_p += 4;
        ReadValue(m_p - 4, "CASE");
      } else if (bAt("DEFAULT")) {
        m_p += 7;
        bDefault = true;
      } else {
        break;
      }
      const bool bBranchDecides = bStatement();
      bDecides = bDecides && bBranchDecides;
    }
    if (bBraces && !bTake('}')) ReportOpen(pBrace);
    m_iBlocks -= bBraces;
    if (!bDefault && m_kind != FlowKind::Action) m_report.Add(Rule::NoDefault, pSwitch);
    return bDefault && bDecides;
  }

  CheckReport& m_report;
  CommandCheck& m_commands;
  const char* m_p;
  const char* m_pWord = nullptr;  // the word that the statement began with
  const char* const m_pEnd;
  const FlowKind m_kind;
  int m_iDepth = 0;         // statements within statements
  int m_iBlocks = 0;        // braces that are open
  int m_iThens = 0;         // IF statements whose THEN is being read
  bool m_bTooDeep = false;  // the rest was given up
};

}  // namespace

void CheckFlowText(CheckReport& report, CommandCheck& commands, Piece text, FlowKind kind) {
  FlowCheck(report, commands, text, kind).Run();
}
