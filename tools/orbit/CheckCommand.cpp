#include "CheckCommand.h"

#include <algorithm>

namespace {

const Piece STATEMENTS[] = {"CONTINUE", "IF",         "THEN", "ELSE",  "SWITCH", "CASE",
                            "DEFAULT",  "END_DIALOG", "EXIT", "BREAK", "DIALOG", "FINISH_ACTION"};

// Without blanks, quotes and apostrophes at its ends.
Piece Unquote(Piece text) {
  const size_t first = text.find_first_not_of(" \t\"'");
  if (first == Piece::npos) return {};
  return text.substr(first, text.find_last_not_of(" \t\"'") + 1 - first);
}

bool bOddQuotes(Piece text) { return std::count(text.begin(), text.end(), '"') % 2 != 0; }

}  // namespace

Piece QuotedName(Piece text) {
  const size_t open = text.find('"');
  const size_t close = open == Piece::npos ? open : text.find('"', open + 1);
  return close == Piece::npos ? Piece() : text.substr(open + 1, close - open - 1);
}

// What the parameters of some of the engine's commands name.
struct CommandCheck::ParameterRow {
  Piece command;
  void (CommandCheck::*pCheck)(Piece place, Piece parameters);
};

const CommandCheck::ParameterRow CommandCheck::PARAMETERS[] = {
    {"EnableControl", &CommandCheck::ControlParameter}, {"DisableControl", &CommandCheck::ControlParameter},
    {"ShowControl", &CommandCheck::ControlParameter},   {"HideControl", &CommandCheck::ControlParameter},
    {"Strlen", &CommandCheck::OperandParameter},        {"EndsWith", &CommandCheck::TwoOperands},
    {"NotEndsWith", &CommandCheck::TwoOperands},        {"btn_set_var_quit_OnClick", &CommandCheck::SetAndQuit},
};

bool CommandCheck::bCommand(Piece text) {
  text = piece::Trim(text);
  const Piece word = piece::Word(text);
  for (const Piece statement : {Piece("BREAK"), Piece("EXIT")}) {
    if (!piece::bStarts(text, statement)) continue;
    if (word != statement) m_report.Add(Rule::ReadAs, word, {word, statement});
    const Piece rest = piece::TrimFront(text.substr(word.size()));
    if (!rest.empty() && word == statement) m_report.Add(Rule::TextIgnored, rest);
    return true;
  }
  const Piece jump = "DIALOG";
  if (piece::bStarts(text, jump)) return bJump(text, text.substr(jump.size()));
  const Piece name = text.substr(0, text.find_first_of(" \t"));
  const Piece rest = piece::TrimFront(text.substr(name.size()));
  const size_t glued = name.find_first_of("(=");
  if (glued != Piece::npos && glued > 0) {
    if (name[glued] == '=') m_names.SetsVariable(name.substr(0, glued));
    m_report.Add(Rule::BlankMissing, name.substr(glued), {name.substr(glued, 1)});
  } else if (!rest.empty() && rest.front() == '=') {
    Assign(name, rest.substr(1));
  } else if (!rest.empty() && rest.front() == '(') {
    CallLine(name, rest.substr(1));
  } else if (bBeginsControl(text)) {
    m_report.Add(Rule::OutsideControl, text, {word});
  } else {
    const std::string hint = NearMiss(name, STATEMENTS);
    m_report.Add(Rule::NotStatement, text, {name}, hint.empty() ? m_names.CommandHint(name) : hint);
  }
  return false;
}

// The statement DIALOG "name"; rest is what follows the word.
bool CommandCheck::bJump(Piece text, Piece rest) {
  rest = piece::TrimFront(rest);
  const Piece name = !rest.empty() && rest.front() == '"' ? QuotedName(rest) : Piece();
  if (!name.data()) {
    m_report.Add(Rule::NameQuote, text);
    return false;
  }
  m_names.NeedsDialog(name);
  return true;
}

// rest is what follows the opening parenthesis. The first ')' ends the parameters.
void CommandCheck::CallLine(Piece name, Piece rest) {
  const size_t close = rest.find(')');
  if (close == Piece::npos) return m_report.Add(Rule::ParenthesisMissing, rest.data() - 1);
  const Piece parameters = rest.substr(0, close);
  const Piece tail = piece::Trim(rest.substr(close + 1));
  if (bOddQuotes(parameters))
    m_report.Add(Rule::QuotedParenthesis, rest.substr(close));
  else if (!tail.empty())
    m_report.Add(Rule::TextIgnored, tail);
  Call(std::string(name), name, parameters);
}

bool CommandCheck::bBlankBeforeJump(Piece parameters) {
  const Piece text = piece::TrimFront(parameters), jump = "DIALOG";
  if (text.size() == parameters.size() || !piece::bStarts(text, jump)) return false;
  return piece::bStarts(piece::TrimFront(text.substr(jump.size())), "\"");
}

