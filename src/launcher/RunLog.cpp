#include "launcher/RunLog.h"

#include <windows.h>

#include <cstdarg>
#include <memory>
#include <new>

#include "foundation/Text.h"

void RunLog::Line(const char* szFormat, ...) {
  if (!bIsOpen()) return;
  CNString csText, csUtf8;
  va_list args;
  va_start(args, szFormat);
  csText.vPrintf("RunLog::Line", "csText", szFormat, args);
  va_end(args);
  Cp1250ToUtf8(csText.Text(), csUtf8);
  Write(csUtf8);
}

void RunLog::WideLine(const char* szText, const wchar_t* pWide) {
  if (!bIsOpen()) return;
  CNString csUtf8;
  Cp1250ToUtf8(szText, csUtf8);
  const int iSize = WideCharToMultiByte(CP_UTF8, 0, pWide, -1, nullptr, 0, nullptr, nullptr);
  const std::unique_ptr<char[]> pText(iSize > 0 ? new (std::nothrow) char[static_cast<size_t>(iSize)] : nullptr);
  if (pText) WideCharToMultiByte(CP_UTF8, 0, pWide, -1, pText.get(), iSize, nullptr, nullptr);
  if (pText) csUtf8.Concat(pText.get());
  Write(csUtf8);
}

// In one call to the system: a run that is killed leaves whole lines.
void RunLog::Write(CNString& csUtf8) {
  SYSTEMTIME now;
  CNString csLine;
  GetLocalTime(&now);
  csUtf8.SubstituteAll("RunLog::Write", "csUtf8", "\r\n", " | ");
  csUtf8.SubstituteAll("RunLog::Write", "csUtf8", "\n", " | ");
  csLine.Printf("RunLog::Write", "csLine", "%04d-%02d-%02d %02d:%02d:%02d.%03d ", now.wYear, now.wMonth, now.wDay,
                now.wHour, now.wMinute, now.wSecond, now.wMilliseconds);
  csLine.Concat(csUtf8.Text());
  csLine.Concat("\r\n");
  CNSemHold hold(m_Lock);
  m_File.bWrite(csLine.Text(), static_cast<size_t>(csLine.Length()));
}
