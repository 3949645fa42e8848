// Where the product goes: the default folder, the folder check behind the destination page's Next, Browse.
#include <cstring>

#include "foundation/os/Os.h"
#include "installer/CNInstallWizard.h"

static const long MAX_DESTINATION = 260;

// ---- paths ----

// Cuts one trailing backslash.
static void CutSlash(CNString& csPath) {
  if (csPath.EndsWith("\\")) csPath.SetLength(csPath.Length() - 1);
}

static bool bHasDrive(const char* szPath) {
  const char c = static_cast<char>(szPath[0] | 0x20);
  return c >= 'a' && c <= 'z' && szPath[1] == ':' && (!szPath[2] || szPath[2] == '\\');
}

// Length of "C:\" or "\\server\share\" at the start of szPath (without the last backslash when the path ends there); 0
// for a path that is not absolute.
static long lRootLength(const char* szPath) {
  if (bHasDrive(szPath)) return szPath[2] ? 3 : 2;
  if (strncmp(szPath, "\\\\", 2) != 0) return 0;
  const char* pShare = strchr(szPath + 2, '\\');
  if (!pShare || pShare == szPath + 2 || !pShare[1] || pShare[1] == '\\') return 0;
  const char* pRest = strchr(pShare + 1, '\\');
  return static_cast<long>(pRest ? pRest + 1 - szPath : strlen(szPath));
}

// The text whose free space is asked for, always with its trailing backslash.
static void GetRoot(const char* szPath, CNString& csRoot) {
  csRoot.Copy(szPath, lRootLength(szPath));
  csRoot.AddSlash();
}

// Makes every missing folder of an absolute path, top down, and adds what it made to pMade (may be null). When that
// fails csReason is the system's explanation.
static bool bMakeFolders(const char* szPath, CNString& csReason, CNStringArray* pMade = nullptr) {
  CNString csFolder;
  const char* pEnd = szPath + lRootLength(szPath);
  do {
    pEnd += strcspn(pEnd, "\\");
    csFolder.Copy(szPath, static_cast<long>(pEnd - szPath));
    const OsMakeFolderResult result = OsMakeFolder(csFolder.Text());
    const unsigned uError = OsLastError();
    if (result == OsMakeFolderResult::Made && pMade) pMade->Add(csFolder.Text(), 1);
    if (result != OsMakeFolderResult::Made && !bOsIsFolder(csFolder.Text())) {
      OsErrorText(uError, csReason);
      return false;
    }
    while (*pEnd == '\\') pEnd++;
  } while (*pEnd);
  return true;
}

int CNInstallWizard::iCreateDirectory(const char* szPath) {
  if (!szPath)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNInstallWizard::iCreateDirectory -> !szPath -> return PRECONDITIONS_NOT_VALID");
  if (!*szPath)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNInstallWizard::iCreateDirectory -> !*szPath -> return PRECONDITIONS_NOT_VALID");
  CNString csReason;
  if (!bMakeFolders(szPath, csReason))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCreateDirectory -> !bMakeFolders(%s, %s) -> return "
                      "FUNCTION_ERROR",
                      szPath, csReason.Text());
  return EVERYTHING_IS_OK;
}

// A person who leaves after all, or chooses another destination, finds no empty folder afterwards.
void CNInstallWizard::RemoveUnusedFolders() {
  for (int i = m_MadeFolders.Size() - 1; i >= 0; i--) {
    RemoveUnusedJournal(m_MadeFolders[i]->Text());
    bOsDeleteFolder(m_MadeFolders[i]->Text());
  }
  m_MadeFolders.RemoveAll();
  bOsDeleteFile(csFoldersFile().Text());
}

// ---- free space ----

static uint64_t FileSize(const char* szFile) {
  OsFile file;
  const int64_t size = file.bOpen(szFile, OsOpenMode::Read) ? file.Size() : 0;
  return size > 0 ? static_cast<uint64_t>(size) : 0;
}

