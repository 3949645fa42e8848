#include "controls/Kinds.h"

#include <cstring>

#include "controls/ScriptText.h"

using namespace ScriptText;

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

// The items stand before the size, so the first digit outside quotes ends them.
void CNListBox::ReadText(ScriptCursor& cursor, ScriptContext& context) {
  for (const char* p = cursor.pPos; p < cursor.pLineEnd; p++) {
    if (bIsDigit(*p) || bStartsWith(p, cursor.pLineEnd, "TOOLTIP") || bStartsWith(p, cursor.pLineEnd, "ACTION")) return;
    if (*p != '"') continue;
    const char* pClose = FindClosingQuote(p + 1, cursor.pLineEnd);
    if (!pClose) {
      context.Fault(FAULT_QUOTE, cursor);
      cursor.pPos = p + 1;
      return;
    }
    CNString csItem;
    Unescape(p + 1, pClose, csItem);
    m_Items.Add(csItem.Text(), 1);
    p = pClose;
    cursor.pPos = pClose + 1;
  }
}

void CNListBox::WriteText(CNString& csOut) const {
  for (int i = 0; i < m_Items.Size(); i++) {
    csOut.Concat(" \"");
    AppendEscaped(csOut, m_Items[i], std::strlen(m_Items[i]));
    csOut.Concat("\"");
  }
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
