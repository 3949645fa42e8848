#include "foundation/CNConfigFile.h"

#include <cstdlib>
#include <cstring>

#include "foundation/CNStream.h"
#include "foundation/ResultCodes.h"
#include "foundation/os/Os.h"

namespace {

const char* const DEFAULT_FILE = "config.ini";
const char* const LINE_END = "\r\n";
const int READ_TIMEOUT = 25;
const long COUNT_DIGITS = 3;
const uint32_t NAME_TRIES = 10;
const int RENAME_TRIES = 4;
const unsigned RENAME_PAUSE = 50;  // milliseconds
const size_t LONG_VALUE = 255;
const unsigned char UNINITIALISED_FILL = 0xCC;

bool bEmpty(const char* szText) { return !szText || !*szText; }

bool bHasKey(const char* szLine, const char* szEquals, const char* szKeyName) {
  const size_t nLength = size_t(szEquals - szLine);
  return std::strlen(szKeyName) == nLength && std::memcmp(szLine, szKeyName, nLength) == 0;
}

// A new, empty file beside szFile, opened for writing, under a name that nothing had: whatever is there stays as it is.
bool bCreateBeside(const char* szFile, OsFile& file, CNString& csNew) {
  const uint32_t uFirst = OsTickCount();
  for (uint32_t i = 0; i < NAME_TRIES; i++)
    if (csNew.Printf("bCreateBeside", "csNew", "%s.%x-%lx.tmp", szFile, uFirst + i, OsThreadId()) &&
        file.bOpen(csNew.Text(), OsOpenMode::CreateNew))
      return true;
  return false;
}

// Others, a virus scanner above all, may have either file open for a moment.
bool bRenameWithPatience(const char* szFrom, const char* szTo) {
  for (int i = 0; i < RENAME_TRIES; i++) {
    if (i > 0) OsSleep(RENAME_PAUSE);
    if (bOsRename(szFrom, szTo)) return true;
  }
  return false;
}

// The file's next content, built while the old one is read: the count line, then entry lines.
class NewContent {
 public:
  // The line that holds the count, null for a file without content. Returns the count.
  int iStart(const char* szCountLine) {
    if (!szCountLine) {
      m_csBuffer = "000";
      return 0;
    }
    m_csBuffer = szCountLine;
    if (m_csBuffer.Length() < COUNT_DIGITS) m_csBuffer.SetLength(COUNT_DIGITS);  // room for the new count
    Append(LINE_END);
    return std::atoi(szCountLine);
  }
  // The last line gets no line end; which one that is the count says, deliberately, even when it is wrong.
  void Keep(const char* szLine, bool bLast) {
    Append(szLine);
    if (!bLast) Append(LINE_END);
  }
  void KeepEntry(const char* szKeyName, const char* szKeyValue, bool bLast) {
    Append(szKeyName);
    Append("=");
    Keep(szKeyValue, bLast);
  }
  // The line end behind a count line without entries separates already.
  void Add(const char* szKeyName, const char* szKeyValue, bool bFirst) {
    if (!bFirst || !m_csBuffer.EndsWith(LINE_END)) Append(LINE_END);
    KeepEntry(szKeyName, szKeyValue, true);
  }
  // Only the first three digits of a count of 1000 and more: deliberate.
  void SetCount(int iCount) {
    CNString csCount;
    m_bWhole = m_bWhole && m_csBuffer.Ptr() && csCount.Printf("NewContent::SetCount", "csCount", "%.3d", iCount);
    if (m_bWhole) std::memcpy(m_csBuffer.Ptr(), csCount.Ptr(), COUNT_DIGITS);
  }
  // Puts the content, written to a file beside it, in the file's place in one step: until then the old file is whole,
  // and stays when anything fails. The file itself is never written, as nothing could undo that half-way.
  bool bReplace(const char* szFile) const {
    OsFile file;
    CNString csNew;
    if (!m_bWhole || !bCreateBeside(szFile, file, csNew)) return false;
    const bool bWritten = file.bWrite(m_csBuffer.Text(), size_t(m_csBuffer.Length()));
    OsFileInfo old;
    if (bOsGetFileInfo(szFile, old)) bOsSetAttributes(csNew.Text(), old.attributes);  // a hidden file stays hidden
    if (file.bClose() && bWritten && bRenameWithPatience(csNew.Text(), szFile)) return true;
    bOsDeleteFile(csNew.Text());
    return false;
  }

