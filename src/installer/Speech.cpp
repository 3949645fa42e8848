// The speech files of the product: found on a CD, copied by a worker, and named in the settings file "kv.ini", which
// is read and written through the system's profile functions.
#include <windows.h>

#include "foundation/CNSystem.h"
#include "foundation/os/Os.h"
#include "foundation/os/OsWide.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"
#include "installer/ExtractionReport.h"
#include "installer/InstallJournal.h"

static const char SETTINGS_FILE[] = "kv.ini";

int CNInstallWizard::iCheckForCDInstallation(const char* /*szParam*/, int* pCommandResult) {
  const UINT uMode = SetErrorMode(SEM_FAILCRITICALERRORS);  // no box for a drive without a disk
  char szFolder[] = "C:\\speech";
  bool bFound = false;
  for (char cDrive = 'C'; cDrive <= 'J' && !bFound; cDrive++) {
    szFolder[0] = cDrive;
    bFound = bOsExists(Joined(szFolder, "\\EnaSpk.ndx").Text());
  }
  SetErrorMode(uMode);
  iSetVariable("CD_installation", bFound ? "1" : "0");
  if (bFound) iSetVariable("speech_path", szFolder);
  return iAnswer(pCommandResult, bFound ? COMMAND_DONE : COMMAND_NEGATIVE);
}

// ---- kv.ini ----

// A file that is made here is one of Unicode: the profile functions keep every letter in it.
bool CNInstallWizard::bWriteProduct(const char* szKey, const char* szText) {
  CNString csFolder;
  GetDestination(csFolder);
  if (csFolder.bEmpty()) return false;
  AddUndo("kv_ini", SETTINGS_FILE);
  const CNString csFile = Joined(csFolder.Text(), "\\", SETTINGS_FILE);
  OsFile file;
  if (file.bOpen(csFile.Text(), OsOpenMode::CreateNew) && !(file.bWrite("\xFF\xFE", 2) && file.bClose())) return false;
  return WritePrivateProfileStringW(L"General", Wide(szKey), Wide(szText), Wide(csFile.Text())) != FALSE;
}

int CNInstallWizard::iCopyKVIniFile(const char* /*szParam*/, int* pCommandResult) {
  if (!*szValue("speech_path"))
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iCopyKVIniFile -> !speech_path -> COMMAND_NEGATIVE");
  if (!bWriteProduct("SpeechPath", szValue("speech_path")))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCopyKVIniFile -> !bWriteProduct -> return FUNCTION_ERROR");
  return iAnswer(pCommandResult, COMMAND_DONE);
}

int CNInstallWizard::iSetInterfaceLang(const char* szParam, int* pCommandResult) {
  if (!bWriteProduct("InterfaceLanguage", szParam))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iSetInterfaceLang -> !bWriteProduct -> return FUNCTION_ERROR");
  return iAnswer(pCommandResult, COMMAND_DONE);
}

// ---- copying ----

namespace {

// One run over the tree below a folder. Each file stands in the list before it is filled.
class SpeechCopy {
 public:
  SpeechCopy(COrbitWizard& wizard, const char* szTo, const std::atomic<int>& iGoesOn)
      : m_Wizard(wizard), m_csTo(szTo, 0), m_iGoesOn(iGoesOn), m_Journal(szTo) {}

  // szBelow is the way from the destination to the folder, with a backslash at its end, or empty.
  void CopyFolder(const char* szFrom, const char* szBelow) {
    Step step = {this, szFrom, szBelow};
    if (!bOsListFolder(szFrom, bVisit, &step) && m_iGoesOn) m_Failed.Add(szFrom);
  }
  const FailedFiles& Failed() const { return m_Failed; }

 private:
  struct Step {
    SpeechCopy* pCopy;
    const char *szFrom, *szBelow;
  };

