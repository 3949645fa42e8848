#include "launcher/SfxStream.h"

#include <windows.h>

#include "archive/CNArchive.h"
#include "archive/Payload.h"
#include "archive/TempArchives.h"
#include "installer/CNExitInstallWizard.h"

static const int PLEASE_WAIT_ICON = 434;

namespace {

// What the expansion's thread works on.
struct Expansion {
  SfxStreamParams params;
  const SfxContext* pContext;
};

}  // namespace

// Unpacks the extra archive into a folder beside it. Single entries may fail.
static void ExtractExtra(const char* szArchive) {
  CNString csFolder(szArchive, 0);
  csFolder.Trim('\\');
  csFolder.Concat("\\Savjetnici\\");
  CNArchive archive(szArchive);
  CNArray<CNArchiveEntry> entries;
  archive.ListEntries(entries);
  for (int i = 0; i < entries.Size(); i++) archive.ExtractEntry(i, csFolder.Text());
}

// Runs on the expansion's thread.
static int iExpand(void* pContext) {
  Expansion& expansion = *static_cast<Expansion*>(pContext);
  const int iResult = ExpandStream(expansion.params);
  if (iResult == 0 && expansion.pContext->GetExtraArchive()) ExtractExtra(expansion.pContext->GetExtraArchive());
  return iResult;
}

int ReadSfxStream(const SetupSurroundings& surroundings, SfxContext& context, const char* szExePath) {
  OsFile input, output;
  SfxStamp stamp;
  CNString csPath;
  if (!input.bOpen(szExePath, OsOpenMode::Read) || !bReadSfxStamp(input, stamp))
    return iLogReturn(SFX_NO_STAMP, "INFO: ReadSfxStream -> !bReadSfxStamp(%s) -> return -99", szExePath);
  if (!input.bSeek(stamp.payloadOffset) || !bOsMakeTempFile(context.csTempFolder.Text(), "@", csPath))
    return iLogReturn(SFX_FAILED, "ERROR: ReadSfxStream -> !bSeek || !bOsMakeTempFile(%s) -> return -98",
                      context.csTempFolder.Text());
  context.csExpandedFile = csPath;
  if (!output.bOpen(csPath.Text(), OsOpenMode::Truncate))
    return iLogReturn(SFX_FAILED, "ERROR: ReadSfxStream -> !bOpen(%s) -> return -98", csPath.Text());
  Expansion expansion;
  expansion.params.pInput = &input;
  expansion.params.pOutput = &output;
  expansion.params.payloadLength = stamp.payloadLength;
  expansion.params.pProgress = [](uint32_t) -> uint32_t { return 0; };
  expansion.pContext = &context;
  int iResult;
  {
    const std::unique_ptr<WizardView> pView = surroundings.pMakeView(surroundings.pContext);
    CNExitInstallWizard wizard(*pView, iExpand, &expansion);
    wizard.iExecuteWizard(surroundings.pScripts->csPleaseWait.Text(), PLEASE_WAIT_ICON);
    iResult = wizard.ExpansionResult();
  }
  context.held.bOpen(csPath.Text(), OsOpenMode::Read);
  if (!output.bClose() || iResult != 0)
    return iLogReturn(SFX_FAILED, "ERROR: ReadSfxStream -> ExpandStream(%s) -> return -98", szExePath);
  return SFX_EXPANDED;
}

int ExpandSfx(const SetupSurroundings& surroundings, SfxContext& context, const char* szExePath) {
  context.csTempFolder = surroundings.szTempFolder;
  if (surroundings.szTempFolder ? !context.csTempFolder.AddSlash() : !bOsGetTempFolder(context.csTempFolder))
    return iLogReturn(SFX_FAILED, "ERROR: ExpandSfx -> !bOsGetTempFolder -> return -98");
  FILETIME now;
  GetSystemTimeAsFileTime(&now);
  RemoveLeftTempArchives(context.csTempFolder.Text(),
                         static_cast<uint64_t>(now.dwHighDateTime) << 32 | now.dwLowDateTime);
  return ReadSfxStream(surroundings, context, szExePath);
}

static void DeleteAndFree(CNString& csPath) {
  if (!csPath.bEmpty() && bOsExists(csPath.Text()) && !bOsDeleteFile(csPath.Text()))
    LogPrintf("ERROR: ReleaseSfx -> !bOsDeleteFile(%s) -> return", csPath.Text());
  csPath.Free();
}

void ReleaseSfx(SfxContext& context, unsigned uPause) {
  context.csTempFolder.Free();
  OsSleep(uPause);
  context.held.bClose();
  DeleteAndFree(context.csExpandedFile);
  DeleteAndFree(context.csExtraArchive);
}
