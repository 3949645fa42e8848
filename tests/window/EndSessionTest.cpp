// The end of the session while a wizard waits, and while it works.
#include "Page.h"
#include "foundation/os/Os.h"
#include "wizard/COrbitWizard.h"
#include "wizard/HeadlessView.h"

using Events = std::vector<std::string>;

namespace {

class WorkingWizard : public RecordingWizard {
 public:
  const char* szHoldReason() override { return events.push_back("reason"), "Files are being copied to šator."; }
  void OnBreakOff() override { events.push_back("break off"); }
};

class EndSession : public testing::Test {
 protected:
  void SetUp() override {
    WizardWindowOptions options;
    options.szClassName = "EndSessionClass";
    ASSERT_TRUE(m_view->bOpenWindow(m_wizard, options));
    ASSERT_TRUE(m_view->bCreateDialog(m_page.info));
    m_view->ShowDialog();
  }
  LRESULT Send(UINT uMessage, bool bEnds) {
    return SendMessageW(FindWindowW(L"EndSessionClass", nullptr), uMessage, bEnds, 0);
  }
  bool bMayEnd() { return Send(WM_QUERYENDSESSION, false) != 0; }
  Events TakeEvents() {
    Events taken;
    taken.swap(m_wizard.events);
    return taken;
  }

  Page m_page{DialogKind::DialogSys, "0 0 300 200", "BUTTON 'b' \"B\" 1 1 75 23\n"};
  WorkingWizard m_wizard;
  const std::unique_ptr<WizardView> m_view = pMakeWin32View(GetModuleHandleW(nullptr));
};

}  // namespace

TEST_F(EndSession, AWizardThatWorksSaysWhyOnceAndIsToldWhenItEndsAllTheSame) {
  EXPECT_TRUE(bMayEnd());
  EXPECT_EQ(TakeEvents(), Events{}) << "nobody need know why";
  m_wizard.holdsQuit = true;
  EXPECT_FALSE(bMayEnd());
  EXPECT_FALSE(bMayEnd());
  EXPECT_EQ(TakeEvents(), Events{"reason"});
  Send(WM_ENDSESSION, false);  // it does not end: the reason is withdrawn
  EXPECT_FALSE(bMayEnd());
  EXPECT_EQ(TakeEvents(), Events{"reason"});
  Send(WM_ENDSESSION, true);
  EXPECT_EQ(TakeEvents(), Events{"break off"});
  EXPECT_TRUE(m_view->bHasWindow()) << "only the wizard closes it";
  m_wizard.holdsQuit = false;
  Send(WM_ENDSESSION, true);
  EXPECT_EQ(TakeEvents(), Events{"end session"});
}

TEST_F(EndSession, TheReasonIsWithdrawnWhenTheWorkIsDone) {
  m_wizard.holdsQuit = true;
  EXPECT_FALSE(bMayEnd());
  EXPECT_EQ(TakeEvents(), Events{"reason"});
  MSG message;
  // Until the view has looked at its wizard: it then has to ask anew.
  for (int i = 0; i < 3000 && m_wizard.events.empty(); i++, OsSleep(10)) {
    m_wizard.holdsQuit = false;
    while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) DispatchMessageW(&message);
    m_wizard.holdsQuit = true;
    EXPECT_FALSE(bMayEnd());
  }
  EXPECT_EQ(TakeEvents(), Events{"reason"});
}

TEST(EndOfSession, TheScriptMayGiveTheReasonAndAWizardThatWaitsEndsWithExit) {
  struct Wizard : COrbitWizard {
    using COrbitWizard::COrbitWizard;
    bool bHoldsQuit() override { return bWorking; }
    void OnBreakOff() override { bBrokenOff = true; }
    bool bWorking = true, bBrokenOff = false;
  };
  HeadlessView view;
  Wizard wizard(view);
  EXPECT_STREQ(wizard.szHoldReason(), "Files are being copied.");
  view.onIdle = [&](HeadlessView&) {
    view.EndSession();
    EXPECT_EQ(view.bHasWindow(), wizard.bWorking);
    EXPECT_TRUE(wizard.bBrokenOff);
    wizard.bWorking = false;
    return true;
  };
  EXPECT_EQ(wizard.iExecuteWizard("INIT\nhold_reason = \"Wait\"\nEND_INIT\nDIALOG1 'a' \"\" 0 0 9 9\nBEGIN\nEND\n"
                                  "CONTINUE\nEND_DIALOG1\n",
                                  0),
            0);
  EXPECT_STREQ(wizard.szHoldReason(), "Wait");
  EXPECT_EQ(wizard.EndedBy(), ID_EXIT);
}
