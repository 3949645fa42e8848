#include "archive/EntryExtractor.h"

#include <cstring>

#include "archive/PathGuard.h"
#include "foundation/Log.h"

namespace {

// The attribute bits that a file can be given. Whatever else an entry claims (folder, link, encrypted) is left out.
const uint32_t SETTABLE_ATTRIBUTES =
    OS_READ_ONLY | OS_HIDDEN | OS_SYSTEM | OS_ARCHIVE | OS_NORMAL | 0x100 | 0x1000 | 0x2000;

// Cuts the last name of a path with backslashes and the backslash before it.
CNString csFolderOf(const CNString& csPath) {
  const char* pSlash = strrchr(csPath.Text(), '\\');
  CNString csFolder;
  if (pSlash) csFolder.Copy(csPath.Ptr(), static_cast<long>(pSlash - csPath.Ptr()));
  return csFolder;
}

// The last folder's name of a path that ends with a slash, with a backslash.
CNString csLastFolder(const char* szFolder) {
  size_t nEnd = strlen(szFolder);
  while (nEnd > 0 && strchr("\\/", szFolder[nEnd - 1])) nEnd--;
  size_t nStart = nEnd;
  while (nStart > 0 && !strchr("\\/:", szFolder[nStart - 1])) nStart--;
  CNString csName;
  csName.Copy(szFolder + nStart, static_cast<long>(nEnd - nStart));
  if (!csName.bEmpty()) csName.Concat("\\");
  return csName;
}

// Makes the destination folder itself. What fails on the way (a drive, a share, a folder that may not be listed) is no
// failure as long as the folder is there in the end.
bool bMakeBase(const char* szFolder) {
  if (bOsIsFolder(szFolder)) return true;
  const size_t nLength = strlen(szFolder);
  for (size_t i = nLength >= 3 && szFolder[1] == ':' ? 3 : 1; i < nLength; i++) {
    if (!strchr("\\/", szFolder[i])) continue;
    CNString csPrefix;
    csPrefix.Copy(szFolder, static_cast<long>(i));
    OsMakeFolder(csPrefix.Text());
  }
  return bOsIsFolder(szFolder);
}

}  // namespace

CNString csNameForLog(const CNString& csName) {
  CNString csShown;
  csShown.Copy(csName.Text(), csName.Length());
  for (long i = 0; i < csShown.Length(); i++)
    if (static_cast<unsigned char>(csShown.Ptr()[i]) < 0x20) csShown.Ptr()[i] = '?';
  return csShown;
}

int EntryExtractor::iExtract(const ArchiveEntryHeader& entry, EntryFeed& feed, const ExtractTarget& target,
                             PercentReporter& percent) {
  CNString csRelative;
  int iResult = iChoosePath(entry, target, csRelative);
  if (iResult == ArchiveOk) iResult = iMakeFolders(entry, target, csRelative);
  if (iResult != ArchiveOk) return iResult;

  CNString csPath;
  csPath = target.szFolder;
  csPath.Concat(csRelative.Text());
  if (target.pJournal && !target.pJournal->bOnFile(csRelative.Text()))
    return iLogReturn(ErrDestinationFile,
                      "ERROR: CNArchive::ExtractEntry -> !bOnFile (%s) -> return ErrDestinationFile",
                      csNameForLog(entry.csName).Text());
  ArchiveFileMark mark;
  bool bTouched = false;
  iResult = iMakeFile(entry, feed, csPath.Text(), percent, mark, bTouched);
  if (target.pJournal && iResult == ArchiveOk) target.pJournal->OnFileDone(mark);
  if (target.pJournal && iResult != ArchiveOk && !bTouched) target.pJournal->OnFileNotMade();
  return iResult;
}

// bTouched: what is at szPath afterwards is of this run's making.
int EntryExtractor::iMakeFile(const ArchiveEntryHeader& entry, EntryFeed& feed, const char* szPath,
                              PercentReporter& percent, ArchiveFileMark& mark, bool& bTouched) {
  bool bIsNew = false;
  int iResult = iOpenOutput(entry, szPath, bIsNew);
  if (iResult != ArchiveOk) return iResult;
  iResult = iWriteContent(entry, feed, percent, mark);
  if (iResult == ArchiveOk) {
    iResult = iFinish(entry, szPath, bIsNew, mark);
  } else {
    m_output.bClose();
    // Half a file that was not there before helps nobody; one that was there is not taken away.
    if (bIsNew) bOsDeleteFile(szPath);
  }
  bTouched = iResult == ArchiveOk || bOsExists(szPath);
  return iResult;
}

