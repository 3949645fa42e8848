#include "installer/ExtractionReport.h"

#include <cstdint>
#include <cstring>

void MakeFileLabel(const char* szName, CNString& csLabel) {
  const size_t SHOWN = 45;
  const size_t nLength = strlen(szName);
  const char* pSlash = nLength > SHOWN ? strchr(szName + nLength - SHOWN, '/') : nullptr;
  csLabel = pSlash ? ".." : szName;
  if (pSlash) csLabel.Concat(pSlash);
}

int iEntryPercent(int iEntry, int iEntries) {
  return iEntries > 0 ? static_cast<int>(int64_t{iEntry} * 100 / iEntries) : 100;
}

void FailedFiles::Add(const char* szName) {
  if (m_iCount++ >= MAX_SHOWN) return;
  CNString csName = szName && *szName ? CNString(szName, 0) : CNString("?", 0);
  // The text is searched for variable markers when it is shown; a name must not look like one.
  for (char* p = csName.Ptr(); p && *p; p++)
    if (*p == '<' || static_cast<unsigned char>(*p) < ' ') *p = '?';
  if (!m_csNames.bEmpty()) m_csNames.Concat("\n");
  m_csNames.Concat(csName.Text());
}

void FailedFiles::MakeText(CNString& csText) const {
  csText = m_csNames.Text();
  if (m_iCount <= MAX_SHOWN) return;
  CNString csMore;
  csMore.Printf("FailedFiles::MakeText", "csMore", "\n... and %d more", m_iCount - MAX_SHOWN);
  csText.Concat(csMore.Text());
}
