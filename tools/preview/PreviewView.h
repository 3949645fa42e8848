// The native view of a script that somebody is writing: tells on the standard output what the wizard shows, in UTF-8
// and one line each.
#pragma once

#include <string>

#include "window/WindowView.h"

// Prints a line; its text is code page 1250 and may hold line feeds.
void PrintLine(const std::string& text);

class PreviewView : public CNWindowView {
 public:
  // bStill: pictures are taken of it. Nobody answers its boxes, and no command moves it.
  explicit PreviewView(bool bStill);

  HWND hWindow() const;
  // The dialog shown, null before the first.
  const DialogInfo* Dialog() const { return m_pDialog; }

  bool bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) override;
  bool bCreateDialog(DialogInfo& dialog) override;
  void SetCaption(const char* szCaption) override;
  void ShowDialog() override;
  void PostCommand(int iID) override;
  void SendCommand(int iID) override;
  // Faults of a script that is being loaded are printed only.
  int iShowMessage(const MessageText& message) override;
  bool bOpenLink(const char* szTarget, const char* szFolder) override;
  bool bChooseFolder(const char* szTitle, CNString& csFolder) override;
  bool bChooseFile(const char* szTitle, CNString& csFile) override;

 private:
  const bool m_bStill;
  DialogInfo* m_pDialog = nullptr;
  std::string m_caption;
  std::wstring m_className;
};
