#include "launcher/Launcher.h"

#include "launcher/BundleStart.h"
#include "launcher/SetupRun.h"
#include "window/Win32View.h"

int iRunSetup(void* hInstance, const wchar_t* pCommandLine) {
  BundleStart bundle;
  ReadBundleStart(bundle);
  CarriedScripts scripts;
  scripts.bLoad(hInstance);     // a build without them ends at once, with the loader's log line
  bUseBundle(bundle, scripts);  // so does a bundle without a script
  SetupSurroundings surroundings;
  surroundings.pMakeView = [](void* pContext) { return pMakeWin32View(pContext); };
  surroundings.pContext = hInstance;
  surroundings.pScripts = &scripts;
  surroundings.szTempFolder = szTempFolderOf(bundle);
  surroundings.pSwitches = bundle.pSwitches.get();
  const int iCode = iRunSetupIn(surroundings, pCommandLine);
  TellEnd(bundle);
  return iCode;
}
