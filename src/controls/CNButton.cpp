#include <cstring>

#include "controls/Kinds.h"
#include "controls/ScriptText.h"
#include "foundation/ResultCodes.h"

using namespace ScriptText;

namespace {

struct NavigationRow {
  const char* szWord;
  int iID;
};
const NavigationRow g_navigation[] = {
    {"ID_NEXT", ID_NEXT},
    {"ID_BACK", ID_BACK},
    {"ID_CANCEL", ID_CANCEL},
    {"ID_EXIT", ID_EXIT},
};

const FlagRow g_flags[] = {
    {"DEFAULT", STYLE_BS_DEFPUSHBUTTON},
    {"MULTILINE", STYLE_BS_MULTILINE},
    {"CENTER", STYLE_BS_VCENTER},
};

const char PICTURE_PREFIX[] = "IDB_";

const char* pPictureEnd(const char* p, const char* pEnd) {
  while (p < pEnd && (bIsDigit(*p) || *p == '_' || IsLetter(static_cast<unsigned char>(*p)))) p++;
  return p;
}

}  // namespace

void CNButton::ReadOwnWords(ScriptCursor& cursor, ScriptContext& context) {
  const char* p = SkipBlanks(cursor.pPos, cursor.pLineEnd);
  if (bStartsWith(p, cursor.pLineEnd, PICTURE_PREFIX)) {
    cursor.pPos = pPictureEnd(p, cursor.pLineEnd);
    m_csPicture.Copy(p, long(cursor.pPos - p));
    return;
  }
  if (!bStartsWith(p, cursor.pLineEnd, "ID_")) return;
  cursor.pPos = SkipWord(p, cursor.pLineEnd);
  CNString csWord;
  csWord.Copy(p, long(cursor.pPos - p));
  for (const NavigationRow& row : g_navigation)
    if (std::strcmp(csWord.Text(), row.szWord) == 0) m_iID = m_iNavigationID = row.iID;
  if (!m_iNavigationID) context.Fault(FAULT_ID, cursor);
}

void CNButton::WriteOwnWords(CNString& csOut) const {
  for (const NavigationRow& row : g_navigation) {
    if (row.iID != m_iNavigationID) continue;
    csOut.Concat(" ");
    csOut.Concat(row.szWord);
  }
  if (m_csPicture.bEmpty() || bHasFlag(PICTURE_PREFIX)) return;
  csOut.Concat(" ");
  csOut.Concat(m_csPicture.Ptr());
}

void CNButton::ReadOwnFlags(ScriptContext&) {
  ApplyFlags(g_flags);
  m_bDefault = bHasFlag("DEFAULT");
  m_bGradient = bHasFlag("GRADIENT");
  m_Top = FlagColor("TOP");
  m_Bottom = FlagColor("BOTTOM");
  const char* pEnd = m_csFlags.Text() + m_csFlags.Length();
  const char* pPicture = FindText(m_csFlags.Text(), pEnd, PICTURE_PREFIX);
  if (pPicture) m_csPicture.Copy(pPicture, long(pPictureEnd(pPicture, pEnd) - pPicture));
  m_bOwnerDrawn = bHasFlag("OWNER_DRAWN") || m_Background.bSet || m_bGradient || !m_csPicture.bEmpty();
  if (m_bOwnerDrawn) m_dwStyle |= STYLE_BS_OWNERDRAW;
}
