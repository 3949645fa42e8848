#include "CommandLine.h"

#include <cstdlib>
#include <cstring>

#include "foundation/os/Os.h"

namespace {

bool bBegins(const char* sz, const char* szHead) {
  CNString csHead;
  csHead.Copy(sz, static_cast<long>(strnlen(sz, strlen(szHead))));
  return iOsCompareNoCase(csHead.Text(), szHead) == 0;
}

const char* SkipBlanks(const char* sz) {
  while (*sz == ' ' || *sz == '\t') sz++;
  return sz;
}

// The entry among the installed programs starts us without quotes, blanks in the path or not: without a quote the
// program's name ends where our own path does, else at its ".exe".
const char* SkipProgram(const char* sz, const char* szOwnPath) {
  if (*sz == '"') {
    const char* pEnd = strchr(sz + 1, '"');
    return SkipBlanks(pEnd ? pEnd + 1 : sz + strlen(sz));
  }
  if (*szOwnPath && bBegins(sz, szOwnPath)) return SkipBlanks(sz + strlen(szOwnPath));
  for (const char* p = strchr(sz, '.'); p; p = strchr(p + 1, '.')) {
    if (bBegins(p, ".exe") && (p[4] == ' ' || p[4] == '\0')) return SkipBlanks(p + 4);
  }
  return SkipBlanks(sz + strcspn(sz, " "));
}

// Takes one word, quoted or not, off the front.
CNString TakeWord(const char*& sz) {
  bool bQuoted = *sz == '"';
  if (bQuoted) sz++;
  size_t nLength = strcspn(sz, bQuoted ? "\"" : " ");
  CNString csWord;
  csWord.Copy(sz, static_cast<long>(nLength));
  sz += nLength;
  if (bQuoted && *sz) sz++;
  sz = SkipBlanks(sz);
  return csWord;
}

// What installers of several makers call the same.
const char* const SILENT[] = {"/S", "/SILENT", "/VERYSILENT", "/quiet"};

// Takes one such switch off the front.
bool bTakeSilentFront(const char*& sz) {
  for (const char* szSwitch : SILENT) {
    const size_t nLength = strlen(szSwitch);
    if (!bBegins(sz, szSwitch) || (sz[nLength] != ' ' && sz[nLength] != '\0')) continue;
    sz = SkipBlanks(sz + nLength);
    return true;
  }
  return false;
}

// And one off the end, behind the folder.
bool bTakeSilentEnd(CNString& csRest) {
  for (const char* szSwitch : SILENT) {
    const long lLength = csRest.Length() - static_cast<long>(strlen(szSwitch));
    if (lLength < 1 || csRest.Text()[lLength - 1] != ' ' || iOsCompareNoCase(csRest.Text() + lLength, szSwitch) != 0)
      continue;
    csRest.SetLength(lLength - 1);
    return true;
  }
  return false;
}

// What is left of the line is the folder, blanks included, whether or not it is quoted.
CNString FolderOf(const char* szRest) {
  CNString csFolder(szRest, 0);
  while (csFolder.Length() && strchr(" \"\\", csFolder.Text()[csFolder.Length() - 1]))
    csFolder.SetLength(csFolder.Length() - 1);
  CNString csUnquoted(csFolder.Text()[0] == '"' ? csFolder.Text() + 1 : csFolder.Text(), 0);
  return csUnquoted;
}

}  // namespace

Request ParseCommandLine(const char* szLine, const char* szOwnPath) {
  Request request;
  const char* sz = SkipProgram(szLine, szOwnPath);
  if (strncmp(sz, "/2 ", 3) == 0) {
    sz = SkipBlanks(sz + 3);
    request.bSecondStep = true;
    request.ulFirstProcess = strtoul(TakeWord(sz).Text(), nullptr, 10);
    request.csProgram = TakeWord(sz);
  }
  while (bTakeSilentFront(sz)) request.bSilent = true;
  CNString csRest(sz, 0);
  while (bTakeSilentEnd(csRest)) request.bSilent = true;
  request.csFolder = FolderOf(csRest.Text());
  return request;
}
