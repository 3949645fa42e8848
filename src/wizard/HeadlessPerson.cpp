// What a person does at the view without a screen.
#include <algorithm>
#include <cstring>

#include "controls/Kinds.h"
#include "controls/MenuKinds.h"
#include "wizard/FieldKinds.h"
#include "wizard/HeadlessView.h"

namespace {

bool bIsClickable(const BaseControl& control) {
  if (control.Kind() == ControlKind::Static) return static_cast<const CNStatic&>(control).m_bLink;
  return control.Kind() == ControlKind::Button || control.Kind() == ControlKind::CheckBox;
}

bool bIsOneOf(const BaseControl& control, std::initializer_list<ControlKind> kinds) {
  return std::find(kinds.begin(), kinds.end(), control.Kind()) != kinds.end();
}

bool bIsTyped(const BaseControl& control) {
  if (control.m_dwStyle & STYLE_ES_READONLY) return false;
  return bIsOneOf(control, {ControlKind::Edit, ControlKind::RichEdit}) ||
         (control.Kind() == ControlKind::Combo && control.bHasFlag("EDIT"));
}

}  // namespace

BaseControl* HeadlessView::pUsable(const char* szName) {
  BaseControl* pControl = m_pDialog && m_pEvents ? m_pDialog->GetBaseControl(szName) : nullptr;
  return pControl && bUsable(*pControl) ? pControl : nullptr;
}

// What stands in a container goes with it.
bool HeadlessView::bUsable(const BaseControl& control) {
  CNSemHold hold(m_lock);
  for (const BaseControl* p = &control; p; p = p->m_pParent) {
    const ControlState* pState = pStateOf(*p);
    if (!pState || !pState->enabled || !pState->visible) return false;
  }
  return true;
}

bool HeadlessView::bPress(const char* szName) {
  BaseControl* pControl = pUsable(szName);
  return pControl && bPress(*pControl);
}

bool HeadlessView::bPress(BaseControl& control) {
  if (!m_pEvents || !bUsable(control) || !bIsClickable(control)) return false;
  const int iNavigationID = control.Kind() == ControlKind::Button ? static_cast<CNButton&>(control).m_iNavigationID : 0;
  if (iNavigationID) {
    m_pEvents->OnCommand(iNavigationID);
    return true;
  }
  if (control.Kind() == ControlKind::CheckBox) {
    const bool bRadio = static_cast<CNCheckBox&>(control).m_bRadio;
    bSetText(control, !bRadio && TextOf(control) == "1" ? "0" : "1");
  }
  m_pEvents->OnControl(control, NOTIFY_CLICK);
  return true;
}

void HeadlessView::SetField(BaseControl& control, const char* szText) {
  if (bSetText(control, szText) && m_pEvents) m_pEvents->OnControl(control, NOTIFY_SELECTION_CHANGED);
}

bool HeadlessView::bType(const char* szName, const char* szText) {
  BaseControl* pControl = pUsable(szName);
  if (!pControl) return bTypeCell(szName, szText);
  if (bIsSetter(pControl->Kind())) {
    if (bSetText(*pControl, szText)) m_pEvents->OnControl(*pControl, NOTIFY_SELECTION_CHANGED);
    return true;
  }
  if (!bIsTyped(*pControl)) return false;
  m_pEvents->OnControl(*pControl, NOTIFY_SET_FOCUS);
  // The first event may have led to another dialog: what is not shown has no text and loses no focus.
  if (bSetText(*pControl, szText)) m_pEvents->OnControl(*pControl, NOTIFY_KILL_FOCUS);
  return true;
}

bool HeadlessView::bSelect(const char* szName, const char* szItem) {
  BaseControl* pControl = pUsable(szName);
  const bool bHeader = pControl && pControl->Kind() == ControlKind::Header && pControl->bHasFlag("BUTTONS");
  if (!pControl || !(bHeader || bIsList(pControl->Kind()) || pControl->Kind() == ControlKind::Combo)) return false;
  bool bHasItem = false;
  ItemLook look;
  for (const std::string& item : m_states[pControl].items)
    bHasItem |= std::strcmp(szBehindLook(item.c_str(), look), szItem) == 0;
  if (!bHasItem) return false;
  bSetText(*pControl, szItem);
  m_pEvents->OnControl(*pControl, bHeader ? NOTIFY_CLICK : NOTIFY_SELECTION_CHANGED);
  return true;
}