 private:
  void Append(const char* szText) { m_bWhole = m_csBuffer.Concat(szText) && m_bWhole; }

  CNString m_csBuffer;
  bool m_bWhole = true;  // false once there was no memory for a piece
};

// Tells of values that look like a mistake, in lines that name the opposite of it. None is refused. All deliberate.
void InspectValue(const char* szKeyValue) {
  if (!*szKeyValue) LogPrintf("ERROR: CNConfigFile::iWriteConfigString -> !*szKeyValue == 0");
  if (static_cast<unsigned char>(*szKeyValue) == UNINITIALISED_FILL)
    LogPrintf("ERROR: CNConfigFile::iWriteConfigString -> !szKeyValue == %s", szKeyValue);
  const size_t nLength = std::strlen(szKeyValue);
  for (size_t i = LONG_VALUE; i < nLength; i++)  // once for every byte too many: deliberate
    LogPrintf("ERROR: CNConfigFile::iWriteConfigString -> !szKeyValue length > 255");
}

}  // namespace

CNConfigFile::CNConfigFile(const char* szFile) : m_csFileName(bEmpty(szFile) ? DEFAULT_FILE : szFile, 0) {
  CNFile file;
  if (!file.Open(m_csFileName.Ptr(), "rb+")) {
    // Not opened for emptying: the file may be there and only be closed to us at this moment.
    OsFile().bOpen(m_csFileName.Ptr(), OsOpenMode::CreateNew);
    return;
  }
  const char* szLine = file.ReadLine("CNConfigFile::CNConfigFile", "szLine", READ_TIMEOUT);
  m_iCount = szLine ? std::atoi(szLine) : 0;
}

int CNConfigFile::iReadConfigString(const char* szKeyName, CNString& csKeyValue) {
  if (bEmpty(szKeyName))
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNConfigFile::iReadConfigString -> !szKeyName || !*szKeyName -> return "
                      "PRECONDITIONS_NOT_VALID");
  const CNString csKey(szKeyName, 0);  // a copy: the value may replace the key's own text
  CNFile file(m_csFileName.Ptr(), "rb");
  if (!file.bFileOpened())
    return iLogReturn(FILE_COULD_NOT_BE_OPEN,
                      "ERROR: CNConfigFile::iReadConfigString -> !file.bFileOpened() -> return FILE_COULD_NOT_BE_OPEN");
  csKeyValue = "";
  file.ReadLine("CNConfigFile::iReadConfigString", "szLine", READ_TIMEOUT);
  while (const char* szLine = file.ReadLine("CNConfigFile::iReadConfigString", "szLine", READ_TIMEOUT)) {
    const char* szEquals = std::strchr(szLine, '=');
    if (!szEquals)
      return iLogReturn(FUNCTION_ERROR, "ERROR: CNConfigFile::iReadConfigString -> !'='(%s) -> return FUNCTION_ERROR",
                        szLine);
    if (!bHasKey(szLine, szEquals, csKey.Text())) continue;
    csKeyValue = szEquals + 1;
    break;
  }
  if (file.bFailed())
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNConfigFile::iReadConfigString -> file.bFailed() -> return FUNCTION_ERROR");
  return EVERYTHING_IS_OK;
}

int CNConfigFile::iReadConfigString(const char* szKeyName, char* szKeyValue) {
  if (!bEmpty(szKeyName) && !szKeyValue)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNConfigFile::iReadConfigString -> !szKeyValue -> return PRECONDITIONS_NOT_VALID");
  CNString csKeyValue;
  const int iResult = iReadConfigString(szKeyName, csKeyValue);
  if (csKeyValue.Ptr()) std::memcpy(szKeyValue, csKeyValue.Ptr(), size_t(csKeyValue.Length()) + 1);
  return iResult;
}

