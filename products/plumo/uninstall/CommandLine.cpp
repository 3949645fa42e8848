#include "CommandLine.h"

#include <cstdlib>
#include <cstring>

#include "foundation/os/Os.h"

const char SWITCHES_HELP[] =
    "UnInstall.exe [SWITCHES] FOLDER\n\n"
    "/S, /SILENT, /VERYSILENT, /quiet, /q, /passive\tremoves without asking\n"
    "/norestart\tis accepted: a restart is never needed\n"
    "/LOG=FILE\tadds to the file what is removed and what stays\n\n"
    "Exit codes: 0 all is gone, 1602 not wanted, 1603 something stays, 87 wrong switch.";

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
const char* const SILENT[] = {"S", "SILENT", "VERYSILENT", "quiet", "q", "passive"};

// In quotes, too, as some shells put it.
bool bIsSwitch(const char* szWord) { return szWord[*szWord == '"'] == '/' || szWord[*szWord == '"'] == '-'; }

// False when there is no such switch, or its value is missing.
bool bTakeSwitch(const char* szWord, Request& request) {
  const char* szName = szWord + 1;
  for (const char* szSilent : SILENT)
    if (iOsCompareNoCase(szName, szSilent) == 0) return request.bSilent = true;
  if (strcmp(szName, "?") == 0) return request.bHelp = true;
  if (iOsCompareNoCase(szName, "norestart") == 0) return true;  // nothing here ever restarts the system
  if (!bBegins(szName, "LOG=")) return false;
  request.csLog = szName + 4;
  return !request.csLog.bEmpty();
}

void TakeOrRefuse(const CNString& csWord, Request& request) {
  if (!bTakeSwitch(csWord.Text(), request) && request.csFault.bEmpty())
    request.csFault.Printf("ParseCommandLine", "csFault", "The switch %s is not known, or has no value.",
                           csWord.Text());
}

// Up to the blank outside quotes that ends the word.
size_t WordLength(const char* sz) {
  bool bQuoted = false;
  size_t n = 0;
  for (; sz[n] && (bQuoted || sz[n] != ' '); n++)
    if (sz[n] == '"') bQuoted = !bQuoted;
  return n;
}

// Without its quotes, wherever they are.
CNString csWordAt(const char* sz) {
  CNString csWord;
  csWord.Copy(sz, static_cast<long>(WordLength(sz)));
  csWord.SubstituteAll("csWordAt", "csWord", "\"", "");
  return csWord;
}

const char* NextWord(const char* sz) { return SkipBlanks(sz + WordLength(sz)); }

// Where the switches behind the folder begin: all words from there on are some.
const char* SwitchesBehind(const char* szFolder) {
  const char* szSwitches = nullptr;
  for (const char* sz = NextWord(szFolder); *sz; sz = NextWord(sz)) {
    Request ignored;
    const CNString csWord = csWordAt(sz);
    const bool bOne = *csWord.Text() == '/' || (*csWord.Text() == '-' && bTakeSwitch(csWord.Text(), ignored));
    szSwitches = !bOne ? nullptr : szSwitches ? szSwitches : sz;
  }
  return szSwitches ? szSwitches : szFolder + strlen(szFolder);
}

// Blanks included, whether or not it is quoted.
CNString FolderOf(const char* szBegin, const char* szEnd) {
  CNString csFolder;
  csFolder.Copy(szBegin, static_cast<long>(szEnd - szBegin));
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
  for (; bIsSwitch(sz); sz = NextWord(sz)) TakeOrRefuse(csWordAt(sz), request);
  const char* szBehind = SwitchesBehind(sz);
  request.csFolder = FolderOf(sz, szBehind);
  for (; *szBehind; szBehind = NextWord(szBehind)) TakeOrRefuse(csWordAt(szBehind), request);
  return request;
}
