#include <algorithm>
#include <cstring>

#include "controls/Kinds.h"
#include "controls/ScriptText.h"

using namespace ScriptText;

// The picture is a bare word, or the caption when its name holds blanks. A word of digits alone is the size already.
void CNImage::ReadOwnWords(ScriptCursor& cursor, ScriptContext&) {
  const char* pFound = FindWord(cursor.pPos, cursor.pLineEnd, "ACTION");
  const char* p = SkipBlanks(cursor.pPos, cursor.pLineEnd);
  const char* pWordEnd = SkipWord(p, pFound ? pFound : cursor.pLineEnd);
  if (std::any_of(p, pWordEnd, [](char c) { return !bIsDigit(c) && c != '-'; })) {
    m_csPicture.Copy(p, long(pWordEnd - p));
    cursor.pPos = pWordEnd;
  } else if (!m_csCaption.bEmpty()) {
    m_csPicture = m_csCaption.Ptr();
  }
}

void CNImage::WriteOwnWords(CNString& csOut) const {
  if (m_csPicture.bEmpty() || std::strcmp(m_csPicture.Text(), m_csCaption.Text()) == 0) return;
  csOut.Concat(" ");
  csOut.Concat(m_csPicture.Ptr());
}

void CNImage::ReadOwnFlags(ScriptContext&) {
  m_bCustom = bHasFlag("CUSTOM");
  m_bStretch = bHasFlag("STRETCH");
  m_Transparent = FlagColor("TRANSPARENT");
  m_dwStyle &= ~STYLE_TABSTOP;
  if (!m_bCustom) m_dwStyle |= STYLE_SS_BITMAP | STYLE_SS_NOTIFY;
}
