// The text boundary. Inside, text is 8-bit code page 1250 whatever the system's own code page; these helpers, with a
// table of their own, convert where text meets the system (UTF-16 on Windows, UTF-8 elsewhere) or an author (UTF-8).
#pragma once

#include "foundation/CNString.h"

// A zero-terminated UTF-16 copy of a code page 1250 text, for one system call. Null text gives a null pointer.
class CNWideText {
 public:
  explicit CNWideText(const char* szText);
  ~CNWideText();
  CNWideText(const CNWideText&) = delete;
  CNWideText& operator=(const CNWideText&) = delete;

  const char16_t* Ptr() const { return m_pText; }

 private:
  char16_t* m_pText = nullptr;
};

// Convert a zero-terminated text into csOut. Return false when some character has no place in code page 1250 (or the
// UTF-8 is malformed); csOut then holds '?' in its place.
bool bUtf16ToCp1250(const char16_t* pText, CNString& csOut);
bool bUtf8ToCp1250(const char* szText, CNString& csOut);
// Never fails: every byte of code page 1250 has a character (the five unassigned bytes map to their C1 control code).
void Cp1250ToUtf8(const char* szText, CNString& csOut);