bool CNInstallWizard::bGetFreeSpace(const char* szDrive, uint64_t& bytes) { return bOsGetFreeSpace(szDrive, bytes); }

bool CNInstallWizard::bCheckForDiskSpace(bool bOwned, const char* szDrive, const char* szFile, int iMode) {
  if (!szDrive || !*szDrive)
    return iLogReturn(0, "ERROR: CNInstallWizard::bCheckForDiskSpace -> !szDrive || !*szDrive -> return FALSE");
  if (!szFile || !*szFile)
    return iLogReturn(0, "ERROR: CNInstallWizard::bCheckForDiskSpace -> !szFile || !*szFile -> return FALSE");
  uint64_t freeBytes = 0;
  const uint64_t size = FileSize(szFile);
  // A drive that cannot be asked is not called full: what is wrong with it shows when its folder is made.
  if (!bGetFreeSpace(szDrive, freeBytes) || bEnoughSpace(freeBytes, size)) return true;
  if (iMode != SPACE_ON_TEMP_DRIVE && iMode != SPACE_ON_DESTINATION) return true;
  CNString csText, csDrive;
  csDrive.Copy(szDrive, static_cast<long>(strcspn(szDrive, ":")));
  Tell(InstallEvent::NoSpace, szDrive);
  csText.Printf("CNInstallWizard::bCheckForDiskSpace", "csText", "%s%s%s%li%s", szValue("no_space1"), csDrive.Text(),
                szValue("no_space2"), lSpaceToFree(size, iMode), szValue("no_space3"));
  m_View.iShowMessage({csText.Text(), szValue("msgbox_capt"), MessageIcon::Error, MessageButtons::Ok, bOwned});
  return false;
}

// ---- making the folder ----

// Tells the user and logs; to be followed by a return that keeps the page.
void CNInstallWizard::ShowFolderFault(const char* szFolder, const char* szReason) {
  CNString csText;
  LogPrintf("ERROR: CNInstallWizard::ShowFolderFault -> %s -> %s", szFolder, szReason);
  csText.Printf("CNInstallWizard::ShowFolderFault", "csText", "The directory:\n\n'%s'\n\ncannot be used: %s", szFolder,
                szReason);
  m_View.iShowMessage({csText.Text(), szValue("msgbox_capt"), MessageIcon::Error});
}

bool CNInstallWizard::bAskCreate(const char* szFolder) {
  CNString csText;
  csText.Printf("CNInstallWizard::bAskCreate", "csText", "%s%s%s", szValue("create_dir1"), szFolder,
                szValue("create_dir2"));
  return m_View.iShowMessage({csText.Text(), szValue("msgbox_capt"), MessageIcon::Question, MessageButtons::YesNo}) ==
         ANSWER_YES;
}

// Makes sure that the folder is there and can be written to; false after the user has said No or has been told why not.
bool CNInstallWizard::bMakeDestination(const char* szFolder) {
  CNString csProbeFolder(szFolder, 0), csProbe, csReason;
  if (bOsIsFolder(szFolder)) {
    csProbeFolder.AddSlash();  // "C:" alone would be that drive's current folder
    if (bOsMakeTempFile(csProbeFolder.Text(), "@", csProbe) && bOsDeleteFile(csProbe.Text())) return true;
    OsErrorText(OsLastError(), csReason);
  } else {
    // A file of that name needs no question: it is in the way.
    if (!bOsExists(szFolder) && !bAskCreate(szFolder)) return false;
    AnnounceFolders(szFolder);
    if (bMakeFolders(szFolder, csReason, &m_MadeFolders)) return NoteMadeFolders(szFolder), true;
  }
  ShowFolderFault(szFolder, csReason.Text());
  return false;
}

// ---- commands ----

