#include "CheckNames.h"

#include <array>

#include "OrbitText.h"
#include "installer/CommandNames.h"
#include "wizard/COrbitWizard.h"

namespace {

// For hints; what the engine knows it says itself.
const Piece BUILT_INS[] = {"FillRecentFiles",
                           "OpenRecentFile",
                           "RecordMacro",
                           "PlayMacro",
                           "Next",
                           "Back",
                           "EnableControl",
                           "DisableControl",
                           "ShowControl",
                           "HideControl",
                           "HideWizard",
                           "ShowWizard",
                           "EndsWith",
                           "NotEndsWith",
                           "Strlen",
                           "btn_set_var_quit_OnClick",
                           "MESSAGE_BOX"};

// The commands of the launcher's two one-page scripts.
const Piece LAUNCHER_COMMANDS[] = {"ExpandStream", "b_exit_OnClick"};

// Variables that a script reads without setting them, and the installer's command that sets each; without one it is
// always there.
const struct {
  Piece name, command;
} SET_ELSEWHERE[] = {
    {"win_ver", ""},
    {"link_next_var", ""},
    {"msgbox_answer", ""},
    {"version", ""},
    {"failed_files", "Unzip"},
    {"from_file", "CopySpeechFile"},
    {"to_file", "CopySpeechFile"},
    {"default_path", "InitDefaultPath"},
    {"default_path", "CheckForFolder"},
    {"default_path", "b_browse_OnClick"},
    {"default_path", "CheckForOldVersion"},
    {"path", "b_browse_OnClick"},
    {"path", "CheckForOldVersion"},
    {"old_path", "CheckForOldVersion"},
    {"old_def_path", "CheckForOldVersion"},
    {"upgrade", "CheckForOldVersion"},
    {"CD_installation", "CheckForCDInstallation"},
    {"speech_path", "CheckForCDInstallation"},
    {"bInstallWizard_A", "btn_no_cro_supp_a_OnClick"},
    {"bInstallWizard_B", "btn_no_cro_supp_b_OnClick"},
    {"total_size", "SetExpansionCardTotalSize"},
    {"user", "GetUsers"},
    {"lang_supp", "GetLangSupport"},
    {"missed_size_in_mem", "CheckIfAllIsInstalled"},
    {"missed_size_on_card", "CheckIfAllIsInstalled"},
    {"IE_version", "CheckForIEVersion"},
    {"proxy", "CheckForProxy"},
    {"back", "btn_back_OnClick"},
    {"failed_files", "CopySpeechFile"},
    {"halvex_backup", "BackupOldHalvex"},
    {"running_programs", "CheckIfSoftwareIsRuning"},
    {"running_programs", "CheckForFolder"},
    {"running_programs", "DeinstallToolbar"},
    {"installed_products", "CheckForInstalledSoftware"},
    {"colvane_ver", "AddColvaneToOldInstallation"},
    {"start_halvex_msg", "StartHalvexMsg"},
    {"updown0_free_space", "GetFreeMemSize"},
    {"updown1_free_space", "GetFreeMemSize"},
};

std::vector<Piece> CollectCommands() {
  std::vector<Piece> names(std::begin(BUILT_INS), std::end(BUILT_INS));
  names.insert(names.end(), std::begin(LAUNCHER_COMMANDS), std::end(LAUNCHER_COMMANDS));
  for (const InstallCommandName& row : INSTALL_COMMAND_NAMES) {
    names.push_back(row.szName);
    if (row.szSecondName) names.push_back(row.szSecondName);
  }
  return names;
}

}  // namespace

Piece EventControlOf(Piece command) {
  static const Piece SUFFIXES[] = {"_OnClick",      "_OnSetFocus", "_OnKillFocus", "_OnSelChange",   "_OnEditUpdate",
                                   "_OnEditChange", "_OnDropUp",   "_OnDropDown",  "_OnDoubleClick", "_OnMouseIn",
                                   "_OnMouseOut",   "_OnMouseUp",  "_OnMouseDown"};
  for (const Piece suffix : SUFFIXES)
    if (command.size() > suffix.size() && command.substr(command.size() - suffix.size()) == suffix)
      return command.substr(0, command.size() - suffix.size());
  return {};
}

