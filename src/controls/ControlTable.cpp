#include "controls/ControlTable.h"

#include <iterator>

#include "controls/ContainerKinds.h"
#include "controls/Kinds.h"
#include "controls/MenuKinds.h"
#include "controls/ScriptText.h"
#include "controls/SimpleKinds.h"
#include "foundation/ResultCodes.h"

namespace {

template <class T>
BaseControl* pMake(const ControlRow&) {
  return new T;
}

BaseControl* pMakeList(const ControlRow& row) { return new CNListBox(row.kind == ControlKind::SimulatedListBox); }

BaseControl* pMakeKey(const ControlRow& row) { return new CNKeyAccelerators(row.kind); }

template <const SimpleKind& KIND>
BaseControl* pMakeSimple(const ControlRow&) {
  return new CNSimpleControl(KIND);
}

template <class T, const SimpleKind& KIND>
BaseControl* pMakeContainer(const ControlRow& row) {
  return new T(KIND, row.szEndWord);
}

// In the order of the test. It matters, because a keyword is compared over the given length only: GROUP_BOX stands
// before GROUP, and PROGRESS_BAR is deliberately known by its first six letters. A row that needs variables says true.
const ControlRow g_rows[] = {
    {"BUTTON", 6, ControlRow::iAdd, pMake<CNButton>, "AddButton"},
    {"TEXT_FIELD", 10, ControlRow::iAdd, pMake<CNStatic>, "AddStatic"},
    {"PROGRESS_BAR", 6, ControlRow::iAdd, pMake<CNProgressBar>, "AddProgress"},
    {"CHECK_BOX", 9, ControlRow::iAddCheckBox, pMake<CNCheckBox>, "AddChecBox"},
    {"EDIT_FIELD", 10, ControlRow::iAdd, pMake<CNEdit>, "AddEdit", true},
    {"RICH_EDIT", 9, ControlRow::iAdd, pMake<CNRtf>, "AddRtf", true},
    {"LIST_FIELD", 10, ControlRow::iAdd, pMakeList, "AddListBox", false, ControlKind::ListBox},
    {"SIMULATED_LIST_FIELD", 20, ControlRow::iAdd, pMakeList, "AddListBoxSim", true, ControlKind::SimulatedListBox},
    {"COMBO_FIELD", 11, ControlRow::iAdd, pMake<CNCombo>, "AddCombo", true, ControlKind::Combo, "END_COMBO"},
    {"MESSAGE_BOX", 11, ControlRow::iAdd, pMake<CNMessageBox>, "AddMsgbox"},
    {"MENU_BAR", 8, ControlRow::iAdd, pMake<CNMenu>, "AddMenu", false, ControlKind::MenuBar, "END_MENUBAR"},
    {"RIGHT_CLICK_MENU", 16, ControlRow::iAdd, pMake<CNRightMenu>, "AddRightMenu", false, ControlKind::RightMenu,
     "END_RIGHT_CLICK_MENU"},
    {"GROUP_BOX", 9, ControlRow::iAddGroupBox, pMakeContainer<CNContainer, g_CNGroupBox>, "AddGroupBox", false,
     ControlKind::GroupBox, "END_GROUP_BOX"},
    {"FRAME", 5, ControlRow::iAddFrame, pMakeContainer<CNContainer, g_CNFrame>, "AddFrame", false, ControlKind::Frame,
     "END_FRAME"},
    {"TRACKBAR", 8, ControlRow::iAdd, pMakeSimple<g_CNTrackBar>, "AddTrackbar"},
    {"LISTVIEW", 8, ControlRow::iAdd, pMake<CNListView>, "AddListView", false, ControlKind::ListView, "END_LISTVIEW"},
    {"REBAR", 5, ControlRow::iAdd, pMake<CNRebar>, "AddRebar", true, ControlKind::Rebar, "END_REBAR"},
    {"UP_DOWN", 7, ControlRow::iAdd, pMakeSimple<g_CNUpDown>, "AddUpDown"},
    {"GROUP", 5, ControlRow::iOpenGroup},
    {"END_GROUP", 9, ControlRow::iEndGroup},
    {"ACCELERATOR", 11, ControlRow::iAdd, pMakeKey, "AddAccelerator", false, ControlKind::Accelerator},
    {"GLOBAL_ACCELERATOR", 18, ControlRow::iAdd, pMakeKey, "AddGlobalAccelerator", false,
     ControlKind::GlobalAccelerator},
    {"CURSOR", 6, ControlRow::iAdd, pMakeSimple<g_CNCursor>, "AddCursor"},
    {"SPLITTER", 8, ControlRow::iAdd, pMakeSimple<g_CNSplitter>, "AddSplitter"},
    {"WAVE", 4, ControlRow::iAdd, pMakeSimple<g_CNWave>, "AddWave"},
    {"TREE_VIEW", 9, ControlRow::iAdd, pMake<CNTreeView>, "AddTreeView", false, ControlKind::TreeView, "END_TREE_VIEW"},
    {"IMAGE", 5, ControlRow::iAdd, pMake<CNImage>, "AddBitmap"},
    {"IPADDRESS", 9, ControlRow::iAdd, pMakeSimple<g_CNIPAddress>, "AddIPAddress"},
    {"MONTHCALENDAR", 13, ControlRow::iAdd, pMakeSimple<g_CNMonthCalendar>, "AddMonthCalendar"},
    {"ANIMATION", 9, ControlRow::iAdd, pMakeSimple<g_CNAnimation>, "AddAnimation"},
    {"DATE_PICKER", 11, ControlRow::iAdd, pMakeSimple<g_CNDateTime>, "AddDateTimePicker"},
    {"HOTKEY", 6, ControlRow::iAdd, pMakeSimple<g_CNHotKey>, "AddHotkey"},
    {"HEADER", 6, ControlRow::iAdd, pMake<CNHeader>, "AddHeader"},
    {"PAGER", 5, ControlRow::iAdd, pMakeSimple<g_CNPager>, "AddPager"},
    {"STATUS_BAR", 10, ControlRow::iAdd, pMake<CNStatusBar>, "AddStatusBar"},
    {"TABLE_START", 11, ControlRow::iAddTable},
    {"START_BEFORE_DRAWING", 18, ControlRow::iBeforeDrawing},
    {"START_AFTER_DRAWING", 18, ControlRow::iAfterDrawing},
};
static_assert(std::size(g_rows) == 38, "the dispatch table has 38 rows");

const ControlRow g_containerRows[] = {
    {"PROPERTY_SHEET", 14, ControlRow::iAddContainer, pMakeContainer<CNTabControl, g_CNPropertySheet>,
     "AddPropertySheet", false, ControlKind::PropSheet, "END_PROPERTY_SHEET"},
    {"TAB_CONTROL", 11, ControlRow::iAddContainer, pMakeContainer<CNTabControl, g_CNTabControl>, "AddTabControl", false,
     ControlKind::TabControl, "END_TAB_CONTROL"},
    {"TOOLBAR", 7, ControlRow::iAdd, pMake<CNToolbar>, "AddToolbar", false, ControlKind::Toolbar, "END_TOOLBAR"},
};

template <size_t N>
const ControlRow* pFindRow(const ControlRow (&rows)[N], const char* pLine, const char* pEnd) {
  for (const ControlRow& row : rows)
    if (ScriptText::bStartsWith(pLine, pEnd, row.szKeyword, size_t(row.iLength))) return &row;
  return nullptr;
}

}  // namespace

