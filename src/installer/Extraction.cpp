// The command Unzip and the worker that extracts the product archive.
#include <memory>

#include "archive/CNArchive.h"
#include "archive/PathGuard.h"
#include "installer/CNInstallWizard.h"
#include "installer/ExtractionReport.h"
#include "installer/InstallJournal.h"
#include "installer/Slowdown.h"

// ---- progress on the page ----

namespace {

class CheckProgress : public ArchiveProgress {
 public:
  explicit CheckProgress(COrbitWizard& wizard) : m_Wizard(wizard) {}
  void OnPercent(int iPercent) override { m_Wizard.CWSetProgress("progress", iPercent); }

 protected:
  COrbitWizard& m_Wizard;
};

class EntryProgress : public CheckProgress {
 public:
  using CheckProgress::CheckProgress;
  void OnPercent(int iPercent) override {
    if (iPercent == m_iShown) return;  // a thousand files show a hundred numbers
    m_iShown = iPercent;
    CNString csText;
    csText.Printf("EntryProgress::OnPercent", "csText", "%d%%", iPercent);
    m_Wizard.CWSetWindowText("percent", csText.Text());
    CheckProgress::OnPercent(iPercent);
  }

 private:
  int m_iShown = -1;
};

// An entry that bears the name of one of setup's own records would take its place, the list's while it is written.
bool bIsOwnRecord(const char* szName) {
  CNString csPath;
  bMakeSafePath(szName, csPath);
  for (const char* szRecord : {InstallJournal::FILE_NAME, "Uninstall.log", "config.ini"})
    if (iOsCompareNoCase(csPath.Text(), szRecord) == 0) return true;
  return false;
}

// One pass over all entries.
class ExtractionPass {
 public:
  ExtractionPass(COrbitWizard& wizard, CNArchive& archive, ExtractionState& state, const char* szFolder)
      : m_Wizard(wizard), m_Archive(archive), m_State(state), m_Journal(szFolder), m_Progress(wizard) {
    m_csFolder = szFolder;
    m_Archive.SetJournal(&m_Journal);
  }
  ~ExtractionPass() { m_Archive.SetJournal(nullptr); }

  void Run(const CNArray<CNArchiveEntry>& entries) {
    const int iCount = entries.Size();
    uint64_t total = 0;
    for (int i = 0; i < iCount; i++) total += entries[i]->storedSize;
    Slowdown slowdown(total);
    uint32_t uStart = 0;
    for (int i = 0; i < iCount; i++) {
      if (slowdown.bStartsStretch()) uStart = OsTickCount();
      ExtractOne(*entries[i], i, iCount);
      if (m_State.bAllSlidesShown) continue;
      const uint32_t uPause =
          slowdown.PauseAfter(entries[i]->storedSize, iCount - i, OsTickCount() - uStart, m_State.uMinimumTime);
      SleepUnless(uPause, [this] { return m_State.bAllSlidesShown != 0; });
    }
    m_Progress.OnPercent(100);
    if (m_Journal.bFailed()) m_Failed.Add(InstallJournal::FILE_NAME);
  }

  const FailedFiles& Failed() const { return m_Failed; }

 private:
  void ExtractOne(const CNArchiveEntry& entry, int iEntry, int iCount) {
    const int iLow = iEntryPercent(iEntry, iCount), iHigh = iEntryPercent(iEntry + 1, iCount);
    CNString csLabel;
    MakeFileLabel(entry.csName.Text(), csLabel);
    m_Progress.OnPercent(iLow);
    m_Wizard.CWSetWindowText("files", csLabel.Text());
    const bool bOwnRecord = bIsOwnRecord(entry.csName.Text());
    if (bOwnRecord) LogPrintf("ERROR: ExtractionPass::ExtractOne -> bIsOwnRecord(%s) -> return", entry.csName.Text());
    if (bOwnRecord || m_Archive.ExtractEntry(iEntry, m_csFolder.Text(), &m_Progress, iLow, iHigh - iLow) != ArchiveOk)
      m_Failed.Add(entry.csName.Text());
  }

  COrbitWizard& m_Wizard;
  CNArchive& m_Archive;
  ExtractionState& m_State;
  InstallJournal m_Journal;
  EntryProgress m_Progress;
  FailedFiles m_Failed;
  CNString m_csFolder;
};

}  // namespace

