// Keys that run commands, and the names of keys.
#include <algorithm>
#include <cstring>
#include <iterator>

#include "controls/MenuKinds.h"
#include "controls/ScriptText.h"

using namespace ScriptText;

namespace {

struct KeyRow {
  const char* szName;
  int iNumber;
};
const KeyRow g_modifiers[] = {{"Ctrl", KEY_CTRL}, {"Shift", KEY_SHIFT}, {"Alt", KEY_ALT}};
// Letters, digits and F1 to F24 follow from their names.
const KeyRow g_keys[] = {
    {"Backspace", 0x08}, {"Tab", 0x09},   {"Enter", 0x0D},  {"Escape", 0x1B}, {"Esc", 0x1B},  {"Space", 0x20},
    {"PgUp", 0x21},      {"PgDn", 0x22},  {"End", 0x23},    {"Home", 0x24},   {"Left", 0x25}, {"Up", 0x26},
    {"Right", 0x27},     {"Down", 0x28},  {"Insert", 0x2D}, {"Ins", 0x2D},    {"Del", 0x2E},  {"Delete", 0x2E},
    {"Plus", 0xBB},      {"Minus", 0xBD}, {"+", 0xBB},      {"-", 0xBD},
};
const int KEY_F1 = 0x70;

char cUpper(char c) { return c >= 'a' && c <= 'z' ? char(c - 'a' + 'A') : c; }

template <size_t N>
int iFindName(const KeyRow (&rows)[N], const char* p, const char* pEnd) {
  for (const KeyRow& row : rows) {
    const char* sz = row.szName;
    const char* q = p;
    while (q < pEnd && *sz && cUpper(*q) == cUpper(*sz)) q++, sz++;
    if (q == pEnd && !*sz) return row.iNumber;
  }
  return 0;
}

int iKeyNamed(const char* p, const char* pEnd) {
  const char c = cUpper(*p);
  if (pEnd - p == 1 && (bIsDigit(c) || (c >= 'A' && c <= 'Z'))) return c;
  if (c == 'F' && pEnd - p > 1 && bIsDigit(p[1])) {
    const int iNumber = iReadNumber(++p, pEnd);
    return p == pEnd && iNumber >= 1 && iNumber <= 24 ? KEY_F1 + iNumber - 1 : 0;
  }
  if (c == '#' && pEnd - p > 1 && bIsDigit(p[1])) {
    const int iNumber = iReadNumber(++p, pEnd);
    return p == pEnd && iNumber < 256 ? iNumber : 0;
  }
  return iFindName(g_keys, p, pEnd);
}

}  // namespace

// What joins a modifier to what follows is a plus sign or a blank; a plus sign behind it is the key.
bool bReadKey(const char* p, const char* pEnd, KeyChord& chord) {
  for (;;) {
    p = SkipBlanks(p, pEnd);
    const char* pWordEnd = p;
    while (pWordEnd < pEnd && IsLetter(static_cast<unsigned char>(*pWordEnd))) pWordEnd++;
    const int iModifier = iFindName(g_modifiers, p, pWordEnd);
    if (!iModifier) break;
    chord.uModifiers |= unsigned(iModifier);
    p = SkipBlanks(pWordEnd, pEnd);
    if (p < pEnd && *p == '+') p++;
  }
  CNString csKey;
  CopyTrimmed(p, pEnd, csKey);
  chord.iKey = csKey.bEmpty() ? 0 : iKeyNamed(csKey.Text(), csKey.Text() + csKey.Length());
  return chord.iKey != 0;
}

void WriteKey(const KeyChord& chord, CNString& csText) {
  CNString csKey;
  csText = "";
  if (!chord.iKey) return;
  for (const KeyRow& row : g_modifiers) {
    if (!(chord.uModifiers & unsigned(row.iNumber))) continue;
    csText.Concat(row.szName);
    csText.Concat("+");
  }
  const KeyRow* pRow =
      std::find_if(g_keys, std::end(g_keys), [&](const KeyRow& row) { return row.iNumber == chord.iKey; });
  const char cKey = char(chord.iKey);
  if (bIsDigit(cKey) || (cKey >= 'A' && cKey <= 'Z'))
    csText.Concat(&cKey, 1);
  else if (chord.iKey >= KEY_F1 && chord.iKey < KEY_F1 + 24)
    csText.Concat(csKey.Printf("WriteKey", "csKey", "F%d", chord.iKey - KEY_F1 + 1));
  else if (pRow != std::end(g_keys))
    csText.Concat(pRow->szName);
  else
    csText.Concat(csKey.Printf("WriteKey", "csKey", "#%d", chord.iKey));
}

void CNKeyAccelerators::ReadOwnWords(ScriptCursor& cursor, ScriptContext& context) {
  const char* pFirst = SkipBlanks(cursor.pPos, cursor.pLineEnd);
  bool bMore = m_csCaption.bEmpty() && !bStartsWith(pFirst, cursor.pLineEnd, "ACTION");
  while (bMore) {
    const char* p = SkipBlanks(cursor.pPos, cursor.pLineEnd);
    cursor.pPos = SkipWord(p, cursor.pLineEnd);
    bMore = iFindName(g_modifiers, p, cursor.pPos) != 0;
    if (!bMore) CopyTrimmed(pFirst, cursor.pPos, m_csCaption);
  }
  if (!bReadKey(m_csCaption.Text(), m_csCaption.Text() + m_csCaption.Length(), m_Key)) context.Fault(FAULT_ID, cursor);
}

void CNKeyAccelerators::ReadOwnFlags(ScriptContext&) {
  const char* pEnd = m_csFlags.Text() + m_csFlags.Length();
  for (const char* p = m_csFlags.Text(); p < pEnd; p++) {
    p = SkipBlanks(p, pEnd);
    const char* pWordEnd = SkipWord(p, pEnd);
    m_Key.uModifiers |= unsigned(iFindName(g_modifiers, p, pWordEnd));
    p = pWordEnd;
  }
}