void CommandCheck::Call(const std::string& name, Piece place, Piece parameters, bool bEvent) {
  if (piece::bStarts(name, "MESSAGE_BOX")) return BoxCall(place, parameters);
  if (bBlankBeforeJump(parameters)) return m_report.Add(Rule::JumpBlank, parameters);
  if (piece::bStarts(parameters, "DIALOG")) {
    const Piece dialog = QuotedName(parameters);
    if (!dialog.data()) return m_report.Add(Rule::NameQuote, parameters);
    return m_names.NeedsDialog(dialog);
  }
  if (!m_names.bIsCommand(name)) {
    if (!bEvent) m_report.Add(Rule::UnknownCommand, place, {name}, m_names.CommandHint(name));
    return;
  }
  m_names.Calls(name);
  const Piece control = EventControlOf(name);
  if (!bEvent && !control.empty() && !m_names.bHasControl(control))
    m_report.Add(Rule::EventControl, place, {name, control});
  for (const ParameterRow& row : PARAMETERS)
    if (row.command == name) (this->*row.pCheck)(place, parameters);
}

// A box of the script by its name, or one that the parameters describe: 'name' "caption" > text.
void CommandCheck::BoxCall(Piece place, Piece parameters) {
  const Piece name = Unquote(parameters);
  const bool bDescribed = parameters.find('"') != Piece::npos && parameters.find('>') != Piece::npos;
  if (name.empty())
    m_report.Add(Rule::OperandMissing, place);
  else if (!bDescribed)
    m_names.NeedsBox(name);
}

void CommandCheck::ControlParameter(Piece place, Piece parameters) {
  const Piece name = piece::Trim(parameters);
  if (name.empty())
    m_report.Add(Rule::OperandMissing, place);
  else
    m_names.NeedsControl(name);
}

void CommandCheck::OperandParameter(Piece place, Piece parameters) {
  const Piece operand = piece::Trim(parameters);
  if (operand.empty())
    m_report.Add(Rule::OperandMissing, place);
  else if (operand.front() != '"')
    m_names.ReadsVariable(operand);
}

void CommandCheck::TwoOperands(Piece place, Piece parameters) {
  const size_t separator = parameters.find(';');
  OperandParameter(place, parameters.substr(0, separator));
  if (separator == Piece::npos)
    m_report.Add(Rule::OperandMissing, piece::End(parameters));
  else
    OperandParameter(parameters.substr(separator), parameters.substr(separator + 1));
}

void CommandCheck::SetAndQuit(Piece, Piece parameters) {
  const size_t separator = parameters.find(';');
  if (separator != Piece::npos) m_names.SetsVariable(parameters.substr(0, separator));
}

void CommandCheck::Assign(Piece name, Piece value) {
  m_names.SetsVariable(name);
  if (!value.empty() && value.front() == '=') return m_report.Add(Rule::DoubleEquals, value);
  Piece text = piece::Trim(value);
  if (text.empty()) m_report.Add(Rule::ExpressionMissing, value.data() - 1);
  for (bool bCut = false; !(text = piece::TrimFront(text)).empty();) {
    if (text.front() == '+' || text.front() == '-') {
      bCut = text.front() == '-';
      text.remove_prefix(1);
      continue;
    }
    text = ReadTerm(text, bCut);
    bCut = false;
  }
}

// A literal, a variable, or a call, behind which nothing is read. Returns what is left.
Piece CommandCheck::ReadTerm(Piece text, bool bCut) {
  if (text.front() == '"') {
    const size_t close = text.find('"', 1);
    if (close == Piece::npos) m_report.Add(Rule::QuoteMissing, text);
    if (bCut && close != 2) m_report.Add(Rule::CutDigit, text);
    return text.substr(close == Piece::npos ? text.size() : close + 1);
  }
  const size_t end = text.find_first_of("\"+-(");
  if (end != Piece::npos && text[end] == '(') {
    const size_t close = text.find(')', end);
    if (close == Piece::npos) m_report.Add(Rule::ParenthesisMissing, text.substr(end));
    if (close == Piece::npos) return {};
    const Piece name = piece::Trim(text.substr(0, end));
    if (bOddQuotes(text.substr(end, close - end))) m_report.Add(Rule::QuotedParenthesis, text.substr(close));
    const Piece tail = piece::Trim(text.substr(close + 1));
    Call(std::string(name), name, text.substr(end + 1, close - end - 1));
    if (!tail.empty()) m_report.Add(Rule::TextIgnored, tail);
    return {};
  }
  const Piece name = piece::Trim(text.substr(0, end));
  m_names.ReadsVariable(name);
  return text.substr(end == Piece::npos ? text.size() : end);
}
