// Conditions, read as the engine reads them: "||" around "&&" around comparisons, groups in parentheses.
#include <algorithm>

#include "CheckCommand.h"
#include "wizard/TextRange.h"

namespace {

const int MAX_NESTING = 100;

class ConditionCheck {
 public:
  ConditionCheck(CheckReport& report, ScriptNames& names, CommandCheck& commands)
      : m_report(report), m_names(names), m_commands(commands) {}

  void Run(Piece text) {
    m_rest = text;
    ReadOr();
    m_rest = piece::TrimFront(m_rest);
    if (!m_rest.empty()) Fail(Rule::ConditionRest, m_rest.data());
  }

 private:
  // What other languages write where a condition breaks off.
  static std::string Hint(Piece rest) {
    static const struct {
      Piece written, meant;
    } ROWS[] = {{"=", "=="}, {"&", "&&"}, {"AND", "&&"}, {"and", "&&"}, {"|", "||"}, {"OR", "||"}, {"or", "||"}};
    for (const auto& row : ROWS)
      if (piece::bStarts(rest, row.written)) return " (did you mean '" + std::string(row.meant) + "'?)";
    return "";
  }

  bool bTake(Piece text) {
    m_rest = piece::TrimFront(m_rest);
    if (!piece::bStarts(m_rest, text)) return false;
    m_rest.remove_prefix(text.size());
    return true;
  }

  void ReadOr() {
    do ReadAnd();
    while (bTake("||"));
  }

  void ReadAnd() {
    do ReadComparison();
    while (bTake("&&"));
  }

  void ReadComparison() {
    ReadOperand();
    for (const Piece comparison : {Piece("=="), Piece("!="), Piece(">="), Piece(">"), Piece("<="), Piece("<")})
      if (bTake(comparison)) return ReadOperand();
  }

  void ReadOperand() {
    if (bTake("(")) return ReadGroup();
    if (bTake("[")) return SkipTo(']');
    if (bTake("\"")) {
      if (m_rest.find('"') == Piece::npos) Fail(Rule::QuoteMissing, m_rest.data() - 1);
      return SkipTo('"');
    }
    ReadName();
  }

  void SkipTo(char c) {
    const size_t at = m_rest.find(c);
    m_rest = m_rest.substr(at == Piece::npos ? m_rest.size() : at + 1);
  }

  void ReadGroup() {
    if (bTake(")")) return Fail(Rule::OperandMissing, m_rest.data() - 1);
    if (m_iDepth >= MAX_NESTING) return Fail(Rule::TooDeep, m_rest.data());
    m_iDepth++;
    ReadOr();
    m_iDepth--;
    if (!bTake(")")) Fail(Rule::ConditionRest, m_rest.data());
  }

  // A variable, a boolean word, or a command with its parameters.
  void ReadName() {
    const size_t end = std::min(m_rest.size(), m_rest.find_first_of("!=<>[]()&|"));
    const Piece name = piece::Trim(m_rest.substr(0, end));
    const char* const pPlace = m_rest.data();
    m_rest.remove_prefix(end);
    if (name.empty()) return Fail(Rule::OperandMissing, pPlace);
    if (name == "_TRUE" || name == "_FALSE") return;
    if (m_rest.empty() || (m_rest.front() != '(' && m_rest.front() != '[')) return m_names.ReadsVariable(name);
    const char* const pOpen = m_rest.data();
    const char* const pEnd = piece::End(m_rest);
    const char* const pClose =
        *pOpen == '(' ? range::ClosingParenthesis(pOpen, pEnd) : range::FindChar(pOpen, pEnd, ']');
    if (!pClose) return Fail(Rule::ParenthesisMissing, pOpen);
    m_commands.Call(std::string(name), name, piece::Between(pOpen + 1, pClose));
    m_rest = piece::Between(pClose + 1, pEnd);
  }

  // One fault is enough for a condition: what follows it is read wrong.
  void Fail(Rule rule, const char* pPlace) {
    const std::string hint = rule == Rule::ConditionRest ? Hint(piece::Between(pPlace, piece::End(m_rest))) : "";
    if (!m_bFailed) m_report.Add(rule, pPlace, {}, hint);
    m_bFailed = true;
    m_rest = {};
  }

  CheckReport& m_report;
  ScriptNames& m_names;
  CommandCheck& m_commands;
  Piece m_rest;
  int m_iDepth = 0;
  bool m_bFailed = false;
};

}  // namespace

void CommandCheck::Condition(Piece text) {
  const Piece shown = piece::Trim(text);
  const auto opening = std::count(shown.begin(), shown.end(), '('),
             closing = std::count(shown.begin(), shown.end(), ')');
  if (shown.empty()) return m_report.Add(Rule::OperandMissing, text);
  if (opening != closing)
    return m_report.Add(Rule::Parentheses, shown, {std::to_string(opening), std::to_string(closing)});
  ConditionCheck(m_report, m_names, *this).Run(shown);
}
