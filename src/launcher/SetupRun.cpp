#include "launcher/SetupRun.h"

#include <cstring>

#include "foundation/os/Os.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"
#include "launcher/CommandLine.h"
#include "launcher/RunGuards.h"
#include "launcher/RunReport.h"
#include "launcher/SfxStream.h"
#include "launcher/Unattended.h"
#include "launcher/WatchedView.h"

namespace {

// The run's context; whatever it holds is deleted when the run ends, however that comes.
class SfxHolder {
 public:
  SfxHolder() = default;
  ~SfxHolder() { ReleaseSfx(context, uEndPause); }
  SfxHolder(const SfxHolder&) = delete;
  SfxHolder& operator=(const SfxHolder&) = delete;

  SfxContext context;
  unsigned uEndPause = 0;
};

// One run, from the switches to the exit code.
class Run {
 public:
  Run(const SetupSurroundings& surroundings, const wchar_t* pCommandLine) : m_Surroundings(surroundings) {
    ReadCommandLine(pCommandLine, m_Line);
  }

  int iRun();

 private:
  int iBegin();
  int iRefuse(int iCode, const char* szWhy);
  int iReportMissing();
  int iInstall();
  int iMayInstall(CNInstallWizard& installer);
  int iExpand(SfxContext& context);
  int iOutcome(const CNInstallWizard& installer) const;
  void Prepare(CNInstallWizard& installer);
  std::unique_ptr<WizardView> pMakeView();
  std::unique_ptr<WizardView> pMakeWaitView();
  std::unique_ptr<WizardView> pMakeScreen() const { return m_Surroundings.pMakeView(m_Surroundings.pContext); }
  bool bBundled() const { return m_Surroundings.pSwitches != nullptr; }
  bool bWatched() const { return m_Log.bIsOpen() || !m_Switches.csSaveAnswers.bEmpty(); }

