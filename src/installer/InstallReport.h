// What an installation tells of its work to whoever keeps a log and answers for the result.
#pragma once

enum class InstallEvent {
  Command,        // a command has run: its line; 0, or the result code with which it failed
  FileFailed,     // an entry could not be installed: its name
  StepFailed,     // of the finalization: what it was to do
  PayloadFailed,  // the product archive is missing or damaged: which
  NoSpace,        // a drive is too full: which
  Percent,        // of the copying: null; the percentage
  Copied,         // all entries have had their turn: null; how many failed
  Restart,        // the computer is to be restarted: null
};

class InstallReport {
 public:
  virtual ~InstallReport() = default;
  // Any thread.
  virtual void OnInstallEvent(InstallEvent event, const char* szText, int iNumber) = 0;
};
