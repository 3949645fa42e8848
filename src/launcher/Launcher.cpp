#include "launcher/Launcher.h"

#include "launcher/SetupRun.h"
#include "window/Win32View.h"

int iRunSetup(void* hInstance, const wchar_t* pCommandLine) {
  CarriedScripts scripts;
  scripts.bLoad(hInstance);  // a build without them ends at once, with the loader's log line
  SetupSurroundings surroundings;
  surroundings.pMakeView = [](void* pContext) { return pMakeWin32View(pContext); };
  surroundings.pContext = hInstance;
  surroundings.pScripts = &scripts;
  return iRunSetupIn(surroundings, pCommandLine);
}
