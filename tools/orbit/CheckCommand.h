// Commands, conditions and the values of assignments: what a line of a flow or action text does.
#pragma once

#include "CheckNames.h"

class CommandCheck {
 public:
  CommandCheck(CheckReport& report, ScriptNames& names) : m_report(report), m_names(names) {}

  // One command line. True when nothing behind it runs: it leaves the page or the text.
  bool bCommand(Piece text);
  // A call with its parameters; pPlace is its name in the text. An event's call is made by the control itself.
  void Call(const std::string& name, Piece place, Piece parameters, bool bEvent = false);
  // Parameters that were meant as a jump: the engine wants DIALOG at once behind the parenthesis.
  static bool bBlankBeforeJump(Piece parameters);
  // The text of a condition (CheckCondition.cpp).
  void Condition(Piece text);

 private:
  struct Statement;
  struct ParameterRow;

  bool bJump(Piece text, Piece rest);
  void CallLine(Piece name, Piece rest);
  void Assign(Piece name, Piece value);
  Piece ReadTerm(Piece text, bool bCut);
  void BoxCall(Piece place, Piece parameters);
  void ControlParameter(Piece place, Piece parameters);
  void OperandParameter(Piece place, Piece parameters);
  void TwoOperands(Piece place, Piece parameters);
  void SetAndQuit(Piece place, Piece parameters);
  static const ParameterRow PARAMETERS[];

  CheckReport& m_report;
  ScriptNames& m_names;
};

// The text between the first two double quotes, or an empty piece without data when one is missing.
Piece QuotedName(Piece text);
