// One control's line: name, texts, tooltip, words of its kind, size, flags and action, in the order of the grammar.
#include <algorithm>

#include "CheckScan.h"
#include "wizard/TextRange.h"

namespace {

const Piece WORD_ACTION = "ACTION", WORD_TOOLTIP = "TOOLTIP";

class LineScan {
 public:
  LineScan(CheckReport& report, ScannedControl& control) : m_report(report), m_control(control) {}

  void Run(Piece rest) {
    const char* const pEnd = piece::End(rest);
    rest = ReadName(rest);
    if (const char* const pQuote = LoneQuote(rest)) Break(Rule::QuoteMissing, piece::Between(pQuote, pEnd));
    while (!(rest = piece::TrimFront(rest)).empty() && !bAtFlags(rest) && !bAtWord(rest, WORD_ACTION))
      rest = ReadPart(rest);
    CheckSize(rest);
    const char* const pAction = range::FindWord(rest.data(), pEnd, WORD_ACTION.data());
    m_control.flags = piece::Between(rest.data(), pAction ? pAction : pEnd);
    if (!m_control.bBroken) ScanFlags(m_report, m_control.flags, m_control.pKind);
    if (pAction) ReadAction(piece::Between(pAction + WORD_ACTION.size(), pEnd));
  }

 private:
  static bool bAtWord(Piece text, Piece word) { return range::bStartsWord(text.data(), piece::End(text), word.data()); }
  // A flag without its comma begins the list as well, so that it is the only fault.
  bool bAtFlags(Piece rest) {
    if (rest.front() == ',') return true;
    const Piece word = piece::Word(rest);
    if (m_control.bBroken || bIs(OWN_WORDS) || word.empty() || !bIsFlag(word) || piece::bStarts(word, "IDB_"))
      return false;
    m_report.Add(Rule::CommaMissing, word, {word});
    return true;
  }
  bool bIs(unsigned trait) const { return m_control.pKind->traits & trait; }

  Piece ReadName(Piece rest) {
    const size_t glued = std::min(rest.size(), rest.find_first_of(" \t,\""));
    if (glued > 0) m_report.Add(Rule::WordIgnored, rest, {rest.substr(0, glued)});
    rest = piece::TrimFront(rest.substr(glued));
    if (rest.empty() || rest.front() != '\'') return rest;
    const size_t close = rest.find('\'', 1);
    if (close == Piece::npos) {
      Break(Rule::ApostropheMissing, rest);
      return rest.substr(1);
    }
    m_control.name = rest.substr(1, close - 1);
    return rest.substr(close + 1);
  }

  // The double quote that has no partner, or null; a tooltip's text may hold any.
  static const char* LoneQuote(Piece text) {
    const char* const pEnd = piece::End(text);
    for (const char* p = text.data(); p < pEnd; p++) {
      const char* pClose = p;
      if (*p == '"') pClose = range::FindClosingQuote(p + 1, pEnd);
      if (!pClose) return p;
      if (*p == 'T' && range::bStartsWord(p, pEnd, WORD_TOOLTIP.data())) {
        const char* const pOpen = range::SkipBlanks(p + WORD_TOOLTIP.size(), pEnd);
        if (pOpen < pEnd && *pOpen == '\'') pClose = range::FindChar(pOpen + 1, pEnd, '\'');
      }
      if (pClose) p = pClose;
    }
    return nullptr;
  }

  // What follows cannot be told apart any more.
  void Break(Rule rule, Piece place) {
    if (!m_control.bBroken) m_report.Add(rule, place);
    m_control.bBroken = true;
    m_report.GiveUpLine(place.data());
  }

  // A part that stands before the flags; returns what is left.
  Piece ReadPart(Piece rest) {
    const char c = rest.front();
    if (c == '"') return ReadString(rest);
    if (bAtWord(rest, WORD_TOOLTIP)) return ReadToolTip(rest.substr(WORD_TOOLTIP.size()));
    if (ScriptText::bIsDigit(c) || (c == '-' && rest.size() > 1 && ScriptText::bIsDigit(rest[1])))
      return ReadNumber(rest);
    return ReadWord(rest);
  }

  Piece ReadString(Piece rest) {
    const char* const pClose = range::FindClosingQuote(rest.data() + 1, piece::End(rest));
    if (!pClose) return rest.substr(1);  // reported as a lone one
    m_control.strings.push_back(piece::Between(rest.data() + 1, pClose));
    if (!bIs(STRINGS)) m_nNumbers = 0;  // the numbers before a caption are not read
    return piece::Between(pClose + 1, piece::End(rest));
  }

  Piece ReadToolTip(Piece rest) {
    const Piece text = piece::TrimFront(rest);
    const size_t close = text.empty() || text.front() != '\'' ? Piece::npos : text.find('\'', 1);
    if (close != Piece::npos) return text.substr(close + 1);
    Break(Rule::ApostropheMissing, text);
    return rest;
  }

  Piece ReadNumber(Piece rest) {
    const Piece number = rest.substr(0, rest.find_first_not_of("0123456789", 1));
    if (number.front() == '-') m_report.Add(Rule::ReadAs, number, {number, number.substr(1)});
    m_nNumbers++;
    return rest.substr(number.size());
  }

  Piece ReadWord(Piece rest) {
    const char* pEnd = std::max(ScriptText::SkipWord(rest.data(), piece::End(rest)), rest.data() + 1);
    const size_t close = rest.front() == '(' && bIs(OWN_WORDS) ? rest.find(')') : Piece::npos;
    if (close != Piece::npos) pEnd = rest.data() + close + 1;  // a group is one word
    const Piece word = piece::Between(rest.data(), pEnd);
    rest.remove_prefix(word.size());
    if (m_control.bBroken || bIs(OWN_WORDS) || piece::bStarts(word, "IDB_")) return rest;
    if (m_control.pKind->keyword == "BUTTON" && piece::bStarts(word, "ID_") && m_nNumbers == 0)
      ReadNavigation(word);
    else
      m_report.Add(Rule::WordIgnored, word, {word});
    return rest;
  }

  void ReadNavigation(Piece word) {
    m_control.navigation = word;
    const std::span<const Piece> known = NavigationWords();
    if (std::find(known.begin(), known.end(), word) == known.end())
      m_report.Add(Rule::UnknownNavigation, word, {word}, NearMiss(word, known));
  }

  void CheckSize(Piece rest) {
    if (bIs(SIZED) && m_nNumbers < 4 && !m_control.bBroken && rest.find("HIDE") == Piece::npos)
      m_report.Add(Rule::SizeIncomplete, rest);
  }

  void ReadAction(Piece rest) {
    m_control.bAction = true;
    const size_t open = rest.find('(');
    if (open == Piece::npos) return;
    if (rest.find(')', open) == Piece::npos) {
      m_control.bAction = false;  // as the engine has it
      return Break(Rule::ParenthesisMissing, rest.substr(open));
    }
    m_control.action = rest.substr(open);
  }

  CheckReport& m_report;
  ScannedControl& m_control;
  int m_nNumbers = 0;
};

}  // namespace

void ScanControl(CheckReport& report, Piece rest, ScannedControl& control) { LineScan(report, control).Run(rest); }
