// The two demonstration wizards, every page of them with native windows.
#include <gtest/gtest.h>

#include "controls/ContainerKinds.h"
#include "support/DemoWizard.h"
#include "support/HighestHandle.h"
#include "support/TestFolder.h"

namespace {

void HandleMessages() {
  MSG message;
  while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) {
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
}

// Every page, and every page of its tab controls.
void ShowAll(DemoView& view, DemoWizard& wizard) {
  for (int i = 1; i <= wizard.DialogCount(); i++) {
    wizard.Show(i);
    const DialogInfo& dialog = *wizard.GetDialog(i);
    for (int k = 0; k < dialog.m_Controls.Size(); k++) {
      if (!bIsTabControl(dialog.m_Controls[k])) continue;
      const auto& tabs = static_cast<const CNTabControl&>(*dialog.m_Controls[k]);
      for (int iPage = tabs.m_Pages.Size(); iPage; iPage--)
        EXPECT_TRUE(view.bSetText(tabs, std::to_string(iPage).c_str())) << tabs.m_csName.Text();
    }
    HandleMessages();
    ASSERT_EQ(wizard.CurrentDialog(), &dialog);
  }
}

// What a script means to be seen: a window of its own, with some size.
void ExpectWindows(DemoView& view, DemoWizard& wizard) {
  for (int i = 1; i <= wizard.DialogCount(); i++) {
    wizard.Show(i);
    const DialogInfo& dialog = *wizard.GetDialog(i);
    for (int k = 0; k < dialog.m_Controls.Size(); k++) {
      const BaseControl& control = *dialog.m_Controls[k];
      if (!control.szWindowClass() || control.bHasFlag("HIDE")) continue;
      CNString csText;
      EXPECT_TRUE(view.bGetText(control, csText)) << dialog.m_csName.Text() << ": " << control.szKeyword() << " "
                                                  << control.m_csName.Text() << " has no window";
    }
  }
}

class GalleryTest : public testing::TestWithParam<const char*> {};

}  // namespace

TEST_P(GalleryTest, ShowsEveryPageWithoutAFaultOrALeak) {
  DemoView view;
  DemoWizard wizard(view);
  ASSERT_TRUE(wizard.bOpen(GetParam()));
  TestFolder folder;
  TestLog log(folder);
  ShowAll(view, wizard);
  ExpectWindows(view, wizard);
  EXPECT_EQ(view.messages, std::vector<std::string>());
  EXPECT_EQ(log.Lines(), std::vector<std::string>());
  // What leaks does so in every round; what the system itself opens late, on a slow machine, does not. (Some of its
  // controls leave a font or two behind each time.)
  int nGrown = 0;
  for (int iRound = 0; iRound < 5; iRound++) {
    const unsigned uObjects = HighestObject(), uWindows = HighestWindow();
    ShowAll(view, wizard);
    nGrown += HighestObject() > uObjects + 16 || HighestWindow() > uWindows + 16;
  }
  EXPECT_LT(nGrown, 5);
}

INSTANTIATE_TEST_SUITE_P(Products, GalleryTest, testing::Values("gallery", "wizard97"));
