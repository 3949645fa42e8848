// The scripts that the setup program carries, from the source tree.
#pragma once

#include <string>

#include "installer/CarriedScripts.h"
#include "support/TestFolder.h"

inline std::string ReadSource(const std::string& name) {
  const std::string path = std::string(ORBIT_SOURCE_DIR) + "/" + name;
  OsFile file;
  // The drive that holds the source tree, when the tests run elsewhere.
  return TestFolder::ReadFile(file.bOpen(path.c_str(), OsOpenMode::Read) ? path : "Z:" + path);
}

inline void LoadSourceScripts(CarriedScripts& scripts) {
  scripts.csInstaller = ReadSource("src/installer/scripts/installer.txt").c_str();
  scripts.csPleaseWait = ReadSource("src/installer/scripts/please_wait.txt").c_str();
  scripts.csExit = ReadSource("src/installer/scripts/exit.txt").c_str();
}
