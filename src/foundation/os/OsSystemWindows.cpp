#include <windows.h>

#include <atomic>
#include <climits>
#include <cstdio>
#include <memory>
#include <new>
#include <utility>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"

namespace {

// A lock that is free is taken and given back without the system, as nearly all are.
struct BinarySemaphore {
  HANDLE hWaiting = CreateSemaphoreW(nullptr, 0, LONG_MAX, nullptr);
  std::atomic<long> lFree{1};  // 1: free; 0: taken; below: so many threads wait, too

  ~BinarySemaphore() {
    if (hWaiting) CloseHandle(hWaiting);
  }
};

BinarySemaphore& ToSemaphore(void* pHandle) { return *static_cast<BinarySemaphore*>(pHandle); }

struct ThreadStart {
  void (*pRun)(void* pContext);
  void* pContext;
};

DWORD WINAPI RunThread(void* pStart) {
  const std::unique_ptr<ThreadStart> start(static_cast<ThreadStart*>(pStart));
  start->pRun(start->pContext);
  return 0;
}

// The systems by their numbers, the latest first. A row holds for its build and later ones.
struct SystemRow {
  DWORD dwPlatform, dwMajor, dwMinor;
  bool bServer;
  DWORD dwBuild;
  const char* szName;
};
const DWORD NT = VER_PLATFORM_WIN32_NT, NINE = VER_PLATFORM_WIN32_WINDOWS;
const SystemRow SYSTEMS[] = {
    {NT, 10, 0, false, 22000, "Windows 11"},
    {NT, 10, 0, false, 0, "Windows 10"},
    {NT, 10, 0, true, 26100, "Windows Server 2025"},
    {NT, 10, 0, true, 20348, "Windows Server 2022"},
    {NT, 10, 0, true, 17763, "Windows Server 2019"},
    {NT, 10, 0, true, 0, "Windows Server 2016"},
    {NT, 6, 3, false, 0, "Windows 8.1"},
    {NT, 6, 3, true, 0, "Windows Server 2012 R2"},
    {NT, 6, 2, false, 0, "Windows 8"},
    {NT, 6, 2, true, 0, "Windows Server 2012"},
    {NT, 6, 1, false, 0, "Windows 7"},
    {NT, 6, 1, true, 0, "Windows Server 2008 R2"},
    {NT, 6, 0, false, 0, "Windows Vista"},
    {NT, 6, 0, true, 0, "Windows Server 2008"},
    {NT, 5, 2, false, 0, "Windows XP"},
    {NT, 5, 2, true, 0, "Windows Server 2003"},
    {NT, 5, 1, false, 0, "Windows XP"},
    {NT, 5, 0, false, 0, "Windows 2000"},
    {NT, 5, 0, true, 0, "Windows 2000"},
    {NT, 4, 0, false, 0, "Windows NT 4.0"},
    {NT, 4, 0, true, 0, "Windows NT 4.0"},
    {NINE, 4, 90, false, 0, "Windows Me"},
    {NINE, 4, 10, false, 0, "Windows 98"},
    {NINE, 4, 0, false, 0, "Windows 95"},
};

// The true version: the documented call answers what the program's manifest names.
bool bGetVersion(OSVERSIONINFOEXW& version) {
  using GetVersionFunction = LONG(WINAPI*)(OSVERSIONINFOEXW*);
  const HMODULE hSystem = GetModuleHandleW(L"ntdll.dll");
  const auto pGetVersion = reinterpret_cast<GetVersionFunction>(
      reinterpret_cast<void*>(hSystem ? GetProcAddress(hSystem, "RtlGetVersion") : nullptr));
  version = {};
  version.dwOSVersionInfoSize = sizeof version;
  return pGetVersion && pGetVersion(&version) == 0;
}

struct FreeLocal {
  void operator()(wchar_t* pText) const { LocalFree(pText); }
};

}  // namespace

