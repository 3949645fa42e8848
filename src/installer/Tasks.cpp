// Commands that work in the background while their page is shown, and then go on to the next page as Unzip does.
#include "installer/CNInstallWizard.h"

bool CNInstallWizard::bStartTask(void (CNInstallWizard::*pWork)()) {
  m_iPage = CurrentDialogNumber();
  m_iTaskPage = CurrentDialogNumber();
  m_iUnreported++;
  if (bStartWorker(pWork, m_iTasks)) return true;
  m_iUnreported--;
  return false;
}

// Any thread, at the end of each task; Next is pressed once for each showing of a page. Only while the page that
// started the work is shown: who has left it does not wait any more. The last page has none to go on to.
void CNInstallWizard::PostWorkDone() {
  const bool bLast = --m_iUnreported == 0;
  if (bLast && m_iPage == m_iTaskPage && m_iPage < DialogCount() && !m_bReported.exchange(1))
    m_View.PostCommand(ID_NEXT);
}

// A command that refuses to go on ends the wizard by its result when it stands in a flow text; here it stays.
void CNInstallWizard::OnCommand(int iID) {
  if (iID == ID_EXIT && m_bPageStays) {
    m_bPageStays = false;
    return;
  }
  if (iID == ID_SHOW_DIALOG) m_bReported = 0;
  COrbitWizard::OnCommand(iID);
  m_bPageStays = false;
  m_iPage = CurrentDialogNumber();
  if (m_iPage != m_iTaskPage) m_bStopSearch = 1;
}
