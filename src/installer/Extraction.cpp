// The command Unzip and the worker that extracts the product archive.
#include <cstring>
#include <memory>

#include "archive/CNArchive.h"
#include "archive/PathGuard.h"
#include "installer/CNInstallWizard.h"
#include "installer/ExtractionReport.h"
#include "installer/InstallJournal.h"
#include "installer/ShellFolder.h"
#include "installer/Slowdown.h"
#include "installer/StaleFiles.h"

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
  EntryProgress(COrbitWizard& wizard, InstallReport* pReport) : CheckProgress(wizard), m_pReport(pReport) {}
  void OnPercent(int iPercent) override {
    if (iPercent == m_iShown) return;  // a thousand files show a hundred numbers
    m_iShown = iPercent;
    CNString csText;
    csText.Printf("EntryProgress::OnPercent", "csText", "%d%%", iPercent);
    m_Wizard.CWSetWindowText("percent", csText.Text());
    CheckProgress::OnPercent(iPercent);
    if (m_pReport) m_pReport->OnInstallEvent(InstallEvent::Percent, nullptr, iPercent);
  }

 private:
  InstallReport* m_pReport;
  int m_iShown = -1;
};

// An entry that bears the name of one of setup's own records would take its place, the list's while it is written.
bool bIsOwnRecord(const char* szName) {
  CNString csPath;
  bMakeSafePath(szName, csPath);
  for (const char* szRecord : {InstalledList::FILE_NAME, "Uninstall.log", "config.ini"})
    if (iOsCompareNoCase(csPath.Text(), szRecord) == 0) return true;
  return false;
}

// One pass over all entries.
class ExtractionPass {
 public:
  ExtractionPass(COrbitWizard& wizard, CNArchive& archive, ExtractionState& state, const char* szFolder,
                 InstallReport* pReport)
      : m_Wizard(wizard),
        m_Archive(archive),
        m_State(state),
        m_pReport(pReport),
        m_Journal(szFolder),
        m_Progress(wizard, pReport) {
    m_csFolder = szFolder;
    m_Stale.Read(szFolder);
    m_Journal.bAddLines(state.csJournalStart.Text());
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
      if (m_State.bCancelled) return;
      if (slowdown.bStartsStretch()) uStart = OsTickCount();
      ExtractOne(*entries[i], i, iCount);
      if (m_State.bAllSlidesShown) continue;
      const uint32_t uPause =
          slowdown.PauseAfter(entries[i]->storedSize, iCount - i, OsTickCount() - uStart, m_State.uMinimumTime);
      SleepUnless(uPause, [this] { return m_State.bAllSlidesShown != 0; });
    }
    m_Progress.OnPercent(100);
    m_Journal.bFlush();
    if (m_Journal.bFailed()) Fail(InstalledList::FILE_NAME);
    // What could not be replaced must not be taken for what is no longer part of the product.
    if (!m_Failed.Count()) m_Stale.RemoveAll();
  }

  const FailedFiles& Failed() const { return m_Failed; }
  uint64_t CopiedBytes() const { return m_Journal.ContentBytes(); }

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
      Fail(entry.csName.Text());
  }
  void Fail(const char* szName) {
    m_Failed.Add(szName);
    if (m_pReport) m_pReport->OnInstallEvent(InstallEvent::FileFailed, szName, 0);
  }

  COrbitWizard& m_Wizard;
  CNArchive& m_Archive;
  ExtractionState& m_State;
  InstallReport* m_pReport;
  StaleFiles m_Stale;  // read before the journal goes on
  InstallJournal m_Journal;
  EntryProgress m_Progress;
  FailedFiles m_Failed;
  CNString m_csFolder;
};

}  // namespace

// ---- the command and its worker ----

