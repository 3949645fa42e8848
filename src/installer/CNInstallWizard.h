// The installer: the wizard engine with the vocabulary of commands that installation scripts call. Everything the
// installer shows and decides is in its script; everything it does to the machine is one of the commands below.
//
// The methods run on the thread of the view's iRun; those named Work, and the workers of Unzip, on one of their own.
#pragma once

#include "foundation/CNSem.h"
#include "installer/CarriedScripts.h"
#include "installer/DiskSpace.h"
#include "installer/ExtractionState.h"
#include "installer/InstallReport.h"
#include "installer/SfxContext.h"
#include "installer/UninstallRecord.h"
#include "wizard/COrbitWizard.h"

class CNListBox;

// What the worker of AddScheduledTask needs.
struct ScheduledTask {
  CNString csName, csProgram, csFolder, csArguments;
  int iHour = 0, iMinute = 0;
};

class CNInstallWizard : public COrbitWizard {
 public:
  // All three must outlive the wizard. The context may still be empty: it is read when commands run.
  CNInstallWizard(WizardView& view, const SfxContext& context, const CarriedScripts& scripts);
  // Waits for the workers, and removes the folders that it made for nothing.
  ~CNInstallWizard() override;

  // Loads the installer script and checks that the drive for temporary files has room for szSizeSource expanded (the
  // user is told when it has not). Returns 0, also after a failed space check, or FUNCTION_ERROR.
  int iExecuteInstallWizard(const char* szSizeSource);
  // Opens the window, shows the first page and returns when the window has closed.
  int iRunInstallWindow();
  void SetSetupPath(const char* szPath) { m_csSetupPath = szPath; }

