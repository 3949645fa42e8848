// The lines between BEGIN and END: controls, the blocks that belong to them, groups, actions and tables.
#include <algorithm>
#include <cstring>

#include "CheckScan.h"
#include "controls/ControlTable.h"
#include "wizard/TextRange.h"

namespace {

const int MAX_NESTING = 50;

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
    const KindRow* const pPart = m_containers.empty() ? nullptr : pFindPart(word);
    if (pPart) return ReadControl(line, *pPart, line.substr(word.size()));
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
    if (kind.traits & NAMES_CONTROL) NoteReference(control);
    if (kind.traits & CONTAINER)
      m_containers.push_back({&kind, line});
    else if (!kind.endWord.empty())
      ReadBlock(line, kind);
  }

  // The control that a line stands for must be there; the line itself has no name then.
  void NoteReference(ScannedControl& control) {
    const bool bWindow = !(control.pKind->traits & NO_WINDOW);
    const Piece name = !bWindow ? control.name : control.strings.empty() ? Piece() : control.strings.front();
    if (!name.empty()) m_dialog.cells.push_back(name);
    if (!bWindow) control.name = {};
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
      if (!pEndLine && (bBeginsControl(next) || bClosesOpen(piece::Word(next)))) return;
      const bool bTextLine = !next.empty() && next.front() == '>';
      bText |= bTextLine;
      if (bBox && !bTextLine && !next.empty()) m_report.Add(Rule::BoxLine, next);
      if (!bBox && pEndLine) ReadItem(next, kind);
    }
    m_rest = rest;
    if (bBox && !bText) m_report.Add(Rule::BoxEmpty, line);
  }

  // A line within a block: a control's line with any word before it, or none. What runs a command is kept.
  void ReadItem(Piece line, const KindRow& owner) {
    const Piece word = piece::Word(line), rest = line.substr(word.size());
    const bool bItem = !rest.empty() && strchr(word.empty() ? "\"" : " '\"", rest.front());
    if (!bItem) return;
    ScannedControl item{&ItemKind(), line, {}, {}, {}, {}, false, false, {}};
    ScanControl(m_report, rest, item);
    const bool bNamed = (owner.traits & NAMES_COMMAND) && word == item.pKind->keyword && !item.name.empty();
    if (item.bAction || bNamed || item.bHasFlag("VAR(")) m_dialog.items.push_back(item);
    if (word == "BAND" && !item.name.empty()) m_dialog.cells.push_back(item.name);
    if (word == "COMBO" && !item.name.empty()) m_dialog.choices.push_back(item.name);
  }

  bool bClosesOpen(Piece word) const {
    return std::any_of(m_containers.begin(), m_containers.end(),
                       [&](const Container& container) { return container.pKind->endWord == word; });
  }

  bool bCloseContainer(Piece word) {
    if (!bClosesOpen(word)) return false;
    size_t depth = m_containers.size();
    while (m_containers[depth - 1].pKind->endWord != word) depth--;
    CloseContainers(depth);
    m_containers.pop_back();
    return true;
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
      const Piece trimmed = piece::Trim(next);
      if (next.find("START_ACTION") != Piece::npos || pFindEndWord(piece::Word(trimmed)) || bBeginsControl(trimmed))
        break;
      m_report.GiveUpLine(next.data());
      piece::bNextLine(rest, next);
    }
    m_report.Add(Rule::FinishActionMissing, line, {keyword});
    m_dialog.actions.push_back({keyword, piece::Between(commands.data(), rest.data())});
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

  // A container within a cell holds controls like any other, and tables of its own.
  void ReadTable(Piece line) {
    const Piece block = piece::SkipSpace(piece::Between(line.data() + piece::Word(line).size(), piece::End(m_rest)));
    if (block.empty() || block.front() != '{' || m_iTables == MAX_NESTING) return m_report.Add(Rule::TableBrace, line);
    m_iTables++;
    m_rest = block.substr(1);
    const size_t depth = m_containers.size();
    bool bRow = false, bColumn = false, bClosed = false;
    for (Piece rest = m_rest, next; !bClosed && piece::bNextLine(rest, next); rest = m_rest) {
      next = piece::Trim(next);
      const Piece word = piece::Word(next);
      const bool bWithin = m_containers.size() > depth;
      if (!bWithin && (word == "TABLE_START" || pFindEndWord(word))) break;
      m_rest = rest;
      const KindRow* const pKind = bWithin ? nullptr : pFindKind(word);
      const bool bCell = pKind && ((pKind->traits & CONTAINER) || pKind->keyword == "TOOLBAR");
      if (pKind && !bCell) m_report.Add(Rule::CellApostrophe, next);
      if (bWithin || pKind) {
        if (!next.empty()) ReadLine(next);
        continue;
      }
      bRow |= next.find("TABLE_ROW") != Piece::npos;
      bColumn |= next.find("TABLE_COLUMN") != Piece::npos;
      const size_t close = Brace(next);
      bClosed = close != Piece::npos;
      ReadCells(piece::Trim(next.substr(0, close)));
    }
    m_iTables--;
    if (!bClosed) return m_report.Add(Rule::TableBrace, line);
    if (!bRow) m_report.Add(Rule::TableRow, line);
    if (!bColumn) m_report.Add(Rule::TableColumn, line);
  }

  // The brace that closes the table; one in a name is none.
  static size_t Brace(Piece line) {
    bool bName = false;
    for (size_t i = 0; i < line.size(); i++) {
      bName ^= line[i] == '\'';
      if (line[i] == '}' && !bName) return i;
    }
    return Piece::npos;
  }

  // A line of a table: a column, a row, or cells. A row's first cells may stand on its own line.
  void ReadCells(Piece line) {
    const Piece word = piece::Word(line);
    const bool bOther = word == "TABLE_COLUMN" || word == "TABLE_ROW";
    if (line.empty() || line == "{") return;
    const bool bCells = line.find('\'') != Piece::npos || line.front() == '-';
    if (!bOther && !bCells) return m_report.Add(Rule::CellApostrophe, line);
    for (size_t open = 0; (open = line.find('\'', open)) != Piece::npos;) {
      const size_t close = line.find('\'', open + 1);
      if (close == Piece::npos) return m_report.Add(Rule::CellApostrophe, line.substr(open));
      if (close > open + 1) m_dialog.cells.push_back(line.substr(open + 1, close - open - 1));
      open = close + 1;
    }
  }

  CheckReport& m_report;
  ScannedDialog& m_dialog;
  Piece m_rest;
  int m_iTables = 0;  // that are open, each in a container of the one around it
  Piece m_group;      // the line that opened the group, empty without one
  std::vector<Container> m_containers;
  std::vector<Piece> m_actions;  // the keywords that have their block
};

}  // namespace

void ScanBody(CheckReport& report, Piece body, ScannedDialog& dialog) { BodyScan(report, body, dialog).Run(); }
