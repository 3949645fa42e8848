#include "PreviewWizard.h"

#include <algorithm>

#include "OrbitText.h"
#include "controls/MenuKinds.h"
#include "foundation/os/Os.h"
#include "installer/CommandNames.h"

namespace {

const struct {
  int iNumber;
  const char* szWord;
} NOTIFICATIONS[] =
    {
        {NOTIFY_CLICK, "clicked"},
        {NOTIFY_SELECTION_CHANGED, "changed"},
        {NOTIFY_DOUBLE_CLICK, "double clicked"},
        {NOTIFY_EDIT_CHANGE, "edited"},
        {NOTIFY_EDIT_UPDATE, "about to be edited"},
        {NOTIFY_DROP_DOWN, "opened"},
        {NOTIFY_DROP_UP, "closed"},
        {NOTIFY_MOUSE_IN, "mouse came"},
        {NOTIFY_MOUSE_OUT, "mouse left"},
        {NOTIFY_MOUSE_UP, "mouse button up"},
        {NOTIFY_MOUSE_DOWN, "mouse button down"},
        {NOTIFY_SET_FOCUS, "got the keyboard"},
        {NOTIFY_KILL_FOCUS, "lost the keyboard"},
},
  COMMANDS[] = {
      {ID_OK, "Enter"},     {ID_CLOSE, "Escape"},     {ID_NEXT, "ID_NEXT"},
      {ID_BACK, "ID_BACK"}, {ID_CANCEL, "ID_CANCEL"}, {ID_EXIT, "ID_EXIT"},
};

template <class Rows>
const char* szWordOf(const Rows& rows, int iNumber) {
  const auto* pRow =
      std::find_if(std::begin(rows), std::end(rows), [&](const auto& row) { return row.iNumber == iNumber; });
  return pRow == std::end(rows) ? nullptr : pRow->szWord;
}

// The commands behind a page's Next that go on when all is well.
bool bGoesOn(const char* szInstallCommand) {
  static const char* const NAMES[] = {"CheckForFolder", "btn_next_folder_OnClick", "btn_next_OnClick"};
  return std::any_of(std::begin(NAMES), std::end(NAMES),
                     [=](const char* szName) { return iOsCompareNoCase(szName, szInstallCommand) == 0; });
}

const int KEY_PAGE_UP = 0x21, KEY_PAGE_DOWN = 0x22;

}  // namespace

int PreviewWizard::iLoad(const std::string& path) {
  const int iResult = iLoadScript(path, stderr);
  m_loaded = m_told = AllValues();
  return iResult;
}

bool PreviewWizard::bOpen() {
  CNVariable* pIcon = m_Variables.pFind("program_icon");
  const WizardWindowOptions options{"OrbitPreviewClass", 434, pIcon ? pIcon->csValue.Ptr() : nullptr};
  return m_View.bOpenWindow(*this, options);
}

void PreviewWizard::Show(int iDialog) {
  m_iCurrentDialog = m_iNextDialog = iDialog;
  if (iShowCurrentDialog()) m_View.CloseWindow();
  TellChanges();
}

int PreviewWizard::Find(const PreviewPlace& place) const {
  int iDialog = std::clamp(place.iDialog, 1, DialogCount());
  if (!place.dialog.empty()) iGetDialogNumberByName(place.dialog.c_str(), &iDialog);
  return iDialog;
}

bool PreviewWizard::bRun(PreviewPlace& place) {
  for (const auto& [name, value] : place.values) iSetVariable(name.c_str(), value.c_str());
  if (!bOpen()) return false;
  Show(Find(place));
  if (place.bPlaced)
    SetWindowPos(m_Screen.hWindow(), nullptr, place.corner.x, place.corner.y, 0, 0,
                 SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE);
  m_View.iRun();
  if (!m_bReload) PrintLine(std::string("ended ") + (EndedBy() ? szWordOf(COMMANDS, EndedBy()) : "closed"));
  Note(place);
  return m_bReload;
}

