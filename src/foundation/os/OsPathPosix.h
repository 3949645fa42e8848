// A code page 1250 path as this system's own: UTF-8 with '/' as its separator. Internal to this folder.
#pragma once

#include "foundation/Text.h"

class PosixPath {
 public:
  explicit PosixPath(const char* szPath) {
    Cp1250ToUtf8(szPath ? szPath : "", m_csPath);
    for (char* p = m_csPath.Ptr(); p && *p; p++)
      if (*p == '\\') *p = '/';
    // A final separator would make the system follow a link.
    while (m_csPath.Length() > 1 && m_csPath.EndsWith("/")) m_csPath.SetLength(m_csPath.Length() - 1);
  }
  operator const char*() const { return m_csPath.Text(); }

 private:
  CNString m_csPath;
};
