#include "InstallerRun.h"

// With one slide of ten minutes the copying pauses behind the first file, however quick the machine.
TEST(BreakOff, TheEndOfTheSessionStopsTheCopyingAndTheNextRunCompletesIt) {
  InstallerRun run, next;
  bool bEnded = false, bReleased = false;
  run.folder.MakeFolder("target");
  run.Load();
  run.wizard.iSetVariable("commercial", "s1");
  run.wizard.Extraction().uSlideInterval = 600000;
  run.wizard.SetEndOfSession([](void* pReleased) { *static_cast<bool*>(pReleased) = true; }, &bReleased);
  run.view.onIdle = [&, onIdle = run.view.onIdle](HeadlessView& shown) {
    if (bEnded || !run.Installed("Plumo.exe")) return onIdle(shown);
    bEnded = true;
    EXPECT_TRUE(run.wizard.bHoldsQuit());
    run.view.EndSession();
    EXPECT_FALSE(run.wizard.bWorks());
    EXPECT_TRUE(bReleased);
    EXPECT_FALSE(run.view.bHasWindow());
    return onIdle(shown);
  };
  run.Run(run.Copying());
  EXPECT_TRUE(bEnded);
  EXPECT_FALSE(run.Installed("UnInstall.exe"));
  const std::string list = TestFolder::ReadFile(run.Destination() + "\\Installed.lst");
  EXPECT_NE(list.find("F Plumo.exe\r\nS 000000007 "), std::string::npos) << list;
  next.Load();
  next.Run(next.ThroughDestination(run.Destination()) + Steps{Press("b_next"), next.ExpectPage("PL-dlg6")});
  for (const char* szName : {"Plumo.exe", "UnInstall.exe", "Help\\Deep\\read me.txt"})
    EXPECT_TRUE(run.Installed(szName)) << szName;
}
