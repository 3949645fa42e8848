#include <windows.h>

#include <memory>
#include <new>

#include "foundation/os/Os.h"
#include "foundation/os/OsPath.h"
#include "foundation/os/OsWide.h"

namespace {

// The attributes that a program may set.
const DWORD SETTABLE = FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_HIDDEN | FILE_ATTRIBUTE_SYSTEM |
                       FILE_ATTRIBUTE_ARCHIVE | FILE_ATTRIBUTE_NORMAL | FILE_ATTRIBUTE_TEMPORARY |
                       FILE_ATTRIBUTE_OFFLINE | FILE_ATTRIBUTE_NOT_CONTENT_INDEXED;

uint64_t Join(DWORD dwHigh, DWORD dwLow) { return uint64_t(dwHigh) << 32 | dwLow; }

uint64_t Join(const FILETIME& time) { return Join(time.dwHighDateTime, time.dwLowDateTime); }

// The two structures that describe a file name their members alike.
template <class Data>
void Describe(const Data& data, OsFileInfo& info) {
  info.size = Join(data.nFileSizeHigh, data.nFileSizeLow);
  info.times = {Join(data.ftCreationTime), Join(data.ftLastAccessTime), Join(data.ftLastWriteTime)};
  info.attributes = data.dwFileAttributes;
}

DWORD Attributes(const char* szPath) { return szPath ? GetFileAttributesW(WidePath(szPath)) : INVALID_FILE_ATTRIBUTES; }

struct CloseFind {
  using pointer = HANDLE;
  void operator()(HANDLE hFind) const { FindClose(hFind); }
};
struct CloseObject {
  using pointer = HANDLE;
  void operator()(HANDLE hObject) const { CloseHandle(hObject); }
};

// The numbers by which a file system knows a file or folder. Asking for no access, any user may.
bool bIdentify(const char* szPath, BY_HANDLE_FILE_INFORMATION& identity) {
  const HANDLE hFile = CreateFileW(WidePath(szPath), 0, FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr,
                                   OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS, nullptr);
  if (hFile == INVALID_HANDLE_VALUE) return false;
  const std::unique_ptr<HANDLE, CloseObject> pFile(hFile);
  return GetFileInformationByHandle(hFile, &identity);
}

void NarrowName(const WIN32_FIND_DATAW& data, CNString& csName) {
  if (bNarrow(data.cFileName, csName) || !data.cAlternateFileName[0]) return;
  CNString csShort;
  if (bNarrow(data.cAlternateFileName, csShort)) csName = csShort;
}

// A path asked for by a call that gets a buffer and returns the length, or the size that it needs.
template <class Ask>
bool bGrowingPath(CNString& csPath, Ask ask) {
  for (DWORD dwSize = MAX_PATH + 1; dwSize <= 32768; dwSize *= 2) {
    const std::unique_ptr<wchar_t[]> pBuffer(new (std::nothrow) wchar_t[dwSize]);
    const DWORD dwLength = pBuffer ? ask(pBuffer.get(), dwSize) : 0;
    if (!dwLength) return false;
    if (dwLength < dwSize) return bNarrowPath(pBuffer.get(), csPath);
  }
  return false;
}

bool bAskFreeSpace(const char* szPath, void* pBytes) {
  ULARGE_INTEGER free;
  if (!GetDiskFreeSpaceExW(WidePath(szPath), &free, nullptr, nullptr)) return false;
  *static_cast<uint64_t*>(pBytes) = free.QuadPart;
  return true;
}

}  // namespace

bool bOsGetFileInfo(const char* szPath, OsFileInfo& info) {
  WIN32_FILE_ATTRIBUTE_DATA data;
  if (!szPath || !GetFileAttributesExW(WidePath(szPath), GetFileExInfoStandard, &data)) return false;
  Describe(data, info);
  return true;
}

bool bOsSetAttributes(const char* szPath, uint32_t attributes) {
  const DWORD dwAttributes = attributes & SETTABLE;
  return szPath && SetFileAttributesW(WidePath(szPath), dwAttributes ? dwAttributes : FILE_ATTRIBUTE_NORMAL);
}

bool bOsExists(const char* szPath) { return Attributes(szPath) != INVALID_FILE_ATTRIBUTES; }