  static bool bVisit(const OsFolderEntry& entry, void* pContext) {
    const Step& step = *static_cast<const Step*>(pContext);
    const CNString csFrom = Joined(step.szFrom, "\\", entry.csName.Text());
    const CNString csName = Joined(step.szBelow, entry.csName.Text());
    if (entry.info.attributes & OS_DIRECTORY)
      step.pCopy->EnterFolder(csFrom.Text(), csName.Text());
    else
      step.pCopy->CopyFile(csFrom.Text(), csName.Text());
    return step.pCopy->m_iGoesOn != 0;
  }
  void EnterFolder(const char* szFrom, const char* szName) {
    if (!bOsExists(Joined(m_csTo.Text(), szName).Text())) m_Journal.bOnFolder(szName);
    if (OsMakeFolder(Joined(m_csTo.Text(), szName).Text()) == OsMakeFolderResult::Failed) m_Failed.Add(szName);
    CopyFolder(szFrom, Joined(szName, "\\").Text());
  }
  void CopyFile(const char* szFrom, const char* szName) {
    const CNString csTo = Joined(m_csTo.Text(), szName);
    m_Wizard.CWSetWindowText("from_file", szFrom);
    m_Wizard.CWSetWindowText("to_file", csTo.Text());
    const bool bListed = m_Journal.bOnFile(szName);
    if (bListed) bOsSetAttributes(csTo.Text(), OS_NORMAL);  // what came from a CD before is read-only
    if (bListed && CNSystem::CopyFile(szFrom, csTo.Text()))
      NoteWhole(m_Journal, csTo.Text());
    else
      m_Failed.Add(szName);
  }

  COrbitWizard& m_Wizard;
  const CNString m_csTo;
  const std::atomic<int>& m_iGoesOn;
  InstallJournal m_Journal;
  FailedFiles m_Failed;
};

}  // namespace

void CNInstallWizard::CopySpeechWork() {
  CNString csNames;
  iCreateDirectory(m_csUnzipFolder.Text());
  SpeechCopy copy(*this, m_csUnzipFolder.Text(), m_Extraction.iBusy);
  copy.CopyFolder(m_csSpeechFolder.Text(), "");
  copy.Failed().MakeText(csNames);
  iSetVariable("failed_files", csNames.Text());
  if (copy.Failed().Count()) {
    const CNString csText = Joined("These files could not be copied:\n\n", csNames.Text());
    m_View.iShowMessage({csText.Text(), m_csSpeechCaption.Text(), MessageIcon::Error});
  }
  EndUnzip(ID_NEXT);
}

int CNInstallWizard::iCopySpeechFile(const char* /*szParam*/, int* pCommandResult) {
  m_csSpeechFolder = szValue("speech_path");
  if (m_csSpeechFolder.EndsWith("\\")) m_csSpeechFolder.SetLength(m_csSpeechFolder.Length() - 1);
  if (!bOsIsFolder(m_csSpeechFolder.Text()))
    return iAnswer(pCommandResult, COMMAND_NEGATIVE),
           iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iCopySpeechFile -> !speech_path -> COMMAND_NEGATIVE");
  GetDestination(m_csUnzipFolder);
  if (m_csUnzipFolder.bEmpty() || m_Extraction.iWorkers)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iCopySpeechFile -> !default_path -> return FUNCTION_ERROR");
  m_csUnzipFolder.AddSlash();
  iSetVariable("from_file", m_csSpeechFolder.Text());
  iSetVariable("to_file", m_csUnzipFolder.Text());
  m_csSpeechCaption = szValue("msgbox_capt");
  iSetVariable("failed_files", "");  // made here, so that the worker only changes its value
  m_Extraction.iBusy = 1;
  if (bStartWorker(&CNInstallWizard::CopySpeechWork, m_Extraction.iWorkers))
    return iAnswer(pCommandResult, COMMAND_DONE);
  m_Extraction.iBusy = 0;
  return iLogReturn(FUNCTION_ERROR,
                    "ERROR: CNInstallWizard::iCopySpeechFile -> !bStartWorker -> return FUNCTION_ERROR");
}
