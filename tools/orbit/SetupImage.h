// A setup program as a linker made it: an executable for Windows with room in its DOS header for the payload stamp.
#pragma once

#include <cstdint>
#include <string>

#include "foundation/os/Os.h"

// In the order of OpenSetup's refusals.
enum class ImageKind {
  NotExecutable,
  Damaged,  // an executable's first bytes, but no Windows program behind them
  NoRoom,   // the place of the stamp is in use
  Stamped,
  Unstamped,
};

// Looks at an open file; leaves its position anywhere.
ImageKind KindOfImage(OsFile& file);

// Opens a setup program (UTF-8 path) that can be stamped. Throws OrbitError that says why it cannot.
void OpenSetup(const std::string& path, OsFile& file);
