#include "System.h"

#include <windows.h>
// after windows.h
#include <objbase.h>
#include <shlobj.h>

#include <cstring>

#include "archive/PathGuard.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"

namespace {

template <typename T>
struct ComPointer {
  T* p = nullptr;
  ~ComPointer() {
    if (p) p->Release();
  }
};

struct ComInit {
  ComInit() { CoInitialize(nullptr); }
  ~ComInit() { CoUninitialize(); }
};

// Where an installation puts shortcuts, for all users and for this one.
struct ShortcutPlace {
  int iFolder;
  const char* szBelow;
  bool bProgramFolder;  // the start menu's programs: inside the product's own folder
};

const ShortcutPlace PLACES[] = {
    {CSIDL_COMMON_PROGRAMS, "", true},
    {CSIDL_PROGRAMS, "", true},
    {CSIDL_COMMON_DESKTOPDIRECTORY, "", false},
    {CSIDL_DESKTOPDIRECTORY, "", false},
    {CSIDL_APPDATA, "Microsoft\\Internet Explorer\\Quick Launch\\", false},
};

struct Sweep {
  const wchar_t* pFolder;  // that the shortcuts lead into, in its long form
  bool (*pIsOurs)(const char* szPath, void* pContext);
  void* pContext;
  CNString csPlace;
  CNString* pFailures;
};

bool bSpecialFolder(int iFolder, CNString& csPath) {
  wchar_t szPath[MAX_PATH] = L"";
  if (FAILED(SHGetFolderPathW(nullptr, iFolder, nullptr, 0, szPath)) || !bNarrowPath(szPath, csPath)) return false;
  csPath.AddSlash();
  return true;
}

// The item list holds the path in Unicode; the stored path beside it may be in the system's code page only.
bool bTargetOf(IShellLinkW* pLink, wchar_t* pTarget) {
  PIDLIST_ABSOLUTE pItems = nullptr;
  bool bFound = pLink->GetIDList(&pItems) == S_OK && SHGetPathFromIDListW(pItems, pTarget);
  CoTaskMemFree(pItems);
  return bFound || SUCCEEDED(pLink->GetPath(pTarget, MAX_PATH, nullptr, 0));
}

// pTarget holds MAX_PATH characters.
bool bLinkTarget(const char* szLink, wchar_t* pTarget) {
  ComPointer<IShellLinkW> link;
  ComPointer<IPersistFile> file;
  return SUCCEEDED(CoCreateInstance(CLSID_ShellLink, nullptr, CLSCTX_INPROC_SERVER, IID_IShellLinkW,
                                    reinterpret_cast<void**>(&link.p))) &&
         SUCCEEDED(link.p->QueryInterface(IID_IPersistFile, reinterpret_cast<void**>(&file.p))) &&
         SUCCEEDED(file.p->Load(Wide(szLink), STGM_READ)) && bTargetOf(link.p, pTarget);
}

// Short (8.3) names become long ones; a path that leads nowhere stays as it is. pLong holds MAX_PATH characters.
void MakeLongPath(const wchar_t* pPath, wchar_t* pLong) {
  const DWORD dwLength = GetLongPathNameW(pPath, pLong, MAX_PATH);
  if (!dwLength || dwLength >= MAX_PATH) lstrcpynW(pLong, pPath, MAX_PATH);
}

bool bIsOurs(const Sweep& sweep, const wchar_t* pTarget) {
  wchar_t szLong[MAX_PATH];
  CNString csRelative;
  MakeLongPath(pTarget, szLong);
  const int iFolder = lstrlenW(sweep.pFolder);
  return lstrlenW(szLong) > iFolder &&
         CompareStringW(LOCALE_INVARIANT, NORM_IGNORECASE, szLong, iFolder, sweep.pFolder, iFolder) == CSTR_EQUAL &&
         bNarrow(szLong + iFolder, csRelative) && sweep.pIsOurs(csRelative.Text(), sweep.pContext);
}

bool bVisitLink(const OsFolderEntry& entry, void* pContext) {
  Sweep& sweep = *static_cast<Sweep*>(pContext);
  CNString csLower(entry.csName.Text(), 0);
  wchar_t szTarget[MAX_PATH] = L"";
  csLower.MakeLower();
  if (entry.info.attributes & OS_DIRECTORY || !csLower.EndsWith(".lnk")) return true;
  CNString csLink(sweep.csPlace.Text(), 0);
  csLink.Concat(entry.csName.Text());
  if (!bLinkTarget(csLink.Text(), szTarget) || !bIsOurs(sweep, szTarget)) return true;
  if (!bOsDeleteFile(csLink.Text())) {
    sweep.pFailures->Concat(csLink.Text());
    sweep.pFailures->Concat("\n");
  }
  return true;
}

// szProgramFolder is a safe relative path.
bool bPlacePath(const ShortcutPlace& place, const char* szProgramFolder, CNString& csPath) {
  if (!bSpecialFolder(place.iFolder, csPath)) return false;
  const char* szBelow = place.bProgramFolder ? szProgramFolder : place.szBelow;
  if (place.bProgramFolder && !bNoLinkOnPath(csPath.Text(), szBelow)) return false;
  csPath.Concat(szBelow);
  csPath.AddSlash();
  return true;
}

// Shares everything: the copy that compares itself is already marked for deletion.
struct ReadHandle {
  explicit ReadHandle(const char* szPath, DWORD dwAccess = GENERIC_READ)
      : h(CreateFileW(WidePath(szPath), dwAccess, FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr,
                      OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS, nullptr)) {}
  ~ReadHandle() {
    if (h != INVALID_HANDLE_VALUE) CloseHandle(h);
  }
  HANDLE h;
};

}  // namespace