// The path below the destination: safe, and with the destination's own name in front when that is wanted.
int EntryExtractor::iChoosePath(const ArchiveEntryHeader& entry, const ExtractTarget& target, CNString& csRelative) {
  CNString csSafe;
  const bool bHasZero = strlen(entry.csName.Text()) != static_cast<size_t>(entry.csName.Length());
  if (bHasZero || !bMakeSafePath(entry.csName.Text(), csSafe))
    return iLogReturn(ErrUnsafeName, "ERROR: CNArchive::ExtractEntry -> !bMakeSafePath (%s) -> return ErrUnsafeName",
                      csNameForLog(entry.csName).Text());
  if (target.bKeepFolder) csRelative = csLastFolder(target.szFolder);
  csRelative.Concat(csSafe.Text());
  return ArchiveOk;
}

int EntryExtractor::iMakeFolders(const ArchiveEntryHeader& entry, const ExtractTarget& target,
                                 const CNString& csRelative) {
  const CNString csRelativeFolder = csFolderOf(csRelative);
  CNString csFolder;
  csFolder = target.szFolder;
  csFolder.Concat(csRelativeFolder.Text());
  if (m_csReadyFolder.Ptr() && strcmp(csFolder.Text(), m_csReadyFolder.Text()) == 0) return ArchiveOk;

  const CNString csShown = csNameForLog(entry.csName);
  if (!bMakeBase(target.szFolder))
    return iLogReturn(ErrDestinationFolder,
                      "ERROR: CNArchive::ExtractEntry -> !bMakeBase (%s) -> return ErrDestinationFolder",
                      csShown.Text());
  if (!csRelativeFolder.bEmpty() && !bNoLinkOnPath(target.szFolder, csRelativeFolder.Text()))
    return iLogReturn(ErrUnsafeName, "ERROR: CNArchive::ExtractEntry -> !bNoLinkOnPath (%s) -> return ErrUnsafeName",
                      csShown.Text());
  m_csReadyFolder.Free();
  m_bFreshFolder = false;
  for (long i = 1; i <= csRelativeFolder.Length(); i++) {
    if (csRelativeFolder.Ptr()[i] != '\\' && csRelativeFolder.Ptr()[i] != 0) continue;
    CNString csStep, csPath;
    csStep.Copy(csRelativeFolder.Ptr(), i);
    csPath = target.szFolder;
    csPath.Concat(csStep.Text());
    if (target.pJournal && !bOsExists(csPath.Text()) && !target.pJournal->bOnFolder(csStep.Text()))
      return iLogReturn(ErrDestinationFolder,
                        "ERROR: CNArchive::ExtractEntry -> !bOnFolder (%s) -> return ErrDestinationFolder",
                        csShown.Text());
    const OsMakeFolderResult made = OsMakeFolder(csPath.Text());
    m_bFreshFolder = made == OsMakeFolderResult::Made;
    if (made == OsMakeFolderResult::NoParent || made == OsMakeFolderResult::Failed)
      return iLogReturn(ErrDestinationFolder,
                        "ERROR: CNArchive::ExtractEntry -> !OsMakeFolder (%s) -> return ErrDestinationFolder",
                        csShown.Text());
  }
  m_csReadyFolder = csFolder;
  return ArchiveOk;
}

