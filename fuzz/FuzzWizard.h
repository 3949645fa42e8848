// A wizard that no script can end the process of, on a view that waits for nobody and that no script keeps going round.
#pragma once

#include <deque>
#include <functional>

#include "wizard/COrbitWizard.h"
#include "wizard/HeadlessView.h"

class FuzzView : public HeadlessView {
 public:
  // Called when no command is queued; false ends the run.
  std::function<bool()> onStep;

  // Something only a real window would report; nothing without a window.
  void Notify(BaseControl& control, int iNotification);

  bool bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) override;
  int iRun() override;
  void PostCommand(int iID) override;
  void SendCommand(int iID) override;
  void ShowDialog() override;

 private:
  void Move();

  WizardEvents* m_pWizard = nullptr;
  std::deque<int> m_queue;
  int m_iMoves = 0;
};

class FuzzWizard : public COrbitWizard {
 public:
  explicit FuzzWizard(WizardView& view) : COrbitWizard(view) {}

 protected:
  void EndProcess(int) override {}
};

// Shows the first page of a script with all kinds of controls, variables and flow statements, and calls pRun there.
void FuzzOnPage(const std::function<void(FuzzWizard& wizard)>& run);
