// The names of a script: what it sets, reads, jumps to and calls, held against what there is.
#pragma once

#include <set>
#include <string>
#include <unordered_set>

#include "CheckScan.h"

// What an author's own program adds; UTF-8.
struct CheckOptions {
  std::vector<std::string> commands;
  std::vector<std::string> variables;
};

class ScriptNames {
 public:
  // Everything given must outlive the names. Reports dialogs of one name.
  ScriptNames(CheckReport& report, const ScannedScript& script, const CheckOptions& options);

  // The dialog whose texts are checked now; reports its controls of one name.
  void EnterDialog(const ScannedDialog& dialog);

  void SetsVariable(Piece name) { m_set.emplace(name); }
  void ReadsVariable(Piece name) { m_read.push_back(name); }
  bool bHasControl(Piece name) const { return m_controls.count(name) != 0; }
  // Each reports a name that is not there. The piece is its place in the text.
  void NeedsDialog(Piece name);
  void NeedsBox(Piece name);
  void NeedsControl(Piece name);

  // Whether the engine, the installer, the launcher or the author's program has the command.
  bool bIsCommand(const std::string& name) const;
  // A call: the variables that the command sets are set somewhere.
  void Calls(const std::string& name);
  // A hint for a command that does not exist.
  std::string CommandHint(Piece name) const;

  // At the end: the variables that are read and set nowhere.
  void CheckVariables();

 private:
  using NameSet = std::set<Piece>;  // in order, so that hints are the same everywhere

  std::string NeverSetHint(Piece name);
  template <class Names>
  std::string Hint(Piece name, const Names& names);

  CheckReport& m_report;
  std::unordered_set<std::string> m_commands;  // the author's
  std::set<std::string, std::less<>> m_set;
  std::vector<Piece> m_read;
  NameSet m_dialogs, m_boxes;
  NameSet m_controls;              // of the current dialog
  std::vector<bool> m_called;      // by row of the installer's commands
  size_t m_nComparisons = 200000;  // that hints may still make: a long script with many faults goes without
};

// The control that an event's command belongs to, or empty: "b_next" for "b_next_OnClick".
Piece EventControlOf(Piece command);