int CNInstallWizard::iInitDefaultPath(const char* /*szParam*/, int* pCommandResult) {
  char szPrograms[512] = "";
  CNString csPath;
  if (m_bDefaultPathInitialised) {
    *pCommandResult = COMMAND_DONE;
    return EVERYTHING_IS_OK;
  }
  if (!*szValue("default_path"))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iInitDefaultPath -> !default_path -> return FUNCTION_ERROR");
  if (iReadRegistryKey(OS_HKEY_LOCAL_MACHINE, "SOFTWARE\\Microsoft\\Windows\\CurrentVersion", "ProgramFilesDir",
                       szPrograms) != EVERYTHING_IS_OK)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iInitDefaultPath -> iReadRegistryKey -> return FUNCTION_ERROR");
  csPath.Printf("CNInstallWizard::iInitDefaultPath", "csPath", "%s\\%s", szPrograms, szValue("default_path"));
  m_bDefaultPathInitialised = true;
  *pCommandResult = COMMAND_DONE;
  return iSetField("default_path", csPath.Text());
}

int CNInstallWizard::iParseDefaultPath(const char* /*szParam*/, int* pCommandResult) {
  CNString csPath;
  csGetField("default_path", csPath);
  *pCommandResult = COMMAND_DONE;
  // A drive's root keeps its backslash: without it the path would mean the drive's current folder.
  const bool bDriveRoot = csPath.Length() == 3 && bHasDrive(csPath.Text());
  if (csPath.Length() <= 2 || bDriveRoot || !csPath.EndsWith("\\")) return EVERYTHING_IS_OK;
  CutSlash(csPath);
  return iSetField("default_path", csPath.Text());
}

// Deliberately works on the field as it is on the screen: fields are saved only after this command has said "go on".
int CNInstallWizard::iCheckForFolder(const char* szParam, int* pCommandResult) {
  CNString csPath, csRoot;
  if (!csGetField("default_path", csPath) || csPath.bEmpty())
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCheckForFolder -> !default_path -> return FUNCTION_ERROR");
  csPath.SubstituteAll("CNInstallWizard::iCheckForFolder", "csPath", "/", "\\");
  while (csPath.EndsWith(" ")) csPath.SetLength(csPath.Length() - 1);  // the file system would drop them silently
  CutSlash(csPath);
  *pCommandResult = COMMAND_DONE;  // stay, until everything is right
  if (!lRootLength(csPath.Text())) {
    ShowFolderFault(csPath.Text(), "it is not a full path with a drive.");
    return EVERYTHING_IS_OK;
  }
  if (csPath.Length() > MAX_DESTINATION) {
    ShowFolderFault(csPath.Text(), "its name is longer than 260 characters.");
    return EVERYTHING_IS_OK;
  }
  GetRoot(csPath.Text(), csRoot);
  if (!m_Context.GetExpandedFile()) iShowMessageBox("msgBox_err_missing", MessageIcon::Error);
  if (!bCheckForDiskSpace(true, csRoot.Text(), m_Context.GetExpandedFile(), SPACE_ON_DESTINATION)) {
    m_bPageStays = true;  // the one place where result 2 does not end the wizard
    *pCommandResult = COMMAND_EXIT;
    return EVERYTHING_IS_OK;
  }
  if (!bMakeDestination(csPath.Text())) return EVERYTHING_IS_OK;
  iSetField("default_path", csPath.Text());
  if (!*szParam || !bSoftwareRuns(szParam)) *pCommandResult = COMMAND_CONTINUE;
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::b_browse_OnClick(const char* szParam, int* pCommandResult) {
  if (!szParam || !*szParam)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: CNInstallWizard::b_browse_OnClick -> !szParam || !*szParam -> return "
                      "PRECONDITIONS_NOT_VALID");
  CNString csFolder;
  csGetField("default_path", csFolder);
  *pCommandResult = COMMAND_DONE;
  if (iGetDirectoryDialog(szParam, csFolder) != EVERYTHING_IS_OK || csFolder.bEmpty()) return EVERYTHING_IS_OK;
  iSetField("default_path", csFolder.Text());
  if (!bOsIsFolder(csFolder.Text())) bMakeDestination(csFolder.Text());
  return EVERYTHING_IS_OK;
}
