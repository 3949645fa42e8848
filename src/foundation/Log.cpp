#include "foundation/Log.h"

#include <atomic>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <memory>
#include <new>

#include "foundation/ResultCodes.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsFault.h"

namespace {

const char* const LOG_FILE = "execution.log";
const size_t LOG_MESSAGE_SIZE = 500000;

// Made by the first line that needs it and never released, so that the lock outlives every static object.
OsSemaphore* LogLock() {
  static std::atomic<OsSemaphore*> pInstalled{nullptr};
  OsSemaphore* pLock = pInstalled.load();
  if (pLock) return pLock;
  std::unique_ptr<OsSemaphore> pNew(new (std::nothrow) OsSemaphore);
  if (!pNew || !pNew->bCreated()) return nullptr;
  if (!pInstalled.compare_exchange_strong(pLock, pNew.get())) return pLock;
  return pNew.release();
}

struct CloseStream {
  void operator()(FILE* pFile) const { std::fclose(pFile); }
};
struct FreeBlock {
  void operator()(char* pBlock) const { std::free(pBlock); }
};

// An entry begins with its line end, so that the file never ends with one: deliberate.
void WriteHeader(FILE* pFile) {
  const std::time_t now = std::time(nullptr);
  const char* szTime = std::ctime(&now);
  std::fprintf(pFile, "\n[%li, %.24s] ", long(OsThreadId()), szTime ? szTime : "?");
}

// A message that is longer than the buffer is cut; without memory a short buffer serves.
void WriteMessage(FILE* pFile, const char* szFormat, va_list args) {
  char szShort[1024];
  const std::unique_ptr<char, FreeBlock> pLong(static_cast<char*>(std::malloc(LOG_MESSAGE_SIZE)));
  char* const szMessage = pLong ? pLong.get() : szShort;
  iOsFormat(szMessage, pLong ? LOG_MESSAGE_SIZE : sizeof szShort, szFormat, args);
  std::fputs(szMessage, pFile);
}

// Not OsOpenStream, which without memory would log.
FILE* OpenLog() { return bOsFault(OsCall::Open) ? nullptr : OsFaultStream(std::fopen(LOG_FILE, "r+"), "r+"); }

// Nothing in here may log: the lock is not recursive.
void AppendEntry(const char* szFormat, va_list args) {
  iGetSemaphore();  // a failed wait loses the order of entries at most, so the entry is written all the same
  {
    const std::unique_ptr<FILE, CloseStream> pFile(OpenLog());
    if (pFile && std::fseek(pFile.get(), 0, SEEK_END) == 0) {
      WriteHeader(pFile.get());
      WriteMessage(pFile.get(), szFormat, args);
    }
  }
  iReleaseSemaphore();
}

}  // namespace

int iGetSemaphore() {
  OsSemaphore* pLock = LogLock();
  return !pLock || pLock->bWait() ? EVERYTHING_IS_OK : LOG_LOCK_WAIT_FAILED;
}

int iReleaseSemaphore() {
  OsSemaphore* pLock = LogLock();
  return !pLock || pLock->bRelease() ? EVERYTHING_IS_OK : LOG_LOCK_RELEASE_FAILED;
}

void* LogPrintf(const char* szFormat, ...) {
  va_list args;
  va_start(args, szFormat);
  AppendEntry(szFormat, args);
  va_end(args);
  return nullptr;
}

int iLogReturn(int iCode, const char* szFormat, ...) {
  va_list args;
  va_start(args, szFormat);
  AppendEntry(szFormat, args);
  va_end(args);
  return iCode;
}
