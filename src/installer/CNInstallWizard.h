// The installer: the wizard engine with the vocabulary of commands that installation scripts call. Everything the
// installer shows and decides is in its script; everything it does to the machine is one of the commands below.
//
// The methods run on the thread of the view's iRun, the two workers of Unzip excepted.
#pragma once

#include "installer/CarriedScripts.h"
#include "installer/DiskSpace.h"
#include "installer/ExtractionState.h"
#include "installer/SfxContext.h"
#include "wizard/COrbitWizard.h"

class CNListBox;

class CNInstallWizard : public COrbitWizard {
 public:
  // All three must outlive the wizard. The context may still be empty: it is read when commands run.
  CNInstallWizard(WizardView& view, const SfxContext& context, const CarriedScripts& scripts);
  // Waits for the workers of Unzip, and removes the folders that it made for nothing.
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
  bool bHoldsQuit() override { return m_Extraction.iBusy != 0; }

  // ---- Destination.cpp: parts that other code and tests use ----
  // True when szDrive has room for szFile's content (see DiskSpace.h), when its free space cannot be found out, and for
  // an unknown mode. Else the user is told.
  bool bCheckForDiskSpace(bool bOwned, const char* szDrive, const char* szFile, int iMode);
  // Makes every missing folder of an absolute path. Returns 0, PRECONDITIONS_NOT_VALID or FUNCTION_ERROR.
  static int iCreateDirectory(const char* szPath);

  ExtractionState& Extraction() { return m_Extraction; }

 protected:
  int iOnCancel() override;
  int iOnExit() override;
  // The free bytes of a drive; false when the system cannot tell. Tests replace it.
  virtual bool bGetFreeSpace(const char* szDrive, uint64_t& bytes);

 private:
  friend struct InstallCommandRow;

  // ---- CNInstallWizard.cpp ----
  bool bMayLeave();

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
  bool bRunningProgram(const char* szPrograms);

  // ---- Extraction.cpp, SlideShow.cpp ----
  int iUnzip(const char* szParam, int* pCommandResult);
  int iUnzipThread();
  void EndUnzip(int iPostedCommand);
  void PrepareSlides();
  void ShowSlide(int iSlide, bool bVisible);
  void SlideShowThread();
  bool bStartWorker(void (CNInstallWizard::*pWork)());
  void UnzipWork() { iUnzipThread(); }

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
  int iInstallFonts();
  int iMoveUninstaller();
  int iAddRemoveProgram(const char* szKey, const char* szPath, const char* szProgram);
  int iWriteSettings();
  const CNListBox* pShortcutList(const char* szName) const;
  void GetListItem(const CNListBox& list, int iItem, CNString& csText);
  void GetDestination(CNString& csFolder);

  const SfxContext& m_Context;
  const CarriedScripts& m_Scripts;
  CNString m_csSetupPath;
  CNString m_csVersion;
  bool m_bDefaultPathInitialised = false;
  bool m_bSeparateSetup = false;
  bool m_bPageStays = false;  // the last command's result 2 means: stay on this page
  bool m_bAsking = false;     // the exit confirmation is open
  ExtractionState m_Extraction;
  CNStringArray m_MadeFolders;  // that the folder question led to, parents first; removed at the end when still empty
  CNString m_csUnzipFolder;     // copied by Unzip for its workers, which must not search the variables
  CNCharArray m_Slides;
};