// In a folder that this run has made there is nothing to look for: no older file and no link. Looking costs a good part
// of what creating a file does.
int EntryExtractor::iOpenOutput(const ArchiveEntryHeader& entry, const char* szPath, bool& bIsNew) {
  if (m_bFreshFolder && m_output.bOpen(szPath, OsOpenMode::Create)) return bIsNew = true, ArchiveOk;
  OsFileInfo before;
  bIsNew = !bOsGetFileInfo(szPath, before);
  if (!bIsNew && (before.attributes & OS_REPARSE_POINT))
    return iLogReturn(ErrUnsafeName, "ERROR: CNArchive::ExtractEntry -> OS_REPARSE_POINT (%s) -> return ErrUnsafeName",
                      csNameForLog(entry.csName).Text());
  if (m_output.bOpen(szPath, OsOpenMode::Create)) return ArchiveOk;
  // A read-only file of an earlier installation: once more without its attributes.
  if (!bIsNew && !(before.attributes & OS_DIRECTORY) && bOsSetAttributes(szPath, OS_NORMAL) &&
      m_output.bOpen(szPath, OsOpenMode::Create))
    return ArchiveOk;
  return iLogReturn(ErrDestinationFile, "ERROR: CNArchive::ExtractEntry -> !bOpen (%s) -> return ErrDestinationFile",
                    csNameForLog(entry.csName).Text());
}

int EntryExtractor::iWriteContent(const ArchiveEntryHeader& entry, EntryFeed& feed, PercentReporter& percent,
                                  ArchiveFileMark& mark) {
  const CNString csShown = csNameForLog(entry.csName);
  if (!feed.bStarted())
    return iLogReturn(ErrTemporaryFile, "ERROR: CNArchive::ExtractEntry -> !bStarted (%s) -> return ErrTemporaryFile",
                      csShown.Text());
  const unsigned char* pBytes;
  while (const size_t nBytes = feed.Read(pBytes)) {
    if (!m_output.bWrite(pBytes, nBytes))
      return iLogReturn(ErrDestinationFile,
                        "ERROR: CNArchive::ExtractEntry -> !bWrite (%s) -> return ErrDestinationFile", csShown.Text());
    mark.size += nBytes;
    percent.At(mark.size);
  }
  if (feed.Result() == GzipEntryReader::End::Unreadable)
    return iLogReturn(ErrArchiveOpen, "ERROR: CNArchive::ExtractEntry -> !lRead (%s) -> return ErrArchiveOpen",
                      csShown.Text());
  // Data that ends early or fails its check is deliberately kept as far as it goes, and no failure.
  if (feed.Result() != GzipEntryReader::End::Complete)
    LogPrintf("ERROR: CNArchive::ExtractEntry -> %s (%s) -> return ArchiveOk",
              feed.Result() == GzipEntryReader::End::Early ? "data ends early" : "data damaged", csShown.Text());
  mark.sum = feed.Sum();
  return ArchiveOk;
}

// Times on the open file, attributes after it is closed.
int EntryExtractor::iFinish(const ArchiveEntryHeader& entry, const char* szPath, bool bIsNew, ArchiveFileMark& mark) {
  OsFileTimes times;
  times.creation = static_cast<uint64_t>(entry.creationTimeHigh) << 32;
  times.lastAccess = static_cast<uint64_t>(entry.lastAccessTimeHigh) << 32;
  times.lastWrite = static_cast<uint64_t>(entry.lastWriteTimeHigh) << 32;
  const bool bTimesSet = m_output.bSetTimes(times), bClosed = m_output.bClose();
  if (!bClosed && bIsNew) bOsDeleteFile(szPath);  // as after a failed write
  if (!bClosed || !bTimesSet)
    return iLogReturn(ErrDestinationFile,
                      "ERROR: CNArchive::ExtractEntry -> !bSetTimes || !bClose (%s) -> return ErrDestinationFile",
                      csNameForLog(entry.csName).Text());
  OsFileInfo info;
  mark.lastWrite = times.lastWrite;
  if (!mark.lastWrite && bOsGetFileInfo(szPath, info)) mark.lastWrite = info.times.lastWrite;
  const uint32_t attributes = entry.attributes & SETTABLE_ATTRIBUTES;
  // A new file has the archive bit and nothing else already; asking again costs as much as opening it.
  if (bIsNew && attributes == OS_ARCHIVE) return ArchiveOk;
  m_bFreshFolder = false;  // should the archive name this file again, its attributes are to be seen
  if (!bOsSetAttributes(szPath, attributes ? attributes : OS_NORMAL))
    LogPrintf("ERROR: CNArchive::ExtractEntry -> !bOsSetAttributes (%s) -> return ArchiveOk",
              csNameForLog(entry.csName).Text());
  return ArchiveOk;
}
