// Finds a command's row and runs its handler.
#include "installer/CNInstallWizard.h"
#include "installer/CommandList.h"
#include "installer/CommandNames.h"

// A handler gets the text between the parentheses ("" when its row takes none) and sets the command result, which
// starts as COMMAND_FAILED.
struct InstallCommandRow {
  using Handler = int (CNInstallWizard::*)(const char* szParam, int* pCommandResult);

  Handler pHandler;
  const char* szHandler;

  static const InstallCommandRow ROWS[INSTALL_COMMAND_COUNT];
};

#define HANDLER_ROW(name, second, parameter, handler, help) {&CNInstallWizard::handler, #handler},

const InstallCommandRow InstallCommandRow::ROWS[] = {ORBIT_INSTALL_COMMANDS(HANDLER_ROW)};

int CNInstallWizard::iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pCommandResult,
                                      CNString* pOutput) {
  int iUnused;
  if (!pCommandResult) pCommandResult = &iUnused;
  *pCommandResult = COMMAND_FAILED;
  m_bPageStays = false;
  if (!szCommand)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNInstallWizard::iExecuteFunction -> !szCommand -> return PRECONDITIONS_NOT_VALID");
  if (!*szCommand)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNInstallWizard::iExecuteFunction -> !*szCommand -> return PRECONDITIONS_NOT_VALID");
  if (!szParam)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNInstallWizard::iExecuteFunction -> !szParam -> return PRECONDITIONS_NOT_VALID");
  const int iRow = iFindInstallCommand(szCommand);
  if (iRow == -1) {
    if (bIsBuiltIn(szCommand))
      return COrbitWizard::iExecuteFunction(szCommand, szParam, iFlag, pCommandResult, pOutput);
    *pCommandResult = COMMAND_DONE;  // deliberately no failure: a script may know more commands than this build
    return iLogReturn(EVERYTHING_IS_OK, "ERROR: CNInstallWizard::iExecuteFunction -> %s -> return FUNCTION_ERROR",
                      szCommand);
  }
  const InstallCommandRow& row = InstallCommandRow::ROWS[iRow];
  m_pOutput = pOutput;
  const int iCode = (this->*row.pHandler)(INSTALL_COMMAND_NAMES[iRow].bTakesParameter ? szParam : "", pCommandResult);
  CNString csLine;
  csLine.Printf("CNInstallWizard::iExecuteFunction", "csLine", "%s (%s) -> %d", szCommand, szParam, *pCommandResult);
  Tell(InstallEvent::Command, csLine.Text(), iCode);
  if (iCode != EVERYTHING_IS_OK)
    return iLogReturn(FUNCTION_ERROR, "ERROR: CNInstallWizard::iExecuteFunction -> %s -> return FUNCTION_ERROR",
                      row.szHandler);
  return EVERYTHING_IS_OK;
}
