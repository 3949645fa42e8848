#include "CheckRules.h"

#include <iterator>

#include "controls/ScriptReport.h"

namespace {

constexpr bool ERROR = true, WARNING = false;

constexpr RuleRow g_rules[] = {
    {Rule::NotCp1250, ERROR, "the file is UTF-8: the setup program reads Windows-1250 and shows other letters here"},
    {Rule::NoDialog, ERROR, "the script has no dialog"},
    {Rule::InitMissing, ERROR, "END_INIT without an INIT line before it", ENGINE_INIT},
    {Rule::EndInitMissing, ERROR, "INIT without an END_INIT line", ENGINE_INIT},
    {Rule::OutsideText, WARNING, "this line stands outside of every dialog and is ignored"},
    {Rule::OutsideControl, ERROR, "{} stands outside of the BEGIN and END of a dialog and is ignored"},
    {Rule::EndDialogAlone, ERROR, "END_DIALOG without a DIALOG before it", ENGINE_MISMATCH},
    {Rule::EndDialogMissing, ERROR, "the dialog has no END_DIALOG", ENGINE_MISMATCH},
    {Rule::EndDialogNumber, WARNING, "END_DIALOG{} closes DIALOG{}"},
    {Rule::BeginMissing, ERROR, "the dialog has no BEGIN", ENGINE_BEGIN},
    {Rule::EndMissing, ERROR, "the dialog's controls have no END before this", FAULT_MISSING_WORD},
    {Rule::EndWithin, ERROR, "this END ends the controls: the lines below it are lost"},

    {Rule::LineQuote, ERROR, "a line of the INIT block must end with a double quote", FAULT_QUOTE},
    {Rule::EqualsMissing, ERROR, "'=' is missing: a variable is written name = \"value\", its continuation > \"more\"",
     FAULT_MISSING_WORD},
    {Rule::VariableName, ERROR, "the variable has no name"},
    {Rule::ValueQuote, ERROR, "a double quote of the value is missing", FAULT_QUOTE},
    {Rule::UnknownEscape, WARNING, "'\\{}' gives a lone backslash: a backslash is written twice"},
    {Rule::DeclaredTwice, WARNING, "the variable '{}' is declared again; this value replaces the first"},
    {Rule::TextIgnored, WARNING, "this text is ignored"},

    {Rule::UnknownKind, ERROR, "unknown dialog kind '{}'"},
    {Rule::ReadAs, WARNING, "'{}' is read as {}"},
    {Rule::SameDialog, ERROR, "another dialog is named '{}': jumps find that one"},
    {Rule::SameControl, ERROR, "another control of the dialog is named '{}'"},
    {Rule::UnknownWord, ERROR, "unknown control word '{}': the line is ignored"},
    {Rule::ApostropheMissing, ERROR, "an apostrophe is missing", FAULT_APOSTROPHE},
    {Rule::QuoteMissing, ERROR, "a double quote is missing", FAULT_QUOTE},
    {Rule::ParenthesisMissing, ERROR, "the closing parenthesis is missing", FAULT_PARENTHESIS},
    {Rule::UnknownNavigation, ERROR, "unknown navigation word '{}'", FAULT_ID},
    {Rule::CommaMissing, ERROR, "the comma before the flags is missing: '{}' is ignored"},
    {Rule::WordIgnored, WARNING, "'{}' is ignored here"},
    {Rule::SizeIncomplete, WARNING, "the place and size are incomplete: x y width height"},
    {Rule::UnknownFlag, ERROR, "unknown flag '{}'"},
    {Rule::FlagReadAs, ERROR, "unknown flag '{}', which counts as {}"},
    {Rule::ForeignFlag, WARNING, "'{}' means nothing to {}"},
    {Rule::ColorForm, ERROR, "{} needs a colour: (red,green,blue)"},
    {Rule::ColorRange, ERROR, "the parts of a colour go from 0 to 255"},
    {Rule::NumberForm, ERROR, "{} needs a number in parentheses"},

    {Rule::BlockOpen, ERROR, "{} without its {}", FAULT_MISSING_WORD},
    {Rule::GroupOpen, ERROR, "GROUP without END_GROUP: its boxes do not switch each other off"},
    {Rule::GroupNested, WARNING, "a GROUP within a GROUP: they are one"},
    {Rule::StrayWord, WARNING, "{} without its {}"},
    {Rule::BoxLine, WARNING, "a line of a message box begins with '>': this one is ignored"},
    {Rule::BoxEmpty, WARNING, "the message box has no text"},
    {Rule::StartActionMissing, ERROR, "{} without START_ACTION behind it", ENGINE_START_ACTION},
    {Rule::FinishActionMissing, ERROR, "{} without FINISH_ACTION", ENGINE_FINISH_ACTION},
    {Rule::ActionReplaced, ERROR, "a second {} replaces the first"},
    {Rule::TableBrace, ERROR, "TABLE_START without its braces: the table is dropped", ENGINE_TABLE},
    {Rule::TableRow, ERROR, "the table has no TABLE_ROW and is dropped", ENGINE_TABLE},
    {Rule::TableColumn, ERROR, "the table has no TABLE_COLUMN and is dropped", ENGINE_TABLE},
    {Rule::CellApostrophe, ERROR, "a cell names its control in apostrophes", ENGINE_TABLE},

    {Rule::NameMissing, WARNING, "the {} has no name and keeps nothing: a name stands in apostrophes"},
    {Rule::UnknownControl, ERROR, "the dialog has no control '{}'"},
    {Rule::NothingHappens, WARNING, "nothing happens when '{}' is pressed: it has {} ACTION"},
    {Rule::ActionNever, WARNING, "this ACTION never runs: {}"},
    {Rule::NoCommand, WARNING, "nothing happens here: no name and no command behind ACTION"},
    {Rule::SameMnemonic, WARNING, "another control of the dialog has the mnemonic '{}'"},
    {Rule::LabelOrder, WARNING, "the mnemonic '{}' leads to nothing: no field follows its label"},

    {Rule::ThenMissing, ERROR, "IF without THEN on its line"},
    {Rule::Parentheses, ERROR, "the condition has {} '(' and {} ')'"},
    {Rule::ConditionRest, ERROR, "the condition cannot be read from here on"},
    {Rule::OperandMissing, ERROR, "an operand is missing"},
    {Rule::ValueForm, ERROR, "{} needs a value in parentheses"},
    {Rule::StatementAlone, ERROR, "{} without its {}"},
    {Rule::NoDefault, WARNING, "SWITCH without DEFAULT: the page cannot be left when no CASE is true"},
    {Rule::BraceOpen, ERROR, "the closing brace is missing"},
    {Rule::TooDeep, ERROR, "too many statements within each other"},
    {Rule::NameQuote, ERROR, "the dialog's name stands in double quotes: DIALOG \"name\""},
    {Rule::JumpBlank, ERROR, "the blank before DIALOG keeps it from being a jump"},
    {Rule::NotStatement, ERROR, "'{}' is no statement; commands are written Name (parameters)"},
    {Rule::BlankMissing, ERROR, "a blank is missing before the '{}'"},
    {Rule::ExpressionMissing, ERROR, "the value to assign is missing"},
    {Rule::DoubleEquals, ERROR, "an assignment has one '='"},
    {Rule::CutDigit, WARNING, "behind '-' only the first digit counts"},
    {Rule::QuotedParenthesis, WARNING, "this ')' ends the parameters, although it is quoted"},
    {Rule::Unreachable, WARNING, "this statement is never reached"},
    {Rule::NoNextDialog, WARNING, "no dialog follows: Next does nothing here"},

    {Rule::UnknownDialog, ERROR, "no dialog is named '{}'"},
    {Rule::UnknownBox, ERROR, "no message box is named '{}'"},
    {Rule::UnknownCommand, ERROR, "unknown command '{}'"},
    {Rule::UnknownEvent, ERROR, "the event runs '{}', which is no command"},
    {Rule::EventControl, WARNING, "'{}' is an event's command, but the dialog has no control '{}'"},
    {Rule::NeverSet, ERROR, "the variable '{}' is set nowhere"},
    {Rule::MarkerOpen, WARNING, "'<%' without '%>': it is shown as it stands"},

    {Rule::Engine, ERROR, "the engine reports: {}"},
};
static_assert(std::size(g_rules) == static_cast<size_t>(Rule::Count), "one row for each rule");

constexpr bool bInOrder() {
  for (size_t i = 0; i < std::size(g_rules); i++)
    if (g_rules[i].rule != static_cast<Rule>(i)) return false;
  return true;
}

}  // namespace

const RuleRow& RowOf(Rule rule) {
  static_assert(bInOrder(), "the rows stand in the order of the rules");
  return g_rules[static_cast<size_t>(rule)];
}

std::string RuleList() {
  std::string list;
  for (const RuleRow& row : g_rules) {
    std::string text = row.szText;
    for (size_t at; (at = text.find("{}")) != std::string::npos;) text.replace(at, 2, "...");
    const std::string line = (row.bError ? "  error    " : "  warning  ") + text + "\n";
    if (list.find(line) == std::string::npos) list += line;
  }
  return list;
}
