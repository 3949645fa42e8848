// The run of the setup program, apart from where its windows and scripts come from.
#pragma once

#include <memory>

#include "installer/CarriedScripts.h"
#include "wizard/WizardView.h"

const int SETUP_FILE_NOT_OPEN = -200;

struct SetupSurroundings {
  // Makes the view of one wizard. Called once for the installer and once for the "please wait" page.
  std::unique_ptr<WizardView> (*pMakeView)(void* pContext) = nullptr;
  void* pContext = nullptr;
  const CarriedScripts* pScripts = nullptr;
  unsigned uEndPause = 1500;  // milliseconds before the temporary files are deleted
};

// Returns 0, or SETUP_FILE_NOT_OPEN. No temporary file is left, however the run ends.
int iRunSetupIn(const SetupSurroundings& surroundings, const wchar_t* pCommandLine);
