#include "bootstrap/PrivateFolder.h"

#include <aclapi.h>
#include <sddl.h>

#include <cstring>
#include <cwchar>

#include "bootstrap/Handles.h"

namespace {

const wchar_t PREFIX[] = L"orbit-";
const int RANDOM_BYTES = 16;
const size_t NAME_LENGTH = 6 + 2 * RANDOM_BYTES;
const size_t LONGEST_PARENT = MAX_PATH - 2 * NAME_LENGTH;
const int REMOVE_TRIES = 50;
const DWORD REMOVE_PAUSE = 100;                     // milliseconds
const ULONGLONG ONE_MINUTE = 60ull * 10 * 1000000;  // in file time
const DWORD FOLDER_FLAGS = FILE_FLAG_BACKUP_SEMANTICS | FILE_FLAG_OPEN_REPARSE_POINT;
const SECURITY_INFORMATION OWNER_AND_ACCESS = OWNER_SECURITY_INFORMATION | DACL_SECURITY_INFORMATION;

// ---- who may

bool bIsElevated() {
  SID_IDENTIFIER_AUTHORITY authority = SECURITY_NT_AUTHORITY;
  PSID pAdministrators = nullptr;
  BOOL bMember = FALSE;
  if (!AllocateAndInitializeSid(&authority, 2, SECURITY_BUILTIN_DOMAIN_RID, DOMAIN_ALIAS_RID_ADMINS, 0, 0, 0, 0, 0, 0,
                                &pAdministrators))
    return false;
  if (!CheckTokenMembership(nullptr, pAdministrators, &bMember)) bMember = FALSE;
  FreeSid(pAdministrators);
  return bMember != FALSE;
}

// Full access for this user alone, inherited by what is made inside.
bool bUserOnly(wchar_t* szDescriptor, size_t nSize) {
  HANDLE hToken = nullptr;
  alignas(TOKEN_USER) BYTE user[256];
  DWORD dwSize = 0;
  if (!OpenProcessToken(GetCurrentProcess(), TOKEN_QUERY, &hToken)) return false;
  const Handle token(hToken);
  if (!GetTokenInformation(token.get(), TokenUser, user, sizeof(user), &dwSize)) return false;
  wchar_t* pSid = nullptr;
  if (!ConvertSidToStringSidW(reinterpret_cast<TOKEN_USER*>(user)->User.Sid, &pSid)) return false;
  const LocalMemory sid(pSid);
  return _snwprintf(szDescriptor, nSize, L"D:P(A;OICI;FA;;;%ls)", pSid) > 0;
}

// The folder above, without a trailing backslash, and who may use the new one, in the system's description language.
bool bChoosePlace(wchar_t* szParent, wchar_t* szDescriptor, size_t nDescriptor) {
  if (bIsElevated()) {
    const UINT uLength = GetSystemWindowsDirectoryW(szParent, MAX_PATH);
    if (!uLength || uLength + 5 > LONGEST_PARENT) return false;
    wcscpy(szParent + uLength, szParent[uLength - 1] == L'\\' ? L"Temp" : L"\\Temp");
    wcscpy(szDescriptor, L"O:BAD:P(A;OICI;FA;;;BA)(A;OICI;FA;;;SY)");
    return true;
  }
  const DWORD dwLength = GetTempPathW(MAX_PATH, szParent);
  if (dwLength < 4 || dwLength > LONGEST_PARENT) return false;
  if (szParent[dwLength - 1] == L'\\') szParent[dwLength - 1] = L'\0';
  return bUserOnly(szDescriptor, nDescriptor);
}

// ---- making

// RtlGenRandom, which the system exports under this name only.
bool bRandom(void* pBytes, ULONG ulSize) {
  const auto pGenerate = reinterpret_cast<BOOLEAN(WINAPI*)(void*, ULONG)>(
      reinterpret_cast<void*>(GetProcAddress(GetModuleHandleW(L"advapi32.dll"), "SystemFunction036")));
  return pGenerate && pGenerate(pBytes, ulSize);
}

bool bAppendRandomName(wchar_t* szPath) {
  unsigned char random[RANDOM_BYTES];
  if (!bRandom(random, sizeof(random))) return false;
  wcscat(szPath, L"\\");
  wcscat(szPath, PREFIX);
  wchar_t* p = szPath + wcslen(szPath);
  for (const unsigned char byte : random) {
    *p++ = L"0123456789abcdef"[byte >> 4];
    *p++ = L"0123456789abcdef"[byte & 15];
  }
  *p = L'\0';
  return true;
}

// CreateDirectory fails when anything of that name exists.
bool bMakeClosed(const wchar_t* szPath, const wchar_t* szDescriptor) {
  PSECURITY_DESCRIPTOR pDescriptor = nullptr;
  if (!ConvertStringSecurityDescriptorToSecurityDescriptorW(szDescriptor, SDDL_REVISION_1, &pDescriptor, nullptr))
    return false;
  const LocalMemory descriptor(pDescriptor);
  SECURITY_ATTRIBUTES attributes = {sizeof(attributes), pDescriptor, FALSE};
  return CreateDirectoryW(szPath, &attributes) != FALSE;
}

bool bIsPlainFolder(HANDLE hFolder, BY_HANDLE_FILE_INFORMATION& info) {
  const DWORD dwKind = FILE_ATTRIBUTE_DIRECTORY | FILE_ATTRIBUTE_REPARSE_POINT;
  return GetFileInformationByHandle(hFolder, &info) && (info.dwFileAttributes & dwKind) == FILE_ATTRIBUTE_DIRECTORY;
}

// ---- removing

bool bIsDots(const wchar_t* szName) { return wcscmp(szName, L".") == 0 || wcscmp(szName, L"..") == 0; }

// The path that is worked on: as long as the system allows, which folders inside may make it.
class LongPath {
 public:
  explicit LongPath(const wchar_t* szPath) {
    wcscpy(s_szPath, wcsncmp(szPath, L"\\\\", 2) == 0 ? L"" : L"\\\\?\\");  // a share's has another form
    wcscat(s_szPath, szPath);
    m_nLength = wcslen(s_szPath);
  }
  // For the time of an entry in the folder.
  LongPath(const LongPath& folder, const wchar_t* szName) : m_nLength(folder.m_nLength + 1 + wcslen(szName)) {
    if (!bFits()) return;
    s_szPath[folder.m_nLength] = L'\\';
    wcscpy(s_szPath + folder.m_nLength + 1, szName);
  }
  bool bFits() const { return m_nLength < MOST - MAX_PATH; }
  const wchar_t* Text() const {
    s_szPath[m_nLength] = L'\0';
    return s_szPath;
  }

