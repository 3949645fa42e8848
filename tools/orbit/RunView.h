// The view of `orbit run`: prints what a person would see, one line each, in UTF-8.
#pragma once

#include <cstdio>

#include "wizard/COrbitWizard.h"
#include "wizard/HeadlessView.h"

class RunView : public HeadlessView {
 public:
  // Prints to pOut, and what goes wrong with the run itself to pErrors.
  RunView(FILE* pOut, FILE* pErrors) : m_pOut(pOut), m_pErrors(pErrors) {}

  // The wizard whose dialogs are shown; to be set before it is loaded.
  void SetWizard(const COrbitWizard* pWizard) { m_pWizard = pWizard; }

  // Prints a line; its text is code page 1250 and may hold line feeds.
  void Line(const std::string& text);
  // Prints "error: ..." (UTF-8): the run cannot go on as asked.
  void Fail(const std::string& message);
  bool bFailed() const { return m_bFailed; }
  // A step begins: from here the wizard may show its share of dialogs and post its share of commands.
  void BeginStep() { m_iMoves = 0; }

  int iShowMessage(const MessageText& message) override;
  void ShowDialog() override;
  void PostCommand(int iID) override;
  void CloseWindow() override;
  bool bOpenLink(const char* szTarget, const char* szFolder) override;

 private:
  void Move();
  std::string EndWord() const;
  int ShownNumber() const;

  FILE* m_pOut;
  FILE* m_pErrors;
  const COrbitWizard* m_pWizard = nullptr;
  bool m_bFailed = false;
  int m_iMoves = 0;
};