template <class Match>
CNItem* HeadlessView::pFindItem(Match match, BaseControl*& pHolder, int& iItem) {
  for (int i = 0; m_pDialog && m_pEvents && i < m_pDialog->m_Controls.Size(); i++) {
    pHolder = m_pDialog->m_Controls[i];
    const CNItemControl* pItems = pHolder->pItemControl();
    for (iItem = 0; pItems && iItem < pItems->m_Items.Size(); iItem++)
      if (match(*pItems->m_Items[iItem])) return bUsable(*pHolder) ? pItems->m_Items[iItem] : nullptr;
  }
  return nullptr;
}

bool HeadlessView::bChooseItem(const char* szText) {
  BaseControl* pHolder;
  int iItem;
  const auto bCalled = [=](const CNItem& item) {
    ItemLook look;
    return std::strcmp(item.m_csName.Text(), szText) == 0 ||
           std::strcmp(item.m_Shown.Size() ? item.szShown(0, look) : item.szText(), szText) == 0;
  };
  if (CNItem* pItem = pFindItem(bCalled, pHolder, iItem)) {
    CNString csCommand;
    ItemCommand(*pItem, csCommand);
    if (pItem->bHasFlag("DISABLE")) return false;
    if (csCommand.bEmpty() && bIsList(pHolder->Kind()))
      m_pEvents->OnControl(*pHolder, NOTIFY_DOUBLE_CLICK);
    else
      m_pEvents->OnItem(*pItem);
    return true;
  }
  KeyChord chord;
  return m_pEvents && bReadKey(szText, szText + std::strlen(szText), chord) &&
         m_pEvents->iTranslateKeyAccelerators(chord.iKey, chord.uModifiers) == EVERYTHING_IS_OK;
}

bool HeadlessView::bTick(const char* szVariable, bool bChecked) {
  BaseControl* pHolder;
  int iItem;
  const CNItem* pItem = pFindItem(
      [=](const CNItem& item) {
        CNString csVariable;
        item.FlagArgument("VAR", csVariable);
        return *szVariable && std::strcmp(csVariable.Text(), szVariable) == 0;
      },
      pHolder, iItem);
  if (!pItem || pItem->bHasFlag("DISABLE")) return false;
  bool bBefore = false;
  bIsItemChecked(*pHolder->pItemControl(), iItem, bBefore);
  bCheckItem(*pHolder->pItemControl(), iItem, bChecked);
  if (bBefore != bChecked && bIsList(pHolder->Kind())) m_pEvents->OnControl(*pHolder, NOTIFY_SELECTION_CHANGED);
  return true;
}

// A cell of a list view is known by the variable whose marker it is.
bool HeadlessView::bTypeCell(const char* szVariable, const char* szText) {
  BaseControl* pHolder;
  int iItem, iCell = -1;
  CNItem* pItem = pFindItem(
      [&](const CNItem& item) {
        CNString csVariable;
        for (iCell = 0; iCell < item.m_Texts.Size(); iCell++) {
          item.MarkedVariable(iCell, csVariable);
          if (*szVariable && std::strcmp(csVariable.Text(), szVariable) == 0) return true;
        }
        return false;
      },
      pHolder, iItem);
  if (!pItem || pItem->bHasFlag("DISABLE") || pHolder->Kind() != ControlKind::ListView) return false;
  if (!static_cast<const CNListView*>(pHolder)->bCanEdit(iCell)) return false;
  pItem->SetText(iCell, szText);
  m_states[pHolder].items[size_t(pItem->m_iFirstText) + size_t(iCell)] = szText;
  m_pEvents->OnControl(*pHolder, NOTIFY_EDIT_CHANGE);
  return true;
}

void HeadlessView::Close() {
  if (m_pEvents) m_pEvents->OnCloseRequest();
}

void HeadlessView::EndSession() {
  if (!m_pEvents) return;
  if (m_pEvents->bHoldsQuit())
    m_pEvents->OnBreakOff();
  else
    m_pEvents->OnEndSession();
}

const HeadlessView::ControlState* HeadlessView::pState(const char* szName) const {
  const BaseControl* pControl = m_pDialog ? m_pDialog->GetBaseControl(szName) : nullptr;
  const auto found = m_states.find(pControl);
  return found == m_states.end() ? nullptr : &found->second;
}
