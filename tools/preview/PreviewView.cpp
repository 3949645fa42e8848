#include "PreviewView.h"

#include <cstdio>

#include "OrbitText.h"
#include "RunSteps.h"
#include "foundation/os/OsWide.h"

void PrintLine(const std::string& text) {
  std::printf("%s\n", ToUtf8(OneLine(text).c_str()).c_str());
  std::fflush(stdout);
}

static std::string Quoted(const char* szText) { return "\"" + std::string(szText ? szText : "") + "\""; }

PreviewView::PreviewView(bool bStill) : CNWindowView(GetModuleHandleW(nullptr), nullptr), m_bStill(bStill) {}

HWND PreviewView::hWindow() const { return FindWindowW(m_className.c_str(), nullptr); }

bool PreviewView::bOpenWindow(WizardEvents& events, const WizardWindowOptions& options) {
  m_className = Wide(options.szClassName);
  return CNWindowView::bOpenWindow(events, options);
}

bool PreviewView::bCreateDialog(DialogInfo& dialog) {
  if (!CNWindowView::bCreateDialog(dialog)) return false;
  m_pDialog = &dialog;
  return true;
}

void PreviewView::SetCaption(const char* szCaption) {
  m_caption = szCaption;
  CNWindowView::SetCaption(szCaption);
}

void PreviewView::ShowDialog() {
  if (!m_pDialog) return;
  if (m_bStill) m_pDialog->m_bHide = false;
  PrintLine("dialog '" + std::string(m_pDialog->m_csName.Text()) + "' " + Quoted(m_caption.c_str()));
  CNWindowView::ShowDialog();
}

void PreviewView::PostCommand(int iID) {
  if (!m_bStill) CNWindowView::PostCommand(iID);
}

void PreviewView::SendCommand(int iID) {
  if (!m_bStill) CNWindowView::SendCommand(iID);
}

int PreviewView::iShowMessage(const MessageText& message) {
  const std::string box = "message " + Quoted(message.szCaption) + " " + Quoted(message.szText);
  if (m_bStill || !bHasWindow()) {
    PrintLine(box);
    return ANSWER_OK;
  }
  const int iAnswer = CNWindowView::iShowMessage(message);
  PrintLine(box + " -> " + AnswerWord(iAnswer));
  return iAnswer;
}

// Shown, not followed: the person may be trying the same link fifty times.
bool PreviewView::bOpenLink(const char* szTarget, const char*) {
  PrintLine("open " + std::string(szTarget ? szTarget : ""));
  return true;
}

bool PreviewView::bChooseFolder(const char* szTitle, CNString& csFolder) {
  return !m_bStill && CNWindowView::bChooseFolder(szTitle, csFolder);
}

bool PreviewView::bChooseFile(const char* szTitle, CNString& csFile) {
  return !m_bStill && CNWindowView::bChooseFile(szTitle, csFile);
}
