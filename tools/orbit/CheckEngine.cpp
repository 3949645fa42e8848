// The engine's own view: what it reports about the script and the scan has not seen is reported as well.
#include <set>

#include "CheckPasses.h"
#include "controls/ScriptReport.h"
#include "wizard/COrbitWizard.h"
#include "wizard/HeadlessView.h"

namespace {

// What the engine's messages say, and what an author is told.
const struct {
  Piece message;
  int iFault;
  Piece told;
} MESSAGES[] = {
    {"nedostaje apostrof!", FAULT_APOSTROPHE, "an apostrophe is missing"},
    {"nedostaje navodnik!", FAULT_QUOTE, "a double quote is missing"},
    {"nedostaje dvotocka!", FAULT_COLON, "a colon is missing"},
    {"nedostaje zagrada!", FAULT_PARENTHESIS, "a parenthesis is missing"},
    {"pogresan ID,", FAULT_ID, "an identifier is unknown"},
    {"nedostaje zarez!", FAULT_COMMA, "a comma is missing"},
    {"neocekivan kraj skripte!", FAULT_END_OF_SCRIPT, "the script ends unexpectedly"},
    {"nedostaje ", FAULT_MISSING_WORD, "a word is missing"},
    {"missing INIT or END_INIT", ENGINE_INIT, "INIT or END_INIT is missing"},
    {"END_DIALOG and DIALOG mismatch", ENGINE_MISMATCH, "DIALOG and END_DIALOG do not match"},
    {"Missing BEGIN", ENGINE_BEGIN, "BEGIN is missing"},
    {"Missing START_ACTION", ENGINE_START_ACTION, "START_ACTION is missing"},
    {"Missing FINISH_ACTION", ENGINE_FINISH_ACTION, "FINISH_ACTION is missing"},
    {"After TABLE_START", ENGINE_TABLE, "a table is incomplete"},
    {"Missing single quotation marks", ENGINE_TABLE, "an apostrophe of a table is missing"},
};

class RecordingView : public HeadlessView {
 public:
  std::vector<std::string> messages;

  int iShowMessage(const MessageText& message) override {
    messages.push_back(message.szText ? message.szText : "");
    return ANSWER_OK;
  }
};

class LoadingWizard : public COrbitWizard {
 public:
  explicit LoadingWizard(WizardView& view) : COrbitWizard(view) {}

 protected:
  void EndProcess(int) override {}
};

// The line that a message names; 0 without.
size_t LineOf(const std::string& message) {
  const Piece word = " u liniji ";
  const size_t at = message.find(word);
  return at == std::string::npos ? 0 : std::strtoul(message.c_str() + at + word.size(), nullptr, 10);
}

class EngineFaults {
 public:
  explicit EngineFaults(CheckReport& report) : m_report(report) {
    for (const CheckFault& fault : report.Faults()) {
      const int iFault = RowOf(fault.rule).iEngine;
      if (iFault != ENGINE_NONE) m_seen.insert({iFault, report.File().PositionOf(fault.pEnginePlace).line});
    }
  }

  void Add(const std::string& message) {
    const size_t line = LineOf(message);
    for (const auto& row : MESSAGES) {
      if (message.find(row.message) == std::string::npos) continue;
      if (!bSeen(row.iFault, line)) Report(line, row.told);
      return;
    }
    Report(line, message);
  }

 private:
  // A message without a line stands for the fault anywhere.
  bool bSeen(int iFault, size_t line) const {
    if (line && m_report.bGivenUp(line)) return true;
    const auto found = m_seen.lower_bound({iFault, line});
    return found != m_seen.end() && found->first == iFault && (line == 0 || found->second == line);
  }

  void Report(size_t line, Piece told) {
    const char* const pPlace = m_report.File().LineText(line ? line : 1);
    m_report.Add(Rule::Engine, pPlace, {told});
  }

  CheckReport& m_report;
  std::set<std::pair<int, size_t>> m_seen;
};

}  // namespace

void CheckThroughEngine(CheckReport& report) {
  const std::string& text = report.File().Written();
  if (text.find("DIALOG") == std::string::npos) return;  // the loader would take it for a file's name
  RecordingView view;
  LoadingWizard wizard(view);
  const int iResult = wizard.iLoadMainList(text.c_str());
  EngineFaults faults(report);
  for (const std::string& message : view.messages) faults.Add(message);
  if (iResult && report.Faults().empty()) faults.Add("the script cannot be loaded, result " + std::to_string(iResult));
}
