// A run without a person: the pages of the script in a view without a screen, walked through as by somebody who gives
// the answers of a file and otherwise presses Next.
#pragma once

#include "installer/CNInstallWizard.h"
#include "launcher/Answers.h"
#include "launcher/RunLog.h"
#include "launcher/Switches.h"
#include "wizard/HeadlessView.h"

// How the walk through a run's pages goes. Its views share it; it must outlive them. Made on their thread.
class Walk {
 public:
  Walk(const Switches& switches, const Answers& answers, RunLog& log)
      : m_Switches(switches), m_Answers(answers), m_Log(log) {}

  // The wizard whose pages are shown; null until it is there.
  void SetInstaller(CNInstallWizard* pInstaller) { m_pInstaller = pInstaller; }
  // True when the script has every page and control that the answers name; else the first that is missing is logged.
  bool bAnswersFit();

  // Called when nothing is left to be done: does the next thing that a person would do, at most one that makes the
  // wizard act. False when there is none: the window is to be closed.
  bool bStep(HeadlessView& view);
  void OnEvent(const std::string& event);
  // The answer to a message box, which is logged.
  int iAnswer(const HeadlessView& view, const MessageText& message, int iDefault);
  void LogLine(const char* szWhat, const char* szText) { m_Log.Line("%s %s", szWhat, szText); }
  // A person, or the system, has asked for the end: what the log is to say. The view's thread.
  void Cancel(const char* szWhy);

  bool bFailed() const { return m_bFailed; }        // a page that could not be left, an answer that could not be given
  bool bCancelled() const { return m_bCancelled; }  // by a person, the system, or the answers' press of a Cancel button

 private:
  bool bFail(const char* szFormat, const char* szA, const char* szB);
  void StartPage(HeadlessView& view);
  bool bTakeLine(HeadlessView& view, const AnswerLine& line);
  bool bIsSo(HeadlessView& view, const AnswerLine& line);
  bool bMakeSo(HeadlessView& view, const AnswerLine& line);
  bool bVerify(HeadlessView& view, bool& bActed);
  bool bPressLast(HeadlessView& view);
  bool bAgain(const char* szText);
  bool bHasControl(const DialogInfo& dialog, const AnswerLine& line);

  const Switches& m_Switches;
  const Answers& m_Answers;
  RunLog& m_Log;
  CNInstallWizard* m_pInstaller = nullptr;
  std::atomic<bool> m_bFailed{false};
  bool m_bCancelled = false;
  bool m_bClosed = false;    // the end was asked for: no page is gone on with
  unsigned m_uShowings = 0;  // pages shown so far
  unsigned m_uAnswered = 0;  // m_uShowings of the page that the members below tell of
  const AnswerPage* m_pPage = nullptr;
  CNString m_csPage;
  int m_iLine = 0;          // the next line of the page's answers
  int m_iTried = -1;        // the last line that was tried once more
  bool m_bPressed = false;  // its last button was pressed
  CNString m_csPressed;
  CNString m_csMessage;  // shown last, and how often again
  int m_iRepeats = 0;
  int m_iMessages = 0;                            // on this showing of the page
  const unsigned long m_ulThread = OsThreadId();  // of the views
};

// The view of one wizard of such a run.
class UnattendedView : public HeadlessView {
 public:
  // pScreen (may be null) shows the pages that have a progress bar, and nothing can be pressed on them.
  UnattendedView(Walk& walk, std::unique_ptr<WizardView> pScreen);
  ~UnattendedView() override;

  bool bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) override;
  void CloseWindow() override;
  bool bCreateDialog(DialogInfo& dialog) override;
  void ShowDialog() override;
  void SetCaption(const char* szCaption) override;
  bool bSetText(const BaseControl& control, const char* szText) override;
  bool bSetCaption(const BaseControl& control, const char* szCaption) override;
  bool bSetItems(const BaseControl& control, const CNCharArray& items) override;
  bool bSetProgress(const BaseControl& control, int iPercent) override;
  bool bShow(const BaseControl& control, bool bVisible) override;
  void SetPixelLayout(bool bPixels) override;
  double dScale() const override;
  int iCaptionHeight(bool bSmallCaption) const override;
  int iShowMessage(const MessageText& message) override;
  bool bChooseFolder(const char* szTitle, CNString& csFolder) override;
  bool bChooseFile(const char* szTitle, CNString& csFile) override;
  bool bOpenLink(const char* szTarget, const char* szFolder) override;

 private:
  class Screen;

  Walk& m_Walk;
  std::unique_ptr<Screen> m_pScreen;
};
