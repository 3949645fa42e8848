// What a run's log and exit code are made from: the installer tells it of its work.
#pragma once

#include <atomic>

#include "installer/InstallReport.h"
#include "launcher/RunLog.h"

class RunReport : public InstallReport {
 public:
  explicit RunReport(RunLog& log) : m_Log(log) {}

  void OnInstallEvent(InstallEvent event, const char* szText, int iNumber) override;

  bool bFailed() const { return m_bFailed; }    // a file, a step, the payload, a command
  bool bNoSpace() const { return m_bNoSpace; }  // a drive was found too full
  bool bCopied() const { return m_bCopied; }
  bool bRestart() const { return m_bRestart; }

 private:
  void Command(const char* szText, int iCode);
  void Percent(int iPercent);

  RunLog& m_Log;
  std::atomic<bool> m_bFailed{false}, m_bNoSpace{false}, m_bCopied{false}, m_bRestart{false};
  int m_iTold = -1;  // the tenth of the copying that was logged last; the copying thread's
};
