// The program's entry: close the door to foreign libraries, then hand over to the launcher.
#include <windows.h>

#include "launcher/Launcher.h"

namespace {

const DWORD SEARCH_SYSTEM_FOLDER_ONLY = 0x800;  // LOAD_LIBRARY_SEARCH_SYSTEM32
const DWORD SAFE_SEARCH_FOR_GOOD = 0x8001;      // BASE_SEARCH_PATH_ENABLE_SAFE_SEARCHMODE | BASE_SEARCH_PATH_PERMANENT

template <class Function>
Function pKernelFunction(const char* szName) {
  const HMODULE hKernel = GetModuleHandleW(L"kernel32.dll");
  return reinterpret_cast<Function>(reinterpret_cast<void*>(GetProcAddress(hKernel, szName)));
}

// The program is started from download folders, where anybody may have put a library: none is ever loaded from there.
// Older systems have only some of these functions, so each is asked for by name.
void LoadLibrariesFromSystemOnly() {
  if (const auto pSetDirectories = pKernelFunction<BOOL(WINAPI*)(DWORD)>("SetDefaultDllDirectories"))
    pSetDirectories(SEARCH_SYSTEM_FOLDER_ONLY);
  if (const auto pSetDirectory = pKernelFunction<BOOL(WINAPI*)(const wchar_t*)>("SetDllDirectoryW")) pSetDirectory(L"");
  if (const auto pSetSearchMode = pKernelFunction<BOOL(WINAPI*)(DWORD)>("SetSearchPathMode"))
    pSetSearchMode(SAFE_SEARCH_FOR_GOOD);
}

}  // namespace

int WINAPI WinMain(HINSTANCE hInstance, HINSTANCE, LPSTR, int) {
  LoadLibrariesFromSystemOnly();
  return iRunSetup(hInstance, GetCommandLineW());
}
