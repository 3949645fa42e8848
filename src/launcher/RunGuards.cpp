#include "launcher/RunGuards.h"

#include <windows.h>

#include <cstdlib>
#include <cstring>

#include "foundation/os/OsWide.h"
#include "installer/CommandTools.h"
#include "installer/Programs.h"

ProductLock::~ProductLock() {
  if (m_hMutex) CloseHandle(m_hMutex);
}

// Whose it is does not matter: another user's, which cannot be opened, holds as well.
bool ProductLock::bTake(const char* szProduct) {
  CNString csProduct(szProduct, 0);
  for (char* p = csProduct.Ptr(); p && *p; p++)
    if (*p == '\\') *p = '/';
  csProduct.MakeLower();
  const Wide name(Joined("Global\\OrbitSetup ", csProduct.Text()).Text());  // lives on while the error is asked for
  m_hMutex = CreateMutexW(nullptr, FALSE, name);
  return m_hMutex && GetLastError() != ERROR_ALREADY_EXISTS;
}

static unsigned long ulNextNumber(const char*& p) {
  p += strcspn(p, "0123456789");
  char* pEnd;
  const unsigned long ulNumber = strtoul(p, &pEnd, 10);
  p = *pEnd == '.' ? pEnd + 1 : "";
  return ulNumber;
}

int iCompareVersions(const char* szA, const char* szB) {
  while (*szA || *szB) {
    const unsigned long ulA = ulNextNumber(szA), ulB = ulNextNumber(szB);
    if (ulA != ulB) return ulA < ulB ? -1 : 1;
  }
  return 0;
}

bool bRefusesInstalled(COrbitWizard& wizard) {
  char szVersion[512] = "";
  if (strcmp(wizard.szValue("refuse_installed"), "1") != 0) return false;
  const CNString csKey = Joined(INSTALLED_PROGRAMS, wizard.szValue("program_name"));
  return COrbitWizard::iReadRegistryKey(OS_HKEY_LOCAL_MACHINE, csKey.Text(), "DisplayVersion", szVersion) ==
             EVERYTHING_IS_OK &&
         iCompareVersions(szVersion, wizard.szValue("program_version")) >= 0;
}
