#include "controls/ItemKinds.h"

namespace {

const ItemWord g_words[] = {{"ITEM"}};

const FlagRow g_flags[] = {
    {"SORT", STYLE_CBS_SORT},
    {"OWNER_DRAWN", STYLE_CBS_OWNERDRAWFIXED | STYLE_CBS_HASSTRINGS},
};

}  // namespace

CNCombo::CNCombo() : CNItemControl(ControlKind::Combo, g_words, "END_COMBO") {}

void CNCombo::ReadOwnFlags(ScriptContext&) {
  m_bPictures = bHasFlag("IMAGE_COMBO");
  m_bEditable = bHasFlag("EDIT");
  m_dwStyle |= STYLE_VSCROLL | (m_bEditable ? STYLE_CBS_DROPDOWN | STYLE_CBS_AUTOHSCROLL : STYLE_CBS_DROPDOWNLIST);
  // The class with pictures draws and sorts by itself.
  if (!m_bPictures) ApplyFlags(g_flags);
}
