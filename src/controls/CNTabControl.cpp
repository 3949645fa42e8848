#include "controls/ContainerKinds.h"
#include "controls/ScriptText.h"

namespace {

const FlagRow g_flags[] = {{"MULTILINE", STYLE_TCS_MULTILINE}};
const char TAB_CLASS[] = "SysTabControl32", PAGE_CLASS[] = "FrameWizardClass";

}  // namespace

const SimpleKind g_CNTabControl = {
    ControlKind::TabControl, "TAB_CONTROL", "CNTabControl", TAB_CLASS, 0, 0, 0, g_flags, 1};
const SimpleKind g_CNPropertySheet = {
    ControlKind::PropSheet, "PROPERTY_SHEET", "CNPropertySheet", TAB_CLASS, 0, 0, 0, g_flags, 1};
const SimpleKind g_CNTab = {ControlKind::Tab,      "TAB", "CNTab", PAGE_CLASS, STYLE_CLIPCHILDREN, STYLE_TABSTOP,
                            STYLE_EX_CONTROLPARENT};
const SimpleKind g_CNSheet = {ControlKind::Tab,      "SHEET", "CNSheet", PAGE_CLASS, STYLE_CLIPCHILDREN, STYLE_TABSTOP,
                              STYLE_EX_CONTROLPARENT};

bool bIsTabControl(const BaseControl* pControl) {
  return pControl && (pControl->Kind() == ControlKind::TabControl || pControl->Kind() == ControlKind::PropSheet);
}

bool CNTabControl::bItemTexts(CNCharArray& texts) const {
  for (int i = 0; i < m_Pages.Size(); i++) texts.Add(m_Pages[i]->m_csCaption.Text(), 1);
  return true;
}

// Compared as a whole word: TABLE_START begins with the letters of TAB.
CNContainer* CNTabControl::pMakePage(const char* pLine, const char* pEnd) const {
  const bool bTab = Kind() == ControlKind::TabControl;
  const SimpleKind& kind = bTab ? g_CNTab : g_CNSheet;
  if (!ScriptText::bStartsWithWord(pLine, pEnd, kind.szKeyword)) return nullptr;
  return new CNContainer(kind, bTab ? "END_TAB" : "END_SHEET");
}
