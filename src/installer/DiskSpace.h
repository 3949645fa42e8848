// The arithmetic of the free-space check, apart from the system and the message box.
#pragma once

#include <cstdint>

// Which drive is checked; decides what the message asks the user to free.
enum SpaceCheckMode : int {
  SPACE_ON_TEMP_DRIVE = 0,  // holds the archive and the extracted files
  SPACE_ON_DESTINATION = 1,
};

// True when 1.8 times the archive's size (cut to whole bytes) is free, and always when more than 4 GiB are.
bool bEnoughSpace(uint64_t freeBytes, uint64_t archiveSize);
// The KB that the message asks to free: 3 times the archive for the temporary drive, else twice. More than the check
// asks for, deliberately.
long lSpaceToFree(uint64_t archiveSize, int iMode);