// ---- Threads and time

OsSemaphore::OsSemaphore() {
  std::unique_ptr<BinarySemaphore> pSemaphore(new (std::nothrow) BinarySemaphore);
  if (pSemaphore && pSemaphore->hWaiting) m_handle = pSemaphore.release();
}

bool OsSemaphore::bWait() {
  if (!m_handle) return SetLastError(ERROR_INVALID_HANDLE), false;
  BinarySemaphore& semaphore = ToSemaphore(m_handle);
  if (semaphore.lFree-- > 0 || WaitForSingleObject(semaphore.hWaiting, INFINITE) == WAIT_OBJECT_0) return true;
  semaphore.lFree++;
  return false;
}

bool OsSemaphore::bRelease() {
  if (!m_handle) return SetLastError(ERROR_INVALID_HANDLE), false;
  BinarySemaphore& semaphore = ToSemaphore(m_handle);
  long lFree = semaphore.lFree;
  do {
    if (lFree > 0) return SetLastError(ERROR_TOO_MANY_POSTS), false;
  } while (!semaphore.lFree.compare_exchange_weak(lFree, lFree + 1));
  return lFree == 0 || ReleaseSemaphore(semaphore.hWaiting, 1, nullptr);
}

bool OsSemaphore::bClose() {
  delete static_cast<BinarySemaphore*>(std::exchange(m_handle, nullptr));
  return true;
}

bool bOsStartThread(void (*pRun)(void* pContext), void* pContext) {
  std::unique_ptr<ThreadStart> start(new (std::nothrow) ThreadStart{pRun, pContext});
  const HANDLE hThread = start ? CreateThread(nullptr, 0, RunThread, start.get(), 0, nullptr) : nullptr;
  if (!hThread) return false;
  start.release();  // the thread's own now
  CloseHandle(hThread);
  return true;
}

unsigned long OsThreadId() { return GetCurrentThreadId(); }

void OsSleep(unsigned uMilliseconds) { Sleep(uMilliseconds); }

uint32_t OsTickCount() { return GetTickCount(); }

// ---- Process

int iOsFormat(char* szBuffer, size_t nSize, const char* szFormat, va_list args) {
  if (!nSize) return -1;
  const int iWritten = _vsnprintf(szBuffer, nSize, szFormat, args);
  szBuffer[nSize - 1] = 0;
  return iWritten < 0 || size_t(iWritten) >= nSize ? -1 : iWritten;
}

void OsGetSystemName(CNString& csName) {
  csName = "unknown";
  OSVERSIONINFOEXW version;
  if (!bGetVersion(version)) return;
  const bool bServer = version.wProductType > VER_NT_WORKSTATION;
  for (const SystemRow& row : SYSTEMS) {
    if (row.dwPlatform != version.dwPlatformId || row.dwMajor != version.dwMajorVersion ||
        row.dwMinor != version.dwMinorVersion || row.bServer != bServer || row.dwBuild > version.dwBuildNumber)
      continue;
    csName = row.szName;
    return;
  }
}

unsigned OsLastError() { return GetLastError(); }

void OsErrorText(unsigned uError, CNString& csText) {
  wchar_t* pBuffer = nullptr;
  FormatMessageW(FORMAT_MESSAGE_ALLOCATE_BUFFER | FORMAT_MESSAGE_FROM_SYSTEM | FORMAT_MESSAGE_IGNORE_INSERTS, nullptr,
                 uError, 0, reinterpret_cast<wchar_t*>(&pBuffer), 0, nullptr);
  const std::unique_ptr<wchar_t, FreeLocal> pText(pBuffer);
  if (!pText) {
    csText.Printf("OsErrorText", "csText", "unknown error (%u)", uError);
    return;
  }
  bNarrow(pText.get(), csText);
  csText.TrimRight();
}

void OsExitProcess(int iExitCode) { ExitProcess(UINT(iExitCode)); }
