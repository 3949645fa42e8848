#include "launcher/Switches.h"

#include <windows.h>
// after windows.h
#include <shellapi.h>

#include <cstring>
#include <cwchar>
#include <memory>
#include <new>

#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"

const char SWITCHES_HELP[] =
    "/S  /SILENT  /VERYSILENT  /quiet  /q\n      installs without any window\n"
    "/passive\n      asks nothing; only the copying is shown\n"
    "/norestart\n      does not offer to restart the computer\n"
    "/DIR=PATH\n      the folder to install into\n"
    "/D=PATH\n      the same, last on the line, without quotes\n"
    "/LOG=FILE\n      adds what is done and what fails to the file\n"
    "/SET NAME=VALUE\n      sets a variable of the installation script\n"
    "/ANSWERS=FILE\n      answers what you would be asked\n"
    "/SAVEANSWERS=FILE\n      saves your answers for such a run\n\n"
    "Exit codes of a run without windows: 0 done, 3010 restart needed, 1602 cancelled, 1603 failed, 1618 another "
    "setup runs, 1638 installed already, 112 no space, 87 wrong switch.";

namespace {

using WideText = std::unique_ptr<wchar_t[]>;

struct ArgumentsDeleter {
  void operator()(wchar_t** pArguments) const { LocalFree(pArguments); }
};

void Fault(Switches& out, const char* szFormat, const char* szSwitch) {
  if (out.csFault.bEmpty()) out.csFault.Printf("ReadSwitches", "csFault", szFormat, szSwitch);
}

// A file or folder that need not be there yet. One whose name code page 1250 cannot hold is reached through the short
// name of its folder, when its own name is not the trouble.
bool bFullPath(const wchar_t* pPath, CNString& csPath) {
  const DWORD dwSize = *pPath ? GetFullPathNameW(pPath, 0, nullptr, nullptr) : 0;
  const WideText pFull(dwSize ? new (std::nothrow) wchar_t[dwSize] : nullptr);
  if (!pFull || GetFullPathNameW(pPath, dwSize, pFull.get(), nullptr) >= dwSize) return false;
  if (bNarrow(pFull.get(), csPath)) return true;
  wchar_t* pName = wcsrchr(pFull.get(), L'\\');
  CNString csName;
  if (!pName || !bNarrow(pName + 1, csName)) return false;
  pName[0] = L'\0';
  if (!bNarrowPath(pFull.get(), csPath)) return false;
  csPath.AddSlash();
  csPath.Concat(csName.Text());
  return true;
}

// Takes a path for a member that is still empty or holds the same.
void TakePath(Switches& out, CNString Switches::*pMember, const char* szName, const wchar_t* pValue) {
  CNString csPath, &csMember = out.*pMember;
  if (!*pValue) return Fault(out, "The switch %s needs a value.", szName);
  if (!bFullPath(pValue, csPath)) return Fault(out, "The path of the switch %s cannot be used.", szName);
  if (!csMember.bEmpty() && !csMember.IsEqual(csPath.Text()))
    return Fault(out, "The switch %s contradicts an earlier one.", szName);
  csMember = csPath;
}

struct Row {
  const char* szName;
  RunMode mode;               // Attended: the switch says nothing about it
  bool Switches::*pFlag;      // or null
  CNString Switches::*pPath;  // not null: the switch takes a path
};

const Row ROWS[] = {
    {"S", RunMode::Silent, nullptr, nullptr},
    {"SILENT", RunMode::Silent, nullptr, nullptr},
    {"VERYSILENT", RunMode::Silent, nullptr, nullptr},
    {"quiet", RunMode::Silent, nullptr, nullptr},
    {"q", RunMode::Silent, nullptr, nullptr},
    {"passive", RunMode::Passive, nullptr, nullptr},
    {"norestart", RunMode::Attended, &Switches::bNoRestart, nullptr},
    {"?", RunMode::Attended, &Switches::bHelp, nullptr},
    {"DIR", RunMode::Attended, nullptr, &Switches::csFolder},
    {"D", RunMode::Attended, nullptr, &Switches::csFolder},
    {"LOG", RunMode::Attended, nullptr, &Switches::csLog},
    {"ANSWERS", RunMode::Attended, nullptr, &Switches::csAnswers},
    {"SAVEANSWERS", RunMode::Attended, nullptr, &Switches::csSaveAnswers},
};

void TakeRow(Switches& out, const Row& row, const char* szArgument, const wchar_t* pValue) {
  if (row.pPath) return TakePath(out, row.pPath, szArgument, pValue ? pValue : L"");
  if (pValue) return Fault(out, "The switch %s takes no value.", szArgument);
  if (row.pFlag) out.*row.pFlag = true;
  if (row.mode == RunMode::Attended) return;
  if (out.bUnattended() && out.mode != row.mode)
    return Fault(out, "The switch %s contradicts an earlier one.", szArgument);
  out.mode = row.mode;
}

void TakeVariable(Switches& out, const wchar_t* pArgument) {
  CNString csText;
  const bool bWhole = bNarrow(pArgument, csText);
  const char* pEquals = strchr(csText.Text(), '=');
  if (!bWhole || !pEquals || pEquals == csText.Text())
    return Fault(out, "The switch /SET needs NAME=VALUE, not \"%s\".", csText.Text());
  auto* pVariable = new SetVariable;
  pVariable->csName.Copy(csText.Text(), static_cast<long>(pEquals - csText.Text()));
  pVariable->csValue = pEquals + 1;
  out.variables.Add(pVariable, 1);
}

// One argument, without the next one that /SET takes.
void TakeArgument(Switches& out, const wchar_t* pArgument) {
  CNString csArgument, csName;
  bNarrow(pArgument, csArgument);
  const char* szArgument = csArgument.Text();
  if (*szArgument != '/' && *szArgument != '-') return Fault(out, "\"%s\" is not a switch.", szArgument);
  csName.Copy(szArgument + 1, static_cast<long>(strcspn(szArgument + 1, "=")));
  const wchar_t* pEquals = wcschr(pArgument, L'=');
  if (pEquals) csArgument.SetLength(csName.Length() + 1);
  for (const Row& row : ROWS)
    if (iOsCompareNoCase(csName.Text(), row.szName) == 0)  // the system's own knows I from i in some languages
      return TakeRow(out, row, csArgument.Text(), pEquals ? pEquals + 1 : nullptr);
  if (iOsCompareNoCase(csName.Text(), "SET") == 0)
    return Fault(out, "The switch %s needs a blank and NAME=VALUE behind it.", csArgument.Text());
  Fault(out, "The switch %s is not known.", szArgument);
}

bool bIsSet(const wchar_t* pArgument) {
  return (*pArgument == L'/' || *pArgument == L'-') && _wcsicmp(pArgument + 1, L"SET") == 0;
}

bool bIsBlankOrEnd(wchar_t c) { return !c || c == L' ' || c == L'\t'; }

// True for a quote that a backslash makes a part of the text: an odd number of them is in front of it.
bool bIsEscaped(const wchar_t* pLine, const wchar_t* pQuote) {
  const wchar_t* p = pQuote;
  while (p > pLine && p[-1] == L'\\') p--;
  return (pQuote - p) % 2 != 0;
}

// Copies the line. The system's splitting would take the last quote of /DIR="C:\a b\" for a part of the path, and the
// switches behind it too: a backslash in front of a quote that ends a word is doubled, unless it closes a text's own.
void CopyLine(const wchar_t* pLine, wchar_t* pOut) {
  bool bQuoted = false, bOwn = false;
  for (const wchar_t* p = pLine; *p; p++) {
    const bool bQuote = *p == L'"', bEscaped = bQuote && bIsEscaped(pLine, p);
    const bool bEnds = bEscaped && bQuoted && !bOwn && bIsBlankOrEnd(p[1]);
    if (bEnds) *pOut++ = L'\\';
    if (bQuote && (!bEscaped || bEnds))
      bQuoted = !bQuoted;
    else if (bQuote)
      bOwn = !bOwn;
    *pOut++ = *p;
  }
  *pOut = L'\0';
}

// The place of "/D=" at the beginning of an argument and outside quotes: what follows is one path. Null without.
wchar_t* pFolderToEnd(wchar_t* pLine) {
  bool bQuoted = false;
  for (wchar_t* p = pLine; *p; p++) {
    const bool bBegins = p == pLine || bIsBlankOrEnd(p[-1]);
    if (!bQuoted && bBegins && (*p == L'/' || *p == L'-') && (p[1] | 0x20) == L'd' && p[2] == L'=') return p;
    if (*p == L'"' && !bIsEscaped(pLine, p)) bQuoted = !bQuoted;
  }
  return nullptr;
}

void TakeFolderToEnd(Switches& out, wchar_t* pPath) {
  for (int i = lstrlenW(pPath); i > 0 && bIsBlankOrEnd(pPath[i - 1]); i--) pPath[i - 1] = L'\0';
  const int iLast = lstrlenW(pPath) - 1;
  const bool bQuoted = iLast > 0 && pPath[0] == L'"' && pPath[iLast] == L'"';  // by mistake, but clear
  if (bQuoted) pPath[iLast] = L'\0';
  TakePath(out, &Switches::csFolder, "/D", pPath + bQuoted);
}

void CheckTogether(Switches& out) {
  if (!out.csAnswers.bEmpty() && !out.bUnattended())
    Fault(out, "The switch %s needs /S or /passive beside it.", "/ANSWERS");
  if (!out.csSaveAnswers.bEmpty() && out.bUnattended())
    Fault(out, "The switch %s is for a run with windows.", "/SAVEANSWERS");
}

}  // namespace

