// Installs the product's fonts: those known by name that the destination holds.
#include <windows.h>

#include <cstring>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "installer/CNInstallWizard.h"
#include "installer/ShellFolder.h"

static const char* const FONTS[] = {"ModGr.ttf", "ModGrI.ttf"};

// Registers a file of the Fonts folder under its name without ".ttf".
static int iAddFontToRegistry(const char* szFile) {
  CNString csVersion, csName;
  OsGetSystemName(csVersion);
  if (csVersion.IsEqual("unknown"))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iAddFontToRegistry -> iGetWinVer(&csVersion)==WUNKNOWN -> return "
                      "FUNCTION_ERROR");
  csName.Copy(szFile, static_cast<long>(strcspn(szFile, ".")));
  csName.Concat(" (TrueType)");
  // The systems of the older family, with a key of their own, do not run this program.
  return COrbitWizard::iWriteRegistryKey(
      OS_HKEY_LOCAL_MACHINE, "Software\\Microsoft\\Windows NT\\CurrentVersion\\Fonts", csName.Text(), szFile, nullptr);
}

static int iInstallFont(const char* szFolder, const char* szFonts, const char* szFile) {
  CNString csFrom, csTo;
  csFrom.Printf("iInstallFont", "csFrom", "%s\\%s", szFolder, szFile);
  csTo.Printf("iInstallFont", "csTo", "%s\\%s", szFonts, szFile);
  if (!bOsExists(csFrom.Text())) return EVERYTHING_IS_OK;
  if (!CopyFileW(WidePath(csFrom.Text()), WidePath(csTo.Text()), FALSE)) return FUNCTION_ERROR;
  return iAddFontToRegistry(szFile);
}

int CNInstallWizard::iInstallFonts() {
  CNString csFolder, csFonts;
  GetDestination(csFolder);
  bool bAny = false;
  for (const char* szFile : FONTS) {
    CNString csFile;
    csFile.Printf("iInstallFonts", "csFile", "%s\\%s", csFolder.Text(), szFile);
    bAny = bAny || bOsExists(csFile.Text());
  }
  if (!bAny) return EVERYTHING_IS_OK;
  int iResult = bGetShellFolder(nullptr, "Fonts", csFonts) ? EVERYTHING_IS_OK : FUNCTION_ERROR;
  for (const char* szFile : FONTS)
    if (iResult == EVERYTHING_IS_OK) iResult = iInstallFont(csFolder.Text(), csFonts.Text(), szFile);
  if (iResult != EVERYTHING_IS_OK)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iFinalizeInstallation -> iInstallFonts -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}
