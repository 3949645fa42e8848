#include "System.h"

#include <windows.h>
// after windows.h
#include <shlobj.h>

#include <cstring>

#include "Records.h"
#include "archive/PathGuard.h"
#include "archive/TempArchives.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "installer/ComPointer.h"

namespace {

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
  const Installation& installation;
  CNString& csFailures;
  CNString csPlace;
  bool bBelow;  // the folders in it too
};

bool bSpecialFolder(int iFolder, CNString& csPath) {
  wchar_t szPath[MAX_PATH] = L"";
  if (FAILED(SHGetFolderPathW(nullptr, iFolder, nullptr, 0, szPath)) || !bNarrowPath(szPath, csPath)) return false;
  csPath.AddSlash();
  return true;
}

// The item list holds the path in Unicode; the stored path beside it may be in the system's code page only.
bool bTargetOf(const ComPointer<IShellLinkW>& pLink, wchar_t* pTarget) {
  PIDLIST_ABSOLUTE pItems = nullptr;
  bool bFound = pLink->GetIDList(&pItems) == S_OK && SHGetPathFromIDListW(pItems, pTarget);
  CoTaskMemFree(pItems);
  return bFound || SUCCEEDED(pLink->GetPath(pTarget, MAX_PATH, nullptr, 0));
}

// pTarget holds MAX_PATH characters.
bool bLinkTarget(const char* szLink, wchar_t* pTarget) {
  ComPointer<IShellLinkW> link;
  ComPointer<IPersistFile> file;
  return SUCCEEDED(CoCreateInstance(CLSID_ShellLink, nullptr, CLSCTX_INPROC_SERVER, IID_IShellLinkW, link.Receive())) &&
         SUCCEEDED(link->QueryInterface(IID_IPersistFile, file.Receive())) &&
         SUCCEEDED(file->Load(Wide(szLink), STGM_READ)) && bTargetOf(link, pTarget);
}

// Short (8.3) names become long ones; a path that leads nowhere stays as it is. pLong holds MAX_PATH characters.
void MakeLongPath(const wchar_t* pPath, wchar_t* pLong) {
  const DWORD dwLength = GetLongPathNameW(pPath, pLong, MAX_PATH);
  if (!dwLength || dwLength >= MAX_PATH) lstrcpynW(pLong, pPath, MAX_PATH);
}

bool bIsOurs(const Installation& installation, const wchar_t* pTarget) {
  wchar_t szLong[MAX_PATH], szFolder[MAX_PATH];
  CNString csRelative;
  MakeLongPath(pTarget, szLong);
  MakeLongPath(Wide(installation.csFolder.Text()), szFolder);
  const int iFolder = lstrlenW(szFolder);
  return lstrlenW(szLong) > iFolder &&
         CompareStringW(LOCALE_INVARIANT, NORM_IGNORECASE, szLong, iFolder, szFolder, iFolder) == CSTR_EQUAL &&
         bNarrow(szLong + iFolder, csRelative) && installation.bListed(csRelative.Text());
}

void SweepPlace(const Sweep& sweep);

bool bVisitLink(const OsFolderEntry& entry, void* pContext) {
  const Sweep& sweep = *static_cast<const Sweep*>(pContext);
  const CNString csPath = csJoined(sweep.csPlace.Text(), entry.csName.Text());
  const bool bFolder = (entry.info.attributes & (OS_DIRECTORY | OS_REPARSE_POINT)) == OS_DIRECTORY;
  if (bFolder && sweep.bBelow)
    SweepPlace({sweep.installation, sweep.csFailures, csJoined(csPath.Text(), "\\"), true});
  else if (!bFolder)
    RemoveLink(csPath.Text(), sweep.installation, sweep.csFailures);
  return true;
}

void SweepPlace(const Sweep& sweep) { bOsListFolder(sweep.csPlace.Text(), bVisitLink, const_cast<Sweep*>(&sweep)); }