ScriptNames::ScriptNames(CheckReport& report, const ScannedScript& script, const CheckOptions& options)
    : m_report(report), m_called(INSTALL_COMMAND_COUNT) {
  std::string name;
  for (const std::string& command : options.commands)
    if (ToCp1250(command, name)) m_commands.insert(name);
  for (const std::string& variable : options.variables)
    if (ToCp1250(variable, name)) m_set.insert(name);
  for (const Piece variable : script.variables) SetsVariable(variable);
  for (const ScannedDialog& dialog : script.dialogs) {
    if (!dialog.name.empty() && !m_dialogs.insert(dialog.name).second)
      m_report.Add(Rule::SameDialog, dialog.name, {dialog.name});
    for (const ScannedControl& control : dialog.controls)
      if (control.pKind->keyword == "MESSAGE_BOX" && !control.name.empty()) m_boxes.insert(control.name);
  }
}

void ScriptNames::EnterDialog(const ScannedDialog& dialog) {
  m_controls.clear();
  for (const ScannedControl& control : dialog.controls)
    if (!control.name.empty() && !m_controls.insert(control.name).second)
      m_report.Add(Rule::SameControl, control.name, {control.name});
}

template <class Names>
std::string ScriptNames::Hint(Piece name, const Names& names) {
  if (names.size() > m_nComparisons) return "";
  m_nComparisons -= names.size();
  const std::vector<Piece> candidates(names.begin(), names.end());
  return NearMiss(name, candidates);
}

void ScriptNames::NeedsDialog(Piece name) {
  if (!m_dialogs.count(name)) m_report.Add(Rule::UnknownDialog, name, {name}, Hint(name, m_dialogs));
}

void ScriptNames::NeedsBox(Piece name) {
  if (!m_boxes.count(name)) m_report.Add(Rule::UnknownBox, name, {name}, Hint(name, m_boxes));
}

void ScriptNames::NeedsControl(Piece name) {
  if (!m_controls.count(name)) m_report.Add(Rule::UnknownControl, name, {name}, Hint(name, m_controls));
}

bool ScriptNames::bIsCommand(const std::string& name) const {
  for (const Piece command : LAUNCHER_COMMANDS)
    if (name == command) return true;
  return COrbitWizard::bIsBuiltIn(name.c_str()) || iFindInstallCommand(name.c_str()) >= 0 ||
         m_commands.count(name) != 0;
}

void ScriptNames::Calls(const std::string& name) {
  const int iRow = iFindInstallCommand(name.c_str());
  if (iRow >= 0) m_called[static_cast<size_t>(iRow)] = true;
}

std::string ScriptNames::CommandHint(Piece name) const {
  static const std::vector<Piece> commands = CollectCommands();
  const Piece control = EventControlOf(name);
  if (control.empty()) return NearMiss(name, commands);
  // The common ending makes no two names alike.
  std::vector<Piece> near;
  for (const Piece command : commands)
    if (!NearMiss(control, std::array{EventControlOf(command)}).empty()) near.push_back(command);
  return NearMiss(name, near);
}

std::string ScriptNames::NeverSetHint(Piece name) {
  const bool bLiteral = name.find_first_not_of("0123456789") == Piece::npos || name.front() == '\'';
  if (bLiteral) return " (a literal stands in double quotes)";
  if (name == "TRUE" || name == "FALSE") return " (did you mean '_" + std::string(name) + "'?)";
  for (const auto& row : SET_ELSEWHERE)
    if (row.name == name) return " (" + std::string(row.command) + " sets it, but is never called)";
  return Hint(name, m_set);
}

void ScriptNames::CheckVariables() {
  for (const auto& row : SET_ELSEWHERE) {
    const int iRow = iFindInstallCommand(std::string(row.command).c_str());
    if (row.command.empty() || (iRow >= 0 && m_called[static_cast<size_t>(iRow)])) SetsVariable(row.name);
  }
  for (const Piece name : m_read)
    if (m_set.find(name) == m_set.end()) m_report.Add(Rule::NeverSet, name, {name}, NeverSetHint(name));
}
