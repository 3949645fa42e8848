#include "launcher/SetupRun.h"

#include "foundation/os/Os.h"
#include "installer/CNInstallWizard.h"
#include "launcher/CommandLine.h"
#include "launcher/SfxStream.h"

namespace {

// The run's context; whatever it holds is deleted when the run ends, however that comes.
class SfxHolder {
 public:
  explicit SfxHolder(unsigned uEndPause) : m_uEndPause(uEndPause) {}
  ~SfxHolder() { ReleaseSfx(context, m_uEndPause); }
  SfxHolder(const SfxHolder&) = delete;
  SfxHolder& operator=(const SfxHolder&) = delete;

  SfxContext context;

 private:
  unsigned m_uEndPause;
};

}  // namespace

static bool bCanBeRead(const CNString& csPath) {
  OsFile file;
  return !csPath.bEmpty() && file.bOpen(csPath.Text(), OsOpenMode::Read);
}

static int iReportMissing(WizardView& view, const SetupCommandLine& line) {
  CNString csText;
  csText.Printf("iRunSetup", "csText", "Failed to Open the SFX!?\n%s\n%s", line.csLine.Text(), line.csArgument.Text());
  view.iShowMessage({csText.Text(), nullptr, MessageIcon::Error, MessageButtons::Ok, false});
  csText.SubstituteAll("iRunSetup", "csText", "\n", " -> ");
  return iLogReturn(SETUP_FILE_NOT_OPEN, "ERROR: %s", csText.Text());
}

int iRunSetupIn(const SetupSurroundings& surroundings, const wchar_t* pCommandLine) {
  SetupCommandLine line;
  ReadCommandLine(pCommandLine, line);
  const std::unique_ptr<WizardView> pView = surroundings.pMakeView(surroundings.pContext);
  if (!bCanBeRead(line.csArgument)) return iReportMissing(*pView, line);
  SfxHolder holder(surroundings.uEndPause);  // outlives the wizard, whose workers read the files
  CNInstallWizard installer(*pView, holder.context, *surroundings.pScripts);
  installer.SetSetupPath(line.csArgument.Text());
  installer.SetEndOfSession([](void* pContext) { ReleaseSfx(*static_cast<SfxContext*>(pContext), 0); },
                            &holder.context);
  // Neither result matters: the installer's window opens all the same, and its pages tell what is missing.
  installer.iExecuteInstallWizard(line.csArgument.Text());
  ExpandSfx(surroundings, holder.context, line.csArgument.Text());
  installer.iRunInstallWindow();
  return 0;
}
