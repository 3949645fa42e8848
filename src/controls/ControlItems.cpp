#include "controls/ControlItems.h"

#include <cstring>

#include "controls/ScriptText.h"
#include "foundation/ResultCodes.h"

using namespace ScriptText;

namespace {

const ItemWord g_bareItem = {"ITEM"};

bool bIsPictureName(const char* p, const char* pEnd) {
  return (pEnd - p > 4 && !std::memcmp(pEnd - 4, ".bmp", 4)) || bStartsWith(p, pEnd, "IDB_");
}

bool bIsWord(const char* p, const char* pEnd, const char* szWord) {
  return size_t(pEnd - p) == std::strlen(szWord) && bStartsWith(p, pEnd, szWord);
}

}  // namespace

// The items stand before the size, so the first digit outside quotes ends them.
void ReadQuotedTexts(ScriptCursor& cursor, ScriptContext& context, CNCharArray& texts) {
  for (const char* p = cursor.pPos; p < cursor.pLineEnd; p++) {
    if (bIsDigit(*p) || bStartsWith(p, cursor.pLineEnd, "TOOLTIP") || bStartsWith(p, cursor.pLineEnd, "ACTION")) return;
    if (*p != '"') continue;
    const char* pClose = FindClosingQuote(p + 1, cursor.pLineEnd);
    if (!pClose) {
      context.Fault(FAULT_QUOTE, cursor);
      cursor.pPos = p + 1;
      return;
    }
    CNString csText;
    Unescape(p + 1, pClose, csText);
    texts.Add(csText.Text(), 1);
    p = pClose;
    cursor.pPos = pClose + 1;
  }
}

void WriteQuotedTexts(CNString& csOut, const CNCharArray& texts) {
  for (int i = 0; i < texts.Size(); i++) {
    csOut.Concat(" \"");
    AppendEscaped(csOut, texts[i], std::strlen(texts[i]));
    csOut.Concat("\"");
  }
}

// ---- looks ----

void ItemLook::Read(const char* p, const char* pEnd) {
  while (p < pEnd) {
    p = SkipBlanks(p, pEnd);
    const char* pWord = p;
    if (bStartsWith(p, pEnd, "RGB(")) {
      bReadColor(p, pEnd, text);
      const char* pClose = FindChar(p, pEnd, ')');
      p = pClose ? pClose + 1 : pEnd;
    } else {
      while (p < pEnd && *p != ',') p++;
      const char* pWordEnd = p;
      while (pWordEnd > pWord && pWordEnd[-1] == ' ') pWordEnd--;
      if (bIsPictureName(pWord, pWordEnd)) csPicture.Copy(pWord, long(pWordEnd - pWord));
      if (bIsWord(pWord, pWordEnd, "RIGHT")) bRight = true;
      if (bIsWord(pWord, pWordEnd, "LEFT")) bRight = false;
    }
    if (p < pEnd) p++;
  }
}

const char* szBehindLook(const char* szText, ItemLook& look) {
  const char* pEnd = szText + std::strlen(szText);
  const char* pClose = *szText == '<' ? FindChar(szText, pEnd, '>') : nullptr;
  // Text that only looks like a bracket stays text.
  if (!pClose || !(bStartsWith(szText + 1, pClose, "RGB(") || bIsPictureName(szText + 1, pClose) ||
                   FindText(szText, pClose, ".bmp,") || bIsWord(szText + 1, pClose, "RIGHT")))
    return szText;
  look.Read(szText + 1, pClose);
  return pClose + 1;
}

// ---- one item ----

bool CNItem::bIs(const char* szWord) const { return std::strcmp(m_Word.szWord, szWord) == 0; }

void ItemCommand(const BaseControl& item, CNString& csCommand) {
  csCommand = "";
  if (!item.m_csName.bEmpty() && !bIsDigit(*item.m_csName.Text())) {
    csCommand = item.m_csName.Text();
    if (!FindChar(item.m_csName.Text(), item.m_csName.Text() + item.m_csName.Length(), '('))
      csCommand.Concat(item.m_csAction.Ptr() ? item.m_csAction.Text() : " ()");
    return;
  }
  const char* szAction = item.m_csAction.Text();
  const char* pOpen = std::strchr(szAction, '(');
  const char* pClose = std::strrchr(szAction, ')');
  if (pOpen && pClose > pOpen) CopyTrimmed(pOpen + 1, pClose, csCommand);
}

void CNItem::FlagArgument(const char* szWord, CNString& csArgument) const {
  const char* pEnd = m_csFlags.Text() + m_csFlags.Length();
  csArgument = "";
  const char* p = FindWord(m_csFlags.Text(), pEnd, szWord);
  if (!p || (p += std::strlen(szWord)) == pEnd || *p != '(') return;
  const char* pClose = FindChar(p, pEnd, ')');
  if (pClose) CopyTrimmed(p + 1, pClose, csArgument);
}

const char* CNItem::szShown(int i, ItemLook& look) const {
  look = m_Look;
  return szBehindLook(i < m_Shown.Size() ? m_Shown[i] : "", look);
}

void CNItem::MarkedVariable(int i, CNString& csName) const {
  ItemLook look;
  const char* p = szBehindLook(szText(i), look);
  const char* const pEnd = p + std::strlen(p);
  csName = "";
  if (bStartsWith(p, pEnd, "<%") && FindText(p + 2, pEnd, "%>") == pEnd - 2) csName.Copy(p + 2, long(pEnd - p - 4));
}

