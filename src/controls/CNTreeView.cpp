#include "controls/ItemKinds.h"
#include "controls/ScriptText.h"

using namespace ScriptText;

namespace {

const ItemWord g_words[] = {{"ITEM"}};

const FlagRow g_flags[] = {{"CHECKBOX", STYLE_TVS_CHECKBOXES}};

}  // namespace

CNTreeView::CNTreeView() : CNItemControl(ControlKind::TreeView, g_words, "END_TREE_VIEW") {}

void CNTreeView::ReadOwnFlags(ScriptContext&) {
  m_dwExStyle |= STYLE_EX_CLIENTEDGE;
  m_dwStyle |= STYLE_TVS_LOOK;
  if (!ItemDragging(*this).bAny) m_dwStyle |= STYLE_TVS_DISABLEDRAGDROP;
  ApplyFlags(g_flags);
}

void CNTreeView::Position(const CNItem& item, int& iLevel, int& iPlace) {
  iLevel = 0;
  iPlace = -1;
  const char* p = item.m_csName.Text();
  const char* pEnd = p + item.m_csName.Length();
  if (p == pEnd || !bIsDigit(*p)) return;
  iLevel = iReadNumber(p, pEnd);
  p = SkipBlanks(p, pEnd);
  if (p == pEnd || *p != ',') return;
  p = SkipBlanks(p + 1, pEnd);
  if (p < pEnd && bIsDigit(*p)) iPlace = iReadNumber(p, pEnd);
}
