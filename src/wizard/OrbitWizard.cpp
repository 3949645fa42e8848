// Construction and the run of a wizard.
#include "wizard/COrbitWizard.h"

#include "foundation/os/Os.h"

namespace {

// Several wizards in one process never share a window class.
std::atomic<int> g_iWizards{0};

}  // namespace

COrbitWizard::COrbitWizard(WizardView& view) : m_View(view), m_Report(&view) {
  CNString csSystem;
  OsGetSystemName(csSystem);
  iSetVariable("win_ver", csSystem.Text());
}

COrbitWizard::~COrbitWizard() = default;

int COrbitWizard::iExecuteWizard(const char* szScript, int iIconResource) {
  if (!szScript || !*szScript)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: COrbitWizard::iExecuteWizard -> !szScript || !*szScript -> return PRECONDITIONS_NOT_VALID");
  CNString csClassName;
  csClassName.Printf("COrbitWizard::iExecuteWizard", "csClassName", "WindowWizardClass%d", ++g_iWizards);
  const int iResult = iLoadMainList(szScript);
  return iResult ? iResult : iRunWindow(csClassName.Text(), iIconResource);
}

int COrbitWizard::iRunWindow(const char* szClassName, int iIconResource) {
  CNVariable* pIcon = m_Variables.pFind("program_icon");
  const WizardWindowOptions options{szClassName, iIconResource, pIcon ? pIcon->csValue.Ptr() : nullptr,
                                    m_csConfigurationFile.Ptr(), m_bModeless};
  if (!m_View.bOpenWindow(*this, options))
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: COrbitWizard::iRunWindow -> !m_View.bOpenWindow -> return FUNCTION_ERROR");
  m_View.SetCaption("default");
  m_iEndedBy = 0;
  m_iCurrentDialog = m_iNextDialog = 1;
  m_iNumLastDialog = 0;
  const int iResult = iShowCurrentDialog();
  if (iResult) m_View.CloseWindow();
  m_View.iRun();
  m_pShownDialog = nullptr;
  return iResult;
}

void COrbitWizard::QuitWizard() {
  LogPrintf("EXIT: COrbitWizard::QuitWizard -> return ID_EXIT");
  m_View.PostCommand(ID_EXIT);
}

void COrbitWizard::SetFontOverride(const DialogFont& font) {
  m_FontOverride.csFace = font.csFace;
  m_FontOverride.iHeight = font.iHeight;
  m_FontOverride.iWeight = font.iWeight;
  m_FontOverride.iCharSet = font.iCharSet;
  m_bHasFontOverride = true;
}

void COrbitWizard::EndProcess(int iExitCode) { OsExitProcess(iExitCode); }
