// The log of one run of setup: UTF-8 without a byte-order mark, one line for each event, with the local time.
#pragma once

#include "foundation/CNSem.h"
#include "foundation/os/Os.h"

class RunLog {
 public:
  // Lines are added to the end of an existing file. False when it cannot be opened.
  bool bOpen(const char* szPath) { return m_File.bOpen(szPath, OsOpenMode::Append); }
  bool bIsOpen() const { return m_File.bIsOpen(); }
  // Nothing without an open file. Line feeds in the text become " | ". Any thread.
  void Line(const char* szFormat, ...) ORBIT_PRINTF(2, 3);
  // The text, with one of the system's behind it as it is.
  void WideLine(const char* szText, const wchar_t* pWide);

 private:
  void Write(CNString& csUtf8);

  OsFile m_File;
  CNSem m_Lock;
};
