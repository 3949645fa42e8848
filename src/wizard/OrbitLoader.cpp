// Loading a script: the text is cleaned once, then everything works on ranges of it, so that a fault's position still
// gives its line in the file.
#include <cstdlib>

#include "foundation/CNStream.h"
#include "wizard/COrbitWizard.h"
#include "wizard/TextRange.h"

namespace {

// One pass: tabs outside quoted text become blanks (quoted text does not go on across lines), carriage returns go, and
// so do comments that have a line to themselves. Line feeds all stay. A zero byte of a file becomes a blank.
void CleanScript(const char* p, long lLength, CNString& csOut) {
  csOut = "";
  char* pOut = csOut.SetLength(lLength);
  if (!pOut) return;
  for (const char* pEnd = p + lLength; p < pEnd;) {
    if (range::bStarts(range::SkipBlanks(p, pEnd), pEnd, "//")) p = range::LineEnd(p, pEnd);
    bool bQuoted = false;
    for (const char* pLine = p; p < pEnd && *p != '\n'; p++) {
      if (*p == '"' && (p == pLine || p[-1] != '\\')) bQuoted = !bQuoted;
      if (*p != '\r') *pOut++ = (*p == '\t' && !bQuoted) || !*p ? ' ' : *p;
    }
    if (p < pEnd) *pOut++ = *p++;
  }
  csOut.SetLength(pOut - csOut.Ptr());
}

bool bLineIs(const char* pLine, const char* pLineEnd, const char* szWord) {
  pLine = range::SkipBlanks(pLine, pLineEnd);
  pLineEnd = range::TrimEnd(pLine, pLineEnd);
  return static_cast<size_t>(pLineEnd - pLine) == strlen(szWord) && range::bStarts(pLine, pLineEnd, szWord);
}

// The first line that consists of the word, or null.
const char* FindLine(const char* p, const char* pEnd, const char* szWord) {
  for (; p < pEnd; p = range::NextLine(p, pEnd))
    if (bLineIs(p, range::LineEnd(p, pEnd), szWord)) return p;
  return nullptr;
}

// A backslash before any other character stays and takes that character with it: deliberate.
void AppendUnescaped(const char* p, const char* pEnd, CNString& csOut) {
  static const char ESCAPES[] = "n\nr\rt\t\"\"";
  CNString csPiece;
  csPiece.Copy(p, pEnd - p);
  char* pOut = csPiece.Ptr();
  for (; p < pEnd; p++) {
    *pOut = *p;
    if (*p == '\\' && p + 1 < pEnd) {
      p++;
      for (const char* pEscape = ESCAPES; *pEscape; pEscape += 2)
        if (*p == *pEscape) *pOut = pEscape[1];
    }
    pOut++;
  }
  csOut.Concat(csPiece.Ptr(), pOut - csPiece.Ptr());
}

// Reads the quoted text at or after p, and those that '>' continues it with. Null when a quote is missing.
const char* pReadValue(const char* p, const char* pEnd, CNString& csValue) {
  for (csValue = "";;) {
    const char* pLineEnd = range::LineEnd(p, pEnd);
    const char* pOpen = range::FindChar(p, pLineEnd, '"');
    const char* pClose = pOpen ? range::FindClosingQuote(pOpen + 1, pLineEnd) : nullptr;
    if (!pClose) return nullptr;
    AppendUnescaped(pOpen + 1, pClose, csValue);
    p = range::SkipSpace(pClose + 1, pEnd);
    if (p >= pEnd || *p != '>') return pClose + 1;
    p++;
  }
}

}  // namespace

