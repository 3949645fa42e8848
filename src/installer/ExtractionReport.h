// What the page and the final message show of an extraction. No window and no wizard needed.
#pragma once

#include "foundation/CNString.h"

// What the page shows of an entry's name: a name of 46 characters or more is cut to ".." and the text from the first
// '/' among its last 45 characters on; without a '/' there it stays whole.
void MakeFileLabel(const char* szName, CNString& csLabel);
// The percentage at which entry iEntry (from 0) of iEntries begins; 100 without entries.
int iEntryPercent(int iEntry, int iEntries);

// The names of the archive entries that could not be installed, for one message at the end.
class FailedFiles {
 public:
  static const int MAX_SHOWN = 10;

  void Add(const char* szName);
  int Count() const { return m_iCount; }
  // One name a line, the first ten, and "... and N more".
  void MakeText(CNString& csText) const;

 private:
  int m_iCount = 0;
  CNString m_csNames;
};
