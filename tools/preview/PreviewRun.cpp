#include "PreviewRun.h"

#include <chrono>
#include <filesystem>
#include <thread>

#include "OrbitText.h"
#include "PictureFile.h"
#include "PreviewWizard.h"
#include "controls/ContainerKinds.h"
#include "window/Pictures.h"

namespace {

const int EXIT_USAGE = 2;
const auto POLL = std::chrono::milliseconds(300);
const DWORD REST = 250;  // milliseconds that a dialog gets to come to rest before its picture is taken

// Tells whether the script has been written since; a file that is just being replaced has not.
class ScriptWatch {
 public:
  explicit ScriptWatch(const std::string& path) : m_path(ToPath(path)), m_seen(Now()) {}
  bool bChanged() {
    const auto now = Now();
    const bool bRested = now == m_last;
    m_last = now;
    if (!bRested || now == m_seen || now == Time()) return false;
    m_seen = now;
    return true;
  }

 private:
  using Time = std::filesystem::file_time_type;
  Time Now() const {
    std::error_code error;
    const Time time = std::filesystem::last_write_time(m_path, error);
    return error ? Time() : time;
  }

  const std::filesystem::path m_path;
  Time m_seen, m_last = m_seen;
};

// Handles the window's messages for a while.
void Rest() {
  const DWORD dwStart = GetTickCount();
  for (DWORD dwPassed = 0; dwPassed < REST; dwPassed = GetTickCount() - dwStart) {
    MSG message;
    while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) {
      TranslateMessage(&message);
      DispatchMessageW(&message);
    }
    MsgWaitForMultipleObjects(0, nullptr, FALSE, REST - dwPassed, QS_ALLINPUT);
  }
}

std::string NumberOf(int iNumber) { return (iNumber < 10 ? "0" : "") + std::to_string(iNumber); }

std::string FileName(const DialogInfo& dialog, int iNumber) {
  std::string name = NumberOf(iNumber) + "-";
  for (const char c : std::string(dialog.m_csName.Text())) name += isalnum(static_cast<unsigned char>(c)) ? c : '-';
  return name;
}

// Texts of the wizard are code page 1250.
PreviewPlace FirstPlace(const PreviewJob& job) {
  PreviewPlace place;
  ToCp1250(job.page, place.dialog);
  return place;
}

// The page that somebody asks for must be there; one that goes while the script is written is no fault.
void RequirePage(const PreviewWizard& wizard, const PreviewJob& job) {
  int iNumber = 0;
  if (!job.page.empty() && !wizard.iGetDialogNumberByName(FirstPlace(job).dialog.c_str(), &iNumber))
    throw OrbitError("the script has no dialog '" + job.page + "'");
}

class PictureRun {
 public:
  PictureRun(PreviewView& view, PreviewWizard& wizard, const PreviewJob& job)
      : m_view(view), m_wizard(wizard), m_job(job) {}
  int Run() {
    std::error_code ignored;
    std::filesystem::create_directories(ToPath(m_job.folder), ignored);
    const PreviewPlace place = FirstPlace(m_job);
    for (int i = 1; i <= m_wizard.DialogCount() && m_bGood; i++)
      if (m_job.page.empty() || i == m_wizard.Find(place)) Dialog(i);
    m_view.CloseWindow();
    return m_bGood ? 0 : EXIT_USAGE;
  }

 private:
  void Dialog(int iDialog) {
    m_wizard.Show(iDialog);
    DialogInfo& dialog = *m_wizard.GetDialog(iDialog);
    const std::string name = FileName(dialog, iDialog);
    Take(name);
    int iPicture = 1;
    for (int i = 0; i < dialog.m_Controls.Size(); i++) {
      if (!bIsTabControl(dialog.m_Controls[i])) continue;
      const auto& tabs = static_cast<const CNTabControl&>(*dialog.m_Controls[i]);
      for (int iPage = 2; iPage <= tabs.m_Pages.Size(); iPage++) {
        m_view.bSetText(tabs, std::to_string(iPage).c_str());
        Take(name + "-" + std::to_string(++iPicture));
      }
    }
  }
  void Take(const std::string& name) {
    Rest();
    const std::string path = m_job.folder + "/" + name + ".png";
    m_bGood = m_bGood && bWritePicture(m_view.hWindow(), path);
    if (m_bGood)
      PrintLine("picture " + name + ".png");
    else
      std::fprintf(stderr, "error: %s cannot be written\n", path.c_str());
  }

  PreviewView& m_view;
  PreviewWizard& m_wizard;
  const PreviewJob& m_job;
  bool m_bGood = true;
};

int TakePictures(const PreviewJob& job) {
  PreviewView view(true);
  PreviewWizard wizard(view);
  if (const int iResult = wizard.iLoad(job.script)) return iResult;
  RequirePage(wizard, job);
  return wizard.bOpen() ? PictureRun(view, wizard, job).Run() : EXIT_USAGE;
}

// One reading of the script, until it ends or is to be read again.
bool bShowOnce(const PreviewJob& job, ScriptWatch& watch, PreviewPlace& place) {
  PreviewView view(false);
  PreviewWizard wizard(view);
  if (wizard.iLoad(job.script)) {
    PrintLine("the script cannot be shown; waiting for another version of it");
    while (!watch.bChanged()) std::this_thread::sleep_for(POLL);
    return true;
  }
  if (!place.bPlaced) RequirePage(wizard, job);
  std::jthread watcher([&](const std::stop_token& stop) {
    for (; !stop.stop_requested(); std::this_thread::sleep_for(POLL))
      if (watch.bChanged()) wizard.PostReload();
  });
  return wizard.bRun(place);
}

}  // namespace

int RunPreview(const PreviewJob& job) {
  std::error_code ignored;
  std::string folder;
  ToCp1250(FromPath(std::filesystem::absolute(ToPath(job.script), ignored).parent_path() / "pict"), folder);
  SetPictureFolder(folder.c_str());
  if (!job.folder.empty()) return TakePictures(job);
  ScriptWatch watch(job.script);
  PreviewPlace place = FirstPlace(job);
  while (bShowOnce(job, watch, place)) PrintLine("the script has changed");
  return 0;
}