 private:
  static const size_t MOST = 32768;
  static wchar_t s_szPath[MOST];
  size_t m_nLength;
};
wchar_t LongPath::s_szPath[LongPath::MOST];

bool bRemoveFolder(const LongPath& folder);

bool bRemoveEntry(const LongPath& folder, const WIN32_FIND_DATAW& found) {
  const LongPath entry(folder, found.cFileName);
  if (!entry.bFits()) return false;
  const bool bLink = found.dwFileAttributes & FILE_ATTRIBUTE_REPARSE_POINT;
  if (found.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY)
    return bLink ? RemoveDirectoryW(entry.Text()) != FALSE : bRemoveFolder(entry);
  if (found.dwFileAttributes & FILE_ATTRIBUTE_READONLY) SetFileAttributesW(entry.Text(), FILE_ATTRIBUTE_NORMAL);
  return DeleteFileW(entry.Text()) != FALSE;
}

bool bEmpty(const LongPath& folder) {
  WIN32_FIND_DATAW found;
  const HANDLE hFind = FindFirstFileW(LongPath(folder, L"*").Text(), &found);
  if (hFind == INVALID_HANDLE_VALUE) return false;
  bool bAll = true;
  do {
    if (!bIsDots(found.cFileName) && !bRemoveEntry(folder, found)) bAll = false;
  } while (FindNextFileW(hFind, &found));
  FindClose(hFind);
  return bAll;
}

// While its content goes the folder is held so that it can neither be renamed nor be made a link.
bool bRemoveFolder(const LongPath& folder) {
  {
    const Handle held(CreateFileW(folder.Text(), FILE_LIST_DIRECTORY, FILE_SHARE_READ, nullptr, OPEN_EXISTING,
                                  FOLDER_FLAGS, nullptr));
    BY_HANDLE_FILE_INFORMATION info;
    if (!held || !bIsPlainFolder(held.get(), info) || !bEmpty(folder)) return false;
  }
  return RemoveDirectoryW(folder.Text()) != FALSE;
}

// ---- what killed starters have left

bool bHasTheName(const wchar_t* szName) {
  return wcslen(szName) == NAME_LENGTH && wcsncmp(szName, PREFIX, 6) == 0 &&
         wcsspn(szName + 6, L"0123456789abcdef") == NAME_LENGTH - 6;
}

bool bHasAge(const FILETIME& made) {
  FILETIME now;
  GetSystemTimeAsFileTime(&now);
  const auto number = [](const FILETIME& time) {
    return static_cast<ULONGLONG>(time.dwHighDateTime) << 32 | time.dwLowDateTime;
  };
  return number(made) + ONE_MINUTE < number(now);
}

// Owner and access list of a folder.
struct Closure {
  BYTE bytes[512];
  DWORD dwSize = 0;
  bool bRead(HANDLE hFolder) {
    memset(bytes, 0, sizeof(bytes));
    return GetKernelObjectSecurity(hFolder, OWNER_AND_ACCESS, bytes, sizeof(bytes), &dwSize) != FALSE;
  }
  bool bSame(const Closure& other) const {
    return dwSize == other.dwSize && !memcmp(bytes, other.bytes, sizeof(bytes));
  }
};

}  // namespace

