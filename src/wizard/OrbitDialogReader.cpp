// Reading one dialog block of a script: its header, its font and what its body is made of.
#include "wizard/COrbitWizard.h"
#include "wizard/TextRange.h"

namespace {

// Tested in this order against the first letters after the dialog's number.
const struct {
  const char* szWord;
  DialogKind kind;
} KINDS[] = {
    {"WINDOW", DialogKind::Window}, {"DIALOG_SYS", DialogKind::DialogSys}, {"FLAT_BORDER", DialogKind::FlatBorder},
    {"FLAT", DialogKind::Flat},     {"POPUP", DialogKind::Popup},          {"FLOAT", DialogKind::Float}};

const char* ReadDialogKind(DialogInfo& dialog, const char* p, const char* pLineEnd) {
  dialog.m_csKind = "DIALOG";
  p += strlen("DIALOG");
  while (p < pLineEnd && !IsLetter(static_cast<unsigned char>(*p)) && *p != '\'' && *p != '"') p++;
  dialog.m_bKindWord = p < pLineEnd && IsLetter(static_cast<unsigned char>(*p));
  for (const auto& row : KINDS) {
    if (!range::bStarts(p, pLineEnd, row.szWord)) continue;
    dialog.m_Kind = row.kind;
    dialog.m_csKind = row.szWord;
    break;
  }
  return p;
}

void ReadToolTipTime(DialogInfo& dialog, const char* p, const char* pEnd) {
  p = range::FindText(p, pEnd, "TOOLTIP_TIME");
  const char* pOpen = p ? range::FindChar(p, pEnd, '\'') : nullptr;
  const char* pClose = pOpen ? range::FindChar(pOpen + 1, pEnd, '\'') : nullptr;
  if (!pClose) return;
  pOpen = range::SkipBlanks(pOpen + 1, pClose);
  dialog.m_iToolTipTime = ScriptText::iReadNumber(pOpen, pClose);
}

// A number of the font line, behind blanks: a negative size is that of the characters alone, without the room above.
int iReadFontNumber(const char*& p, const char* pEnd) {
  p = range::SkipBlanks(p, pEnd);
  const bool bNegative = p < pEnd && *p == '-';
  if (bNegative) p++;
  const int iNumber = ScriptText::iReadNumber(p, pEnd);
  return bNegative ? -iNumber : iNumber;
}

}  // namespace

int COrbitWizard::iReadDialog(DialogInfo& dialog, const char* pText, const char* pEnd) {
  ReadDialogHeader(dialog, pText, range::LineEnd(pText, pEnd));
  pText = pReadDialogFont(dialog, range::NextLine(pText, pEnd), pEnd);
  ReadToolTipTime(dialog, pText, pEnd);
  const char* pBegin = range::FindText(pText, pEnd, "BEGIN");
  if (!pBegin) return iFatal("Missing BEGIN in dialog number %d.\nProgram will exit.", m_Dialogs.Size() - 1);
  ReadDialogBody(dialog, range::NextLine(pBegin, pEnd), pEnd);
  return EVERYTHING_IS_OK;
}

void COrbitWizard::ReadDialogHeader(DialogInfo& dialog, const char* pText, const char* pLineEnd) {
  // The first dialog speaks for the whole wizard, which has one window.
  if (m_Dialogs.Size() <= 1) m_View.SetPixelLayout(range::FindText(pText, pLineEnd, "NO_LOGPIXELS") != nullptr);
  ScriptContext context{&m_Report, &m_Variables, m_View.dScale()};
  pText = ReadDialogKind(dialog, pText, pLineEnd);
  pText = pReadDialogName(dialog, pText, pLineEnd);
  if (const char* pOpen = range::FindChar(pText, pLineEnd, '"')) {
    const char* pClose = range::FindChar(pOpen + 1, pLineEnd, '"');
    if (!pClose) m_Report.iReport(FAULT_QUOTE, pOpen);
    dialog.m_csCaption.Copy(pOpen + 1, (pClose ? pClose : pLineEnd) - pOpen - 1);
    pText = pClose ? pClose + 1 : pLineEnd;
  }
  dialog.ReadHeader(pText, pLineEnd, context);
  if (range::FindText(pText, pLineEnd, "MODELESS")) m_bModeless = true;
  AdjustCaptionHeight(dialog);
}

