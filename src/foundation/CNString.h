// The system's owned, growable string of 8-bit characters (code page 1250). A null text (no string at all) is distinct
// from an empty one. No operation throws: a missing text or argument and a failed allocation write one diagnostic line
// and return null, 0 or -1, and the text stays as it was unless the operation says otherwise. Not synchronised.
#pragma once

#include <cstdarg>
#include <cstddef>

#include "foundation/Log.h"

class CNString {
 public:
  explicit CNString(int iMode = 0) : m_iMode(iMode) {}
  CNString(const char* szText, int iMode);
  // Copies up to the first zero byte (assignment copies all Length() bytes).
  CNString(const CNString& csOther);
  CNString(CNString&& csOther) noexcept;
  ~CNString() { Free(); }

  // The text up to its terminator is copied; null gives a null string. The mode becomes -1.
  CNString& operator=(const char* szText);
  CNString& operator=(const CNString& csOther);
  CNString& operator=(CNString&& csOther) noexcept;

  // Releases the text; the string is null afterwards, its mode unchanged.
  void Free();

  // The text itself, null when there is none. Two zero bytes always follow it. Valid until the next change.
  char* Ptr() { return m_szString; }
  const char* Ptr() const { return m_szString; }
  // The text, or "" when there is none: for printing and comparing.
  const char* Text() const { return m_szString ? m_szString : ""; }
  // Length in bytes; may count embedded zeros after Copy and the counted Concat.
  long Length() const { return m_lLength; }
  bool bEmpty() const { return m_lLength == 0; }
  // Stores the mode (1: searched as 16-bit characters by Has) and returns 0.
  int iGetMode(int* pMode) const;

  // Append; null adds nothing. The counted form appends exactly lCount bytes. Return the new text.
  char* Concat(const char* szText);
  char* Concat(const char* pBytes, long lCount);
  // Replaces the text by exactly lCount bytes. A failed allocation leaves a null text.
  char* Copy(const char* pBytes, long lCount);
  // Inserts before byte iAt (0 to Length()). Returns 1, also for an empty text, or 0.
  int iInsert(const char* szText, int iAt);
  // Replaces every occurrence from left to right, without rescanning what was put in. An empty str is refused.
  char* SubstituteAll(const char* szFunction, const char* szVariable, const char* str, const char* newstr);
  // Cuts the text at the last occurrence of c; position 0 is deliberately never examined, so a text without c after its
  // first byte becomes empty. This is how the folder part of a path is taken.
  char* Trim(char c);
  // Removes trailing carriage returns and line feeds, and only those.
  char* TrimRight();
  // Makes a non-empty text end in exactly one backslash; a final '/' is turned into it. An empty text becomes "\".
  char* AddSlash();
  // Grows (zero-filled) or cuts the text to lLength bytes.
  char* SetLength(long lLength);
  // Lower-cases 'A' to 'Z' of szText in place, or of this text when szText is null. Returns this text.
  char* MakeLower(char* szText = nullptr);
  // Replace the text by the formatted result, of any length. A null format (and for Printf an empty one) changes
  // nothing.
  char* vPrintf(const char* szFunction, const char* szVariable, const char* szFormat, va_list args);
  char* Printf(const char* szFunction, const char* szVariable, const char* szFormat, ...) ORBIT_PRINTF(4, 5);

  int Has(char c) const;
  int Has(const char* szText) const;
  long Find(const char* szText) const;
  // First occurrence without regard to ASCII letter case, null when there is none. With bWholeWord no letter of code
  // page 1250 may stand right before or after it; digits and the underscore are not letters.
  const char* IHas(const char* szSubStr, bool bWholeWord) const;
  int EndsWith(const char* szText) const;
  int IsEqual(const char* szText) const;

 private:
  char* Resize(long lLength);
  char* Cut(long lLength);
  bool bOwns(const char* p) const;

  char* m_szString = nullptr;
  long m_lLength = 0;
  int m_iMode = 0;
};

// True for the letters of code page 1250 (not for digits, the underscore and byte 0).
bool IsLetter(unsigned char c);
