#include "Records.h"

#include <cstring>

#include "System.h"
#include "foundation/os/Os.h"

const char PROGRAMS_KEY[] = "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\";

CNString csJoined(const char* szA, const char* szB, const char* szC) {
  CNString csText(szA, 0);
  csText.Concat(szB);
  csText.Concat(szC);
  return csText;
}

bool bIsFile(const char* szPath) {
  OsFileInfo info;
  return bOsGetFileInfo(szPath, info) && !(info.attributes & OS_DIRECTORY);
}

bool bTakePart(const char*& szParts, CNString& csPart) {
  szParts += strspn(szParts, "; ");
  const size_t nLength = strcspn(szParts, ";");
  csPart.Copy(szParts, static_cast<long>(nLength));
  szParts += nLength;
  return nLength > 0;
}

bool bReadRegistryText(OsRegKey hRoot, const char* szKey, const char* szName, CNString& csText) {
  OsRegistryKey key;
  OsRegType type = OsRegType::None;
  char szText[2048] = "";
  long lSize = 0;
  if (!key.bOpen(hRoot, szKey, OsRegAccess::Read) || !key.bQuery(szName, type, szText, sizeof(szText) - 1, lSize))
    return false;
  csText = szText;
  return type == OsRegType::String || type == OsRegType::ExpandString;
}

bool Installation::bRead(const char* szFolder) {
  csFolder = szFolder;
  csFolder.AddSlash();
  m_bList = list.bRead(csJoined(csFolder.Text(), InstalledList::FILE_NAME).Text());
  const bool bLog = bReadLog();
  csInstalledTo = csValue("default_path");
  if (csInstalledTo.EndsWith("\\")) csInstalledTo.SetLength(csInstalledTo.Length() - 1);
  csProgramName = csValue("program_name");
  FindEntry();
  NoteUnknown(bLog);
  return m_bList || bLog || m_bEntry;
}

bool Installation::bReadLog() {
  OsFile file;
  static char szText[64 * 1024];
  const bool bOpen = file.bOpen(csJoined(csFolder.Text(), "Uninstall.log").Text(), OsOpenMode::Read);
  const long lRead = bOpen ? file.lRead(szText, sizeof(szText)) : -1;
  for (long i = 0; i < lRead; i++)
    if (!szText[i] || szText[i] == '\r') szText[i] = '\n';
  if (lRead > 0) m_csLog.Copy(szText, lRead);
  return lRead > 0;
}

// Two installations may bear the same name: ours is the one that starts the uninstaller of this folder.
void Installation::FindEntry() {
  CNString csCommand, csName;
  const auto bOurs = [&](const char* szName) {
    return bReadRegistryText(OS_HKEY_LOCAL_MACHINE, csJoined(PROGRAMS_KEY, szName).Text(), "UninstallString",
                             csCommand) &&
           bStartsUs(csCommand.Text());
  };
  m_bEntry = !csProgramName.bEmpty() && bOurs(csProgramName.Text());
  OsRegistryKey programs;
  if (!csProgramName.bEmpty() || !programs.bOpen(OS_HKEY_LOCAL_MACHINE, PROGRAMS_KEY, OsRegAccess::Read)) return;
  for (unsigned u = 0; !m_bEntry && programs.bEnumSubkey(u, csName); u++) {
    m_bEntry = bOurs(csName.Text());
    if (m_bEntry) csProgramName = csName;
  }
}

// An installation that broke off has no log yet, and no entry: its list says what the log would.
void Installation::NoteUnknown(bool bLog) {
  bool bStarted = !m_bList;  // a run that was killed before its first file has installed nothing
  for (int i = 0; i < list.Size(); i++) bStarted = bStarted || list[i].cKind != 'P';
  const bool bBrokeOff = !bLog && !m_bEntry && (!bStarted || list.szValue("program_name"));
  const bool bNames = m_csLog.Has("\nprogram_name=") || bBrokeOff;
  if (!bNames)
    csUnknown.Concat(
        "Uninstall.log is missing or damaged: it is not known what was registered besides the program itself.\n");
  if (!m_bList) csUnknown.Concat("Installed.lst is missing: it is not known which files were installed.\n");
  CNString csLines;
  csLines.Printf("NoteUnknown", "csLines", "Installed.lst is damaged: %d of its lines cannot be read.\n",
                 list.iBadLines());
  if (list.iBadLines()) csUnknown.Concat(csLines.Text());
}

CNString Installation::csValue(const char* szKey) const {
  const CNString csStart = csJoined("\n", szKey, "=");
  const char* szFound = strstr(m_csLog.Text(), csStart.Text());
  CNString csText;
  if (szFound) {
    szFound += csStart.Length();
    csText.Copy(szFound, static_cast<long>(strcspn(szFound, "\n")));
  }
  const char* szListed = list.szValue(szKey);
  if (csText.bEmpty() && szListed) csText = szListed;
  return csText;
}

CNString Installation::csValues(const char* szKey) const {
  CNString csAll = csValue(szKey);
  const size_t nKey = strlen(szKey);
  for (int i = 0; i < list.Size(); i++) {
    if (list[i].cKind != 'V' || strncmp(list[i].szText, szKey, nKey) != 0 || list[i].szText[nKey] != '=') continue;
    csAll.Concat(";");
    csAll.Concat(list[i].szText + nKey + 1);
  }
  return csAll;
}

bool Installation::bListed(const char* szPath) const {
  if (m_bList) return list.pFile(szPath) != nullptr;
  const CNString csPath(szPath, 0);
  return csPath.Length() > 4 && iOsCompareNoCase(csPath.Text() + csPath.Length() - 4, ".exe") == 0;
}

bool Installation::bLeadsHere(const char* szCommand) const {
  CNString csCommand(szCommand, 0);
  const CNString csThen = csJoined(csInstalledTo.Text(), "\\");
  csCommand.MakeLower();
  for (const CNString* pFolder : {static_cast<const CNString*>(&csFolder), &csThen}) {
    if (pFolder == &csThen && (csInstalledTo.bEmpty() || !bSameObject(csInstalledTo.Text(), csFolder.Text()))) continue;
    CNString csLower(pFolder->Text(), 0);
    csLower.MakeLower();
    if (csCommand.Has(csLower.Text())) return true;
  }
  return false;
}

// The command may spell the folder as it was given to setup or as it was given to us.
bool Installation::bStartsUs(const char* szCommand) const {
  CNString csOurs(csFolder.Text(), 0);
  csOurs.Trim('\\');
  const char* szThen = csInstalledTo.Text();
  const char* const spellings[] = {csOurs.Text(), szThen};
  for (const char* szSpelling : spellings) {
    const CNString csFull = csJoined(szSpelling, "\\UnInstall.exe ", szSpelling);
    if (iOsCompareNoCase(szCommand, csFull.Text()) != 0) continue;
    return szSpelling != szThen || bSameObject(szThen, csFolder.Text());
  }
  return false;
}
