// The lines between BEGIN and END: controls, the blocks that belong to them, groups, actions and tables.
#include <algorithm>

#include "CheckScan.h"
#include "controls/ControlTable.h"
#include "wizard/TextRange.h"

namespace {

Piece LineOf(Piece text) { return text.substr(0, text.find('\n')); }

class BodyScan {
 public:
  BodyScan(CheckReport& report, Piece body, ScannedDialog& dialog) : m_report(report), m_dialog(dialog), m_rest(body) {}

  void Run() {
    for (Piece line; piece::bNextLine(m_rest, line);) {
      line = piece::Trim(line);
      if (!line.empty()) ReadLine(line);
    }
    CloseContainers(0);
    if (!m_group.empty()) m_report.Add(Rule::GroupOpen, m_group);
  }

 private:
  struct Container {
    const KindRow* pKind;
    Piece line;
  };
  struct Directive {
    Piece keyword;
    void (BodyScan::*pRead)(Piece line);
  };

  // What the engine takes the line for; null for a line that it ignores.
  static const char* EngineKeyword(Piece line) {
    const char* const pEnd = piece::End(line);
    const ControlRow* pRow = ControlRow::pFindContainer(line.data(), pEnd);
    if (!pRow) pRow = ControlRow::pFind(line.data(), pEnd);
    return pRow ? pRow->szKeyword : nullptr;
  }

  void ReadLine(Piece line) {
    static const Directive DIRECTIVES[] = {{"GROUP", &BodyScan::OpenGroup},
                                           {"END_GROUP", &BodyScan::CloseGroup},
                                           {"TABLE_START", &BodyScan::ReadTable},
                                           {"START_BEFORE_DRAWING", &BodyScan::ReadAction},
                                           {"START_AFTER_DRAWING", &BodyScan::ReadAction}};
    const Piece word = piece::Word(line);
    if (bCloseContainer(word)) return;
    const char* const szKeyword = EngineKeyword(line);
    if (!szKeyword) return ReportUnknown(line, word);
    const Piece keyword = szKeyword;
    if (word != keyword) m_report.Add(Rule::ReadAs, word, {word, keyword});
    for (const Directive& row : DIRECTIVES)
      if (row.keyword == keyword) return (this->*row.pRead)(line);
    if (const KindRow* pKind = pFindKind(keyword)) ReadControl(line, *pKind, line.substr(word.size()));
  }

  void ReportUnknown(Piece line, Piece word) {
    if (!m_containers.empty() && (m_containers.back().pKind->traits & OWN_ITEMS)) return;
    if (const EndWordRow* pRow = pFindEndWord(word))
      return m_report.Add(Rule::StrayWord, line, {word, pRow->beginning});
    const Piece shown = word.empty() ? line.substr(0, line.find_first_of(" \t")) : word;
    m_report.Add(Rule::UnknownWord, line, {shown}, NearMiss(shown, LineWords()));
  }

  // ---- controls ----

  void ReadControl(Piece line, const KindRow& kind, Piece rest) {
    ScannedControl& control = m_dialog.controls.emplace_back();
    control.pKind = &kind;
    control.line = line;
    ScanControl(m_report, rest, control);
    if (kind.traits & CONTAINER)
      m_containers.push_back({&kind, line});
    else if (!kind.endWord.empty())
      ReadBlock(line, kind);
  }

  // The lines up to the kind's end word. Without one, up to a line that can be no part of them.
  void ReadBlock(Piece line, const KindRow& kind) {
    const char* const pEnd = piece::End(m_rest);
    const char* const pEndLine = m_rest.empty() ? nullptr
                                                : ScriptText::FindEndLine(m_rest.data() - 1, pEnd, kind.keyword.data(),
                                                                          kind.endWord.data(), false);
    if (!pEndLine) m_report.Add(Rule::BlockOpen, line, {kind.keyword, kind.endWord});
    const bool bBox = kind.keyword == "MESSAGE_BOX";
    bool bText = !pEndLine;
    Piece rest = m_rest;
    for (Piece next; piece::bNextLine(rest, next); m_rest = rest) {
      next = piece::Trim(next);
      if (next.data() == pEndLine) break;
      if (!pEndLine && bBeginsControl(next)) return;
      const bool bTextLine = !next.empty() && next.front() == '>';
      bText |= bTextLine;
      if (bBox && !bTextLine && !next.empty()) m_report.Add(Rule::BoxLine, next);
    }
    m_rest = rest;
    if (bBox && !bText) m_report.Add(Rule::BoxEmpty, line);
  }

  bool bCloseContainer(Piece word) {
    if (!piece::bStarts(word, "END_")) return false;
    for (size_t i = m_containers.size(); i-- > 0;) {
      if (!piece::bStarts(word, m_containers[i].pKind->endWord)) continue;
      CloseContainers(i + 1);
      m_containers.pop_back();
      return true;
    }
    return false;
  }

