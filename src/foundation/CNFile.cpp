#include <climits>
#include <cstring>

#include "foundation/CNStream.h"
#include "foundation/os/Os.h"

namespace {

const int BLOCK_SIZE = 4096;
const int LINE_LIMIT = 4094;  // with the terminator: a longer line comes in pieces of 4093 characters

}  // namespace

CNFile::CNFile(const char* file, const char* type) {
  if (!file || !*file) {
    LogPrintf("ERROR: CNFile::CNFile(char *file, char *type) -> !file || !*file -> return");
    return;
  }
  if (!type || !*type) {
    LogPrintf("ERROR: CNFile::CNFile(char *file, char *type) -> !type || !*type -> return");
    return;
  }
  Open(file, type);
}

CNFile::~CNFile() { Close(); }

int CNFile::Open(const char* file, const char* type) {
  if (!type || !*type) return iLogReturn(0, "ERROR: CNFile::Open -> !type || !*type -> return 0");
  CNSemHold hold(m_sem);
  CloseLocked();
  if (file) m_csFileName = file;
  if (!m_csFileName.Length()) return iLogReturn(0, "ERROR: CNFile::Open -> !m_csFileName.Length() -> return 0");
  m_File = OsOpenStream(m_csFileName.Ptr(), type);
  m_bOpened = m_File ? 1 : 0;
  return m_bOpened;
}

void CNFile::Close() {
  CNSemHold hold(m_sem);
  CloseLocked();
}

void CNFile::CloseLocked() {
  if (m_File) std::fclose(m_File);
  m_File = nullptr;
  m_bOpened = 0;
}

long CNFile::Read(const char* szFunction, const char* szVariable, char* szBuffer, long lMaxReadBufferLength) {
  return lRead(szFunction, szVariable, szBuffer, lMaxReadBufferLength);
}

long CNFile::Write(const char* szFunction, const char* szVariable, const char* szBuffer, long lBufferLength) {
  // A first byte of zero counts as no content: deliberate, this is a writer of texts.
  if (!szBuffer || !*szBuffer)
    return iLogReturn(-1,
                      "ERROR: CNFile::Write -> !szBuffer || !*szBuffer -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  if (lBufferLength < 1)  // 0 too, although the line says "<0": deliberate
    return iLogReturn(-1, "ERROR: CNFile::Write -> lBufferLength<0 -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  CNSemHold hold(m_sem);
  if (!m_File)
    return iLogReturn(-1, "ERROR: CNFile::Write -> !m_File -> return -1 -> szFunction=%s, szVariable=%s", szFunction,
                      szVariable);
  if (std::fwrite(szBuffer, 1, size_t(lBufferLength), m_File) != size_t(lBufferLength))
    return iLogReturn(-1,
                      "ERROR: CNFile::Write -> fwrite()!=lBufferLength -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  return lBufferLength;
}

// Without the lock, as every formatted write to a file.
long CNFile::vPrintf(const char* szFunction, const char* szVariable, const char* szFormat, va_list args) {
  if (!m_File)
    return iLogReturn(-1, "ERROR: CNFile::Printf -> !m_File -> return -1 -> szFunction=%s, szVariable=%s", szFunction,
                      szVariable);
  if (!szFormat || !*szFormat)
    return iLogReturn(-1, "ERROR: CNStream::Printf -> !format || !*format -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  CNString csText;
  if (!csText.vPrintf(szFunction, szVariable, szFormat, args)) return -1;
  if (std::fwrite(csText.Ptr(), 1, size_t(csText.Length()), m_File) != size_t(csText.Length()))
    return iLogReturn(-1,
                      "ERROR: CNStream::Printf -> lNumBytesPrinted==-1 -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  return csText.Length();
}

long CNFile::lRead(const char* szFunction, const char* szVariable, char* szBuffer, long lMax) {
  if (!szBuffer)
    return iLogReturn(-1, "ERROR: CNFile::lRead -> !szBuffer -> return -1 -> szFunction=%s, szVariable=%s", szFunction,
                      szVariable);
  if (lMax < 0)  // the line breaks off: deliberate
    return iLogReturn(-1, "ERROR: CNFile::lRead -> lMaxReadBufferLength-> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  CNSemHold hold(m_sem);
  // The line tells of 0 for -1: deliberate, here and below.
  if (!m_File) return iLogReturn(-1, "ERROR: CNFile::lRead -> !m_File -> return 0");
  const long lCount = long(std::fread(szBuffer, 1, size_t(lMax), m_File));
  if (lCount < lMax && std::ferror(m_File))
    return iLogReturn(-1, "ERROR: CNFile::lRead -> ferror(m_File) -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  return lCount;
}

long CNFile::lRead(CNString& csOut) {
  CNSemHold hold(m_sem);
  if (!m_File) return iLogReturn(-1, "ERROR: CNFile::lRead -> !m_File -> return 0");
  csOut = "";
  const long lFileSize = lSize();
  if (lFileSize < 0) return -1;
  if (lFileSize == 0) return iLogReturn(-1, "INFO: CNFile::lRead -> empty file -> return -1");
  if (!csOut.SetLength(lFileSize)) return -1;
  const long lCount = long(std::fread(csOut.Ptr(), 1, size_t(lFileSize), m_File));
  csOut.SetLength(lCount);  // text mode delivers fewer bytes than the file has
  if (std::ferror(m_File)) return iLogReturn(-1, "ERROR: CNFile::lRead -> ferror(m_File) -> return -1");
  return lCount;
}

const char* CNFile::ReadLine(const char* szFunction, const char* szVariable, int iTimeOut) {
  if (iTimeOut < 1)
    return static_cast<const char*>(
        LogPrintf("ERROR: CNFile::ReadLine -> iTimeOut<=0 -> return NULL -> szFunction=%s, szVariable=%s", szFunction,
                  szVariable));
  CNSemHold hold(m_sem);
  if (!m_File)
    return static_cast<const char*>(LogPrintf(
        "ERROR: CNFile::ReadLine -> !m_File -> return NULL -> szFunction=%s, szVariable=%s", szFunction, szVariable));
  char szLine[LINE_LIMIT];
  if (!std::fgets(szLine, LINE_LIMIT, m_File) || std::ferror(m_File)) return nullptr;
  return KeepLine(szLine, long(std::strlen(szLine)));
}

// A line that is longer than the block counts more than once: deliberate.
long CNFile::lGetNumLines() {
  if (!m_File) return iLogReturn(-1, "ERROR: CNFile::lGetNumLines -> !m_File -> return -1");
  const long lPosition = std::ftell(m_File);
  char szLine[BLOCK_SIZE];
  long lLines = 0;
  while (std::fgets(szLine, BLOCK_SIZE, m_File)) lLines++;
  std::fseek(m_File, lPosition, SEEK_SET);
  return lLines;
}

long CNFile::lSize() {
  if (!m_File) return iLogReturn(-1, "ERROR: CNFile::lSize -> !m_File -> return -1");
  const long lPosition = std::ftell(m_File);
  std::fseek(m_File, 0, SEEK_END);
  const long lBytes = std::ftell(m_File);
  std::fseek(m_File, lPosition, SEEK_SET);
  if (lPosition < 0 || lBytes < 0) return iLogReturn(-1, "ERROR: CNFile::lSize -> ftell(m_File)==-1 -> return -1");
  return lBytes;
}
