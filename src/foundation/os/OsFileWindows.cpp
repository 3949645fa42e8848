#include <windows.h>

#include <climits>
#include <utility>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"

namespace {

// How each OsOpenMode opens, in their order. A file that may exist is opened and then emptied: the system's own
// "create always" refuses hidden and system files.
struct OpenRow {
  DWORD dwAccess, dwShare, dwDisposition;
  bool bEmpty;
};
const OpenRow OPEN_ROWS[] = {
    {GENERIC_READ, FILE_SHARE_READ | FILE_SHARE_WRITE, OPEN_EXISTING, false},
    {GENERIC_WRITE, FILE_SHARE_READ, OPEN_EXISTING, true},
    {GENERIC_WRITE, FILE_SHARE_READ, OPEN_ALWAYS, true},
    {FILE_APPEND_DATA | FILE_WRITE_ATTRIBUTES | SYNCHRONIZE, FILE_SHARE_READ | FILE_SHARE_WRITE, OPEN_ALWAYS, false},
    {GENERIC_WRITE, FILE_SHARE_READ, CREATE_NEW, false},
};

HANDLE ToHandle(intptr_t handle) { return reinterpret_cast<HANDLE>(handle); }

FILETIME ToFileTime(uint64_t time) { return {DWORD(time), DWORD(time >> 32)}; }

}  // namespace

bool OsFile::bOpen(const char* szPath, OsOpenMode mode) {
  bClose();
  if (!szPath) return false;
  const OpenRow& row = OPEN_ROWS[int(mode)];
  const WidePath path(szPath);  // lives on, so that nothing comes between the call and its error
  SetLastError(ERROR_SUCCESS);
  m_handle = reinterpret_cast<intptr_t>(
      CreateFileW(path, row.dwAccess, row.dwShare, nullptr, row.dwDisposition, FILE_ATTRIBUTE_NORMAL, nullptr));
  if (!bIsOpen()) return false;
  const bool bNew = row.dwDisposition == OPEN_ALWAYS && GetLastError() != ERROR_ALREADY_EXISTS;
  if (!row.bEmpty || bNew || SetEndOfFile(ToHandle(m_handle))) return true;
  bClose();
  return false;
}

bool OsFile::bClose() {
  if (!bIsOpen()) return true;
  return CloseHandle(ToHandle(std::exchange(m_handle, -1)));
}

long OsFile::lRead(void* pBytes, size_t nBytes) {
  DWORD dwRead = 0;
  const DWORD dwWanted = nBytes > LONG_MAX ? DWORD(LONG_MAX) : DWORD(nBytes);
  return bIsOpen() && ReadFile(ToHandle(m_handle), pBytes, dwWanted, &dwRead, nullptr) ? long(dwRead) : -1;
}

bool OsFile::bWrite(const void* pBytes, size_t nBytes) {
  if (!bIsOpen()) return false;
  const char* p = static_cast<const char*>(pBytes);
  while (nBytes > 0) {
    DWORD dwWritten = 0;
    if (!WriteFile(ToHandle(m_handle), p, DWORD(nBytes), &dwWritten, nullptr) || !dwWritten) return false;
    p += dwWritten;
    nBytes -= dwWritten;
  }
  return true;
}

bool OsFile::bSeek(uint64_t offset) {
  LARGE_INTEGER to;
  to.QuadPart = LONGLONG(offset);
  return bIsOpen() && SetFilePointerEx(ToHandle(m_handle), to, nullptr, FILE_BEGIN);
}

int64_t OsFile::Size() const {
  LARGE_INTEGER size;
  return bIsOpen() && GetFileSizeEx(ToHandle(m_handle), &size) ? size.QuadPart : -1;
}

bool OsFile::bSetTimes(const OsFileTimes& times) {
  const FILETIME creation = ToFileTime(times.creation), lastAccess = ToFileTime(times.lastAccess),
                 lastWrite = ToFileTime(times.lastWrite);
  return bIsOpen() && SetFileTime(ToHandle(m_handle), times.creation ? &creation : nullptr,
                                  times.lastAccess ? &lastAccess : nullptr, times.lastWrite ? &lastWrite : nullptr);
}

FILE* OsOpenStream(const char* szPath, const char* szMode) {
  return szPath && szMode ? _wfopen(WidePath(szPath), Wide(szMode)) : nullptr;
}
