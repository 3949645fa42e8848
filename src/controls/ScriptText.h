// Reading pieces of a script's text: everything works on ranges [p, pEnd) that need no terminator and are never
// changed, so that whatever a file holds cannot lead a reader beyond the text. "Blank" means a space or a tab.
#pragma once

#include "foundation/CNString.h"

namespace ScriptText {

// Sizes, margins and the like are cut off here: larger than any screen, small enough that sums of scaled ones fit an
// int.
const int NUMBER_LIMIT = 100000000;
// Blocks of one kind within each other. Looking for the end of one gives up beyond that, so that a script of many
// blocks without an end does not have each of them searched to the end of the text.
const int NESTING_LIMIT = 50;

bool bIsDigit(char c);
const char* SkipBlanks(const char* p, const char* pEnd);
// Blanks and line feeds.
const char* SkipSpace(const char* p, const char* pEnd);
// To the first blank, comma, quote or apostrophe.
const char* SkipWord(const char* p, const char* pEnd);
bool bStartsWith(const char* p, const char* pEnd, const char* szText, size_t nLength);
bool bStartsWith(const char* p, const char* pEnd, const char* szText);
// The same, when no longer word begins there.
bool bStartsWithWord(const char* p, const char* pEnd, const char* szWord);
// The first occurrence, or null.
const char* FindChar(const char* p, const char* pEnd, char c);
const char* FindText(const char* p, const char* pEnd, const char* szText);
// The first occurrence that is no part of a longer word: no letter or underscore before it, and none nor a digit after
// it.
const char* FindWord(const char* p, const char* pEnd, const char* szWord);
// The first double quote that no backslash precedes, or null. p stands behind the opening one.
const char* FindClosingQuote(const char* p, const char* pEnd);
// Reads the digits at p, at most NUMBER_LIMIT, and moves p behind them.
int iReadNumber(const char*& p, const char* pEnd);
// The first line after the one that ends at pLineEnd that begins with szEndWord, or null. Lines that begin with
// szKeyword are blocks inside when bNests (null beyond NESTING_LIMIT), else they prove that the end word was forgotten.
const char* FindEndLine(const char* pLineEnd, const char* pEnd, const char* szKeyword, const char* szEndWord,
                        bool bNests);

// Turns \" \n \r into characters; any other backslash stays.
void Unescape(const char* p, const char* pEnd, CNString& csOut);
void AppendEscaped(CNString& csOut, const char* szText, size_t nLength);
// csOut becomes the range without blanks at its ends.
void CopyTrimmed(const char* p, const char* pEnd, CNString& csOut);
// csOut becomes the range without blanks and commas at its ends.
void CopyFlagList(const char* p, const char* pEnd, CNString& csOut);
// A number of a script in pixels of a screen with dFactor times 96 dots per inch, truncated.
int iScaleSize(int iNumber, double dFactor);

}  // namespace ScriptText
