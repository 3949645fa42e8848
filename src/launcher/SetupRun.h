// The run of the setup program, apart from where its windows and scripts come from.
#pragma once

#include <memory>

#include "installer/CarriedScripts.h"
#include "wizard/WizardView.h"

// What a run returns. One with windows returns only 0 and SETUP_FILE_NOT_OPEN, and, started by the starter of a packed
// file, SETUP_WRONG_SWITCH, SETUP_RUNNING, SETUP_INSTALLED, and SETUP_FAILED when it cannot begin.
enum SetupExitCode : int {
  SETUP_DONE = 0,
  SETUP_WRONG_SWITCH = 87,
  SETUP_NO_SPACE = 112,
  SETUP_CANCELLED = 1602,
  SETUP_FAILED = 1603,
  SETUP_RUNNING = 1618,    // another setup of the product
  SETUP_INSTALLED = 1638,  // this version or a newer one, and the script refuses that
  SETUP_RESTART = 3010,    // done; the computer is to be restarted
  SETUP_FILE_NOT_OPEN = -200,
};

struct SetupSurroundings {
  // Makes a view with windows. Called once for the installer and once for the "please wait" page; in a passive run once
  // for the copying page, in a silent one for faults of the command line that nobody else could tell.
  std::unique_ptr<WizardView> (*pMakeView)(void* pContext) = nullptr;
  void* pContext = nullptr;
  const CarriedScripts* pScripts = nullptr;
  const char* szTempFolder = nullptr;  // where the payload is expanded to; null: the system's temporary folder
  unsigned uEndPause = 1500;           // milliseconds before the temporary files are deleted, when a person looks on
  // The switches of a packed file's command line, see Switches.h; null: not started by a packed file's starter.
  const wchar_t* pSwitches = nullptr;
};

// Returns a SetupExitCode. No temporary file is left, however the run ends.
int iRunSetupIn(const SetupSurroundings& surroundings, const wchar_t* pCommandLine);
