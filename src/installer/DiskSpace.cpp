#include "installer/DiskSpace.h"

bool bEnoughSpace(uint64_t freeBytes, uint64_t archiveSize) {
  const uint64_t FOUR_GIB = uint64_t{4} << 30;
  return freeBytes >= archiveSize * 9 / 5 || freeBytes > FOUR_GIB;
}

long lSpaceToFree(uint64_t archiveSize, int iMode) {
  return static_cast<long>(archiveSize * (iMode == SPACE_ON_TEMP_DRIVE ? 3 : 2) / 1024);
}