int COrbitWizard::iLoadMainList(const char* szFileName) {
  m_Dialogs.RemoveAll();
  m_pDialogNumbers = std::make_unique<CNVariables>();
  m_pWizDialogInfo = nullptr;
  m_pShownDialog = nullptr;
  if (!szFileName || !*szFileName)
    return iLogReturn(
        PRECONDITIONS_NOT_VALID,
        "ERROR: COrbitWizard::iLoadMainList -> !szFileName | !*szFileName -> return PRECONDITIONS_NOT_VALID");
  // An argument without the word is deliberately a file's name, even when it is meant as text.
  if (strstr(szFileName, "DIALOG")) {
    m_csFileName.Free();
    CleanScript(szFileName, static_cast<long>(strlen(szFileName)), m_csScript);
  } else {
    CNString csText;
    if (const int iResult = iReadScriptFile(szFileName, csText)) return iResult;
    m_csFileName = szFileName;
    CleanScript(csText.Text(), csText.Length(), m_csScript);
  }
  m_Report.Setup(m_csScript.Text(), m_csFileName.Ptr());
  const char* pText = m_csScript.Text();
  const char* pEnd = pText + m_csScript.Length();
  if (const int iResult = iLoadVariables(&pText, pEnd)) return iResult;
  m_iCurrentDialog = m_iNextDialog = 1;
  m_iNumLastDialog = 0;
  if (const int iResult = iLoadDialogs(pText, pEnd)) return iResult;
  if (m_Dialogs.Size() == 0)
    return iLogReturn(SYNTAX_ERROR, "ERROR: COrbitWizard::iLoadMainList -> !m_Dialogs.Size() -> return SYNTAX_ERROR");
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iReadScriptFile(const char* szFileName, CNString& csText) {
  CNFile file;
  csText = "";
  if (file.Open(szFileName, "r") && (file.lSize() == 0 || file.lRead(csText) >= 0)) return EVERYTHING_IS_OK;
  CNString csMessage;
  csMessage.Printf("COrbitWizard::iLoadMainList", "csMessage", "Error - could not open file! (%s)", szFileName);
  m_View.iShowMessage({csMessage.Text(), "Error", MessageIcon::Exclamation, MessageButtons::Ok, false});
  return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iLoadMainList -> !file.Open (%s) -> return FUNCTION_ERROR",
                    szFileName);
}

// Reads the block of variables, if there is one, and moves the text's start behind it.
int COrbitWizard::iLoadVariables(const char** ppText, const char* pEnd) {
  const char* pBegin = FindLine(*ppText, pEnd, "INIT");
  const char* pEndInit = FindLine(*ppText, pEnd, "END_INIT");
  if (!pBegin && !pEndInit) return EVERYTHING_IS_OK;
  if (!pBegin || !pEndInit || pEndInit < pBegin) {
    m_View.iShowMessage({"missing INIT or END_INIT", "Syntax Error", MessageIcon::None, MessageButtons::Ok, false});
    return iLogReturn(FUNCTION_ERROR,
                      "ERROR: COrbitWizard::iLoadMainList -> !ptrBeginInit || !ptrEndInit -> return FUNCTION_ERROR");
  }
  *ppText = range::NextLine(pEndInit, pEnd);
  pBegin = range::NextLine(pBegin, pEndInit);
  const int iResult = iCheckVariableLines(pBegin, pEndInit);
  return iResult ? iResult : iStoreVariables(pBegin, pEndInit);
}

int COrbitWizard::iCheckVariableLines(const char* pText, const char* pEnd) {
  for (; pText < pEnd; pText = range::NextLine(pText, pEnd)) {
    const char* pLineEnd = range::TrimEnd(pText, range::LineEnd(pText, pEnd));
    if (pLineEnd == pText || pLineEnd[-1] == '"') continue;
    m_Report.iReport(FAULT_QUOTE, pText);
    return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iLoadMainList -> return FUNCTION_ERROR");
  }
  return EVERYTHING_IS_OK;
}

int COrbitWizard::iStoreVariables(const char* pText, const char* pEnd) {
  CNString csName, csValue;
  while ((pText = range::SkipSpace(pText, pEnd)) < pEnd) {
    const char* pLineEnd = range::LineEnd(pText, pEnd);
    const char* pEquals = range::FindChar(pText, pLineEnd, '=');
    if (!pEquals) {
      m_Report.iReport(FAULT_MISSING_WORD, pText, "=");
      pText = pLineEnd;
      continue;
    }
    const char* pNext = pReadValue(pEquals + 1, pEnd, csValue);
    if (!pNext) {
      m_Report.iReport(FAULT_QUOTE, pText);
      return iLogReturn(FUNCTION_ERROR, "ERROR: COrbitWizard::iLoadMainList -> return FUNCTION_ERROR");
    }
    csName.Copy(pText, range::TrimEnd(pText, pEquals) - pText);
    iSetVariable(csName.Text(), csValue.Text());
    pText = range::LineEnd(pNext, pEnd);
  }
  return EVERYTHING_IS_OK;
}

