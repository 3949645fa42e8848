// What menu bars and right-click menus have in common.
#include <cstring>

#include "controls/MenuKinds.h"

namespace {

const ItemWord g_words[] = {
    {"ITEM"},
    {"SEPARATOR"},
    {"MENU", ItemLevel::Opens},
    {"SUBMENU", ItemLevel::Opens},
    {"END_MENU", ItemLevel::Closes},
    {"END_SUBMENU", ItemLevel::Closes},
    {"BEGIN"},  // of a right-click menu
};

// "\t" is no escape elsewhere: it is turned here, once, so that a variable's value that holds a path stays a path.
void TurnTabs(CNCharArray& texts) {
  CNStringArray turned;
  for (int i = 0; i < texts.Size(); i++) {
    turned.Add(texts[i], 1);
    if (std::strstr(texts[i], "\\t")) turned[i]->SubstituteAll("CNBaseMenu::TurnTabs", "turned", "\\t", "\t");
  }
  texts.RemoveAll();
  for (int i = 0; i < turned.Size(); i++) texts.Add(turned[i]->Text(), 1);
}

bool bHasLook(const CNItem& item) {
  return item.m_Look.text.bSet || item.m_Look.csPicture.Ptr() || item.m_Font != FontVariant::Normal;
}

}  // namespace

CNBaseMenu::CNBaseMenu(ControlKind kind, const char* szEndWord) : CNItemControl(kind, g_words, szEndWord) {}

void CNBaseMenu::ItemsRead(const ScriptCursor& cursor, ScriptContext& context) {
  m_bOwnerDrawn = bHasFlag("OWNER_DRAWN");
  for (int i = 0; i < m_Items.Size(); i++) {
    TurnTabs(m_Items[i]->m_Texts);
    m_bOwnerDrawn |= bHasLook(*m_Items[i]);
  }
  ReportOpenBlock(*this, cursor, context);
}

void ReportOpenBlock(const CNItemControl& control, const ScriptCursor& cursor, const ScriptContext& context) {
  int nOpen = 0;
  const CNItem* pLast = nullptr;
  for (int i = 0; i < control.m_Items.Size(); i++) {
    const CNItem& item = *control.m_Items[i];
    if (item.Level() == ItemLevel::Opens) pLast = &item;
    nOpen += (item.Level() == ItemLevel::Opens) - (item.Level() == ItemLevel::Closes);
  }
  if (nOpen == 0) return;
  CNString csWord;
  csWord = "END_";
  csWord.Concat(pLast->szKeyword());
  context.Fault(FAULT_MISSING_WORD, cursor, csWord.Text());
}
