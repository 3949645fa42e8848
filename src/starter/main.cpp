// The program's entry: close the door to foreign libraries, then hand over to the launcher.
#include <windows.h>

#include "foundation/os/OsLibraries.h"
#include "launcher/Launcher.h"

int WINAPI WinMain(HINSTANCE hInstance, HINSTANCE, LPSTR, int) {
  LoadLibrariesFromSystemOnly();
  return iRunSetup(hInstance, GetCommandLineW());
}