  const SetupSurroundings& m_Surroundings;
  SetupCommandLine m_Line;
  Switches m_Switches;
  RunLog m_Log;
  Answers m_Answers;  // given, or to be saved
  RunReport m_Report{m_Log};
  Walk m_Walk{m_Switches, m_Answers, m_Log};
  WatchedView* m_pWatched = nullptr;  // the installer's view of an attended run that is watched
  ProductLock m_Lock;
};

const int NOT_REFUSED = -1;
const uint64_t LEAST_SPACE = 65536;  // with less free a drive is full

bool bCanBeRead(const CNString& csPath) {
  OsFile file;
  return !csPath.bEmpty() && file.bOpen(csPath.Text(), OsOpenMode::Read);
}

// ---- before anything is done ----

// Tells why setup does not begin, to the person or the log.
int Run::iRefuse(int iCode, const char* szWhy) {
  m_Log.Line("failed: %s", szWhy);
  if (!m_Switches.bUnattended())
    pMakeScreen()->iShowMessage({szWhy, "Setup", MessageIcon::Error, MessageButtons::Ok, false});
  return iLogReturn(iCode, "ERROR: Run::iRefuse -> %s -> return %d", szWhy, iCode);
}

int Run::iReportMissing() {
  CNString csText;
  csText.Printf("iRunSetup", "csText", "Failed to Open the SFX!?\n%s\n%s", m_Line.csLine.Text(),
                m_Line.csArgument.Text());
  if (m_Switches.bUnattended()) return iRefuse(SETUP_FAILED, csText.Text());
  pMakeScreen()->iShowMessage({csText.Text(), nullptr, MessageIcon::Error, MessageButtons::Ok, false});
  csText.SubstituteAll("iRunSetup", "csText", "\n", " -> ");
  return iLogReturn(SETUP_FILE_NOT_OPEN, "ERROR: %s", csText.Text());
}

// NOT_REFUSED, or the code of a run that ends before it has begun.
int Run::iBegin() {
  CNString csFault, csSystem;
  ReadSwitches(m_Surroundings.pSwitches, m_Switches);
  if (!m_Switches.csLog.bEmpty() && !m_Log.bOpen(m_Switches.csLog.Text())) {
    csFault.Printf("Run::iBegin", "csFault", "The log %s cannot be written.", m_Switches.csLog.Text());
    return iRefuse(SETUP_FAILED, csFault.Text());
  }
  OsGetSystemName(csSystem);
  m_Log.Line("start of %s on %s", m_Line.csArgument.Text(), csSystem.Text());
  m_Log.WideLine("switches: ", m_Surroundings.pSwitches);
  if (!m_Switches.csFault.bEmpty()) return iRefuse(SETUP_WRONG_SWITCH, m_Switches.csFault.Text());
  if (m_Switches.bHelp) {
    if (!m_Switches.bUnattended())
      pMakeScreen()->iShowMessage({SWITCHES_HELP, "Setup", MessageIcon::Information, MessageButtons::Ok, false});
    return SETUP_DONE;
  }
  if (!m_Switches.csAnswers.bEmpty() && !m_Answers.bReadFile(m_Switches.csAnswers.Text(), csFault))
    return iRefuse(SETUP_WRONG_SWITCH, csFault.Text());
  return NOT_REFUSED;
}

// ---- the run ----

std::unique_ptr<WizardView> Run::pMakeView() {
  if (m_Switches.bUnattended())
    return std::make_unique<UnattendedView>(m_Walk, m_Switches.mode == RunMode::Passive ? pMakeScreen() : nullptr);
  if (!bWatched()) return pMakeScreen();
  auto pWatched = std::make_unique<WatchedView>(pMakeScreen(), m_Log, m_Answers);
  m_pWatched = pWatched.get();
  return pWatched;
}

std::unique_ptr<WizardView> Run::pMakeWaitView() {
  if (m_Switches.bUnattended()) return std::make_unique<UnattendedView>(m_Walk, nullptr);
  return pMakeScreen();
}

int Run::iExpand(SfxContext& context) {
  SetupSurroundings surroundings = m_Surroundings;
  surroundings.pMakeView = [](void* pRun) { return static_cast<Run*>(pRun)->pMakeWaitView(); };
  surroundings.pContext = this;
  return ExpandSfx(surroundings, context, m_Line.csArgument.Text());
}

// What the switches say about the installer, once its script is loaded.
void Run::Prepare(CNInstallWizard& installer) {
  if (!m_Switches.csFolder.bEmpty()) installer.SetDestination(m_Switches.csFolder.Text());
  for (int i = 0; i < m_Switches.variables.Size(); i++) {
    const char *szName = m_Switches.variables[i]->csName.Text(), *szValue = m_Switches.variables[i]->csValue.Text();
    if (!installer.Variables().pFind(szName)) m_Log.Line("new variable %s", szName);  // or a misspelt one
    if (strcmp(szName, "default_path") == 0 && bIsFullPath(szValue))
      installer.SetDestination(szValue);
    else
      installer.iSetVariable(szName, szValue);
  }
  if (m_Switches.bNoRestart || m_Switches.bUnattended()) installer.SetNoRestart();
  if (m_Switches.bUnattended()) installer.SetUnattended();
  m_Log.Line("product %s %s", installer.szValue("program_name"), installer.szValue("program_version"));
}

int Run::iMayInstall(CNInstallWizard& installer) {
  if (!installer.DialogCount()) return iRefuse(SETUP_FAILED, "The installation script is missing or damaged.");
  Prepare(installer);
  if (!m_Lock.bTake(installer.szValue("program_name")))
    return iRefuse(SETUP_RUNNING, "Another setup of this product is running. Please wait until it has ended.");
  if (bRefusesInstalled(installer))
    return iRefuse(SETUP_INSTALLED, "This version of the product, or a newer one, is installed already.");
  if (m_Switches.bUnattended() && !m_Walk.bAnswersFit()) return SETUP_FAILED;
  return NOT_REFUSED;
}

int Run::iInstall() {
  const bool bUnattended = m_Switches.bUnattended();
  const std::unique_ptr<WizardView> pView = pMakeView();
  SfxHolder holder;  // outlives the wizard, whose workers read the files
  CNInstallWizard installer(*pView, holder.context, *m_Surroundings.pScripts);
  installer.SetReport(&m_Report);
  installer.SetSetupPath(m_Line.csArgument.Text());
  installer.SetEndOfSession([](void* pContext) { ReleaseSfx(*static_cast<SfxContext*>(pContext), 0); },
                            &holder.context);
  m_Walk.SetInstaller(&installer);
  if (m_pWatched) m_pWatched->SetWizard(&installer);
  // Whoever looks on is told by the installer's pages what is missing: its window opens all the same.
  installer.iExecuteInstallWizard(m_Line.csArgument.Text());
  const int iRefused = bBundled() ? iMayInstall(installer) : NOT_REFUSED;
  if (iRefused != NOT_REFUSED) return iRefused;
  if (bUnattended && m_Report.bNoSpace()) return SETUP_NO_SPACE;
  if (!bUnattended) holder.uEndPause = m_Surroundings.uEndPause;
  if (iExpand(holder.context) != SFX_EXPANDED && bUnattended) {
    uint64_t freeBytes = 0;
    const bool bFull = bOsGetFreeSpace(holder.context.csTempFolder.Text(), freeBytes) && freeBytes < LEAST_SPACE;
    return bFull ? iRefuse(SETUP_NO_SPACE, "The drive for temporary files is full.")
                 : iRefuse(SETUP_FAILED, "The packed files are missing or damaged.");
  }
  installer.iRunInstallWindow();
  const int iCode = iOutcome(installer);
  const bool bSaves = !m_Switches.csSaveAnswers.bEmpty() && (iCode == SETUP_DONE || iCode == SETUP_RESTART);
  if (bSaves && !m_Answers.bWriteFile(m_Switches.csSaveAnswers.Text(), installer.szValue("program_name")))
    return iRefuse(SETUP_FAILED, "The answers could not be written.");
  return bUnattended ? iCode : static_cast<int>(SETUP_DONE);
}

int Run::iOutcome(const CNInstallWizard& installer) const {
  const bool bLast = installer.CurrentDialogNumber() >= installer.DialogCount();
  if (m_Walk.bCancelled()) return SETUP_CANCELLED;
  if (m_Report.bNoSpace()) return SETUP_NO_SPACE;
  if (m_Walk.bFailed() || m_Report.bFailed()) return SETUP_FAILED;
  // A script that ends on its way, with nothing copied that it copies otherwise, has refused.
  const bool bMissed = !m_Report.bCopied() && m_Surroundings.pScripts->csInstaller.Has("Unzip");
  if (!bLast && (installer.EndedBy() == ID_CANCEL || bMissed)) return SETUP_CANCELLED;
  return m_Report.bRestart() ? SETUP_RESTART : SETUP_DONE;
}

int Run::iRun() {
  int iCode = bBundled() ? iBegin() : NOT_REFUSED;
  if (iCode == NOT_REFUSED) iCode = bCanBeRead(m_Line.csArgument) ? iInstall() : iReportMissing();
  m_Log.Line("end, exit code %d", iCode);
  return iCode;
}

}  // namespace

int iRunSetupIn(const SetupSurroundings& surroundings, const wchar_t* pCommandLine) {
  return Run(surroundings, pCommandLine).iRun();
}