// What a file system does with a folder's name that was typed with blanks, dots or a backslash at its end.
void TrimFolderName(CNString& csName) {
  while (csName.Length() && strchr(" .\\", csName.Text()[csName.Length() - 1])) csName.SetLength(csName.Length() - 1);
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

void RemoveLink(const char* szLink, const Installation& installation, CNString& csFailures) {
  const ComApartment com;
  wchar_t szTarget[MAX_PATH] = L"";
  const CNString csLink(szLink, 0);
  if (csLink.Length() < 4 || iOsCompareNoCase(csLink.Text() + csLink.Length() - 4, ".lnk") != 0) return;
  if (!bLinkTarget(szLink, szTarget) || !bIsOurs(installation, szTarget)) return;
  if (!bOsDeleteFile(szLink)) csFailures.Concat(csJoined(szLink, "\n").Text());
}

// Of those that setup was about to make, the ones that it did not finish.
static void RemoveHalfLinks(const Installation& installation, CNString& csFailures) {
  const CNString csLinks = installation.csValues("links");
  const char* szLinks = csLinks.Text();
  for (CNString csLink; bTakePart(szLinks, csLink);) {
    wchar_t szTarget[MAX_PATH] = L"";
    const bool bLink = csLink.Length() > 4 && iOsCompareNoCase(csLink.Text() + csLink.Length() - 4, ".lnk") == 0;
    if (bLink && bIsFile(csLink.Text()) && !bLinkTarget(csLink.Text(), szTarget) && !bOsDeleteFile(csLink.Text()))
      csFailures.Concat(csJoined(csLink.Text(), "\n").Text());
  }
}

void RemoveShortcuts(const Installation& installation, CNString& csFailures) {
  const ComApartment com;
  RemoveHalfLinks(installation, csFailures);
  CNString csName = installation.csValue("program_folder"), csSafe;
  const bool bKnown = !csName.bEmpty();
  TrimFolderName(csName);
  const bool bProgramFolder = bKnown && bMakeSafePath(csName.Text(), csSafe);
  if (bKnown && !bProgramFolder) csFailures.Concat(csJoined(csName.Text(), "\n").Text());
  for (const ShortcutPlace& place : PLACES) {
    // A name that is not known: the shortcuts are looked for in all folders, and an empty one may be anybody's.
    Sweep sweep = {installation, csFailures, CNString(), place.bProgramFolder && !bKnown};
    if (place.bProgramFolder && bKnown && !bProgramFolder) continue;
    if (!bPlacePath(place, csSafe.Text(), sweep.csPlace)) continue;
    SweepPlace(sweep);
    sweep.csPlace.Trim('\\');
    if (place.bProgramFolder && bKnown) bOsDeleteFolder(sweep.csPlace.Text());  // stays when it is not empty
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

bool bUserDataFolder(CNString& csPath) { return bSpecialFolder(CSIDL_APPDATA, csPath); }

bool bFontsFolder(CNString& csPath) { return bSpecialFolder(CSIDL_FONTS, csPath); }

bool bBeginsWith(const char* szWhole, const char* szPart) {
  ReadHandle whole(szWhole), part(szPart);
  char szBlockA[4096], szBlockB[4096];
  DWORD dwA = 0, dwB = 0;
  if (whole.h == INVALID_HANDLE_VALUE || part.h == INVALID_HANDLE_VALUE) return false;
  do {
    if (!ReadFile(whole.h, szBlockA, sizeof(szBlockA), &dwA, nullptr)) return false;
    if (!ReadFile(part.h, szBlockB, sizeof(szBlockB), &dwB, nullptr)) return false;
    if (dwB > dwA || memcmp(szBlockA, szBlockB, dwB) != 0) return false;
  } while (dwB > 0 && dwA == dwB);
  return true;
}

bool bSameFile(const char* szA, const char* szB) { return bBeginsWith(szA, szB) && bBeginsWith(szB, szA); }

bool bDeleteAtRestart(const char* szPath) {
  return MoveFileExW(WidePath(szPath), nullptr, MOVEFILE_DELAY_UNTIL_REBOOT) != 0;
}

bool bMoveAside(const char* szPath, CNString& csMoved) {
  CNString csTemp;
  if (!bOsGetTempFolder(csTemp) || !bOsMakeTempFile(csTemp.Text(), "uni", csMoved)) return false;
  bOsSetAttributes(szPath, OS_NORMAL);
  if (MoveFileExW(WidePath(szPath), WidePath(csMoved.Text()), MOVEFILE_REPLACE_EXISTING)) return true;
  bOsDeleteFile(csMoved.Text());
  return false;
}

static bool bVisitTemp(const OsFolderEntry& entry, void* pContext) {
  const auto pPaths = static_cast<const char* const*>(pContext);  // the folder, the program
  const CNString csName(entry.csName.Text(), 0);
  const bool bNamed = csName.Length() > 7 && strncmp(csName.Text(), "uni", 3) == 0 &&
                      iOsCompareNoCase(csName.Text() + csName.Length() - 4, ".tmp") == 0;
  if (!bNamed || (entry.info.attributes & (OS_DIRECTORY | OS_REPARSE_POINT))) return true;
  const CNString csPath = csJoined(pPaths[0], csName.Text());
  if (bSameFile(csPath.Text(), pPaths[1])) bOsDeleteFile(csPath.Text());
  return true;
}

void RemoveTempFiles(const char* szOwnPath) {
  CNString csTemp;
  FILETIME now;
  if (!bOsGetTempFolder(csTemp)) return;
  const char* paths[] = {csTemp.Text(), szOwnPath};
  bOsListFolder(csTemp.Text(), bVisitTemp, paths);
  GetSystemTimeAsFileTime(&now);
  RemoveLeftTempArchives(csTemp.Text(), static_cast<uint64_t>(now.dwHighDateTime) << 32 | now.dwLowDateTime);
}