// Returns the place behind the name. An apostrophe of the caption begins no name.
const char* COrbitWizard::pReadDialogName(DialogInfo& dialog, const char* pText, const char* pLineEnd) {
  const char* pQuote = range::FindChar(pText, pLineEnd, '"');
  const char* pOpen = range::FindChar(pText, pQuote ? pQuote : pLineEnd, '\'');
  if (!pOpen) return pText;
  const char* pClose = range::FindChar(pOpen + 1, pLineEnd, '\'');
  if (!pClose) {
    m_Report.iReport(FAULT_APOSTROPHE, pOpen);
    return pText;
  }
  dialog.m_csName.Copy(pOpen + 1, pClose - pOpen - 1);
  const char* szName = dialog.m_csName.Text();
  if (iGetDialogNumberByName(szName, nullptr)) {
    LogPrintf("ERROR: COrbitWizard::iLoadMainListBuffer -> Same names for dialog variable name '%s'", szName);
  } else {
    CNString csNumber;
    csNumber.Printf("COrbitWizard::iLoadMainListBuffer", "csNumber", "%d", m_Dialogs.Size());
    m_pDialogNumbers->Set(szName, csNumber.Text());
  }
  return pClose + 1;
}

// Scripts are written for caption bars of 19 pixels, 16 for the small ones.
void COrbitWizard::AdjustCaptionHeight(DialogInfo& dialog) {
  const bool bSmall = dialog.m_Kind == DialogKind::Popup;
  dialog.m_iHeightDifference = m_View.iCaptionHeight(bSmall) - (bSmall ? 16 : 19);
  dialog.m_bHeightAdjusted = dialog.m_iHeightDifference != 0;
  dialog.m_iSize[3] += dialog.m_iHeightDifference;
}

// Returns the start of the line behind the font line. A BEGIN in its place is no font.
const char* COrbitWizard::pReadDialogFont(DialogInfo& dialog, const char* pText, const char* pEnd) {
  pText = range::SkipSpace(pText, pEnd);
  const char* pLineEnd = range::LineEnd(pText, pEnd);
  const bool bNone = range::bStartsWord(pText, pLineEnd, "BEGIN");
  if (!bNone && pText < pLineEnd && *pText == '"') {
    const char* pClose = range::FindChar(pText + 1, pLineEnd, '"');
    if (!pClose) m_Report.iReport(FAULT_QUOTE, pText);
    dialog.m_Font.csFace.Copy(pText + 1, (pClose ? pClose : pLineEnd) - pText - 1);
    const char* p = pClose ? pClose + 1 : pLineEnd;
    dialog.m_Font.iHeight = iReadFontNumber(p, pLineEnd);
    dialog.m_Font.iWeight = iReadFontNumber(p, pLineEnd);
  } else if (!bNone) {
    dialog.m_Font.csFace.Copy(pText, range::TrimEnd(pText, pLineEnd) - pText);
  }
  dialog.m_Font.iCharSet = 238;  // whatever the line says
  if (m_bHasFontOverride) {
    dialog.m_Font.csFace = m_FontOverride.csFace;
    dialog.m_Font.iHeight = m_FontOverride.iHeight;
    dialog.m_Font.iWeight = m_FontOverride.iWeight;
    dialog.m_Font.iCharSet = m_FontOverride.iCharSet;
  }
  return bNone ? pText : range::NextLine(pText, pEnd);
}

// pText is the line after BEGIN. The flow text keeps the END_DIALOG that ends the block: it is a statement.
void COrbitWizard::ReadDialogBody(DialogInfo& dialog, const char* pText, const char* pEnd) {
  ScriptContext context{&m_Report, &m_Variables, m_View.dScale()};
  const char* pEndWord = DialogInfo::pFindEnd(pText, pEnd);
  if (!pEndWord) m_Report.iReport(FAULT_MISSING_WORD, pText, "END");
  dialog.ReadControls(pText, pEndWord ? pEndWord : pEnd, context);
  if (!pEndWord) return;
  const char* pFlow = range::NextLine(pEndWord, pEnd);
  if (pFlow < pEnd) dialog.m_csFlow.Copy(pFlow, pEnd - pFlow);
}
