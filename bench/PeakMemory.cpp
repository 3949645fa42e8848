#include "PeakMemory.h"

#ifdef _WIN32
#include <windows.h>
// After windows.h.
#include <psapi.h>

// The library is not among those that every Windows has by this name, so it is asked for at run time.
PeakMemory GetPeakMemory() {
  using Function = BOOL(WINAPI*)(HANDLE, PROCESS_MEMORY_COUNTERS*, DWORD);
  PeakMemory peak;
  const HMODULE library = LoadLibraryW(L"psapi.dll");
  if (!library) return peak;
  const FARPROC address = GetProcAddress(library, "GetProcessMemoryInfo");
  PROCESS_MEMORY_COUNTERS counters = {};
  counters.cb = sizeof counters;
  if (address &&
      reinterpret_cast<Function>(reinterpret_cast<void*>(address))(GetCurrentProcess(), &counters, sizeof counters)) {
    peak.workingSet = counters.PeakWorkingSetSize;
    peak.privateBytes = counters.PeakPagefileUsage;
  }
  FreeLibrary(library);
  return peak;
}
#else
#include <sys/resource.h>

PeakMemory GetPeakMemory() {
  rusage usage = {};
  getrusage(RUSAGE_SELF, &usage);
  return {static_cast<uint64_t>(usage.ru_maxrss) * 1024, 0};
}
#endif
