// Plain text files as wide text: UTF-8 and UTF-16 by their marks, UTF-8 also without one, else code page 1250.
#pragma once

#include <windows.h>

#include "foundation/CNString.h"

// Owned wide text, as the system's heap gives it. Null when reading failed.
class WideText {
 public:
  WideText() = default;
  ~WideText() { HeapFree(GetProcessHeap(), 0, m_pText); }
  WideText(const WideText&) = delete;
  WideText& operator=(const WideText&) = delete;

  // Room for nLength characters and the terminator, all zero. False without memory.
  bool bAllocate(size_t nLength);
  wchar_t* Ptr() { return m_pText; }
  size_t Length() const { return m_nLength; }

 private:
  wchar_t* m_pText = nullptr;
  size_t m_nLength = 0;
};

const long MAX_TEXT_FILE = 16 * 1024 * 1024;

enum class TextFileResult { Read, CannotOpen, TooLong, NoMemory };

// Reads szPath and makes every line end CR LF and every zero character a blank, as an edit control needs it.
TextFileResult ReadTextFile(const wchar_t* szPath, WideText& text);
