#include "Traces.h"

#include <windows.h>
// after windows.h
#include <mstask.h>

#include <cstring>

#include "System.h"
#include "archive/PathGuard.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "installer/ComPointer.h"

namespace {

OsRegKey const CLASSES = OS_HKEY_CLASSES_ROOT;
// Under names of their own: the import library's unit with all of the system's identifiers is large.
const GUID SCHEDULER_CLASS = {0x148BD52A, 0xA2AB, 0x11CE, {0xB1, 0x1F, 0x00, 0xAA, 0x00, 0x53, 0x05, 0x03}};
const GUID SCHEDULER_INTERFACE = {0x148BD527, 0xA2AB, 0x11CE, {0xB1, 0x1F, 0x00, 0xAA, 0x00, 0x53, 0x05, 0x03}};
const char FONTS_KEY[] = "Software\\Microsoft\\Windows NT\\CurrentVersion\\Fonts";

struct Work {
  const Installation& installation;
  CNString& csFailures;

  void Report(const char* szWhat) const { csFailures.Concat(csJoined(szWhat, "\n").Text()); }
};

bool bKeyExists(const char* szKey) { return OsRegistryKey().bOpen(CLASSES, szKey, OsRegAccess::Read); }

bool bKeyIsEmpty(OsRegKey hRoot, const char* szKey) {
  OsRegistryKey key;
  CNString csAny;
  return key.bOpen(hRoot, szKey, OsRegAccess::Read) && !key.bEnumValue(0, csAny) && !key.bEnumSubkey(0, csAny);
}

bool bDeleteTree(const char* szKey) {
  CNString csName;
  for (;;) {
    OsRegistryKey key;
    if (!key.bOpen(CLASSES, szKey, OsRegAccess::Read) || !key.bEnumSubkey(0, csName)) break;
    key.Close();
    if (!bDeleteTree(csJoined(szKey, "\\", csName.Text()).Text())) return false;
  }
  return bOsDeleteRegistryKey(CLASSES, szKey);
}

// A key whose command (szCommand below it) leads here, or that a broken installation left without one. The latter is
// deleted step by step, never with anything below it that is not known.
void RemoveClass(const Work& work, const char* szKey, const char* const* pSteps, int iSteps) {
  CNString csCommand;
  if (!bKeyExists(szKey)) return;
  const bool bCommand = bReadRegistryText(CLASSES, csJoined(szKey, pSteps[0]).Text(), "", csCommand);
  if (bCommand && !work.installation.bLeadsHere(csCommand.Text())) return;  // somebody else's by now
  if (bCommand && bDeleteTree(szKey)) return;
  for (int i = 0; !bCommand && i < iSteps; i++) bOsDeleteRegistryKey(CLASSES, csJoined(szKey, pSteps[i]).Text());
  if (!bCommand) bOsDeleteRegistryKey(CLASSES, szKey);
  if (bKeyExists(szKey)) work.Report(szKey);
}

// The "shell" key above goes too when that was all it held.
void RemoveMenuKey(const Work& work, const char* szKey) {
  static const char* const STEPS[] = {"\\command"};
  CNString csShell(szKey, 0);
  csShell.Trim('\\');
  RemoveClass(work, szKey, STEPS, 1);
  if (bKeyIsEmpty(CLASSES, csShell.Text())) bOsDeleteRegistryKey(CLASSES, csShell.Text());
}

// The record holds the key below HKEY_CLASSES_ROOT, or only its name there.
void RemoveContextMenu(const Work& work, const char* szEntry) {
  static const char* const PLACES[] = {"*\\shell\\", "Directory\\shell\\", "Folder\\shell\\"};
  for (const char* szRoot : {"HKEY_CLASSES_ROOT\\", "HKCR\\"})
    if (strncmp(szEntry, szRoot, strlen(szRoot)) == 0) szEntry += strlen(szRoot);
  CNString csLower(szEntry, 0);
  csLower.MakeLower();
  const char* szShell = strstr(csLower.Text(), "\\shell\\");
  if (szShell && szShell[7] && !strchr(szShell + 7, '\\')) return RemoveMenuKey(work, szEntry);
  for (const char* szPlace : PLACES)
    if (!strchr(szEntry, '\\')) RemoveMenuKey(work, csJoined(szPlace, szEntry).Text());
}

// Takes a type off one extension; true when the extension's key is gone with it.
bool bRemoveFromExtension(const char* szExtension, const char* szType) {
  CNString csType, csAny;
  const CNString csOpenWith = csJoined(szExtension, "\\OpenWithProgids");
  OsRegistryKey openWith;
  if (openWith.bOpen(CLASSES, csOpenWith.Text(), OsRegAccess::Full)) {
    openWith.bDeleteValue(szType);
    const bool bEmpty = !openWith.bEnumValue(0, csAny) && !openWith.bEnumSubkey(0, csAny);
    openWith.Close();
    if (bEmpty) bOsDeleteRegistryKey(CLASSES, csOpenWith.Text());
  }
  if (!bReadRegistryText(CLASSES, szExtension, "", csType) || iOsCompareNoCase(csType.Text(), szType) != 0)
    return false;
  OsRegistryKey key;
  if (!key.bOpen(CLASSES, szExtension, OsRegAccess::Full)) return false;
  key.bDeleteValue("");
  const bool bEmpty = !key.bEnumValue(0, csAny) && !key.bEnumSubkey(0, csAny);
  key.Close();
  return bEmpty && bOsDeleteRegistryKey(CLASSES, szExtension);
}

void RemoveFileType(const Work& work, const char* szType) {
  static const char* const STEPS[] = {"\\shell\\open\\command", "\\shell\\open", "\\shell", "\\DefaultIcon"};
  if (strchr(szType, '\\') || szType[0] == '.' || szType[0] == '*') return work.Report(szType);
  CNString csCommand, csName;
  const bool bThere = bReadRegistryText(CLASSES, csJoined(szType, STEPS[0]).Text(), "", csCommand);
  if (bThere && !work.installation.bLeadsHere(csCommand.Text())) return;
  OsRegistryKey classes;
  if (classes.bOpen(CLASSES, "", OsRegAccess::Read))
    for (unsigned u = 0; classes.bEnumSubkey(u, csName); u++)
      if (csName.Text()[0] == '.' && bRemoveFromExtension(csName.Text(), szType)) u--;
  RemoveClass(work, szType, STEPS, 4);
}

// The value that names the file, for it and no other.
void RemoveFontValue(const char* szFile) {
  OsRegistryKey fonts;
  CNString csName, csText;
  if (!fonts.bOpen(OS_HKEY_LOCAL_MACHINE, FONTS_KEY, OsRegAccess::Full)) return;
  for (unsigned u = 0; fonts.bEnumValue(u, csName); u++)
    if (bReadRegistryText(OS_HKEY_LOCAL_MACHINE, FONTS_KEY, csName.Text(), csText) &&
        iOsCompareNoCase(csText.Text(), szFile) == 0 && fonts.bDeleteValue(csName.Text()))
      u--;
}

// Ours is a copy of the file in the destination.
void RemoveFont(const Work& work, const char* szFile) {
  CNString csName, csFonts;
  if (!bMakeSafePath(szFile, csName) || strchr(csName.Text(), '\\') || !bFontsFolder(csFonts))
    return work.Report(szFile);
  const CNString csPath = csJoined(csFonts.Text(), csName.Text());
  const CNString csSource = csJoined(work.installation.csFolder.Text(), csName.Text());
  if (!bIsFile(csPath.Text())) return RemoveFontValue(csName.Text());
  if (bIsFile(csSource.Text()) && !bBeginsWith(csSource.Text(), csPath.Text())) return;  // another version
  while (RemoveFontResourceW(Wide(csPath.Text()))) continue;
  RemoveFontValue(csName.Text());
  bOsSetAttributes(csPath.Text(), OS_NORMAL);
  if (!bOsDeleteFile(csPath.Text()) && !bDeleteAtRestart(csPath.Text())) work.Report(csPath.Text());
  SendNotifyMessageW(HWND_BROADCAST, WM_FONTCHANGE, 0, 0);
}

void RemoveTask(const Work& work, const char* szName) {
  const ComApartment com;
  ComPointer<ITaskScheduler> scheduler;
  const HRESULT made =
      CoCreateInstance(SCHEDULER_CLASS, nullptr, CLSCTX_INPROC_SERVER, SCHEDULER_INTERFACE, scheduler.Receive());
  const HRESULT result = FAILED(made) ? made : scheduler->Delete(Wide(szName));
  if (FAILED(result) && result != HRESULT_FROM_WIN32(ERROR_FILE_NOT_FOUND))
    work.Report(csJoined("Scheduled task ", szName).Text());
}

// A share that is out of reach may still hold it.
void RemoveNetLink(const Work& work, const char* szPath) {
  CNString csShare(szPath, 0);
  csShare.Trim('\\');
  if (!bIsFile(szPath)) {
    if (!bOsIsFolder(csShare.Text())) work.Report(szPath);
    return;
  }
  RemoveLink(szPath, work.installation, work.csFailures);
}

// True for a settings file with nothing but the section's name, in one byte or two for each character.
bool bHoldsNothing(const char* szPath) {
  OsFile file;
  char szBytes[64] = {}, szText[64] = {};
  const long lRead = file.bOpen(szPath, OsOpenMode::Read) ? file.lRead(szBytes, sizeof(szBytes)) : -1;
  int iText = 0;
  for (long i = 0; i < lRead; i++)
    if (szBytes[i] > ' ') szText[iText++] = szBytes[i];
  return lRead >= 0 && lRead < 40 && (!iText || iOsCompareNoCase(szText, "[General]") == 0);
}

// Setup wrote these two keys; what else is in the file is the program's.
void RemoveKvIni(const Work& work, const char*) {
  const CNString csPath = csJoined(work.installation.csFolder.Text(), "kv.ini");
  if (!bIsFile(csPath.Text()) || !bNoLinkOnPath(work.installation.csFolder.Text(), "kv.ini")) return;
  for (const wchar_t* pKey : {L"SpeechPath", L"InterfaceLanguage"})
    WritePrivateProfileStringW(L"General", pKey, nullptr, Wide(csPath.Text()));
  WritePrivateProfileStringW(nullptr, nullptr, nullptr, Wide(csPath.Text()));
  const bool bBare = bHoldsNothing(csPath.Text());
  // One that came with the product is no longer as it was installed because setup itself changed it.
  if ((bBare || work.installation.list.pFile("kv.ini")) && !bOsDeleteFile(csPath.Text())) work.Report(csPath.Text());
}

// The values that setup writes there; the key goes when nothing else is in it, and so do those above it.
void RemoveProductKey(const Work& work, const char* szKey) {
  static const char SOFTWARE[] = "software\\";
  CNString csDir, csKey(szKey, 0), csHead;
  csHead.Copy(szKey, static_cast<long>(strnlen(szKey, sizeof(SOFTWARE) - 1)));
  if (iOsCompareNoCase(csHead.Text(), SOFTWARE) != 0) return work.Report(szKey);
  const bool bDir = bReadRegistryText(OS_HKEY_LOCAL_MACHINE, szKey, "Dir", csDir);
  if (bDir && !work.installation.bLeadsHere(csDir.Text())) return;  // another installation's by now
  {
    OsRegistryKey key;
    if (!key.bOpen(OS_HKEY_LOCAL_MACHINE, szKey, OsRegAccess::Full)) return;
    for (const char* szValue : {"Dir", "DictDir", "DictPath", "Mode"}) key.bDeleteValue(szValue);
  }
  while (csKey.Has('\\') && bKeyIsEmpty(OS_HKEY_LOCAL_MACHINE, csKey.Text()) &&
         bOsDeleteRegistryKey(OS_HKEY_LOCAL_MACHINE, csKey.Text()))
    csKey.Trim('\\');
}

// Folders for shortcuts that setup had to make in the user's own; after the shortcuts, and only when they are empty.
void RemoveMadeFolder(const Work& work, const char* szFolder) {
  CNString csOwn, csHead;
  if (!bUserDataFolder(csOwn)) return;
  csHead.Copy(szFolder, static_cast<long>(strnlen(szFolder, static_cast<size_t>(csOwn.Length()))));
  const bool bBelow = iOsCompareNoCase(csHead.Text(), csOwn.Text()) == 0;
  if (bBelow && bMakeSafePath(szFolder + csOwn.Length(), csHead)) bOsDeleteFolder(szFolder);
  if (!bBelow) work.Report(szFolder);
}

}  // namespace

void RemoveMadeFolders(const Installation& installation, CNString& csFailures) {
  const CNString csParts = installation.csValues("made_folders");
  const char* szParts = csParts.Text();
  for (CNString csPart; bTakePart(szParts, csPart);) RemoveMadeFolder({installation, csFailures}, csPart.Text());
}

void RemoveTraces(const Installation& installation, CNString& csFailures) {
  static const struct {
    const char* szKey;
    void (*pRemove)(const Work& work, const char* szPart);
  } KINDS[] = {
      {"context_menu", RemoveContextMenu}, {"file_types", RemoveFileType}, {"fonts", RemoveFont},
      {"scheduled_task", RemoveTask},      {"net_links", RemoveNetLink},   {"kv_ini", RemoveKvIni},
      {"registry_key", RemoveProductKey},
  };
  const Work work = {installation, csFailures};
  for (const auto& kind : KINDS) {
    const CNString csParts = installation.csValues(kind.szKey);
    const char* szParts = csParts.Text();
    for (CNString csPart; bTakePart(szParts, csPart);) kind.pRemove(work, csPart.Text());
  }
}