bool bOsIsFolder(const char* szPath) {
  const DWORD dwAttributes = Attributes(szPath);
  return dwAttributes != INVALID_FILE_ATTRIBUTES && (dwAttributes & FILE_ATTRIBUTE_DIRECTORY);
}

OsMakeFolderResult OsMakeFolder(const char* szPath) {
  if (!szPath) return OsMakeFolderResult::Failed;
  if (CreateDirectoryW(WidePath(szPath), nullptr)) return OsMakeFolderResult::Made;
  const DWORD dwError = GetLastError();
  if (bOsIsFolder(szPath)) return OsMakeFolderResult::Exists;
  SetLastError(dwError);
  return dwError == ERROR_PATH_NOT_FOUND ? OsMakeFolderResult::NoParent : OsMakeFolderResult::Failed;
}

bool bOsDeleteFile(const char* szPath) { return szPath && DeleteFileW(WidePath(szPath)); }

bool bOsDeleteFolder(const char* szPath) { return szPath && RemoveDirectoryW(WidePath(szPath)); }

bool bOsIsSameFile(const char* szPathA, const char* szPathB) {
  BY_HANDLE_FILE_INFORMATION a, b;
  return szPathA && szPathB && bIdentify(szPathA, a) && bIdentify(szPathB, b) &&
         a.dwVolumeSerialNumber == b.dwVolumeSerialNumber && a.nFileIndexHigh == b.nFileIndexHigh &&
         a.nFileIndexLow == b.nFileIndexLow;
}

bool bOsRename(const char* szFrom, const char* szTo) {
  return szFrom && szTo && MoveFileExW(WidePath(szFrom), WidePath(szTo), MOVEFILE_REPLACE_EXISTING);
}

OsListResult OsListEntries(const char* szPath, bool (*pVisit)(const OsFolderEntry& entry, void* pContext),
                           void* pContext) {
  if (!szPath || !*szPath) return OsListResult::NotStarted;
  CNString csPattern(szPath, 0);
  csPattern.AddSlash();
  csPattern.Concat("*");
  WIN32_FIND_DATAW data;
  const WidePath path(csPattern.Text());  // lives on, so that nothing comes between the call and its error
  const HANDLE hFind = FindFirstFileW(path, &data);
  if (hFind == INVALID_HANDLE_VALUE) {
    // An empty drive has no entry at all, not even the dots.
    const bool bEmpty = GetLastError() == ERROR_FILE_NOT_FOUND && bOsIsFolder(szPath);
    return bEmpty ? OsListResult::Listed : OsListResult::NotStarted;
  }
  std::unique_ptr<HANDLE, CloseFind> pFind(hFind);
  do {
    OsFolderEntry entry;
    NarrowName(data, entry.csName);
    Describe(data, entry.info);
    if (!pVisit(entry, pContext)) return OsListResult::Listed;
  } while (FindNextFileW(hFind, &data));
  const DWORD dwError = GetLastError();
  pFind.reset();
  SetLastError(dwError);
  return dwError == ERROR_NO_MORE_FILES ? OsListResult::Listed : OsListResult::Failed;
}

bool bOsGetTempFolder(CNString& csFolder) {
  return bGrowingPath(csFolder, [](wchar_t* pBuffer, DWORD dwSize) { return GetTempPathW(dwSize, pBuffer); });
}

bool bOsMakeTempFile(const char* szFolder, const char* szPrefix, CNString& csPath) {
  wchar_t buffer[MAX_PATH];
  return szFolder && szPrefix && GetTempFileNameW(Wide(szFolder), Wide(szPrefix), 0, buffer) &&
         bNarrowPath(buffer, csPath);
}

bool bOsGetFreeSpace(const char* szPath, uint64_t& bytes) { return bAskUpwards(szPath, bAskFreeSpace, &bytes); }

bool bOsGetProgramPath(CNString& csPath) {
  return bGrowingPath(csPath,
                      [](wchar_t* pBuffer, DWORD dwSize) { return GetModuleFileNameW(nullptr, pBuffer, dwSize); });
}

bool bOsGetCurrentFolder(CNString& csPath) {
  if (!bGrowingPath(csPath, [](wchar_t* pBuffer, DWORD dwSize) { return GetCurrentDirectoryW(dwSize, pBuffer); }))
    return false;
  if (csPath.EndsWith("\\")) csPath.SetLength(csPath.Length() - 1);
  return true;
}