bool PrivateFolder::bMake() {
  wchar_t szPath[MAX_PATH], szDescriptor[256];
  if (!bChoosePlace(szPath, szDescriptor, 256) || !bAppendRandomName(szPath) || !bMakeClosed(szPath, szDescriptor))
    return false;
  m_hFolder = CreateFileW(szPath, FILE_LIST_DIRECTORY | READ_CONTROL, FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr,
                          OPEN_EXISTING, FOLDER_FLAGS, nullptr);
  wcscpy(m_szPath, szPath);
  BY_HANDLE_FILE_INFORMATION info;
  if (m_hFolder != INVALID_HANDLE_VALUE && bIsPlainFolder(m_hFolder, info)) return true;
  Remove();
  return false;
}

void PrivateFolder::Remove() {
  if (!*m_szPath) return;
  RemoveLeft();
  if (m_hFolder != INVALID_HANDLE_VALUE) CloseHandle(m_hFolder);
  m_hFolder = INVALID_HANDLE_VALUE;
  for (int i = 0; i < REMOVE_TRIES && !bRemoveTree(m_szPath); i++) Sleep(REMOVE_PAUSE);
  *m_szPath = L'\0';
}

// A folder is another starter's when it bears such a name and is closed exactly as this one: nobody else could make one
// like that. It is left when it is a minute old, so that its maker had the time to hold it, and neither its starter nor
// its setup program holds it.
bool PrivateFolder::bIsLeft(const wchar_t* szPath) const {
  const Handle other(CreateFileW(szPath, FILE_LIST_DIRECTORY | READ_CONTROL | DELETE, FILE_SHARE_READ, nullptr,
                                 OPEN_EXISTING, FOLDER_FLAGS, nullptr));
  BY_HANDLE_FILE_INFORMATION info;
  Closure mine, others;
  return other && bIsPlainFolder(other.get(), info) && bHasAge(info.ftCreationTime) && mine.bRead(m_hFolder) &&
         others.bRead(other.get()) && mine.bSame(others);
}

void PrivateFolder::RemoveLeft() const {
  wchar_t szPath[MAX_PATH];
  wcscpy(szPath, m_szPath);
  wchar_t* const pName = wcsrchr(szPath, L'\\') + 1;
  wcscpy(pName, L"orbit-*");
  WIN32_FIND_DATAW found;
  const HANDLE hFind = FindFirstFileW(szPath, &found);
  if (hFind == INVALID_HANDLE_VALUE) return;
  do {
    if (!bHasTheName(found.cFileName)) continue;
    wcscpy(pName, found.cFileName);
    if (wcscmp(szPath, m_szPath) != 0 && bIsLeft(szPath)) bRemoveTree(szPath);
  } while (FindNextFileW(hFind, &found));
  FindClose(hFind);
}

bool bRemoveTree(const wchar_t* szPath) { return bRemoveFolder(LongPath(szPath)); }
