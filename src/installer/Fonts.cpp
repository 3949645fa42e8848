// Installs the product's fonts: files of the destination, those known by name and those of the variable "fonts".
#include <windows.h>

#include <cstring>

#include "archive/PathGuard.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"
#include "installer/ShellFolder.h"

static const char KNOWN_FONTS[] = "ModGr.ttf;ModGrI.ttf;";

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

// A copy keeps the time. One that is there already may be in use, and need not be replaced.
static bool bSameVersion(const char* szFrom, const char* szTo) {
  OsFileInfo from, to;
  return bOsGetFileInfo(szFrom, from) && bOsGetFileInfo(szTo, to) && from.size == to.size &&
         from.times.lastWrite == to.times.lastWrite;
}

// A font that was there before us is not ours to replace, or to remove later.
int CNInstallWizard::iInstallFont(const char* szFrom, const char* szFonts, const char* szFile) {
  const CNString csTo = Joined(szFonts, "\\", szFile);
  if (bOsExists(csTo.Text()) && !m_Record.bHolds("fonts", szFile))
    return iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iInstallFont -> bOsExists(%s) -> kept", csTo.Text());
  AddUndo("fonts", szFile);
  if (!bSameVersion(szFrom, csTo.Text())) {
    RemoveFontResourceW(Wide(csTo.Text()));
    if (!CopyFileW(WidePath(szFrom), WidePath(csTo.Text()), FALSE)) return FUNCTION_ERROR;
  }
  AddFontResourceW(Wide(csTo.Text()));
  return iAddFontToRegistry(szFile);
}

int CNInstallWizard::iInstallFonts() {
  const TextList names(Joined(KNOWN_FONTS, szValue("fonts")).Text());
  CNString csFolder, csFonts, csSafe;
  GetDestination(csFolder);
  int iResult = EVERYTHING_IS_OK;
  bool bAny = false;
  for (int i = 0; i < names.Size() && iResult == EVERYTHING_IS_OK; i++) {
    const CNString csFile = Joined(csFolder.Text(), "\\", names[i]);
    if (!bMakeSafePath(names[i], csSafe) || csSafe.Has('\\') || !bOsExists(csFile.Text())) continue;
    bAny = true;
    iResult = bGetShellFolder(nullptr, "Fonts", csFonts) ? iInstallFont(csFile.Text(), csFonts.Text(), names[i])
                                                         : FUNCTION_ERROR;
  }
  // Running programs list the new fonts; one that hangs does not hold setup up.
  if (bAny) SendNotifyMessageW(HWND_BROADCAST, WM_FONTCHANGE, 0, 0);
  if (iResult != EVERYTHING_IS_OK)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iFinalizeInstallation -> iInstallFonts -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}
