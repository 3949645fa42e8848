#include "archive/PathGuard.h"

#include <cstring>

#include "foundation/os/Os.h"

namespace {

// The system takes these for devices, whatever follows a dot or a blank after them.
const char* const DEVICE_NAMES[] = {"con",  "prn",  "aux",  "nul",  "conin$", "conout$", "clock$", "com1", "com2",
                                    "com3", "com4", "com5", "com6", "com7",   "com8",    "com9",   "lpt1", "lpt2",
                                    "lpt3", "lpt4", "lpt5", "lpt6", "lpt7",   "lpt8",    "lpt9"};

bool bIsDeviceName(const char* szStep) {
  CNString csStem;
  csStem.Copy(szStep, static_cast<long>(strcspn(szStep, ".")));
  while (csStem.Length() > 0 && csStem.Ptr()[csStem.Length() - 1] == ' ') csStem.SetLength(csStem.Length() - 1);
  for (const char* szDevice : DEVICE_NAMES)
    if (iOsCompareNoCase(csStem.Text(), szDevice) == 0) return true;
  return false;
}

// One name between two slashes. A step of nothing but dots ends in a dot.
bool bIsSafeStep(const char* pStep, size_t nLength) {
  if (nLength == 0 || pStep[nLength - 1] == ' ' || pStep[nLength - 1] == '.') return false;
  for (size_t i = 0; i < nLength; i++) {
    const unsigned char c = static_cast<unsigned char>(pStep[i]);
    if (c < 0x20 || c == 0x7f || strchr("<>\"|?*:", c)) return false;
  }
  CNString csStep;
  csStep.Copy(pStep, static_cast<long>(nLength));
  return !bIsDeviceName(csStep.Text());
}

bool bIsLink(const char* szPath) {
  OsFileInfo info;
  return bOsGetFileInfo(szPath, info) && (info.attributes & OS_REPARSE_POINT);
}

}  // namespace

bool bMakeSafePath(const char* szName, CNString& csPath) {
  csPath.Free();
  if (!szName) return false;
  for (const char* pStep = szName;;) {
    const size_t nLength = strcspn(pStep, "\\/");
    if (!bIsSafeStep(pStep, nLength)) return csPath.Free(), false;
    csPath.Concat(pStep, static_cast<long>(nLength));
    pStep += nLength;
    if (!*pStep) return csPath.Ptr() != nullptr;
    csPath.Concat("\\");
    pStep++;
  }
}

bool bNoLinkOnPath(const char* szFolder, const char* szRelativePath) {
  for (const char* pEnd = szRelativePath;;) {
    pEnd += strcspn(pEnd, "\\/");
    CNString csPrefix;
    csPrefix = szFolder;
    csPrefix.Concat(szRelativePath, static_cast<long>(pEnd - szRelativePath));
    if (bIsLink(csPrefix.Text())) return false;
    if (!*pEnd) return true;
    pEnd++;
  }
}