int CNConfigFile::iWriteConfigString(const char* szKeyName, const char* szKeyValue) {
  if (bEmpty(szKeyName))
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNConfigFile::iWriteConfigString -> !szKeyName || !*szKeyName -> return "
                      "PRECONDITIONS_NOT_VALID");
  if (!szKeyValue)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNConfigFile::iWriteConfigString -> !szKeyValue -> return PRECONDITIONS_NOT_VALID");
  InspectValue(szKeyValue);
  CNFile file(m_csFileName.Ptr(), "rb+");
  if (!file.bFileOpened())
    return iLogReturn(
        FILE_COULD_NOT_BE_OPEN,
        "ERROR: CNConfigFile::iWriteConfigString -> !file.bFileOpened() -> return FILE_COULD_NOT_BE_OPEN");

  NewContent content;
  m_iCount = content.iStart(file.ReadLine("CNConfigFile::iWriteConfigString", "szLine", READ_TIMEOUT));
  bool bFound = false;
  int nLines = 0;
  while (const char* szLine = file.ReadLine("CNConfigFile::iWriteConfigString", "szLine", READ_TIMEOUT)) {
    const char* szEquals = std::strchr(szLine, '=');
    if (!szEquals)
      return iLogReturn(FUNCTION_ERROR, "ERROR: CNConfigFile::iWriteConfigString -> !'='(%s) -> return FUNCTION_ERROR",
                        szLine);
    const bool bLast = ++nLines >= m_iCount;
    const bool bThis = bHasKey(szLine, szEquals, szKeyName);
    bThis ? content.KeepEntry(szKeyName, szKeyValue, bLast) : content.Keep(szLine, bLast);
    bFound = bFound || bThis;
  }
  if (file.bFailed())
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNConfigFile::iWriteConfigString -> file.bFailed() -> return FUNCTION_ERROR");
  if (!bFound) content.Add(szKeyName, szKeyValue, nLines == 0);
  m_iCount = nLines + (bFound ? 0 : 1);
  content.SetCount(m_iCount);
  file.Close();
  if (!content.bReplace(m_csFileName.Ptr()))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNConfigFile::iWriteConfigString -> !csBuffer.bReplace(%s) -> return FUNCTION_ERROR",
                      m_csFileName.Text());
  return EVERYTHING_IS_OK;
}

int CNConfigFile::iRemoveConfigString(const char* szKeyName) {
  if (bEmpty(szKeyName))
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNConfigFile::iRemoveConfigString -> !szKeyName || !*szKeyName -> return "
                      "PRECONDITIONS_NOT_VALID");
  CNFile file(m_csFileName.Ptr(), "rb+");
  if (!file.bFileOpened())
    return iLogReturn(
        FILE_COULD_NOT_BE_OPEN,
        "ERROR: CNConfigFile::iRemoveConfigString -> !file.bFileOpened() -> return FILE_COULD_NOT_BE_OPEN");
  const char* szCountLine = file.ReadLine("CNConfigFile::iRemoveConfigString", "szLine", READ_TIMEOUT);
  if (!szCountLine && !file.bFailed()) return EVERYTHING_IS_OK;

  NewContent content;
  const int iLastLine = m_iCount = content.iStart(szCountLine);
  bool bFound = false;
  int nLines = 0;
  while (const char* szLine = file.ReadLine("CNConfigFile::iRemoveConfigString", "szLine", READ_TIMEOUT)) {
    const char* szEquals = std::strchr(szLine, '=');
    if (!szEquals)
      return iLogReturn(FUNCTION_ERROR, "ERROR: CNConfigFile::iRemoveConfigString -> !'='(%s) -> return FUNCTION_ERROR",
                        szLine);
    nLines++;
    if (bHasKey(szLine, szEquals, szKeyName))
      bFound = true;
    else
      content.Keep(szLine, nLines >= iLastLine);
  }
  if (file.bFailed())
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNConfigFile::iRemoveConfigString -> file.bFailed() -> return FUNCTION_ERROR");
  if (bFound) m_iCount--;
  content.SetCount(m_iCount);
  file.Close();
  if (!content.bReplace(m_csFileName.Ptr()))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNConfigFile::iRemoveConfigString -> !csBuffer.bReplace(%s) -> return FUNCTION_ERROR",
                      m_csFileName.Text());
  return EVERYTHING_IS_OK;
}
