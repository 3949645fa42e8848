#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <climits>
#include <utility>

#include "foundation/os/Os.h"
#include "foundation/os/OsFault.h"
#include "foundation/os/OsPathPosix.h"

namespace {

// In the order of OsOpenMode.
const int OPEN_FLAGS[] = {O_RDONLY, O_WRONLY | O_TRUNC, O_WRONLY | O_CREAT | O_TRUNC, O_WRONLY | O_CREAT | O_APPEND,
                          O_WRONLY | O_CREAT | O_EXCL};

// The system opens folders for reading, which is no file here.
bool bIsFolder(int fd) {
  struct stat status;
  return fstat(fd, &status) == 0 && S_ISDIR(status.st_mode);
}

timespec ToTimespec(uint64_t time) {
  const int64_t UNIX_EPOCH = 11644473600;
  if (!time) return {0, UTIME_OMIT};
  return {time_t(int64_t(time / 10000000) - UNIX_EPOCH), long(time % 10000000 * 100)};
}

}  // namespace

bool OsFile::bOpen(const char* szPath, OsOpenMode mode) {
  bClose();
  if (bOsFault(OsCall::Open)) return false;
  m_handle = open(PosixPath(szPath), OPEN_FLAGS[int(mode)] | O_CLOEXEC, 0666);
  if (!bIsOpen() || !bIsFolder(int(m_handle))) return bIsOpen();
  bClose();
  errno = EISDIR;
  return false;
}

bool OsFile::bClose() {
  if (!bIsOpen()) return true;
  const bool bFault = bOsFaultOfClose(int(m_handle));
  return close(int(std::exchange(m_handle, -1))) == 0 && !bFault;
}

long OsFile::lRead(void* pBytes, size_t nBytes) {
  if (bOsFault(OsCall::Read)) return -1;
  ssize_t lCount;
  do lCount = read(int(m_handle), pBytes, nBytes > LONG_MAX ? LONG_MAX : nBytes);
  while (lCount < 0 && errno == EINTR);
  return long(lCount);
}

bool OsFile::bWrite(const void* pBytes, size_t nBytes) {
  const char* p = static_cast<const char*>(pBytes);
  const bool bFault = bOsFault(OsCall::Write);
  if (bFault) nBytes /= 2;
  while (nBytes > 0) {
    const ssize_t lCount = write(int(m_handle), p, nBytes);
    if (lCount < 0 && errno == EINTR) continue;
    if (lCount <= 0) return false;
    p += lCount;
    nBytes -= size_t(lCount);
  }
  return bIsOpen() && !bFault;
}

bool OsFile::bSeek(uint64_t offset) {
  return !bOsFault(OsCall::Seek) && lseek(int(m_handle), off_t(offset), SEEK_SET) != -1;
}

int64_t OsFile::Size() const {
  struct stat status;
  return !bOsFault(OsCall::Size) && fstat(int(m_handle), &status) == 0 ? int64_t(status.st_size) : -1;
}

// The time of creation is the system's own here.
bool OsFile::bSetTimes(const OsFileTimes& times) {
  const timespec values[] = {ToTimespec(times.lastAccess), ToTimespec(times.lastWrite)};
  return !bOsFault(OsCall::SetTimes) && futimens(int(m_handle), values) == 0;
}

FILE* OsOpenStream(const char* szPath, const char* szMode) {
  if (!szPath || !szMode || bOsFault(OsCall::Open)) return nullptr;
  FILE* const pFile = std::fopen(PosixPath(szPath), szMode);
  if (!pFile || !bIsFolder(fileno(pFile))) return OsFaultStream(pFile, szMode);
  std::fclose(pFile);
  return nullptr;
}
