// The commands for handhelds, as they answer on a computer without one: nobody to synchronise with, nothing waiting,
// no room. Only what the computer itself knows is looked up.
#include "archive/PathGuard.h"
#include "installer/CNInstallWizard.h"
#include "installer/CommandTools.h"

static const char NO_BYTES[] = "0.00 MB";

int CNInstallWizard::iNoHandheld(int* pCommandResult) {
  iAnswer(pCommandResult, COMMAND_NEGATIVE);
  return iLogReturn(EVERYTHING_IS_OK, "INFO: CNInstallWizard::iNoHandheld -> no handheld -> COMMAND_NEGATIVE");
}

int CNInstallWizard::iGetUsers(const char* /*szParam*/, int* pCommandResult) {
  bFillList("user", CNCharArray());
  iSetVariable("user", "");
  return iNoHandheld(pCommandResult);
}

int CNInstallWizard::iInstallTessor(const char* /*szParam*/, int* pCommandResult) {
  return iNoHandheld(pCommandResult);
}

int CNInstallWizard::iInstallMirab(const char* /*szParam*/, int* pCommandResult) { return iNoHandheld(pCommandResult); }

int CNInstallWizard::iCheckIfHotSyncInit(const char* /*szParam*/, int* pCommandResult) {
  return iNoHandheld(pCommandResult);
}

// A script waits for this answer: nothing is waiting, so it has finished.
int CNInstallWizard::iCheckIfHotSyncIsFinished(const char* /*szParam*/, int* pCommandResult) {
  return iAnswer(pCommandResult, COMMAND_DONE);
}

int CNInstallWizard::iCheckIfAllIsInstalled(const char* /*szParam*/, int* pCommandResult) {
  iSetVariable("missed_size_in_mem", NO_BYTES);
  iSetVariable("missed_size_on_card", NO_BYTES);
  return iAnswer(pCommandResult, COMMAND_DONE);
}

int CNInstallWizard::iRemoveNotInstalledFiles(const char* /*szParam*/, int* pCommandResult) {
  return iAnswer(pCommandResult, COMMAND_DONE);
}

// Dictionaries are folders of the destination; several chosen ones stand one a line.
int CNInstallWizard::iSetExpansionCardTotalSize(const char* /*szParam*/, int* pCommandResult) {
  CNString csChosen, csFolder, csSafe, csTotal;
  uint64_t total = 0;
  csGetField("dictionaries", csChosen);
  GetDestination(csFolder);
  const TextList chosen(csChosen.Text(), ";\r\n");
  for (int i = 0; i < chosen.Size(); i++)
    if (bMakeSafePath(chosen[i], csSafe))
      total += FolderBytes(Joined(csFolder.Text(), "\\", csSafe.Text()).Text(), "*.pdb");
  const unsigned uTotal = total > 0xffffffff ? 0xffffffff : static_cast<unsigned>(total);
  csTotal.Printf("iSetExpansionCardTotalSize", "csTotal", "%u", uTotal);
  iSetVariable("total_size", csTotal.Text());
  return iAnswer(pCommandResult, COMMAND_DONE);
}

// Nothing fits on a card that is not there, and nothing else does.
int CNInstallWizard::iCheckFreeSpace(const char* /*szParam*/, int* pCommandResult) {
  for (const char* p = szValue("total_size"); *p; p++)
    if (*p >= '1' && *p <= '9') return iNoHandheld(pCommandResult);
  return iAnswer(pCommandResult, COMMAND_DONE);
}

int CNInstallWizard::iGetFreeMemSize(const char* szParam, int* pCommandResult) {
  const TextList controls(szOr(szParam, "updown0;updown1"));
  for (int i = 0; i < controls.Size(); i++) {
    const CNString csName = Joined(controls[i], "_free_space");
    iSetVariable(csName.Text(), NO_BYTES);
    if (GetBaseControl(csName.Text())) CWSetWindowText(csName.Text(), NO_BYTES);
  }
  return iAnswer(pCommandResult, COMMAND_DONE);
}

int CNInstallWizard::iCheckActiveSync(const char* /*szParam*/, int* pCommandResult) {
  OsRegistryKey key;
  if (key.bOpen(OS_HKEY_LOCAL_MACHINE, "SOFTWARE\\Microsoft\\Windows\\CurrentVersion\\App Paths\\CEAPPMGR.EXE",
                OsRegAccess::Read))
    return iAnswer(pCommandResult, COMMAND_DONE);
  iShowMessageBox("msgBox_err_noActiveSync", MessageIcon::Error);
  return iStay(pCommandResult);
}
