// The controls of one dialog: the variables that they set, their events, and the letters that lead to them.
#include <unordered_set>

#include "CheckPasses.h"
#include "controls/ScriptText.h"

namespace {

bool bIs(const ScannedControl& control, unsigned trait) { return control.pKind->traits & trait; }
bool bIsText(const ScannedControl& control) { return control.pKind->keyword == "TEXT_FIELD"; }
bool bIsLink(const ScannedControl& control) { return bIsText(control) && control.bHasFlag("LINK"); }

// A hidden list carries data for commands and sets nothing.
bool bSetsVariable(const ScannedControl& control) {
  if (bIs(control, KEEPS_VALUE)) return control.bHasFlag("REMEMBER");
  if (!bIs(control, HOLDS_VALUE) || control.bHasFlag("NO_VAR_SAVE")) return false;
  return !(bIs(control, STRINGS) && control.bHasFlag("HIDE"));
}

// A text in the place of the name. A box may have a caption alone, and what cannot be changed a text.
bool bMisnamed(const ScannedControl& control) {
  return bSetsVariable(control) && !bIs(control, STRINGS | OWN_WORDS | MNEMONIC | KEEPS_VALUE) && !control.bBroken &&
         control.name.empty() && !control.strings.empty() && !control.bHasFlag("READ_ONLY");
}

// The variable that an item's tick is kept in: VAR(name).
Piece ItemVariable(const ScannedControl& item) {
  const size_t from = item.flags.find("VAR("), to = item.flags.find(')', from);
  return to == Piece::npos ? Piece() : piece::Trim(item.flags.substr(from + 4, to - from - 4));
}

bool bTakesFocus(const ScannedControl& control) {
  if (control.bHasFlag("HIDE") || control.bHasFlag("DISABLE")) return false;
  return bIs(control, TAKES_FOCUS) || bIsLink(control);
}

// The place of the letter behind the '&' of a caption, or null. "&&" is one character of the text.
const char* Mnemonic(const ScannedControl& control) {
  if (!bIs(control, MNEMONIC) || control.bHasFlag("HIDE")) return nullptr;
  for (const Piece caption : control.strings) {
    for (size_t at = 0; (at = caption.find('&', at)) != Piece::npos; at += 2)
      if (at + 1 < caption.size() && caption[at + 1] != '&' && caption[at + 1] != ' ') return &caption[at + 1];
  }
  return nullptr;
}

class DialogCheck {
 public:
  DialogCheck(CheckReport& report, ScriptNames& names, CommandCheck& commands, const ScannedDialog& dialog)
      : m_report(report), m_names(names), m_commands(commands), m_dialog(dialog) {}

  void Run() {
    for (const ScannedControl& control : m_dialog.controls) {
      if (bSetsVariable(control) && !control.name.empty()) m_names.SetsVariable(control.name);
      if (bMisnamed(control))
        m_report.Add(Rule::NameMissing, control.strings.front().data() - 1, {control.pKind->keyword});
      if (bIs(control, RUNS_ACTION))
        CheckItem(control);
      else if (control.bAction)
        CheckAction(control);
      else
        CheckPress(control);
    }
    for (const ScannedControl& item : m_dialog.items) {
      const Piece variable = ItemVariable(item);
      if (!variable.empty()) m_names.SetsVariable(variable);
      if (variable.empty() || item.bAction) CheckItem(item);
    }
    for (const Piece choice : m_dialog.choices) m_names.SetsVariable(choice);
    for (const Piece cell : m_dialog.cells) m_names.NeedsControl(cell);
    CheckMnemonics();
  }

 private:
  void CheckPress(const ScannedControl& control) {
    const bool bPressed = bIs(control, CLICKED) || bIsLink(control);
    if (!bPressed || control.bBroken || !control.navigation.empty() || control.bHasFlag("DISABLE") ||
        control.bHasFlag("HIDE"))
      return;
    const Piece caption = control.strings.empty() ? Piece() : control.strings.front();
    m_report.Add(
        Rule::NothingHappens, control.line,
        {control.name.empty() ? caption : control.name, bIsText(control) ? "no" : "no navigation word and no"});
  }

