#include "controls/ScriptReport.h"

#include <algorithm>
#include <cstring>
#include <iterator>

#include "foundation/Log.h"

namespace {

// In the order of the fault codes.
const char* const g_faultTexts[] = {
    "nedostaje apostrof!",
    "nedostaje navodnik!",
    "nedostaje dvotocka!",
    "nedostaje zagrada!",
    "pogresan ID, ili verzija Bafunpraik ne podrzava taj ID",
    "nedostaje zarez!",
    "nedostaje %s!",
    "nedostaje %s!",
    "neocekivan kraj skripte!",
};
static_assert(std::size(g_faultTexts) == FAULT_END_OF_SCRIPT + 1, "one text for each fault code");

}  // namespace

void ScriptReport::Setup(const char* szBuffer, const char* szFileName) {
  if (!szBuffer) LogPrintf("ERROR: BaseControl::SetupForErrorReport -> !szBuffer -> return PRECONDITIONS_NOT_VALID");
  m_szScript = szBuffer;
  m_nScriptSize = szBuffer ? std::strlen(szBuffer) : 0;
  m_csFileName = szFileName;
  m_nCounted = 0;
  m_iCountedLine = 1;
  m_pLastPosition = nullptr;
}

// 0 when the position is not known.
int ScriptReport::iLine(const char* pPosition) {
  if (!m_szScript || !pPosition) return 0;
  const size_t nOffset = size_t(pPosition) - size_t(m_szScript);
  if (nOffset > m_nScriptSize) return 0;
  // A block's missing end is reported behind faults that follow it.
  const auto [nFrom, nTo] = std::minmax(nOffset, m_nCounted);
  const int nLines = int(std::count(m_szScript + nFrom, m_szScript + nTo, '\n'));
  m_iCountedLine += nOffset < m_nCounted ? -nLines : nLines;
  m_nCounted = nOffset;
  return m_iCountedLine;
}

int ScriptReport::iReport(int iFault, const char* pPosition, const char* szWord) {
  const bool bRepeated = pPosition && pPosition == m_pLastPosition && iFault == m_iLastFault;
  m_pLastPosition = pPosition;
  m_iLastFault = iFault;
  if (bRepeated) return 0;

  CNString csText;
  if (iFault < 0 || iFault >= int(std::size(g_faultTexts))) {
    csText = "Greska je nedefinirana!";
  } else {
    const int iAtLine = iLine(pPosition);
    CNString csPart;
    csText = "U ";
    if (!m_csFileName.bEmpty())
      csText.Concat(csPart.Printf("ScriptReport::iReport", "csPart", "datoteci %s,", m_csFileName.Text()));
    if (iAtLine > 0) csText.Concat(csPart.Printf("ScriptReport::iReport", "csPart", " u liniji %d,", iAtLine));
    if (iFault == FAULT_MISSING_WORD || iFault == FAULT_MISSING_WORD_ALSO)
      csText.Concat(csPart.Printf("ScriptReport::iReport", "csPart", "nedostaje %s!", szWord ? szWord : ""));
    else
      csText.Concat(g_faultTexts[iFault]);
  }
  Show(csText.Text(), "syntax error");
  return 0;
}

void ScriptReport::Show(const char* szText, const char* szCaption, MessageIcon icon) {
  m_iFaults++;
  if (m_pSink) m_pSink->iShowMessage({szText, szCaption, icon, MessageButtons::Ok, false});
}
