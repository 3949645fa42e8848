// Small helpers that several commands share. Texts are code page 1250. Any thread.
#pragma once

#include <cstdint>

#include "foundation/ResultCodes.h"
#include "installer/InstallJournal.h"

// The end of a command that did its work: stores the answer, returns EVERYTHING_IS_OK.
inline int iAnswer(int* pCommandResult, CommandResult result) {
  *pCommandResult = result;
  return EVERYTHING_IS_OK;
}

// The three texts one after the other.
CNString Joined(const char* szA, const char* szB, const char* szC = "");

// The pieces of a text between separators (one character, or one of several), without blanks at their ends; empty
// pieces are left out.
class TextList {
 public:
  explicit TextList(const char* szText, const char* szSeparators = ";");
  int Size() const { return m_Pieces.Size(); }
  const char* operator[](int i) const { return m_Pieces[i]; }
  // Letters match without regard to case.
  bool bHas(const char* szPiece) const;

 private:
  CNCharArray m_Pieces;
};

// szText, or szDefault for an empty one.
inline const char* szOr(const char* szText, const char* szDefault) { return *szText ? szText : szDefault; }

// Writes a file of the destination (szFolder has no trailing backslash) and enters it in the list of what was
// installed: it goes with the product. False, the file perhaps half written, when the disk or the list refuses.
bool bWriteListed(const char* szFolder, const char* szName, const CNString& csText);
// After a file was written: tells the journal what it is like as a whole.
void NoteWhole(InstallJournal& journal, const char* szFile);

// True when szPath is szFolder (without a trailing backslash) or lies below it, going by the names.
bool bIsBelow(const char* szPath, const char* szFolder);
// True for a path with a drive or a server: nothing is looked for in the current folder.
bool bIsFullPath(const char* szPath);
// The bytes of all files below szFolder whose names match the pattern; links are not followed.
uint64_t FolderBytes(const char* szFolder, const char* szPattern);
