#include "archive/TempArchives.h"

#include <cstring>

#include "archive/PathGuard.h"
#include "foundation/Log.h"
#include "foundation/os/Os.h"

namespace {

const uint64_t TEN_MINUTES = 10ull * 60 * 10000000;
const uint32_t LONGEST_NAME = 4096;

struct Sweep {
  const char* szFolder;
  uint64_t now;
};

bool bHasTheName(const char* szName) {
  if (szName[0] != '@') return false;
  const size_t nDigits = strspn(szName + 1, "0123456789abcdefABCDEF");
  return nDigits >= 1 && nDigits <= 8 && iOsCompareNoCase(szName + 1 + nDigits, ".tmp") == 0;
}

uint32_t Number(const unsigned char* p) { return p[0] | p[1] << 8 | p[2] << 16 | static_cast<uint32_t>(p[3]) << 24; }

enum class Look { Other, Archive, TooShort };

// The first entry's header and the first bytes of its data.
Look BeginsLike(const char* szPath) {
  OsFile file;
  unsigned char head[4 + LONGEST_NAME + 24 + 2];
  const long lRead = file.bOpen(szPath, OsOpenMode::Read) ? file.lRead(head, sizeof(head)) : -1;
  if (lRead < 0) return Look::Other;
  if (lRead < 4) return Look::TooShort;
  const uint32_t nName = Number(head);
  if (!nName || nName > LONGEST_NAME) return Look::Other;
  if (static_cast<uint32_t>(lRead) < 4 + nName + 24 + 2) return Look::TooShort;
  CNString csName, csPath;
  csName.Copy(reinterpret_cast<char*>(head) + 4, static_cast<long>(nName));
  const unsigned char* pTimes = head + 4 + nName;
  const uint32_t uWritten = Number(pTimes + 8), uStored = Number(pTimes + 20);
  // Upper halves of file times from 1980 to 2130, or none.
  const bool bTime = !uWritten || (uWritten > 0x01a80000 && uWritten < 0x02600000);
  const bool bData = !uStored || (pTimes[24] == 0x1f && pTimes[25] == 0x8b);
  return strlen(csName.Text()) == nName && bMakeSafePath(csName.Text(), csPath) && bTime && bData ? Look::Archive
                                                                                                  : Look::Other;
}

bool bVisit(const OsFolderEntry& entry, void* pContext) {
  const Sweep& sweep = *static_cast<const Sweep*>(pContext);
  if (!bHasTheName(entry.csName.Text()) || (entry.info.attributes & (OS_DIRECTORY | OS_REPARSE_POINT))) return true;
  CNString csPath(sweep.szFolder, 0);
  csPath.Concat(entry.csName.Text());
  const Look look = BeginsLike(csPath.Text());
  const bool bOld = entry.info.times.lastWrite + TEN_MINUTES < sweep.now;
  if (look == Look::Archive || (look == Look::TooShort && bOld))
    if (bOsDeleteFile(csPath.Text())) LogPrintf("INFO: RemoveLeftTempArchives -> %s", csPath.Text());
  return true;
}

}  // namespace

void RemoveLeftTempArchives(const char* szFolder, uint64_t now) {
  Sweep sweep = {szFolder, now};
  bOsListFolder(szFolder, bVisit, &sweep);
}
