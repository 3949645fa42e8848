#include "launcher/RunReport.h"

void RunReport::OnInstallEvent(InstallEvent event, const char* szText, int iNumber) {
  // By InstallEvent; what fails makes the run one that has failed.
  static const struct {
    const char* szFormat;  // null: the event has a method of its own
    std::atomic<bool> RunReport::*pNoted;
  } ROWS[] = {{nullptr, nullptr},
              {"failed: the file %s could not be installed", &RunReport::m_bFailed},
              {"failed: %s", &RunReport::m_bFailed},
              {"failed: the product archive is %s", &RunReport::m_bFailed},
              {"no space on %s", &RunReport::m_bNoSpace},
              {nullptr, nullptr},
              {"the files are copied%s", &RunReport::m_bCopied},
              {"a restart is needed%s", &RunReport::m_bRestart}};
  if (event == InstallEvent::Command) return Command(szText, iNumber);
  if (event == InstallEvent::Percent) return Percent(iNumber);
  const auto& row = ROWS[static_cast<int>(event)];
  this->*row.pNoted = true;
  CNString csText;
  csText.Printf("RunReport::OnInstallEvent", "csText", row.szFormat, szText ? szText : "");
  m_Log.Line("%s", csText.Text());
}

void RunReport::Command(const char* szText, int iCode) {
  if (iCode) m_bFailed = true;
  m_Log.Line(iCode ? "failed: command %s" : "command %s", szText);
}

void RunReport::Percent(int iPercent) {
  if (iPercent / 10 <= m_iTold) return;
  m_iTold = iPercent / 10;
  m_Log.Line("copied %d%%", m_iTold * 10);
}
