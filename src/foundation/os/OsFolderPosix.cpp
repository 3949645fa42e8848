#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <unistd.h>

#include <cerrno>
#include <climits>
#include <cstdlib>
#include <memory>

#include "foundation/os/Os.h"
#include "foundation/os/OsFault.h"
#include "foundation/os/OsPath.h"
#include "foundation/os/OsPathPosix.h"

namespace {

uint64_t FromTimestamp(const statx_timestamp& time) {
  const int64_t UNIX_EPOCH = 11644473600;
  return uint64_t(time.tv_sec + UNIX_EPOCH) * 10000000 + time.tv_nsec / 100;
}

bool bStatus(int fdFolder, const char* szPath, int iFlags, struct statx& status) {
  return statx(fdFolder, szPath, iFlags | AT_NO_AUTOMOUNT, STATX_BASIC_STATS | STATX_BTIME, &status) == 0;
}

bool bDescribe(int fdFolder, const char* szPath, OsFileInfo& info) {
  struct statx status, target;
  if (!bStatus(fdFolder, szPath, AT_SYMLINK_NOFOLLOW, status)) return false;
  const bool bLink = S_ISLNK(status.stx_mode);
  const bool bFolder =
      S_ISDIR(status.stx_mode) || (bLink && bStatus(fdFolder, szPath, 0, target) && S_ISDIR(target.stx_mode));
  const bool bReadOnly = !bFolder && !bLink && !(status.stx_mode & S_IWUSR);
  info.size = bFolder || bLink ? 0 : status.stx_size;
  info.times = {FromTimestamp(status.stx_mask & STATX_BTIME ? status.stx_btime : status.stx_mtime),
                FromTimestamp(status.stx_atime), FromTimestamp(status.stx_mtime)};
  info.attributes = (bFolder ? OS_DIRECTORY : 0u) | (bLink ? OS_REPARSE_POINT : 0u) | (bReadOnly ? OS_READ_ONLY : 0u);
  if (!info.attributes) info.attributes = OS_NORMAL;
  return true;
}

struct CloseFolder {
  void operator()(DIR* pFolder) const { closedir(pFolder); }
};
struct FreeText {
  void operator()(char* szText) const { std::free(szText); }
};

bool bAskFreeSpace(const char* szPath, void* pBytes) {
  struct statvfs status;
  if (statvfs(PosixPath(szPath), &status) != 0) return false;
  *static_cast<uint64_t*>(pBytes) = uint64_t(status.f_bavail) * status.f_frsize;
  return true;
}

}  // namespace

bool bOsGetFileInfo(const char* szPath, OsFileInfo& info) {
  return !bOsFault(OsCall::GetInfo) && bDescribe(AT_FDCWD, PosixPath(szPath), info);
}

bool bOsSetAttributes(const char* szPath, uint32_t attributes) {
  struct stat status;
  if (bOsFault(OsCall::SetAttributes) || lstat(PosixPath(szPath), &status) != 0) return false;
  if (!S_ISREG(status.st_mode)) return true;
  const mode_t all = S_IWUSR | S_IWGRP | S_IWOTH;
  const mode_t mode = attributes & OS_READ_ONLY ? status.st_mode & ~all : status.st_mode | S_IWUSR;
  return mode == status.st_mode || chmod(PosixPath(szPath), mode & 07777) == 0;
}

bool bOsExists(const char* szPath) {
  struct stat status;
  return !bOsFault(OsCall::Exists) && lstat(PosixPath(szPath), &status) == 0;
}

bool bOsIsFolder(const char* szPath) {
  struct stat status;
  return !bOsFault(OsCall::IsFolder) && stat(PosixPath(szPath), &status) == 0 && S_ISDIR(status.st_mode);
}

OsMakeFolderResult OsMakeFolder(const char* szPath) {
  if (bOsFault(OsCall::MakeFolder)) return OsMakeFolderResult::Failed;
  if (mkdir(PosixPath(szPath), 0777) == 0) return OsMakeFolderResult::Made;
  const int iError = errno;
  if (bOsIsFolder(szPath)) return OsMakeFolderResult::Exists;
  errno = iError;
  return iError == ENOENT ? OsMakeFolderResult::NoParent : OsMakeFolderResult::Failed;
}

bool bOsDeleteFile(const char* szPath) { return !bOsFault(OsCall::DeleteFile) && unlink(PosixPath(szPath)) == 0; }

bool bOsDeleteFolder(const char* szPath) { return !bOsFault(OsCall::DeleteFolder) && rmdir(PosixPath(szPath)) == 0; }

bool bOsIsSameFile(const char* szPathA, const char* szPathB) {
  struct stat a, b;
  return stat(PosixPath(szPathA), &a) == 0 && stat(PosixPath(szPathB), &b) == 0 && a.st_dev == b.st_dev &&
         a.st_ino == b.st_ino;
}

bool bOsRename(const char* szFrom, const char* szTo) {
  return !bOsFault(OsCall::Rename) && std::rename(PosixPath(szFrom), PosixPath(szTo)) == 0;
}

OsListResult OsListEntries(const char* szPath, bool (*pVisit)(const OsFolderEntry& entry, void* pContext),
                           void* pContext) {
  std::unique_ptr<DIR, CloseFolder> pFolder(bOsFault(OsCall::List) ? nullptr : opendir(PosixPath(szPath)));
  if (!pFolder) return OsListResult::NotStarted;
  errno = 0;
  while (const dirent* pEntry = bOsFault(OsCall::ListNext) ? nullptr : readdir(pFolder.get())) {
    OsFolderEntry entry;
    bUtf8ToCp1250(pEntry->d_name, entry.csName);
    if (bDescribe(dirfd(pFolder.get()), pEntry->d_name, entry.info) && !pVisit(entry, pContext))
      return OsListResult::Listed;
    errno = 0;
  }
  const int iError = errno;
  pFolder.reset();
  errno = iError;
  return iError ? OsListResult::Failed : OsListResult::Listed;
}

bool bOsGetTempFolder(CNString& csFolder) {
  const char* szFolder = std::getenv("TMPDIR");
  if (!bUtf8ToCp1250(szFolder && *szFolder ? szFolder : "/tmp", csFolder)) return false;
  if (!csFolder.EndsWith("/")) csFolder.Concat("/");
  return true;
}

bool bOsMakeTempFile(const char* szFolder, const char* szPrefix, CNString& csPath) {
  CNString csTemplate;
  if (!csTemplate.Printf("bOsMakeTempFile", "csTemplate", "%s/%.3sXXXXXX.tmp",
                         static_cast<const char*>(PosixPath(szFolder)), szPrefix))
    return false;
  const int fd = mkstemps(csTemplate.Ptr(), 4);
  return fd != -1 && close(fd) == 0 && bUtf8ToCp1250(csTemplate.Ptr(), csPath);
}

bool bOsGetFreeSpace(const char* szPath, uint64_t& bytes) { return bAskUpwards(szPath, bAskFreeSpace, &bytes); }

bool bOsGetProgramPath(CNString& csPath) {
  char szPath[PATH_MAX];
  const ssize_t lLength = readlink("/proc/self/exe", szPath, sizeof szPath - 1);
  if (lLength < 0) return false;
  szPath[lLength] = 0;
  return bUtf8ToCp1250(szPath, csPath);
}

bool bOsGetCurrentFolder(CNString& csPath) {
  const std::unique_ptr<char, FreeText> szPath(getcwd(nullptr, 0));
  if (!szPath || !bUtf8ToCp1250(szPath.get(), csPath)) return false;
  if (csPath.EndsWith("/")) csPath.SetLength(csPath.Length() - 1);
  return true;
}
