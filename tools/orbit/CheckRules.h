// What can be wrong with a script: one row for each fault, with its weight and its words.
#pragma once

#include <string>

// In the order of the table in CheckRules.cpp.
enum class Rule {
  // The file and its blocks.
  NotCp1250,
  NoDialog,
  InitMissing,
  EndInitMissing,
  OutsideText,
  OutsideControl,
  EndDialogAlone,
  EndDialogMissing,
  EndDialogNumber,
  BeginMissing,
  EndMissing,
  EndWithin,
  // Lines of the INIT block.
  LineQuote,
  EqualsMissing,
  VariableName,
  ValueQuote,
  UnknownEscape,
  DeclaredTwice,
  TextIgnored,
  // Headers and control lines.
  UnknownKind,
  ReadAs,
  SameDialog,
  SameControl,
  UnknownWord,
  ApostropheMissing,
  QuoteMissing,
  ParenthesisMissing,
  UnknownNavigation,
  CommaMissing,
  WordIgnored,
  SizeIncomplete,
  UnknownFlag,
  FlagReadAs,
  ForeignFlag,
  ColorForm,
  ColorRange,
  NumberForm,
  // Groups, blocks and tables within a dialog.
  BlockOpen,
  GroupOpen,
  GroupNested,
  StrayWord,
  BoxLine,
  BoxEmpty,
  StartActionMissing,
  FinishActionMissing,
  ActionReplaced,
  TableBrace,
  TableRow,
  TableColumn,
  CellApostrophe,
  // Controls among each other.
  NameMissing,
  UnknownControl,
  NothingHappens,
  ActionNever,
  NoCommand,
  SameMnemonic,
  LabelOrder,
  // Flow and action texts.
  ThenMissing,
  Parentheses,
  ConditionRest,
  OperandMissing,
  ValueForm,
  StatementAlone,
  NoDefault,
  BraceOpen,
  TooDeep,
  NameQuote,
  JumpBlank,
  NotStatement,
  BlankMissing,
  ExpressionMissing,
  DoubleEquals,
  CutDigit,
  QuotedParenthesis,
  Unreachable,
  NoNextDialog,
  // Names.
  UnknownDialog,
  UnknownBox,
  UnknownCommand,
  UnknownEvent,
  EventControl,
  NeverSet,
  MarkerOpen,
  // Seen by the engine only.
  Engine,
  Count,
};

// Which of the engine's own messages a fault stands for; the ScriptFault codes are the others.
enum EngineFault : int {
  ENGINE_NONE = -1,
  ENGINE_INIT = 100,
  ENGINE_MISMATCH,
  ENGINE_BEGIN,
  ENGINE_START_ACTION,
  ENGINE_FINISH_ACTION,
  ENGINE_TABLE,
};

struct RuleRow {
  Rule rule;
  bool bError;         // it changes or breaks the run; else it is merely suspicious
  const char* szText;  // each {} is filled in
  int iEngine = ENGINE_NONE;
};

const RuleRow& RowOf(Rule rule);
// The weight and the words of every rule, one line each, for --help.
std::string RuleList();