// ---- the command and its worker ----

bool CNInstallWizard::bStartWorker(void (CNInstallWizard::*pWork)()) {
  struct Job {
    CNInstallWizard* pWizard;
    void (CNInstallWizard::*pWork)();
  };
  const auto run = [](void* pContext) {
    const std::unique_ptr<Job> pJob(static_cast<Job*>(pContext));
    (pJob->pWizard->*pJob->pWork)();
    pJob->pWizard->m_Extraction.iWorkers--;  // last: from here on the wizard may be destroyed
  };
  auto pJob = std::make_unique<Job>(Job{this, pWork});
  m_Extraction.iWorkers++;
  if (!bOsStartThread(run, pJob.get())) {
    m_Extraction.iWorkers--;
    return false;
  }
  static_cast<void>(pJob.release());
  return true;
}

int CNInstallWizard::iUnzip(const char* /*szParam*/, int* pCommandResult) {
  if (m_Extraction.iWorkers)
    return iLogReturn(FUNCTION_ERROR, "ERROR: CNInstallWizard::iUnzip -> iWorkers -> return FUNCTION_ERROR");
  GetDestination(m_csUnzipFolder);
  m_csUnzipFolder.AddSlash();
  PrepareSlides();
  iSetVariable("failed_files", "");  // made here, so that the worker only changes its value
  m_Extraction.iBusy = 1;
  if (!bStartWorker(&CNInstallWizard::UnzipWork)) {
    m_Extraction.iBusy = 0;
    return iLogReturn(FUNCTION_ERROR, "ERROR: CNInstallWizard::iUnzip -> !bStartWorker -> return FUNCTION_ERROR");
  }
  if (!bStartWorker(&CNInstallWizard::SlideShowThread)) m_Extraction.bAllSlidesShown = 1;
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

void CNInstallWizard::EndUnzip(int iPostedCommand) {
  // Nobody may ask to leave between the end and the next page, so that command goes first; a close would be held back.
  if (iPostedCommand == ID_NEXT) m_View.PostCommand(iPostedCommand);
  m_Extraction.iBusy = 0;
  if (iPostedCommand != ID_NEXT) m_View.PostCommand(iPostedCommand);
}

int CNInstallWizard::iUnzipThread() {
  const auto giveUp = [this](const char* szMessageBox) {
    iShowMessageBox(szMessageBox, MessageIcon::Error);
    EndUnzip(ID_EXIT);
  };
  if (!m_Context.GetExpandedFile()) {
    giveUp("msgBox_err_missing");
    return iLogReturn(EVERYTHING_IS_OK,
                      "ERROR: CNInstallWizard::iUnzipThread -> !pUserDataName -> return EVERYTHING_IS_OK");
  }
  CNArchive archive(m_Context.GetExpandedFile());
  CNArray<CNArchiveEntry> entries;
  CheckProgress progress(*this);
  const int iCheck = archive.CheckArchive(&progress);
  if (iCheck == ErrZipFileNotFound) {
    giveUp("msgBox_err_missing");
    return iLogReturn(EVERYTHING_IS_OK,
                      "ERROR: CNInstallWizard::iUnzipThread -> ErrZipFileNotFound -> return EVERYTHING_IS_OK");
  }
  if (iCheck != ArchiveOk || archive.ListEntries(entries) != ArchiveOk) {
    giveUp("msgBox_err_corrupted");
    return iLogReturn(EVERYTHING_IS_OK,
                      "ERROR: CNInstallWizard::iUnzipThread -> ErrCRCError -> return EVERYTHING_IS_OK");
  }
  iCreateDirectory(m_csUnzipFolder.Text());
  ExtractionPass pass(*this, archive, m_Extraction, m_csUnzipFolder.Text());
  pass.Run(entries);
  if (pass.Failed().Count()) {
    CNString csNames;
    pass.Failed().MakeText(csNames);
    iSetVariable("failed_files", csNames.Text());
    iShowMessageBox("msgBox_err_files", MessageIcon::Error);
  }
  EndUnzip(ID_NEXT);
  return EVERYTHING_IS_OK;
}