bool Switches::bSets(const char* szVariable) const {
  for (int i = 0; i < variables.Size(); i++)
    if (variables[i]->csName.IsEqual(szVariable)) return true;
  return !csFolder.bEmpty() && strcmp(szVariable, "default_path") == 0;
}

void ReadSwitches(const wchar_t* pLine, Switches& out) {
  // The system's splitting treats the first argument, the program's name, by rules of its own.
  const int iSize = 2 * lstrlenW(pLine) + 3;
  const WideText pCopy(new (std::nothrow) wchar_t[static_cast<size_t>(iSize)]);
  if (!pCopy) return Fault(out, "There is no memory for the switches.%s", "");
  lstrcpyW(pCopy.get(), L"x ");
  CopyLine(pLine, pCopy.get() + 2);
  wchar_t* pToEnd = pFolderToEnd(pCopy.get() + 2);
  if (pToEnd) *pToEnd = L'\0';
  int nArguments = 0;
  const std::unique_ptr<wchar_t*[], ArgumentsDeleter> pArguments(CommandLineToArgvW(pCopy.get(), &nArguments));
  for (int i = 1; pArguments && i < nArguments; i++) {
    if (!bIsSet(pArguments[i]))
      TakeArgument(out, pArguments[i]);
    else
      TakeVariable(out, ++i < nArguments ? pArguments[i] : L"");
  }
  if (pToEnd) TakeFolderToEnd(out, pToEnd + 3);
  CheckTogether(out);
}
