#include "controls/ItemKinds.h"

namespace {

const FlagRow g_flags[] = {
    {"SORT", STYLE_LBS_SORT},
    {"MULTIPLE_SEL", STYLE_LBS_MULTIPLESEL},
    {"KEYINPUT", STYLE_LBS_WANTKEYBOARDINPUT},
    {"OWNER_DRAWN", STYLE_LBS_OWNERDRAWFIXED | STYLE_LBS_HASSTRINGS},
};

const FlagRow g_scrollFlags[] = {
    {"NO_VSCROLL", STYLE_VSCROLL, FlagEffect::Toggle},
    {"NO_HSCROLL", STYLE_HSCROLL, FlagEffect::Toggle},
    {"NO_SCROLL", STYLE_LBS_DISABLENOSCROLL, FlagEffect::Toggle},
};

}  // namespace

void CNTextList::ReadText(ScriptCursor& cursor, ScriptContext& context) { ReadQuotedTexts(cursor, context, m_Items); }

void CNTextList::WriteText(CNString& csOut) const { WriteQuotedTexts(csOut, m_Items); }

bool CNTextList::bItemTexts(CNCharArray& texts) const {
  for (int i = 0; i < m_Items.Size(); i++) texts.Add(m_Items[i], 1);
  return true;
}

void CNListBox::ReadOwnFlags(ScriptContext&) {
  m_dwStyle |= STYLE_LBS_NOTIFY;
  m_dwExStyle |= STYLE_EX_CLIENTEDGE;
  ApplyFlags(g_flags);
  // Each word with SCROLL in it counts as SCROLL, and the toggles may therefore switch a bar on: deliberate, scripts
  // rely on it.
  if (!bHasFlag("SCROLL")) m_dwStyle |= STYLE_VSCROLL | STYLE_HSCROLL;
  ApplyFlags(g_scrollFlags);
}
