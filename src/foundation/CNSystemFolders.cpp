#include <cstring>
#include <new>

#include "foundation/CNSystem.h"
#include "foundation/Log.h"
#include "foundation/NamePattern.h"
#include "foundation/ResultCodes.h"
#include "foundation/os/Os.h"

namespace {

bool bEmpty(const char* szText) { return !szText || !*szText; }

CNString csJoin(const char* szFolder, const char* szSeparator, const char* szName) {
  CNString csPath(szFolder, -1);
  csPath.Concat(szSeparator);
  csPath.Concat(szName);
  return csPath;
}

// ---- Searches

struct Search {
  const char* szPattern;
  bool bFoldersOnly;
  CNStringArray* pNames;
};

bool bKeepMatch(const OsFolderEntry& entry, void* pContext) {
  const Search& search = *static_cast<Search*>(pContext);
  const char* const szName = entry.csName.Text();
  const bool bWanted = !search.bFoldersOnly || ((entry.info.attributes & OS_DIRECTORY) && !bOsIsDots(szName));
  if (bWanted && bMatchesPattern(szName, search.szPattern)) search.pNames->Add(szName, 1);
  return true;
}

// The folder is what stands before the last separator.
OsListResult FindNames(const CNString& csSearch, bool bFoldersOnly, CNStringArray* pNames) {
  const char* const szSearch = csSearch.Text();
  const char *const pSlash = std::strrchr(szSearch, '/'), *const pBackSlash = std::strrchr(szSearch, '\\');
  const char* const pLast = pBackSlash > pSlash ? pBackSlash : pSlash;
  CNString csFolder;
  csFolder.Copy(szSearch, long(pLast - szSearch + 1));  // with the separator, or "C:/" would not be the root
  Search search = {pLast + 1, bFoldersOnly, pNames};
  return OsListEntries(csFolder.Text(), bKeepMatch, &search);
}

// ---- Trees

struct TreeEntry {
  CNString csPath;
  const char* szName;  // within csPath
  uint32_t attributes;

  bool bFolder() const { return attributes & OS_DIRECTORY; }
  bool bLink() const { return attributes & OS_REPARSE_POINT; }
};

// A folder's entries, all read at once: what is then done in the folder must not change them, and no handle stays open
// meanwhile.
class FolderReader {
 public:
  explicit FolderReader(const char* szFolder) : m_szFolder(szFolder), m_result(OsListEntries(szFolder, bKeep, this)) {}

  OsListResult Result() const { return m_result; }
  int Size() const { return m_entries.Size(); }
  const TreeEntry& operator[](int i) const { return *m_entries[i]; }

 private:
  static bool bKeep(const OsFolderEntry& entry, void* pContext) {
    FolderReader& reader = *static_cast<FolderReader*>(pContext);
    if (bOsIsDots(entry.csName.Text())) return true;
    TreeEntry* const pEntry = new (std::nothrow) TreeEntry;
    if (!pEntry) return false;
    pEntry->csPath = csJoin(reader.m_szFolder, "\\", entry.csName.Text());
    pEntry->szName = pEntry->csPath.Text() + pEntry->csPath.Length() - entry.csName.Length();
    pEntry->attributes = entry.info.attributes;
    reader.m_entries.Add(pEntry, 1);
    return true;
  }