  int iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pCommandResult,
                       CNString* pOutput) override;
  int iProcessDecideNextDialogAction(int iResult) override;
  void OnCommand(int iID) override;
  bool bHoldsQuit() override { return m_Extraction.iBusy != 0; }
  // Also removes the folders made for nothing, and calls what SetEndOfSession was given.
  void OnEndSession() override;
  // Has the copying stop behind the entry that it is at, waits for that a moment, and ends as OnEndSession does.
  void OnBreakOff() override;
  // pRelease deletes the temporary files when the session ends before the run does; the process may not live to the
  // run's own end.
  void SetEndOfSession(void (*pRelease)(void* pContext), void* pContext) {
    m_pRelease = pRelease;
    m_pReleaseContext = pContext;
  }

  // ---- to be set before the run ----
  // Is told of the work from then on; must outlive the wizard.
  void SetReport(InstallReport* pReport) { m_pReport = pReport; }
  // Nobody watches: no slides, no slowing down for them.
  void SetUnattended() { m_bUnattended = true; }
  // A restart is not offered, only reported.
  void SetNoRestart() { m_bNoRestart = true; }
  // The destination that is proposed, a full path: neither the default nor an earlier version's folder replaces it.
  void SetDestination(const char* szFolder);
  // Has the copying stop behind the entry that it is at, and the wizard end. What was copied stays, listed. Any thread.
  void CancelExtraction() { m_Extraction.bCancelled = 1; }

  // ---- Destination.cpp: parts that other code and tests use ----
  // True when szDrive has room for szFile's content (see DiskSpace.h), when its free space cannot be found out, and for
  // an unknown mode. Else the user is told.
  bool bCheckForDiskSpace(bool bOwned, const char* szDrive, const char* szFile, int iMode);
  // Makes every missing folder of an absolute path. Returns 0, PRECONDITIONS_NOT_VALID or FUNCTION_ERROR.
  static int iCreateDirectory(const char* szPath);

  ExtractionState& Extraction() { return m_Extraction; }
  // True while a worker besides those of Unzip and CopySpeechFile runs.
  bool bTaskRuns() const { return m_iTasks != 0; }
  // A script may hold quitting back without any worker: that is not work.
  bool bWorks() override { return m_Extraction.iWorkers || m_iTasks; }

 protected:
  int iOnCancel() override;
  int iOnExit() override;
  // The free bytes of a drive; false when the system cannot tell. Tests replace it.
  virtual bool bGetFreeSpace(const char* szDrive, uint64_t& bytes);

 private:
  friend struct InstallCommandRow;

  // ---- CNInstallWizard.cpp ----
  bool bMayLeave();
  void Tell(InstallEvent event, const char* szText = nullptr, int iNumber = 0);  // any thread

  // ---- SmallCommands.cpp ----
  int iSetQuitInstall(const char* szParam, int* pCommandResult);
  int iSetVersion(const char* szParam, int* pCommandResult);
  int iRequestSetupA(const char* szParam, int* pCommandResult);
  int iRequestSetupB(const char* szParam, int* pCommandResult);
  int iCheckForMabFon(const char* szParam, int* pCommandResult);
  int iSetUnzipVar(const char* szParam, int* pCommandResult);
  int iReboot(const char* szParam, int* pCommandResult);
  int iEnd(const char* szParam, int* pCommandResult);
  int iOpenAddress(const char* szParam, int* pCommandResult);
  int iCheckForProxy(const char* szParam, int* pCommandResult);
  int iNextPage(const char* szParam, int* pCommandResult);
  int iBackPage(const char* szParam, int* pCommandResult);
  int iRunApp(const char* szParam, int* pCommandResult);

  // ---- Destination.cpp ----
  int iInitDefaultPath(const char* szParam, int* pCommandResult);
  int iParseDefaultPath(const char* szParam, int* pCommandResult);
  int iCheckForFolder(const char* szParam, int* pCommandResult);
  int b_browse_OnClick(const char* szParam, int* pCommandResult);
  bool bMakeDestination(const char* szFolder);
  bool bAskCreate(const char* szFolder);
  void RemoveUnusedFolders();
  void ShowFolderFault(const char* szFolder, const char* szReason);

  // ---- Extraction.cpp, SlideShow.cpp ----
  int iUnzip(const char* szParam, int* pCommandResult);
  int iUnzipThread();
  void StartJournal();
  static CNString csFoldersFile();
  static void AnnounceFolders(const char* szFolder);
  void NoteMadeFolders(const char* szFolder);
  static void RemoveUnusedJournal(const char* szFolder);
  void EndUnzip(int iPostedCommand);
  void PrepareSlides();
  void ShowSlide(int iSlide, bool bVisible);
  void SlideShowThread();
  // The count is that of the running workers.
  bool bStartWorker(void (CNInstallWizard::*pWork)(), std::atomic<int>& iCount);
  void UnzipWork() { iUnzipThread(); }

  // ---- Tasks.cpp: work in the background whose end is a press of Next ----
  bool bStartTask(void (CNInstallWizard::*pWork)());
  void PostWorkDone();

  // ---- OldVersions.cpp ----
  int iCheckForOldVersion(const char* szParam, int* pCommandResult);
  int iRemoveOldLinks(const char* szParam, int* pCommandResult);
  int iBackupOldHalvex(const char* szParam, int* pCommandResult);
  int iCheckForInstalledSoftware(const char* szParam, int* pCommandResult);
  int iAddColvaneToOldInstallation(const char* szParam, int* pCommandResult);
  int iCheckRegistryEntry(const char* szParam, int* pCommandResult);
  bool bFindOldVersion(const char* szNames, CNString& csFolder);
  bool bAddLink(const char* szFolder, const char* szTarget);

  // ---- RunningSoftware.cpp ----
  int iCheckIfSoftwareIsRuning(const char* szParam, int* pCommandResult);
  int iInstallWizard(const char* szParam, int* pCommandResult);
  int iRunHalvex(const char* szParam, int* pCommandResult);
  int iStopHalvex(const char* szParam, int* pCommandResult);
  int iDeinstallToolbar(const char* szParam, int* pCommandResult);
  int iStartHalvexMsg(const char* szParam, int* pCommandResult);
  int iStartDorvik(const char* szParam, int* pCommandResult);
  int iCheckForIEVersion(const char* szParam, int* pCommandResult);
  int iInstallIE(const char* szParam, int* pCommandResult);
  void InstallIEWork();
  bool bSoftwareRuns(const char* szPrograms);
  bool bAskToClose(const char* szBox, const char* szNames, const char* szFolder);
  bool bHasMessageBox(const char* szName) const;
  bool bFindProductFile(const char* szName, CNString& csPath);
  int iStay(int* pCommandResult);  // the answer of a command that refuses to go on

  // ---- Network.cpp ----
  int iSearchNet(const char* szParam, int* pCommandResult);
  int iFillNetListView(const char* szParam, int* pCommandResult);
  int iCreateNetShortCut(const char* szParam, int* pCommandResult);
  void SearchNetWork();
  bool bFoundShare(const char* szShare);

  // ---- Speech.cpp ----
  int iCheckForCDInstallation(const char* szParam, int* pCommandResult);
  int iCopyKVIniFile(const char* szParam, int* pCommandResult);
  int iSetInterfaceLang(const char* szParam, int* pCommandResult);
  int iCopySpeechFile(const char* szParam, int* pCommandResult);
  void CopySpeechWork();
  bool bWriteProduct(const char* szKey, const char* szText);

  // ---- Dictionaries.cpp ----
  int iGetDictionaries(const char* szParam, int* pCommandResult);
  int iDictionariesChanged(const char* szParam, int* pCommandResult);
  int iSetAllowedDict(const char* szParam, int* pCommandResult);
  int iGetLangSupport(const char* szParam, int* pCommandResult);
  int iInstallLangSupport(const char* szParam, int* pCommandResult);
  bool bFillList(const char* szControl, const CNCharArray& texts);
  void EnableControl(const char* szControl, bool bEnabled);
  void GetProductKey(CNString& csKey);
  bool bWriteProductValue(const char* szName, const char* szText);
  bool bRequestLanguages(const char* szGroups);

  // ---- Profile.cpp, ScheduledTask.cpp ----
  int iWriteUserProfile(const char* szParam, int* pCommandResult);
  int iCreateSizeFile(const char* szParam, int* pCommandResult);
  int iAddScheduledTask(const char* szParam, int* pCommandResult);
  void AddTaskWork();

  // ---- FileTypes.cpp ----
  int iAddToContextMenu(const char* szParam, int* pCommandResult);
  int iRegisterWithShell();
  bool bAddFileType(const char* szType);
  void GetMenuKey(CNString& csKey);
  void GetOpenCommand(CNString& csProgram, CNString& csCommand);

  // ---- Handheld.cpp ----
  int iGetUsers(const char* szParam, int* pCommandResult);
  int iInstallTessor(const char* szParam, int* pCommandResult);
  int iSetExpansionCardTotalSize(const char* szParam, int* pCommandResult);
  int iCheckIfHotSyncInit(const char* szParam, int* pCommandResult);
  int iCheckIfHotSyncIsFinished(const char* szParam, int* pCommandResult);
  int iCheckIfAllIsInstalled(const char* szParam, int* pCommandResult);
  int iRemoveNotInstalledFiles(const char* szParam, int* pCommandResult);
  int iCheckActiveSync(const char* szParam, int* pCommandResult);
  int iInstallMirab(const char* szParam, int* pCommandResult);
  int iCheckFreeSpace(const char* szParam, int* pCommandResult);
  int iGetFreeMemSize(const char* szParam, int* pCommandResult);
  int iNoHandheld(int* pCommandResult);

  // ---- Finalization.cpp, Shortcuts.cpp, Fonts.cpp, UpdateRegistry.cpp ----
  int iFinalizeInstallation(const char* szParam, int* pCommandResult);
  int iUpdateRegistry(const char* szParam, int* pCommandResult);
  void ShowNotComplete(const char* szStep);
  int iCheckNames();
  void TrimProgramFolder();
  int iAddToProgramFolders();
  int iCreateDesktopShortcut();
  int iCreateQuickLaunchShortcut();
  int iCreateShortcut(const char* szList, const char* szFolder);
  int iCreateUninstallFile();
  bool bWriteRecord(const char* szFile);
  // To be called before the thing is made.
  void AddUndo(const char* szKey, const char* szItem);
  int iInstallFonts();
  int iInstallFont(const char* szFrom, const char* szFonts, const char* szFile);
  int iMoveUninstaller();
  int iAddRemoveProgram(const char* szKey, const char* szPath, const char* szProgram);
  int iWriteSettings();
  int iWriteEntryDetails(const char* szKey, const char* szPath);
  int iWriteOnlineSettings();
  int iWriteProductKey();
  const CNListBox* pShortcutList(const char* szName) const;
  void GetListItem(const CNListBox& list, int iItem, CNString& csText);
  void GetDestination(CNString& csFolder);

  const SfxContext& m_Context;
  const CarriedScripts& m_Scripts;
  CNString m_csSetupPath;
  CNString m_csVersion;
  InstallReport* m_pReport = nullptr;
  bool m_bUnattended = false;
  bool m_bNoRestart = false;
  bool m_bDestinationGiven = false;
  bool m_bDefaultPathInitialised = false;
  bool m_bSeparateSetup = false;
  bool m_bPageStays = false;  // the last command's result 2 means: stay on this page
  bool m_bAsking = false;     // the exit confirmation is open
  void (*m_pRelease)(void* pContext) = nullptr;
  void* m_pReleaseContext = nullptr;
  ExtractionState m_Extraction;
  CNStringArray m_MadeFolders;  // that the folder question led to, parents first; removed at the end when still empty
  CNString m_csUnzipFolder;     // copied by Unzip for its workers, which must not search the variables
  CNCharArray m_Slides;
  UninstallRecord m_Record;
  CNString* m_pOutput = nullptr;      // of the command that runs
  std::atomic<int> m_iTasks{0};       // workers besides those of m_Extraction
  std::atomic<int> m_iUnreported{0};  // tasks whose end has not been reported
  std::atomic<int> m_bReported{0};
  std::atomic<int> m_iPage{1};      // the number of the dialog shown
  std::atomic<int> m_iTaskPage{0};  // that of the page whose end the running task is
  std::atomic<int> m_bEnding{0};    // the wizard is being destroyed
  std::atomic<int> m_bStopSearch{0};
  std::atomic<int> m_bSearching{0};
  CNSem m_NetLock;                               // for m_Shares
  CNStringArray m_Shares;                        // found by SearchNet
  CNString m_csNetServers;                       // copied for the worker
  CNString m_csSpeechFolder, m_csSpeechCaption;  // copied for its worker
  CNString m_csBrowserSetup;                     // the same
  std::atomic<int> m_bAddingTask{0};             // m_Task is being used
  ScheduledTask m_Task;
};
