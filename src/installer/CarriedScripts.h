// The three wizard scripts that the setup program carries as resources of type RCDATA (sources: installer/scripts/).
// A product may bring pages of its own in place of the first.
#pragma once

#include "foundation/CNString.h"

struct CarriedScripts {
  CNString csInstaller;   // SCRIPT_INSTALLER: the pages of the installation
  CNString csPleaseWait;  // SCRIPT_PLEASE_WAIT: shown while the payload is expanded
  CNString csExit;        // SCRIPT_EXIT: asks whether to leave an unfinished installation

  // Copies the texts from the program's resources; hInstance is its module. False (logged) when one is missing or
  // empty.
  bool bLoad(void* hInstance);
  // Takes csInstaller from a file. False (logged) when it is not there, empty or larger than MOST_SCRIPT; csInstaller
  // is then empty.
  bool bLoadInstallerFrom(const char* szPath);

  static const long MOST_SCRIPT = 16 << 20;  // bytes
};