  // Those that are open beyond the given depth were not closed.
  void CloseContainers(size_t depth) {
    for (; m_containers.size() > depth; m_containers.pop_back())
      m_report.Add(Rule::BlockOpen, m_containers.back().line,
                   {m_containers.back().pKind->keyword, m_containers.back().pKind->endWord});
  }

  // ---- directives ----

  void OpenGroup(Piece line) {
    if (!m_group.empty()) m_report.Add(Rule::GroupNested, line);
    m_group = line;
  }

  void CloseGroup(Piece line) {
    if (m_group.empty()) m_report.Add(Rule::StrayWord, line, {"END_GROUP", "GROUP"});
    m_group = {};
  }

  void ReadAction(Piece line) {
    const Piece keyword = piece::Word(line);
    const char* const pEnd = piece::End(m_rest);
    const Piece start = piece::SkipSpace(m_rest);
    if (!piece::bStarts(start, "START_ACTION")) {
      m_report.Add(Rule::StartActionMissing, line, {keyword});
      SkipCommands();
      return;
    }
    Piece rest = start, next;
    piece::bNextLine(rest, next);
    const Piece commands = rest;
    while (!rest.empty()) {
      next = LineOf(rest);
      const size_t finish = next.find("FINISH_ACTION");
      if (finish != Piece::npos) {
        AddAction(keyword, line, piece::Between(commands.data(), next.data() + finish));
        m_rest = piece::Between(std::min(piece::End(next) + 1, pEnd), pEnd);
        return;
      }
      if (next.find("START_ACTION") != Piece::npos || bBeginsControl(piece::Trim(next))) break;
      m_report.GiveUpLine(next.data());
      piece::bNextLine(rest, next);
    }
    m_report.Add(Rule::FinishActionMissing, line, {keyword});
    m_rest = rest;
  }

  void AddAction(Piece keyword, Piece line, Piece commands) {
    if (std::find(m_actions.begin(), m_actions.end(), keyword) == m_actions.end())
      m_actions.push_back(keyword);
    else
      m_report.Add(Rule::ActionReplaced, line, {keyword});
    m_dialog.actions.push_back({keyword, commands});
  }

  // Behind a missing START_ACTION: what can only be commands is no second fault.
  void SkipCommands() {
    for (Piece rest = m_rest, line; piece::bNextLine(rest, line); m_rest = rest) {
      line = piece::Trim(line);
      const Piece word = piece::Word(line);
      if (word == "FINISH_ACTION") m_rest = rest;
      if (word == "FINISH_ACTION" || pFindEndWord(word) || bBeginsControl(line)) return;
      m_report.GiveUpLine(line.data());
    }
  }

  // ---- tables ----

  void ReadTable(Piece line) {
    const Piece block = piece::SkipSpace(piece::Between(line.data() + piece::Word(line).size(), piece::End(m_rest)));
    const size_t close = block.find('}');
    const Piece text = block.substr(0, close);
    if (text.empty() || text.front() != '{' || close == Piece::npos || text.find("TABLE_START") != Piece::npos)
      return m_report.Add(Rule::TableBrace, line);
    if (text.find("TABLE_ROW") == Piece::npos) m_report.Add(Rule::TableRow, line);
    if (text.find("TABLE_COLUMN") == Piece::npos) m_report.Add(Rule::TableColumn, line);
    Piece rest = text.substr(1);
    for (Piece next; piece::bNextLine(rest, next);) ReadCells(piece::Trim(next));
    m_rest = piece::Between(block.data() + close + 1, piece::End(m_rest));
    Piece tail;
    piece::bNextLine(m_rest, tail);
  }

  // A line of a table: a column, a row, or cells. A row's first cells may stand on its own line.
  void ReadCells(Piece line) {
    const Piece word = piece::Word(line);
    const bool bOther = word == "TABLE_COLUMN" || word == "TABLE_ROW" || pFindEndWord(word);
    if (line.empty() || line == "{") return;
    if (pFindKind(word)) return;  // a container within the cell: its controls are its own
    if (!bOther && line.find('\'') == Piece::npos) return m_report.Add(Rule::CellApostrophe, line);
    for (size_t open = 0; (open = line.find('\'', open)) != Piece::npos;) {
      const size_t close = line.find('\'', open + 1);
      if (close == Piece::npos) return m_report.Add(Rule::CellApostrophe, line.substr(open));
      m_dialog.cells.push_back(line.substr(open + 1, close - open - 1));
      open = close + 1;
    }
  }

  CheckReport& m_report;
  ScannedDialog& m_dialog;
  Piece m_rest;
  Piece m_group;  // the line that opened the group, empty without one
  std::vector<Container> m_containers;
  std::vector<Piece> m_actions;  // the keywords that have their block
};

}  // namespace

void ScanBody(CheckReport& report, Piece body, ScannedDialog& dialog) { BodyScan(report, body, dialog).Run(); }