// The numbers behind DIALOG and END_DIALOG are deliberately not looked at.
int COrbitWizard::iLoadDialogs(const char* pText, const char* pEnd) {
  for (;;) {
    const char* pEndDialog = range::FindText(pText, pEnd, "END_DIALOG");
    const char* pDialog = range::FindText(pText, pEnd, "DIALOG");
    if (!pDialog) return EVERYTHING_IS_OK;
    if (!pEndDialog || pDialog > pEndDialog)
      return iFatal("END_DIALOG and DIALOG mismatch in dialog number %d.\nProgram will exit.", m_Dialogs.Size());
    m_Dialogs.Add(new DialogInfo, 1);
    if (iLoadMainListBuffer(pDialog) == SYNTAX_ERROR) return SYNTAX_ERROR;
    const int iSearchOn = 11;  // past END_DIALOG and its first digit
    pText = pEnd - pEndDialog > iSearchOn ? pEndDialog + iSearchOn : pEnd;
  }
}

// A fault that no reading can go on from. The number is deliberately two above the last good dialog's.
int COrbitWizard::iFatal(const char* szFormat, int iDialogs) {
  CNString csMessage, csNumber;
  csNumber.Printf("COrbitWizard::iFatal", "csNumber", "%d", iDialogs + 2);
  csMessage = szFormat;
  csMessage.SubstituteAll("COrbitWizard::iFatal", "csMessage", "%d", csNumber.Text());
  m_View.iShowMessage({csMessage.Text(), "Critcal Error!", MessageIcon::None, MessageButtons::Ok, false});
  csMessage.SubstituteAll("COrbitWizard::iFatal", "csMessage", "\n", " ");
  LogPrintf("ERROR: COrbitWizard::iLoadMainList -> %s -> return SYNTAX_ERROR", csMessage.Text());
  EndProcess(1);
  return SYNTAX_ERROR;
}

int COrbitWizard::iLoadMainListBuffer(const char* szBuffer) {
  if (!szBuffer)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iLoadMainListBuffer -> !szBuffer -> return PRECONDITIONS_NOT_VALID");
  DialogInfo* pDialog = m_Dialogs[m_Dialogs.Size() - 1];
  if (!pDialog)
    return iLogReturn(PRECONDITIONS_NOT_VALID,
                      "ERROR: COrbitWizard::iLoadMainListBuffer -> !pDialog -> return PRECONDITIONS_NOT_VALID");
  const uintptr_t offset = reinterpret_cast<uintptr_t>(szBuffer) - reinterpret_cast<uintptr_t>(m_csScript.Text());
  const bool bForeign = offset > static_cast<uintptr_t>(m_csScript.Length());
  CNString csForeign;
  if (bForeign) {
    CleanScript(szBuffer, static_cast<long>(strlen(szBuffer)), csForeign);
    m_Report.Setup(csForeign.Text(), nullptr);
  }
  const char* pText = bForeign ? csForeign.Text() : szBuffer;
  const char* pEnd = bForeign ? pText + csForeign.Length() : m_csScript.Text() + m_csScript.Length();
  const char* pEndDialog = range::FindText(pText, pEnd, "END_DIALOG");
  const int iResult = iReadDialog(*pDialog, pText, pEndDialog ? pEndDialog + strlen("END_DIALOG") : pEnd);
  if (bForeign) m_Report.Setup(m_csScript.Text(), m_csFileName.Ptr());
  return iResult;
}

bool COrbitWizard::iGetDialogNumberByName(const char* szName, int* pNumber) const {
  const CNVariable* pRecord = m_pDialogNumbers ? m_pDialogNumbers->pFind(szName) : nullptr;
  const int iNumber = pRecord ? atoi(pRecord->csValue.Text()) : 0;
  const DialogInfo* pDialog = GetDialog(iNumber);
  // A block that was read again may have another name by now.
  if (!pDialog || !*szName || strcmp(pDialog->m_csName.Text(), szName) != 0) return false;
  if (pNumber) *pNumber = iNumber;
  return true;
}
