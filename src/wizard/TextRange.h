// Searches in a piece of text that need not end in a zero: [p, pEnd). Nothing here reads pEnd or beyond.
#pragma once

#include <cstring>

#include "controls/ScriptText.h"

namespace range {

using ScriptText::FindChar;
using ScriptText::FindClosingQuote;
using ScriptText::FindText;
using ScriptText::FindWord;
using ScriptText::SkipBlanks;
using ScriptText::SkipSpace;

inline bool bStarts(const char* p, const char* pEnd, const char* szText) {
  return ScriptText::bStartsWith(p, pEnd, szText);
}

// As bStarts, and no letter, digit or underscore follows.
inline bool bStartsWord(const char* p, const char* pEnd, const char* szWord) {
  if (!bStarts(p, pEnd, szWord)) return false;
  p += strlen(szWord);
  return p == pEnd || !(IsLetter(static_cast<unsigned char>(*p)) || ScriptText::bIsDigit(*p) || *p == '_');
}

// The end without trailing blanks and line ends.
inline const char* TrimEnd(const char* p, const char* pEnd) {
  while (pEnd > p && strchr(" \t\r\n", pEnd[-1])) pEnd--;
  return pEnd;
}

// The line feed that ends the line, or the end of the text.
inline const char* LineEnd(const char* p, const char* pEnd) {
  const char* pFeed = FindChar(p, pEnd, '\n');
  return pFeed ? pFeed : pEnd;
}

// The start of the following line, or the end of the text.
inline const char* NextLine(const char* p, const char* pEnd) {
  p = LineEnd(p, pEnd);
  return p < pEnd ? p + 1 : p;
}

// The ')' that closes the '(' at p, counting nested ones and passing over double-quoted text; null without.
inline const char* ClosingParenthesis(const char* p, const char* pEnd) {
  int iDepth = 0;
  for (bool bQuoted = false; p < pEnd; p++) {
    if (*p == '"') bQuoted = !bQuoted;
    if (bQuoted) continue;
    if (*p == '(') iDepth++;
    if (*p == ')' && --iDepth == 0) return p;
  }
  return nullptr;
}

}  // namespace range
