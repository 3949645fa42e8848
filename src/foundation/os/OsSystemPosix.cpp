#include <pthread.h>
#include <sys/syscall.h>
#include <time.h>
#include <unistd.h>

#include <cerrno>
#include <condition_variable>
#include <cstdio>
#include <cstring>
#include <memory>
#include <mutex>
#include <new>

#include "foundation/os/Os.h"

namespace {

// The system's own semaphores have no maximum count.
struct BinarySemaphore {
  std::mutex mutex;
  std::condition_variable released;
  bool bFree = true;
};

BinarySemaphore* ToSemaphore(void* pHandle) { return static_cast<BinarySemaphore*>(pHandle); }

struct ThreadStart {
  void (*pRun)(void* pContext);
  void* pContext;
};

void* RunThread(void* pStart) {
  const std::unique_ptr<ThreadStart> start(static_cast<ThreadStart*>(pStart));
  start->pRun(start->pContext);
  return nullptr;
}

}  // namespace

// ---- Threads and time

OsSemaphore::OsSemaphore() : m_handle(new (std::nothrow) BinarySemaphore) {}

bool OsSemaphore::bWait() {
  if (!m_handle) return false;
  BinarySemaphore& semaphore = *ToSemaphore(m_handle);
  std::unique_lock<std::mutex> lock(semaphore.mutex);
  semaphore.released.wait(lock, [&] { return semaphore.bFree; });
  semaphore.bFree = false;
  return true;
}

bool OsSemaphore::bRelease() {
  if (!m_handle) return false;
  BinarySemaphore& semaphore = *ToSemaphore(m_handle);
  const std::lock_guard<std::mutex> lock(semaphore.mutex);
  if (semaphore.bFree) {
    errno = EOVERFLOW;
    return false;
  }
  semaphore.bFree = true;
  semaphore.released.notify_one();
  return true;
}

bool OsSemaphore::bClose() {
  delete ToSemaphore(m_handle);
  m_handle = nullptr;
  return true;
}

bool bOsStartThread(void (*pRun)(void* pContext), void* pContext) {
  std::unique_ptr<ThreadStart> start(new (std::nothrow) ThreadStart{pRun, pContext});
  pthread_t thread;
  if (!start || pthread_create(&thread, nullptr, RunThread, start.get()) != 0) return false;
  start.release();  // the thread's own now
  pthread_detach(thread);
  return true;
}

unsigned long OsThreadId() { return static_cast<unsigned long>(syscall(SYS_gettid)); }

void OsSleep(unsigned uMilliseconds) {
  timespec left = {time_t(uMilliseconds / 1000), long(uMilliseconds % 1000) * 1000000};
  while (nanosleep(&left, &left) != 0 && errno == EINTR) continue;
}

uint32_t OsTickCount() {
  timespec now;
  clock_gettime(CLOCK_MONOTONIC, &now);
  return uint32_t(uint64_t(now.tv_sec) * 1000 + uint64_t(now.tv_nsec) / 1000000);
}

// ---- Process

int iOsFormat(char* szBuffer, size_t nSize, const char* szFormat, va_list args) {
  const int iLength = std::vsnprintf(szBuffer, nSize, szFormat, args);
  return iLength < 0 || size_t(iLength) >= nSize ? -1 : iLength;
}

void OsGetSystemName(CNString& csName) { csName = "unknown"; }

unsigned OsLastError() { return unsigned(errno); }

void OsErrorText(unsigned uError, CNString& csText) { csText = std::strerror(int(uError)); }

void OsExitProcess(int iExitCode) { _exit(iExitCode); }