void PreviewWizard::LeaveForReload() {
  m_bReload = true;
  iSaveVarFromCurrentDlg(m_pWizDialogInfo);
  GetWindowRect(m_Screen.hWindow(), &m_area);
  m_View.CloseWindow();
}

void PreviewWizard::Note(PreviewPlace& place) const {
  place.iDialog = m_iCurrentDialog;
  if (m_pWizDialogInfo) place.dialog = m_pWizDialogInfo->m_csName.Text();
  place.values = Changes(AllValues(), m_loaded);
  place.corner = {m_area.left, m_area.top};
  place.bPlaced = true;
}

PreviewWizard::Values PreviewWizard::AllValues() const {
  Values values;
  for (int i = 0; i < m_Variables.Size(); i++)
    values.emplace_back(m_Variables[i]->csName.Text(), m_Variables[i]->csValue.Text());
  return values;
}

PreviewWizard::Values PreviewWizard::Changes(const Values& now, const Values& before) {
  Values changes;
  std::copy_if(now.begin(), now.end(), std::back_inserter(changes),
               [&](const auto& value) { return std::find(before.begin(), before.end(), value) == before.end(); });
  return changes;
}

void PreviewWizard::TellChanges() {
  const Values now = AllValues();
  for (const auto& [name, value] : Changes(now, m_told)) PrintLine("variable " + name + " = \"" + value + "\"");
  m_told = now;
}

int PreviewWizard::iExecuteFunction(const char* szCommand, const char* szParam, int iFlag, int* pCommandResult,
                                    CNString* pOutput) {
  const bool bInstaller = iFindInstallCommand(szCommand) >= 0;
  PrintLine("command " + std::string(szCommand) + " (" + (szParam ? szParam : "") + ")" +
            (bInstaller ? ", of the setup program: not run" : ""));
  if (!bInstaller) return COrbitWizard::iExecuteFunction(szCommand, szParam, iFlag, pCommandResult, pOutput);
  *pCommandResult = bGoesOn(szCommand) ? COMMAND_CONTINUE : COMMAND_DONE;
  return EVERYTHING_IS_OK;
}

void PreviewWizard::OnCommand(int iID) {
  if (iID == ID_RELOAD) return LeaveForReload();
  if (const char* szWord = szWordOf(COMMANDS, iID)) PrintLine(std::string("event ") + szWord);
  ToolWizard::OnCommand(iID);
  TellChanges();
}

void PreviewWizard::OnControl(BaseControl& control, int iNotification) {
  const char* szWord = szWordOf(NOTIFICATIONS, iNotification);
  PrintLine(std::string("event ") + control.szKeyword() + " '" + control.m_csName.Text() + "' " +
            (szWord ? szWord : ""));
  ToolWizard::OnControl(control, iNotification);
  TellChanges();
}

void PreviewWizard::OnItem(BaseControl& item) {
  PrintLine(std::string("event ") + item.szKeyword() + " '" + item.m_csName.Text() + "' \"" + item.m_csCaption.Text() +
            "\" chosen");
  ToolWizard::OnItem(item);
  TellChanges();
}

int PreviewWizard::iTranslateKeyAccelerators(int iKey, unsigned uModifiers) {
  const int iResult = ToolWizard::iTranslateKeyAccelerators(iKey, uModifiers);
  const int iStep = iKey == KEY_PAGE_DOWN ? 1 : iKey == KEY_PAGE_UP ? -1 : 0;
  if (iResult != FUNCTION_ERROR || uModifiers != KEY_CTRL || !iStep) return iResult;
  const int iDialog = std::clamp(m_iCurrentDialog + iStep, 1, DialogCount());
  if (iDialog != m_iCurrentDialog) {
    iSaveVarFromCurrentDlg(m_pWizDialogInfo);
    Show(iDialog);
  }
  return EVERYTHING_IS_OK;
}
