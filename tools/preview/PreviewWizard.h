// The wizard of a script that is looked at: tells its events and commands as they happen, and leaves the installer's
// commands alone. Ctrl+PgDn and Ctrl+PgUp show the next and the former dialog of the text, whatever the flow says.
#pragma once

#include <utility>
#include <vector>

#include "PreviewView.h"
#include "ToolWizard.h"

// What is on the screen when a script is to be read again.
struct PreviewPlace {
  std::string dialog;                                            // its name
  int iDialog = 1;                                               // used when there is no dialog of that name
  std::vector<std::pair<std::string, std::string>> values = {};  // variables that differ from what the script said
  POINT corner = {};
  bool bPlaced = false;
};

class PreviewWizard : public ToolWizard {
 public:
  // The view must outlive the wizard.
  explicit PreviewWizard(PreviewView& view) : ToolWizard(view), m_Screen(view) {}

  // ToolWizard::iLoadScript, and remembers the variables.
  int iLoad(const std::string& path);
  bool bOpen();
  int Find(const PreviewPlace& place) const;
  // Shows a dialog by its number, without going through the flow.
  void Show(int iDialog);
  // Runs from that place until the window closes; place then says where it was. True when the script is to be read
  // again.
  bool bRun(PreviewPlace& place);
  // Any thread: ends bRun.
  void PostReload() { m_View.PostCommand(ID_RELOAD); }

  int iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pCommandResult,
                       CNString* pOutput) override;
  void OnCommand(int iID) override;
  void OnControl(BaseControl& control, int iNotification) override;
  void OnItem(BaseControl& item) override;
  int iTranslateKeyAccelerators(int iKey, unsigned uModifiers) override;

 private:
  static const int ID_RELOAD = 490;  // below the first control's identifier
  using Values = std::vector<std::pair<std::string, std::string>>;

  Values AllValues() const;
  // Those that the other list does not have.
  static Values Changes(const Values& now, const Values& before);
  void TellChanges();
  void LeaveForReload();
  void Note(PreviewPlace& place) const;

  PreviewView& m_Screen;
  Values m_loaded, m_told;
  RECT m_area = {};  // of the window when it was closed to read the script again
  bool m_bReload = false;
};
