// A wizard on a view without a screen, in a folder of its own with the diagnostic log switched on.
#pragma once

#include <memory>

#include "support/TestFolder.h"
#include "wizard/COrbitWizard.h"
#include "wizard/HeadlessView.h"

using Lines = std::vector<std::string>;

// The four navigation buttons.
inline const char BUTTONS[] =
    " BUTTON 'b_back' \"< Back\" ID_BACK 1 1 1 1\n BUTTON 'b_next' \"Next >\" ID_NEXT 1 1 1 1,DEFAULT,FOCUS\n"
    " BUTTON 'b_cancel' \"Cancel\" ID_CANCEL 1 1 1 1\n BUTTON 'b_exit' \"Exit\" ID_EXIT 1 1 1 1\n";

// Has a few commands that tell what ran, and keeps the process alive.
class TestWizard : public COrbitWizard {
 public:
  explicit TestWizard(WizardView& view) : COrbitWizard(view) {}

  Lines ran;  // "Name(parameters)" of every command that no built-in took

  int Counter() const { return m_iNextDialog; }
  bool bModeless() const { return m_bModeless; }
  std::string Value(const char* szName) { return szValue(szName); }

  // Names: "Result N" gives that command result, "Fail" fails, "Say" has an output; others go to the base class.
  int iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pCommandResult,
                       CNString* pOutput) override {
    const std::string name = szCommand ? szCommand : "";
    if (name.rfind("Do", 0) == 0) {
      ran.push_back(name + "(" + szParam + ")");
      *pCommandResult = 0;
      return 0;
    }
    if (name == "Result") return *pCommandResult = atoi(szParam), 0;
    if (name == "Fail") return *pCommandResult = COMMAND_FAILED, FUNCTION_ERROR;
    if (name == "Say") {
      if (pOutput) *pOutput = szParam;
      return *pCommandResult = 0, 0;
    }
    return COrbitWizard::iExecuteFunction(szCommand, szParam, iFlag, pCommandResult, pOutput);
  }

 protected:
  void EndProcess(int) override {}
};

class WizardTest : public testing::Test {
 protected:
  TestFolder folder;
  TestLog log{folder};
  HeadlessView view;
  TestWizard wizard{view};

  // The messages and other events since the last call.
  Lines Events() {
    Lines events;
    events.swap(view.events);
    return events;
  }
  Lines Logged() {
    Lines lines = log.Lines();
    log.Clear();
    return lines;
  }
  // What a control of the current dialog shows.
  std::string Text(const char* szControl) {
    const HeadlessView::ControlState* pState = view.pState(szControl);
    return pState ? pState->text : "(none)";
  }
  // A dialog named name with the given control and flow lines.
  static std::string Dialog(const std::string& name, const std::string& controls, const std::string& flow,
                            const std::string& actions = "") {
    return "DIALOG1 '" + name + "' \"" + name + "\" 0 0 100 100\n\"Arial\" 15 500\nBEGIN\n" + actions + controls +
           "END\n" + flow + "END_DIALOG1\n";
  }
  // The action block that runs before (or after) the drawing.
  static std::string Action(const std::string& lines, const std::string& when = "BEFORE") {
    return "START_" + when + "_DRAWING\nSTART_ACTION\n" + lines + "FINISH_ACTION\n";
  }
  // Runs the loaded script's window; each idle step is given to press, and the window closes when press is done.
  void Run(const std::string& script, std::vector<std::function<void()>> steps) {
    ASSERT_EQ(wizard.iLoadMainList(script.c_str()), 0);
    size_t next = 0;
    view.onIdle = [&](HeadlessView&) {
      if (next >= steps.size()) return false;
      steps[next++]();
      return true;
    };
    EXPECT_EQ(wizard.iRunWindow("WizardTestClass", 0), 0);
    EXPECT_EQ(next, steps.size());
  }
};
