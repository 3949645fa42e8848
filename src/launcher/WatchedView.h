// The view of an attended run that keeps a log, or the answers that a person gives: everything goes to the view behind
// it, and what is to be kept is noted on the way.
#pragma once

#include "launcher/Answers.h"
#include "launcher/RunLog.h"
#include "wizard/COrbitWizard.h"

class WatchedView : public WizardView, private WizardEvents {
 public:
  // The log and the answers must outlive the view.
  WatchedView(std::unique_ptr<WizardView> pView, RunLog& log, Answers& answers)
      : m_pView(std::move(pView)), m_Log(log), m_Answers(answers) {}
  // The wizard that is shown, which knows the numbers of its pages.
  void SetWizard(const COrbitWizard* pWizard) { m_pWizard = pWizard; }

  bool bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) override;
  void CloseWindow() override;
  bool bHasWindow() const override { return m_pView->bHasWindow(); }
  int iRun() override { return m_pView->iRun(); }
  void SetCaption(const char* szCaption) override { m_pView->SetCaption(szCaption); }
  void ShowWindow(bool bShow) override { m_pView->ShowWindow(bShow); }
  void PostCommand(int iID) override;
  void SendCommand(int iID) override;
  bool bCreateDialog(DialogInfo& dialog) override;
  void ShowDialog() override { m_pView->ShowDialog(); }
  bool bSetText(const BaseControl& control, const char* szText) override { return m_pView->bSetText(control, szText); }
  bool bGetText(const BaseControl& control, CNString& csText) override { return m_pView->bGetText(control, csText); }
  bool bSetCaption(const BaseControl& control, const char* szText) override {
    return m_pView->bSetCaption(control, szText);
  }
  bool bSetItems(const BaseControl& control, const CNCharArray& items) override {
    return m_pView->bSetItems(control, items);
  }
  bool bCheckItem(const CNItemControl& control, int iItem, bool bChecked) override {
    return m_pView->bCheckItem(control, iItem, bChecked);
  }
  bool bIsItemChecked(const CNItemControl& control, int iItem, bool& bChecked) override {
    return m_pView->bIsItemChecked(control, iItem, bChecked);
  }
  bool bSetToolTip(const BaseControl& control, const char* szText) override {
    return m_pView->bSetToolTip(control, szText);
  }
  bool bSetProgress(const BaseControl& control, int iPercent) override {
    return m_pView->bSetProgress(control, iPercent);
  }
  bool bEnable(const BaseControl& control, bool bEnabled) override { return m_pView->bEnable(control, bEnabled); }
  bool bShow(const BaseControl& control, bool bVisible) override { return m_pView->bShow(control, bVisible); }
  bool bSetFocus(const BaseControl& control) override { return m_pView->bSetFocus(control); }
  intptr_t lSendMessage(const BaseControl& control, unsigned uMessage, uintptr_t wParam, intptr_t lParam) override {
    return m_pView->lSendMessage(control, uMessage, wParam, lParam);
  }
  void Redraw(const BaseControl& control) override { m_pView->Redraw(control); }
  bool bChooseFolder(const char* szTitle, CNString& csFolder) override;
  bool bChooseFile(const char* szTitle, CNString& csFile) override;
  bool bOpenLink(const char* szTarget, const char* szFolder) override { return m_pView->bOpenLink(szTarget, szFolder); }
  int iShowMessage(const MessageText& message) override;
  void SetPixelLayout(bool bPixels) override { m_pView->SetPixelLayout(bPixels); }
  double dScale() const override { return m_pView->dScale(); }
  int iCaptionHeight(bool bSmallCaption) const override { return m_pView->iCaptionHeight(bSmallCaption); }
  std::unique_ptr<WizardView> pMakeOwnedView() override { return m_pView->pMakeOwnedView(); }

 private:
  void OnCommand(int iID) override;
  void OnControl(BaseControl& control, int iNotification) override;
  void OnItem(BaseControl& item) override { m_pEvents->OnItem(item); }
  int iTranslateKeyAccelerators(int iKey, unsigned uModifiers) override {
    return m_pEvents->iTranslateKeyAccelerators(iKey, uModifiers);
  }
  void OnCloseRequest() override { m_pEvents->OnCloseRequest(); }
  bool bHoldsQuit() override { return m_pEvents->bHoldsQuit(); }
  bool bWorks() override { return m_pEvents->bWorks(); }
  const char* szHoldReason() override { return m_pEvents->szHoldReason(); }
  void OnEndSession() override;
  void OnBreakOff() override { m_pEvents->OnBreakOff(); }

  void OnPress(BaseControl& button);
  void NoteFields();
  void NoteItems(const CNItemControl& control);
  void LeavePage();
  std::atomic<int>* pOwnCommands(int iID);

  std::unique_ptr<WizardView> m_pView;
  RunLog& m_Log;
  Answers& m_Answers;
  const COrbitWizard* m_pWizard = nullptr;
  WizardEvents* m_pEvents = nullptr;
  const DialogInfo* m_pDialog = nullptr;
  CNString m_csPage;
  CNArray<BaseControl> m_Pressed;                                     // buttons of this page, in their order
  std::atomic<int> m_OwnCommands[ID_SHOW_DIALOG - ID_NEXT + 1] = {};  // the wizard's that are still to come
  CNSem m_Lock;                                                       // for m_Answers: a worker may show a message
  AnswerPage m_Noted;                                                 // its fields as they were at the last press
};
