#include <algorithm>

#include "controls/DialogInfo.h"
#include "controls/ScriptText.h"

using namespace ScriptText;

namespace {

struct KindRow {
  DialogKind kind;
  uint32_t dwStyle;
  uint32_t dwExStyle;
};
const uint32_t STYLE_INNER = STYLE_CHILD | STYLE_CLIPSIBLINGS | STYLE_CLIPCHILDREN;
const KindRow g_kinds[] = {
    {DialogKind::Window, STYLE_OVERLAPPEDWINDOW, 0},
    {DialogKind::Dialog, STYLE_CAPTION, 0},
    {DialogKind::DialogSys, STYLE_CAPTION | STYLE_SYSMENU, 0},
    {DialogKind::Popup, STYLE_POPUP, 0},
    {DialogKind::Flat, STYLE_INNER, 0},
    {DialogKind::FlatBorder, STYLE_INNER | STYLE_BORDER, 0},
    {DialogKind::Float, STYLE_OVERLAPPEDWINDOW, STYLE_EX_TOOLWINDOW},
};

struct HeaderFlagRow {
  const char* szWord;
  bool DialogInfo::*pMember;
};
const HeaderFlagRow g_flags[] = {
    {"HIDE", &DialogInfo::m_bHide},
    {"INHERIT_SIZE", &DialogInfo::m_bInheritSize},
    {"INHERIT_POSITION", &DialogInfo::m_bInheritPosition},
    {"CENTER", &DialogInfo::m_bCenter},
    {"MAXIMIZE", &DialogInfo::m_bMaximize},
    {"FOCUS", &DialogInfo::m_bFocus},
    {"MODELESS", &DialogInfo::m_bModeless},
    {"NO_LOGPIXELS", &DialogInfo::m_bNoScaling},
};

// A picture's name, and where it stands: PICTURE(name), PICTURE(name,place), PICTURE(name,change_position,x,y).
void ReadPicture(DialogInfo& dialog, const char* p, const char* pEnd) {
  const char* pOpen = FindWord(p, pEnd, "PICTURE");
  pOpen = pOpen ? FindChar(pOpen, pEnd, '(') : nullptr;
  const char* pClose = pOpen ? FindChar(pOpen, pEnd, ')') : nullptr;
  if (!pClose) return;
  p = pOpen;
  for (CNString* pText : {&dialog.m_csPicture, &dialog.m_csPicturePlace}) {
    if (p == pClose) return;
    const char* pStart = p + 1;
    p = FindChar(pStart, pClose, ',');
    if (!p) p = pClose;
    CopyTrimmed(pStart, p, *pText);
  }
  for (int& iNumber : dialog.m_iPictureAt) {
    p = std::find_if(p, pClose, bIsDigit);
    iNumber = iReadNumber(p, pClose);
  }
}

}  // namespace

void DialogInfo::ReadHeader(const char* pText, const char* pEnd, const ScriptContext& context) {
  const char* pFlags = FindChar(pText, pEnd, ',');
  if (!pFlags) pFlags = pEnd;
  const char* p = pText;
  for (int& iNumber : m_iSize) {
    p = std::find_if(p, pFlags, bIsDigit);
    iNumber = iReadNumber(p, pFlags);
  }
  CopyFlagList(pFlags, pEnd, m_csFlags);

  const char* pList = m_csFlags.Text();
  const char* pListEnd = pList + m_csFlags.Length();
  for (const HeaderFlagRow& row : g_flags) this->*row.pMember = FindText(pList, pListEnd, row.szWord) != nullptr;
  const char* pBackground = FindWord(pList, pListEnd, "BACKGROUND");
  if (pBackground) bReadColor(pBackground + sizeof("BACKGROUND") - 1, pListEnd, m_Background);
  const char* pToolTipTime = FindWord(pList, pListEnd, "TOOLTIP_TIME");
  if (pToolTipTime) {
    const char* pTime = std::find_if(pToolTipTime, pListEnd, bIsDigit);
    if (pTime < pListEnd) m_iToolTipTime = iReadNumber(pTime, pListEnd);
  }

  const DialogKind kind = m_bKindWord ? m_Kind : DialogKind::DialogSys;
  for (const KindRow& row : g_kinds) {
    if (row.kind != kind) continue;
    m_dwStyle = row.dwStyle;
    m_dwExStyle = row.dwExStyle;
  }
  if (!m_bHide) m_dwStyle |= STYLE_VISIBLE;
  if (FindText(pList, pListEnd, "FLAT_BORDER")) m_dwStyle |= STYLE_BORDER;
  if (FindText(pList, pListEnd, "FLOATING")) m_dwExStyle |= STYLE_EX_TOOLWINDOW;
  ReadPicture(*this, pList, pListEnd);
  if (context.dScale <= 1.0 || m_bNoScaling) return;
  m_dScale = context.dScale;
  for (int& iNumber : m_iSize) iNumber = iScaleSize(iNumber, m_dScale);
  for (int& iNumber : m_iPictureAt) iNumber = iScaleSize(iNumber, m_dScale);
}
