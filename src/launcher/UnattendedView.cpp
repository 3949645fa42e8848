// The view of an unattended run, and what a passive one shows.
#include <windows.h>

#include "controls/Kinds.h"
#include "launcher/Unattended.h"

// The screen beside the view in memory, with a window only while a page with a progress bar is shown. The view in
// memory stays what the wizard asks; the screen is only told. Its window's events end here: there is nothing to press,
// and the close box asks for the end of the run.
class UnattendedView::Screen : public WizardEvents {
 public:
  Screen(Walk& walk, std::unique_ptr<WizardView> pView) : m_Walk(walk), m_pView(std::move(pView)) {}
  ~Screen() override { m_pView->CloseWindow(); }

  void Open(WizardEvents& wizard, const WizardWindowOptions& options) {
    m_pWizard = &wizard;
    m_csClassName = options.szClassName;
    m_csClassName.Concat("Passive");
    m_csIcon = options.szProgramIcon;
    m_iIcon = options.iIconResource;
  }
  void Create(DialogInfo& dialog) {
    const WizardWindowOptions options{m_csClassName.Text(), m_iIcon, m_csIcon.Ptr(), nullptr, false};
    bool bProgress = false;
    for (int i = 0; i < dialog.m_Controls.Size(); i++)
      bProgress = bProgress || dialog.m_Controls[i]->Kind() == ControlKind::Progress;
    if (!bProgress) return m_pView->CloseWindow();
    if (m_pView->bHasWindow() || m_pView->bOpenWindow(*this, options)) m_pView->bCreateDialog(dialog);
  }
  void Show(DialogInfo& dialog) {
    if (!m_pView->bHasWindow()) return;
    for (int i = 0; i < dialog.m_Controls.Size(); i++)
      if (dialog.m_Controls[i]->Kind() == ControlKind::Button) m_pView->bEnable(*dialog.m_Controls[i], false);
    m_pView->ShowDialog();
  }
  WizardView& View() { return *m_pView; }

  void OnCommand(int) override {}
  void OnControl(BaseControl&, int) override {}
  void OnCloseRequest() override { m_Walk.Cancel("cancelled by the user"); }
  bool bHoldsQuit() override { return true; }
  const char* szHoldReason() override { return m_pWizard->szHoldReason(); }
  void OnBreakOff() override {
    m_Walk.Cancel("the session ends");
    m_pWizard->OnBreakOff();
  }

 private:
  Walk& m_Walk;
  WizardEvents* m_pWizard = nullptr;
  std::unique_ptr<WizardView> m_pView;
  CNString m_csClassName, m_csIcon;
  int m_iIcon = 0;
};

// The screen's window, and messages that other threads send to it, have no other loop than the walk.
static void HandleMessages() {
  MSG message;
  while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) {
    TranslateMessage(&message);
    DispatchMessageW(&message);
  }
}

UnattendedView::UnattendedView(Walk& walk, std::unique_ptr<WizardView> pScreen) : m_Walk(walk) {
  if (pScreen) m_pScreen.reset(new Screen(walk, std::move(pScreen)));
  onEvent = [&walk](const std::string& event) { walk.OnEvent(event); };
  onIdle = [&walk](HeadlessView& view) {
    HandleMessages();
    return walk.bStep(view);
  };
}

UnattendedView::~UnattendedView() = default;

// ---- what the screen is told ----

bool UnattendedView::bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) {
  if (m_pScreen) m_pScreen->Open(events, options);
  return HeadlessView::bOpenWindow(events, options);
}

void UnattendedView::CloseWindow() {
  if (m_pScreen) m_pScreen->View().CloseWindow();
  HeadlessView::CloseWindow();
}

bool UnattendedView::bCreateDialog(DialogInfo& dialog) {
  if (m_pScreen) m_pScreen->Create(dialog);
  return HeadlessView::bCreateDialog(dialog);
}

void UnattendedView::ShowDialog() {
  HeadlessView::ShowDialog();
  if (m_pScreen && Dialog()) m_pScreen->Show(*Dialog());
}

void UnattendedView::SetCaption(const char* szCaption) {
  if (m_pScreen) m_pScreen->View().SetCaption(szCaption);
  HeadlessView::SetCaption(szCaption);
}

bool UnattendedView::bSetText(const BaseControl& control, const char* szText) {
  if (m_pScreen) m_pScreen->View().bSetText(control, szText);
  return HeadlessView::bSetText(control, szText);
}

bool UnattendedView::bSetCaption(const BaseControl& control, const char* szCaption) {
  if (m_pScreen) m_pScreen->View().bSetCaption(control, szCaption);
  return HeadlessView::bSetCaption(control, szCaption);
}

bool UnattendedView::bSetItems(const BaseControl& control, const CNCharArray& items) {
  if (m_pScreen) m_pScreen->View().bSetItems(control, items);
  return HeadlessView::bSetItems(control, items);
}

bool UnattendedView::bSetProgress(const BaseControl& control, int iPercent) {
  if (m_pScreen) m_pScreen->View().bSetProgress(control, iPercent);
  return HeadlessView::bSetProgress(control, iPercent);
}

bool UnattendedView::bShow(const BaseControl& control, bool bVisible) {
  if (m_pScreen) m_pScreen->View().bShow(control, bVisible);
  return HeadlessView::bShow(control, bVisible);
}

void UnattendedView::SetPixelLayout(bool bPixels) {
  if (m_pScreen) m_pScreen->View().SetPixelLayout(bPixels);
}

double UnattendedView::dScale() const { return m_pScreen ? m_pScreen->View().dScale() : HeadlessView::dScale(); }

int UnattendedView::iCaptionHeight(bool bSmallCaption) const {
  return m_pScreen ? m_pScreen->View().iCaptionHeight(bSmallCaption) : HeadlessView::iCaptionHeight(bSmallCaption);
}

// ---- what would ask a person, or show something of another program ----

int UnattendedView::iShowMessage(const MessageText& message) {
  return m_Walk.iAnswer(*this, message, HeadlessView::iShowMessage(message));
}

bool UnattendedView::bChooseFolder(const char* szTitle, CNString&) {
  m_Walk.LogLine("nobody chooses a folder:", szTitle);
  return false;
}

bool UnattendedView::bChooseFile(const char* szTitle, CNString&) {
  m_Walk.LogLine("nobody chooses a file:", szTitle);
  return false;
}

bool UnattendedView::bOpenLink(const char* szTarget, const char*) {
  m_Walk.LogLine("not opened:", szTarget);
  return true;
}