namespace {

void Replace(CNCharArray& texts, int iText, const char* szText) {
  CNCharArray before;
  const int nTexts = texts.Size();
  for (int i = 0; i < nTexts; i++) before.Add(texts[i], 1);
  texts.RemoveAll();
  CNString csNew;
  for (int i = 0; i < nTexts || i <= iText; i++) {
    const char* szOld = i < nTexts ? before[i] : "";
    ItemLook look;
    csNew.Copy(szOld, i == iText ? long(szBehindLook(szOld, look) - szOld) : long(std::strlen(szOld)));
    if (i == iText) csNew.Concat(szText);
    texts.Add(csNew.Text(), 1);
  }
}

}  // namespace

void CNItem::SetText(int i, const char* szText) {
  CNString csVariable;
  MarkedVariable(i, csVariable);
  if (csVariable.bEmpty()) Replace(m_Texts, i, szText);
  Replace(m_Shown, i, szText);
}

// A line may do without anything behind its keyword.
int CNItem::iReadScript(ScriptCursor& cursor, ScriptContext& context) {
  ReadLine(cursor, context);
  return EVERYTHING_IS_OK;
}

void CNItem::ReadText(ScriptCursor& cursor, ScriptContext& context) { ReadQuotedTexts(cursor, context, m_Texts); }

void CNItem::WriteText(CNString& csOut) const { WriteQuotedTexts(csOut, m_Texts); }

// The size keeps a quote among the flags from being read as a text.
bool CNItem::bWritesSize() const { return m_iSize[0] || m_iSize[1] || std::strchr(m_csFlags.Text(), '"'); }

void CNItem::ReadOwnFlags(ScriptContext&) { m_Look.Read(m_csFlags.Text(), m_csFlags.Text() + m_csFlags.Length()); }

// ---- the control that holds them ----

int CNItemControl::iReadScript(ScriptCursor& cursor, ScriptContext& context) {
  ReadLine(cursor, context);
  const char* pEndLine = FindEndLine(cursor.pLineEnd, cursor.pTextEnd, szKeyword(), m_szEndWord, false);
  if (!pEndLine) {
    context.Fault(FAULT_MISSING_WORD, cursor, m_szEndWord);
    return EVERYTHING_IS_OK;
  }
  int iLevel = 0;
  while (cursor.bNextLine()) {
    cursor.pPos = SkipBlanks(cursor.pPos, cursor.pLineEnd);
    if (cursor.pPos >= pEndLine) break;
    ReadItem(cursor, context, iLevel);
  }
  cursor.pPos = cursor.pLineEnd;
  CountTexts();
  ItemsRead(cursor, context);
  return EVERYTHING_IS_OK;
}

void CNItemControl::CountTexts() {
  int iTexts = 0;
  for (int i = 0; i < m_Items.Size(); i++) {
    m_Items[i]->m_iFirstText = iTexts;
    iTexts += m_Items[i]->m_Texts.Size();
  }
}

void CNItemControl::TakeShown(const CNCharArray& texts) const {
  for (int i = 0; i < m_Items.Size(); i++) {
    CNItem& item = *m_Items[i];
    item.m_Shown.RemoveAll();
    for (int j = 0; j < item.m_Texts.Size() && item.m_iFirstText + j < texts.Size(); j++)
      item.m_Shown.Add(texts[item.m_iFirstText + j], 1);
  }
}

const ItemWord* CNItemControl::pFindWord(const char* p, const char* pEnd) const {
  if (p < pEnd && *p == '"') return &g_bareItem;
  for (size_t i = 0; i < m_nWords; i++)
    if (bStartsWith(p, pEnd, m_pWords[i].szWord)) return &m_pWords[i];
  return nullptr;
}

// A line that is none of the kind's is ignored, as in a dialog.
void CNItemControl::ReadItem(ScriptCursor& cursor, ScriptContext& context, int& iLevel) {
  const ItemWord* pWord = pFindWord(cursor.pPos, cursor.pLineEnd);
  if (!pWord) return;
  if (*cursor.pPos != '"') cursor.pPos += std::strlen(pWord->szWord);
  if (pWord->level == ItemLevel::Closes) {
    if (iLevel == 0) return;
    iLevel--;
  }
  std::unique_ptr<CNItem> pItem(new CNItem(*pWord));
  pItem->m_iLevel = iLevel;
  ScriptContext itemContext = context;
  if (!m_bScaled) itemContext.dScale = 1.0;  // numbers of items are scaled as those of their control
  pItem->iReadScript(cursor, itemContext);
  if (pWord->level == ItemLevel::Opens) iLevel++;
  m_Items.Add(pItem.release(), 1);
}

void CNItemControl::WriteControl(CNString& csOut) const {
  BaseControl::WriteControl(csOut);
  for (int i = 0; i < m_Items.Size(); i++) {
    csOut.Concat("\n");
    m_Items[i]->WriteControl(csOut);
  }
  csOut.Concat("\n");
  csOut.Concat(m_szEndWord);
}

bool CNItemControl::bItemTexts(CNCharArray& texts) const {
  for (int i = 0; i < m_Items.Size(); i++)
    for (int j = 0; j < m_Items[i]->m_Texts.Size(); j++) texts.Add(m_Items[i]->m_Texts[j], 1);
  return true;
}

void CNItemControl::TakeIDs(int& iNewIDNum) {
  BaseControl::TakeIDs(iNewIDNum);
  for (int i = 0; i < m_Items.Size(); i++) m_Items[i]->m_iID = iNewIDNum++;
}

CNItem* CNItemControl::pFindItem(int iID) const {
  for (int i = 0; i < m_Items.Size(); i++)
    if (m_Items[i]->m_iID == iID) return m_Items[i];
  return nullptr;
}
