#include "installer/CNInstallWizard.h"

#include <windows.h>

#include <cstring>

#include "foundation/os/Os.h"
#include "installer/CNExitInstallWizard.h"
#include "installer/VersionText.h"

static const int WIZARD_ICON = 434;

CNInstallWizard::CNInstallWizard(WizardView& view, const SfxContext& context, const CarriedScripts& scripts)
    : COrbitWizard(view), m_Context(context), m_Scripts(scripts) {}

CNInstallWizard::~CNInstallWizard() {
  m_Extraction.iBusy = 0;
  m_Extraction.bAllSlidesShown = 1;
  m_bStopSearch = m_bEnding = 1;
  while (m_Extraction.iWorkers || m_iTasks) OsSleep(5);
  RemoveUnusedFolders();
}

// The drive of the folder for temporary files, as "C:\".
static void GetTempDrive(CNString& csDrive) {
  const char* pColon = bOsGetTempFolder(csDrive) ? strchr(csDrive.Text(), ':') : nullptr;
  if (!pColon) {
    csDrive = "C:\\";
    return;
  }
  csDrive.SetLength(static_cast<long>(pColon - csDrive.Text()) + 1);
  csDrive.Concat("\\");
}

int CNInstallWizard::iExecuteInstallWizard(const char* szSizeSource) {
  if (iLoadMainList(m_Scripts.csInstaller.Text()) != EVERYTHING_IS_OK)
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: CNInstallWizard::iExecuteInstallWizard -> iLoadMainListBuffer -> return FUNCTION_ERROR");
  CNString csDrive;
  GetTempDrive(csDrive);
  if (!bCheckForDiskSpace(false, csDrive.Text(), szSizeSource, SPACE_ON_TEMP_DRIVE)) return EVERYTHING_IS_OK;
  MakeVersionText(__DATE__, m_csVersion);
  iSetVariable("version", m_csVersion.Text());  // so that captions are right from their first drawing on
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iRunInstallWindow() { return iRunWindow("WindowWizardClass", WIZARD_ICON); }

void CNInstallWizard::SetDestination(const char* szFolder) {
  m_bDestinationGiven = m_bDefaultPathInitialised = true;
  iSetVariable("default_path", szFolder);
}

void CNInstallWizard::Tell(InstallEvent event, const char* szText, int iNumber) {
  if (m_pReport) m_pReport->OnInstallEvent(event, szText, iNumber);
}

// ---- leaving the wizard ----

// Asks before the last page; false when the installation goes on.
bool CNInstallWizard::bMayLeave() {
  if (bHoldsQuit() || m_bAsking) return false;
  if (CurrentDialogNumber() >= DialogCount()) return true;
  m_bAsking = true;
  const std::unique_ptr<WizardView> pView = m_View.pMakeOwnedView();
  CNExitInstallWizard exitWizard(*pView);
  const int iResult = exitWizard.iExecuteWizard(m_Scripts.csExit.Text(), WIZARD_ICON);
  m_bAsking = false;
  return iResult != EVERYTHING_IS_OK || exitWizard.ExitConfirmed();  // who cannot be asked is let go
}

// The close box ends here too.
int CNInstallWizard::iOnCancel() {
  if (bMayLeave()) return COrbitWizard::iOnCancel();
  m_bOutOfDialogs = false;  // a flow that wanted to end has been refused
  return EVERYTHING_IS_OK;
}

int CNInstallWizard::iOnExit() { return bHoldsQuit() ? EVERYTHING_IS_OK : COrbitWizard::iOnExit(); }

void CNInstallWizard::OnEndSession() {
  COrbitWizard::OnEndSession();
  RemoveUnusedFolders();
  if (m_pRelease) m_pRelease(m_pReleaseContext);
}

// Workers that send the window a message wait until it has been handled.
static void HandleSentMessages() {
  MSG message;
  PeekMessageW(&message, nullptr, 0, 0, PM_NOREMOVE);
}

// The list in the destination tells the next run, or the uninstaller, how far the copying came. Where one file takes
// too long the process is ended while it is written; if not, the wizard ends behind that file.
void CNInstallWizard::OnBreakOff() {
  const uint32_t uStart = OsTickCount(), uPatience = 3000;  // of the 5 seconds that the system leaves
  if (m_Extraction.iWorkers) Tell(InstallEvent::StepFailed, "the session ended before everything was copied");
  CancelExtraction();
  m_Extraction.iBusy = 0;
  m_Extraction.bAllSlidesShown = 1;
  for (; m_Extraction.iWorkers && OsTickCount() - uStart < uPatience; OsSleep(5)) HandleSentMessages();
  if (!m_Extraction.iWorkers) OnEndSession();
}

int CNInstallWizard::iProcessDecideNextDialogAction(int iResult) {
  const bool bStays = iResult == COMMAND_EXIT && m_bPageStays;
  m_bPageStays = false;
  return bStays ? EVERYTHING_IS_OK : COrbitWizard::iProcessDecideNextDialogAction(iResult);
}