bool CNInstallWizard::bStartWorker(void (CNInstallWizard::*pWork)(), std::atomic<int>& iCount) {
  struct Job {
    CNInstallWizard* pWizard;
    void (CNInstallWizard::*pWork)();
    std::atomic<int>& iCount;
  };
  const auto run = [](void* pContext) {
    const std::unique_ptr<Job> pJob(static_cast<Job*>(pContext));
    (pJob->pWizard->*pJob->pWork)();
    pJob->iCount--;  // last: from here on the wizard may be destroyed
  };
  auto pJob = std::make_unique<Job>(Job{this, pWork, iCount});
  iCount++;
  if (!bOsStartThread(run, pJob.get())) {
    iCount--;
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
  StartJournal();
  m_Extraction.iBusy = 1;
  if (!bStartWorker(&CNInstallWizard::UnzipWork, m_Extraction.iWorkers)) {
    m_Extraction.iBusy = 0;
    return iLogReturn(FUNCTION_ERROR, "ERROR: CNInstallWizard::iUnzip -> !bStartWorker -> return FUNCTION_ERROR");
  }
  if (m_bUnattended || !bStartWorker(&CNInstallWizard::SlideShowThread, m_Extraction.iWorkers))
    m_Extraction.bAllSlidesShown = 1;
  *pCommandResult = COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

CNString CNInstallWizard::csFoldersFile() {
  CNString csFile;
  bOsGetTempFolder(csFile);
  csFile.Concat(InstalledList::FOLDERS_FILE);
  return csFile;
}

// Before a folder is made there is no place for a list in it: until then the temporary folder tells what is missing,
// and so will be ours. The file goes at the end of the run; of one that was killed the next run, or the uninstaller,
// reads it.
void CNInstallWizard::AnnounceFolders(const char* szFolder) {
  CNString csLines;
  OsFile file;
  for (const char* pEnd = strchr(szFolder, '\\'); pEnd; pEnd = *pEnd ? pEnd + 1 + strcspn(pEnd + 1, "\\") : nullptr) {
    CNString csPart;
    csPart.Copy(szFolder, static_cast<long>(pEnd - szFolder));
    if (!bOsExists(csPart.Text())) InstallJournal::AddLine(csLines, 'P', csPart.Text());
  }
  if (!csLines.bEmpty() && file.bOpen(csFoldersFile().Text(), OsOpenMode::Append))
    file.bWrite(csLines.Text(), static_cast<size_t>(csLines.Length()));
}

static void AddAnnouncedFolders(CNString& csLines, const char* szFoldersFile) {
  InstalledList announced;
  announced.bRead(szFoldersFile);
  for (int i = 0; i < announced.Size(); i++)
    if (announced[i].cKind == 'P') InstallJournal::AddLine(csLines, 'P', announced[i].szText);
}

// As soon as the folders are made: were the run killed on the next page, nobody would know whose they are.
void CNInstallWizard::NoteMadeFolders(const char* szFolder) {
  CNString csFolder(szFolder, 0), csLines;
  csFolder.AddSlash();
  AddAnnouncedFolders(csLines, csFoldersFile().Text());
  if (!csLines.bEmpty()) InstallJournal(csFolder.Text()).bAddLines(csLines.Text());
}

// One that tells of folders only.
void CNInstallWizard::RemoveUnusedJournal(const char* szFolder) {
  CNString csPath(szFolder, 0);
  InstalledList list;
  csPath.AddSlash();
  csPath.Concat(InstalledList::FILE_NAME);
  bool bUsed = !list.bRead(csPath.Text());
  for (int i = 0; i < list.Size(); i++) bUsed = bUsed || list[i].cKind != 'P';
  if (!bUsed) bOsDeleteFile(csPath.Text());
}

// The journal's first lines: what the uninstaller must know when this run breaks off before Uninstall.log is written.
void CNInstallWizard::StartJournal() {
  CNString& csLines = m_Extraction.csJournalStart;
  csLines.Free();
  for (const char* szKey : {"program_name", "program_folder", "default_path", "uninstall"})
    InstallJournal::AddLine(csLines, 'V', szKey, szValue(szKey));
  AddAnnouncedFolders(csLines, csFoldersFile().Text());
  // The quick-launch folder of a user who has never had one.
  CNString csAppData;
  for (const char* szFolder : {"\\Microsoft\\Internet Explorer\\Quick Launch", "\\Microsoft\\Internet Explorer"}) {
    if (strcmp(szValue("quick_launch"), "1") != 0 || !bGetShellFolder(nullptr, "AppData", csAppData)) break;
    csAppData.Concat(szFolder);
    if (!bOsExists(csAppData.Text())) InstallJournal::AddLine(csLines, 'V', "made_folders", csAppData.Text());
  }
  // Ours whatever they hold, as nobody else's is there.
  for (const char* szRecord : {"Uninstall.log", "config.ini"}) {
    CNString csPath = m_csUnzipFolder;
    csPath.Concat(szRecord);
    if (!bOsExists(csPath.Text())) InstallJournal::AddLine(csLines, 'R', szRecord);
  }
}

void CNInstallWizard::EndUnzip(int iPostedCommand) {
  // Nobody may ask to leave between the end and the next page, so that command goes first; a close would be held back.
  if (iPostedCommand == ID_NEXT) m_View.PostCommand(iPostedCommand);
  m_Extraction.iBusy = 0;
  if (iPostedCommand != ID_NEXT) m_View.PostCommand(iPostedCommand);
}

int CNInstallWizard::iUnzipThread() {
  const auto giveUp = [this](const char* szMessageBox) {
    Tell(InstallEvent::PayloadFailed, szMessageBox + strlen("msgBox_err_"));
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
  archive.StartReadAhead();
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
  ExtractionPass pass(*this, archive, m_Extraction, m_csUnzipFolder.Text(), m_pReport);
  pass.Run(entries);
  m_Extraction.copiedBytes = pass.CopiedBytes();
  if (m_Extraction.bCancelled) {
    EndUnzip(ID_EXIT);
    return iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iUnzipThread -> bCancelled -> return EVERYTHING_IS_OK");
  }
  Tell(InstallEvent::Copied, nullptr, pass.Failed().Count());
  if (pass.Failed().Count()) {
    LogPrintf("ERROR: CNInstallWizard::iUnzipThread -> %d of %d entries not installed -> return EVERYTHING_IS_OK",
              pass.Failed().Count(), entries.Size());
    CNString csNames;
    pass.Failed().MakeText(csNames);
    iSetVariable("failed_files", csNames.Text());
    iShowMessageBox("msgBox_err_files", MessageIcon::Error);
  }
  EndUnzip(ID_NEXT);
  return EVERYTHING_IS_OK;
}
