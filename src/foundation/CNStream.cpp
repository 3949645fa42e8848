#include "foundation/CNStream.h"

CNStream::CNStream() : m_csLine(-1), m_szSeparator("\n"), m_bTrim(1) {}

int CNStream::iReset() {
  m_bTrim = 0;
  m_szSeparator = nullptr;
  return 0;
}

long CNStream::Printf(const char* szFunction, const char* szVariable, const char* szFormat, ...) {
  va_list args;
  va_start(args, szFormat);
  const long lWritten = vPrintf(szFunction, szVariable, szFormat, args);
  va_end(args);
  return lWritten;
}

long CNStream::vPrintf(const char* szFunction, const char* szVariable, const char* szFormat, va_list args) {
  if (!szFormat || !*szFormat)
    return iLogReturn(-1, "ERROR: CNStream::Printf -> !format || !*format -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  CNString csText;
  if (!csText.vPrintf(szFunction, szVariable, szFormat, args)) return -1;
  if (csText.bEmpty()) return 0;
  const long lNumBytesPrinted = Write(szFunction, szVariable, csText.Ptr(), csText.Length());
  if (lNumBytesPrinted == -1)
    return iLogReturn(-1,
                      "ERROR: CNStream::Printf -> lNumBytesPrinted==-1 -> return -1 -> szFunction=%s, szVariable=%s",
                      szFunction, szVariable);
  return lNumBytesPrinted;
}

const char* CNStream::KeepLine(const char* pLine, long lLength) {
  if (m_csLine.Copy(pLine, lLength) && m_bTrim) m_csLine.TrimRight();
  return m_csLine.Ptr();
}
