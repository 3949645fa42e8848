#include "archive/InstalledList.h"

#include <zlib.h>

#include <cstdlib>
#include <cstring>
#include <new>

const char InstalledList::FILE_NAME[] = "Installed.lst";
const char InstalledList::FOLDERS_FILE[] = "orbit-folders.lst";

namespace {

const int64_t MOST_BYTES = 64 * 1024 * 1024;
const int MOST_LINES = 1000000;
const uint64_t TIME_STEP = 20000000;  // file systems that know even seconds only

// Takes a hexadecimal number off the front.
uint64_t TakeHex(const char*& sz) {
  uint64_t value = 0;
  while (*sz == ' ') sz++;
  for (; *sz && strchr("0123456789abcdef", *sz); sz++)
    value = value * 16 + static_cast<unsigned>(*sz <= '9' ? *sz - '0' : *sz - 'a' + 10);
  return value;
}

int iCompareFiles(const void* pA, const void* pB) {
  const auto& a = **static_cast<const InstalledList::Line* const*>(pA);
  const auto& b = **static_cast<const InstalledList::Line* const*>(pB);
  const int iOrder = iOsCompareNoCase(a.szText, b.szText);
  return iOrder ? iOrder : a.iNumber - b.iNumber;
}

}  // namespace

bool InstalledList::bRead(const char* szFile) {
  m_iSize = m_iFiles = m_iBad = 0;
  OsFile file;
  const int64_t size = file.bOpen(szFile, OsOpenMode::Read) ? file.Size() : -1;
  if (size < 0 || size > MOST_BYTES) return false;
  m_text.reset(new (std::nothrow) char[static_cast<size_t>(size) + 1]);
  if (!m_text) return false;
  size_t nBytes = 0;
  for (long lRead; (lRead = file.lRead(m_text.get() + nBytes, static_cast<size_t>(size) - nBytes)) > 0;)
    nBytes += static_cast<size_t>(lRead);
  int iLines = 0;
  // After a power cut there may be zeros where text should be.
  for (size_t i = 0; i < nBytes; i++) {
    if (!m_text[i]) m_text[i] = '\n';
    if (m_text[i] == '\n') iLines++;
  }
  m_text[nBytes] = 0;
  if (iLines > MOST_LINES) return false;
  m_lines.reset(new (std::nothrow) Line[static_cast<size_t>(iLines) + 1]);
  m_files.reset(new (std::nothrow) const Line*[static_cast<size_t>(iLines) + 1]);
  if (!m_lines || !m_files) return false;
  char* szLine = m_text.get();
  for (char* pEnd; (pEnd = strchr(szLine, '\n')) != nullptr; szLine = pEnd + 1) {
    const bool bReturn = pEnd > szLine && pEnd[-1] == '\r';
    pEnd[bReturn ? -1 : 0] = 0;
    TakeLine(szLine, strlen(szLine));
  }
  SortFiles();
  return true;
}

void InstalledList::TakeLine(char* szLine, size_t nLength) {
  // A later run ends what an earlier one left without an end with a character that is in no path.
  if (!nLength || szLine[nLength - 1] == '|') return;
  Line* pLast = m_iSize && m_lines[m_iSize - 1].cKind == 'F' ? &m_lines[m_iSize - 1] : nullptr;
  if (strcmp(szLine, "N") == 0 && pLast) {  // the file before was not made
    m_iSize--;
    return;
  }
  if (szLine[0] == 'S' && szLine[1] == ' ' && pLast) {
    const char* sz = szLine + 1;
    pLast->mark.size = TakeHex(sz);
    pLast->mark.lastWrite = TakeHex(sz);
    pLast->mark.sum = static_cast<uint32_t>(TakeHex(sz));
    pLast->bMarked = true;
    return;
  }
  if (!strchr("FDWPRV", szLine[0]) || szLine[1] != ' ' || !szLine[2]) {
    m_iBad++;
    return;
  }
  Line& line = m_lines[m_iSize];
  line = Line();
  line.cKind = szLine[0];
  line.iNumber = m_iSize++;
  line.szText = szLine + 2;
}

void InstalledList::SortFiles() {
  for (int i = 0; i < m_iSize; i++)
    if (m_lines[i].cKind == 'F') m_files[m_iFiles++] = &m_lines[i];
  if (m_iFiles) qsort(m_files.get(), static_cast<size_t>(m_iFiles), sizeof(void*), iCompareFiles);
}

const InstalledList::Line* InstalledList::pFile(const char* szPath) const {
  int iLow = 0, iHigh = m_iFiles;  // the first line that sorts behind all of this path
  while (iLow < iHigh) {
    const int iMiddle = (iLow + iHigh) / 2;
    if (iOsCompareNoCase(m_files[iMiddle]->szText, szPath) > 0)
      iHigh = iMiddle;
    else
      iLow = iMiddle + 1;
  }
  return iLow && iOsCompareNoCase(m_files[iLow - 1]->szText, szPath) == 0 ? m_files[iLow - 1] : nullptr;
}

const char* InstalledList::szValue(const char* szKey) const {
  const size_t nKey = strlen(szKey);
  for (int i = m_iSize - 1; i >= 0; i--)
    if (m_lines[i].cKind == 'V' && strncmp(m_lines[i].szText, szKey, nKey) == 0 && m_lines[i].szText[nKey] == '=')
      return m_lines[i].szText + nKey + 1;
  return nullptr;
}

static bool bHasSum(const char* szPath, uint32_t sum) {
  OsFile file;
  std::unique_ptr<unsigned char[]> pBuffer(new (std::nothrow) unsigned char[64 * 1024]);
  if (!pBuffer || !file.bOpen(szPath, OsOpenMode::Read)) return false;
  uLong found = crc32(0, nullptr, 0);
  long lRead;
  while ((lRead = file.lRead(pBuffer.get(), 64 * 1024)) > 0)
    found = crc32(found, pBuffer.get(), static_cast<uInt>(lRead));
  return lRead == 0 && found == sum;
}

InstalledFileState CheckInstalledFile(const char* szPath, const InstalledList::Line& line) {
  OsFileInfo info;
  if (!bOsGetFileInfo(szPath, info)) return InstalledFileState::Gone;
  if (info.attributes & OS_DIRECTORY) return InstalledFileState::Changed;
  if (!line.bMarked) return InstalledFileState::Same;
  const ArchiveFileMark& mark = line.mark;
  if (info.size != mark.size) return InstalledFileState::Changed;
  const uint64_t time = info.times.lastWrite;
  const bool bSameTime = (time > mark.lastWrite ? time - mark.lastWrite : mark.lastWrite - time) <= TIME_STEP;
  const bool bSame = bSameTime || !mark.size || (mark.sum && bHasSum(szPath, mark.sum));
  return bSame ? InstalledFileState::Same : InstalledFileState::Changed;
}
