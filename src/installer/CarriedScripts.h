// The three wizard scripts that the setup program carries as resources of type RCDATA (sources: installer/scripts/).
#pragma once

#include "foundation/CNString.h"

struct CarriedScripts {
  CNString csInstaller;   // SCRIPT_INSTALLER: the pages of the installation
  CNString csPleaseWait;  // SCRIPT_PLEASE_WAIT: shown while the payload is expanded
  CNString csExit;        // SCRIPT_EXIT: asks whether to leave an unfinished installation

  // Copies the texts from the program's resources; hInstance is its module. False (logged) when one is missing or
  // empty.
  bool bLoad(void* hInstance);
};
