#include "foundation/os/OsFault.h"

#ifdef ORBIT_FAULTS
#include <unistd.h>

#include <cerrno>
#include <cstdint>

namespace {

int ToDescriptor(void* pCookie) { return int(reinterpret_cast<intptr_t>(pCookie)); }

ssize_t ReadStream(void* pCookie, char* pBytes, size_t nBytes) {
  return bOsFault(OsCall::Read) ? -1 : read(ToDescriptor(pCookie), pBytes, nBytes);
}

ssize_t WriteStream(void* pCookie, const char* pBytes, size_t nBytes) {
  const bool bFault = bOsFault(OsCall::Write);
  const ssize_t lCount = write(ToDescriptor(pCookie), pBytes, bFault ? nBytes / 2 : nBytes);
  if (bFault) errno = EIO;
  return bFault || lCount < 0 ? 0 : lCount;
}

int SeekStream(void* pCookie, off64_t* pOffset, int iFrom) {
  if (bOsFault(OsCall::Seek)) return -1;
  *pOffset = lseek64(ToDescriptor(pCookie), *pOffset, iFrom);
  return *pOffset < 0 ? -1 : 0;
}

int CloseStream(void* pCookie) {
  const bool bFault = bOsFault(OsCall::Close);
  return close(ToDescriptor(pCookie)) == 0 && !bFault ? 0 : -1;
}

}  // namespace

bool (*OsFaultHook)(OsCall call) = nullptr;

bool bOsFault(OsCall call) {
  if (!OsFaultHook || !OsFaultHook(call)) return false;
  errno = EIO;
  return true;
}

bool bOsFaultOfClose(int fd) {
  if (!bOsFault(OsCall::Close)) return false;
  const off_t size = lseek(fd, 0, SEEK_END);
  return ftruncate(fd, size / 2) == 0 || true;  // refused for a file that is only read
}

FILE* OsFaultStream(FILE* pFile, const char* szMode) {
  if (!pFile || !OsFaultHook) return pFile;
  void* const pCookie = reinterpret_cast<void*>(intptr_t(dup(fileno(pFile))));
  std::fclose(pFile);
  return fopencookie(pCookie, szMode, {ReadStream, WriteStream, SeekStream, CloseStream});
}
#endif