  // The command is the name with the action's parameters, or without a name what the action's parentheses hold. What
  // begins with a digit is no name but a place in a tree.
  void CheckItem(const ScannedControl& item) {
    if (item.bBroken) return;
    const bool bNamed = !item.name.empty() && !ScriptText::bIsDigit(item.name.front());
    if (bNamed && item.name.find('(') != Piece::npos) {
      m_commands.bCommand(item.name);
    } else if (bNamed) {
      m_commands.Call(std::string(item.name), item.name, Parameters(item.action));
    } else {
      const size_t close = item.action.rfind(')');
      const Piece command = item.action.empty() ? Piece() : piece::Trim(item.action.substr(1, close - 1));
      if (command.empty())
        m_report.Add(Rule::NoCommand, item.line);
      else
        m_commands.bCommand(command);
    }
  }

  static Piece Parameters(Piece action) { return action.empty() ? action : action.substr(1, action.find(')') - 1); }

  void CheckAction(const ScannedControl& control) {
    const char* szReason = nullptr;
    if (control.name.empty()) szReason = "the control has no name";
    if (control.pKind->events.empty()) szReason = "the control has no events";
    if (!control.navigation.empty()) szReason = "the navigation word decides";
    if (bIsText(control) && !bIsLink(control)) szReason = "a text without LINK is not pressed";
    if (szReason)
      m_report.Add(Rule::ActionNever, control.action.empty() ? control.line : control.action, {szReason});
    else
      CheckEvents(control);
  }

  // At least one of the kind's events must be a command, unless the action jumps or shows a box.
  void CheckEvents(const ScannedControl& control) {
    const Piece parameters = Parameters(control.action);
    Piece events = control.pKind->events;
    const std::string first = std::string(control.name) + std::string(events.substr(0, events.find(' ')));
    if (piece::bStarts(parameters, "DIALOG") || CommandCheck::bBlankBeforeJump(parameters) ||
        piece::bStarts(first, "MESSAGE_BOX"))
      return m_commands.Call(first, control.name, parameters, true);
    bool bKnown = false;
    for (Piece suffix; !(suffix = piece::Word(events)).empty();
         events = piece::TrimFront(events.substr(suffix.size()))) {
      const std::string command = std::string(control.name) + std::string(suffix);
      if (!m_names.bIsCommand(command)) continue;
      m_commands.Call(command, control.name, parameters, true);
      bKnown = true;
    }
    if (!bKnown) m_report.Add(Rule::UnknownEvent, control.name, {first}, m_names.CommandHint(first));
  }

  void CheckMnemonics() {
    std::unordered_set<char> seen;
    const std::vector<ScannedControl>& controls = m_dialog.controls;
    for (size_t i = 0; i < controls.size(); i++) {
      const char* const pLetter = Mnemonic(controls[i]);
      if (!pLetter) continue;
      const char cUpper = *pLetter >= 'a' && *pLetter <= 'z' ? static_cast<char>(*pLetter - 'a' + 'A') : *pLetter;
      if (!seen.insert(cUpper).second) m_report.Add(Rule::SameMnemonic, pLetter, {Piece(pLetter, 1)});
      if (!bIsText(controls[i]) || bIsLink(controls[i])) continue;
      size_t next = i + 1;
      while (next < controls.size() && bIs(controls[next], NO_WINDOW)) next++;
      if (next == controls.size() || !bTakesFocus(controls[next]))
        m_report.Add(Rule::LabelOrder, pLetter, {Piece(pLetter, 1)});
    }
  }

  CheckReport& m_report;
  ScriptNames& m_names;
  CommandCheck& m_commands;
  const ScannedDialog& m_dialog;
};

}  // namespace

void CheckDialog(CheckReport& report, ScriptNames& names, CommandCheck& commands, const ScannedDialog& dialog) {
  DialogCheck(report, names, commands, dialog).Run();
}