  const char* m_szFolder;
  CNArray<TreeEntry> m_entries;
  OsListResult m_result;
};

int CopyTree(const char* SrcDir, const char* DstDir, const char* szTopDstDir);

void CopyTreeEntry(const TreeEntry& entry, const char* DstDir, const char* szTopDstDir) {
  const CNString csTo = csJoin(DstDir, "\\", entry.szName);
  if (!entry.bFolder()) {
    CNSystem::CopyFile(entry.csPath.Text(), csTo.Text());
    return;
  }
  // Either would be copied into itself without end.
  if (entry.bLink() || bOsIsSameFile(entry.csPath.Text(), szTopDstDir)) {
    LogPrintf("INFO: CNSystem::CopyAll -> %s is not copied", entry.csPath.Text());
    return;
  }
  const OsMakeFolderResult made = OsMakeFolder(csTo.Text());
  if (made == OsMakeFolderResult::Made || made == OsMakeFolderResult::Exists)
    CopyTree(entry.csPath.Text(), csTo.Text(), szTopDstDir);
  else
    LogPrintf("ERROR: CNSystem::CopyAll -> !OsMakeFolder(%s)", csTo.Text());
}

int CopyTree(const char* SrcDir, const char* DstDir, const char* szTopDstDir) {
  const FolderReader folder(SrcDir);
  if (folder.Result() == OsListResult::NotStarted)  // the line tells of -1 for 0: deliberate
    return iLogReturn(0, "ERROR: CNSystem::CopyAll -> _findfirst()==-1, SrcDir=%s -> return -1", SrcDir);
  for (int i = 0; i < folder.Size(); i++) CopyTreeEntry(folder[i], DstDir, szTopDstDir);
  return 1;
}

// A program that is running, or a library that it has loaded, cannot be opened for writing.
bool bWritable(const TreeEntry& entry) {
  if (!bMatchesPattern(entry.szName, "*.dll") && !bMatchesPattern(entry.szName, "*.exe")) return true;
  const char* const szPath = entry.csPath.Text();
  const bool bReadOnly = entry.attributes & OS_READ_ONLY;
  if (bReadOnly) bOsSetAttributes(szPath, entry.attributes & ~OS_READ_ONLY);
  OsFile file;
  const bool bOpened = file.bOpen(szPath, OsOpenMode::Append);
  file.bClose();
  if (bReadOnly) bOsSetAttributes(szPath, entry.attributes);
  return bOpened;
}

// Whether nothing below the folder speaks against its removal.
bool bMayDelete(const char* szFolder) {
  const FolderReader folder(szFolder);
  bool bMay = folder.Result() == OsListResult::Listed;
  for (int i = 0; i < folder.Size() && bMay; i++)
    if (!folder[i].bLink()) bMay = folder[i].bFolder() ? bMayDelete(folder[i].csPath.Text()) : bWritable(folder[i]);
  return bMay;
}

bool bDeleteTree(const char* szFolder);

bool bDeleteEntry(const char* szPath, uint32_t attributes) {
  if (attributes & OS_READ_ONLY) bOsSetAttributes(szPath, attributes & ~OS_READ_ONLY);
  if (!(attributes & OS_DIRECTORY)) return bOsDeleteFile(szPath);
  if (attributes & OS_REPARSE_POINT) return bOsDeleteFolder(szPath) || bOsDeleteFile(szPath);  // as the system has it
  return bDeleteTree(szPath);
}

bool bDeleteTree(const char* szFolder) {
  const FolderReader folder(szFolder);
  bool bDone = folder.Result() == OsListResult::Listed;
  for (int i = 0; i < folder.Size(); i++)
    if (!bDeleteEntry(folder[i].csPath.Text(), folder[i].attributes)) bDone = false;
  return bDone && bOsDeleteFolder(szFolder);
}

// A path whose last step names a folder: not the root of a drive, not the folder that it starts from or the one above.
bool bNamesFolder(const char* szPath) {
  long lEnd = long(std::strlen(szPath));
  while (lEnd > 0 && std::strchr("\\/", szPath[lEnd - 1])) lEnd--;
  long lStart = lEnd;
  while (lStart > 0 && !std::strchr("\\/:", szPath[lStart - 1])) lStart--;
  CNString csLast;
  csLast.Copy(szPath + lStart, lEnd - lStart);
  return !csLast.bEmpty() && !bOsIsDots(csLast.Text());
}

}  // namespace

// The lines of a search that broke off have no colon behind their first word: deliberate.
int CNSystem::ListFilesAndFolders(const char* szPath, CNStringArray* parcsFileNames, const char* szPattern) {
  if (bEmpty(szPath))  // the garbled name is deliberate
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT: CNSystem::ListFListFilesAndFoldersiles-> (!szPath || !*szPath) -> return "
                      "PRECONDITIONS_NOT_VALID");
  if (!parcsFileNames)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT: CNSystem::ListFilesAndFolders-> (!parcsFileNames) -> return PRECONDITIONS_NOT_VALID");
  if (FindNames(csJoin(szPath, "/*", szPattern), false, parcsFileNames) == OsListResult::Failed)
    return iLogReturn(FUNCTION_ERROR, "ERROR CNSystem::ListFilesAndFolders dwError= %u", OsLastError());
  return EVERYTHING_IS_OK;
}

int CNSystem::ListFolders(const char* szPath, CNStringArray* parcsFolderNames, const char* szPattern) {
  if (bEmpty(szPath))
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT: CNSystem::ListFolders-> (!szPath || !*szPath) -> return PRECONDITIONS_NOT_VALID");
  if (!parcsFolderNames)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT: CNSystem::ListFolders-> (!parcsFolderNames) -> return PRECONDITIONS_NOT_VALID");
  if (FindNames(csJoin(szPath, "/", szPattern), true, parcsFolderNames) == OsListResult::Failed)
    return iLogReturn(FUNCTION_ERROR, "ERROR CNSystem::ListFolders dwError= %u", OsLastError());
  return EVERYTHING_IS_OK;
}

int CNSystem::CopyAll(const char* SrcDir, const char* DstDir) {
  if (bEmpty(SrcDir)) return iLogReturn(0, "ENTER: CNSystem::CopyAll -> !SrcDir || !*SrcDir -> return 0");
  if (bEmpty(DstDir)) return iLogReturn(0, "ENTER: CNSystem::CopyAll -> !DstDir || !*DstDir -> return 0");
  return CopyTree(SrcDir, DstDir, DstDir);
}

int CNSystem::iDeleteFolderAndSubFolders(const char* szPath) {
  if (bEmpty(szPath))
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT: CNSystem::iDeleteFolderAndSubFolders-> (!szPath || !*szPath) -> return "
                      "PRECONDITIONS_NOT_VALID");
  if (!bNamesFolder(szPath))
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT: CNSystem::iDeleteFolderAndSubFolders-> (!bNamesFolder(%s)) -> return "
                      "PRECONDITIONS_NOT_VALID",
                      szPath);
  OsFileInfo info;
  const bool bFolder = bOsGetFileInfo(szPath, info) && (info.attributes & OS_DIRECTORY);
  const bool bMay = bFolder && ((info.attributes & OS_REPARSE_POINT) || bMayDelete(szPath));
  if (!bMay || !bDeleteEntry(szPath, info.attributes))
    return iLogReturn(
        FUNCTION_ERROR,
        "ERROR: CNSystem::iDeleteFolderAndSubFolders -> iDeleteFolderAndSubFolders -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}
