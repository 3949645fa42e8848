#include "foundation/CNSystem.h"

#include <cstring>
#include <memory>
#include <new>

#include "foundation/Log.h"
#include "foundation/ResultCodes.h"
#include "foundation/os/Os.h"

namespace {

const size_t COPY_CHUNK = 100000;

bool bEmpty(const char* szText) { return !szText || !*szText; }

// Behind the last separator of either kind; the text itself when it has none.
const char* LastStep(const char* szPath) {
  const char* szStep = szPath;
  for (const char* p = szPath; *p; p++)
    if (*p == '\\' || *p == '/') szStep = p + 1;
  return szStep;
}

// False when a read or a write fails, or the system cannot keep what was written.
bool bCopyContent(OsFile& source, OsFile& destination) {
  const std::unique_ptr<char[]> pChunk(new (std::nothrow) char[COPY_CHUNK]);
  long lRead = -1;
  while (pChunk && (lRead = source.lRead(pChunk.get(), COPY_CHUNK)) > 0)
    if (!destination.bWrite(pChunk.get(), size_t(lRead))) return false;
  return lRead == 0 && destination.bClose();
}

}  // namespace

// ---- Files

int CNSystem::CopyFile(const char* SrcFile, const char* DestFile) {
  if (bEmpty(SrcFile)) return iLogReturn(0, "ERROR: CNSystem::CopyFile -> !SrcFile || !*SrcFile -> return 0");
  if (bEmpty(DestFile)) return iLogReturn(0, "ERROR: CNSystem::CopyFile -> !DestFile || !*DestFile -> return 0");
  // Emptying the destination would lose the content.
  if (bOsIsSameFile(SrcFile, DestFile)) return iLogReturn(0, "ERROR: CNSystem::CopyFile -> f==g -> return 0");
  OsFile source, destination;
  if (!source.bOpen(SrcFile, OsOpenMode::Read) || !destination.bOpen(DestFile, OsOpenMode::Create))
    return iLogReturn(0, "ERROR: CNSystem::CopyFile -> f==-1 || g==-1 -> return 0");
  if (!bCopyContent(source, destination))
    return iLogReturn(0, "ERROR: CNSystem::CopyFile -> !bCopyContent(%s, %s) -> return 0", SrcFile, DestFile);
  return 1;
}

int CNSystem::bExistFile(const char* szPath) {
  if (bEmpty(szPath)) return iLogReturn(0, "EXIT: CNSystem::bExistFile-> (!szPath || !*szPath) -> return FALSE");
  return bOsExists(szPath) ? 1 : 0;
}

int CNSystem::GetSize(const char* szPath, int64_t* i64Size) {
  if (!szPath)
    return iLogReturn(PRECONDITIONS_NOT_VALID, "EXIT: CNSystem::GetSize-> (!szPath) -> return PRECONDITIONS_NOT_VALID");
  if (!i64Size)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT: CNSystem::GetSize-> (!i64Size) -> return PRECONDITIONS_NOT_VALID");
  OsFileInfo info;
  OsFile file;
  const bool bFound = bOsGetFileInfo(szPath, info);
  // The size that a link has is not that of its file.
  const bool bLink = bFound && (info.attributes & OS_REPARSE_POINT) && !(info.attributes & OS_DIRECTORY);
  const bool bOpened = bLink && file.bOpen(szPath, OsOpenMode::Read);
  const int64_t size = bOpened ? file.Size() : int64_t(info.size);
  if (!bFound || bLink != bOpened || size < 0)
    return iLogReturn(FUNCTION_ERROR, "EXIT: CNSystem::GetSize-> return FUNCTION_ERROR");
  *i64Size = size;
  return EVERYTHING_IS_OK;
}

int CNSystem::GetFileCreationTime(const char* szPath, int64_t* i64Time) {
  if (!szPath)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT: CNSystem::GetFileCreationTime-> (!szPath) -> return PRECONDITIONS_NOT_VALID");
  if (!i64Time)  // the message's name of it is that of GetSize: deliberate
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT: CNSystem::GetFileCreationTime-> (!i64Size) -> return PRECONDITIONS_NOT_VALID");
  OsFileInfo info;
  if (!bOsGetFileInfo(szPath, info))
    return iLogReturn(FUNCTION_ERROR, "EXIT: CNSystem::GetFileCreationTime-> return FUNCTION_ERROR");
  *i64Time = int64_t(info.times.creation);
  return EVERYTHING_IS_OK;
}

// ---- Paths

int CNSystem::GetCurrentApplicationDir(CNString& csPath) {
  CNString csProgram;
  if (!bOsGetProgramPath(csProgram))
    return iLogReturn(FUNCTION_ERROR, "EXIT: CNSystem::GetCurrentApplicationDir-> return FUNCTION_ERROR");
  csProgram.SetLength(long(LastStep(csProgram.Text()) - csProgram.Text()));
  csProgram.AddSlash();
  csPath = csProgram;
  return EVERYTHING_IS_OK;
}

int CNSystem::GetCurrentDir(CNString* pcsPath) {
  if (!pcsPath)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "EXIT: CNSystem::GetCurrentDir-> (!pcsPath) -> return PRECONDITIONS_NOT_VALID");
  CNString csFolder;
  if (!bOsGetCurrentFolder(csFolder))
    return iLogReturn(FUNCTION_ERROR, "EXIT: CNSystem::GetCurrentDir-> return FUNCTION_ERROR");
  csFolder.Concat("/");
  *pcsPath = csFolder;
  return EVERYTHING_IS_OK;
}

int CNSystem::GetFileNameFromPath(const char* szFullPath, CNString& csFileName) {
  if (bEmpty(szFullPath))
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "EXIT: CNSystem::GetFileNameFromPath-> (!szFullPath || !*szFullPath) -> return PRECONDITIONS_NOT_VALID");
  csFileName = CNString(LastStep(szFullPath), -1);  // a copy: the path may be the result's own text
  return EVERYTHING_IS_OK;
}

int CNSystem::SwapBackSlashToSlash(char* szString) {
  if (bEmpty(szString))
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "EXIT: CNSystem::SwapBackSlashToSlash-> (!szString || !*szString) -> return PRECONDITIONS_NOT_VALID");
  for (char* p = szString; *p; p++)
    if (*p == '\\') *p = '/';
  return EVERYTHING_IS_OK;
}