void RemoveShortcuts(const char* szFolder, const char* szProgramFolder, bool (*pIsOurs)(const char*, void*),
                     void* pContext, CNString& csFailures) {
  ComInit com;
  CNString csSafe;
  const bool bProgramFolder = bMakeSafePath(szProgramFolder, csSafe);
  if (!bProgramFolder && *szProgramFolder) csFailures.Concat(szProgramFolder), csFailures.Concat("\n");
  wchar_t szLongFolder[MAX_PATH];
  MakeLongPath(Wide(szFolder), szLongFolder);
  for (const ShortcutPlace& place : PLACES) {
    Sweep sweep = {szLongFolder, pIsOurs, pContext, CNString(), &csFailures};
    if (place.bProgramFolder && !bProgramFolder) continue;
    if (!bPlacePath(place, csSafe.Text(), sweep.csPlace)) continue;
    bOsListFolder(sweep.csPlace.Text(), bVisitLink, &sweep);
    sweep.csPlace.Trim('\\');
    if (place.bProgramFolder) bOsDeleteFolder(sweep.csPlace.Text());  // stays when it is not empty
  }
}

void MakeFullPath(CNString& csPath) {
  if (csPath.bEmpty()) return;
  csPath.AddSlash();  // "C:" alone would be that drive's current folder
  wchar_t szFull[MAX_PATH] = L"";
  const DWORD dwLength = GetFullPathNameW(Wide(csPath.Text()), MAX_PATH, szFull, nullptr);
  if (dwLength && dwLength < MAX_PATH) bNarrowPath(szFull, csPath);
  if (csPath.Length() > 3) csPath.SetLength(csPath.Length() - 1);
}

bool bSameObject(const char* szA, const char* szB) {
  const ReadHandle a(szA, FILE_READ_ATTRIBUTES), b(szB, FILE_READ_ATTRIBUTES);
  BY_HANDLE_FILE_INFORMATION infoA, infoB;
  return a.h != INVALID_HANDLE_VALUE && b.h != INVALID_HANDLE_VALUE && GetFileInformationByHandle(a.h, &infoA) &&
         GetFileInformationByHandle(b.h, &infoB) && infoA.dwVolumeSerialNumber == infoB.dwVolumeSerialNumber &&
         infoA.nFileIndexHigh == infoB.nFileIndexHigh && infoA.nFileIndexLow == infoB.nFileIndexLow;
}

bool bWindowsFolder(CNString& csPath) {
  wchar_t szPath[MAX_PATH] = L"";
  return GetWindowsDirectoryW(szPath, MAX_PATH) && bNarrowPath(szPath, csPath);
}

bool bSameFile(const char* szA, const char* szB) {
  ReadHandle a(szA), b(szB);
  char szBlockA[4096], szBlockB[4096];
  DWORD dwA = 0, dwB = 0;
  if (a.h == INVALID_HANDLE_VALUE || b.h == INVALID_HANDLE_VALUE) return false;
  do {
    if (!ReadFile(a.h, szBlockA, sizeof(szBlockA), &dwA, nullptr)) return false;
    if (!ReadFile(b.h, szBlockB, sizeof(szBlockB), &dwB, nullptr)) return false;
    if (dwA != dwB || memcmp(szBlockA, szBlockB, dwA) != 0) return false;
  } while (dwA > 0);
  return true;
}
