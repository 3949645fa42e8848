// Windows only: code page 1250 texts as arguments of wide system calls, and their answers back.
#pragma once

#include "foundation/Text.h"

// For one call: RegOpenKeyExW(key, Wide(szSubkey), ...). The pointer lives until the end of the full expression.
class Wide {
 public:
  explicit Wide(const char* szText) : m_text(szText) {}
  operator const wchar_t*() const { return reinterpret_cast<const wchar_t*>(m_text.Ptr()); }

 private:
  CNWideText m_text;
};

// As Wide, for a path in a file call: one that is longer than the system's usual limit is given in the form without it.
class WidePath {
 public:
  explicit WidePath(const char* szPath);
  ~WidePath();
  WidePath(const WidePath&) = delete;
  WidePath& operator=(const WidePath&) = delete;

  operator const wchar_t*() const { return m_pLong ? m_pLong : static_cast<const wchar_t*>(m_path); }

 private:
  Wide m_path;
  wchar_t* m_pLong = nullptr;
};

inline bool bNarrow(const wchar_t* pText, CNString& csOut) {
  return bUtf16ToCp1250(reinterpret_cast<const char16_t*>(pText), csOut);
}

// A path that came from the system, as code page 1250; one that it cannot hold travels as its short (8.3) name. False
// when the file system has no short name for it either.
bool bNarrowPath(const wchar_t* pPath, CNString& csOut);
