#include "Run.h"

#include "RunSteps.h"
#include "RunView.h"
#include "ScriptWriter.h"
#include "ToolWizard.h"
#include "controls/Kinds.h"

namespace {

const int EXIT_USAGE = 2;

class ScriptRun {
 public:
  ScriptRun(const RunJob& job, FILE* pOut, FILE* pErrors);
  int Run();

 private:
  bool TakeStep();
  void LeftOver();
  void Do(const RunStep& step);
  void DoNavigation(const RunStep& step);
  void DoClick(const RunStep& step);
  void DoType(const RunStep& step);
  void DoCheck(const RunStep& step);
  void DoChoose(const RunStep& step);
  void DoCommand(const RunStep& step);
  void DoVars(const RunStep& step);
  void DoControls(const RunStep& step);
  // Refuses the step unless the control was there to be used.
  void Used(const RunStep& step, bool bUsed, const std::string& cannot);

  const RunJob& m_job;
  FILE* m_pErrors;
  RunView m_view;
  ToolWizard m_wizard{m_view};
  std::vector<RunSetting> m_settings;
  std::vector<RunStep> m_steps;
  size_t m_next = 0;  // the step to be taken
};

// Every word is read before anything runs.
ScriptRun::ScriptRun(const RunJob& job, FILE* pOut, FILE* pErrors)
    : m_job(job), m_pErrors(pErrors), m_view(pOut, pErrors) {
  for (const std::string& word : job.settings) m_settings.push_back(ReadSetting(word));
  for (const std::string& word : job.answers) m_view.answers.push_back(ReadAnswer(word));
  for (const std::string& word : job.steps) m_steps.push_back(ReadStep(word));
  m_view.SetWizard(&m_wizard);
  m_view.onIdle = [this](HeadlessView&) { return TakeStep(); };
}

int ScriptRun::Run() {
  if (const int iResult = m_wizard.iLoadScript(m_job.script, m_pErrors)) return iResult;
  for (const RunSetting& setting : m_settings) m_wizard.iSetVariable(setting.name.c_str(), setting.value.c_str());
  const int iResult = m_wizard.iRunWindow("OrbitRunClass", 0);
  if (!m_view.bFailed()) LeftOver();
  return m_view.bFailed() ? EXIT_USAGE : iResult;
}

// False ends the run.
bool ScriptRun::TakeStep() {
  if (m_view.bFailed() || m_next == m_steps.size()) return false;
  m_view.BeginStep();
  Do(m_steps[m_next++]);
  return !m_view.bFailed();
}

// The wizard has ended: its variables can still be looked at.
void ScriptRun::LeftOver() {
  for (; m_next < m_steps.size(); m_next++) {
    const RunStep& step = m_steps[m_next];
    if (step.kind != StepKind::Vars) return m_view.Fail(step.shown + ": the wizard has ended");
    Do(step);
  }
}

void ScriptRun::Do(const RunStep& step) {
  static void (ScriptRun::*const HANDLERS[])(const RunStep&) = {
      &ScriptRun::DoNavigation, &ScriptRun::DoNavigation, &ScriptRun::DoNavigation, &ScriptRun::DoNavigation,
      &ScriptRun::DoClick,      &ScriptRun::DoType,       &ScriptRun::DoCheck,      &ScriptRun::DoCheck,
      &ScriptRun::DoChoose,     &ScriptRun::DoCommand,    &ScriptRun::DoVars,       &ScriptRun::DoControls};
  static_assert(std::size(HANDLERS) == static_cast<size_t>(StepKind::Controls) + 1, "one handler for each kind");
  (this->*HANDLERS[static_cast<size_t>(step.kind)])(step);
}

void ScriptRun::DoNavigation(const RunStep& step) {
  static const int IDS[] = {ID_NEXT, ID_BACK, ID_CANCEL, ID_EXIT};
  m_view.SendCommand(IDS[static_cast<size_t>(step.kind)]);
}

void ScriptRun::Used(const RunStep& step, bool bUsed, const std::string& cannot) {
  if (bUsed) return;
  const HeadlessView::ControlState* pState = m_view.pState(step.name.c_str());
  m_view.Fail(step.shown + ": " +
              (!pState            ? "the shown dialog has no such control"
               : !pState->visible ? "the control is hidden"
               : !pState->enabled ? "the control is disabled"
                                  : cannot));
}

void ScriptRun::DoClick(const RunStep& step) {
  Used(step, m_view.bPress(step.name.c_str()) || m_view.bChooseItem(step.name.c_str()),
       "the control cannot be pressed");
}

void ScriptRun::DoType(const RunStep& step) {
  Used(step, m_view.bType(step.name.c_str(), step.text.c_str()), "the control takes no text");
}

void ScriptRun::DoChoose(const RunStep& step) {
  Used(step, m_view.bSelect(step.name.c_str(), step.text.c_str()), "the control has no such item");
}

void ScriptRun::DoCheck(const RunStep& step) {
  const BaseControl* pControl = m_wizard.GetBaseControl(step.name.c_str());
  const HeadlessView::ControlState* pState = m_view.pState(step.name.c_str());
  const bool bOn = step.kind == StepKind::Check;
  if (!pControl && m_view.bTick(step.name.c_str(), bOn)) return;
  const bool bBox = pControl && pControl->Kind() == ControlKind::CheckBox;
  if (bBox && pState && (pState->text == "1") == bOn) return;
  const bool bRadio = bBox && static_cast<const CNCheckBox*>(pControl)->m_bRadio;
  const bool bCan = bBox && (bOn || !bRadio);
  Used(step, bCan && m_view.bPress(step.name.c_str()),
       bRadio ? "a radio button is not unchecked by pressing it" : "the control is no check box");
}

// A line that fails cancels no wizard here: the result is what was asked for.
void ScriptRun::DoCommand(const RunStep& step) {
  int iResult = COMMAND_DONE;
  const int iCode = m_wizard.iDecideNextDialog(m_wizard.CurrentDialogNumber(), 3, step.name.c_str(), &iResult);
  m_view.Line("result " + std::to_string(iCode) + " " + std::to_string(iResult));
  if (iResult != COMMAND_FAILED) m_wizard.iProcessDecideNextDialogAction(iResult);
}

void ScriptRun::DoVars(const RunStep&) {
  const CNVariables& variables = m_wizard.Variables();
  for (int i = 0; i < variables.Size(); i++) m_view.Line(VariableLine(*variables[i]));
}

void ScriptRun::DoControls(const RunStep&) {
  const CNArray<BaseControl>& controls = m_wizard.CurrentDialog()->m_Controls;
  for (int i = 0; i < controls.Size(); i++) m_view.Line(ControlText(*controls[i]));
}

}  // namespace

int RunScript(const RunJob& job, FILE* pOut, FILE* pErrors) {
  try {
    return ScriptRun(job, pOut, pErrors).Run();
  } catch (const OrbitError& error) {
    std::fprintf(pErrors, "error: %s\n", error.what());
    return EXIT_USAGE;
  }
}
