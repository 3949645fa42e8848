#include <charconv>

#include "CheckScan.h"
#include "wizard/TextRange.h"

namespace {

// The text between the parentheses that follow, and what stands behind them. False without a pair of parentheses.
bool bTakeParameters(Piece& text, Piece& parameters) {
  const size_t close = text.find(')');
  if (text.empty() || text.front() != '(' || close == Piece::npos) return false;
  parameters = text.substr(1, close - 1);
  text.remove_prefix(close + 1);
  return true;
}

// Takes one whole number with blanks around it.
bool bTakeNumber(Piece& text, Piece& number) {
  text = piece::TrimFront(text);
  size_t length = !text.empty() && text.front() == '-';
  const size_t first = length;
  while (length < text.size() && ScriptText::bIsDigit(text[length])) length++;
  if (length == first) return false;
  number = text.substr(0, length);
  text = piece::TrimFront(text.substr(length));
  return true;
}

class FlagScan {
 public:
  FlagScan(CheckReport& report, const KindRow* pKind) : m_report(report), m_pKind(pKind) {}

  void Run(Piece text) {
    while (!text.empty()) {
      const char c = text.front();
      if (c == '"' || c == '\'') {
        const size_t close = text.find(c, 1);
        text = text.substr(close == Piece::npos ? text.size() : close + 1);
      } else if (!piece::bIsWordLetter(c)) {
        text.remove_prefix(1);
      } else {
        const Piece word = piece::Word(text);
        text.remove_prefix(word.size());
        text = ReadFlag(word, text);
      }
    }
  }

 private:
  // The word and what stands behind it; returns what is left.
  Piece ReadFlag(Piece word, Piece rest) {
    if (!rest.empty() && rest.front() == '.')
      return rest.substr(ScriptText::SkipWord(rest.data(), piece::End(rest)) - rest.data());  // a file's name
    if (word == "TOOLTIP" || word == "TOOLTIP_TIME") return ReadToolTip(word, rest);
    if (!bKnowsFlag(m_pKind, word)) ReportUnknown(word);
    Piece parameters;
    const bool bParameters = bTakeParameters(rest, parameters);
    if (bTakesColor(m_pKind, word) && !(bParameters && bReadColor(parameters)))
      m_report.Add(Rule::ColorForm, word, {word});
    Piece number;
    if (bTakesNumber(word) && !(bParameters && bTakeNumber(parameters, number) && parameters.empty()))
      m_report.Add(Rule::NumberForm, word, {word});
    return rest;
  }

  Piece ReadToolTip(Piece word, Piece rest) {
    Piece text = piece::TrimFront(rest), number;
    if (word == "TOOLTIP_TIME" && bTakeParameters(rest, number)) return rest;
    if (word == "TOOLTIP_TIME" && bTakeNumber(text, number)) return text;
    if (text.empty() || text.front() != '\'') {
      if (word == "TOOLTIP") m_report.Add(Rule::ApostropheMissing, word);
      return rest;
    }
    const size_t close = text.find('\'', 1);
    if (close != Piece::npos) return text.substr(close + 1);
    m_report.Add(Rule::ApostropheMissing, text);
    return text.substr(text.size());
  }

  void ReportUnknown(Piece word) {
    if (bIsFlag(word)) return m_report.Add(Rule::ForeignFlag, word, {word, m_pKind ? m_pKind->keyword : "a dialog"});
    const Piece within = FlagWithin(m_pKind, word);
    if (within.empty())
      m_report.Add(Rule::UnknownFlag, word, {word}, NearMiss(word, AllFlags()));
    else
      m_report.Add(Rule::FlagReadAs, word, {word, within});
  }

  // False without three numbers; numbers out of range are reported.
  bool bReadColor(Piece text) {
    for (int i = 0; i < 3; i++) {
      Piece number;
      if (!bTakeNumber(text, number)) return false;
      int iPart = -1;
      std::from_chars(number.data(), piece::End(number), iPart);
      if (iPart < 0 || iPart > 255) m_report.Add(Rule::ColorRange, number);
      const char cNext = i < 2 ? ',' : '\0';
      if (cNext && (text.empty() || text.front() != cNext)) return false;
      if (cNext) text.remove_prefix(1);
    }
    return text.empty();
  }

  CheckReport& m_report;
  const KindRow* m_pKind;
};

}  // namespace

void ScanFlags(CheckReport& report, Piece flags, const KindRow* pKind) { FlagScan(report, pKind).Run(flags); }
