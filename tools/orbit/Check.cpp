#include "Check.h"

#include <algorithm>

#include "CheckPasses.h"
#include "ScriptFile.h"

namespace {

void CheckAllDialogs(CheckReport& report, ScriptNames& names, const ScannedScript& script) {
  CommandCheck commands(report, names);
  for (const ScannedDialog& dialog : script.dialogs) {
    const bool bLast = &dialog == &script.dialogs.back();
    names.EnterDialog(dialog);
    CheckDialog(report, names, commands, dialog);
    for (const ScannedAction& action : dialog.actions)
      CheckFlowText(report, commands, action.commands, FlowKind::Action);
    CheckFlowText(report, commands, dialog.flow, bLast ? FlowKind::LastFlow : FlowKind::Flow);
  }
}

// Letters in comments do no harm; a file without any is UTF-8 by its mark.
void ReportEncoding(CheckReport& report, const ScriptFile& file) {
  if (!file.bUtf8) return;
  const auto bLetter = [](char c) { return (c & 0x80) != 0; };
  const Piece text = report.File().Text();
  const auto letter = std::find_if(text.begin(), text.end(), bLetter);
  if (letter != text.end())
    report.Add(Rule::NotCp1250, &*letter);
  else if (std::none_of(file.text.begin(), file.text.end(), bLetter))
    report.Add(Rule::NotCp1250, text);
}

// Returns the number of errors.
int CheckScript(const std::string& path, const ScriptFile& file, const CheckOptions& options, FILE* pOut) {
  const CheckedText text(path, file.text);
  CheckReport report(text);
  ReportEncoding(report, file);
  const ScannedScript script = ScanScript(report);
  ScriptNames names(report, script, options);
  CheckAllDialogs(report, names, script);
  CheckMarkers(report, names);
  names.CheckVariables();
  CheckThroughEngine(report);
  return report.Print(pOut);
}

}  // namespace

int CheckScripts(const CheckJob& job, FILE* pOut, FILE* pErrors) {
  bool bFailed = false;
  for (const std::string& path : job.scripts) {
    ScriptFile file;
    const bool bRead = bReadScriptFile(path, file);
    if (!bRead) std::fprintf(pErrors, "orbit: cannot read %s\n", path.c_str());
    if (!bRead || CheckScript(path, file, job.options, pOut) > 0) bFailed = true;
  }
  return bFailed;
}

std::string CheckHelp() {
  return "Nothing is run. Every fault of a script, in order of place, is printed as\n"
         "  FILE:LINE:COLUMN: error|warning: TEXT\n"
         "with the source line and a caret below it, in UTF-8. Lines and columns begin at 1; a tab is one column. An "
         "error\n"
         "changes or breaks the run, a warning is merely suspicious. SCRIPT is in code page 1250, as the setup "
         "program\n"
         "reads it. Exit code: 1 when there is an error or a script cannot be read, 2 for wrong usage, else 0.\n"
         "What is checked:\n" +
         RuleList();
}
