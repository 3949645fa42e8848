// The wizard of the two fixed one-page scripts: the "please wait" page, whose command ExpandStream runs the payload
// expansion on a thread of its own, and the exit confirmation.
#pragma once

#include <atomic>

#include "wizard/COrbitWizard.h"

class CNExitInstallWizard : public COrbitWizard {
 public:
  // The expansion: returns 0, or not 0 on failure. Runs on the worker thread.
  using Expansion = int (*)(void* pContext);

  // pContext must outlive the wizard. Without pExpand the command ExpandStream fails.
  explicit CNExitInstallWizard(WizardView& view, Expansion pExpand = nullptr, void* pContext = nullptr)
      : COrbitWizard(view), m_pExpand(pExpand), m_pContext(pContext) {}
  // Waits until the expansion has ended, so that nothing it uses goes away under it.
  ~CNExitInstallWizard() override;

  int iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pCommandResult,
                       CNString* pOutput) override;

  // 1 after "Exit Setup" was pressed.
  int ExitConfirmed() const { return m_iExitConfirmed; }
  // 0 success or not run. To be read after the wizard's run has returned.
  int ExpansionResult() const { return m_iExpansionResult; }

  bool bHoldsQuit() override { return m_bWorking; }

 protected:
  // The page cannot be closed while the expansion runs.
  int iOnCancel() override;

 private:
  int iExpandStream();
  void Work();

  Expansion m_pExpand;
  void* m_pContext;
  int m_iExitConfirmed = 0;
  int m_iExpansionResult = 0;
  std::atomic<bool> m_bWorking{false};
};
