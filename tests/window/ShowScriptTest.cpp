// Shows a wizard script on the screen for a person to look at:
// ORBIT_SCRIPT=page.txt window_tests.exe --gtest_also_run_disabled_tests --gtest_filter=*Show*
#include <cstdlib>

#include "Page.h"
#include "wizard/COrbitWizard.h"

TEST(ShowScript, DISABLED_RunsTheWizardOfAFile) {
  const char* szScript = getenv("ORBIT_SCRIPT");
  ASSERT_NE(szScript, nullptr) << "ORBIT_SCRIPT names the script file";
  const std::unique_ptr<WizardView> view = pMakeWin32View(GetModuleHandleW(nullptr));
  COrbitWizard wizard(*view);
  EXPECT_EQ(wizard.iExecuteWizard(szScript, 0), 0);
}
