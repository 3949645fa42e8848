// The portable floors' only door to the operating system. One header, two implementations: Os*Windows.cpp and
// Os*Posix.cpp.
//
// Paths are code page 1250 texts; both kinds of slash are accepted. On Windows they reach the wide system calls,
// elsewhere they are turned into UTF-8 with '/' as the separator. Functions named `b` return false on failure and do
// not log: the caller knows what failed and writes the line. All functions may be called from any thread.
#pragma once

#include <cstdarg>
#include <cstdint>
#include <cstdio>

#include "foundation/CNString.h"

// ---- Files

enum class OsOpenMode {
  Read,       // must exist; others may read and write
  Truncate,   // write; must exist, is emptied
  Create,     // write; is created, or emptied when it exists
  Append,     // write at the end; is created when missing
  CreateNew,  // write; is created, and must not exist, not even as a link
};

// The system's file times: 100-nanosecond units since 1601-01-01 UTC; 0 leaves that time alone.
struct OsFileTimes {
  uint64_t creation = 0;
  uint64_t lastAccess = 0;
  uint64_t lastWrite = 0;
};

// An open file without buffering. Movable, closed by its destructor. One thread at a time.
class OsFile {
 public:
  OsFile() = default;
  ~OsFile() { bClose(); }
  OsFile(OsFile&& other) noexcept : m_handle(other.m_handle) { other.m_handle = -1; }
  OsFile& operator=(OsFile&& other) noexcept;
  OsFile(const OsFile&) = delete;
  OsFile& operator=(const OsFile&) = delete;

  bool bOpen(const char* szPath, OsOpenMode mode);
  bool bIsOpen() const { return m_handle != -1; }
  // False when the system reports that written data could not be stored.
  bool bClose();
  // Reads up to nBytes; the count, 0 at the end of the file, -1 on failure.
  long lRead(void* pBytes, size_t nBytes);
  // Writes all of nBytes or fails.
  bool bWrite(const void* pBytes, size_t nBytes);
  bool bSeek(uint64_t offset);
  // The size in bytes, or -1.
  int64_t Size() const;
  bool bSetTimes(const OsFileTimes& times);

 private:
  intptr_t m_handle = -1;
};

// fopen with a code page 1250 path; null on failure.
FILE* OsOpenStream(const char* szPath, const char* szMode);

// Windows attribute bits, the same numbers everywhere; elsewhere only OS_READ_ONLY and OS_DIRECTORY have an effect.
enum OsAttribute : uint32_t {
  OS_READ_ONLY = 0x1,
  OS_HIDDEN = 0x2,
  OS_SYSTEM = 0x4,
  OS_DIRECTORY = 0x10,
  OS_ARCHIVE = 0x20,
  OS_NORMAL = 0x80,
  OS_REPARSE_POINT = 0x400,  // a junction or a symbolic link; the link itself is described, not its target
};

struct OsFileInfo {
  uint64_t size = 0;
  OsFileTimes times;
  uint32_t attributes = 0;
};

// Describes a file or folder, links not followed; false when there is none.
bool bOsGetFileInfo(const char* szPath, OsFileInfo& info);
bool bOsSetAttributes(const char* szPath, uint32_t attributes);
bool bOsExists(const char* szPath);
bool bOsIsFolder(const char* szPath);  // a link to a folder counts

enum class OsMakeFolderResult { Made, Exists, NoParent, Failed };
OsMakeFolderResult OsMakeFolder(const char* szPath);
bool bOsDeleteFile(const char* szPath);
bool bOsDeleteFolder(const char* szPath);  // must be empty
// True when both paths lead to one file or folder, links followed.
bool bOsIsSameFile(const char* szPathA, const char* szPathB);
// Renames, replacing an existing target in one step.
bool bOsRename(const char* szFrom, const char* szTo);

// True for "." and "..", the names that a folder has for itself and the one above.
bool bOsIsDots(const char* szName);

// One entry of a folder listing.
struct OsFolderEntry {
  CNString csName;
  OsFileInfo info;
};
enum class OsListResult {
  Listed,
  NotStarted,  // there is no such folder, or it cannot be read
  Failed,      // the system stopped before the end; OsLastError() says why
};
// Calls pVisit for every entry, "." and ".." among them where the system has them, in the system's order, until it
// returns false. An entry whose name code page 1250 cannot hold is given by its short name, else with '?' in it.
OsListResult OsListEntries(const char* szPath, bool (*pVisit)(const OsFolderEntry& entry, void* pContext),
                           void* pContext);
// The same without "." and ".."; false when the folder cannot be read to its end.
bool bOsListFolder(const char* szPath, bool (*pVisit)(const OsFolderEntry& entry, void* pContext), void* pContext);

// The folder for temporary files, with its trailing separator.
bool bOsGetTempFolder(CNString& csFolder);
// Creates a new empty file in szFolder whose name begins with szPrefix (at most three characters).
bool bOsMakeTempFile(const char* szFolder, const char* szPrefix, CNString& csPath);
// Bytes that this user may still write on the drive that holds szPath.
bool bOsGetFreeSpace(const char* szPath, uint64_t& bytes);
// The running program's full path, its current folder (no trailing separator).
bool bOsGetProgramPath(CNString& csPath);
bool bOsGetCurrentFolder(CNString& csPath);

// ---- Threads and time

// A semaphore with an initial and maximum count of 1.
class OsSemaphore {
 public:
  OsSemaphore();
  ~OsSemaphore() { bClose(); }
  OsSemaphore(const OsSemaphore&) = delete;
  OsSemaphore& operator=(const OsSemaphore&) = delete;

  bool bCreated() const { return m_handle != nullptr; }
  uintptr_t Handle() const { return reinterpret_cast<uintptr_t>(m_handle); }
  // Waits without limit.
  bool bWait();
  // False when the count is 1 already.
  bool bRelease();
  // Gives the semaphore up; nobody may be waiting for it. False when the system refuses.
  bool bClose();

 private:
  void* m_handle = nullptr;
};

// Runs pRun(pContext) on a new thread that nobody waits for. False when it could not be started.
bool bOsStartThread(void (*pRun)(void* pContext), void* pContext);
unsigned long OsThreadId();
void OsSleep(unsigned uMilliseconds);
// Milliseconds since an arbitrary start; wraps after 49 days.
uint32_t OsTickCount();

// ---- Process

// vsnprintf with one meaning everywhere: the length written, or -1 when it did not fit (the text is then cut).
int iOsFormat(char* szBuffer, size_t nSize, const char* szFormat, va_list args);
// Case-insensitive comparison of ASCII letters; <0, 0 or >0.
int iOsCompareNoCase(const char* szA, const char* szB);
// The marketing name of the running system ("Windows 10"), for the script variable win_ver; "unknown" elsewhere.
void OsGetSystemName(CNString& csName);
// Number of the last failed system call of this thread, and its text, for diagnostic lines.
unsigned OsLastError();
void OsErrorText(unsigned uError, CNString& csText);
// Ends the process at once.
[[noreturn]] void OsExitProcess(int iExitCode);
