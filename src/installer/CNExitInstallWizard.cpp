#include "installer/CNExitInstallWizard.h"

#include <cstring>

#include "foundation/os/Os.h"

CNExitInstallWizard::~CNExitInstallWizard() {
  while (m_bWorking) OsSleep(5);
}

int CNExitInstallWizard::iExecuteFunction(const char* szCommand, const char* szParam, int /*iFlag*/,
                                          int* pCommandResult, CNString* /*pOutput*/) {
  int iUnused;
  if (!pCommandResult) pCommandResult = &iUnused;
  *pCommandResult = COMMAND_FAILED;
  if (!szCommand || !*szCommand)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNExitInstallWizard::iExecuteFunction -> !szCommand || !*szCommand -> return "
                      "PRECONDITIONS_NOT_VALID");
  if (!szParam)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNExitInstallWizard::iExecuteFunction -> !szParam -> return PRECONDITIONS_NOT_VALID");
  if (strcmp(szCommand, "b_exit_OnClick") == 0) {
    m_iExitConfirmed = 1;
    *pCommandResult = COMMAND_EXIT;
    return EVERYTHING_IS_OK;
  }
  if (strcmp(szCommand, "ExpandStream") != 0) return FUNCTION_ERROR;
  if (iExpandStream() != EVERYTHING_IS_OK)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNExitInstallWizard::iExecuteFunction -> iExpandStream -> return FUNCTION_ERROR");
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

int CNExitInstallWizard::iExpandStream() {
  if (m_bWorking) return FUNCTION_ERROR;
  m_bWorking = m_pExpand != nullptr;
  const auto run = [](void* pWizard) { static_cast<CNExitInstallWizard*>(pWizard)->Work(); };
  if (m_bWorking && bOsStartThread(run, this)) return EVERYTHING_IS_OK;
  m_bWorking = false;
  m_iExpansionResult = FUNCTION_ERROR;  // nothing was expanded
  return FUNCTION_ERROR;
}

void CNExitInstallWizard::Work() {
  m_iExpansionResult = m_pExpand(m_pContext);
  QuitWizard();
  m_bWorking = false;  // last: from here on the wizard may be destroyed
}

int CNExitInstallWizard::iOnCancel() { return m_bWorking ? EVERYTHING_IS_OK : COrbitWizard::iOnCancel(); }