const ControlRow* ControlRow::pFind(const char* pLine, const char* pEnd) { return pFindRow(g_rows, pLine, pEnd); }

const ControlRow* ControlRow::pFindContainer(const char* pLine, const char* pEnd) {
  return pFindRow(g_containerRows, pLine, pEnd);
}

int ControlRow::iAdd(DialogInfo& dialog, const ControlRow& row, ControlLine& line) {
  return dialog.iAddControl(row, line);
}

int ControlRow::iAddCheckBox(DialogInfo& dialog, const ControlRow& row, ControlLine& line) {
  const int iResult = dialog.iAddControl(row, line);
  if (iResult == EVERYTHING_IS_OK && line.bGroupCheck)
    dialog.m_OpenGroup.Add(dialog.m_Controls[dialog.m_Controls.Size() - 1], 0);
  return iResult;
}

int ControlRow::iAddContainer(DialogInfo& dialog, const ControlRow& row, ControlLine& line) {
  const int iResult = dialog.iAddControl(row, line);
  if (iResult == EVERYTHING_IS_OK)
    dialog.OpenContainer(static_cast<CNContainer&>(*dialog.m_Controls[dialog.m_Controls.Size() - 1]), line);
  return iResult;
}

int ControlRow::iAddGroupBox(DialogInfo& dialog, const ControlRow& row, ControlLine& line) {
  dialog.m_bHasGroupBoxes = true;
  return iAddContainer(dialog, row, line);
}

int ControlRow::iAddFrame(DialogInfo& dialog, const ControlRow& row, ControlLine& line) {
  dialog.m_bHasFrames = true;
  return iAddContainer(dialog, row, line);
}

int ControlRow::iOpenGroup(DialogInfo& dialog, const ControlRow&, ControlLine& line) {
  line.bGroupCheck = 1;
  dialog.m_bHasCheckGroups = true;
  return EVERYTHING_IS_OK;
}

int ControlRow::iEndGroup(DialogInfo& dialog, const ControlRow&, ControlLine& line) {
  line.bGroupCheck = 0;
  dialog.CloseGroup();
  return EVERYTHING_IS_OK;
}

int ControlRow::iAddTable(DialogInfo& dialog, const ControlRow&, ControlLine& line) {
  return dialog.iAddTable(line.cursor, line.context);
}

int ControlRow::iBeforeDrawing(DialogInfo& dialog, const ControlRow& row, ControlLine& line) {
  return dialog.iAddExecuteAction(line.cursor, line.context, row.szKeyword, dialog.m_csBeforeDrawing);
}

int ControlRow::iAfterDrawing(DialogInfo& dialog, const ControlRow& row, ControlLine& line) {
  return dialog.iAddExecuteAction(line.cursor, line.context, row.szKeyword, dialog.m_csAfterDrawing);
}
